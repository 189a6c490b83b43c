// The census date check on generated family files (gen_family_gedcom.py; the
// folder is QM_BENCH_DIR, else build/gen): the analysis with its proposals,
// run when the dialog opens and at each country chosen, and the details of the
// most frequent date (the individuals of the longest list the dialog fills).
#include "tools/datecheck.h"

#include "benchfiles.h"

namespace {

using qmbench::benchfilefound;
using qmbench::benchindex;

void analysis(benchmark::State& state, const char* name)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    size_t dates = 0;
    for (auto _ : state) {
        qm::datecheckstate check(*ix, qm::dateorder::dmy);
        check.choosecountry(QStringLiteral("UK"));
        const qm::datelists lists = check.lists();
        dates = check.changes().size();
        benchmark::DoNotOptimize(lists.canchange);
    }
    state.SetItemsProcessed(static_cast<int64_t>(state.iterations()) * ix->censusevents);
    state.counters["census_events"] = static_cast<double>(ix->censusevents);
    state.counters["dates"] = static_cast<double>(dates);
}

void details(benchmark::State& state, const char* name)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    qm::datecheckstate check(*ix, qm::dateorder::dmy);
    check.choosecountry(QStringLiteral("UK"));
    int most = 0;
    for (size_t k = 0; k < check.changes().size(); ++k)
        if (check.changes()[k].count > check.changes()[static_cast<size_t>(most)].count)
            most = static_cast<int>(k);
    size_t rows = 0;
    for (auto _ : state) {
        rows = check.details(most, false).size();
        benchmark::DoNotOptimize(rows);
    }
    state.counters["rows"] = static_cast<double>(rows);
}

} // namespace

BENCHMARK_CAPTURE(analysis, fam10000, "fam10000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(analysis, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(analysis, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(details, fam10000, "fam10000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(details, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(details, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(3);

BENCHMARK_MAIN();
