#pragma once
// A wizard main over hand-built design data, with its bonding page at hand.

#include "Qvz_MGTRCB.h"
#include "Qvz_MGTWizMain.h"

#include <initializer_list>
#include <memory>

struct RcbRig {
    Qvz_WizData data;
    Qvz_MGTWizMain wiz{"test", false};
    std::unique_ptr<Qvz_MGTRCB> owned;
    Qvz_MGTRCB* page = nullptr;

    // Makes the bonding page afresh over data (target facts as they are now).
    // Only this page: the General Setup page would clear the active block's
    // pin signals and look the block up by type and width on construction.
    Qvz_MGTRCB* Start(Qvz_RunMode mode = Qvz_RunMode::Batch) {
        wiz.SetWizData(&data);
        wiz.SetRunMode(mode);
        wiz.m_batchMode = mode == Qvz_RunMode::Batch;
        owned.reset();
        owned = std::make_unique<Qvz_MGTRCB>(&wiz);
        page = owned.get();
        return page;
    }
    Qvz_Block* Block(const char* name, const char* primitive, bool used = true) {
        auto b = std::make_unique<Qvz_Block>(name, primitive, Qvz_FamilyOfPrimitive(primitive));
        b->SetIsUsed(used);
        return data.AddBlock(std::move(b));
    }
    const std::vector<Qvz_Message>& Messages() const { return wiz.GetMessages(); }
};

inline Qvz_Attribute* Attr(Qvz_Block* b, const char* name, const char* value,
                           const char* def = nullptr, bool editable = true,
                           std::initializer_list<const char*> legal = {}) {
    Qvz_Attribute* a = b->AddAttribute(name, value);
    a->SetDefaultValue(def ? def : value);
    a->SetEditable(editable);
    a->GetLegalValues().RemoveAll();
    for (const char* l : legal)
        a->GetLegalValues().Add(l);
    return a;
}

// The attributes a bonding-capable block carries.
inline void BondingAttrs(Qvz_Block* b, const char* display, const char* number) {
    Attr(b, "MGT_DISPLAY_NAME", display);
    Attr(b, "QVZ_BOOL_RX_USE", "TRUE");
    Attr(b, "QVZ_CHAN_BOND_NUMBER", number);
    Attr(b, "QVZ_CHAN_BOND_PRIMARY_ROW", "1");
    Attr(b, "CHAN_BOND_MODE", "OFF");
    Attr(b, "CHAN_BOND_ONE_SHOT", "FALSE");
    Attr(b, "CHAN_BOND_LIMIT", "16", nullptr, true, {"1..31"});
    Attr(b, "CHAN_BOND_OFFSET", "8", nullptr, true, {"0..15"});
    Attr(b, "CHAN_BOND_WAIT", "8", nullptr, true, {"1..15"});
    Attr(b, "CHAN_BOND_SEQ_LEN", "4", "4", true, {"1", "2", "4"});
    Attr(b, "CHAN_BOND_SEQ_1_MASK", "1111");
    Attr(b, "CHAN_BOND_SEQ_2_MASK", "1111");
}
