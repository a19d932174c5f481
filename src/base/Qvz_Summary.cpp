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
    s.dataWidth =
        active->GetAttributeValue(active->SupportsMGT3() ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH")
            .ToQString();
    s.loc = active->GetAttributeValue("LOC").ToQString();
    s.role = active->GetAttributeValue("CHAN_BOND_MODE").ToQString();
    for (const auto& pin : active->GetPins()) {
        if (pin->IsGrounded() || pin->IsVcc()) {
            s.ties.push_back({pin->GetName().ToQString(), pin->IsVcc() ? 1 : 0});
        } else if (pin->HasPinSigBitProp()) {
            s.bitMapped.push_back(pin->GetName().ToQString());
        } else if (!pin->GetSigName().IsEmpty()) {
            const Qvz_Signal* sig = data.GetNamedSignal(pin->GetSigName());
            // The port is as wide as its signal (a 64-bit pin may use 32 bits).
            Port p{pin->GetName().ToQString(), pin->GetSigName().ToQString(), DirectionOf(*pin),
                   sig ? sig->GetWidth() : pin->GetWidth()};
            (sig && sig->IsExternal() ? s.ports : s.wired).push_back(p);
        } else {
            s.unconnected.push_back(pin->GetName().ToQString());
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
    if (!loc.isEmpty())
        lines << QString("Placement:     %1").arg(loc);
    if (!role.isEmpty())
        lines << QString("Bonding role:  %1").arg(role);
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
        lines << QString("Bit-wise:      %1")
                     .arg(QStringList(bitMapped.begin(), bitMapped.end()).join(", "));
    if (!wired.empty())
        lines << QString("Internal pins: %1").arg(wired.size());
    if (!brief)
        for (const auto& w : wired)
            lines << QString("  %1 -> %2").arg(w.pin, w.signal);
    lines << QString("Unconnected:   %1").arg(unconnected.size());
    if (!brief && !unconnected.empty())
        lines << "  " + QStringList(unconnected.begin(), unconnected.end()).join(", ");
    if (!brief && !internals.empty())
        lines << QString("Internal signals: %1")
                     .arg(QStringList(internals.begin(), internals.end()).join(", "));
    // The copies are few and each becomes an instance of its own in the
    // generated design, so even the short form names them.
    lines << QString("Bonded copies: %1").arg(copies.size());
    for (const auto& c : copies) {
        QStringList parts{c.name, c.loc, c.role};
        parts.removeAll(QString()); // unplaced copies have no LOC
        lines << "  " + parts.join(' ');
    }
    return lines.join('\n') + '\n';
}

namespace {

QString Cell(const QString& text) {
    return "<td>" + text.toHtmlEscaped() + "</td>";
}

QString Heading(const QString& text, std::size_t count) {
    return QString("<h3>%1 (%2)</h3>").arg(text.toHtmlEscaped()).arg(count);
}

} // namespace

QString Qvz_Summary::ToHtml(bool finished) const {
    if (!hasBlock)
        return "<p>No transceiver block is active.</p>";
    QString h;
    h += "<style>td, th { padding: 2px 10px 2px 0; } th { text-align: left; }"
         " h3 { margin-top: 14px; margin-bottom: 4px; }</style>";
    h += "<table>";
    const auto row = [&h](const QString& label, const QString& value) {
        h += "<tr><th>" + label.toHtmlEscaped() + "</th>" + Cell(value) + "</tr>";
    };
    row("Instance", instance);
    row("Primitive", primitive);
    row("Transceiver type", type.isEmpty() ? QString("(none)") : type);
    row("Data width", dataWidth + " byte(s)");
    if (!loc.isEmpty())
        row("Placement", loc);
    if (!role.isEmpty())
        row("Bonding role", role);
    h += "</table>";
    if (!finished) {
        h += "<p><b>The ports, pins and bonded copies could not be completed.</b></p>";
        return h;
    }

    h += Heading("Ports", ports.size());
    if (ports.empty()) {
        h += "<p>None.</p>";
    } else {
        h += "<table><tr><th>Pin</th><th>Signal</th><th>Direction</th><th>Width</th></tr>";
        for (const auto& p : ports)
            h += "<tr>" + Cell(p.pin) + Cell(p.signal) + Cell(p.direction) +
                 Cell(QString::number(p.width)) + "</tr>";
        h += "</table>";
    }
    h += Heading("Tied pins", ties.size());
    if (ties.empty()) {
        h += "<p>None.</p>";
    } else {
        QStringList zero, one;
        for (const auto& t : ties)
            (t.level ? one : zero) << t.pin;
        h += "<table>";
        if (!zero.isEmpty())
            row("Tied to 0", zero.join(", "));
        if (!one.isEmpty())
            row("Tied to 1", one.join(", "));
        h += "</table>";
    }
    if (!bitMapped.empty()) {
        h += Heading("Pins wired bit by bit", bitMapped.size());
        h += "<p>" + QStringList(bitMapped.begin(), bitMapped.end()).join(", ").toHtmlEscaped() +
             "</p>";
    }
    if (!wired.empty()) {
        h += Heading("Pins on internal signals", wired.size());
        h += "<table><tr><th>Pin</th><th>Signal</th></tr>";
        for (const auto& w : wired)
            h += "<tr>" + Cell(w.pin) + Cell(w.signal) + "</tr>";
        h += "</table>";
    }
    h += Heading("Unconnected pins", unconnected.size());
    h += unconnected.empty()
             ? QString("<p>None.</p>")
             : "<p>" +
                   QStringList(unconnected.begin(), unconnected.end()).join(", ").toHtmlEscaped() +
                   "</p>";
    h += Heading("Internal signals", internals.size());
    h += internals.empty()
             ? QString("<p>None.</p>")
             : "<p>" + QStringList(internals.begin(), internals.end()).join(", ").toHtmlEscaped() +
                   "</p>";
    h += Heading("Bonded copies", copies.size());
    if (copies.empty()) {
        h += "<p>None.</p>";
    } else {
        h += "<table><tr><th>Instance</th><th>Placement</th><th>Bonding role</th></tr>";
        for (const auto& c : copies)
            h += "<tr>" + Cell(c.name) + Cell(c.loc) + Cell(c.role) + "</tr>";
        h += "</table>";
    }
    return h;
}
