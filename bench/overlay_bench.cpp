// Overlays, swing and point-and-figure charts on a 1000 x 700 area from a 30,000-record daily
// history, on a RecordingSurface: a point-and-figure build over the whole file (counting pass
// and drawing pass), a swing chart build, and the overlays alone on a drawn daily chart.
#include "chart/build_chart.h"
#include "chart/draw_price_chart.h"
#include "chart/overlays.h"
#include "platform/dialogs.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <filesystem>

using namespace kori;

namespace {

constexpr int kRecords = 30000;

class HistorySource : public chart::PriceSource {
public:
    HistorySource() {
        m_bars.reserve(kRecords);
        for (int i = 0; i < kRecords; ++i) {
            store::ChartBar b;
            char date[16];
            std::snprintf(date, sizeof date, "%04d%02d%02d", 1900 + i / 250, 1 + (i / 21) % 12,
                          1 + i % 21);
            b.SetDate(date);
            const float mid = 20 + 8 * std::sin(static_cast<float>(i) / 300) +
                              2 * std::sin(static_cast<float>(i) / 13) +
                              static_cast<float>(i % 7) * 0.1f;
            b.Open = mid - 0.2f;
            b.High = mid + 0.5f;
            b.Low = mid - 0.5f;
            b.Close = mid + 0.1f;
            b.Volume = 10000 + (i * 7919) % 50000;
            m_bars.push_back(b);
        }
    }
    std::string FileName() const override { return "BENCH.WDT"; }
    std::int16_t RecordCount() override { return static_cast<std::int16_t>(kRecords); }
    std::string DateOf(std::int16_t rec) override {
        return std::string(m_bars[static_cast<std::size_t>(rec - 1)].DateText());
    }
    std::string NoteText(std::int16_t) override { return {}; }
    platform::Status Load(const chart::LoadRequest& req, store::ChartSeries& s) override {
        s.ChartBars.assign(m_bars.begin() + (req.FirstRecord - 1), m_bars.begin() + req.LastRecord);
        s.LastBar = static_cast<std::int16_t>(req.LastRecord - req.FirstRecord);
        store::LoadResults r;
        std::int64_t sum = 0;
        for (const auto& b : s.ChartBars) {
            r.HighestPrice = std::max(r.HighestPrice, b.High);
            r.LowestPrice = std::min(r.LowestPrice, b.Low);
            r.HighestVolume = std::max(r.HighestVolume, b.Volume);
            r.LowestVolume = std::min(r.LowestVolume, b.Volume);
            sum += b.Volume;
        }
        r.AverageVolume =
            static_cast<std::int32_t>(sum / static_cast<std::int64_t>(s.ChartBars.size()));
        r.VolumesPresent = req.WantVolume;
        s.Results = r;
        return platform::Status::Ok();
    }

private:
    std::vector<store::ChartBar> m_bars;
};

struct Setup {
    platform::Palette palette{};
    platform::ChartFonts fonts;
    chart::ChartDefaults defaults;
    chart::ChartName name{"BENCH", "BENCHMARK SECURITY", "", 4, 0, 0, 5, 5};
    chart::ChartRequest request;
    platform::ScriptedDialogs dialogs;
    platform::RecordingSurface surface{1000, 700};
    HistorySource source;
    std::filesystem::path stream = std::filesystem::temp_directory_path() / "kori-obench-TCht.Tmp";
    Setup() {
        for (std::size_t i = 0; i < palette.size(); ++i)
            palette[i] = static_cast<platform::Colour>(i * 0x10101);
        request.ChartStyle = 'B';
        request.BarSpacing = 2;
        request.ShowVolume = true;
    }
    ~Setup() { std::filesystem::remove(stream); }
};

void RunBuild(benchmark::State& state, Setup& s) {
    chart::Chart c;
    const chart::ChartBuild build{s.request, s.defaults, s.name,  s.palette,
                                  s.fonts,   s.dialogs,  s.stream};
    for (auto _ : state) {
        s.surface.ClearCalls();
        if (!chart::BuildChart(c, build, s.source, s.surface)) state.SkipWithError("build failed");
        benchmark::DoNotOptimize(c.BarCloseY.data());
    }
    state.counters["bars"] = c.LastBar() + 1;
    state.counters["calls"] = static_cast<double>(s.surface.calls().size());
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
    s.request.SwingMethod = state.range(0) == 0 ? "NORM" : "XPointAuto";
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
    c.Stream.Close();
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
