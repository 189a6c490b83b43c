// The flag check over small family files: the matching rule, missing and
// superfluous flags, the country question and the place memory, silent mode,
// and the flag changes written back by the rewrite.
#include "flags/flagcheck.h"

#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "settings/settings.h"
#include "support/testflags.h"
#include "writer/rewritefile.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <tuple>

using namespace qm;
using qmtest::testflag;
using qmtest::testflagdefs;

namespace {

std::string indi(int id, const char* name, const std::string& body)
{
    return "0 @I" + std::to_string(id) + "@ INDI\r\n1 NAME " + name + "\r\n" + body;
}

std::string cens(const char* date, const char* place = nullptr)
{
    std::string s = "1 CENS\r\n2 DATE " + std::string(date) + "\r\n";
    if (place)
        s += "2 PLAC " + std::string(place) + "\r\n";
    return s;
}

std::string flags(std::initializer_list<const char*> lines)
{
    std::string s = "1 _FLGS\r\n";
    for (const char* l : lines)
        s += std::string("2 ") + l + "\r\n";
    return s;
}

std::string family(const std::string& records)
{
    return "0 HEAD\r\n1 CHAR ANSI\r\n" + records + "0 TRLR\r\n";
}

std::unique_ptr<gedcomindex> load(const std::string& bytes, const flagtable& defs = testflagdefs())
{
    return loadgedcombytes(bytes, defs);
}

// Answers every country question with one country, counting the questions.
struct answers {
    QString country;
    bool always = false;
    int asked = 0;
    std::vector<countryquestion> questions{};

    countryasker asker()
    {
        return [this](const countryquestion& q) {
            ++asked;
            questions.push_back(q);
            return countrychoice{static_cast<int>(q.countries.indexOf(country)), always};
        };
    }
};

TEST(FlagMatch, ExactDateOrFourCharacterYearWithin)
{
    // A full date matches exactly (case counts); a four-character date is
    // looked for within the event's; the country plays no part.
    const flagrec day = testflag("__D", "Day", "3 APR 1881", "UK");
    const flagrec year = testflag("__Y", "Year", "1881", "Canada");
    const flagrec month = testflag("__M", "Month", "APR 1881", "UK");
    const flagrec empty = testflag("__E", "Empty", "", "UK");
    const struct {
        const char* event;
        const flagrec& flag;
        bool matches;
    } cases[] = {{"3 APR 1881", day, true},   {"4 APR 1881", day, false},  {"3 apr 1881", day, false},
                 {"1881", day, false},        {"ABT 3 APR 1881", day, false}, {"3 APR 1881", year, true},
                 {"1881", year, true},        {"ABT 1881", year, true},    {"1882", year, false},
                 {"", year, false},           {"3 APR 1881", month, false}, {"", empty, false},
                 {"1881", empty, false}};
    for (const auto& c : cases)
        EXPECT_EQ(eventmatchesflag(c.event, c.flag), c.matches) << c.event << " / " << c.flag.date;
}

class FlagCheck : public ::testing::Test {
protected:
    // John: two 1881 events. Mary: holds the 1881 flag and an unallocated one,
    // no census events. Ann and Pat: 1901 in Dublin (any case), holding
    // neither 1901 flag. Kate: 1901, holding the UK one.
    const std::string mixed = family(
        indi(1, "John /Smith/", cens("3 APR 1881", "Leeds") + cens("3 APR 1881", "Leeds, Yorkshire")) +
        indi(2, "Mary /Smith/", flags({"__CENSUS_1881 Census 1881", "__OLD Old flag"})) +
        indi(3, "Ann /Byrne/", cens("31 MAR 1901", "Dublin")) +
        indi(4, "Pat /Byrne/", cens("31 MAR 1901", "DUBLIN")) +
        indi(5, "Kate /Byrne/", cens("31 MAR 1901", "Cork") + flags({"__CENSUS_UK_1901 Census UK 1901"})));
};

TEST_F(FlagCheck, RowsForMissingAndSuperfluousFlags)
{
    auto ix = load(mixed);
    ASSERT_TRUE(ix);
    answers a{QStringLiteral("Ireland"), true};
    const flagcheckresult r = checkflags(*ix, true, QStringLiteral("UK"), a.asker());
    ASSERT_FALSE(r.cancelled);
    EXPECT_TRUE(r.outofstep);
    // Two events of one date give one suggestion; the "always" answer for
    // Dublin decides DUBLIN without asking.
    EXPECT_EQ(r.addrows, QStringList({QStringLiteral("'Census 1881' flag to individual Smith, John (ID: 1)"),
                                      QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Ann (ID: 3)"),
                                      QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Pat (ID: 4)")}));
    // The unallocated flag is never suggested for removal.
    EXPECT_EQ(r.removerows, QStringList({QStringLiteral("'Census 1881' flag from individual Smith, Mary (ID: 2)")}));
    EXPECT_EQ(a.asked, 1);
    std::vector<std::tuple<int, int, bool>> changes;
    for (const auto& c : r.changes)
        changes.emplace_back(c.person, c.flag, c.add);
    EXPECT_EQ(changes, (std::vector<std::tuple<int, int, bool>>{{0, 2, true}, {1, 2, false}, {2, 1, true}, {3, 1, true}}));
    EXPECT_TRUE(r.canchange());
    EXPECT_EQ(r.addlist(), r.addrows);
}

TEST_F(FlagCheck, CountryQuestionOffersTheCandidatesWithTheSettingPreselected)
{
    auto ix = load(mixed);
    answers a{QStringLiteral("UK")};
    checkflags(*ix, true, QStringLiteral("Ireland"), a.asker());
    // Without "always" both Dublin events are asked.
    ASSERT_EQ(a.asked, 2);
    const countryquestion& q = a.questions[0];
    EXPECT_TRUE(q.person == 2 && q.date == "31 MAR 1901" && q.place == "Dublin");
    EXPECT_EQ(q.countries, QStringList({QStringLiteral("UK"), QStringLiteral("Ireland")}));
    EXPECT_EQ(q.candidates, (std::vector<size_t>{0, 1}));
    EXPECT_EQ(q.preselected, 1);
    EXPECT_EQ(a.questions[1].place, "DUBLIN");

    answers none{QStringLiteral("UK")};
    checkflags(*ix, true, QStringLiteral("Canada"), none.asker());
    EXPECT_EQ(none.questions.at(0).preselected, -1);
}

TEST_F(FlagCheck, PlaceCountryIsRememberedUntilTheFileIsReadAgain)
{
    auto ix = load(mixed);
    answers a{QStringLiteral("UK"), true};
    const flagcheckresult first = checkflags(*ix, true, QStringLiteral("UK"), a.asker());
    EXPECT_EQ(a.asked, 1);
    EXPECT_EQ(first.addrows.at(1), QStringLiteral("'Census UK 1901' flag to individual Byrne, Ann (ID: 3)"));
    EXPECT_EQ(ix->places[static_cast<size_t>(findplace(*ix, "dublin"))].country, "UK");

    // A later check on the same index asks nothing.
    answers later{QStringLiteral("Ireland")};
    const flagcheckresult second = checkflags(*ix, true, QStringLiteral("UK"), later.asker());
    EXPECT_EQ(later.asked, 0);
    EXPECT_EQ(second.addrows, first.addrows);

    // A remembered country that none of the candidates has is asked as for an unknown place.
    ix->places[static_cast<size_t>(findplace(*ix, "Dublin"))].country = "USA";
    answers asked{QStringLiteral("Ireland")};
    checkflags(*ix, true, QStringLiteral("UK"), asked.asker());
    EXPECT_EQ(asked.asked, 2);

    // A fresh load knows no country.
    auto fresh = load(mixed);
    EXPECT_TRUE(fresh->places[static_cast<size_t>(findplace(*fresh, "Dublin"))].country.empty());
}

TEST_F(FlagCheck, CancelledQuestionEndsTheCheckWithNothingToChange)
{
    auto ix = load(mixed);
    int asked = 0;
    const flagcheckresult r = checkflags(*ix, true, QStringLiteral("UK"), [&](const countryquestion&) {
        ++asked;
        return countrychoice{-1, true};
    });
    EXPECT_EQ(asked, 1);
    EXPECT_TRUE(r.cancelled && r.changes.empty() && r.addrows.isEmpty() && r.removerows.isEmpty());
    EXPECT_FALSE(r.canchange());
    EXPECT_TRUE(ix->places[static_cast<size_t>(findplace(*ix, "Dublin"))].country.empty());
    // An answer outside the options ("OK" with none selected) is a cancel too.
    EXPECT_TRUE(checkflags(*ix, true, QStringLiteral("UK"), [](const countryquestion&) {
                    return countrychoice{7, false};
                }).cancelled);
    // With nobody to ask, the question cannot be answered.
    EXPECT_TRUE(checkflags(*ix, true, QStringLiteral("UK")).cancelled);
}

TEST_F(FlagCheck, SilentModeStopsAtTheFirstIndividualOutOfStep)
{
    // John is out of step: the scan ends with him.
    auto ix = load(mixed);
    const flagcheckresult r = checkflags(*ix, false, QStringLiteral("UK"));
    EXPECT_TRUE(r.outofstep && r.changes.empty() && r.addrows.isEmpty());
    EXPECT_EQ(r.peoplechecked, 1);
    EXPECT_TRUE(flagsoutofstep(*ix));

    // Kate holds one of the two 1901 flags: in step. Ann holds neither: out of
    // step, with no question asked. Tom after her is never looked at.
    const std::string bytes = family(
        indi(1, "Kate /Byrne/", cens("31 MAR 1901", "Cork") + flags({"__CENSUS_IRELAN Census Ireland 1901"})) +
        indi(2, "Ann /Byrne/", cens("31 MAR 1901", "Dublin")) + indi(3, "Tom /Byrne/", cens("1881")));
    auto two = load(bytes);
    const flagcheckresult s = checkflags(*two, false, QStringLiteral("UK"), [](const countryquestion&) {
        ADD_FAILURE() << "silent mode asks nothing";
        return countrychoice{};
    });
    EXPECT_TRUE(s.outofstep);
    EXPECT_EQ(s.peoplechecked, 2);

    // A superfluous flag alone is enough.
    auto held = load(family(indi(1, "Kate /Byrne/", cens("31 MAR 1901", "Cork") +
                                                         flags({"__CENSUS_UK_1901 Census UK 1901"})) +
                            indi(2, "Mary /Smith/", cens("1891") + flags({"__CENSUS_1881 Census 1881"}))));
    EXPECT_TRUE(flagsoutofstep(*held));
}

TEST_F(FlagCheck, InStepFilesAndEmptyFilesGiveTheTwoNothingRows)
{
    const auto nothing = [](gedcomindex& ix) {
        const flagcheckresult r = checkflags(ix, true, QStringLiteral("UK"));
        EXPECT_FALSE(r.outofstep || r.canchange());
        EXPECT_EQ(r.addlist(), QStringList{QStringLiteral("(There are no individuals with missing census flags)")});
        EXPECT_EQ(r.removelist(),
                  QStringList{QStringLiteral("(There are no individuals with census flags that need to be removed)")});
    };
    // In step: an ABT year event holding its year flag, Kate holding one 1901 flag.
    auto instep = load(family(
        indi(1, "Tom /Byrne/", cens("ABT 1881") + flags({"__CENSUS_1881 Census 1881"})) +
        indi(2, "Kate /Byrne/", cens("31 MAR 1901", "Cork") + flags({"__CENSUS_IRELAN Census Ireland 1901"}))));
    nothing(*instep);
    EXPECT_FALSE(flagsoutofstep(*instep));
    nothing(*load(family("")));
    // No allocated flags: flags held and census events are left alone.
    nothing(*load(mixed, flagtable{}));
}

// The changes of a check written by the rewrite (mode 4), read back and checked again.
class FlagRewrite : public ::testing::Test {
protected:
    void SetUp() override { setclockfortests(QDateTime(QDate(2026, 12, 6), QTime(10, 11, 12))); }
    void TearDown() override { setclockfortests(QDateTime()); }

    std::string apply(const std::string& input, const QString& answer = QStringLiteral("UK"))
    {
        auto ix = load(input);
        answers a{answer, true};
        const flagcheckresult r = checkflags(*ix, true, QStringLiteral("UK"), a.asker());
        rewriterequest rq;
        rq.mode = rewritemode::flagchanges;
        rq.flagchanges = r.changes;
        std::string out;
        const rewriteresult w = rewritebytes(input, out, *ix, defaultsettings(), rq);
        EXPECT_TRUE(w.ok) << w.message.toStdString();
        return out;
    }
};

TEST_F(FlagRewrite, AddsAndRemovalsLeaveTheFileInStep)
{
    const std::string input = family(
        indi(1, "Mary /Smith/", cens("1891") + flags({"__OLD Old flag", "__CENSUS_1881 Census 1881"})) +
        indi(2, "Ann /Byrne/", cens("31 MAR 1901", "Dublin") + cens("31 MAR 1901", "dublin")) +
        indi(3, "John /Smith/", cens("3 APR 1881") + cens("3 APR 1881")));
    const std::string out = apply(input, QStringLiteral("Ireland"));
    // The unallocated flag stays; the allocated one without an event goes.
    EXPECT_NE(out.find("1 _FLGS\r\n2 __OLD Old flag\r\n"), std::string::npos) << out;
    EXPECT_GT(out.find("__CENSUS_1881"), out.find("0 @I2@")) << out;
    EXPECT_NE(out.find("1 _FLGS\r\n2 __CENSUS_IRELAN Census Ireland 1901\r\n"), std::string::npos) << out;
    // One flag line for John's two events.
    const size_t john = out.find("0 @I3@");
    ASSERT_NE(john, std::string::npos);
    const size_t first = out.find("2 __CENSUS_1881 Census 1881", john);
    ASSERT_NE(first, std::string::npos) << out;
    EXPECT_EQ(out.find("2 __CENSUS_1881 Census 1881", first + 1), std::string::npos) << out;

    auto again = load(out);
    EXPECT_FALSE(flagsoutofstep(*again));
    EXPECT_FALSE(checkflags(*again, true, QStringLiteral("UK")).canchange());
}

} // namespace
