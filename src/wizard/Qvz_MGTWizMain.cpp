#include "Qvz_MGTWizMain.h"

#include "Qvz_MGTGeneralSetup.h"
#include "Qvz_MGTRCB.h"
#include "Qvz_MGTRCC.h"
#include "Qvz_MGTRCD.h"
#include "Qvz_MGTRX.h"
#include "Qvz_MGTTransmitter.h"
#include "Wg_Wizard.h"

#include <new>

namespace {
const char* const kPageTitles[Qvz_MGTWizMain::kPageCount] = {
    "General Setup",  "Transmitter Setup",
    "Receiver Comma Detect Setup", "Receiver Setup",
    "Receiver Clock Correction Setup", "Receiver Channel Bonding Setup"};
} // namespace

const char* Qvz_MGTWizMain::PageTitle(int slot) {
    return slot >= 0 && slot < kPageCount ? kPageTitles[slot] : "";
}

Qvz_MGTWizMain::Qvz_MGTWizMain(const Port::StringBase& name, bool flag) : Qvz_WizMain(name, flag) {}

Qvz_MGTWizMain::Qvz_MGTWizMain(const Qvz_MGTWizMain& other) = default;

Qvz_MGTWizMain& Qvz_MGTWizMain::operator=(const Qvz_MGTWizMain& other) {
    Qvz_WizMain::operator=(other);
    return *this;
}

Qvz_MGTWizMain::~Qvz_MGTWizMain() = default;

Port::StringBase Qvz_MGTWizMain::GetPageTitle(int slot) const {
    return PageTitle(slot);
}

bool Qvz_MGTWizMain::InstantiatePages() {
    m_pPages[kGeneralSetup] = new (std::nothrow) Qvz_MGTGeneralSetup(this);
    m_pPages[kTransmitter] = new (std::nothrow) Qvz_MGTTransmitter(this);
    m_pPages[kCommaDetect] = new (std::nothrow) Qvz_MGTRCD(this);
    m_pPages[kReceiver] = new (std::nothrow) Qvz_MGTRX(this);
    m_pPages[kClockCorrection] = new (std::nothrow) Qvz_MGTRCC(this);
    m_pPages[kChannelBonding] = new (std::nothrow) Qvz_MGTRCB(this);
    return true;
}

bool Qvz_MGTWizMain::CustomizeGui(Wg_Wizard* wizard) {
    if (wizard)
        wizard->setCaption("Velomux Wizard");
    bool result = true;
    for (int i = 0; i < kMaxPages && m_pPages[i]; ++i) {
        Wg_WizardPage* gui = m_pPages[i]->GetGuiDlg();
        if (!gui) {
            result = false;
            continue;
        }
        if (i > 0)
            gui->setPageBackName(PageTitle(i - 1));
        if (i + 1 < kMaxPages && m_pPages[i + 1]) {
            gui->setPageNextName(PageTitle(i + 1));
        } else {
            gui->setPageNextName("Summary");
            if (m_pSummaryPage)
                m_pSummaryPage->setPageBackName(PageTitle(i));
        }
        if (wizard)
            wizard->addPage(gui);
    }
    if (wizard && m_pSummaryPage)
        wizard->addPage(m_pSummaryPage);
    return result;
}

int Qvz_MGTWizMain::Finish() {
    auto* general = static_cast<Qvz_MGTGeneralSetup*>(m_pPages[kGeneralSetup]);
    if (m_batchMode && general)
        general->FinalizePins();
    return 0;
}

bool Qvz_MGTWizMain::DoFinishAtSummaryStart() {
    auto* general = static_cast<Qvz_MGTGeneralSetup*>(m_pPages[kGeneralSetup]);
    return general ? general->FinalizePins() : false;
}

void Qvz_MGTWizMain::GoBackFromSummary() {
    if (auto* bonding = static_cast<Qvz_MGTRCB*>(m_pPages[kChannelBonding]))
        bonding->RemoveBondedInstances();
}

Port::StringBase Qvz_MGTWizMain::GetBlkPrimName(Qvz_Block* block) {
    if (!block)
        return Port::StringBase();
    Port::StringBase name = block->GetPrimitiveName();
    if (block->SupportsMGT3() && name.Compare("GT_CUSTOM", Port::CompareExact) != 0) {
        name += "_";
        name += block->GetAttributeValue("RX_DATA_WIDTH");
    }
    return name;
}

Qvz_Block* Qvz_MGTWizMain::GetBlock(Qvz_WizData* data, const Port::StringBase& displayName,
                                    const Port::StringBase& dataWidth, bool anyWidth) {
    if (!data)
        return nullptr;
    const bool testWidth = !anyWidth &&
                           displayName.GetIndexOfString("Custom", Port::CompareSearch) ==
                               Port::StringBase::npos &&
                           !m_supportsMGT3;
    for (const auto& b : data->GetBlocks()) {
        const bool familyOk = (b->SupportsMGT3() && m_supportsMGT3) ||
                              (b->SupportsMGT10() && m_supportsMGT10) ||
                              (b->SupportsMGT11() && m_supportsMGT11);
        if (!familyOk)
            continue;
        Port::StringBase shown = b->GetAttributeValue("MGT_DISPLAY_NAME");
        if (shown.IsEmpty())
            shown = b->GetAttributeValue("QVZ_OLD_DISPLAY_NAME");
        if (shown.Compare(displayName, Port::CompareExact) != 0)
            continue;
        if (testWidth &&
            b->GetAttributeValue("QVZ_RX_DATA_WIDTH").Compare(dataWidth, Port::CompareExact) != 0)
            continue;
        return b.get();
    }
    return nullptr;
}

void Qvz_MGTWizMain::ClearPinSigBitAttrs(Qvz_Block* /*block*/) {
    // Deliberately nothing: the finish routine keeps the bit maps it made.
}
