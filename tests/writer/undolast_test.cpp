// Undo of the last change: the file put back byte for byte, once, and only
// while nothing else has changed it, its backup and its note are sound, and no
// other Quillmark is saving it.
#include "writer/undolast.h"

#include "model/loadgedcom.h"
#include "support/savefolder.h"
#include "support/censusentries.h"

#include <QFile>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLockFile>

using namespace qm;
using qmtest::readfile;

namespace {

const std::string original = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n"
                             "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n0 TRLR\r\n";

class UndoLast : public qmtest::savefolder {
protected:
    void SetUp() override
    {
        savefolder::SetUp();
        putfamily(original);
    }

    // Saves a census entry for John and Mary; returns what the file then holds.
    std::string save()
    {
        loadresult loaded = loadgedcom(family, {});
        EXPECT_TRUE(loaded.index);
        censusentry e = qmtest::censusof(QString::number(loaded.index->nextsourceid), "Census 1851 Leeds HO107/2319",
                                         "Leeds", "30 MAR 1851");
        e.selection = {qmtest::chosen(1, 0, "Smith, John", "40"), qmtest::chosen(2, 1, "Smith, Mary", "38")};
        const saveoutcome out = saveentry(*loaded.index, s, e);
        EXPECT_TRUE(out.saved()) << out.message.toStdString();
        EXPECT_TRUE(out.undoerror.isEmpty()) << out.undoerror.toStdString();
        return readfile(family);
    }

    // Refused, with the file and the backups as they were.
    void expectrefused(const QString& says)
    {
        const std::string bytes = readfile(family);
        const qsizetype count = backups().size();
        const undooutcome u = undolast(family, s);
        EXPECT_EQ(u.status, undostatus::refused);
        EXPECT_TRUE(u.message.contains(says)) << u.message.toStdString();
        EXPECT_EQ(readfile(family), bytes);
        EXPECT_EQ(backups().size(), count);
    }
};

} // namespace

TEST_F(UndoLast, PutsTheFileBackExactlyAndOnlyOnce)
{
    const std::string saved = save();
    const lastchange c = readlastchange(family, s.backupfolder);
    ASSERT_TRUE(c.known) << c.problem.toStdString();
    EXPECT_EQ(c.summary, QStringLiteral("Census entry added: Census 1851 Leeds HO107/2319 (ID: 1), 2 individuals"));
    EXPECT_TRUE(undoquestion(c).contains(c.summary));

    setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 55, 0)));
    const undooutcome u = undolast(family, s);
    ASSERT_TRUE(u.undone()) << u.message.toStdString();
    EXPECT_EQ(readfile(family), original) << "byte for byte the file before the save";
    EXPECT_EQ(readfile(u.backuppath), saved) << "the file as the save left it is backed up first";
    EXPECT_EQ(backups().size(), 2);
    EXPECT_EQ(u.newstamp, stampof(family));
    EXPECT_TRUE(u.logwritten);
    const std::string log = readfile(s.logpath);
    EXPECT_NE(log.find("Change undone: "), std::string::npos) << log;
    EXPECT_NE(log.find("Undone: Census entry added: Census 1851 Leeds HO107/2319 (ID: 1), 2 individuals (made "),
              std::string::npos)
        << log;
    EXPECT_EQ(besidefamily(), (QStringList{QStringLiteral("censuslog.txt"), QStringLiteral("family.ged")}))
        << "no temporary file, no lock left";

    expectrefused(QStringLiteral("was undone at")); // one step back, not a toggle
    save();
    ASSERT_TRUE(undolast(family, s).undone()) << "the next change can be undone again";
    EXPECT_EQ(readfile(family), original);
}

TEST_F(UndoLast, RefusesAfterAnOutsideChange)
{
    const std::string saved = save();
    const filestamp after = stampof(family);
    const QString changed = QStringLiteral("has been changed since Quillmark's last change");
    qmtest::writefile(family, saved + "0 @N1@ NOTE x\r\n"); // another program appends a line
    expectrefused(changed);

    // One letter changed with the size and the time put back as they were: only the content tells.
    std::string edited = saved;
    edited[edited.find("John")] = 'j';
    qmtest::writefile(family, edited);
    setmodified(family, after.modified);
    ASSERT_EQ(stampof(family), after);
    expectrefused(changed);

    qmtest::writefile(family, saved);
    setmodified(family, after.modified);
    EXPECT_TRUE(undolast(family, s).undone()) << "put back as the save left it, the undo works";
}

TEST_F(UndoLast, RefusesWithoutAUsableNoteOrBackup)
{
    expectrefused(QStringLiteral("has no change"));
    save();
    const lastchange c = readlastchange(family, s.backupfolder);

    // The backup holding the old file removed (by hand, or by "Remove Old Backup Files...") or changed.
    const std::string old = readfile(c.backuppath);
    QFile::remove(c.backuppath);
    expectrefused(QStringLiteral("is no longer there or has been changed"));
    qmtest::writefile(c.backuppath, old + "x");
    expectrefused(QStringLiteral("is no longer there or has been changed"));
    qmtest::writefile(c.backuppath, old);

    // A note edited to copy some other file over the family file, or not a note at all.
    QFile f(c.notepath);
    ASSERT_TRUE(f.open(QIODevice::ReadOnly));
    const QJsonObject note = QJsonDocument::fromJson(f.readAll()).object();
    const QString other = dir.filePath(QStringLiteral("other.ged"));
    qmtest::writefile(other, "0 HEAD\r\n0 TRLR\r\n");
    const struct {
        const char* key;
        QString value;
        const char* says;
    } tampered[] = {{"backup", other, "cannot be used"},
                    {"file", other, "it is the note of another file"},
                    {"hash", QStringLiteral("zz"), "cannot be used"}};
    for (const auto& t : tampered) {
        QJsonObject o = note;
        o.insert(QLatin1String(t.key), t.value);
        qmtest::writefile(c.notepath, QJsonDocument(o).toJson().toStdString());
        expectrefused(QString::fromLatin1(t.says));
    }
    qmtest::writefile(c.notepath, "{not json");
    expectrefused(QStringLiteral("cannot be used"));
}

TEST_F(UndoLast, WaitsForNoOtherQuillmark)
{
    save();
    QLockFile other(family + QStringLiteral(".quillmark-lock"));
    ASSERT_TRUE(other.tryLock(0));
    expectrefused(QStringLiteral("Another Quillmark"));
    other.unlock();
    EXPECT_TRUE(undolast(family, s).undone());
}

TEST_F(UndoLast, FamilyFilesSharingABackupFolderKeepTheirOwnNotes)
{
    const QString first = family, second = dir.filePath(QStringLiteral("second.ged"));
    qmtest::writefile(second, original);
    const std::string firstsaved = save();
    family = second;
    save();
    ASSERT_TRUE(undolast(second, s).undone());
    EXPECT_EQ(readfile(second), original);
    EXPECT_EQ(readfile(first), firstsaved) << "the other file is not touched";
    ASSERT_TRUE(undolast(first, s).undone());
    EXPECT_EQ(readfile(first), original);
}
