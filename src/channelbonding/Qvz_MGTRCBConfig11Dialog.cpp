#include "Qvz_MGTRCBConfig11Dialog.h"

#include "Qvz_MGTRCB.h"
#include "Qvz_MGTRCBConfigDialog.h"

#include <QCheckBox>
#include <QLabel>

Qvz_MGTRCBConfig11Dialog::Qvz_MGTRCBConfig11Dialog(QWidget* parent, const char* name, bool modal,
                                                   Qt::WindowFlags fl)
    : Qvz_MGTRCBConfig11DialogBase(parent, name, modal, fl) {
    for (int x = 0; x < 2; ++x)
        for (int y = 0; y < kRows; ++y) {
            const QString xy = QString("%1%2").arg(x).arg(y);
            m_checks[x * kRows + y] = findChild<QCheckBox*>("IDC_CHECK_CONFIG_" + xy);
            m_labels[x * kRows + y] = findChild<QLabel*>("IDC_STATIC_CONFIG_" + xy);
        }
    connect(pbOK, &QPushButton::clicked, this, &QDialog::accept);
}

Qvz_MGTRCBConfig11Dialog::~Qvz_MGTRCBConfig11Dialog() = default;

QCheckBox* Qvz_MGTRCBConfig11Dialog::CheckBox(int x, int y) const {
    if (x < 0 || x > 1 || y < 0 || y >= kRows)
        return nullptr;
    return m_checks[x * kRows + y];
}

QLabel* Qvz_MGTRCBConfig11Dialog::RoleLabel(int x, int y) const {
    if (x < 0 || x > 1 || y < 0 || y >= kRows)
        return nullptr;
    return m_labels[x * kRows + y];
}

void Qvz_MGTRCBConfig11Dialog::DataToWidgets() {
    if (!m_pPage || m_maxCBondNum < 0)
        return;
    for (int i = 0; i <= m_maxCBondNum; ++i) {
        if (i == 1)
            continue;
        const int x = m_pPage->GetLocX(i);
        const int y = m_pPage->GetLocY(i);
        if (x < 0 || x > 1 || y < 0 || y >= kRows)
            continue;
        const int k = x * kRows + y;
        m_states[k] = i <= m_cbondNum;
        if (m_labels[k])
            m_labels[k]->setText(
                Qvz_MGTRCBConfigDialog::RoleLabelText(m_pPage->GetBondMode(i), i, m_cbondNum));
        if (m_checks[k])
            m_checks[k]->setVisible(true);
    }
    for (int k = 0; k < kLocations; ++k)
        if (m_checks[k])
            m_checks[k]->setChecked(m_states[k]);
}
