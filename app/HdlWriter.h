#pragma once
// Turns finished design data into the design files of a synthesis project: a
// Verilog wrapper, a VHDL wrapper and a placement-constraints file. The
// mapping rules are set out in docs/hdl-output.md.

#include "Qvz_WizData.h"

#include <QByteArray>
#include <QString>

namespace VelomuxHost {

struct HdlTexts {
    QByteArray verilog;
    QByteArray vhdl;
    QByteArray constraints;
};

// The top module name when none is asked for and the target names no file.
extern const char* const kDefaultModuleName;

// Builds all three texts from the used blocks and signals of data. module
// names the top module or entity ("" takes the target's file name, made
// HDL-safe, else kDefaultModuleName); version goes into the headers. False,
// with error saying what and where, when the design data cannot be written as
// HDL (a pin on a signal that does not exist, a bit map outside its pin or
// signal, a pin or attribute name that is no identifier, ...).
bool GenerateHdl(const Qvz_WizData& data, const QString& module, const QString& version,
                 HdlTexts& out, QString& error);

// True when name can stand unchanged in both languages: a letter, then
// letters, digits and single inner underscores, and no keyword of either.
bool IsHdlIdentifier(const QString& name);

} // namespace VelomuxHost
