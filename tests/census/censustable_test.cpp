#include "census/censustable.h"

#include <gtest/gtest.h>

using namespace qm;
using namespace Qt::StringLiterals;

TEST(Censustable, RowsInTheirFixedOrder)
{
    const auto& t = censustable();
    ASSERT_EQ(t.size(), 33u);
    // Every official date ends in a four-digit year; only Canada 1851 lies in
    // another year than its census.
    for (const censusdef& c : t) {
        EXPECT_EQ(c.date.right(4).toInt() == c.year, !(c.country == "Canada" && c.year == 1851)) << c.year;
        EXPECT_EQ(c.refprefix.isEmpty(), c.country != "UK");
    }
}

TEST(Censustable, YearListsPerCountry)
{
    EXPECT_EQ(fillyears(u"UK"_s), QStringList({"1841", "1851", "1861", "1871", "1881", "1891", "1901"}));
    QStringList usa;
    for (int y = 1790; y <= 1930; y += 10)
        usa.append(QString::number(y));
    EXPECT_EQ(fillyears(u"USA"_s), usa);
    EXPECT_EQ(fillyears(u"Ireland"_s), QStringList({"1901", "1911"}));
    EXPECT_EQ(fillyears(u"Canada"_s),
              QStringList({"1825", "1831", "1851", "1861", "1871", "1881", "1891", "1901", "1911"}));
    // The country must match exactly.
    EXPECT_TRUE(fillyears(u"uk"_s).isEmpty());
    EXPECT_TRUE(fillyears(u""_s).isEmpty());
    EXPECT_EQ(censusyearcaption(u"Canada"_s), "Canada Census Year:");
}

TEST(Censustable, LookupTakesTheCountrysRow)
{
    EXPECT_EQ(findcensusrow(u"UK"_s, 1901), 6);
    EXPECT_EQ(findcensusrow(u"Ireland"_s, 1901), 22);
    EXPECT_EQ(findcensusrow(u"Canada"_s, 1901), 31);
    EXPECT_EQ(findcensusrow(u"UK"_s, 1911), -1);
    ASSERT_TRUE(lookupcensus(u"Canada"_s, 1851));
    EXPECT_EQ(lookupcensus(u"Canada"_s, 1851)->date, "12 JAN 1852");
    EXPECT_FALSE(lookupcensus(u"USA"_s, 1851));
}

namespace {
censuschoice choose(const QString& country, const QString& year, const QString& reference,
                    const QString& lastprefix, bool autoreference = true)
{
    censuschoice c;
    c.country = country;
    c.yeartext = year;
    c.autoreference = autoreference;
    c.referencetext = reference;
    c.lastrefprefix = lastprefix;
    return c;
}
} // namespace

TEST(Findcensus, OfficialDateOrError)
{
    auto r = findcensus(choose(u"Canada"_s, u"1851"_s, u""_s, u""_s, false));
    EXPECT_EQ(r.date, "12 JAN 1852");
    EXPECT_EQ(r.error, "");
    EXPECT_FALSE(r.setreference);

    r = findcensus(choose(u"UK"_s, u" 1881 "_s, u""_s, u""_s, false));
    EXPECT_EQ(r.date, "3 APR 1881");

    r = findcensus(choose(u"   "_s, u""_s, u""_s, u""_s));
    EXPECT_EQ(r.date, "");
    EXPECT_EQ(r.error, "");

    for (const QString& year : {u"1850"_s, u"18x1"_s}) {
        r = findcensus(choose(u"UK"_s, year, u""_s, u"RG9/"_s));
        EXPECT_EQ(r.date, "");
        EXPECT_EQ(r.error, "Serious Error - the year and country chosen are not supported by Quillmark - please "
                           "contact the author");
        EXPECT_FALSE(r.setreference);
        EXPECT_EQ(r.lastrefprefix, "RG9/");
    }
}

TEST(Findcensus, AutoReferenceFillsOnlyUntouchedFields)
{
    // Empty field: the prefix goes in with the cursor after the slash.
    auto r = findcensus(choose(u"UK"_s, u"1861"_s, u""_s, u""_s));
    EXPECT_EQ(r.date, "7 APR 1861");
    ASSERT_TRUE(r.setreference);
    EXPECT_EQ(r.referencetext, "RG9/");
    EXPECT_EQ(r.cursor, 4);
    EXPECT_EQ(r.lastrefprefix, "RG9/");

    // Still the prefix filled in last: replaced.
    r = findcensus(choose(u"UK"_s, u"1871"_s, u"RG9/"_s, r.lastrefprefix));
    ASSERT_TRUE(r.setreference);
    EXPECT_EQ(r.referencetext, "RG10/");
    EXPECT_EQ(r.cursor, 5);
    EXPECT_EQ(r.lastrefprefix, "RG10/");

    // Typed into: left alone.
    r = findcensus(choose(u"UK"_s, u"1881"_s, u"RG9/123"_s, u"RG9/"_s));
    EXPECT_EQ(r.date, "3 APR 1881");
    EXPECT_FALSE(r.setreference);
    EXPECT_EQ(r.lastrefprefix, "RG9/");

    // Blank counts as empty; a country without prefixes empties the field.
    r = findcensus(choose(u"UK"_s, u"1841"_s, u"  "_s, u"RG9/"_s));
    EXPECT_EQ(r.referencetext, "HO107/");
    r = findcensus(choose(u"USA"_s, u"1880"_s, u"HO107/"_s, u"HO107/"_s));
    ASSERT_TRUE(r.setreference);
    EXPECT_EQ(r.referencetext, "");
    EXPECT_EQ(r.cursor, 0);
    EXPECT_EQ(r.lastrefprefix, "");

    // Without "Auto Reference" nothing is filled in.
    r = findcensus(choose(u"UK"_s, u"1861"_s, u""_s, u""_s, false));
    EXPECT_FALSE(r.setreference);
}
