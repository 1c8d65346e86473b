// The security details: loading a 3000-line table into sorted records with its index, and one
// security's lookup, each beside its floor (the same bytes read and written, nothing else).
#include "maint/security_details.h"
#include "platform/files.h"
#include "synthetic_market.h"

#include <benchmark/benchmark.h>

#include <fcntl.h>
#include <unistd.h>

#include <filesystem>
#include <string>
#include <vector>

using namespace kori;
namespace fs = std::filesystem;

namespace {

constexpr int kLines = 3000;

fs::path Root() {
    static const fs::path root = [] {
        const auto d = fs::temp_directory_path() / "kori-details-bench";
        fs::create_directories(d / "In");
        fs::create_directories(d / "sys");
        return d;
    }();
    return root;
}
std::string In() {
    return (Root() / "In").string() + "/";
}
std::string Sys() {
    return (Root() / "sys").string() + "/";
}

// The table in the order the service lists it (not sorted: the load sorts it).
const std::string& Table() {
    static const std::string text = [] {
        std::string t = "CODE,SHORTDESCRIPTION,SECURITYTYPE,TOTALCLASSISSUE,PARVALUE,"
                        "ANNUALDIVIDENDRATE,EARNINGSPERSHARE,FRANKINGPERCENT,EXDATE\r\n";
        for (int i = kLines - 1; i >= 0; --i)
            t += bench::SyntheticCode(i) + ",SECURITY NUMBER " + std::to_string(i) +
                 " LIMITED,ORD," + std::to_string(1000000 + i * 17) +
                 ",0,0.12,0.3,100,20261010\r\n";
        return t;
    }();
    return text;
}

void PutTable() {
    (void)platform::WriteFileAtomic(In() + "SecurityDetails.Asx.Stk", Table());
}

void BM_RefreshSecurityDetails3000(benchmark::State& state) {
    for (auto _ : state) {
        state.PauseTiming();
        PutTable();
        state.ResumeTiming();
        const auto r = maint::RefreshSecurityDetails(Sys(), In());
        if (!r.Status || r.Records != kLines) state.SkipWithError("the table did not load");
    }
}
BENCHMARK(BM_RefreshSecurityDetails3000)->Unit(benchmark::kMillisecond)->UseRealTime();

// Floor: read the table, write as many bytes as the records take beside the file and rename.
void BM_FloorRefresh(benchmark::State& state) {
    const std::string records(static_cast<std::size_t>(kLines) * maint::kDetailsRecord, ' ');
    for (auto _ : state) {
        state.PauseTiming();
        PutTable();
        state.ResumeTiming();
        const auto text = platform::ReadWholeFile(In() + "SecurityDetails.Asx.Stk");
        benchmark::DoNotOptimize(text);
        if (!platform::WriteFileAtomic(Sys() + "Floor.Stx", records))
            state.SkipWithError("write failed");
    }
}
BENCHMARK(BM_FloorRefresh)->Unit(benchmark::kMillisecond)->UseRealTime();

void BM_LookUpSecurityDetails(benchmark::State& state) {
    PutTable();
    if (!maint::RefreshSecurityDetails(Sys(), In()).Status) state.SkipWithError("no table");
    std::vector<std::string> codes;
    for (int i = 0; i < kLines; i += 7)
        codes.push_back(bench::SyntheticCode(i));
    std::size_t next = 0;
    for (auto _ : state) {
        const auto d = maint::LookUpSecurityDetails(Sys(), codes[next++ % codes.size()]);
        if (!d) state.SkipWithError("a code was not found");
        benchmark::DoNotOptimize(d);
    }
}
BENCHMARK(BM_LookUpSecurityDetails)->Unit(benchmark::kMicrosecond);

// Floor of a lookup: open the index and the records, read one record each, close.
void BM_FloorLookUp(benchmark::State& state) {
    char buffer[maint::kDetailsRecord];
    for (auto _ : state) {
        for (const char* name : {"Sdix1.inx", "SecurityDetails.Stx"}) {
            const int fd = ::open((Sys() + name).c_str(), O_RDONLY | O_CLOEXEC);
            benchmark::DoNotOptimize(::pread(fd, buffer, sizeof buffer, 0));
            ::close(fd);
        }
    }
}
BENCHMARK(BM_FloorLookUp)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
