// quillmark-cli stats, run as a user would run it.
#include "platform/settingsstore.h"

#include "support/testfiles.h"

#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

struct run {
    int status = -1;
    QByteArray out, err;
};

run cli(const QStringList& args)
{
    QProcess p;
    p.start(QStringLiteral(QM_CLI_PATH), args);
    run r;
    if (!p.waitForFinished(60000) || p.exitStatus() != QProcess::NormalExit)
        return r;
    r.status = p.exitCode();
    r.out = p.readAllStandardOutput();
    r.err = p.readAllStandardError();
    return r;
}

class CliStats : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        ini = dir.filePath(QStringLiteral("settings.ini"));
        // A settings file with one allocated flag.
        auto store = qm::settingsstore::onfile(ini);
        store->write(QStringLiteral("Flags/1"), QStringLiteral("Code"), QStringLiteral("__C1881"));
        store->write(QStringLiteral("Flags/1"), QStringLiteral("Name"), QStringLiteral("Census 1881"));
        store->write(QStringLiteral("Flags/1"), QStringLiteral("Date"), QStringLiteral("3 APR 1881"));
        store->write(QStringLiteral("Flags/1"), QStringLiteral("Country"), QStringLiteral("UK"));
        store->sync();
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
    const run r = cli({QStringLiteral("stats"), path, QStringLiteral("--settings"), ini});
    ASSERT_EQ(r.status, 0) << r.err.toStdString();
    EXPECT_EQ(r.out.count('\n'), 1);
    QJsonParseError error;
    const QJsonObject o = QJsonDocument::fromJson(r.out, &error).object();
    ASSERT_EQ(error.error, QJsonParseError::NoError) << r.out.toStdString();
    EXPECT_EQ(o.value(QStringLiteral("individuals")).toInt(), 2);
    EXPECT_EQ(o.value(QStringLiteral("sources")).toInt(), 2);
    EXPECT_EQ(o.value(QStringLiteral("census_sources")).toInt(), 1);
    EXPECT_EQ(o.value(QStringLiteral("objects")).toInt(), 1);
    EXPECT_EQ(o.value(QStringLiteral("places")).toInt(), 2);
    EXPECT_EQ(o.value(QStringLiteral("census_events")).toInt(), 2);
    EXPECT_EQ(o.value(QStringLiteral("flags")).toInt(), 2); // the defined one and __C1891
    EXPECT_EQ(o.value(QStringLiteral("next_source")).toInt(), 10);
    EXPECT_EQ(o.value(QStringLiteral("maxobjectid")).toInt(), 6);
    EXPECT_EQ(o.value(QStringLiteral("maxnoteid")).toInt(), 3);
    EXPECT_EQ(o.value(QStringLiteral("encoding")).toString(), QStringLiteral("utf-8"));
    EXPECT_TRUE(o.value(QStringLiteral("load_ms")).isDouble());
    EXPECT_EQ(o.size(), 12);

    // The option may come first; an 8-bit file without a CHAR line is Windows-1252.
    const QString ansi = file("ansi.ged", "0 HEAD\n0 @I1@ INDI\n1 NAME Ren\xE9 /X/\n");
    const run a = cli({QStringLiteral("stats"), QStringLiteral("--settings=") + ini, ansi});
    ASSERT_EQ(a.status, 0) << a.err.toStdString();
    const QJsonObject ao = QJsonDocument::fromJson(a.out).object();
    EXPECT_EQ(ao.value(QStringLiteral("encoding")).toString(), QStringLiteral("windows-1252"));
    EXPECT_EQ(ao.value(QStringLiteral("flags")).toInt(), 1);
    EXPECT_EQ(ao.value(QStringLiteral("maxnoteid")).toInt(), -1);
    EXPECT_EQ(ao.value(QStringLiteral("next_source")).toInt(), 1);
}

TEST_F(CliStats, UnusableFilesFailWithOneLine)
{
    expectfailure(cli({QStringLiteral("stats"), dir.filePath(QStringLiteral("missing.ged")), QStringLiteral("--settings"), ini}));
    expectfailure(cli({QStringLiteral("stats"), dir.path(), QStringLiteral("--settings"), ini}));
    const QString nohead = file("notes.txt", "just some text\n0 @I1@ INDI\n");
    const run r = cli({QStringLiteral("stats"), nohead, QStringLiteral("--settings"), ini});
    expectfailure(r);
    EXPECT_TRUE(r.err.contains("0 HEAD")) << r.err.toStdString();
    expectfailure(cli({QStringLiteral("stats"), file("empty.ged", ""), QStringLiteral("--settings"), ini}));
    expectfailure(cli({QStringLiteral("stats"), nohead, QStringLiteral("--settings"),
                       dir.filePath(QStringLiteral("nosuch.ini"))}));
}

TEST_F(CliStats, UsageMistakesAndHelp)
{
    const QString ged = file("f.ged", "0 HEAD\n");
    expectfailure(cli({QStringLiteral("stats")}));
    expectfailure(cli({QStringLiteral("stats"), ged, ged, QStringLiteral("--settings"), ini}));
    expectfailure(cli({QStringLiteral("stats"), ged, QStringLiteral("--settings")}));
    expectfailure(cli({QStringLiteral("stats"), ged, QStringLiteral("--verbose"), QStringLiteral("--settings"), ini}));
    expectfailure(cli({QStringLiteral("frobnicate")}));

    const run help = cli({QStringLiteral("--help")});
    EXPECT_EQ(help.status, 0);
    EXPECT_TRUE(help.out.contains("quillmark-cli stats FILE [--settings S.ini]")) << help.out.toStdString();
    const run statshelp = cli({QStringLiteral("stats"), QStringLiteral("--help")});
    EXPECT_EQ(statshelp.status, 0);
    EXPECT_TRUE(statshelp.out.contains("stats FILE"));
    EXPECT_EQ(cli({}).status, 2);
}
