#pragma once
// Data side of the "Receiver Comma Detect Setup" page: comma patterns, mask,
// detection modes and alignment of the receiver.

#include "Qvz_MGTWizPage.h"

#include <cstdint>

class Qvz_Attribute;
class Qvz_Block;
class Qvz_MGTRCDGui;
class Wg_WizardPage;

class Qvz_MGTRCD : public Qvz_MGTWizPage {
public:
    // Detection modes of the plus- and minus-comma.
    enum CommaMode { kModeDynamic = 0, kModeAlways = 1, kModeDisabled = 2 };

    explicit Qvz_MGTRCD(Qvz_WizMain* main);
    ~Qvz_MGTRCD() override;

    bool DoBatchPage() override;
    bool CreateGuiDlg(QWidget* parent) override;
    Wg_WizardPage* GetGuiDlg() override;

    // Active block into the fields; false without data or active block.
    bool ReadWizData();
    // Fields into the attributes the active block has.
    bool WriteWizData();

    // The digits of a comma attribute's value (after any "'h"). On GT11 a
    // pattern (pad) is fitted to eight hexadecimal digits; elsewhere a
    // hexadecimal literal is turned into ten binary digits.
    Port::StringBase ReadCommaValue(const Qvz_Attribute* attribute, bool pad) const;
    // Sets the attribute from digits in the page's notation: on GT11 a
    // 10-bit attribute (tenBit) gets "10'h" and three digits, a 32-bit one
    // "32'h" and eight; on the other families the digits go in unchanged.
    void FormatCommaValue(Qvz_Attribute* attribute, const Port::StringBase& value,
                          bool tenBit) const;

    // After m_turnOffComma changed in the form: off clears the decoder
    // flags, the MSB alignment and the mask; on brings them back from the
    // active block.
    void ApplyTurnOffComma();

    // Fields, edited by the page's controller between read and write.
    int32_t m_decPcommaDetect = 1;
    int32_t m_decMcommaDetect = 1;
    int32_t m_alignCommaMsb = 0;
    int32_t m_decValidCommaOnly = 1;
    int32_t m_turnOffComma = 0;
    int32_t m_mcommaMode = kModeAlways;
    int32_t m_pcommaMode = kModeAlways;
    Port::StringBase m_pcommaValue = "0000000000";
    Port::StringBase m_mcommaValue = "0000000000";
    Port::StringBase m_commaMask = "0000000000";
    Port::StringBase m_alignCommaWord = "1";
    bool m_isBatch = false;
    bool m_isGT = true;
    bool m_isGT10 = false;
    bool m_isGT11 = false;
    Qvz_MGTRCDGui* m_pGui = nullptr;

private:
    Qvz_Block* ActiveBlock() const;
    // Reads one comma pattern (10-bit attribute, else the 32-bit one) and
    // its detection mode.
    void ReadComma(Qvz_Block* block, const char* attr10, const char* attr32, const char* detect,
                   const char* ctrl, Port::StringBase& value, int32_t& mode);
    // Writes one comma pattern (on GT11 into the 32-bit attribute too).
    void WriteCommaPattern(Qvz_Block* block, const char* attr10, const char* attr32,
                           const Port::StringBase& value);
    // The mask digits of COMMA_10B_MASK, three of them on GT11.
    Port::StringBase ReadCommaMask(const Qvz_Attribute* attribute) const;

    // The GUI side of a read; null in batch runs or before the controller exists.
    Qvz_MGTRCDGui* Gui() const { return m_isBatch ? nullptr : m_pGui; }
};
