#include "Qvz_MGTRCBLaneIDDialog.h"

#include "Qvz_MGTRCB.h"

#include <QMessageBox>

#include <algorithm>

namespace {

// Entries 1..24 the bonding number uses; never more than the dialog has.
int EntriesInUse(int cbondNum) {
    return std::clamp(cbondNum, 0, Qvz_MGTRCBLaneIDDialog::kEntries);
}

QString Suffix(int k) {
    return k == 1 ? QString() : QString::number(k);
}

} // namespace

Qvz_MGTRCBLaneIDDialog::Qvz_MGTRCBLaneIDDialog(QWidget* parent, const char* name, bool modal,
                                               Qt::WindowFlags fl)
    : Qvz_MGTRCBLaneIDDialogBase(parent, name, modal, fl) {
    for (int k = 1; k <= kEntries; ++k)
        m_laneText[k] = Qvz_MGTRCB::kNoLaneId;
    connect(pbOK, &QPushButton::clicked, this, &Qvz_MGTRCBLaneIDDialog::OnOK);
    connect(pbCancel, &QPushButton::clicked, this, &QDialog::reject);
    for (int k = 1; k <= kEntries; ++k) {
        QLineEdit* edit = findChild<QLineEdit*>("IDC_EDIT_LANE_ID" + Suffix(k));
        m_labels[k - 1] = findChild<QLabel*>("IDC_STATIC_LANE_ID" + Suffix(k));
        if (edit)
            connect(edit, &QLineEdit::textChanged, this, &Qvz_MGTRCBLaneIDDialog::ValidateLE_ALL);
    }
    IDC_STATIC_LANE_ID25->setVisible(false);
    IDC_EDIT_LANE_ID25->setVisible(false);
    for (int k = 1; k <= kEntries; ++k) {
        Port::StringBase message;
        message.Format("Please enter a valid 11-bit binary value for LANE_ID #%d", k);
        m_entries[k - 1].Setup(findChild<QLineEdit*>("IDC_EDIT_LANE_ID" + Suffix(k)), "([01]){11}",
                               message);
    }
}

Qvz_MGTRCBLaneIDDialog::~Qvz_MGTRCBLaneIDDialog() = default;

QLineEdit* Qvz_MGTRCBLaneIDDialog::Entry(int k) const {
    return k >= 1 && k <= kEntries ? m_entries[k - 1].m_pLineEdit : nullptr;
}

QLabel* Qvz_MGTRCBLaneIDDialog::EntryLabel(int k) const {
    return k >= 1 && k <= kEntries ? m_labels[k - 1] : nullptr;
}

void Qvz_MGTRCBLaneIDDialog::SetLaneIds(const Qvz_StrArray& list) {
    for (int i = 0; i < list.GetSize(); ++i)
        m_laneIds.SetAt(i, list.GetAt(i));
}

void Qvz_MGTRCBLaneIDDialog::DataToWidgets() {
    const int inUse = EntriesInUse(m_cbondNum);
    for (int k = 1; k <= inUse; ++k)
        // A list shorter than the bonding number has no LANE_ID yet for the
        // last transceivers.
        m_laneText[k] = k - 1 < m_laneIds.GetSize() ? m_laneIds.GetAt(k - 1)
                                                    : Port::StringBase(Qvz_MGTRCB::kNoLaneId);
    for (int k = 1; k <= kEntries; ++k) {
        QLabel* label = m_labels[k - 1];
        QLineEdit* edit = Entry(k);
        for (QWidget* w : {static_cast<QWidget*>(label), static_cast<QWidget*>(edit)})
            if (w) {
                w->setEnabled(true);
                w->setVisible(m_cbondNum >= k);
            }
    }
    for (int k = 1; k <= kEntries; ++k)
        if (QLineEdit* edit = Entry(k))
            edit->setText(m_laneText[k].ToQString());
}

void Qvz_MGTRCBLaneIDDialog::WidgetsToData() {
    for (int k = 1; k <= kEntries; ++k)
        if (const QLineEdit* edit = Entry(k))
            m_laneText[k] = Port::StringBase(edit->text().toLatin1().toStdString());
}

void Qvz_MGTRCBLaneIDDialog::OnOK() {
    for (const Qvz_MGTPageGui::LEValidator& e : m_entries) {
        QLineEdit* edit = e.m_pLineEdit;
        if (!edit || !edit->isEnabled() || edit->hasAcceptableInput())
            continue;
        QMessageBox::critical(this, "Lane ID Configuration", e.m_message.ToQString());
        edit->setFocus();
        return;
    }
    WidgetsToData();
    const int inUse = EntriesInUse(m_cbondNum);
    for (int k = 1; k <= inUse; ++k)
        m_laneIds.SetAt(k - 1, m_laneText[k]);
    accept();
}
