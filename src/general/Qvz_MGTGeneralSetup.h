#pragma once
// Data side of the "General Setup" page: finds the transceiver block to
// configure, keeps the general choices (type, width, directions, clocks,
// options) and writes them into the block, with the per-family resets and the
// enabling of the later pages.
//
// The value fields and the six pin-name lists are public on purpose: the GUI
// controller reads and writes the value fields, and the finish routine
// (FinalizePins) reads m_isGT, m_isGT10, m_isGT11, m_bypassPcs, m_dataWidth
// and the pin-name lists. Every other page reaches this one only through the
// active block's attributes.

#include "Qvz_MGTWizPage.h"
#include "Qvz_StrArray.h"

class Qvz_MGTWizMain;
class Wg_WizardPage;

class Qvz_MGTGeneralSetup : public Qvz_MGTWizPage {
public:
    // Finds the block to configure and reads it (when the main has design data).
    explicit Qvz_MGTGeneralSetup(Qvz_WizMain* main);
    ~Qvz_MGTGeneralSetup() override;

    // Writes what the constructor read.
    bool DoBatchPage() override;
    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

    // Block -> fields; nothing for a null block.
    void ReadWizData(Qvz_Block* block);
    // Validates, then fields -> the block chosen by type and width, which
    // becomes the only active block. False refuses the page.
    bool WriteWizData();

    // The transceiver types to offer: each display name of an offered family
    // once, never "Zephine_8" or a "3GIO" name, always the current type.
    void GetMgtTypeChoices(Qvz_StrArray& out, Qvz_WizData* data);
    // Legal data widths of the block, or null when it has no width attribute.
    Qvz_StrArray* GetDataWidthChoices(Qvz_Block* block);
    // Legal PMA speeds for width, or null when the block has none.
    Qvz_StrArray* GetPmaSpeedChoices(Qvz_Block* block, Port::StringBase width);
    // Replaces a PMA speed the block does not allow for width by the default.
    void CheckPmaSpeed(Qvz_Block* block, Port::StringBase& pmaSpeed, Port::StringBase& width);

    // Resets applied by WriteWizData; each checks by itself whether it applies.
    void ApplyPcsBypassResets(Qvz_Block* block);
    void ResetZephineClockCorrection(Qvz_Block* block);
    void PruneGT10Attributes(Qvz_Block* block);
    void CleanUpGT11Attributes(Qvz_Block* block);

    // Decides every pin of the active block at finish.
    bool FinalizePins();

    // Pin-name lists, filled by the constructor.
    Qvz_StrArray m_pcsPins;
    Qvz_StrArray m_commaPins;
    Qvz_StrArray m_rxExtraPins;
    Qvz_StrArray m_userClockPins;
    Qvz_StrArray m_tx64b66bPins;
    Qvz_StrArray m_rx64b66bPins;

    // The general choices. "Editable" flags are set only when the block has
    // the attribute and it may be edited.
    Port::StringBase m_displayName = "FibreChannel";
    Port::StringBase m_dataWidth = "4"; // bytes, decimal text
    Port::StringBase m_pmaSpeed = "0_32";
    bool m_pmaSpeedEditable = false;
    Port::StringBase m_termination;
    bool m_terminationEditable = false;
    bool m_txUse = true;
    bool m_rxUse = true;
    bool m_gt11Single = false; // false: dual mode
    bool m_gt11UseB = true;
    Port::StringBase m_refClkVSel;
    bool m_refClkVSelEditable = false;
    int m_useRefClk = 0; // 0 or 1
    Port::StringBase m_refClkDyn;
    Port::StringBase m_refClk;
    int m_useBRefClk = 0; // 0 or 1
    Port::StringBase m_bRefClkDyn;
    Port::StringBase m_bRefClk;
    bool m_serdes10b = false;
    bool m_serdes10bEditable = false;
    bool m_bypassPcs = false;
    bool m_bypassPcsEditable = false;
    bool m_enablePma = false;
    bool m_enablePmaEditable = false;
    Port::StringBase m_rxPmaClkSel;
    Port::StringBase m_txabPmaClkSel;
    // The target's families, copied from the wizard main.
    bool m_isGT = false;
    bool m_isGT10 = false;
    bool m_isGT11 = false;
    // The block last read into the page.
    Qvz_Block* m_pBlock = nullptr;

protected:
    Qvz_Block* FindBlock();
    void MigrateOldAttributes(Qvz_Block* block);
    Qvz_Block* Rename3GIOBlock(Qvz_WizData* data, Qvz_Block* block);
    void FixBlockInstanceName(Qvz_WizData* data, Qvz_Block* block);
    void SetPinWidths(Qvz_Block* block, const Port::StringBase& primName);
    void EnableDependentPages(Qvz_Block* block, const Port::StringBase& primType);
    // Enables or disables pages first..last by title (last -1: first only).
    void EnablePages(bool enable, int first, int last);

private:
    Qvz_MGTWizMain* WizMain() const;
    bool IsBatch() const;

    Wg_WizardPage* m_pGui = nullptr;
};
