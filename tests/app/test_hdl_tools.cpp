// Every transceiver type of every sample target, at each of its widths and
// bonded where the target offers it, configured in a batch run: the generated
// Verilog, with black-box stubs of the primitives made here from the same
// design data, must compile and elaborate with Icarus Verilog and pass
// Verilator's lint; the VHDL must analyse and elaborate with GHDL.

#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QJsonArray>
#include <QProcess>
#include <QRegularExpression>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <map>
#include <vector>

namespace {

struct Config {
    QString target, type, width;
    int bond = 0;
    QString Label() const {
        return QString("%1 \"%2\" width %3 bond %4").arg(target, type, width).arg(bond);
    }
};

// Types and widths as the targets offer them, found from the data.
std::vector<Config> Configs() {
    std::vector<Config> out;
    for (const QString target : {"gt", "gt10", "gt11"}) {
        Qvz_WizData d;
        QString err;
        if (!Qvz_DesignJson::LoadFile(QString(VELOMUX_TARGETS) + "/" + target + ".json", d, err))
            continue;
        const int maxBond = d.Target().supportsGT11   ? d.Target().maxBondGT11
                            : d.Target().supportsGT10 ? d.Target().maxBondGT10
                                                      : d.Target().maxBondGT;
        std::map<QString, QStringList> widths;
        QStringList order;
        for (const auto& b : d.GetBlocks()) {
            const QString type = b->GetAttributeValue("MGT_DISPLAY_NAME").ToQString();
            if (type.isEmpty())
                continue;
            if (!widths.count(type))
                order << type;
            const Qvz_Attribute* w =
                b->GetNamedAttribute(b->SupportsMGT3() ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH");
            if (w)
                for (const auto& v : w->GetLegalValues().Items())
                    if (!widths[type].contains(v.ToQString()))
                        widths[type] << v.ToQString();
        }
        for (const QString& type : order) {
            for (const QString& w : widths[type])
                out.push_back({target, type, w, 0});
            if (maxBond >= 2 && !widths[type].isEmpty())
                out.push_back({target, type, widths[type].last(), maxBond});
        }
    }
    return out;
}

enum class Kind { Integer, Vector, String };

// The documented typing rule, restated from the outside.
Kind KindOf(const Qvz_Attribute& a) {
    const QString v = a.GetValue().ToQString();
    if (QRegularExpression("^[0-9]+'[bBhH][0-9A-Fa-f]+$").match(v).hasMatch())
        return Kind::Vector;
    if (QRegularExpression("^[01]{2,}$").match(v).hasMatch() &&
        (v.startsWith('0') || a.GetLegalValues().IsEmpty()))
        return Kind::Vector;
    if (QRegularExpression("^-?[0-9]{1,9}$").match(v).hasMatch())
        return Kind::Integer;
    return Kind::String;
}

bool Hidden(const QString& name) {
    return name == "MGT_DISPLAY_NAME" || name == "LOC" || name.startsWith("QVZ_") ||
           name.startsWith("QVZX_ONLY_");
}

// Black boxes of the primitives the used blocks name: their parameters and
// pins; VHDL inputs default to 0 the way library primitives do.
void WriteStubs(const Qvz_WizData& d, const QString& vPath, const QString& vhdPath) {
    struct Prim {
        std::vector<std::pair<QString, Kind>> params;
        std::vector<const Qvz_Pin*> pins;
    };
    std::map<QString, Prim> prims;
    QStringList order;
    for (const auto& b : d.GetBlocks()) {
        if (!b->IsUsed())
            continue;
        const QString name = b->GetPrimitiveName().ToQString();
        if (!prims.count(name))
            order << name;
        Prim& p = prims[name];
        for (const auto& a : b->GetAttributes()) {
            const QString an = a->GetName().ToQString();
            if (Hidden(an))
                continue;
            auto it = std::find_if(p.params.begin(), p.params.end(),
                                   [&](const auto& x) { return x.first == an; });
            if (it == p.params.end())
                p.params.push_back({an, KindOf(*a)});
            else if (it->second != KindOf(*a))
                it->second = Kind::String;
        }
        if (p.pins.empty())
            for (const auto& pin : b->GetPins())
                p.pins.push_back(pin.get());
    }
    QString v, h;
    for (const QString& name : order) {
        const Prim& p = prims[name];
        QStringList params, ports, generics, vports;
        for (const auto& [pn, kind] : p.params) {
            params << QString("    parameter %1 = 0").arg(pn);
            generics << QString("    %1 : %2")
                            .arg(pn, kind == Kind::Integer  ? "integer"
                                     : kind == Kind::Vector ? "bit_vector"
                                                            : "string");
        }
        for (const Qvz_Pin* pin : p.pins) {
            const QString dir = pin->GetDirection().ToQString();
            const int w = pin->GetWidth();
            const QString vdir = dir == "IN" ? "input" : dir == "OUT" ? "output" : "inout";
            ports << QString("    %1 wire %2%3")
                         .arg(vdir, w > 1 ? QString("[%1:0] ").arg(w - 1) : "",
                              pin->GetName().ToQString());
            const QString type =
                w > 1 ? QString("std_logic_vector(%1 downto 0)").arg(w - 1) : "std_logic";
            const QString def =
                dir == "IN" ? (w > 1 ? " := (others => '0')" : " := '0'") : QString();
            vports << QString("    %1 : %2 %3%4")
                          .arg(pin->GetName().ToQString(),
                               dir == "IN"    ? "in"
                               : dir == "OUT" ? "out"
                                              : "inout",
                               type, def);
        }
        v += QString("module %1 #(\n%2\n) (\n%3\n);\nendmodule\n\n")
                 .arg(name, params.join(",\n"), ports.join(",\n"));
        h += QString("library ieee;\nuse ieee.std_logic_1164.all;\nentity %1 is\n").arg(name);
        if (!generics.isEmpty())
            h += QString("  generic (\n%1\n  );\n").arg(generics.join(";\n"));
        h += QString("  port (\n%1\n  );\nend entity %2;\n\narchitecture stub of %2 is\nbegin\nend "
                     "architecture stub;\n\n")
                 .arg(vports.join(";\n"), name);
    }
    WriteAll(vPath, v.toUtf8());
    WriteAll(vhdPath, h.toUtf8());
}

struct ToolResult {
    bool ok = false;
    QString log;
};

ToolResult RunTool(const QString& dir, const QString& program, const QStringList& args) {
    QProcess p;
    p.setWorkingDirectory(dir);
    p.setProcessChannelMode(QProcess::MergedChannels);
    p.start(program, args);
    const bool finished = p.waitForFinished(120000);
    ToolResult r;
    r.log = QString::fromUtf8(p.readAll());
    // Warnings count as failures: the output must come through clean.
    r.ok = finished && p.exitStatus() == QProcess::NormalExit && p.exitCode() == 0 &&
           !r.log.contains("arning");
    return r;
}

// Compiles top.v/top.vhd with the stubs made from design; empty when clean.
QString CheckWithTools(const QString& dir, const QString& design, const QString& top) {
    Qvz_WizData d;
    QString err;
    if (!Qvz_DesignJson::LoadFile(design, d, err))
        return err;
    WriteStubs(d, dir + "/stubs.v", dir + "/stubs.vhd");
    const struct {
        const char* program;
        QStringList args;
    } steps[] = {
        {"iverilog", {"-g2005", "-o", "sim.out", "-s", top, "stubs.v", "top.v"}},
        {"verilator", {"--lint-only", "--top-module", top, "stubs.v", "top.v"}},
        {"ghdl", {"-a", "--std=93c", "stubs.vhd", "top.vhd"}},
        {"ghdl", {"-e", "--std=93c", top}},
    };
    for (const auto& s : steps) {
        const ToolResult r = RunTool(dir, s.program, s.args);
        if (!r.ok)
            return QString("%1 %2:\n%3").arg(s.program, s.args.join(' '), r.log.left(3000));
    }
    return QString();
}

bool HaveTools(QString& missing) {
    for (const char* t : {"iverilog", "verilator", "ghdl"})
        if (QStandardPaths::findExecutable(t).isEmpty())
            missing += QString(" ") + t;
    return missing.isEmpty();
}

} // namespace

TEST(HdlTools, EveryTypeOfEveryTargetCompiles) {
    QString missing;
    if (!HaveTools(missing))
        GTEST_SKIP() << "HDL tools not installed (scripts/setup.sh installs them):"
                     << missing.toStdString();
    const std::vector<Config> configs = Configs();
    ASSERT_GE(configs.size(), 30u);
    int bonded = 0, withPorts = 0;
    for (const Config& c : configs) {
        SCOPED_TRACE(c.Label().toStdString());
        QTemporaryDir tmp;
        const HostResult r =
            RunHost({"--batch", "--target", c.target, "--type", c.type, "--width", c.width, "--set",
                     QString("QVZ_CHAN_BOND_NUMBER=%1").arg(c.bond), "-o",
                     tmp.filePath("design.json"), "--verilog", tmp.filePath("top.v"), "--vhdl",
                     tmp.filePath("top.vhd"), "--module", "top"});
        ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
        const QString verilog = ReadAll(tmp.filePath("top.v"));
        bonded += verilog.count("(* LOC = ") > 1;
        withPorts += verilog.contains("module top (");
        const QString fault = CheckWithTools(tmp.path(), tmp.filePath("design.json"), "top");
        EXPECT_TRUE(fault.isEmpty()) << fault.toStdString();
    }
    // Until the finish routine decides the pins, runs leave few ports and no copies.
    RecordProperty("bonded_configurations", bonded);
    RecordProperty("configurations_with_ports", withPorts);
}

TEST(HdlTools, HandWrittenFinishedDesignCompiles) {
    QString missing;
    if (!HaveTools(missing))
        GTEST_SKIP() << "HDL tools not installed:" << missing.toStdString();
    QTemporaryDir tmp;
    const QString design = TestData("hdl/finished_bonded.json");
    const HostResult r = RunHost({"--check", design, "--verilog", tmp.filePath("top.v"), "--vhdl",
                                  tmp.filePath("top.vhd"), "--module", "top"});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    const QString fault = CheckWithTools(tmp.path(), design, "top");
    EXPECT_TRUE(fault.isEmpty()) << fault.toStdString();
}
