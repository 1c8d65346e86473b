// A daily bar chart with volume, 1000 x 700, from a 30,000-record history: the whole build
// (window, load of the ~470 records on show, scale, drawing, stream written to a file) and the
// drawing alone on bars already loaded.
#include "bench_history.h"
#include "chart/build_chart.h"
#include "chart/draw_price_chart.h"
#include "platform/dialogs.h"

#include <benchmark/benchmark.h>

using namespace kori;

namespace {

using bench::kRecords;

struct Setup : bench::ChartSetup {
    platform::RecordingSurface surface{1000, 700};
    bench::HistorySource source;
    Setup() : ChartSetup("kori-bench-TCht.Tmp") {}
};

void BM_BuildChart(benchmark::State& state) {
    Setup s;
    bench::RunChartBuild(state, s, s.source, s.surface);
}
BENCHMARK(BM_BuildChart)->Unit(benchmark::kMicrosecond);

void BM_DrawLoadedChart(benchmark::State& state) {
    Setup s;
    chart::Chart c;
    const chart::PlotGeometry g = chart::ComputePlotGeometry(1000, 700, s.request);
    if (!s.source.Load({kRecords - 471, kRecords, 'A', true, 4}, c.Series)) return;
    (void)c.Stream.Open(s.stream, false);
    const chart::DrawInputs in{s.request, s.defaults, s.name, s.palette, s.fonts};
    for (auto _ : state) {
        s.surface.ClearCalls();
        if (!chart::DrawLoadedChart(c, in, g, s.dialogs, s.surface))
            state.SkipWithError("draw failed");
    }
    (void)c.Stream.Close();
}
BENCHMARK(BM_DrawLoadedChart)->Unit(benchmark::kMicrosecond);

// The same drawing on a surface that does nothing: what the build itself costs, without the
// text the recording surface makes of every call.
void BM_DrawLoadedChartNullSurface(benchmark::State& state) {
    Setup s;
    bench::NullSurface surface(1000, 700);
    chart::Chart c;
    const chart::PlotGeometry g = chart::ComputePlotGeometry(1000, 700, s.request);
    if (!s.source.Load({kRecords - 471, kRecords, 'A', true, 4}, c.Series)) return;
    (void)c.Stream.Open(s.stream, false);
    const chart::DrawInputs in{s.request, s.defaults, s.name, s.palette, s.fonts};
    for (auto _ : state)
        if (!chart::DrawLoadedChart(c, in, g, s.dialogs, surface))
            state.SkipWithError("draw failed");
    (void)c.Stream.Close();
}
BENCHMARK(BM_DrawLoadedChartNullSurface)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
