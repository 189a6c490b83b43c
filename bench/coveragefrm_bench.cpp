// The Census Coverage window on the 100,000-individual generated file: from
// the call that opens it to its first paint (the coverage worked out, every
// individual put in name order, the grid drawn), and paging down through the
// grid, one page painted per step. Runs on Qt's offscreen platform unless
// QT_QPA_PLATFORM says otherwise.
#include "platform/scriptedprompts.h"
#include "settings/settings.h"
#include "tools/coveragefrm.h"

#include "benchfiles.h"

#include <QApplication>
#include <QScrollBar>
#include <QTableView>

namespace {

using qmbench::benchfilefound;
using qmbench::benchindex;

void BM_coveragewindow_open(benchmark::State& state)
{
    const qm::gedcomindex* ix = benchindex("fam100000.ged");
    if (!benchfilefound(state, ix != nullptr, "fam100000.ged"))
        return;
    qm::scriptedprompts prompts;
    const qm::settings s = qm::defaultsettings();
    for (auto _ : state) {
        qm::coveragefrm w(*ix, s, prompts, {});
        w.show();
        QApplication::processEvents();
        benchmark::DoNotOptimize(w.grab());
    }
    state.counters["individuals"] = static_cast<double>(ix->people.size());
}
BENCHMARK(BM_coveragewindow_open)->Unit(benchmark::kMillisecond);

void BM_coveragewindow_pagedown(benchmark::State& state)
{
    const qm::gedcomindex* ix = benchindex("fam100000.ged");
    if (!benchfilefound(state, ix != nullptr, "fam100000.ged"))
        return;
    qm::scriptedprompts prompts;
    qm::coveragefrm w(*ix, qm::defaultsettings(), prompts, {});
    w.show();
    QApplication::processEvents();
    QTableView* grid = w.findChild<QTableView*>(QStringLiteral("coveragegrid"));
    QScrollBar* bar = grid->verticalScrollBar();
    for (auto _ : state) {
        bar->setValue(bar->value() + bar->pageStep() >= bar->maximum() ? 0 : bar->value() + bar->pageStep());
        grid->viewport()->repaint();
    }
}
BENCHMARK(BM_coveragewindow_pagedown)->Unit(benchmark::kMillisecond);

} // namespace

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
