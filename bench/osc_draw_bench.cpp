// The drawing of each oscillator panel on a 1000-bar chart at the default periods: the
// computation, the scale and every line, with the stream written to a scratch file as the
// chart window writes TCht.Tmp. BM_DrawPanel's surface takes the calls and draws nothing,
// so its figures are the routine's own cost; BM_PaintPanel paints a 2100 x 210 picture
// through Qt as the screen does.
#include "bench_history.h"
#include "osc/osc_draw.h"
#include "osc/osc_identifiers.h"

#include <benchmark/benchmark.h>

#if __has_include(<QGuiApplication>)
#include "gui/paint/qt_surface.h"

#include <QGuiApplication>
#define KORI_BENCH_QT 1
#endif

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <random>
#include <string>

namespace {

using namespace kori;
using namespace kori::osc;

constexpr int kBars = 1000;

const char* const kNames[] = {"ATR", "STO", "FX",  "ROC", "RMX", "RMO", "R/F", "RSI", "MACD",
                              "WMS", "ERY", "MOM", "DM",  "JHG", "COP", "VTY", "OBV"};

store::ChartSeries SyntheticBars(unsigned seed, float start, int bars) {
    std::mt19937 rng(seed);
    std::normal_distribution<float> step(0.0f, 0.015f);
    std::uniform_real_distribution<float> spread(0.0f, 0.02f);
    std::uniform_int_distribution<std::int32_t> volume(1000, 500000);
    store::ChartSeries s;
    s.ChartBars.resize(static_cast<std::size_t>(bars));
    float close = start;
    for (int i = 0; i < bars; ++i) {
        store::ChartBar& b = s.ChartBars[static_cast<std::size_t>(i)];
        close = std::max(0.05f, close * (1.0f + step(rng)));
        b.Open = close;
        b.High = close * (1.0f + spread(rng));
        b.Low = close * (1.0f - spread(rng));
        b.Close = close;
        b.Volume = volume(rng);
    }
    s.LastBar = static_cast<std::int16_t>(bars - 1);
    return s;
}

template <class MakeSurface>
void RunPanel(benchmark::State& state, const char* name, MakeSurface makeSurface) {
    const store::ChartSeries reference = SyntheticBars(11, 3000.0f, kBars);
    chart::Chart c;
    c.Series = SyntheticBars(7, 2.5f, kBars);
    c.BarSpacing = 2;
    c.FirstRecord = 1;
    c.PlotRight = 2010;
    OscDef def;
    for (const auto& id : OscIdentifiers())
        FillOscDefaults(def, id.OscName, false);
    def.AtrD = 14;
    def.NoClassicMACD = true;
    platform::Palette palette{};
    platform::ChartFonts fonts;
    platform::ScriptedDialogs dialogs;
    OscDrawInputs in(palette, fonts, dialogs);
    in.StreamPath = std::filesystem::temp_directory_path() / "kori_osc_draw_bench.tmp";
    in.CompareFile = &reference;
    in.CompareCode = "XAO";
    in.SecurityFile = &c.Series;
    auto panel = makeSurface();
    for (auto _ : state) {
        // Each pass starts the stream afresh, as a new chart does.
        std::filesystem::remove(in.StreamPath);
        benchmark::DoNotOptimize(ShowOscillator(c, name, 'A', def, in, *panel));
    }
    std::filesystem::remove(in.StreamPath);
}

void BM_DrawPanel(benchmark::State& state, const char* name) {
    RunPanel(state, name, [] { return std::make_unique<bench::NullSurface>(2100, 210); });
}

#ifdef KORI_BENCH_QT
void BM_PaintPanel(benchmark::State& state, const char* name) {
    if (!QCoreApplication::instance()) {
        if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
        static int argc = 1;
        static char arg0[] = "kori_bench_osc_draw";
        static char* argv[] = {arg0, nullptr};
        static QGuiApplication app(argc, argv);
    }
    RunPanel(state, name, [] { return std::make_unique<gui::ImageSurface>(2100, 210); });
}
#endif

const int kRegistered = [] {
    for (const char* name : kNames)
        benchmark::RegisterBenchmark((std::string("BM_DrawPanel/") + name).c_str(), BM_DrawPanel,
                                     name)
            ->Unit(benchmark::kMicrosecond);
#ifdef KORI_BENCH_QT
    for (const char* name : kNames)
        benchmark::RegisterBenchmark((std::string("BM_PaintPanel/") + name).c_str(), BM_PaintPanel,
                                     name)
            ->Unit(benchmark::kMicrosecond);
#endif
    return 0;
}();

} // namespace

BENCHMARK_MAIN();
