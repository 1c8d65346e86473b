// Overlays, swing and point-and-figure charts on a 1000 x 700 area from a 30,000-record daily
// history, on a RecordingSurface: a point-and-figure build over the whole file (counting pass
// and drawing pass), a swing chart build, and the overlays alone on a drawn daily chart.
#include "bench_history.h"
#include "chart/build_chart.h"
#include "chart/draw_price_chart.h"
#include "chart/overlays.h"
#include "platform/dialogs.h"

#include <benchmark/benchmark.h>

using namespace kori;

namespace {

using bench::kRecords;

// The history has a faster ripple on its wave, so that swings and reversals turn often.
struct Setup : bench::ChartSetup {
    platform::RecordingSurface surface{1000, 700};
    bench::HistorySource source{2};
    Setup() : ChartSetup("kori-obench-TCht.Tmp") {}
};

void RunBuild(benchmark::State& state, Setup& s) {
    bench::RunChartBuild(state, s, s.source, s.surface);
}

void BM_PointFigureBuild(benchmark::State& state) {
    Setup s;
    s.request.ChartStyle = 'P';
    s.request.BarSpacing = 3;
    s.name.PFIncrement = 0.25f;
    RunBuild(state, s);
}
BENCHMARK(BM_PointFigureBuild)->Unit(benchmark::kMicrosecond);

void BM_SwingChartBuild(benchmark::State& state) {
    Setup s;
    s.request.SwingOn = true;
    s.request.BarSpacing = 3;
    s.request.SwingMethod =
        state.range(0) == 0 ? chart::SwingMethod::Norm : chart::SwingMethod::XPointAuto;
    s.request.SwingPanel =
        state.range(0) == 0 ? chart::SidePanel::None : chart::SidePanel::XPointAuto;
    RunBuild(state, s);
}
BENCHMARK(BM_SwingChartBuild)->Arg(0)->Arg(1)->Unit(benchmark::kMicrosecond);

// Overlays alone on a drawn chart: range 0 the two averages and percentage bands, range 1 the
// twelve averages, Bollinger bands and the parabolic.
void BM_Overlays(benchmark::State& state) {
    Setup s;
    s.request.AvOne = s.request.AvTwo = true;
    s.request.ChartBands = 1;
    if (state.range(0) == 1) {
        s.request.MMAOn = true;
        s.request.ChartBands = 2;
        s.request.AutoOsc = true;
        s.request.AutoOscCode = "PARA";
    }
    chart::Chart c;
    const chart::PlotGeometry g = chart::ComputePlotGeometry(1000, 700, s.request);
    if (!s.source.Load({kRecords - 471, kRecords, 'A', true, 4}, c.Series)) return;
    (void)c.Stream.Open(s.stream, false);
    const chart::DrawInputs in{s.request, s.defaults, s.name, s.palette, s.fonts};
    if (!chart::DrawLoadedChart(c, in, g, s.dialogs, s.surface)) return;
    for (auto _ : state) {
        s.surface.ClearCalls();
        chart::ChartPainter p(c, in, s.surface);
        chart::DrawChartOverlays(p);
    }
    state.counters["calls"] = static_cast<double>(s.surface.calls().size());
    (void)c.Stream.Close();
}
BENCHMARK(BM_Overlays)->Arg(0)->Arg(1)->Unit(benchmark::kMicrosecond);

// A whole daily build with every overlay of range 1 on top.
void BM_OverlaysBuild(benchmark::State& state) {
    Setup s;
    s.request.MMAOn = true;
    s.request.ChartBands = 2;
    s.request.AutoOsc = true;
    s.request.AutoOscCode = "PARA";
    RunBuild(state, s);
}
BENCHMARK(BM_OverlaysBuild)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
