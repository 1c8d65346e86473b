#pragma once
// A throw-away folder for one test, removed when the test ends.
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::test {

class TempRoot {
public:
    TempRoot();
    ~TempRoot();
    TempRoot(const TempRoot&) = delete;
    TempRoot& operator=(const TempRoot&) = delete;

    const std::filesystem::path& path() const { return m_path; }
    // The folder as the system's folder variables hold it: with a closing separator.
    std::string folder() const { return m_path.string() + "/"; }
    std::filesystem::path Write(std::string_view name, std::string_view bytes) const;
    std::string Read(std::string_view name) const;

private:
    std::filesystem::path m_path;
};

// The names of the files in `dir`, sorted: what a write left behind.
std::vector<std::string> FilesIn(const std::filesystem::path& dir);

// Path of a file under tests/fixtures.
std::filesystem::path Fixture(std::string_view name);

} // namespace kori::test
