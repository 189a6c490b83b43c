// The preview of a save: what it shows is byte for byte what the save then
// writes, it writes nothing itself, and it refuses what the save refuses.
#include "writer/preview.h"

#include "model/loadgedcom.h"
#include "support/savefolder.h"
#include "support/censusentries.h"

#include <QFileInfo>

using namespace qm;
using qmtest::readfile;

namespace {

// John's record gains a census event in the middle of the file; Mary's, the
// last individual, too; the new source is added before the trailer.
const std::string original = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 SEX M\r\n1 FAMS @F1@\r\n"
                             "0 @I2@ INDI\r\n1 NAME Peter /Other/\r\n0 @I3@ INDI\r\n1 NAME Mary /Smith/\r\n1 FAMS @F1@\r\n"
                             "0 @F1@ FAM\r\n1 HUSB @I1@\r\n1 WIFE @I3@\r\n0 TRLR\r\n";

class Preview : public qmtest::savefolder {
protected:
    void SetUp() override
    {
        savefolder::SetUp();
        qmtest::writefile(family, original);
        loadresult loaded = loadgedcom(family, {});
        ASSERT_TRUE(loaded.index);
        ix = std::move(loaded.index);
        entry = qmtest::censusof(QStringLiteral("1"), "Census 1851 Leeds HO107/2319", "Leeds", "30 MAR 1851");
        entry.reference = QStringLiteral("HO107/2319");
        entry.year = 1851;
        entry.selection = {qmtest::chosen(1, 0, "Smith, John", "40", "Weaver"), qmtest::chosen(3, 2, "Smith, Mary", "38")};
    }

    std::unique_ptr<gedcomindex> ix;
    censusentry entry;
};

} // namespace

TEST_F(Preview, ShowsExactlyWhatTheSaveThenWrites)
{
    const savepreview p = previewentry(*ix, s, entry);
    ASSERT_TRUE(p.ok) << p.message.toStdString();
    // Nothing written, backed up or logged by the preview.
    EXPECT_EQ(readfile(family), original);
    EXPECT_TRUE(QDir(s.backupfolder).isEmpty());
    EXPECT_FALSE(QFileInfo::exists(s.logpath));

    const saveoutcome out = saveentry(*ix, s, entry);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_EQ(p.newcontent, readfile(family)) << "the preview is byte for byte what the save wrote";

    // Record by record: John and Mary changed, the source added, Peter not shown.
    QStringList shown;
    for (const auto& r : p.records)
        shown << r.header + (r.added ? QStringLiteral(" added") : QStringLiteral(" changed"));
    EXPECT_EQ(shown, (QStringList{QStringLiteral("0 @I1@ INDI changed"), QStringLiteral("0 @I3@ INDI changed"),
                                  QStringLiteral("0 @S1@ SOUR added")}));
    EXPECT_EQ(p.records.at(0).oldline, 3);
    for (const diffline& l : p.records[0].lines)
        EXPECT_NE(l.tag, difftag::removed) << "a census entry takes no line away: " << l.text.toStdString();
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
    const auto count = [](const QString& range) {
        const qsizetype comma = range.indexOf(u',');
        return comma < 0 ? 1 : range.mid(comma + 1).toLongLong();
    };
    for (const QString& l : lines.mid(2)) {
        if (l.startsWith(QStringLiteral("@@"))) {
            EXPECT_EQ(std::make_pair(oldleft, newleft), std::make_pair(int64_t(0), int64_t(0))) << l.toStdString();
            oldleft = count(l.section(u' ', 1, 1));
            newleft = count(l.section(u' ', 2, 2));
        } else {
            oldleft -= l.startsWith(u'-') || l.startsWith(u' ');
            newleft -= l.startsWith(u'+') || l.startsWith(u' ');
        }
    }
    EXPECT_EQ(std::make_pair(oldleft, newleft), std::make_pair(int64_t(0), int64_t(0)));
}

TEST_F(Preview, RefusesWhatTheSaveRefuses)
{
    entry.selection[0].occupation = QStringLiteral("Weaver \u2227");
    savepreview p = previewentry(*ix, s, entry);
    EXPECT_FALSE(p.ok);
    EXPECT_TRUE(p.message.contains(QStringLiteral("occupation of Smith, John"))) << p.message.toStdString();

    entry.selection[0].occupation.clear();
    qmtest::writefile(family, original + "0 @I9@ INDI\r\n");
    p = previewentry(*ix, s, entry);
    EXPECT_FALSE(p.ok);
    EXPECT_TRUE(p.changed);
    EXPECT_TRUE(p.message.endsWith(QStringLiteral("has been modified by another application and will be reloaded.")));
}
