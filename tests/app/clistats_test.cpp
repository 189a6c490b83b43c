// quillmark-cli stats, run as a user would run it.
#include "flags/flagtable.h"
#include "platform/settingsstore.h"

#include "support/clirun.h"
#include "support/testfiles.h"

#include <QJsonDocument>
#include <QJsonObject>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

using run = qmtest::clirun;
using qmtest::runcli;

class CliStats : public ::testing::Test {
protected:
    run stats(const QString& path, const QStringList& more = {}) const
    {
        return runcli(QStringList{QStringLiteral("stats"), path} + more + QStringList{QStringLiteral("--settings"), ini});
    }

protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        ini = dir.filePath(QStringLiteral("settings.ini"));
        // A settings file with one allocated flag.
        qm::saveflagdefs(*qm::settingsstore::onfile(ini), {{"__C1881", "Census 1881", "3 APR 1881", 0, "UK"}});
    }

    QString file(const char* name, const std::string& bytes)
    {
        const QString path = dir.filePath(QString::fromLatin1(name));
        qmtest::writefile(path, bytes);
        return path;
    }

    QTemporaryDir dir;
    QString ini;
};

// One line on standard error, nothing on standard output, status 2.
void expectfailure(const run& r)
{
    EXPECT_EQ(r.status, 2);
    EXPECT_TRUE(r.out.isEmpty());
    EXPECT_TRUE(r.err.startsWith("quillmark-cli: ")) << r.err.toStdString();
    EXPECT_EQ(r.err.count('\n'), 1) << r.err.toStdString();
}

} // namespace

TEST_F(CliStats, PrintsTheIndexAsJson)
{
    const QString path = file("family.ged",
                              "\xEF\xBB\xBF" "0 HEAD\r\n1 CHAR UTF-8\r\n"
                              "0 @I1@ INDI\r\n1 NAME A /B/\r\n1 BIRT\r\n2 PLAC Leeds\r\n1 CENS\r\n2 PLAC leeds\r\n"
                              "1 _FLGS\r\n2 __C1891 Census 1891\r\n2 __C1881 Census 1881\r\n"
                              "0 @I2@ INDI\r\n1 CENS\r\n2 PLAC York\r\n"
                              "0 @S4@ SOUR\r\n1 TITL 1881 Census\r\n0 @S9@ SOUR\r\n1 TITL Register\r\n"
                              "0 @O6@ OBJE\r\n0 @N3@ NOTE\r\n0 TRLR\r\n");
    const run r = stats(path);
    ASSERT_EQ(r.status, 0) << r.err.toStdString();
    EXPECT_EQ(r.out.count('\n'), 1);
    QJsonParseError error;
    const QJsonObject o = QJsonDocument::fromJson(r.out, &error).object();
    ASSERT_EQ(error.error, QJsonParseError::NoError) << r.out.toStdString();
    const std::vector<std::pair<const char*, QJsonValue>> expected{
        {"individuals", 2}, {"sources", 2}, {"census_sources", 1}, {"objects", 1},
        {"places", 2}, {"census_events", 2}, {"flags", 2} /* the defined one and __C1891 */,
        {"next_source", 10}, {"maxobjectid", 6}, {"maxnoteid", 3}, {"encoding", "utf-8"}};
    for (const auto& [key, value] : expected)
        EXPECT_EQ(o.value(QLatin1String(key)), value) << key;
    EXPECT_TRUE(o.value(QStringLiteral("load_ms")).isDouble());
    EXPECT_EQ(o.size(), 12);

    // The option may come first; an 8-bit file without a CHAR line is Windows-1252.
    const QString ansi = file("ansi.ged", "0 HEAD\n0 @I1@ INDI\n1 NAME Ren\xE9 /X/\n");
    const run a = runcli({QStringLiteral("stats"), QStringLiteral("--settings=") + ini, ansi});
    ASSERT_EQ(a.status, 0) << a.err.toStdString();
    const QJsonObject ao = QJsonDocument::fromJson(a.out).object();
    for (const auto& [key, value] : std::vector<std::pair<const char*, QJsonValue>>{
             {"encoding", "windows-1252"}, {"flags", 1}, {"maxnoteid", -1}, {"next_source", 1}})
        EXPECT_EQ(ao.value(QLatin1String(key)), value) << key;
}

TEST_F(CliStats, UnusableFilesFailWithOneLine)
{
    expectfailure(stats(dir.filePath(QStringLiteral("missing.ged"))));
    expectfailure(stats(dir.path()));
    const QString nohead = file("notes.txt", "just some text\n0 @I1@ INDI\n");
    const run r = stats(nohead);
    expectfailure(r);
    EXPECT_TRUE(r.err.contains("0 HEAD")) << r.err.toStdString();
    expectfailure(stats(file("empty.ged", "")));
    expectfailure(runcli({QStringLiteral("stats"), nohead, QStringLiteral("--settings"),
                       dir.filePath(QStringLiteral("nosuch.ini"))}));
}

TEST_F(CliStats, UsageMistakesAndHelp)
{
    const QString ged = file("f.ged", "0 HEAD\n");
    expectfailure(runcli({QStringLiteral("stats")}));
    expectfailure(stats(ged, {ged}));
    expectfailure(runcli({QStringLiteral("stats"), ged, QStringLiteral("--settings")}));
    expectfailure(stats(ged, {QStringLiteral("--verbose")}));
    expectfailure(runcli({QStringLiteral("frobnicate")}));

    const run help = runcli({QStringLiteral("--help")});
    EXPECT_EQ(help.status, 0);
    EXPECT_TRUE(help.out.contains("quillmark-cli stats FILE [--settings S.ini]")) << help.out.toStdString();
    const run statshelp = runcli({QStringLiteral("stats"), QStringLiteral("--help")});
    EXPECT_EQ(statshelp.status, 0);
    EXPECT_TRUE(statshelp.out.contains("stats FILE"));
    EXPECT_EQ(runcli({}).status, 2);
}
