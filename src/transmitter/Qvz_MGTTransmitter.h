#pragma once
// Data side of the "Transmitter Setup" page: encoding, transmit CRC,
// pre-emphasis, output swing and the tap DACs of the active block.

#include "Qvz_MGTWizPage.h"

#include <cstdint>

class Qvz_MGTTransmitterGui;
class Wg_WizardPage;

class Qvz_MGTTransmitter : public Qvz_MGTWizPage {
public:
    explicit Qvz_MGTTransmitter(Qvz_WizMain* main);
    ~Qvz_MGTTransmitter() override;

    bool DoBatchPage() override;
    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override;

    // Block into fields (and, in a window run, into the form).
    bool ReadWizData();
    // Fields into block.
    bool WriteWizData();

    Port::StringBase m_preEmphasisText = "0";
    Port::StringBase m_forcedCrcValue = "11010110";
    Port::StringBase m_diffCtrl = "500";
    Port::StringBase m_crcFormat = "FIBRE_CHAN";
    Port::StringBase m_crcStartOfPkt = "K27_7";
    Port::StringBase m_crcEndOfPkt = "K29_7";
    Port::StringBase m_preTapDac = "00000";
    Port::StringBase m_datTapDac = "10110";
    Port::StringBase m_postTapDac = "01110";
    Port::StringBase m_crcDataWidth = "8";
    Port::StringBase m_crcInitVal = "00000000";
    int32_t m_preEmphasisLevel = 0;
    // 0 encoding disabled, 1 dynamic, 2 static.
    int32_t m_encodingMode = 0;
    // Static encoding: 0 8B/10B, 1 64B/66B.
    int32_t m_staticEncoding = 0;
    bool m_crcUse = false;
    bool m_isGT = true;
    bool m_isGT10 = false;
    bool m_isGT11 = false;
    bool m_isBatch = false;
    bool m_bypassPcs = false;
    bool m_preDriverOn = true;
    bool m_postDriverOn = true;
    bool m_crcClockDouble = false;
    Qvz_MGTTransmitterGui* m_pGui = nullptr;

    // The block's name as the CRC packet characters test it.
    static bool IsFibreChannel(const Qvz_Block* block);

private:
    void SetSliderValue(Qvz_Block* block);
    void ResolveEncoding(Qvz_Block* block);
    // The GUI side of a read; null in batch runs or before the controller exists.
    Qvz_MGTTransmitterGui* Gui() const { return m_isBatch ? nullptr : m_pGui; }
};
