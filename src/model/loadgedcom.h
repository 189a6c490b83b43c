#pragma once
// Reading a family file into a new index, in one pass.

#include "model/gedcomindex.h"

#include <QString>

#include <memory>

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
void addplace(gedcomindex& index, std::string_view name);
void insertplace(gedcomindex& index, std::string_view name); // a place typed after the load
int findplace(const gedcomindex& index, std::string_view name); // position of the group, or -1

// People list: an individual's label and the positions of individuals in label order.
QString personlabel(const personrec& p, bool idonly);
std::vector<int32_t> sortedpeople(const gedcomindex& index, bool idonly);
// Census source list: titles of census sources with their positions in `sources`.
bool peoplelistshown(const gedcomindex& index); // fewer than 32,001 individuals

} // namespace qm
