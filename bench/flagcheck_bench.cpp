// The flag check on generated family files (folder QM_BENCH_DIR, else
// build/gen) with one year flag allocated to each UK census: the interactive
// check that builds every change and row of the Flag Check dialog. It looks at
// every individual, as the silent check after a load does when the flags are
// in step (the silent check builds no rows, so this bounds it).
#include "flags/flagcheck.h"

#include "benchfiles.h"

#include <string>


namespace {

using qmbench::benchfilefound;
using qmbench::benchindex;

qm::flagtable yearflags()
{
    qm::flagtable t;
    for (int year = 1841; year <= 1921; year += 10) {
        qm::flagrec f;
        f.code = "__CENSUS_" + std::to_string(year);
        f.name = "Census " + std::to_string(year);
        f.date = std::to_string(year);
        f.country = "UK";
        t.push_back(f);
    }
    return t;
}

void interactive(benchmark::State& state, const char* name)
{
    qm::gedcomindex* ix = benchindex(name, yearflags());
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    size_t changes = 0;
    for (auto _ : state) {
        const qm::flagcheckresult r = qm::checkflags(*ix, true, QStringLiteral("UK"));
        changes = r.changes.size();
        benchmark::DoNotOptimize(changes);
    }
    state.counters["changes"] = static_cast<double>(changes);
}

} // namespace

BENCHMARK_CAPTURE(interactive, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(interactive, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(2);

BENCHMARK_MAIN();
