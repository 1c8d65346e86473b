#pragma once
// Kori.ini-style settings: sections of key=value lines. Section and key names compare without
// case; a key not found or an empty value reads "unknown"; reads are cut at 60 characters;
// writes trim the value and go to disk at once, or once at the end of a `Batch`.
// The file is read from disk once and again only when it changed on disk (another window or
// program wrote it), so a command that reads a hundred keys opens it once.
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

    // While one is alive, writes change the copy in memory and the file is saved once when the
    // outermost batch ends.
    class Batch {
    public:
        explicit Batch(IniFile& ini) : m_ini(ini) { ++m_ini.m_batchDepth; }
        ~Batch();
        // Ends the batch now: saves what it holds (when it is the outermost) and says whether
        // the file was written.
        bool Commit();
        Batch(const Batch&) = delete;
        Batch& operator=(const Batch&) = delete;

    private:
        IniFile& m_ini;
        bool m_done = false;
    };

    // Times the file was read from disk (for tests and measurements).
    std::size_t DiskReads() const { return m_diskReads; }

    // Every key of a section in file order.
    std::vector<std::pair<std::string, std::string>> Section(std::string_view section) const;

private:
    struct Line {
        std::string text;    // the line as it stands in the file
        std::string section; // section the line belongs to
        std::string key;     // empty for comments, blanks and section headers
        std::string value;
    };
    struct Stamp {
        bool exists = false;
        long long size = 0, seconds = 0, nanos = 0;
        unsigned long long inode = 0;
        bool operator==(const Stamp&) const = default;
    };
    static Stamp StampOf(const std::filesystem::path& path);
    void Load() const;
    bool Save();

    std::filesystem::path m_path;
    mutable std::vector<Line> m_lines;
    mutable bool m_loaded = false;
    mutable Stamp m_stamp;
    mutable std::size_t m_diskReads = 0;
    int m_batchDepth = 0;
    bool m_unsaved = false;
};

} // namespace kori::platform
