// The census coverage on generated family files (gen_family_gedcom.py; the
// folder is QM_BENCH_DIR, else build/gen): working out every cell of the UK's
// and the USA's censuses, and the rows of the grid in name order, with all
// individuals and with those with a gap, and a name search over them.
#include "tools/coverage.h"

#include "benchfiles.h"

namespace {

using qmbench::benchfilefound;
using qmbench::benchindex;

void cells(benchmark::State& state, const char* name, const char* country)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    int64_t missing = 0;
    for (auto _ : state) {
        const qm::censuscoverage c = qm::computecoverage(*ix, QLatin1String(country), false, qm::dateorder::dmy);
        missing = 0;
        for (const int32_t m : c.missing)
            missing += m;
        benchmark::DoNotOptimize(missing);
    }
    state.SetItemsProcessed(static_cast<int64_t>(state.iterations()) * static_cast<int64_t>(ix->people.size()));
    state.counters["missing"] = static_cast<double>(missing);
}

void rows(benchmark::State& state, const char* name, bool gapsonly)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    const qm::censuscoverage c = qm::computecoverage(*ix, QStringLiteral("UK"), false, qm::dateorder::dmy);
    qm::coveragefilter f;
    f.gapsonly = gapsonly;
    size_t n = 0;
    for (auto _ : state) {
        n = qm::coveragerows(*ix, c, f, qm::coveragesort::name).size();
        benchmark::DoNotOptimize(n);
    }
    state.counters["rows"] = static_cast<double>(n);
}

// What the grid does at each name typed: the rows of a name search, from the
// name order worked out once.
void namesearch(benchmark::State& state, const char* name, const char* text)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    const qm::censuscoverage c = qm::computecoverage(*ix, QStringLiteral("UK"), false, qm::dateorder::dmy);
    const std::vector<int32_t> ordered = qm::coverageorder(*ix, c, qm::coveragesort::name);
    qm::coveragefilter f;
    f.name = QString::fromUtf8(text);
    size_t n = 0;
    for (auto _ : state) {
        n = qm::filtercoverage(*ix, c, f, ordered).size();
        benchmark::DoNotOptimize(n);
    }
    state.counters["rows"] = static_cast<double>(n);
}

} // namespace

BENCHMARK_CAPTURE(cells, fam10000_uk, "fam10000.ged", "UK")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(cells, fam100000_uk, "fam100000.ged", "UK")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(cells, fam1000000_uk, "fam1000000.ged", "UK")->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(cells, fam1000000_usa, "fam1000000.ged", "USA")->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(rows, fam100000_all, "fam100000.ged", false)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(rows, fam100000_gaps, "fam100000.ged", true)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(namesearch, fam100000_smith, "fam100000.ged", "smith")->Unit(benchmark::kMillisecond);

BENCHMARK_MAIN();
