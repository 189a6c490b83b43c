#include "census/birthdate.h"

#include <QLocale>

#include <gtest/gtest.h>

using qm::calculatedbirthdate;

TEST(BirthDate, Years)
{
    EXPECT_EQ(calculatedbirthdate(QDate(1851, 3, 30), 45, u'Y'), QStringLiteral("1806"));
    EXPECT_EQ(calculatedbirthdate(QDate(1851, 3, 30), 0, u'Y'), QStringLiteral("1851"));
}

TEST(BirthDate, MonthsRollIntoEarlierYears)
{
    EXPECT_EQ(calculatedbirthdate(QDate(1851, 3, 30), 6, u'M'), QStringLiteral("SEP 1850"));
    EXPECT_EQ(calculatedbirthdate(QDate(1861, 4, 7), 3, u'M'), QStringLiteral("JAN 1861"));
    EXPECT_EQ(calculatedbirthdate(QDate(1861, 4, 7), 15, u'M'), QStringLiteral("JAN 1860"));
    // The census day plays no part: a month back from 31 March is February.
    EXPECT_EQ(calculatedbirthdate(QDate(1901, 3, 31), 1, u'M'), QStringLiteral("FEB 1901"));
}

TEST(BirthDate, DaysRollIntoEarlierMonths)
{
    EXPECT_EQ(calculatedbirthdate(QDate(1851, 3, 30), 45, u'D'), QStringLiteral("13 FEB 1851"));
    EXPECT_EQ(calculatedbirthdate(QDate(1871, 4, 2), 10, u'D'), QStringLiteral("23 MAR 1871"));
    EXPECT_EQ(calculatedbirthdate(QDate(1881, 4, 3), 0, u'D'), QStringLiteral("03 APR 1881"));
}

TEST(BirthDate, FromTexts)
{
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("7 APR 1861"), QStringLiteral("3"), u'm'), QStringLiteral("JAN 1861"));
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("7 APR 1861"), QStringLiteral("x"), u'Y'), QString());
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("1861"), QStringLiteral("3"), u'Y'), QString());
    EXPECT_EQ(calculatedbirthdate(QDate(1861, 4, 7), 3, u'W'), QString());
}

TEST(BirthDate, EnglishMonthsWhateverTheLocale)
{
    QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany));
    EXPECT_EQ(calculatedbirthdate(QDate(1851, 3, 30), 0, u'M'), QStringLiteral("MAR 1851"));
    EXPECT_EQ(calculatedbirthdate(QDate(1851, 3, 30), 2, u'D'), QStringLiteral("28 MAR 1851"));
    EXPECT_EQ(calculatedbirthdate(QStringLiteral("30 MAR 1851"), QStringLiteral("10"), u'M'), QStringLiteral("MAY 1850"));
    QLocale::setDefault(QLocale::c());
}
