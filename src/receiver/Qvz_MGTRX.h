#pragma once
// Data side of the "Receiver Setup" page.

#include "Qvz_MGTWizPage.h"

class Wg_WizardPage;

class Qvz_MGTRX : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTRX(Qvz_WizMain* main);
    ~Qvz_MGTRX() override;

    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

private:
    Wg_WizardPage* m_pGui = nullptr;
};
