#pragma once
// Census entries for the writer, save and validation tests: a chosen
// individual as the census rows hand it on, and the source fields of an entry.

#include "writer/censusentry.h"

#include <QString>

namespace qmtest {

// An individual chosen in a census row (`personindex` is the position in the
// index's people, -1 when not there).
qm::selectionrec chosen(int32_t id, int32_t personindex, const char* name = "Someone", const char* age = "40",
                        const char* occupation = "", char16_t agetype = u'Y');

// An entry for source `sourceid` with this title and place on the census day
// `date`; no year chosen and no individuals yet.
qm::censusentry censusof(const QString& sourceid, const char* title, const char* place,
                         const char* date = "3 APR 1881");

} // namespace qmtest
