#include "support/testflags.h"

namespace qmtest {

qm::flagrec testflag(const char* code, const char* name, const char* date, const char* country)
{
    qm::flagrec f;
    f.code = code;
    f.name = name;
    f.date = date;
    f.country = country;
    return f;
}

qm::flagtable testflagdefs()
{
    return {testflag("__CENSUS_UK_1901", "Census UK 1901", "31 MAR 1901", "UK"),
            testflag("__CENSUS_IRELAN", "Census Ireland 1901", "31 MAR 1901", "Ireland"),
            testflag("__CENSUS_1881", "Census 1881", "1881", "UK")};
}

} // namespace qmtest
