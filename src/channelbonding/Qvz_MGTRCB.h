#pragma once
// Data side of the "Receiver Channel Bonding Setup" page: the bonding number,
// sequences, masks and timing of the active block, the master's placement and
// the bonded copies of the block made at finish.

#include "Qvz_MGTRCBPlacement.h"
#include "Qvz_MGTWizPage.h"

#include <vector>

class QComboBox;
class QSpinBox;
class Wg_WizardPage;

// What the page needs of its form in a window run. The page's controller
// provides it; without one the page behaves as in a batch run where it would
// otherwise touch a widget.
class Qvz_MGTRCBView {
public:
    virtual ~Qvz_MGTRCBView() = default;
    virtual QComboBox* SeqLenComboBox() = 0;
    virtual QSpinBox* CBondNumSpinBox() = 0;
    virtual QSpinBox* LimitSpinBox() = 0;
    virtual QSpinBox* OffsetSpinBox() = 0;
    virtual QSpinBox* WaitSpinBox() = 0;
    virtual void DataToWidgets() = 0;
};

class Qvz_MGTRCB : public Qvz_MGTWizPage {
public:
    static constexpr int kSeqCount = 8;
    static constexpr const char* kNoLaneId = "00000000000";

    explicit Qvz_MGTRCB(Qvz_WizMain* main);
    ~Qvz_MGTRCB() override;

    bool DoBatchPage() override;
    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override { return m_pGui; }

    // Block into fields; false when there is nothing to bond on (no data, no
    // active block, or a family maximum of 0).
    bool ReadWizData();
    // Fields into block after the checks; full also writes LANE_ID,
    // CHAN_BOND_MODE and the master's LOC.
    bool WriteWizData(bool full);
    // Sequence masks against the sequence length: on read, bad masks fall
    // back to the defaults (with a note); on write, they refuse.
    bool CheckSeqMasks(Qvz_Block* block, bool onRead);

    // Placement of position i (0 master, 2..N slaves) by the last read.
    Qvz_MGTRCBPlacement Placement() const;
    int GetLocX(int i) const { return Placement().LocX(i); }
    int GetLocY(int i) const { return Placement().LocY(i); }
    Port::StringBase GetBondMode(int i) const { return Placement().BondMode(i); }
    Port::StringBase MakeLocString(int x, int y) const { return Placement().LocString(x, y); }

    // LANE_ID of bonded transceiver k at index k - 1; kNoLaneId when missing.
    Port::StringBase GetLaneId(int index) const;

    // Makes one placed, wired copy of block per slave (and the second GT11
    // of a pair). A previous generation not yet withdrawn is withdrawn first.
    void GenerateBondedInstances(Qvz_Block* block, bool dual, int n);
    // Withdraws exactly what the last generation made.
    void RemoveBondedInstances();

    void SetView(Qvz_MGTRCBView* view) { m_pView = view; }

    Port::StringBase m_seqLen = "1";
    Port::StringBase m_limitText = "16";
    Port::StringBase m_offsetText = "8";
    Port::StringBase m_waitText = "8";
    Port::StringBase m_cbondNumText = "0";
    Port::StringBase m_seq[kSeqCount] = {kNoLaneId, kNoLaneId, kNoLaneId, kNoLaneId,
                                         kNoLaneId, kNoLaneId, kNoLaneId, kNoLaneId};
    Port::StringBase m_seq1Mask = "1111";
    Port::StringBase m_seq2Mask = "1111";
    Port::StringBase m_displayName;
    Port::StringBase m_laneIdBlockName = "GT10_CUSTOM_INST";
    int m_allowRepeat = 1;
    int m_primaryRowBottom = 0;
    int m_limit = 16;
    int m_offset = 8;
    int m_wait = 8;
    int m_cbondNum = 0;
    int m_seq2Use = 0;
    int m_offsetMin = 1;
    int m_offsetMax = 30;
    int m_waitMin = 1;
    int m_waitMax = 30;
    int m_limitMin = 1;
    int m_limitMax = 30;
    int m_MinCBondNum = 0;
    int m_MaxCBondNum = 24;
    bool m_isBatch = false;
    bool m_isGT = false;
    bool m_isGT10 = false;
    bool m_isGT11 = false;
    Qvz_StrArray m_laneIds;

private:
    enum class ReadResult { Read, NoData, NoBlock, NoBonding };
    ReadResult Read();
    // The family's bonding maximum (GT11 rounded down to even; never negative).
    int FamilyMaximum(const Qvz_Block* block) const;
    void SetFamily(const Qvz_Block* block);
    bool GuiMode() const { return !m_isBatch && m_pView; }
    void ReadRange(Qvz_Block* block, const char* name, int lowStart, int highStart,
                   bool resetOutOfRange, int& value, Port::StringBase& text, int& low, int& high,
                   QSpinBox* spin);
    void LoadLaneIds(Qvz_Block* block);
    Port::StringBase ReadBinary(Qvz_Attribute* attr, bool resetIfLocked) const;
    void WriteBinary(Qvz_Block* block, const char* name, const Port::StringBase& digits) const;
    void WireCopyPin(Qvz_Block* master, Qvz_Block* prev, Qvz_Pin* pin, int i);
    // Undoes the blocks of the last generation (copies, rename).
    void WithdrawCopies();

    Wg_WizardPage* m_pGui = nullptr;
    Qvz_MGTRCBView* m_pView = nullptr;
    bool m_laneIdsLoaded = false;

    // What the last generation did, so that withdrawing undoes exactly that.
    std::vector<Port::StringBase> m_generatedCopies;
    Port::StringBase m_renamedFrom;
    Port::StringBase m_renamedTo;

    // Per generation: the clock and chain choices the pin rules use.
    struct GenContext {
        bool dual = false;
        int n = 0;
        bool refclk1 = false, refclk2 = false, grefclk = false;
        bool brefclk = false, brefclkDynamic = false, brefclk2 = false;
        Port::StringBase masterChain, chainBase;
        bool far = false;
        Port::StringBase role;
    } m_gen;
};
