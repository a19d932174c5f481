#pragma once
// Base of every page of a wizard: the design data, the wizard main, messages,
// help and the combo-box helpers.

#include "Port_StringBase.h"
#include "Qvz_WizData.h"

class QComboBox;
class QWidget;
class Qvz_WizMain;
class Wg_WizardPage;

class Qvz_WizPage {
public:
    explicit Qvz_WizPage(Qvz_WizMain* main);
    // Virtual: the wizard main deletes its pages through this base.
    virtual ~Qvz_WizPage();
    Qvz_WizPage(const Qvz_WizPage&) = delete;
    Qvz_WizPage& operator=(const Qvz_WizPage&) = delete;

    // The batch step; false refuses the run.
    virtual bool DoBatchPage() { return true; }
    virtual bool CreateGuiDlg(QWidget* parent) = 0;
    virtual Wg_WizardPage* GetGuiDlg() = 0;

    void IssueMessage(const Port::StringBase& text, bool f1, bool f2, bool f3);
    void InvokeMoreInfo(const Port::StringBase& key);

    // Selects the item whose text is exactly text; false (and no change) when none is.
    static bool SetComboBoxText(QComboBox* combo, const Port::StringBase& text);
    // Index of the item whose text is exactly text, or -1.
    static int GetComboBoxIndex(QComboBox* combo, const Port::StringBase& text);

    Qvz_WizData* m_pWizData = nullptr;
    Qvz_WizMain* m_pWizMain = nullptr;
};
