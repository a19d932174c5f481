#include "HdlWriter.h"

#include "Qvz_Summary.h"

#include <QRegularExpression>
#include <QSet>
#include <QStringList>

#include <algorithm>
#include <climits>
#include <cstring>
#include <map>
#include <vector>

namespace VelomuxHost {

const char* const kDefaultModuleName = "velomux_xcvr";

namespace {

// Verilog-2005 and SystemVerilog-2017 keywords (linters read .v files as the
// latter), VHDL-2008 reserved words, and the library and type names the VHDL
// text itself uses. Compared without case, since VHDL ignores it.
const char* const kKeywords[] = {
    // Verilog / SystemVerilog
    "accept_on", "alias", "always", "always_comb", "always_ff", "always_latch", "and", "assert",
    "assign", "assume", "automatic", "before", "begin", "bind", "bins", "binsof", "bit", "break",
    "buf", "bufif0", "bufif1", "byte", "case", "casex", "casez", "cell", "chandle", "checker",
    "class", "clocking", "cmos", "config", "const", "constraint", "context", "continue", "cover",
    "covergroup", "coverpoint", "cross", "deassign", "default", "defparam", "design", "disable",
    "dist", "do", "edge", "else", "end", "endcase", "endchecker", "endclass", "endclocking",
    "endconfig", "endfunction", "endgenerate", "endgroup", "endinterface", "endmodule",
    "endpackage", "endprimitive", "endprogram", "endproperty", "endspecify", "endsequence",
    "endtable", "endtask", "enum", "event", "eventually", "expect", "export", "extends", "extern",
    "final", "first_match", "for", "force", "foreach", "forever", "fork", "forkjoin", "function",
    "generate", "genvar", "global", "highz0", "highz1", "if", "iff", "ifnone", "ignore_bins",
    "illegal_bins", "implements", "implies", "import", "incdir", "include", "initial", "inout",
    "input", "inside", "instance", "int", "integer", "interconnect", "interface", "intersect",
    "join", "join_any", "join_none", "large", "let", "liblist", "library", "local", "localparam",
    "logic", "longint", "macromodule", "matches", "medium", "modport", "module", "nand", "negedge",
    "nettype", "new", "nexttime", "nmos", "nor", "noshowcancelled", "not", "notif0", "notif1",
    "null", "or", "output", "package", "packed", "parameter", "pmos", "posedge", "primitive",
    "priority", "program", "property", "protected", "pull0", "pull1", "pulldown", "pullup",
    "pulsestyle_ondetect", "pulsestyle_onevent", "pure", "rand", "randc", "randcase",
    "randsequence", "rcmos", "real", "realtime", "ref", "reg", "reject_on", "release", "repeat",
    "restrict", "return", "rnmos", "rpmos", "rtran", "rtranif0", "rtranif1", "s_always",
    "s_eventually", "s_nexttime", "s_until", "s_until_with", "scalared", "sequence", "shortint",
    "shortreal", "showcancelled", "signed", "small", "soft", "solve", "specify", "specparam",
    "static", "string", "strong", "strong0", "strong1", "struct", "super", "supply0", "supply1",
    "sync_accept_on", "sync_reject_on", "table", "tagged", "task", "this", "throughout", "time",
    "timeprecision", "timeunit", "tran", "tranif0", "tranif1", "tri", "tri0", "tri1", "triand",
    "trior", "trireg", "type", "typedef", "union", "unique", "unique0", "unsigned", "until",
    "until_with", "untyped", "use", "uwire", "var", "vectored", "virtual", "void", "wait",
    "wait_order", "wand", "weak", "weak0", "weak1", "while", "wildcard", "wire", "with", "within",
    "wor", "xnor", "xor",
    // VHDL
    "abs", "access", "after", "all", "architecture", "array", "attribute", "block", "body",
    "buffer", "bus", "component", "configuration", "constant", "context", "downto", "elsif",
    "entity", "exit", "fairness", "file", "group", "guarded", "impure", "in", "inertial", "is",
    "label", "linkage", "literal", "loop", "map", "mod", "next", "of", "on", "open", "others",
    "out", "parameter", "port", "postponed", "procedure", "process", "protected", "range", "record",
    "register", "reject", "rem", "report", "rol", "ror", "select", "severity", "shared", "signal",
    "sla", "sll", "sra", "srl", "strong", "subtype", "then", "to", "transport", "units", "variable",
    "vmode", "vprop", "vunit", "when",
    // names the VHDL text uses
    "ieee", "std", "work", "std_logic_1164", "std_logic", "std_ulogic", "std_logic_vector",
    "std_ulogic_vector", "bit_vector", "boolean", "natural", "positive", "character", "structure"};

const QSet<QString>& Keywords() {
    static const QSet<QString> set = [] {
        QSet<QString> s;
        for (const char* k : kKeywords)
            s.insert(QString::fromLatin1(k));
        return s;
    }();
    return set;
}

bool IsKeyword(const QString& name) {
    return Keywords().contains(name.toLower());
}

bool HasPlainShape(const QString& name) {
    static const QRegularExpression re("^[A-Za-z][A-Za-z0-9]*(_[A-Za-z0-9]+)*$");
    return re.match(name).hasMatch();
}

QString Q(const StringBase& s) {
    return s.ToQString();
}

// Names of the generated module share one space in both languages (VHDL
// ignores case), so every name is given out here, once.
class Namer {
public:
    // Takes name exactly; false when it is no safe identifier or is taken.
    bool Take(const QString& name) {
        if (!IsHdlIdentifier(name) || m_taken.contains(name.toLower()))
            return false;
        m_taken.insert(name.toLower());
        return true;
    }
    // A free name as close to wanted as the rules allow; the change is noted.
    QString Fresh(const QString& wanted, const QString& what) {
        if (Take(wanted))
            return wanted;
        QString base;
        for (QChar c : wanted)
            base += (c.isLetterOrNumber() && c.unicode() < 128) || c == '_' ? c : QChar('_');
        base.replace(QRegularExpression("_+"), "_");
        while (base.startsWith('_'))
            base.remove(0, 1);
        while (base.endsWith('_'))
            base.chop(1);
        if (base.isEmpty() || !base.at(0).isLetter())
            base.prepend("n_");
        QString name = base;
        for (int k = 1; !Take(name); ++k)
            name = base + "_" + QString::number(k);
        if (!what.isEmpty())
            m_renamed << QString("%1 \"%2\" -> %3").arg(what, Printable(wanted), name);
        return name;
    }
    const QStringList& Renamed() const { return m_renamed; }

    // Text safe inside a one-line comment.
    static QString Printable(const QString& text) {
        QString s;
        for (QChar c : text)
            s += c.unicode() < 32 || c.unicode() == 127 ? QChar(' ') : c;
        return s;
    }

private:
    QSet<QString> m_taken;
    QStringList m_renamed;
};

enum class ParamType { Integer, Vector, String };

struct ParamValue {
    QString name;
    QString text; // the attribute's value
    ParamType type = ParamType::String;
    QString bits; // Vector: the bits, most significant first
    QString vlog; // Vector: the sized literal for Verilog
};

// The typing rule: a sized literal (N'b..., N'h...) whose value fits N bits is
// a vector; so is a bare string of 0s and 1s of two or more digits that begins
// with 0 or belongs to an attribute with no legal values (bit patterns are
// kept that way); other decimal numbers in the 32-bit range are integers;
// everything else is a string.
ParamValue TypeOf(const Qvz_Attribute& a) {
    ParamValue v;
    v.name = Q(a.GetName());
    v.text = Q(a.GetValue());
    static const QRegularExpression sized("^([0-9]+)'([bBhH])([0-9A-Fa-f]+)$");
    static const QRegularExpression digits("^-?[0-9]+$");
    const QRegularExpressionMatch m = sized.match(v.text);
    if (m.hasMatch()) {
        const int size = UT_STR::AToI(m.captured(1).toStdString().c_str());
        const bool hex = m.captured(2).toLower() == "h";
        QString bits;
        bool ok = size >= 1 && size <= 65536;
        for (QChar c : m.captured(3)) {
            if (!ok)
                break;
            const int d = QString(c).toInt(&ok, 16);
            if (!hex && d > 1)
                ok = false;
            bits += hex ? QString::number(d, 2).rightJustified(4, '0') : QString(c);
        }
        if (ok) {
            // Bits above the size must be zero, else the literal lies about its value.
            const int extra = int(bits.size()) - size;
            if (extra > 0 && bits.left(extra).contains('1'))
                ok = false;
            else if (extra > 0)
                bits = bits.mid(extra);
            else
                bits = bits.rightJustified(size, '0');
        }
        if (ok) {
            v.type = ParamType::Vector;
            v.bits = bits;
            v.vlog = v.text;
        }
        return v;
    }
    if (!digits.match(v.text).hasMatch())
        return v;
    static const QRegularExpression binary("^[01]{2,}$");
    if (binary.match(v.text).hasMatch() &&
        (v.text.startsWith('0') || a.GetLegalValues().IsEmpty())) {
        v.type = ParamType::Vector;
        v.bits = v.text;
        v.vlog = QString("%1'b%2").arg(v.text.size()).arg(v.text);
        return v;
    }
    bool ok = false;
    const long long n = v.text.toLongLong(&ok);
    // VHDL guarantees integers down to -(2**31 - 1) only.
    if (ok && v.text.size() <= 12 && n >= -INT_MAX && n <= INT_MAX)
        v.type = ParamType::Integer;
    return v;
}

struct Net {
    enum Kind { Port, Wire, Const0, Const1 };
    QString name;
    QString vhdlName; // differs for an output port read inside (VHDL-93 cannot)
    int width = 1;
    bool vector = false;
    Kind kind = Wire;
    QString dir; // ports: "in", "out" or "inout"; "" until known
    bool driven = false, read = false, bidir = false;
};

struct Piece {
    enum Kind { Bits, Zero, One };
    int pinHi = 0, pinLo = 0;
    Kind kind = Zero;
    int net = -1;
    int sigHi = 0, sigLo = 0;
    int Width() const { return pinHi - pinLo + 1; }
};

struct PinConn {
    QString name;
    int width = 1;
    QString dir;               // "in", "out", "inout"
    std::vector<Piece> pieces; // highest pin bits first; empty: open
};

struct Inst {
    QString name;
    QString primitive;
    QString loc;
    std::vector<ParamValue> params;
    std::vector<PinConn> pins;
};

struct CompParam {
    QString name;
    ParamType type = ParamType::Integer;
    ParamValue first;
    int count = 0;
};

struct CompPort {
    QString name;
    QString dir;
    int width = 1;
    int connected = 0; // instances that connect it
};

struct Component {
    QString primitive;
    int instances = 0;
    std::vector<CompParam> params;
    std::vector<CompPort> ports;
};

struct Design {
    QString module;
    QString version;
    Qvz_Summary summary;
    std::vector<Net> nets;
    std::vector<Inst> insts;
    std::vector<Component> comps;
    QStringList renamed;
    bool anyLoc = false;
};

QString PinDir(const Qvz_Pin& pin) {
    if (pin.GetDirection() == "IN")
        return "in";
    if (pin.GetDirection() == "OUT")
        return "out";
    return "inout";
}

bool SkipAttribute(const StringBase& name) {
    return name == "MGT_DISPLAY_NAME" || name == "LOC" ||
           name.GetIndexOfString("QVZ_", Port::CompareSearch) == 0 ||
           name.GetIndexOfString("QVZX_ONLY_", Port::CompareSearch) == 0;
}

bool IsPrintableAscii(const QString& s) {
    for (QChar c : s)
        if (c.unicode() < 32 || c.unicode() > 126)
            return false;
    return true;
}

// Reads "N" as a non-negative decimal without sign or blanks.
bool ReadIndex(const QString& s, int& out) {
    static const QRegularExpression re("^[0-9]{1,9}$");
    if (!re.match(s).hasMatch())
        return false;
    out = s.toInt();
    return true;
}

class Builder {
public:
    Builder(const Qvz_WizData& data, Design& d, QString& error)
        : m_data(data), m_d(d), m_error(error) {}

    bool Build(const QString& module) {
        for (const auto& b : m_data.GetBlocks())
            if (b->IsUsed())
                m_blocks.push_back(b.get());
        if (m_blocks.empty())
            return Fail("the design data has no used block; there is nothing to generate");
        m_d.summary = Qvz_Summary::Of(m_data);

        if (!module.isEmpty()) {
            if (!m_names.Take(module))
                return Fail(QString("\"%1\" cannot name the top module").arg(module));
            m_d.module = module;
        } else {
            const QString file = Q(m_data.Target().fileName);
            m_d.module = m_names.Fresh(file.isEmpty() ? kDefaultModuleName : file,
                                       file.isEmpty() ? "" : "module");
        }
        if (!CheckPrimitives())
            return false;
        for (const Qvz_Block* b : m_blocks)
            if (!b->GetAttributeValue("LOC").IsEmpty())
                m_d.anyLoc = true;
        if (m_d.anyLoc && !m_names.Take("LOC"))
            return Fail("the top module cannot be named LOC when instances are placed");
        if (!CollectNets() || !NameEverything())
            return false;
        for (std::size_t i = 0; i < m_blocks.size(); ++i)
            if (!BuildInstance(*m_blocks[i], m_d.insts[i]))
                return false;
        SettleDirections();
        if (!BuildComponents())
            return false;
        m_d.renamed = m_names.Renamed();
        return true;
    }

private:
    bool Fail(const QString& text) {
        m_error = text;
        return false;
    }

    // Primitive, pin and attribute names are the library's: they must stand
    // as they are, so anything unsafe is an error rather than a rename.
    bool CheckPrimitives() {
        QSet<QString> seen;
        for (const Qvz_Block* b : m_blocks) {
            const QString prim = Q(b->GetPrimitiveName());
            if (seen.contains(prim))
                continue;
            seen.insert(prim);
            if (!m_names.Take(prim))
                return Fail(QString("primitive \"%1\" cannot be written as a module name (not an "
                                    "identifier in both languages, or taken)")
                                .arg(prim));
        }
        for (const Qvz_Block* b : m_blocks) {
            QSet<QString> inBlock;
            auto check = [&](const QString& name, const char* what) {
                if (!IsHdlIdentifier(name))
                    return Fail(QString("block %1: %2 \"%3\" is not an identifier in both "
                                        "languages")
                                    .arg(Q(b->GetName()), what, name));
                if (inBlock.contains(name.toLower()))
                    return Fail(QString("block %1: %2 \"%3\" clashes with another name that "
                                        "differs only in case")
                                    .arg(Q(b->GetName()), what, name));
                inBlock.insert(name.toLower());
                return true;
            };
            for (const auto& a : b->GetAttributes())
                if (!SkipAttribute(a->GetName()) && !check(Q(a->GetName()), "attribute"))
                    return false;
            for (const auto& p : b->GetPins())
                if (!check(Q(p->GetName()), "pin"))
                    return false;
        }
        return true;
    }

    const Qvz_Signal* Signal(const StringBase& name) const { return m_data.GetNamedSignal(name); }

    // Used signals, and any signal a used block's pin refers to.
    bool CollectNets() {
        QSet<QString> referenced;
        for (const Qvz_Block* b : m_blocks)
            for (const auto& p : b->GetPins()) {
                if (p->IsGrounded() || p->IsVcc())
                    continue;
                if (p->HasPinSigBitProp()) {
                    for (const auto& nv : p->GetAttributes())
                        if (Qvz_Pin::IsBitMapName(nv.name)) {
                            const QString v = Q(nv.value);
                            referenced.insert(v.left(v.indexOf('[')));
                        }
                } else if (!p->GetSigName().IsEmpty()) {
                    referenced.insert(Q(p->GetSigName()));
                }
            }
        for (const auto& s : m_data.GetSignals()) {
            if (!s->IsUsed() && !referenced.contains(Q(s->GetName())))
                continue;
            if (s->IsConst0() && s->IsConst1())
                return Fail(
                    QString("signal %1 is both constant 0 and constant 1").arg(Q(s->GetName())));
            Net n;
            n.width = std::max(1, s->GetWidth());
            n.vector = s->IsBus() || n.width > 1;
            if (s->IsConst0())
                n.kind = Net::Const0;
            else if (s->IsConst1())
                n.kind = Net::Const1;
            else if (s->IsExternal())
                n.kind = Net::Port;
            if (n.kind == Net::Port) {
                if (s->GetDirection() == "I")
                    n.dir = "in";
                else if (s->GetDirection() == "O")
                    n.dir = "out";
                else if (s->GetDirection() == "B")
                    n.dir = "inout";
            }
            m_netOf[Q(s->GetName())] = int(m_d.nets.size());
            m_sigOf.push_back(s.get());
            m_d.nets.push_back(n);
        }
        return true;
    }

    // Signals and instances keep their names where they can; the rest are
    // renamed after every keepable name is taken, so a rename never pushes a
    // later, valid name aside.
    bool NameEverything() {
        m_d.insts.resize(m_blocks.size());
        std::vector<bool> netDone(m_d.nets.size()), instDone(m_blocks.size());
        for (std::size_t i = 0; i < m_d.nets.size(); ++i)
            if ((netDone[i] = m_names.Take(Q(m_sigOf[i]->GetName()))))
                m_d.nets[i].name = Q(m_sigOf[i]->GetName());
        for (std::size_t i = 0; i < m_blocks.size(); ++i)
            if ((instDone[i] = m_names.Take(Q(m_blocks[i]->GetName()))))
                m_d.insts[i].name = Q(m_blocks[i]->GetName());
        for (std::size_t i = 0; i < m_d.nets.size(); ++i)
            if (!netDone[i])
                m_d.nets[i].name = m_names.Fresh(Q(m_sigOf[i]->GetName()), "signal");
        for (std::size_t i = 0; i < m_blocks.size(); ++i)
            if (!instDone[i])
                m_d.insts[i].name = m_names.Fresh(Q(m_blocks[i]->GetName()), "instance");
        for (Net& n : m_d.nets)
            n.vhdlName = n.name;
        return true;
    }

    bool PinFail(const Qvz_Block& b, const Qvz_Pin& p, const QString& what) {
        return Fail(QString("block %1, pin %2: %3").arg(Q(b.GetName()), Q(p.GetName()), what));
    }

    bool BuildInstance(const Qvz_Block& b, Inst& inst) {
        inst.primitive = Q(b.GetPrimitiveName());
        inst.loc = Q(b.GetAttributeValue("LOC"));
        if (!IsPrintableAscii(inst.loc))
            return Fail(QString("block %1: LOC \"%2\" has characters that cannot be written")
                            .arg(Q(b.GetName()), Nm(inst.loc)));
        for (const auto& a : b.GetAttributes()) {
            if (SkipAttribute(a->GetName()))
                continue;
            ParamValue v = TypeOf(*a);
            if (!IsPrintableAscii(v.text))
                return Fail(QString("block %1: the value of attribute %2 has characters that "
                                    "cannot be written in a string")
                                .arg(Q(b.GetName()), v.name));
            inst.params.push_back(v);
        }
        for (const auto& p : b.GetPins()) {
            PinConn c;
            c.name = Q(p->GetName());
            c.width = std::max(1, p->GetWidth());
            c.dir = PinDir(*p);
            if (!Connect(b, *p, inst.name, c))
                return false;
            inst.pins.push_back(c);
        }
        return true;
    }

    static QString Nm(const QString& s) { return Namer::Printable(s); }

    // Decides what feeds each bit of the pin: a tie, its bit maps, its
    // signal (all of it, or the low bits BUS_ONLY_USE_BITS names), or nothing.
    bool Connect(const Qvz_Block& b, const Qvz_Pin& p, const QString& instName, PinConn& c) {
        const bool input = c.dir == "in";
        if (p.IsVcc() || p.IsGrounded()) {
            // A constant cannot drive an output or bidirectional pin.
            if (input)
                c.pieces.push_back({c.width - 1, 0, p.IsVcc() ? Piece::One : Piece::Zero});
            return true;
        }
        std::vector<Piece> got;
        if (p.HasPinSigBitProp()) {
            static const QRegularExpression value("^(.+)\\[([0-9]+):([0-9]+)\\]$");
            const int prefix = int(std::strlen(Qvz_Pin::kBitMapPrefix));
            for (const auto& nv : p.GetAttributes()) {
                if (!Qvz_Pin::IsBitMapName(nv.name))
                    continue;
                const QString range = Q(nv.name).mid(prefix);
                const QStringList hl = range.split('_');
                Piece pc;
                pc.kind = Piece::Bits;
                const QRegularExpressionMatch m = value.match(Q(nv.value));
                if (hl.size() != 2 || !ReadIndex(hl[0], pc.pinHi) || !ReadIndex(hl[1], pc.pinLo) ||
                    !m.hasMatch() || !ReadIndex(m.captured(2), pc.sigHi) ||
                    !ReadIndex(m.captured(3), pc.sigLo))
                    return PinFail(b, p,
                                   QString("bit map %1 = \"%2\" is not of the form "
                                           "%3<high>_<low> = <signal>[<high>:<low>]")
                                       .arg(Q(nv.name), Nm(Q(nv.value)), Qvz_Pin::kBitMapPrefix));
                const auto net = m_netOf.find(m.captured(1));
                if (net == m_netOf.end())
                    return PinFail(b, p,
                                   QString("bit map %1 names signal \"%2\", which the "
                                           "design data does not have")
                                       .arg(Q(nv.name), Nm(m.captured(1))));
                pc.net = net->second;
                if (pc.pinHi < pc.pinLo || pc.sigHi < pc.sigLo ||
                    pc.pinHi - pc.pinLo != pc.sigHi - pc.sigLo)
                    return PinFail(b, p,
                                   QString("bit map %1 = %2: the two ranges must run "
                                           "downward and be equally wide")
                                       .arg(Q(nv.name), Nm(Q(nv.value))));
                if (pc.pinHi >= c.width)
                    return PinFail(b, p,
                                   QString("bit map %1 reaches past the pin's %2 bit(s)")
                                       .arg(Q(nv.name))
                                       .arg(c.width));
                if (pc.sigHi >= m_d.nets[std::size_t(pc.net)].width)
                    return PinFail(b, p,
                                   QString("bit map %1 = %2 reaches past the signal's %3 "
                                           "bit(s)")
                                       .arg(Q(nv.name), Nm(Q(nv.value)))
                                       .arg(m_d.nets[std::size_t(pc.net)].width));
                got.push_back(pc);
            }
            std::sort(got.begin(), got.end(),
                      [](const Piece& x, const Piece& y) { return x.pinLo > y.pinLo; });
            for (std::size_t i = 1; i < got.size(); ++i)
                if (got[i].pinHi >= got[i - 1].pinLo)
                    return PinFail(b, p,
                                   QString("two bit maps cover pin bit %1").arg(got[i - 1].pinLo));
        } else if (!p.GetSigName().IsEmpty()) {
            const auto net = m_netOf.find(Q(p.GetSigName()));
            if (net == m_netOf.end())
                return PinFail(b, p,
                               QString("its signal \"%1\" is not in the design data")
                                   .arg(Nm(Q(p.GetSigName()))));
            const Qvz_Signal& sig = *m_sigOf[std::size_t(net->second)];
            int bits = std::min(c.width, m_d.nets[std::size_t(net->second)].width);
            const StringBase only = sig.GetAttributeValue("BUS_ONLY_USE_BITS");
            if (!only.IsEmpty() && UT_STR::AToI(only) > 0)
                bits = std::min(bits, UT_STR::AToI(only));
            got.push_back({bits - 1, 0, Piece::Bits, net->second, bits - 1, 0});
        } else {
            return true; // open
        }
        for (const Piece& pc : got) {
            Net& n = m_d.nets[std::size_t(pc.net)];
            n.driven = n.driven || c.dir != "in";
            n.read = n.read || c.dir != "out";
            n.bidir = n.bidir || c.dir == "inout";
        }
        // Bits no map covers: inputs read 0, outputs go to a spare net.
        std::vector<Piece> all;
        int next = c.width - 1;
        std::vector<std::pair<int, int>> gaps;
        auto gap = [&](int hi, int lo) {
            if (input) {
                all.push_back({hi, lo, Piece::Zero});
            } else {
                gaps.push_back({hi, lo});
                all.push_back({hi, lo, Piece::Bits, -1});
            }
        };
        for (const Piece& pc : got) {
            if (pc.pinHi < next)
                gap(next, pc.pinHi + 1);
            all.push_back(pc);
            next = pc.pinLo - 1;
        }
        if (next >= 0)
            gap(next, 0);
        if (!gaps.empty()) {
            int spare = 0;
            for (const auto& g : gaps)
                spare += g.first - g.second + 1;
            Net n;
            n.name = n.vhdlName = m_names.Fresh(instName + "_" + c.name + "_open", "");
            n.width = spare;
            n.vector = spare > 1;
            n.driven = true;
            const int index = int(m_d.nets.size());
            m_d.nets.push_back(n);
            int top = spare - 1;
            for (Piece& pc : all)
                if (pc.kind == Piece::Bits && pc.net == -1) {
                    pc.net = index;
                    pc.sigHi = top;
                    pc.sigLo = top - pc.Width() + 1;
                    top = pc.sigLo - 1;
                }
        }
        c.pieces = all;
        return true;
    }

    // Ports without a direction code take it from the pins on them; VHDL-93
    // cannot read an output port, so one read inside gets an inner copy.
    void SettleDirections() {
        for (Net& n : m_d.nets) {
            if (n.kind != Net::Port)
                continue;
            if (n.dir.isEmpty())
                n.dir = n.bidir ? "inout" : n.driven ? "out" : "in";
            if (n.dir == "out" && n.read)
                n.vhdlName = m_names.Fresh(n.name + "_int", "");
        }
    }

    bool BuildComponents() {
        std::map<QString, std::size_t> index;
        for (const Inst& inst : m_d.insts) {
            auto it = index.find(inst.primitive);
            if (it == index.end()) {
                it = index.emplace(inst.primitive, m_d.comps.size()).first;
                m_d.comps.push_back(Component{inst.primitive, 0, {}, {}});
            }
            Component& comp = m_d.comps[it->second];
            ++comp.instances;
            for (const ParamValue& v : inst.params) {
                auto p = std::find_if(comp.params.begin(), comp.params.end(),
                                      [&](const CompParam& x) { return x.name == v.name; });
                if (p == comp.params.end()) {
                    comp.params.push_back({v.name, v.type, v, 1});
                } else {
                    ++p->count;
                    if (p->type != v.type)
                        p->type = ParamType::String;
                }
            }
            for (const PinConn& c : inst.pins) {
                auto p = std::find_if(comp.ports.begin(), comp.ports.end(),
                                      [&](const CompPort& x) { return x.name == c.name; });
                if (p == comp.ports.end()) {
                    comp.ports.push_back({c.name, c.dir, c.width});
                    p = comp.ports.end() - 1;
                } else if (p->dir != c.dir || p->width != c.width) {
                    return Fail(QString("instance %1: pin %2 of %3 differs in direction or width "
                                        "from the same pin of another instance")
                                    .arg(inst.name, c.name, inst.primitive));
                }
                if (!c.pieces.empty())
                    ++p->connected;
            }
        }
        return true;
    }

    const Qvz_WizData& m_data;
    Design& m_d;
    QString& m_error;
    Namer m_names;
    std::vector<const Qvz_Block*> m_blocks;
    std::vector<const Qvz_Signal*> m_sigOf;
    std::map<QString, int> m_netOf;
};

// ------------------------------------------------------------------ writing

QString Pad(const QString& s, int n) {
    return s.leftJustified(n, ' ');
}

ParamType TypeIn(const Design& d, const QString& primitive, const QString& param) {
    for (const Component& c : d.comps)
        if (c.primitive == primitive)
            for (const CompParam& p : c.params)
                if (p.name == param)
                    return p.type;
    return ParamType::String;
}

QStringList HeaderLines(const Design& d, const QString& what) {
    QStringList l;
    l << QString("%1 generated by velomux-wizard %2.").arg(what, d.version);
    l << QString("Transceiver type: %1, data width: %2 byte(s).")
             .arg(Namer::Printable(d.summary.type.isEmpty() ? "(none)" : d.summary.type),
                  Namer::Printable(d.summary.dataWidth.isEmpty() ? "?" : d.summary.dataWidth));
    QStringList prims;
    for (const Component& c : d.comps)
        prims << QString("%1 x%2").arg(c.primitive).arg(c.instances);
    l << QString("Instances: %1.").arg(prims.join(", "));
    l << "Generated from the design data; change that and generate again rather than editing.";
    for (const QString& r : d.renamed)
        l << "Renamed: " + r;
    return l;
}

// --- Verilog

QString VlogString(const QString& s) {
    QString o = "\"";
    for (QChar c : s) {
        if (c == '\\' || c == '"')
            o += '\\';
        o += c;
    }
    return o + "\"";
}

QString VlogParam(const ParamValue& v, ParamType type) {
    if (type == ParamType::Integer)
        return v.text;
    if (type == ParamType::Vector)
        return v.vlog;
    return VlogString(v.text);
}

QString VlogConst(int width, bool one) {
    const QString bit = one ? "1'b1" : "1'b0";
    return width == 1 ? bit : QString("{%1{%2}}").arg(width).arg(bit);
}

QString VlogBits(const Net& n, int hi, int lo) {
    if (!n.vector || (lo == 0 && hi == n.width - 1 && n.width > 1))
        return n.name;
    if (hi == lo)
        return QString("%1[%2]").arg(n.name).arg(hi);
    return QString("%1[%2:%3]").arg(n.name).arg(hi).arg(lo);
}

QString VlogRange(const Net& n) {
    return n.vector ? QString("[%1:0]").arg(n.width - 1) : QString();
}

QString VlogPiece(const Design& d, const Piece& pc) {
    if (pc.kind == Piece::Bits)
        return VlogBits(d.nets[std::size_t(pc.net)], pc.sigHi, pc.sigLo);
    return VlogConst(pc.Width(), pc.kind == Piece::One);
}

QString VlogConnection(const Design& d, const PinConn& c) {
    if (c.pieces.empty())
        return QString();
    if (c.pieces.size() == 1)
        return VlogPiece(d, c.pieces.front());
    QStringList parts;
    for (const Piece& pc : c.pieces)
        parts << VlogPiece(d, pc);
    return "{" + parts.join(", ") + "}";
}

QByteArray WriteVerilog(const Design& d) {
    QString t;
    for (const QString& l : HeaderLines(d, "Verilog wrapper"))
        t += "// " + l + "\n";
    t += "\n`default_nettype none\n\n";

    std::vector<const Net*> ports, wires, consts;
    for (const Net& n : d.nets)
        (n.kind == Net::Port ? ports : n.kind == Net::Wire ? wires : consts).push_back(&n);

    int rangeWidth = 0;
    for (const Net* n : ports)
        rangeWidth = std::max(rangeWidth, int(VlogRange(*n).size()));
    if (ports.empty()) {
        t += QString("module %1;\n").arg(d.module);
    } else {
        t += QString("module %1 (\n").arg(d.module);
        for (std::size_t i = 0; i < ports.size(); ++i) {
            const Net& n = *ports[i];
            const QString dir = n.dir == "in" ? "input" : n.dir == "out" ? "output" : "inout";
            QString line = QString("    %1 wire %2 %3")
                               .arg(Pad(dir, 6), Pad(VlogRange(n), rangeWidth), n.name);
            if (rangeWidth == 0)
                line = QString("    %1 wire %2").arg(Pad(dir, 6), n.name);
            t += line + (i + 1 < ports.size() ? ",\n" : "\n");
        }
        t += ");\n";
    }

    auto declare = [&](const std::vector<const Net*>& nets, const char* title) {
        if (nets.empty())
            return;
        int w = 0;
        for (const Net* n : nets)
            w = std::max(w, int(VlogRange(*n).size()));
        t += QString("\n    // %1\n").arg(title);
        for (const Net* n : nets)
            t += (w ? QString("    wire %1 %2;\n").arg(Pad(VlogRange(*n), w), n->name)
                    : QString("    wire %1;\n").arg(n->name));
    };
    declare(wires, "Internal signals");
    declare(consts, "Constants");
    for (const Net* n : consts)
        t += QString("    assign %1 = %2;\n")
                 .arg(n->name, VlogConst(n->width, n->kind == Net::Const1));

    for (const Inst& inst : d.insts) {
        t += "\n";
        if (!inst.loc.isEmpty())
            t += QString("    (* LOC = %1 *)\n").arg(VlogString(inst.loc));
        if (inst.params.empty()) {
            t += QString("    %1 %2 (\n").arg(inst.primitive, inst.name);
        } else {
            t += QString("    %1 #(\n").arg(inst.primitive);
            int w = 0;
            for (const ParamValue& v : inst.params)
                w = std::max(w, int(v.name.size()));
            for (std::size_t i = 0; i < inst.params.size(); ++i) {
                const ParamValue& v = inst.params[i];
                t += QString("        .%1 (%2)%3\n")
                         .arg(Pad(v.name, w), VlogParam(v, TypeIn(d, inst.primitive, v.name)),
                              i + 1 < inst.params.size() ? "," : "");
            }
            t += QString("    ) %1 (\n").arg(inst.name);
        }
        int w = 0;
        for (const PinConn& c : inst.pins)
            w = std::max(w, int(c.name.size()));
        for (std::size_t i = 0; i < inst.pins.size(); ++i) {
            const PinConn& c = inst.pins[i];
            t +=
                QString("        .%1 (%2)%3\n")
                    .arg(Pad(c.name, w), VlogConnection(d, c), i + 1 < inst.pins.size() ? "," : "");
        }
        t += "    );\n";
    }
    t += "\nendmodule\n\n`default_nettype wire\n";
    return t.toUtf8();
}

// --- VHDL

QString VhdlString(const QString& s) {
    QString o = "\"";
    for (QChar c : s) {
        if (c == '"')
            o += '"';
        o += c;
    }
    return o + "\"";
}

QString VhdlParam(const ParamValue& v, ParamType type) {
    if (type == ParamType::Integer)
        return v.text;
    if (type == ParamType::Vector)
        return "\"" + v.bits + "\"";
    return VhdlString(v.text);
}

const char* VhdlTypeName(ParamType t) {
    return t == ParamType::Integer ? "integer" : t == ParamType::Vector ? "bit_vector" : "string";
}

QString VhdlType(bool vector, int width) {
    return vector ? QString("std_logic_vector(%1 downto 0)").arg(width - 1) : QString("std_logic");
}

QString VhdlBits(const Net& n, int hi, int lo) {
    if (!n.vector)
        return n.vhdlName;
    if (hi == lo)
        return QString("%1(%2)").arg(n.vhdlName).arg(hi);
    if (lo == 0 && hi == n.width - 1)
        return n.vhdlName;
    return QString("%1(%2 downto %3)").arg(n.vhdlName).arg(hi).arg(lo);
}

QString VhdlConst(int width, bool one, bool whole) {
    const QChar bit = one ? '1' : '0';
    if (width == 1)
        return QString("'%1'").arg(bit);
    return whole ? QString("(others => '%1')").arg(bit) : "\"" + QString(width, bit) + "\"";
}

QString VhdlActual(const Design& d, const Piece& pc, bool whole) {
    if (pc.kind == Piece::Bits)
        return VhdlBits(d.nets[std::size_t(pc.net)], pc.sigHi, pc.sigLo);
    return VhdlConst(pc.Width(), pc.kind == Piece::One, whole);
}

// Formal and actual pairs of one pin: whole when one piece covers it, else
// one association per piece (VHDL-93 has no concatenated actuals).
std::vector<std::pair<QString, QString>> VhdlAssociations(const Design& d, const PinConn& c) {
    std::vector<std::pair<QString, QString>> out;
    if (c.pieces.empty()) {
        out.push_back({c.name, "open"});
        return out;
    }
    if (c.pieces.size() == 1) {
        out.push_back({c.name, VhdlActual(d, c.pieces.front(), true)});
        return out;
    }
    for (const Piece& pc : c.pieces) {
        const QString formal =
            pc.pinHi == pc.pinLo
                ? QString("%1(%2)").arg(c.name).arg(pc.pinHi)
                : QString("%1(%2 downto %3)").arg(c.name).arg(pc.pinHi).arg(pc.pinLo);
        out.push_back({formal, VhdlActual(d, pc, false)});
    }
    return out;
}

QByteArray WriteVhdl(const Design& d) {
    QString t;
    for (const QString& l : HeaderLines(d, "VHDL wrapper"))
        t += "-- " + l + "\n";
    t += "\nlibrary ieee;\nuse ieee.std_logic_1164.all;\n\n";

    std::vector<const Net*> ports, wires, consts;
    for (const Net& n : d.nets)
        (n.kind == Net::Port ? ports : n.kind == Net::Wire ? wires : consts).push_back(&n);

    t += QString("entity %1 is\n").arg(d.module);
    if (!ports.empty()) {
        int w = 0;
        for (const Net* n : ports)
            w = std::max(w, int(n->name.size()));
        t += "  port (\n";
        for (std::size_t i = 0; i < ports.size(); ++i) {
            const Net& n = *ports[i];
            t += QString("    %1 : %2 %3%4\n")
                     .arg(Pad(n.name, w), Pad(n.dir, 5), VhdlType(n.vector, n.width),
                          i + 1 < ports.size() ? ";" : "");
        }
        t += "  );\n";
    }
    t += QString("end entity %1;\n\n").arg(d.module);
    t += QString("architecture structure of %1 is\n").arg(d.module);

    for (const Component& c : d.comps) {
        t += QString("\n  component %1\n").arg(c.primitive);
        if (!c.params.empty()) {
            int w = 0;
            for (const CompParam& p : c.params)
                w = std::max(w, int(p.name.size()));
            t += "    generic (\n";
            for (std::size_t i = 0; i < c.params.size(); ++i) {
                const CompParam& p = c.params[i];
                // A generic some instance leaves out needs a default to fall back on.
                const QString def =
                    p.count < c.instances ? " := " + VhdlParam(p.first, p.type) : QString();
                t += QString("      %1 : %2%3%4\n")
                         .arg(Pad(p.name, w), VhdlTypeName(p.type), def,
                              i + 1 < c.params.size() ? ";" : "");
            }
            t += "    );\n";
        }
        if (!c.ports.empty()) {
            int w = 0;
            for (const CompPort& p : c.ports)
                w = std::max(w, int(p.name.size()));
            t += "    port (\n";
            for (std::size_t i = 0; i < c.ports.size(); ++i) {
                const CompPort& p = c.ports[i];
                // VHDL-93 refuses an open input without a default.
                const QString def = p.dir == "in" && p.connected < c.instances
                                        ? (p.width > 1 ? " := (others => '0')" : " := '0'")
                                        : "";
                t += QString("      %1 : %2 %3%4%5\n")
                         .arg(Pad(p.name, w), Pad(p.dir, 5), VhdlType(p.width > 1, p.width), def,
                              i + 1 < c.ports.size() ? ";" : "");
            }
            t += "    );\n";
        }
        t += "  end component;\n";
    }

    std::vector<const Net*> inner;
    for (const Net* n : ports)
        if (n->vhdlName != n->name)
            inner.push_back(n);
    int w = 0;
    for (const auto* list : {&wires, &consts, &inner})
        for (const Net* n : *list)
            w = std::max(w, int(n->vhdlName.size()));
    if (!wires.empty() || !consts.empty() || !inner.empty())
        t += "\n";
    for (const auto* list : {&inner, &wires, &consts})
        for (const Net* n : *list)
            t += QString("  signal %1 : %2;\n")
                     .arg(Pad(n->vhdlName, w), VhdlType(n->vector, n->width));

    if (d.anyLoc) {
        t += "\n  attribute LOC : string;\n";
        for (const Inst& inst : d.insts)
            if (!inst.loc.isEmpty())
                t += QString("  attribute LOC of %1 : label is %2;\n")
                         .arg(inst.name, VhdlString(inst.loc));
    }

    t += "\nbegin\n";
    if (!consts.empty() || !inner.empty())
        t += "\n";
    for (const Net* n : consts) {
        const QString bit = n->kind == Net::Const1 ? "'1'" : "'0'";
        t += QString("  %1 <= %2;\n").arg(n->vhdlName, n->vector ? "(others => " + bit + ")" : bit);
    }
    for (const Net* n : inner)
        t += QString("  %1 <= %2;\n").arg(n->name, n->vhdlName);

    for (const Inst& inst : d.insts) {
        t += QString("\n  %1 : %2\n").arg(inst.name, inst.primitive);
        if (!inst.params.empty()) {
            int pw = 0;
            for (const ParamValue& v : inst.params)
                pw = std::max(pw, int(v.name.size()));
            t += "    generic map (\n";
            for (std::size_t i = 0; i < inst.params.size(); ++i) {
                const ParamValue& v = inst.params[i];
                t += QString("      %1 => %2%3\n")
                         .arg(Pad(v.name, pw), VhdlParam(v, TypeIn(d, inst.primitive, v.name)),
                              i + 1 < inst.params.size() ? "," : "");
            }
            t += "    )\n";
        }
        std::vector<std::pair<QString, QString>> assoc;
        for (const PinConn& c : inst.pins)
            for (auto& a : VhdlAssociations(d, c))
                assoc.push_back(a);
        if (!assoc.empty()) {
            int aw = 0;
            for (const auto& a : assoc)
                aw = std::max(aw, int(a.first.size()));
            t += "    port map (\n";
            for (std::size_t i = 0; i < assoc.size(); ++i)
                t += QString("      %1 => %2%3\n")
                         .arg(Pad(assoc[i].first, aw), assoc[i].second,
                              i + 1 < assoc.size() ? "," : "");
            t += "    )";
        }
        t += ";\n";
    }
    t += QString("\nend architecture structure;\n");
    return t.toUtf8();
}

// --- constraints

QString SiteText(const QString& loc) {
    static const QRegularExpression plain("^[A-Za-z0-9_.:/\\[\\]-]+$");
    if (plain.match(loc).hasMatch())
        return loc;
    QString o = "\"";
    for (QChar c : loc) {
        if (c == '\\' || c == '"')
            o += '\\';
        o += c;
    }
    return o + "\"";
}

QByteArray WriteConstraints(const Design& d) {
    QString t;
    for (const QString& l : HeaderLines(d, "Placement constraints"))
        t += "# " + l + "\n";
    t += QString("# One line per placed instance of module %1: place <instance> <site>\n")
             .arg(d.module);
    int w = 0;
    for (const Inst& inst : d.insts)
        if (!inst.loc.isEmpty())
            w = std::max(w, int(inst.name.size()));
    for (const Inst& inst : d.insts)
        if (!inst.loc.isEmpty())
            t += QString("place %1 %2\n").arg(Pad(inst.name, w), SiteText(inst.loc));
    return t.toUtf8();
}

} // namespace

bool IsHdlIdentifier(const QString& name) {
    return HasPlainShape(name) && !IsKeyword(name);
}

bool GenerateHdl(const Qvz_WizData& data, const QString& module, const QString& version,
                 HdlTexts& out, QString& error) {
    Design d;
    d.version = version;
    Builder builder(data, d, error);
    if (!builder.Build(module))
        return false;
    out.verilog = WriteVerilog(d);
    out.vhdl = WriteVhdl(d);
    out.constraints = WriteConstraints(d);
    return true;
}

} // namespace VelomuxHost
