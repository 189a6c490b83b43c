#include "census/censustable.h"

#include <gtest/gtest.h>

using namespace qm;
using namespace Qt::StringLiterals;

// Shows texts readably in failure messages.
[[maybe_unused]] static void PrintTo(const QString& s, std::ostream* os)
{
    *os << '"' << s.toStdString() << '"';
}

TEST(Censustable, TheThirtyThreeCensusesInTheirFixedOrder)
{
    // Country, year, official day, reference prefix. Canada's 1851 census was
    // held in 1852; days shared: 2 APR 1871 (UK, Canada), 31 MAR 1901 (UK,
    // Ireland, Canada).
    const QStringList rows{
        "UK 1841 6 JUN 1841 HO107/",   "UK 1851 30 MAR 1851 HO107/",  "UK 1861 7 APR 1861 RG9/",
        "UK 1871 2 APR 1871 RG10/",    "UK 1881 3 APR 1881 RG11/",    "UK 1891 5 APR 1891 RG12/",
        "UK 1901 31 MAR 1901 RG13/",   "USA 1790 2 AUG 1790 ",        "USA 1800 4 AUG 1800 ",
        "USA 1810 6 AUG 1810 ",        "USA 1820 7 AUG 1820 ",        "USA 1830 1 JUN 1830 ",
        "USA 1840 1 JUN 1840 ",        "USA 1850 1 JUN 1850 ",        "USA 1860 1 JUN 1860 ",
        "USA 1870 1 JUN 1870 ",        "USA 1880 1 JUN 1880 ",        "USA 1890 1 JUN 1890 ",
        "USA 1900 1 JUN 1900 ",        "USA 1910 15 APR 1910 ",       "USA 1920 1 JAN 1920 ",
        "USA 1930 1 APR 1930 ",        "Ireland 1901 31 MAR 1901 ",   "Ireland 1911 2 APR 1911 ",
        "Canada 1825 20 JUN 1825 ",    "Canada 1831 1 JUN 1831 ",     "Canada 1851 12 JAN 1852 ",
        "Canada 1861 14 JAN 1861 ",    "Canada 1871 2 APR 1871 ",     "Canada 1881 4 APR 1881 ",
        "Canada 1891 6 APR 1891 ",     "Canada 1901 31 MAR 1901 ",    "Canada 1911 1 JUN 1911 "};
    QStringList table;
    for (const censusdef& c : censustable())
        table << QStringLiteral("%1 %2 %3 %4").arg(c.country).arg(c.year).arg(c.date, c.refprefix);
    EXPECT_EQ(table.join(u'\n').toStdString(), rows.join(u'\n').toStdString());
}

TEST(Censustable, YearListsAndLookupsTakeTheCountrysRows)
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

    EXPECT_EQ(findcensusrow(u"UK"_s, 1901), 6);
    EXPECT_EQ(findcensusrow(u"Ireland"_s, 1901), 22);
    EXPECT_EQ(findcensusrow(u"Canada"_s, 1901), 31);
    EXPECT_EQ(findcensusrow(u"UK"_s, 1911), -1);
    ASSERT_TRUE(lookupcensus(u"Canada"_s, 1851));
    EXPECT_EQ(lookupcensus(u"Canada"_s, 1851)->date, "12 JAN 1852");
    EXPECT_FALSE(lookupcensus(u"USA"_s, 1851));
}

// A year chosen in the form: the official date, an error or not, the
// reference field ("ref=" its new text, "|" the cursor, when it is set) and
// the prefix the form then holds as filled in last.
TEST(Findcensus, OfficialDateAndTheReferenceFilledInOnlyWhileUntouched)
{
    const struct {
        const char* country;
        const char* year;
        const char* reference;
        const char* lastprefix;
        bool autoreference;
        const char* found;
    } cases[] = {
        {"Canada", "1851", "", "", false, "12 JAN 1852 last="},
        {"UK", " 1881 ", "", "", false, "3 APR 1881 last="},
        {"   ", "", "", "", true, " last="},
        {"UK", "1850", "", "RG9/", true, " error last=RG9/"},
        {"UK", "18x1", "", "RG9/", true, " error last=RG9/"},
        {"UK", "1861", "", "", true, "7 APR 1861 ref=RG9/| last=RG9/"},     // empty: the prefix goes in
        {"UK", "1871", "RG9/", "RG9/", true, "2 APR 1871 ref=RG10/| last=RG10/"}, // the prefix filled in last
        {"UK", "1881", "RG9/123", "RG9/", true, "3 APR 1881 last=RG9/"},    // typed into: left alone
        {"UK", "1841", "  ", "RG9/", true, "6 JUN 1841 ref=HO107/| last=HO107/"}, // blank counts as empty
        {"USA", "1880", "HO107/", "HO107/", true, "1 JUN 1880 ref=| last="},  // no prefixes: emptied
        {"UK", "1861", "", "", false, "7 APR 1861 last="},                    // without "Auto Reference"
    };
    for (const auto& c : cases) {
        censuschoice choice;
        choice.country = QString::fromLatin1(c.country);
        choice.yeartext = QString::fromLatin1(c.year);
        choice.referencetext = QString::fromLatin1(c.reference);
        choice.lastrefprefix = QString::fromLatin1(c.lastprefix);
        choice.autoreference = c.autoreference;
        const censusfound r = findcensus(choice);
        QString found = r.date;
        if (!r.error.isEmpty())
            found += QStringLiteral(" error");
        if (r.setreference)
            found += QStringLiteral(" ref=") + r.referencetext.left(r.cursor) + u'|' + r.referencetext.mid(r.cursor);
        EXPECT_EQ(found + QStringLiteral(" last=") + r.lastrefprefix, QString::fromLatin1(c.found))
            << c.country << " " << c.year;
        if (!r.error.isEmpty()) {
            EXPECT_EQ(r.error, "Serious Error - the year and country chosen are not supported by Quillmark - please "
                               "contact the author");
        }
    }
}
