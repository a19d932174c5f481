#include "Qvz_MGTRX.h"

#include "Qvz_MGTRXGui.h"
#include "Qvz_MGTRXWidget.h"
#include "Qvz_WizMain.h"

#include <QComboBox>
#include <QSpinBox>
#include <new>
#include <string>
#include <utility>

namespace {

bool Is(const Port::StringBase& value, const char* text) {
    return value.Compare(text, Port::CompareExact) == 0;
}

} // namespace

Qvz_MGTRX::Qvz_MGTRX(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {
    if (main) {
        m_supportsMGT3 = main->m_supportsMGT3;
        m_supportsMGT10 = main->m_supportsMGT10;
        m_supportsMGT11 = main->m_supportsMGT11;
    }
}

Qvz_MGTRX::~Qvz_MGTRX() = default;

bool Qvz_MGTRX::DoBatchPage() {
    if (!ReadWizData())
        return false;
    return WriteWizData();
}

bool Qvz_MGTRX::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_MGTRXGui(this, parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

Wg_WizardPage* Qvz_MGTRX::GetGuiDlg() {
    return m_pGui;
}

Port::StringBase Qvz_MGTRX::AfeEqDigits(const Port::StringBase& value) {
    const std::size_t prefixLength = std::char_traits<char>::length(kAfeEqPrefix);
    if (value.GetLength() >= prefixLength)
        return TextFrom(value, prefixLength);
    // A shorter value cannot carry the full prefix. Take it as a short binary
    // literal (or bare digits) and widen it to three digits, so that the write
    // still produces a well-formed value; anything else reads as zero.
    const Port::StringBase digits = StripSizedLiteral(value, 0);
    if (digits.IsEmpty() || digits.GetLength() > 3)
        return "000";
    for (std::size_t i = 0; i < digits.GetLength(); ++i)
        if (digits.GetAt(i) != '0' && digits.GetAt(i) != '1')
            return "000";
    Port::StringBase out(std::string(3 - digits.GetLength(), '0'));
    out += digits;
    return out;
}

bool Qvz_MGTRX::IsDecimalNumber(const Port::StringBase& text) {
    std::size_t i = 0;
    while (text.GetAt(i) == ' ' || text.GetAt(i) == '\t')
        ++i;
    if (text.GetAt(i) == '+' || text.GetAt(i) == '-')
        ++i;
    if (i >= text.GetLength())
        return false;
    for (; i < text.GetLength(); ++i)
        if (!UT_STR::IsDigit(static_cast<unsigned char>(text.GetAt(i))))
            return false;
    return true;
}

bool Qvz_MGTRX::ReadWizData() {
    if (!m_pWizData)
        return true;
    m_isBatch = m_pWizMain ? m_pWizMain->m_batchMode : true;
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }

    m_bypassPcs = IsTrue(block->GetAttributeValue("QVZX_ONLY_BYPASS_PCS"));
    if (const Qvz_Attribute* a = block->GetNamedAttribute("RXAFEEQ"))
        m_rxAfeEq = AfeEqDigits(a->GetValue());
    if (const Qvz_Attribute* a = block->GetNamedAttribute("RXCRCINITVAL"))
        m_crcInitVal = StripSizedLiteral(a->GetValue(), 1);

    Qvz_MGTRXGui* gui = Gui();
    Qvz_MGTRXWidget* form = gui ? gui->Form() : nullptr;
    if (gui)
        gui->LoadComboBoxes(block);

    ReadDecoding(block);

    const struct {
        const char* attr;
        QComboBox* combo;
        Port::StringBase& field;
    } choices[] = {{"RX_LOS_INVALID_INCR", form ? form->cbRXIncr : nullptr, m_losInvalidIncr},
                   {"RX_LOS_THRESHOLD", form ? form->cbRXThreshold : nullptr, m_losThreshold},
                   {"QVZ_RXCRC_DATAWIDTH", form ? form->cbRxCRCwidth : nullptr, m_crcDataWidth}};
    for (const auto& c : choices) {
        const Port::StringBase value = block->GetAttributeValue(c.attr);
        if (value.IsEmpty())
            continue;
        c.field = value;
        if (c.combo)
            SetComboBoxText(c.combo, value);
    }

    ReadCounter(block, "SH_CNT_MAX", form ? form->sbSHMax : nullptr, m_shCntMax, m_shCntMaxMin,
                m_shCntMaxMax, m_shCntMaxText);
    ReadCounter(block, "SH_INVALID_CNT_MAX", form ? form->sbSHInvalidMax : nullptr,
                m_shInvalidCntMax, m_shInvalidCntMaxMin, m_shInvalidCntMaxMax,
                m_shInvalidCntMaxText);

    if (gui)
        gui->UpdateData(false);
    return true;
}

void Qvz_MGTRX::ReadDecoding(Qvz_Block* block) {
    m_lossOfSyncFsm = IsTrue(block->GetAttributeValue("RX_LOSS_OF_SYNC_FSM")) ? 1 : 0;
    if (const Qvz_Attribute* a = block->GetNamedAttribute("RX_CRC_USE"))
        m_rxCrcUse = IsTrue(a->GetValue());
    if (const Qvz_Attribute* a = block->GetNamedAttribute("QVZ_RXCRC_USE"))
        m_crcUse = IsTrue(a->GetValue());
    if (const Qvz_Attribute* a = block->GetNamedAttribute("RXCRCCLOCKDOUBLE"))
        m_crcClockDouble = IsTrue(a->GetValue());

    // A decoder the user may switch off and has switched off wins over the
    // wizard's own decoding choice.
    const Qvz_Attribute* decodeUse = block->GetNamedAttribute("RX_DECODE_USE");
    if (decodeUse && Is(decodeUse->GetValue(), "FALSE") && decodeUse->IsEditable()) {
        m_decodingMode = kDecodingDisabled;
        return;
    }

    Port::StringBase staticValue;
    if (const Qvz_Attribute* a = block->GetNamedAttribute("QVZX_ONLY_DEC_STATIC")) {
        staticValue = a->GetValue();
        m_staticDecoding = Is(staticValue, "8B10B") ? kStatic8B10B : kStatic64B66B;
    }

    bool allowNone = true, allow8B10B = true, allow64B66B = true;
    GetGT10EncodingChoices(block, allowNone, allow8B10B, allow64B66B);

    if (const Qvz_Attribute* a = block->GetNamedAttribute("QVZX_ONLY_DECODING")) {
        const Port::StringBase& mode = a->GetValue();
        if (Is(mode, "DISABLE")) {
            m_decodingMode = allowNone ? kDecodingDisabled : kDecodingStatic;
        } else if (Is(mode, "DYNAMIC")) {
            if (allow8B10B && allow64B66B)
                m_decodingMode = kDecodingDynamic;
            else if (!allow8B10B && !allow64B66B)
                m_decodingMode = kDecodingDisabled;
            else
                m_decodingMode = kDecodingStatic;
        } else if (!allow8B10B && !allow64B66B) {
            m_decodingMode = kDecodingDisabled;
        } else {
            m_decodingMode = kDecodingStatic;
            if (!allow8B10B && Is(staticValue, "8B10B"))
                m_staticDecoding = kStatic64B66B;
            else if (!allow64B66B && Is(staticValue, "64B66B"))
                m_staticDecoding = kStatic8B10B;
        }
    }
    // First-family transceivers have no dynamic decoding control.
    if (m_supportsMGT3 && m_decodingMode == kDecodingDynamic)
        m_decodingMode = kDecodingStatic;
}

void Qvz_MGTRX::ReadCounter(Qvz_Block* block, const char* attrName, QSpinBox* spin, int32_t& value,
                            int32_t& low, int32_t& high, Port::StringBase& text) {
    Qvz_Attribute* a = block->GetNamedAttribute(attrName);
    if (!a)
        return;
    int lo = 1, hi = 255;
    const Qvz_StrArray& legal = a->GetLegalValues();
    for (int i = 0; i < legal.GetSize(); ++i) {
        int l = 0, h = 0;
        if (Qvz_Attribute::GetRangeValues(legal.GetAt(i), l, h)) {
            lo = l;
            hi = h;
        }
    }
    // A range written high to low still means the values between them.
    if (lo > hi)
        std::swap(lo, hi);
    if (a->GetValue().GetLength() == 8)
        a->SetValue(a->GetDefaultValue());
    // A value that is no number would read as whatever digits it starts
    // with; the block's default stands in for it when that is a number.
    if (!IsDecimalNumber(a->GetValue()) && IsDecimalNumber(a->GetDefaultValue()))
        a->SetValue(a->GetDefaultValue());
    value = UT_STR::AToI(a->GetValue());
    if (spin) {
        spin->setRange(lo, hi);
        spin->setValue(value);
    }
    text.Format("%d", static_cast<int>(value));
    low = lo;
    high = hi;
}

bool Qvz_MGTRX::CheckCounter(const char* attrName, const Port::StringBase& text, int32_t low,
                             int32_t high) {
    const int32_t n = UT_STR::AToI(text);
    if (IsDecimalNumber(text) && n >= low && n <= high)
        return true;
    Port::StringBase message;
    message.Format("The allowable range for the attribute %s is between %d and %d.", attrName,
                   static_cast<int>(low), static_cast<int>(high));
    IssueMessage(message, false, false, false);
    return false;
}

bool Qvz_MGTRX::WriteWizData() {
    if (!CheckCounter("SH_CNT_MAX", m_shCntMaxText, m_shCntMaxMin, m_shCntMaxMax))
        return false;
    if (!CheckCounter("SH_INVALID_CNT_MAX", m_shInvalidCntMaxText, m_shInvalidCntMaxMin,
                      m_shInvalidCntMaxMax))
        return false;
    if (UT_STR::AToI(m_losInvalidIncr) > UT_STR::AToI(m_losThreshold)) {
        IssueMessage("The value of RX_LOS_THRESHOLD must be at least as big as the value of "
                     "RX_LOS_INVLID_INCR.",
                     false, false, false);
        return false;
    }
    if (!m_pWizData)
        return true;
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;

    SetIfPresent(block, "RX_LOS_INVALID_INCR", m_losInvalidIncr);
    SetIfPresent(block, "RX_LOS_THRESHOLD", m_losThreshold);
    SetIfPresent(block, "RX_LOSS_OF_SYNC_FSM", BoolText(m_lossOfSyncFsm != 0));
    if (block->GetNamedAttribute("QVZX_ONLY_DECODING")) {
        const char* mode = m_decodingMode == kDecodingDisabled  ? "DISABLE"
                           : m_decodingMode == kDecodingDynamic ? "DYNAMIC"
                                                                : "STATIC";
        SetIfPresent(block, "QVZX_ONLY_DECODING", mode);
        SetIfPresent(block, "RX_DECODE_USE", BoolText(m_decodingMode != kDecodingDisabled));
    }
    SetIfPresent(block, "QVZX_ONLY_DEC_STATIC", m_staticDecoding != 0 ? "64B66B" : "8B10B");
    SetIfPresent(block, "RX_CRC_USE", BoolText(m_rxCrcUse));
    SetIfPresent(block, "QVZ_RXCRC_USE", BoolText(m_crcUse));
    SetIfPresent(block, "QVZ_RXCRC_DATAWIDTH", m_crcDataWidth);
    SetIfPresent(block, "RXCRCCLOCKDOUBLE", BoolText(m_crcClockDouble));
    SetIfPresent(block, "RXCRCINITVAL", GetSizedLiteral(m_crcInitVal, 1));
    SetIfPresent(block, "SH_CNT_MAX", m_shCntMaxText);
    SetIfPresent(block, "SH_INVALID_CNT_MAX", m_shInvalidCntMaxText);
    SetIfPresent(block, "RXAFEEQ", Port::StringBase(kAfeEqPrefix) + m_rxAfeEq);
    return true;
}
