#pragma once
// GUI controller of the "General Setup" page. Every value lives in the page;
// the controller only moves it between the page and the form, and switches
// the page to another block when the user picks another type or width.

#include "Port_StringBase.h"
#include "Wg_WizardPage.h"

class GeneralSetupWidget;
class QComboBox;
class Qvz_Block;
class Qvz_MGTGeneralSetup;
class Qvz_StrArray;

class Qvz_MGTGeneralSetupGui : public Wg_WizardPage {
    Q_OBJECT
public:
    Qvz_MGTGeneralSetupGui(Qvz_MGTGeneralSetup* page, QWidget* parent);
    ~Qvz_MGTGeneralSetupGui() override;

    GeneralSetupWidget* Form() const { return m_pForm; }

    bool isAdvanced() override { return false; }

    // Form -> page fields.
    void SaveGUIToPage();
    // Page fields -> form.
    void DataToWidgets();
    // Replaces the combo box's items by the list (none for a null list).
    void LoadComboBox(QComboBox* combo, Qvz_StrArray* list);
    Port::StringBase GetCurrentWidthSetting() const;
    // Lists and values of the block the page has just read; nothing for null.
    void RefreshForBlock(Qvz_Block* block);
    // Shows the page's PMA speed as the block allows it at the chosen width.
    void UpdatePmaSpeed(Qvz_Block* block);

public slots:
    void onActive() override;
    bool onCancel() override { return true; }
    // Going back keeps the page's values as they are.
    bool onBack() override { return true; }
    bool onNext() override;
    // Keeps the dialog here: the block to finish is chosen only by Next.
    bool onFinish() override { return true; }
    void onMoreInfo() override;
    void init() override {}
    void OnComboDataWidth(const QString& text);
    void OnComboMGTType(const QString& text);
    void OnRadioRefClk();
    void OnCheckRefClk() { OnRadioRefClk(); }
    void OnCheckTXRX();
    void OnSingleMGT();
    // The one-time set-up after construction (run by the page).
    void InitUIData();

private:
    Qvz_MGTGeneralSetup* m_pPage = nullptr;
    GeneralSetupWidget* m_pForm = nullptr;
};
