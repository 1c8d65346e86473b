#pragma once
// Kori.ini-style settings: sections of key=value lines. Section and key names compare without
// case; a key not found or an empty value reads "unknown"; reads are cut at 60 characters;
// writes trim the value and go to disk at once.
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::platform {

inline constexpr std::string_view kUnknown = "unknown";

class IniFile {
public:
    explicit IniFile(std::filesystem::path path);

    const std::filesystem::path& path() const { return m_path; }
    bool exists() const;

    std::string Read(std::string_view section, std::string_view key) const;
    // Raw value without the 60-character cut or the "unknown" rule; empty when absent.
    std::string ReadRaw(std::string_view section, std::string_view key) const;
    // Writes at once; failures are ignored as the settings rules say, but reported here.
    bool Write(std::string_view section, std::string_view key, std::string_view value);

    // Every key of a section in file order.
    std::vector<std::pair<std::string, std::string>> Section(std::string_view section) const;

private:
    struct Line {
        std::string text;    // the line as it stands in the file
        std::string section; // section the line belongs to
        std::string key;     // empty for comments, blanks and section headers
        std::string value;
    };
    void Load() const;
    bool Save() const;

    std::filesystem::path m_path;
    mutable std::vector<Line> m_lines;
    mutable bool m_loaded = false;
};

} // namespace kori::platform
