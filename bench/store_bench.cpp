// Name-file search and the load of chart bars from a cached price file.
#include "platform/dialogs.h"
#include "store/load_chart_series.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <benchmark/benchmark.h>

#include <filesystem>
#include <string>
#include <vector>

using namespace kori;

namespace {

std::filesystem::path Folder() {
    static const auto dir = [] {
        auto d = std::filesystem::temp_directory_path() / "kori-store-bench";
        std::filesystem::create_directories(d);
        // 32,767 names, the last one the code searched for.
        std::vector<store::NameRecord> names(32767);
        for (std::size_t i = 0; i < names.size(); ++i) {
            names[i].Code = "C" + std::to_string(i);
            names[i].Name = "Security " + std::to_string(i);
        }
        names.back().Code = "LAST";
        store::NameFile nf(store::NameFile::PathIn(d.string() + "/"));
        (void)nf.WriteAll(names);
        // 30,000 weekdays of prices.
        std::vector<store::PriceRecord> recs;
        int y = 1990, m = 1, day = 1, wd = 2;
        for (int i = 0; i < 30000; ++i) {
            char date[9];
            std::snprintf(date, sizeof date, "%04d%02d%02d", y, m, day);
            store::PriceRecord r;
            r.Date = date;
            r.Open = 10.0f + static_cast<float>(i % 97) * 0.01f;
            r.High = r.Open + 0.2f;
            r.Low = r.Open - 0.2f;
            r.Close = r.Open + 0.05f;
            r.Volume = 1000 + i % 5000;
            recs.push_back(r);
            do { // next weekday, months of 28 days are enough for a benchmark calendar
                ++wd;
                if (++day > 28) {
                    day = 1;
                    if (++m > 12) {
                        m = 1;
                        ++y;
                    }
                }
                if (wd > 7) wd = 1;
            } while (wd == 1 || wd == 7);
        }
        store::PriceFile pf(store::PriceFile::PathFor(d.string() + "/", "BIG"));
        (void)pf.WriteAll(recs);
        return d;
    }();
    return dir;
}

void BM_FindCodeInNameFile(benchmark::State& state) {
    const std::string folder = Folder().string() + "/";
    platform::ScriptedDialogs dialogs;
    for (auto _ : state) {
        auto found = store::FindCodeInNameFile(folder, "LAST", dialogs);
        benchmark::DoNotOptimize(found);
        if (!found || found->RecordNumber != 32767) state.SkipWithError("not found");
    }
    state.SetBytesProcessed(state.iterations() * 32767 * 96);
}
BENCHMARK(BM_FindCodeInNameFile)->Unit(benchmark::kMillisecond);

void BM_LoadChartSeries(benchmark::State& state) {
    const auto path = (Folder() / "BIG.WDT").string();
    store::SeriesRequest q;
    q.FirstRecord = 1;
    q.LastRecord = 30000;
    q.Period = "AWM"[state.range(0)];
    store::ChartSeries s;
    for (auto _ : state) {
        auto st = store::LoadChartSeries(path, q, s);
        benchmark::DoNotOptimize(s.ChartBars.data());
        if (!st) state.SkipWithError(st.message().c_str());
    }
    state.SetBytesProcessed(state.iterations() * 30000 * 50);
    state.SetLabel(std::string(1, q.Period));
}
BENCHMARK(BM_LoadChartSeries)->Arg(0)->Arg(1)->Arg(2)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
