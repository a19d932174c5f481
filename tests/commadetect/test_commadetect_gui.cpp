// The comma detect controller and form, driven offscreen through their slots
// with the real widgets found by object name.

#include "../framework/DialogDriver.h"
#include "HostRunner.h"
#include "PageGuiSupport.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTRCD.h"
#include "Qvz_MGTRCDGui.h"
#include "Qvz_MGTRCDWidget.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMetaMethod>
#include <QRadioButton>
#include <QValidator>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

Qvz_WizData LoadFixture(const char* name) {
    return LoadFixtureFile(QString("commadetect/") + name);
}

// A window-mode wizard main over data with the comma detect controller
// created and initialised as the dialog would.
struct RcdGui : PageGuiRig<Qvz_MGTRCD, Qvz_MGTRCDGui> {
    explicit RcdGui(Qvz_WizData d, bool init = true)
        : PageGuiRig(std::move(d), Qvz_MGTWizMain::kCommaDetect) {
        if (init)
            gui->init();
    }
    explicit RcdGui(const char* fixture, bool init = true) : RcdGui(LoadFixture(fixture), init) {}

    Qvz_MGTRCD* Page() const { return page; }
    bool Checked(const char* name) { return W<QAbstractButton>(name)->isChecked(); }
    QString Text(const char* name) {
        QObject* o = W<QObject>(name);
        if (auto* l = qobject_cast<QLabel*>(o))
            return l->text();
        if (auto* e = qobject_cast<QLineEdit*>(o))
            return e->text();
        return {};
    }
    // Whether the entry's validator takes text as a whole.
    bool Accepts(const char* name, const QString& text) {
        const QValidator* v = W<QLineEdit>(name)->validator();
        if (!v)
            return false;
        QString t = text;
        int pos = 0;
        return v->validate(t, pos) == QValidator::Acceptable;
    }
};

const char* const kCommaControls[] = {
    "gbPCD",       "IDC_STATIC_PCOMMA_10B_VALUE", "lePCV",    "bgPCD",      "cbPComma",
    "gbMCD",       "IDC_STATIC_MCOMMA_10B_VALUE", "leMCV",    "bgMCD",      "cbMComma",
    "leCommaMask", "IDC_STATIC_COMMA_10B_MASK",   "cbVComma", "cbAlignMSB", "cbAlign"};

} // namespace

TEST(CommaDetectGui, SlotsInTheirOrder) {
    const std::vector<std::string> names = OwnSlots(Qvz_MGTRCDGui::staticMetaObject);
    const std::vector<std::string> expected = {"onActive()",
                                               "onCancel()",
                                               "onBack()",
                                               "onNext()",
                                               "onFinish()",
                                               "onMoreInfo()",
                                               "init()",
                                               "OnCheckTurnoffComma()",
                                               "ValidatePComma()",
                                               "ValidateMComma()",
                                               "ValidateCommaMask()",
                                               "ValidateLE_ALL()"};
    EXPECT_EQ(names, expected);
}

TEST(CommaDetectGui, FormControlsAsDesigned) {
    TestApp();
    Qvz_MGTRCDWidget form;
    EXPECT_EQ(form.windowTitle(), "Korvane Velomux Wizard - Receiver Comma Detect Setup");
    const struct {
        const char* name;
        const char* parent;
        const char* text;
    } controls[] = {
        {"cbDisableCD", "Qvz_MGTRCDWidget", "&Disable comma alignment and comma detect"},
        {"gbPCD", "Qvz_MGTRCDWidget", "Plus-comma detection"},
        {"IDC_STATIC_PCOMMA_10B_VALUE", "gbPCD", "Plus-comma value (10bit-value):"},
        {"lePCV", "gbPCD", ""},
        {"IDC_STATIC_MSB_PCOMMA", "gbPCD", "MSB"},
        {"IDC_STATIC_LSB_PCOMMA", "gbPCD", "LSB"},
        {"bgPCD", "gbPCD", ""},
        {"rbDynamicPCD", "bgPCD", "Dynamic control of plus-comma detection"},
        {"rbAlwaysPCD", "bgPCD", "Always enable plus-comma detection"},
        {"rbDisablePCD", "bgPCD", "Disable plus-comma detection"},
        {"gbMCD", "Qvz_MGTRCDWidget", "Minus-comma detection"},
        {"IDC_STATIC_MCOMMA_10B_VALUE", "gbMCD", "Minus-comma value (10bit-value):"},
        {"leMCV", "gbMCD", ""},
        {"IDC_STATIC_MSB_MCOMMA", "gbMCD", "MSB"},
        {"IDC_STATIC_LSB_MCOMMA", "gbMCD", "LSB"},
        {"bgMCD", "gbMCD", ""},
        {"rbDynamicMCD", "bgMCD", "Dynamic control of minus-comma detection"},
        {"rbAlwaysMCD", "bgMCD", "Always enable minus-comma detection"},
        {"rbDisableMCD", "bgMCD", "Disable minus-comma detection"},
        {"gbCommaMask", "Qvz_MGTRCDWidget", ""},
        {"IDC_STATIC_COMMA_10B_MASK", "gbCommaMask", "Comma Mask (10-bit value):"},
        {"leCommaMask", "gbCommaMask", ""},
        {"IDC_STATIC_MSB_COMMA", "gbCommaMask", "MSB"},
        {"IDC_STATIC_LSB_COMMA", "gbCommaMask", "LSB"},
        {"cbVComma", "Qvz_MGTRCDWidget", "&Raise RXCHARISCOMMA only on valid characters"},
        {"cbPComma", "Qvz_MGTRCDWidget", "Raise RXC&HARISCOMMA on 0011111xxx"},
        {"cbMComma", "Qvz_MGTRCDWidget", "Raise RXCHARISC&OMMA on 1100000xxx"},
        {"IDC_STATIC_ALIGN_COMMA_WORD", "Qvz_MGTRCDWidget", "Set ALIGN_COMMA_WORD:"},
        {"cbAlign", "Qvz_MGTRCDWidget", ""},
        {"cbAlignMSB", "Qvz_MGTRCDWidget", "Align Comma MSB"},
    };
    // Creation order: the named widgets in the order a depth-first walk of
    // the form meets them.
    std::vector<std::string> expectedOrder, order;
    for (const auto& c : controls)
        expectedOrder.push_back(c.name);
    for (QWidget* w : form.findChildren<QWidget*>()) {
        const std::string n = w->objectName().toStdString();
        for (const auto& c : controls)
            if (n == c.name)
                order.push_back(n);
    }
    EXPECT_EQ(order, expectedOrder);

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
        EXPECT_EQ(text.toStdString(), c.text) << c.name;
    }

    // Accelerators of the check boxes.
    EXPECT_EQ(QKeySequence::mnemonic(form.cbDisableCD->text()), QKeySequence("Alt+D"));
    EXPECT_EQ(QKeySequence::mnemonic(form.cbVComma->text()), QKeySequence("Alt+R"));
    EXPECT_EQ(QKeySequence::mnemonic(form.cbPComma->text()), QKeySequence("Alt+H"));
    EXPECT_EQ(QKeySequence::mnemonic(form.cbMComma->text()), QKeySequence("Alt+O"));

    // Untitled groups keep their frame; the radio groups number their
    // buttons in creation order and start on dynamic control.
    for (QGroupBox* g : {form.bgPCD, form.bgMCD, form.gbCommaMask})
        EXPECT_FALSE(g->isFlat()) << g->objectName().toStdString();
    QRadioButton* const pcd[] = {form.rbDynamicPCD, form.rbAlwaysPCD, form.rbDisablePCD};
    QRadioButton* const mcd[] = {form.rbDynamicMCD, form.rbAlwaysMCD, form.rbDisableMCD};
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(form.bgPCDButtons->id(pcd[i]), i);
        EXPECT_EQ(form.bgMCDButtons->id(mcd[i]), i);
    }
    EXPECT_TRUE(form.bgPCDButtons->exclusive());
    EXPECT_TRUE(form.rbDynamicPCD->isChecked());
    EXPECT_TRUE(form.rbDynamicMCD->isChecked());

    // The validators, not the entries, bound the length.
    for (QLineEdit* e : {form.lePCV, form.leMCV, form.leCommaMask}) {
        EXPECT_EQ(e->maxLength(), 32767);
        EXPECT_EQ(e->validator(), nullptr);
    }
    EXPECT_FALSE(form.cbAlign->isEditable());
    ASSERT_EQ(form.cbAlign->count(), 1);
    EXPECT_EQ(form.cbAlign->itemText(0), "XX");
    form.cbAlign->clear();
    form.cbAlign->addItem("1");
    form.cbAlign->addItem("2");
    form.IDC_STATIC_MSB_PCOMMA->setText("LSB");
    form.languageChange();
    ASSERT_EQ(form.cbAlign->count(), 1);
    EXPECT_EQ(form.cbAlign->itemText(0), "XX");
    EXPECT_EQ(form.IDC_STATIC_MSB_PCOMMA->text(), "MSB");
}

TEST(CommaDetectGui, ValidatorsAndTheTurnOffWaitForActivationAndInit) {
    RcdGui t("gt.json", false);
    EXPECT_EQ(t.W<QLineEdit>("lePCV")->validator(), nullptr);
    EXPECT_EQ(t.gui->Entry(Qvz_MGTRCDGui::kPlusComma).m_pLineEdit, nullptr);
    EXPECT_EQ(t.gui->EntryCount(), 3);

    // Before init, cbDisableCD reaches nothing.
    t.gui->onActive();
    EXPECT_NE(t.W<QLineEdit>("lePCV")->validator(), nullptr);
    t.W<QCheckBox>("cbDisableCD")->setChecked(true);
    EXPECT_EQ(t.Page()->m_turnOffComma, 0);
    EXPECT_EQ(t.Page()->m_commaMask, "1111111000");
    EXPECT_TRUE(t.Enabled("lePCV"));
    t.W<QCheckBox>("cbDisableCD")->setChecked(false);

    t.gui->init();
    t.W<QCheckBox>("cbDisableCD")->setChecked(true);
    EXPECT_EQ(t.Page()->m_turnOffComma, 1);
    EXPECT_EQ(t.Page()->m_commaMask, "0000000000");
    EXPECT_FALSE(t.Enabled("lePCV"));
}

TEST(CommaDetectGui, ActivationShowsTheBlock) {
    struct Case {
        const char* fixture;
        const char* pcv;
        const char* mcv;
        const char* mask;
        const char* pcdChecked;
        const char* mcdChecked;
        bool pComma, mComma, vComma, alignMsb;
        const char* align;
        int alignItems;
    };
    const Case cases[] = {
        {"gt.json", "0101111100", "1010000011", "1111111000", "rbDynamicPCD", "rbAlwaysMCD", true,
         true, true, true, "2", 2},
        // A pattern the block forbids changing shows its default; PCOMMA_DETECT
        // "FALSE" wins over "ALWAYS".
        {"gt10.json", "0011111000", "1100000101", "0001111111", "rbDisablePCD", "rbDynamicMCD",
         false, true, false, false, "1", 3},
        // Without QVZX_ONLY_MCOMMA_CTRL the minus-comma mode keeps its initial "always".
        {"gt11.json", "0000017C", "00000283", "3FF", "rbDynamicPCD", "rbAlwaysMCD", true, true,
         true, false, "1", 3},
    };
    for (const Case& c : cases) {
        RcdGui t(c.fixture);
        t.gui->onActive();
        EXPECT_TRUE(t.gui->IsActive());
        EXPECT_EQ(t.Text("lePCV"), c.pcv) << c.fixture;
        EXPECT_EQ(t.Text("leMCV"), c.mcv) << c.fixture;
        EXPECT_EQ(t.Text("leCommaMask"), c.mask) << c.fixture;
        EXPECT_TRUE(t.Checked(c.pcdChecked)) << c.fixture;
        EXPECT_TRUE(t.Checked(c.mcdChecked)) << c.fixture;
        EXPECT_EQ(t.Checked("cbPComma"), c.pComma) << c.fixture;
        EXPECT_EQ(t.Checked("cbMComma"), c.mComma) << c.fixture;
        EXPECT_EQ(t.Checked("cbVComma"), c.vComma) << c.fixture;
        EXPECT_EQ(t.Checked("cbAlignMSB"), c.alignMsb) << c.fixture;
        EXPECT_FALSE(t.Checked("cbDisableCD")) << c.fixture;
        EXPECT_EQ(t.W<QComboBox>("cbAlign")->currentText(), c.align) << c.fixture;
        EXPECT_EQ(t.W<QComboBox>("cbAlign")->count(), c.alignItems) << c.fixture;
    }
}

TEST(CommaDetectGui, FamilyDecidesPatternsLabelsAndMarkers) {
    struct Case {
        const char* fixture;
        const char* good[3]; // accepted by lePCV, leMCV, leCommaMask
        const char* bad[3];
        const char* left;
        const char* right;
        const char* patternEnd;
        const char* maskEnd;
    };
    const Case cases[] = {
        {"gt.json",
         {"0011111000", "1100000000", "1111111111"},
         {"001111100", "0011111002", "3FF"},
         "LSB",
         "MSB",
         " (10-bit value):",
         " (10-bit value):"},
        {"gt10.json",
         {"0011111000", "1100000000", "0000000000"},
         {"00111110001", "0000017C", "1111111x11"},
         "MSB",
         "LSB",
         " (10-bit value):",
         " (10-bit value):"},
        {"gt11.json",
         {"0000017c", "FFFFFFFF", "3fF"},
         {"17C", "0011111000", "3FFF"},
         "MSB",
         "LSB",
         " (8 hex digits):",
         " (3 hex digits):"},
    };
    const char* const entries[3] = {"lePCV", "leMCV", "leCommaMask"};
    for (const Case& c : cases) {
        RcdGui t(c.fixture);
        t.gui->onActive();
        for (int i = 0; i < 3; ++i) {
            EXPECT_TRUE(t.Accepts(entries[i], c.good[i])) << c.fixture << " " << entries[i];
            EXPECT_FALSE(t.Accepts(entries[i], c.bad[i])) << c.fixture << " " << entries[i];
        }
        for (const char* l :
             {"IDC_STATIC_MSB_PCOMMA", "IDC_STATIC_MSB_MCOMMA", "IDC_STATIC_MSB_COMMA"})
            EXPECT_EQ(t.Text(l), c.left) << c.fixture << " " << l;
        for (const char* l :
             {"IDC_STATIC_LSB_PCOMMA", "IDC_STATIC_LSB_MCOMMA", "IDC_STATIC_LSB_COMMA"})
            EXPECT_EQ(t.Text(l), c.right) << c.fixture << " " << l;
        EXPECT_EQ(t.Text("IDC_STATIC_PCOMMA_10B_VALUE"),
                  QString("&Plus-comma value") + c.patternEnd);
        EXPECT_EQ(t.Text("IDC_STATIC_MCOMMA_10B_VALUE"),
                  QString("&Minus-comma value") + c.patternEnd);
        EXPECT_EQ(t.Text("IDC_STATIC_COMMA_10B_MASK"), QString("&Comma mask") + c.maskEnd);
        // The relabelled accelerators reach their entries.
        EXPECT_EQ(t.W<QLabel>("IDC_STATIC_PCOMMA_10B_VALUE")->buddy(), t.W<QWidget>("lePCV"));
        EXPECT_EQ(t.W<QLabel>("IDC_STATIC_COMMA_10B_MASK")->buddy(), t.W<QWidget>("leCommaMask"));
    }
}

TEST(CommaDetectGui, SwitchingTheBlockToGt11BetweenActivations) {
    // One design holding a first-family block (active) and a GT11 block, as
    // after choosing another type on the General Setup page.
    Qvz_WizData d = LoadFixture("gt.json");
    Qvz_WizData gt11 = LoadFixture("gt11.json");
    Qvz_Block* second = d.AddBlock(std::make_unique<Qvz_Block>(*gt11.GetActiveBlock()));
    second->SetIsUsed(false);
    RcdGui t(std::move(d));
    t.gui->onActive();
    EXPECT_TRUE(t.Accepts("lePCV", "0011111000"));
    EXPECT_TRUE(t.Accepts("leCommaMask", "1111111111"));
    EXPECT_EQ(t.Text("IDC_STATIC_MSB_PCOMMA"), "LSB");

    t.data.SetAllBlksIsActive(false);
    t.data.GetNamedBlock("GT11_CUSTOM_INST")->SetIsUsed(true);
    t.gui->onActive();
    EXPECT_FALSE(t.Accepts("lePCV", "0011111000"));
    EXPECT_TRUE(t.Accepts("lePCV", "0000017C"));
    EXPECT_TRUE(t.Accepts("leMCV", "ABCDEF01"));
    EXPECT_FALSE(t.Accepts("leCommaMask", "1111111111"));
    EXPECT_TRUE(t.Accepts("leCommaMask", "3FF"));
    EXPECT_EQ(t.gui->Entry(Qvz_MGTRCDGui::kCommaMask).m_message,
              "Please enter a valid 3-digit hex value for Comma Mask");
    EXPECT_EQ(t.Text("IDC_STATIC_PCOMMA_10B_VALUE"), "&Plus-comma value (8 hex digits):");
    EXPECT_EQ(t.Text("IDC_STATIC_COMMA_10B_MASK"), "&Comma mask (3 hex digits):");
    EXPECT_EQ(t.Text("IDC_STATIC_MSB_PCOMMA"), "MSB");
    EXPECT_EQ(t.Text("IDC_STATIC_LSB_COMMA"), "LSB");
    // Each activation replaces the validator instead of adding one.
    EXPECT_EQ(t.W<QLineEdit>("lePCV")->findChildren<QValidator*>().size(), 1);

    // The first-family text no longer passes; the GT11 notation is written.
    t.SetText("lePCV", "0011111000");
    EXPECT_FALSE(t.gui->onNext());
    ASSERT_EQ(t.Messages().size(), 1u);
    EXPECT_EQ(t.Messages()[0], "Please enter a valid 8-digit hex value for Plus-comma value");
    t.SetText("lePCV", "0000027C");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_EQ(t.Value("PCOMMA_10B_VALUE"), "10'h27C");
    EXPECT_EQ(t.Value("PCOMMA_32B_VALUE"), "32'h0000027C");
    EXPECT_EQ(t.Value("COMMA_10B_MASK"), "10'h3FF");
}

TEST(CommaDetectGui, AttributesDecideWhatIsShownAndEnabled) {
    struct Edit {
        const char* name;
        const char* value; // nullptr: remove the attribute
        bool editable;
    };
    struct Case {
        const char* label;
        std::vector<Edit> edits;
        std::vector<const char*> disabled;
        std::vector<const char*> hidden;
    };
    const std::vector<Case> cases = {
        {"as read", {}, {}, {}},
        {"bypassed PCS",
         {{"QVZX_ONLY_BYPASS_PCS", "TRUE", true}},
         {"cbPComma", "cbMComma", "cbVComma"},
         {}},
        {"fixed attributes",
         {{"MCOMMA_10B_VALUE", "1100000000", false},
          {"PCOMMA_DETECT", "TRUE", false},
          {"DEC_MCOMMA_DETECT", "TRUE", false},
          {"COMMA_10B_MASK", "1111111111", false},
          {"DEC_VALID_COMMA_ONLY", "TRUE", false},
          {"ALIGN_COMMA_MSB", "TRUE", false},
          {"ALIGN_COMMA_WORD", "1", false}},
         {"IDC_STATIC_MCOMMA_10B_VALUE", "IDC_STATIC_MSB_MCOMMA", "IDC_STATIC_LSB_MCOMMA", "leMCV",
          "bgPCD", "cbMComma", "IDC_STATIC_COMMA_10B_MASK", "leCommaMask", "IDC_STATIC_MSB_COMMA",
          "IDC_STATIC_LSB_COMMA", "cbVComma", "cbAlignMSB", "IDC_STATIC_ALIGN_COMMA_WORD",
          "cbAlign"},
         {}},
        {"absent attributes",
         {{"PCOMMA_10B_VALUE", nullptr, true},
          {"MCOMMA_DETECT", nullptr, true},
          {"DEC_PCOMMA_DETECT", nullptr, true},
          {"COMMA_10B_MASK", nullptr, true},
          {"DEC_VALID_COMMA_ONLY", nullptr, true},
          {"ALIGN_COMMA_MSB", nullptr, true},
          {"ALIGN_COMMA_WORD", nullptr, true}},
         {"IDC_STATIC_PCOMMA_10B_VALUE", "IDC_STATIC_MSB_PCOMMA", "IDC_STATIC_LSB_PCOMMA", "lePCV",
          "bgMCD", "cbPComma"},
         {"IDC_STATIC_COMMA_10B_MASK", "leCommaMask", "IDC_STATIC_MSB_COMMA",
          "IDC_STATIC_LSB_COMMA", "cbVComma", "cbAlignMSB", "IDC_STATIC_ALIGN_COMMA_WORD",
          "cbAlign"}},
        // The 32-bit attribute stands in for the 10-bit one.
        {"32-bit pattern only",
         {{"PCOMMA_10B_VALUE", nullptr, true}, {"PCOMMA_32B_VALUE", "0011111000", true}},
         {},
         {}},
    };
    const char* const all[] = {"gbPCD",
                               "IDC_STATIC_PCOMMA_10B_VALUE",
                               "IDC_STATIC_MSB_PCOMMA",
                               "IDC_STATIC_LSB_PCOMMA",
                               "lePCV",
                               "bgPCD",
                               "cbPComma",
                               "gbMCD",
                               "IDC_STATIC_MCOMMA_10B_VALUE",
                               "IDC_STATIC_MSB_MCOMMA",
                               "IDC_STATIC_LSB_MCOMMA",
                               "leMCV",
                               "bgMCD",
                               "cbMComma",
                               "IDC_STATIC_COMMA_10B_MASK",
                               "leCommaMask",
                               "IDC_STATIC_MSB_COMMA",
                               "IDC_STATIC_LSB_COMMA",
                               "cbVComma",
                               "cbAlignMSB",
                               "IDC_STATIC_ALIGN_COMMA_WORD",
                               "cbAlign"};
    auto In = [](const std::vector<const char*>& v, const char* n) {
        for (const char* x : v)
            if (std::string(x) == n)
                return true;
        return false;
    };
    for (const Case& c : cases) {
        Qvz_WizData d = LoadFixture("gt.json");
        Qvz_Block* b = d.GetActiveBlock();
        for (const Edit& e : c.edits) {
            if (!e.value) {
                b->RemoveAttribute(e.name);
                continue;
            }
            Qvz_Attribute* a = b->AddAttribute(e.name, e.value);
            a->SetDefaultValue(e.value);
            a->SetEditable(e.editable);
        }
        RcdGui t(std::move(d));
        t.gui->onActive();
        for (const char* n : all) {
            EXPECT_EQ(t.Shown(n), !In(c.hidden, n)) << c.label << ": " << n;
            if (!In(c.hidden, n)) {
                EXPECT_EQ(t.Enabled(n), !In(c.disabled, n)) << c.label << ": " << n;
            }
        }
    }
}

TEST(CommaDetectGui, GroupsDoNotStayGreyFromAnEarlierBlock) {
    // A turned-off block greys the groups; a block without comma patterns
    // shown next must still offer its detection choices.
    Qvz_WizData d = LoadFixture("gt.json");
    d.GetActiveBlock()->GetNamedAttribute("QVZX_ONLY_TURNOFF_COMMA")->SetValue("TRUE");
    auto bare = std::make_unique<Qvz_Block>(*d.GetActiveBlock());
    bare->SetName("BARE");
    bare->SetIsUsed(false);
    for (const char* n : {"QVZX_ONLY_TURNOFF_COMMA", "PCOMMA_10B_VALUE", "MCOMMA_10B_VALUE"})
        bare->RemoveAttribute(n);
    d.AddBlock(std::move(bare));
    RcdGui t(std::move(d));
    t.gui->onActive();
    EXPECT_FALSE(t.Enabled("gbPCD"));
    EXPECT_FALSE(t.Enabled("gbMCD"));

    t.data.SetAllBlksIsActive(false);
    t.data.GetNamedBlock("BARE")->SetIsUsed(true);
    t.gui->onActive();
    for (const char* n : {"gbPCD", "bgPCD", "rbAlwaysPCD", "gbMCD", "bgMCD", "rbDynamicMCD"})
        EXPECT_TRUE(t.Enabled(n)) << n;
    EXPECT_FALSE(t.Enabled("lePCV"));
    EXPECT_FALSE(t.Enabled("leMCV"));
}

TEST(CommaDetectGui, TurningCommaHandlingOffAndOn) {
    for (const char* fixture : {"gt.json", "gt11.json"}) {
        const bool gt11 = std::string(fixture) == "gt11.json";
        const QString zeros = gt11 ? "000" : "0000000000";
        RcdGui t(fixture);
        t.gui->onActive();
        const QString pcv = t.Text("lePCV"), mask = t.Text("leCommaMask");
        t.W<QCheckBox>("cbAlignMSB")->setChecked(!gt11); // gt: already on; gt11: edit it on
        t.W<QCheckBox>("cbVComma")->setChecked(true);

        t.W<QCheckBox>("cbDisableCD")->setChecked(true);
        EXPECT_TRUE(t.Page()->m_turnOffComma) << fixture;
        for (const char* n : kCommaControls)
            EXPECT_FALSE(t.Enabled(n)) << fixture << ": " << n;
        EXPECT_TRUE(t.Enabled("cbDisableCD"));
        EXPECT_EQ(t.Text("leCommaMask"), zeros) << fixture;
        EXPECT_EQ(t.Text("lePCV"), pcv) << fixture;
        EXPECT_FALSE(t.Checked("cbPComma")) << fixture;
        EXPECT_FALSE(t.Checked("cbMComma")) << fixture;
        EXPECT_FALSE(t.Checked("cbAlignMSB")) << fixture;
        EXPECT_TRUE(t.Checked("cbVComma")) << fixture;

        // Back on: the decoder flags, MSB alignment and mask come from the block.
        t.W<QCheckBox>("cbDisableCD")->setChecked(false);
        for (const char* n : kCommaControls)
            EXPECT_TRUE(t.Enabled(n)) << fixture << ": " << n;
        EXPECT_EQ(t.Text("leCommaMask"), mask) << fixture;
        EXPECT_TRUE(t.Checked("cbPComma")) << fixture;
        EXPECT_TRUE(t.Checked("cbMComma")) << fixture;
        EXPECT_EQ(t.Checked("cbAlignMSB"), !gt11) << fixture;
    }
}

TEST(CommaDetectGui, NextWhileOffWritesTheTurnedOffValues) {
    RcdGui t("gt.json");
    t.gui->onActive();
    t.W<QCheckBox>("cbDisableCD")->setChecked(true);
    // Disabled entries are not checked.
    t.SetText("lePCV", "12");
    t.SetText("leMCV", "");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(t.Messages().empty());
    const struct {
        const char* name;
        const char* value;
    } written[] = {{"QVZX_ONLY_TURNOFF_COMMA", "TRUE"}, {"DEC_PCOMMA_DETECT", "FALSE"},
                   {"DEC_MCOMMA_DETECT", "FALSE"},      {"ALIGN_COMMA_MSB", "FALSE"},
                   {"DEC_VALID_COMMA_ONLY", "TRUE"},    {"QVZX_ONLY_PCOMMA_CTRL", "DISABLE"},
                   {"PCOMMA_DETECT", "FALSE"},          {"QVZX_ONLY_MCOMMA_CTRL", "DISABLE"},
                   {"MCOMMA_DETECT", "FALSE"},          {"COMMA_10B_MASK", "0000000000"}};
    for (const auto& w : written)
        EXPECT_EQ(t.Value(w.name), w.value) << w.name;

    // Coming back shows it off, with the slot quiet while the form loads.
    t.gui->onActive();
    EXPECT_TRUE(t.Checked("cbDisableCD"));
    EXPECT_FALSE(t.Enabled("lePCV"));
    EXPECT_TRUE(t.Checked("rbDisablePCD"));
    EXPECT_TRUE(t.Checked("rbDisableMCD"));
}

TEST(CommaDetectGui, FirstBadEnabledEntryStopsNext) {
    struct Case {
        const char* fixture;
        const char* entry;
        const char* text;
        const char* message;
    };
    const Case cases[] = {
        {"gt.json", "lePCV", "001111100",
         "Please enter a valid 10-bit binary value for Plus-comma value"},
        {"gt.json", "leMCV", "", "Please enter a valid 10-bit binary value for Minus-comma value"},
        {"gt.json", "leCommaMask", "11111111111",
         "Please enter a valid 10-bit binary value for Comma Mask"},
        {"gt11.json", "lePCV", "17C",
         "Please enter a valid 8-digit hex value for Plus-comma value"},
        {"gt11.json", "leMCV", "0000028G",
         "Please enter a valid 8-digit hex value for Minus-comma value"},
        {"gt11.json", "leCommaMask", "3F", "Please enter a valid 3-digit hex value for Comma Mask"},
    };
    const char* const order[] = {"lePCV", "leMCV", "leCommaMask"};
    for (const Case& c : cases) {
        RcdGui t(c.fixture);
        t.gui->onActive();
        // This entry and every later one are bad: only this one speaks.
        bool from = false;
        for (const char* e : order) {
            from = from || std::string(e) == c.entry;
            if (from)
                t.SetText(e, c.text);
        }
        const Qvz_Block before(*t.data.GetActiveBlock());
        EXPECT_FALSE(t.gui->onNext()) << c.fixture << " " << c.entry;
        ASSERT_EQ(t.Messages().size(), 1u) << c.fixture << " " << c.entry;
        EXPECT_EQ(t.Messages()[0], c.message);
        const Qvz_Message& m = t.sink.messages[0];
        EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3);
        EXPECT_EQ(t.gui->pageWidget()->focusWidget(), t.W<QWidget>(c.entry)) << c.entry;
        EXPECT_TRUE(*t.data.GetActiveBlock() == before) << c.fixture << " " << c.entry;
    }

    // An entry whose attribute is fixed is disabled and not checked.
    RcdGui fixed("gt10.json");
    fixed.gui->onActive();
    EXPECT_FALSE(fixed.Enabled("lePCV"));
    fixed.SetText("lePCV", "xyz");
    EXPECT_TRUE(fixed.gui->onNext());
    EXPECT_TRUE(fixed.Messages().empty());
}

TEST(CommaDetectGui, BackDropsEditsNextWritesThem) {
    RcdGui t("gt.json");
    t.gui->onActive();
    const Qvz_Block before(*t.data.GetActiveBlock());
    t.SetText("lePCV", "0011111000");
    t.SetText("leCommaMask", "0000000111");
    t.W<QRadioButton>("rbDisableMCD")->setChecked(true);
    t.W<QRadioButton>("rbAlwaysPCD")->setChecked(true);
    t.W<QCheckBox>("cbVComma")->setChecked(false);
    t.W<QComboBox>("cbAlign")->setCurrentIndex(0);
    t.SetText("leMCV", "bad"); // Back does not check either
    EXPECT_TRUE(t.gui->onBack());
    EXPECT_TRUE(*t.data.GetActiveBlock() == before);
    EXPECT_TRUE(t.Messages().empty());

    // The next activation shows the block again; Next then writes the edits.
    t.gui->onActive();
    EXPECT_EQ(t.Text("lePCV"), "0101111100");
    EXPECT_EQ(t.Text("leMCV"), "1010000011");
    t.SetText("lePCV", "0011111000");
    t.SetText("leCommaMask", "0000000111");
    t.W<QRadioButton>("rbDisableMCD")->setChecked(true);
    t.W<QRadioButton>("rbAlwaysPCD")->setChecked(true);
    t.W<QCheckBox>("cbVComma")->setChecked(false);
    t.W<QComboBox>("cbAlign")->setCurrentIndex(0);
    EXPECT_TRUE(t.gui->onNext());
    const struct {
        const char* name;
        const char* value;
    } written[] = {{"PCOMMA_10B_VALUE", "0011111000"}, {"MCOMMA_10B_VALUE", "1010000011"},
                   {"COMMA_10B_MASK", "0000000111"},   {"QVZX_ONLY_PCOMMA_CTRL", "ALWAYS"},
                   {"PCOMMA_DETECT", "TRUE"},          {"QVZX_ONLY_MCOMMA_CTRL", "DISABLE"},
                   {"MCOMMA_DETECT", "FALSE"},         {"DEC_VALID_COMMA_ONLY", "FALSE"},
                   {"ALIGN_COMMA_WORD", "1"},          {"QVZX_ONLY_TURNOFF_COMMA", "FALSE"}};
    for (const auto& w : written)
        EXPECT_EQ(t.Value(w.name), w.value) << w.name;
}

TEST(CommaDetectGui, FinishWritesWithoutCheckingAndWriteFailureKeepsThePage) {
    RcdGui t("gt11.json");
    t.gui->onActive();
    t.SetText("leMCV", "283");
    EXPECT_FALSE(t.gui->onFinish()); // the framework's own answer
    EXPECT_TRUE(t.Messages().empty());
    EXPECT_EQ(t.Value("MCOMMA_10B_VALUE"), "10'h283");
    EXPECT_EQ(t.Value("MCOMMA_32B_VALUE"), "32'h00000283");
    EXPECT_TRUE(t.gui->onCancel());

    t.SetText("leMCV", "00000283");
    t.data.SetAllBlksIsActive(false);
    EXPECT_TRUE(t.gui->onFinish());
    EXPECT_FALSE(t.gui->onNext());
    EXPECT_TRUE(t.gui->onBack());
    // Activating without a block leaves the form alone and does not crash.
    t.gui->onActive();
    EXPECT_TRUE(t.gui->IsActive());
    t.W<QCheckBox>("cbDisableCD")->setChecked(true);
}

TEST(CommaDetectGui, AlignmentWordList) {
    // An empty list keeps the block's word; a word the list lacks shows the
    // first item, which Next then writes.
    const struct {
        const char* value;
        std::vector<const char*> legal;
        const char* shown;
        const char* written;
    } cases[] = {
        {"2", {"1", "2"}, "2", "2"},
        {"4", {}, "", "4"},
        {"8", {"1", "2"}, "1", "1"},
    };
    for (const auto& c : cases) {
        Qvz_WizData d = LoadFixture("gt.json");
        Qvz_Attribute* a = d.GetActiveBlock()->GetNamedAttribute("ALIGN_COMMA_WORD");
        a->SetValue(c.value);
        a->GetLegalValues().RemoveAll();
        for (const char* l : c.legal)
            a->GetLegalValues().Add(l);
        RcdGui t(std::move(d));
        t.gui->onActive();
        EXPECT_EQ(t.W<QComboBox>("cbAlign")->count(), static_cast<int>(c.legal.size()));
        EXPECT_EQ(t.W<QComboBox>("cbAlign")->currentText(), c.shown) << c.value;
        EXPECT_TRUE(t.gui->onNext());
        EXPECT_EQ(t.Value("ALIGN_COMMA_WORD"), c.written) << c.value;
    }
}

TEST(CommaDetectGui, ValidationSlotsThroughTheMetaObject) {
    struct Case {
        const char* fixture;
        const char* slot;
        const char* entry;
        const char* text;
        const char* message; // nullptr: nothing said
    };
    const char* const binValue = "Please enter a valid 10-bit binary value for comma value";
    const char* const hexValue = "Please enter a valid 8-digit hex decimal value for comma value";
    const Case cases[] = {
        {"gt.json", "ValidatePComma", "lePCV", "001111100", binValue},
        {"gt.json", "ValidatePComma", "lePCV", "0011111000", nullptr},
        {"gt.json", "ValidateMComma", "leMCV", "", binValue},
        // Too long is as wrong as too short.
        {"gt.json", "ValidateMComma", "leMCV", "11000000000", binValue},
        {"gt.json", "ValidateCommaMask", "leCommaMask", "111",
         "Please enter a valid 10-bit binary value for comma mask"},
        {"gt11.json", "ValidatePComma", "lePCV", "17C", hexValue},
        {"gt11.json", "ValidateMComma", "leMCV", "0000028G", hexValue},
        {"gt11.json", "ValidateMComma", "leMCV", "00000283", nullptr},
        {"gt11.json", "ValidateCommaMask", "leCommaMask", "3F",
         "Please enter a valid 3-digit hex decimal value for comma mask"},
        {"gt11.json", "ValidateCommaMask", "leCommaMask", "3fF", nullptr},
    };
    for (const Case& c : cases) {
        RcdGui t(c.fixture);
        t.gui->onActive();
        t.SetText(c.entry, c.text);
        ASSERT_TRUE(QMetaObject::invokeMethod(t.gui, c.slot)) << c.slot;
        const std::string label = std::string(c.fixture) + " " + c.slot + " '" + c.text + "'";
        if (!c.message) {
            EXPECT_TRUE(t.Messages().empty()) << label;
            continue;
        }
        ASSERT_EQ(t.Messages().size(), 1u) << label;
        EXPECT_EQ(t.Messages()[0], c.message) << label;
        EXPECT_FALSE(t.sink.messages[0].flag1);
        EXPECT_EQ(t.gui->pageWidget()->focusWidget(), t.W<QWidget>(c.entry)) << label;
    }
}

TEST(CommaDetectGui, PageNameFormAndMoreInfo) {
    RcdGui t("gt10.json");
    EXPECT_EQ(t.gui->pageName(), "Receiver Comma Detect Setup");
    EXPECT_EQ(t.gui->Form(), t.gui->pageWidget());
    EXPECT_EQ(t.Page()->GetGuiDlg(), t.gui);
    EXPECT_FALSE(t.gui->isAdvanced());
    t.gui->onMoreInfo();
    EXPECT_EQ(t.help.keys, std::vector<std::string>{"qvz_mgtrx1"});
}

TEST(CommaDetectGui, WindowRunThroughTheDialog) {
    // The dialog initialises the page before showing it, so cbDisableCD
    // works there; Finish on the page writes it.
    Qvz_WizData data = LoadFixture("gt10.json");
    Qvz_MGTWizMain main("Velomux Wizard", false);
    Qvz_RecordingSink sink;
    main.SetWizData(&data);
    main.SetMessageSink(&sink);
    main.SetRunMode(Qvz_RunMode::Window);
    QString shown;
    bool maskZero = false;
    DialogDriver driver({
        [] { Click("buttonNext"); },
        [] { Click("buttonNext"); },
        [&] {
            shown = CurrentPageName();
            if (Wg_Wizard* w = FindWizard()) {
                if (auto* cb = w->findChild<QCheckBox*>("cbDisableCD"))
                    cb->click();
                if (auto* le = w->findChild<QLineEdit*>("leCommaMask"))
                    maskZero = le->text() == "0000000000";
            }
        },
        [] { Click("buttonFinish"); },
        [] { Click("buttonFinish"); },
    });
    driver.Start();
    EXPECT_EQ(main.Run(), Qvz_RunCompleted);
    EXPECT_FALSE(driver.TimedOut());
    EXPECT_EQ(shown, "Receiver Comma Detect Setup");
    EXPECT_TRUE(maskZero);
    Qvz_Block* b = data.GetActiveBlock();
    ASSERT_NE(b, nullptr);
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_TURNOFF_COMMA"), "TRUE");
    EXPECT_EQ(b->GetAttributeValue("COMMA_10B_MASK"), "0000000000");
    EXPECT_EQ(b->GetAttributeValue("DEC_MCOMMA_DETECT"), "FALSE");
}
