#include "Qvz_MGTRCC.h"

#include "Qvz_MGTRCCGui.h"
#include "Qvz_WizMain.h"

#include <QComboBox>
#include <QSpinBox>

#include <new>

namespace {

const char* const kSeq1Names[4] = {"CLK_COR_SEQ_1_1", "CLK_COR_SEQ_1_2", "CLK_COR_SEQ_1_3",
                                   "CLK_COR_SEQ_1_4"};
const char* const kSeq2Names[4] = {"CLK_COR_SEQ_2_1", "CLK_COR_SEQ_2_2", "CLK_COR_SEQ_2_3",
                                   "CLK_COR_SEQ_2_4"};

} // namespace

Qvz_MGTRCC::Qvz_MGTRCC(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRCC::~Qvz_MGTRCC() = default;

bool Qvz_MGTRCC::DoBatchPage() {
    if (!ReadWizData())
        return false;
    return WriteWizData();
}

bool Qvz_MGTRCC::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    m_pGui = new (std::nothrow) Qvz_MGTRCCGui(this, parent);
    SetView(m_pGui);
    return FinishGuiCreation(m_pGui != nullptr);
}

Wg_WizardPage* Qvz_MGTRCC::GetGuiDlg() {
    return m_pGui;
}

void Qvz_MGTRCC::ReadNumber(Qvz_Block* block, const char* name, Qvz_MGTRCCView::SpinBoxId spin,
                            Port::StringBase& text, int& value, int& low, int& high) {
    const Qvz_Attribute* a = block->GetNamedAttribute(name);
    if (!a)
        return;
    low = 0;
    high = spin == Qvz_MGTRCCView::kRepeatWait ? 31 : 63;
    for (const Port::StringBase& legal : a->GetLegalValues().Items())
        Qvz_Attribute::GetRangeValues(legal, low, high);
    value = UT_STR::AToI(a->GetValue());
    text.Format("%d", value);
    if (Qvz_MGTRCCView* view = GuiView()) {
        if (QSpinBox* box = view->LatencySpinBox(spin)) {
            // Range first, so the old range does not clip the value.
            box->setRange(low, high);
            box->setValue(value);
        }
    }
}

bool Qvz_MGTRCC::ReadWizData() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;

    m_isBatch = m_pWizMain ? m_pWizMain->m_batchMode : true;
    m_isGT11 = block->SupportsMGT11();
    m_isGT10 = block->SupportsMGT10();

    Qvz_MGTRCCView* view = GuiView();
    if (view)
        view->InitDataMembers(block);
    QComboBox* lengths = view ? view->SeqLengthComboBox() : nullptr;

    if (const Qvz_Attribute* len = block->GetNamedAttribute("CLK_COR_SEQ_LEN")) {
        m_seqLength = len->GetLegalValues().Contains(len->GetValue()) ? len->GetValue()
                                                                      : len->GetDefaultValue();
        if (lengths)
            SetComboBoxText(lengths, m_seqLength);
    } else if (lengths) {
        lengths->clear();
        lengths->addItem(m_seqLength.ToQString());
        lengths->setCurrentIndex(0);
    }

    m_clkCorrectUse = IsTrue(block, "CLK_CORRECT_USE");
    m_keepIdle = IsTrue(block, "CLK_COR_KEEP_IDLE");
    m_insertIdleFlag = IsTrue(block, "CLK_COR_INSERT_IDLE_FLAG");
    m_seq2Use = IsTrue(block, "CLK_COR_SEQ_2_USE");
    m_seqDrop = IsTrue(block, "CLK_COR_SEQ_DROP");
    m_8b10bDe = IsTrue(block, "CLK_COR_8B10B_DE");

    ReadNumber(block, "CLK_COR_REPEAT_WAIT", Qvz_MGTRCCView::kRepeatWait, m_repeatWait,
               m_repeatWaitValue, m_repeatWaitLow, m_repeatWaitHigh);
    ReadNumber(block, "CLK_COR_MIN_LAT", Qvz_MGTRCCView::kMinLat, m_minLat, m_minLatValue,
               m_minLatLow, m_minLatHigh);
    ReadNumber(block, "CLK_COR_MAX_LAT", Qvz_MGTRCCView::kMaxLat, m_maxLat, m_maxLatValue,
               m_maxLatLow, m_maxLatHigh);

    const Qvz_Attribute* mask1 = block->GetNamedAttribute("CLK_COR_SEQ_1_MASK");
    const Qvz_Attribute* mask2 = block->GetNamedAttribute("CLK_COR_SEQ_2_MASK");
    m_seq1Mask = mask1 ? GetBinaryValue(mask1) : Port::StringBase("1111");
    m_seq2Mask = mask2 ? GetBinaryValue(mask2) : Port::StringBase("1111");

    for (int i = 0; i < 4; ++i) {
        if (const Qvz_Attribute* a = block->GetNamedAttribute(kSeq1Names[i]))
            m_seq1[i] = GetBinaryValue(a);
        if (const Qvz_Attribute* a = block->GetNamedAttribute(kSeq2Names[i]))
            m_seq2[i] = GetBinaryValue(a);
    }

    CheckMasks(block, true);

    if (view) {
        view->UpdateData(false);
        view->UpdateControls();
    }
    return true;
}

bool Qvz_MGTRCC::CheckMasks(Qvz_Block* block, bool useDefaults) {
    if (!m_isGT10 && !m_isGT11)
        return true;
    const bool mask1Ok = ValidateSeqMask(m_seq1Mask, m_seqLength);
    const bool mask2Ok = ValidateSeqMask(m_seq2Mask, m_seqLength);
    if (mask1Ok && mask2Ok)
        return true;

    const char* unit = UT_STR::AToI(m_seqLength) == 1 ? "zero" : "zeros";
    Port::StringBase text;

    if (!useDefaults) {
        if (!mask1Ok && !mask2Ok)
            text.Format("The CLK_COR_SEQ_1_MASK(=%s) and CLK_COR_SEQ_2_MASK(=%s) values are not "
                        "valid.  They each can have only %s %s (the length of the clock "
                        "correction sequence).  Please change the mask values to be valid.",
                        m_seq1Mask.c_str(), m_seq2Mask.c_str(), m_seqLength.c_str(), unit);
        else if (!mask1Ok)
            text.Format("The CLK_COR_SEQ_1_MASK value of %s is not valid.  It can have only %s %s "
                        "(the length of the clock correction sequence).  Please change the value "
                        "to be valid.",
                        m_seq1Mask.c_str(), m_seqLength.c_str(), unit);
        else
            text.Format("The CLK_COR_SEQ_2_MASK value of %s is not valid.  It can have only %s %s "
                        "(the length of the clock correction sequence).  Please change the value "
                        "to be valid.",
                        m_seq2Mask.c_str(), m_seqLength.c_str(), unit);
        IssueMessage(text, true, false, false);
        return false;
    }

    Port::StringBase defMask1 = "1111";
    Port::StringBase defMask2 = "1111";
    Port::StringBase defLength = "4";
    if (block) {
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CLK_COR_SEQ_1_MASK"))
            defMask1 = StripSizedLiteral(a->GetDefaultValue(), 0);
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CLK_COR_SEQ_2_MASK"))
            defMask2 = StripSizedLiteral(a->GetDefaultValue(), 0);
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CLK_COR_SEQ_LEN"))
            defLength = a->GetDefaultValue();
    }
    Port::StringBase lengthSuffix;
    if (defLength != m_seqLength)
        lengthSuffix.Format(", using default length %s", defLength.c_str());
    Port::StringBase bothDefaults;
    bothDefaults.Format("  The wizard will use the default length %s and defaults for both "
                        "CLK_COR_SEQ_1_MASK (%s) and CLK_COR_SEQ_2_MASK (%s) instead of the "
                        "current values.",
                        defLength.c_str(), defMask1.c_str(), defMask2.c_str());

    if (!mask1Ok && !mask2Ok) {
        text.Format("The CLK_COR_SEQ_1_MASK(=%s) and CLK_COR_SEQ_2_MASK(=%s) values are not "
                    "valid.  They each can have only %s %s (the length of the clock correction "
                    "sequence).  The wizard will use the defaults (%s and %s, respectively%s) "
                    "instead of the current values.",
                    m_seq1Mask.c_str(), m_seq2Mask.c_str(), m_seqLength.c_str(), unit,
                    defMask1.c_str(), defMask2.c_str(), lengthSuffix.c_str());
        m_seq1Mask = defMask1;
        m_seq2Mask = defMask2;
        if (!lengthSuffix.IsEmpty())
            m_seqLength = defLength;
    } else if (!mask1Ok) {
        text.Format("The CLK_COR_SEQ_1_MASK value of %s is not valid.  It can have only %s %s "
                    "(the length of the clock correction sequence).",
                    m_seq1Mask.c_str(), m_seqLength.c_str(), unit);
        m_seq1Mask = defMask1;
        m_seqLength = defLength;
        if (!ValidateSeqMask(m_seq2Mask, defLength)) {
            m_seq2Mask = defMask2;
            text += bothDefaults;
        } else {
            Port::StringBase onlyMask1;
            onlyMask1.Format("  The wizard will use the default length %s and the "
                             "CLK_COR_SEQ_1_MASK default %s instead of the current values.",
                             defLength.c_str(), defMask1.c_str());
            text += onlyMask1;
        }
    } else {
        text.Format("The CLK_COR_SEQ_2_MASK value of %s is not valid.  It can have only %s %s "
                    "(the length of the clock correction sequence).",
                    m_seq2Mask.c_str(), m_seqLength.c_str(), unit);
        m_seq2Mask = defMask2;
        m_seqLength = defLength;
        if (!ValidateSeqMask(m_seq1Mask, defLength)) {
            m_seq1Mask = defMask1;
            text += bothDefaults;
        }
    }
    IssueMessage(text, false, false, false);
    return true;
}

bool Qvz_MGTRCC::WriteWizData() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }

    Port::StringBase text;
    const int repeatWait = UT_STR::AToI(m_repeatWait);
    if (repeatWait < m_repeatWaitLow || repeatWait > m_repeatWaitHigh) {
        text.Format("The allowable range for the minimum number of RXUSRCLK cycles is between %d "
                    "and %d.",
                    m_repeatWaitLow, m_repeatWaitHigh);
        IssueMessage(text, false, false, false);
        return false;
    }
    m_maxLatValue = UT_STR::AToI(m_maxLat);
    if (m_maxLatValue < m_maxLatLow || m_maxLatValue > m_maxLatHigh) {
        text.Format("The allowable range for the maximum clock correction latency is between %d "
                    "and %d.",
                    m_maxLatLow, m_maxLatHigh);
        IssueMessage(text, false, false, false);
        return false;
    }
    m_minLatValue = UT_STR::AToI(m_minLat);
    if (m_minLatValue < m_minLatLow || m_minLatValue > m_minLatHigh) {
        text.Format("The allowable range for the minimum clock correction latency is between %d "
                    "and %d.",
                    m_minLatLow, m_minLatHigh);
        IssueMessage(text, false, false, false);
        return false;
    }
    if (m_maxLatValue <= m_minLatValue) {
        IssueMessage(m_isBatch ? "The Maximum Latency (CLK_COR_MAX_LAT) value must be greater "
                                 "than the Minimum Latency (CLK_COR_MIN_LAT) value.  The wizard "
                                 "cannot continue."
                               : "Please enter a Maximum Latency value that is greater than the "
                                 "Minimum Latency value.",
                     false, false, false);
        return false;
    }

    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;

    // Written before the masks are checked, so it stays even when they are refused.
    SetIfPresent(block, "CLK_COR_REPEAT_WAIT", m_repeatWait);
    if (!CheckMasks(block, false))
        return false;

    SetIfPresent(block, "CLK_CORRECT_USE", BoolText(m_clkCorrectUse != 0));
    SetIfPresent(block, "CLK_COR_KEEP_IDLE", BoolText(m_keepIdle != 0));
    SetIfPresent(block, "CLK_COR_INSERT_IDLE_FLAG", BoolText(m_insertIdleFlag != 0));
    // Clock correction needs the receive buffer.
    if (Qvz_Attribute* buffer = block->GetNamedAttribute("RX_BUFFER_USE"))
        if (buffer->GetValue().Compare("FALSE", Port::CompareExact) == 0)
            buffer->SetValue("TRUE");
    SetIfPresent(block, "CLK_COR_SEQ_LEN", m_seqLength);
    SetIfPresent(block, "CLK_COR_SEQ_2_USE", BoolText(m_seq2Use == 1));
    for (int i = 0; i < 4; ++i)
        SetBinaryValue(block->GetNamedAttribute(kSeq1Names[i]), m_seq1[i], m_isGT11);
    for (int i = 0; i < 4; ++i)
        SetBinaryValue(block->GetNamedAttribute(kSeq2Names[i]), m_seq2[i], m_isGT11);
    SetBinaryValue(block->GetNamedAttribute("CLK_COR_SEQ_1_MASK"), m_seq1Mask, m_isGT11);
    SetBinaryValue(block->GetNamedAttribute("CLK_COR_SEQ_2_MASK"), m_seq2Mask, m_isGT11);
    SetIfPresent(block, "CLK_COR_MIN_LAT", m_minLat);
    SetIfPresent(block, "CLK_COR_MAX_LAT", m_maxLat);
    SetIfPresent(block, "CLK_COR_SEQ_DROP", BoolText(m_seqDrop != 0));
    SetIfPresent(block, "CLK_COR_8B10B_DE", BoolText(m_8b10bDe != 0));
    return true;
}
