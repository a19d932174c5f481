// The channel bonding controller and its form, driven offscreen through the
// real widgets found by object name.

#include "Qvz_MGTRCBConfig11Dialog.h"
#include "Qvz_MGTRCBConfigDialog.h"
#include "Qvz_MGTRCBLaneIDDialog.h"
#include "Qvz_MGTRCBWidget.h"
#include "RcbGuiSupport.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QMetaMethod>
#include <QPushButton>
#include <QRadioButton>
#include <QSignalBlocker>
#include <QSpinBox>

namespace {

const char* const kSeqEdits[8] = {"IDC_EDIT_CHAN_BOND_SEQ_1_1", "IDC_EDIT_CHAN_BOND_SEQ_1_2",
                                  "IDC_EDIT_CHAN_BOND_SEQ_1_3", "IDC_EDIT_CHAN_BOND_SEQ_1_4",
                                  "IDC_EDIT_CHAN_BOND_SEQ_2_1", "IDC_EDIT_CHAN_BOND_SEQ_2_2",
                                  "IDC_EDIT_CHAN_BOND_SEQ_2_3", "IDC_EDIT_CHAN_BOND_SEQ_2_4"};

// Every control of the form that bonding settings go through, except the
// number itself.
const char* const kBondingControls[] = {"IDC_BUTTON_VIEW_PLACEMENT",
                                        "IDC_CHECK_CHAN_BOND_ONE_SHOT",
                                        "sbCBondLimit",
                                        "cbSeqLen",
                                        "sbCBondOffset",
                                        "sbCBondWait",
                                        "IDC_EDIT_CHAN_BOND_SEQ_1_MASK",
                                        "IDC_EDIT_CHAN_BOND_SEQ_2_MASK",
                                        "IDC_EDIT_CHAN_BOND_SEQ_1_1",
                                        "IDC_EDIT_CHAN_BOND_SEQ_1_4",
                                        "IDC_CHECK_CHAN_BOND_SEQ_2_USE",
                                        "IDC_EDIT_CHAN_BOND_SEQ_2_1",
                                        "IDC_EDIT_CHAN_BOND_SEQ_2_4"};

} // namespace

TEST(RcbGui, SlotsInTheirOrder) {
    const std::vector<std::string> names = OwnSlots(Qvz_MGTRCBGui::staticMetaObject);
    const std::vector<std::string> expected = {"onActive()",
                                               "onCancel()",
                                               "onBack()",
                                               "onNext()",
                                               "onMoreInfo()",
                                               "init()",
                                               "OnButtonViewPlacement()",
                                               "OnButtonDefineLaneID()",
                                               "OnSpinCBondNum(int)",
                                               "OnCheckCBondSeq2Use()",
                                               "ValidateLE_ALL()"};
    EXPECT_EQ(names, expected);
}

TEST(RcbGui, FormControlsInCreationOrderWithTheirTexts) {
    TestApp();
    Qvz_MGTRCBWidget form;
    EXPECT_EQ(form.objectName(), "Qvz_MGTRCBWidget");
    EXPECT_EQ(form.windowTitle(), "Korvane Velomux Wizard - Receiver Channel Bonding Setup");
    EXPECT_GE(form.width(), 482);
    EXPECT_GE(form.height(), 589);
    const struct {
        const char* name;
        const char* kind;
        const char* inside;
        const char* text;
    } controls[] = {
        {"IDC_STATIC_CHAN_BOND_NUM", "QLabel", "", "Number of transceivers to be bonded:"},
        {"sbCBondNum", "QSpinBox", "", ""},
        {"buttonGroup26", "QGroupBox", "",
         "Which edge of the chip to start placing the transceivers?"},
        {"IDC_RADIO_PRIMARY_ROW_TOP", "QRadioButton", "buttonGroup26", "Top"},
        {"IDC_RADIO_PRIMARY_ROW_BOTTOM", "QRadioButton", "buttonGroup26", "Bottom"},
        {"IDC_BUTTON_VIEW_PLACEMENT", "QPushButton", "", "View Placement"},
        {"IDC_BUTTON_LANE_ID", "QPushButton", "", "Define LANE_IDs"},
        {"gbChanBond", "QGroupBox", "", "Common to all transceivers"},
        {"IDC_CHECK_CHAN_BOND_ONE_SHOT", "QCheckBox", "gbChanBond",
         "Allow repeated execution of channel bonding"},
        {"IDC_STATIC_CHAN_BOND_LIMIT", "QLabel", "gbChanBond",
         "Maximum number of bytes a slave receiver can read:"},
        {"sbCBondLimit", "QSpinBox", "gbChanBond", ""},
        {"IDC_STATIC_BYTES0", "QLabel", "gbChanBond", "Bytes"},
        {"IDC_STATIC_CHAN_BOND_SEQ_LEN", "QLabel", "gbChanBond",
         "Length of channel bonding sequence:"},
        {"cbSeqLen", "QComboBox", "gbChanBond", "XX"},
        {"IDC_STATIC_BYTES3", "QLabel", "gbChanBond", "Bytes"},
        {"IDC_STATIC_CHAN_BOND_OFFSET", "QLabel", "gbChanBond",
         "Offset from channel bonding sequence:"},
        {"sbCBondOffset", "QSpinBox", "gbChanBond", ""},
        {"IDC_STATIC_BYTES1", "QLabel", "gbChanBond", "Bytes"},
        {"IDC_STATIC_CHAN_BOND_WAIT", "QLabel", "gbChanBond",
         "Length of wait after channel bonding sequence:"},
        {"sbCBondWait", "QSpinBox", "gbChanBond", ""},
        {"IDC_STATIC_BYTES2", "QLabel", "gbChanBond", "Bytes"},
        {"IDC_STATIC_CHAN_BOND_SEQ_1_MASK", "QLabel", "gbChanBond",
         "Mask for channel bonding sequence 1 (4-bit vector)"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_MASK", "QLineEdit", "gbChanBond", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_2_MASK", "QLabel", "gbChanBond",
         "Mask for channel bonding sequence 2 (4-bit vector)"},
        {"IDC_EDIT_CHAN_BOND_SEQ_2_MASK", "QLineEdit", "gbChanBond", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ", "QGroupBox", "gbChanBond",
         "Define channel bonding sequence (11-bit vector)"},
        {"IDC_STATIC_CHAN_BOND_SEQ_1_1", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "1_1"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_1", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_1_2", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "1_2"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_2", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_1_3", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "1_3"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_3", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_1_4", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "1_4"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_4", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_CHECK_CHAN_BOND_SEQ_2_USE", "QCheckBox", "IDC_STATIC_CHAN_BOND_SEQ",
         "&Use second channel bonding sequence"},
        {"IDC_STATIC_CHAN_BOND_SEQ_2_1", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "2_1"},
        {"IDC_EDIT_CHAN_BOND_SEQ_2_1", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_2_2", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "2_2"},
        {"IDC_EDIT_CHAN_BOND_SEQ_2_2", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_2_3", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "2_3"},
        {"IDC_EDIT_CHAN_BOND_SEQ_2_3", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
        {"IDC_STATIC_CHAN_BOND_SEQ_2_4", "QLabel", "IDC_STATIC_CHAN_BOND_SEQ", "2_4"},
        {"IDC_EDIT_CHAN_BOND_SEQ_2_4", "QLineEdit", "IDC_STATIC_CHAN_BOND_SEQ", ""},
    };
    std::vector<std::string> expectedOrder;
    for (const auto& c : controls) {
        expectedOrder.push_back(c.name);
        QWidget* w = form.findChild<QWidget*>(c.name);
        ASSERT_NE(w, nullptr) << c.name;
        EXPECT_TRUE(w->inherits(c.kind)) << c.name;
        const QWidget* inside = *c.inside ? form.findChild<QWidget*>(c.inside) : &form;
        EXPECT_EQ(w->parentWidget(), inside) << c.name;
        QString text;
        if (auto* l = qobject_cast<QLabel*>(w))
            text = l->text();
        else if (auto* b = qobject_cast<QAbstractButton*>(w))
            text = b->text();
        else if (auto* g = qobject_cast<QGroupBox*>(w))
            text = g->title();
        else if (auto* cb = qobject_cast<QComboBox*>(w))
            text = cb->count() == 1 ? cb->itemText(0) : QString("<%1 items>").arg(cb->count());
        else if (auto* le = qobject_cast<QLineEdit*>(w))
            text = le->text();
        EXPECT_EQ(text.toStdString(), c.text) << c.name;
    }
    // Creation order: the named widgets as the form made them.
    std::vector<std::string> order;
    for (QWidget* w : form.findChildren<QWidget*>())
        for (const auto& c : controls)
            if (w->objectName() == c.name)
                order.push_back(c.name);
    EXPECT_EQ(order, expectedOrder);

    EXPECT_TRUE(form.sbCBondNum->wrapping());
    EXPECT_TRUE(form.IDC_RADIO_PRIMARY_ROW_TOP->isChecked());
    EXPECT_EQ(form.buttonGroup26Buttons->id(form.IDC_RADIO_PRIMARY_ROW_TOP), 0);
    EXPECT_EQ(form.buttonGroup26Buttons->id(form.IDC_RADIO_PRIMARY_ROW_BOTTOM), 1);
    EXPECT_TRUE(form.buttonGroup26Buttons->exclusive());
    for (QLineEdit* mask :
         {form.IDC_EDIT_CHAN_BOND_SEQ_1_MASK, form.IDC_EDIT_CHAN_BOND_SEQ_2_MASK}) {
        EXPECT_EQ(mask->minimumWidth(), 40);
        EXPECT_EQ(mask->maximumWidth(), 40);
    }

    // languageChange gives the designed texts back, the list its placeholder.
    form.IDC_RADIO_PRIMARY_ROW_TOP->setText("&Right");
    form.cbSeqLen->clear();
    form.cbSeqLen->addItem("1");
    form.cbSeqLen->addItem("2");
    form.languageChange();
    EXPECT_EQ(form.IDC_RADIO_PRIMARY_ROW_TOP->text(), "Top");
    ASSERT_EQ(form.cbSeqLen->count(), 1);
    EXPECT_EQ(form.cbSeqLen->itemText(0), "XX");
}

TEST(RcbGui, PageCreatesTheControllerWhichLoadsTheForm) {
    RcbGui g("gui_gt.json");
    ASSERT_NE(g.gui, nullptr);
    EXPECT_EQ(g.gui->pageName(), "Receiver Channel Bonding Setup");
    EXPECT_EQ(g.gui->EntryCount(), 10);
    EXPECT_FALSE(g.gui->IsActive());
    g.Activated();
    EXPECT_TRUE(g.gui->IsActive());
    Qvz_MGTRCBWidget& f = *g.gui->Form();
    EXPECT_EQ(f.sbCBondNum->value(), 4);
    EXPECT_EQ(f.sbCBondNum->minimum(), 0);
    EXPECT_EQ(f.sbCBondNum->maximum(), 20);
    EXPECT_EQ(f.sbCBondLimit->maximum(), 31);
    EXPECT_EQ(f.cbSeqLen->count(), 3);
    EXPECT_EQ(f.cbSeqLen->currentText(), "4");
    EXPECT_EQ(f.IDC_EDIT_CHAN_BOND_SEQ_1_1->text(), "00101111100");
    EXPECT_EQ(f.IDC_EDIT_CHAN_BOND_SEQ_2_4->text(), "00000000111");
    EXPECT_TRUE(f.IDC_RADIO_PRIMARY_ROW_TOP->isChecked());
    EXPECT_TRUE(f.IDC_CHECK_CHAN_BOND_ONE_SHOT->isChecked());
    // GT11 sized literals arrive as bare digits.
    RcbGui g11("gui_gt11.json");
    g11.Activated();
    EXPECT_EQ(g11.gui->Form()->IDC_EDIT_CHAN_BOND_SEQ_1_1->text(), "00101111100");
    EXPECT_EQ(g11.gui->Form()->IDC_EDIT_CHAN_BOND_SEQ_1_MASK->text(), "1111");

    g.gui->onMoreInfo();
    EXPECT_EQ(g.help.keys, std::vector<std::string>{"qvz_mgtrx3"});
    EXPECT_TRUE(g.gui->onCancel());
}

TEST(RcbGui, SpinningKeepsTheNumberLegal) {
    enum Step { Up, Down };
    const struct {
        const char* fixture;
        int start;
        Step step;
        int shown;
    } cases[] = {
        {"gui_gt.json", 0, Up, 2},    // 1 is skipped
        {"gui_gt.json", 2, Down, 0},  // likewise downwards
        {"gui_gt.json", 0, Down, 20}, // below 0 wraps to the maximum
        {"gui_gt.json", 20, Up, 0},   // and above it to 0
        {"gui_gt.json", 4, Up, 5},    // odd numbers are fine off GT11
        {"gui_gt11.json", 12, Up, 0}, // GT11, maximum 12
        {"gui_gt11.json", 2, Up, 4},  // GT11 moves in pairs
        {"gui_gt11.json", 4, Down, 2}, {"gui_gt11.json", 0, Down, 12}, {"gui_gt11.json", 0, Up, 2},
    };
    for (const auto& c : cases) {
        RcbGui g(c.fixture);
        g.data.GetActiveBlock()->SetAttributeValue("QVZ_CHAN_BOND_NUMBER", std::to_string(c.start));
        g.Activated();
        QSpinBox* spin = g.W<QSpinBox>("sbCBondNum");
        ASSERT_EQ(spin->value(), c.start);
        if (c.step == Up)
            spin->stepUp();
        else
            spin->stepDown();
        const std::string where = std::string(c.fixture) + " from " + std::to_string(c.start);
        EXPECT_EQ(spin->value(), c.shown) << where;
        EXPECT_EQ(g.page->m_cbondNum, c.shown) << where;
        EXPECT_EQ(g.page->m_cbondNumText.str(), std::to_string(c.shown)) << where;
    }
}

TEST(RcbGui, SpinningToAndFromZeroSwitchesTheBondingControls) {
    RcbGui g("gui_gt10.json"); // "10G Custom" with number 0
    g.Activated();
    EXPECT_TRUE(g.Enabled("sbCBondNum"));
    EXPECT_TRUE(g.Enabled("IDC_STATIC_CHAN_BOND_NUM"));
    for (const char* name : kBondingControls)
        EXPECT_FALSE(g.Enabled(name)) << name;
    EXPECT_FALSE(g.Shown("IDC_BUTTON_LANE_ID"));

    g.W<QSpinBox>("sbCBondNum")->stepUp();
    EXPECT_EQ(g.page->m_cbondNum, 2);
    for (const char* name : {"IDC_BUTTON_VIEW_PLACEMENT", "IDC_CHECK_CHAN_BOND_ONE_SHOT",
                             "sbCBondLimit", "cbSeqLen", "sbCBondOffset", "sbCBondWait",
                             "IDC_EDIT_CHAN_BOND_SEQ_1_MASK", "IDC_EDIT_CHAN_BOND_SEQ_1_1",
                             "IDC_EDIT_CHAN_BOND_SEQ_1_4", "IDC_CHECK_CHAN_BOND_SEQ_2_USE"})
        EXPECT_TRUE(g.Enabled(name)) << name;
    // The second sequence waits for its check box.
    EXPECT_FALSE(g.Enabled("IDC_EDIT_CHAN_BOND_SEQ_2_1"));
    EXPECT_FALSE(g.Enabled("IDC_EDIT_CHAN_BOND_SEQ_2_MASK"));
}

TEST(RcbGui, SecondSequenceFollowsItsCheckBox) {
    RcbGui g("gui_gt.json");
    g.Activated();
    QCheckBox* use2 = g.W<QCheckBox>("IDC_CHECK_CHAN_BOND_SEQ_2_USE");
    ASSERT_TRUE(use2->isEnabled());
    ASSERT_FALSE(use2->isChecked());
    use2->click();
    EXPECT_EQ(g.page->m_seq2Use, 1);
    for (const char* name : {"IDC_EDIT_CHAN_BOND_SEQ_2_1", "IDC_EDIT_CHAN_BOND_SEQ_2_4",
                             "IDC_STATIC_CHAN_BOND_SEQ_2_2", "IDC_EDIT_CHAN_BOND_SEQ_2_MASK",
                             "IDC_STATIC_CHAN_BOND_SEQ_2_MASK"})
        EXPECT_TRUE(g.Enabled(name)) << name;
    use2->click();
    EXPECT_EQ(g.page->m_seq2Use, 0);
    EXPECT_FALSE(g.Enabled("IDC_EDIT_CHAN_BOND_SEQ_2_3"));
    EXPECT_FALSE(g.Enabled("IDC_EDIT_CHAN_BOND_SEQ_2_MASK"));
}

TEST(RcbGui, NamesDecideTheNumberAndTheSequences) {
    {
        // XAUI always bonds four; the number cannot be changed.
        RcbGui g("gui_gt.json", "GT_XAUI_INST");
        g.Activated();
        EXPECT_EQ(g.W<QSpinBox>("sbCBondNum")->value(), 4);
        EXPECT_FALSE(g.Enabled("sbCBondNum"));
        EXPECT_FALSE(g.Enabled("IDC_STATIC_CHAN_BOND_NUM"));
        EXPECT_TRUE(g.Enabled("IDC_BUTTON_VIEW_PLACEMENT"));
        // Not custom-like: the sequences are the protocol's own.
        EXPECT_FALSE(g.Enabled("IDC_EDIT_CHAN_BOND_SEQ_1_1"));
        EXPECT_TRUE(g.Shown("IDC_EDIT_CHAN_BOND_SEQ_1_1"));
    }
    {
        // "PCI Express" edits the first sequence only, even with the second on.
        RcbGui g("gui_gt10.json", "GT10_PCI_EXPRESS_2_INST");
        g.Activated();
        ASSERT_EQ(g.page->m_seq2Use, 1);
        for (int s = 0; s < 4; ++s)
            EXPECT_TRUE(g.Enabled(kSeqEdits[s])) << kSeqEdits[s];
        for (int s = 4; s < 8; ++s)
            EXPECT_FALSE(g.Enabled(kSeqEdits[s])) << kSeqEdits[s];
        EXPECT_FALSE(g.Enabled("IDC_CHECK_CHAN_BOND_SEQ_2_USE"));
        EXPECT_TRUE(g.Shown("IDC_CHECK_CHAN_BOND_SEQ_2_USE"));
    }
    {
        // A GT11 in single mode bonds nothing itself: its number is fixed.
        RcbGui g("gui_gt11.json", "GT11_SINGLE_INST");
        g.Activated();
        EXPECT_FALSE(g.Enabled("sbCBondNum"));
    }
    {
        // The LANE_ID button is for Infiniband of the older families only.
        RcbGui gt10("gui_gt10.json", "GT10_INFINIBAND_INST");
        gt10.Activated();
        EXPECT_TRUE(gt10.Shown("IDC_BUTTON_LANE_ID"));
        EXPECT_TRUE(gt10.Enabled("IDC_BUTTON_LANE_ID"));
        RcbGui gt11("gui_gt11.json", "GT11_INFINIBAND_INST");
        gt11.Activated();
        EXPECT_FALSE(gt11.Shown("IDC_BUTTON_LANE_ID"));
    }
}

TEST(RcbGui, Gt11NamesTheEdgesRightAndLeft) {
    RcbGui g11("gui_gt11.json");
    g11.Activated();
    EXPECT_EQ(g11.W<QRadioButton>("IDC_RADIO_PRIMARY_ROW_TOP")->text(), "&Right");
    EXPECT_EQ(g11.W<QRadioButton>("IDC_RADIO_PRIMARY_ROW_BOTTOM")->text(), "&Left");
    RcbGui g("gui_gt.json");
    g.Activated();
    EXPECT_EQ(g.W<QRadioButton>("IDC_RADIO_PRIMARY_ROW_TOP")->text(), "Top");
    EXPECT_EQ(g.W<QRadioButton>("IDC_RADIO_PRIMARY_ROW_BOTTOM")->text(), "Bottom");
}

TEST(RcbGui, AttributesDecideWhatIsShownAndEditable) {
    RcbGui g("gui_gt.json", "GT_AMBERLANE_INST"); // number 2, a locked limit, little else
    g.Activated();
    for (const char* name :
         {"sbCBondOffset", "IDC_STATIC_CHAN_BOND_OFFSET", "IDC_STATIC_BYTES1", "sbCBondWait",
          "IDC_STATIC_BYTES2", "cbSeqLen", "IDC_STATIC_CHAN_BOND_SEQ_LEN", "IDC_STATIC_BYTES3",
          "IDC_EDIT_CHAN_BOND_SEQ_1_MASK", "IDC_STATIC_CHAN_BOND_SEQ_2_MASK"})
        EXPECT_FALSE(g.Shown(name)) << name;
    EXPECT_TRUE(g.Shown("sbCBondLimit"));
    EXPECT_FALSE(g.Enabled("sbCBondLimit"));
    EXPECT_FALSE(g.Enabled("IDC_STATIC_BYTES0"));
    // Without CHAN_BOND_ONE_SHOT the group still follows the number.
    EXPECT_TRUE(g.Enabled("gbChanBond"));
    EXPECT_FALSE(g.Enabled("IDC_CHECK_CHAN_BOND_ONE_SHOT"));
    // Hidden masks must not hold the page.
    g.W<QLineEdit>("IDC_EDIT_CHAN_BOND_SEQ_1_MASK")->setText("1");
    EXPECT_TRUE(g.gui->onNext());

    // The next block that has them shows them again.
    Activate(g.data, "GT_CUSTOM_INST");
    g.gui->onActive();
    for (const char* name : {"sbCBondOffset", "cbSeqLen", "IDC_EDIT_CHAN_BOND_SEQ_1_MASK"})
        EXPECT_TRUE(g.Shown(name)) << name;
    EXPECT_TRUE(g.Enabled("sbCBondLimit"));
}

TEST(RcbGui, NextChecksTheEnabledEntriesInOrder) {
    const struct {
        const char* edit;
        const char* text;
        const char* message; // empty: Next goes on
    } cases[] = {
        {"IDC_EDIT_CHAN_BOND_SEQ_1_3", "0101",
         "Please enter a valid 11-bit binary value for "
         "channel bonding sequence 1_3"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_1", "",
         "Please enter a valid 11-bit binary value for channel "
         "bonding sequence 1_1"},
        {"IDC_EDIT_CHAN_BOND_SEQ_1_MASK", "11",
         "Please enter a valid 4-bit binary value for "
         "channel bonding sequence 1 mask"},
        // Disabled while the second sequence is off.
        {"IDC_EDIT_CHAN_BOND_SEQ_2_2", "01", ""},
        {"IDC_EDIT_CHAN_BOND_SEQ_2_MASK", "1", ""},
    };
    for (const auto& c : cases) {
        RcbGui g("gui_gt10.json");
        g.data.GetActiveBlock()->SetAttributeValue("QVZ_CHAN_BOND_NUMBER", "4");
        g.Activated();
        QLineEdit* edit = g.W<QLineEdit>(c.edit);
        edit->setText(c.text);
        const bool moved = g.gui->onNext();
        if (*c.message) {
            EXPECT_FALSE(moved) << c.edit;
            EXPECT_EQ(g.Messages(), std::vector<std::string>{c.message});
            EXPECT_EQ(g.Value("CHAN_BOND_MODE"), "OFF") << "nothing written";
            EXPECT_TRUE(edit->hasFocus() || QApplication::focusWidget() == nullptr);
        } else {
            EXPECT_TRUE(moved) << c.edit;
            EXPECT_TRUE(g.Messages().empty()) << c.edit;
        }
    }
}

TEST(RcbGui, NextWritesFullyBackPartlyFinishLikeNext) {
    {
        RcbGui g("gui_gt.json");
        g.Activated();
        g.W<QRadioButton>("IDC_RADIO_PRIMARY_ROW_BOTTOM")->setChecked(true);
        g.W<QLineEdit>("IDC_EDIT_CHAN_BOND_SEQ_1_2")->setText("11111111111");
        g.W<QSpinBox>("sbCBondLimit")->setValue(20);
        EXPECT_TRUE(g.gui->onNext());
        EXPECT_EQ(g.Value("QVZ_CHAN_BOND_NUMBER"), "4");
        EXPECT_EQ(g.Value("QVZ_CHAN_BOND_PRIMARY_ROW"), "0");
        EXPECT_EQ(g.Value("CHAN_BOND_LIMIT"), "20");
        EXPECT_EQ(g.Value("CHAN_BOND_SEQ_1_2"), "11111111111");
        EXPECT_EQ(g.Value("CHAN_BOND_MODE"), "MASTER");
        EXPECT_EQ(g.Value("LOC"), "GT_X5Y0");
    }
    {
        // Back writes the settings without the master's role and place, and
        // without checking the entries.
        RcbGui g("gui_gt.json");
        g.Activated();
        g.W<QLineEdit>("IDC_EDIT_CHAN_BOND_SEQ_1_3")->setText("01");
        g.W<QSpinBox>("sbCBondNum")->stepUp();
        EXPECT_TRUE(g.gui->onBack());
        EXPECT_EQ(g.Value("QVZ_CHAN_BOND_NUMBER"), "5");
        EXPECT_EQ(g.Value("CHAN_BOND_SEQ_1_3"), "01");
        EXPECT_EQ(g.Value("CHAN_BOND_MODE"), "OFF");
        EXPECT_EQ(g.Value("LOC"), "");
    }
    {
        // GT11: an odd number cannot come from the spin box, but a write that
        // fails keeps the page on every way out.
        RcbGui g("gui_gt11.json");
        g.Activated();
        {
            const QSignalBlocker quiet(g.W<QSpinBox>("sbCBondNum"));
            g.W<QSpinBox>("sbCBondNum")->setValue(3);
        }
        EXPECT_FALSE(g.gui->onNext());
        EXPECT_FALSE(g.gui->onBack());
        EXPECT_TRUE(g.gui->onFinish());
        for (const std::string& m : g.Messages())
            EXPECT_EQ(m, "Because dual GT11s will be generated, the number of channel bonded "
                         "transceivers must be an even number.");
        EXPECT_EQ(g.Value("QVZ_CHAN_BOND_NUMBER"), "2");
    }
    {
        // Finish from this page checks and writes as Next does.
        RcbGui g("gui_gt10.json");
        g.Activated();
        g.W<QSpinBox>("sbCBondNum")->stepUp();
        g.W<QLineEdit>("IDC_EDIT_CHAN_BOND_SEQ_1_1")->setText("0");
        EXPECT_TRUE(g.gui->onFinish()) << "an unacceptable entry keeps the page";
        EXPECT_EQ(g.Value("QVZ_CHAN_BOND_NUMBER"), "0");
        g.W<QLineEdit>("IDC_EDIT_CHAN_BOND_SEQ_1_1")->setText("00000000000");
        EXPECT_FALSE(g.gui->onFinish());
        EXPECT_EQ(g.Value("QVZ_CHAN_BOND_NUMBER"), "2");
        EXPECT_EQ(g.Value("CHAN_BOND_MODE"), "MASTER");
        EXPECT_EQ(g.Value("LOC"), "GT10_X5Y1");
    }
}

TEST(RcbGui, ButtonsRefuseAnIllegalNumberAndOpenNothing) {
    for (const char* button : {"IDC_BUTTON_VIEW_PLACEMENT", "IDC_BUTTON_LANE_ID"}) {
        RcbGui g("gui_gt10.json", "GT10_INFINIBAND_INST");
        g.Activated();
        {
            const QSignalBlocker quiet(g.W<QSpinBox>("sbCBondNum"));
            g.W<QSpinBox>("sbCBondNum")->setValue(1);
        }
        const Qvz_StrArray before = g.page->m_laneIds;
        g.W<QPushButton>(button)->click(); // would block if a dialog opened
        EXPECT_EQ(g.Messages(),
                  std::vector<std::string>{"The allowable range for the number of channel bonded "
                                           "transceivers is between 0 and 20, excluding 1."})
            << button;
        EXPECT_TRUE(g.page->m_laneIds == before);
    }
}

TEST(RcbGui, ViewPlacementShowsThePageSettingsInTheFamilysDialog) {
    {
        RcbGui g("gui_gt.json");
        g.Activated();
        g.W<QRadioButton>("IDC_RADIO_PRIMARY_ROW_BOTTOM")->setChecked(true);
        bool seen = false;
        WhenShown<Qvz_MGTRCBConfigDialog>([&](Qvz_MGTRCBConfigDialog* d) {
            seen = true;
            EXPECT_EQ(d->m_cbondNum, 4);
            EXPECT_EQ(d->m_maxCBondNum, 20);
            EXPECT_EQ(d->m_primaryRowBottom, 1);
            EXPECT_EQ(d->RoleLabel(5, 0)->text(), "M");
            EXPECT_TRUE(d->CheckBox(5, 0)->isChecked());
            d->pbOK->click();
        });
        g.W<QPushButton>("IDC_BUTTON_VIEW_PLACEMENT")->click();
        EXPECT_TRUE(seen);
        // The dialog changes nothing.
        EXPECT_EQ(g.Value("CHAN_BOND_MODE"), "OFF");
    }
    {
        RcbGui g("gui_gt11.json");
        g.Activated();
        bool seen = false;
        WhenShown<Qvz_MGTRCBConfig11Dialog>([&](Qvz_MGTRCBConfig11Dialog* d) {
            seen = true;
            EXPECT_EQ(d->m_pPage, g.page);
            EXPECT_EQ(d->m_cbondNum, 2);
            EXPECT_EQ(d->m_maxCBondNum, 12);
            // Maximum 12, Right: the master at X1 Y3, position 2 below it.
            EXPECT_EQ(d->RoleLabel(1, 3)->text(), "M");
            EXPECT_EQ(d->RoleLabel(1, 2)->text(), "S1");
            d->pbOK->click();
        });
        g.W<QPushButton>("IDC_BUTTON_VIEW_PLACEMENT")->click();
        EXPECT_TRUE(seen);
    }
}

TEST(RcbGui, LaneIdsComeBackOnlyOnOk) {
    RcbGui g("gui_gt10.json", "GT10_INFINIBAND_INST");
    g.Activated();
    const Qvz_StrArray before = g.page->m_laneIds;
    ASSERT_EQ(before.GetSize(), 20);
    EXPECT_EQ(before.GetAt(0).str(), "00000000011");
    EXPECT_EQ(before.GetAt(2).str(), "00000000101");

    // Cancel after editing leaves the page's list as it was.
    WhenShown<Qvz_MGTRCBLaneIDDialog>([](Qvz_MGTRCBLaneIDDialog* d) {
        EXPECT_EQ(d->m_cbondNum, 4);
        EXPECT_EQ(d->Entry(3)->text(), "00000000101");
        d->Entry(2)->setText("11111111111");
        d->pbCancel->click();
    });
    g.W<QPushButton>("IDC_BUTTON_LANE_ID")->click();
    EXPECT_TRUE(g.page->m_laneIds == before);

    // OK hands the edited list over, which the full write then uses.
    WhenShown<Qvz_MGTRCBLaneIDDialog>([](Qvz_MGTRCBLaneIDDialog* d) {
        d->Entry(1)->setText("11111111111");
        d->Entry(4)->setText("00000000111");
        d->pbOK->click();
    });
    g.W<QPushButton>("IDC_BUTTON_LANE_ID")->click();
    EXPECT_EQ(g.page->m_laneIds.GetSize(), 20);
    EXPECT_EQ(g.page->m_laneIds.GetAt(0).str(), "11111111111");
    EXPECT_EQ(g.page->m_laneIds.GetAt(2).str(), "00000000101");
    EXPECT_EQ(g.page->m_laneIds.GetAt(3).str(), "00000000111");
    EXPECT_TRUE(g.gui->onNext());
    EXPECT_EQ(g.Value("LANE_ID"), "11111111111");
    EXPECT_EQ(g.Value("CHAN_BOND_SEQ_1_2"), "11111111111");

    // Coming back to the page keeps the edited list.
    g.gui->onActive();
    EXPECT_EQ(g.page->m_laneIds.GetAt(3).str(), "00000000111");
}
