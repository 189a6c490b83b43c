// The Find Individual dialog and the log viewer on generated files (folder
// QM_BENCH_DIR, else build/gen): showing an individual (one pass over every
// individual for its relatives), the dialog's list of a file just under the
// people-list limit, a name search that misses, and paging through a large log.
#include "log/logpages.h"
#include "tools/findindividual.h"

#include "benchfiles.h"

#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>

namespace {

using qmbench::benchfilefound;
using qmbench::benchindex;

bool absent(benchmark::State& state, const qm::gedcomindex* ix, const char* name)
{
    return !benchfilefound(state, ix && !ix->people.empty(), name);
}

// Showing the individual in the middle of the file: census lines and relatives.
void showperson(benchmark::State& state, const char* name)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (absent(state, ix, name))
        return;
    const auto k = static_cast<int32_t>(ix->people.size() / 2);
    size_t found = 0;
    for (auto _ : state) {
        const QStringList lines = qm::censuslines(ix->people[static_cast<size_t>(k)]);
        const qm::relatives r = qm::findrelatives(*ix, k);
        found = r.parents.size() + r.spouses.size() + r.children.size() + static_cast<size_t>(lines.size());
        benchmark::DoNotOptimize(found);
    }
    state.counters["people"] = static_cast<double>(ix->people.size());
}

// The dialog's list at opening, and a name search that looks at every entry.
void openlist(benchmark::State& state, const char* name)
{
    const qm::gedcomindex* ix = benchindex(name);
    if (absent(state, ix, name))
        return;
    size_t rows = 0;
    for (auto _ : state) {
        const std::vector<qm::listentry> list = qm::findlist(*ix, false, {});
        rows = list.size();
        benchmark::DoNotOptimize(qm::findbyname(list, QStringLiteral("zzz")));
    }
    state.counters["rows"] = static_cast<double>(rows);
}

// Every page of a log of 20,000 entries of 10 lines.
void logpaging(benchmark::State& state)
{
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("censuslog.txt"));
    {
        QFile f(path);
        if (!f.open(QIODevice::WriteOnly)) {
            state.SkipWithError("cannot write the log");
            return;
        }
        const QByteArray entry = QByteArray(78, '=') + "\r\nCensus entry added: 06/12/2026 13:05:09\r\n"
                                 "To Gedcom File: /home/user/family.ged\r\nSource created: 1881 Census (ID: 12)\r\n\r\n"
                                 "Individual records changed (linked to source above): \r\n" +
                                 QByteArray("Name: Ashworth, John (3) : created census event   \r\n").repeated(4);
        for (int i = 0; i < 20000; ++i)
            f.write(entry);
    }
    int pages = 0;
    for (auto _ : state) {
        qm::logpages log;
        log.open(path);
        while (log.more())
            log.nextpage();
        pages = log.page();
        benchmark::DoNotOptimize(pages);
    }
    state.counters["pages"] = pages;
    state.SetBytesProcessed(static_cast<int64_t>(state.iterations()) * QFileInfo(path).size());
}

} // namespace

BENCHMARK_CAPTURE(showperson, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(showperson, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(openlist, fam30000, "fam30000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK(logpaging)->Unit(benchmark::kMillisecond);

BENCHMARK_MAIN();
