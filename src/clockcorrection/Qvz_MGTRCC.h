#pragma once
// Data side of the "Receiver Clock Correction Setup" page.

#include "Qvz_MGTWizPage.h"

class Wg_WizardPage;

class Qvz_MGTRCC : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTRCC(Qvz_WizMain* main);
    ~Qvz_MGTRCC() override;

    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

private:
    Wg_WizardPage* m_pGui = nullptr;
};
