// Every saved census entry rewrites the whole family file, so the rewrite
// must stay one quick pass even for files of 100,000 individuals and more.

#include "model/loadgedcom.h"
#include "writer/rewritefile.h"

#include "benchfiles.h"

#include <benchmark/benchmark.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <cstdlib>

using namespace qm;
using qmbench::benchfile;

namespace {

rewriterequest entryfor(const gedcomindex& ix)
{
    rewriterequest r;
    r.entry.sourceid = QString::number(ix.nextsourceid);
    r.entry.title = QStringLiteral("Census 1881 Leeds RG11/1 (Test)");
    r.entry.place = QStringLiteral("Leeds");
    r.entry.entrydate = QStringLiteral("3 APR 1881");
    r.entry.sourcetext = QStringLiteral("Line one\r\nLine two");
    for (size_t i : {size_t(0), ix.people.size() / 2}) {
        selectionrec s;
        s.id = ix.people[i].id;
        s.personindex = static_cast<int32_t>(i);
        s.age = QStringLiteral("30");
        s.occupation = QStringLiteral("Weaver");
        r.entry.selection.push_back(s);
    }
    return r;
}

// The whole rewrite of a file on disk, through the temporary file and the atomic replace.
void BM_rewritefile(benchmark::State& state, const char* name)
{
    const QString path = benchfile(name);
    if (!QFile::exists(path)) {
        state.SkipWithError("generated file missing");
        return;
    }
    const loadresult loaded = loadgedcom(path, {});
    const rewriterequest r = entryfor(*loaded.index);
    // QM_BENCH_OUT (a folder in memory such as /dev/shm) leaves the disk out
    // and measures the rewrite's own work.
    const char* outdir = std::getenv("QM_BENCH_OUT");
    QTemporaryDir dir(outdir && *outdir ? QString::fromLocal8Bit(outdir) + QStringLiteral("/rewrite-XXXXXX")
                                        : QDir::tempPath() + QStringLiteral("/rewrite-XXXXXX"));
    const QString out = dir.filePath(QStringLiteral("family.ged"));
    for (auto _ : state) {
        const rewriteresult res = rewritefile(path, out, *loaded.index, settings{}, r);
        if (!res.ok)
            state.SkipWithError("rewrite failed");
    }
    state.SetBytesProcessed(state.iterations() * QFile(path).size());
}

BENCHMARK_CAPTURE(BM_rewritefile, fam10000, "fam10000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(BM_rewritefile, fam100000, "fam100000.ged")->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(BM_rewritefile, fam1000000, "fam1000000.ged")->Unit(benchmark::kMillisecond)->Iterations(2);

} // namespace

BENCHMARK_MAIN();
