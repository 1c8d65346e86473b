// The day-file update over a synthetic market of 3000 securities of 5000 daily records: a normal
// day (all appends), the same day inserted into the last month, the no-trade fill, the check of
// a day file, and the floor under them: 3000 opens and 50-byte appends with nothing else.
//
// The market is made once in its own folder and kept. Benchmarks that append put it back by
// cutting each file to its 5000 records; the insert runs on a folder of hard links to it, which
// the update's rename-over writes never reach through, relinked between iterations.
#include "synthetic_market.h"

#include "intake/download_update.h"
#include "platform/dialogs.h"
#include "platform/progress.h"

#include <benchmark/benchmark.h>

#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>

namespace {

using namespace kori;
namespace fs = std::filesystem;

constexpr bench::MarketShape kShape{3000, 5000};

fs::path BenchFolder() {
    if (const char* dir = std::getenv("KORI_BENCH_INTAKE")) return dir;
    return fs::temp_directory_path() / "kori-bench-intake-3000x5000";
}

const std::string& Market() {
    static const std::string folder = bench::MakeSyntheticMarket(BenchFolder() / "market", kShape);
    return folder;
}

std::vector<std::string> Codes() {
    std::vector<std::string> codes;
    for (int i = 0; i < kShape.Securities; ++i)
        codes.push_back(bench::SyntheticCode(i));
    return codes;
}

// Every price file back to its 5000 records, Names.dat to its 3000.
void CutBack(const std::string& folder) {
    for (const auto& c : Codes())
        (void)::truncate((folder + c + ".WDT").c_str(), static_cast<off_t>(kShape.Records) * 50);
    (void)::truncate((folder + "Names.dat").c_str(), static_cast<off_t>(kShape.Securities) * 96);
}

// A day file of one line a security.
std::string DayFile(const std::string& folder, const std::string& name, const std::string& date) {
    fs::create_directories(folder);
    std::string text;
    for (const auto& c : Codes())
        text += c + "," + date + ",1.5,1.6,1.4,1.55,12345,0\r\n";
    std::ofstream(folder + name, std::ios::binary) << text;
    return folder + name;
}

struct Run {
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    intake::UpdateHooks hooks;
    intake::UpdateSettings settings;
    Run(const std::string& data, const std::string& download) {
        settings.DataService = 4;
        settings.DataFolder = data;
        settings.DownloadFolder = download;
        settings.SystemFolder = download;
    }
    intake::RunResult Go(const std::string& file, const std::string& date) {
        dialogs.QueueAnswer(platform::Answer::Ok);
        intake::UpdateHost host{dialogs, progress, nullptr, nullptr};
        return intake::RunDownloadUpdate(settings, host, hooks, file, date, false);
    }
};

// A normal day after the last: 3000 appends, then the no-trade walk finds nothing to fill.
void BM_NormalDay(benchmark::State& state) {
    const std::string data = Market();
    CutBack(data);
    const std::string dl = (BenchFolder() / "download").string() + "/";
    const std::string day = DayFile(dl, "23NOV26.D", "20261123");
    Run run(data, dl);
    for (auto _ : state) {
        const auto r = run.Go("23NOV26.D", "20261123");
        state.PauseTiming();
        if (r.Files.empty() || r.Files[0].Records != kShape.Securities ||
            r.Files[0].State != intake::FileState::Normal)
            state.SkipWithError("the day did not go in as a normal day");
        CutBack(data);
        fs::rename(day + "X", day);
        state.ResumeTiming();
    }
}
BENCHMARK(BM_NormalDay)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(5);

// Hard links to the market: a rename over one of them leaves the market's file as it was.
void LinkMarket(const std::string& market, const fs::path& work) {
    fs::remove_all(work);
    fs::create_directories(work);
    for (const auto& c : Codes())
        fs::create_hard_link(market + c + ".WDT", work / (c + ".WDT"));
    fs::copy_file(market + "Names.dat", work / "Names.dat");
}

// A Saturday of the last month: every file is searched and rewritten with the day in place.
void BM_InsertDay(benchmark::State& state) {
    const std::string market = Market();
    CutBack(market);
    const fs::path work = BenchFolder() / "work";
    LinkMarket(market, work);
    const std::string dl = (BenchFolder() / "download").string() + "/";
    const std::string day = DayFile(dl, "07NOV26.D", "20261107");
    Run run(work.string() + "/", dl);
    for (auto _ : state) {
        const auto r = run.Go("07NOV26.D", "20261107");
        state.PauseTiming();
        if (r.Files.empty() || r.Files[0].Records != kShape.Securities ||
            r.Files[0].State != intake::FileState::Insert)
            state.SkipWithError("the day did not go in as an insert");
        LinkMarket(market, work);
        fs::rename(day + "X", day);
        state.ResumeTiming();
    }
}
BENCHMARK(BM_InsertDay)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(5);

// The fill walk when every security traded (nothing to write) and when none did (3000 fillers).
void BM_FillNoTradeDays(benchmark::State& state) {
    const std::string data = Market();
    CutBack(data);
    const bool fillAll = state.range(0) == 1;
    platform::NullProgress progress;
    for (auto _ : state) {
        const auto r = intake::FillNoTradeDays(data, fillAll ? "20261123" : "20261120", "20261123",
                                               false, progress);
        state.PauseTiming();
        if (r.Fillers != (fillAll ? kShape.Securities : 0)) state.SkipWithError("wrong fill");
        CutBack(data);
        state.ResumeTiming();
    }
}
BENCHMARK(BM_FillNoTradeDays)
    ->Arg(0)
    ->Arg(1)
    ->Unit(benchmark::kMillisecond)
    ->UseRealTime()
    ->Iterations(10);

// The whole-file check of a 3000-line day file and the decision from its first security.
void BM_CheckDownloadFile(benchmark::State& state) {
    const std::string data = Market();
    const std::string dl = (BenchFolder() / "download").string() + "/";
    const std::string day = DayFile(dl, "check.D", "20261123");
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    intake::CheckInput in;
    in.DataService = 4;
    in.TargetFolder = data;
    for (auto _ : state) {
        const auto r = intake::CheckDownloadFile(day, in, dialogs, progress);
        if (r.Lines.size() != static_cast<std::size_t>(kShape.Securities))
            state.SkipWithError("lines lost");
        benchmark::DoNotOptimize(r);
    }
}
BENCHMARK(BM_CheckDownloadFile)->Unit(benchmark::kMillisecond)->UseRealTime();

// Floor: open each of the 3000 price files, append 50 bytes, close. Nothing else.
void BM_FloorOpenAndAppend(benchmark::State& state) {
    const std::string data = Market();
    CutBack(data);
    std::vector<std::string> files;
    for (const auto& c : Codes())
        files.push_back(data + c + ".WDT");
    const std::string record(50, 'x');
    for (auto _ : state) {
        for (const auto& f : files) {
            const int fd = ::open(f.c_str(), O_WRONLY | O_APPEND | O_CLOEXEC);
            if (fd < 0 || ::write(fd, record.data(), record.size()) != 50)
                state.SkipWithError("append failed");
            ::close(fd);
        }
        state.PauseTiming();
        CutBack(data);
        state.ResumeTiming();
    }
}
BENCHMARK(BM_FloorOpenAndAppend)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(10);

// Floor of an insert day: read each file whole, write it beside with one record more and rename
// it over the old one, with nothing else (no search, no fsync).
void BM_FloorRewriteBeside(benchmark::State& state) {
    const std::string market = Market();
    CutBack(market);
    const fs::path work = BenchFolder() / "work";
    LinkMarket(market, work);
    const std::string record(50, 'x');
    std::string bytes;
    for (auto _ : state) {
        for (const auto& c : Codes()) {
            const std::string f = (work / (c + ".WDT")).string();
            const int in = ::open(f.c_str(), O_RDONLY | O_CLOEXEC);
            bytes.resize(static_cast<std::size_t>(kShape.Records) * 50);
            const bool read =
                ::read(in, bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size());
            ::close(in);
            bytes.insert(bytes.size() - 500, record);
            const std::string tmp = f + ".new";
            const int out = ::open(tmp.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
            const bool wrote =
                ::write(out, bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size());
            ::close(out);
            if (!read || !wrote || ::rename(tmp.c_str(), f.c_str()) != 0)
                state.SkipWithError("rewrite failed");
        }
        state.PauseTiming();
        LinkMarket(market, work);
        state.ResumeTiming();
    }
}
BENCHMARK(BM_FloorRewriteBeside)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(5);

} // namespace

BENCHMARK_MAIN();
