// Finishing more than once, as a window run does when the user goes back
// from the summary and enters it again.

#include "FinalizeSupport.h"
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <gtest/gtest.h>

namespace {

// A wizard run on a fixture, driven step by step.
struct Session {
    Qvz_WizData data;
    Qvz_MGTWizMain main{"Velomux Wizard", false};

    explicit Session(const char* fixture, std::initializer_list<const char*> settings = {}) {
        QString error;
        const bool loaded =
            Qvz_DesignJson::LoadFile(TestData(QString("finish/") + fixture), data, error);
        EXPECT_TRUE(loaded) << error.toStdString();
        for (const char* setting : settings)
            for (const auto& kv : Pairs(setting))
                data.GetActiveBlock()->SetAttributeValue(kv.first.c_str(), kv.second.c_str());
        main.SetWizData(&data);
        main.SetRunMode(Qvz_RunMode::Batch);
    }

    // Every page's batch step, then the finish: the design data as the
    // summary page first shows it.
    void ToSummary() { ASSERT_EQ(main.Run(), Qvz_RunCompleted) << Messages(); }
    // The same, with settings changed after the pages wrote and before the
    // one finish: as if the pages had written them.
    void ToSummaryWith(const char* settings) {
        main.Prepare();
        for (int i = 0; i < Qvz_WizMain::kMaxPages && main.GetPage(i); ++i)
            ASSERT_TRUE(main.GetPage(i)->DoBatchPage()) << Messages();
        for (const auto& kv : Pairs(settings))
            Master()->SetAttributeValue(kv.first.c_str(), kv.second.c_str());
        ASSERT_TRUE(Enter()) << Messages();
    }
    void Back() { main.LeaveSummary(); }
    bool Enter() { return main.EnterSummary(); }

    Qvz_Block* Master() const { return data.GetActiveBlock(); }
    std::string Of(const char* pin) const { return Describe(data, Master()->GetNamedPin(pin)); }
    std::string Messages() const {
        std::string all;
        for (const auto& m : main.GetMessages())
            all += m.text.str() + "\n";
        return all;
    }
};

std::string PinState(const Qvz_WizData& d, const Qvz_Pin& p) {
    return Describe(d, &p) + " width " + std::to_string(p.GetWidth()) +
           (p.IsUsed() ? " used" : "") + " attributes " + std::to_string(p.GetAttributes().size());
}

void ExpectSamePins(const Qvz_WizData& da, const Qvz_Block* a, const Qvz_WizData& db,
                    const Qvz_Block* b) {
    ASSERT_TRUE(a && b);
    ASSERT_EQ(a->GetPins().size(), b->GetPins().size());
    for (std::size_t i = 0; i < a->GetPins().size(); ++i) {
        const Qvz_Pin& pa = *a->GetPins()[i];
        const Qvz_Pin& pb = *b->GetPins()[i];
        EXPECT_TRUE(pa == pb) << pa.GetName().str() << ": " << PinState(da, pa) << " vs "
                              << PinState(db, pb);
    }
}

} // namespace

TEST(FinishAgain, NothingChangedGivesTheSameDesignData) {
    const struct {
        const char* fixture;
        const char* settings;
    } cases[] = {
        {"gt10_custom.json", ""}, {"gt10_custom.json", "QVZ_CHAN_BOND_NUMBER=4"},
        {"gt11_custom.json", ""}, {"gt11_custom.json", "QVZ_GT11_MODE=DUAL;QVZ_CHAN_BOND_NUMBER=4"},
        {"gt_custom.json", ""},
    };
    for (const auto& c : cases) {
        Session once(c.fixture, {c.settings});
        once.ToSummary();
        Session again(c.fixture, {c.settings});
        again.ToSummary();
        for (int round = 0; round < 2; ++round) {
            again.Back();
            EXPECT_TRUE(again.Enter()) << again.Messages();
        }
        EXPECT_TRUE(again.data == once.data) << c.fixture << " " << c.settings;
        EXPECT_EQ(again.Messages(), once.Messages());
        // Checked piecewise too, for a readable failure.
        ExpectSamePins(again.data, again.Master(), once.data, once.Master());
        EXPECT_EQ(again.data.GetBlocks().size(), once.data.GetBlocks().size());
        EXPECT_EQ(again.data.GetSignals().size(), once.data.GetSignals().size());
    }
}

TEST(FinishAgain, ATiedPinMadeAPortIsNotBoth) {
    // First without an encoder: the 10-bit bus and tied encoder controls.
    Session s("gt_custom.json");
    s.ToSummary();
    EXPECT_EQ(s.Of("TXBYPASS8B10B"), "tie 1");
    EXPECT_EQ(s.Of("TXCHARISK"), "tie 0");
    ASSERT_EQ(s.Of("TXDATA").rfind("maps ", 0), 0u);

    // Back on the transmitter page the user picks dynamic encoding.
    s.Back();
    s.Master()->SetAttributeValue("QVZX_ONLY_ENCODING", "DYNAMIC");
    ASSERT_TRUE(s.Enter());
    EXPECT_EQ(s.Of("TXBYPASS8B10B"), "port TXBYPASS8B10B_IN/2");
    EXPECT_EQ(s.Of("TXCHARISK"), "port TXCHARISK_IN/2");
    EXPECT_EQ(s.Of("TXDATA"), "port TXDATA_IN/16");
    EXPECT_EQ(s.Of("TXCHARDISPVAL"), "port TXCHARDISPVAL_IN/2");
    // What only the first finish needed is no longer in use.
    for (const char* gone : {"TXDATA_GND", "TXCHARDISPVAL_GND", "TXCHARDISPMODE_GND"})
        EXPECT_FALSE(s.data.GetNamedSignal(gone)->IsUsed()) << gone;
    // The receive side did not change.
    EXPECT_TRUE(s.data.GetNamedSignal("RXDATA_float")->IsUsed());

    // The pins are those of a run that had dynamic encoding from the start.
    Session fresh("gt_custom.json");
    fresh.ToSummaryWith("QVZX_ONLY_ENCODING=DYNAMIC");
    ExpectSamePins(s.data, s.Master(), fresh.data, fresh.Master());
}

TEST(FinishAgain, APortMadeATieLosesItsSignal) {
    Session s("gt10_custom.json");
    s.ToSummary();
    EXPECT_EQ(s.Of("TXBYPASS8B10B"), "port TXBYPASS8B10B_IN/4");
    EXPECT_EQ(s.Of("TXDATA"), "port TXDATA_IN/32");

    s.Back();
    s.Master()->SetAttributeValue("QVZX_ONLY_ENCODING", "DISABLE");
    s.Master()->SetAttributeValue("QVZ_BOOL_RX_USE", "FALSE");
    ASSERT_TRUE(s.Enter());
    EXPECT_EQ(s.Of("TXBYPASS8B10B"), "tie 1");
    EXPECT_EQ(s.Of("RXN"), "port RXN_IN/1");
    EXPECT_EQ(s.Of("RXDATA"), "unconnected");
    EXPECT_FALSE(s.data.GetNamedSignal("RXDATA_OUT")->IsUsed());
    EXPECT_FALSE(s.data.GetNamedSignal("TXBYPASS8B10B_IN")->IsUsed());
    // TXDATA is wired bit by bit now, with no whole-pin signal besides.
    EXPECT_EQ(s.Master()->GetNamedPin("TXDATA")->GetSigName(), "");
    EXPECT_TRUE(s.Master()->GetNamedPin("TXDATA")->HasPinSigBitProp());
    EXPECT_EQ(s.data.GetNamedSignal("TXDATA_IN")->GetWidth(), 40);

    Session fresh("gt10_custom.json");
    fresh.ToSummaryWith("QVZX_ONLY_ENCODING=DISABLE;QVZ_BOOL_RX_USE=FALSE");
    ExpectSamePins(s.data, s.Master(), fresh.data, fresh.Master());
}

TEST(FinishAgain, ABlockNoLongerChosenGetsItsPinsBack) {
    Session s("gt11_custom.json");
    const Qvz_Block before(*s.data.GetNamedBlock("GT11_CUSTOM_INST"));
    s.ToSummary();
    s.Back();
    // Back on the first page the user picks the XAUI type.
    s.data.SetAllBlksIsActive(false);
    s.data.GetNamedBlock("GT11_XAUI_INST")->SetIsUsed(true);
    s.Enter();
    EXPECT_EQ(s.Master()->GetPrimitiveName(), "GT11_XAUI");
    const Qvz_Block* custom = s.data.GetNamedBlock("GT11_CUSTOM_INST");
    ASSERT_NE(custom, nullptr);
    EXPECT_FALSE(custom->IsUsed());
    // Its pins are as before the first finish; the tile bus pins are gone.
    ExpectSamePins(s.data, custom, s.data, &before);
}
