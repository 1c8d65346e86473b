// Oscillator computations over 30,000 daily bars, at the default periods and at period 200:
// each routine alone, all seventeen together, and the same through the table entry point.
// Each routine returns fresh arrays of about 1 to 5 MB; with glibc's default heap trimming
// that memory goes back to the system between routines and every pass pays a page fault a
// page again. The programs keep freed memory for reuse (platform/heap.h), and so does this
// benchmark; --default-heap measures the library's default behaviour instead.
#include "osc/atr_volatility_obv.h"
#include "osc/compare_osc.h"
#include "osc/directional.h"
#include "osc/macd_coppock_elder.h"
#include "osc/momentum_roc.h"
#include "osc/osc_compute.h"
#include "osc/rsi.h"
#include "osc/stoch_fx.h"
#include "osc/williams_holy_grail.h"
#include "platform/heap.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <random>
#include <string_view>

namespace {

using namespace kori;
using namespace kori::osc;

constexpr int kBars = 30000;

const char* const kNames[] = {"ATR", "STO", "FX",  "ROC", "RMX", "RMO", "R/F", "RSI", "MACD",
                              "WMS", "ERY", "MOM", "DM",  "JHG", "COP", "VTY", "OBV"};

// A random walk of daily bars with the odd no-trade day (close 0), as in a real library.
store::ChartSeries SyntheticBars(unsigned seed, float start) {
    std::mt19937 rng(seed);
    std::normal_distribution<float> step(0.0f, 0.015f);
    std::uniform_real_distribution<float> spread(0.0f, 0.02f);
    std::uniform_int_distribution<std::int32_t> volume(1000, 500000);
    store::ChartSeries s;
    s.ChartBars.resize(kBars);
    float close = start;
    for (int i = 0; i < kBars; ++i) {
        store::ChartBar& b = s.ChartBars[static_cast<std::size_t>(i)];
        close = std::max(0.05f, close * (1.0f + step(rng)));
        b.Open = close;
        b.High = close * (1.0f + spread(rng));
        b.Low = close * (1.0f - spread(rng));
        b.Close = i % 997 == 500 ? 0.0f : close;
        b.Volume = volume(rng);
    }
    s.LastBar = kBars - 1;
    return s;
}

const store::ChartSeries& Bars() {
    static const store::ChartSeries bars = SyntheticBars(7, 2.5f);
    return bars;
}
const store::ChartSeries& Reference() {
    static const store::ChartSeries bars = SyntheticBars(11, 3000.0f);
    return bars;
}

OscDef Settings(bool longPeriods) {
    OscDef def;
    if (longPeriods) {
        for (const auto& k : OscPeriodKeys())
            def.*k.DailyField = 200;
        return def;
    }
    for (const char* name : kNames)
        FillOscDefaults(def, name, false);
    def.AtrD = 14; // set in the chart defaults, not the oscillator dialog
    return def;
}

// The typed computation of one identifier, as the chart's drawing step uses it.
void ComputeTyped(std::string_view name, const OscDef& d) {
    const auto& s = Bars();
    if (name == "ATR")
        benchmark::DoNotOptimize(ComputeATR(s, d.AtrD));
    else if (name == "STO")
        benchmark::DoNotOptimize(ComputeStochFX(s, d.StochK, d.StochD, true, 4));
    else if (name == "FX")
        benchmark::DoNotOptimize(ComputeStochFX(s, d.FXF, d.FXX, false, 4));
    else if (name == "ROC")
        benchmark::DoNotOptimize(ComputeROC(s, d.RocP));
    else if (name == "RMX")
        benchmark::DoNotOptimize(ComputeRMX(s, Reference(), d.RmxP));
    else if (name == "RMO")
        benchmark::DoNotOptimize(ComputeRMO(s, Reference(), d.RmoP, 1, kBars));
    else if (name == "R/F") {
        benchmark::DoNotOptimize(ComputeROC(s, d.RocP));
        benchmark::DoNotOptimize(ComputeStochFX(s, d.FXF, d.FXX, false, 4));
    } else if (name == "RSI")
        benchmark::DoNotOptimize(ComputeRSI(s, d.RsiP));
    else if (name == "MACD")
        benchmark::DoNotOptimize(ComputeMACD(s, d.Md1, d.Md2, d.Md3));
    else if (name == "WMS")
        benchmark::DoNotOptimize(ComputeWilliams(s, d.WmsA, 4));
    else if (name == "ERY")
        benchmark::DoNotOptimize(ComputeElderRay(s, d.ERA, 4));
    else if (name == "MOM")
        benchmark::DoNotOptimize(ComputeMomentum(s, d.MMA));
    else if (name == "DM")
        benchmark::DoNotOptimize(ComputeDirectional(s, d.DMA, d.DMXA));
    else if (name == "JHG")
        benchmark::DoNotOptimize(ComputeHolyGrail(s, d.HolyD));
    else if (name == "COP")
        benchmark::DoNotOptimize(ComputeCoppock(s, d.CopD));
    else if (name == "VTY")
        benchmark::DoNotOptimize(ComputeVolatility(s, d.VtyD));
    else if (name == "OBV")
        benchmark::DoNotOptimize(ComputeOBV(s));
}

void BM_Oscillator(benchmark::State& state, const char* name, bool longPeriods) {
    const OscDef def = Settings(longPeriods);
    Bars();
    Reference();
    for (auto _ : state)
        ComputeTyped(name, def);
}

void BM_AllSeventeen(benchmark::State& state) {
    const OscDef def = Settings(state.range(0) != 0);
    Bars();
    Reference();
    for (auto _ : state)
        for (const char* name : kNames)
            ComputeTyped(name, def);
}
BENCHMARK(BM_AllSeventeen)->Arg(0)->Arg(1)->ArgName("period200")->Unit(benchmark::kMillisecond);

void BM_AllSeventeenAsTables(benchmark::State& state) {
    const OscDef def = Settings(state.range(0) != 0);
    OscInputs in;
    in.SlowStochastic = true;
    in.CompareFile = &Reference();
    for (auto _ : state)
        for (const char* name : kNames)
            benchmark::DoNotOptimize(ComputeOscillator(name, Bars(), def, in));
}
BENCHMARK(BM_AllSeventeenAsTables)
    ->Arg(0)
    ->Arg(1)
    ->ArgName("period200")
    ->Unit(benchmark::kMillisecond);

const int kRegistered = [] {
    for (const char* name : kNames) {
        for (bool longPeriods : {false, true}) {
            const std::string label =
                std::string("BM_Oscillator/") + name + (longPeriods ? "/200" : "/default");
            benchmark::RegisterBenchmark(label.c_str(), BM_Oscillator, name, longPeriods)
                ->Unit(benchmark::kMicrosecond);
        }
    }
    return 0;
}();

} // namespace

int main(int argc, char** argv) {
    bool defaultHeap = false;
    int kept = 1;
    for (int i = 1; i < argc; ++i) {
        if (std::strcmp(argv[i], "--default-heap") == 0)
            defaultHeap = true;
        else
            argv[kept++] = argv[i];
    }
    argc = kept;
    if (!defaultHeap) kori::platform::KeepFreedMemoryForReuse();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
