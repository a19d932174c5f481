#pragma once
// GUI controller of the "Receiver Comma Detect Setup" page.

#include "Qvz_MGTPageGui.h"

class QLineEdit;
class Qvz_Block;
class Qvz_MGTRCD;
class Qvz_MGTRCDWidget;

class Qvz_MGTRCDGui : public Qvz_MGTPageGui {
    Q_OBJECT
public:
    // Validated entries, in checking order.
    enum EntryIndex { kPlusComma = 0, kMinusComma, kCommaMask, kEntryCount };

    Qvz_MGTRCDGui(Qvz_MGTRCD* page, QWidget* parent);
    ~Qvz_MGTRCDGui() override;

    Qvz_MGTRCDWidget* Form() const { return m_pForm; }

    void LoadComboBoxes(Qvz_Block* block) override;
    void DataToWidgets() override;
    void WidgetsToData() override;
    // Enabling, showing and labels by the active block and the turn-off;
    // the page runs it after each read in window runs.
    void UpdateControls() override;

public slots:
    // Reads the block and sets the entries up for its family, every time.
    void onActive() override;
    bool onCancel() override { return Qvz_MGTPageGui::onCancel(); }
    // Edits are dropped: the next activation reloads the block.
    bool onBack() override { return true; }
    bool onNext() override { return Qvz_MGTPageGui::onNext(); }
    bool onFinish() override { return Qvz_MGTPageGui::onFinish(); }
    void onMoreInfo() override { Qvz_MGTPageGui::onMoreInfo(); }
    void init() override;
    void OnCheckTurnoffComma();
    // Not connected to any signal; each says whether its entry holds a
    // whole pattern of the block's family.
    void ValidatePComma();
    void ValidateMComma();
    void ValidateCommaMask();
    // The validators refuse bad characters while the user types; nothing
    // is left to do here.
    void ValidateLE_ALL() {}

protected:
    bool ReadPage() override;
    bool WritePage() override;

private:
    // Validators and messages of the three entries for the family last read.
    void SetupEntries();
    void ValidateEntry(int index, QLineEdit* edit, const char* gt11Message, const char* message);

    Qvz_MGTRCDWidget* m_pForm = nullptr;
    Qvz_MGTRCD* m_pPage = nullptr;
};
