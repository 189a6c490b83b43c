#pragma once
// Census flags: Family Historian's per-individual flags ("1 _FLGS" followed by
// "2 " + code + " " + name), the user's allocation of one flag to each census,
// and the settings groups "Flags/1", "Flags/2" ... that keep the allocations.

#include <QString>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace qm {

class settingsstore;

struct flagrec {
    std::string code;    // the tag, such as "__CENSUS_1881" (UTF-8)
    std::string name;    // the name written after the code (UTF-8)
    std::string date;    // census date ("3 APR 1881") or year ("1881"); empty: not allocated
    int32_t count = 0;   // individuals of the loaded file holding the flag
    std::string country; // "UK", "USA", "Ireland" or "Canada" when allocated
};

using flagtable = std::vector<flagrec>;

// Position of the flag with this code, its count raised by one; a new entry
// (count 1, not allocated) when there is none.
size_t noteflag(flagtable& table, std::string_view code, std::string_view name);

// Reads the allocated flags from the groups "Flags/1", "Flags/2" ... into an
// empty table. Returns false when a group was faulty: the good ones are then
// in the table, the store has been rewritten from them (saveflagdefs), and the
// caller shows flagloaderrormessage().
bool loadflagdefs(settingsstore& store, flagtable& table);
QString flagloaderrormessage();

// Rewrites the flag groups from the allocated flags of the table.
void saveflagdefs(settingsstore& store, const flagtable& table);

// The flag code for a flag name: "__" + the name's letters and digits upper-cased,
// accents folded, spaces as "_", at most 15 characters in all.
std::string codeforflag(const QString& name);

// The flag a new census entry of that census date and country gives its
// individuals: the first allocated flag of the country whose date occurs in the
// census date.
std::optional<size_t> findentryflag(const flagtable& table, std::string_view censusdate, std::string_view country);

} // namespace qm
