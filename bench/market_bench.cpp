// The floor of every walk over the whole market: read each price file once, and the shared walk
// over the name file that the scans, the update and the repair tools stand on.
#include "synthetic_market.h"

#include "platform/progress.h"
#include "scan/snapshot.h"
#include "store/security_walk.h"

#include <benchmark/benchmark.h>

#include <cstdlib>

namespace {

using namespace kori;

// Machine floor: open and read every price file whole, nothing else.
void BM_ReadEveryPriceFile(benchmark::State& state) {
    const std::string folder = bench::DefaultMarket();
    std::vector<std::string> files;
    for (int i = 0; i < bench::MarketShape{}.Securities; ++i)
        files.push_back(folder + bench::SyntheticCode(i) + ".WDT");
    std::string buffer(5000 * store::PriceRecord::kSize, '\0');
    for (auto _ : state) {
        std::size_t total = 0;
        for (const auto& f : files) {
            std::FILE* fp = std::fopen(f.c_str(), "rb");
            total += std::fread(buffer.data(), 1, buffer.size(), fp);
            std::fclose(fp);
        }
        benchmark::DoNotOptimize(total);
    }
}
BENCHMARK(BM_ReadEveryPriceFile)->Unit(benchmark::kMillisecond)->UseRealTime();

// The shared walk alone: name file, limits, each price file's length checked.
void BM_ForEachSecurity(benchmark::State& state) {
    const store::SecurityList list{bench::DefaultMarket(), 0};
    platform::NullProgress progress;
    for (auto _ : state) {
        int seen = 0;
        const auto result = store::ForEachSecurity(list, progress, [&](const store::WalkItem&) {
            ++seen;
            return store::WalkStep::Continue;
        });
        benchmark::DoNotOptimize(result.Visited + seen);
    }
}
BENCHMARK(BM_ForEachSecurity)->Unit(benchmark::kMillisecond)->UseRealTime();

// The current snapshot of the whole market: the last 400 records of each file, three
// oscillators, two averages and the year's range, on both cores.
void BM_SnapshotWholeMarket(benchmark::State& state) {
    const store::SecurityList list{bench::DefaultMarket(), 0};
    platform::NullProgress progress;
    const auto settings =
        scan::SnapshotSettingsFrom(platform::IniFile(bench::DefaultMarket() + "Kori.ini"));
    std::size_t rows = 0;
    for (auto _ : state) {
        const auto result = scan::TakeSnapshot(list, settings, progress);
        rows = result.Rows.size();
    }
    state.counters["rows"] = static_cast<double>(rows);
}
BENCHMARK(BM_SnapshotWholeMarket)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

BENCHMARK_MAIN();
