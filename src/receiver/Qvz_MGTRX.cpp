#include "Qvz_MGTRX.h"

#include "Qvz_PlaceholderGui.h"

#include <new>

Qvz_MGTRX::Qvz_MGTRX(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRX::~Qvz_MGTRX() = default;

bool Qvz_MGTRX::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_PlaceholderGui("Receiver Setup", parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

