// The receiver controller and form, driven offscreen through their slots
// with the real widgets found by object name.

#include "HostRunner.h"
#include "PageGuiSupport.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTRX.h"
#include "Qvz_MGTRXGui.h"
#include "Qvz_MGTRXWidget.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLabel>
#include <QLineEdit>
#include <QMetaMethod>
#include <QRadioButton>
#include <QSpinBox>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace {

const char* kThresholdMessage = "The value of RX_LOS_THRESHOLD must be at least as big as the "
                                "value of RX_LOS_INVLID_INCR.";

// A receiver fixture, its first block's primitive replaced when prim is given.
Qvz_WizData LoadFixture(const char* name, const char* prim = nullptr) {
    QJsonObject doc = ReadJson(TestData(QString("receiver/") + name));
    if (prim) {
        QJsonArray blocks = doc["blocks"].toArray();
        QJsonObject b = blocks[0].toObject();
        b["primitive"] = prim;
        blocks[0] = b;
        doc["blocks"] = blocks;
    }
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::Load(QJsonDocument(doc).toJson(), name, d, err))
        << err.toStdString();
    return d;
}

// A wizard main over data in the given mode, with the messages recorded.
struct Wizard {
    Wizard(Qvz_WizData& data, Qvz_RunMode mode) : main("w", false) {
        main.SetWizData(&data);
        main.SetRunMode(mode);
        main.SetMessageSink(&sink);
        main.SetHelpHandler(&help);
        main.Prepare();
    }
    Qvz_MGTRX* Page() const {
        return static_cast<Qvz_MGTRX*>(main.GetPage(Qvz_MGTWizMain::kReceiver));
    }
    std::vector<std::string> Messages() const {
        std::vector<std::string> out;
        for (const Qvz_Message& m : sink.messages) {
            EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3) << m.text.str();
            out.push_back(m.text.str());
        }
        return out;
    }
    Qvz_RecordingSink sink;
    RecordingHelp help;
    Qvz_MGTWizMain main;
};

// A window run's receiver page with its controller made and activated.
struct RxGui {
    explicit RxGui(Qvz_WizData d, bool activate = true) : data(std::move(d)) {
        TestApp();
        wiz = std::make_unique<Wizard>(data, Qvz_RunMode::Window);
        EXPECT_TRUE(Page()->CreateGuiDlg(&parent));
        gui = Page()->GuiDlg();
        if (activate)
            gui->onActive();
    }
    explicit RxGui(const char* fixture) : RxGui(LoadFixture(fixture)) {}

    Qvz_MGTRX* Page() const { return wiz->Page(); }
    template <class T> T* W(const char* name) {
        T* w = gui->pageWidget()->findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    bool Shown(const char* name) { return W<QWidget>(name)->isVisibleTo(gui->pageWidget()); }
    bool Enabled(const char* name) { return W<QWidget>(name)->isEnabled(); }
    void Check(const char* name, bool on) { W<QAbstractButton>(name)->setChecked(on); }
    void Click(const char* name) { W<QAbstractButton>(name)->click(); }
    void SetText(const char* name, const char* text) { W<QLineEdit>(name)->setText(text); }
    void Choose(const char* combo, const char* text) {
        QComboBox* c = W<QComboBox>(combo);
        const int i = c->findText(text);
        ASSERT_GE(i, 0) << combo << " " << text;
        c->setCurrentIndex(i);
    }
    std::string Value(const char* attr) {
        const Qvz_Attribute* a = data.GetActiveBlock()->GetNamedAttribute(attr);
        return a ? a->GetValue().str() : "<absent>";
    }

    Qvz_WizData data;
    QWidget parent;
    std::unique_ptr<Wizard> wiz;
    Qvz_MGTRXGui* gui = nullptr;
};

// Edits the active block's attributes before the controller sees them.
Qvz_WizData Edited(const char* fixture, const std::function<void(Qvz_Block&)>& edit,
                   const char* prim = nullptr) {
    Qvz_WizData d = LoadFixture(fixture, prim);
    edit(*d.GetActiveBlock());
    return d;
}

} // namespace

TEST(ReceiverGui, SlotsInTheirOrder) {
    const std::vector<std::string> names = OwnSlots(Qvz_MGTRXGui::staticMetaObject);
    const std::vector<std::string> expected = {"onActive()",
                                               "onCancel()",
                                               "onBack()",
                                               "onNext()",
                                               "onFinish()",
                                               "onMoreInfo()",
                                               "init()",
                                               "OnCheckRxLossOfSync()",
                                               "OnCheckUseCRC()",
                                               "OnRadioDecoding()",
                                               "OnRadio8b10bDecoding()",
                                               "ValidateLE_ALL()"};
    EXPECT_EQ(names, expected);
}

TEST(ReceiverGui, FormControlsAsDesigned) {
    TestApp();
    Qvz_MGTRXWidget form;
    EXPECT_EQ(form.windowTitle(), "Korvane Velomux Wizard - Receiver Setup");
    const struct {
        const char* name;
        const char* parent;
        const char* text;
    } controls[] = {
        {"gbDecoding", "Qvz_MGTRXWidget", "Decoding"},
        {"bgDecoding", "gbDecoding", ""},
        {"rbDisableDecoding", "bgDecoding", "Disable decodin&g"},
        {"rbDDC", "bgDecoding", "D&ynamic decoding control"},
        {"rbSDC", "bgDecoding", "Static decoding c&ontrol"},
        {"bgStaticDecodingControl", "gbDecoding", ""},
        {"rb8BDecoding", "bgStaticDecodingControl", "Enable 8B/10B decoding"},
        {"rb64BDecoding", "bgStaticDecodingControl",
         "Enable 64B/&66B decoding, scrambler, gearbox"},
        {"gb8BSynchronization", "Qvz_MGTRXWidget", "8B/10B Synchronization"},
        {"cbLossOfSync", "gb8BSynchronization", "&Detect the loss of sync on RXLOSSOFSYNC"},
        {"IDC_STATIC_RX_LOS_INVALID_INCR", "gb8BSynchronization", "Set RX_LOS_INVALID_INCR:"},
        {"cbRXIncr", "gb8BSynchronization", "512"},
        {"IDC_STATIC_RX_LOS_THRESHOLD", "gb8BSynchronization", "Set RX_LOS_THRESHOLD:"},
        {"cbRXThreshold", "gb8BSynchronization", "512"},
        {"gb64BSynchronization", "Qvz_MGTRXWidget", "64B/66B Synchronization"},
        {"IDC_STATIC_SH_CNT_MAX", "gb64BSynchronization", "Set SH_CNT_MAX:"},
        {"sbSHMax", "gb64BSynchronization", ""},
        {"IDC_STATIC_SH_INVALID_CNT_MAX", "gb64BSynchronization", "Set SH_INVALID_CNT_MAX:"},
        {"sbSHInvalidMax", "gb64BSynchronization", ""},
        {"cbCRC", "Qvz_MGTRXWidget", "Use CRC for receiver"},
        {"gbEqualization", "Qvz_MGTRXWidget", "RX Equalization (Continuous-Time)"},
        {"labelEqualiz", "gbEqualization", "Set RXAFEEQ (3-bit binary):"},
        {"leRXAFEEQ", "gbEqualization", "XXX"},
        {"gbCRC", "Qvz_MGTRXWidget", "CRC (Cyclic Redundancy Check)"},
        {"cbUseCRC", "gbCRC", "&Use CRC for receiver"},
        {"labelCRCwidth", "gbCRC", "CRC data width:"},
        {"cbRxCRCwidth", "gbCRC", ""},
        {"checkboxRatio", "gbCRC", "Allow 2:1 ratio for RXCRCCLK : RXCRCINTCLK"},
        {"labelCRCinit", "gbCRC", "RXCRCINITVAL (32-bit vector):"},
        {"leCRCinit", "gbCRC", ""},
    };
    for (const auto& c : controls) {
        QWidget* w = form.findChild<QWidget*>(c.name);
        ASSERT_NE(w, nullptr) << c.name;
        EXPECT_EQ(w->parentWidget()->objectName().toStdString(), c.parent) << c.name;
        QString text;
        if (auto* l = qobject_cast<QLabel*>(w))
            text = l->text();
        else if (auto* b = qobject_cast<QAbstractButton*>(w))
            text = b->text();
        else if (auto* g = qobject_cast<QGroupBox*>(w))
            text = g->title();
        else if (auto* e = qobject_cast<QLineEdit*>(w))
            text = e->text();
        else if (auto* cb = qobject_cast<QComboBox*>(w))
            text = cb->currentText();
        EXPECT_EQ(text.toStdString(), c.text) << c.name;
    }
    // The two CRC check boxes are different controls.
    EXPECT_NE(form.cbCRC, form.cbUseCRC);
    EXPECT_TRUE(form.rbDisableDecoding->isChecked());
    EXPECT_TRUE(form.rb8BDecoding->isChecked());
    EXPECT_EQ(form.bgDecodingButtons->id(form.rbDisableDecoding), 0);
    EXPECT_EQ(form.bgDecodingButtons->id(form.rbDDC), 1);
    EXPECT_EQ(form.bgDecodingButtons->id(form.rbSDC), 2);
    EXPECT_EQ(form.bgStaticDecodingControlButtons->id(form.rb8BDecoding), 0);
    EXPECT_EQ(form.bgStaticDecodingControlButtons->id(form.rb64BDecoding), 1);
    EXPECT_TRUE(form.sbSHMax->wrapping());
    EXPECT_TRUE(form.sbSHInvalidMax->wrapping());
    EXPECT_EQ(form.leRXAFEEQ->maxLength(), 3);
    EXPECT_EQ(form.leCRCinit->maxLength(), 32767);
    for (QComboBox* c : {form.cbRXIncr, form.cbRXThreshold, form.cbRxCRCwidth})
        EXPECT_FALSE(c->isEditable()) << c->objectName().toStdString();
    EXPECT_EQ(form.cbRXIncr->count(), 1);
    EXPECT_EQ(form.cbRxCRCwidth->count(), 0);

    // languageChange starts the lists again from the designed items.
    form.cbRXIncr->clear();
    form.cbRXIncr->addItem("1");
    form.cbRXIncr->addItem("2");
    form.cbRxCRCwidth->addItem("16");
    form.languageChange();
    EXPECT_EQ(form.cbRXIncr->count(), 1);
    EXPECT_EQ(form.cbRXIncr->itemText(0), "512");
    EXPECT_EQ(form.cbRXThreshold->itemText(0), "512");
    EXPECT_EQ(form.cbRxCRCwidth->count(), 0);
}

TEST(ReceiverGui, DecodingChoiceSwitchesTheSynchronizationGroups) {
    // The user's radio clicks on a GT10 block that has both groups.
    const struct {
        const char* mode;   // radio clicked in bgDecoding
        const char* choice; // radio clicked in bgStaticDecodingControl, or null
        int decodingMode, staticDecoding;
        bool sync8B, sync64B, staticChoices;
    } cases[] = {
        {"rbSDC", "rb64BDecoding", 2, 1, false, true, true},
        {"rbSDC", "rb8BDecoding", 2, 0, true, false, true},
        {"rbDDC", nullptr, 1, 1, true, true, false},
        {"rbDisableDecoding", nullptr, 0, 1, false, false, false},
    };
    for (const auto& c : cases) {
        RxGui t("rx_gt10.json"); // static 64B/66B, loss of sync on
        t.Click(c.mode);
        if (c.choice)
            t.Click(c.choice);
        const std::string label = std::string(c.mode) + "/" + (c.choice ? c.choice : "-");
        EXPECT_EQ(t.Page()->m_decodingMode, c.decodingMode) << label;
        EXPECT_EQ(t.Page()->m_staticDecoding, c.staticDecoding) << label;
        EXPECT_EQ(t.Enabled("gb8BSynchronization"), c.sync8B) << label;
        EXPECT_EQ(t.Enabled("cbLossOfSync"), c.sync8B) << label;
        EXPECT_EQ(t.Enabled("cbRXIncr"), c.sync8B) << label;
        EXPECT_EQ(t.Enabled("cbRXThreshold"), c.sync8B) << label;
        EXPECT_EQ(t.Enabled("gb64BSynchronization"), c.sync64B) << label;
        EXPECT_EQ(t.Enabled("sbSHMax"), c.sync64B) << label;
        EXPECT_EQ(t.Enabled("sbSHInvalidMax"), c.sync64B) << label;
        EXPECT_EQ(t.Enabled("rb8BDecoding"), c.staticChoices) << label;
        EXPECT_EQ(t.Enabled("rb64BDecoding"), c.staticChoices) << label;
        EXPECT_TRUE(t.Enabled("gbDecoding")) << label;

        // What the form shows is what Next writes.
        ASSERT_TRUE(t.gui->onNext()) << label;
        const char* written[] = {"DISABLE", "DYNAMIC", "STATIC"};
        EXPECT_EQ(t.Value("QVZX_ONLY_DECODING"), written[c.decodingMode]) << label;
        EXPECT_EQ(t.Value("RX_DECODE_USE"), c.decodingMode == 0 ? "FALSE" : "TRUE") << label;
        EXPECT_EQ(t.Value("QVZX_ONLY_DEC_STATIC"), c.staticDecoding ? "64B66B" : "8B10B") << label;
    }
}

TEST(ReceiverGui, LossOfSyncCheckBoxEnablesOnlyTheCounters) {
    RxGui t("rx_gt10.json");
    t.Click("rbDDC");
    EXPECT_TRUE(t.Enabled("cbRXIncr"));
    t.Check("cbLossOfSync", false);
    EXPECT_EQ(t.Page()->m_lossOfSyncFsm, 0);
    for (const char* name : {"cbRXIncr", "cbRXThreshold", "IDC_STATIC_RX_LOS_INVALID_INCR",
                             "IDC_STATIC_RX_LOS_THRESHOLD"})
        EXPECT_FALSE(t.Enabled(name)) << name;
    EXPECT_TRUE(t.Enabled("cbLossOfSync"));
    EXPECT_TRUE(t.Enabled("gb8BSynchronization"));
    t.Check("cbLossOfSync", true);
    EXPECT_TRUE(t.Enabled("cbRXThreshold"));

    // A counter the block does not let the user edit stays off.
    RxGui fixed(Edited("rx_gt10.json", [](Qvz_Block& b) {
        b.GetNamedAttribute("RX_LOS_THRESHOLD")->SetEditable(false);
        b.GetNamedAttribute("QVZX_ONLY_DEC_STATIC")->SetValue("8B10B");
    }));
    EXPECT_TRUE(fixed.Enabled("cbRXIncr"));
    EXPECT_FALSE(fixed.Enabled("cbRXThreshold"));
    // The GT11 fixture reads loss of sync off.
    RxGui off("rx_gt11.json");
    EXPECT_FALSE(off.W<QCheckBox>("cbLossOfSync")->isChecked());
    EXPECT_FALSE(off.Enabled("cbRXIncr"));
}

TEST(ReceiverGui, MissingAttributesHideTheirControls) {
    struct Case {
        const char* fixture;
        std::vector<const char*> remove;
        std::vector<const char*> hidden, shown;
    };
    const Case cases[] = {
        // The first family has neither sync-header counter.
        {"rx_gt.json",
         {},
         {"gb64BSynchronization", "gbEqualization", "gbCRC"},
         {"cbCRC", "gb8BSynchronization", "cbRXIncr"}},
        {"rx_gt10.json",
         {"SH_CNT_MAX"},
         {"gb64BSynchronization", "sbSHMax", "IDC_STATIC_SH_CNT_MAX", "cbCRC"},
         {"gb8BSynchronization"}},
        {"rx_gt10.json",
         {"SH_INVALID_CNT_MAX", "RX_LOS_THRESHOLD"},
         {"sbSHInvalidMax", "IDC_STATIC_SH_INVALID_CNT_MAX", "cbRXThreshold",
          "IDC_STATIC_RX_LOS_THRESHOLD"},
         {"gb64BSynchronization", "sbSHMax", "cbRXIncr"}},
        {"rx_gt11.json",
         {"RXCRCCLOCKDOUBLE", "RXCRCINITVAL"},
         {"checkboxRatio", "leCRCinit", "labelCRCinit", "cbCRC"},
         {"gbCRC", "cbUseCRC", "cbRxCRCwidth", "gbEqualization", "leRXAFEEQ"}},
        {"rx_gt11.json", {"QVZ_RXCRC_USE", "RXAFEEQ"}, {"gbCRC", "gbEqualization"}, {}},
    };
    for (const Case& c : cases) {
        RxGui t(Edited(c.fixture, [&](Qvz_Block& b) {
            for (const char* name : c.remove)
                b.RemoveAttribute(name);
        }));
        for (const char* name : c.hidden)
            EXPECT_FALSE(t.Shown(name)) << c.fixture << ": " << name;
        for (const char* name : c.shown)
            EXPECT_TRUE(t.Shown(name)) << c.fixture << ": " << name;
    }
}

TEST(ReceiverGui, DeviceFamiliesDecideTheDecodingChoices) {
    struct Case {
        const char* fixture;
        std::vector<const char*> families;
        const char* bypass; // QVZX_ONLY_BYPASS_PCS, or null for none
        bool decoding, dynamic, shown64B, crc;
        const char* checked;
    };
    const Case cases[] = {
        // Dynamic decoding reads as static on a first-family device.
        {"rx_gt.json", {"GT"}, nullptr, true, false, false, true, "rbSDC"},
        {"rx_gt.json", {"GT", "GT10"}, nullptr, true, false, true, true, "rbSDC"},
        {"rx_gt.json", {"GT10"}, nullptr, true, true, true, true, "rbDDC"},
        {"rx_gt.json", {"GT11"}, "TRUE", false, false, true, false, "rbDDC"},
        {"rx_gt10.json", {"GT10"}, "TRUE", false, false, true, true, "rbSDC"},
        {"rx_gt10.json", {"GT10"}, nullptr, true, true, true, true, "rbSDC"},
        // RX_DECODE_USE is not editable there, so it does not switch decoding off.
        {"rx_gt11.json", {"GT11"}, nullptr, true, true, true, true, "rbSDC"},
    };
    for (const Case& c : cases) {
        Qvz_WizData d = LoadFixture(c.fixture);
        d.Target().supportsGT = d.Target().supportsGT10 = d.Target().supportsGT11 = false;
        for (const std::string f : c.families)
            (f == "GT"     ? d.Target().supportsGT
             : f == "GT10" ? d.Target().supportsGT10
                           : d.Target().supportsGT11) = true;
        if (c.bypass)
            d.GetActiveBlock()->AddAttribute("QVZX_ONLY_BYPASS_PCS", c.bypass);
        RxGui t(std::move(d));
        const std::string label =
            std::string(c.fixture) + "/" + c.families.back() + (c.bypass ? "/bypass" : "");
        EXPECT_EQ(t.Enabled("gbDecoding"), c.decoding) << label;
        EXPECT_EQ(t.Enabled("rbSDC"), c.decoding) << label;
        EXPECT_EQ(t.Enabled("rbDisableDecoding"), c.decoding) << label;
        EXPECT_EQ(t.Enabled("rbDDC"), c.dynamic) << label;
        EXPECT_EQ(t.Shown("rb64BDecoding"), c.shown64B) << label;
        EXPECT_TRUE(t.W<QRadioButton>(c.checked)->isChecked()) << label;
        if (t.Shown("cbCRC")) {
            EXPECT_EQ(t.Enabled("cbCRC"), c.crc) << label;
        }
    }
}

TEST(ReceiverGui, Gt10SpeedLimitsTheDecodingChoices) {
    const struct {
        const char* prim;
        const char* speed;
        bool all, dynamic, b8, b64;
    } cases[] = {
        {"GT10_CUSTOM", "0_32", true, true, true, true},
        {"GT10_CUSTOM", "1_32", true, false, true, false},
        {"GT10_CUSTOM", "2_32", true, false, false, true},
        // Zephine primitives ignore the speed lists.
        {"GT10_ZEPHINE_4", "1_32", true, true, true, true},
    };
    for (const auto& c : cases) {
        RxGui t(Edited(
            "rx_gt10.json",
            [&](Qvz_Block& b) {
                b.GetNamedAttribute("PMA_SPEED")->SetValue(c.speed);
                b.AddAttribute("QVZ_PMASPD_ENC_NONE", "")->GetLegalValues().Add(c.speed);
            },
            c.prim));
        const std::string label = std::string(c.prim) + "/" + c.speed;
        EXPECT_EQ(t.Enabled("gbDecoding"), c.all) << label;
        EXPECT_EQ(t.Enabled("rbDDC"), c.dynamic) << label;
        EXPECT_EQ(t.Enabled("rb8BDecoding"), c.b8) << label;
        EXPECT_EQ(t.Enabled("rb64BDecoding"), c.b64) << label;
    }
}

TEST(ReceiverGui, CrcCheckBoxEnablesItsControls) {
    RxGui t("rx_gt11.json");
    const char* controls[] = {"labelCRCwidth", "cbRxCRCwidth", "checkboxRatio", "labelCRCinit",
                              "leCRCinit"};
    EXPECT_TRUE(t.W<QCheckBox>("cbUseCRC")->isChecked());
    for (const char* name : controls)
        EXPECT_TRUE(t.Enabled(name)) << name;
    t.Check("cbUseCRC", false);
    EXPECT_FALSE(t.Page()->m_crcUse);
    for (const char* name : controls)
        EXPECT_FALSE(t.Enabled(name)) << name;
    EXPECT_TRUE(t.Enabled("cbUseCRC"));

    // Off, the initial value is not checked on Next and goes in as typed.
    t.SetText("leCRCinit", "BAD");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(t.wiz->Messages().empty());
    EXPECT_EQ(t.Value("QVZ_RXCRC_USE"), "FALSE");
    EXPECT_EQ(t.Value("RXCRCINITVAL"), "12'hBAD");
    // On again, it stops Next.
    t.Check("cbUseCRC", true);
    EXPECT_FALSE(t.gui->onNext());
    EXPECT_EQ(t.wiz->Messages(),
              std::vector<std::string>{"Please enter a valid 8-digit hex value for RXCRCINITVAL"});
}

TEST(ReceiverGui, FirstBadEntryStopsNextWithItsMessageAndFocus) {
    const struct {
        const char* afeEq;
        const char* crcInit;
        const char* focus;
        const char* message;
    } cases[] = {
        {"01", "DEADBEEF", "leRXAFEEQ", "Please enter a valid 3-bit binary value for RXAFEEQ"},
        {"", "0123456", "leRXAFEEQ", "Please enter a valid 3-bit binary value for RXAFEEQ"},
        {"110", "0123456", "leCRCinit", "Please enter a valid 8-digit hex value for RXCRCINITVAL"},
        {"110", "", "leCRCinit", "Please enter a valid 8-digit hex value for RXCRCINITVAL"},
    };
    for (const auto& c : cases) {
        RxGui t("rx_gt11.json");
        t.SetText("leRXAFEEQ", c.afeEq);
        t.SetText("leCRCinit", c.crcInit);
        const Qvz_Block before(*t.data.GetActiveBlock());
        EXPECT_FALSE(t.gui->onNext()) << c.focus;
        EXPECT_EQ(t.wiz->Messages(), std::vector<std::string>{c.message});
        EXPECT_EQ(t.gui->pageWidget()->focusWidget(), t.W<QWidget>(c.focus)) << c.focus;
        EXPECT_TRUE(*t.data.GetActiveBlock() == before) << c.focus;
    }
}

TEST(ReceiverGui, HiddenEntryDoesNotStopNext) {
    // A block without RXAFEEQ hides the equalization group; whatever its
    // entry still holds cannot be corrected there, so it is not checked.
    RxGui t(Edited("rx_gt11.json", [](Qvz_Block& b) { b.RemoveAttribute("RXAFEEQ"); }));
    ASSERT_FALSE(t.Shown("leRXAFEEQ"));
    t.SetText("leRXAFEEQ", "1");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(t.wiz->Messages().empty());
    EXPECT_EQ(t.Value("RXAFEEQ"), "<absent>");
}

TEST(ReceiverGui, NextBackAndFinishWriteTheForm) {
    const std::function<bool(Qvz_MGTRXGui&)> buttons[] = {
        [](Qvz_MGTRXGui& g) { return g.onNext(); }, [](Qvz_MGTRXGui& g) { return g.onBack(); },
        [](Qvz_MGTRXGui& g) { return !g.onFinish(); }, // false lets the dialog finish
    };
    for (const auto& press : buttons) {
        RxGui t("rx_gt11.json");
        t.SetText("leRXAFEEQ", "011");
        t.SetText("leCRCinit", "0badF00d");
        t.Choose("cbRxCRCwidth", "16");
        t.Check("checkboxRatio", false);
        t.Check("cbLossOfSync", true);
        t.Choose("cbRXIncr", "8");
        t.Choose("cbRXThreshold", "8");
        t.Click("rbSDC");
        t.Click("rb64BDecoding");
        EXPECT_TRUE(press(*t.gui));
        EXPECT_TRUE(t.wiz->Messages().empty());
        EXPECT_EQ(t.Value("RXAFEEQ"), "9'b000000011");
        EXPECT_EQ(t.Value("RXCRCINITVAL"), "32'h0badF00d");
        EXPECT_EQ(t.Value("QVZ_RXCRC_DATAWIDTH"), "16");
        EXPECT_EQ(t.Value("RXCRCCLOCKDOUBLE"), "FALSE");
        EXPECT_EQ(t.Value("QVZ_RXCRC_USE"), "TRUE");
        EXPECT_EQ(t.Value("RX_LOSS_OF_SYNC_FSM"), "TRUE");
        EXPECT_EQ(t.Value("RX_LOS_INVALID_INCR"), "8");
        EXPECT_EQ(t.Value("RX_LOS_THRESHOLD"), "8");
        EXPECT_EQ(t.Value("QVZX_ONLY_DECODING"), "STATIC");
        EXPECT_EQ(t.Value("QVZX_ONLY_DEC_STATIC"), "64B66B");
    }
    // Back does not check the entries.
    RxGui t("rx_gt11.json");
    t.SetText("leRXAFEEQ", "1");
    EXPECT_TRUE(t.gui->onBack());
    EXPECT_EQ(t.Value("RXAFEEQ"), "9'b0000001");
    // The counters and the first-family CRC switch go in as well.
    RxGui gt10("rx_gt10.json");
    gt10.W<QSpinBox>("sbSHMax")->setValue(200);
    gt10.W<QSpinBox>("sbSHInvalidMax")->setValue(32);
    EXPECT_TRUE(gt10.gui->onNext());
    EXPECT_EQ(gt10.Value("SH_CNT_MAX"), "200");
    EXPECT_EQ(gt10.Value("SH_INVALID_CNT_MAX"), "32");
    RxGui gt("rx_gt.json");
    gt.Check("cbCRC", false);
    EXPECT_TRUE(gt.gui->onNext());
    EXPECT_EQ(gt.Value("RX_CRC_USE"), "FALSE");
}

TEST(ReceiverGui, UntouchedFormWritesWhatABatchRunWrites) {
    for (const char* fixture : {"rx_gt.json", "rx_gt10.json", "rx_gt11.json"}) {
        RxGui t(fixture);
        Qvz_WizData batchData = LoadFixture(fixture);
        Wizard batch(batchData, Qvz_RunMode::Batch);
        ASSERT_TRUE(batch.Page()->DoBatchPage()) << fixture;
        EXPECT_TRUE(t.gui->onNext()) << fixture;
        EXPECT_TRUE(*t.data.GetActiveBlock() == *batchData.GetActiveBlock()) << fixture;
        EXPECT_TRUE(t.wiz->Messages().empty()) << fixture;
    }
}

TEST(ReceiverGui, ActivationShowsTheBlock) {
    RxGui t("rx_gt10.json");
    EXPECT_EQ(t.W<QComboBox>("cbRXIncr")->count(), 8);
    EXPECT_EQ(t.W<QComboBox>("cbRXIncr")->currentText(), "2");
    EXPECT_EQ(t.W<QComboBox>("cbRXThreshold")->currentText(), "8");
    EXPECT_EQ(t.W<QComboBox>("cbRxCRCwidth")->count(), 0);
    QSpinBox* shMax = t.W<QSpinBox>("sbSHMax");
    QSpinBox* shInvalid = t.W<QSpinBox>("sbSHInvalidMax");
    EXPECT_EQ(shMax->minimum(), 1);
    EXPECT_EQ(shMax->maximum(), 255);
    EXPECT_EQ(shMax->value(), 64);
    EXPECT_EQ(shInvalid->maximum(), 32);
    EXPECT_EQ(shInvalid->value(), 16);
    EXPECT_TRUE(t.W<QCheckBox>("cbLossOfSync")->isChecked());
    EXPECT_TRUE(t.W<QRadioButton>("rb64BDecoding")->isChecked());
    EXPECT_TRUE(t.gui->IsActive());

    RxGui gt11("rx_gt11.json");
    EXPECT_EQ(gt11.W<QLineEdit>("leRXAFEEQ")->text(), "101");
    EXPECT_EQ(gt11.W<QLineEdit>("leCRCinit")->text(), "DEADBEEF");
    EXPECT_EQ(gt11.W<QComboBox>("cbRxCRCwidth")->currentText(), "32");
    EXPECT_TRUE(gt11.W<QCheckBox>("checkboxRatio")->isChecked());
    EXPECT_TRUE(gt11.W<QRadioButton>("rb8BDecoding")->isChecked());

    // A second activation after the block changed shows the block again:
    // loaded while the controller is quiet, so no slot rewrites the fields.
    gt11.data.GetActiveBlock()->GetNamedAttribute("QVZX_ONLY_DECODING")->SetValue("DISABLE");
    gt11.data.GetActiveBlock()->GetNamedAttribute("QVZ_RXCRC_USE")->SetValue("FALSE");
    gt11.gui->onActive();
    EXPECT_TRUE(gt11.W<QRadioButton>("rbDisableDecoding")->isChecked());
    EXPECT_FALSE(gt11.W<QCheckBox>("cbUseCRC")->isChecked());
    EXPECT_FALSE(gt11.Enabled("leCRCinit"));
    EXPECT_FALSE(gt11.Enabled("rb8BDecoding"));
}

TEST(ReceiverGui, FailedCounterCheckKeepsThePageOnEveryButton) {
    struct Case {
        const char* what;
        std::function<void(RxGui&)> spoil;
        std::string message;
    };
    const Case cases[] = {
        {"threshold below increment",
         [](RxGui& t) {
             t.Choose("cbRXIncr", "128");
             t.Choose("cbRXThreshold", "64");
         },
         kThresholdMessage},
        // The spin box keeps to the block's range; a wider one shows what
        // the page still refuses.
        {"SH_CNT_MAX 0",
         [](RxGui& t) {
             t.W<QSpinBox>("sbSHMax")->setRange(0, 255);
             t.W<QSpinBox>("sbSHMax")->setValue(0);
             t.W<QSpinBox>("sbSHInvalidMax")->setRange(0, 255);
             t.W<QSpinBox>("sbSHInvalidMax")->setValue(0);
         },
         "The allowable range for the attribute SH_CNT_MAX is between 1 and 255."},
        {"SH_INVALID_CNT_MAX 33",
         [](RxGui& t) {
             t.W<QSpinBox>("sbSHInvalidMax")->setRange(1, 255);
             t.W<QSpinBox>("sbSHInvalidMax")->setValue(33);
         },
         "The allowable range for the attribute SH_INVALID_CNT_MAX is between 1 and 32."},
    };
    for (const Case& c : cases) {
        RxGui t("rx_gt10.json");
        c.spoil(t);
        const Qvz_Block before(*t.data.GetActiveBlock());
        EXPECT_FALSE(t.gui->onNext()) << c.what;
        EXPECT_FALSE(t.gui->onBack()) << c.what;
        EXPECT_TRUE(t.gui->onFinish()) << c.what; // true keeps the dialog here
        EXPECT_EQ(t.wiz->Messages(), std::vector<std::string>(3, c.message)) << c.what;
        EXPECT_TRUE(*t.data.GetActiveBlock() == before) << c.what;
    }
}

TEST(ReceiverGui, PageNameHelpAndHooks) {
    RxGui t("rx_gt.json");
    EXPECT_EQ(t.gui->pageName(), "Receiver Setup");
    EXPECT_EQ(static_cast<QWidget*>(t.gui->Form()), t.gui->pageWidget());
    EXPECT_EQ(t.Page()->GetGuiDlg(), t.gui);
    EXPECT_FALSE(t.gui->isAdvanced());
    EXPECT_EQ(t.gui->EntryCount(), 2);
    EXPECT_EQ(t.gui->Entry(Qvz_MGTRXGui::kAfeEq).m_pLineEdit, t.W<QLineEdit>("leRXAFEEQ"));
    EXPECT_EQ(t.gui->Entry(Qvz_MGTRXGui::kCrcInit).m_pLineEdit, t.W<QLineEdit>("leCRCinit"));
    EXPECT_TRUE(t.gui->onCancel());
    t.gui->onMoreInfo();
    EXPECT_EQ(t.wiz->help.keys, std::vector<std::string>{"qvz_mgtrx2"});

    // Without an active block nothing is written and the page stays.
    t.data.SetAllBlksIsActive(false);
    EXPECT_FALSE(t.gui->onNext());
    EXPECT_FALSE(t.gui->onBack());
    EXPECT_TRUE(t.gui->onFinish());
}
