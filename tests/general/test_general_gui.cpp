// The General Setup controller and form inside a real wizard dialog,
// offscreen, with the real widgets found by object name.

#include "GeneralSetupWidget.h"
#include "HostRunner.h"
#include "PageGuiSupport.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTGeneralSetup.h"
#include "Qvz_MGTGeneralSetupGui.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"
#include "Wg_Wizard.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QKeySequence>
#include <QLabel>
#include <QMetaMethod>
#include <QRadioButton>
#include <QStackedWidget>
#include <QVBoxLayout>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace {

std::vector<std::string> Items(const QComboBox* combo) {
    std::vector<std::string> out;
    for (int i = 0; i < combo->count(); ++i)
        out.push_back(combo->itemText(i).toStdString());
    return out;
}

// A window run's wizard main over a fixture, its dialog built and shown on
// the General Setup page.
struct Session {
    explicit Session(const char* fixture, const std::function<void(Qvz_WizData&)>& edit = {}) {
        TestApp();
        QString err;
        EXPECT_TRUE(Qvz_DesignJson::LoadFile(TestData(QString("general/") + fixture), data, err))
            << err.toStdString();
        if (edit)
            edit(data);
        main.SetWizData(&data);
        main.SetRunMode(Qvz_RunMode::Window);
        main.SetMessageSink(&sink);
        main.SetHelpHandler(&help);
        main.Prepare();
        wizard = std::make_unique<Wg_Wizard>();
        main.BuildDialog(wizard.get());
        page = static_cast<Qvz_MGTGeneralSetup*>(main.GetPage(Qvz_MGTWizMain::kGeneralSetup));
        gui = qobject_cast<Qvz_MGTGeneralSetupGui*>(page->GetGuiDlg());
        EXPECT_NE(gui, nullptr);
        wizard->show();
    }
    ~Session() { wizard.reset(); } // the controllers go with the dialog, before the pages

    template <class T = QWidget> T* W(const char* name) {
        T* w = gui->pageWidget()->findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    bool Shown(const char* name) { return !W(name)->isHidden(); }
    bool Enabled(const char* name) { return W(name)->isEnabled(); }
    bool Checked(const char* name) { return W<QAbstractButton>(name)->isChecked(); }
    void Click(const char* name) { W<QAbstractButton>(name)->click(); }
    std::string Text(const char* combo) { return W<QComboBox>(combo)->currentText().toStdString(); }
    // What choosing an item of a list does.
    void Choose(const char* combo, const char* text) {
        QComboBox* c = W<QComboBox>(combo);
        const int i = c->findText(text);
        if (i >= 0)
            c->setCurrentIndex(i);
        emit c->textActivated(QString(text));
    }
    std::string Value(const char* attr) {
        Qvz_Block* b = data.GetActiveBlock();
        const Qvz_Attribute* a = b ? b->GetNamedAttribute(attr) : nullptr;
        return a ? a->GetValue().str() : "<absent>";
    }
    std::vector<std::string> Messages() const { return MessageTexts(sink); }
    // '1' or '0' for pages 1..5.
    std::string LaterPages() const {
        std::string s;
        for (int i = 1; i < Qvz_MGTWizMain::kPageCount; ++i)
            s += wizard->isPageEnabled(Qvz_MGTWizMain::PageTitle(i)) ? '1' : '0';
        return s;
    }
    std::string CurrentPage() const {
        return wizard->currentPage() ? wizard->currentPage()->pageName().toStdString() : "";
    }

    Qvz_WizData data;
    Qvz_RecordingSink sink;
    RecordingHelp help;
    Qvz_MGTWizMain main{"w", false};
    std::unique_ptr<Wg_Wizard> wizard;
    Qvz_MGTGeneralSetup* page = nullptr;
    Qvz_MGTGeneralSetupGui* gui = nullptr;
};

} // namespace

TEST(GeneralSetupGui, SlotsInTheirOrder) {
    const QMetaObject& mo = Qvz_MGTGeneralSetupGui::staticMetaObject;
    EXPECT_STREQ(mo.className(), "Qvz_MGTGeneralSetupGui");
    EXPECT_EQ(mo.superClass(), &Wg_WizardPage::staticMetaObject);
    std::vector<std::string> names;
    for (int i = mo.methodOffset(); i < mo.methodCount(); ++i) {
        const QMetaMethod m = mo.method(i);
        EXPECT_EQ(m.methodType(), QMetaMethod::Slot) << m.methodSignature().toStdString();
        EXPECT_EQ(m.access(), QMetaMethod::Public) << m.methodSignature().toStdString();
        names.push_back(m.methodSignature().toStdString());
        const bool answers = names.back() == "onCancel()" || names.back() == "onBack()" ||
                             names.back() == "onNext()" || names.back() == "onFinish()";
        EXPECT_EQ(m.returnType(), answers ? QMetaType::Bool : QMetaType::Void) << names.back();
    }
    const std::vector<std::string> expected = {"onActive()",
                                               "onCancel()",
                                               "onBack()",
                                               "onNext()",
                                               "onFinish()",
                                               "onMoreInfo()",
                                               "init()",
                                               "OnComboDataWidth(QString)",
                                               "OnComboMGTType(QString)",
                                               "OnRadioRefClk()",
                                               "OnCheckRefClk()",
                                               "OnCheckTXRX()",
                                               "OnSingleMGT()",
                                               "InitUIData()"};
    EXPECT_EQ(names, expected);
}

TEST(GeneralSetupGui, FormControlsAsDesigned) {
    TestApp();
    GeneralSetupWidget form;
    EXPECT_EQ(form.windowTitle(), "Form3");
    ASSERT_NE(qobject_cast<QVBoxLayout*>(form.layout()), nullptr);
    EXPECT_EQ(form.layout()->objectName(), "GeneralSetupWidgetLayout");
    const int checked = 1, unchecked = 0, any = -1;
    const struct {
        const char* name;
        const char* kind;
        const char* parent;
        const char* text;
        int state;
    } controls[] = {
        {"textLabel1", "QLabel", "GeneralSetupWidget", nullptr, any},
        {"groupBox1", "QGroupBox", "GeneralSetupWidget", "Select the transceiver", any},
        {"cbTransceiver", "QComboBox", "groupBox1", nullptr, any},
        {"textLabel1_2", "QLabel", "groupBox1", "Data width:", any},
        {"cbMGTWidth", "QComboBox", "groupBox1", nullptr, any},
        {"textLabel2", "QLabel", "groupBox1", "Byte", any},
        {"cbTX", "QCheckBox", "groupBox1", "&Transmitter", checked},
        {"cbRX", "QCheckBox", "groupBox1", "Receiver", unchecked},
        {"gbRefClkSelection", "QGroupBox", "GeneralSetupWidget", "Reference clock selection", any},
        {"groupBox17", "QGroupBox", "gbRefClkSelection", "", any},
        {"bgRefClkSelectionGT3", "QGroupBox", "groupBox17", "", any},
        {"rbUseREFCLK", "QRadioButton", "bgRefClkSelectionGT3", "Use REFCLK/2", checked},
        {"rbUseBREFCLK", "QRadioButton", "bgRefClkSelectionGT3", "Use BREFCLK/2", unchecked},
        {"gbRefClkSelectionGT10", "QGroupBox", "groupBox17", "", any},
        {"cbUseREFCLK", "QCheckBox", "gbRefClkSelectionGT10", "Use REFCLK/2", unchecked},
        {"cbUseBREFCLK", "QCheckBox", "gbRefClkSelectionGT10", "Use BREFCLK", unchecked},
        {"groupBox22", "QGroupBox", "gbRefClkSelection", "", any},
        {"gbREFCLK", "QGroupBox", "groupBox22", "", any},
        {"bgREFCLK", "QGroupBox", "gbREFCLK", "", any},
        {"rbDynamicControl", "QRadioButton", "bgREFCLK", "Dynamic control", checked},
        {"rbStaticControl", "QRadioButton", "bgREFCLK", "Static control", unchecked},
        {"bgStaticControl", "QGroupBox", "gbREFCLK", "", any},
        {"rbREFCLK", "QRadioButton", "bgStaticControl", "REFCLK", checked},
        {"rbREFCLK2", "QRadioButton", "bgStaticControl", "REFCLK2", unchecked},
        {"gbBREFCLK", "QGroupBox", "groupBox22", "", any},
        {"bgBREFCLK", "QGroupBox", "gbBREFCLK", "", any},
        {"rbDynamicControlB", "QRadioButton", "bgBREFCLK", "Dynamic control", checked},
        {"rbStaticControlB", "QRadioButton", "bgBREFCLK", "Static control", unchecked},
        {"bgStaticControlB", "QGroupBox", "gbBREFCLK", "", any},
        {"rbBREFCLK", "QRadioButton", "bgStaticControlB", "BREFCLK", checked},
        {"rbBREFCLK2", "QRadioButton", "bgStaticControlB", "BREFCLK2", unchecked},
        {"bgTXRef", "QGroupBox", "GeneralSetupWidget", "TX Reference Clock Selection", any},
        {"rbTXREFCLK", "QRadioButton", "bgTXRef", "Use REFCLK1", checked},
        {"rbTXREFCLK2", "QRadioButton", "bgTXRef", "Use REFCLK2", unchecked},
        {"rbTXGREFCLK", "QRadioButton", "bgTXRef", "Use GREFCLK", unchecked},
        {"bgRXRef", "QGroupBox", "GeneralSetupWidget", "RX Reference Clock Selection", any},
        {"rbRXREFCLK", "QRadioButton", "bgRXRef", "Use REFCLK1", checked},
        {"rbRXREFCLK2", "QRadioButton", "bgRXRef", "Use REFCLK2", unchecked},
        {"rbRXGREFCLK", "QRadioButton", "bgRXRef", "Use GREFCLK", unchecked},
        {"cbBypassPCS", "QCheckBox", "GeneralSetupWidget",
         "Bypass PCS features (Use SERDES with CDR only)", unchecked},
        {"cbHalfRate", "QCheckBox", "GeneralSetupWidget", "Half-rate mode", unchecked},
        {"bgGT11Mode", "QGroupBox", "GeneralSetupWidget", "MGT usage in the tile", any},
        {"radioBothMGTs", "QRadioButton", "bgGT11Mode", "Use both MGTs in the tile", unchecked},
        {"radioSingleMGT", "QRadioButton", "bgGT11Mode", "Use a single MGT in the tile", unchecked},
        {"buttonGrpSingleMGT", "QGroupBox", "bgGT11Mode", "", any},
        {"radioA", "QRadioButton", "buttonGrpSingleMGT", "Use MGT \"A\"", unchecked},
        {"radioB", "QRadioButton", "buttonGrpSingleMGT", "Use MGT \"B\"", unchecked},
        {"gbPMASpeed", "QGroupBox", "GeneralSetupWidget", "", any},
        {"textLabel3", "QLabel", "gbPMASpeed", "PMA Speed:", any},
        {"cbPMASpeed", "QComboBox", "gbPMASpeed", nullptr, any},
        {"cbEnablePMA", "QCheckBox", "GeneralSetupWidget", "Enable dynamic PMA configuration",
         unchecked},
        {"bgImpedence", "QGroupBox", "GeneralSetupWidget", "Termination impedance", any},
        {"rb50Ohms", "QRadioButton", "bgImpedence", "50 Ohms", checked},
        {"rb75Ohms", "QRadioButton", "bgImpedence", "75 Ohms", unchecked},
    };
    // Widgets in the order they were made (a depth-first walk of the tree).
    const QList<QWidget*> made = form.findChildren<QWidget*>();
    int previous = -1;
    for (const auto& c : controls) {
        QWidget* w = form.findChild<QWidget*>(c.name);
        ASSERT_NE(w, nullptr) << c.name;
        EXPECT_STREQ(w->metaObject()->className(), c.kind) << c.name;
        EXPECT_EQ(w->parentWidget()->objectName().toStdString(), c.parent) << c.name;
        const int at = static_cast<int>(made.indexOf(w));
        EXPECT_GT(at, previous) << c.name << " made out of order";
        previous = at;
        QString text;
        if (auto* b = qobject_cast<QAbstractButton*>(w))
            text = b->text();
        else if (auto* g = qobject_cast<QGroupBox*>(w))
            text = g->title();
        else if (auto* l = qobject_cast<QLabel*>(w))
            text = l->text();
        if (c.text) {
            EXPECT_EQ(text.toStdString(), c.text) << c.name;
        }
        if (c.state != any) {
            EXPECT_EQ(qobject_cast<QAbstractButton*>(w)->isChecked(), c.state == checked) << c.name;
        }
    }
    EXPECT_TRUE(form.textLabel1->wordWrap());
    EXPECT_EQ(form.cbTX->shortcut(), QKeySequence("Alt+T"));
    EXPECT_TRUE(form.buttonGrpSingleMGT->isFlat());
    // Each group's buttons are numbered in the order they were made.
    const struct {
        QButtonGroup* group;
        std::vector<QAbstractButton*> buttons;
    } groups[] = {
        {form.bgRefClkSelectionGT3Buttons, {form.rbUseREFCLK, form.rbUseBREFCLK}},
        {form.bgREFCLKButtons, {form.rbDynamicControl, form.rbStaticControl}},
        {form.bgStaticControlButtons, {form.rbREFCLK, form.rbREFCLK2}},
        {form.bgBREFCLKButtons, {form.rbDynamicControlB, form.rbStaticControlB}},
        {form.bgStaticControlBButtons, {form.rbBREFCLK, form.rbBREFCLK2}},
        {form.bgTXRefButtons, {form.rbTXREFCLK, form.rbTXREFCLK2, form.rbTXGREFCLK}},
        {form.bgRXRefButtons, {form.rbRXREFCLK, form.rbRXREFCLK2, form.rbRXGREFCLK}},
        {form.bgGT11ModeButtons, {form.radioBothMGTs, form.radioSingleMGT}},
        {form.buttonGrpSingleMGTButtons, {form.radioA, form.radioB}},
        {form.bgImpedenceButtons, {form.rb50Ohms, form.rb75Ohms}},
    };
    for (const auto& g : groups) {
        EXPECT_TRUE(g.group->exclusive());
        ASSERT_EQ(g.group->buttons().size(), static_cast<qsizetype>(g.buttons.size()));
        for (int i = 0; i < static_cast<int>(g.buttons.size()); ++i)
            EXPECT_EQ(g.group->id(g.buttons[i]), i) << g.group->objectName().toStdString();
    }
}

TEST(GeneralSetupGui, FamilyShowsItsControlsAndUserGuide) {
    const char* const controls[] = {
        "cbHalfRate",  "bgImpedence", "gbBREFCLK",    "bgRefClkSelectionGT3", "gbPMASpeed",
        "cbEnablePMA", "cbUseREFCLK", "cbUseBREFCLK", "cbBypassPCS",          "gbRefClkSelection",
        "bgTXRef",     "bgRXRef",     "bgGT11Mode"};
    const struct {
        const char* fixture;
        const char* shown; // per control above
        const char* guide;
    } cases[] = {
        {"gui_gt.json", "1111000011000", "DOC1"},
        {"gui_gt10.json", "0000111111000", "DOC2"},
        {"gui_gt11.json", "0000000000111", "DOC3"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.fixture);
        Session r(c.fixture);
        std::string shown;
        for (const char* name : controls)
            shown += r.Shown(name) ? '1' : '0';
        EXPECT_EQ(shown, c.shown);
        const std::string note = r.W<QLabel>("textLabel1")->text().toStdString();
        const std::string expected =
            std::string("In order to ensure a successful multi-gigabit transceiver design, please "
                        "review the Korvane Velomux Transceiver User Guide, ") +
            c.guide +
            ".  The user guide contains detailed information on digital and analog design "
            "considerations, including board level design guidelines to facilitate your system "
            "design.  The user guide is available on the Korvane support website, ";
        EXPECT_EQ(note.substr(0, expected.size()), expected);
        const std::string tail =
            " in the documentation category under the Products and Services heading.";
        ASSERT_GT(note.size(), expected.size() + tail.size());
        EXPECT_EQ(note.substr(note.size() - tail.size()), tail);
    }
}

TEST(GeneralSetupGui, TypeListSortedFromOfferedFamilies) {
    const struct {
        const char* fixture;
        const char* activate; // primitive of another block to make the active one
        std::vector<std::string> types;
    } cases[] = {
        {"gui_gt.json", nullptr, {"Custom", "Ethernet", "FibreChannel"}},
        // Never the obsolete or renamed primitives, nor another family's.
        {"gui_gt10.json", nullptr, {"10G Custom", "Ethernet", "OC192", "OC48"}},
        {"gui_gt11.json", nullptr, {"Amberlane", "Custom"}},
        // The current type is offered even when no offered block carries it.
        {"gui_gt.json", "GT10_CUSTOM", {"10G Custom", "Custom", "Ethernet", "FibreChannel"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.fixture) + (c.activate ? c.activate : ""));
        Session r(c.fixture, [&](Qvz_WizData& d) {
            if (!c.activate)
                return;
            d.SetAllBlksIsActive(false);
            d.GetPrimitiveBlock(c.activate)->SetIsUsed(true);
        });
        EXPECT_EQ(Items(r.W<QComboBox>("cbTransceiver")), c.types);
        EXPECT_EQ(r.Text("cbTransceiver"), r.page->m_displayName.str());
    }
}

TEST(GeneralSetupGui, FirstDisplayShowsTheBlock) {
    {
        SCOPED_TRACE("GT");
        Session r("gui_gt.json");
        EXPECT_EQ(Items(r.W<QComboBox>("cbMGTWidth")), (std::vector<std::string>{"1", "2", "4"}));
        EXPECT_EQ(r.Text("cbMGTWidth"), "2");
        EXPECT_TRUE(r.Checked("cbHalfRate"));
        EXPECT_TRUE(r.Enabled("cbHalfRate"));
        EXPECT_TRUE(r.Checked("rb75Ohms"));
        // REF_CLK_V_SEL "1": BREFCLK is used, so only its group is open.
        EXPECT_TRUE(r.Checked("rbUseBREFCLK"));
        EXPECT_FALSE(r.Enabled("gbREFCLK"));
        EXPECT_TRUE(r.Enabled("gbBREFCLK"));
        EXPECT_TRUE(r.Checked("rbStaticControlB"));
        EXPECT_TRUE(r.Checked("rbBREFCLK2"));
        EXPECT_TRUE(r.Enabled("bgStaticControlB"));
        EXPECT_TRUE(r.Checked("rbDynamicControl"));
        EXPECT_TRUE(r.Checked("rbREFCLK"));
        EXPECT_FALSE(r.Enabled("bgStaticControl"));
        EXPECT_TRUE(r.Checked("cbTX"));
        EXPECT_TRUE(r.Checked("cbRX"));
        EXPECT_FALSE(r.Checked("cbBypassPCS"));
        // Choosing REFCLK opens the other group.
        r.Click("rbUseREFCLK");
        EXPECT_TRUE(r.Enabled("gbREFCLK"));
        EXPECT_FALSE(r.Enabled("gbBREFCLK"));
        r.Click("rbStaticControl");
        EXPECT_TRUE(r.Enabled("bgStaticControl"));
    }
    {
        SCOPED_TRACE("GT10");
        Session r("gui_gt10.json");
        EXPECT_EQ(r.Text("cbTransceiver"), "10G Custom");
        EXPECT_EQ(Items(r.W<QComboBox>("cbPMASpeed")),
                  (std::vector<std::string>{"31_64", "32_64"}));
        EXPECT_EQ(r.Text("cbPMASpeed"), "31_64");
        EXPECT_TRUE(r.Enabled("cbPMASpeed"));
        EXPECT_TRUE(r.Checked("cbUseREFCLK"));
        EXPECT_FALSE(r.Checked("cbUseBREFCLK"));
        EXPECT_TRUE(r.Enabled("gbREFCLK"));
        EXPECT_FALSE(r.Enabled("gbBREFCLK"));
        EXPECT_FALSE(r.Checked("cbEnablePMA"));
        r.Click("cbUseREFCLK");
        EXPECT_FALSE(r.Enabled("gbREFCLK"));
    }
    {
        SCOPED_TRACE("GT11");
        Session r("gui_gt11.json");
        EXPECT_TRUE(r.Checked("radioSingleMGT"));
        EXPECT_TRUE(r.Checked("radioB"));
        EXPECT_TRUE(r.Enabled("buttonGrpSingleMGT"));
        EXPECT_TRUE(r.Checked("rbTXREFCLK2"));
        EXPECT_TRUE(r.Checked("rbRXGREFCLK"));
        EXPECT_TRUE(r.Checked("cbTX"));
        EXPECT_FALSE(r.Checked("cbRX"));
        // The first display raises no OnCheckTXRX: the RX clocks stay open
        // until the user toggles the check boxes.
        EXPECT_TRUE(r.Enabled("bgRXRef"));
        EXPECT_TRUE(r.Enabled("bgTXRef"));
        r.Click("cbRX");
        EXPECT_TRUE(r.Enabled("bgRXRef"));
        r.Click("cbRX");
        EXPECT_FALSE(r.Enabled("bgRXRef"));
        r.Click("cbTX");
        EXPECT_FALSE(r.Enabled("bgTXRef"));
        r.Click("radioBothMGTs");
        EXPECT_FALSE(r.Enabled("buttonGrpSingleMGT"));
        r.Click("radioSingleMGT");
        EXPECT_TRUE(r.Enabled("buttonGrpSingleMGT"));
    }
}

TEST(GeneralSetupGui, Gt10CustomWidthChangesOnlyThePmaSpeeds) {
    Session r("gui_gt10.json");
    // Settings the user made before changing the width.
    r.Click("cbUseBREFCLK");
    r.Click("rbStaticControl");
    r.Click("rbREFCLK2");
    r.Click("cbEnablePMA");
    r.Click("cbRX");

    r.Choose("cbMGTWidth", "2");
    EXPECT_EQ(Items(r.W<QComboBox>("cbPMASpeed")), (std::vector<std::string>{"16_64", "31_64"}));
    EXPECT_EQ(r.Text("cbPMASpeed"), "31_64");
    r.Choose("cbMGTWidth", "1");
    EXPECT_EQ(Items(r.W<QComboBox>("cbPMASpeed")), (std::vector<std::string>{"8_64", "16_64"}));
    // The page's speed is not allowed at this width: the width's default shows.
    EXPECT_EQ(r.Text("cbPMASpeed"), "8_64");
    EXPECT_EQ(r.page->m_pmaSpeed.str(), "31_64");
    EXPECT_EQ(r.page->m_dataWidth.str(), "4"); // the page was not re-read

    EXPECT_TRUE(r.Checked("cbUseBREFCLK"));
    EXPECT_TRUE(r.Checked("rbStaticControl"));
    EXPECT_TRUE(r.Checked("rbREFCLK2"));
    EXPECT_TRUE(r.Checked("cbEnablePMA"));
    EXPECT_FALSE(r.Checked("cbRX"));
    EXPECT_EQ(r.Text("cbMGTWidth"), "1");

    r.wizard->next();
    EXPECT_EQ(r.CurrentPage(), "Transmitter Setup");
    EXPECT_EQ(r.Value("QVZ_RX_DATA_WIDTH"), "1");
    EXPECT_EQ(r.Value("QVZ_TX_DATA_WIDTH"), "1");
    EXPECT_EQ(r.Value("PMA_SPEED"), "8_64");
    EXPECT_EQ(r.Value("QVZX_ONLY_USE_BREFCLK"), "TRUE");
    EXPECT_EQ(r.Value("QVZX_ONLY_REFCLK_DYN"), "STATIC");
    EXPECT_EQ(r.Value("QVZX_ONLY_REFCLK"), "REFCLK2");
    EXPECT_EQ(r.Value("QVZX_ONLY_ENABLE_PMA"), "TRUE");
    EXPECT_EQ(r.Value("QVZ_BOOL_RX_USE"), "FALSE");
}

TEST(GeneralSetupGui, TypeAndWidthChangesReadTheirBlock) {
    Session r("gui_gt10.json");
    Qvz_Block* oc48at4 = r.data.GetNamedBlock("GT10_OC48_4_INST");
    Qvz_Block* oc48at2 = r.data.GetNamedBlock("GT10_OC48_2_INST");

    r.Choose("cbTransceiver", "OC48"); // at the shown width, 4
    EXPECT_EQ(r.page->m_pBlock, oc48at4);
    EXPECT_EQ(Items(r.W<QComboBox>("cbMGTWidth")), (std::vector<std::string>{"2", "4"}));
    EXPECT_EQ(r.Text("cbMGTWidth"), "4");
    EXPECT_FALSE(r.Checked("cbUseREFCLK"));
    EXPECT_TRUE(r.Checked("cbUseBREFCLK"));
    EXPECT_TRUE(r.Checked("rbStaticControl"));
    EXPECT_TRUE(r.Checked("rbREFCLK2"));
    EXPECT_FALSE(r.Checked("cbRX"));
    EXPECT_FALSE(r.Enabled("gbREFCLK"));
    EXPECT_TRUE(r.Enabled("gbBREFCLK"));

    r.Choose("cbMGTWidth", "2");
    EXPECT_EQ(r.page->m_pBlock, oc48at2);
    EXPECT_EQ(r.page->m_dataWidth.str(), "2");
    EXPECT_TRUE(r.Checked("cbRX")); // a missing QVZ_BOOL_RX_USE reads as used

    // A width or type without a block leaves page and form as they are.
    r.Click("cbRX");
    r.Choose("cbMGTWidth", "8");
    r.Choose("cbTransceiver", "Nonexistent");
    EXPECT_EQ(r.page->m_pBlock, oc48at2);
    EXPECT_FALSE(r.Checked("cbRX"));
    EXPECT_TRUE(r.page->m_rxUse);

    // A type offered only at another width is found all the same.
    r.Choose("cbTransceiver", "OC192");
    EXPECT_EQ(r.page->m_pBlock, r.data.GetNamedBlock("GT10_OC192_8_INST"));
    EXPECT_EQ(r.Text("cbTransceiver"), "OC192");
    EXPECT_EQ(Items(r.W<QComboBox>("cbMGTWidth")), (std::vector<std::string>{"8"}));
    EXPECT_EQ(r.Text("cbMGTWidth"), "8");
    EXPECT_TRUE(r.Messages().empty());
}

TEST(GeneralSetupGui, WidthOnGtAndGt11CustomIsTakenAtNext) {
    {
        SCOPED_TRACE("GT");
        Session r("gui_gt.json");
        r.Choose("cbMGTWidth", "4");
        EXPECT_EQ(r.page->m_dataWidth.str(), "2");
        r.wizard->next();
        EXPECT_EQ(r.Value("RX_DATA_WIDTH"), "4");
        EXPECT_EQ(r.Value("TX_DATA_WIDTH"), "4");
        Qvz_Block* b = r.data.GetActiveBlock();
        ASSERT_NE(b, nullptr);
        EXPECT_EQ(b->GetNamedPin("TXDATA")->GetWidth(), 32);
        EXPECT_EQ(b->GetNamedPin("TXCHARISK")->GetWidth(), 4);
        EXPECT_EQ(r.Value("REF_CLK_V_SEL"), "1");
        EXPECT_EQ(r.Value("SERDES_10B"), "TRUE");
        EXPECT_EQ(r.Value("TERMINATION_IMP"), "75");
        EXPECT_EQ(r.Value("QVZX_ONLY_BREFCLK_DYN"), "STATIC");
        EXPECT_EQ(r.Value("QVZX_ONLY_BREFCLK"), "BREFCLK2");
    }
    {
        SCOPED_TRACE("GT11");
        Session r("gui_gt11.json");
        r.Click("rbTXGREFCLK");
        r.Choose("cbMGTWidth", "4");
        EXPECT_EQ(r.page->m_dataWidth.str(), "2");
        EXPECT_TRUE(r.Checked("rbTXGREFCLK"));
        r.Click("radioA");
        r.Click("cbRX");
        r.wizard->next();
        EXPECT_EQ(r.Value("QVZ_RX_DATA_WIDTH"), "4");
        EXPECT_EQ(r.Value("TXABPMACLKSEL"), "GREFCLK");
        EXPECT_EQ(r.Value("RXPMACLKSEL"), "GREFCLK");
        EXPECT_EQ(r.Value("QVZ_GT11_MODE"), "SINGLE");
        EXPECT_EQ(r.Value("QVZ_GT11_USE_B"), "FALSE");
        EXPECT_EQ(r.Value("CHAN_BOND_MODE"), "NONE");
    }
}

TEST(GeneralSetupGui, Gt11OtherTypeFollowsTheWidth) {
    Session r("gui_gt11.json");
    r.Choose("cbTransceiver", "Amberlane"); // shown width 2
    EXPECT_EQ(r.page->m_pBlock, r.data.GetNamedBlock("GT11_AMBERLANE_2_INST"));
    EXPECT_TRUE(r.Checked("radioBothMGTs"));
    EXPECT_FALSE(r.Enabled("buttonGrpSingleMGT"));
    EXPECT_TRUE(r.Checked("rbTXGREFCLK"));
    r.Choose("cbMGTWidth", "4");
    EXPECT_EQ(r.page->m_pBlock, r.data.GetNamedBlock("GT11_AMBERLANE_INST"));
    EXPECT_TRUE(r.Checked("rbTXREFCLK"));
    EXPECT_TRUE(r.Checked("rbRXREFCLK2"));
}

TEST(GeneralSetupGui, NextWithoutDirectionsKeepsThePage) {
    Session r("gui_gt10.json");
    r.Click("cbTX");
    r.Click("cbRX");
    r.wizard->next();
    EXPECT_EQ(r.CurrentPage(), "General Setup");
    EXPECT_EQ(r.Messages(),
              std::vector<std::string>{"Please select transmitter mode and/or receiver mode."});
    EXPECT_EQ(r.Value("QVZ_BOOL_TX_USE"), "TRUE");
    EXPECT_EQ(r.Value("QVZ_BOOL_RX_USE"), "TRUE");
    // Once a direction is chosen again the page lets the user on.
    r.Click("cbRX");
    r.wizard->next();
    EXPECT_EQ(r.CurrentPage(), "Receiver Comma Detect Setup");
    EXPECT_EQ(r.Value("QVZ_BOOL_TX_USE"), "FALSE");
}

TEST(GeneralSetupGui, NextEnablesTheLaterPagesOfTheChosenPrimitive) {
    const struct {
        const char* fixture;
        const char* type;      // chosen before Next, or null
        const char* click;     // a button clicked before Next, or null
        const char* primitive; // the block written and active afterwards
        const char* pages;     // pages 1..5 enabled
        const char* nextPage;
    } cases[] = {
        {"gui_gt10.json", nullptr, nullptr, "GT10_CUSTOM", "11111", "Transmitter Setup"},
        {"gui_gt10.json", "Ethernet", nullptr, "GT10_ETHERNET_4", "10111", "Transmitter Setup"},
        {"gui_gt10.json", "OC48", "cbRX", "GT10_OC48_4", "11100", "Transmitter Setup"},
        {"gui_gt10.json", nullptr, "cbTX", "GT10_CUSTOM", "01111", "Receiver Comma Detect Setup"},
        {"gui_gt10.json", nullptr, "cbBypassPCS", "GT10_CUSTOM", "11100", "Transmitter Setup"},
        {"gui_gt.json", nullptr, nullptr, "GT_FIBRE_CHAN", "10110", "Transmitter Setup"},
        {"gui_gt.json", "Custom", nullptr, "GT_CUSTOM", "11111", "Transmitter Setup"},
        {"gui_gt.json", "Custom", "cbRX", "GT_CUSTOM", "10000", "Transmitter Setup"},
        {"gui_gt11.json", nullptr, "cbRX", "GT11_CUSTOM", "11110", "Transmitter Setup"},
        {"gui_gt11.json", nullptr, nullptr, "GT11_CUSTOM", "10000", "Transmitter Setup"},
        {"gui_gt11.json", "Amberlane", nullptr, "GT11_AMBERLANE_2", "11101", "Transmitter Setup"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.fixture) + " " + (c.type ? c.type : "") + " " +
                     (c.click ? c.click : ""));
        Session r(c.fixture);
        if (c.type)
            r.Choose("cbTransceiver", c.type);
        if (c.click)
            r.Click(c.click);
        r.wizard->next();
        EXPECT_TRUE(r.Messages().empty());
        EXPECT_EQ(r.LaterPages(), c.pages);
        EXPECT_EQ(r.CurrentPage(), c.nextPage);
        std::vector<std::string> active;
        for (const auto& b : r.data.GetBlocks())
            if (b->IsUsed())
                active.push_back(b->GetPrimitiveName().str());
        EXPECT_EQ(active, std::vector<std::string>{c.primitive});
    }
}

TEST(GeneralSetupGui, EmptyListsKeepThePageValues) {
    // A block without legal widths or speeds leaves its list empty; Next must
    // not write an empty width (data pins of no bits) or an empty speed.
    const struct {
        const char* fixture;
        const char* primitive;
        std::vector<const char*> unlisted; // attributes whose legal values go
        const char* attr;
        const char* value;
    } cases[] = {
        {"gui_gt.json", "GT_FIBRE_CHAN", {"RX_DATA_WIDTH"}, "RX_DATA_WIDTH", "2"},
        {"gui_gt10.json",
         "GT10_CUSTOM",
         {"PMA_SPEED", "QVZ_PMA_SPEED_1", "QVZ_PMA_SPEED_2", "QVZ_PMA_SPEED_4", "QVZ_PMA_SPEED_8"},
         "PMA_SPEED",
         "31_64"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.attr);
        Session r(c.fixture, [&](Qvz_WizData& d) {
            Qvz_Block* b = d.GetPrimitiveBlock(c.primitive);
            for (const char* name : c.unlisted)
                b->GetNamedAttribute(name)->GetLegalValues().RemoveAll();
        });
        r.wizard->next();
        EXPECT_EQ(r.CurrentPage(), "Transmitter Setup");
        EXPECT_EQ(r.Value(c.attr), c.value);
        if (Qvz_Pin* pin = r.data.GetActiveBlock()->GetNamedPin("TXDATA")) {
            EXPECT_EQ(pin->GetWidth(), 16);
        }
    }
}

TEST(GeneralSetupGui, BackFinishAndCancelSaveNothing) {
    Session r("gui_gt10.json");
    r.Click("cbRX");
    r.Choose("cbMGTWidth", "8");
    EXPECT_TRUE(r.gui->onBack());
    EXPECT_TRUE(r.gui->onCancel());
    r.wizard->finish(); // Finish is refused here: nothing is chosen yet
    EXPECT_EQ(r.CurrentPage(), "General Setup");
    EXPECT_TRUE(r.wizard->isVisible());
    EXPECT_TRUE(r.page->m_rxUse);
    EXPECT_EQ(r.page->m_dataWidth.str(), "4");
    EXPECT_EQ(r.Value("QVZ_BOOL_RX_USE"), "TRUE");
    EXPECT_EQ(r.Value("QVZ_RX_DATA_WIDTH"), "4");

    // Coming back from the next page the form keeps what the user left.
    r.wizard->next();
    ASSERT_EQ(r.CurrentPage(), "Transmitter Setup");
    r.wizard->back();
    ASSERT_EQ(r.CurrentPage(), "General Setup");
    EXPECT_FALSE(r.Checked("cbRX"));
    EXPECT_EQ(r.Text("cbMGTWidth"), "8");
    EXPECT_TRUE(r.wizard->findChild<QWidget*>("buttonMoreInfo")->isEnabled());
    r.wizard->moreInfo();
    EXPECT_EQ(r.help.keys, std::vector<std::string>{"qvz_mgtintro"});
}

TEST(GeneralSetupGui, FitsTheDialogWithoutOverlaps) {
    for (const char* fixture : {"gui_gt.json", "gui_gt10.json", "gui_gt11.json"}) {
        SCOPED_TRACE(fixture);
        Session r(fixture);
        QWidget* form = r.gui->pageWidget();
        r.wizard->resize(860, 600); // the dialog's default size
        QApplication::processEvents();
        EXPECT_EQ(r.wizard->size(), QSize(860, 600)) << "a form forced the dialog to grow";
        // The form fits its page without scrolling.
        QWidget* viewport = form->parentWidget();
        ASSERT_NE(viewport, nullptr);
        EXPECT_LE(form->minimumSizeHint().height(), viewport->height());
        EXPECT_LE(form->minimumSizeHint().width(), viewport->width());

        QList<QWidget*> parents = form->findChildren<QWidget*>();
        parents.prepend(form);
        for (QWidget* parent : parents) {
            if (!parent->isVisible())
                continue;
            std::vector<QWidget*> kids;
            for (QObject* o : parent->children())
                if (auto* w = qobject_cast<QWidget*>(o); w && w->isVisible())
                    kids.push_back(w);
            for (std::size_t i = 0; i < kids.size(); ++i) {
                const std::string name = kids[i]->objectName().toStdString();
                EXPECT_TRUE(parent->rect().contains(kids[i]->geometry())) << name << " cut off";
                EXPECT_GE(kids[i]->width(), kids[i]->minimumSizeHint().width()) << name;
                EXPECT_GE(kids[i]->height(), kids[i]->minimumSizeHint().height()) << name;
                for (std::size_t j = i + 1; j < kids.size(); ++j) {
                    EXPECT_FALSE(kids[i]->geometry().intersects(kids[j]->geometry()))
                        << name << " overlaps " << kids[j]->objectName().toStdString();
                }
            }
        }
    }
}
