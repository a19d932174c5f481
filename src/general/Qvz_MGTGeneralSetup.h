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

#include <vector>

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

    // Decides every pin of the active block at finish: ports, ties, bit-wise
    // wiring or unconnected, then the 10-bit buses, the grounding of floating
    // inputs and the bonded copies. False only when the bonded copies are due
    // and there is no Channel Bonding page. Finishing again (after going back
    // from the summary) first undoes what the last finish did to the pins.
    bool FinalizePins();

    // Helpers of FinalizePins (Qvz_MGTFinalizePins.cpp).
    // GT11: gives a data-width pin the width of the library "Custom" block's
    // pin of that name for the current data width.
    void RestorePinWidth(Qvz_Pin* pin);
    bool IsInPcsPinList(const Port::StringBase& name) const;
    bool IsInRxExtraPinList(const Port::StringBase& name) const;
    bool IsInUserClockPinList(const Port::StringBase& name) const;
    bool IsInTx64b66bPinList(const Port::StringBase& name) const;
    bool IsInRx64b66bPinList(const Port::StringBase& name) const;
    // Gather TXDATA/TXCHARDISPVAL/TXCHARDISPMODE (RXDATA/RXRUNDISP/RXCHARISK)
    // into one bus of 10 bits per byte; nothing without all three pins.
    void BuildTxTenBitBus(Qvz_Block* block);
    void BuildRxTenBitBus(Qvz_Block* block);
    // Ties the bits of a CRC data-width pin to the code of the CRC width.
    void TieCrcDataWidth(Qvz_Block* block, Qvz_Pin* pin, bool tx);
    // Ties to 0 every input that is still connected to nothing (not the
    // GT11 tile bus, which the bonding step wires).
    void GroundFloatingInputs(Qvz_Block* block);
    // Connects the pin to an external signal of its own; dataWidth in bytes
    // (below 1: unknown, the pin's own width is used).
    void MakePinPort(Qvz_Pin* pin, int dataWidth);

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

    // What the last finish found, so that finishing again starts from the
    // pins as they were before it.
    struct PinRecord {
        Port::StringBase name;
        Port::StringBase signal;
        bool grounded = false;
        bool vcc = false;
        bool used = false;
        std::vector<Qvz_NameValue> attributes;
    };
    struct FinishRecord {
        Qvz_Block* block = nullptr;
        std::vector<PinRecord> pins;
        // Signals the finish put to use.
        std::vector<Port::StringBase> activated;
    };
    FinishRecord m_lastFinish;
    void UndoLastFinish();
    void RecordBeforeFinish(Qvz_Block* block);
    bool DecidePins(Qvz_Block* block);
};
