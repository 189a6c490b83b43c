// quillmark-cli flag-check, run as a process on small family files.
#include "flags/flagtable.h"
#include "platform/settingsstore.h"
#include "support/clirun.h"
#include "support/testfiles.h"
#include "support/testflags.h"

using qmtest::readfile;
using qmtest::writefile;

namespace {

// John lacks the 1881 flag, Mary holds it without an event (in a block after
// her change stamp, as some programs write it), Ann has a 1901 event in Dublin
// (UK or Ireland), Kate holds the UK 1901 flag for hers.
const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n"
                           "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n1 CHAN\r\n2 DATE 1 JAN 2000\r\n"
                           "1 _FLGS\r\n2 __CENSUS_1881 Census 1881\r\n"
                           "0 @I3@ INDI\r\n1 NAME Ann /Byrne/\r\n1 CENS\r\n2 DATE 31 MAR 1901\r\n2 PLAC Dublin\r\n"
                           "0 @I4@ INDI\r\n1 NAME Kate /Byrne/\r\n1 CENS\r\n2 DATE 31 MAR 1901\r\n2 PLAC Cork\r\n"
                           "1 _FLGS\r\n2 __CENSUS_UK_1901 Census UK 1901\r\n"
                           "0 TRLR\r\n";

struct run {
    int status = -1;
    QStringList out;
    std::string err;
};

class CliFlagCheck : public qmtest::clitest {
protected:
    void SetUp() override
    {
        clitest::SetUp();
        writefile(file, family);
        qm::saveflagdefs(*qm::settingsstore::onfile(ini), qmtest::testflagdefs());
    }

    // The lines of standard output.
    run flagcheck(const QStringList& args) const
    {
        const qmtest::clitextrun c = cli(QStringLiteral("flag-check"), args);
        QString out = QString::fromStdString(c.out);
        if (out.endsWith(QLatin1Char('\n')))
            out.chop(1);
        return {c.status, out.split(QLatin1Char('\n')), c.err};
    }
};

TEST_F(CliFlagCheck, ListsTheRowsUnderTheHeadingsAndWritesNothing)
{
    const run r = flagcheck({file, QStringLiteral("--country-for"), QStringLiteral("dublin=ireland")});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, QStringList({QStringLiteral("Flags that need to be added to individuals:"),
                                  QStringLiteral("'Census 1881' flag to individual Smith, John (ID: 1)"),
                                  QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Ann (ID: 3)"),
                                  QStringLiteral("Flags that need to be removed from individuals:"),
                                  QStringLiteral("'Census 1881' flag from individual Smith, Mary (ID: 2)")}));
    EXPECT_EQ(readfile(file), family);
    EXPECT_TRUE(backups().isEmpty());
}

TEST_F(CliFlagCheck, CountryQuestionWithoutAnAnswerFailsNamingTheEvent)
{
    run r = flagcheck({file});
    EXPECT_EQ(r.status, 2);
    EXPECT_EQ(r.out, QStringList({QString()}));
    EXPECT_NE(r.err.find("Byrne, Ann (ID: 3)"), std::string::npos) << r.err;
    EXPECT_NE(r.err.find("date 31 MAR 1901, place Dublin"), std::string::npos) << r.err;
    EXPECT_EQ(std::count(r.err.begin(), r.err.end(), '\n'), 1) << r.err;

    // An answer for another place, or a country none of the flags has, does not answer it.
    r = flagcheck({file, QStringLiteral("--apply"), QStringLiteral("--country-for=Cork=UK")});
    EXPECT_EQ(r.status, 2);
    r = flagcheck({file, QStringLiteral("--apply"), QStringLiteral("--country-for"), QStringLiteral("Dublin=Canada")});
    EXPECT_EQ(r.status, 2);
    EXPECT_NE(r.err.find("not of Canada"), std::string::npos) << r.err;
    EXPECT_EQ(readfile(file), family);
    EXPECT_TRUE(backups().isEmpty());

    // Not a census country, no "=", or no file.
    EXPECT_EQ(flagcheck({file, QStringLiteral("--country-for"), QStringLiteral("Dublin=Eire")}).status, 2);
    EXPECT_EQ(flagcheck({file, QStringLiteral("--country-for"), QStringLiteral("Dublin")}).status, 2);
    EXPECT_EQ(flagcheck({QStringLiteral("--apply")}).status, 2);
}

TEST_F(CliFlagCheck, ApplyMakesTheChangesAfterABackup)
{
    const run r = flagcheck({file, QStringLiteral("--apply"), QStringLiteral("--country-for"), QStringLiteral("DUBLIN=UK")});
    ASSERT_EQ(r.status, 0) << r.err;
    ASSERT_EQ(r.out.size(), 6);
    EXPECT_EQ(r.out[2], QStringLiteral("'Census UK 1901' flag to individual Byrne, Ann (ID: 3)"));
    ASSERT_TRUE(r.out[5].startsWith(QStringLiteral("Backup: "))) << r.out[5].toStdString();
    EXPECT_EQ(readfile(r.out[5].mid(8)), family);
    EXPECT_EQ(backups().size(), 1);

    const std::string now = readfile(file);
    EXPECT_NE(now.find("1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n1 _FLGS\r\n2 __CENSUS_1881 Census 1881\r\n"),
              std::string::npos)
        << now;
    const size_t mary = now.find("Mary"), ann = now.find("0 @I3@");
    EXPECT_EQ(now.substr(mary, ann - mary).find("_FLGS"), std::string::npos) << now;
    // The census log counts the changes made.
    EXPECT_NE(readfile(dir.filePath(QStringLiteral("censuslog.txt"))).find("Made 3 changes."), std::string::npos);

    // In step now: the two nothing rows, and --apply writes nothing.
    const run again = flagcheck({file, QStringLiteral("--apply")});
    ASSERT_EQ(again.status, 0) << again.err;
    EXPECT_EQ(again.out,
              QStringList({QStringLiteral("Flags that need to be added to individuals:"),
                           QStringLiteral("(There are no individuals with missing census flags)"),
                           QStringLiteral("Flags that need to be removed from individuals:"),
                           QStringLiteral("(There are no individuals with census flags that need to be removed)")}));
    EXPECT_EQ(backups().size(), 1);
}

} // namespace
