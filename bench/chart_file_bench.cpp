// The chart as the program makes it: a 30,000-record price file on disk (in the page cache after
// the first pass), read through the file source, built as a 1000 x 700 daily bar chart with
// volume and the stream written; once on a recording surface and once to a PNG picture through
// the Qt surface, encoding included.
#include "chart/build_chart.h"
#include "chart/file_price_source.h"
#include "gui/paint/qt_surface.h"
#include "platform/dialogs.h"
#include "store/price_file.h"

#include <benchmark/benchmark.h>

#include <QBuffer>
#include <QGuiApplication>

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <memory>

using namespace kori;

namespace {

constexpr int kRecords = 30000;

std::filesystem::path WriteHistory() {
    const auto dir = std::filesystem::temp_directory_path() / "kori-bench-chart-file";
    std::filesystem::create_directories(dir);
    const auto path = dir / "BENCH.WDT";
    std::vector<store::PriceRecord> records;
    records.reserve(kRecords);
    for (int i = 0; i < kRecords; ++i) {
        store::PriceRecord r;
        char date[16];
        std::snprintf(date, sizeof date, "%04d%02d%02d", 1900 + i / 250, 1 + (i / 21) % 12,
                      1 + i % 21);
        r.Date = date;
        const float mid =
            20 + 8 * std::sin(static_cast<float>(i) / 300) + static_cast<float>(i % 7) * 0.1f;
        r.Open = mid - 0.2f;
        r.High = mid + 0.5f;
        r.Low = mid - 0.5f;
        r.Close = mid + 0.1f;
        r.Volume = 10000 + (i * 7919) % 50000;
        records.push_back(r);
    }
    std::filesystem::remove(path);
    store::PriceFile file(path);
    if (!file.Open() || !file.WriteAll(records)) return {};
    return path;
}

struct Setup {
    platform::Palette palette{};
    platform::ChartFonts fonts;
    chart::ChartDefaults defaults;
    chart::ChartName name{"BENCH", "BENCHMARK SECURITY", "", 4, 0, 0, 5, 5};
    chart::ChartRequest request;
    platform::ScriptedDialogs dialogs;
    std::filesystem::path file = WriteHistory();
    std::filesystem::path stream = file.parent_path() / "TCht.Tmp";
    chart::ChartBuild build{request, defaults, name, palette, fonts, dialogs, stream};
    Setup() {
        for (std::size_t i = 0; i < palette.size(); ++i)
            palette[i] = static_cast<platform::Colour>(i * 0x10101);
        request.ChartStyle = 'B';
        request.BarSpacing = 2;
        request.ShowVolume = true;
    }
    ~Setup() { std::filesystem::remove_all(file.parent_path()); }

    bool Build(platform::Surface& surface) {
        chart::Chart c;
        chart::FilePriceSource source(file);
        return source.Open().ok() && chart::BuildChart(c, build, source, surface).ok();
    }
};

void BM_BuildChartFromFile(benchmark::State& state) {
    Setup s;
    platform::RecordingSurface surface{1000, 700};
    for (auto _ : state) {
        surface.ClearCalls();
        if (!s.Build(surface)) state.SkipWithError("build failed");
    }
    state.counters["calls"] = static_cast<double>(surface.calls().size());
}
BENCHMARK(BM_BuildChartFromFile)->Unit(benchmark::kMicrosecond);

void BM_ChartFromFileToPng(benchmark::State& state) {
    Setup s;
    std::size_t pngBytes = 0;
    for (auto _ : state) {
        gui::ImageSurface area(1000, 700);
        if (!s.Build(area)) state.SkipWithError("build failed");
        QByteArray png;
        QBuffer buffer(&png);
        buffer.open(QIODevice::WriteOnly);
        if (!area.Finish().save(&buffer, "PNG")) state.SkipWithError("encoding failed");
        pngBytes = static_cast<std::size_t>(png.size());
    }
    state.counters["png_bytes"] = static_cast<double>(pngBytes);
}
BENCHMARK(BM_ChartFromFileToPng)->Unit(benchmark::kMillisecond);

} // namespace

int main(int argc, char** argv) {
    // Fonts and painting need a Qt application; no display is needed.
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
