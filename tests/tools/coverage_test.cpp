// Census coverage: each rule on hand-made individuals (one letter per census:
// R recorded, N not alive, U uncertain, E elsewhere, M missing), the totals,
// and the grid's filters and orders.
#include "tools/coverage.h"

#include "model/loadgedcom.h"

#include <gtest/gtest.h>

using namespace qm;

namespace {

std::unique_ptr<gedcomindex> load(const std::string& records)
{
    return loadgedcombytes("0 HEAD\r\n1 CHAR UTF-8\r\n" + records + "0 TRLR\r\n", flagtable{});
}

// An individual's record: "BIRT date", "DEAT date", "CENS date|place",
// "RESI date|place" facts, "FAMC n", "FAMS n".
std::string person(int id, const std::string& name, const std::vector<std::string>& facts)
{
    std::string out = "0 @I" + std::to_string(id) + "@ INDI\r\n1 NAME " + name + "\r\n";
    for (const std::string& f : facts) {
        const std::string tag = f.substr(0, 4), value = f.substr(5);
        if (tag == "FAMC" || tag == "FAMS") {
            out += "1 " + tag + " @F" + value + "@\r\n";
            continue;
        }
        const size_t bar = value.find('|');
        out += "1 " + tag + "\r\n2 DATE " + value.substr(0, bar) + "\r\n";
        if (bar != std::string::npos)
            out += "2 PLAC " + value.substr(bar + 1) + "\r\n";
    }
    return out;
}

// The cells of one individual as letters.
std::string letters(const censuscoverage& c, size_t k)
{
    std::string out;
    for (size_t col = 0; col < c.columns(); ++col)
        out += "RNUEM"[static_cast<size_t>(c.cell(k, col))];
    return out;
}

} // namespace

TEST(Coverage, RulesForEachIndividual)
{
    // UK censuses: 6 JUN 1841, 30 MAR 1851, 7 APR 1861, 2 APR 1871, 3 APR 1881, 5 APR 1891, 31 MAR 1901.
    const struct {
        std::vector<std::string> facts;
        const char* cells;
    } cases[] = {
        {{"BIRT 3 APR 1881"}, "NNNNMMM"},                     // born on the census day: counted
        {{"BIRT 4 APR 1881"}, "NNNNNMM"},                     // the day after
        {{"BIRT 2 APR 1881"}, "NNNNMMM"},                     // the day before
        {{"BIRT MAR 1881"}, "NNNNMMM"},                       // a month before the day
        {{"BIRT 1881"}, "NNNNUMM"},                           // the census year, around the day
        {{"BIRT APR 1881"}, "NNNNUMM"},
        {{"BIRT ABT 1851"}, "NUMMMMM"},                       // 1849-1853
        {{"BIRT BEF 1851"}, "UMMMMMM"},                       // by 31 DEC 1850
        {{"BIRT AFT 1850"}, "NUUUUUU"},                       // from 1 JAN 1851, no end
        {{"BIRT 1 JAN 1850", "DEAT 2 APR 1881"}, "NMMMNNN"},  // died the day before
        {{"BIRT 1 JAN 1850", "DEAT 3 APR 1881"}, "NMMMNNN"},  // died on the day: not counted
        {{"BIRT 1 JAN 1850", "DEAT 4 APR 1881"}, "NMMMMNN"},  // the day after
        {{"BIRT 1840", "DEAT 1881"}, "MMMMUNN"},
        {{"BIRT 1840", "DEAT ABT 1885"}, "MMMMMNN"},          // 1883-1887
        {{"BIRT 1840", "DEAT BEF 1872"}, "UUUUNNN"},          // any day before 1872
        {{"BIRT 1840", "DEAT AFT 1870"}, "MMMUUUU"},
        {{"BIRT 1735"}, "MNNNNNN"},                           // 110 years on: no longer alive
        {{"DEAT 1900"}, "MMMMMMN"},                           // 110 years back from the death
        {{}, "UUUUUUU"},                                      // no dates at all
        {{"BIRT (unknown)", "DEAT 31 FEB 1881"}, "UUUUUUU"},  // none that can be read
        // No birth or death date: census events tell when the individual was alive.
        {{"CENS 7 APR 1861|Leeds"}, "MMRMMMM"},
        // The census date check's proposals count: ABT 1861, 30 Mar 1851, DEC 1890.
        {{"BIRT 1840", "CENS ABT 1861|Leeds", "CENS 30 Mar 1851|Leeds", "CENS DEC 1890|Leeds"}, "MRRMMRM"},
        // 1881 is proposed as Canada's 4 APR 1881 (nearer 30 June): the UK's census of that year.
        {{"BIRT 1840", "CENS 1881|Leeds, Yorkshire, England", "CENS 4 APR 1881|Hull, England"}, "MMMMRMM"},
        // Canada's census day with a place that tells no country: Canada's census.
        {{"BIRT 1840", "CENS 4 APR 1881|Hull"}, "MMMMEMM"},
        // An emigrant: England, then Canada (a census and a residence), then a period in Australia.
        {{"BIRT 1830", "CENS 30 MAR 1851|Leeds, Yorkshire, England", "CENS 1871|Toronto, Ontario",
          "RESI 4 APR 1881|Toronto, Ontario, Canada", "RESI FROM 1885 TO 1905|Sydney, New South Wales, Australia"},
         "MRMEEEE"},
        // A recorded census wins over dates that say otherwise.
        {{"BIRT 1890", "CENS 3 APR 1881|Leeds"}, "NNNNRMM"},
        // A residence fact is no census entry while "Residence" is off.
        {{"BIRT 1850", "RESI 3 APR 1881|Leeds, England"}, "NMMMMMM"},
    };
    std::string records;
    int id = 0;
    for (const auto& c : cases)
        records += person(++id, "A /B/", c.facts);
    const auto ix = load(records);
    const censuscoverage cov = computecoverage(*ix, QStringLiteral("UK"), false, dateorder::dmy);
    ASSERT_EQ(cov.people, std::size(cases));
    ASSERT_EQ(cov.columns(), 7u);
    for (size_t k = 0; k < std::size(cases); ++k)
        EXPECT_EQ(letters(cov, k), cases[k].cells) << "individual " << k + 1;

    // With "Residence" on, the residence fact of 1881 is the census entry.
    const censuscoverage resi = computecoverage(*ix, QStringLiteral("UK"), true, dateorder::dmy);
    EXPECT_EQ(letters(resi, std::size(cases) - 1), "NMMMRMM");
    // The emigrant's residence abroad stays elsewhere.
    EXPECT_EQ(letters(resi, std::size(cases) - 3), "MRMEEEE");
}

TEST(Coverage, CountriesColumnsAndTotals)
{
    // 31 MAR 1901 is the census day of the UK, Ireland and Canada: Dublin
    // decides. Canada's 1851 census was taken on 12 JAN 1852 and is shown as 1851.
    const auto ix = load(person(1, "Ann /Kelly/", {"BIRT 1880", "CENS 31 MAR 1901|Dublin, Ireland"})
                         + person(2, "Ben /Roy/", {"BIRT 1840", "CENS 12 JAN 1852|Quebec"})
                         + person(3, "Cal /Roy/", {"BIRT 1845"}));
    const censuscoverage ireland = computecoverage(*ix, QStringLiteral("Ireland"), false, dateorder::dmy);
    EXPECT_EQ(ireland.country, QStringLiteral("Ireland"));
    EXPECT_EQ(letters(ireland, 0), "RM");
    const censuscoverage uk = computecoverage(*ix, QStringLiteral("UK"), false, dateorder::dmy);
    EXPECT_EQ(letters(uk, 0), "NNNNMME");
    const censuscoverage canada = computecoverage(*ix, QStringLiteral("Canada"), false, dateorder::dmy);
    EXPECT_EQ(canada.year(2), QStringLiteral("1851"));
    EXPECT_EQ(letters(canada, 1), "NNRMMMMMM");
    EXPECT_EQ((std::vector<int32_t>(canada.recorded.begin(), canada.recorded.begin() + 4)),
              (std::vector<int32_t>{0, 0, 1, 0}));
    EXPECT_EQ((std::vector<int32_t>(canada.missing.begin(), canada.missing.begin() + 4)),
              (std::vector<int32_t>{0, 0, 1, 2}));
    EXPECT_TRUE(canada.hasgap(1));
    // An unknown country is the UK's, as in the census date check.
    EXPECT_EQ(computecoverage(*ix, QStringLiteral("France"), false).country, QStringLiteral("UK"));

    const auto counts = countcells(uk, {0, 2});
    EXPECT_EQ(counts[6][static_cast<size_t>(coveragecell::elsewhere)], 1);
    EXPECT_EQ(counts[6][static_cast<size_t>(coveragecell::missing)], 1);
    EXPECT_EQ(counts[0][static_cast<size_t>(coveragecell::notalive)], 2);
}

TEST(Coverage, RelativesNamesGapsAndOrders)
{
    // F1: I1 + I2 with children I3, I4; F2: I3 + I5 with child I6; F3: I8, parent of I5; I7 alone.
    const auto ix = load(person(1, "John /Smith/", {"BIRT 1800", "FAMS 1"})
                         + person(2, "Mary /Brown/", {"BIRT 1802", "FAMS 1"})
                         + person(3, "Tom /Smith/", {"BIRT 1830", "FAMC 1", "FAMS 2"})
                         + person(4, "Ann /Smith/", {"BIRT 1832", "FAMC 1"})
                         + person(5, "Éva /Ébert/", {"BIRT 1831", "FAMC 3", "FAMS 2"})
                         + person(6, "Joe /Smith/", {"BIRT 1860", "FAMC 2", "CENS 7 APR 1861|Leeds",
                                                     "CENS 2 APR 1871|Leeds", "CENS 3 APR 1881|Leeds",
                                                     "CENS 5 APR 1891|Leeds", "CENS 31 MAR 1901|Leeds"})
                         + person(7, "Zoe /Alone/", {})
                         + person(8, "Old /Ebert/", {"BIRT 1805", "FAMS 3"}));
    using v = std::vector<int32_t>;
    EXPECT_EQ(relativesof(*ix, 5, relation::ancestors), (v{0, 1, 2, 4, 5, 7}));
    EXPECT_EQ(relativesof(*ix, 0, relation::descendants), (v{0, 2, 3, 5}));
    EXPECT_EQ(relativesof(*ix, 0, relation::related), (v{0, 1, 2, 3, 4, 5, 7}));
    EXPECT_EQ(relativesof(*ix, 6, relation::related), (v{6}));
    EXPECT_TRUE(relativesof(*ix, 99, relation::related).empty());

    const censuscoverage c = computecoverage(*ix, QStringLiteral("UK"), false, dateorder::dmy);
    coveragefilter f;
    EXPECT_EQ(coveragerows(*ix, c, f, coveragesort::name), (v{6, 1, 4, 7, 3, 5, 0, 2}));
    EXPECT_EQ(coveragerows(*ix, c, f, coveragesort::birthyear), (v{0, 1, 7, 2, 4, 3, 5, 6}));
    f.name = QStringLiteral(" ebert");
    EXPECT_EQ(coveragerows(*ix, c, f, coveragesort::name), (v{4, 7}));
    f.name.clear();
    f.gapsonly = true; // Joe is in every census he lived for; Zoe has no dates
    EXPECT_EQ(coveragerows(*ix, c, f, coveragesort::name), (v{1, 4, 7, 3, 0, 2}));
    f.relativeof = 2;
    f.relatives = relation::descendants;
    EXPECT_EQ(coveragerows(*ix, c, f, coveragesort::name), (v{2}));
}
