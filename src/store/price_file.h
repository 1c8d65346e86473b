#pragma once
// <code>.WDT: the daily records of one security, 50 bytes each, oldest first.
#include "platform/status.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

struct PriceRecord {
    static constexpr std::size_t kSize = 50;

    std::string Date = "        "; // "yyyymmdd"
    float Open = 0, High = 0, Low = 0, Close = 0; // close 0 marks a no-trade record
    std::int32_t Volume = 0;
    float AdjFactor = 0;
    std::string AdjDesc;  // 14
    std::string Flag = " "; // "I" from an intraday update
    std::string Reserved; // 3, written blank

    std::array<char, kSize> Encode() const;
    static PriceRecord Decode(const char* bytes);
};

class PriceFile {
public:
    // <DataFolder><code>.WDT, found whatever its case.
    static std::filesystem::path PathFor(std::string_view dataFolder, std::string_view code);

    explicit PriceFile(std::filesystem::path path) : m_path(std::move(path)) {}
    const std::filesystem::path& path() const { return m_path; }

    // Opening for random access creates an absent file empty.
    platform::Status Open();
    std::int16_t Count() const { return m_count; }

    platform::Status Read(int recordNumber, PriceRecord& out) const;
    platform::Status Write(int recordNumber, const PriceRecord& r);
    platform::Status Append(const PriceRecord& r) { return Write(m_count + 1, r); }
    // Records first..last (1-based, inclusive) as raw bytes in one read.
    platform::Status ReadRange(int first, int last, std::string& bytes) const;
    platform::Status ReadAll(std::vector<PriceRecord>& out) const;
    platform::Status WriteAll(const std::vector<PriceRecord>& records);

    // Orders the records by the number their date reads as, through Temp.Wk2 beside the file.
    platform::Status SortByDate();

private:
    std::filesystem::path m_path;
    std::int16_t m_count = 0;
};

} // namespace kori::store
