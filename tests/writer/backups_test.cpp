// Backups of the family file: their names and bytes, failures told in the
// system's words, the folder checks, the removal of old backups, and two
// Quillmarks backing up into one folder at once.
#include "writer/backups.h"

#include "platform/scriptedprompts.h"
#include "support/savefolder.h"
#include "support/readonlyfolder.h"

#include <QFile>
#include <QFileInfo>

#include <thread>
#include <utility>
#include <vector>

using namespace qm;
using qmtest::readfile;
using qmtest::writefile;

namespace {

class Backups : public qmtest::savefolder {
protected:
    void SetUp() override
    {
        savefolder::SetUp();
        folder = s.backupfolder;
        putfamily("0 HEAD\r\n0 TRLR\r\n");
    }

    // A file in the backup folder with a given last-modified day.
    void put(const QString& name, int day)
    {
        const QString path = QDir(folder).filePath(name);
        writefile(path, "x");
        setmodified(path, QDateTime(QDate(2021, 3, day), QTime(12, 0)).toMSecsSinceEpoch());
    }
    QStringList names() const { return QDir(folder).entryList(QDir::Files, QDir::Name); }

    QString folder;
    scriptedprompts prompts;
};

} // namespace

// A copy with the file's bytes and time; a second one in the same second gets
// a suffix. (A read-only family file, as a shared one may be, backs up all the same.)
TEST_F(Backups, CopyKeepsBytesAndTimeAndSameSecondGetsSuffixes)
{
    QFile::setPermissions(family, QFileDevice::ReadOwner);
    const filestamp before = stampof(family);
    QStringList got;
    for (int i = 0; i < 4; ++i) {
        const backupresult r = makebackup(family, folder);
        ASSERT_TRUE(r.ok()) << r.error.toStdString();
        EXPECT_EQ(readfile(r.path), readfile(family));
        EXPECT_EQ(stampof(r.path), before);
        got << QFileInfo(r.path).fileName();
    }
    EXPECT_EQ(stampof(family), before);
    EXPECT_EQ(got, (QStringList{QStringLiteral("QM Backup 2026_12_04_23_50_07.ged"),
                                QStringLiteral("QM Backup 2026_12_04_23_50_071.ged"),
                                QStringLiteral("QM Backup 2026_12_04_23_50_07 2.ged"),
                                QStringLiteral("QM Backup 2026_12_04_23_50_07 3.ged")}));
}

TEST_F(Backups, FailureGivesMessageAndLeavesNothing)
{
    const backupresult r = makebackup(family, dir.filePath(QStringLiteral("missing")));
    EXPECT_FALSE(r.ok());
    // With the system's reason, in its words.
#ifdef Q_OS_WIN
    EXPECT_TRUE(r.error.startsWith(backupfailedmessage() + QStringLiteral(" (")) && r.error.endsWith(u')')) << r.error.toStdString();
    EXPECT_GT(r.error.size(), backupfailedmessage().size() + 3);
#else
    EXPECT_EQ(r.error, backupfailedmessage() + QStringLiteral(" (No such file or directory)"));
#endif
    EXPECT_TRUE(r.error.startsWith(QStringLiteral("There was an error when attempting to back up your family historian file.")));
    EXPECT_FALSE(makebackup(dir.filePath(QStringLiteral("nofile.ged")), folder).ok());
    EXPECT_FALSE(makebackup(family, QStringLiteral(" ")).ok());
    EXPECT_TRUE(names().isEmpty());
}

TEST_F(Backups, FolderCheck)
{
    EXPECT_FALSE(checkbackupfolder(prompts, folder));
    EXPECT_TRUE(names().isEmpty()) << "the probe file is removed";
    prompts.expect(answer::ok, QStringLiteral("does not exist. "));
    EXPECT_TRUE(checkbackupfolder(prompts, dir.filePath(QStringLiteral("gone"))));
    EXPECT_EQ(prompts.unexpected(), 0);
}

TEST_F(Backups, ReadOnlyFolderCannotBeWrittenTo)
{
    const qmtest::readonlyfolder readonly(folder);
    if (!readonly.ineffective().isEmpty())
        GTEST_SKIP() << readonly.ineffective().toStdString();
    prompts.expect(answer::ok, QStringLiteral("can not be written to. ") + folder);
    EXPECT_TRUE(checkbackupfolder(prompts, folder));
    EXPECT_EQ(prompts.history().at(0).m.kind, icon::critical);
}

TEST_F(Backups, CheckPathsStopsAtLogProblem)
{
    s.logpath = dir.filePath(QStringLiteral("nofolder/censuslog.txt"));
    s.backupfolder = dir.filePath(QStringLiteral("gone")); // not reported: the log check came first
    prompts.expect(answer::ok, QStringLiteral("The current log file can not be written to ("));
    EXPECT_TRUE(checkpaths(prompts, s));
    EXPECT_EQ(prompts.unexpected(), 0);

    s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
    s.backupfolder = folder;
    EXPECT_FALSE(checkpaths(prompts, s));
    EXPECT_TRUE(QFileInfo::exists(s.logpath)) << "a missing log is created";
    s.keeplog = false;
    s.logpath = dir.filePath(QStringLiteral("nofolder/censuslog.txt"));
    EXPECT_FALSE(checkpaths(prompts, s));
}

TEST_F(Backups, RemoveOldNoneAndFewAndOldFormRenamedFirst)
{
    put(QStringLiteral("other.ged"), 1);
    prompts.expect(answer::ok, QStringLiteral("You have no Quillmark backup files to delete."));
    removeoldbackups(prompts, folder);
    put(QStringLiteral("Backup  12.ged"), 9);
    put(QStringLiteral("Backup  x.ged"), 10);
    for (int d = 1; d <= 4; ++d)
        put(QStringLiteral("QM Backup 2021_03_0%1_12_00_00.ged").arg(d), d);
    prompts.expect(answer::ok, QStringLiteral("You only have 5 Quillmark backup files and so none will be deleted"));
    removeoldbackups(prompts, folder);
    EXPECT_EQ(prompts.unexpected(), 0);
    EXPECT_EQ(names().size(), 7);
    EXPECT_TRUE(names().contains(QStringLiteral("QM Backup 2021_03_09_12_00_00.ged")));
    EXPECT_TRUE(names().contains(QStringLiteral("Backup  x.ged")));
}

TEST_F(Backups, RemoveOldKeepsFiveNewestByTime)
{
    // Names sort in the opposite order to their times.
    for (int d = 1; d <= 7; ++d)
        put(QStringLiteral("qm backup %1.GED").arg(8 - d), d);
    prompts.expect(answer::no, QStringLiteral("2 Quillmark backup files will be deleted leaving you with the 5 most recent backups."));
    removeoldbackups(prompts, folder);
    EXPECT_EQ(names().size(), 7);
    EXPECT_EQ(prompts.history().at(0).m.defaultanswer, answer::no);

    QFile::setPermissions(QDir(folder).filePath(QStringLiteral("qm backup 7.GED")), QFileDevice::ReadOwner);
    prompts.expect(answer::yes, QStringLiteral("2 Quillmark backup files"));
    prompts.expect(answer::ok, QStringLiteral("Deleted 2 backup files."));
    removeoldbackups(prompts, folder);
    EXPECT_EQ(names(), (QStringList{QStringLiteral("qm backup 1.GED"), QStringLiteral("qm backup 2.GED"),
                                    QStringLiteral("qm backup 3.GED"), QStringLiteral("qm backup 4.GED"),
                                    QStringLiteral("qm backup 5.GED")}));
    EXPECT_EQ(prompts.unexpected(), 0);
}

// Two Quillmarks backing up two family files into one folder in the same
// second: each takes a name of its own by creating it, none fails, and none
// removes or overwrites the other's backup.
TEST_F(Backups, BackupsMadeAtOnceNeverTakeEachOthersName)
{
    const QString second = dir.filePath(QStringLiteral("second.ged"));
    writefile(second, "0 HEAD\r\n1 NOTE the second family\r\n0 TRLR\r\n");
    constexpr int each = 150;
    std::vector<backupresult> a, b;
    std::thread other([&] {
        for (int i = 0; i < each; ++i)
            b.push_back(makebackup(second, folder));
    });
    for (int i = 0; i < each; ++i)
        a.push_back(makebackup(family, folder));
    other.join();
    for (const auto& [made, from] : {std::pair{&a, family}, std::pair{&b, second}})
        for (const backupresult& r : *made) {
            ASSERT_TRUE(r.ok()) << r.error.toStdString();
            EXPECT_EQ(readfile(r.path), readfile(from)) << r.path.toStdString();
        }
    EXPECT_EQ(names().size(), 2 * each) << "every backup made is there";
}
