// The main window's lists of individuals must appear at once even for big
// family files: opening a file of 30,000 individuals until the people list is
// filled, and choosing a census year in a file of 100,000 until the list of
// those who could be alive is filled. The list view itself only shows the
// rows on screen (model/view), so the work measured here is what fills it.

#include "census/selection.h"
#include "model/loadgedcom.h"

#include "benchfiles.h"

#include <benchmark/benchmark.h>

using namespace qm;
using qmbench::benchfile;

namespace {

// Load, then the label order of everyone: what opening a file costs.
void BM_openfile_peoplelist(benchmark::State& state)
{
    const QString path = benchfile("fam30000.ged");
    for (auto _ : state) {
        loadresult r = loadgedcom(path, flagtable{});
        if (!r.index) {
            state.SkipWithError("fam30000.ged could not be read");
            return;
        }
        benchmark::DoNotOptimize(sortedpeople(*r.index, false));
    }
}
BENCHMARK(BM_openfile_peoplelist)->Unit(benchmark::kMillisecond);

// Choosing 1881: who could be alive, in label order.
void BM_chooseyear_alivelist(benchmark::State& state)
{
    loadresult r = loadgedcom(benchfile("fam100000.ged"), flagtable{});
    if (!r.index) {
        state.SkipWithError("fam100000.ged could not be read");
        return;
    }
    size_t listed = 0;
    for (auto _ : state) {
        const alivelist alive = couldbealive(*r.index, QDate(1881, 4, 3), dateorder::dmy);
        const std::vector<int32_t> shown = sortbylabel(*r.index, alive.people, false);
        listed = shown.size();
        benchmark::DoNotOptimize(shown);
    }
    state.counters["listed"] = static_cast<double>(listed);
}
BENCHMARK(BM_chooseyear_alivelist)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
