#include "census/censustable.h"

namespace qm {

const std::vector<censusdef>& censustable()
{
    static const std::vector<censusdef> table = [] {
        struct row {
            const char* country;
            int16_t year;
            const char* date;
            const char* refprefix;
        };
        static constexpr row rows[] = {
            {"UK", 1841, "6 JUN 1841", "HO107/"},    {"UK", 1851, "30 MAR 1851", "HO107/"},
            {"UK", 1861, "7 APR 1861", "RG9/"},      {"UK", 1871, "2 APR 1871", "RG10/"},
            {"UK", 1881, "3 APR 1881", "RG11/"},     {"UK", 1891, "5 APR 1891", "RG12/"},
            {"UK", 1901, "31 MAR 1901", "RG13/"},    {"USA", 1790, "2 AUG 1790", ""},
            {"USA", 1800, "4 AUG 1800", ""},         {"USA", 1810, "6 AUG 1810", ""},
            {"USA", 1820, "7 AUG 1820", ""},         {"USA", 1830, "1 JUN 1830", ""},
            {"USA", 1840, "1 JUN 1840", ""},         {"USA", 1850, "1 JUN 1850", ""},
            {"USA", 1860, "1 JUN 1860", ""},         {"USA", 1870, "1 JUN 1870", ""},
            {"USA", 1880, "1 JUN 1880", ""},         {"USA", 1890, "1 JUN 1890", ""},
            {"USA", 1900, "1 JUN 1900", ""},         {"USA", 1910, "15 APR 1910", ""},
            {"USA", 1920, "1 JAN 1920", ""},         {"USA", 1930, "1 APR 1930", ""},
            {"Ireland", 1901, "31 MAR 1901", ""},    {"Ireland", 1911, "2 APR 1911", ""},
            {"Canada", 1825, "20 JUN 1825", ""},     {"Canada", 1831, "1 JUN 1831", ""},
            // The census of 1851 was taken in January 1852.
            {"Canada", 1851, "12 JAN 1852", ""},     {"Canada", 1861, "14 JAN 1861", ""},
            {"Canada", 1871, "2 APR 1871", ""},      {"Canada", 1881, "4 APR 1881", ""},
            {"Canada", 1891, "6 APR 1891", ""},      {"Canada", 1901, "31 MAR 1901", ""},
            {"Canada", 1911, "1 JUN 1911", ""},
        };
        std::vector<censusdef> t;
        t.reserve(std::size(rows));
        for (const row& r : rows)
            t.push_back({QString::fromLatin1(r.country), r.year, QString::fromLatin1(r.date),
                         QString::fromLatin1(r.refprefix)});
        return t;
    }();
    return table;
}

QStringList fillyears(const QString& country)
{
    QStringList years;
    for (const censusdef& c : censustable())
        if (c.country == country)
            years.append(QString::number(c.year));
    return years;
}

QString censusyearcaption(const QString& country)
{
    return country + QStringLiteral(" Census Year:");
}

int findcensusrow(const QString& country, int year)
{
    const std::vector<censusdef>& table = censustable();
    for (size_t i = 0; i < table.size(); ++i)
        if (table[i].country == country && table[i].year == year)
            return static_cast<int>(i);
    return -1;
}

const censusdef* lookupcensus(const QString& country, int year)
{
    const int row = findcensusrow(country, year);
    return row < 0 ? nullptr : &censustable()[static_cast<size_t>(row)];
}

QString seriouscensuserror()
{
    return QStringLiteral(
        "Serious Error - the year and country chosen are not supported by Quillmark - please contact the author");
}

censusfound findcensus(const censuschoice& choice)
{
    censusfound r;
    r.lastrefprefix = choice.lastrefprefix;
    const QString yeartext = choice.yeartext.trimmed();
    if (yeartext.isEmpty())
        return r;
    bool isnumber = false;
    const int year = yeartext.toInt(&isnumber);
    const censusdef* census = isnumber ? lookupcensus(choice.country, year) : nullptr;
    if (!census) {
        r.error = seriouscensuserror();
        return r;
    }
    // A reference the user has typed into is left alone.
    if (choice.autoreference
        && (choice.referencetext == choice.lastrefprefix || choice.referencetext.trimmed().isEmpty())) {
        r.setreference = true;
        r.referencetext = census->refprefix;
        r.cursor = static_cast<int>(census->refprefix.size());
        r.lastrefprefix = census->refprefix;
    }
    r.date = census->date;
    return r;
}

} // namespace qm
