#pragma once
// The household of a census entry compared with what the tree already knows,
// before anything is written. Typing a household from a census image is where
// errors slip in: an age typed as 54 for 45, the wrong John chosen among three,
// a household entered twice. Each row of the entry is checked for:
//
// - its age against the individual's recorded birth date. A plain date allows
//   the ages its day, month or year gives at the census day, an approximate
//   one (ABT, EST, CAL) the same ages; an age more than two years outside them
//   is found. A date that states bounds (BET ... AND, FROM ... TO, AFT, BEF)
//   allows the ages within its bounds, and nothing outside them. In the 1841
//   UK census the ages of those over 15 were rounded down to a multiple of 5,
//   so such an age there stands for itself and the four years above it.
// - death before the census day, or birth after it, by the recorded dates;
// - a census event of this census already held (the same day, or, citing an
//   existing census source, a citation of that source), and, with
//   "Residence" on, a residence fact of this census: a household entered twice;
// - the same individual in two rows;
// - an individual related to no one else of the household (information
//   only). Related means joined in the tree by any chain of parent, child,
//   sibling and spouse links, in-laws included, however long: the same
//   connected part of the tree, families being the links. A lodger, a servant,
//   or a second record of the same person that was never joined to the family
//   is found; a distant cousin is not.
//
// Findings are warnings, except the last, which is information. The windows
// show them before the save, quillmark-cli add-entry prints them; the
// "Household Check" setting turns the check off.

#include "writer/censusentry.h"

#include <QString>

#include <vector>

namespace qm {

struct gedcomindex;
struct settings;

enum class findingkind {
    age,        // the typed age does not fit the recorded birth date
    diedbefore, // died before the census day
    notborn,    // born after the census day
    entered,    // already holds a census event (or residence fact) of this census
    twice,      // the same individual in an earlier row
    unrelated,  // related to no one else of the household
};

enum class findingseverity { warning, information };

struct householdfinding {
    int row = -1; // the row it concerns: the position in the entry's selection
    findingkind kind = findingkind::age;
    findingseverity severity = findingseverity::warning;
    QString message; // for the user, naming the individual
};

// The findings for the entry's household, by row, in the order of the list
// above. Residence facts are read from the family file itself (the index does
// not hold them) when "Residence" is on; a file that cannot be read gives none.
std::vector<householdfinding> householdcheck(const gedcomindex& index, const settings& s, const censusentry& entry);

bool anywarning(const std::vector<householdfinding>& findings);

// "Row 2: " + the message.
QString findingline(const householdfinding& f);

} // namespace qm
