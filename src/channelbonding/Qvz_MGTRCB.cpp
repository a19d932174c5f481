#include "Qvz_MGTRCB.h"

#include "Qvz_PlaceholderGui.h"

#include <new>

Qvz_MGTRCB::Qvz_MGTRCB(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRCB::~Qvz_MGTRCB() = default;

bool Qvz_MGTRCB::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_PlaceholderGui("Receiver Channel Bonding Setup", parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

void Qvz_MGTRCB::RemoveBondedInstances() {}
