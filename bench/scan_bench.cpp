// The scans over the whole synthetic market, beside the floor of market_bench (every price file
// read once, and the shared walk alone).
#include "synthetic_market.h"

#include "osc/osc_settings.h"
#include "platform/progress.h"
#include "scan/chart_scans.h"
#include "scan/cht_scan1.h"
#include "scan/statistics.h"
#include "store/security_walk.h"

#include <benchmark/benchmark.h>

#include <cstdlib>

namespace {

using namespace kori;

osc::OscDef Settings() {
    osc::OscDef d;
    d.StochK = 10;
    d.StochD = 5;
    d.WmsA = 7;
    d.RocP = 21;
    d.RsiP = 14;
    return d;
}

void BM_ForEachSecurity(benchmark::State& state) {
    const store::SecurityList list{bench::DefaultMarket(), 0};
    platform::NullProgress progress;
    for (auto _ : state) {
        const auto r = store::ForEachSecurity(
            list, progress, [](const store::WalkItem&) { return store::WalkStep::Continue; });
        benchmark::DoNotOptimize(r.Visited);
    }
}
BENCHMARK(BM_ForEachSecurity)->Unit(benchmark::kMillisecond)->UseRealTime();

// Every oscillator and every indication ticked, with rises and falls.
void BM_Scan1Everything(benchmark::State& state) {
    scan::Scan1Options o;
    o.Rise = o.Fall = true;
    o.Osc = {true, true, true, true, true};
    o.Indications = {true, true, true, true};
    const auto def = Settings();
    platform::NullProgress progress;
    std::size_t rows = 0;
    for (auto _ : state) {
        const auto r = scan::RunScan1(bench::DefaultMarket(), o, def, progress);
        rows = r.Rows.size();
        benchmark::DoNotOptimize(rows);
    }
    state.counters["rows"] = static_cast<double>(rows);
}
BENCHMARK(BM_Scan1Everything)->Unit(benchmark::kMillisecond)->UseRealTime();

// Without rate of change and momentum: the oscillators that need only the last bars.
void BM_Scan1TailOscillators(benchmark::State& state) {
    scan::Scan1Options o;
    o.Rise = o.Fall = true;
    o.Osc = {true, true, false, false, true};
    o.Indications = {true, true, true, true};
    const auto def = Settings();
    platform::NullProgress progress;
    for (auto _ : state)
        benchmark::DoNotOptimize(
            scan::RunScan1(bench::DefaultMarket(), o, def, progress).Rows.size());
}
BENCHMARK(BM_Scan1TailOscillators)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_Scan2(benchmark::State& state) {
    scan::Scan2Options o;
    o.Volume = true;
    o.VolumeDays = "20";
    o.VolumePercent = "100";
    o.Price = true;
    o.PricePercent = "3";
    platform::NullProgress progress;
    for (auto _ : state)
        benchmark::DoNotOptimize(scan::RunScan2(bench::DefaultMarket(), o, progress).Rows.size());
}
BENCHMARK(BM_Scan2)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_Scan3(benchmark::State& state) {
    scan::Scan3Options o;
    o.Up = o.Down = true;
    platform::NullProgress progress;
    for (auto _ : state)
        benchmark::DoNotOptimize(scan::RunScan3(bench::DefaultMarket(), o, progress).Rows.size());
}
BENCHMARK(BM_Scan3)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_Scan6(benchmark::State& state) {
    scan::Scan6Options o;
    o.Av1D = 10;
    o.Av2D = 30;
    platform::NullProgress progress;
    for (auto _ : state)
        benchmark::DoNotOptimize(scan::RunScan6(bench::DefaultMarket(), o, progress).Rows.size());
}
BENCHMARK(BM_Scan6)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_Statistics(benchmark::State& state) {
    platform::NullProgress progress;
    for (auto _ : state) {
        scan::MarketStatistics stats;
        if (!stats.Check(bench::DefaultMarket(), "ALL", progress))
            state.SkipWithError("statistics failed");
        benchmark::DoNotOptimize(stats.Movers().size());
    }
}
BENCHMARK(BM_Statistics)->Unit(benchmark::kMillisecond)->UseRealTime();

// An advance-decline series of 5000 records, recomputed and rewritten.
void BM_ADTotals(benchmark::State& state) {
    const auto dir = std::filesystem::temp_directory_path() / "kori-bench-adtotals";
    std::filesystem::create_directories(dir);
    const auto file = dir / "ADV.WDT";
    std::string bytes;
    for (int i = 0; i < 5000; ++i) {
        store::PriceRecord r;
        r.Date = "20261120";
        r.High = static_cast<float>(300 + i % 200);
        r.Low = static_cast<float>(350 - i % 150);
        r.Close = static_cast<float>(10000 + i);
        const auto b = r.Encode();
        bytes.append(b.data(), b.size());
    }
    if (!platform::WriteFileAtomic(file, bytes)) state.SkipWithError("cannot write");
    for (auto _ : state) {
        double base = 0;
        std::int32_t total = 0;
        if (!scan::ADBaseValue(file, base) || !scan::CheckADTotals(file, base, total))
            state.SkipWithError("recompute failed");
        benchmark::DoNotOptimize(total);
    }
    std::filesystem::remove_all(dir);
}
BENCHMARK(BM_ADTotals)->Unit(benchmark::kMicrosecond)->UseRealTime();

} // namespace

BENCHMARK_MAIN();
