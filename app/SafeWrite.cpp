#include "SafeWrite.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#ifdef Q_OS_UNIX
#include <climits>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#else
#include <QSaveFile>
#endif

namespace VelomuxHost {
namespace {

QString Why(int err) {
    return QString::fromLocal8Bit(std::strerror(err));
}

bool Fail(QString& error, const QString& path, const QString& why) {
    error = path + ": cannot write: " + why;
    return false;
}

bool WriteStdout(const QByteArray& bytes, QString& error) {
    errno = 0;
    const bool ok = std::fwrite(bytes.constData(), 1, std::size_t(bytes.size()), stdout) ==
                        std::size_t(bytes.size()) &&
                    std::fflush(stdout) == 0;
    if (!ok)
        error = "cannot write to standard output" + (errno ? ": " + Why(errno) : QString());
    return ok;
}

#ifdef Q_OS_UNIX

// The temporary file of the write in progress, for the signal handler; only
// changed with the handled signals blocked, so the handler never sees it half
// set and never misses a file that exists.
char g_pending[PATH_MAX];
volatile std::sig_atomic_t g_hasPending = 0;

const int kHandledSignals[] = {SIGHUP, SIGINT, SIGTERM};

sigset_t HandledSet() {
    sigset_t set;
    sigemptyset(&set);
    for (int sig : kHandledSignals)
        sigaddset(&set, sig);
    return set;
}

extern "C" void OnInterrupt(int sig) {
    if (g_hasPending)
        ::unlink(g_pending);
    ::_exit(128 + sig);
}

// Holds the handled signals off while a temporary file comes into being or
// goes away together with its record in g_pending.
class SignalBlock {
public:
    SignalBlock() {
        const sigset_t set = HandledSet();
        sigprocmask(SIG_BLOCK, &set, &m_old);
    }
    ~SignalBlock() { sigprocmask(SIG_SETMASK, &m_old, nullptr); }
    SignalBlock(const SignalBlock&) = delete;
    SignalBlock& operator=(const SignalBlock&) = delete;

private:
    sigset_t m_old;
};

bool WriteAllTo(int fd, const QByteArray& bytes, int& err) {
    // Chunks keep a pending interruption from waiting for one huge write.
    constexpr qsizetype kChunk = 1 << 20;
    const char* p = bytes.constData();
    qsizetype left = bytes.size();
    while (left > 0) {
        const ssize_t n = ::write(fd, p, std::size_t(std::min(left, kChunk)));
        if (n < 0 && errno == EINTR)
            continue;
        if (n <= 0) {
            err = n < 0 ? errno : EIO;
            return false;
        }
        p += n;
        left -= n;
    }
    return true;
}

// Devices and pipes cannot be replaced by a rename (and must not be: that
// would put a plain file where /dev/null or a pipe was), so they are written
// in place.
bool WriteInPlace(const QString& path, const QByteArray& native, bool isFifo,
                  const QByteArray& bytes, QString& error) {
    // Non-blocking open: a pipe nobody reads from fails instead of hanging.
    const int fd = ::open(native.constData(), O_WRONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (fd < 0) {
        const int err = errno;
        return Fail(error, path, isFifo && err == ENXIO ? "nobody reads from this pipe" : Why(err));
    }
    ::fcntl(fd, F_SETFL, ::fcntl(fd, F_GETFL) & ~O_NONBLOCK);
    int err = 0;
    const bool wrote = WriteAllTo(fd, bytes, err);
    if (::close(fd) != 0 && wrote)
        err = errno;
    return err == 0 || Fail(error, path, Why(err));
}

void RemoveTemp(const QByteArray& temp) {
    SignalBlock block;
    ::unlink(temp.constData());
    g_hasPending = 0;
}

bool WriteReplacing(const QString& path, const QByteArray& bytes, QString& error) {
    QByteArray target = QFile::encodeName(path);
    struct stat st {};
    const bool exists = ::stat(target.constData(), &st) == 0;
    if (exists && S_ISDIR(st.st_mode)) {
        error = path + ": is a directory";
        return false;
    }
    if (exists && !S_ISREG(st.st_mode))
        return WriteInPlace(path, target, S_ISFIFO(st.st_mode), bytes, error);
    if (exists) {
        // Replace the file a link points to, not the link.
        if (char* real = ::realpath(target.constData(), nullptr)) {
            target = real;
            std::free(real);
        }
        // A file its owner made read-only is not replaced behind their back.
        if (::access(target.constData(), W_OK) != 0)
            return Fail(error, path, Why(errno));
    }

    const qsizetype slash = target.lastIndexOf('/');
    const QByteArray dir = slash < 0 ? QByteArray(".") : target.left(std::max<qsizetype>(slash, 1));
    const QByteArray base = slash < 0 ? target : target.mid(slash + 1);
    struct stat dirSt {};
    if (::stat(dir.constData(), &dirSt) != 0)
        return Fail(error, path,
                    errno == ENOENT
                        ? QString("the folder %1 does not exist").arg(QFile::decodeName(dir))
                        : Why(errno));
    if (!S_ISDIR(dirSt.st_mode))
        return Fail(error, path, QString("%1 is not a folder").arg(QFile::decodeName(dir)));

    // A hidden name in the same folder (so the rename stays on one file
    // system), short enough for any name the folder accepts.
    static unsigned counter = 0;
    QByteArray temp;
    int fd = -1;
    int err = EEXIST;
    for (int attempt = 0; fd < 0 && err == EEXIST && attempt < 100; ++attempt) {
        temp = dir + "/." + base.left(200) + ".tmp" + QByteArray::number(qint64(::getpid())) + "-" +
               QByteArray::number(++counter);
        if (temp.size() >= qsizetype(sizeof g_pending))
            return Fail(error, path, Why(ENAMETOOLONG));
        SignalBlock block;
        fd = ::open(temp.constData(), O_WRONLY | O_CREAT | O_EXCL | O_NOCTTY | O_CLOEXEC, 0666);
        err = errno;
        if (fd >= 0) {
            std::memcpy(g_pending, temp.constData(), std::size_t(temp.size()) + 1);
            g_hasPending = 1;
        }
    }
    if (fd < 0)
        return Fail(error, path, Why(err));

    if (exists) {
        // Keep the earlier file's permissions, and its owner where that is
        // allowed (only root may give a file away; ours is fine otherwise).
        [[maybe_unused]] const bool owned = ::fchown(fd, st.st_uid, st.st_gid) == 0;
        ::fchmod(fd, st.st_mode & 07777);
    }
    // Sync before the rename: a crash must not leave an empty file in place
    // of the earlier one. File systems that cannot sync say EINVAL.
    err = 0;
    if (WriteAllTo(fd, bytes, err) && ::fsync(fd) != 0 && errno != EINVAL)
        err = errno;
    if (err != 0) {
        ::close(fd);
        RemoveTemp(temp);
        return Fail(error, path, Why(err));
    }
    if (::close(fd) != 0) {
        err = errno;
        RemoveTemp(temp);
        return Fail(error, path, Why(err));
    }
    {
        SignalBlock block;
        if (::rename(temp.constData(), target.constData()) != 0) {
            err = errno;
            ::unlink(temp.constData());
        }
        g_hasPending = 0;
    }
    return err == 0 || Fail(error, path, Why(err));
}

#else // !Q_OS_UNIX

bool WriteReplacing(const QString& path, const QByteArray& bytes, QString& error) {
    if (QFileInfo(path).isDir()) {
        error = path + ": is a directory";
        return false;
    }
    QSaveFile file(path);
    if (!file.open(QIODevice::WriteOnly))
        return Fail(error, path, file.errorString());
    if (file.write(bytes) != bytes.size() || !file.flush()) {
        const QString why = file.errorString();
        file.cancelWriting();
        return Fail(error, path, why);
    }
    return file.commit() || Fail(error, path, file.errorString());
}

#endif

} // namespace

void InstallSignalHandlers() {
#ifdef Q_OS_UNIX
    struct sigaction sa {};
    sa.sa_handler = OnInterrupt;
    sa.sa_mask = HandledSet();
    for (int sig : kHandledSignals) {
        // A signal the caller chose to ignore (nohup, background jobs) stays ignored.
        struct sigaction old {};
        if (sigaction(sig, nullptr, &old) == 0 && old.sa_handler == SIG_IGN)
            continue;
        sigaction(sig, &sa, nullptr);
    }
    std::signal(SIGXFSZ, SIG_IGN);
#endif
}

namespace SafeWrite {

bool WriteFile(const QString& path, const QByteArray& bytes, QString& error) {
    if (path == "-")
        return WriteStdout(bytes, error);
    return WriteReplacing(path, bytes, error);
}

bool SameFile(const QString& a, const QString& b) {
    if (a == "-" || b == "-")
        return a == b;
#ifdef Q_OS_UNIX
    struct stat sa {};
    struct stat sb {};
    const bool hasA = ::stat(QFile::encodeName(a).constData(), &sa) == 0;
    const bool hasB = ::stat(QFile::encodeName(b).constData(), &sb) == 0;
    // Devices and pipes hold nothing one write could destroy for the other
    // (both into /dev/null is fine).
    if (hasA && hasB)
        return S_ISREG(sa.st_mode) && sa.st_dev == sb.st_dev && sa.st_ino == sb.st_ino;
    if (hasA != hasB)
        return false;
#endif
    // Neither exists yet: compare where they would be created.
    const auto where = [](const QString& p) {
        const QFileInfo fi(p);
        const QString dir = QFileInfo(fi.absolutePath()).canonicalFilePath();
        return QDir::cleanPath((dir.isEmpty() ? fi.absolutePath() : dir) + "/" + fi.fileName());
    };
    return where(a) == where(b);
}

} // namespace SafeWrite
} // namespace VelomuxHost
