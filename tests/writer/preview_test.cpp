#include "writer/preview.h"

#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "settings/settings.h"
#include "support/censusentries.h"
#include "support/testfiles.h"
#include "writer/saveroad.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;
using qmtest::readfile;

namespace {

// John's record gains a census event in the middle of the file; Mary's, the
// last individual, too; the new source is added before the trailer.
const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 SEX M\r\n1 FAMS @F1@\r\n"
                           "0 @I2@ INDI\r\n1 NAME Peter /Other/\r\n"
                           "0 @I3@ INDI\r\n1 NAME Mary /Smith/\r\n1 FAMS @F1@\r\n"
                           "0 @F1@ FAM\r\n1 HUSB @I1@\r\n1 WIFE @I3@\r\n"
                           "0 TRLR\r\n";

class Preview : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 50, 7)));
        QDir(dir.path()).mkpath(QStringLiteral("backups"));
        path = dir.filePath(QStringLiteral("family.ged"));
        qmtest::writefile(path, family);
        loadresult loaded = loadgedcom(path, {});
        ASSERT_TRUE(loaded.index);
        ix = std::move(loaded.index);
        s.backupfolder = dir.filePath(QStringLiteral("backups"));
        s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
        entry = qmtest::censusof(QStringLiteral("1"), "Census 1851 Leeds HO107/2319", "Leeds", "30 MAR 1851");
        entry.reference = QStringLiteral("HO107/2319");
        entry.year = 1851;
        entry.selection = {qmtest::chosen(1, 0, "Smith, John", "40", "Weaver"), qmtest::chosen(3, 2, "Smith, Mary", "38")};
    }
    void TearDown() override { setclockfortests(QDateTime()); }

    QTemporaryDir dir;
    QString path;
    std::unique_ptr<gedcomindex> ix;
    settings s;
    censusentry entry;
};

} // namespace

TEST_F(Preview, ShowsExactlyWhatTheSaveThenWrites)
{
    const savepreview p = previewentry(*ix, s, entry);
    ASSERT_TRUE(p.ok) << p.message.toStdString();
    // Nothing written, backed up or logged by the preview.
    EXPECT_EQ(readfile(path), family);
    EXPECT_TRUE(QDir(s.backupfolder).isEmpty());
    EXPECT_FALSE(QFileInfo::exists(s.logpath));

    const saveoutcome out = saveentry(*ix, s, entry);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_EQ(p.newcontent, readfile(path)) << "the preview is byte for byte what the save wrote";

    // Record by record: John and Mary changed, the source added, Peter not shown.
    ASSERT_EQ(p.records.size(), 3u);
    EXPECT_EQ(p.records[0].header, QStringLiteral("0 @I1@ INDI"));
    EXPECT_FALSE(p.records[0].added);
    EXPECT_EQ(p.records[0].oldline, 3);
    EXPECT_EQ(p.records[1].header, QStringLiteral("0 @I3@ INDI"));
    EXPECT_EQ(p.records[2].header, QStringLiteral("0 @S1@ SOUR"));
    EXPECT_TRUE(p.records[2].added);
    for (const diffline& l : p.records[0].lines)
        if (l.tag == difftag::removed)
            ADD_FAILURE() << "a census entry takes no line away: " << l.text.toStdString();
    EXPECT_EQ(p.gaps[1].count, 2) << "Peter's two lines lie between the changed records";
}

TEST_F(Preview, UnifiedDiff)
{
    const QString diff = unifieddiff(previewentry(*ix, s, entry));
    const QStringList lines = diff.split(u'\n');
    ASSERT_GT(lines.size(), 4) << diff.toStdString();
    EXPECT_EQ(lines[0], QStringLiteral("--- a/family.ged"));
    EXPECT_EQ(lines[1], QStringLiteral("+++ b/family.ged"));
    // The first hunk starts three lines before John's new lines (written before his FAMS line), headed by his record.
    EXPECT_TRUE(lines[2].startsWith(QStringLiteral("@@ -3,"))) << lines[2].toStdString();
    EXPECT_TRUE(lines[2].endsWith(QStringLiteral(" @@ 0 @I1@ INDI"))) << lines[2].toStdString();
    EXPECT_TRUE(diff.contains(QStringLiteral("\n+1 CENS\n+2 DATE 30 MAR 1851\n+2 PLAC Leeds\n")));
    EXPECT_TRUE(diff.contains(QStringLiteral("\n+1 OCCU Weaver\n")));
    EXPECT_TRUE(diff.contains(QStringLiteral("\n+0 @S1@ SOUR\n")));
    EXPECT_TRUE(diff.endsWith(QStringLiteral(" 0 TRLR\n")));
    // Every hunk's counts match its lines, so that patch(1) can apply it.
    int64_t oldleft = 0, newleft = 0;
    for (const QString& l : lines) {
        if (l.startsWith(QStringLiteral("@@"))) {
            EXPECT_EQ(oldleft, 0);
            EXPECT_EQ(newleft, 0);
            const QStringList parts = l.split(u' ');
            const auto count = [](const QString& range) {
                const qsizetype comma = range.indexOf(u',');
                return comma < 0 ? 1 : range.mid(comma + 1).toLongLong();
            };
            oldleft = count(parts[1]);
            newleft = count(parts[2]);
        } else if (l.startsWith(u'-') && !l.startsWith(QStringLiteral("---"))) {
            --oldleft;
        } else if (l.startsWith(u'+') && !l.startsWith(QStringLiteral("+++"))) {
            --newleft;
        } else if (l.startsWith(u' ')) {
            --oldleft;
            --newleft;
        }
    }
    EXPECT_EQ(oldleft, 0);
    EXPECT_EQ(newleft, 0);
}

TEST_F(Preview, RefusesWhatTheSaveRefuses)
{
    entry.selection[0].occupation = QStringLiteral("Weaver \u2227");
    savepreview p = previewentry(*ix, s, entry);
    EXPECT_FALSE(p.ok);
    EXPECT_TRUE(p.message.contains(QStringLiteral("occupation of Smith, John"))) << p.message.toStdString();

    entry.selection[0].occupation.clear();
    qmtest::writefile(path, family + "0 @I9@ INDI\r\n");
    p = previewentry(*ix, s, entry);
    EXPECT_FALSE(p.ok);
    EXPECT_TRUE(p.changed);
    EXPECT_TRUE(p.message.endsWith(QStringLiteral("has been modified by another application and will be reloaded.")));
}
