#include "Qvz_MGTTransmitter.h"

#include "Qvz_PlaceholderGui.h"

#include <new>

Qvz_MGTTransmitter::Qvz_MGTTransmitter(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTTransmitter::~Qvz_MGTTransmitter() = default;

bool Qvz_MGTTransmitter::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_PlaceholderGui("Transmitter Setup", parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

