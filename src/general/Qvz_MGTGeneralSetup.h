#pragma once
// Data side of the "General Setup" page.

#include "Qvz_MGTWizPage.h"

class Wg_WizardPage;

class Qvz_MGTGeneralSetup : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTGeneralSetup(Qvz_WizMain* main);
    ~Qvz_MGTGeneralSetup() override;

    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

    // Decides every pin of the active block at finish.
    bool FinalizePins();

private:
    Wg_WizardPage* m_pGui = nullptr;
};
