// Feeds arbitrary bytes to the loader and checks what it promises about any
// input: it returns an index whose texts and tables hang together, which the
// census coverage reads without harm.
#include "model/loadgedcom.h"
#include "tools/coverage.h"

#include "fuzzcheck.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>

using qmfuzz::check;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    qm::flagtable defs;
    defs.push_back({"__C1881", "Census 1881", "3 APR 1881", 0, "UK"});
    auto ix = qm::loadgedcombytes(bytes, defs);
    check(ix != nullptr);

    for (const qm::personrec& p : ix->people) {
        check(!p.name.empty());
        for (int32_t f : p.flagids)
            check(f >= 0 && static_cast<size_t>(f) < ix->flags.size());
        size_t censuscites = 0;
        for (const qm::censusrec& c : p.census)
            censuscites += c.sourceids.size();
        check(censuscites <= p.sourceids.size());
    }
    for (int32_t s : ix->censussources)
        check(s >= 0 && static_cast<size_t>(s) < ix->sources.size() && ix->sources[static_cast<size_t>(s)].iscensus);
    for (size_t i = 0; i < ix->places.size(); ++i) {
        check(ix->places[i].count > 0);
        check(qm::findplace(*ix, ix->places[i].name) == static_cast<int>(i));
        if (i > 0)
            check(qm::placekey(ix->places[i - 1].name) < qm::placekey(ix->places[i].name));
    }
    check(ix->nextsourceid >= 1);

    // The list data the windows take from the index.
    if (ix->people.size() <= 200) {
        const auto order = qm::sortedpeople(*ix, size % 2 == 0);
        check(order.size() == ix->people.size());
    }
    (void)qm::censussourcelist(*ix);
    // The census coverage reads every date and place of every individual.
    const qm::censuscoverage c = qm::computecoverage(*ix, size % 3 == 0 ? QStringLiteral("USA") : QStringLiteral("UK"),
                                                     size % 2 == 0, qm::dateorder::dmy);
    check(c.cells.size() == ix->people.size() * c.columns());
    if (!ix->people.empty())
        qm::insertplace(*ix, ix->people.front().name);
    return 0;
}
