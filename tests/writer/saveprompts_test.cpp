#include "writer/saveprompts.h"

#include "platform/scriptedprompts.h"

#include <gtest/gtest.h>

using namespace qm;

namespace {

saveoutcome outcome(savestatus status, const QString& message, const QString& logerror = QString())
{
    saveoutcome out;
    out.status = status;
    out.message = message;
    out.logerror = logerror;
    return out;
}

} // namespace

TEST(SavePrompts, EachFailureShownWithItsIconAndTheWindowToldWhatIsLeft)
{
    struct row {
        savestatus status;
        aftersave after;
        icon kind;
    };
    const row rows[] = {
        {savestatus::refused, aftersave::stay, icon::exclamation},
        {savestatus::backupfailed, aftersave::stay, icon::exclamation},
        {savestatus::rewritefailed, aftersave::fatal, icon::critical},
    };
    for (const row& r : rows) {
        scriptedprompts p;
        p.expect(answer::ok, QStringLiteral("went wrong"));
        EXPECT_EQ(tellsaveoutcome(p, outcome(r.status, QStringLiteral("It went wrong"))), r.after);
        ASSERT_EQ(p.history().size(), 1u);
        EXPECT_EQ(p.history()[0].m.kind, r.kind);
        EXPECT_EQ(p.unexpected(), 0);
    }
}

TEST(SavePrompts, ChangedFileLeftToTheWindowsOwnWords)
{
    scriptedprompts p;
    EXPECT_EQ(tellsaveoutcome(p, outcome(savestatus::changed, QStringLiteral("changed"))), aftersave::changed);
    EXPECT_TRUE(p.history().empty());
}

TEST(SavePrompts, SaveStandsAndOnlyALogErrorIsShown)
{
    scriptedprompts quiet;
    EXPECT_EQ(tellsaveoutcome(quiet, outcome(savestatus::saved, QString())), aftersave::saved);
    EXPECT_TRUE(quiet.history().empty());

    scriptedprompts p;
    p.expect(answer::ok, QStringLiteral("census log"));
    EXPECT_EQ(tellsaveoutcome(p, outcome(savestatus::saved, QString(), QStringLiteral("The census log could not be written"))),
              aftersave::saved);
    ASSERT_EQ(p.history().size(), 1u);
    EXPECT_EQ(p.history()[0].m.kind, icon::critical);
    EXPECT_EQ(p.unexpected(), 0);
}
