#include "writer/saveroad.h"

#include "log/censuslog.h"
#include "model/gedcomindex.h"
#include "platform/clock.h"
#include "settings/settings.h"
#include "support/censusentries.h"
#include "support/testfiles.h"
#include "writer/linewriter.h"
#include "writer/rewritefile.h"

#include <QDir>
#include <QFileInfo>
#include <QLockFile>
#include <QProcess>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <functional>

#ifdef Q_OS_WIN
#include <windows.h>
#else
#include <sys/stat.h>
#include <unistd.h>
#endif
#ifdef Q_OS_LINUX
#include <sys/resource.h>

#include <cerrno>
#include <csignal>
#include <cstring>
#endif

using namespace qm;
using qmtest::readfile;

namespace {

// A family file of two individuals of the entry and, when asked, enough
// others to make the rewrite flush several times before its end.
std::string familybytes(int filler)
{
    std::string s = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n";
    for (int i = 3; i < 3 + filler; ++i)
        s += "0 @I" + std::to_string(i) + "@ INDI\r\n1 NAME Filler Person Number " + std::to_string(i)
            + " /Padding/\r\n1 BIRT\r\n2 DATE 1 JAN 1850\r\n2 PLAC Somewhere, Yorkshire, England\r\n";
    s += "0 @S1@ SOUR\r\n1 TITL Census 1851 Leeds\r\n0 TRLR\r\n";
    return s;
}

class SaveRoad : public ::testing::Test {
protected:
    void SetUp() override { prepare(0); }
    void TearDown() override
    {
        setclockfortests(QDateTime());
        setwritefaultfortests(writefault());
        setinputfaultfortests(false);
        setsavehookfortests({});
    }

    void prepare(int filler)
    {
        ASSERT_TRUE(dir.isValid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 50, 7)));
        QDir(dir.path()).mkpath(QStringLiteral("backups"));
        family = dir.filePath(QStringLiteral("family.ged"));
        original = familybytes(filler);
        qmtest::writefile(family, original);
        setmodified(family, QDateTime(QDate(2024, 5, 6), QTime(7, 8, 9)).toMSecsSinceEpoch());
        before = stampof(family);

        index.gedcomfile = family;
        index.gedcomdate = before;
        index.encoding = textencoding::windows1252;
        index.people.clear();
        for (int id = 1; id <= 2 + filler; ++id) {
            personrec p;
            p.id = id;
            index.people.push_back(p);
        }
        index.nextsourceid = 2;

        s.backupfolder = dir.filePath(QStringLiteral("backups"));
        s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
        s.keeplog = true;

        entry = qmtest::censusof(QStringLiteral("2"), "Census 1851 Leeds HO107/2319 (John Smith)", "Leeds, Yorkshire",
                                 "30 MAR 1851");
        entry.reference = QStringLiteral("HO107/2319");
        entry.sourcetext = QStringLiteral("John Smith Head 40\r\nMary Smith Wife 38");
        entry.year = 1851;
        entry.selection = {qmtest::chosen(1, 0, "Smith, John", "40"), qmtest::chosen(2, 1, "Smith, Mary", "38")};
    }

    QStringList backups() const { return QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files); }
    QString lockpath() const { return family + QStringLiteral(".quillmark-lock"); }
    // Nothing but the family file is left beside it (no temporary files).
    QStringList besidefamily() const
    {
        return QDir(dir.path()).entryList(QDir::Files | QDir::Hidden, QDir::Name);
    }
    void expectuntouched()
    {
        EXPECT_EQ(readfile(family), original);
        EXPECT_EQ(stampof(family), before);
        EXPECT_FALSE(QFileInfo::exists(s.logpath)) << "no log entry for a change not made";
    }

    QTemporaryDir dir;
    QString family;
    std::string original;
    filestamp before;
    gedcomindex index;
    settings s;
    censusentry entry;
};

// What tells a file apart from others on its disk, and its number of names.
struct fileidentity {
    quint64 index = 0;
    quint64 links = 0;
};

#ifdef Q_OS_WIN
// A symbolic link (QFile::link makes a shortcut on Windows, which opening a
// file does not follow). Windows makes them without privileges in developer mode.
bool symlink(const QString& target, const QString& name)
{
    const QString from = QDir::toNativeSeparators(target), to = QDir::toNativeSeparators(name);
    return CreateSymbolicLinkW(reinterpret_cast<const wchar_t*>(to.utf16()), reinterpret_cast<const wchar_t*>(from.utf16()),
                               SYMBOLIC_LINK_FLAG_ALLOW_UNPRIVILEGED_CREATE);
}

bool hardlink(const QString& existing, const QString& name)
{
    const QString from = QDir::toNativeSeparators(existing), to = QDir::toNativeSeparators(name);
    return CreateHardLinkW(reinterpret_cast<const wchar_t*>(to.utf16()), reinterpret_cast<const wchar_t*>(from.utf16()),
                           nullptr);
}

fileidentity identityof(const QString& path)
{
    const QString native = QDir::toNativeSeparators(path);
    const HANDLE h = CreateFileW(reinterpret_cast<const wchar_t*>(native.utf16()), FILE_READ_ATTRIBUTES,
                                 FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_EXISTING, 0, nullptr);
    fileidentity id;
    BY_HANDLE_FILE_INFORMATION info;
    if (h != INVALID_HANDLE_VALUE && GetFileInformationByHandle(h, &info))
        id = {(quint64(info.nFileIndexHigh) << 32) | info.nFileIndexLow, info.nNumberOfLinks};
    if (h != INVALID_HANDLE_VALUE)
        CloseHandle(h);
    return id;
}
#else
bool symlink(const QString& target, const QString& name)
{
    return QFile::link(target, name);
}

bool hardlink(const QString& existing, const QString& name)
{
    return ::link(QFile::encodeName(existing).constData(), QFile::encodeName(name).constData()) == 0;
}

fileidentity identityof(const QString& path)
{
    struct stat st;
    if (::stat(QFile::encodeName(path).constData(), &st) != 0)
        return {};
    return {quint64(st.st_ino), quint64(st.st_nlink)};
}
#endif

} // namespace

TEST_F(SaveRoad, SavesBacksUpAndLogs)
{
    ASSERT_EQ(identityof(family).links, 1u);
    const saveoutcome out = saveentry(index, s, entry);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_FALSE(out.rewrite.inplace) << "a file of one name is replaced whole (rename, ReplaceFileW on Windows)";
    EXPECT_EQ(QFileInfo(out.backuppath).fileName(), QStringLiteral("QM Backup 2026_12_04_23_50_07.ged"));
    EXPECT_EQ(readfile(out.backuppath), original);
    EXPECT_EQ(stampof(out.backuppath).modified, before.modified) << "the backup keeps the file's time";

    const std::string now = readfile(family);
    EXPECT_NE(now.find("0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 30 MAR 1851\r\n2 PLAC Leeds, Yorkshire\r\n"
                       "2 AGE 40y\r\n2 SOUR @S2@\r\n"),
              std::string::npos)
        << now;
    EXPECT_NE(now.find("0 @S2@ SOUR\r\n"), std::string::npos);
    EXPECT_EQ(out.newstamp, stampof(family));
    EXPECT_TRUE(out.logwritten);
    const std::string log = readfile(s.logpath);
    EXPECT_NE(log.find("Source created: Census 1851 Leeds HO107/2319 (John Smith) (ID: 2)\r\n"), std::string::npos);
    EXPECT_NE(log.find("Name: Smith, Mary (2) : created census event\r\n"), std::string::npos);
    EXPECT_EQ(besidefamily(), (QStringList{QStringLiteral("censuslog.txt"), QStringLiteral("family.ged")}));
}

TEST_F(SaveRoad, NoLogWhenOff)
{
    s.keeplog = false;
    const saveoutcome out = saveentry(index, s, entry);
    ASSERT_TRUE(out.saved());
    EXPECT_FALSE(out.logwritten);
    EXPECT_FALSE(QFileInfo::exists(s.logpath));
}

TEST_F(SaveRoad, ChangedFileIsNeverWrittenOver)
{
    index.gedcomdate.modified -= 5000;
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::changed);
    EXPECT_EQ(out.message, QDir::toNativeSeparators(family)
                               + QStringLiteral(" has been modified by another application and will be reloaded."));
    EXPECT_TRUE(backups().isEmpty());
    expectuntouched();

    index.gedcomdate = before;
    index.gedcomdate.size += 1;
    entry.chosenimages.push_back(imagechoice{});
    EXPECT_TRUE(saveentry(index, s, entry).message.contains(QStringLiteral("will need to be reselected")));
}

TEST_F(SaveRoad, TextTheFileCannotHoldIsRefusedFirst)
{
    entry.selection[1].occupation = QStringLiteral("Weaver \u2227");
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::refused);
    EXPECT_TRUE(out.message.contains(QStringLiteral("occupation of Smith, Mary"))) << out.message.toStdString();
    EXPECT_TRUE(backups().isEmpty());
    expectuntouched();
}

TEST_F(SaveRoad, FailedBackupWritesNothing)
{
    s.backupfolder = dir.filePath(QStringLiteral("missing"));
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::backupfailed);
    EXPECT_TRUE(out.message.startsWith(QStringLiteral("There was an error when attempting to back up")));
    EXPECT_FALSE(out.fatal());
    expectuntouched();
}

// Every way the write can fail leaves the family file as it was, keeps the
// backup and writes no log entry; the message is the one after which the
// program closes.
struct faultcase {
    const char* name;
    bool input;
    writefault fault;
};
constexpr int64_t nearend = -2; // a write error at the family file's own size, near the end of the new one

class SaveRoadFault : public SaveRoad, public ::testing::WithParamInterface<faultcase> {};

TEST_P(SaveRoadFault, FamilyFileStaysByteForByte)
{
    prepare(30000); // several megabytes: the middle of the write is a real flush
    ASSERT_GT(original.size(), 3u << 20);
    setinputfaultfortests(GetParam().input);
    writefault fault = GetParam().fault;
    if (fault.failafterbytes == nearend)
        fault.failafterbytes = static_cast<int64_t>(original.size());
    setwritefaultfortests(fault);
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::rewritefailed);
    EXPECT_TRUE(out.fatal());
    EXPECT_TRUE(out.message.startsWith(QStringLiteral("An error occurred (")));
    EXPECT_TRUE(out.message.endsWith(QStringLiteral("): Census entry not added and program will close when you press OK")))
        << out.message.toStdString();
    expectuntouched();
    ASSERT_EQ(backups().size(), 1);
    EXPECT_EQ(readfile(out.backuppath), original);
    EXPECT_EQ(besidefamily(), QStringList{QStringLiteral("family.ged")}) << "no temporary file left behind";
}

INSTANTIATE_TEST_SUITE_P(
    EveryStep, SaveRoadFault,
    ::testing::Values(faultcase{"CannotOpenInput", true, {}}, faultcase{"CannotCreateOutput", false, {true, -1, false}},
                      faultcase{"WriteErrorAtTheFirstByte", false, {false, 0, false}},
                      faultcase{"WriteErrorAfterOneByte", false, {false, 1, false}},
                      faultcase{"WriteErrorInTheMiddle", false, {false, 1500000, false}},
                      faultcase{"WriteErrorNearTheEnd", false, {false, nearend, false}},
                      faultcase{"CannotReplace", false, {false, -1, true}}),
    [](const ::testing::TestParamInfo<faultcase>& i) { return std::string(i.param.name); });

#ifdef Q_OS_LINUX
// A write the system refuses (here: past the largest file this process may
// write) is reported in the system's words, never as "Unknown error".
TEST_F(SaveRoad, WriteErrorsGiveTheSystemsReason)
{
    struct rlimit old;
    ASSERT_EQ(getrlimit(RLIMIT_FSIZE, &old), 0);
    const auto oldsignal = std::signal(SIGXFSZ, SIG_IGN);
    struct rlimit small = old;
    small.rlim_cur = original.size() + 16; // the backup fits, the new content is longer
    ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &small), 0);
    const saveoutcome out = saveentry(index, s, entry);
    setrlimit(RLIMIT_FSIZE, &old);
    std::signal(SIGXFSZ, oldsignal);
    EXPECT_EQ(out.status, savestatus::rewritefailed);
    EXPECT_EQ(out.message, rewritefailuremessage(rewritemode::censusentry, QString::fromLocal8Bit(strerror(EFBIG))));
    expectuntouched();
}
#endif

TEST_F(SaveRoad, BackupMadeAheadIsUsedOnlyWhenItHoldsTheFileAsLoaded)
{
    backupresult made = makebackup(family, s.backupfolder);
    ASSERT_TRUE(made.ok());
    saveoutcome out = saveentry(index, s, entry, &made);
    ASSERT_TRUE(out.saved());
    EXPECT_EQ(out.backuppath, made.path);
    EXPECT_EQ(backups().size(), 1);

    // A copy of something else (here: the file as it is now) is replaced by a true backup.
    setclockfortests(QDateTime(QDate(2026, 12, 5), QTime(1, 2, 3)));
    const std::string saved = readfile(family);
    made = makebackup(family, s.backupfolder);
    qmtest::writefile(made.path, "junk");
    index.gedcomdate = out.newstamp;
    out = saveentry(index, s, entry, &made);
    ASSERT_TRUE(out.saved());
    EXPECT_EQ(readfile(out.backuppath), saved);
    EXPECT_EQ(stampof(out.backuppath).modified, index.gedcomdate.modified);
    EXPECT_EQ(backups().size(), 2);

    // Refused: the backup made ahead goes too.
    made = makebackup(family, s.backupfolder);
    index.gedcomdate.size += 1;
    EXPECT_EQ(saveentry(index, s, entry, &made).status, savestatus::changed);
    EXPECT_FALSE(QFileInfo::exists(made.path));
    EXPECT_EQ(backups().size(), 2);
}

// Another Quillmark saving the same family file: this save waits for nothing
// and writes nothing, and says what to do.
TEST_F(SaveRoad, OneSaveOfAFamilyFileAtATimeAcrossQuillmarks)
{
    QLockFile other(lockpath());
    ASSERT_TRUE(other.tryLock(0));
    saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::refused);
    EXPECT_TRUE(out.message.startsWith(QStringLiteral("Another Quillmark (process "))) << out.message.toStdString();
    EXPECT_TRUE(out.message.contains(QDir::toNativeSeparators(lockpath()))) << "names the lock to delete";
    EXPECT_TRUE(backups().isEmpty());
    expectuntouched();

    other.unlock();
    out = saveentry(index, s, entry);
    EXPECT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_FALSE(QFileInfo::exists(lockpath())) << "the lock goes with the save";
}

TEST_F(SaveRoad, LockLeftByAQuillmarkThatEndedIsTakenOver)
{
    // The lock file a process that has ended left behind, as QLockFile writes it.
    QProcess ended;
#ifdef Q_OS_WIN
    ended.start(QStringLiteral("cmd"), {QStringLiteral("/c"), QStringLiteral("exit 0")});
#else
    ended.start(QStringLiteral("sh"), {QStringLiteral("-c"), QStringLiteral("exit 0")});
#endif
    ASSERT_TRUE(ended.waitForStarted());
    const qint64 pid = ended.processId();
    ASSERT_TRUE(ended.waitForFinished());
    {
        QLockFile model(dir.filePath(QStringLiteral("model.lock")));
        ASSERT_TRUE(model.tryLock(0));
        QString text = QString::fromUtf8(readfile(dir.filePath(QStringLiteral("model.lock"))));
        text = QString::number(pid) + text.mid(text.indexOf(u'\n'));
        qmtest::writefile(lockpath(), text.toStdString());
    }
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_FALSE(QFileInfo::exists(lockpath()));
}

// Another program changes the file at any moment of the save: the change is
// found, nothing is written over it, and only the file as it left it remains.
class SaveRoadOutsideChange : public SaveRoad, public ::testing::WithParamInterface<savestep> {};

TEST_P(SaveRoadOutsideChange, IsNeverWrittenOver)
{
    const std::string appended = "0 @N9@ NOTE written by another program\r\n";
    setsavehookfortests([&](savestep step) {
        if (step != GetParam())
            return;
        QFile f(family);
        ASSERT_TRUE(f.open(QIODevice::Append));
        f.write(appended.data(), static_cast<qint64>(appended.size()));
    });
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::changed);
    EXPECT_TRUE(out.message.endsWith(QStringLiteral("has been modified by another application and will be reloaded.")));
    EXPECT_EQ(readfile(family), original + appended);
    EXPECT_TRUE(backups().isEmpty()) << "the backup of a change not made is removed";
    EXPECT_EQ(besidefamily(), QStringList{QStringLiteral("family.ged")}) << "no temporary file, no lock, no log";
}

INSTANTIATE_TEST_SUITE_P(EveryStep, SaveRoadOutsideChange,
                         ::testing::Values(savestep::locked, savestep::backedup, savestep::written),
                         [](const ::testing::TestParamInfo<savestep>& i) {
                             return std::string(i.param == savestep::locked     ? "BeforeTheFirstLook"
                                                : i.param == savestep::backedup ? "WhileTheBackupIsMade"
                                                                                : "WhileTheNewFileIsWritten");
                         });

// A census log that cannot be written is reported with the system's reason;
// the change itself stands.
struct logfaultcase {
    const char* name;
    const char* path; // null: a folder that is not there
};

class SaveRoadLogFault : public SaveRoad, public ::testing::WithParamInterface<logfaultcase> {};

TEST_P(SaveRoadLogFault, IsReportedNotClaimed)
{
    s.logpath = GetParam().path ? QString::fromLatin1(GetParam().path) : dir.filePath(QStringLiteral("nofolder/log.txt"));
    if (GetParam().path && !QFileInfo::exists(s.logpath))
        GTEST_SKIP() << GetParam().path << " is not on this system";
    const saveoutcome out = saveentry(index, s, entry);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_FALSE(out.logwritten);
    EXPECT_TRUE(out.logerror.startsWith(QStringLiteral("Quillmark was unable to add a log entry for this record to the log file ")
                                        + QDir::toNativeSeparators(s.logpath) + QStringLiteral(" (")))
        << out.logerror.toStdString();
}

INSTANTIATE_TEST_SUITE_P(Logs, SaveRoadLogFault,
                         ::testing::Values(logfaultcase{"MissingFolder", nullptr}, logfaultcase{"FullDisk", "/dev/full"},
                                           logfaultcase{"FileThatTakesNoWriting", "/proc/version"}),
                         [](const auto& i) { return std::string(i.param.name); });

// The census log is never written into a family file or a backup.
struct logpathcase {
    const char* name;
    std::function<QString(const QString& dir, const QString& family)> path;
    const char* says;
};

class SaveRoadLogPath : public SaveRoad, public ::testing::WithParamInterface<logpathcase> {};

TEST_P(SaveRoadLogPath, IsRefusedBeforeAnythingIsWritten)
{
    const QString log = GetParam().path(dir.path(), family);
    if (log.isEmpty())
        GTEST_SKIP() << "no symbolic link that leads to the family file can be made here";
    s.logpath = log;
    const std::string before = readfile(log);
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::refused);
    EXPECT_TRUE(out.message.contains(QString::fromUtf8(GetParam().says))) << out.message.toStdString();
    EXPECT_TRUE(out.message.endsWith(QStringLiteral("Nothing has been changed.")));
    EXPECT_EQ(readfile(family), original);
    EXPECT_EQ(readfile(log), before);
    EXPECT_TRUE(backups().isEmpty());
}

INSTANTIATE_TEST_SUITE_P(
    Paths, SaveRoadLogPath,
    ::testing::Values(
        logpathcase{"TheFamilyFile", [](const QString&, const QString& f) { return f; }, "is the family file itself"},
        logpathcase{"TheFamilyFileThroughALink",
                    [](const QString& d, const QString& f) {
                        const QString link = QDir(d).filePath(QStringLiteral("log.txt"));
                        // Under Wine a link is made that does not lead to the file.
                        return symlink(f, link) && readfile(link) == readfile(f) ? link : QString();
                    },
                    "is the family file itself"},
        logpathcase{"AnotherGedcomFile",
                    [](const QString& d, const QString&) { return QDir(d).filePath(QStringLiteral("other.GED")); },
                    "is a GEDCOM file"},
        logpathcase{"InTheBackupFolder",
                    [](const QString& d, const QString&) { return QDir(d).filePath(QStringLiteral("backups/log.txt")); },
                    "is in the backup folder"}),
    [](const auto& i) { return std::string(i.param.name); });

// A file with a second name keeps it: the new content is copied into the file
// itself after the backup is on the disk.
TEST_F(SaveRoad, LinkedFileIsWrittenInPlace)
{
    const QString other = dir.filePath(QStringLiteral("other name.ged"));
    ASSERT_TRUE(hardlink(family, other));
    const fileidentity before = identityof(family);
    ASSERT_EQ(before.links, 2u);
    const saveoutcome out = saveentry(index, s, entry);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_TRUE(out.rewrite.inplace);
    const fileidentity after = identityof(family);
    EXPECT_EQ(after.index, before.index);
    EXPECT_EQ(after.links, 2u);
    EXPECT_EQ(readfile(other), readfile(family));
    EXPECT_NE(readfile(family), original);
    EXPECT_EQ(readfile(out.backuppath), original);
    EXPECT_EQ(out.newstamp, stampof(family));
}
