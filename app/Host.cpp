#include "Host.h"

#include "HdlWriter.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTWizMain.h"
#include "Qvz_Summary.h"
#include "SafeWrite.h"

#include <QApplication>
#include <QCommandLineParser>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTextStream>

namespace VelomuxHost {
namespace {

const char* const kUsage =
    "Usage:\n"
    "  velomux-wizard [--batch] [--target NAME] [--type TYPE [--width N]] [--set NAME=VALUE]...\n"
    "                 [-o FILE] [--report FILE] [HDL OPTIONS] [DESIGN]\n"
    "  velomux-wizard --check [--target NAME] [-o FILE] [HDL OPTIONS] [DESIGN]\n"
    "  velomux-wizard --list-targets | --help | --version\n"
    "HDL OPTIONS: [--verilog FILE] [--vhdl FILE] [--constraints FILE] [--module NAME]\n";

const char* const kHelp =
    "Configures one multi-gigabit serial transceiver of an FPGA design: reads design data\n"
    "(library blocks of transceiver primitives), runs the configuration wizard on the active\n"
    "block, and writes the finished design data (attributes, ports, ties, signals and bonded\n"
    "copies) for a design generator.\n"
    "\n"
    "Arguments:\n"
    "  DESIGN               a design-data file (JSON). Without it, the embedded sample\n"
    "                       target named by --target is used.\n"
    "\n"
    "Options:\n"
    "  --batch              run without windows: every page checks and writes its settings,\n"
    "                       then the run finishes. Without it the wizard dialog opens.\n"
    "  --target NAME        embedded sample target to use without DESIGN (default gt10;\n"
    "                       see --list-targets).\n"
    "  --type TYPE          make the block of this transceiver type (MGT_DISPLAY_NAME) the\n"
    "                       active block before the run.\n"
    "  --width N            with --type: the data width in bytes (default 4).\n"
    "  --set NAME=VALUE     set an attribute of the active block before the run\n"
    "                       (repeatable, applied in order after --type).\n"
    "  -o, --output FILE    write the finished design data to FILE ('-' for standard\n"
    "                       output). Written only when the run completes, atomically.\n"
    "  --report FILE        write a JSON run report (outcome, failed page, messages).\n"
    "  --check              load and validate the design data, write it normalized to -o\n"
    "                       if given; run no page. With the HDL options it generates the\n"
    "                       design files from an already finished design.\n"
    "  --verilog FILE       write a Verilog wrapper that instantiates the configured\n"
    "                       transceiver(s): one port per external signal, ties, bit maps,\n"
    "                       attributes as parameters.\n"
    "  --vhdl FILE          write the same wrapper in VHDL (VHDL-93).\n"
    "  --constraints FILE   write the placement (LOC) of each placed instance.\n"
    "  --module NAME        name of the top module or entity (default: the target's file\n"
    "                       name, else velomux_xcvr).\n"
    "                       The design files are written like -o: only when the run\n"
    "                       completes, atomically.\n"
    "  --list-targets       list the embedded sample targets.\n"
    "  -h, --help           show this help.\n"
    "  -v, --version        show the version.\n"
    "\n"
    "Exit status: 0 completed, 1 refused or cancelled, 2 usage error, 3 input error,\n"
    "4 the output or the report could not be written, 129/130/143 ended by SIGHUP/SIGINT/\n"
    "SIGTERM (nothing more is written; a file being written is left as it was).\n"
    "\n"
    "Example:\n"
    "  velomux-wizard --batch --target gt10 --type \"10G Custom\" --width 4 \\\n"
    "      --set QVZ_CHAN_BOND_NUMBER=0 -o design.json --report run.json\n";

struct Target {
    const char* name;
    const char* description;
};
const Target kTargets[] = {
    {"gt", "a device with first-family (GT) transceivers"},
    {"gt10", "a device with GT10 transceivers"},
    {"gt11", "a device with GT11 transceiver pairs"},
};

QTextStream& Out() {
    static QTextStream s(stdout);
    return s;
}
QTextStream& Err() {
    static QTextStream s(stderr);
    return s;
}

int UsageError(const QString& message) {
    Err() << "velomux-wizard: " << message << "\n" << kUsage << "Try 'velomux-wizard --help'.\n";
    Err().flush();
    return kExitUsage;
}

int InputError(const QString& message) {
    Err() << "velomux-wizard: " << message << "\n";
    Err().flush();
    return kExitInput;
}

// Writes bytes to path atomically ('-': standard output). False leaves any
// earlier file at path as it was.
bool WriteAtomically(const QString& path, const QByteArray& bytes, QString& error) {
    // The summary so far goes out before anything written to standard output.
    Out().flush();
    return SafeWrite::WriteFile(path, bytes, error);
}

QByteArray ReportJson(Qvz_RunMode mode, int exitCode, const Qvz_WizMain& wiz) {
    QJsonObject o;
    o["format"] = "velomux-run-report";
    o["version"] = 1;
    o["mode"] = mode == Qvz_RunMode::Batch ? "batch" : "window";
    o["ok"] = exitCode == kExitCompleted;
    o["exit_code"] = exitCode;
    const auto failed = wiz.GetFailedPageTitle();
    o["failed_page"] = failed.IsEmpty() ? QJsonValue(QJsonValue::Null) : QJsonValue(failed.ToQString());
    QJsonArray messages;
    for (const auto& m : wiz.GetMessages()) {
        QJsonObject jm;
        jm["text"] = m.text.ToQString();
        jm["flags"] = QJsonArray{m.flag1, m.flag2, m.flag3};
        messages.append(jm);
    }
    o["messages"] = messages;
    return QJsonDocument(o).toJson(QJsonDocument::Indented);
}

struct Options {
    bool batch = false;
    bool check = false;
    QString target = "gt10";
    bool targetGiven = false;
    QString type;
    QString width = "4";
    bool widthGiven = false;
    QStringList sets;
    QString output;
    QString report;
    QString design;
    QString verilog;
    QString vhdl;
    QString constraints;
    QString module;
    bool WantsHdl() const {
        return !verilog.isEmpty() || !vhdl.isEmpty() || !constraints.isEmpty();
    }
};

bool LoadDesign(const Options& opt, Qvz_WizData& data, QString& error) {
    if (!opt.design.isEmpty())
        return Qvz_DesignJson::LoadFile(opt.design, data, error);
    return Qvz_DesignJson::LoadFile(":/targets/" + opt.target + ".json", data, error);
}

// Makes the block of --type/--width active and applies --set; false with a
// message on an input error.
bool ApplyChoices(const Options& opt, Qvz_MGTWizMain& wiz, Qvz_WizData& data, QString& error) {
    if (!opt.type.isEmpty()) {
        const StringBase type = StringBase::FromQString(opt.type);
        const StringBase width = StringBase::FromQString(opt.width);
        Qvz_Block* block = wiz.GetBlock(&data, type, width, false);
        if (!block)
            block = wiz.GetBlock(&data, type, width, true);
        if (!block) {
            error = QString("no block of type \"%1\" on this target").arg(opt.type);
            return false;
        }
        data.SetAllBlksIsActive(false);
        block->SetIsUsed(true);
        const char* widthAttr = block->SupportsMGT3() ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH";
        if (Qvz_Attribute* a = block->GetNamedAttribute(widthAttr))
            if (a->GetLegalValues().Contains(width))
                a->SetValue(width);
    }
    for (const QString& s : opt.sets) {
        const int eq = s.indexOf('=');
        const StringBase name = StringBase::FromQString(s.left(eq));
        Qvz_Block* block = data.GetActiveBlock();
        if (!block) {
            error = QString("--set %1: the design data has no active block").arg(s);
            return false;
        }
        Qvz_Attribute* a = block->GetNamedAttribute(name);
        if (!a) {
            error = QString("--set %1: block %2 has no attribute %3")
                        .arg(s, block->GetName().ToQString(), name.ToQString());
            return false;
        }
        a->SetValue(StringBase::FromQString(s.mid(eq + 1)));
    }
    return true;
}

// Writes the design files asked for, each atomically.
bool WriteHdl(const Options& opt, const HdlTexts& hdl, QString& error) {
    const std::pair<const QString*, const QByteArray*> files[] = {
        {&opt.verilog, &hdl.verilog}, {&opt.vhdl, &hdl.vhdl}, {&opt.constraints, &hdl.constraints}};
    for (const auto& f : files)
        if (!f.first->isEmpty() && !WriteAtomically(*f.first, *f.second, error))
            return false;
    return true;
}

void PrintHdlFiles(const Options& opt) {
    if (!opt.verilog.isEmpty())
        Out() << "Verilog:       " << opt.verilog << "\n";
    if (!opt.vhdl.isEmpty())
        Out() << "VHDL:          " << opt.vhdl << "\n";
    if (!opt.constraints.isEmpty())
        Out() << "Constraints:   " << opt.constraints << "\n";
}

int ListTargets() {
    for (const auto& t : kTargets)
        Out() << QString("%1  %2\n").arg(t.name, -5).arg(t.description);
    return kExitCompleted;
}

// Parses args into opt; returns -1 to go on, else an exit status.
int Parse(const QStringList& args, Options& opt) {
    QCommandLineParser p;
    p.setSingleDashWordOptionMode(QCommandLineParser::ParseAsLongOptions);
    const QCommandLineOption batch("batch"), check("check"), list("list-targets");
    const QCommandLineOption help(QStringList{"h", "help"}), version(QStringList{"v", "version"});
    const QCommandLineOption target("target", "", "NAME"), type("type", "", "TYPE");
    const QCommandLineOption width("width", "", "N"), set("set", "", "NAME=VALUE");
    const QCommandLineOption output(QStringList{"o", "output"}, "", "FILE"),
        report("report", "", "FILE");
    const QCommandLineOption verilog("verilog", "", "FILE"), vhdl("vhdl", "", "FILE");
    const QCommandLineOption constraints("constraints", "", "FILE"), module("module", "", "NAME");
    p.addOptions({batch, check, list, help, version, target, type, width, set, output, report,
                  verilog, vhdl, constraints, module});
    if (!p.parse(args))
        return UsageError(p.errorText());
    if (p.isSet(help)) {
        Out() << kUsage << "\n" << kHelp;
        return kExitCompleted;
    }
    if (p.isSet(version)) {
        Out() << "velomux-wizard " << VELOMUX_VERSION << "\n";
        return kExitCompleted;
    }
    if (p.isSet(list))
        return ListTargets();
    for (const QCommandLineOption* single :
         {&target, &type, &width, &output, &report, &verilog, &vhdl, &constraints, &module})
        if (p.values(*single).size() > 1)
            return UsageError(QString("--%1 given more than once").arg(single->names().last()));
    opt.batch = p.isSet(batch);
    opt.check = p.isSet(check);
    opt.targetGiven = p.isSet(target);
    if (opt.targetGiven)
        opt.target = p.value(target);
    opt.type = p.value(type);
    opt.widthGiven = p.isSet(width);
    if (opt.widthGiven)
        opt.width = p.value(width);
    opt.sets = p.values(set);
    opt.output = p.value(output);
    opt.report = p.value(report);
    opt.verilog = p.value(verilog);
    opt.vhdl = p.value(vhdl);
    opt.constraints = p.value(constraints);
    opt.module = p.value(module);
    const QStringList pos = p.positionalArguments();
    if (pos.size() > 1)
        return UsageError("give at most one design-data file");
    if (!pos.isEmpty())
        opt.design = pos.first();

    if (opt.check &&
        (opt.batch || p.isSet(type) || opt.widthGiven || !opt.sets.isEmpty() || p.isSet(report)))
        return UsageError(
            "--check takes only --target, -o, the HDL options and a design-data file");
    if (p.isSet(type) && opt.type.isEmpty())
        return UsageError("--type needs a transceiver type");
    if (opt.widthGiven && opt.type.isEmpty())
        return UsageError("--width goes with --type");
    if (opt.widthGiven && opt.width.trimmed().isEmpty())
        return UsageError("--width needs a data width");
    for (const QString& s : opt.sets)
        if (s.indexOf('=') <= 0)
            return UsageError(QString("--set expects NAME=VALUE, got \"%1\"").arg(s));
    if (p.isSet(output) && opt.output.isEmpty())
        return UsageError("-o needs a file name");
    if (p.isSet(report) && opt.report.isEmpty())
        return UsageError("--report needs a file name");
    for (const QCommandLineOption* file : {&verilog, &vhdl, &constraints})
        if (p.isSet(*file) && p.value(*file).isEmpty())
            return UsageError(QString("--%1 needs a file name").arg(file->names().last()));
    if (p.isSet(module) && !opt.WantsHdl())
        return UsageError("--module goes with --verilog, --vhdl or --constraints");
    if (p.isSet(module) && !IsHdlIdentifier(opt.module))
        return UsageError(QString("--module \"%1\": give a plain identifier (a letter, then "
                                  "letters, digits and single underscores) that is no keyword "
                                  "of Verilog or VHDL")
                              .arg(opt.module));
    // Two outputs on one file (or both on standard output) would overwrite or interleave.
    QStringList files;
    for (const QString& f : {opt.output, opt.report, opt.verilog, opt.vhdl, opt.constraints}) {
        // Devices such as /dev/null may take several outputs.
        if (f.isEmpty() || (f != "-" && QFileInfo(f).exists() && !QFileInfo(f).isFile() &&
                            !QFileInfo(f).isDir()))
            continue;
        const QString key = f == "-" ? f : QFileInfo(f).absoluteFilePath();
        if (files.contains(key))
            return UsageError(QString("\"%1\" is given for two outputs").arg(f));
        files << key;
    }
    if (opt.targetGiven && !opt.design.isEmpty())
        return UsageError("give either --target or a design-data file, not both");
    if (opt.design.isEmpty()) {
        bool known = false;
        for (const auto& t : kTargets)
            known = known || opt.target == QLatin1String(t.name);
        if (!known)
            return UsageError(QString("unknown target \"%1\" (see --list-targets)").arg(opt.target));
    }
    return -1;
}

} // namespace

bool WantsWindow(const QStringList& args) {
    for (const QString& a : args.mid(1)) {
        if (a == "--")
            break;
        if (a == "--batch" || a == "--check" || a == "--list-targets" || a == "--help" ||
            a == "-h" || a == "--version" || a == "-v")
            return false;
    }
    return true;
}

int Run(const QStringList& args) {
    Options opt;
    const int parsed = Parse(args, opt);
    if (parsed >= 0)
        return parsed;
    // The report must not overwrite the design data it reports on.
    if (!opt.report.isEmpty() && !opt.output.isEmpty() &&
        SafeWrite::SameFile(opt.report, opt.output))
        return UsageError("--report and -o name the same file");
    if (!opt.report.isEmpty() && !opt.design.isEmpty() &&
        SafeWrite::SameFile(opt.report, opt.design))
        return UsageError("--report names the design-data file");

    Qvz_WizData data;
    QString error;
    if (!LoadDesign(opt, data, error))
        return InputError(error);

    const bool toStdout =
        opt.output == "-" || opt.verilog == "-" || opt.vhdl == "-" || opt.constraints == "-";
    if (opt.check) {
        HdlTexts hdl;
        if (opt.WantsHdl() && !GenerateHdl(data, opt.module, VELOMUX_VERSION, hdl, error))
            return InputError(error);
        if (!opt.output.isEmpty() &&
            !WriteAtomically(opt.output, Qvz_DesignJson::Save(data), error)) {
            Err() << "velomux-wizard: " << error << "\n";
            return kExitOutput;
        }
        if (!WriteHdl(opt, hdl, error)) {
            Err() << "velomux-wizard: " << error << "\n";
            return kExitOutput;
        }
        if (!toStdout) {
            Out() << QString("Design data is valid: %1 block(s), %2 signal(s).\n")
                         .arg(data.GetBlocks().size())
                         .arg(data.GetSignals().size());
            PrintHdlFiles(opt);
        }
        return kExitCompleted;
    }

    Qvz_MGTWizMain wiz("Velomux Wizard", false);
    wiz.SetWizData(&data);
    if (!ApplyChoices(opt, wiz, data, error))
        return InputError(error);

    const Qvz_RunMode mode = opt.batch ? Qvz_RunMode::Batch : Qvz_RunMode::Window;
    if (mode == Qvz_RunMode::Window && !qobject_cast<QApplication*>(QCoreApplication::instance()))
        return UsageError("the wizard dialog needs a GUI application; use --batch");
    // Batch runs tell the user on standard error, window runs in message
    // boxes over the dialog; the report records both alike.
    Qvz_StderrSink stderrSink;
    Qvz_MessageBoxSink boxSink(&wiz);
    Qvz_HelpWindow help(&wiz);
    if (mode == Qvz_RunMode::Window) {
        wiz.SetMessageSink(&boxSink);
        wiz.SetHelpHandler(&help);
    } else {
        wiz.SetMessageSink(&stderrSink);
    }
    wiz.SetRunMode(mode);
    int status = wiz.Run() == Qvz_RunCompleted ? kExitCompleted : kExitRefused;

    // The design files come from the finished data; when they cannot be made,
    // nothing at all is written, so the outputs never disagree.
    HdlTexts hdl;
    if (status == kExitCompleted && opt.WantsHdl() &&
        !GenerateHdl(data, opt.module, VELOMUX_VERSION, hdl, error)) {
        Err() << "velomux-wizard: " << error << "\n";
        status = kExitInput;
    }
    if (status == kExitCompleted && !opt.output.isEmpty() &&
        !WriteAtomically(opt.output, Qvz_DesignJson::Save(data), error)) {
        Err() << "velomux-wizard: " << error << "\n";
        status = kExitOutput;
    }
    if (status == kExitCompleted && !WriteHdl(opt, hdl, error)) {
        Err() << "velomux-wizard: " << error << "\n";
        status = kExitOutput;
    }
    if (!opt.report.isEmpty() && !WriteAtomically(opt.report, ReportJson(mode, status, wiz), error)) {
        Err() << "velomux-wizard: " << error << "\n";
        status = kExitOutput;
    }
    if (status == kExitRefused && !wiz.GetFailedPageTitle().IsEmpty())
        Err() << "velomux-wizard: refused at page \"" << wiz.GetFailedPageTitle().ToQString()
              << "\"; nothing written.\n";
    else if (status == kExitRefused)
        Err() << (wiz.EndedIncomplete()
                      ? "velomux-wizard: the ports, pins and bonded copies could not be completed; "
                        "nothing written.\n"
                      : "velomux-wizard: cancelled; nothing written.\n");
    if (status == kExitCompleted && !toStdout) {
        Out() << Qvz_Summary::Of(data).ToText(true);
        Out() << "Output:        "
              << (opt.output.isEmpty() ? QString("(none; use -o FILE)") : opt.output) << "\n";
        PrintHdlFiles(opt);
    }
    Out().flush();
    Err().flush();
    return status;
}

} // namespace VelomuxHost
