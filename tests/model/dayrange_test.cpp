// Reading the days a GEDCOM date allows: plain, partial, qualified, ranges,
// periods, and what reads as no date.
#include "model/dayrange.h"

#include <gtest/gtest.h>

using namespace qm;

TEST(DayRange, FormsQualifiersAndRefusals)
{
    const daynumber y1880end = daynumberof(1880, 12, 31), y1881 = daynumberof(1881, 1, 1),
                    y1881end = daynumberof(1881, 12, 31), apr3 = daynumberof(1881, 4, 3);
    const struct {
        const char* text;
        bool valid;
        daynumber first, last;
        int year;
    } cases[] = {
        {"3 APR 1881", true, apr3, apr3, 1881},
        {"03 april 1881", true, apr3, apr3, 1881},
        {"@#DGREGORIAN@ 3 APR 1881", true, apr3, apr3, 1881},
        {"APR 1881", true, daynumberof(1881, 4, 1), daynumberof(1881, 4, 30), 1881},
        {"FEB 1880", true, daynumberof(1880, 2, 1), daynumberof(1880, 2, 29), 1880},
        {"Q2 1881", true, daynumberof(1881, 4, 1), daynumberof(1881, 6, 30), 1881},
        {"1881", true, y1881, y1881end, 1881},
        {"1880/81", true, y1881, y1881end, 1881},
        {"abt 1881", true, y1881 - 731, y1881end + 731, 1881},
        {"CAL 3 APR 1881", true, apr3 - 731, apr3 + 731, 1881},
        {"BEF 1881", true, nodaybefore, y1880end, 1881},
        {"AFT 1880", true, y1881, nodayafter, 1880},
        {"BET 1850 AND 1852", true, daynumberof(1850, 1, 1), daynumberof(1852, 12, 31), 1850},
        {"INT 1881 (from the census)", true, y1881, y1881end, 1881},
        {"TO 1881", true, y1881, y1881end, 1881},
        {"(unknown)", false, 0, 0, 0},
        {"31 FEB 1881", false, 0, 0, 0},
        {"0 APR 1881", false, 0, 0, 0},
        {"3 APR", false, 0, 0, 0},
        {"ABT", false, 0, 0, 0},
        {"BET 1850", false, 0, 0, 0},
        {"1881 B.C.", false, 0, 0, 0},
        {"1881 or so", false, 0, 0, 0},
        {"31 MAR1901", false, 0, 0, 0},
        {"", false, 0, 0, 0},
    };
    for (const auto& c : cases) {
        const dayrange r = readdayrange(c.text);
        EXPECT_EQ(r.valid, c.valid) << c.text;
        if (r.valid && c.valid) {
            EXPECT_EQ(r.first, c.first) << c.text;
            EXPECT_EQ(r.last, c.last) << c.text;
            EXPECT_EQ(r.year, c.year) << c.text;
            EXPECT_FALSE(r.period) << c.text;
        }
    }
    EXPECT_EQ(daynumberof(1881, 3, 1) - daynumberof(1881, 2, 28), 1);
    EXPECT_EQ(daynumberof(1900, 3, 1) - daynumberof(1900, 2, 28), 1); // 1900 was no leap year

    // A period: the days certainly within it run from the first date's last day to the second's first.
    const dayrange p = readdayrange("FROM 1885 TO MAR 1905");
    ASSERT_TRUE(p.valid && p.period);
    EXPECT_EQ(p.first, daynumberof(1885, 1, 1));
    EXPECT_EQ(p.last, daynumberof(1905, 3, 31));
    EXPECT_EQ(p.fromlast, daynumberof(1885, 12, 31));
    EXPECT_EQ(p.tofirst, daynumberof(1905, 3, 1));
}
