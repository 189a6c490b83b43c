// quillmark-cli date-check, run as a user would run it: the three lists on the
// bundled sample, --country, --apply and its refusals.
#include "support/clirun.h"
#include "support/testfiles.h"

namespace {

using run = qmtest::clitextrun;

class CliDateCheck : public qmtest::clitest {
protected:
    run datecheck(const QStringList& args) const { return cli(QStringLiteral("date-check"), args); }

    // A copy of the sample with some census dates changed.
    QString sample(const std::vector<std::pair<std::string, std::string>>& edits = {})
    {
        std::string bytes = qmtest::readfile(qmtest::samplefile());
        for (const auto& [from, to] : edits) {
            const size_t at = bytes.find(from);
            EXPECT_NE(at, std::string::npos) << from;
            if (at != std::string::npos)
                bytes.replace(at, from.size(), to);
        }
        qmtest::writefile(file, bytes);
        return file;
    }
};

void expectfailure(const run& r, const char* contains)
{
    EXPECT_EQ(r.status, 2);
    EXPECT_EQ(r.out, "");
    EXPECT_TRUE(r.err.starts_with("quillmark-cli: ")) << r.err;
    EXPECT_NE(r.err.find(contains), std::string::npos) << r.err;
}

} // namespace

TEST_F(CliDateCheck, ListsTheSampleAsTheDialogDoes)
{
    const run uk = datecheck({sample()});
    ASSERT_EQ(uk.status, 0) << uk.err;
    EXPECT_EQ(uk.out, "Unknown Census dates:\n"
                                     "Census entries found assumed to be for the UK:\n"
                                     "6 JUN 1841 (6 occurences) : UK 1841 Census\n"
                                     "30 MAR 1851 (5 occurences) : UK 1851 Census\n"
                                     "7 APR 1861 (7 occurences) : UK 1861 Census\n"
                                     "3 APR 1881 (7 occurences) : UK 1881 Census\n"
                                     "2 APR 1871 (12 occurences) : UK 1871 Census\n"
                                     "5 APR 1891 (8 occurences) : UK 1891 Census\n"
                                     "31 MAR 1901 (3 occurences) : UK 1901 Census\n"
                                     "Entries assumed to be for countries other than the UK:\n");

    // From the USA's rows, days shared by several countries are met at the
    // first of them after the USA's.
    const run usa = datecheck({sample(), QStringLiteral("--country"), QStringLiteral("usa")});
    ASSERT_EQ(usa.status, 0);
    EXPECT_TRUE(usa.out.starts_with("Unknown Census dates:\nCensus entries found assumed to be for the "
                                    "USA:\nEntries assumed to be for countries other than the USA:\n"));
    EXPECT_NE(usa.out.find("\n2 APR 1871 (12 occurences) : Canada 1871 Census\n"), std::string::npos);
    EXPECT_NE(usa.out.find("\n31 MAR 1901 (3 occurences) : Ireland 1901 Census\n"), std::string::npos);

    expectfailure(datecheck({sample(), QStringLiteral("--country=France")}), "--country France");
    expectfailure(datecheck({}), "needs one family file");
    expectfailure(datecheck({dir.filePath(QStringLiteral("none.ged"))}), "no such file");
}

TEST_F(CliDateCheck, AppliesTheSuggestedChanges)
{
    const QString path = sample({{"2 DATE 6 JUN 1841", "2 DATE ABT 1841"},
                                 {"2 DATE 30 MAR 1851", "2 DATE 30 Mar 1851"},
                                 {"2 DATE 7 APR 1861", "2 DATE ABT 1650"}});
    const std::string before = qmtest::readfile(path);
    const run r = datecheck({path, QStringLiteral("--apply")});
    ASSERT_EQ(r.status, 0) << r.err;
    const QStringList lines = QString::fromStdString(r.out).split(QLatin1Char('\n'), Qt::SkipEmptyParts);
    ASSERT_GE(lines.size(), 6);
    EXPECT_EQ(lines.mid(0, 4),
              (QStringList{QStringLiteral("Unknown Census dates:"),
                           QStringLiteral("ABT 1841 (1 occurence) : [Suggest replacing with UK 1841 Census date 6 JUN 1841]"),
                           QStringLiteral("30 Mar 1851 (1 occurence) : [Suggest replacing with UK 1851 Census date 30 MAR 1851]"),
                           QStringLiteral("ABT 1650 (1 occurence) : [Quillmark can not suggest a date to replace this with]")}));
    EXPECT_EQ(lines[lines.size() - 2], QStringLiteral("Changed 2 census event dates and 0 occupation dates"));
    ASSERT_TRUE(lines.back().startsWith(QStringLiteral("Backup: ")));
    EXPECT_EQ(qmtest::readfile(lines.back().mid(8)), before);

    const std::string after = qmtest::readfile(path);
    EXPECT_TRUE(after.find("2 DATE ABT 1841") == std::string::npos && after.find("2 DATE 30 Mar 1851") == std::string::npos
                && after.find("2 DATE ABT 1650") != std::string::npos);

    // Again: nothing left to change, nothing written.
    const run again = datecheck({path, QStringLiteral("--apply")});
    ASSERT_EQ(again.status, 0);
    EXPECT_EQ(again.out.find("Backup:"), std::string::npos);
    EXPECT_EQ(qmtest::readfile(path), after);
    EXPECT_EQ(backups().size(), 1);
}
