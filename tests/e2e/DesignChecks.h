#pragma once
// What finished design data must hold for a design generator to use it: the
// configured block and its bonded copies carry only legal attribute values,
// every pin is decided, and every port signal is as wide as its pins use it.
// Each check returns the faults it finds as readable lines.

#include "Qvz_WizData.h"

#include <QRegularExpression>
#include <QString>
#include <QStringList>

#include <algorithm>
#include <map>
#include <vector>

namespace DesignChecks {

// The blocks a generator instantiates: the active block first, then every
// other used block (the bonded copies).
inline std::vector<const Qvz_Block*> PlacedBlocks(const Qvz_WizData& d) {
    std::vector<const Qvz_Block*> blocks;
    const Qvz_Block* active = d.GetActiveBlock();
    if (!active)
        return blocks;
    blocks.push_back(active);
    for (const auto& b : d.GetBlocks())
        if (b->IsUsed() && b.get() != active)
            blocks.push_back(b.get());
    return blocks;
}

// "N'bDIGITS" with N binary digits, or "N'hDIGITS" whose hex digits hold just
// N bits (the 10-bit comma values take three digits).
inline bool IsSizedLiteral(const QString& v) {
    static const QRegularExpression re("^([0-9]+)'([bh])([0-9A-Fa-f]+)$");
    const QRegularExpressionMatch m = re.match(v);
    if (!m.hasMatch())
        return false;
    const int size = m.captured(1).toInt();
    const QString digits = m.captured(3);
    if (m.captured(2) == "b")
        return digits.count(QRegularExpression("[01]")) == digits.size() && size == digits.size();
    return size > 4 * (digits.size() - 1) && size <= 4 * digits.size();
}

inline bool IsLegalValue(const Qvz_Attribute& a) {
    const StringBase& v = a.GetValue();
    const QString text = v.ToQString();
    static const QRegularExpression decimal("^-?[0-9]+$");
    for (const StringBase& entry : a.GetLegalValues().Items()) {
        int low = 0, high = 0;
        if (Qvz_Attribute::GetRangeValues(entry, low, high)) {
            if (decimal.match(text).hasMatch() && UT_STR::AToI(v) >= low && UT_STR::AToI(v) <= high)
                return true;
        } else if (entry == v) {
            return true;
        }
    }
    return IsSizedLiteral(text);
}

inline QStringList IllegalAttributes(const Qvz_WizData& d) {
    QStringList faults;
    for (const Qvz_Block* b : PlacedBlocks(d))
        for (const auto& a : b->GetAttributes())
            if (!a->GetLegalValues().IsEmpty() && !IsLegalValue(*a))
                faults << QString("%1: %2 = \"%3\" is not legal")
                              .arg(b->GetName().ToQString(), a->GetName().ToQString(),
                                   a->GetValue().ToQString());
    return faults;
}

struct BitMap {
    QString signal;
    int pinHigh, pinLow, sigHigh, sigLow;
};

// The pin's bit maps; a map that cannot be read is reported in faults.
inline std::vector<BitMap> BitMapsOf(const Qvz_Pin& pin, const QString& where,
                                     QStringList& faults) {
    static const QRegularExpression nameRe("^QVZX_ONLY_PIN_SIG_BIT_([0-9]+)_([0-9]+)$");
    static const QRegularExpression valueRe("^([^\\[]+)\\[([0-9]+):([0-9]+)\\]$");
    std::vector<BitMap> maps;
    for (const Qvz_NameValue& nv : pin.GetAttributes()) {
        if (!Qvz_Pin::IsBitMapName(nv.name))
            continue;
        const QRegularExpressionMatch n = nameRe.match(nv.name.ToQString());
        const QRegularExpressionMatch v = valueRe.match(nv.value.ToQString());
        if (!n.hasMatch() || !v.hasMatch()) {
            faults << QString("%1: unreadable bit map %2 = %3")
                          .arg(where, nv.name.ToQString(), nv.value.ToQString());
            continue;
        }
        maps.push_back({v.captured(1), n.captured(1).toInt(), n.captured(2).toInt(),
                        v.captured(2).toInt(), v.captured(3).toInt()});
    }
    return maps;
}

// Every pin is tied, on a signal the design data has, wired bit by bit onto
// signals it has, or deliberately left open; only inputs may not be left
// open (a floating input is undefined in hardware). External signals in use
// have a direction and exactly the width their pins use.
inline QStringList UndecidedPinsAndBadPorts(const Qvz_WizData& d) {
    QStringList faults;
    struct Use {
        int width = 0;    // highest bit used + 1
        bool out = false; // driven by an output pin
        bool any = false;
    };
    std::map<QString, Use> uses;
    for (const Qvz_Block* b : PlacedBlocks(d)) {
        for (const auto& p : b->GetPins()) {
            const QString where = b->GetName().ToQString() + "." + p->GetName().ToQString();
            const bool in = p->GetDirection() == "IN";
            if (p->IsGrounded() && p->IsVcc())
                faults << where + ": tied to 0 and to 1";
            const std::vector<BitMap> maps = BitMapsOf(*p, where, faults);
            bool mapsOk = !maps.empty();
            std::vector<bool> covered(std::max(p->GetWidth(), 1), false);
            for (const BitMap& m : maps) {
                const Qvz_Signal* s = d.GetNamedSignal(StringBase::FromQString(m.signal));
                const QString map = QString("%1[%2:%3] -> %4[%5:%6]")
                                        .arg(where)
                                        .arg(m.pinHigh)
                                        .arg(m.pinLow)
                                        .arg(m.signal)
                                        .arg(m.sigHigh)
                                        .arg(m.sigLow);
                if (!s) {
                    faults << map + ": no such signal";
                    mapsOk = false;
                    continue;
                }
                if (m.pinHigh < m.pinLow || m.sigHigh < m.sigLow ||
                    m.pinHigh - m.pinLow != m.sigHigh - m.sigLow || m.pinHigh >= p->GetWidth() ||
                    m.sigHigh >= s->GetWidth()) {
                    faults << map + QString(": bits out of place (pin %1, signal %2 bits wide)")
                                        .arg(p->GetWidth())
                                        .arg(s->GetWidth());
                    mapsOk = false;
                    continue;
                }
                for (int bit = m.pinLow; bit <= m.pinHigh; ++bit) {
                    if (covered[bit])
                        faults << map + QString(": pin bit %1 mapped twice").arg(bit);
                    covered[bit] = true;
                }
                Use& u = uses[m.signal];
                u.any = true;
                u.width = std::max(u.width, m.sigHigh + 1);
                u.out = u.out || p->GetDirection() == "OUT";
            }
            if (!maps.empty() && in &&
                !std::all_of(covered.begin(), covered.end(), [](bool c) { return c; }))
                faults << where + ": input bits left out of its bit maps";

            const QString sigName = p->GetSigName().ToQString();
            bool onSignal = false;
            if (!sigName.isEmpty()) {
                const Qvz_Signal* s = d.GetNamedSignal(p->GetSigName());
                if (!s) {
                    faults << where + ": on signal " + sigName + ", which does not exist";
                } else {
                    onSignal = true;
                    // A copy's bit-mapped pin names one of its map signals;
                    // the maps say how it is used.
                    const bool named = std::any_of(maps.begin(), maps.end(), [&](const BitMap& m) {
                        return m.signal == sigName;
                    });
                    if (!named && !s->IsConst0() && !s->IsConst1()) {
                        Use& u = uses[sigName];
                        u.any = true;
                        int w = p->GetWidth();
                        const StringBase only = s->GetAttributeValue("BUS_ONLY_USE_BITS");
                        if (!only.IsEmpty()) {
                            const int n = UT_STR::AToI(only);
                            if (n < 1 || n > p->GetWidth())
                                faults << QString("%1: BUS_ONLY_USE_BITS %2 of %3 does not fit "
                                                  "the %4-bit pin")
                                              .arg(where, only.ToQString(), sigName)
                                              .arg(p->GetWidth());
                            else
                                w = n;
                        }
                        u.width = std::max(u.width, w);
                        u.out = u.out || p->GetDirection() == "OUT";
                    }
                }
            }
            const bool tied = p->IsGrounded() || p->IsVcc() ||
                              !p->GetAttributeValue("QVZ_PIN_TIE").IsEmpty() ||
                              p->GetAttributeValue("QVZ_PIN_GND_IN_DATAFILE") == "TRUE" ||
                              p->GetAttributeValue("QVZ_PIN_VCC_IN_DATAFILE") == "TRUE";
            if (in && !tied && !onSignal && !mapsOk)
                faults << where + ": input left floating";
        }
    }
    for (const auto& s : d.GetSignals()) {
        if (!s->IsUsed() || !s->IsExternal())
            continue;
        const QString name = s->GetName().ToQString();
        const QString dir = s->GetDirection().ToQString();
        if (dir != "I" && dir != "O" && dir != "B")
            faults << QString("port %1: direction \"%2\"").arg(name, dir);
        const auto it = uses.find(name);
        if (it == uses.end()) {
            faults << QString("port %1: no pin uses it").arg(name);
            continue;
        }
        if (it->second.width != s->GetWidth())
            faults << QString("port %1: %2 bits wide, its pins use %3")
                          .arg(name)
                          .arg(s->GetWidth())
                          .arg(it->second.width);
        if (dir == "I" && it->second.out)
            faults << QString("port %1: an input driven by an output pin").arg(name);
    }
    return faults;
}

inline QStringList AllFaults(const Qvz_WizData& d) {
    if (!d.GetActiveBlock())
        return {"no active block"};
    return IllegalAttributes(d) + UndecidedPinsAndBadPorts(d);
}

} // namespace DesignChecks
