// A manual adjustment and its removal on a 30,000-record history in the page cache, rewrite
// included, beside the floor: reading and rewriting the same file with nothing else.
#include "adjust/adjustment.h"
#include "adjust/adjustment_list.h"
#include "adjust/bulletin_filter.h"
#include "bench_history.h"
#include "platform/files.h"
#include "synthetic_market.h"

#include <benchmark/benchmark.h>

#include <filesystem>
#include <fstream>
#include <string>

using namespace kori;

namespace {

const std::string& Folder() {
    static const std::string dir = [] {
        auto d = std::filesystem::temp_directory_path() / "kori-adjust-bench";
        std::filesystem::create_directories(d);
        return d.string() + "/";
    }();
    return dir;
}

std::filesystem::path File() {
    return std::filesystem::path(Folder()) / "BIG.WDT";
}

// The history's bytes; `adjusted` puts a factor of 0.8 on the last record.
std::string History(bool adjusted) {
    std::string bytes;
    for (int i = 0; i < bench::kRecords; ++i) {
        store::PriceRecord r = bench::SyntheticRecord(i);
        if (adjusted && i == bench::kRecords - 1) {
            r.AdjFactor = 0.8f;
            r.AdjDesc = "bi1:4";
        }
        const auto b = r.Encode();
        bytes.append(b.data(), b.size());
    }
    return bytes;
}

// Puts the file back as it was, outside the timing.
void Restore(const std::string& bytes) {
    std::ofstream out(File(), std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

void BM_ApplyAdjustment(benchmark::State& state) {
    const std::string plain = History(false);
    Restore(plain);
    adjust::AdjustmentJob job;
    job.DataFolder = Folder();
    job.ChtMiscFolder = Folder();
    job.Code = "BIG";
    job.AdjRecord = bench::kRecords;
    job.AdjFactor = 0.8f;
    job.AdjNote = "bi1:4";
    for (auto _ : state) {
        adjust::Applied applied;
        if (auto s = adjust::ApplyAdjustment(job, applied); !s) state.SkipWithError("failed");
        state.PauseTiming();
        Restore(plain);
        state.ResumeTiming();
    }
    state.SetBytesProcessed(state.iterations() * static_cast<long long>(plain.size()));
}
BENCHMARK(BM_ApplyAdjustment)->Unit(benchmark::kMillisecond);

void BM_RemoveLatestAdjustment(benchmark::State& state) {
    const std::string adjusted = History(true);
    Restore(adjusted);
    for (auto _ : state) {
        adjust::Removed removed;
        if (auto s = adjust::RemoveLatestAdjustment(Folder(), "BIG", removed);
            !s || removed.Record != bench::kRecords)
            state.SkipWithError("failed");
        state.PauseTiming();
        Restore(adjusted);
        state.ResumeTiming();
    }
    state.SetBytesProcessed(state.iterations() * static_cast<long long>(adjusted.size()));
}
BENCHMARK(BM_RemoveLatestAdjustment)->Unit(benchmark::kMillisecond);

// The floor: the same file read whole and written back through the same gate.
void BM_ReadAndRewriteFloor(benchmark::State& state) {
    const std::string plain = History(false);
    Restore(plain);
    for (auto _ : state) {
        auto bytes = platform::ReadWholeFile(File());
        if (!bytes || !platform::WriteFileAtomic(File(), *bytes, {"Temp.Wk1", ""}).ok())
            state.SkipWithError("failed");
    }
    state.SetBytesProcessed(state.iterations() * static_cast<long long>(plain.size()));
}
BENCHMARK(BM_ReadAndRewriteFloor)->Unit(benchmark::kMillisecond);

// A 5000-line bulletin of every action, with long names to shorten and warrants to test.
void BM_FilterBulletin(benchmark::State& state) {
    static constexpr const char* kForms[] = {
        "nl,c%04d,asx.stk,0,n,Karoo Exploration Limited Macquarie Warrant,abc\r\n",
        "ni,c%04d,asx.stk,0,n,Karoo Expl\r\n",
        "di,c%04d,asx.stk,0,n,05jan24,,,12.5\r\n",
        "bi,c%04dw,asx.stk,0,n,05jan24,1,4\r\n",
        "nc,c%04d,asx.opt,0,n,05jan24,d%04d\r\n",
        "dc,c%04d,lsx.stk,0,n,05jan24\r\n"};
    std::string bulletin;
    for (int i = 0; i < 5000; ++i) {
        char line[128];
        std::snprintf(line, sizeof line, kForms[i % 6], i, i);
        bulletin += line;
    }
    adjust::BulletinOptions o;
    o.DateStem = "05JAN24";
    o.WarrantFilter = true;
    o.NoShortNames = true;
    o.Divs = adjust::DividendRule::MarkY;
    o.HasPriceFile = [](std::string_view code) { return code.size() % 2 == 0; };
    for (auto _ : state) {
        auto lines = adjust::FilterBulletin(bulletin, o);
        benchmark::DoNotOptimize(lines);
        if (lines.size() < 3000) state.SkipWithError("lines lost");
    }
    state.SetBytesProcessed(state.iterations() * static_cast<long long>(bulletin.size()));
}
BENCHMARK(BM_FilterBulletin)->Unit(benchmark::kMillisecond);

// 500 bonus issues, splits and dividends over a 3000-security library of 1000 days each, every
// history rewritten through the write gate; the histories are put back outside the timing.
void BM_MakeAdjustments(benchmark::State& state) {
    const bench::MarketShape shape{3000, 1000};
    const std::string folder = bench::MakeSyntheticMarket(
        std::filesystem::temp_directory_path() / "kori-bench-market-3000x1000", shape);
    const auto dates = bench::SyntheticWeekdays(shape.LastDate, shape.Records);
    const std::string stem = dates[800];
    std::vector<adjust::ListItem> list;
    std::vector<std::pair<std::filesystem::path, std::string>> saved;
    for (int i = 0; i < 500; ++i) {
        const std::string code = bench::SyntheticCode(i * 6);
        const std::string line = i % 3 == 0   ? "BI," + code + ",X,0,Y," + stem + ",1,4"
                                 : i % 3 == 1 ? "SP," + code + ",X,0,Y," + stem + ",-1,2"
                                              : "DI," + code + ",X,0,Y," + stem + ",,,0.1";
        list.push_back(adjust::ParseListLine(line));
        const auto path = std::filesystem::path(folder) / (code + ".WDT");
        saved.emplace_back(path, platform::ReadWholeFile(path).value_or(""));
    }
    adjust::MakeSettings settings;
    settings.DataFolder = folder;
    settings.Today = shape.LastDate;
    platform::NullProgress progress;
    for (auto _ : state) {
        auto items = list;
        adjust::MakeReport report;
        if (auto s = adjust::MakeAdjustments(settings, items, progress, report);
            !s || report.Messages.size() < 490)
            state.SkipWithError("not every item was carried out");
        state.PauseTiming();
        for (const auto& [path, bytes] : saved)
            std::ofstream(path, std::ios::binary | std::ios::trunc)
                .write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        state.ResumeTiming();
    }
}
BENCHMARK(BM_MakeAdjustments)->Unit(benchmark::kMillisecond)->Iterations(3);

// Its floor: the same 500 histories read whole and written back through the same gate.
void BM_MakeAdjustmentsFloor(benchmark::State& state) {
    const bench::MarketShape shape{3000, 1000};
    const std::string folder = bench::MakeSyntheticMarket(
        std::filesystem::temp_directory_path() / "kori-bench-market-3000x1000", shape);
    for (auto _ : state)
        for (int i = 0; i < 500; ++i) {
            const auto path =
                std::filesystem::path(folder) / (bench::SyntheticCode(i * 6) + ".WDT");
            auto bytes = platform::ReadWholeFile(path);
            if (!bytes || !platform::WriteFileAtomic(path, *bytes, {"Temp.Wk1", ""}).ok())
                state.SkipWithError("failed");
        }
}
BENCHMARK(BM_MakeAdjustmentsFloor)->Unit(benchmark::kMillisecond)->Iterations(3);

} // namespace

BENCHMARK_MAIN();
