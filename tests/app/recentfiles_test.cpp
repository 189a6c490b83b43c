#include "app/recentfiles.h"
#include "app/startup.h"
#include "platform/settingsstore.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

// Each step remembers or removes a path; the four slots after it.
TEST(RecentFiles, RememberMovesToFirstSlotRemoveMovesLaterSlotsUp)
{
    recentfiles r;
    r.paths = {QStringLiteral("/a.ged"), QStringLiteral("/b.ged"), QStringLiteral("/c.ged"), QStringLiteral("/d.ged")};
    const struct {
        bool remember;
        const char* path;
        std::array<QString, 4> after;
    } steps[] = {
        {true, "/c.ged", {"/c.ged", "/a.ged", "/b.ged", "/d.ged"}}, // slot 3 to 1, 1 and 2 down, 4 stays
        {true, "/c.ged", {"/c.ged", "/a.ged", "/b.ged", "/d.ged"}}, // already first: nothing moves
        {true, "/e.ged", {"/e.ged", "/c.ged", "/a.ged", "/b.ged"}}, // new: the last is dropped
        {true, "/C.ged", {"/C.ged", "/e.ged", "/c.ged", "/a.ged"}}, // compared as exact text
        {false, "/c.ged", {"/C.ged", "/e.ged", "/a.ged", ""}},
        {false, "/x.ged", {"/C.ged", "/e.ged", "/a.ged", ""}},
    };
    for (const auto& step : steps) {
        step.remember ? r.remember(QString::fromLatin1(step.path)) : r.remove(QString::fromLatin1(step.path));
        EXPECT_EQ(r.paths, step.after) << step.path;
    }
    EXPECT_FALSE(r.inuse(3));
}

TEST(RecentFiles, CaptionShortensPastFortyCharacters)
{
    recentfiles r;
    const QString forty = QStringLiteral("/home/user/") + QString(25, u'x') + QStringLiteral(".ged");
    ASSERT_EQ(forty.size(), 40);
    r.paths[0] = forty;
    EXPECT_EQ(r.caption(0), "&1 " + forty);
    r.paths[0] = QStringLiteral("/") + forty;
    EXPECT_EQ(r.caption(0), "&1.." + forty);
    r.paths[2] = QStringLiteral("/a.ged");
    EXPECT_EQ(r.caption(2), "&3 /a.ged");
}

TEST(RecentFiles, ReadAndWriteTheFourValues)
{
    QTemporaryDir dir;
    auto store = settingsstore::onfile(dir.filePath(QStringLiteral("s.ini")));
    store->write(QStringLiteral("Recent Files  1"), QStringLiteral("  /a.ged  "));
    store->write(QStringLiteral("Recent Files  2"), QStringLiteral("x")); // too short: empty slot
    store->write(QStringLiteral("Recent Files  4"), QStringLiteral("/d.ged"));
    recentfiles r;
    r.read(*store);
    EXPECT_EQ(r.paths, (std::array<QString, 4>{"/a.ged", "", "", "/d.ged"}));
    r.remember(QStringLiteral("/n.ged"));
    r.write(*store);
    EXPECT_EQ(store->read(QStringLiteral("Recent Files  1")), QStringLiteral("/n.ged"));
    EXPECT_EQ(store->read(QStringLiteral("Recent Files  2")), QStringLiteral("/a.ged"));
    EXPECT_EQ(store->read(QStringLiteral("Recent Files  4")), QString());
}

TEST(RecentFiles, PathParts)
{
    EXPECT_EQ(folderof(QStringLiteral("C:\\fam\\smith.ged")), "C:\\fam\\");
    EXPECT_EQ(folderof(QStringLiteral("/home/u/smith.ged")), "/home/u/");
    EXPECT_EQ(folderof(QStringLiteral("smith.ged")), "");
    EXPECT_EQ(filenameof(QStringLiteral("C:\\fam/smith.ged")), "smith.ged");
    EXPECT_EQ(windowtitle(QStringLiteral("/x/smith.ged")), versiontitle() + " - smith.ged");
    EXPECT_TRUE(versiontitle().startsWith("Quillmark v"));
}

TEST(Startup, CommandLine)
{
    EXPECT_EQ(commandlinefile({}), std::nullopt);
    EXPECT_EQ(commandlinefile({QStringLiteral("\"\"")}), std::nullopt); // two quotes: ignored
    EXPECT_EQ(commandlinefile({QStringLiteral("  ")}), std::nullopt);
    EXPECT_EQ(commandlinefile({QStringLiteral("\"/my files/a.ged\"")}), QStringLiteral("/my files/a.ged"));
    // The shell has already removed the quotes.
    EXPECT_EQ(commandlinefile({QStringLiteral("/my"), QStringLiteral("files/a.ged")}),
              QStringLiteral("/my files/a.ged"));
    // A relative path, as typed in a terminal, is remembered whole.
    EXPECT_EQ(commandlinefile({QStringLiteral("family.ged")}), QDir::current().filePath(QStringLiteral("family.ged")));
    EXPECT_EQ(commandlinefile({QStringLiteral("\"../b/family.ged\"")}),
              QDir::cleanPath(QDir::currentPath() + QStringLiteral("/../b/family.ged")));
}

TEST(Startup, PlacementStopsAtFirstMissingValue)
{
    QTemporaryDir dir;
    auto store = settingsstore::onfile(dir.filePath(QStringLiteral("s.ini")));
    placement p = readplacement(*store);
    EXPECT_FALSE(p.top);
    EXPECT_EQ(p.divider, 1);

    store->write(QStringLiteral("Main Top"), QStringLiteral("1200"));
    store->write(QStringLiteral("Main Width"), QStringLiteral("9000"));
    store->write(QStringLiteral("Main Height"), QStringLiteral("7000"));
    p = readplacement(*store); // "Main Left" missing: stops there
    EXPECT_EQ(p.top, 1200);
    EXPECT_FALSE(p.left);
    EXPECT_FALSE(p.width);
    EXPECT_FALSE(p.complete());

    store->write(QStringLiteral("Main Left"), QStringLiteral("300"));
    p = readplacement(*store);
    ASSERT_TRUE(p.complete());
    EXPECT_TRUE(p.centre); // "Main Maximised" missing
    EXPECT_FALSE(p.maximised);

    writeplacement(*store, true, 10, 20, 30000, 40000, 0.5);
    p = readplacement(*store);
    EXPECT_TRUE(p.maximised);
    EXPECT_FALSE(p.centre);
    EXPECT_EQ(p.width, 30000);
    EXPECT_EQ(p.divider, 0.5);
    writeplacement(*store, false, 10, 20, 30000, 40000, 2);
    p = readplacement(*store);
    EXPECT_FALSE(p.maximised);
    EXPECT_FALSE(p.centre);
}

// The window's own size when nothing is kept; the kept placement within the
// screen, also when it was on a screen that is no longer there; centred when
// "Main Maximised" was missing.
TEST(Startup, WindowIsPlacedWithinTheScreen)
{
    const QRect screen(0, 0, 1920, 1080);
    const auto at = [&](const placement& p) {
        const windowplace w = placewindow(p, QPoint(5, 5), QSize(900, 600), QSize(400, 300), screen, 96);
        return std::to_string(w.at.x()) + "," + std::to_string(w.at.y()) + " " + std::to_string(w.size.width()) +
               "x" + std::to_string(w.size.height()) + (w.move ? " moved" : "");
    };
    EXPECT_EQ(at(placement{}), "5,5 1280x760");
    EXPECT_EQ(at(placement{1440, 2880, 15000, 9000}), "192,96 1000x600 moved");
    EXPECT_EQ(at(placement{1440, 60000, 15000, 9000}), "919,96 1000x600 moved"); // off to the right
    EXPECT_EQ(at(placement{-9000, -9000, 90000, 90000}), "0,0 1904x1040 moved");
    EXPECT_EQ(at(placement{1440, 2880, 1500, 900}), "192,96 400x300 moved"); // never below the smallest
    placement centred{1440, 2880, 15000, 9000};
    centred.centre = true;
    EXPECT_EQ(at(centred), "459,239 1000x600 moved");
}

TEST(Startup, DefaultFileQuestion)
{
    EXPECT_TRUE(askdefaultfile(QString(), false, false));
    EXPECT_FALSE(askdefaultfile(QStringLiteral("/a.ged"), false, true)); // at start-up
    EXPECT_FALSE(askdefaultfile(QStringLiteral("/a.ged"), true, false));
    EXPECT_TRUE(askdefaultfile(QStringLiteral("/a.ged"), true, true));
    EXPECT_EQ(twipstopixels(12000, 96), 800);
    EXPECT_EQ(pixelstotwips(800, 96), 12000);
}
