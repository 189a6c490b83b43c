#include "census/birthdate.h"

#include <QLocale>

#include <gtest/gtest.h>

using qm::calculatedbirthdate;

// Years, months and days back from the census day, months and days rolling
// into earlier years and months; the census day plays no part in a month's
// count (a month back from 31 March is February). English months whatever
// the locale.
TEST(BirthDate, CountsBackFromTheCensusDay)
{
    QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany));
    const struct {
        QDate census;
        int age;
        char16_t unit;
        const char* birth;
    } cases[] = {
        {QDate(1851, 3, 30), 45, u'Y', "1806"},       {QDate(1851, 3, 30), 0, u'Y', "1851"},
        {QDate(1851, 3, 30), 6, u'M', "SEP 1850"},    {QDate(1861, 4, 7), 3, u'M', "JAN 1861"},
        {QDate(1861, 4, 7), 15, u'M', "JAN 1860"},    {QDate(1901, 3, 31), 1, u'M', "FEB 1901"},
        {QDate(1851, 3, 30), 0, u'M', "MAR 1851"},    {QDate(1851, 3, 30), 45, u'D', "13 FEB 1851"},
        {QDate(1871, 4, 2), 10, u'D', "23 MAR 1871"}, {QDate(1881, 4, 3), 0, u'D', "03 APR 1881"},
        {QDate(1851, 3, 30), 2, u'D', "28 MAR 1851"}, {QDate(1861, 4, 7), 3, u'W', ""},
    };
    for (const auto& c : cases)
        EXPECT_EQ(calculatedbirthdate(c.census, c.age, c.unit), QString::fromLatin1(c.birth)) << c.age << char(c.unit);

    // From the texts of the form; no age or no census day gives nothing.
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("30 MAR 1851"), QStringLiteral("10"), u'm'), QStringLiteral("MAY 1850"));
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("7 APR 1861"), QStringLiteral("x"), u'Y'), QString());
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("1861"), QStringLiteral("3"), u'Y'), QString());
    QLocale::setDefault(QLocale::c());
}
