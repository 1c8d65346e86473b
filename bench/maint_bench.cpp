// The maintenance tools against their floors: the duplicate-date repair over a whole synthetic
// market, the name-file sort of the editor on a full file, and the data editor's load of a long
// price file. Each floor reads (and where the tool writes, writes) the same bytes and does
// nothing else.
#include "app/data_form_model.h"
#include "maint/rem_dup_st.h"
#include "maint/repair_result.h"
#include "platform/dialogs.h"
#include "platform/files.h"
#include "platform/progress.h"
#include "store/name_editor.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "synthetic_market.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

using namespace kori;
namespace fs = std::filesystem;

namespace {

fs::path BenchRoot() {
    static const fs::path root = [] {
        auto d = fs::temp_directory_path() / "kori-maint-bench";
        fs::create_directories(d);
        return d;
    }();
    return root;
}

const std::string& Market() {
    static const std::string folder =
        bench::MakeSyntheticMarket(BenchRoot() / "market", bench::MarketShape{3000, 5000});
    return folder;
}

// A fresh copy of the market for one run, made outside the timing.
std::string CopyOfMarket() {
    const fs::path work = BenchRoot() / "work";
    fs::remove_all(work);
    fs::copy(Market(), work);
    return work.string() + "/";
}

void BM_RemDupST_Market3000(benchmark::State& state) {
    platform::NullProgress progress;
    for (auto _ : state) {
        state.PauseTiming();
        const std::string folder = CopyOfMarket();
        state.ResumeTiming();
        const auto r = maint::RemDupST(folder, progress);
        if (!r.Done || r.Issues.size() != 0) state.SkipWithError("repair did not finish cleanly");
        benchmark::DoNotOptimize(r);
    }
    state.SetBytesProcessed(state.iterations() * 3000LL * 5000 * 50);
}
BENCHMARK(BM_RemDupST_Market3000)->Unit(benchmark::kMillisecond)->Iterations(3);

// Floor: every price file of the market read, and its bytes written to a new file beside it
// that takes its place (no sync: the floor of the bytes alone).
void BM_RemDupST_Floor(benchmark::State& state) {
    for (auto _ : state) {
        state.PauseTiming();
        const std::string folder = CopyOfMarket();
        state.ResumeTiming();
        for (int i = 0; i < 3000; ++i) {
            const std::string path = folder + bench::SyntheticCode(i) + ".WDT";
            const auto bytes = maint::ReadFileBytes(path);
            std::ofstream(path + ".new", std::ios::binary)
                .write(bytes->data(), static_cast<std::streamsize>(bytes->size()));
            std::rename((path + ".new").c_str(), path.c_str());
        }
    }
    state.SetBytesProcessed(state.iterations() * 3000LL * 5000 * 50);
}
BENCHMARK(BM_RemDupST_Floor)->Unit(benchmark::kMillisecond)->Iterations(3);

// What a rewritten file costs: 50 securities, each with one date twice, so each one is sorted,
// cut and replaced through the gate (synced to disk).
void BM_RemDupST_EveryFileRewritten50(benchmark::State& state) {
    const fs::path dir = BenchRoot() / "dups";
    for (auto _ : state) {
        state.PauseTiming();
        fs::remove_all(dir);
        fs::create_directories(dir);
        std::vector<store::NameRecord> names;
        for (int i = 0; i < 50; ++i) {
            const std::string code = bench::SyntheticCode(i);
            store::NameRecord n;
            n.Code = code;
            names.push_back(n);
            auto bytes = *maint::ReadFileBytes(Market() + code + ".WDT");
            bytes += bytes.substr(bytes.size() - 50); // the last day twice
            std::ofstream(dir / (code + ".WDT"), std::ios::binary)
                .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        }
        (void)store::NameFile(dir / "Names.dat").WriteAll(names);
        platform::NullProgress progress;
        state.ResumeTiming();
        const auto r = maint::RemDupST(dir.string() + "/", progress);
        if (r.FilesChanged != 50) state.SkipWithError("not every file was rewritten");
    }
}
BENCHMARK(BM_RemDupST_EveryFileRewritten50)->Unit(benchmark::kMillisecond)->Iterations(3);

std::vector<store::NameRecord> FullNameFile() {
    std::vector<store::NameRecord> names;
    for (int i = 32767; i >= 1; --i) {
        store::NameRecord n;
        n.Code = "C" + std::to_string((i * 7919) % 32768);
        n.Name = "Security " + std::to_string(i);
        n.Category = static_cast<std::int16_t>(i % 100);
        n.IndustryClass = std::to_string(100 + i % 900);
        names.push_back(n);
    }
    return names;
}

void BM_SortNameFile32767(benchmark::State& state) {
    const auto names = FullNameFile();
    const std::string folder = (BenchRoot() / "names").string() + "/";
    fs::create_directories(folder);
    platform::NullProgress progress;
    const auto order = static_cast<store::NameSortOrder>(state.range(0));
    for (auto _ : state) {
        std::vector<store::NameRecord> sorted;
        if (!store::SortNamesThroughFiles(folder, names, order, progress, sorted).ok())
            state.SkipWithError("sort failed");
        benchmark::DoNotOptimize(sorted);
    }
}
BENCHMARK(BM_SortNameFile32767)
    ->Arg(static_cast<int>(store::NameSortOrder::Code))
    ->Arg(static_cast<int>(store::NameSortOrder::Category))
    ->Unit(benchmark::kMillisecond);

// Floor of the sort: the records encoded and written twice, read back twice (its two scratch
// files), no keys and no sort.
void BM_SortNameFile32767_Floor(benchmark::State& state) {
    const auto names = FullNameFile();
    const fs::path dir = BenchRoot() / "names";
    fs::create_directories(dir);
    for (auto _ : state) {
        for (const char* file : {"Floor.WK2", "Floor.Wk1"}) {
            std::string bytes;
            for (const auto& n : names) {
                const auto b = n.Encode();
                bytes.append(b.data(), b.size());
            }
            std::ofstream(dir / file, std::ios::binary)
                .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
            std::vector<store::NameRecord> back;
            (void)store::NameFile(dir / file).ReadAll(back);
            benchmark::DoNotOptimize(back);
        }
    }
}
BENCHMARK(BM_SortNameFile32767_Floor)->Unit(benchmark::kMillisecond);

fs::path LongPriceFile() {
    const fs::path path = BenchRoot() / "LONG.WDT";
    if (platform::FileSizeOr0(path) != 30000u * 50) {
        const auto dates = bench::SyntheticWeekdays("20261120", 30000);
        std::vector<store::PriceRecord> recs;
        for (int i = 0; i < 30000; ++i) {
            store::PriceRecord r;
            r.Date = dates[static_cast<std::size_t>(i)];
            r.Open = 10.0f + static_cast<float>(i % 97) * 0.01f;
            r.High = r.Open + 0.2f;
            r.Low = r.Open - 0.2f;
            r.Close = r.Open + 0.05f;
            r.Volume = 1000 + i % 5000;
            recs.push_back(r);
        }
        (void)store::PriceFile(path).WriteAll(recs);
    }
    return path;
}

void BM_DataEditorLoad30000(benchmark::State& state) {
    const auto path = LongPriceFile();
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    for (auto _ : state) {
        app::DataFormModel model(path, "LONG", dialogs, progress);
        if (!model.ShowData() || model.grid().rowCount() != 30000)
            state.SkipWithError("load failed");
        benchmark::DoNotOptimize(model.grid().rows().data());
    }
}
BENCHMARK(BM_DataEditorLoad30000)->Unit(benchmark::kMillisecond);

// Floor of the load: the file's bytes read.
void BM_DataEditorLoad30000_Floor(benchmark::State& state) {
    const auto path = LongPriceFile();
    for (auto _ : state) {
        auto bytes = maint::ReadFileBytes(path);
        benchmark::DoNotOptimize(bytes);
    }
}
BENCHMARK(BM_DataEditorLoad30000_Floor)->Unit(benchmark::kMillisecond);

} // namespace

BENCHMARK_MAIN();
