#pragma once
// What the chart benchmarks share: a synthetic 30,000-record daily history (in memory, as a
// price source, or as price records for a file), the settings of a plain 1000 x 700 daily bar
// chart, and a surface that takes drawing calls and does nothing with them.
#include "chart/build_chart.h"
#include "platform/dialogs.h"
#include "store/price_file.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <filesystem>
#include <string>
#include <vector>

namespace kori::bench {

inline constexpr int kRecords = 30000;

// Record i of the history: weekday-like dates, a slow wave (plus a faster one of amplitude
// `ripple`) and volumes that vary without pattern.
inline store::PriceRecord SyntheticRecord(int i, float ripple = 0) {
    store::PriceRecord r;
    char date[16];
    std::snprintf(date, sizeof date, "%04d%02d%02d", 1900 + i / 250, 1 + (i / 21) % 12, 1 + i % 21);
    r.Date = date;
    const float x = static_cast<float>(i);
    const float mid =
        20 + 8 * std::sin(x / 300) + ripple * std::sin(x / 13) + static_cast<float>(i % 7) * 0.1f;
    r.Open = mid - 0.2f;
    r.High = mid + 0.5f;
    r.Low = mid - 0.5f;
    r.Close = mid + 0.1f;
    r.Volume = 10000 + (i * 7919) % 50000;
    return r;
}

// The history in memory; a load copies the window as the daily rules keep it.
class HistorySource : public chart::PriceSource {
public:
    explicit HistorySource(float ripple = 0) {
        m_bars.reserve(kRecords);
        for (int i = 0; i < kRecords; ++i) {
            const store::PriceRecord r = SyntheticRecord(i, ripple);
            store::ChartBar b;
            b.SetDate(r.Date);
            b.Open = r.Open;
            b.High = r.High;
            b.Low = r.Low;
            b.Close = r.Close;
            b.Volume = r.Volume;
            m_bars.push_back(b);
        }
    }
    std::string FileName() const override { return "BENCH.WDT"; }
    std::int16_t RecordCount() override { return static_cast<std::int16_t>(kRecords); }
    std::string DateOf(std::int16_t rec) override {
        return std::string(m_bars[static_cast<std::size_t>(rec - 1)].DateText());
    }
    std::string NoteText(std::int16_t) override { return {}; }
    platform::Status Load(const store::SeriesRequest& req, store::ChartSeries& s) override {
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

// A daily bar chart with volume, spacing 2, and the stream written to `streamName` in the
// temporary folder.
struct ChartSetup {
    platform::Palette palette{};
    platform::ChartFonts fonts;
    chart::ChartDefaults defaults;
    chart::ChartName name{"BENCH", "BENCHMARK SECURITY", "", 4, 0, 0, 5, 5};
    chart::ChartRequest request;
    platform::ScriptedDialogs dialogs;
    std::filesystem::path stream;

    explicit ChartSetup(const char* streamName)
        : stream(std::filesystem::temp_directory_path() / streamName) {
        for (std::size_t i = 0; i < palette.size(); ++i)
            palette[i] = static_cast<platform::Colour>(i * 0x10101);
        request.ChartStyle = 'B';
        request.BarSpacing = 2;
        request.ShowVolume = true;
    }
    ~ChartSetup() { std::filesystem::remove(stream); }
    ChartSetup(const ChartSetup&) = delete;
    ChartSetup& operator=(const ChartSetup&) = delete;

    chart::ChartBuild Build() {
        return chart::ChartBuild{request, defaults, name, palette, fonts, dialogs, stream};
    }
};

// Builds the chart again and again on a recording surface, counting bars and drawing calls.
inline void RunChartBuild(benchmark::State& state, ChartSetup& setup, chart::PriceSource& source,
                          platform::RecordingSurface& surface) {
    chart::Chart c;
    const chart::ChartBuild build = setup.Build();
    for (auto _ : state) {
        surface.ClearCalls();
        if (!chart::BuildChart(c, build, source, surface)) state.SkipWithError("build failed");
        benchmark::DoNotOptimize(c.BarCloseY.data());
    }
    state.counters["bars"] = c.LastBar() + 1;
    state.counters["calls"] = static_cast<double>(surface.calls().size());
}

// Takes the calls and draws nothing: what the drawing code itself costs. Text is measured as
// a plain proportional font would be.
class NullSurface : public platform::Surface {
public:
    NullSurface(double width, double height) : m_width(width), m_height(height) {}
    void Clear() override {}
    void SetBackColour(platform::Colour) override {}
    void SetLineWidth(int) override {}
    void SetLineStyle(platform::LineStyle) override {}
    void SetForeColour(platform::Colour) override {}
    void Line(double x1, double y1, double, double, platform::Colour) override {
        benchmark::DoNotOptimize(x1 + y1);
    }
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
    double ScaleWidth() const override { return m_width; }
    double ScaleHeight() const override { return m_height; }

private:
    double m_width, m_height;
    double m_size = 8;
};

} // namespace kori::bench
