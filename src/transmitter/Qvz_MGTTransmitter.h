#pragma once
// Data side of the "Transmitter Setup" page.

#include "Qvz_MGTWizPage.h"

class Wg_WizardPage;

class Qvz_MGTTransmitter : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTTransmitter(Qvz_WizMain* main);
    ~Qvz_MGTTransmitter() override;

    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

private:
    Wg_WizardPage* m_pGui = nullptr;
};
