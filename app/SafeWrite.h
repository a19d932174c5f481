#pragma once
// Writing the program's files so that a fault or an interruption never leaves
// a half-written file behind, and handling the signals that interrupt a run.

#include <QByteArray>
#include <QString>

namespace VelomuxHost {

// Exit statuses of a run ended by a signal: 128 + the signal number, as
// shells report them.
enum InterruptStatus { kExitHangup = 129, kExitInterrupted = 130, kExitTerminated = 143 };

// Makes SIGHUP, SIGINT and SIGTERM remove the temporary file of a write in
// progress and end the program with the status above, and makes a file-size
// limit fail the write (EFBIG) instead of killing the program.
void InstallSignalHandlers();

namespace SafeWrite {

// Writes bytes to path ('-': standard output). A regular file (or a new one)
// is replaced atomically: a temporary file in the same folder, synced, then
// renamed over it, keeping the earlier file's permissions; a symbolic link
// keeps pointing where it did and its target is replaced. An existing
// non-regular file (device, pipe) is written directly. False with a message
// naming the path leaves any earlier file at path as it was.
bool WriteFile(const QString& path, const QByteArray& bytes, QString& error);

// True when a and b name the same file: the same regular file on disk when
// both exist (links and hard links included), else the same absolute path.
// "-" (standard output) is the same only as "-".
bool SameFile(const QString& a, const QString& b);

} // namespace SafeWrite
} // namespace VelomuxHost
