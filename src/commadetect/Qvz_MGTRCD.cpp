#include "Qvz_MGTRCD.h"

#include <algorithm>
#include <cctype>

#include "Qvz_MGTRCDGui.h"
#include "Qvz_MGTRCDWidget.h"
#include "Qvz_WizMain.h"

#include <algorithm>
#include <cctype>
#include <new>

namespace {

// Digit counts of the GT11 notation: 32-bit patterns and the 10-bit mask.
constexpr std::size_t kGT11PatternDigits = 8;
constexpr std::size_t kGT11TenBitDigits = 3;
constexpr std::size_t kBinaryDigits = 10;

bool IsHexText(const Port::StringBase& text) {
    return std::all_of(text.str().begin(), text.str().end(),
                       [](unsigned char c) { return std::isxdigit(c) != 0; });
}

// Exactly n digits: leading zeros added, or only the low-order n kept (all
// an attribute of that width can hold). Text that is not hexadecimal is left
// whole: cutting it could split a character and corrupt the design data.
Port::StringBase FitDigits(const Port::StringBase& digits, std::size_t n) {
    if (!IsHexText(digits))
        return digits;
    if (digits.GetLength() >= n)
        return digits.Right(n);
    Port::StringBase out(std::string(n - digits.GetLength(), '0'));
    out += digits;
    return out;
}

// Hexadecimal digits as binary digits, four a digit; false when the text is
// empty or holds anything else.
bool HexToBinary(const Port::StringBase& hex, Port::StringBase& binary) {
    if (hex.IsEmpty())
        return false;
    std::string bits;
    for (char c : hex.str()) {
        int v;
        if (c >= '0' && c <= '9')
            v = c - '0';
        else if (c >= 'A' && c <= 'F')
            v = c - 'A' + 10;
        else if (c >= 'a' && c <= 'f')
            v = c - 'a' + 10;
        else
            return false;
        for (int bit = 3; bit >= 0; --bit)
            bits += ((v >> bit) & 1) ? '1' : '0';
    }
    binary = bits;
    return true;
}

} // namespace

Qvz_MGTRCD::Qvz_MGTRCD(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRCD::~Qvz_MGTRCD() = default;

bool Qvz_MGTRCD::DoBatchPage() {
    if (!ReadWizData())
        return false;
    return WriteWizData();
}

bool Qvz_MGTRCD::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_MGTRCDGui(this, parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

Wg_WizardPage* Qvz_MGTRCD::GetGuiDlg() {
    return m_pGui;
}

Qvz_Block* Qvz_MGTRCD::ActiveBlock() const {
    return m_pWizData ? m_pWizData->GetActiveBlock() : nullptr;
}

Port::StringBase Qvz_MGTRCD::ReadCommaValue(const Qvz_Attribute* attribute, bool pad) const {
    if (!attribute)
        return Port::StringBase();
    Port::StringBase value = attribute->GetValue();
    const std::size_t pos = value.GetIndexOfString("'h", Port::CompareSearch);
    const bool sized = pos != Port::StringBase::npos;
    if (sized)
        value = value.Mid(pos + 2);
    if (m_isGT11) {
        // A 10'h value of a 10-bit attribute has fewer digits, a wider
        // literal more; the 32-bit pattern always holds eight.
        if (pad)
            value = FitDigits(value, kGT11PatternDigits);
        return value;
    }
    // The other families hold binary digits: a hexadecimal literal keeps its
    // meaning only when converted.
    Port::StringBase binary;
    if (sized && HexToBinary(value, binary))
        value = FitDigits(binary, kBinaryDigits);
    return value;
}

Port::StringBase Qvz_MGTRCD::ReadCommaMask(const Qvz_Attribute* attribute) const {
    Port::StringBase mask = ReadCommaValue(attribute, false);
    // The mask is a 10-bit attribute: three digits in the GT11 notation.
    if (m_isGT11)
        mask = FitDigits(mask, kGT11TenBitDigits);
    return mask;
}

void Qvz_MGTRCD::FormatCommaValue(Qvz_Attribute* attribute, const Port::StringBase& value,
                                  bool tenBit) const {
    if (!attribute)
        return;
    if (!m_isGT11) {
        attribute->SetValue(value);
        return;
    }
    if (tenBit) {
        // Short values are padded: there may be fewer than three digits to take.
        attribute->SetValue(Port::StringBase("10'h") + FitDigits(value, kGT11TenBitDigits));
        return;
    }
    // The size stays 32: more digits would make a literal wider than the attribute.
    attribute->SetValue(GetSizedLiteral(FitDigits(value, kGT11PatternDigits), 1));
}

void Qvz_MGTRCD::ReadComma(Qvz_Block* block, const char* attr10, const char* attr32,
                           const char* detect, const char* ctrl, Port::StringBase& value,
                           int32_t& mode) {
    Qvz_Attribute* a = block->GetNamedAttribute(attr10);
    if (!a)
        a = block->GetNamedAttribute(attr32);
    if (a) {
        // A pattern the block forbids changing is never carried over.
        if (!a->IsEditable())
            a->SetValue(a->GetDefaultValue());
        value = ReadCommaValue(a, true);
    }

    if (m_turnOffComma ||
        block->GetAttributeValue(detect).Compare("FALSE", Port::CompareExact) == 0) {
        mode = kModeDisabled;
        return;
    }
    const Port::StringBase control = block->GetAttributeValue(ctrl);
    if (control.Compare("DYNAMIC", Port::CompareExact) == 0)
        mode = kModeDynamic;
    else if (control.Compare("ALWAYS", Port::CompareExact) == 0)
        mode = kModeAlways;
    else if (control.Compare("DISABLE", Port::CompareExact) == 0)
        mode = kModeDisabled;
}

bool Qvz_MGTRCD::ReadWizData() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }
    // Without a wizard main there is no window to update.
    m_isBatch = m_pWizMain ? m_pWizMain->m_batchMode : true;
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;

    m_isGT = block->SupportsMGT3();
    m_isGT10 = block->SupportsMGT10();
    m_isGT11 = block->SupportsMGT11();
    m_pcommaValue = m_isGT11 ? "11111000" : "0011111000";
    m_mcommaValue = m_isGT11 ? "00000000" : "1100000000";
    m_commaMask = m_isGT11 ? "000" : "0000000000";

    Qvz_MGTRCDGui* gui = Gui();
    if (gui)
        gui->LoadComboBoxes(block);

    if (const Qvz_Attribute* a = block->GetNamedAttribute("ALIGN_COMMA_WORD")) {
        m_alignCommaWord = a->GetValue();
        if (gui)
            SetComboBoxText(gui->Form()->cbAlign, m_alignCommaWord);
    }

    m_turnOffComma = IsTrue(block, "QVZX_ONLY_TURNOFF_COMMA");
    m_decPcommaDetect = IsTrue(block, "DEC_PCOMMA_DETECT");
    ReadComma(block, "PCOMMA_10B_VALUE", "PCOMMA_32B_VALUE", "PCOMMA_DETECT",
              "QVZX_ONLY_PCOMMA_CTRL", m_pcommaValue, m_pcommaMode);
    m_decMcommaDetect = IsTrue(block, "DEC_MCOMMA_DETECT");
    ReadComma(block, "MCOMMA_10B_VALUE", "MCOMMA_32B_VALUE", "MCOMMA_DETECT",
              "QVZX_ONLY_MCOMMA_CTRL", m_mcommaValue, m_mcommaMode);

    m_alignCommaMsb = IsTrue(block, "ALIGN_COMMA_MSB");
    m_decValidCommaOnly = IsTrue(block, "DEC_VALID_COMMA_ONLY");

    if (Qvz_Attribute* mask = block->GetNamedAttribute("COMMA_10B_MASK")) {
        if (!mask->IsEditable())
            mask->SetValue(mask->GetDefaultValue());
        m_commaMask = ReadCommaMask(mask);
    }

    if (gui) {
        gui->UpdateData(false);
        gui->UpdateControls();
    }
    return true;
}

void Qvz_MGTRCD::WriteCommaPattern(Qvz_Block* block, const char* attr10, const char* attr32,
                                   const Port::StringBase& value) {
    if (Qvz_Attribute* a10 = block->GetNamedAttribute(attr10)) {
        // The GT11 block takes the pattern in its 32-bit attribute as well.
        if (m_isGT11)
            FormatCommaValue(block->AddAttribute(attr32, ""), value, false);
        FormatCommaValue(a10, value, true);
    } else if (m_isGT11) {
        FormatCommaValue(block->GetNamedAttribute(attr32), value, false);
    }
}

bool Qvz_MGTRCD::WriteWizData() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;

    const bool off = m_turnOffComma != 0;
    SetIfPresent(block, "QVZX_ONLY_TURNOFF_COMMA", BoolText(off));
    SetIfPresent(block, "DEC_PCOMMA_DETECT", BoolText(!off && m_decPcommaDetect));
    SetIfPresent(block, "DEC_MCOMMA_DETECT", BoolText(!off && m_decMcommaDetect));
    SetIfPresent(block, "ALIGN_COMMA_MSB", BoolText(!off && m_alignCommaMsb));
    SetIfPresent(block, "DEC_VALID_COMMA_ONLY", BoolText(m_decValidCommaOnly));

    const struct {
        const char* ctrl;
        const char* detect;
        int32_t mode;
    } modes[] = {{"QVZX_ONLY_PCOMMA_CTRL", "PCOMMA_DETECT", m_pcommaMode},
                 {"QVZX_ONLY_MCOMMA_CTRL", "MCOMMA_DETECT", m_mcommaMode}};
    for (const auto& m : modes) {
        Qvz_Attribute* ctrl = block->GetNamedAttribute(m.ctrl);
        Qvz_Attribute* detect = block->GetNamedAttribute(m.detect);
        // The control choice means nothing without the attribute it drives.
        if (!ctrl || !detect)
            continue;
        const int32_t mode = off ? kModeDisabled : m.mode;
        if (mode == kModeDynamic) {
            ctrl->SetValue("DYNAMIC");
            detect->SetValue("TRUE");
        } else if (mode == kModeAlways) {
            ctrl->SetValue("ALWAYS");
            detect->SetValue("TRUE");
        } else if (mode == kModeDisabled) {
            ctrl->SetValue("DISABLE");
            detect->SetValue("FALSE");
        }
    }

    WriteCommaPattern(block, "PCOMMA_10B_VALUE", "PCOMMA_32B_VALUE", m_pcommaValue);
    WriteCommaPattern(block, "MCOMMA_10B_VALUE", "MCOMMA_32B_VALUE", m_mcommaValue);

    if (Qvz_Attribute* mask = block->GetNamedAttribute("COMMA_10B_MASK")) {
        if (off)
            mask->SetValue(m_isGT11 ? "000" : "0000000000");
        else
            FormatCommaValue(mask, m_commaMask, true);
    }

    SetIfPresent(block, "ALIGN_COMMA_WORD", m_alignCommaWord);
    return true;
}

void Qvz_MGTRCD::ApplyTurnOffComma() {
    if (m_turnOffComma) {
        m_decPcommaDetect = 0;
        m_decMcommaDetect = 0;
        m_alignCommaMsb = 0;
        m_commaMask = m_isGT11 ? "000" : "0000000000";
        return;
    }
    Qvz_Block* block = ActiveBlock();
    if (!block)
        return;
    const struct {
        const char* name;
        int32_t& field;
    } flags[] = {{"DEC_PCOMMA_DETECT", m_decPcommaDetect},
                 {"DEC_MCOMMA_DETECT", m_decMcommaDetect},
                 {"ALIGN_COMMA_MSB", m_alignCommaMsb}};
    for (const auto& f : flags) {
        if (block->GetNamedAttribute(f.name))
            f.field = IsTrue(block, f.name);
    }
    if (const Qvz_Attribute* mask = block->GetNamedAttribute("COMMA_10B_MASK"))
        m_commaMask = ReadCommaMask(mask);
}
