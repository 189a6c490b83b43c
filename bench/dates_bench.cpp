// Date words and ages are worked out for every individual when the people
// list is filtered by census year, so they must stay cheap per date.

#include "model/dates.h"

#include <benchmark/benchmark.h>

#include <QStringList>

using namespace qm;

namespace {

const QStringList& sampledates()
{
    static const QStringList dates = {
        QStringLiteral("3 MAR 1851"), QStringLiteral("ABT 1851"),          QStringLiteral("MAR 1851"),
        QStringLiteral("1851"),       QStringLiteral("BET 1850 AND 1852"), QStringLiteral("EST 12 DEC 1849"),
        QStringLiteral("BEF 1900"),   QStringLiteral("31 FEB 1851"),
    };
    return dates;
}

void BM_datephrase(benchmark::State& state)
{
    const std::optional<QDate> census = QDate(1881, 4, 3);
    const QStringList& dates = sampledates();
    qsizetype i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(datephrase(dates[i], census, dateorder::dmy));
        i = (i + 1) % dates.size();
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_datephrase);

void BM_dateyears(benchmark::State& state)
{
    const std::optional<QDate> census = QDate(1881, 4, 3);
    const QStringList& dates = sampledates();
    qsizetype i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(dateyears(dates[i], census, dateorder::dmy));
        i = (i + 1) % dates.size();
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_dateyears);

void BM_recognisedate(benchmark::State& state)
{
    const QString text = QStringLiteral("30 MAR 1851");
    for (auto _ : state)
        benchmark::DoNotOptimize(recognisedate(text, dateorder::dmy));
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_recognisedate);

void BM_recognisedate_localeorder(benchmark::State& state)
{
    const QString text = QStringLiteral("30 MAR 1851");
    for (auto _ : state)
        benchmark::DoNotOptimize(recognisedate(text));
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_recognisedate_localeorder);

} // namespace

BENCHMARK_MAIN();
