// The open family file: reading it (listeners, failures, faulty flag
// definitions), the pause of the watch, changes by other programs (told by
// time, size or absence), and the save through it.
#include "writer/openfile.h"

#include "model/filechanged.h"
#include "platform/scriptedprompts.h"
#include "platform/settingsstore.h"
#include "support/savefolder.h"
#include "support/censusentries.h"

#include <QFile>

#include <stdexcept>

using namespace qm;
using qmtest::readfile;

namespace {

const std::string original = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n0 @I2@ INDI\r\n"
                             "1 NAME Mary /Smith/\r\n0 @S1@ SOUR\r\n1 TITL Census 1851 Leeds\r\n0 TRLR\r\n";

class OpenFile : public qmtest::savefolder {
protected:
    void SetUp() override
    {
        savefolder::SetUp();
        store = settingsstore::onfile(dir.filePath(QStringLiteral("settings.ini")));
        putfamily(original);
    }

    std::unique_ptr<settingsstore> store;
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

    const readoutcome out = f.load(family);
    EXPECT_TRUE(out.ok && out.error.isEmpty() && out.flagerror.isEmpty());
    EXPECT_EQ(f.path(), family);
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
    const QString missing = dir.filePath(QStringLiteral("gone.ged")), nohead = dir.filePath(QStringLiteral("nohead.ged"));
    qmtest::writefile(nohead, "0 @I1@ INDI\r\n");
    // Nothing read before: an empty index over the path asked for.
    readoutcome out = f.load(missing);
    EXPECT_FALSE(out.ok);
    ASSERT_NE(f.index(), nullptr);
    EXPECT_TRUE(f.index()->people.empty());
    EXPECT_EQ(f.path(), missing);
    EXPECT_EQ(heard, 1);

    ASSERT_TRUE(f.load(family).ok);
    const gedcomindex* before = f.index();
    for (const QString& bad : {missing, dir.path(), nohead}) {
        prompts.clear();
        out = f.load(bad, true);
        EXPECT_FALSE(out.ok) << bad.toStdString();
        EXPECT_FALSE(out.error.isEmpty());
        EXPECT_EQ(prompts.texts(), QStringList{out.error}) << "told as a warning";
        EXPECT_EQ(f.index(), before);
        EXPECT_EQ(f.path(), family);
    }
    EXPECT_EQ(heard, 5) << "listeners run after a failed read too";
    EXPECT_TRUE(f.load(family + QStringLiteral("x"), true).error.contains(QStringLiteral("family.gedx")));
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
    EXPECT_FALSE(quiet.load(family).flagerror.isEmpty());
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
    ASSERT_TRUE(f.load(family).ok);
    EXPECT_FALSE(f.changed() || f.missing());
    qmtest::writefile(family, original + "0 @I3@ INDI\r\n");
    EXPECT_TRUE(f.changed());
    EXPECT_FALSE(f.missing());
    ASSERT_TRUE(f.reload().ok);
    EXPECT_FALSE(f.changed());
    ASSERT_TRUE(QFile::rename(family, family + QStringLiteral(".moved")));
    EXPECT_TRUE(f.missing());
    EXPECT_TRUE(f.changed());
}

TEST_F(OpenFile, SaveRunsTheSaveRoadAndNotesTheNewStamp)
{
    openfile f(*store);
    ASSERT_TRUE(f.load(family).ok);
    const settings folders = s;
    s = f.currentsettings();
    s.backupfolder = folders.backupfolder;
    s.logpath = folders.logpath;
    s.keeplog = true;
    f.usesettings(s);
    rewriterequest rq;
    rq.entry = qmtest::censusof(QStringLiteral("2"), "Census 1851 Leeds", "Leeds, Yorkshire", "30 MAR 1851");
    rq.entry.year = 1851;
    rq.entry.selection = {qmtest::chosen(1, 0, "Smith, John", "40")};
    const saveoutcome out = f.save(rq);
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_EQ(readfile(out.backuppath), original);
    EXPECT_NE(readfile(family).find("0 @S2@ SOUR\r\n"), std::string::npos);
    EXPECT_TRUE(out.logwritten);
    EXPECT_FALSE(f.changed()) << "our own save is not an outside change";
    EXPECT_EQ(f.index()->gedcomdate, stampof(family));

    // Another program's change is never written over.
    qmtest::writefile(family, original);
    rq.entry.sourceid = QStringLiteral("3");
    EXPECT_EQ(f.save(rq).status, savestatus::changed);
    EXPECT_EQ(readfile(family), original);
    EXPECT_TRUE(f.changed());
}

TEST_F(OpenFile, ChangeIsToldByTimeOrSizeOrAbsence)
{
    const int64_t t = 1'600'000'000'000;
    setmodified(family, t);
    const filestamp noted = stampof(family);
    EXPECT_FALSE(filechanged(family, noted));
    setmodified(family, t + 2000);
    EXPECT_TRUE(filechanged(family, noted));
    // Same time, other size: an editor that restores the time is still caught.
    qmtest::writefile(family, original + "0 TRLR\r\n");
    setmodified(family, t);
    EXPECT_TRUE(filechanged(family, noted));
    QFile::remove(family);
    EXPECT_TRUE(filechanged(family, noted));
    EXPECT_TRUE(changedonsavemessage(QStringLiteral("f.ged"), true)
                    .endsWith(QStringLiteral("when you click 'Save Changes' again. Please wait for the details to be reloaded...")));
}
