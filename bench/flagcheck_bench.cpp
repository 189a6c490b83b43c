// The flag check on generated family files (folder QM_BENCH_DIR, else
// /work/gen) with one year flag allocated to each UK census: the interactive
// check that builds every change and row of the Flag Check dialog. It looks at
// every individual, as the silent check after a load does when the flags are
// in step (the silent check builds no rows, so this bounds it).
#include "flags/flagcheck.h"
#include "model/loadgedcom.h"

#include <QFileInfo>

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <map>
#include <memory>

namespace {

QString benchfile(const char* name)
{
    const char* dir = std::getenv("QM_BENCH_DIR");
    return QString::fromLocal8Bit(dir && *dir ? dir : "/work/gen") + QLatin1Char('/') + QLatin1String(name);
}

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

qm::gedcomindex* indexof(const char* name)
{
    static std::map<std::string, std::unique_ptr<qm::gedcomindex>> loaded;
    auto& slot = loaded[name];
    if (!slot) {
        const QString path = benchfile(name);
        if (!QFileInfo(path).isFile())
            return nullptr;
        slot = qm::loadgedcom(path, yearflags()).index;
    }
    return slot.get();
}

void interactive(benchmark::State& state, const char* name)
{
    qm::gedcomindex* ix = indexof(name);
    if (!ix) {
        state.SkipWithError((benchfile(name).toStdString() + " is absent: make it with gen_family_gedcom.py").c_str());
        return;
    }
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
