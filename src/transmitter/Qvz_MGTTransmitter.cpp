#include "Qvz_MGTTransmitter.h"

#include "Qvz_MGTTXWidget.h"
#include "Qvz_MGTTransmitterGui.h"
#include "Qvz_WizMain.h"

#include <QSlider>

#include <algorithm>
#include <new>
#include <utility>

namespace {

// Decimal text as a whole (blanks, sign, digits, nothing after); text that
// is no number cannot be a slider position.
bool IsWholeDecimal(const Port::StringBase& text) {
    const std::string& s = text.str();
    std::size_t i = 0;
    while (i < s.size() && (s[i] == ' ' || s[i] == '\t'))
        ++i;
    if (i < s.size() && (s[i] == '+' || s[i] == '-'))
        ++i;
    const std::size_t digits = i;
    while (i < s.size() && UT_STR::IsDigit(static_cast<unsigned char>(s[i])))
        ++i;
    return i > digits && i == s.size();
}

} // namespace

Qvz_MGTTransmitter::Qvz_MGTTransmitter(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTTransmitter::~Qvz_MGTTransmitter() = default;

bool Qvz_MGTTransmitter::DoBatchPage() {
    m_isBatch = true;
    ReadWizData();
    return WriteWizData();
}

bool Qvz_MGTTransmitter::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_MGTTransmitterGui(this, parent);
    return FinishGuiCreation(m_pGui != nullptr);
}

Wg_WizardPage* Qvz_MGTTransmitter::GetGuiDlg() {
    return m_pGui;
}

bool Qvz_MGTTransmitter::IsFibreChannel(const Qvz_Block* block) {
    return block && block->GetPrimitiveName().Compare("GT_FIBRE_CHAN", Port::CompareExact) == 0;
}

bool Qvz_MGTTransmitter::ReadWizData() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }
    m_isBatch = m_pWizMain ? m_pWizMain->m_batchMode : true;
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;

    m_isGT = block->SupportsMGT3();
    m_isGT10 = block->SupportsMGT10();
    m_isGT11 = block->SupportsMGT11();
    m_bypassPcs = IsTrue(block->GetAttributeValue("QVZX_ONLY_BYPASS_PCS"));

    Qvz_MGTTransmitterGui* gui = Gui();
    Qvz_MGTTXWidget* form = gui ? gui->Form() : nullptr;
    if (gui)
        gui->LoadComboBoxes(block);

    if (m_isGT) {
        SetSliderValue(block);
        const Port::StringBase swing = block->GetAttributeValue("TX_DIFF_CTRL");
        if (!swing.IsEmpty()) {
            m_diffCtrl = swing;
            if (form)
                SetComboBoxText(form->cbOVS, swing);
        }
    }

    const Port::StringBase width = block->GetAttributeValue("QVZ_TXCRC_DATAWIDTH");
    if (!width.IsEmpty()) {
        m_crcDataWidth = width;
        if (form)
            SetComboBoxText(form->cbCRCwidth, width);
    }

    if (Qvz_Attribute* format = block->GetNamedAttribute("CRC_FORMAT")) {
        Port::StringBase value = format->GetValue();
        if (form) {
            // A format the list does not offer falls back to the primitive's default.
            if (GetComboBoxIndex(form->cbCRCFormat, value) == -1) {
                value = format->GetDefaultValue();
                format->SetValue(value);
            }
            SetComboBoxText(form->cbCRCFormat, value);
        }
        m_crcFormat = value;
    }

    if (!IsFibreChannel(block)) {
        const Port::StringBase sop = block->GetAttributeValue("CRC_START_OF_PKT");
        if (!sop.IsEmpty()) {
            m_crcStartOfPkt = sop;
            if (form)
                SetComboBoxText(form->cbSOP, sop);
        }
        const Port::StringBase eop = block->GetAttributeValue("CRC_END_OF_PKT");
        if (!eop.IsEmpty()) {
            m_crcEndOfPkt = eop;
            if (form)
                SetComboBoxText(form->cbEOP, eop);
        }
    }

    ResolveEncoding(block);

    if (const Qvz_Attribute* a = block->GetNamedAttribute("TXPRE_TAP_PD"))
        m_preDriverOn = IsTrue(a->GetValue());
    if (const Qvz_Attribute* a = block->GetNamedAttribute("TXPOST_TAP_PD"))
        m_postDriverOn = IsTrue(a->GetValue());
    if (const Qvz_Attribute* a = block->GetNamedAttribute("TXPRE_TAP_DAC"))
        m_preTapDac = StripSizedLiteral(a->GetValue(), 0);
    if (const Qvz_Attribute* a = block->GetNamedAttribute("TXDAT_TAP_DAC"))
        m_datTapDac = StripSizedLiteral(a->GetValue(), 0);
    if (const Qvz_Attribute* a = block->GetNamedAttribute("TXPOST_TAP_DAC"))
        m_postTapDac = StripSizedLiteral(a->GetValue(), 0);

    if (const Qvz_Attribute* a = block->GetNamedAttribute("TX_CRC_FORCE_VALUE"))
        m_forcedCrcValue = a->GetValue();
    if (const Qvz_Attribute* a = block->GetNamedAttribute("TXCRCINITVAL"))
        m_crcInitVal = StripSizedLiteral(a->GetValue(), 1);

    if (gui)
        gui->UpdateData(false);
    return true;
}

void Qvz_MGTTransmitter::SetSliderValue(Qvz_Block* block) {
    const Qvz_Attribute* attr = block->GetNamedAttribute("TX_PREEMPHASIS");
    if (!attr)
        return;
    int low = 0, high = 3;
    for (const Port::StringBase& entry : attr->GetLegalValues().Items()) {
        int lo = 0, hi = 0;
        if (Qvz_Attribute::GetRangeValues(entry, lo, hi)) {
            low = lo;
            high = hi;
        }
    }
    // A range given high to low still names the same positions.
    if (low > high)
        std::swap(low, high);

    const Port::StringBase& value = attr->GetValue();
    if (IsWholeDecimal(value)) {
        m_preEmphasisLevel = UT_STR::AToI(value);
        m_preEmphasisText = value;
    }
    // The level must be a position the slider has, and the written text
    // must say the same as the slider.
    const int level = std::clamp<int>(m_preEmphasisLevel, low, high);
    if (level != m_preEmphasisLevel) {
        m_preEmphasisLevel = level;
        m_preEmphasisText = UT_STR::IToA(level);
    }

    if (Qvz_MGTTransmitterGui* gui = Gui()) {
        QSlider* slider = gui->Form()->sPre;
        slider->setRange(low, high);
        slider->setValue(m_preEmphasisLevel);
    }
}

void Qvz_MGTTransmitter::ResolveEncoding(Qvz_Block* block) {
    m_crcUse = IsTrue(block->GetAttributeValue("TX_CRC_USE"));
    if (const Qvz_Attribute* own = block->GetNamedAttribute("QVZ_TXCRC_USE"))
        m_crcUse = IsTrue(own->GetValue());
    m_crcClockDouble = IsTrue(block->GetAttributeValue("TXCRCCLOCKDOUBLE"));

    if (m_bypassPcs) {
        m_encodingMode = 0;
        return;
    }

    Port::StringBase staticValue;
    if (const Qvz_Attribute* st = block->GetNamedAttribute("QVZX_ONLY_ENC_STATIC")) {
        staticValue = st->GetValue();
        m_staticEncoding = staticValue.Compare("8B10B", Port::CompareExact) == 0 ? 0 : 1;
    }

    bool allowNone = true, allow8B10B = true, allow64B66B = true;
    const bool pmaUnchanged = GetGT10EncodingChoices(block, allowNone, allow8B10B, allow64B66B);

    const Qvz_Attribute* encoding = block->GetNamedAttribute("QVZX_ONLY_ENCODING");
    if (!encoding)
        return;

    // Replacements forced by a changed PMA speed speak only then; the static
    // 8B/10B <-> 64B/66B swaps always speak.
    const char* from = nullptr;
    const char* to = nullptr;
    bool speakAlways = false;
    const Port::StringBase& mode = encoding->GetValue();
    if (mode.Compare("DISABLE", Port::CompareExact) == 0) {
        if (allowNone) {
            m_encodingMode = 0;
        } else if (allow8B10B) {
            m_encodingMode = 2;
            m_staticEncoding = 0;
            from = "to Disable Encoding";
            to = "Static 8B/10B Encoding";
        } else {
            m_encodingMode = 2;
            m_staticEncoding = 1;
            from = "to Disable Encoding";
            to = "Static 64B/66B Encoding";
        }
    } else if (mode.Compare("DYNAMIC", Port::CompareExact) == 0) {
        if (m_isGT) {
            m_encodingMode = 2;
        } else if (allow8B10B && allow64B66B) {
            m_encodingMode = 1;
        } else if (!allow8B10B && !allow64B66B) {
            m_encodingMode = 0;
            from = "Dynamic Encoding control";
            to = "Disable Encoding";
        } else if (allow8B10B) {
            m_encodingMode = 2;
            m_staticEncoding = 0;
            from = "Dynamic Encoding control";
            to = "Static 8B/10B Encoding";
        } else {
            m_encodingMode = 2;
            m_staticEncoding = 1;
            from = "Dynamic Encoding control";
            to = "Static 64B/66B Encoding";
        }
    } else {
        if (!allow8B10B && !allow64B66B) {
            m_encodingMode = 0;
            from = "Static Encoding control";
            to = "Disable encoding";
        } else if (!allow8B10B && staticValue.Compare("8B10B", Port::CompareExact) == 0) {
            m_encodingMode = 2;
            m_staticEncoding = 1;
            from = "Static 8B/10B Encoding control";
            to = "Static 64B/66B Encoding control";
            speakAlways = true;
        } else if (!allow64B66B && staticValue.Compare("64B66B", Port::CompareExact) == 0) {
            m_encodingMode = 2;
            m_staticEncoding = 0;
            from = "Static 64B/66B Encoding control";
            to = "Static 8B/10B Encoding control";
            speakAlways = true;
        } else {
            m_encodingMode = 2;
        }
    }

    if (from && (speakAlways || !pmaUnchanged)) {
        Port::StringBase text;
        text.Format("The previous selection %s is no longer a valid choice, based on the current "
                    "PMA_SPEED setting.  The encoding setting has been changed to %s.",
                    from, to);
        IssueMessage(text, false, false, false);
    }
}

bool Qvz_MGTTransmitter::WriteWizData() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;
    const bool fibreChannel = IsFibreChannel(block);

    if (m_isGT) {
        SetIfPresent(block, "TX_PREEMPHASIS", m_preEmphasisText);
        SetIfPresent(block, "TX_DIFF_CTRL", m_diffCtrl);
    }
    SetIfPresent(block, "TX_CRC_USE", BoolText(m_crcUse));
    SetIfPresent(block, "CRC_FORMAT", m_crcFormat);
    if (!fibreChannel)
        SetIfPresent(block, "CRC_START_OF_PKT", m_crcStartOfPkt);
    SetIfPresent(block, "QVZ_TXCRC_USE", BoolText(m_crcUse));
    SetIfPresent(block, "QVZ_TXCRC_DATAWIDTH", m_crcDataWidth);
    SetIfPresent(block, "TXCRCCLOCKDOUBLE", BoolText(m_crcClockDouble));
    SetIfPresent(block, "TXCRCINITVAL", GetSizedLiteral(m_crcInitVal, 1));
    if (!fibreChannel)
        SetIfPresent(block, "CRC_END_OF_PKT", m_crcEndOfPkt);
    SetIfPresent(block, "TX_CRC_FORCE_VALUE", m_forcedCrcValue);
    if (Qvz_Attribute* buffer = block->GetNamedAttribute("TX_BUFFER_USE"))
        if (buffer->GetValue().Compare("FALSE", Port::CompareExact) == 0)
            buffer->SetValue("TRUE");
    SetIfPresent(block, "QVZX_ONLY_ENCODING",
                 m_encodingMode == 0   ? "DISABLE"
                 : m_encodingMode == 1 ? "DYNAMIC"
                                       : "STATIC");
    SetIfPresent(block, "QVZX_ONLY_ENC_STATIC", m_staticEncoding != 0 ? "64B66B" : "8B10B");
    if (Qvz_Attribute* old = block->GetNamedAttribute("QVZX_ONLY_TX_8B10B_USE"))
        block->DeleteAttribute(old);
    SetIfPresent(block, "TXPRE_TAP_PD", BoolText(m_preDriverOn));
    SetIfPresent(block, "TXPOST_TAP_PD", BoolText(m_postDriverOn));
    SetIfPresent(block, "TXPRE_TAP_DAC", GetSizedLiteral(m_preTapDac, 0));
    SetIfPresent(block, "TXDAT_TAP_DAC", GetSizedLiteral(m_datTapDac, 0));
    SetIfPresent(block, "TXPOST_TAP_DAC", GetSizedLiteral(m_postTapDac, 0));
    return true;
}
