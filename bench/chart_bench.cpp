// A daily bar chart with volume, 1000 x 700, from a 30,000-record history: the whole build
// (window, load of the ~470 records on show, scale, drawing, stream written to a file) and the
// drawing alone on bars already loaded.
#include "chart/build_chart.h"
#include "chart/draw_price_chart.h"
#include "platform/dialogs.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <filesystem>

using namespace kori;

namespace {

constexpr int kRecords = 30000;

// Daily records in memory; the load copies the window as the daily rules keep it.
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
            const float mid =
                20 + 8 * std::sin(static_cast<float>(i) / 300) + static_cast<float>(i % 7) * 0.1f;
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
    std::filesystem::path stream = std::filesystem::temp_directory_path() / "kori-bench-TCht.Tmp";
    Setup() {
        for (std::size_t i = 0; i < palette.size(); ++i)
            palette[i] = static_cast<platform::Colour>(i * 0x10101);
        request.ChartStyle = 'B';
        request.BarSpacing = 2;
        request.ShowVolume = true;
    }
    ~Setup() { std::filesystem::remove(stream); }
};

void BM_BuildChart(benchmark::State& state) {
    Setup s;
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
    c.Stream.Close();
}
BENCHMARK(BM_DrawLoadedChart)->Unit(benchmark::kMicrosecond);

// The same drawing on a surface that does nothing: what the build itself costs, without the
// text the recording surface makes of every call.
class NullSurface : public platform::Surface {
public:
    void Clear() override {}
    void SetBackColour(platform::Colour) override {}
    void SetLineWidth(int) override {}
    void SetLineStyle(platform::LineStyle) override {}
    void SetForeColour(platform::Colour) override {}
    void Line(double, double, double, double, platform::Colour) override {}
    void Box(double, double, double, double, platform::Colour) override {}
    void FilledBox(double, double, double, double, platform::Colour) override {}
    void Point(double, double, platform::Colour) override {}
    void SetFontName(std::string_view) override {}
    void SetFontSize(double points) override { m_size = points; }
    void SetFontBold(bool) override {}
    void SetFontItalic(bool) override {}
    void SetTextPosition(double, double) override {}
    void PrintText(std::string_view) override {}
    double TextWidth(std::string_view t) override {
        return 0.6 * m_size * static_cast<double>(t.size());
    }
    double TextHeight(std::string_view) override { return 1.5 * m_size; }
    double ScaleWidth() const override { return 1000; }
    double ScaleHeight() const override { return 700; }

private:
    double m_size = 8;
};

void BM_DrawLoadedChartNullSurface(benchmark::State& state) {
    Setup s;
    NullSurface surface;
    chart::Chart c;
    const chart::PlotGeometry g = chart::ComputePlotGeometry(1000, 700, s.request);
    if (!s.source.Load({kRecords - 471, kRecords, 'A', true, 4}, c.Series)) return;
    (void)c.Stream.Open(s.stream, false);
    const chart::DrawInputs in{s.request, s.defaults, s.name, s.palette, s.fonts};
    for (auto _ : state)
        if (!chart::DrawLoadedChart(c, in, g, s.dialogs, surface))
            state.SkipWithError("draw failed");
    c.Stream.Close();
}
BENCHMARK(BM_DrawLoadedChartNullSurface)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
