#pragma once
// Auto Text: a transcription-style table of the household, one line per census
// row under a heading line, written into the source text box for the user to
// edit. The first row is the head of the household; every other row is
// described by its relationship to the head, found from the family links.
//
// The window runs, in order: the age check of the rows; checkautotextdate;
// notes the census date as the entry's date; stops when no row is in use;
// stores the rows; runs birthcheck on each row (showing the birth details
// dialog or the ID message); then puts autotext() into the source text box.

#include "model/dates.h"
#include "model/gedcomindex.h"
#include "settings/settings.h"
#include "writer/censusentry.h"

#include <QString>

#include <optional>
#include <vector>

namespace qm {

struct autotextproblem {
    QString message;
    bool focusdate = false; // the census date box takes the focus
};

// The census date check before the text is made: an empty or unrecognised
// census date stops Auto Text with the message returned.
std::optional<autotextproblem> checkautotextdate(const QString& censusdate,
                                                 dateorder order = localedateorder());

enum class censuskind {
    other,
    uk1841, // no condition column, no birth place
    uklate, // 1891 and 1901: short condition words
};

// The kind of census, from the country and the census date compared as a
// calendar date with 6 June 1841, 5 April 1891 and 31 March 1901.
censuskind autotextkind(const QString& country, const QString& censusdate,
                        dateorder order = localedateorder());

// What Save and Auto Text do with a row before going on.
enum class birthcheck {
    none,       // the individual has birth details
    ask,        // no birth date, birth place or birth details: show the birth details dialog
    idmismatch, // the row no longer points at its individual: show idmismatchmessage()
};

birthcheck checkbirth(const selectionrec& row, const gedcomindex& index);
QString idmismatchmessage();

// The table, lines ending in CR LF. Birth places come from the family file,
// or from the birth details given for a row.
QString autotext(const std::vector<selectionrec>& rows, const gedcomindex& index, const QString& censusdate,
                 const QString& country, const settings& s, dateorder order = localedateorder());

} // namespace qm
