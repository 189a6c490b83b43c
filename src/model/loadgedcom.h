#pragma once
// Reading a family file into a new index, in one pass.

#include "model/gedcomindex.h"

#include <QString>

#include <memory>
#include <string>
#include <vector>

namespace qm {

struct loadresult {
    std::unique_ptr<gedcomindex> index; // null when the file could not be read
    QString error;                      // why not, for the user
    double ms = 0;                      // time the load took
};

// Reads `path` into a new index. `flagdefs` is the table of defined flags
// (loadflagdefs); the index's flag table starts as a copy of it and gains every
// flag met in the file. A load touches nothing else, so a failed one leaves the
// caller's previous index as it was.
loadresult loadgedcom(const QString& path, const flagtable& flagdefs);

// Parses bytes held in memory (tests and fuzzing); path is only recorded.
std::unique_ptr<gedcomindex> loadgedcombytes(std::string_view bytes, const flagtable& flagdefs);

// Message shown when a file holds no individuals.
QString nopeoplemessage();

// Place table operations (the table is one entry per group, sorted ignoring case).
// insertplace counts one more occurrence of a (UTF-8) name typed after the
// load: its group's count is raised, or a new group is inserted at its sorted
// place. An empty name adds nothing.
void insertplace(gedcomindex& index, std::string_view name);
int findplace(const gedcomindex& index, std::string_view name); // position of the group, or -1
// Sorts places[low..high] (inclusive) by name ignoring case.
void sortplaces(gedcomindex& index, size_t low, size_t high);
// Sorts the whole table and merges entries equal ignoring case into one group
// each (first spelling, counts added up).
void countplaces(gedcomindex& index);
// The form of a place name under which names equal ignoring case are equal.
std::string placekey(std::string_view name);

// People list: an individual's label and the positions of individuals in label order.
QString personlabel(const personrec& p, bool idonly);
std::vector<int32_t> sortedpeople(const gedcomindex& index, bool idonly);
// Census source list: titles of census sources with their positions in
// `sources`, in the order of their titles (model/labelorder.h).
struct sourceitem {
    QString title;
    int32_t source = 0; // position in `sources`
};
std::vector<sourceitem> censussourcelist(const gedcomindex& index);
bool peoplelistshown(const gedcomindex& index); // fewer than 32,001 individuals

} // namespace qm
