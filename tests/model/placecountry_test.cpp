// The country a place's name tells, and a country the flag check learnt for it.
#include "model/placecountry.h"

#include "model/loadgedcom.h"

#include <gtest/gtest.h>

using namespace qm;

TEST(PlaceCountry, LastPartOfTheName)
{
    using c = countrycode;
    const std::pair<const char*, countrycode> cases[] = {
        {"Leeds, Yorkshire, England", c::uk},       {"Cardiff, Glamorgan, WALES ", c::uk},
        {"Douglas, Isle Of Man", c::uk},            {"St Helier, Jersey", c::uk},
        {"Boston, Massachusetts, USA", c::usa},     {"Springfield, IL", c::usa},
        {"Boston, Massachusetts", c::usa},          {"Los Angeles, CA", c::unknown},
        {"Berlin, DE", c::unknown},                 {"Dublin, Éire", c::ireland},
        {"Cork, Co. Cork", c::ireland},             {"Skibbereen, County Cork", c::ireland},
        {"Belfast, Antrim, Northern Ireland", c::ireland}, {"Tullamore, King's County", c::ireland},
        {"Toronto, Ontario", c::canada},            {"Halifax, NS", c::canada},
        {"Montréal, Québec, Canada", c::canada},    {"St John's, Newfoundland", c::other},
        {"Sydney, New South Wales, Australia", c::other}, {"Leeds", c::unknown},
        {"Leeds, ", c::unknown},                    {"", c::unknown},
    };
    for (const auto& [place, country] : cases)
        EXPECT_EQ(countryofplacename(place), country) << place;
    EXPECT_EQ(countryname(c::ireland), QStringLiteral("Ireland"));
    EXPECT_EQ(countryofname(QStringLiteral("Canada")), c::canada);
    EXPECT_EQ(countryname(c::other), QString());
}

TEST(PlaceCountry, ACountryLearntForThePlaceWins)
{
    auto ix = loadgedcombytes("0 HEAD\r\n0 @I1@ INDI\r\n1 CENS\r\n2 PLAC Leeds, England\r\n1 RESI\r\n2 PLAC Hull\r\n"
                              "0 TRLR\r\n",
                              flagtable{});
    ix->places[static_cast<size_t>(findplace(*ix, "leeds, england"))].country = "Ireland";
    EXPECT_EQ(placecountry(*ix, "Leeds, England"), countrycode::ireland);
    EXPECT_EQ(placecountry(*ix, "Hull"), countrycode::unknown);
    EXPECT_EQ(placecountry(*ix, "York, England"), countrycode::uk); // not in the file: its name
}
