#include "Qvz_Summary.h"

#include <QStringList>

namespace {

QString DirectionOf(const Qvz_Pin& pin) {
    if (pin.GetDirection() == "IN")
        return "in";
    if (pin.GetDirection() == "OUT")
        return "out";
    return "inout";
}

} // namespace

Qvz_Summary Qvz_Summary::Of(const Qvz_WizData& data) {
    Qvz_Summary s;
    const Qvz_Block* active = data.GetActiveBlock();
    if (!active)
        return s;
    s.hasBlock = true;
    s.instance = active->GetName().ToQString();
    s.primitive = active->GetPrimitiveName().ToQString();
    StringBase type = active->GetAttributeValue("MGT_DISPLAY_NAME");
    if (type.IsEmpty())
        type = active->GetAttributeValue("QVZ_OLD_DISPLAY_NAME");
    s.type = type.ToQString();
    s.dataWidth = active->GetAttributeValue(active->SupportsMGT3() ? "RX_DATA_WIDTH"
                                                                   : "QVZ_RX_DATA_WIDTH")
                      .ToQString();
    for (const auto& pin : active->GetPins()) {
        if (pin->IsGrounded() || pin->IsVcc()) {
            s.ties.push_back({pin->GetName().ToQString(), pin->IsVcc() ? 1 : 0});
        } else if (pin->HasPinSigBitProp()) {
            s.bitMapped.push_back(pin->GetName().ToQString());
        } else if (!pin->GetSigName().IsEmpty()) {
            const Qvz_Signal* sig = data.GetNamedSignal(pin->GetSigName());
            if (sig && sig->IsExternal())
                s.ports.push_back({pin->GetName().ToQString(), sig->GetName().ToQString(),
                                   DirectionOf(*pin), pin->GetWidth()});
        }
    }
    for (const auto& sig : data.GetSignals())
        if (sig->IsUsed() && !sig->IsExternal())
            s.internals.push_back(sig->GetName().ToQString());
    for (const auto& b : data.GetBlocks())
        if (b->IsUsed() && b.get() != active)
            s.copies.push_back({b->GetName().ToQString(), b->GetAttributeValue("LOC").ToQString(),
                                b->GetAttributeValue("CHAN_BOND_MODE").ToQString()});
    return s;
}

QString Qvz_Summary::ToText(bool brief) const {
    if (!hasBlock)
        return "No transceiver block is active.\n";
    QStringList lines;
    lines << QString("Primitive:     %1 (instance %2)").arg(primitive, instance);
    lines << QString("Type:          %1").arg(type);
    lines << QString("Data width:    %1 byte(s)").arg(dataWidth);
    lines << QString("Ports:         %1").arg(ports.size());
    if (!brief)
        for (const auto& p : ports)
            lines << QString("  %1 %2 -> %3 (%4 bit%5)")
                         .arg(p.direction, -5)
                         .arg(p.pin, p.signal)
                         .arg(p.width)
                         .arg(p.width == 1 ? "" : "s");
    lines << QString("Tied pins:     %1").arg(ties.size());
    if (!brief)
        for (const auto& t : ties)
            lines << QString("  %1 = %2").arg(t.pin).arg(t.level);
    if (!bitMapped.empty())
        lines << QString("Bit-wise:      %1").arg(QStringList(bitMapped.begin(), bitMapped.end()).join(", "));
    if (!brief && !internals.empty())
        lines << QString("Internal signals: %1")
                     .arg(QStringList(internals.begin(), internals.end()).join(", "));
    lines << QString("Bonded copies: %1").arg(copies.size());
    if (!brief)
        for (const auto& c : copies)
            lines << QString("  %1 %2 %3").arg(c.name, c.loc, c.role).trimmed();
    return lines.join('\n') + '\n';
}
