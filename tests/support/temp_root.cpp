#include "support/temp_root.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <random>
#include <sstream>

namespace kori::test {

TempRoot::TempRoot() {
    std::random_device rd;
    const auto base = std::filesystem::temp_directory_path();
    for (;;) {
        auto candidate = base / ("kori-test-" + std::to_string(rd()));
        if (std::filesystem::create_directory(candidate)) {
            m_path = candidate;
            break;
        }
    }
}

TempRoot::~TempRoot() {
    std::error_code ec;
    std::filesystem::remove_all(m_path, ec);
}

std::filesystem::path TempRoot::Write(std::string_view name, std::string_view bytes) const {
    const auto p = m_path / std::string(name);
    std::filesystem::create_directories(p.parent_path());
    std::ofstream out(p, std::ios::binary);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    return p;
}

std::string TempRoot::Read(std::string_view name) const {
    std::ifstream in(m_path / std::string(name), std::ios::binary);
    std::ostringstream ss;
    ss << in.rdbuf();
    return ss.str();
}

std::vector<std::string> FilesIn(const std::filesystem::path& dir) {
    std::vector<std::string> names;
    for (const auto& e : std::filesystem::directory_iterator(dir))
        names.push_back(e.path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
}

std::filesystem::path Fixture(std::string_view name) {
    const char* dir = std::getenv("KORI_FIXTURES");
    return std::filesystem::path(dir ? dir : "tests/fixtures") / std::string(name);
}

} // namespace kori::test
