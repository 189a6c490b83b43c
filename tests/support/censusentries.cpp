#include "support/censusentries.h"

namespace qmtest {

qm::selectionrec chosen(int32_t id, int32_t personindex, const char* name, const char* age, const char* occupation,
                        char16_t agetype)
{
    qm::selectionrec r;
    r.id = id;
    r.personindex = personindex;
    r.name = QString::fromUtf8(name);
    r.age = QString::fromUtf8(age);
    r.occupation = QString::fromUtf8(occupation);
    r.agetype = agetype;
    return r;
}

qm::censusentry censusof(const QString& sourceid, const char* title, const char* place, const char* date)
{
    qm::censusentry e;
    e.sourceid = sourceid;
    e.title = QString::fromUtf8(title);
    e.place = QString::fromUtf8(place);
    e.entrydate = QString::fromUtf8(date);
    return e;
}

} // namespace qmtest
