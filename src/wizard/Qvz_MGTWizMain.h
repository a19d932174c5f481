#pragma once
// The wizard the host constructs and runs: its pages, the dialog's captions
// and links, the summary hooks, and the lookup of the transceiver block.

#include "Qvz_Export.h"
#include "Qvz_WizMain.h"

class QVZ_WIZARD_EXPORT Qvz_MGTWizMain : public Qvz_WizMain {
public:
    // Page slots, in page order.
    enum PageSlot {
        kGeneralSetup = 0,
        kTransmitter = 1,
        kCommaDetect = 2,
        kReceiver = 3,
        kClockCorrection = 4,
        kChannelBonding = 5,
        kPageCount = 6
    };
    // Title of a page slot, "" outside 0..5.
    static const char* PageTitle(int slot);

    Qvz_MGTWizMain(const Port::StringBase& name, bool flag);
    Qvz_MGTWizMain(const Qvz_MGTWizMain& other);
    Qvz_MGTWizMain& operator=(const Qvz_MGTWizMain& other);
    ~Qvz_MGTWizMain() override;

    Qvz_Block* GetBlock(Qvz_WizData* data, const Port::StringBase& displayName,
                        const Port::StringBase& dataWidth, bool anyWidth);
    static Port::StringBase GetBlkPrimName(Qvz_Block* block);
    static void ClearPinSigBitAttrs(Qvz_Block* block);

private:
    void GoBackFromSummary() override;
    bool DoFinishAtSummaryStart() override;
    int Finish() override;
    bool CustomizeGui(Wg_Wizard* wizard) override;
    bool InstantiatePages() override;
    Port::StringBase GetPageTitle(int slot) const override;
};
