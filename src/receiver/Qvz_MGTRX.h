#pragma once
// Data side of the "Receiver Setup" page: decoding, 8B/10B loss of sync, the
// 64B/66B sync-header counters, receive CRC and equalisation. The page's GUI
// controller edits the public fields directly between a read and a write.

#include "Qvz_MGTWizPage.h"

#include <cstdint>

class QSpinBox;
class Qvz_MGTRXGui;
class Wg_WizardPage;

class Qvz_MGTRX : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTRX(Qvz_WizMain* main);
    ~Qvz_MGTRX() override;

    bool DoBatchPage() override;
    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override;

    // Active block into the fields (and, in a window run, into the form).
    bool ReadWizData();
    // Checks the counters, then the fields into the active block.
    bool WriteWizData();

    // Decoding modes (m_decodingMode) and static choices (m_staticDecoding).
    enum { kDecodingDisabled = 0, kDecodingDynamic = 1, kDecodingStatic = 2 };
    enum { kStatic8B10B = 0, kStatic64B66B = 1 };

    Port::StringBase m_losInvalidIncr = "1";
    Port::StringBase m_losThreshold = "4";
    Port::StringBase m_shInvalidCntMaxText = "16";
    Port::StringBase m_shCntMaxText = "64";
    // The three binary digits of RXAFEEQ, without its fixed prefix.
    Port::StringBase m_rxAfeEq = "000";
    Port::StringBase m_crcDataWidth = "8";
    // The eight hexadecimal digits of RXCRCINITVAL.
    Port::StringBase m_crcInitVal = "00000000";
    int32_t m_shCntMax = 64;
    int32_t m_shCntMaxMin = 1;
    int32_t m_shCntMaxMax = 255;
    int32_t m_shInvalidCntMax = 16;
    int32_t m_shInvalidCntMaxMin = 1;
    int32_t m_shInvalidCntMaxMax = 255;
    int32_t m_lossOfSyncFsm = 1;
    int32_t m_decodingMode = kDecodingDisabled;
    int32_t m_staticDecoding = kStatic8B10B;
    bool m_isBatch = false;
    bool m_bypassPcs = false;
    // RX_CRC_USE and QVZ_RXCRC_USE are separate switches with separate controls.
    bool m_rxCrcUse = false;
    bool m_crcUse = false;
    bool m_crcClockDouble = false;
    // The device's families, as the wizard main knew them when the page was made.
    bool m_supportsMGT3 = false;
    bool m_supportsMGT10 = false;
    bool m_supportsMGT11 = false;

    // RXAFEEQ is stored as this prefix and three binary digits.
    static constexpr const char* kAfeEqPrefix = "9'b000000";

    // The three digits the page edits, taken from a stored RXAFEEQ value.
    static Port::StringBase AfeEqDigits(const Port::StringBase& value);
    // A whole decimal number: optional leading blanks and sign, then digits only.
    static bool IsDecimalNumber(const Port::StringBase& text);

    // The page's controller, once CreateGuiDlg has made it.
    Qvz_MGTRXGui* GuiDlg() const { return m_pGui; }

private:
    void ReadDecoding(Qvz_Block* block);
    // Reads SH_CNT_MAX or SH_INVALID_CNT_MAX into its three fields and text.
    void ReadCounter(Qvz_Block* block, const char* attrName, QSpinBox* spin, int32_t& value,
                     int32_t& low, int32_t& high, Port::StringBase& text);
    // False (with the range message) when text is no number within low..high.
    bool CheckCounter(const char* attrName, const Port::StringBase& text, int32_t low,
                      int32_t high);

    // The GUI side of a read; null in batch runs or before the controller exists.
    Qvz_MGTRXGui* Gui() const { return m_isBatch ? nullptr : m_pGui; }

    Qvz_MGTRXGui* m_pGui = nullptr;
};
