#pragma once
// Names.dat: fixed 96-byte records, 1-based, no header, in the data folder. Found whatever the
// case of its name; an absent file opened for random access is created empty.
#include "platform/dialogs.h"
#include "platform/status.h"
#include "store/name_record.h"

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

inline constexpr std::int32_t kMaxRecords = 32767;

// Number of whole records of `size` bytes in a file, refused when over 32,767.
platform::Status CountRecords(const std::filesystem::path& file, std::size_t recordSize,
                              std::int16_t& count);

class NameFile {
public:
    static std::filesystem::path PathIn(std::string_view dataFolder);

    explicit NameFile(std::filesystem::path path) : m_path(std::move(path)) {}
    const std::filesystem::path& path() const { return m_path; }

    // Creates the file when absent and takes the count.
    platform::Status Open();
    std::int16_t Count() const { return m_count; }

    platform::Status Read(int recordNumber, NameRecord& out) const;
    // Writes at a place; one past the end appends.
    platform::Status Write(int recordNumber, const NameRecord& r);
    platform::Status Append(const NameRecord& r) { return Write(m_count + 1, r); }

    // Every record in one read.
    platform::Status ReadAll(std::vector<NameRecord>& out) const;
    // Replaces the whole file (written beside, then renamed).
    platform::Status WriteAll(const std::vector<NameRecord>& records);

private:
    std::filesystem::path m_path;
    std::int16_t m_count = 0;
};

struct FoundCode {
    std::string CurrentFile; // data folder + trimmed code + ".WDT"
    int RecordNumber = 0;
    NameRecord Record;
};

// Scans from record 1 for the padded upper-case code; "No File For That Name" when absent.
std::optional<FoundCode> FindCodeInNameFile(std::string_view dataFolder, std::string_view code,
                                            platform::Dialogs& dialogs);

// Silent: trimmed name and industry class of a code. Both outputs stay as they were when the
// file is absent, and become empty when nothing matches.
void LookupNameAndClass(std::string_view dataFolder, std::string_view code, std::string& name,
                        std::string& industryClass);

// Silent: "0000" for an empty code, an empty file or no match; else the sector, four digits.
std::string LookupGicsSector(std::string_view dataFolder, std::string_view code);

} // namespace kori::store
