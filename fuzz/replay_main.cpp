// Replays a corpus through a fuzzing entry point without libFuzzer: each file given, or each
// file of each folder given, once. Used by the tests on every build.
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include <unistd.h>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

int RunFile(const std::filesystem::path& p) {
    std::ifstream in(p, std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(in), {}};
    std::vector<std::uint8_t> copy(bytes.begin(), bytes.end()); // exact size: overreads show
    LLVMFuzzerTestOneInput(copy.data(), copy.size());
    return 1;
}

} // namespace

int main(int argc, char** argv) {
    int ran = 0;
    for (int i = 1; i < argc; ++i) {
        const std::filesystem::path p = argv[i];
        if (std::filesystem::is_directory(p)) {
            for (const auto& e : std::filesystem::directory_iterator(p))
                if (e.is_regular_file()) ran += RunFile(e.path());
        } else {
            ran += RunFile(p);
        }
    }
    std::printf("%d inputs replayed\n", ran);
    std::error_code ec;
    std::filesystem::remove_all(
        std::filesystem::temp_directory_path() / ("kori-fuzz-" + std::to_string(::getpid())), ec);
    return ran > 0 ? 0 : 1;
}
