// The chart as the program makes it: a 30,000-record price file on disk (in the page cache after
// the first pass), read through the file source, built as a 1000 x 700 daily bar chart with
// volume and the stream written; once on a recording surface and to a PNG picture through the
// raster surface and through the Qt surface, encoding included.
#include "bench_history.h"
#include "chart/build_chart.h"
#include "chart/file_price_source.h"
#include "gui/paint/qt_surface.h"
#include "raster/raster_surface.h"

#include <benchmark/benchmark.h>

#include <QBuffer>
#include <QGuiApplication>

#include <filesystem>
#include <memory>

using namespace kori;

namespace {

std::filesystem::path WriteHistory() {
    const auto dir = std::filesystem::temp_directory_path() / "kori-bench-chart-file";
    std::filesystem::create_directories(dir);
    const auto path = dir / "BENCH.WDT";
    std::vector<store::PriceRecord> records;
    records.reserve(bench::kRecords);
    for (int i = 0; i < bench::kRecords; ++i)
        records.push_back(bench::SyntheticRecord(i));
    std::filesystem::remove(path);
    store::PriceFile file(path);
    if (!file.Open() || !file.WriteAll(records)) return {};
    return path;
}

struct Setup : bench::ChartSetup {
    std::filesystem::path file = WriteHistory();
    chart::ChartBuild build = Build();
    Setup() : ChartSetup("kori-bench-file-TCht.Tmp") {}
    ~Setup() { std::filesystem::remove_all(file.parent_path()); }

    bool Draw(platform::Surface& surface) {
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
        if (!s.Draw(surface)) state.SkipWithError("build failed");
    }
    state.counters["calls"] = static_cast<double>(surface.calls().size());
}
BENCHMARK(BM_BuildChartFromFile)->Unit(benchmark::kMicrosecond);

// What kori chart --png does: the raster surface, encoding included.
void BM_ChartFromFileToPng(benchmark::State& state) {
    Setup s;
    std::size_t pngBytes = 0;
    std::string png;
    for (auto _ : state) {
        raster::RasterSurface area(1000, 700);
        if (!s.Draw(area)) state.SkipWithError("build failed");
        if (!area.EncodePng(png)) state.SkipWithError("encoding failed");
        pngBytes = png.size();
    }
    state.counters["png_bytes"] = static_cast<double>(pngBytes);
}
BENCHMARK(BM_ChartFromFileToPng)->Unit(benchmark::kMillisecond);

// The same through the desktop's Qt surface.
void BM_ChartFromFileToPngQt(benchmark::State& state) {
    Setup s;
    std::size_t pngBytes = 0;
    for (auto _ : state) {
        gui::ImageSurface area(1000, 700);
        if (!s.Draw(area)) state.SkipWithError("build failed");
        QByteArray png;
        if (!gui::EncodePng(area.Finish(), png)) state.SkipWithError("encoding failed");
        pngBytes = static_cast<std::size_t>(png.size());
    }
    state.counters["png_bytes"] = static_cast<double>(pngBytes);
}
BENCHMARK(BM_ChartFromFileToPngQt)->Unit(benchmark::kMillisecond);

// The two halves of the above apart: drawing into the picture, and encoding it.
void BM_ChartFromFileToPicture(benchmark::State& state) {
    Setup s;
    for (auto _ : state) {
        gui::ImageSurface area(1000, 700);
        if (!s.Draw(area)) state.SkipWithError("build failed");
        benchmark::DoNotOptimize(area.Finish().constBits());
    }
}
BENCHMARK(BM_ChartFromFileToPicture)->Unit(benchmark::kMillisecond);

void BM_EncodeChartPng(benchmark::State& state) {
    Setup s;
    gui::ImageSurface area(1000, 700);
    if (!s.Draw(area)) state.SkipWithError("build failed");
    const QImage& picture = area.Finish();
    QByteArray png;
    for (auto _ : state) {
        if (!gui::EncodePng(picture, png)) state.SkipWithError("encoding failed");
    }
    state.counters["png_bytes"] = static_cast<double>(png.size());
}
BENCHMARK(BM_EncodeChartPng)->Unit(benchmark::kMillisecond);

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
