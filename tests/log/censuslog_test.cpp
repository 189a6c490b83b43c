#include "log/censuslog.h"

#include "platform/clock.h"
#include "settings/settings.h"
#include "support/testfiles.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

namespace {

class CensusLog : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 50, 7)));
        s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
        e.gedcomfile = QStringLiteral("/home/ann/family.ged");
        e.sourceid = QStringLiteral("12 ");
        e.title = QStringLiteral(" Census 1851 Leeds ");
        e.reference = QStringLiteral("HO107/1 ");
    }
    void TearDown() override { setclockfortests(QDateTime()); }

    static selectionrec person(int id, const QString& name, const QString& occupation = QString())
    {
        selectionrec r;
        r.id = id;
        r.name = name;
        r.occupation = occupation;
        return r;
    }
    QStringList lines() const { return loglines(s, e); }

    QTemporaryDir dir;
    settings s;
    logentry e;
    const QString sep = QString(78, u'=');
    const QString stamp = QStringLiteral("2026-12-04 23:50:07");
    const QString file = QDir::toNativeSeparators(QStringLiteral("/home/ann/family.ged"));
};

} // namespace

TEST_F(CensusLog, EntryFullMethodTwoPeople)
{
    e.selection = {person(3, QStringLiteral("Smith, John")), person(4, QStringLiteral("Smith, Mary"), QStringLiteral("-"))};
    EXPECT_EQ(lines(), (QStringList{sep, QStringLiteral("Census entry added: ") + stamp,
                                    QStringLiteral("To Gedcom File: ") + file,
                                    QStringLiteral("Source created: Census 1851 Leeds (ID: 12)"), QString(),
                                    QStringLiteral("Individual records changed (linked to source above): "),
                                    QStringLiteral("Name: Smith, John (3) : created census event"),
                                    QStringLiteral("Name: Smith, Mary (4) : created census event")}));
}

TEST_F(CensusLog, OccupationBirthResidenceFlagAndImages)
{
    selectionrec r = person(7, QStringLiteral("Brown, Ann"), QStringLiteral("Weaver"));
    r.birthedited = true;
    r.birthdate = QStringLiteral(" 1806 ");
    r.birthplace = QStringLiteral("Leeds");
    e.selection = {r};
    e.flagname = QStringLiteral("Census 1851");
    e.chosenimages = {imagechoice{3, {}, QStringLiteral("Page 3"), QStringLiteral("/img/p3.jpg"), {}, true, 0, {}},
                      imagechoice{2, {}, QStringLiteral("Page 2"), {}, {}, false, 0, {}}};
    s.residence = true;
    s.fullentry = false;
    s.sharednote = true;
    const QStringList l = lines();
    ASSERT_EQ(l.size(), 12);
    EXPECT_EQ(l.mid(3, 3), (QStringList{QStringLiteral("Source referred to: Census 1851 Leeds (ID: 12)"),
                                        QStringLiteral("Where within source: HO107/1"),
                                        QStringLiteral("Note created containing census text and linked to each source citation")}));
    EXPECT_EQ(l.mid(8), (QStringList{
        QStringLiteral("Name: Brown, Ann (7) : created residence attribute and occupation attribute (Weaver)"
                       " and birth event (1806 (cal) Leeds)"),
        QStringLiteral("Each individual was given flag 'Census 1851' unless they already had it."),
        QStringLiteral("Multimedia image record created and linked to the census source: Page 3 (/img/p3.jpg)"),
        QStringLiteral("Existing image record linked to the census source: Page 2")}));

    // Without "Birthdate" no birth event is written, so none is logged.
    s.birthdate = false;
    EXPECT_FALSE(lines()[8].contains(QStringLiteral("birth event")));
}

TEST_F(CensusLog, OtherModes)
{
    e.mode = 2;
    EXPECT_EQ(lines().mid(1), (QStringList{QStringLiteral("Image(s) attached: ") + stamp,
                                           QStringLiteral("To GEDCOM File: ") + file,
                                           QStringLiteral("Source image(s) attached to: Census 1851 Leeds (ID: 12)")}));
    e.mode = 3;
    datechange a{QStringLiteral("30 MAR 1850"), 4, QStringLiteral("30 MAR 1851"), 2, 0};
    datechange refused{QStringLiteral("1851"), 2, QString(), -2, 0};
    datechange official{QStringLiteral("3 APR 1881"), 1, QStringLiteral("3 APR 1881"), 5, 1};
    e.datechanges = {a, refused, official};
    e.occdateschanged = 3;
    EXPECT_EQ(lines().mid(1), (QStringList{QStringLiteral("Census dates changed: ") + stamp,
                                           QStringLiteral("In GEDCOM File: ") + file,
                                           QStringLiteral("Changed 4 census events dated 30 MAR 1850 to 30 MAR 1851"),
                                           QStringLiteral("and changed 3 associated occupation dates")}));
    e.mode = 4;
    e.flagchangecount = 3;
    EXPECT_EQ(lines().mid(1), (QStringList{QStringLiteral("Flag Check changes made: ") + stamp,
                                           QStringLiteral("In GEDCOM File: ") + file,
                                           QStringLiteral("Made 3 changes.")}));
}

TEST_F(CensusLog, AppendsWithCrLfAndReportsUnwritableLog)
{
    e.selection = {person(3, QStringLiteral("Søren, Jens"))};
    EXPECT_EQ(writelogentry(s, e), QString());
    EXPECT_EQ(writelogentry(s, e), QString());
    const std::string text = qmtest::readfile(s.logpath);
    const std::string one = (lines().join(QStringLiteral("\r\n")) + QStringLiteral("\r\n")).toStdString();
    EXPECT_EQ(text, one + one);

    // With the system's reason.
    s.logpath = dir.filePath(QStringLiteral("missing/censuslog.txt"));
    QFile missing(s.logpath);
    missing.open(QIODevice::WriteOnly | QIODevice::Append);
    EXPECT_EQ(writelogentry(s, e),
              QStringLiteral("Quillmark was unable to add a log entry for this record to the log file ")
                  + QDir::toNativeSeparators(s.logpath) + QStringLiteral(" (") + missing.errorString()
                  + QStringLiteral(")"));
}

TEST_F(CensusLog, CheckCreatesMissingLogAndKeepsExisting)
{
    EXPECT_TRUE(checklogfile(s.logpath).isEmpty() && QFile::exists(s.logpath));
    qmtest::writefile(s.logpath, "old\r\n");
    EXPECT_EQ(checklogfile(s.logpath), QString());
    EXPECT_EQ(qmtest::readfile(s.logpath), "old\r\n");
    const QString bad = dir.filePath(QStringLiteral("missing/log.txt"));
    EXPECT_TRUE(checklogfile(bad).startsWith(QStringLiteral("The current log file can not be written to (")
                                             + QDir::toNativeSeparators(bad) + QStringLiteral("). Error: ")));
}
