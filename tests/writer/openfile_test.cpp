#include "writer/openfile.h"

#include "platform/filetime.h"
#include "platform/scriptedprompts.h"
#include "platform/settingsstore.h"
#include "support/censusentries.h"
#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <stdexcept>

using namespace qm;
using qmtest::readfile;

namespace {

const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n0 @I2@ INDI\r\n"
                           "1 NAME Mary /Smith/\r\n0 @S1@ SOUR\r\n1 TITL Census 1851 Leeds\r\n0 TRLR\r\n";

class OpenFile : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        store = settingsstore::onfile(dir.filePath(QStringLiteral("settings.ini")));
        path = write(QStringLiteral("family.ged"), family);
        // Another second than the writes of the test, so that a change is seen.
        setmodified(path, QDateTime(QDate(2024, 5, 6), QTime(7, 8, 9)).toMSecsSinceEpoch());
    }
    QString write(const QString& name, const std::string& bytes)
    {
        const QString p = dir.filePath(name);
        qmtest::writefile(p, bytes);
        return p;
    }

    QTemporaryDir dir;
    std::unique_ptr<settingsstore> store;
    QString path;
    scriptedprompts prompts;
};

} // namespace

TEST_F(OpenFile, ReadTellsListenersInOrderWithTheWatchPaused)
{
    openfile f(*store, &prompts);
    EXPECT_EQ(f.index(), nullptr);
    QStringList heard;
    f.onread([&] { heard << QStringLiteral("a:%1:%2").arg(f.index()->people.size()).arg(int(f.watching())); });
    f.onread([&] { heard << QStringLiteral("b"); });

    const readoutcome out = f.load(path);
    EXPECT_TRUE(out.ok && out.error.isEmpty() && out.flagerror.isEmpty());
    EXPECT_EQ(f.path(), path);
    EXPECT_EQ(heard, (QStringList{QStringLiteral("a:2:0"), QStringLiteral("b")}));
    EXPECT_TRUE(f.watching()) << "the watch comes back after the read";
    EXPECT_EQ(prompts.busy, 0);
    EXPECT_TRUE(prompts.texts().isEmpty());

    EXPECT_TRUE(f.reload().ok);
    EXPECT_EQ(heard.size(), 4);
}

TEST_F(OpenFile, FailedReadKeepsTheFileReadBefore)
{
    openfile f(*store, &prompts);
    int heard = 0;
    f.onread([&] { ++heard; });
    const QString missing = dir.filePath(QStringLiteral("gone.ged"));
    // Nothing read before: an empty index over the path asked for.
    readoutcome out = f.load(missing);
    EXPECT_FALSE(out.ok);
    ASSERT_NE(f.index(), nullptr);
    EXPECT_TRUE(f.index()->people.empty());
    EXPECT_EQ(f.path(), missing);
    EXPECT_EQ(heard, 1);

    ASSERT_TRUE(f.load(path).ok);
    const gedcomindex* before = f.index();
    for (const QString& bad : {missing, dir.path(), write(QStringLiteral("nohead.ged"), "0 @I1@ INDI\r\n")}) {
        prompts.clear();
        out = f.load(bad, true);
        EXPECT_FALSE(out.ok) << bad.toStdString();
        EXPECT_FALSE(out.error.isEmpty());
        EXPECT_EQ(prompts.texts(), QStringList{out.error}) << "told as a warning";
        EXPECT_EQ(f.index(), before);
        EXPECT_EQ(f.path(), path);
    }
    EXPECT_EQ(heard, 5) << "listeners run after a failed read too";
    EXPECT_TRUE(f.load(path + QStringLiteral("x"), true).error.contains(QStringLiteral("family.gedx")));
    EXPECT_TRUE(out.error.contains(QStringLiteral("has no \"0 HEAD\" line")));
}

TEST_F(OpenFile, FaultyFlagDefinitionsAreToldBeforeTheReadFails)
{
    store->write(QStringLiteral("Flags/1"), QStringLiteral("Code"), QStringLiteral("__"));
    openfile f(*store, &prompts);
    const readoutcome out = f.load(dir.filePath(QStringLiteral("gone.ged")));
    EXPECT_FALSE(out.flagerror.isEmpty());
    EXPECT_EQ(prompts.texts(), (QStringList{out.flagerror, out.error}));

    // Without prompts (the command-line tool) the messages are only in the outcome.
    store->write(QStringLiteral("Flags/1"), QStringLiteral("Code"), QStringLiteral("__"));
    openfile quiet(*store);
    EXPECT_FALSE(quiet.load(path).flagerror.isEmpty());
    EXPECT_EQ(prompts.texts().size(), 2);
}

TEST_F(OpenFile, WatchComesBackWhenTheLastPauseEndsOnEveryPath)
{
    openfile f(*store);
    EXPECT_TRUE(f.watching());
    {
        const pausewatch outer = f.pause();
        {
            pausewatch inner = f.pause();
            const pausewatch moved = std::move(inner);
            EXPECT_FALSE(f.watching());
        }
        EXPECT_FALSE(f.watching()) << "the outer pause still holds";
    }
    EXPECT_TRUE(f.watching());
    try {
        const pausewatch paused = f.pause();
        throw std::runtime_error("tool failed");
    } catch (const std::runtime_error&) {
    }
    EXPECT_TRUE(f.watching());
}

TEST_F(OpenFile, SeesChangesAndRemovalByOtherPrograms)
{
    openfile f(*store);
    EXPECT_FALSE(f.changed() || f.missing()) << "nothing read yet";
    ASSERT_TRUE(f.load(path).ok);
    EXPECT_FALSE(f.changed() || f.missing());
    qmtest::writefile(path, family + "0 @I3@ INDI\r\n");
    EXPECT_TRUE(f.changed());
    EXPECT_FALSE(f.missing());
    ASSERT_TRUE(f.reload().ok);
    EXPECT_FALSE(f.changed());
    ASSERT_TRUE(QFile::rename(path, path + QStringLiteral(".moved")));
    EXPECT_TRUE(f.missing());
    EXPECT_TRUE(f.changed());
}

TEST_F(OpenFile, SaveRunsTheSaveRoadAndNotesTheNewStamp)
{
    openfile f(*store);
    ASSERT_TRUE(f.load(path).ok);
    settings s = f.currentsettings();
    s.backupfolder = dir.filePath(QStringLiteral("backups"));
    s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
    s.keeplog = true;
    QDir(dir.path()).mkpath(QStringLiteral("backups"));
    f.usesettings(s);

    rewriterequest rq;
    rq.entry = qmtest::censusof(QStringLiteral("2"), "Census 1851 Leeds", "Leeds, Yorkshire", "30 MAR 1851");
    rq.entry.year = 1851;
    rq.entry.selection = {qmtest::chosen(1, 0, "Smith, John", "40")};
    const saveoutcome out = f.save(rq);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_EQ(readfile(out.backuppath), family);
    EXPECT_NE(readfile(path).find("0 @S2@ SOUR\r\n"), std::string::npos);
    EXPECT_TRUE(out.logwritten);
    EXPECT_FALSE(f.changed()) << "our own save is not an outside change";
    EXPECT_EQ(f.index()->gedcomdate, stampof(path));

    // Another program's change is never written over.
    qmtest::writefile(path, family);
    const std::string theirs = readfile(path);
    rq.entry.sourceid = QStringLiteral("3");
    EXPECT_EQ(f.save(rq).status, savestatus::changed);
    EXPECT_EQ(readfile(path), theirs);
    EXPECT_TRUE(f.changed());
}
