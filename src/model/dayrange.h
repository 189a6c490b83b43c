#pragma once
// The days a GEDCOM date of a family file allows, read from its bytes without
// allocating: for the census coverage, which reads the birth, death, census
// and residence dates of every individual of a file.
//
// A date is [day] [month] year ("3 APR 1881", "APR 1881", "1881"), with
// English month names or their first three letters in any letter case, a
// quarter "Q1 1881" .. "Q4 1881" (January-March ...), or a double year
// "1750/51" (the later year). In front of it may stand:
//   ABT, EST, CAL      about: the date's days widened by two years either way
//   BEF                strictly before the date's first day
//   AFT                strictly after the date's last day
//   BET x AND y        from x's first day to y's last
//   FROM x TO y        a period: it also tells which days lie within it for
//                      certain (from x's last day to y's first)
//   FROM x, TO x, INT x (the date alone)
// A calendar escape such as "@#DJULIAN@" is passed over (its dates are read
// as they are written), and so is a phrase in brackets after the date
// ("INT 1851 (from the census)"). Anything else, a phrase alone
// ("(unknown)"), "B.C." dates and impossible days ("31 FEB 1881") read as no
// date at all.

#include <cstdint>
#include <limits>
#include <string_view>

namespace qm {

// Days are counted from 1 March of year 0 of the Gregorian calendar: only
// their order and differences matter.
using daynumber = int32_t;
inline constexpr daynumber nodaybefore = std::numeric_limits<daynumber>::min(); // open start (BEF)
inline constexpr daynumber nodayafter = std::numeric_limits<daynumber>::max();  // open end (AFT)

// The day of a calendar date (month 1-12), not checked.
daynumber daynumberof(int year, int month, int day);

struct dayrange {
    bool valid = false;
    daynumber first = nodaybefore; // the earliest day the date allows
    daynumber last = nodayafter;   // the latest
    // FROM x TO y (period set): x's last day and y's first. The days between
    // them lie within the period for certain (none when fromlast > tofirst).
    bool period = false;
    daynumber fromlast = nodaybefore;
    daynumber tofirst = nodayafter;
    int year = 0; // the first year written ("ABT 1851": 1851; "BET 1840 AND 1845": 1840)
};

dayrange readdayrange(std::string_view date);

} // namespace qm
