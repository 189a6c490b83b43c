#include "writer/undolast.h"

#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "platform/filetime.h"
#include "settings/settings.h"
#include "support/censusentries.h"
#include "support/testfiles.h"
#include "writer/saveroad.h"

#include <QDir>
#include <QFile>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLockFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;
using qmtest::readfile;

namespace {

const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n"
                           "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n"
                           "0 TRLR\r\n";

class UndoLast : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 50, 7)));
        QDir(dir.path()).mkpath(QStringLiteral("backups"));
        path = dir.filePath(QStringLiteral("family.ged"));
        qmtest::writefile(path, family);
        setmodified(path, QDateTime(QDate(2024, 5, 6), QTime(7, 8, 9)).toMSecsSinceEpoch());
        s.backupfolder = dir.filePath(QStringLiteral("backups"));
        s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
        s.keeplog = true;
    }
    void TearDown() override { setclockfortests(QDateTime()); }

    // Saves a census entry for John and Mary; returns what the file then holds.
    std::string save()
    {
        loadresult loaded = loadgedcom(path, {});
        EXPECT_TRUE(loaded.index);
        censusentry e = qmtest::censusof(QString::number(loaded.index->nextsourceid), "Census 1851 Leeds HO107/2319",
                                         "Leeds", "30 MAR 1851");
        e.selection = {qmtest::chosen(1, 0, "Smith, John", "40"), qmtest::chosen(2, 1, "Smith, Mary", "38")};
        const saveoutcome out = saveentry(*loaded.index, s, e);
        EXPECT_TRUE(out.saved()) << out.message.toStdString();
        EXPECT_TRUE(out.undoerror.isEmpty()) << out.undoerror.toStdString();
        return readfile(path);
    }

    QStringList backups() const { return QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files); }
    QString notepath() const { return readlastchange(path, s.backupfolder).notepath; }

    // Refused, with the file and the backups as they were.
    void expectrefused(const undooutcome& u, const QString& says)
    {
        const std::string bytes = readfile(path);
        const qsizetype count = backups().size();
        EXPECT_EQ(u.status, undostatus::refused);
        EXPECT_TRUE(u.message.contains(says)) << u.message.toStdString();
        EXPECT_EQ(readfile(path), bytes);
        EXPECT_EQ(backups().size(), count);
    }

    QTemporaryDir dir;
    QString path;
    settings s;
};

} // namespace

TEST_F(UndoLast, PutsTheFileBackExactlyAndOnlyOnce)
{
    const std::string saved = save();
    const lastchange c = readlastchange(path, s.backupfolder);
    ASSERT_TRUE(c.known) << c.problem.toStdString();
    EXPECT_EQ(c.summary, QStringLiteral("Census entry added: Census 1851 Leeds HO107/2319 (ID: 1), 2 individuals"));
    EXPECT_TRUE(undoquestion(c).contains(c.summary));

    setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 55, 0)));
    const undooutcome u = undolast(path, s);
    ASSERT_TRUE(u.undone()) << u.message.toStdString();
    EXPECT_EQ(readfile(path), family) << "byte for byte the file before the save";
    EXPECT_EQ(readfile(u.backuppath), saved) << "the file as the save left it is backed up first";
    EXPECT_EQ(backups().size(), 2);
    EXPECT_EQ(u.newstamp, stampof(path));
    EXPECT_TRUE(u.logwritten);
    const std::string log = readfile(s.logpath);
    EXPECT_NE(log.find("Change undone: "), std::string::npos) << log;
    EXPECT_NE(log.find("Undone: Census entry added: Census 1851 Leeds HO107/2319 (ID: 1), 2 individuals (made "),
              std::string::npos)
        << log;
    // Nothing beside the family file but the log: no temporary file, no lock left.
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden, QDir::Name),
              (QStringList{QStringLiteral("censuslog.txt"), QStringLiteral("family.ged")}));

    // One step back, not a toggle.
    expectrefused(undolast(path, s), QStringLiteral("was undone at"));
    // The next change can be undone again.
    save();
    ASSERT_TRUE(undolast(path, s).undone());
    EXPECT_EQ(readfile(path), family);
}

TEST_F(UndoLast, RefusesAfterAnOutsideChange)
{
    const std::string saved = save();
    const filestamp after = stampof(path);
    const QString changed = QStringLiteral("has been changed since Quillmark's last change");

    // Another program appends a line.
    qmtest::writefile(path, saved + "0 @N1@ NOTE x\r\n");
    expectrefused(undolast(path, s), changed);

    // One digit changed with the size and the time put back as they were: only the content tells.
    std::string edited = saved;
    edited[edited.find("John")] = 'j';
    qmtest::writefile(path, edited);
    setmodified(path, after.modified);
    ASSERT_EQ(stampof(path), after);
    expectrefused(undolast(path, s), changed);

    // Put back as the save left it, the undo works.
    qmtest::writefile(path, saved);
    setmodified(path, after.modified);
    EXPECT_TRUE(undolast(path, s).undone());
}

TEST_F(UndoLast, RefusesWithoutAUsableNoteOrBackup)
{
    expectrefused(undolast(path, s), QStringLiteral("has no change"));
    save();
    const lastchange c = readlastchange(path, s.backupfolder);

    // The backup holding the old file removed (by hand, or by "Remove Old Backup Files...").
    const QString backup = c.backuppath;
    const std::string old = readfile(backup);
    QFile::remove(backup);
    expectrefused(undolast(path, s), QStringLiteral("is no longer there or has been changed"));
    qmtest::writefile(backup, old + "x");
    expectrefused(undolast(path, s), QStringLiteral("is no longer there or has been changed"));
    qmtest::writefile(backup, old);

    // A note edited to copy some other file over the family file, or not a note at all.
    QFile f(notepath());
    ASSERT_TRUE(f.open(QIODevice::ReadOnly));
    QJsonObject o = QJsonDocument::fromJson(f.readAll()).object();
    f.close();
    const auto tamper = [&](const char* key, const QString& value) {
        QJsonObject t = o;
        t.insert(QLatin1String(key), value);
        qmtest::writefile(notepath(), QJsonDocument(t).toJson().toStdString());
    };
    const QString other = dir.filePath(QStringLiteral("other.ged"));
    qmtest::writefile(other, "0 HEAD\r\n0 TRLR\r\n");
    tamper("backup", other);
    expectrefused(undolast(path, s), QStringLiteral("cannot be used"));
    tamper("file", other);
    expectrefused(undolast(path, s), QStringLiteral("it is the note of another file"));
    tamper("hash", QStringLiteral("zz"));
    expectrefused(undolast(path, s), QStringLiteral("cannot be used"));
    qmtest::writefile(notepath(), "{not json");
    expectrefused(undolast(path, s), QStringLiteral("cannot be used"));
}

TEST_F(UndoLast, WaitsForNoOtherQuillmark)
{
    save();
    QLockFile other(path + QStringLiteral(".quillmark-lock"));
    ASSERT_TRUE(other.tryLock(0));
    const std::string bytes = readfile(path);
    const undooutcome u = undolast(path, s);
    EXPECT_EQ(u.status, undostatus::refused);
    EXPECT_EQ(readfile(path), bytes);
    other.unlock();
    EXPECT_TRUE(undolast(path, s).undone());
}

TEST_F(UndoLast, FamilyFilesSharingABackupFolderKeepTheirOwnNotes)
{
    QString second = dir.filePath(QStringLiteral("second.ged"));
    qmtest::writefile(second, family);
    save();
    const std::string first = readfile(path);
    std::swap(path, second);
    save();
    std::swap(path, second);
    ASSERT_TRUE(undolast(second, s).undone());
    EXPECT_EQ(readfile(second), family);
    EXPECT_EQ(readfile(path), first) << "the other file is not touched";
    ASSERT_TRUE(undolast(path, s).undone());
    EXPECT_EQ(readfile(path), family);
}
