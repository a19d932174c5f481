#include "Qvz_MGTRCD.h"

#include "Qvz_PlaceholderGui.h"

#include <new>

Qvz_MGTRCD::Qvz_MGTRCD(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRCD::~Qvz_MGTRCD() = default;

bool Qvz_MGTRCD::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_PlaceholderGui("Receiver Comma Detect Setup", parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

