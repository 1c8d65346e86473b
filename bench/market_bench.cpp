// The floor of every walk over the whole market: read each price file once, and the shared walk
// over the name file that the scans, the update and the repair tools stand on.
#include "synthetic_market.h"

#include "maint/data_check.h"
#include "maint/text_export.h"
#include "platform/progress.h"
#include "scan/snapshot.h"
#include "store/security_walk.h"

#include <benchmark/benchmark.h>

#include <cstdlib>

#include <fcntl.h>
#include <unistd.h>

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

// The data check of the whole market: every file read whole and every record looked at.
void BM_DataCheckWholeMarket(benchmark::State& state) {
    const store::SecurityList list{bench::DefaultMarket(), 0};
    platform::NullProgress progress;
    std::size_t findings = 0;
    for (auto _ : state) {
        const auto result = maint::CheckLibrary(list, {}, progress);
        findings = result.Findings.size();
    }
    state.counters["findings"] = static_cast<double>(findings);
}
BENCHMARK(BM_DataCheckWholeMarket)->Unit(benchmark::kMillisecond)->UseRealTime();

// The closing prices of one day (the latest, named) for every security.
void BM_ExportClosesForADate(benchmark::State& state) {
    const store::SecurityList list{bench::DefaultMarket(), 0};
    platform::NullProgress progress;
    const std::string date = maint::ExportCloses(list, "", progress).Date;
    int lines = 0;
    for (auto _ : state)
        lines = maint::ExportCloses(list, date, progress).Lines;
    state.counters["lines"] = lines;
}
BENCHMARK(BM_ExportClosesForADate)->Unit(benchmark::kMillisecond)->UseRealTime();

// Its floor: open each price file and read its last record, nothing else.
void BM_ReadLastRecordOfEveryFile(benchmark::State& state) {
    const std::string folder = bench::DefaultMarket();
    std::vector<std::string> files;
    for (int i = 0; i < bench::MarketShape{}.Securities; ++i)
        files.push_back(folder + bench::SyntheticCode(i) + ".WDT");
    char record[store::PriceRecord::kSize];
    for (auto _ : state) {
        std::size_t total = 0;
        for (const auto& f : files) {
            const int fd = ::open(f.c_str(), O_RDONLY | O_CLOEXEC);
            const off_t end = ::lseek(fd, 0, SEEK_END);
            total += static_cast<std::size_t>(
                ::pread(fd, record, sizeof record, end - static_cast<off_t>(sizeof record)));
            ::close(fd);
        }
        benchmark::DoNotOptimize(total);
    }
}
BENCHMARK(BM_ReadLastRecordOfEveryFile)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace

BENCHMARK_MAIN();
