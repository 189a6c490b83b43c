#pragma once
// The in-memory index of one family file: the few facts of each individual,
// source, multimedia record and place that the census screens and writers need.
//
// The index is rebuilt from the file by every load and never written back: the
// file is the only truth. Tables are in file order and addressed by position
// (0-based); references between records (families, cited sources, linked
// objects) are record numbers, the digits of an identifier such as 12 in @I12@.
//
// All texts are UTF-8, whatever the file's encoding, and are views into the
// index's own arena: they live as long as the index. So do the records' lists.

#include "flags/flagtable.h"
#include "model/indexlist.h"
#include "model/textarena.h"
#include "platform/encoding.h"
#include "platform/filetime.h"

#include <QString>

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace qm {

// One "1 CENS" event of an individual.
struct censusrec {
    std::string_view date;    // "2 DATE" value (a later one replaces an earlier)
    std::string_view place;   // "2 PLAC" value
    std::string_view address; // "2 ADDR" value
    std::string_view age;     // "2 AGE" value
    indexlist<int32_t> sourceids; // sources cited under the event, in file order

    int32_t citecount() const { return static_cast<int32_t>(sourceids.size()); }
};

// One "1 RESI" fact of an individual: where the individual lived on a day or
// during a period (saved census entries are residence facts when the setting
// "Residence" is on).
struct residencerec {
    std::string_view date;  // "2 DATE" value (a later one replaces an earlier)
    std::string_view place; // "2 PLAC" value
    indexlist<int32_t> sourceids; // sources cited under the fact, in file order
};

// One individual ("0 @I...").
struct personrec {
    int32_t id = 0;
    int32_t famc = 0; // family as a child (last "1 FAMC"), 0 if none
    bool hasbirthdate = false;
    bool hasbirthplace = false;
    bool birthedited = false; // birth details given on the form since the load
    bool hasdeathdate = false;
    std::string_view name; // "Surname, Given names", or "<no name>"
    std::string_view sex;
    std::string_view birthplace;
    std::string_view birthdate;
    std::string_view deathdate;
    indexlist<int32_t> fams;      // families as a spouse, in file order
    indexlist<int32_t> sourceids; // every "2 SOUR @" citation of the record, in file order
    indexlist<int32_t> flagids;   // flags held: positions in the index's flag table
    indexlist<censusrec> census;  // "1 CENS" events, in file order
    indexlist<residencerec> residences; // "1 RESI" facts, in file order

    int32_t citecount() const { return static_cast<int32_t>(sourceids.size()); }
};

// One "1 CENS" event of a family ("0 @F..."): a census event of the file like
// those of individuals, which the census date check lists and changes too.
struct familycensusrec {
    int32_t family = 0;     // the family's record number
    std::string_view date;  // "2 DATE" value
    std::string_view place; // "2 PLAC" value
};

// One source record ("0 @S...").
struct sourcerec {
    int32_t id = 0;
    std::string_view xref;  // the identifier as the file writes it, without its "@"s ("S12", "S0012")
    std::string_view title; // first TITL or ABBR, trimmed
    indexlist<int32_t> objectids;   // "1 OBJE @O" links, in file order
    bool iscensus = false;          // that first TITL/ABBR line mentions "census"
    std::string censusdate;         // filled when images are attached to existing sources
    bool censusdatesought = false;
};

// One multimedia record ("0 @O...").
struct objectrec {
    int32_t id = 0;
    std::string_view xref; // the identifier as the file writes it ("O7", "O0007")
    std::string_view form, title, file, date;
    int32_t maxasid = 0; // highest "2 _ASID" value, 0 if none
};

// One group of place names that are equal ignoring letter case.
struct placerec {
    std::string_view name; // the spelling met first in the file
    int32_t count = 0;     // how many PLAC lines carry it
    std::string country{}; // census country learnt by the flag check ("" until then)
};

struct gedcomindex {
    QString gedcomfile;    // full path of the family file
    filestamp gedcomdate;  // its last-modified time and size when it was read
    textencoding encoding = textencoding::windows1252;
    bool bom = false;
    bool hashead = false; // a "0 HEAD" line was met: the file looks like GEDCOM

    std::vector<personrec> people;
    std::vector<sourcerec> sources;
    std::vector<objectrec> objects;
    std::vector<placerec> places; // sorted by name ignoring case, one entry per group
    std::vector<familycensusrec> familycensus; // in file order
    flagtable flags;              // the defined flags, then those met in the file

    std::vector<int32_t> censussources; // positions in `sources` of census sources, in file order
    int64_t censusevents = 0;           // "1 CENS" events of all individuals

    int32_t maxobjectid = 0;
    int32_t maxnoteid = -1;
    int32_t nextsourceid = 1; // highest source number + 1

    // Last: a move assignment replaces the records before the storage their
    // texts and lists live in.
    textarena arena;

    gedcomindex() = default;
    gedcomindex(gedcomindex&&) = default;
    gedcomindex& operator=(gedcomindex&&) = default;
    // The records go before the arena, which members declared before it would outlive.
    ~gedcomindex() { people.clear(); }
};

} // namespace qm
