#pragma once
// Allocating census flags: which flag stands for which census of which
// country, as the Census Flags dialog and its two choosers edit it. The
// windows only show what these functions decide.

#include "flags/flagtable.h"

#include <QString>
#include <QStringList>

#include <optional>
#include <vector>

namespace qm {

struct gedcomindex;

// The census countries in the order of the chooser's options.
const QStringList& flagcountries();

// A row of the Census Flags list: the date padded to 15 characters, the
// country padded to 15, then the name. The list is shown in a fixed-pitch
// font under flagheading().
QString flagrowtext(const flagrec& f);
QString flagheading();

// Positions of the allocated flags (non-empty date), in table order: the rows
// of the Census Flags list.
std::vector<size_t> allocatedflags(const flagtable& table);
// Positions of the flags allocated to no census, in table order: the existing
// names the Census Flag Names chooser offers.
std::vector<size_t> unallocatedflags(const flagtable& table);

// Gives a flag a census: the flag at `chosen` when the name was picked from the
// existing flags, else the first flag of that name, else a new flag (code made
// from the name, count 0) appended to the table. Returns its position.
size_t allocateflag(flagtable& table, const QString& name, const QString& date, const QString& country,
                    std::optional<size_t> chosen = std::nullopt);

// Takes a flag off the Census Flags list. A flag that individuals hold only
// loses its census (it stays in the table, offered again as an existing name);
// any other flag leaves the table, and every individual's flag positions are
// renumbered so that they designate the same flags as before.
void deleteflag(gedcomindex& index, size_t flag);

// The census dates of the country, in census table order, that no flag of the
// country is allocated to with exactly that date.
QStringList flagdates(const flagtable& table, const QString& country);

// Why a census date (or year) may not be allocated for the country: another
// flag of the country already covers it. Nothing when it may.
std::optional<QString> refusedate(const flagtable& table, const QString& country, const QString& date);
std::optional<QString> refuseyear(const flagtable& table, const QString& country, const QString& year);

// Why a new flag name typed in the Census Flag Names chooser is refused:
// empty (or without a letter or digit for its code: "__" is too short for a
// flag definition), already a flag's name, or giving the code of an existing
// flag. Nothing when it is accepted; the name is taken
// trimmed.
struct namerefusal {
    QString text;
    bool invalid = false; // the name itself is unusable; otherwise it clashes with a flag
};
std::optional<namerefusal> refuseflagname(const flagtable& table, const QString& typed);

// Asked when a flag is allocated while flags are not recorded on save.
QString flaguseprompt();

} // namespace qm
