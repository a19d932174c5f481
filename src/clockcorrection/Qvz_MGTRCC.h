#pragma once
// Data side of the "Receiver Clock Correction Setup" page: the clock-correction
// sequences, their masks and length, the latency window and the flags, read
// from and written to the active block's CLK_COR_* attributes.

#include "Qvz_MGTWizPage.h"

class QComboBox;
class QSpinBox;
class Qvz_MGTRCCGui;
class Wg_WizardPage;

// What the page needs from its form while it reads the block in a window run.
// The page's controller implements it; without one the page reads data only.
class Qvz_MGTRCCView {
public:
    enum SpinBoxId { kRepeatWait, kMinLat, kMaxLat };

    virtual ~Qvz_MGTRCCView() = default;
    // Fills the sequence-length choices from the block (before the fields are read).
    virtual void InitDataMembers(Qvz_Block* block) = 0;
    // false: fields -> widgets; true: widgets -> fields.
    virtual void UpdateData(bool fromWidgets) = 0;
    virtual void UpdateControls() = 0;
    // The form's sequence-length combo box and spin boxes (null when missing).
    virtual QComboBox* SeqLengthComboBox() = 0;
    virtual QSpinBox* LatencySpinBox(SpinBoxId which) = 0;
};

class Qvz_MGTRCC : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTRCC(Qvz_WizMain* main);
    ~Qvz_MGTRCC() override;

    bool DoBatchPage() override;
    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override;

    // Active block -> fields. In a window run the form is loaded too.
    bool ReadWizData();
    // Checks the fields, then writes them into the active block.
    bool WriteWizData();
    // Masks against the sequence length (GT10 and GT11 only). useDefaults
    // (reading) replaces invalid masks by the block's defaults and says so;
    // otherwise (writing) refuses them.
    bool CheckMasks(Qvz_Block* block, bool useDefaults);

    // The controller that shows this page; the page does not own it.
    void SetView(Qvz_MGTRCCView* view) { m_pView = view; }

    // Fields, shared with the controller. Sequences and masks hold bare binary digits.
    Port::StringBase m_repeatWait = "1";
    Port::StringBase m_seqLength = "4";
    Port::StringBase m_maxLat = "36";
    Port::StringBase m_minLat = "28";
    Port::StringBase m_seq1[4] = {"00000000000", "00000000000", "00000000000", "00000000000"};
    Port::StringBase m_seq2[4] = {"00000000000", "00000000000", "00000000000", "00000000000"};
    Port::StringBase m_seq1Mask = "1111";
    Port::StringBase m_seq2Mask = "1111";
    int m_minLatValue = 28;
    int m_minLatLow = 0;
    int m_minLatHigh = 63;
    int m_repeatWaitValue = 1;
    int m_repeatWaitLow = 0;
    int m_repeatWaitHigh = 31;
    int m_clkCorrectUse = 1;
    int m_keepIdle = 0;
    int m_insertIdleFlag = 0;
    int m_seq2Use = 0;
    int m_maxLatValue = 36;
    int m_maxLatLow = 0;
    int m_maxLatHigh = 63;
    int m_seqDrop = 0;
    int m_8b10bDe = 1;
    bool m_isBatch = false;
    bool m_isGT11 = false;
    bool m_isGT10 = false;

private:
    // One of the three numbers: value and range from the attribute, and the
    // matching spin box in a window run.
    void ReadNumber(Qvz_Block* block, const char* name, Qvz_MGTRCCView::SpinBoxId spin,
                    Port::StringBase& text, int& value, int& low, int& high);
    Qvz_MGTRCCView* GuiView() const { return m_isBatch ? nullptr : m_pView; }

    Qvz_MGTRCCGui* m_pGui = nullptr;
    Qvz_MGTRCCView* m_pView = nullptr;
};
