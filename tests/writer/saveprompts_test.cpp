#include "writer/saveprompts.h"

#include "platform/scriptedprompts.h"

#include <gtest/gtest.h>

#include <optional>

using namespace qm;

// Each outcome of a save: what the window is told is left, and the one
// message shown (with its icon), or none.
TEST(SavePrompts, EachOutcomeTellsTheWindowAndShowsAtMostOneMessage)
{
    const struct {
        savestatus status;
        const char* logerror;
        aftersave after;
        std::optional<icon> shown;
    } rows[] = {
        {savestatus::refused, "", aftersave::stay, icon::exclamation},
        {savestatus::backupfailed, "", aftersave::stay, icon::exclamation},
        {savestatus::rewritefailed, "", aftersave::fatal, icon::critical},
        {savestatus::changed, "", aftersave::changed, std::nullopt}, // the window's own words
        {savestatus::saved, "", aftersave::saved, std::nullopt},
        {savestatus::saved, "The census log could not be written", aftersave::saved, icon::critical},
    };
    for (const auto& r : rows) {
        SCOPED_TRACE(static_cast<int>(r.status));
        saveoutcome out;
        out.status = r.status;
        out.message = QStringLiteral("It went wrong");
        out.logerror = QString::fromLatin1(r.logerror);
        scriptedprompts p;
        if (r.shown)
            p.expect(answer::ok, *r.logerror ? QStringLiteral("census log") : QStringLiteral("went wrong"));
        EXPECT_EQ(tellsaveoutcome(p, out), r.after);
        ASSERT_EQ(p.history().size(), r.shown ? 1u : 0u);
        if (r.shown) {
            EXPECT_EQ(p.history()[0].m.kind, *r.shown);
        }
        EXPECT_EQ(p.unexpected(), 0);
    }
}
