// Back-up of the whole 2000 x 5000 synthetic market (500 MB) to one archive, and the check of
// every file of it against the manifest, the first half of a restore.
#include "synthetic_market.h"

#include "maint/backup.h"
#include "platform/progress.h"

#include <benchmark/benchmark.h>

#include <filesystem>

namespace {

using namespace kori;

std::string ArchivePath() {
    return (std::filesystem::temp_directory_path() / "kori-bench-backup.tar.zst").string();
}

void BM_BackupWholeMarket(benchmark::State& state) {
    const std::string folder = bench::DefaultMarket();
    platform::NullProgress progress;
    const auto places = maint::LibraryPlaces(folder, {});
    long long bytes = 0;
    for (auto _ : state) {
        const auto r = maint::WriteBackup(places, ArchivePath(), progress);
        if (!r.Status) state.SkipWithError(r.Status.message().c_str());
        bytes = r.Bytes;
    }
    state.counters["MB"] = static_cast<double>(bytes) / 1e6;
    state.counters["archive_MB"] =
        static_cast<double>(std::filesystem::file_size(ArchivePath())) / 1e6;
}
BENCHMARK(BM_BackupWholeMarket)->Unit(benchmark::kSecond)->UseRealTime()->Iterations(1);

void BM_VerifyBackup(benchmark::State& state) {
    platform::NullProgress progress;
    if (!std::filesystem::exists(ArchivePath()))
        maint::WriteBackup(maint::LibraryPlaces(bench::DefaultMarket(), {}), ArchivePath(),
                           progress);
    for (auto _ : state) {
        const auto plan = maint::VerifyBackup(ArchivePath(), progress);
        if (!plan.Status) state.SkipWithError(plan.Status.message().c_str());
    }
}
BENCHMARK(BM_VerifyBackup)->Unit(benchmark::kSecond)->UseRealTime()->Iterations(2);

} // namespace

BENCHMARK_MAIN();
