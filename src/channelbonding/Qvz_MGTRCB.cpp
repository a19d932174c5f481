#include "Qvz_MGTRCB.h"

#include "Qvz_MGTRCBGui.h"
#include "Qvz_WizMain.h"

#include <QComboBox>
#include <QSpinBox>

#include <algorithm>
#include <new>

using Port::StringBase;

namespace {

// The eight sequence characters, in the order of m_seq.
const char* const kSeqAttrs[Qvz_MGTRCB::kSeqCount] = {
    "CHAN_BOND_SEQ_1_1", "CHAN_BOND_SEQ_1_2", "CHAN_BOND_SEQ_1_3", "CHAN_BOND_SEQ_1_4",
    "CHAN_BOND_SEQ_2_1", "CHAN_BOND_SEQ_2_2", "CHAN_BOND_SEQ_2_3", "CHAN_BOND_SEQ_2_4"};
// Indexes of CHAN_BOND_SEQ_1_2 and CHAN_BOND_SEQ_2_2, which carry the LANE_ID
// on Infiniband primitives of the older families.
constexpr int kSeq12 = 1;
constexpr int kSeq22 = 5;

bool Has(const StringBase& s, const char* text) {
    return s.GetIndexOfString(text, Port::CompareSearch) != StringBase::npos;
}

bool Is(const StringBase& s, const char* text) {
    return s.Compare(text, Port::CompareExact) == 0;
}

StringBase Numbered(const StringBase& base, const char* infix, int i) {
    StringBase s = base;
    s += infix;
    s += UT_STR::IToA(i);
    return s;
}

} // namespace

Qvz_MGTRCB::Qvz_MGTRCB(Qvz_WizMain* main) : Qvz_MGTWizPage(main) {}

Qvz_MGTRCB::~Qvz_MGTRCB() = default;

bool Qvz_MGTRCB::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    auto* gui = new (std::nothrow) Qvz_MGTRCBGui(this, parent);
    m_pGui = gui;
    SetView(gui);
    return FinishGuiCreation(gui != nullptr);
}

bool Qvz_MGTRCB::DoBatchPage() {
    switch (Read()) {
    case ReadResult::Read:
        return WriteWizData(true);
    case ReadResult::NoBonding:
        // The device cannot bond: there is nothing to check or write.
        return true;
    case ReadResult::NoData:
    case ReadResult::NoBlock:
        break;
    }
    return false;
}

int Qvz_MGTRCB::FamilyMaximum(const Qvz_Block* block) const {
    if (!block || !m_pWizMain)
        return 0;
    int max = 0;
    if (block->SupportsMGT3())
        max = m_pWizMain->m_maxBondGT;
    else if (block->SupportsMGT10())
        max = m_pWizMain->m_maxBondGT10;
    else if (block->SupportsMGT11())
        // GT11s come in dual pairs.
        max = m_pWizMain->m_maxBondGT11 - m_pWizMain->m_maxBondGT11 % 2;
    return std::max(max, 0);
}

void Qvz_MGTRCB::SetFamily(const Qvz_Block* block) {
    m_isGT = block->SupportsMGT3();
    m_isGT10 = block->SupportsMGT10();
    m_isGT11 = block->SupportsMGT11();
}

Qvz_MGTRCBPlacement Qvz_MGTRCB::Placement() const {
    const Qvz_Family family = m_isGT11   ? Qvz_Family::GT11
                              : m_isGT10 ? Qvz_Family::GT10
                                         : Qvz_Family::GT;
    return Qvz_MGTRCBPlacement(family, m_MaxCBondNum, m_primaryRowBottom);
}

StringBase Qvz_MGTRCB::GetLaneId(int index) const {
    if (index < 0 || index >= m_laneIds.GetSize())
        return kNoLaneId;
    return m_laneIds.GetAt(index);
}

StringBase Qvz_MGTRCB::ReadBinary(Qvz_Attribute* attr, bool resetIfLocked) const {
    if (resetIfLocked && !attr->IsEditable())
        attr->SetValue(attr->GetDefaultValue());
    return GetBinaryValue(attr);
}

void Qvz_MGTRCB::WriteBinary(Qvz_Block* block, const char* name, const StringBase& digits) const {
    SetBinaryValue(block->GetNamedAttribute(name), digits, m_isGT11);
}

void Qvz_MGTRCB::ReadRange(Qvz_Block* block, const char* name, int lowStart, int highStart,
                           bool resetOutOfRange, int& value, StringBase& text, int& low, int& high,
                           QSpinBox* spin) {
    Qvz_Attribute* a = block->GetNamedAttribute(name);
    if (!a)
        return;
    int lo = lowStart;
    int hi = highStart;
    for (const StringBase& entry : a->GetLegalValues().Items()) {
        if (Qvz_Attribute::IsValueRange(entry))
            Qvz_Attribute::GetRangeValues(entry, lo, hi);
        else
            lo = hi = UT_STR::AToI(entry);
    }
    value = UT_STR::AToI(a->GetValue());
    if (resetOutOfRange && (value < lo || value > hi)) {
        a->SetValue(a->GetDefaultValue());
        value = UT_STR::AToI(a->GetValue());
    }
    if (spin) {
        spin->setRange(lo, hi);
        spin->setValue(value);
    }
    text = UT_STR::IToA(value);
    low = lo;
    high = hi;
}

void Qvz_MGTRCB::LoadLaneIds(Qvz_Block* block) {
    const StringBase& name = block->GetName();
    const Qvz_Attribute* own = block->GetNamedAttribute("LANE_ID");
    m_laneIds.RemoveAll();
    m_laneIds.Add(own ? own->GetValue() : StringBase(kNoLaneId));
    // One entry per bondable transceiver, so that every position has one.
    for (int k = 2; k <= m_MaxCBondNum; ++k) {
        const Qvz_Block* slave = m_pWizData->GetNamedBlock(Numbered(name, "", k));
        const Qvz_Attribute* id = slave ? slave->GetNamedAttribute("LANE_ID") : nullptr;
        m_laneIds.Add(id ? id->GetValue() : StringBase(kNoLaneId));
    }
    m_laneIdBlockName = name;
    m_laneIdsLoaded = true;
}

bool Qvz_MGTRCB::ReadWizData() {
    return Read() == ReadResult::Read;
}

Qvz_MGTRCB::ReadResult Qvz_MGTRCB::Read() {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return ReadResult::NoData;
    }
    m_isBatch = m_pWizMain ? m_pWizMain->m_batchMode : true;
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return ReadResult::NoBlock;
    SetFamily(block);
    m_MaxCBondNum = FamilyMaximum(block);
    if (m_MaxCBondNum == 0)
        return ReadResult::NoBonding;

    m_displayName = block->GetAttributeValue("MGT_DISPLAY_NAME");
    const bool gui = GuiMode();
    QComboBox* seqLenCombo = gui ? m_pView->SeqLenComboBox() : nullptr;
    Qvz_Attribute* seqLen = block->GetNamedAttribute("CHAN_BOND_SEQ_LEN");
    Qvz_MGTPageGui::FillComboBox(seqLenCombo, seqLen);

    m_allowRepeat = Is(block->GetAttributeValue("CHAN_BOND_ONE_SHOT"), "TRUE") ? 0 : 1;
    if (Qvz_Attribute* use2 = block->GetNamedAttribute("CHAN_BOND_SEQ_2_USE")) {
        if (!use2->IsEditable())
            use2->SetValue(use2->GetDefaultValue());
        m_seq2Use = Is(use2->GetValue(), "TRUE") ? 1 : 0;
    }

    const bool rxUsed = !Is(block->GetAttributeValue("QVZ_BOOL_RX_USE"), "FALSE");
    QSpinBox* numberSpin = gui ? m_pView->CBondNumSpinBox() : nullptr;
    if (Has(m_displayName, "XAUI")) {
        // XAUI always bonds its four lanes.
        m_cbondNum = 4;
        m_cbondNumText = "4";
        if (numberSpin) {
            numberSpin->setRange(4, 4);
            numberSpin->setValue(4);
        }
    } else if (const Qvz_Attribute* number = block->GetNamedAttribute("QVZ_CHAN_BOND_NUMBER")) {
        m_cbondNum = rxUsed ? UT_STR::AToI(number->GetValue()) : 0;
        if (numberSpin) {
            numberSpin->setRange(m_MinCBondNum, m_MaxCBondNum);
            numberSpin->setValue(m_cbondNum);
        }
        m_cbondNumText = UT_STR::IToA(m_cbondNum);
    }
    ReadRange(block, "CHAN_BOND_LIMIT", 0, 31, true, m_limit, m_limitText, m_limitMin, m_limitMax,
              gui ? m_pView->LimitSpinBox() : nullptr);
    ReadRange(block, "CHAN_BOND_OFFSET", 0, 15, false, m_offset, m_offsetText, m_offsetMin,
              m_offsetMax, gui ? m_pView->OffsetSpinBox() : nullptr);
    ReadRange(block, "CHAN_BOND_WAIT", 1, 15, false, m_wait, m_waitText, m_waitMin, m_waitMax,
              gui ? m_pView->WaitSpinBox() : nullptr);

    if (seqLen) {
        StringBase value = seqLen->GetValue();
        if (seqLenCombo) {
            if (GetComboBoxIndex(seqLenCombo, value) == -1) {
                value = seqLen->GetDefaultValue();
                seqLen->SetValue(value);
            }
            SetComboBoxText(seqLenCombo, value);
            m_seqLen = value;
        } else {
            m_seqLen = seqLen->GetLegalValues().Contains(value) ? value : seqLen->GetDefaultValue();
        }
    }

    if (Qvz_Attribute* mask = block->GetNamedAttribute("CHAN_BOND_SEQ_1_MASK"))
        m_seq1Mask = ReadBinary(mask, false);
    if (Qvz_Attribute* mask = block->GetNamedAttribute("CHAN_BOND_SEQ_2_MASK"))
        m_seq2Mask = ReadBinary(mask, false);

    const bool infiniband = Has(m_displayName, "Infiniband");
    for (int s = 0; s < kSeqCount; ++s) {
        if (infiniband && !m_isGT11 && (s == kSeq12 || s == kSeq22)) {
            // These two sequence characters carry the lane's own LANE_ID.
            if (const Qvz_Attribute* id = block->GetNamedAttribute("LANE_ID"))
                m_seq[s] = id->GetValue();
        } else if (Qvz_Attribute* a = block->GetNamedAttribute(kSeqAttrs[s])) {
            m_seq[s] = ReadBinary(a, true);
        }
    }

    if (const Qvz_Attribute* row = block->GetNamedAttribute("QVZ_CHAN_BOND_PRIMARY_ROW"))
        m_primaryRowBottom = row->GetValue().Compare("1", Port::CompareSearch) == 0 ? 0 : 1;

    if (!m_isGT11 && infiniband &&
        (!m_laneIdsLoaded || block->GetName().Compare(m_laneIdBlockName, Port::CompareExact) != 0))
        LoadLaneIds(block);

    CheckSeqMasks(block, true);

    if (gui)
        m_pView->DataToWidgets();
    return ReadResult::Read;
}

bool Qvz_MGTRCB::WriteWizData(bool full) {
    if (!m_pWizData) {
        IssueMessage(kDataError, false, false, false);
        return false;
    }
    Qvz_Block* block = m_pWizData->GetActiveBlock();
    if (!block)
        return false;
    // On a device that cannot bond, the page's values were never read from
    // the block; writing them would overwrite its settings with page defaults.
    if (FamilyMaximum(block) == 0)
        return true;

    int n = UT_STR::AToI(m_cbondNumText);
    if (n < m_MinCBondNum || n == 1 || n > m_MaxCBondNum) {
        StringBase text;
        text.Format("The allowable range for the number of channel bonded transceivers is between "
                    "0 and %d, excluding 1.",
                    m_MaxCBondNum);
        IssueMessage(text, false, false, false);
        return false;
    }
    if (m_isGT11 && n % 2 != 0) {
        if (!m_isBatch) {
            IssueMessage("Because dual GT11s will be generated, the number of channel bonded "
                         "transceivers must be an even number.",
                         false, false, false);
            return false;
        }
        const int old = n;
        n -= 1;
        StringBase text;
        text.Format("Because dual GT11s will be generated, the number of channel bonded "
                    "transceivers must be an even number.  The current number of %d has been "
                    "changed to be %d.",
                    old, n);
        IssueMessage(text, false, false, false);
        m_cbondNumText = UT_STR::IToA(n);
    }
    m_cbondNum = n;

    const struct {
        int value, low, high;
        const char* text;
    } ranges[] = {
        {m_limit, m_limitMin, m_limitMax,
         "The allowable range for the maximum number of bytes a slave receiver can read is "
         "between %d and %d."},
        {m_wait, m_waitMin, m_waitMax,
         "The allowable range for the minimum number of RXUSRCLK cycles is between %d and %d."},
        {m_offset, m_offsetMin, m_offsetMax,
         "The allowable range for the offset from channel bonding sequence is between %d and "
         "%d."},
    };
    for (const auto& r : ranges) {
        if (r.value < r.low || r.value > r.high) {
            StringBase text;
            text.Format(r.text, r.low, r.high);
            IssueMessage(text, false, false, false);
            return false;
        }
    }
    if (!CheckSeqMasks(block, false))
        return false;

    auto set = [block](const char* name, const StringBase& value) {
        SetIfPresent(block, name, value);
    };
    set("QVZ_CHAN_BOND_PRIMARY_ROW", m_primaryRowBottom == 0 ? "1" : "0");
    set("CHAN_BOND_ONE_SHOT", m_allowRepeat != 0 ? "FALSE" : "TRUE");
    set("QVZ_CHAN_BOND_NUMBER", m_cbondNumText);
    set("CHAN_BOND_LIMIT", m_limitText);
    set("CHAN_BOND_WAIT", m_waitText);
    set("CHAN_BOND_OFFSET", m_offsetText);
    QComboBox* seqLenCombo = GuiMode() ? m_pView->SeqLenComboBox() : nullptr;
    // A list without items (no legal lengths) has no choice to write; the
    // length read stays.
    StringBase seqLen = m_seqLen;
    Qvz_MGTPageGui::ReadComboBox(seqLenCombo, seqLen);
    set("CHAN_BOND_SEQ_LEN", seqLen);
    WriteBinary(block, "CHAN_BOND_SEQ_1_MASK", m_seq1Mask);
    WriteBinary(block, "CHAN_BOND_SEQ_2_MASK", m_seq2Mask);
    set("CHAN_BOND_SEQ_2_USE", m_seq2Use != 0 ? "TRUE" : "FALSE");
    for (int s = 0; s < kSeqCount; ++s)
        WriteBinary(block, kSeqAttrs[s], m_seq[s]);
    if (!full)
        return true;

    if (!m_isGT11 && Has(m_displayName, "Infiniband")) {
        const StringBase laneId = GetLaneId(0);
        block->SetAttributeValue("LANE_ID", laneId);
        block->SetAttributeValue(kSeqAttrs[kSeq12], laneId);
        block->SetAttributeValue(kSeqAttrs[kSeq22], laneId);
    }
    if (n == 0) {
        block->SetAttributeValue("CHAN_BOND_MODE", m_isGT11 ? "NONE" : "OFF");
        return true;
    }
    block->SetAttributeValue("CHAN_BOND_MODE", "MASTER");
    block->SetAttributeValue("LOC", MakeLocString(GetLocX(0), GetLocY(0)));
    return true;
}

bool Qvz_MGTRCB::CheckSeqMasks(Qvz_Block* block, bool onRead) {
    const bool gt10 = block ? block->SupportsMGT10() : m_isGT10;
    const bool gt11 = block ? block->SupportsMGT11() : m_isGT11;
    if (!gt10 && !gt11)
        return true;

    StringBase defMask1 = "1111";
    StringBase defMask2 = "1111";
    StringBase defLen = "4";
    const bool bad1 = !ValidateSeqMask(m_seq1Mask, m_seqLen);
    const bool bad2 = !ValidateSeqMask(m_seq2Mask, m_seqLen);
    if (!bad1 && !bad2)
        return true;
    const char* noun = UT_STR::AToI(m_seqLen) == 1 ? "zero" : "zeros";
    StringBase text;

    if (!onRead) {
        if (bad1 && bad2)
            text.Format("The masks for channel bonding sequences 1 and 2 "
                        "(CHAN_BOND_SEQ_1_MASK(=%s) and CHAN_BOND_SEQ_2_MASK(=%s)) are not valid.  "
                        "They each can have only %s %s (the length of the channel bonding sequence "
                        "(CHAN_BOND_SEQ_LEN)).  Please change the mask values to be valid.",
                        m_seq1Mask.c_str(), m_seq2Mask.c_str(), m_seqLen.c_str(), noun);
        else
            text.Format(
                "The mask for channel bonding sequence %d (CHAN_BOND_SEQ_%d_MASK=%s) is not "
                "valid.  It can have only %s %s (the length of the channel bonding "
                "sequence).  Please change the value to be valid.",
                bad1 ? 1 : 2, bad1 ? 1 : 2, (bad1 ? m_seq1Mask : m_seq2Mask).c_str(),
                m_seqLen.c_str(), noun);
        IssueMessage(text, true, false, false);
        return false;
    }

    if (block) {
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CHAN_BOND_SEQ_1_MASK"))
            defMask1 = StripSizedLiteral(a->GetDefaultValue(), 0);
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CHAN_BOND_SEQ_2_MASK"))
            defMask2 = StripSizedLiteral(a->GetDefaultValue(), 0);
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CHAN_BOND_SEQ_LEN"))
            defLen = a->GetDefaultValue();
    }
    StringBase both;
    both.Format("  The wizard will use the default length %s and defaults for both "
                "CHAN_BOND_SEQ_1_MASK (%s) and CHAN_BOND_SEQ_2_MASK (%s) instead of the current "
                "values.",
                defLen.c_str(), defMask1.c_str(), defMask2.c_str());

    if (bad1 && bad2) {
        StringBase suffix;
        if (defLen.Compare(m_seqLen, Port::CompareExact) != 0)
            suffix.Format(", using default length %s", defLen.c_str());
        text.Format("The masks for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=%s) and "
                    "sequence 2 (CHAN_BOND_SEQ_2_MASK=%s) are not valid.  They each can have only "
                    "%s %s (the length of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  The "
                    "wizard will use the defaults (%s and %s, respectively%s) instead of the "
                    "current values.",
                    m_seq1Mask.c_str(), m_seq2Mask.c_str(), m_seqLen.c_str(), noun,
                    defMask1.c_str(), defMask2.c_str(), suffix.c_str());
        m_seq1Mask = defMask1;
        m_seq2Mask = defMask2;
        m_seqLen = defLen;
    } else if (bad1) {
        text.Format("The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=%s) is not "
                    "valid.  It can have only %s %s (the length of the channel bonding sequence "
                    "(CHAN_BOND_SEQ_LEN)).",
                    m_seq1Mask.c_str(), m_seqLen.c_str(), noun);
        m_seq1Mask = defMask1;
        m_seqLen = defLen;
        if (!ValidateSeqMask(m_seq2Mask, defLen)) {
            m_seq2Mask = defMask2;
            text += both;
        } else {
            StringBase rest;
            rest.Format("  The wizard will use the default length %s and the CHAN_BOND_SEQ_1_MASK "
                        "default %s instead of the current values.",
                        defLen.c_str(), defMask1.c_str());
            text += rest;
        }
    } else {
        text.Format("The mask for channel bonding sequence 2 (CHAN_BOND_SEQ_2_MASK=%s) is not "
                    "valid.  It can have only %s %s (the length of the channel bonding sequence "
                    "(CHAN_BOND_SEQ_LEN)).",
                    m_seq2Mask.c_str(), m_seqLen.c_str(), noun);
        m_seq2Mask = defMask2;
        m_seqLen = defLen;
        if (!ValidateSeqMask(m_seq1Mask, defLen)) {
            m_seq1Mask = defMask1;
            text += both;
        }
    }
    IssueMessage(text, false, false, false);
    return true;
}

// ---------------------------------------------------------------------------
// Bonded copies

void Qvz_MGTRCB::GenerateBondedInstances(Qvz_Block* block, bool dual, int n) {
    if (!block || !m_pWizData)
        return;
    // Finishing again without going back first: start from the design data
    // as it was before the last generation, so no copy is made twice.
    WithdrawCopies();
    SetFamily(block);

    GenContext g;
    if (block->GetNamedAttribute("TXABPMACLKSEL")) {
        for (const char* clockSel : {"TXABPMACLKSEL", "RXPMACLKSEL"}) {
            const StringBase v = block->GetAttributeValue(clockSel);
            g.refclk1 = g.refclk1 || Is(v, "REFCLK1");
            g.refclk2 = g.refclk2 || Is(v, "REFCLK2");
            g.grefclk = g.grefclk || Is(v, "GREFCLK");
        }
    }
    if (m_isGT)
        g.brefclk = Is(block->GetAttributeValue("REF_CLK_V_SEL"), "1");
    else if (m_isGT10)
        g.brefclk = Is(block->GetAttributeValue("QVZX_ONLY_USE_BREFCLK"), "TRUE");
    g.brefclkDynamic = !Is(block->GetAttributeValue("QVZX_ONLY_BREFCLK_DYN"), "STATIC");
    g.brefclk2 = Is(block->GetAttributeValue("QVZX_ONLY_BREFCLK"), "BREFCLK2");
    g.masterChain =
        m_pWizData->GetNamedSignal("CHANBOND_M_S1") ? "CHANBOND_M_S1" : "CHANBOND_M_S1_OUT";
    g.chainBase =
        m_pWizData->GetNamedSignal("CHANBOND_S1_S2") ? "CHANBOND_S1_S2" : "CHANBOND_S1_S2_OUT";

    // The number comes from a stored attribute: never place or copy more
    // transceivers than the device can bond.
    const Qvz_MGTRCBPlacement place = Placement();
    int maxBond = place.MaxBond();
    if (m_isGT11)
        maxBond -= maxBond % 2;
    n = std::clamp(n, 0, maxBond);
    g.n = n;

    int count = n;
    bool useB = false;
    if (m_isGT11) {
        useB = !Is(block->GetAttributeValue("QVZ_GT11_USE_B"), "FALSE");
        if (n >= 3) {
            block->SetAttributeValue("QVZ_GT11_MODE", "DUAL");
            dual = true;
        } else {
            // The other GT11 of the pair always gets an instance.
            count = 2;
        }
        block->SetAttributeValue("GT11_MODE", useB ? "B" : "A");
    }
    g.dual = dual;

    const StringBase base = block->GetName();
    const std::size_t inst = base.GetIndexOfString("INST", Port::CompareSearch);
    if (count > 1 && inst != StringBase::npos && inst + 4 == base.GetLength()) {
        const StringBase renamed = Numbered(base, "", 1);
        // Two blocks of one name would make the design data unreadable.
        if (!m_pWizData->GetNamedBlock(renamed)) {
            block->SetName(renamed);
            m_renamedFrom = base;
            m_renamedTo = renamed;
        }
    }

    Qvz_Block* prev = block;
    for (int i = 2; i <= count; ++i) {
        Qvz_Block* copy = m_pWizData->CopyBlock(block, Numbered(base, "", i));
        if (!copy)
            break;
        copy->SetIsUsed(true);
        m_generatedCopies.push_back(copy->GetName());
        if (m_isGT11) {
            const char* mode = "DONT_CARE";
            if (dual)
                mode = (i % 2 == 0) == useB ? "A" : "B";
            copy->SetAttributeValue("GT11_MODE", mode);
        }
        g.far = i > place.RowLength();
        g.role = place.BondMode(i);
        if (n >= 2) {
            copy->SetAttributeValue("LOC", place.LocString(place.LocX(i), place.LocY(i)));
            copy->SetAttributeValue("CHAN_BOND_MODE", g.role);
            copy->SetAttributeValue("CHAN_BOND_ONE_SHOT", "FALSE");
            if (Has(m_displayName, "Infiniband") && !m_isGT11) {
                const StringBase laneId = GetLaneId(i - 1);
                copy->SetAttributeValue("LANE_ID", laneId);
                copy->SetAttributeValue(kSeqAttrs[kSeq12], laneId);
                copy->SetAttributeValue(kSeqAttrs[kSeq22], laneId);
            }
        }
        m_gen = g;
        for (const auto& pin : copy->GetPins())
            WireCopyPin(block, prev, pin.get(), i);
        prev = copy;
    }
}

void Qvz_MGTRCB::WireCopyPin(Qvz_Block* master, Qvz_Block* prev, Qvz_Pin* pin, int i) {
    const GenContext& g = m_gen;
    const StringBase& name = pin->GetName();

    if (m_isGT11 && !g.dual && !Is(name, "COMBUSIN") && !Is(name, "COMBUSOUT")) {
        // The unused GT11 of a single pair: only its tile bus stays wired.
        pin->RemoveAllPinSigBitProps();
        pin->RemoveAttribute("QVZ_PIN_TIE");
        pin->RemoveAttribute("QVZ_PIN_GND_IN_DATAFILE");
        pin->RemoveAttribute("QVZ_PIN_VCC_IN_DATAFILE");
        const bool input = Is(pin->GetDirection(), "IN");
        // A grounded input must not stay on the master's net as well.
        pin->ClearAllConnections();
        if (input)
            pin->SetIsGrounded(true);
        return;
    }

    auto secondary = [&](bool applies, const char* signal) {
        if (!applies)
            return;
        pin->SetSigName(signal);
        m_pWizData->AddSignal(signal, true, "I");
    };
    auto chainSignal = [&](const StringBase& signal) {
        Qvz_Signal* s = m_pWizData->AddSignal(signal, true, "O");
        s->SetIsBus(true, pin->GetWidth());
        pin->SetSigName(signal);
    };
    auto combus = [&](const char* prevPin, const StringBase& signal) {
        if (Qvz_Pin* other = prev->GetNamedPin(prevPin))
            other->SetSigName(signal);
        pin->SetSigName(signal);
        m_pWizData->AddSignal(signal, false, "")->SetIsBus(true, 16);
    };

    // Reference clocks: far-row copies use the secondary clocks, the others
    // stay on the master's clock nets.
    if (Is(name, "REFCLK"))
        return;
    if (Is(name, "REFCLK2"))
        return secondary(m_isGT11 && g.refclk2 && g.far, "REFCLK2_SECONDARY");
    if (Is(name, "REFCLK1"))
        return secondary(g.refclk1 && g.far, "REFCLK1_SECONDARY");
    if (Is(name, "GREFCLK"))
        return secondary(g.grefclk && g.far, "GREFCLK_SECONDARY");
    if (Is(name, "BREFCLK"))
        return secondary(g.brefclk && g.far && !(!g.brefclkDynamic && g.brefclk2),
                         "BREFCLK_SECONDARY");
    if (Is(name, "BREFCLK2"))
        return secondary(g.brefclk && g.far && !(!g.brefclkDynamic && !g.brefclk2),
                         "BREFCLK2_SECONDARY");
    if (Is(name, "BREFCLKPIN"))
        return secondary(g.brefclk && g.far, "BREFCLKPIN_SECONDARY");
    if (Is(name, "BREFCLKNIN"))
        return secondary(g.brefclk && g.far, "BREFCLKNIN_SECONDARY");

    if (Is(name, "CHBONDI")) {
        if (g.n < 2)
            return;
        pin->SetIsGrounded(false);
        if (Is(g.role, "SLAVE_1_HOP"))
            pin->SetSigName(g.masterChain);
        else if (Is(g.role, "SLAVE_2_HOPS"))
            chainSignal(Numbered(g.chainBase, "_BLK", Placement().Feeder(i)));
        return;
    }
    if (Is(name, "CHBONDO")) {
        if (g.n < 2)
            return;
        if (Is(g.role, "SLAVE_1_HOP"))
            chainSignal(Numbered(g.chainBase, "_BLK", i));
        else if (Is(g.role, "SLAVE_2_HOPS"))
            chainSignal(Numbered("CHBONDO", "_BLK", i));
        else
            chainSignal(g.chainBase);
        return;
    }
    // The two GT11s of a tile share their bus; odd copies are wired by the
    // even copy that completes their pair.
    if (Is(name, "COMBUSIN")) {
        if (i % 2 == 0)
            combus("COMBUSOUT",
                   i == 2 ? StringBase("COMBUSOUT") : Numbered("COMBUSOUT", "_BLK", i - 1));
        return;
    }
    if (Is(name, "COMBUSOUT")) {
        if (i % 2 == 0)
            combus("COMBUSIN", Numbered("COMBUSOUT", "_BLK", i));
        return;
    }

    // Every other connected pin gets a port of its own. A bit-mapped pin
    // counts as connected even without a whole-pin signal.
    const bool bitMapped = pin->HasPinSigBitProp();
    if (pin->IsGrounded() || pin->IsVcc() || (!bitMapped && pin->GetSigName().IsEmpty()))
        return;

    if (bitMapped) {
        // Re-map each bit range onto this copy's own signals, so that the
        // lanes do not share the master's bus.
        std::vector<StringBase> copied;
        for (Qvz_NameValue& map : pin->AttributeList().Items()) {
            if (!Qvz_Pin::IsBitMapName(map.name))
                continue;
            const std::size_t bracket = map.value.GetIndexOfString("[", Port::CompareSearch);
            const StringBase sig =
                bracket == StringBase::npos ? map.value : map.value.Left(bracket);
            const StringBase range =
                bracket == StringBase::npos ? StringBase() : map.value.Mid(bracket);
            const Qvz_Signal* source = m_pWizData->GetNamedSignal(sig);
            if (!source)
                continue;
            if (source->IsConst0() || source->IsConst1()) {
                pin->SetSigName(sig);
                continue;
            }
            const StringBase own = Numbered(sig, "_BLK", i);
            map.value = own + range;
            if (std::find(copied.begin(), copied.end(), own) == copied.end()) {
                Qvz_Signal twin(*source);
                twin.SetName(own);
                twin.SetIsUsed(true);
                // A copy left from an earlier finish follows the master's signal again.
                if (Qvz_Signal* existing = m_pWizData->GetNamedSignal(own))
                    *existing = twin;
                else
                    m_pWizData->AddSignal(twin);
                copied.push_back(own);
            }
            pin->SetSigName(own);
        }
        return;
    }

    const StringBase& dir = pin->GetDirection();
    const char* code = Is(dir, "IN") ? "I" : Is(dir, "OUT") ? "O" : "B";
    const Qvz_Pin* masterPin = master->GetNamedPin(name);
    const StringBase reference = masterPin ? masterPin->GetSigName() : name;
    const Qvz_Signal* refSignal = m_pWizData->GetNamedSignal(reference);
    const int width = refSignal ? refSignal->GetWidth() : 1;
    StringBase newName = name;
    if (Has(reference, "_IN"))
        newName += "_IN";
    else if (Has(reference, "_OUT"))
        newName += "_OUT";
    newName = Numbered(newName, "_BLK", i);

    Qvz_Signal* s = m_pWizData->AddSignal(newName, true, code);
    pin->SetSigName(newName);
    s->SetWidth(width);
    if (pin->SupportsDataWidth()) {
        if (width >= pin->GetWidth())
            s->RemoveAttribute("BUS_ONLY_USE_BITS");
        else
            s->SetAttributeValue("BUS_ONLY_USE_BITS", UT_STR::IToA(width));
    }
    if (pin->GetWidth() >= 2 || (pin->SupportsDataWidth() && width == 1))
        s->SetIsBus(true, width);
    else
        s->SetIsBus(false, 1);
}

void Qvz_MGTRCB::WithdrawCopies() {
    if (m_pWizData) {
        for (const StringBase& name : m_generatedCopies)
            if (Qvz_Block* copy = m_pWizData->GetNamedBlock(name))
                copy->SetIsUsed(false);
        if (!m_renamedTo.IsEmpty() && !m_pWizData->GetNamedBlock(m_renamedFrom))
            if (Qvz_Block* master = m_pWizData->GetNamedBlock(m_renamedTo))
                master->SetName(m_renamedFrom);
    }
    m_generatedCopies.clear();
    m_renamedFrom = StringBase();
    m_renamedTo = StringBase();
}

void Qvz_MGTRCB::RemoveBondedInstances() {
    if (!m_pWizData)
        return;
    static const char* const kChainSignals[] = {"CHANBOND_S1_S2", "CHANBOND_S1_S2_OUT",
                                                "CHANBOND_M_S1",  "CHANBOND_M_S1_OUT",
                                                "CHBONDDONE_OUT", "ENCHANSYNC_IN"};
    for (const auto& s : m_pWizData->GetSignals()) {
        const StringBase& name = s->GetName();
        const bool chain = std::any_of(std::begin(kChainSignals), std::end(kChainSignals),
                                       [&](const char* c) { return Is(name, c); });
        if (chain || Has(name, "_BLK"))
            s->SetIsUsed(false);
    }
    WithdrawCopies();
}
