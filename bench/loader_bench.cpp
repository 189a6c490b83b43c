// Loading generated family files of 10,000, 100,000 and 1,000,000 individuals
// (made by gen_family_gedcom.py; the folder is QM_BENCH_DIR, else build/gen).
#include "platform/linereader.h"

#include "benchfiles.h"

#include <QFileInfo>

namespace {

using qmbench::benchfile;
using qmbench::benchfilefound;

void loadfile(benchmark::State& state, const char* name)
{
    const QString path = benchfile(name);
    const QFileInfo info(path);
    if (!benchfilefound(state, info.isFile(), name))
        return;
    size_t people = 0, arena = 0;
    for (auto _ : state) {
        qm::loadresult r = qm::loadgedcom(path, {});
        if (!r.index) {
            state.SkipWithError(r.error.toStdString().c_str());
            return;
        }
        people = r.index->people.size();
        arena = r.index->arena.capacity();
        benchmark::DoNotOptimize(r.index.get());
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations()) * info.size());
    state.counters["individuals"] = static_cast<double>(people);
    state.counters["arena_MB"] = static_cast<double>(arena) / (1 << 20);
}

// Only the lines, as the loader gets them: the floor under the load's time.
void readlines(benchmark::State& state, const char* name)
{
    const QString path = benchfile(name);
    if (!benchfilefound(state, QFileInfo(path).isFile(), name))
        return;
    int64_t lines = 0;
    for (auto _ : state) {
        qm::linereader reader;
        reader.setmaxline(1 << 20);
        if (!reader.open(path)) {
            state.SkipWithError("cannot open");
            return;
        }
        std::string_view line;
        size_t bytes = 0;
        while (reader.next(line))
            bytes += line.size();
        lines = reader.linenumber();
        benchmark::DoNotOptimize(bytes);
    }
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations()) * QFileInfo(path).size());
    state.counters["lines"] = static_cast<double>(lines);
}

} // namespace

BENCHMARK_CAPTURE(readlines, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK_CAPTURE(loadfile, fam10000, "fam10000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(loadfile, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(loadfile, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(1);

BENCHMARK_MAIN();
