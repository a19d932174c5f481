#include "Qvz_MGTGeneralSetup.h"

#include "Qvz_MGTGeneralSetupGui.h"
#include "Qvz_MGTWizMain.h"
#include "Wg_Wizard.h"

#include <new>

using Port::CompareExact;
using Port::CompareSearch;

namespace {

const char* const kInternalDataError = "Tessel Wizard internal data error";

bool Equals(const Port::StringBase& s, const char* text) {
    return s.Compare(text, CompareExact) == 0;
}

bool BeginsWith(const Port::StringBase& s, const char* text) {
    return s.GetIndexOfString(text, CompareSearch) == 0;
}

bool Contains(const Port::StringBase& s, const char* text) {
    return s.GetIndexOfString(text, CompareSearch) != Port::StringBase::npos;
}

bool Editable(Qvz_Block* block, const char* name) {
    const Qvz_Attribute* a = block->GetNamedAttribute(name);
    return a && a->IsEditable();
}

void DeleteAttributes(Qvz_Block* block, std::initializer_list<const char*> names) {
    for (const char* name : names)
        if (Qvz_Attribute* a = block->GetNamedAttribute(name))
            block->DeleteAttribute(a);
}

Port::StringBase DisplayNameOf(const Qvz_Block* block) {
    Port::StringBase name = block->GetAttributeValue("MGT_DISPLAY_NAME");
    if (name.IsEmpty())
        name = block->GetAttributeValue("QVZ_OLD_DISPLAY_NAME");
    return name;
}

// The attribute holding the PMA speeds allowed at width.
Qvz_Attribute* PmaSpeedAttribute(Qvz_Block* block, const Port::StringBase& width) {
    Port::StringBase name;
    name.Format("QVZ_PMA_SPEED_%s", width.c_str());
    if (Qvz_Attribute* a = block->GetNamedAttribute(name))
        return a;
    return block->GetNamedAttribute("PMA_SPEED");
}

enum PageIndex {
    kTransmitterPage = 1,
    kCommaDetectPage = 2,
    kReceiverPage = 3,
    kClockCorrectionPage = 4,
    kChannelBondingPage = 5
};

} // namespace

Qvz_MGTGeneralSetup::Qvz_MGTGeneralSetup(Qvz_WizMain* main)
    : Qvz_MGTWizPage(main), m_pcsPins{"CHBONDI",       "ENCHANSYNC",    "TXFORCECRCERR",
                                      "TXCHARISK",     "CHBONDDONE",    "CHBONDO",
                                      "RXCHARISCOMMA", "RXCHECKINGCRC", "RXCLKCORCNT",
                                      "RXCOMMADET",    "RXCRCERR",      "RXDISPERR",
                                      "RXLOSSOFSYNC",  "RXNOTINTABLE",  "RXREALIGN",
                                      "TXKERR",        "TXRUNDISP"},
      m_commaPins{"ENMCOMMAALIGN", "ENPCOMMAALIGN", "RXCHARISCOMMA", "RXCOMMADET",
                  "RXCRCERR",      "RXLOSSOFSYNC",  "RXREALIGN"},
      m_rxExtraPins{"ENCHANSYNC",    "CHBONDDONE",    "CHBONDO", "CHBONDI",
                    "ENMCOMMAALIGN", "ENPCOMMAALIGN", "LOOPBACK"},
      m_userClockPins{"RXUSRCLK", "RXUSRCLK2", "TXUSRCLK", "TXUSRCLK2"},
      m_tx64b66bPins{"TXENC64B66BUSE", "TXGEARBOX64B66BUSE", "TXSCRAM64B66BUSE"},
      m_rx64b66bPins{"RXDEC64B66BUSE", "RXBLOCKSYNC64B66BUSE", "RXDESCRAM64B66BUSE",
                     "RXIGNOREBTF"} {
    if (!m_pWizMain || !m_pWizData)
        return;
    m_isGT = m_pWizMain->m_supportsMGT3;
    m_isGT10 = m_pWizMain->m_supportsMGT10;
    m_isGT11 = m_pWizMain->m_supportsMGT11;
    m_displayName = "FibreChannel";
    m_dataWidth = "4";
    m_pBlock = nullptr;
    if (Qvz_Block* block = FindBlock())
        ReadWizData(block);
}

Qvz_MGTGeneralSetup::~Qvz_MGTGeneralSetup() = default;

Qvz_MGTWizMain* Qvz_MGTGeneralSetup::WizMain() const {
    return dynamic_cast<Qvz_MGTWizMain*>(m_pWizMain);
}

bool Qvz_MGTGeneralSetup::IsBatch() const {
    return m_pWizMain && m_pWizMain->m_batchMode;
}

bool Qvz_MGTGeneralSetup::DoBatchPage() {
    return WriteWizData();
}

bool Qvz_MGTGeneralSetup::CreateGuiDlg(QWidget* parent) {
    if (!parent)
        return false;
    auto* gui = new (std::nothrow) Qvz_MGTGeneralSetupGui(this, parent);
    m_pGui = gui;
    if (gui)
        gui->InitUIData();
    return FinishGuiCreation(gui != nullptr);
}

Qvz_Block* Qvz_MGTGeneralSetup::FindBlock() {
    Qvz_WizData* data = m_pWizData;
    if (!data)
        return nullptr;
    if (m_isGT10)
        m_displayName = "10G Custom";
    else if (m_isGT11)
        m_displayName = "Custom";

    if (Qvz_Block* block = data->GetActiveBlock()) {
        block->ClearAllPinSignals();
        if (Equals(block->GetPrimitiveName(), "GT10_ZEPHINE_8")) {
            block->SetIsUsed(false);
            Qvz_Block* replacement = data->GetPrimitiveBlock("GT10_ZEPHINE_4");
            if (!replacement) {
                IssueMessage(kInternalDataError, false, false, false);
                return nullptr;
            }
            replacement->SetIsUsed(true);
            IssueMessage("The primitive GT10_ZEPHINE_8 is obsolete.  The wizard will use "
                         "GT10_ZEPHINE_4 instead.",
                         false, false, false);
            block = replacement;
        }
        block = Rename3GIOBlock(data, block);
        FixBlockInstanceName(data, block);
        return block;
    }

    Qvz_MGTWizMain* main = WizMain();
    Qvz_Block* block = main ? main->GetBlock(data, m_displayName, m_dataWidth, false) : nullptr;
    if (!block)
        IssueMessage(kInternalDataError, false, false, false);
    return block;
}

Qvz_Block* Qvz_MGTGeneralSetup::Rename3GIOBlock(Qvz_WizData* data, Qvz_Block* block) {
    if (!data || !block)
        return block;
    if (!BeginsWith(block->GetName(), "GT10_3GIO") &&
        !BeginsWith(block->GetPrimitiveName(), "GT10_3GIO"))
        return block;

    Port::StringBase width;
    if (const Qvz_Attribute* a = block->GetNamedAttribute("RX_DATA_WIDTH"))
        width = a->GetValue();
    else if (const Qvz_Attribute* q = block->GetNamedAttribute("QVZ_RX_DATA_WIDTH"))
        width = q->GetValue();
    else
        return block;

    const Port::StringBase newPrim = Port::StringBase("GT10_PCI_EXPRESS_") + width;
    Qvz_Block* newBlock = data->GetNamedBlock(newPrim + "_INST");
    if (!newBlock || newBlock == block)
        return block;

    block->SetIsUsed(false);
    newBlock->SetIsUsed(true);
    Port::StringBase message;
    message.Format("The primitive %s has been changed to %s.  The wizard will use %s instead.",
                   block->GetPrimitiveName().c_str(), newPrim.c_str(), newPrim.c_str());
    IssueMessage(message, false, false, false);

    for (const auto& attr : block->GetAttributes()) {
        if (attr->GetName().Compare("MGT_DISPLAY_NAME", CompareSearch) == 0)
            continue;
        if (Qvz_Attribute* target = newBlock->GetNamedAttribute(attr->GetName()))
            target->SetValue(attr->GetValue());
    }
    return newBlock;
}

void Qvz_MGTGeneralSetup::FixBlockInstanceName(Qvz_WizData* /*data*/, Qvz_Block* block) {
    // An empty name has no first character to test.
    if (!block || block->GetName().IsEmpty())
        return;
    if (UT_STR::IsDigit(static_cast<unsigned char>(block->GetName().GetAt(0))))
        block->SetName(Port::StringBase("GT") + block->GetName());
}

void Qvz_MGTGeneralSetup::MigrateOldAttributes(Qvz_Block* block) {
    if (!block)
        return;
    const struct {
        const char* oldName;
        const char* newName;
        bool always;
    } renames[] = {
        {"BOOL_RX_USE", "QVZ_BOOL_RX_USE", true},
        {"BOOL_TX_USE", "QVZ_BOOL_TX_USE", true},
        {"CHAN_BOND_NUMBER", "QVZ_CHAN_BOND_NUMBER", true},
        {"CHAN_BOND_PRIMARY_ROW", "QVZ_CHAN_BOND_PRIMARY_ROW", true},
        {"RX_DATA_WIDTH", "QVZ_RX_DATA_WIDTH", false},
        {"TX_DATA_WIDTH", "QVZ_TX_DATA_WIDTH", false},
    };
    for (const auto& r : renames) {
        if (!r.always && m_isGT)
            continue;
        const Qvz_Attribute* old = block->GetNamedAttribute(r.oldName);
        if (!old)
            continue;
        const Port::StringBase value = old->GetValue();
        block->AddAttribute(r.newName, value);
        block->RemoveAttribute(r.oldName);
    }
}

void Qvz_MGTGeneralSetup::ReadWizData(Qvz_Block* block) {
    if (!block)
        return;
    MigrateOldAttributes(block);
    m_displayName = DisplayNameOf(block);
    m_dataWidth = block->GetAttributeValue(m_isGT ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH");
    m_serdes10b = Equals(block->GetAttributeValue("SERDES_10B"), "TRUE");
    m_serdes10bEditable = Editable(block, "SERDES_10B");
    m_termination = block->GetAttributeValue("TERMINATION_IMP");
    m_terminationEditable = Editable(block, "TERMINATION_IMP");
    if (m_isGT11) {
        m_gt11Single = Equals(block->GetAttributeValue("QVZ_GT11_MODE"), "SINGLE");
        m_gt11UseB = !Equals(block->GetAttributeValue("QVZ_GT11_USE_B"), "FALSE");
    }
    m_refClkVSel = block->GetAttributeValue("REF_CLK_V_SEL");
    m_refClkVSelEditable = Editable(block, "REF_CLK_V_SEL");
    m_bRefClkDyn = block->GetAttributeValue("QVZX_ONLY_BREFCLK_DYN");
    m_bRefClk = block->GetAttributeValue("QVZX_ONLY_BREFCLK");
    m_useRefClk = Equals(block->GetAttributeValue("QVZX_ONLY_USE_REFCLK"), "FALSE") ? 0 : 1;
    m_useBRefClk = Equals(block->GetAttributeValue("QVZX_ONLY_USE_BREFCLK"), "FALSE") ? 0 : 1;
    m_refClk = block->GetAttributeValue("QVZX_ONLY_REFCLK");
    m_refClkDyn = block->GetAttributeValue("QVZX_ONLY_REFCLK_DYN");
    m_bypassPcs = Equals(block->GetAttributeValue("QVZX_ONLY_BYPASS_PCS"), "TRUE");
    m_bypassPcsEditable = Editable(block, "QVZX_ONLY_BYPASS_PCS");
    m_txabPmaClkSel = block->GetAttributeValue("TXABPMACLKSEL");
    m_rxPmaClkSel = block->GetAttributeValue("RXPMACLKSEL");
    m_enablePma = !Equals(block->GetAttributeValue("QVZX_ONLY_ENABLE_PMA"), "FALSE");
    m_enablePmaEditable = Editable(block, "QVZX_ONLY_ENABLE_PMA");
    m_txUse = !Equals(block->GetAttributeValue("QVZ_BOOL_TX_USE"), "FALSE");
    m_rxUse = !Equals(block->GetAttributeValue("QVZ_BOOL_RX_USE"), "FALSE");
    m_pmaSpeed = block->GetAttributeValue("PMA_SPEED");
    CheckPmaSpeed(block, m_pmaSpeed, m_dataWidth);
    m_pmaSpeedEditable = Editable(block, "PMA_SPEED");
    m_pBlock = block;
}

void Qvz_MGTGeneralSetup::CheckPmaSpeed(Qvz_Block* block, Port::StringBase& pmaSpeed,
                                        Port::StringBase& width) {
    if (!block)
        return;
    const Qvz_Attribute* attr = PmaSpeedAttribute(block, width);
    if (!attr)
        return;
    if (!attr->GetLegalValues().Contains(pmaSpeed))
        pmaSpeed = attr->GetDefaultValue();
}

void Qvz_MGTGeneralSetup::GetMgtTypeChoices(Qvz_StrArray& out, Qvz_WizData* data) {
    out.RemoveAll();
    bool found = false;
    if (data) {
        for (const auto& block : data->GetBlocks()) {
            const Port::StringBase name = block->GetAttributeValue("MGT_DISPLAY_NAME");
            if (out.Contains(name))
                continue;
            const bool offered = (block->SupportsMGT3() && m_isGT) ||
                                 (block->SupportsMGT10() && m_isGT10) ||
                                 (block->SupportsMGT11() && m_isGT11);
            if (!offered || name.IsEmpty() || Equals(name, "Zephine_8") || Contains(name, "3GIO"))
                continue;
            out.Add(name);
            if (name == m_displayName)
                found = true;
        }
    }
    if (!found)
        out.Add(m_displayName);
}

Qvz_StrArray* Qvz_MGTGeneralSetup::GetDataWidthChoices(Qvz_Block* block) {
    if (!block)
        return nullptr;
    Qvz_Attribute* a = block->GetNamedAttribute(m_isGT ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH");
    return a ? &a->GetLegalValues() : nullptr;
}

Qvz_StrArray* Qvz_MGTGeneralSetup::GetPmaSpeedChoices(Qvz_Block* block, Port::StringBase width) {
    if (!block)
        return nullptr;
    Qvz_Attribute* a = PmaSpeedAttribute(block, width);
    return a ? &a->GetLegalValues() : nullptr;
}

bool Qvz_MGTGeneralSetup::WriteWizData() {
    if (!m_txUse && !m_rxUse) {
        IssueMessage("Please select transmitter mode and/or receiver mode.", false, false, false);
        return false;
    }
    Qvz_WizData* data = m_pWizData;
    if (!data)
        return true;
    data->SetAllBlksIsActive(false);
    data->SetAllSigsIsActive(false);

    Qvz_MGTWizMain* main = WizMain();
    Qvz_Block* block = main ? main->GetBlock(data, m_displayName, m_dataWidth, false) : nullptr;
    if (!block) {
        IssueMessage(kInternalDataError, false, false, false);
        return false;
    }
    block->SetIsUsed(true);

    SetIfPresent(block, "PMA_SPEED", m_pmaSpeed);
    SetIfPresent(block, "QVZX_ONLY_ENABLE_PMA", BoolText(m_enablePma));
    SetIfPresent(block, "TXABPMACLKSEL", m_txabPmaClkSel);
    SetIfPresent(block, "RXPMACLKSEL", m_rxPmaClkSel);

    // Named before the width is written: a GT name carries the width it had.
    const Port::StringBase primName = Qvz_MGTWizMain::GetBlkPrimName(block);
    if (primName.Compare(m_pWizMain->m_fileName, CompareExact) == 0)
        IssueMessage("The name of a Velomux transceiver primitive you selected is the same as "
                     "your file name.  This will cause an error during synthesis.  Please select "
                     "a different transceiver, or cancel out from the wizard and choose another "
                     "file name.",
                     false, false, false);

    if (m_isGT) {
        block->SetAttributeValue("RX_DATA_WIDTH", m_dataWidth);
        block->SetAttributeValue("TX_DATA_WIDTH", m_dataWidth);
    } else {
        block->SetAttributeValue("QVZ_RX_DATA_WIDTH", m_dataWidth);
        block->SetAttributeValue("QVZ_TX_DATA_WIDTH", m_dataWidth);
    }
    block->SetAttributeValue("QVZ_BOOL_TX_USE", BoolText(m_txUse));
    block->SetAttributeValue("QVZ_BOOL_RX_USE", BoolText(m_rxUse));
    SetIfPresent(block, "SERDES_10B", BoolText(m_serdes10b));
    ApplyPcsBypassResets(block);
    SetIfPresent(block, "TERMINATION_IMP", m_termination);

    if (m_isGT11) {
        if (m_gt11Single) {
            block->AddAttribute("QVZ_GT11_MODE", "SINGLE");
            block->AddAttribute("CHAN_BOND_MODE", "NONE");
        } else {
            block->AddAttribute("QVZ_GT11_MODE", "DUAL");
        }
        block->AddAttribute("QVZ_GT11_USE_B", BoolText(m_gt11UseB));
    }
    SetIfPresent(block, "REF_CLK_V_SEL", m_refClkVSel);
    if (m_isGT10) {
        block->AddAttribute("QVZX_ONLY_USE_REFCLK", BoolText(m_useRefClk != 0));
        block->AddAttribute("QVZX_ONLY_USE_BREFCLK", BoolText(m_useBRefClk != 0));
        block->AddAttribute("QVZX_ONLY_REFCLK_DYN", m_refClkDyn);
        block->AddAttribute("QVZX_ONLY_REFCLK", m_refClk);
    }
    if (m_isGT) {
        block->AddAttribute("QVZX_ONLY_REFCLK_DYN", m_refClkDyn);
        block->AddAttribute("QVZX_ONLY_BREFCLK_DYN", m_bRefClkDyn);
        block->AddAttribute("QVZX_ONLY_REFCLK", m_refClk);
        block->AddAttribute("QVZX_ONLY_BREFCLK", m_bRefClk);
    }

    SetPinWidths(block, primName);
    ResetZephineClockCorrection(block);
    PruneGT10Attributes(block);
    CleanUpGT11Attributes(block);
    EnableDependentPages(block, block->GetPrimitiveName());
    return true;
}

void Qvz_MGTGeneralSetup::SetPinWidths(Qvz_Block* block, const Port::StringBase& primName) {
    if (!block)
        return;
    if (Equals(primName, "GT_CUSTOM") || BeginsWith(primName, "GT10_") ||
        BeginsWith(primName, "GT11_"))
        return;
    // A width that is missing, not positive or too large for the 8-bit data
    // pins would give nonsense pins (or ones no design-data file can hold);
    // they keep the widths they have.
    const int n = UT_STR::AToI(m_dataWidth);
    if (n <= 0 || n > Qvz_MaxWidth / 8)
        return;
    for (const auto& pin : block->GetPins()) {
        if (!pin->SupportsDataWidth())
            continue;
        const bool dataPin = Equals(pin->GetName(), "TXDATA") || Equals(pin->GetName(), "RXDATA");
        pin->SetWidth(dataPin ? 8 * n : n);
    }
}

void Qvz_MGTGeneralSetup::EnablePages(bool enable, int first, int last) {
    Wg_Wizard* wizard = m_pWizMain ? m_pWizMain->m_pWizard : nullptr;
    if (!wizard)
        return;
    if (last == -1)
        last = first;
    for (int i = first; i <= last; ++i) {
        const char* title = Qvz_MGTWizMain::PageTitle(i);
        if (*title)
            wizard->enablePage(title, enable);
    }
}

void Qvz_MGTGeneralSetup::EnableDependentPages(Qvz_Block* block, const Port::StringBase& primType) {
    if (!block)
        return;
    // A batch run has no dialog; only the bonding switch-off is recorded.
    const bool batch = IsBatch();
    auto enable = [&](bool on, int first, int last) {
        if (!batch)
            EnablePages(on, first, last);
    };
    auto noBonding = [&] { block->SetAttributeValue("QVZ_CHAN_BOND_NUMBER", "0"); };

    const Port::StringBase display = DisplayNameOf(block);
    const bool bypass = block->GetNamedAttribute("QVZX_ONLY_BYPASS_PCS") && m_bypassPcs;

    enable(m_txUse, kTransmitterPage, -1);

    if (!m_rxUse) {
        enable(false, kCommaDetectPage, kChannelBondingPage);
        noBonding();
    } else {
        // Comma detect, receiver, clock correction, channel bonding.
        bool comma = true, clockCor = true, bonding = true;
        if (Equals(primType, "GT_FIBRE_CHAN") || Equals(primType, "GT_ETHERNET")) {
            comma = false;
            bonding = false;
        } else if (Equals(primType, "GT_CUSTOM")) {
            // Everything stays on.
        } else if (block->SupportsMGT10()) {
            if (Equals(display, "OC192") || Equals(display, "OC48")) {
                clockCor = false;
                bonding = false;
            } else if (Equals(display, "ZephineX") || Equals(display, "Ethernet") ||
                       Equals(display, "FibreChannel")) {
                comma = false;
            }
        } else if (block->SupportsMGT11()) {
            clockCor = block->HasAttrWPrefix("CLK_COR");
            bonding = !m_gt11Single;
        } else {
            comma = false;
        }
        enable(comma, kCommaDetectPage, -1);
        enable(true, kReceiverPage, -1);
        enable(clockCor, kClockCorrectionPage, -1);
        enable(bonding, kChannelBondingPage, -1);
        if (!bonding)
            noBonding();
    }

    if (bypass) {
        enable(false, kClockCorrectionPage, kChannelBondingPage);
        noBonding();
    }
}

void Qvz_MGTGeneralSetup::ApplyPcsBypassResets(Qvz_Block* block) {
    if (!block)
        return;
    Qvz_Attribute* bypassAttr = block->GetNamedAttribute("QVZX_ONLY_BYPASS_PCS");
    if (!bypassAttr)
        return;
    if (!m_bypassPcs) {
        bypassAttr->SetValue("FALSE");
        return;
    }
    bypassAttr->SetValue("TRUE");
    block->SetAttributeValue("QVZX_ONLY_TX_8B10B_USE", "FALSE");
    // Without the PCS none of its coding, alignment or buffering can be in use.
    const struct {
        const char* name;
        const char* value;
    } resets[] = {
        {"ALIGN_COMMA_MSB", "FALSE"},     {"CHAN_BOND_MODE", "OFF"},
        {"CLK_CORRECT_USE", "FALSE"},     {"COMMA_10B_MASK", "0000000000"},
        {"DEC_MCOMMA_DETECT", "FALSE"},   {"DEC_PCOMMA_DETECT", "FALSE"},
        {"MCOMMA_DETECT", "FALSE"},       {"PCOMMA_DETECT", "FALSE"},
        {"RX_CRC_USE", "FALSE"},          {"RX_DECODE_USE", "FALSE"},
        {"TX_CRC_USE", "FALSE"},          {"RX_BUFFER_USE", "FALSE"},
        {"RX_LOSS_OF_SYNC_FSM", "FALSE"},
    };
    for (const auto& r : resets)
        SetIfPresent(block, r.name, r.value);
}

void Qvz_MGTGeneralSetup::ResetZephineClockCorrection(Qvz_Block* block) {
    if (!block || !Equals(block->GetPrimitiveName(), "GT_ZEPHINE"))
        return;
    block->SetAttributeValue("CLK_COR_SEQ_LEN", m_dataWidth);

    auto assign = [&](const char* name, const Port::StringBase& value) {
        if (Qvz_Attribute* a = block->GetNamedAttribute(name)) {
            a->SetValue(value);
            a->SetChanged(true);
        }
    };
    auto defaultOf = [&](const char* name, Port::StringBase& out) {
        const Qvz_Attribute* a = block->GetNamedAttribute(name);
        if (a)
            out = a->GetDefaultValue();
        return a != nullptr;
    };

    Port::StringBase value;
    if (defaultOf("CLK_COR_SEQ_1_1", value))
        assign("CLK_COR_SEQ_1_1", value);

    const char* const kZeroSequence = "00000000000"; // the 11-bit form
    if (m_dataWidth.Compare("1", CompareSearch) == 0) {
        assign("CLK_COR_SEQ_1_2", kZeroSequence);
        assign("CLK_COR_SEQ_1_3", kZeroSequence);
        assign("CLK_COR_SEQ_1_4", kZeroSequence);
    } else if (m_dataWidth.Compare("2", CompareSearch) == 0) {
        if (defaultOf("CLK_COR_SEQ_1_2", value))
            assign("CLK_COR_SEQ_1_2", value);
        assign("CLK_COR_SEQ_1_3", kZeroSequence);
        assign("CLK_COR_SEQ_1_4", kZeroSequence);
    } else if (m_dataWidth.Compare("4", CompareSearch) == 0) {
        // Four-byte sequences repeat the second character's default.
        if (defaultOf("CLK_COR_SEQ_1_2", value)) {
            assign("CLK_COR_SEQ_1_2", value);
            assign("CLK_COR_SEQ_1_3", value);
            assign("CLK_COR_SEQ_1_4", value);
        }
    }
}

void Qvz_MGTGeneralSetup::PruneGT10Attributes(Qvz_Block* block) {
    if (!block || !block->SupportsMGT10())
        return;
    DeleteAttributes(block, {"PMARXFDETSEL",
                             "PMATXCMSET0",
                             "PMATXCMSET1",
                             "PMATXVCODACSEL",
                             "PMAVSEL",
                             "TX_6466SCRAMBLER_USE",
                             "TX_6466GEARBOX_USE",
                             "CHAN_BOND_WAIT",
                             "CHAN_BOND_OFFSET",
                             "ALIGN_COMMA_MSB",
                             "CLK_COR_REPEAT_WAIT",
                             "CLK_COR_ADJ_MAX",
                             "CLK_COR_KEEP_IDLE",
                             "CLK_COR_INSERT_IDLE_FLAG",
                             "CRC_END_OF_PKT",
                             "CRC_FORMAT",
                             "CRC_START_OF_PKT",
                             "RX_CRC_USE",
                             "TX_CRC_FORCE_VALUE",
                             "TX_CRC_USE",
                             "CLK_COR_64B66B_SV",
                             "LANE0_COMMA_SUB",
                             "LANE1_COMMA_SUB",
                             "LANE2_COMMA_SUB",
                             "LANE3_COMMA_SUB",
                             "LANE4_COMMA_SUB",
                             "LANE5_COMMA_SUB",
                             "LANE6_COMMA_SUB",
                             "LANE7_COMMA_SUB",
                             "PMARXCALSEL",
                             "PMATXCALSEL",
                             "SEQUENCE_ORDERED_SET"});

    for (const char* name :
         {"DISPREGSEL", "PMALOOPBACK", "PMARXCLK0SEL", "PMARXCLK1SEL", "PMARXLATCHSEL",
          "PMARXRECCLKSEL", "PMATXCLK0SEL", "PMATXCLK1SEL", "PMATXLATCHSEL", "PMATXOUTCLKSEL",
          "RXDECODEUSE", "PMAPWRDN", "PMAREGLOAD", "PMACMOUT", "PMACMIN", "PMATERMEN",
          "TXFORCECRCERR", "RXCHECKINGCRC", "RXCRCERR"})
        if (Qvz_Pin* pin = block->GetNamedPin(name))
            block->DeletePin(pin);

    const struct {
        const char* name;
        int width;
    } widths[] = {{"CHBONDI", 5}, {"CHBONDO", 5}, {"RXINTDATAWIDTH", 2}, {"TXINTDATAWIDTH", 2}};
    for (const auto& w : widths)
        if (Qvz_Pin* pin = block->GetNamedPin(w.name))
            pin->SetWidth(w.width);

    if (Equals(block->GetPrimitiveName(), "GT10_ZEPHINE_1")) {
        if (Qvz_Pin* pin = block->GetNamedPin("TXKERR")) {
            pin->SetWidth(1);
            pin->AddFlag("DATAWIDTH");
        }
    }

    const Port::StringBase& shown = m_displayName;
    if (Equals(shown, "Zephine") || Equals(shown, "PCI Express") || Equals(shown, "Infiniband") ||
        Equals(shown, "XAUI") || Equals(shown, "OC192") || Equals(shown, "OC48"))
        DeleteAttributes(block, {"SH_CNT_MAX", "SH_INVALID_CNT_MAX"});
    if (Equals(shown, "FibreChannel") || Equals(shown, "Ethernet") || Equals(shown, "ZephineX"))
        DeleteAttributes(block, {"ALIGN_COMMA_WORD", "COMMA_10B_MASK", "CLK_COR_8B10B_DE",
                                 "DEC_MCOMMA_DETECT", "DEC_PCOMMA_DETECT", "DEC_VALID_COMMA_ONLY"});
    if (Equals(shown, "ZephineX"))
        DeleteAttributes(
            block, {"MCOMMA_10B_VALUE", "MCOMMA_DETECT", "PCOMMA_10B_VALUE", "PCOMMA_DETECT"});
    if (Equals(shown, "OC192") || Equals(shown, "OC48"))
        DeleteAttributes(block,
                         {"CHAN_BOND_LIMIT",    "CHAN_BOND_MODE",       "CHAN_BOND_NUMBER",
                          "CHAN_BOND_ONE_SHOT", "CHAN_BOND_SEQ_1_1",    "CHAN_BOND_SEQ_1_2",
                          "CHAN_BOND_SEQ_1_3",  "CHAN_BOND_SEQ_1_4",    "CHAN_BOND_SEQ_1_MASK",
                          "CHAN_BOND_SEQ_2_1",  "CHAN_BOND_SEQ_2_2",    "CHAN_BOND_SEQ_2_3",
                          "CHAN_BOND_SEQ_2_4",  "CHAN_BOND_SEQ_2_MASK", "CHAN_BOND_SEQ_2_USE",
                          "CHAN_BOND_SEQ_LEN",  "DEC_8B10B_SEL",        "CLK_COR_8B10B_DE",
                          "CLK_COR_MAX_LAT",    "CLK_COR_MIN_LAT",      "CLK_COR_SEQ_1_1",
                          "CLK_COR_SEQ_1_2",    "CLK_COR_SEQ_1_3",      "CLK_COR_SEQ_1_4",
                          "CLK_COR_SEQ_1_MASK", "CLK_COR_SEQ_2_1",      "CLK_COR_SEQ_2_2",
                          "CLK_COR_SEQ_2_3",    "CLK_COR_SEQ_2_4",      "CLK_COR_SEQ_2_MASK",
                          "CLK_COR_SEQ_2_USE",  "CLK_COR_SEQ_DROP",     "CLK_COR_SEQ_LEN",
                          "CLK_CORRECT_USE"});
}

void Qvz_MGTGeneralSetup::CleanUpGT11Attributes(Qvz_Block* block) {
    if (!block || !block->SupportsMGT11())
        return;
    DeleteAttributes(block, {"RXRECCLK2_USE_SYNC", "TXOUTCLK2_USE_SYNC", "QVZX_ONLY_GT11_CLK",
                             "COMMA_32B_MASK", "RX_LOS_INVALID_INCR", "RX_LOS_THRESHOLD"});

    for (const char* name : {"TXFDCAL_CLOCK_DIVIDE", "RXFDCAL_CLOCK_DIVIDE"})
        if (Qvz_Attribute* a = block->GetNamedAttribute(name))
            if (Equals(a->GetValue(), "2'b00"))
                a->SetValue("NONE");
    // Sized binary divider settings are an older form; the default replaces them.
    for (const char* name : {"TXPLLNDIVSEL", "RXPLLNDIVSEL"})
        if (Qvz_Attribute* a = block->GetNamedAttribute(name))
            if (Contains(a->GetValue(), "4'b"))
                a->SetValue(a->GetDefaultValue());
    if (Qvz_Attribute* a = block->GetNamedAttribute("CLK_COR_SEQ_1_MASK"))
        if (Equals(a->GetValue(), "4'1100"))
            a->SetValue("4'b1100");
}
