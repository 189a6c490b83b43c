#include "flags/flagalloc.h"

#include "model/gedcomindex.h"

#include <gtest/gtest.h>

using namespace qm;

namespace {

const QString toosimilar = QStringLiteral(
    "Name is too similar to an existing flag name. Please choose another name. If an existing flagname has the same "
    "first 13 characters (ignoring anything other than letters, digits or spaces) then they are deemed to be too "
    "similar.");

QString refusedname(const flagtable& t, const QString& typed)
{
    const auto r = refuseflagname(t, typed);
    return r ? r->text : QString();
}

// The codes of the flags an individual holds, to compare before and after a
// change of the table.
std::vector<std::string> heldcodes(const gedcomindex& ix, size_t person)
{
    std::vector<std::string> out;
    for (const int32_t f : ix.people[person].flagids)
        out.push_back(ix.flags[static_cast<size_t>(f)].code);
    return out;
}

personrec holding(std::initializer_list<int32_t> flags)
{
    personrec p;
    p.flagids = flags;
    return p;
}

TEST(FlagNames, RefusesEmptyTakenAndTooSimilarNames)
{
    const flagtable t{{"__CENSUS_1881", "Census 1881", "3 APR 1881", 0, "UK"},
                      {"__FAMILY_SEARCH", "Family Search Census", "", 2, ""}};
    // Same code: letter case, punctuation, or a difference after the 13th
    // significant character.
    EXPECT_EQ(refusedname(t, QStringLiteral("census 1881")), toosimilar);
    EXPECT_EQ(refusedname(t, QStringLiteral("Census. 1881!")), toosimilar);
    EXPECT_EQ(refusedname(t, QStringLiteral("Family Search Records")), toosimilar);
    EXPECT_EQ(refusedname(t, QStringLiteral("  Census 1881 ")), QStringLiteral("There is already a flag with this name"));
    EXPECT_EQ(refusedname(t, QStringLiteral("Census 1891")), QString());
    EXPECT_EQ(refusedname(t, QStringLiteral("Family Searc")), QString()) << "12 characters: another code";

    // Empty, or nothing a code can be made of (a code "__" is no usable flag).
    for (const char* bad : {"", "   ", "--- !", "."}) {
        const auto r = refuseflagname(t, QString::fromLatin1(bad));
        ASSERT_TRUE(r) << bad;
        EXPECT_TRUE(r->invalid && r->text == QStringLiteral("This is an invalid flag name"));
    }
    EXPECT_FALSE(refuseflagname(t, QStringLiteral("census 1881"))->invalid);
    EXPECT_EQ(refusedname(t, QStringLiteral("- 1 -")), QString()) << "a digit is enough";

    // The first flag in table order decides which clash is reported.
    const flagtable u{{"__C1881", "Census 1881x", "", 0, ""}, {"__CENSUS_1881", "x", "", 0, ""},
                      {"__OTHER", "Census 1881", "", 0, ""}};
    EXPECT_EQ(refusedname(u, QStringLiteral("Census 1881")), toosimilar);
}

TEST(AllocateFlag, UpdatesTheNamedFlagOrAppendsANewOne)
{
    flagtable t{{"__C1881", "Census 1881", "", 3, ""}, {"__OLD", "Old", "", 1, "UK"}};
    EXPECT_EQ(allocateflag(t, QStringLiteral("Old"), QStringLiteral("1881"), QStringLiteral("Canada")), 1u);
    EXPECT_TRUE(t[1].date == "1881" && t[1].country == "Canada" && t[1].count == 1);

    EXPECT_EQ(allocateflag(t, QStringLiteral("Ireland Census 1901"), QStringLiteral("31 MAR 1901"),
                           QStringLiteral("Ireland")),
              2u);
    ASSERT_EQ(t.size(), 3u);
    EXPECT_TRUE(t[2].code == "__IRELAND_CENSU" && t[2].count == 0);
    EXPECT_EQ(flagrowtext(t[2]), QStringLiteral("31 MAR 1901    Ireland        Ireland Census 1901"));

    // Two flags of one name from the family file: the one picked is the one allocated.
    t.push_back({"__CENSUS_1881", "Census 1881", "", 2, ""});
    EXPECT_EQ(allocateflag(t, QStringLiteral("Census 1881"), QStringLiteral("3 APR 1881"), QStringLiteral("UK"), 3), 3u);
    EXPECT_TRUE(t[0].date.empty() && t[3].date == "3 APR 1881");
    EXPECT_EQ(allocatedflags(t), (std::vector<size_t>{1, 2, 3}));
    EXPECT_EQ(unallocatedflags(t), (std::vector<size_t>{0}));
}

// A flag held by individuals keeps its place and loses only its census; it
// is then offered as an existing name (and, unallocated, no longer stored:
// FlagDefsTest.SaveKeepsOnlyAllocatedFlagsAndClearsStaleGroups).
TEST(DeleteFlag, HeldFlagKeepsItsPlaceWithoutADate)
{
    gedcomindex ix;
    ix.flags = {{"__C1881", "Census 1881", "3 APR 1881", 2, "UK"}, {"__C1891", "Census 1891", "1891", 0, "UK"}};
    ix.people = {holding({0}), holding({0})};
    deleteflag(ix, 0);
    ASSERT_EQ(ix.flags.size(), 2u);
    EXPECT_TRUE(ix.flags[0].date.empty() && ix.flags[0].count == 2);
    EXPECT_EQ(heldcodes(ix, 0), std::vector<std::string>{"__C1881"});
    EXPECT_EQ(unallocatedflags(ix.flags), std::vector<size_t>{0});

    // A count that missed a holder does not take the flag away from under it.
    ix.flags[1].count = 0;
    ix.people[1].flagids = {0, 1};
    deleteflag(ix, 1);
    ASSERT_EQ(ix.flags.size(), 2u);
    deleteflag(ix, 7); // out of range: nothing
    EXPECT_EQ(ix.flags.size(), 2u);
}

TEST(DeleteFlag, UnheldFlagLeavesAndHoldersKeepTheirFlags)
{
    gedcomindex ix;
    ix.flags = {{"__A", "A", "1841", 1, "UK"},
                {"__FREE", "Free", "1851", 0, "UK"},
                {"__B", "B", "1861", 2, "UK"},
                {"__C", "C", "", 1, ""}};
    ix.people = {holding({2, 0}), holding({}), holding({3, 2})};
    std::vector<std::vector<std::string>> before;
    for (size_t k = 0; k < ix.people.size(); ++k)
        before.push_back(heldcodes(ix, k));

    deleteflag(ix, 1);
    ASSERT_EQ(ix.flags.size(), 3u);
    EXPECT_EQ(ix.flags[1].code, "__B");
    for (size_t k = 0; k < ix.people.size(); ++k)
        EXPECT_EQ(heldcodes(ix, k), before[k]) << "individual " << k;
    EXPECT_EQ(std::vector<int32_t>(ix.people[0].flagids.begin(), ix.people[0].flagids.end()),
              (std::vector<int32_t>{1, 0}));
    EXPECT_EQ(std::vector<int32_t>(ix.people[2].flagids.begin(), ix.people[2].flagids.end()),
              (std::vector<int32_t>{2, 1}));
}

TEST(FlagDates, CensusDatesOfTheCountryNotYetAllocated)
{
    const flagtable t{{"__A", "A", "3 APR 1881", 0, "UK"},
                      {"__B", "B", "1891", 0, "UK"},
                      {"__C", "C", "2 APR 1871", 0, "Canada"},
                      {"__D", "D", "", 0, "UK"}};
    EXPECT_EQ(flagdates(t, QStringLiteral("UK")),
              (QStringList{"6 JUN 1841", "30 MAR 1851", "7 APR 1861", "2 APR 1871", "5 APR 1891", "31 MAR 1901"}));
    EXPECT_EQ(flagdates(t, QStringLiteral("Ireland")), (QStringList{"31 MAR 1901", "2 APR 1911"}));
    EXPECT_EQ(flagdates(t, QStringLiteral("Canada")).size(), 8);
    EXPECT_FALSE(flagdates(t, QStringLiteral("Canada")).contains(QStringLiteral("2 APR 1871")));
    EXPECT_TRUE(flagdates(t, QStringLiteral("France")).isEmpty());
}

TEST(FlagDates, AnotherFlagOfTheCountryRefusesDateOrYear)
{
    const flagtable t{{"__A", "A", "1881", 0, "UK"}, {"__B", "B", "31 MAR 1901", 0, "Ireland"},
                      {"__D", "D", "", 0, "Canada"}};
    EXPECT_EQ(refusedate(t, QStringLiteral("UK"), QStringLiteral("3 APR 1881")),
              QStringLiteral("Another flag has already been associated with UK 3 APR 1881. Either choose another "
                             "date or press cancel."));
    EXPECT_EQ(refusedate(t, QStringLiteral("Canada"), QStringLiteral("4 APR 1881")), std::nullopt);
    EXPECT_EQ(refusedate(t, QStringLiteral("UK"), QStringLiteral("5 APR 1891")), std::nullopt);
    EXPECT_TRUE(refuseyear(t, QStringLiteral("UK"), QStringLiteral("1881")));
    // A full date blocks its year; only within its own country.
    EXPECT_TRUE(refuseyear(t, QStringLiteral("Ireland"), QStringLiteral("1901")));
    EXPECT_EQ(refuseyear(t, QStringLiteral("UK"), QStringLiteral("1901")), std::nullopt);
    EXPECT_EQ(refusedate(t, QStringLiteral("UK"), QStringLiteral("31 MAR 1901")), std::nullopt);
    EXPECT_EQ(refuseyear(t, QStringLiteral("Canada"), QStringLiteral("1901")), std::nullopt);
}

} // namespace
