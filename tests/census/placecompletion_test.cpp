#include "census/placecompletion.h"

#include <gtest/gtest.h>

using namespace qm;

namespace {

// Sorted ignoring case, one entry per group, as the loader builds it.
std::vector<placerec> sampleplaces()
{
    return {
        {"Leeds, Yorkshire", 4},
        {"Wakefield, Yorkshire", 1},
        {"Warrington, Lancashire", 3},
        {"Warwick, Warwickshire", 5},
        {"warwick, Warwickshire, England", 5},
        {"Wigan, Lancashire", 9},
        {"York", 2},
    };
}

} // namespace

TEST(PlaceCompletion, MostUsedPlaceWinsAndFirstOnATie)
{
    const auto places = sampleplaces();
    EXPECT_EQ(bestplace(places, u"war"), 3);  // Warwick (5) beats Warrington (3)
    EXPECT_EQ(bestplace(places, u"WARW"), 3); // tie of 5: the first
    EXPECT_EQ(bestplace(places, u"Warr"), 2);
    EXPECT_EQ(bestplace(places, u"w"), 5);    // Wigan (9)
    EXPECT_EQ(bestplace(places, u"york"), 6);
    EXPECT_EQ(bestplace(places, u"Leeds, Yorkshire"), 0);
    EXPECT_EQ(bestplace(places, u"Leeds, Yorkshire, England"), -1);
    EXPECT_EQ(bestplace(places, u"Aberdeen"), -1);
    EXPECT_EQ(bestplace(places, u"Zennor"), -1);
    EXPECT_EQ(bestplace(places, u""), -1);
    EXPECT_EQ(bestplace({}, u"war"), -1);
}

TEST(PlaceCompletion, NonAsciiNamesCompareIgnoringCase)
{
    const std::vector<placerec> places = {{"Échirolles, Isère", 2}, {"Ödeshög", 1}};
    EXPECT_EQ(bestplace(places, u"éch"), 0);
    EXPECT_EQ(bestplace(places, u"öDE"), 1);
}

TEST(PlaceCompletion, OffersTheRestSelectedOnlyAtTheEndOfTheText)
{
    const auto places = sampleplaces();
    auto done = completeplace(places, {"war", 3, 0});
    ASSERT_TRUE(done);
    EXPECT_EQ(*done, (placebox{"Warwick, Warwickshire", 3, 18}));

    // The name's own spelling replaces the typed letters' case.
    done = completeplace(places, {"LEEDS, YORKSHIRE", 16, 0});
    ASSERT_TRUE(done);
    EXPECT_EQ(*done, (placebox{"Leeds, Yorkshire", 16, 0}));

    EXPECT_FALSE(completeplace(places, {"war", 1, 0}));  // caret inside the text
    EXPECT_FALSE(completeplace(places, {"war", 1, 2}));  // a selection
    EXPECT_FALSE(completeplace(places, {"", 0, 0}));
    EXPECT_FALSE(completeplace(places, {"Zennor", 6, 0}));
}

TEST(PlaceCompletion, TypingTheOfferedLetterWalksThroughTheOffer)
{
    const placebox offered{"Warwick, Warwickshire", 3, 18};
    auto next = typethrough(offered, u"w");
    ASSERT_TRUE(next);
    EXPECT_EQ(*next, (placebox{"Warwick, Warwickshire", 4, 17}));

    EXPECT_FALSE(typethrough(offered, u"W")); // case matters
    EXPECT_FALSE(typethrough(offered, u"r"));
    EXPECT_FALSE(typethrough(offered, u"\b"));
    EXPECT_FALSE(typethrough(offered, u""));
    // With one character selected the key is entered as usual.
    EXPECT_FALSE(typethrough({"Leeds", 4, 1}, u"s"));
    EXPECT_FALSE(typethrough({"Leeds", 5, 0}, u"s"));
    // A selection inside the text shrinks to the end of the text.
    next = typethrough({"Leeds, Yorkshire", 0, 3}, u"L");
    ASSERT_TRUE(next);
    EXPECT_EQ(*next, (placebox{"Leeds, Yorkshire", 14, 2}));
}
