// quillmark-cli stats, and the tool's usage as a whole, run as a user would run it.
#include "flags/flagtable.h"
#include "platform/settingsstore.h"
#include "support/clirun.h"
#include "support/testfiles.h"

#include <QJsonDocument>

namespace {

using qmtest::runcli;

class CliStats : public qmtest::clitest {
protected:
    void SetUp() override
    {
        clitest::SetUp();
        // One allocated flag.
        qm::saveflagdefs(*qm::settingsstore::onfile(ini), {{"__C1881", "Census 1881", "3 APR 1881", 0, "UK"}});
    }
    QString make(const char* name, const std::string& bytes) const
    {
        const QString path = dir.filePath(QString::fromLatin1(name));
        qmtest::writefile(path, bytes);
        return path;
    }
};

} // namespace

TEST_F(CliStats, PrintsTheIndexAsOneJsonLine)
{
    make("family.ged", "\xEF\xBB\xBF" "0 HEAD\r\n1 CHAR UTF-8\r\n"
                       "0 @I1@ INDI\r\n1 NAME A /B/\r\n1 BIRT\r\n2 PLAC Leeds\r\n1 CENS\r\n2 PLAC leeds\r\n"
                       "1 _FLGS\r\n2 __C1891 Census 1891\r\n2 __C1881 Census 1881\r\n"
                       "0 @I2@ INDI\r\n1 CENS\r\n2 PLAC York\r\n"
                       "0 @S4@ SOUR\r\n1 TITL 1881 Census\r\n0 @S9@ SOUR\r\n1 TITL Register\r\n"
                       "0 @O6@ OBJE\r\n0 @N3@ NOTE\r\n0 TRLR\r\n");
    const qmtest::clitextrun r = cli(QStringLiteral("stats"), {file});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(std::count(r.out.begin(), r.out.end(), '\n'), 1);
    QJsonObject o = r.json();
    EXPECT_TRUE(o.take(QStringLiteral("load_ms")).isDouble());
    // Flags: the defined one and __C1891.
    EXPECT_EQ(o, QJsonDocument::fromJson(R"({"individuals": 2, "sources": 2, "census_sources": 1, "objects": 1,
        "places": 2, "census_events": 2, "flags": 2, "next_source": 10, "maxobjectid": 6, "maxnoteid": 3,
        "encoding": "utf-8"})").object());

    // The option may come first; an 8-bit file without a CHAR line is Windows-1252.
    const QString ansi = make("ansi.ged", "0 HEAD\n0 @I1@ INDI\n1 NAME Ren\xE9 /X/\n");
    const qmtest::clirun a = runcli({QStringLiteral("stats"), QStringLiteral("--settings=") + ini, ansi});
    ASSERT_EQ(a.status, 0) << a.err.toStdString();
    const QJsonObject ao = QJsonDocument::fromJson(a.out).object();
    for (const auto& [key, value] : std::vector<std::pair<const char*, QJsonValue>>{
             {"encoding", "windows-1252"}, {"flags", 1}, {"maxnoteid", -1}, {"next_source", 1}})
        EXPECT_EQ(ao.value(QLatin1String(key)), value) << key;
}

// Unusable files and usage mistakes: status 2, nothing on standard output,
// one line on standard error.
TEST_F(CliStats, FailuresAreOneLine)
{
    const QString nohead = make("notes.txt", "just some text\n0 @I1@ INDI\n");
    const QString ged = make("f.ged", "0 HEAD\n");
    const QString stats = QStringLiteral("stats"), settings = QStringLiteral("--settings");
    const std::pair<QStringList, const char*> cases[] = {
        {{stats, dir.filePath(QStringLiteral("missing.ged")), settings, ini}, ""},
        {{stats, dir.path(), settings, ini}, ""},
        {{stats, nohead, settings, ini}, "0 HEAD"},
        {{stats, make("empty.ged", ""), settings, ini}, ""},
        {{stats, nohead, settings, dir.filePath(QStringLiteral("nosuch.ini"))}, ""},
        {{stats}, ""},
        {{stats, ged, ged, settings, ini}, ""},
        {{stats, ged, settings}, ""},
        {{stats, ged, QStringLiteral("--verbose"), settings, ini}, ""},
        {{QStringLiteral("frobnicate")}, ""},
    };
    for (const auto& [args, contains] : cases) {
        const qmtest::clirun r = runcli(args);
        SCOPED_TRACE(args.join(u' ').toStdString());
        EXPECT_EQ(r.status, 2);
        EXPECT_TRUE(r.out.isEmpty());
        EXPECT_TRUE(r.err.startsWith("quillmark-cli: ") && r.err.contains(contains)) << r.err.toStdString();
        EXPECT_EQ(r.err.count('\n'), 1) << r.err.toStdString();
    }
    EXPECT_EQ(runcli({}).status, 2);

    const qmtest::clirun help = runcli({QStringLiteral("--help")});
    EXPECT_EQ(help.status, 0);
    EXPECT_TRUE(help.out.contains("quillmark-cli stats FILE [--settings S.ini]")) << help.out.toStdString();
    const qmtest::clirun statshelp = runcli({QStringLiteral("stats"), QStringLiteral("--help")});
    EXPECT_EQ(statshelp.status, 0);
    EXPECT_TRUE(statshelp.out.contains("stats FILE"));
}
