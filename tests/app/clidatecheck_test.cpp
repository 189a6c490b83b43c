// quillmark-cli date-check, run as a user would run it: the three lists on the
// bundled sample, --country, --apply and its refusals.
#include "platform/settingsstore.h"
#include "settings/settings.h"

#include "support/clirun.h"
#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

struct run {
    int status = -1;
    QString out;
    QByteArray err;
};

class CliDateCheck : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        ini = dir.filePath(QStringLiteral("settings.ini"));
        qmtest::writeclisettings(ini, qmtest::clitestsettings(dir.path()));
    }

    run datecheck(const QStringList& args) const
    {
        const qmtest::clirun r = qmtest::runcli(
            QStringList{QStringLiteral("date-check")} + args + QStringList{QStringLiteral("--settings"), ini}, dir.path());
        return {r.status, QString::fromUtf8(r.out), r.err};
    }

    // A copy of the sample with some census dates changed.
    QString sample(const std::vector<std::pair<std::string, std::string>>& edits = {})
    {
        const QString path = dir.filePath(QStringLiteral("sample.ged"));
        std::string bytes = qmtest::readfile(qmtest::samplefile());
        for (const auto& [from, to] : edits) {
            const size_t at = bytes.find(from);
            EXPECT_NE(at, std::string::npos) << from;
            if (at != std::string::npos)
                bytes.replace(at, from.size(), to);
        }
        QFile::remove(path);
        qmtest::writefile(path, bytes);
        return path;
    }

    QTemporaryDir dir;
    QString ini;
};

void expectfailure(const run& r, const char* contains)
{
    EXPECT_EQ(r.status, 2);
    EXPECT_TRUE(r.out.isEmpty()) << r.out.toStdString();
    EXPECT_TRUE(r.err.startsWith("quillmark-cli: ")) << r.err.toStdString();
    EXPECT_TRUE(r.err.contains(contains)) << r.err.toStdString();
}

} // namespace

TEST_F(CliDateCheck, ListsTheSampleAsTheDialogDoes)
{
    const run uk = datecheck({sample()});
    ASSERT_EQ(uk.status, 0) << uk.err.toStdString();
    EXPECT_EQ(uk.out, QStringLiteral("Unknown Census dates:\n"
                                     "Census entries found assumed to be for the UK:\n"
                                     "6 JUN 1841 (6 occurences) : UK 1841 Census\n"
                                     "30 MAR 1851 (5 occurences) : UK 1851 Census\n"
                                     "7 APR 1861 (7 occurences) : UK 1861 Census\n"
                                     "3 APR 1881 (7 occurences) : UK 1881 Census\n"
                                     "2 APR 1871 (12 occurences) : UK 1871 Census\n"
                                     "5 APR 1891 (8 occurences) : UK 1891 Census\n"
                                     "31 MAR 1901 (3 occurences) : UK 1901 Census\n"
                                     "Entries assumed to be for countries other than the UK:\n"));

    // From the USA's rows, days shared by several countries are met at the
    // first of them after the USA's.
    const run usa = datecheck({sample(), QStringLiteral("--country"), QStringLiteral("usa")});
    ASSERT_EQ(usa.status, 0);
    EXPECT_TRUE(usa.out.startsWith(QStringLiteral("Unknown Census dates:\nCensus entries found assumed to be for the "
                                                  "USA:\nEntries assumed to be for countries other than the USA:\n")));
    EXPECT_TRUE(usa.out.contains(QStringLiteral("\n2 APR 1871 (12 occurences) : Canada 1871 Census\n")));
    EXPECT_TRUE(usa.out.contains(QStringLiteral("\n31 MAR 1901 (3 occurences) : Ireland 1901 Census\n")));

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
    ASSERT_EQ(r.status, 0) << r.err.toStdString();
    const QStringList lines = r.out.split(QLatin1Char('\n'), Qt::SkipEmptyParts);
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
    EXPECT_FALSE(again.out.contains(QStringLiteral("Backup:")));
    EXPECT_EQ(qmtest::readfile(path), after);
    EXPECT_EQ(QDir(dir.filePath(QStringLiteral("backups"))).entryList({QStringLiteral("QM Backup*")}, QDir::Files).size(), 1);
}
