// quillmark-cli coverage, run as a user would run it: the JSON object and the
// CSV table, --country, --year, --missing-only, "Residence" from the settings
// file, and the refusals.
#include "support/clirun.h"
#include "support/testfiles.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

#include <gtest/gtest.h>

namespace {

class CliCoverage : public qmtest::clitest {
protected:
    void SetUp() override
    {
        clitest::SetUp();
        // Ann: 1881 recorded, a residence in 1891; "Smith, "Jack"": born 1885;
        // =Cmd: no dates at all (a name a spreadsheet would run).
        qmtest::writefile(file, "0 HEAD\r\n1 CHAR UTF-8\r\n"
                                "0 @I3@ INDI\r\n1 NAME Ann /Kelly/\r\n1 BIRT\r\n2 DATE 1850\r\n"
                                "1 CENS\r\n2 DATE 3 APR 1881\r\n2 PLAC Leeds, England\r\n"
                                "1 RESI\r\n2 DATE 5 APR 1891\r\n2 PLAC Leeds, England\r\n"
                                "0 @I12@ INDI\r\n1 NAME \"Jack\" /Smith/\r\n1 BIRT\r\n2 DATE 4 APR 1885\r\n"
                                "0 @I14@ INDI\r\n1 NAME =Cmd\r\n0 TRLR\r\n");
    }

    qmtest::clitextrun coverage(const QStringList& args) const
    {
        return cli(QStringLiteral("coverage"), QStringList{file} + args);
    }
};

} // namespace

TEST_F(CliCoverage, JsonObject)
{
    const qmtest::clitextrun r = coverage({});
    ASSERT_EQ(r.status, 0) << r.err;
    QJsonParseError error;
    const QJsonObject o = QJsonDocument::fromJson(QByteArray::fromStdString(r.out), &error).object();
    ASSERT_EQ(error.error, QJsonParseError::NoError) << r.out;
    EXPECT_EQ(o.value(QStringLiteral("country")).toString(), QStringLiteral("UK"));
    EXPECT_EQ(o.value(QStringLiteral("censuses")).toArray(),
              QJsonArray({"1841", "1851", "1861", "1871", "1881", "1891", "1901"}));
    const QJsonArray people = o.value(QStringLiteral("individuals")).toArray();
    ASSERT_EQ(people.size(), 3);
    const QJsonObject ann = people[0].toObject();
    EXPECT_EQ(ann.value(QStringLiteral("id")).toInt(), 3);
    EXPECT_EQ(ann.value(QStringLiteral("name")).toString(), QStringLiteral("Kelly, Ann"));
    EXPECT_EQ(ann.value(QStringLiteral("cells")).toObject(),
              QJsonObject({{"1841", "not alive"}, {"1851", "missing"}, {"1861", "missing"}, {"1871", "missing"},
                           {"1881", "recorded"}, {"1891", "missing"}, {"1901", "missing"}}));
    EXPECT_EQ(people[1].toObject().value(QStringLiteral("name")).toString(), QStringLiteral("Smith, \"Jack\""));
    EXPECT_EQ(people[2].toObject().value(QStringLiteral("cells")).toObject().value(QStringLiteral("1901")),
              QStringLiteral("uncertain"));
    // One individual a line, for reading and searching big files.
    EXPECT_EQ(std::count(r.out.begin(), r.out.end(), '\n'), 5);

    // Canada's census of 12 JAN 1852 is keyed by its year as the census table shows it.
    const qmtest::clitextrun canada = coverage({QStringLiteral("--country"), QStringLiteral("canada")});
    ASSERT_EQ(canada.status, 0) << canada.err;
    EXPECT_EQ(canada.json().value(QStringLiteral("censuses")).toArray().at(2), QStringLiteral("1851"));
}

TEST_F(CliCoverage, CsvYearMissingOnlyAndResidence)
{
    const qmtest::clitextrun all = coverage({QStringLiteral("--format"), QStringLiteral("csv")});
    ASSERT_EQ(all.status, 0) << all.err;
    EXPECT_EQ(all.out, "id,name,1841,1851,1861,1871,1881,1891,1901\n"
                       "3,\"Kelly, Ann\",not alive,missing,missing,missing,recorded,missing,missing\n"
                       "12,\"Smith, \"\"Jack\"\"\",not alive,not alive,not alive,not alive,not alive,missing,missing\n"
                       "14,'=Cmd,uncertain,uncertain,uncertain,uncertain,uncertain,uncertain,uncertain\n");

    const qmtest::clitextrun year = coverage({QStringLiteral("--format=CSV"), QStringLiteral("--year"),
                                              QStringLiteral("1891"), QStringLiteral("--missing-only")});
    ASSERT_EQ(year.status, 0) << year.err;
    EXPECT_EQ(year.out, "id,name,1891\n3,\"Kelly, Ann\",missing\n12,\"Smith, \"\"Jack\"\"\",missing\n");

    // With "Residence" on, Ann's residence fact of 1891 is her census entry.
    qm::settings s = qmtest::clitestsettings(dir.path());
    s.residence = true;
    qmtest::writeclisettings(ini, s);
    const qmtest::clitextrun resi = coverage({QStringLiteral("--year=1891"), QStringLiteral("--missing-only")});
    ASSERT_EQ(resi.status, 0) << resi.err;
    const QJsonArray people = resi.json().value(QStringLiteral("individuals")).toArray();
    ASSERT_EQ(people.size(), 1);
    EXPECT_EQ(people[0].toObject().value(QStringLiteral("id")).toInt(), 12);
}

TEST_F(CliCoverage, Refusals)
{
    const std::pair<QStringList, const char*> cases[] = {
        {{QStringLiteral("--year"), QStringLiteral("1850")}, "--year 1850: UK has no census of that year"},
        {{QStringLiteral("--year"), QStringLiteral("soon")}, "--year soon: give a census year"},
        {{QStringLiteral("--format"), QStringLiteral("xml")}, "--format xml: give csv or json"},
        {{QStringLiteral("--country=France")}, "--country France"},
        {{QStringLiteral("--missing")}, "unknown option --missing"},
        {{QStringLiteral("--year")}, "--year needs a value"},
    };
    for (const auto& [args, message] : cases) {
        const qmtest::clitextrun r = coverage(args);
        EXPECT_EQ(r.status, 2) << message;
        EXPECT_TRUE(r.out.empty()) << message;
        EXPECT_NE(r.err.find(message), std::string::npos) << r.err;
    }
    const qmtest::clirun none = qmtest::runcli({QStringLiteral("coverage")}, dir.path());
    EXPECT_EQ(none.status, 2);
    EXPECT_TRUE(none.err.contains("coverage needs one family file")) << none.err.toStdString();
}
