// Attach Images to Existing Sources on generated family files (folder
// QM_BENCH_DIR, else build/gen): the census dates of the sources, read from the
// file each time the dialog opens, and the details of the source cited most
// (the longest list of individuals the dialog fills).
#include "images/sourcedates.h"

#include "benchfiles.h"

#include <QFileInfo>

namespace {

using qmbench::benchfile;
using qmbench::benchfilefound;
using qmbench::benchindex;

void censusdates(benchmark::State& state, const char* name)
{
    qm::gedcomindex* ix = benchindex(name);
    if (!benchfilefound(state, ix != nullptr, name))
        return;
    size_t known = 0;
    for (auto _ : state) {
        // Each opening after a load starts from sources with nothing settled.
        state.PauseTiming();
        for (qm::sourcerec& s : ix->sources) {
            s.censusdate.clear();
            s.censusdatesought = false;
        }
        state.ResumeTiming();
        const QString error = qm::findcensusdates(*ix);
        benchmark::DoNotOptimize(error);
    }
    for (const qm::sourcerec& s : ix->sources)
        known += !s.censusdate.empty() && !s.censusdatesought;
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations()) * QFileInfo(benchfile(name)).size());
    state.counters["sources"] = static_cast<double>(ix->sources.size());
    state.counters["dated"] = static_cast<double>(known);
}

void selectsource(benchmark::State& state, const char* name)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (!ix || ix->sources.empty()) {
        state.SkipWithError((benchfile(name).toStdString() + " is absent: make it with gen_family_gedcom.py").c_str());
        return;
    }
    // The census source cited first in the file stands for a busy one.
    const int32_t id = ix->censussources.empty() ? ix->sources.front().id
                                                 : ix->sources[static_cast<size_t>(ix->censussources.front())].id;
    size_t rows = 0;
    for (auto _ : state) {
        const std::vector<int32_t> listed = qm::filtersources(*ix, qm::sourcefilter::census, {}, true);
        const std::vector<int32_t> people = qm::citingpeople(*ix, id);
        QStringList labels;
        for (const int32_t k : people)
            labels << qm::personlabel(ix->people[static_cast<size_t>(k)], false);
        rows = listed.size() + static_cast<size_t>(labels.size());
        benchmark::DoNotOptimize(rows);
    }
    state.counters["rows"] = static_cast<double>(rows);
}

} // namespace

BENCHMARK_CAPTURE(censusdates, fam10000, "fam10000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(censusdates, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(censusdates, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK_CAPTURE(selectsource, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(selectsource, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(3);

BENCHMARK_MAIN();
