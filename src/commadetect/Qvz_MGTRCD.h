#pragma once
// Data side of the "Receiver Comma Detect Setup" page.

#include "Qvz_MGTWizPage.h"

class Wg_WizardPage;

class Qvz_MGTRCD : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTRCD(Qvz_WizMain* main);
    ~Qvz_MGTRCD() override;

    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

private:
    Wg_WizardPage* m_pGui = nullptr;
};
