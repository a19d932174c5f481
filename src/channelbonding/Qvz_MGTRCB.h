#pragma once
// Data side of the "Receiver Channel Bonding Setup" page.

#include "Qvz_MGTWizPage.h"

class Wg_WizardPage;

class Qvz_MGTRCB : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTRCB(Qvz_WizMain* main);
    ~Qvz_MGTRCB() override;

    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

    // Withdraws the bonded copies the finish routine made.
    void RemoveBondedInstances();

private:
    Wg_WizardPage* m_pGui = nullptr;
};
