// Faults around the files velomux-wizard reads and writes, driven through the
// real program: every fault ends with its exit status and a message naming
// the file, the input is never modified, and an earlier output or report is
// either left as it was or fully replaced, with no temporary file left over.

#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QDir>
#include <QFileInfo>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <chrono>
#include <csignal>
#include <thread>

#include <fcntl.h>
#include <poll.h>
#include <sched.h>
#include <sys/inotify.h>
#include <sys/mount.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <sys/sysmacros.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

const QByteArray kPrevious = "previous contents\n";

QByteArray SampleDesign() {
    return ReadAll(QString(VELOMUX_TARGETS) + "/gt10.json");
}

// Names in dir that look like a temporary file of an atomic write.
QStringList Leftovers(const QString& dir) {
    QStringList stray;
    for (const QString& name :
         QDir(dir).entryList(QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot))
        if (name.startsWith('.') && name.contains(".tmp"))
            stray << name;
    return stray;
}

bool IsCharDevice(const QString& path) {
    struct stat st {};
    return ::stat(QFile::encodeName(path).constData(), &st) == 0 && S_ISCHR(st.st_mode);
}

bool Loads(const QByteArray& bytes) {
    Qvz_WizData d;
    QString err;
    return Qvz_DesignJson::Load(bytes, "output", d, err);
}

// Mounts made here live in a mount namespace of this test program only, so
// nothing else on the machine ever sees them. False where the system does not
// allow one (the tests needing it are skipped then).
bool PrivateMounts() {
    static const bool ok = [] {
        if (::unshare(CLONE_NEWNS) != 0) {
            const uid_t uid = ::geteuid();
            const gid_t gid = ::getegid();
            if (::unshare(CLONE_NEWUSER | CLONE_NEWNS) != 0)
                return false;
            WriteAll("/proc/self/setgroups", "deny");
            WriteAll("/proc/self/uid_map", QByteArray("0 ") + QByteArray::number(uid) + " 1");
            WriteAll("/proc/self/gid_map", QByteArray("0 ") + QByteArray::number(gid) + " 1");
        }
        return ::mount("none", "/", nullptr, MS_REC | MS_PRIVATE, nullptr) == 0;
    }();
    return ok;
}

// A mount on dir, undone when it goes out of scope.
class Mount {
public:
    // A small tmpfs of the given size in bytes.
    static Mount Tmpfs(const QString& dir, int bytes) {
        const QByteArray opts = "size=" + QByteArray::number(bytes);
        return Mount(dir, PrivateMounts() && ::mount("velomux-test", QFile::encodeName(dir),
                                                     "tmpfs", 0, opts.constData()) == 0);
    }
    // dir itself, read-only (its files stay visible).
    static Mount ReadOnly(const QString& dir) {
        const QByteArray d = QFile::encodeName(dir);
        if (!PrivateMounts() || ::mount(d, d, nullptr, MS_BIND, nullptr) != 0)
            return Mount(dir, false);
        // A remount must keep the flags the surrounding mount has.
        struct statvfs sv {};
        ::statvfs(d, &sv);
        unsigned long flags = MS_REMOUNT | MS_BIND | MS_RDONLY;
        flags |= (sv.f_flag & ST_NOSUID ? MS_NOSUID : 0) | (sv.f_flag & ST_NODEV ? MS_NODEV : 0) |
                 (sv.f_flag & ST_NOEXEC ? MS_NOEXEC : 0);
        Mount m(dir, true);
        m.m_ok = ::mount(nullptr, d, nullptr, flags, nullptr) == 0;
        return m;
    }
    Mount(Mount&& o) noexcept : m_dir(o.m_dir), m_ok(o.m_ok), m_mounted(o.m_mounted) {
        o.m_mounted = false;
    }
    ~Mount() {
        if (m_mounted)
            ::umount2(QFile::encodeName(m_dir).constData(), MNT_DETACH);
    }
    bool ok() const { return m_ok; }

private:
    Mount(const QString& dir, bool mounted) : m_dir(dir), m_ok(mounted), m_mounted(mounted) {}
    QString m_dir;
    bool m_ok;
    bool m_mounted;
};

struct RunOptions {
    int timeoutMs = 120000;
    QString stdoutFile;
    std::function<void()> childSetup;
};

// Like RunHost, but a hang is a failure of its own instead of a long wait.
HostResult RunChecked(const QStringList& args, const RunOptions& o = {}) {
    QProcess p;
    p.setProgram(VELOMUX_WIZARD_EXE);
    p.setArguments(args);
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.insert("QT_QPA_PLATFORM", "offscreen");
    p.setProcessEnvironment(env);
    if (!o.stdoutFile.isEmpty())
        p.setStandardOutputFile(o.stdoutFile, QIODevice::Append);
    if (o.childSetup)
        p.setChildProcessModifier(o.childSetup);
    p.start();
    p.closeWriteChannel();
    HostResult r;
    if (!p.waitForFinished(o.timeoutMs)) {
        p.kill();
        p.waitForFinished();
        r.err = "(still running after the time limit)";
        return r;
    }
    r.exitCode = p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -1;
    r.out = p.readAllStandardOutput();
    r.err = p.readAllStandardError();
    return r;
}

std::string Show(const QStringList& args, const HostResult& r) {
    return (args.join(' ') + "\nexit " + QString::number(r.exitCode) + "\n").toStdString() +
           r.err.toStdString();
}

// State letter of a process from /proc ('T' when stopped).
char ProcessState(qint64 pid) {
    const QByteArray stat = ReadAll(QString("/proc/%1/stat").arg(pid));
    const qsizetype close = stat.lastIndexOf(')');
    return close >= 0 && close + 2 < stat.size() ? stat[close + 2] : '?';
}

bool CatchesSignal(qint64 pid, int sig) {
    for (const QByteArray& line : ReadAll(QString("/proc/%1/status").arg(pid)).split('\n'))
        if (line.startsWith("SigCgt:"))
            return (line.mid(7).trimmed().toULongLong(nullptr, 16) >> (sig - 1)) & 1;
    return false;
}

template <typename Pred> bool WaitUntil(Pred pred, int ms = 20000) {
    for (int waited = 0; waited < ms; waited += 5) {
        if (pred())
            return true;
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    return pred();
}

} // namespace

TEST(Faults, UnreadableInputExitsThreeNamingTheFile) {
    QTemporaryDir tmp;
    const QString vanished = tmp.filePath("vanished.json");
    ASSERT_TRUE(WriteAll(vanished, SampleDesign()));
    ASSERT_TRUE(QFile::remove(vanished));
    const QString dangling = tmp.filePath("dangling.json");
    ASSERT_TRUE(QFile::link(tmp.filePath("nowhere.json"), dangling));
    // A socket cannot be opened as a file at all.
    const QString socketPath = tmp.filePath("s.sock");
    const int sock = ::socket(AF_UNIX, SOCK_STREAM, 0);
    sockaddr_un addr{};
    addr.sun_family = AF_UNIX;
    std::strncpy(addr.sun_path, QFile::encodeName(socketPath).constData(),
                 sizeof addr.sun_path - 1);
    ASSERT_EQ(::bind(sock, reinterpret_cast<sockaddr*>(&addr), sizeof addr), 0);

    const struct {
        QString input;
        const char* why;
    } cases[] = {
        {vanished, "No such file or directory"},
        {dangling, "No such file or directory"},
        {tmp.path(), "is a directory"},
        {socketPath, "cannot read"},
        // Endless: would have read until memory ran out.
        {"/dev/zero", "not a regular file"},
        // Opens, then fails on the first read.
        {"/proc/self/mem", "Input/output error"},
    };
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    for (const auto& c : cases) {
        ASSERT_TRUE(WriteAll(out, kPrevious));
        ASSERT_TRUE(WriteAll(report, kPrevious));
        for (const QStringList& args :
             {QStringList{"--batch", "-o", out, "--report", report, c.input},
              QStringList{"--check", "-o", out, c.input}}) {
            HostResult r = RunChecked(args, {30000, {}, {}});
            EXPECT_EQ(r.exitCode, 3) << Show(args, r);
            EXPECT_TRUE(r.err.contains(c.input.toUtf8() + ": ")) << Show(args, r);
            EXPECT_TRUE(r.err.contains(c.why)) << Show(args, r);
            EXPECT_EQ(ReadAll(out), kPrevious);
            EXPECT_EQ(ReadAll(report), kPrevious);
        }
    }
    ::close(sock);
    EXPECT_EQ(Leftovers(tmp.path()), QStringList());
}

TEST(Faults, PipesStillCarryDesignData) {
    QTemporaryDir tmp;
    const QString fifo = tmp.filePath("design.fifo");
    ASSERT_EQ(::mkfifo(QFile::encodeName(fifo), 0644), 0);
    const QByteArray design = SampleDesign();
    // No writer at all: this would have hung for ever.
    HostResult r = RunChecked({"--batch", fifo}, {30000, {}, {}});
    EXPECT_EQ(r.exitCode, 3) << r.err.toStdString();
    EXPECT_TRUE(r.err.contains(fifo.toUtf8() + ": cannot read: nobody wrote to this pipe"))
        << r.err.toStdString();
    // A writer that connects after the program opened the pipe, and one that
    // connects but writes nothing.
    for (const bool writes : {true, false}) {
        std::thread writer([&] {
            std::this_thread::sleep_for(std::chrono::milliseconds(300));
            QFile f(fifo);
            if (f.open(QIODevice::WriteOnly) && writes)
                f.write(design);
        });
        r = RunChecked({"--check", fifo}, {30000, {}, {}});
        writer.join();
        if (writes) {
            EXPECT_EQ(r.exitCode, 0) << r.err.toStdString();
        } else {
            EXPECT_EQ(r.exitCode, 3) << r.err.toStdString();
            EXPECT_TRUE(r.err.contains("nothing was written to this pipe")) << r.err.toStdString();
        }
    }
}

TEST(Faults, OutputOrReportIntoMissingOrUnwritableFolderExitsFour) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    const QString good = tmp.filePath("good.json");
    const QString aFile = tmp.filePath("plain.txt");
    ASSERT_TRUE(WriteAll(aFile, kPrevious));
    const struct {
        QString path;
        const char* why;
    } cases[] = {
        {tmp.filePath("no/such/dir/out.json"), "does not exist"},
        {aFile + "/out.json", "is not a folder"},
        {tmp.path(), "is a directory"},
        // Nothing can be created there, whoever runs the tests.
        {"/proc/velomux-out.json", "cannot write"},
    };
    for (const auto& c : cases) {
        const QStringList asOutput = {"--batch", "-o", c.path, design};
        const QStringList asCheckOutput = {"--check", "-o", c.path, design};
        const QStringList asReport = {"--batch", "-o", good, "--report", c.path, design};
        for (const QStringList& args : {asOutput, asCheckOutput, asReport}) {
            HostResult r = RunChecked(args);
            EXPECT_EQ(r.exitCode, 4) << Show(args, r);
            EXPECT_TRUE(r.err.contains(c.path.toUtf8() + ": ")) << Show(args, r);
            EXPECT_TRUE(r.err.contains(c.why)) << Show(args, r);
        }
    }
    EXPECT_EQ(ReadAll(aFile), kPrevious);
    EXPECT_EQ(ReadAll(design), SampleDesign());
    EXPECT_EQ(Leftovers(tmp.path()), QStringList());
}

// Root may write into any folder whatever its mode; a read-only mount is the
// one thing that stops it.
TEST(Faults, ReadOnlyFolderKeepsEarlierOutputAndReport) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    const QString ro = tmp.filePath("ro");
    ASSERT_TRUE(QDir().mkpath(ro));
    const QString out = ro + "/out.json", report = ro + "/report.json";
    ASSERT_TRUE(WriteAll(out, kPrevious));
    ASSERT_TRUE(WriteAll(report, kPrevious));
    const QString good = tmp.filePath("good.json");
    Mount mount = Mount::ReadOnly(ro);
    if (!mount.ok())
        GTEST_SKIP() << "no read-only bind mount possible here";

    const QStringList cases[] = {
        {"--batch", "-o", out, design},
        {"--check", "-o", out, design},
        {"--batch", "-o", good, "--report", report, design},
        {"--batch", "-o", out, "--report", report, design},
        // A refused run still writes its report.
        {"--batch", "--set", "QVZ_CHAN_BOND_NUMBER=99", "--report", report, design},
    };
    for (const QStringList& args : cases) {
        HostResult r = RunChecked(args);
        EXPECT_EQ(r.exitCode, 4) << Show(args, r);
        EXPECT_TRUE(r.err.contains("Read-only file system")) << Show(args, r);
        EXPECT_EQ(ReadAll(out), kPrevious);
        EXPECT_EQ(ReadAll(report), kPrevious);
    }
    EXPECT_EQ(Leftovers(ro), QStringList());
    // The report says what happened to the output it could write elsewhere.
    const QString goodReport = tmp.filePath("r.json");
    HostResult r = RunChecked({"--batch", "-o", out, "--report", goodReport, design});
    EXPECT_EQ(r.exitCode, 4);
    EXPECT_EQ(ReadJson(goodReport)["exit_code"].toInt(), 4);
    EXPECT_FALSE(ReadJson(goodReport)["ok"].toBool());
}

TEST(Faults, FullDiskOrSizeLimitKeepsEarlierFiles) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");

    // A file-size limit below the design's size, with the signal it raises
    // left at its default (which would kill a program that does not expect it).
    const auto sizeLimit = [] {
        std::signal(SIGXFSZ, SIG_DFL);
        rlimit lim{4096, 4096};
        setrlimit(RLIMIT_FSIZE, &lim);
    };
    for (const QStringList& args :
         {QStringList{"--batch", "-o", out, design}, QStringList{"--check", "-o", out, design},
          QStringList{"--batch", "-o", out, "--report", report, design}}) {
        ASSERT_TRUE(WriteAll(out, kPrevious));
        ASSERT_TRUE(WriteAll(report, kPrevious));
        HostResult r = RunChecked(args, {120000, {}, sizeLimit});
        EXPECT_EQ(r.exitCode, 4) << Show(args, r);
        EXPECT_TRUE(r.err.contains(out.toUtf8() + ": cannot write: File too large"))
            << Show(args, r);
        EXPECT_EQ(ReadAll(out), kPrevious);
        if (args.contains("--report")) { // small enough to fit under the limit
            EXPECT_EQ(ReadJson(report)["exit_code"].toInt(), 4);
        }
    }
    EXPECT_EQ(Leftovers(tmp.path()), QStringList());
}

TEST(Faults, FullFileSystem) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    const QString small = tmp.filePath("small");
    ASSERT_TRUE(QDir().mkpath(small));
    Mount mount = Mount::Tmpfs(small, 16384);
    if (!mount.ok())
        GTEST_SKIP() << "no tmpfs can be mounted here";
    const QString out = small + "/out.json", report = small + "/report.json";
    ASSERT_TRUE(WriteAll(out, kPrevious));
    ASSERT_TRUE(WriteAll(report, kPrevious));
    // Fill what is left, so that not even a short report fits.
    QFile filler(small + "/filler");
    ASSERT_TRUE(filler.open(QIODevice::WriteOnly));
    while (filler.write(QByteArray(512, 'x')) == 512 && filler.flush()) {
    }
    filler.close();

    const QString good = tmp.filePath("good.json");
    const QStringList cases[] = {
        {"--batch", "-o", out, design},
        {"--check", "-o", out, design},
        {"--batch", "-o", good, "--report", report, design},
    };
    for (const QStringList& args : cases) {
        HostResult r = RunChecked(args);
        EXPECT_EQ(r.exitCode, 4) << Show(args, r);
        EXPECT_TRUE(r.err.contains("No space left on device")) << Show(args, r);
        EXPECT_EQ(ReadAll(out), kPrevious);
        EXPECT_EQ(ReadAll(report), kPrevious);
        EXPECT_EQ(Leftovers(small), QStringList());
    }
}

// Devices and pipes are written in place: an atomic rename would put a plain
// file where the device was.
TEST(Faults, DevicesAndPipesAreWrittenNotReplaced) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    // A private full device (as /dev/full) where the tests may create and use one.
    QString full = tmp.filePath("full");
    if (::mknod(QFile::encodeName(full), S_IFCHR | 0666, makedev(1, 7)) != 0 ||
        !QFile(full).open(QIODevice::WriteOnly))
        full = "/dev/full";
    ASSERT_TRUE(IsCharDevice(full));
    const QString good = tmp.filePath("good.json");
    for (const QStringList& args :
         {QStringList{"--batch", "-o", full, design}, QStringList{"--check", "-o", full, design},
          QStringList{"--batch", "-o", good, "--report", full, design}}) {
        HostResult r = RunChecked(args);
        EXPECT_EQ(r.exitCode, 4) << Show(args, r);
        EXPECT_TRUE(r.err.contains(full.toUtf8() + ": cannot write: No space left on device"))
            << Show(args, r);
        EXPECT_TRUE(IsCharDevice(full));
    }

    // Standard output on a full device.
    HostResult r = RunChecked({"--batch", "-o", "-", design}, {120000, full, {}});
    EXPECT_EQ(r.exitCode, 4) << r.err.toStdString();
    EXPECT_TRUE(r.err.contains("cannot write to standard output")) << r.err.toStdString();

    // /dev/null takes everything and stays a device.
    r = RunChecked({"--batch", "-o", "/dev/null", "--report", "/dev/null", design});
    EXPECT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(IsCharDevice("/dev/null"));

    // A pipe nobody reads from fails at once instead of hanging; one with a
    // reader gets the whole design.
    const QString fifo = tmp.filePath("out.fifo");
    ASSERT_EQ(::mkfifo(QFile::encodeName(fifo), 0644), 0);
    r = RunChecked({"--check", "-o", fifo, design}, {30000, {}, {}});
    EXPECT_EQ(r.exitCode, 4) << r.err.toStdString();
    EXPECT_TRUE(r.err.contains("nobody reads from this pipe")) << r.err.toStdString();
    QByteArray received;
    std::thread reader([&] {
        QFile f(fifo);
        if (f.open(QIODevice::ReadOnly))
            received = f.readAll();
    });
    std::this_thread::sleep_for(std::chrono::milliseconds(200)); // the reader opens first
    r = RunChecked({"--check", "-o", fifo, design}, {30000, {}, {}});
    reader.join();
    EXPECT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(Loads(received));
    EXPECT_EQ(Leftovers(tmp.path()), QStringList());
}

TEST(Faults, ReplacedOutputKeepsItsLinkAndPermissions) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    const QString real = tmp.filePath("real.json"), link = tmp.filePath("link.json");
    ASSERT_TRUE(WriteAll(real, kPrevious));
    ASSERT_EQ(::chmod(QFile::encodeName(real), 0640), 0);
    ASSERT_TRUE(QFile::link(real, link));
    HostResult r = RunChecked({"--check", "-o", link, design});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(QFileInfo(link).isSymLink());
    EXPECT_TRUE(Loads(ReadAll(real)));
    struct stat st {};
    ASSERT_EQ(::stat(QFile::encodeName(real), &st), 0);
    EXPECT_EQ(st.st_mode & 07777, 0640u);
}

TEST(Faults, InputAndOutputTheSameFile) {
    QTemporaryDir tmp;
    const QString design = tmp.filePath("design.json");
    const QString symlink = tmp.filePath("symlink.json"), hardlink = tmp.filePath("hardlink.json");
    ASSERT_TRUE(WriteAll(design, SampleDesign()));
    ASSERT_TRUE(QFile::link(design, symlink));
    ASSERT_EQ(::link(QFile::encodeName(design), QFile::encodeName(hardlink)), 0);
    const QString elsewhere = tmp.filePath("report.json");

    // Runs that end without output leave the design as it was, wherever the
    // output would have gone.
    for (const QString& same : {design, symlink, hardlink}) {
        const QStringList refused = {"--batch", "-o", same, "--set", "QVZ_CHAN_BOND_NUMBER=99",
                                     design};
        HostResult r = RunChecked(refused);
        EXPECT_EQ(r.exitCode, 1) << Show(refused, r);
        EXPECT_EQ(ReadAll(design), SampleDesign());
        const QStringList tooBig = {"--batch", "-o", same, design};
        r = RunChecked(tooBig, {120000, {}, [] {
                                    rlimit lim{4096, 4096};
                                    setrlimit(RLIMIT_FSIZE, &lim);
                                }});
        EXPECT_EQ(r.exitCode, 4) << Show(tooBig, r);
        EXPECT_EQ(ReadAll(design), SampleDesign());
    }

    // A report over the design it reports on, or over the output, would lose
    // the design data: refused before anything runs.
    const QStringList clashes[] = {
        {"--batch", "--report", design, design},
        {"--batch", "--report", symlink, design},
        {"--batch", "--report", hardlink, design},
        {"--batch", "-o", elsewhere, "--report", elsewhere, design},
        {"--batch", "-o", tmp.filePath("new.json"), "--report", tmp.filePath("./new.json"), design},
        {"--batch", "-o", "-", "--report", "-", design},
    };
    for (const QStringList& args : clashes) {
        HostResult r = RunChecked(args);
        EXPECT_EQ(r.exitCode, 2) << Show(args, r);
        EXPECT_TRUE(r.err.contains("--report")) << Show(args, r);
        EXPECT_EQ(ReadAll(design), SampleDesign());
        EXPECT_FALSE(QFileInfo::exists(elsewhere));
        EXPECT_FALSE(QFileInfo::exists(tmp.filePath("new.json")));
    }

    // A completed run replaces the file whole; through a hard link only that
    // name gets the new file, the design keeps its own.
    HostResult r = RunChecked({"--batch", "-o", hardlink, design});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(ReadAll(design), SampleDesign());
    EXPECT_TRUE(Loads(ReadAll(hardlink)));
    r = RunChecked({"--batch", "-o", symlink, design});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(QFileInfo(symlink).isSymLink());
    EXPECT_TRUE(Loads(ReadAll(design)));
    EXPECT_NE(ReadAll(design), SampleDesign());
    EXPECT_EQ(Leftovers(tmp.path()), QStringList());
}

// Stops the program while its temporary file exists, so the signal is
// certain to arrive in the middle of the write.
TEST(Faults, InterruptedWriteLeavesEarlierOutputAndNoTemporaryFile) {
    QTemporaryDir tmp;
    // Large enough that writing it takes a noticeable while.
    const QString design = tmp.filePath("big.json");
    {
        Qvz_WizData d;
        QString err;
        ASSERT_TRUE(Qvz_DesignJson::Load(SampleDesign(), "gt10", d, err)) << err.toStdString();
        std::vector<const Qvz_Block*> originals;
        for (const auto& b : d.GetBlocks())
            originals.push_back(b.get());
        for (int copy = 1; copy <= 3; ++copy)
            for (const Qvz_Block* b : originals)
                d.CopyBlock(b, b->GetName() + "_COPY" + UT_STR::IToA(copy));
        ASSERT_TRUE(WriteAll(design, Qvz_DesignJson::Save(d)));
    }
    const QString outDir = tmp.filePath("out");
    ASSERT_TRUE(QDir().mkpath(outDir));
    const QString out = outDir + "/out.json";

    for (const int sig : {SIGINT, SIGTERM, SIGHUP}) {
        bool caught = false;
        for (int attempt = 0; attempt < 5 && !caught; ++attempt) {
            ASSERT_TRUE(WriteAll(out, kPrevious));
            const int watch = ::inotify_init1(IN_CLOEXEC | IN_NONBLOCK);
            ASSERT_GE(watch, 0);
            ::inotify_add_watch(watch, QFile::encodeName(outDir), IN_CREATE);
            QProcess p;
            p.setProgram(VELOMUX_WIZARD_EXE);
            p.setArguments({"--check", "-o", out, design});
            p.start();
            ASSERT_TRUE(p.waitForStarted());
            const qint64 pid = p.processId();
            // The first file created in the folder is the temporary one.
            pollfd pf{watch, POLLIN, 0};
            ASSERT_EQ(::poll(&pf, 1, 120000), 1) << "no temporary file appeared";
            ::kill(pid, SIGSTOP);
            ASSERT_TRUE(WaitUntil([&] { return ProcessState(pid) == 'T'; }));
            caught = !Leftovers(outDir).isEmpty();
            if (caught)
                ::kill(pid, sig);
            ::kill(pid, SIGCONT);
            ASSERT_TRUE(p.waitForFinished(120000));
            ::close(watch);
            if (caught) {
                EXPECT_EQ(p.exitStatus(), QProcess::NormalExit) << strsignal(sig);
                EXPECT_EQ(p.exitCode(), 128 + sig) << strsignal(sig);
                EXPECT_EQ(ReadAll(out), kPrevious) << strsignal(sig);
            } else {
                EXPECT_EQ(p.exitCode(), 0); // finished before it could be stopped
            }
            EXPECT_EQ(Leftovers(outDir), QStringList()) << strsignal(sig);
        }
        EXPECT_TRUE(caught) << "never caught the write in progress for " << strsignal(sig);
    }
}

TEST(Faults, InterruptedWindowRunWritesNothing) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    ASSERT_TRUE(WriteAll(report, kPrevious));
    for (const int sig : {SIGINT, SIGTERM}) {
        QProcess p;
        p.setProgram(VELOMUX_WIZARD_EXE);
        p.setArguments({"-o", out, "--report", report});
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert("QT_QPA_PLATFORM", "offscreen");
        p.setProcessEnvironment(env);
        p.start();
        ASSERT_TRUE(p.waitForStarted());
        ASSERT_TRUE(WaitUntil([&] { return CatchesSignal(p.processId(), sig); }));
        ::kill(p.processId(), sig);
        ASSERT_TRUE(p.waitForFinished(30000));
        EXPECT_EQ(p.exitStatus(), QProcess::NormalExit);
        EXPECT_EQ(p.exitCode(), 128 + sig);
        EXPECT_FALSE(QFileInfo::exists(out));
        EXPECT_EQ(ReadAll(report), kPrevious);
    }
    EXPECT_EQ(Leftovers(tmp.path()), QStringList());
}

TEST(Faults, HelpListsTheInterruptStatuses) {
    HostResult r = RunChecked({"--help"});
    EXPECT_EQ(r.exitCode, 0);
    EXPECT_TRUE(r.out.contains("129/130/143")) << r.out.toStdString();
}
