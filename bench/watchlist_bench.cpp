// A watchlist of 50 securities spread over the synthetic market, worked out as the window and
// kori watchlist do, beside the floor of reading the same 50 price files whole.
#include "synthetic_market.h"

#include "platform/ini_file.h"
#include "scan/watchlist.h"

#include <benchmark/benchmark.h>

#include <cstdio>

namespace {

using namespace kori;

constexpr int kCodes = 50;

std::vector<std::string> Codes() {
    const int step = bench::MarketShape{}.Securities / kCodes;
    std::vector<std::string> codes;
    for (int i = 0; i < kCodes; ++i)
        codes.push_back(bench::SyntheticCode(i * step));
    return codes;
}

// Floor: open and read the 50 price files whole, nothing else.
void BM_ReadFiftyPriceFiles(benchmark::State& state) {
    const std::string folder = bench::DefaultMarket();
    std::string buffer(5000 * store::PriceRecord::kSize, '\0');
    const auto codes = Codes();
    for (auto _ : state) {
        std::size_t total = 0;
        for (const auto& c : codes) {
            std::FILE* fp = std::fopen((folder + c + ".WDT").c_str(), "rb");
            total += std::fread(buffer.data(), 1, buffer.size(), fp);
            std::fclose(fp);
        }
        benchmark::DoNotOptimize(total);
    }
}
BENCHMARK(BM_ReadFiftyPriceFiles)->Unit(benchmark::kMillisecond)->UseRealTime();

// The 50 rows: the name file read once, the last 400 records of each price file, the day's
// figures and the year's range, the entry against the close, and a target on each code.
void BM_Watchlist50(benchmark::State& state) {
    const std::string folder = bench::DefaultMarket();
    scan::Watchlist list{"Bench", {}};
    std::vector<store::TargetLine> targets;
    for (const auto& c : Codes()) {
        list.Entries.push_back({c, "20200102", 10.0, 100, "bench"});
        targets.push_back({c, "10.00", "U"});
    }
    const auto settings = scan::SnapshotSettingsFrom(platform::IniFile(folder + "Kori.ini"));
    std::size_t priced = 0;
    for (auto _ : state) {
        const auto rows = scan::ComputeWatchlist(list, folder, targets, settings);
        priced = 0;
        for (const auto& r : rows)
            priced += r.Close.has_value();
        benchmark::DoNotOptimize(rows.data());
    }
    state.counters["priced"] = static_cast<double>(priced);
}
BENCHMARK(BM_Watchlist50)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

BENCHMARK_MAIN();
