#include "Qvz_MGTRCBConfigDialog.h"

#include "Qvz_MGTRCBPlacement.h"

#include <QCheckBox>
#include <QLabel>

Qvz_MGTRCBConfigDialog::Qvz_MGTRCBConfigDialog(QWidget* parent, const char* name, bool modal,
                                               Qt::WindowFlags fl)
    : Qvz_MGTRCBConfigDialogBase(parent, name, modal, fl) {
    for (int row = 0; row < 2; ++row)
        for (int col = 0; col < kColumns; ++col) {
            const QString xy = QString("%1%2").arg(col).arg(row);
            m_checks[row * kColumns + col] = findChild<QCheckBox*>("IDC_CHECK_CONFIG_" + xy);
            m_labels[row * kColumns + col] = findChild<QLabel*>("IDC_STATIC_CONFIG_" + xy);
        }
    connect(pbOK, &QPushButton::clicked, this, &QDialog::accept);
}

Qvz_MGTRCBConfigDialog::~Qvz_MGTRCBConfigDialog() = default;

QString Qvz_MGTRCBConfigDialog::RoleLabelText(const Port::StringBase& mode, int i, int cbondNum) {
    if (i > cbondNum)
        return QString();
    if (mode.Compare("MASTER", Port::CompareExact) == 0)
        return "M";
    if (mode.Compare("SLAVE_1_HOP", Port::CompareExact) == 0)
        return "S1";
    if (mode.Compare("SLAVE_2_HOPS", Port::CompareExact) == 0)
        return "S2";
    return QString();
}

QCheckBox* Qvz_MGTRCBConfigDialog::CheckBox(int column, int row) const {
    if (column < 0 || column >= kColumns || row < 0 || row > 1)
        return nullptr;
    return m_checks[row * kColumns + column];
}

QLabel* Qvz_MGTRCBConfigDialog::RoleLabel(int column, int row) const {
    if (column < 0 || column >= kColumns || row < 0 || row > 1)
        return nullptr;
    return m_labels[row * kColumns + column];
}

void Qvz_MGTRCBConfigDialog::DataToWidgets() {
    for (int k = 0; k < kLocations; ++k) {
        m_states[k] = false;
        if (m_checks[k]) {
            m_checks[k]->setVisible(false);
            m_checks[k]->setEnabled(false);
        }
        // A second load must not keep the roles of the first.
        if (m_labels[k])
            m_labels[k]->clear();
    }
    // GT and GT10 place alike; the family only matters for LOC texts.
    const Qvz_MGTRCBPlacement placement(Qvz_Family::GT, m_maxCBondNum, m_primaryRowBottom);
    for (int i = 0; i <= m_maxCBondNum; ++i) {
        if (i == 1)
            continue;
        const int col = placement.Column(i);
        const int row = placement.Row(i);
        if (col < 0 || col >= kColumns || row < 0 || row > 1)
            continue;
        const int k = row * kColumns + col;
        m_states[k] = i <= m_cbondNum;
        if (m_labels[k])
            m_labels[k]->setText(RoleLabelText(placement.BondMode(i), i, m_cbondNum));
        if (m_checks[k])
            m_checks[k]->setVisible(true);
    }
    for (int k = 0; k < kLocations; ++k)
        if (m_checks[k])
            m_checks[k]->setChecked(m_states[k]);
}
