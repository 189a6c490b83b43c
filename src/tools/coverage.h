#pragma once
// Census coverage: for every individual of a family file and every census of
// one country, whether the file records the individual in that census, and
// if not, why not. One cell, one word:
//
// recorded   The individual has a census event ("1 CENS"), or with the setting
//            "Residence" on a residence fact ("1 RESI"), dated as that census
//            (below), whose place is in that country or tells no country.
// elsewhere  Not recorded, but a census event or residence fact dated as that
//            census has its place in another country (an emigrant's census
//            abroad), or a residence fact "FROM x TO y" in another country
//            surely covers the census day. A residence fact counts here
//            whatever "Residence" says.
// not alive  Born after the census day, or died on it or before it, for
//            certain from the dates (below); or the latest possible birth lies
//            more than 110 years before the census day, or the earliest
//            possible death more than 110 years after it.
// uncertain  A birth date that allows days both on or before and after the
//            census day ("1881", "APR 1881", "ABT 1880", "AFT 1870", "BEF
//            1890" for the census of 3 APR 1881), or a death date that allows
//            days both on or before the census day and after it; also every
//            census of an individual the file gives no readable date at all
//            (no birth, death, census or residence date).
// missing    Otherwise: alive on the census day as far as the file can tell.
//            A missing birth or death date is no doubt: the life is taken to
//            last up to 110 years from the date that is known.
// The first of recorded, elsewhere, not alive, uncertain, missing that holds
// is the cell.
//
// Dated as a census (of the chosen country C): the census date check, run for
// C, finds the event's date to be that census's official day (searched from
// C's first census; "31 MAR 1901" is UK 1901 for the UK and Ireland 1901 for
// Ireland) or proposes that census for it (the nearest official day, a year
// read as its 30 June). When the census so found is another country's, the
// event is dated as C's census of the same year, if C has one: "4 APR 1881"
// (Canada's day) and "1881" (30 June 1881 is a day nearer Canada's 4 April
// than the UK's 3 April) are the UK's 1881 census for the UK; the year is
// the table's year of the census whose official day the date is, else the
// year of the date. An event dated as another country's census day whose
// place tells no country is that other country's (elsewhere). A period
// ("FROM 1885 TO 1905") is dated as no census.
//
// Dates are read as model/dayrange.h reads them. The census day counts the
// individuals alive at its end: born on it is alive, died on it is not.
// Census and residence dates also tell when the individual was alive (born
// by the last day the date allows, died after the first). Families' census
// events are not an individual's.
//
// The place's country is model/placecountry.h's.

#include "model/dates.h"
#include "model/gedcomindex.h"

#include <QString>

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace qm {

enum class coveragecell : uint8_t { recorded, notalive, uncertain, elsewhere, missing };
inline constexpr size_t coveragecellkinds = 5;

// "recorded", "not alive", "uncertain", "elsewhere", "missing".
std::string_view coverageword(coveragecell c);

// The coverage of every individual (rows, in people order) by every census
// of one country (columns, in census table order).
struct censuscoverage {
    QString country;             // "UK", "USA", "Ireland" or "Canada"
    std::vector<int> censusrows; // the columns: positions in censustable()
    size_t people = 0;
    std::vector<coveragecell> cells; // people x columns, one individual after another
    // Per individual: the first year written in the birth date (sorting); 0 when none.
    std::vector<int16_t> birthyears;
    // Per column, over all individuals.
    std::vector<int32_t> recorded, missing;

    size_t columns() const { return censusrows.size(); }
    coveragecell cell(size_t person, size_t column) const { return cells[person * censusrows.size() + column]; }
    // The census year of a column as the census table shows it ("1851" for Canada's of 12 JAN 1852).
    QString year(size_t column) const;
    // The individual has a missing cell.
    bool hasgap(size_t person) const;
};

// Works the coverage out for the census country `country` (an unknown name
// is the UK, as in the census date check). `residence`: the setting
// "Residence". `order` reads numeric dates as the census date check does.
censuscoverage computecoverage(const gedcomindex& index, const QString& country, bool residence,
                               dateorder order = localedateorder());

// The number of cells of each kind (indexed by coveragecell) per column, over
// the individuals `people` (positions in people): the totals of a filtered grid.
std::vector<std::array<int32_t, coveragecellkinds>> countcells(const censuscoverage& c,
                                                               const std::vector<int32_t>& people);

// The relatives of people[k] through the families the index records
// (FAMC and FAMS links), k included, in people order.
enum class relation {
    ancestors,   // parents, their parents ...
    descendants, // children, their children ...
    related,     // everyone reached through parents, children and spouses
};
std::vector<int32_t> relativesof(const gedcomindex& index, int32_t k, relation r);

// What the grid shows: which individuals, in which order.
struct coveragefilter {
    bool gapsonly = false;      // only individuals with a missing cell
    int32_t relativeof = -1;    // only relatives of this individual (position in people), -1 all
    relation relatives = relation::related;
    QString name;               // only names holding this text (letter case and accents ignored)
};
enum class coveragesort {
    name,      // the order of every list of people (model/labelorder.h)
    birthyear, // the birth year, individuals without one last; equal years in name order
};
std::vector<int32_t> coveragerows(const gedcomindex& index, const censuscoverage& c, const coveragefilter& f,
                                  coveragesort sort);
// The same in two steps, for a grid that filters again at every key typed:
// every individual in the order `sort` (the costly part, done once), then the
// individuals of that order the filter lets through, in the same order.
std::vector<int32_t> coverageorder(const gedcomindex& index, const censuscoverage& c, coveragesort sort);
std::vector<int32_t> filtercoverage(const gedcomindex& index, const censuscoverage& c, const coveragefilter& f,
                                    const std::vector<int32_t>& ordered);

// The grid as CSV, for a spreadsheet: the heading "id,name,1841,1851,..." and
// one line per individual (record number, name, the words), of the columns
// given, each line ending in LF. A name holding a comma or a quote, or
// beginning or ending with a space, is put in quotes (a quote doubled); one
// beginning with =, +, - or @ gets an apostrophe in front so that no
// spreadsheet takes it for a formula; control characters become spaces.
void appendcoveragecsvheading(std::string& out, const censuscoverage& c, const std::vector<size_t>& columns);
void appendcoveragecsvrow(std::string& out, const personrec& p, const censuscoverage& c, size_t person,
                          const std::vector<size_t>& columns);

} // namespace qm
