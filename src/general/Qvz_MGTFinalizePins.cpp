// The finish routine of the General Setup page: decides every pin of the
// active block from the settings all pages wrote, builds the ports and the
// constant and bus signals, and has the bonded copies generated.

#include "Qvz_MGTGeneralSetup.h"

#include "Qvz_MGTRCB.h"
#include "Qvz_MGTWizMain.h"

#include <algorithm>
#include <unordered_set>

using Port::CompareExact;
using Port::CompareSearch;
using Port::StringBase;

namespace {

// The widest data path of the transceivers, in bytes. A stored width beyond
// it is taken as this, so that no port or bus width overflows.
constexpr int kMaxDataWidthBytes = 8;

bool Is(const StringBase& s, const char* text) {
    return s.Compare(text, CompareExact) == 0;
}

bool IsAny(const StringBase& s, std::initializer_list<const char*> texts) {
    return std::any_of(texts.begin(), texts.end(), [&](const char* t) { return Is(s, t); });
}

bool BeginsWith(const StringBase& s, const char* text) {
    return s.GetIndexOfString(text, CompareSearch) == 0;
}

bool InList(const Qvz_StrArray& list, const StringBase& name) {
    for (int i = 0; i < list.GetSize(); ++i)
        if (list.GetAt(i).Compare(name, CompareExact) == 0)
            return true;
    return false;
}

// Bytes of a stored data width; 0 when it is no usable width.
int DataWidthBytes(const StringBase& text) {
    const int n = UT_STR::AToI(text);
    if (n < 1)
        return 0;
    return std::min(n, kMaxDataWidthBytes);
}

// A tie replaces whatever else the pin was connected to.
void Tie(Qvz_Pin* pin, int level) {
    pin->ClearAllConnections();
    if (level)
        pin->SetIsVcc(true);
    else
        pin->SetIsGrounded(true);
}

Qvz_Signal* ConstantSignal(Qvz_WizData* data, const char* name, int level) {
    Qvz_Signal* s = data->AddSignal(name, false, "");
    if (!s)
        return nullptr;
    s->SetIsConst0(level == 0);
    s->SetIsConst1(level != 0);
    return s;
}

// Maps pin bit `bit` onto bit 0 of signal, when the pin has that bit.
void MapBit(Qvz_Pin* pin, int bit, const char* signal) {
    if (bit < pin->GetWidth())
        pin->SetPinSigBitProp(signal, bit, bit, 0, 0);
}

// The settings the pin rules decide by, read from the active block.
struct Settings {
    StringBase primName;
    bool gt = false, gt10 = false, gt11 = false;
    bool refClkUsed = true, bRefClkUsed = true;
    bool xaui = false;
    bool gt11Dual = false;
    bool encUsed = false, encDynamic = false, encStatic8b10b = true;
    bool refClkStatic = false, bRefClkStatic = false;
    bool refClk2 = false, bRefClk2 = false;
    bool pmaEnabled = false;
    bool pcsBypassed = false;
    bool rxUsed = true, txUsed = true;
    int dataWidth = 0; // bytes; 0: unknown
    bool decUsed = false, decDynamic = false, decStatic8b10b = true;
    bool txCrc = false, rxCrc = false;
    int bondNumber = 0;
    bool pageBypass = false;

    // GT_CUSTOM and the two later families share the finer pin rules.
    bool CustomOrLater() const { return Is(primName, "GT_CUSTOM") || gt10 || gt11; }
};

void ReadCoding(const StringBase& coding, const StringBase& staticKind, bool& used, bool& dynamic,
                bool& is8b10b) {
    used = Is(coding, "DYNAMIC") || Is(coding, "STATIC");
    dynamic = Is(coding, "DYNAMIC");
    is8b10b = !Is(staticKind, "64B66B");
}

// Outcomes of a pin's rules, before the common tail.
enum class Outcome { Port, Done };

} // namespace

bool Qvz_MGTGeneralSetup::IsInPcsPinList(const StringBase& name) const {
    return InList(m_pcsPins, name);
}

bool Qvz_MGTGeneralSetup::IsInRxExtraPinList(const StringBase& name) const {
    return InList(m_rxExtraPins, name);
}

bool Qvz_MGTGeneralSetup::IsInUserClockPinList(const StringBase& name) const {
    return InList(m_userClockPins, name);
}

bool Qvz_MGTGeneralSetup::IsInTx64b66bPinList(const StringBase& name) const {
    return InList(m_tx64b66bPins, name);
}

bool Qvz_MGTGeneralSetup::IsInRx64b66bPinList(const StringBase& name) const {
    return InList(m_rx64b66bPins, name);
}

void Qvz_MGTGeneralSetup::RestorePinWidth(Qvz_Pin* pin) {
    if (!m_isGT11 || !pin || !pin->SupportsDataWidth() || !m_pWizData)
        return;
    Qvz_MGTWizMain* main = WizMain();
    if (!main)
        return;
    StringBase custom = "Custom";
    Qvz_Block* library = main->GetBlock(m_pWizData, custom, m_dataWidth, false);
    if (!library)
        return;
    if (const Qvz_Pin* model = library->GetNamedPin(pin->GetName()))
        pin->SetWidth(model->GetWidth());
}

void Qvz_MGTGeneralSetup::TieCrcDataWidth(Qvz_Block* block, Qvz_Pin* pin, bool tx) {
    if (!m_pWizData || !block || !pin)
        return;
    const StringBase width =
        block->GetAttributeValue(tx ? "QVZ_TXCRC_DATAWIDTH" : "QVZ_RXCRC_DATAWIDTH");
    static const char* const kWidths[] = {"16", "24", "32", "40", "48", "56", "64"};
    int code = 0;
    for (int i = 0; i < 7; ++i)
        if (Is(width, kWidths[i]))
            code = i + 1;
    if (!ConstantSignal(m_pWizData, "CRCDATAWIDTH_GND", 0) ||
        !ConstantSignal(m_pWizData, "CRCDATAWIDTH_VCC", 1))
        return;
    for (int bit = 2; bit >= 0; --bit)
        MapBit(pin, bit, (code >> bit) & 1 ? "CRCDATAWIDTH_VCC" : "CRCDATAWIDTH_GND");
}

void Qvz_MGTGeneralSetup::GroundFloatingInputs(Qvz_Block* block) {
    if (!block)
        return;
    for (const auto& pin : block->GetPins()) {
        if (pin->IsGrounded() || pin->IsVcc())
            continue;
        // A pin wired bit by bit is connected even without a whole-pin signal.
        if (pin->HasPinSigBitProp())
            continue;
        // The GT11 tile bus is wired by the bonding step, which comes later.
        if (m_isGT11 && Is(pin->GetName(), "COMBUSIN"))
            continue;
        if (!Is(pin->GetAttributeValue("QVZ_PIN_TIE"), "TRUE") && pin->GetSigName().IsEmpty() &&
            Is(pin->GetDirection(), "IN"))
            pin->SetIsGrounded(true);
    }
}

void Qvz_MGTGeneralSetup::MakePinPort(Qvz_Pin* pin, int dataWidth) {
    if (!pin || !m_pWizData)
        return;
    const StringBase& name = pin->GetName();
    // The data pins may come back from a 10-bit bus: start them afresh, but
    // keep a signal named for the port itself.
    bool dropBitMaps = false;
    StringBase sigName = pin->GetSigName();
    const char* dataSuffix = IsAny(name, {"TXDATA", "TXCHARDISPMODE", "TXCHARDISPVAL"}) ? "_IN"
                             : IsAny(name, {"RXDATA", "RXCHARISK", "RXRUNDISP"})        ? "_OUT"
                                                                                        : nullptr;
    if (dataSuffix) {
        dropBitMaps = true;
        StringBase own;
        own.Format("%s%s", name.c_str(), dataSuffix);
        if (!Is(sigName, own.c_str()) && sigName.Compare(name, CompareExact) != 0)
            sigName = StringBase();
    }

    const StringBase& dir = pin->GetDirection();
    const char* code = Is(dir, "IN") ? "I" : Is(dir, "OUT") ? "O" : "B";

    Qvz_Signal* signal = nullptr;
    if (!sigName.IsEmpty()) {
        signal = m_pWizData->GetNamedSignal(sigName);
    } else if ((signal = m_pWizData->GetNamedSignal(name))) {
        sigName = name;
    }
    if (signal) {
        signal->SetIsUsed(true);
    } else {
        if (sigName.IsEmpty()) {
            // An inout pin has no suffix: its signal is named after it.
            if (Is(code, "I"))
                sigName.Format("%s_IN", name.c_str());
            else if (Is(code, "O"))
                sigName.Format("%s_OUT", name.c_str());
            else
                sigName = name;
        }
        signal = m_pWizData->AddSignal(sigName, true, code);
        if (!signal)
            return; // no signal to connect: the pin stays as it was
    }

    if (dropBitMaps)
        pin->RemoveAllPinSigBitProps();
    signal->RemoveAttribute("BUS_ONLY_USE_BITS");

    int pinWidth = pin->GetWidth();
    int portWidth = pinWidth;
    if (pin->SupportsDataWidth()) {
        if (dataWidth >= 1) {
            const int n = std::min(dataWidth, kMaxDataWidthBytes);
            portWidth = IsAny(name, {"TXDATA", "RXDATA"}) ? 8 * n : n;
        }
        signal->SetWidth(portWidth);
        if (m_isGT11) {
            RestorePinWidth(pin);
            pinWidth = pin->GetWidth();
            if (dataWidth < 1)
                portWidth = pinWidth;
        }
        if (portWidth < pinWidth)
            signal->SetAttributeValue("BUS_ONLY_USE_BITS", UT_STR::IToA(portWidth));
    }
    signal->SetWidth(portWidth);

    if (pinWidth >= 2)
        signal->SetIsBus(true, portWidth);
    else if (pin->SupportsDataWidth() && portWidth == 1)
        signal->SetIsBus(true, 1);
    else
        signal->SetIsBus(false, 1);

    // A port is not tied as well.
    pin->SetIsGrounded(false);
    pin->SetIsVcc(false);
    pin->SetSigName(sigName);
}

namespace {

// One direction of the 10-bit bus.
struct TenBitBus {
    // The data pin, and the one-bit-per-byte pins of bits 8 and 9 of each ten.
    const char* pins[3];
    const char* widthAttr[2]; // GT, the later families
    const char* existingSignal;
    const char* newSignal;
    const char* direction;
    const char* spareSuffix;
    bool spareConstant0;
    bool dataSpareAlwaysBus;
    // Signals of the pins' own ports, which the bus replaces.
    const char* leftovers[4];
};

const TenBitBus kTxBus = {
    {"TXDATA", "TXCHARDISPVAL", "TXCHARDISPMODE"},
    {"TX_DATA_WIDTH", "QVZ_TX_DATA_WIDTH"},
    "TXDATA",
    "TXDATA_IN",
    "I",
    "_GND",
    true,
    false,
    {"TXCHARDISPVAL_IN", "TXCHARDISPVAL", "TXCHARDISPMODE_IN", "TXCHARDISPMODE"}};

const TenBitBus kRxBus = {{"RXDATA", "RXRUNDISP", "RXCHARISK"},
                          {"RX_DATA_WIDTH", "QVZ_RX_DATA_WIDTH"},
                          "RXDATA",
                          "RXDATA_OUT",
                          "O",
                          "_float",
                          false,
                          true,
                          {"RXCHARISK_OUT", "RXCHARISK", "RXRUNDISP_OUT", "RXRUNDISP"}};

// Maps the pin bits above `used` onto a spare signal of their own.
void MapSpareBits(Qvz_WizData* data, Qvz_Pin* pin, int used, const TenBitBus& bus, bool alwaysBus) {
    const int count = pin->GetWidth() - used;
    if (count <= 0)
        return;
    StringBase name = pin->GetName();
    name += bus.spareSuffix;
    Qvz_Signal* spare = data->AddSignal(name, false, "");
    if (!spare)
        return;
    if (bus.spareConstant0)
        spare->SetIsConst0(true);
    spare->SetIsBus(alwaysBus || count > 1, count);
    pin->SetPinSigBitProp(name, pin->GetWidth() - 1, used, count - 1, 0);
}

void BuildTenBitBus(Qvz_MGTGeneralSetup& page, Qvz_WizData* data, Qvz_Block* block,
                    const TenBitBus& bus) {
    if (!data || !block)
        return;
    Qvz_Pin* dataPin = block->GetNamedPin(bus.pins[0]);
    Qvz_Pin* bit8Pin = block->GetNamedPin(bus.pins[1]);
    Qvz_Pin* bit9Pin = block->GetNamedPin(bus.pins[2]);
    if (!dataPin || !bit8Pin || !bit9Pin)
        return;
    if (page.m_isGT11) {
        page.RestorePinWidth(dataPin);
        page.RestorePinWidth(bit8Pin);
        page.RestorePinWidth(bit9Pin);
    }
    const int n = DataWidthBytes(block->GetAttributeValue(bus.widthAttr[page.m_isGT ? 0 : 1]));
    if (n < 1)
        return; // no width to build a bus of

    Qvz_Signal* signal = data->GetNamedSignal(bus.existingSignal);
    StringBase sigName = bus.existingSignal;
    if (!signal) {
        sigName = bus.newSignal;
        signal = data->AddSignal(sigName, true, bus.direction);
    }
    if (!signal)
        return;

    for (Qvz_Pin* pin : {dataPin, bit8Pin, bit9Pin}) {
        pin->RemoveAllPinSigBitProps();
        // Wired bit by bit from here on: no whole-pin signal besides.
        pin->SetSigName(StringBase());
    }
    signal->SetIsUsed(true);
    signal->RemoveAttribute("BUS_ONLY_USE_BITS");
    signal->SetWidth(10 * n);
    signal->SetIsBus(true, 10 * n);

    const int dataBits = dataPin->GetWidth();
    for (int i = 0; i < n; ++i) {
        const int low = 8 * i;
        if (low < dataBits) {
            const int high = std::min(low + 7, dataBits - 1);
            dataPin->SetPinSigBitProp(sigName, high, low, 10 * i + (high - low), 10 * i);
        }
        if (i < bit8Pin->GetWidth())
            bit8Pin->SetPinSigBitProp(sigName, i, i, 10 * i + 8, 10 * i + 8);
        if (i < bit9Pin->GetWidth())
            bit9Pin->SetPinSigBitProp(sigName, i, i, 10 * i + 9, 10 * i + 9);
    }
    MapSpareBits(data, dataPin, 8 * n, bus, bus.dataSpareAlwaysBus);
    MapSpareBits(data, bit8Pin, n, bus, false);
    MapSpareBits(data, bit9Pin, n, bus, false);

    for (const char* leftover : bus.leftovers)
        if (Qvz_Signal* s = data->GetNamedSignal(leftover))
            s->SetIsUsed(false);
}

} // namespace

void Qvz_MGTGeneralSetup::BuildTxTenBitBus(Qvz_Block* block) {
    BuildTenBitBus(*this, m_pWizData, block, kTxBus);
}

void Qvz_MGTGeneralSetup::BuildRxTenBitBus(Qvz_Block* block) {
    BuildTenBitBus(*this, m_pWizData, block, kRxBus);
}

// Undoing the last finish ---------------------------------------------------

void Qvz_MGTGeneralSetup::UndoLastFinish() {
    FinishRecord record = std::move(m_lastFinish);
    m_lastFinish = FinishRecord();
    if (!m_pWizData)
        return;
    for (const StringBase& name : record.activated)
        if (Qvz_Signal* s = m_pWizData->GetNamedSignal(name))
            s->SetIsUsed(false);

    const auto& blocks = m_pWizData->GetBlocks();
    const bool present = std::any_of(blocks.begin(), blocks.end(),
                                     [&](const auto& b) { return b.get() == record.block; });
    if (!present)
        return;
    Qvz_Block* block = record.block;

    // Pins the finish added go again; the others get their connections back.
    std::vector<Qvz_Pin*> added;
    for (const auto& pin : block->GetPins()) {
        const auto rec = std::find_if(record.pins.begin(), record.pins.end(),
                                      [&](const PinRecord& r) { return r.name == pin->GetName(); });
        if (rec == record.pins.end()) {
            added.push_back(pin.get());
            continue;
        }
        pin->SetSigName(rec->signal);
        pin->SetIsGrounded(rec->grounded);
        pin->SetIsVcc(rec->vcc);
        pin->SetIsUsed(rec->used);
        // Bit maps as they were, in their old places; the pin's other
        // attributes keep their current values.
        std::vector<Qvz_NameValue>& now = pin->AttributeList().Items();
        std::vector<Qvz_NameValue> merged;
        for (const Qvz_NameValue& old : rec->attributes) {
            if (Qvz_Pin::IsBitMapName(old.name)) {
                merged.push_back(old);
                continue;
            }
            const auto cur = std::find_if(now.begin(), now.end(), [&](const Qvz_NameValue& nv) {
                return nv.name == old.name;
            });
            if (cur != now.end())
                merged.push_back(*cur);
        }
        for (const Qvz_NameValue& cur : now) {
            if (Qvz_Pin::IsBitMapName(cur.name))
                continue;
            const bool kept =
                std::any_of(merged.begin(), merged.end(),
                            [&](const Qvz_NameValue& nv) { return nv.name == cur.name; });
            if (!kept)
                merged.push_back(cur);
        }
        now = std::move(merged);
    }
    for (Qvz_Pin* pin : added)
        block->DeletePin(pin);
}

void Qvz_MGTGeneralSetup::RecordBeforeFinish(Qvz_Block* block) {
    m_lastFinish = FinishRecord();
    m_lastFinish.block = block;
    for (const auto& pin : block->GetPins()) {
        PinRecord r;
        r.name = pin->GetName();
        r.signal = pin->GetSigName();
        r.grounded = pin->IsGrounded();
        r.vcc = pin->IsVcc();
        r.used = pin->IsUsed();
        r.attributes = pin->GetAttributes();
        m_lastFinish.pins.push_back(std::move(r));
    }
}

// The finish routine ---------------------------------------------------------

bool Qvz_MGTGeneralSetup::FinalizePins() {
    Qvz_WizData* data = m_pWizData;
    if (!data)
        return true;
    Qvz_Block* block = data->GetActiveBlock();
    if (!block)
        return true;

    UndoLastFinish();
    RecordBeforeFinish(block);
    std::unordered_set<std::string> usedBefore;
    for (const auto& s : data->GetSignals())
        if (s->IsUsed())
            usedBefore.insert(s->GetName().str());

    const bool result = DecidePins(block);

    for (const auto& s : data->GetSignals())
        if (s->IsUsed() && !usedBefore.count(s->GetName().str()))
            m_lastFinish.activated.push_back(s->GetName());
    return result;
}

namespace {

// Rules 0 to 37 for one pin; the pin's own outcome (tie, unconnected, bit
// maps) is applied here, Port leaves it a port candidate for the tail.
class PinRules {
public:
    PinRules(Qvz_MGTGeneralSetup& page, Qvz_WizData* data, Qvz_Block* block, const Settings& s)
        : m_page(page), m_data(data), m_block(block), m_s(s) {}

    Outcome Decide(Qvz_Pin* pin);

private:
    Outcome Unconnected(Qvz_Pin* pin, bool restoreWidth) {
        if (restoreWidth)
            m_page.RestorePinWidth(pin);
        pin->ClearAllConnections();
        return Outcome::Done;
    }
    Outcome Tied(Qvz_Pin* pin, int level) {
        Tie(pin, level);
        return Outcome::Done;
    }
    // Both GT11 width constants, added whenever either is mapped.
    void AddWidthConstants() {
        ConstantSignal(m_data, "GNDa", 0);
        ConstantSignal(m_data, "VCCa", 1);
    }
    Outcome DataWidthCode(Qvz_Pin* pin);
    Outcome IntDataWidth(Qvz_Pin* pin, bool dynamic, bool used, bool is8b10b);
    void WireChannelBondOut(Qvz_Pin* pin);
    bool Rx29Names(const StringBase& name) const {
        return m_page.IsInRxExtraPinList(name) ||
               (BeginsWith(name, "RX") && !m_page.IsInUserClockPinList(name));
    }
    bool Tx30Names(const StringBase& name) const {
        return Is(name, "LOOPBACK") ||
               (BeginsWith(name, "TX") && !m_page.IsInUserClockPinList(name));
    }

    Qvz_MGTGeneralSetup& m_page;
    Qvz_WizData* m_data;
    Qvz_Block* m_block;
    const Settings& m_s;
};

Outcome PinRules::DataWidthCode(Qvz_Pin* pin) {
    pin->RemoveAllPinSigBitProps();
    const StringBase& width = m_page.m_dataWidth;
    if (Is(width, "1"))
        return Tied(pin, 0);
    if (Is(width, "2") || Is(width, "4")) {
        AddWidthConstants();
        // Code 01 for two bytes, 10 for four.
        const bool two = Is(width, "2");
        MapBit(pin, 1, two ? "GNDa" : "VCCa");
        MapBit(pin, 0, two ? "VCCa" : "GNDa");
        return Outcome::Done;
    }
    return Tied(pin, 1);
}

Outcome PinRules::IntDataWidth(Qvz_Pin* pin, bool dynamic, bool used, bool is8b10b) {
    if (dynamic)
        return Outcome::Port;
    pin->RemoveAllPinSigBitProps();
    if (used && is8b10b)
        return Tied(pin, 1);
    AddWidthConstants();
    MapBit(pin, 0, "GNDa");
    MapBit(pin, 1, "VCCa");
    return Outcome::Done;
}

void PinRules::WireChannelBondOut(Qvz_Pin* pin) {
    Qvz_Signal* signal = m_data->GetNamedSignal("CHANBOND_M_S1");
    if (signal)
        signal->SetIsUsed(true);
    else
        signal = m_data->AddSignal("CHANBOND_M_S1_OUT", false, "");
    if (!signal)
        return;
    signal->SetIsBus(true, pin->GetWidth());
    signal->SetIsExternal(false, "");
    pin->ClearAllConnections();
    pin->SetSigName(signal->GetName());
}

Outcome PinRules::Decide(Qvz_Pin* pin) {
    const Settings& s = m_s;
    const StringBase& name = pin->GetName();

    // 0: the PCS pins of a bypassed PCS.
    if (s.pcsBypassed && m_page.IsInPcsPinList(name))
        return Unconnected(pin, true);

    // 1 to 11: these names end the rules whatever holds.
    const bool refClkGoesAway = !s.refClkUsed && ((s.gt && s.bRefClkUsed) || s.gt10);
    if (Is(name, "REFCLK")) {
        if (s.refClkUsed && s.refClkStatic && s.refClk2)
            return Tied(pin, 0);
        if (refClkGoesAway)
            return Unconnected(pin, false);
        return Outcome::Port;
    }
    if (Is(name, "REFCLK2")) {
        if (s.gt11)
            return Outcome::Port;
        if (s.refClkUsed && s.refClkStatic && !s.refClk2)
            return Tied(pin, 0);
        if (refClkGoesAway)
            return Unconnected(pin, false);
        return Outcome::Port;
    }
    if (Is(name, "BREFCLK") || Is(name, "BREFCLK2")) {
        const bool second = Is(name, "BREFCLK2");
        if (s.bRefClkUsed && s.bRefClkStatic && s.bRefClk2 != second)
            return Tied(pin, 0);
        if (s.refClkUsed)
            return Unconnected(pin, false);
        return Outcome::Port;
    }
    if (IsAny(name, {"BREFCLKPIN", "BREFCLKNIN"}))
        return s.bRefClkUsed ? Outcome::Port : Unconnected(pin, false);
    if (Is(name, "REFCLKSEL")) {
        if (s.refClkUsed && s.refClkStatic)
            return Tied(pin, s.refClk2 ? 1 : 0);
        if (!s.refClkUsed && s.gt && s.bRefClkUsed && s.bRefClkStatic)
            return Tied(pin, s.bRefClk2 ? 1 : 0);
        return Outcome::Port;
    }
    if (Is(name, "REFCLKBSEL")) {
        if (s.refClkUsed && !s.bRefClkUsed)
            return Tied(pin, 0);
        if (!s.refClkUsed && s.bRefClkUsed)
            return Tied(pin, 1);
        return Outcome::Port;
    }
    if (IsAny(name, {"PMAINIT", "PMAREGADDR", "PMAREGDATAIN", "PMAREGRW", "PMAREGSTROBE"}))
        return s.pmaEnabled ? Outcome::Port : Tied(pin, 0);
    if (IsAny(name, {"COMBUSIN", "COMBUSOUT"}))
        return Outcome::Done;
    if (Is(name, "CONFIGOUT"))
        return Unconnected(pin, false);
    if (IsAny(name, {"CONFIGIN", "CONFIGENABLE"}))
        return Tied(pin, 0);
    if (Is(name, "CHBONDI"))
        return Unconnected(pin, false);

    // 12 to 15: the serial lines and the bonding chain.
    if (IsAny(name, {"RXN", "RXP"}) && !s.rxUsed && s.txUsed)
        return Outcome::Port;
    if (Is(name, "CHBONDO") && s.rxUsed) {
        if (s.bondNumber < 2)
            return Unconnected(pin, false);
        WireChannelBondOut(pin);
        return Outcome::Done;
    }
    if (IsAny(name, {"TXN", "TXP"}) && s.rxUsed && !s.txUsed)
        return Outcome::Port;
    if (IsAny(name, {"CHBONDDONE", "ENCHANSYNC"}) && s.rxUsed && s.bondNumber == 0)
        return Unconnected(pin, false);

    // 16, 17: the GT11 CRC pins.
    for (const bool tx : {false, true}) {
        if (!BeginsWith(name, tx ? "TXCRC" : "RXCRC") || !s.gt11 || !(tx ? s.txUsed : s.rxUsed))
            continue;
        const bool crc = tx ? s.txCrc : s.rxCrc;
        if (Is(name, tx ? "TXCRCPD" : "RXCRCPD"))
            return Tied(pin, crc ? 1 : 0);
        if (!crc)
            return Unconnected(pin, false);
        if (Is(name, tx ? "TXCRCDATAWIDTH" : "RXCRCDATAWIDTH"))
            m_page.TieCrcDataWidth(m_block, pin, tx);
        return Outcome::Port;
    }

    // 18 to 24: coding and CRC pins.
    if (Is(name, "TXFORCECRCERR") && s.txUsed) {
        if (s.pcsBypassed)
            return Tied(pin, 0);
        return s.txCrc ? Outcome::Port : Unconnected(pin, false);
    }
    if (Is(name, "TXBYPASS8B10B")) {
        m_page.RestorePinWidth(pin);
        if (s.pcsBypassed)
            return Tied(pin, 1);
        if (!s.txUsed)
            return Tied(pin, 0);
        if (!s.encUsed)
            return Tied(pin, 1);
        if (!s.encDynamic && s.encStatic8b10b)
            return Tied(pin, 0);
        if (!s.encDynamic && s.gt10)
            return Tied(pin, 1);
        return Outcome::Port;
    }
    if (Is(name, "RXDEC8B10BUSE") && s.rxUsed) {
        if (!s.decUsed)
            return Tied(pin, 0);
        if (!s.decDynamic)
            return Tied(pin, s.decStatic8b10b ? 1 : 0);
        return Outcome::Port;
    }
    if (IsAny(name, {"RXNOTINTABLE", "RXDISPERR"}) && s.rxUsed)
        return s.decUsed ? Outcome::Port : Unconnected(pin, true);
    if (IsAny(name, {"RXCHECKINGCRC", "RXCRCERR"}) && s.rxUsed) {
        if (Is(m_block->GetAttributeValue("RX_CRC_USE"), "FALSE"))
            return Unconnected(pin, false);
        return Outcome::Port;
    }
    if (IsAny(name, {"TXCHARISK", "TXKERR"}) && s.txUsed) {
        if (!s.encUsed && (Is(s.primName, "GT_CUSTOM") || s.gt10 || s.gt11))
            return Unconnected(pin, true);
        return Outcome::Port;
    }
    if (Is(name, "TXENC8B10BUSE") && s.txUsed && (s.gt10 || s.gt11)) {
        if (!s.encUsed)
            return Tied(pin, 0);
        if (!s.encDynamic)
            return Tied(pin, s.encStatic8b10b ? 1 : 0);
        return Outcome::Port;
    }

    // 25, 26: the data pins the 10-bit buses wire.
    if (IsAny(name, {"TXDATA", "TXCHARDISPVAL", "TXCHARDISPMODE"}) &&
        (s.pageBypass || (!s.encUsed && !s.gt11)))
        return Outcome::Done;
    if (IsAny(name, {"RXDATA", "RXCHARISK", "RXRUNDISP"}) &&
        (s.pageBypass || (!s.decUsed && !s.gt11)))
        return Outcome::Done;

    // 27, 28: the 64B/66B controls; dynamic coding goes on to the later rules.
    for (const bool tx : {true, false}) {
        const bool listed =
            tx ? m_page.IsInTx64b66bPinList(name) : m_page.IsInRx64b66bPinList(name);
        if (!listed || !(s.gt10 || s.gt11) || !(tx ? s.txUsed : s.rxUsed))
            continue;
        const bool used = tx ? s.encUsed : s.decUsed;
        const bool dynamic = tx ? s.encDynamic : s.decDynamic;
        const bool is8b10b = tx ? s.encStatic8b10b : s.decStatic8b10b;
        if (!used)
            return Tied(pin, 0);
        if (!dynamic)
            return Tied(pin, is8b10b ? 0 : 1);
    }

    // 29 to 32: the pins of an unused direction.
    const bool customOrLater = s.CustomOrLater();
    if (Rx29Names(name) && !s.rxUsed && !s.pcsBypassed && customOrLater)
        return Unconnected(pin, true);
    if (Tx30Names(name) && !s.txUsed && !s.pcsBypassed && customOrLater)
        return Unconnected(pin, true);
    const bool custom = Is(s.primName, "GT_CUSTOM");
    if (Rx29Names(name) && !s.rxUsed && !custom)
        return Unconnected(pin, true);
    if (Tx30Names(name) && !s.txUsed && !custom)
        return Unconnected(pin, true);

    // 33: what XAUI does not have.
    if (s.xaui &&
        IsAny(name, {"RXLOSSOFSYNC", "RXRUNDISP", "TXRUNDISP", "RXCRCOUT", "TXCRCOUT", "RXMCLK"})) {
        pin->ClearAllConnections();
        m_page.RestorePinWidth(pin);
        return Outcome::Done;
    }

    // 34 to 36: the GT11 width codes.
    if (IsAny(name, {"RXDATAWIDTH", "TXDATAWIDTH"}) && s.gt11)
        return DataWidthCode(pin);
    const bool ownTie = !pin->GetAttributeValue("QVZ_PIN_TIE").IsEmpty();
    if (Is(name, "TXINTDATAWIDTH") && s.gt11 && !ownTie)
        return IntDataWidth(pin, s.encDynamic, s.encUsed, s.encStatic8b10b);
    if (Is(name, "RXINTDATAWIDTH") && s.gt11 && !ownTie)
        return IntDataWidth(pin, s.decDynamic, s.decUsed, s.decStatic8b10b);

    // 37
    return Outcome::Port;
}

} // namespace

bool Qvz_MGTGeneralSetup::DecidePins(Qvz_Block* block) {
    Qvz_WizData* data = m_pWizData;
    Settings s;
    s.primName = Qvz_MGTWizMain::GetBlkPrimName(block);
    s.gt = m_isGT;
    s.gt10 = m_isGT10;
    s.gt11 = m_isGT11;
    s.pageBypass = m_bypassPcs;

    if (m_isGT) {
        const StringBase vSel = block->GetAttributeValue("REF_CLK_V_SEL");
        s.refClkUsed = !Is(vSel, "1");
        s.bRefClkUsed = !Is(vSel, "0");
    } else if (m_isGT10) {
        s.refClkUsed = !Is(block->GetAttributeValue("QVZX_ONLY_USE_REFCLK"), "FALSE");
        s.bRefClkUsed = !Is(block->GetAttributeValue("QVZX_ONLY_USE_BREFCLK"), "FALSE");
    } else if (m_isGT11) {
        s.xaui =
            block->GetAttributeValue("MGT_DISPLAY_NAME").GetIndexOfString("XAUI", CompareSearch) !=
            StringBase::npos;
        // The bus between the two transceivers of a GT11 tile.
        block->AddPin("COMBUSIN", "IN")->SetWidth(16);
        block->AddPin("COMBUSOUT", "OUT")->SetWidth(16);
    }

    s.gt11Dual = Is(block->GetAttributeValue("QVZ_GT11_MODE"), "DUAL");
    ReadCoding(block->GetAttributeValue("QVZX_ONLY_ENCODING"),
               block->GetAttributeValue("QVZX_ONLY_ENC_STATIC"), s.encUsed, s.encDynamic,
               s.encStatic8b10b);
    s.refClkStatic = Is(block->GetAttributeValue("QVZX_ONLY_REFCLK_DYN"), "STATIC");
    s.bRefClkStatic = Is(block->GetAttributeValue("QVZX_ONLY_BREFCLK_DYN"), "STATIC");
    s.refClk2 = Is(block->GetAttributeValue("QVZX_ONLY_REFCLK"), "REFCLK2");
    s.bRefClk2 = Is(block->GetAttributeValue("QVZX_ONLY_BREFCLK"), "BREFCLK2");
    s.pmaEnabled = Is(block->GetAttributeValue("QVZX_ONLY_ENABLE_PMA"), "TRUE");
    s.pcsBypassed = Is(block->GetAttributeValue("QVZX_ONLY_BYPASS_PCS"), "TRUE");

    Qvz_MGTWizMain::ClearPinSigBitAttrs(block);

    s.rxUsed = !Is(block->GetAttributeValue("QVZ_BOOL_RX_USE"), "FALSE");
    s.txUsed = !Is(block->GetAttributeValue("QVZ_BOOL_TX_USE"), "FALSE");
    s.dataWidth =
        DataWidthBytes(block->GetAttributeValue(m_isGT ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH"));
    ReadCoding(block->GetAttributeValue("QVZX_ONLY_DECODING"),
               block->GetAttributeValue("QVZX_ONLY_DEC_STATIC"), s.decUsed, s.decDynamic,
               s.decStatic8b10b);
    s.txCrc = Is(block->GetAttributeValue("TX_CRC_USE"), "TRUE") ||
              Is(block->GetAttributeValue("QVZ_TXCRC_USE"), "TRUE");
    s.rxCrc = Is(block->GetAttributeValue("QVZ_RXCRC_USE"), "TRUE");
    // A negative count bonds nothing.
    s.bondNumber = std::max(0, UT_STR::AToI(block->GetAttributeValue("QVZ_CHAN_BOND_NUMBER")));
    if (IsAny(block->GetAttributeValue("CHAN_BOND_MODE"), {"OFF", "NONE"}))
        s.bondNumber = 0;
    if (!s.rxUsed) {
        block->SetAttributeValue("QVZ_CHAN_BOND_NUMBER", "0");
        s.bondNumber = 0;
    }

    const bool commaRules = Is(s.primName, "GT_CUSTOM") || m_isGT10;
    const bool commaOff = Is(block->GetAttributeValue("QVZX_ONLY_TURNOFF_COMMA"), "TRUE");
    const StringBase pCommaCtrl = block->GetAttributeValue("QVZX_ONLY_PCOMMA_CTRL");
    const StringBase mCommaCtrl = block->GetAttributeValue("QVZX_ONLY_MCOMMA_CTRL");

    PinRules rules(*this, data, block, s);
    for (const auto& owned : block->GetPins()) {
        Qvz_Pin* pin = owned.get();
        pin->SetIsUsed(true);
        const StringBase& name = pin->GetName();
        bool port = rules.Decide(pin) == Outcome::Port;

        if (commaRules) {
            if (!commaOff) {
                const StringBase* ctrl = Is(name, "ENPCOMMAALIGN")   ? &pCommaCtrl
                                         : Is(name, "ENMCOMMAALIGN") ? &mCommaCtrl
                                                                     : nullptr;
                if (ctrl && (Is(*ctrl, "ALWAYS") || Is(*ctrl, "DISABLE"))) {
                    Tie(pin, Is(*ctrl, "ALWAYS") ? 1 : 0);
                    port = false;
                }
            } else if (InList(m_commaPins, name)) {
                if (Is(pin->GetDirection(), "IN")) {
                    Tie(pin, 0);
                    port = false;
                } else if (Is(pin->GetDirection(), "OUT")) {
                    RestorePinWidth(pin);
                    pin->ClearAllConnections();
                    port = false;
                }
            }
        }
        if (Is(name, "RXCLKCORCNT") && Is(block->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "0") &&
            !Is(block->GetAttributeValue("CLK_CORRECT_USE"), "TRUE")) {
            pin->ClearAllConnections();
            continue;
        }
        if (port && !Is(pin->GetAttributeValue("QVZ_PIN_VCC_IN_DATAFILE"), "TRUE") &&
            !Is(pin->GetAttributeValue("QVZ_PIN_GND_IN_DATAFILE"), "TRUE") &&
            pin->GetAttributeValue("QVZ_PIN_TIE").IsEmpty())
            MakePinPort(pin, s.dataWidth);
    }

    if (m_bypassPcs || (!s.encUsed && !m_isGT11))
        BuildTxTenBitBus(block);
    if (m_bypassPcs || (!s.decUsed && !m_isGT11))
        BuildRxTenBitBus(block);

    GroundFloatingInputs(block);

    if (s.bondNumber >= 2 || m_isGT11) {
        auto* bonding =
            m_pWizMain
                ? dynamic_cast<Qvz_MGTRCB*>(m_pWizMain->m_pPages[Qvz_MGTWizMain::kChannelBonding])
                : nullptr;
        if (!bonding) {
            IssueMessage("Internal Error:  Qvz_MGTRCB page pointer is null\n", false, false, false);
            return false;
        }
        bonding->GenerateBondedInstances(block, s.gt11Dual, s.bondNumber);
    }
    return true;
}
