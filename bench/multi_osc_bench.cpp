// The multi-oscillator chart of the sample library's KRM, 1000 x 700, daily bars: the price
// chart and the five oscillators of a full set into one stream, on a recording surface and on a
// picture through the Qt surface; beside it the chart with one oscillator panel as the floor.
#include "app/chart_build.h"
#include "app/multi_osc_chart.h"
#include "app/osc_service.h"
#include "app/sample_library.h"
#include "app/session.h"
#include "app/start_up.h"
#include "chart/chart_defaults.h"
#include "gui/paint/qt_surface.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "store/name_file.h"

#include <benchmark/benchmark.h>

#include <QGuiApplication>

#include <filesystem>

using namespace kori;

namespace {

struct Library {
    std::filesystem::path root =
        std::filesystem::temp_directory_path() / "kori-bench-multi-osc-root";
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::SettingsStore settings{Prepare(root) / "settings.ini"};
    platform::FixedClock clock{"20261120"};
    app::Session session{root, platform::Services{dialogs, progress, settings, clock}};
    app::ChartJob job;
    osc::MultiOscSet full{{"RSI", "MACD", "Stochastic (Slow)", "Directional Movement", "OBV"}};
    bool ok = false;

    static std::filesystem::path Prepare(const std::filesystem::path& root) {
        std::filesystem::remove_all(root);
        std::filesystem::create_directories(root);
        return root;
    }
    Library() {
        dialogs.QueueAnswer(platform::Answer::Yes);
        dialogs.QueueAnswer(platform::Answer::No);
        app::InitialiseSession(session, "");
        app::SampleSummary summary;
        if (!app::MakeSampleLibrary(session.folders.SystemFolder, session.folders.DataFolder,
                                    settings, summary))
            return;
        platform::Status why;
        const auto found = store::FindCode(session.folders.DataFolder, "KRM", why);
        if (!found) return;
        job.Name = found->Record;
        job.Defaults = chart::LoadChartDefaults(session.ini());
        job.Request.ChartStyle = 'B';
        job.Request.ChartPeriod = 'A';
        job.Request.BarSpacing = 4;
        ok = true;
    }
    ~Library() { std::filesystem::remove_all(root); }
};

void BM_MultiOscChartFivePanels(benchmark::State& state) {
    Library lib;
    if (!lib.ok) state.SkipWithError("no sample library");
    platform::RecordingSurface area(1000, 700);
    for (auto _ : state) {
        area.ClearCalls();
        chart::Chart c;
        if (!app::BuildMultiOscChart(lib.session, lib.job, 1, lib.full, c, area).Status)
            state.SkipWithError("build failed");
    }
    state.counters["calls"] = static_cast<double>(area.calls().size());
}
BENCHMARK(BM_MultiOscChartFivePanels)->Unit(benchmark::kMillisecond);

void BM_MultiOscChartFivePanelsToPicture(benchmark::State& state) {
    Library lib;
    if (!lib.ok) state.SkipWithError("no sample library");
    for (auto _ : state) {
        gui::ImageSurface area(1000, 700);
        chart::Chart c;
        if (!app::BuildMultiOscChart(lib.session, lib.job, 1, lib.full, c, area).Status)
            state.SkipWithError("build failed");
        benchmark::DoNotOptimize(area.Finish());
    }
}
BENCHMARK(BM_MultiOscChartFivePanelsToPicture)->Unit(benchmark::kMillisecond);

// The floor: the same chart with the single RSI panel of the chart window.
void BM_ChartWithOnePanel(benchmark::State& state) {
    Library lib;
    if (!lib.ok) state.SkipWithError("no sample library");
    lib.job.Request.AutoOsc = true;
    lib.job.Request.AutoOscCode = "RSI";
    platform::RecordingSurface area(1000, 700);
    for (auto _ : state) {
        area.ClearCalls();
        chart::Chart c;
        if (!app::BuildChartWithPanel(lib.session, lib.job, c, area).Status)
            state.SkipWithError("build failed");
    }
}
BENCHMARK(BM_ChartWithOnePanel)->Unit(benchmark::kMillisecond);

} // namespace

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
