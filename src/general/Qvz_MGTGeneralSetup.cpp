#include "Qvz_MGTGeneralSetup.h"

#include "Qvz_PlaceholderGui.h"

#include <new>

Qvz_MGTGeneralSetup::Qvz_MGTGeneralSetup(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTGeneralSetup::~Qvz_MGTGeneralSetup() = default;

bool Qvz_MGTGeneralSetup::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_PlaceholderGui("General Setup", parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

bool Qvz_MGTGeneralSetup::FinalizePins() {
    return true;
}
