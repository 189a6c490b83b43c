// Feeds arbitrary text to the date recogniser and to what is built on it,
// under each order of day, month and year, and checks what they promise: a
// recognised date is valid and reads back the same once written the GEDCOM
// way; the census date check accepts exactly what the recogniser does.
#include "model/dates.h"
#include "model/dayrange.h"

#include "fuzzcheck.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>

using qmfuzz::check;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    if (size > 4096)
        return 0;
    const QString text = QString::fromUtf8(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
    const qm::dayrange days = qm::readdayrange(std::string_view(reinterpret_cast<const char*>(data), size));
    check(!days.valid || days.first <= days.last);
    check(!days.period || (days.valid && days.first <= days.fromlast && days.tofirst <= days.last));
    const std::optional<QDate> census = qm::recognisedate(u"3 APR 1881", qm::dateorder::dmy);
    for (const qm::dateorder order : {qm::dateorder::dmy, qm::dateorder::mdy, qm::dateorder::ymd}) {
        const std::optional<QDate> d = qm::recognisedate(text, order);
        if (d) {
            check(d->isValid());
            const QString written = qm::formatgedcomdate(*d);
            check(qm::recognisedate(written, order) == d);
        }
        const qm::datecheck c = qm::validdate(text, QStringLiteral("3 APR 1881"), order);
        check(c.isdate == d.has_value());
        if (c.newtext)
            check(qm::recognisedate(*c.newtext, order).has_value());

        // GEDCOM date phrases and the ages they allow at a census.
        const qm::datephraseresult p = qm::datephrase(text, census, order);
        check(p.earliestyear <= p.latestyear || !p.agecomputed);
        const qm::datephraseyears y = qm::dateyears(text, census, order);
        check(y.agecomputed == p.agecomputed);
        if (y.agecomputed)
            check(y.earliestyear == p.earliestyear && y.latestyear == p.latestyear);
    }
    return 0;
}
