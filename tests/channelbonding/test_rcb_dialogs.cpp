// The two placement dialogs and the LANE_ID dialog on their own.

#include "Qvz_MGTRCBConfig11Dialog.h"
#include "Qvz_MGTRCBConfigDialog.h"
#include "Qvz_MGTRCBLaneIDDialog.h"
#include "RcbGuiSupport.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QLayout>
#include <QLabel>
#include <QMessageBox>
#include <QPushButton>

namespace {

// "M5" for a ticked master, "-" for a shown, unticked, unlabelled location,
// "." for a hidden one; one string per row of the GT grid.
std::string GridRow(const Qvz_MGTRCBConfigDialog& d, int row) {
    std::string out;
    for (int col = 0; col < Qvz_MGTRCBConfigDialog::kColumns; ++col) {
        const QCheckBox* box = d.CheckBox(col, row);
        std::string cell;
        if (box->isHidden())
            cell = ".";
        else if (!box->isChecked() && d.RoleLabel(col, row)->text().isEmpty())
            cell = "-";
        else
            cell = (box->isChecked() ? "" : "?") + d.RoleLabel(col, row)->text().toStdString();
        out += (col ? " " : "") + cell;
    }
    return out;
}

// count distinct LANE_IDs: entry i holds i + 1 in eleven binary digits.
Qvz_StrArray Numbered(int count) {
    Qvz_StrArray list;
    for (int i = 0; i < count; ++i) {
        std::string bits;
        for (int b = 10; b >= 0; --b)
            bits += ((i + 1) >> b) & 1 ? '1' : '0';
        list.Add(bits);
    }
    return list;
}

} // namespace

TEST(RcbPlacementDialog, FormsCarryTheirNamesAndTexts) {
    TestApp();
    Qvz_MGTRCBConfigDialog gt;
    EXPECT_EQ(gt.windowTitle(), "Korvane Velomux Wizard - Channel Bonding Placement (Read only)");
    EXPECT_EQ(gt.textLabel3->text(), "Top Edge");
    EXPECT_EQ(gt.textLabel3_2->text(), "Bottom Edge");
    EXPECT_EQ(gt.groupBox3->title(), "Legend");
    EXPECT_EQ(gt.textLabel5->text(), "M  - MASTER");
    EXPECT_EQ(gt.textLabel6->text(), "S1 - SLAVE 1 HOP");
    EXPECT_EQ(gt.textLabel7->text(), "S2 - SLAVE 2 HOPS");
    EXPECT_TRUE(gt.textLabel2->text().endsWith("represented by a label below each checkbox."));
    EXPECT_EQ(gt.findChildren<QCheckBox*>().size(), 24);
    // Names carry X then Y: column 11 of the top row, column 0 of the bottom.
    EXPECT_EQ(gt.CheckBox(11, 1), gt.findChild<QCheckBox*>("IDC_CHECK_CONFIG_111"));
    EXPECT_EQ(gt.RoleLabel(0, 0), gt.findChild<QLabel*>("IDC_STATIC_CONFIG_00"));
    EXPECT_EQ(gt.CheckBox(12, 0), nullptr);
    EXPECT_EQ(gt.CheckBox(0, 2), nullptr);

    Qvz_MGTRCBConfig11Dialog gt11;
    EXPECT_EQ(gt11.windowTitle(), "Korvane Velomux Wizard - Channel Bonding Placement");
    EXPECT_TRUE(gt11.textLabel2->text().endsWith("represented by a label next to each checkbox."));
    const QList<QCheckBox*> boxes = gt11.findChildren<QCheckBox*>();
    ASSERT_EQ(boxes.size(), 36);
    // Row 17 first, so that it is at the top.
    EXPECT_EQ(boxes.front()->objectName(), "IDC_CHECK_CONFIG_017");
    EXPECT_EQ(boxes[17]->objectName(), "IDC_CHECK_CONFIG_00");
    EXPECT_EQ(boxes[18]->objectName(), "IDC_CHECK_CONFIG_117");
    gt11.layout()->activate();
    EXPECT_LT(gt11.CheckBox(0, 17)->y(), gt11.CheckBox(0, 0)->y());
    EXPECT_LT(gt11.CheckBox(0, 0)->x(), gt11.CheckBox(1, 0)->x());
    EXPECT_EQ(gt11.RoleLabel(1, 5), gt11.findChild<QLabel*>("IDC_STATIC_CONFIG_15"));
    EXPECT_EQ(gt11.CheckBox(2, 0), nullptr);
    EXPECT_EQ(gt11.CheckBox(0, 18), nullptr);
    for (QCheckBox* b : boxes)
        EXPECT_TRUE(b->text().isEmpty());
}

TEST(RcbPlacementDialog, GtGridShowsWhereAndAsWhatTheTransceiversGo) {
    TestApp();
    const struct {
        int max, number, bottom;
        const char* top;
        const char* bottomRow;
    } cases[] = {
        // Maximum 20, 4 bonded, Top.
        {20, 4, 0, "- - - S1 S1 M S1 - - - . .", "- - - - - - - - - - . ."},
        // Bottom: the same in the bottom row, the far positions on top.
        {20, 4, 1, "- - - - - - - - - - . .", "- - - S1 S1 M S1 - - - . ."},
        // Into the far row: position 11 is across from the master (one hop),
        // 12 and on two hops.
        {20, 12, 0, "S2 S2 S2 S1 S1 M S1 S1 S2 S2 . .", "- - - - S2 S1 - - - - . ."},
        // Master alone.
        {24, 0, 0, "- - - - - - M - - - - -", "- - - - - - - - - - - -"},
    };
    for (const auto& c : cases) {
        Qvz_MGTRCBConfigDialog d;
        d.m_maxCBondNum = c.max;
        d.m_cbondNum = c.number;
        d.m_primaryRowBottom = c.bottom;
        d.DataToWidgets();
        EXPECT_EQ(GridRow(d, 1), c.top) << c.max << "/" << c.number << "/" << c.bottom;
        EXPECT_EQ(GridRow(d, 0), c.bottomRow) << c.max << "/" << c.number << "/" << c.bottom;
        for (QCheckBox* b : d.findChildren<QCheckBox*>())
            EXPECT_FALSE(b->isEnabled()) << b->objectName().toStdString();
    }
}

TEST(RcbPlacementDialog, GridsAgreeWithThePlacementOfTheCopies) {
    // Whatever the dialog ticks is where the page puts the master and slaves.
    for (const char* fixture : {"gui_gt10.json", "gui_gt11.json"}) {
        for (int bottom : {0, 1}) {
            RcbGui g(fixture);
            g.Activated();
            Qvz_MGTRCB& p = *g.page;
            p.m_primaryRowBottom = bottom;
            const int n = p.m_isGT11 ? 6 : 7;
            Qvz_MGTRCBConfigDialog gt;
            gt.m_maxCBondNum = p.m_MaxCBondNum;
            gt.m_cbondNum = n;
            gt.m_primaryRowBottom = bottom;
            gt.DataToWidgets();
            Qvz_MGTRCBConfig11Dialog gt11;
            gt11.m_pPage = &p;
            gt11.m_maxCBondNum = p.m_MaxCBondNum;
            gt11.m_cbondNum = n;
            gt11.DataToWidgets();
            int ticked = 0;
            for (int i = 0; i <= p.m_MaxCBondNum; ++i) {
                if (i == 1)
                    continue;
                const int x = p.GetLocX(i), y = p.GetLocY(i);
                const QCheckBox* box = p.m_isGT11 ? gt11.CheckBox(x, y) : gt.CheckBox(x, y);
                const QLabel* label = p.m_isGT11 ? gt11.RoleLabel(x, y) : gt.RoleLabel(x, y);
                ASSERT_NE(box, nullptr) << fixture << " position " << i;
                EXPECT_EQ(box->isChecked(), i <= n) << fixture << " position " << i;
                ticked += box->isChecked();
                const std::string mode = p.GetBondMode(i).str();
                const std::string expected = i > n                   ? ""
                                             : mode == "MASTER"      ? "M"
                                             : mode == "SLAVE_1_HOP" ? "S1"
                                                                     : "S2";
                EXPECT_EQ(label->text().toStdString(), expected) << fixture << " position " << i;
            }
            EXPECT_EQ(ticked, n); // the master and n - 1 slaves
        }
    }
}

TEST(RcbPlacementDialog, Gt11GridFromThePage) {
    RcbGui g("gui_gt11.json");
    g.Activated();
    g.page->m_MaxCBondNum = 24; // a larger device than the fixture's
    g.page->m_primaryRowBottom = 0;
    Qvz_MGTRCBConfig11Dialog d;
    d.m_pPage = g.page;
    d.m_maxCBondNum = 24;
    d.m_cbondNum = 2;
    d.DataToWidgets();
    EXPECT_TRUE(d.CheckBox(1, 6)->isChecked());
    EXPECT_EQ(d.RoleLabel(1, 6)->text(), "M");
    EXPECT_TRUE(d.CheckBox(1, 5)->isChecked());
    EXPECT_EQ(d.RoleLabel(1, 5)->text(), "S1");
    EXPECT_FALSE(d.CheckBox(1, 7)->isChecked()); // position 3, not bonded
    EXPECT_EQ(d.RoleLabel(1, 7)->text(), "");
    EXPECT_FALSE(d.CheckBox(0, 6)->isChecked()); // across, position 13
    // Nothing is hidden or disabled on the GT11 grid.
    for (QCheckBox* b : d.findChildren<QCheckBox*>()) {
        EXPECT_FALSE(b->isHidden());
        EXPECT_TRUE(b->isEnabled());
    }

    // Without a page, or with a negative maximum, nothing is loaded.
    for (Qvz_MGTRCB* page : {static_cast<Qvz_MGTRCB*>(nullptr), g.page}) {
        Qvz_MGTRCBConfig11Dialog empty;
        empty.m_pPage = page;
        empty.m_maxCBondNum = page ? -1 : 24;
        empty.DataToWidgets();
        for (QCheckBox* b : empty.findChildren<QCheckBox*>())
            EXPECT_FALSE(b->isChecked());
        for (QLabel* l : empty.findChildren<QLabel*>()) {
            if (l->objectName().startsWith("IDC_STATIC_CONFIG_")) {
                EXPECT_TRUE(l->text().isEmpty());
            }
        }
    }
}

TEST(RcbPlacementDialog, OkCloses) {
    TestApp();
    Qvz_MGTRCBConfigDialog gt;
    WhenShown<Qvz_MGTRCBConfigDialog>([](Qvz_MGTRCBConfigDialog* d) { d->pbOK->click(); });
    EXPECT_EQ(gt.exec(), QDialog::Accepted);
    Qvz_MGTRCBConfig11Dialog gt11;
    WhenShown<Qvz_MGTRCBConfig11Dialog>([](Qvz_MGTRCBConfig11Dialog* d) { d->pbOK->click(); });
    EXPECT_EQ(gt11.exec(), QDialog::Accepted);
}

TEST(RcbLaneIdDialog, FormAndEntries) {
    TestApp();
    Qvz_MGTRCBLaneIDDialog d;
    EXPECT_EQ(d.objectName(), "Qvz_MGTRCBLaneIDDialogBase");
    EXPECT_EQ(d.windowTitle(), "Korvane Velomux Wizard - LANE ID Configuration");
    EXPECT_EQ(d.textLabel1->text(),
              "For each transceiver, define a 11-bit vector value for the LANE_ID attribute.");
    EXPECT_EQ(d.pbOK->text(), "OK");
    EXPECT_EQ(d.pbCancel->text(), "Cancel");
    EXPECT_EQ(d.IDC_STATIC_LANE_ID25->text(), "#INVALID");
    EXPECT_TRUE(d.IDC_STATIC_LANE_ID25->isHidden());
    EXPECT_TRUE(d.IDC_EDIT_LANE_ID25->isHidden());
    EXPECT_EQ(d.Entry(1), d.IDC_EDIT_LANE_ID);
    EXPECT_EQ(d.Entry(24), d.IDC_EDIT_LANE_ID24);
    EXPECT_EQ(d.Entry(0), nullptr);
    EXPECT_EQ(d.Entry(25), nullptr);
    for (int k = 1; k <= 24; ++k) {
        EXPECT_EQ(d.EntryLabel(k)->text(), QString("#%1").arg(k));
        EXPECT_EQ(d.m_entries[k - 1].m_message.str(),
                  "Please enter a valid 11-bit binary value for LANE_ID #" + std::to_string(k));
        EXPECT_EQ(d.m_laneText[k].str(), "00000000000");
    }
    EXPECT_EQ(d.m_cbondNum, 4);
    EXPECT_TRUE(d.m_laneIds.IsEmpty());
    // The validator takes eleven binary digits and nothing else.
    QLineEdit* e = d.Entry(7);
    for (const auto& [text, ok] : std::vector<std::pair<const char*, bool>>{{"01010101010", true},
                                                                            {"0101010101", false},
                                                                            {"010101010102", false},
                                                                            {"0101010101x", false},
                                                                            {"", false}}) {
        e->setText(text);
        EXPECT_EQ(e->hasAcceptableInput(), ok) << text;
    }
}

TEST(RcbLaneIdDialog, ShowsTheBondedEntriesAndReturnsTheWholeList) {
    TestApp();
    Qvz_MGTRCBLaneIDDialog d;
    const Qvz_StrArray given = Numbered(20);
    d.SetLaneIds(given);
    d.m_cbondNum = 4;
    d.DataToWidgets();
    for (int k = 1; k <= 24; ++k) {
        EXPECT_EQ(d.Entry(k)->isHidden(), k > 4) << k;
        EXPECT_EQ(d.EntryLabel(k)->isHidden(), k > 4) << k;
        EXPECT_TRUE(d.Entry(k)->isEnabled()) << k;
        EXPECT_EQ(d.Entry(k)->text().toStdString(),
                  k <= 4 ? given.GetAt(k - 1).str() : "00000000000")
            << k;
    }
    d.Entry(2)->setText("11111111111");
    d.Entry(4)->setText("10101010101");
    WhenShown<Qvz_MGTRCBLaneIDDialog>([](Qvz_MGTRCBLaneIDDialog* dlg) { dlg->pbOK->click(); });
    ASSERT_EQ(d.exec(), QDialog::Accepted);
    ASSERT_EQ(d.m_laneIds.GetSize(), 20);
    for (int i = 0; i < 20; ++i) {
        const std::string expected = i == 1   ? "11111111111"
                                     : i == 3 ? "10101010101"
                                              : given.GetAt(i).str();
        EXPECT_EQ(d.m_laneIds.GetAt(i).str(), expected) << i;
    }
}

TEST(RcbLaneIdDialog, OkRefusesAnEntryThatIsNotElevenDigits) {
    TestApp();
    Qvz_MGTRCBLaneIDDialog d;
    d.SetLaneIds(Numbered(4));
    d.m_cbondNum = 4;
    d.DataToWidgets();
    d.Entry(3)->setText("0101010101"); // ten digits
    std::string title, text;
    int result = -1;
    WhenShown<Qvz_MGTRCBLaneIDDialog>([&](Qvz_MGTRCBLaneIDDialog* dlg) {
        WhenShown<QMessageBox>([&](QMessageBox* box) {
            title = box->windowTitle().toStdString();
            text = box->text().toStdString();
            EXPECT_EQ(box->icon(), QMessageBox::Critical);
            box->accept();
        });
        dlg->pbOK->click(); // returns once the box is answered
        EXPECT_TRUE(dlg->isVisible()) << "OK must not close the dialog";
        EXPECT_EQ(dlg->focusWidget(), dlg->Entry(3));
        dlg->Entry(3)->setText("01010101010");
        dlg->pbOK->click();
    });
    result = d.exec();
    EXPECT_EQ(title, "Lane ID Configuration");
    EXPECT_EQ(text, "Please enter a valid 11-bit binary value for LANE_ID #3");
    EXPECT_EQ(result, QDialog::Accepted);
    EXPECT_EQ(d.m_laneIds.GetAt(2).str(), "01010101010");
}

TEST(RcbLaneIdDialog, CancelReturnsNothing) {
    TestApp();
    Qvz_MGTRCBLaneIDDialog d;
    const Qvz_StrArray given = Numbered(4);
    d.SetLaneIds(given);
    d.m_cbondNum = 4;
    d.DataToWidgets();
    WhenShown<Qvz_MGTRCBLaneIDDialog>([](Qvz_MGTRCBLaneIDDialog* dlg) {
        dlg->Entry(1)->setText("11111111111");
        dlg->pbCancel->click();
    });
    EXPECT_EQ(d.exec(), QDialog::Rejected);
    EXPECT_TRUE(d.m_laneIds == given);
}

TEST(RcbLaneIdDialog, AnyBondingNumberAndListLengthIsSafe) {
    TestApp();
    const struct {
        int listSize, number;
        int shown, returnedSize;
    } cases[] = {
        {2, 4, 4, 4},     // a short list: the missing entries read as zeros
        {30, 30, 24, 30}, // more than the dialog holds: 24 shown, the rest kept
        {20, 0, 0, 20},   // nothing bonded: nothing copied back
        {20, -3, 0, 20},  {0, 24, 24, 24},
    };
    for (const auto& c : cases) {
        Qvz_MGTRCBLaneIDDialog d;
        const Qvz_StrArray given = Numbered(c.listSize);
        d.SetLaneIds(given);
        d.m_cbondNum = c.number;
        d.DataToWidgets();
        int shown = 0;
        for (int k = 1; k <= 24; ++k)
            shown += !d.Entry(k)->isHidden();
        EXPECT_EQ(shown, c.shown) << c.listSize << "/" << c.number;
        for (int k = c.listSize + 1; k <= std::min(c.number, 24); ++k)
            EXPECT_EQ(d.Entry(k)->text(), "00000000000") << k;
        d.OnOK();
        EXPECT_EQ(d.result(), QDialog::Accepted);
        ASSERT_EQ(d.m_laneIds.GetSize(), c.returnedSize) << c.listSize << "/" << c.number;
        for (int i = 0; i < c.returnedSize; ++i) {
            const std::string expected = i < c.listSize ? given.GetAt(i).str() : "00000000000";
            EXPECT_EQ(d.m_laneIds.GetAt(i).str(), expected) << i;
        }
    }
}
