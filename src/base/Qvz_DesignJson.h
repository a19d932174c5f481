#pragma once
// Reading and writing design data as JSON (format "velomux-design-data").

#include "Qvz_WizData.h"

#include <QByteArray>
#include <QString>

namespace Qvz_DesignJson {

// Parses and validates text. On failure returns false and sets error to a
// message naming source with line and column, or the JSON path of the fault.
bool Load(const QByteArray& text, const QString& source, Qvz_WizData& out, QString& error);

// Reads the file at path (see Load); unreadable files fail the same way.
bool LoadFile(const QString& path, Qvz_WizData& out, QString& error);

// Every key written out, in a fixed order; stable across load and save.
QByteArray Save(const Qvz_WizData& data);

} // namespace Qvz_DesignJson
