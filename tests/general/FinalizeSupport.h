#pragma once
// A one-block design with a General Setup page on it, for the finish tests,
// and a readable account of what a pin ended as.

#include "GeneralSupport.h"

#include <QString>
#include <QStringList>

#include <memory>
#include <string>

// "KEY=VALUE;KEY=VALUE" into the pairs (values may be empty).
inline std::vector<std::pair<std::string, std::string>> Pairs(const char* text) {
    std::vector<std::pair<std::string, std::string>> out;
    for (const QString& item : QString(text).split(';', Qt::SkipEmptyParts)) {
        const int eq = item.indexOf('=');
        out.emplace_back(item.left(eq).trimmed().toStdString(),
                         eq < 0 ? std::string() : item.mid(eq + 1).toStdString());
    }
    return out;
}

// What a pin is connected to, e.g. "port TXDATA_IN/16", "tie 0",
// "wire CHANBOND_M_S1_OUT/5", "maps 1_1=GNDa[0:0],0_0=VCCa[0:0]",
// "unconnected"; several parts joined with " + ".
inline std::string Describe(const Qvz_WizData& data, const Qvz_Pin* pin) {
    if (!pin)
        return "no pin";
    QStringList parts;
    if (pin->IsGrounded())
        parts << "tie 0";
    if (pin->IsVcc())
        parts << "tie 1";
    if (!pin->GetSigName().IsEmpty()) {
        const Qvz_Signal* s = data.GetNamedSignal(pin->GetSigName());
        if (!s)
            parts << "dangling " + pin->GetSigName().ToQString();
        else
            parts << QString("%1 %2/%3")
                         .arg(s->IsExternal() ? "port" : "wire", s->GetName().ToQString())
                         .arg(s->GetWidth());
    }
    QStringList maps;
    const QString prefix = Qvz_Pin::kBitMapPrefix;
    for (const auto& a : pin->GetAttributes())
        if (Qvz_Pin::IsBitMapName(a.name))
            maps << a.name.ToQString().mid(prefix.size()) + "=" + a.value.ToQString();
    if (!maps.isEmpty())
        parts << "maps " + maps.join(',');
    return parts.isEmpty() ? "unconnected" : parts.join(" + ").toStdString();
}

// One active block of a family (with the data-width attribute at "4" unless
// the settings give it) and a General Setup page constructed on it.
struct FinishBench {
    std::unique_ptr<Design> design;
    Qvz_Block* block = nullptr;
    std::unique_ptr<Qvz_MGTGeneralSetup> page;

    // settings: block attributes, plus "prim=NAME" for the primitive and
    // "display=NAME" for MGT_DISPLAY_NAME.
    FinishBench(Qvz_Family family, const char* settings) {
        design = std::make_unique<Design>(family == Qvz_Family::GT, family == Qvz_Family::GT10,
                                          family == Qvz_Family::GT11);
        std::string prim = family == Qvz_Family::GT     ? "GT_CUSTOM"
                           : family == Qvz_Family::GT10 ? "GT10_CUSTOM"
                                                        : "GT11_CUSTOM";
        const char* widthAttr = family == Qvz_Family::GT ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH";
        const auto pairs = Pairs(settings);
        for (const auto& kv : pairs)
            if (kv.first == "prim")
                prim = kv.second;
        block = design->Block("XCVR_INST", prim.c_str(), nullptr, widthAttr, "4", true);
        for (const auto& kv : pairs) {
            if (kv.first == "prim")
                continue;
            const std::string name = kv.first == "display" ? "MGT_DISPLAY_NAME" : kv.first;
            block->SetAttributeValue(name.c_str(), kv.second.c_str());
        }
    }

    // Pins are given as "NAME", "NAME/DIR", "NAME/DIR/WIDTH" or
    // "NAME/DIR/WIDTH/dw" (the width follows the data width).
    Qvz_Pin* AddPin(const char* pinText) {
        const QStringList f = QString(pinText).split('/');
        Qvz_Pin* p = block->AddPin(StringBase::FromQString(f[0]),
                                   f.size() > 1 ? StringBase::FromQString(f[1]) : "IN");
        p->SetWidth(f.size() > 2 ? f[2].toInt() : 1);
        p->SetSupportsDataWidth(f.size() > 3 && f[3] == "dw");
        return p;
    }

    // The page reads the block as it stands now.
    Qvz_MGTGeneralSetup& Page() {
        if (!page)
            page = std::make_unique<Qvz_MGTGeneralSetup>(&design->Main());
        return *page;
    }

    Qvz_WizData& Data() { return design->data; }
    std::string Of(const char* pin) { return Describe(Data(), block->GetNamedPin(pin)); }
};
