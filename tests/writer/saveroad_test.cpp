// The save from start to end (backup, rewrite, census log, the lock between
// Quillmarks) and its hostile cases: another program's change at each step,
// a failure at each step of the write, full disks, links, logs that must not
// be written.
#include "writer/saveroad.h"

#include "model/loadgedcom.h"
#include "platform/scriptedprompts.h"
#include "support/savefolder.h"
#include "support/censusentries.h"
#include "writer/saveprompts.h"

#include <QFileInfo>
#include <QLockFile>
#include <QProcess>

#include <functional>
#include <optional>

#ifdef Q_OS_WIN
#include <windows.h>
#else
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

const QString changedtail = QStringLiteral(" has been modified by another application and will be reloaded.");

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
#else
bool symlink(const QString& target, const QString& name)
{
    return QFile::link(target, name);
}

bool hardlink(const QString& existing, const QString& name)
{
    return ::link(QFile::encodeName(existing).constData(), QFile::encodeName(name).constData()) == 0;
}
#endif

// John and Mary, the two of the entry, and when asked enough others to make
// the rewrite flush several times before its end.
class SaveRoad : public qmtest::savefolder {
protected:
    void SetUp() override
    {
        savefolder::SetUp();
        prepare(0);
    }
    void prepare(int filler)
    {
        original = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n";
        for (int i = 3; i < 3 + filler; ++i)
            original += "0 @I" + std::to_string(i) + "@ INDI\r\n1 NAME Filler Person Number " + std::to_string(i)
                        + " /Padding/\r\n1 BIRT\r\n2 DATE 1 JAN 1850\r\n2 PLAC Somewhere, Yorkshire, England\r\n";
        original += "0 @S1@ SOUR\r\n1 TITL Census 1851 Leeds\r\n0 TRLR\r\n";
        putfamily(original);
        before = stampof(family);
        loadresult loaded = loadgedcom(family, {});
        ASSERT_TRUE(loaded.index);
        index = std::move(*loaded.index);
        entry = qmtest::censusof(QStringLiteral("2"), "Census 1851 Leeds HO107/2319 (John Smith)", "Leeds, Yorkshire",
                                 "30 MAR 1851");
        entry.reference = QStringLiteral("HO107/2319");
        entry.sourcetext = QStringLiteral("John Smith Head 40\r\nMary Smith Wife 38");
        entry.year = 1851;
        entry.selection = {qmtest::chosen(1, 0, "Smith, John", "40"), qmtest::chosen(2, 1, "Smith, Mary", "38")};
    }

    QString lockpath() const { return family + QStringLiteral(".quillmark-lock"); }
    // The family file as it was, no backup, no log entry for a change not made.
    void expectuntouched(bool backupkept = false)
    {
        EXPECT_EQ(readfile(family), original);
        EXPECT_EQ(stampof(family), before);
        EXPECT_EQ(besidefamily(), QStringList{QStringLiteral("family.ged")}) << "no temporary file, lock or log";
        EXPECT_TRUE(backupkept || backups().isEmpty());
    }

    std::string original;
    filestamp before;
    gedcomindex index;
    censusentry entry;
};

} // namespace

TEST_F(SaveRoad, SavesBacksUpAndLogs)
{
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

// What is found before the backup stops the save with the family file untouched.
TEST_F(SaveRoad, RefusalsBeforeTheBackupTouchNothing)
{
    const struct {
        const char* name;
        std::function<void()> set;
        savestatus status;
        QString says; // the message's start
    } rows[] = {
        {"changed by another program", [this] { index.gedcomdate.modified -= 5000; }, savestatus::changed,
         QDir::toNativeSeparators(family) + changedtail},
        {"text the file cannot hold", [this] { entry.selection[1].occupation = QStringLiteral("Weaver \u2227"); },
         savestatus::refused, QStringLiteral("The occupation of Smith, Mary holds")},
        {"no backup folder", [this] { s.backupfolder = dir.filePath(QStringLiteral("missing")); },
         savestatus::backupfailed, QStringLiteral("There was an error when attempting to back up")},
    };
    const settings kept = s;
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        prepare(0);
        s = kept;
        row.set();
        const saveoutcome out = saveentry(index, s, entry);
        EXPECT_EQ(out.status, row.status);
        EXPECT_TRUE(out.message.startsWith(row.says)) << out.message.toStdString();
        EXPECT_FALSE(out.fatal());
        expectuntouched();
    }
    // A changed file with images chosen: the user is told to choose them again.
    prepare(0);
    index.gedcomdate.size += 1;
    entry.chosenimages.push_back(imagechoice{});
    EXPECT_TRUE(saveentry(index, s, entry).message.contains(QStringLiteral("will need to be reselected")));
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
    expectuntouched(true);
    ASSERT_EQ(backups().size(), 1);
    EXPECT_EQ(readfile(out.backuppath), original);
}

INSTANTIATE_TEST_SUITE_P(
    EveryStep, SaveRoadFault,
    ::testing::Values(faultcase{"CannotOpenInput", true, {}}, faultcase{"CannotCreateOutput", false, {true, -1, false}},
                      faultcase{"WriteErrorAtTheFirstByte", false, {false, 0, false}},
                      faultcase{"WriteErrorAfterOneByte", false, {false, 1, false}},
                      faultcase{"WriteErrorInTheMiddle", false, {false, 1500000, false}},
                      faultcase{"WriteErrorNearTheEnd", false, {false, nearend, false}},
                      faultcase{"CannotReplace", false, {false, -1, true}}),
    [](const auto& i) { return std::string(i.param.name); });

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
    expectuntouched(true);
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

// Another Quillmark saving the same family file: this save waits for nothing,
// writes nothing and says what to do; a lock left by one that has ended is
// taken over.
TEST_F(SaveRoad, OneSaveOfAFamilyFileAtATimeAcrossQuillmarks)
{
    QLockFile other(lockpath());
    ASSERT_TRUE(other.tryLock(0));
    saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::refused);
    EXPECT_TRUE(out.message.startsWith(QStringLiteral("Another Quillmark (process "))) << out.message.toStdString();
    EXPECT_TRUE(out.message.contains(QDir::toNativeSeparators(lockpath()))) << "names the lock to delete";
    EXPECT_TRUE(backups().isEmpty());
    EXPECT_EQ(readfile(family), original);
    EXPECT_FALSE(QFileInfo::exists(s.logpath));

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
    const QString text = QString::fromUtf8(readfile(lockpath()));
    other.unlock();
    qmtest::writefile(lockpath(), (QString::number(pid) + text.mid(text.indexOf(u'\n'))).toStdString());
    out = saveentry(index, s, entry);
    EXPECT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_FALSE(QFileInfo::exists(lockpath())) << "the lock goes with the save";
}

// Another program changes the file at any moment of the save: the change is
// found, nothing is written over it, and only the file as it left it remains.
class SaveRoadOutsideChange : public SaveRoad, public ::testing::WithParamInterface<savestep> {};

TEST_P(SaveRoadOutsideChange, IsNeverWrittenOver)
{
    const std::string appended = "0 @N9@ NOTE written by another program\r\n";
    setsavehookfortests([&](savestep step) {
        if (step == GetParam())
            qmtest::writefile(family, original + appended);
    });
    const saveoutcome out = saveentry(index, s, entry);
    EXPECT_EQ(out.status, savestatus::changed);
    EXPECT_TRUE(out.message.endsWith(changedtail));
    EXPECT_EQ(readfile(family), original + appended);
    EXPECT_TRUE(backups().isEmpty()) << "the backup of a change not made is removed";
    EXPECT_EQ(besidefamily(), QStringList{QStringLiteral("family.ged")}) << "no temporary file, no lock, no log";
}

INSTANTIATE_TEST_SUITE_P(EveryStep, SaveRoadOutsideChange,
                         ::testing::Values(savestep::locked, savestep::backedup, savestep::written),
                         [](const auto& i) {
                             return std::string(i.param == savestep::locked     ? "BeforeTheFirstLook"
                                                : i.param == savestep::backedup ? "WhileTheBackupIsMade"
                                                                                : "WhileTheNewFileIsWritten");
                         });

// A census log that cannot be written (no folder, a full disk, a file that
// takes no writing) is reported with the system's reason; the change stands.
// Nor is a log claimed when it is off.
TEST_F(SaveRoad, LogThatCannotBeWrittenIsReportedNotClaimed)
{
    s.keeplog = false;
    const saveoutcome off = saveentry(index, s, entry);
    ASSERT_TRUE(off.saved());
    EXPECT_FALSE(off.logwritten || QFileInfo::exists(s.logpath));
    s.keeplog = true;
    for (const QString& log : {dir.filePath(QStringLiteral("nofolder/log.txt")), QStringLiteral("/dev/full"),
                               QStringLiteral("/proc/version")}) {
        SCOPED_TRACE(log.toStdString());
        if (!log.startsWith(dir.path()) && !QFileInfo::exists(log))
            continue; // not on this system
        prepare(0);
        s.logpath = log;
        const saveoutcome out = saveentry(index, s, entry);
        ASSERT_TRUE(out.saved()) << out.message.toStdString();
        EXPECT_FALSE(out.logwritten);
        EXPECT_TRUE(out.logerror.startsWith(QStringLiteral("Quillmark was unable to add a log entry for this record to the log file ")
                                            + QDir::toNativeSeparators(s.logpath) + QStringLiteral(" (")))
            << out.logerror.toStdString();
    }
}

// The census log is never written into a family file or a backup.
TEST_F(SaveRoad, LogPathOfAFamilyFileOrBackupIsRefusedBeforeAnythingIsWritten)
{
    const QString link = dir.filePath(QStringLiteral("log.txt"));
    // Under Wine a link is made that does not lead to the file.
    const bool linked = symlink(family, link) && readfile(link) == original;
    const struct {
        QString log;
        const char* says;
    } rows[] = {
        {family, "is the family file itself"},
        {linked ? link : QString(), "is the family file itself"},
        {dir.filePath(QStringLiteral("other.GED")), "is a GEDCOM file"},
        {dir.filePath(QStringLiteral("backups/log.txt")), "is in the backup folder"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.log.toStdString());
        if (row.log.isEmpty())
            continue; // no symbolic link that leads to the family file can be made here
        s.logpath = row.log;
        const std::string logbefore = readfile(row.log);
        const saveoutcome out = saveentry(index, s, entry);
        EXPECT_EQ(out.status, savestatus::refused);
        EXPECT_TRUE(out.message.contains(QString::fromUtf8(row.says))) << out.message.toStdString();
        EXPECT_TRUE(out.message.endsWith(QStringLiteral("Nothing has been changed.")));
        EXPECT_EQ(readfile(family), original);
        EXPECT_EQ(readfile(row.log), logbefore);
        EXPECT_TRUE(backups().isEmpty());
    }
}

// A file with a second name keeps it: the new content is copied into the file
// itself after the backup is on the disk, and shows under both names.
TEST_F(SaveRoad, LinkedFileIsWrittenInPlace)
{
    const QString other = dir.filePath(QStringLiteral("other name.ged"));
    ASSERT_TRUE(hardlink(family, other));
    const saveoutcome out = saveentry(index, s, entry);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_TRUE(out.rewrite.inplace);
    EXPECT_NE(readfile(family), original);
    EXPECT_EQ(readfile(other), readfile(family));
    EXPECT_EQ(readfile(out.backuppath), original);
    EXPECT_EQ(out.newstamp, stampof(family));
}

// Each outcome of a save: what the window is told is left, and the one
// message shown (with its icon), or none.
TEST(SavePrompts, EachOutcomeTellsTheWindowAndShowsAtMostOneMessage)
{
    const struct {
        savestatus status;
        const char* logerror;
        aftersave after;
        std::optional<icon> shown;
    } rows[] = {
        {savestatus::refused, "", aftersave::stay, icon::exclamation},
        {savestatus::backupfailed, "", aftersave::stay, icon::exclamation},
        {savestatus::rewritefailed, "", aftersave::fatal, icon::critical},
        {savestatus::changed, "", aftersave::changed, std::nullopt}, // the window's own words
        {savestatus::saved, "", aftersave::saved, std::nullopt},
        {savestatus::saved, "The census log could not be written", aftersave::saved, icon::critical},
    };
    for (const auto& r : rows) {
        SCOPED_TRACE(static_cast<int>(r.status));
        saveoutcome out;
        out.status = r.status;
        out.message = QStringLiteral("It went wrong");
        out.logerror = QString::fromLatin1(r.logerror);
        scriptedprompts p;
        if (r.shown)
            p.expect(answer::ok, *r.logerror ? QStringLiteral("census log") : QStringLiteral("went wrong"));
        EXPECT_EQ(tellsaveoutcome(p, out), r.after);
        ASSERT_EQ(p.history().size(), r.shown ? 1u : 0u);
        if (r.shown) {
            EXPECT_EQ(p.history()[0].m.kind, *r.shown);
        }
        EXPECT_EQ(p.unexpected(), 0);
    }
}
