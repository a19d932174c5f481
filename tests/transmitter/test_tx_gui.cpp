// The transmitter controller and form, driven offscreen through their slots
// with the real widgets found by object name.

#include "PageGuiSupport.h"
#include "Qvz_MGTTXWidget.h"
#include "Qvz_MGTTransmitterGui.h"
#include "TxTestSupport.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMetaMethod>
#include <QRadioButton>
#include <QSlider>

#include <memory>

using namespace txtest;

namespace {

// A window-mode wizard over data with the transmitter controller created.
struct TxGui {
    explicit TxGui(Qvz_WizData d) : data(std::move(d)) {
        App();
        wiz = std::make_unique<Wizard>(data, Qvz_RunMode::Window);
        wiz->main.SetHelpHandler(&help);
        EXPECT_TRUE(wiz->Page()->CreateGuiDlg(&parent));
        gui = wiz->Page()->m_pGui;
    }
    explicit TxGui(const char* fixture) : TxGui(LoadFixture(fixture)) {}

    template <class T> T* W(const char* name) {
        T* w = gui->pageWidget()->findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    bool Shown(const char* name) { return !W<QWidget>(name)->isHidden(); }
    bool Enabled(const char* name) { return W<QWidget>(name)->isEnabled(); }
    void SetText(const char* name, const char* text) { W<QLineEdit>(name)->setText(text); }

    Qvz_WizData data;
    RecordingHelp help;
    QWidget parent;
    std::unique_ptr<Wizard> wiz;
    Qvz_MGTTransmitterGui* gui = nullptr;
};

} // namespace

TEST(TransmitterGui, SlotsInTheirOrder) {
    const std::vector<std::string> names = OwnSlots(Qvz_MGTTransmitterGui::staticMetaObject);
    const std::vector<std::string> expected = {
        "onActive()",          "onCancel()",         "onBack()",        "onNext()",
        "onFinish()",          "onMoreInfo()",       "init()",          "OnRadioEncoding()",
        "OnCheckPostDriver()", "OnCheckPreDriver()", "OnCheckUseCrc()", "Validate_leCRCValue()",
        "ValidateLE_ALL()"};
    EXPECT_EQ(names, expected);
}

TEST(TransmitterGui, FormControlsAsDesigned) {
    App();
    Qvz_MGTTXWidget form;
    EXPECT_EQ(form.windowTitle(), "Korvane Velomux Wizard - Transmitter Setup");
    const struct {
        const char* name;
        const char* text;
    } texts[] = {
        {"gbEncoding", "Encoding"},
        {"bgEncoding", ""},
        {"rbDEC", "D&ynamic encoding control"},
        {"rbSEC", "Static encoding c&ontrol"},
        {"rbDisableEncoding", "Disable encoding"},
        {"bgStaticEncodingControl", ""},
        {"rbEnable8B10B", "Enable 8B/10B encoding"},
        {"rbEnable64", "Enable 64B/66B encoding, scrambler, gearbox"},
        {"gbPre", ""},
        {"textLabel1", "Pre-emphasis:"},
        {"textLabel6_2", "(Weakest)"},
        {"textLabel2_2", "20%"},
        {"textLabel3_2", "25%"},
        {"textLabel7_2", "33%"},
        {"textLabel1_2", "10%"},
        {"textLabel5_2", "(Strongest)"},
        {"textLabel2", "Output Voltage swing:"},
        {"textLabel3", "mV"},
        {"gbCRC", "CRC (Cyclic Redundancy Check)"},
        {"cbCRC", "&Use CRC for transmitter"},
        {"IDC_STATIC_CRC_FORMAT", "CRC format:"},
        {"IDC_STATIC_TX_CRC_FORCE_VALUE", "Forced CRC value (8-bit vector):"},
        {"leCRCValue", "XXXXXXXX"},
        {"IDC_STATIC_CRC_START_OF_PKT", "Start-Of-Packet (SOP) K-character:"},
        {"IDC_STATIC_CRC_END_OF_PKT", "End-Of-Packet (EOP) K-character:"},
        {"labelCRCwidth", "CRC data width:"},
        {"checkboxRatio", "Allow 2:1 ratio for TXCRCCLK : TXCRCINTCLK"},
        {"labelCRCinit", "TXCRCINITVAL (32-bit vector):"},
        {"leCRCinit", ""},
        {"gbEmphasis", "TX Emphasis Controls"},
        {"cbPreDriver", "Power up TX pre-driver"},
        {"labelPreTap", "Set TXPRE_TAP_DAC (5-bit binary):"},
        {"lePreTapDac", "XXXXX"},
        {"labelDatTap", "Set TXDAT_TAP_DAC (5-bit binary):"},
        {"leDatTapDac", "XXXXX"},
        {"cbPostDriver", "Power up TX post-driver"},
        {"labelPostTap", "Set TXPOST_TAP_DAC (5-bit binary):"},
        {"lePostTapDac", "XXXXX"},
    };
    for (const auto& t : texts) {
        QObject* o = form.findChild<QObject*>(t.name);
        ASSERT_NE(o, nullptr) << t.name;
        QString text;
        if (auto* l = qobject_cast<QLabel*>(o))
            text = l->text();
        else if (auto* b = qobject_cast<QAbstractButton*>(o))
            text = b->text();
        else if (auto* g = qobject_cast<QGroupBox*>(o))
            text = g->title();
        else if (auto* e = qobject_cast<QLineEdit*>(o))
            text = e->text();
        EXPECT_EQ(text.toStdString(), t.text) << t.name;
    }
    for (const char* flat : {"bgEncoding", "bgStaticEncodingControl", "gbSlider"})
        EXPECT_TRUE(form.findChild<QGroupBox*>(flat)->isFlat()) << flat;
    EXPECT_TRUE(form.rbDisableEncoding->isChecked());
    EXPECT_TRUE(form.rbEnable8B10B->isChecked());
    EXPECT_EQ(form.bgEncodingButtons->id(form.rbDEC), 0);
    EXPECT_EQ(form.bgEncodingButtons->id(form.rbSEC), 1);
    EXPECT_EQ(form.bgEncodingButtons->id(form.rbDisableEncoding), 2);
    EXPECT_EQ(form.bgStaticEncodingControlButtons->id(form.rbEnable64), 1);
    EXPECT_EQ(form.sPre->orientation(), Qt::Horizontal);
    EXPECT_EQ(form.sPre->minimum(), 0);
    EXPECT_EQ(form.sPre->maximum(), 3);
    EXPECT_EQ(form.sPre->pageStep(), 1);
    EXPECT_EQ(form.sPre->value(), 0);
    EXPECT_EQ(form.leCRCValue->maxLength(), 8);
    EXPECT_EQ(form.lePreTapDac->maxLength(), 5);
    EXPECT_EQ(form.leCRCinit->maxLength(), 32767);

    auto Items = [](QComboBox* c) {
        QStringList l;
        for (int i = 0; i < c->count(); ++i)
            l << c->itemText(i);
        return l.join(',').toStdString();
    };
    const std::string designed[] = {
        "400,500,600,700,800", "USER_MODE,ETHERNET,INFINIBAND,FIBRE_CHAN",
        "K28_0,K28_1,K28_2,K28_3,K28_4,K28_5,K28_6,K28_7,K23_7,K27_7,K30_7",
        "K28_0,K28_1,K28_2,K28_3,K28_4,K28_5,K28_6,K28_7,K23_7,K27_7,K29_7,K30_7", ""};
    QComboBox* lists[] = {form.cbOVS, form.cbCRCFormat, form.cbSOP, form.cbEOP, form.cbCRCwidth};
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(Items(lists[i]), designed[i]) << i;
    // languageChange starts the lists again from the designed items.
    form.cbOVS->clear();
    form.cbOVS->addItem("1");
    form.cbCRCwidth->addItem("16");
    form.languageChange();
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(Items(lists[i]), designed[i]) << i;
}

TEST(TransmitterGui, FamilyDecidesWhatIsShownAndEnabled) {
    struct Case {
        const char* fixture;
        bool bypass;
        bool pre;       // gbPre and gbOVS shown
        bool rb64Shown; // rbEnable64 shown
        bool encoding;  // gbEncoding enabled
        bool disable;   // rbDisableEncoding enabled
        bool dynamic;   // rbDEC enabled
        bool emphasis;  // gbEmphasis shown
    };
    const Case cases[] = {
        {"gt_custom.json", false, true, false, true, true, false, false},
        {"gt_fibre_chan.json", false, true, false, true, false, false, false},
        {"gt10_custom.json", false, false, true, true, true, true, true},
        {"gt10_custom.json", true, false, true, false, false, false, true},
        {"gt11_custom.json", true, false, true, false, false, false, true},
        {"gt11_custom.json", false, false, true, true, true, true, true},
    };
    for (const Case& c : cases) {
        Qvz_WizData d = LoadFixture(c.fixture);
        d.GetActiveBlock()->AddAttribute("QVZX_ONLY_BYPASS_PCS", c.bypass ? "TRUE" : "FALSE");
        TxGui t(std::move(d));
        t.gui->onActive();
        const std::string label = std::string(c.fixture) + (c.bypass ? " bypass" : "");
        EXPECT_EQ(t.Shown("gbPre"), c.pre) << label;
        EXPECT_EQ(t.Shown("gbOVS"), c.pre) << label;
        EXPECT_EQ(t.Shown("rbEnable64"), c.rb64Shown) << label;
        EXPECT_EQ(t.Enabled("gbEncoding"), c.encoding) << label;
        EXPECT_EQ(t.Enabled("rbSEC"), c.encoding) << label;
        EXPECT_EQ(t.Enabled("rbDisableEncoding"), c.disable) << label;
        EXPECT_EQ(t.Enabled("rbDEC"), c.dynamic) << label;
        EXPECT_EQ(t.Shown("gbEmphasis"), c.emphasis) << label;
        EXPECT_TRUE(t.gui->IsActive()) << label;
    }
}

TEST(TransmitterGui, Gt10SpeedLimitsTheEncodingChoices) {
    struct Case {
        const char* prim;
        const char* speed;
        const char* encoding;
        bool all, dynamic, b8, b64; // enabled: gbEncoding, rbDEC, rbEnable8B10B, rbEnable64
    };
    const Case cases[] = {
        {"GT10_CUSTOM", "SPD_ALL", "STATIC", true, true, true, true},
        // Static choices only count while static encoding is chosen.
        {"GT10_CUSTOM", "SPD_ALL", "DYNAMIC", true, true, false, false},
        {"GT10_CUSTOM", "SPD_NONE_64", "STATIC", true, false, false, true},
        {"GT10_CUSTOM", "SPD_NONE_8", "STATIC", true, false, true, false},
        {"GT10_CUSTOM", "SPD_64_ONLY", "STATIC", false, false, false, false},
        {"GT10_CUSTOM", "SPD_NONE_ONLY", "DISABLE", false, false, false, false},
        // Zephine and 10GFC primitives ignore the speed lists.
        {"GT10_ZEPHINE_4", "SPD_NONE_8", "STATIC", true, true, true, true},
        {"GT10_10GFC_8", "SPD_NONE_64", "STATIC", true, true, true, true},
    };
    for (const Case& c : cases) {
        QJsonObject doc =
            EditFixture("gt10_custom.json", {{"PMA_SPEED", c.speed, c.speed},
                                             {"QVZX_ONLY_ENCODING", c.encoding, nullptr}});
        QJsonArray blocks = doc["blocks"].toArray();
        QJsonObject b = blocks[0].toObject();
        b["primitive"] = c.prim;
        blocks[0] = b;
        doc["blocks"] = blocks;
        TxGui t(LoadDoc(doc));
        t.gui->onActive();
        const std::string label = std::string(c.prim) + "/" + c.speed + "/" + c.encoding;
        EXPECT_EQ(t.Enabled("gbEncoding"), c.all) << label;
        EXPECT_EQ(t.Enabled("rbDEC"), c.dynamic) << label;
        EXPECT_EQ(t.Enabled("rbEnable8B10B"), c.b8) << label;
        EXPECT_EQ(t.Enabled("rbEnable64"), c.b64) << label;
    }
}

TEST(TransmitterGui, EncodingRadiosUpdateTheStaticChoices) {
    TxGui t("gt10_custom.json"); // dynamic encoding
    t.gui->onActive();
    EXPECT_TRUE(t.W<QRadioButton>("rbDEC")->isChecked());
    EXPECT_FALSE(t.Enabled("rbEnable64"));
    t.W<QRadioButton>("rbSEC")->click();
    EXPECT_EQ(t.wiz->Page()->m_encodingMode, 2);
    EXPECT_TRUE(t.Enabled("rbEnable64"));
    EXPECT_TRUE(t.Enabled("rbEnable8B10B"));
    t.W<QRadioButton>("rbDisableEncoding")->click();
    EXPECT_EQ(t.wiz->Page()->m_encodingMode, 0);
    EXPECT_FALSE(t.Enabled("rbEnable64"));
    // A first-family block without an editable encoding keeps the group off.
    Qvz_WizData d = LoadFixture("gt_custom.json");
    Attr(d, "QVZX_ONLY_ENCODING")->SetEditable(false);
    TxGui gt(std::move(d));
    gt.gui->onActive();
    EXPECT_FALSE(gt.Enabled("gbEncoding"));
}

TEST(TransmitterGui, CrcControlsFollowTheCheckBox) {
    Qvz_WizData d = LoadFixture("gt10_custom.json");
    Attr(d, "QVZ_TXCRC_USE")->SetValue("FALSE");
    Attr(d, "CRC_END_OF_PKT")->SetEditable(false);
    TxGui t(std::move(d));
    t.gui->onActive();
    const char* controls[] = {"IDC_STATIC_CRC_FORMAT",
                              "cbCRCFormat",
                              "leCRCValue",
                              "cbSOP",
                              "labelCRCwidth",
                              "cbCRCwidth",
                              "checkboxRatio",
                              "labelCRCinit",
                              "leCRCinit",
                              "cbEOP"};
    EXPECT_TRUE(t.Shown("gbCRC"));
    EXPECT_FALSE(t.W<QCheckBox>("cbCRC")->isChecked());
    for (const char* name : controls) {
        EXPECT_TRUE(t.Shown(name)) << name;
        EXPECT_FALSE(t.Enabled(name)) << name;
    }
    t.W<QCheckBox>("cbCRC")->setChecked(true);
    EXPECT_TRUE(t.wiz->Page()->m_crcUse);
    for (const char* name : controls)
        EXPECT_EQ(t.Enabled(name), std::string(name) != "cbEOP") << name;
    t.W<QCheckBox>("cbCRC")->setChecked(false);
    EXPECT_FALSE(t.Enabled("leCRCinit"));

    // Rows of absent attributes are hidden; without either CRC flag the
    // whole group is.
    TxGui gt("gt_custom.json");
    gt.gui->onActive();
    EXPECT_TRUE(gt.Enabled("cbCRCFormat"));
    for (const char* name : {"labelCRCwidth", "cbCRCwidth", "checkboxRatio", "leCRCinit"})
        EXPECT_FALSE(gt.Shown(name)) << name;
    Qvz_WizData bare = LoadFixture("gt_custom.json");
    bare.GetActiveBlock()->RemoveAttribute("TX_CRC_USE");
    TxGui none(std::move(bare));
    none.gui->onActive();
    EXPECT_FALSE(none.Shown("gbCRC"));
    // The primitive's CRC flag is not offered under a bypassed PCS.
    Qvz_WizData bypass = LoadFixture("gt11_custom.json");
    TxGui by(std::move(bypass));
    by.gui->onActive();
    EXPECT_TRUE(by.Shown("cbCRC"));
    EXPECT_FALSE(by.Enabled("cbCRC"));
}

TEST(TransmitterGui, DriverCheckBoxesEnableTheirDacs) {
    TxGui t("gt10_custom.json"); // pre-driver off, post-driver on
    t.gui->onActive();
    EXPECT_FALSE(t.Enabled("lePreTapDac"));
    EXPECT_FALSE(t.Enabled("labelPreTap"));
    EXPECT_TRUE(t.Enabled("lePostTapDac"));
    t.W<QCheckBox>("cbPreDriver")->setChecked(true);
    t.W<QCheckBox>("cbPostDriver")->setChecked(false);
    EXPECT_TRUE(t.Enabled("lePreTapDac"));
    EXPECT_FALSE(t.Enabled("lePostTapDac"));
    EXPECT_FALSE(t.Enabled("labelPostTap"));
    EXPECT_TRUE(t.Enabled("leDatTapDac"));
}

TEST(TransmitterGui, ActivationShowsTheBlock) {
    TxGui t("gt10_custom.json");
    t.gui->onActive();
    EXPECT_EQ(t.W<QLineEdit>("leCRCinit")->text(), "DEADBEEF");
    EXPECT_EQ(t.W<QLineEdit>("leCRCValue")->text(), "00001111");
    EXPECT_EQ(t.W<QLineEdit>("lePreTapDac")->text(), "00011");
    EXPECT_EQ(t.W<QLineEdit>("leDatTapDac")->text(), "10101");
    EXPECT_EQ(t.W<QComboBox>("cbCRCwidth")->currentText(), "16");
    EXPECT_EQ(t.W<QComboBox>("cbCRCwidth")->count(), 4);
    EXPECT_EQ(t.W<QComboBox>("cbCRCFormat")->currentText(), "INFINIBAND");
    EXPECT_EQ(t.W<QComboBox>("cbSOP")->currentText(), "K27_7");
    EXPECT_EQ(t.W<QComboBox>("cbEOP")->currentText(), "K28_0");
    EXPECT_TRUE(t.W<QCheckBox>("cbCRC")->isChecked());
    EXPECT_TRUE(t.W<QCheckBox>("checkboxRatio")->isChecked());
    EXPECT_FALSE(t.W<QCheckBox>("cbPreDriver")->isChecked());
    EXPECT_TRUE(t.W<QRadioButton>("rbEnable64")->isChecked());

    // Next from an untouched form writes what a batch run writes.
    Qvz_WizData batchData = LoadFixture("gt10_custom.json");
    Wizard batch(batchData, Qvz_RunMode::Batch);
    ASSERT_TRUE(batch.Page()->DoBatchPage());
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(*t.data.GetActiveBlock() == *batchData.GetActiveBlock());
}

TEST(TransmitterGui, GtSliderAndSwing) {
    const struct {
        const char* value;
        const char* range;
        int min, max, pos;
        const char* written;
    } cases[] = {
        {"2", "0..3", 0, 3, 2, "2"},   {"0", "3..1", 1, 3, 1, "1"}, {"7", "0..3", 0, 3, 3, "3"},
        {"abc", "0..3", 0, 3, 0, "0"}, {"", "1..2", 1, 2, 1, "1"},
    };
    for (const auto& c : cases) {
        Qvz_WizData d = LoadFixture("gt_custom.json");
        Qvz_Attribute* a = Attr(d, "TX_PREEMPHASIS");
        a->SetValue(c.value);
        a->GetLegalValues().RemoveAll();
        a->GetLegalValues().Add(c.range);
        TxGui t(std::move(d));
        t.gui->onActive();
        QSlider* s = t.W<QSlider>("sPre");
        EXPECT_EQ(s->minimum(), c.min) << c.value;
        EXPECT_EQ(s->maximum(), c.max) << c.value;
        EXPECT_EQ(s->value(), c.pos) << c.value;
        EXPECT_EQ(t.wiz->Page()->m_preEmphasisLevel, c.pos) << c.value;
        EXPECT_EQ(t.W<QComboBox>("cbOVS")->currentText(), "600");
        EXPECT_TRUE(t.gui->onNext()) << c.value;
        EXPECT_EQ(Value(t.data, "TX_PREEMPHASIS"), c.written) << c.value;
    }
    TxGui t("gt_custom.json");
    t.gui->onActive();
    t.W<QSlider>("sPre")->setValue(1);
    t.W<QComboBox>("cbOVS")->setCurrentIndex(4);
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_EQ(Value(t.data, "TX_PREEMPHASIS"), "1");
    EXPECT_EQ(Value(t.data, "TX_DIFF_CTRL"), "800");
}

TEST(TransmitterGui, UnlistedCrcFormatFallsBackToDefault) {
    Qvz_WizData d = LoadFixture("gt_custom.json");
    Attr(d, "CRC_FORMAT")->SetValue("BOGUS");
    TxGui t(std::move(d));
    t.gui->onActive();
    EXPECT_EQ(Value(t.data, "CRC_FORMAT"), "USER_MODE");
    EXPECT_EQ(t.W<QComboBox>("cbCRCFormat")->currentText(), "USER_MODE");
}

TEST(TransmitterGui, EmptyListsDoNotBlankTheirAttributes) {
    Qvz_WizData d = LoadFixture("gt10_custom.json");
    Attr(d, "QVZ_TXCRC_DATAWIDTH")->GetLegalValues().RemoveAll();
    TxGui t(std::move(d));
    t.gui->onActive();
    EXPECT_EQ(t.W<QComboBox>("cbCRCwidth")->count(), 0);
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_EQ(Value(t.data, "QVZ_TXCRC_DATAWIDTH"), "16");
}

TEST(TransmitterGui, NextChecksOnlyEnabledEntries) {
    // CRC off: the forced value is disabled and not checked.
    Qvz_WizData d = LoadFixture("gt_custom.json");
    Attr(d, "TX_CRC_USE")->SetValue("FALSE");
    TxGui t(std::move(d));
    t.gui->onActive();
    t.SetText("leCRCValue", "12");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(t.wiz->Messages().empty());
    EXPECT_EQ(Value(t.data, "TX_CRC_FORCE_VALUE"), "12");
    // Turned on, it stops Next.
    t.W<QCheckBox>("cbCRC")->setChecked(true);
    EXPECT_FALSE(t.gui->onNext());
    ASSERT_EQ(t.wiz->Messages().size(), 1u);
    EXPECT_EQ(t.wiz->Messages()[0], "Please enter a valid 8-bit binary value for Forced CRC value");
}

TEST(TransmitterGui, HiddenEntriesDoNotHoldNext) {
    // Without TXCRCINITVAL its entry is hidden but stays enabled with CRC on:
    // bad text there must not stop Next with a message about an unseen field.
    Qvz_WizData d = LoadFixture("gt10_custom.json");
    d.GetActiveBlock()->RemoveAttribute("TXCRCINITVAL");
    TxGui t(std::move(d));
    t.gui->onActive();
    t.W<QCheckBox>("cbCRC")->setChecked(true);
    t.SetText("leCRCinit", "not hex");
    ASSERT_TRUE(t.Enabled("leCRCinit"));
    ASSERT_FALSE(t.Shown("leCRCinit"));
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(t.wiz->Messages().empty());
}

TEST(TransmitterGui, FirstBadEntryStopsNextWithItsMessageAndFocus) {
    struct Case {
        const char* entry;
        const char* text;
        const char* message;
    };
    const Case cases[] = {
        {"leCRCValue", "0101010", "Please enter a valid 8-bit binary value for Forced CRC value"},
        {"lePreTapDac", "0101", "Please enter a valid 5-bit binary value for TXPRE_TAP_DAC"},
        {"leDatTapDac", "012", "Please enter a valid 5-bit binary value for TXDAT_TAP_DAC"},
        {"lePostTapDac", "", "Please enter a valid 5-bit binary value for TXPOST_TAP_DAC"},
        {"leCRCinit", "DEADBEEG", "Please enter a valid 8-digit gex value for TXCRCINITVAL"},
    };
    for (std::size_t i = 0; i < std::size(cases); ++i) {
        TxGui t("gt10_custom.json");
        t.gui->onActive();
        t.W<QCheckBox>("cbPreDriver")->setChecked(true);
        // This entry and every later one are bad: only this one speaks.
        for (std::size_t j = i; j < std::size(cases); ++j)
            t.SetText(cases[j].entry, cases[j].text);
        const Qvz_Block before(*t.data.GetActiveBlock());
        EXPECT_FALSE(t.gui->onNext()) << cases[i].entry;
        ASSERT_EQ(t.wiz->Messages().size(), 1u) << cases[i].entry;
        EXPECT_EQ(t.wiz->Messages()[0], cases[i].message);
        EXPECT_FALSE(t.wiz->sink.messages[0].flag1);
        EXPECT_EQ(t.gui->pageWidget()->focusWidget(), t.W<QWidget>(cases[i].entry))
            << cases[i].entry;
        EXPECT_TRUE(*t.data.GetActiveBlock() == before) << cases[i].entry;
    }
}

TEST(TransmitterGui, BackWritesWithoutChecking) {
    TxGui t("gt10_custom.json");
    t.gui->onActive();
    t.W<QCheckBox>("cbPreDriver")->setChecked(true);
    t.SetText("lePreTapDac", "0101");
    EXPECT_TRUE(t.gui->onBack());
    EXPECT_TRUE(t.wiz->Messages().empty());
    EXPECT_EQ(Value(t.data, "TXPRE_TAP_DAC"), "4'b0101");
    EXPECT_EQ(Value(t.data, "TXPRE_TAP_PD"), "TRUE");
}

TEST(TransmitterGui, WriteFailureKeepsThePage) {
    TxGui t("gt10_custom.json");
    t.gui->onActive();
    EXPECT_FALSE(t.gui->onFinish()); // the framework's own answer
    EXPECT_TRUE(t.gui->onCancel());
    t.data.SetAllBlksIsActive(false);
    EXPECT_TRUE(t.gui->onFinish());
    EXPECT_FALSE(t.gui->onNext());
    EXPECT_FALSE(t.gui->onBack());
    // Activating without a block leaves the form alone and does not crash.
    t.gui->onActive();
    EXPECT_TRUE(t.gui->IsActive());
}

TEST(TransmitterGui, PageNameFormAndMoreInfo) {
    TxGui t("gt_custom.json");
    EXPECT_EQ(t.gui->pageName(), "Transmitter Setup");
    EXPECT_EQ(t.gui->Form(), t.gui->pageWidget());
    EXPECT_EQ(t.wiz->Page()->GetGuiDlg(), t.gui);
    EXPECT_FALSE(t.gui->isAdvanced());
    EXPECT_EQ(t.gui->EntryCount(), 5);
    t.gui->onMoreInfo();
    EXPECT_EQ(t.help.keys, std::vector<std::string>{"qvz_mgttx"});
}
