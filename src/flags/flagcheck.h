#pragma once
// The flag check: compares the census flags each individual holds with the
// individual's census events ("1 CENS"), using the allocated flags of the flag
// table, and lists the flags to add and the flags to take away.
//
// Silent mode only tells whether anything is out of step (it stops at the
// first individual found so). Interactive mode builds the change list for the
// rewrite and the rows the Flag Check dialog shows; when an event matches the
// flags of several countries it asks which country through a callback, so the
// logic needs no window.

#include "model/gedcomindex.h"
#include "writer/censusentry.h"

#include <QString>
#include <QStringList>

#include <cstdint>
#include <functional>
#include <string_view>
#include <vector>

namespace qm {

// A census event dated `eventdate` matches an allocated flag whose date equals
// it, or whose date is a four-character year found within it ("1881" matches
// "3 APR 1881" and "ABT 1881"). An unallocated flag matches nothing.
bool eventmatchesflag(std::string_view eventdate, const flagrec& flag);

// One census event that matches the flags of more than one country, put to the user.
struct countryquestion {
    int32_t person = -1;            // position in `people`
    std::string_view date, place;   // the event's
    std::vector<size_t> candidates; // flag positions, in table order
    QStringList countries;          // the candidates' countries, one option each
    int preselected = -1;           // the option equal to the country setting, -1 none
};

struct countrychoice {
    int chosen = -1;     // 0-based option chosen; -1: the question was cancelled
    bool always = false; // "Assume all census records for this place are in the selected country."
};

using countryasker = std::function<countrychoice(const countryquestion&)>;

struct flagcheckresult {
    bool outofstep = false; // a flag is missing or superfluous
    bool cancelled = false; // the country question was cancelled: no change list
    std::vector<flagchange> changes; // interactive mode: adds and removals in people order
    QStringList addrows;             // interactive mode: one row per flag to add
    QStringList removerows;          // interactive mode: one row per flag to take away
    int32_t peoplechecked = 0;       // individuals looked at (silent mode stops early)

    bool canchange() const { return !cancelled && !changes.empty(); }
    // The rows as the dialog lists them: a "(There are no ...)" row when a list is empty.
    QStringList addlist() const;
    QStringList removelist() const;
};

// Runs the check over the whole index. In interactive mode `ask` is called for
// an event whose place has no known country (or a known country none of the
// candidates has); an answer with "always" ticked gives the place that country
// for the rest of this check and later checks until the file is read again.
// `country` is the country setting, which the question preselects.
flagcheckresult checkflags(gedcomindex& index, bool interactive, const QString& country,
                           const countryasker& ask = {});

// Silent mode alone, over an index it does not change.
bool flagsoutofstep(const gedcomindex& index);

QString flagcheckcancelledmessage(); // "Flag check was cancelled. ..."
QString flagsoutofsyncmessage();     // shown when the silent check finds something
// The family file changed outside the program: the Flag Check dialog writes nothing.
QString flagsfilechangedmessage(const QString& path);
QString flagchangesquestion(); // "Are you sure you want to set/unset flags as suggested?"
QString flagsaddheading();     // "Flags that need to be added to individuals:"
QString flagsremoveheading();  // "Flags that need to be removed from individuals:"

} // namespace qm
