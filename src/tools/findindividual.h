#pragma once
// What the Find Individual dialog shows: its list of individuals, the census
// lines and relatives of the individual shown, and the two searches.

#include "census/selection.h"
#include "model/gedcomindex.h"

#include <QString>
#include <QStringList>

#include <cstdint>
#include <vector>

namespace qm {

// The year alone when the census date ends in one ("30 MAR 1851", "(1851)"
// and "ABT 1851" give "1851"); otherwise the date without its brackets.
QString censusdatetext(const QString& date);
// "45y" -> "45", "1m" -> "1 month", "3D" -> "3 days", "" -> "?".
QString censusagetext(const QString& age);
// One line of the census list: date + ": aged " + age + " at " + place, and
// " (" + address + ")" when there is one.
QString censusline(const censusrec& c);
// A line per census event, or the one line saying there are none.
QStringList censuslines(const personrec& p);

// Relatives of people[k], as positions in people, in people order. A relative
// linked by several families is listed once per link; a parent or spouse is
// never also listed as a child.
struct relatives {
    std::vector<int32_t> parents;
    std::vector<int32_t> spouses;
    std::vector<int32_t> children;
};
relatives findrelatives(const gedcomindex& index, int32_t k);

// The dialog's list: every individual in label order, as the people list
// shows them; above 32,000 individuals only the entries of the main window's
// people list (`mainlist`), which then holds those who could be alive.
std::vector<listentry> findlist(const gedcomindex& index, bool idonly, std::vector<listentry> mainlist);

// Row of the first entry whose text starts with `start`, ignoring case
// (an empty start matches the first entry), or -1.
int findbyname(const std::vector<listentry>& entries, const QString& start);
// Row of the first entry of the individual with this record number, or -1.
int findbyid(const gedcomindex& index, const std::vector<listentry>& entries, int32_t id);
// Position in people of the first individual with this record number, or -1.
int32_t personofid(const gedcomindex& index, int32_t id);

} // namespace qm
