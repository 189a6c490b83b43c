#pragma once
// Census flag definitions for the tests of the flag check.

#include "flags/flagtable.h"

namespace qmtest {

qm::flagrec testflag(const char* code, const char* name, const char* date, const char* country);

// UK and Ireland share the 1901 census day; the 1881 flag is a year flag.
qm::flagtable testflagdefs();

} // namespace qmtest
