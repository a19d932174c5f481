#include "Qvz_MGTRCC.h"

#include "Qvz_PlaceholderGui.h"

#include <new>

Qvz_MGTRCC::Qvz_MGTRCC(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRCC::~Qvz_MGTRCC() = default;

bool Qvz_MGTRCC::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_PlaceholderGui("Receiver Clock Correction Setup", parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

