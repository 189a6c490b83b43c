#include "model/dates.h"

#include "model/gedcomindex.h"

#include <gtest/gtest.h>

using namespace qm;
using namespace Qt::StringLiterals;

namespace {

QDate d(int y, int m, int day)
{
    return QDate(y, m, day);
}

const std::optional<QDate> census1881 = QDate(1881, 4, 3);

// Sets the default locale for the life of a test.
class localeguard {
public:
    explicit localeguard(const QLocale& l) : old_(QLocale()) { QLocale::setDefault(l); }
    ~localeguard() { QLocale::setDefault(old_); }

private:
    QLocale old_;
};

} // namespace

TEST(Recognisedate, EnglishMonthsInAnyCaseAndNumbersInTheLocaleOrder)
{
    constexpr dateorder dmy = dateorder::dmy, mdy = dateorder::mdy, ymd = dateorder::ymd;
    const struct {
        dateorder order;
        std::optional<QDate> day; // none: not one day
        std::vector<const char*> texts;
    } rows[] = {
        {dmy, d(1881, 4, 4), {"4 apr 1881", "04 APR 1881", "4 April 1881", "4-Apr-1881", "4 Apr. 1881", "April 4 1881",
                              "apr 4, 1881", " 4  APR 1881 ", "4 aPrIl 1881"}},
        {dmy, d(1851, 9, 3), {"3 Sept 1851"}},
        {mdy, d(1881, 4, 1), {"APR 1881"}},
        {dmy, d(1852, 2, 29), {"29 FEB 1852"}},
        {dmy, std::nullopt, {"", "1881", "ABT 1881", "BET 1850 AND 1852", "31 FEB 1881", "29 FEB 1851", "0 APR 1881",
                             "32 APR 1881", "4 Apr", "4/4/81", "4 AP 1881", "4 Aprilx 1881", "4 APR 1881 1882",
                             "4 MAI 1881", "4 APR 18810", "4 APR 1881?", "13/13/1881", "4 APR 0000"}},
        {dmy, d(1881, 4, 3), {"3/4/1881", "03.04.1881", "1881-04-03"}},
        {mdy, d(1881, 3, 4), {"3/4/1881"}},
        {mdy, std::nullopt, {"13/4/1881"}},
        {ymd, std::nullopt, {"3/4/1881"}},
        {mdy, d(1881, 4, 3), {"1881-04-03"}}, // year first with four digits reads the same everywhere
        {ymd, d(1881, 4, 3), {"1881-04-03"}},
    };
    for (const auto& row : rows)
        for (const char* text : row.texts)
            EXPECT_EQ(recognisedate(QString::fromLatin1(text), row.order), row.day) << text << " " << int(row.order);

    EXPECT_EQ(localedateorder(QLocale(QLocale::German, QLocale::Germany)), dmy);
    EXPECT_EQ(localedateorder(QLocale(QLocale::English, QLocale::UnitedKingdom)), dmy);
    EXPECT_EQ(localedateorder(QLocale(QLocale::English, QLocale::UnitedStates)), mdy);
    EXPECT_EQ(localedateorder(QLocale(QLocale::Chinese, QLocale::China)), ymd);
}

TEST(Recognisedate, TypedUnderAnyLocaleIsWrittenInEnglish)
{
    {
        localeguard g(QLocale(QLocale::German, QLocale::Germany));
        auto typed = recognisedate(u"3.4.1881");
        ASSERT_TRUE(typed);
        EXPECT_EQ(formatgedcomdate(*typed), "03 APR 1881");
        EXPECT_EQ(formatgedcomdate(d(1881, 3, 3)), "03 MAR 1881"); // not "MÄR"
        EXPECT_EQ(formatgedcommonth(d(1850, 10, 1)), "OCT 1850");  // not "OKT"
        EXPECT_EQ(validdate(u"3.5.1881"_s, u"3 APR 1881"_s).newtext, u"03 MAY 1881"_s);
    }
    {
        localeguard g(QLocale(QLocale::English, QLocale::UnitedStates));
        auto typed = recognisedate(u"4/3/1881");
        ASSERT_TRUE(typed);
        EXPECT_EQ(formatgedcomdate(*typed), "03 APR 1881");
    }
}

TEST(Formatgedcomdate, StampsMonthsAndCompletedYears)
{
    EXPECT_EQ(formatgedcomdate(d(2026, 12, 4)), "04 DEC 2026");
    EXPECT_EQ(formatgedcomdate(d(1851, 3, 30)), "30 MAR 1851");
    EXPECT_EQ(formatgedcomdate(d(987, 12, 31)), "31 DEC 0987");
    EXPECT_EQ(formatgedcomdate(QDate()), "");
    EXPECT_EQ(formatgedcomtime(QTime(9, 5, 7)), "09:05:07");
    EXPECT_EQ(englishmonth(9), "SEP");
    EXPECT_EQ(englishmonth(13), "");
    // Whole years to the census day of 3 APR 1881 (a birthday on the day counts).
    std::vector<int> years;
    for (const QDate& born : {d(1851, 3, 3), d(1851, 4, 3), d(1851, 4, 4), d(1851, 12, 31), d(1881, 5, 1), d(1883, 5, 1)})
        years.push_back(completedyears(born, d(1881, 4, 3)));
    EXPECT_EQ(years, (std::vector<int>{30, 30, 29, 29, 0, -2}));
}

TEST(Datephrase, PhrasesAndAges)
{
    const std::optional<QDate> none;
    const struct {
        const char* text;
        std::optional<QDate> census;
        const char* phrase;
        const char* age; // "" when no age is given
    } cases[] = {
        {"3 MAR 1851", census1881, "on 3 Mar 1851", "30"},
        {"MAR 1851", census1881, "in Mar 1851", "30"}, // born on 1 or on 31 March: 30 either way
        {"1851", census1881, "in 1851", "29 or 30"},
        {"  12 apr 1851 ", census1881, "on 12 Apr 1851", "29"},
        // A month's latest day is its last: 29 FEB 1852 turns 29 on 1 MAR 1881.
        {"FEB 1852", d(1881, 2, 28), "in Feb 1852", "28 or 29"},
        {"FEB 1852", d(1881, 3, 1), "in Feb 1852", "29"},
        {"FEB 1851", d(1880, 2, 28), "in Feb 1851", "29"}, // 28 days in 1851
        {"APR 1851", d(1881, 4, 30), "in Apr 1851", "30"},
        // Qualifiers.
        {"BET 1850 AND 1852", census1881, "between 1850 and 1852", ""},
        {"aft 1851", census1881, "after 1851", ""},
        {"BEF 3 MAR 1851", census1881, "before 3 Mar 1851", ""},
        {"FROM 1850 TO 1852", census1881, "during a period from 1850 To 1852", ""},
        {"TO 1852", census1881, "during a period to 1852", ""},
        {"ABT 1851", census1881, "in 1851 (approx.)", "29 or 30 (approx.)"},
        {"EST 3 MAR 1851", census1881, "on 3 Mar 1851 (estimated)", "30 (estimated)"},
        {"CAL MAR 1851", none, "in Mar 1851 (calculated)", ""},
        {"ABT", census1881, "in (approx.)", ""},
        // Words of two or more characters not starting with a digit are
        // capitalised; single characters and numbers are lower case. Split at
        // single spaces, twelve words at most: the last keeps the rest.
        {"@#DJULIAN@ 3 mar 1751", none, "in @#djulian@ 3 Mar 1751", ""},
        {"3 MAR 1851 A", none, "on 3 Mar 1851 a", ""},
        {"1851 and 1852", none, "in 1851 and 1852", ""},
        {"3  MAR", none, "on 3  Mar", ""},
        {"A B C D E F G H I J K LL MM", none, "in a b c d e f g h i j k Ll mm", ""},
    };
    for (const auto& c : cases) {
        const auto r = datephrase(QString::fromLatin1(c.text), c.census, dateorder::dmy);
        EXPECT_EQ(r.phrase, QString::fromLatin1(c.phrase)) << c.text;
        EXPECT_EQ(r.agephrase, *c.age ? " and in this census would be aged " + QString::fromLatin1(c.age) : QString())
            << c.text;
        EXPECT_EQ(r.agecomputed, *c.age != 0) << c.text;
    }
    const auto plain = datephrase(u"3 MAR 1851", census1881, dateorder::dmy);
    EXPECT_EQ(plain.earliestyear, 1851);
    EXPECT_EQ(plain.latestyear, 1851);
    EXPECT_EQ(datephrase(u"BET 1850 AND 1852", census1881, dateorder::dmy).earliestyear, -9999);
}

TEST(Datephrase, NoAgeWithoutCensusDayOrUsableDate)
{
    EXPECT_FALSE(datephrase(u"3 MAR 1851", std::nullopt, dateorder::dmy).agecomputed);
    EXPECT_FALSE(datephrase(u"3 MAR 1851", u""_s).agecomputed);
    EXPECT_FALSE(datephrase(u"3 MAR 1851", u"sometime in 1881"_s).agecomputed);
    EXPECT_TRUE(datephrase(u"3 MAR 1851", u"3 APR 1881"_s).agecomputed);

    for (const char* text : {"31 FEB 1851", "0 MAR 1851", "32 MAR 1851", "MARCH 1851", "XYZ 1851", "3 MAR 185",
                             "3 MAR", "INT 3 MAR 1851 (BAPTISM)", "3  MAR 1851", ""}) {
        auto r = datephrase(QString::fromLatin1(text), census1881, dateorder::dmy);
        EXPECT_FALSE(r.agecomputed) << text;
        EXPECT_EQ(r.earliestyear, -9999) << text;
    }
    // The year is the first four digits of the last word.
    auto r = datephrase(u"1851/52", census1881, dateorder::dmy);
    EXPECT_TRUE(r.agecomputed);
    EXPECT_EQ(r.phrase, "in 1851/52");
    EXPECT_EQ(r.latestyear, 1851);
}

TEST(Datephrase, YearsAloneAgreeWithThePhrase)
{
    for (const char* text : {"3 MAR 1851", "MAR 1851", "FEB 1852", "1851", "ABT 1851", "CAL DEC 1849", "BET 1850 AND 1852",
                             "AFT 1851", "31 FEB 1851", "1851/52", "ABT", ""}) {
        for (const std::optional<QDate>& census : {census1881, std::optional<QDate>()}) {
            auto full = datephrase(QString::fromLatin1(text), census, dateorder::dmy);
            auto years = dateyears(QString::fromLatin1(text), census, dateorder::dmy);
            EXPECT_EQ(years.agecomputed, full.agecomputed) << text;
            EXPECT_EQ(years.earliestyear, full.earliestyear) << text;
            EXPECT_EQ(years.latestyear, full.latestyear) << text;
        }
    }
    EXPECT_EQ(dateyears(u"ABT 1851", census1881, dateorder::dmy).latestyear, 1851);
}

TEST(Personinfo, TheLineForAnIndividual)
{
    personrec p;
    p.name = "Smith, John";
    p.hasbirthdate = true;
    p.birthdate = "ABT 1851";
    p.hasbirthplace = true;
    p.birthplace = "Leeds";
    EXPECT_EQ(personinfo(p, u"3 APR 1881"_s),
              "John Smith was born in 1851 (approx.) in Leeds and in this census would be aged 29 or 30 (approx.).");
    EXPECT_EQ(personinfo(p, u""_s), "John Smith was born in 1851 (approx.) in Leeds.");

    p.hasbirthplace = false;
    p.birthdate = "BET 1850 AND 1852";
    EXPECT_EQ(personinfo(p, census1881, dateorder::dmy), "John Smith was born between 1850 and 1852.");

    p.name = "Plato";
    p.hasbirthdate = false;
    p.hasbirthplace = true;
    EXPECT_EQ(personinfo(p, census1881, dateorder::dmy), "Plato was born in Leeds.");

    p.name = "";
    EXPECT_EQ(personinfo(p, census1881, dateorder::dmy), "[No Name] was born in Leeds.");
    p.name = "Smith";
    p.hasbirthplace = false;
    EXPECT_EQ(personinfo(p, census1881, dateorder::dmy), "");

    p.name = "Brontë, Anne";
    p.hasbirthdate = true;
    p.birthdate = "17 JAN 1820";
    EXPECT_EQ(personinfo(p, census1881, dateorder::dmy),
              u"Anne Bront\u00eb was born on 17 Jan 1820 and in this census would be aged 61."_s);
}

TEST(Validdate, NormalisesTypedDates)
{
    const struct {
        const char* typed;
        const char* official;
        bool isdate;
        std::optional<QString> newtext; // none: the text stands
    } rows[] = {
        {"4 apr 1881", "3 APR 1881", true, u"04 APR 1881"_s},
        {"3 APR 1881", "3 APR 1881", true, std::nullopt}, // the official date stands as it is
        {" 03 apr 1881", "3 APR 1881", true, u"3 APR 1881"_s}, // typed otherwise, it keeps the official spelling
        {"3/4/1881", "3 APR 1881", true, u"3 APR 1881"_s},
        {"04 APR 1881", "3 APR 1881", true, std::nullopt}, // already in the written form
        {"4 apr 1881", "", true, u"04 APR 1881"_s},
        {"ABT 1881", "3 APR 1881", false, std::nullopt},
        {"", "3 APR 1881", false, std::nullopt},
    };
    for (const auto& row : rows) {
        const datecheck r = validdate(QString::fromLatin1(row.typed), QString::fromLatin1(row.official), dateorder::dmy);
        EXPECT_EQ(r.isdate, row.isdate) << row.typed;
        EXPECT_EQ(r.newtext, row.newtext) << row.typed;
    }
}
