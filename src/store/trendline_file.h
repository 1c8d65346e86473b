#pragma once
// <code>.TND: the trendlines of one security, fixed 27-byte records in the chart folder. A
// deleted record stays in place with a blank period and is reused; packing drops them.
#include "platform/status.h"
#include "store/record_file.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

struct TrendRecord {
    std::int16_t LineKind = 0;
    char Period = ' '; // 'A', 'W' or 'M'; blank marks a deleted record
    std::string DateA; // 8 characters "yyyymmdd"
    float PriceA = 0;
    std::string DateB; // "yyyymmdd", or "X" then an x position beyond the last bar
    float PriceB = 0;

    bool deleted() const { return Period == ' '; }
    static constexpr std::size_t kSize = 27;
    std::array<char, kSize> Encode() const;
    static TrendRecord Decode(const char* bytes);
    static TrendRecord Blank();
};

class TrendlineFile : public RecordFile<TrendRecord> {
public:
    using RecordFile::RecordFile;
    // Path of the file of a code in the chart folder.
    static std::filesystem::path PathFor(std::string_view chartFolder, std::string_view code);

    // Every record, deleted ones included; empty when the file is absent or cannot be read.
    static std::vector<TrendRecord> ReadAll(const std::filesystem::path& path);
    // Writes the record at the next free place: the first deleted record, else the end.
    // Returns the 1-based record number written.
    static int AddRecord(const std::filesystem::path& path, const TrendRecord& r,
                         platform::Status& status);
    // Rewrites one record in place (1-based).
    static platform::Status WriteRecord(const std::filesystem::path& path, int recordNumber,
                                        const TrendRecord& r);
    static platform::Status DeleteRecord(const std::filesystem::path& path, int recordNumber) {
        return WriteRecord(path, recordNumber, TrendRecord::Blank());
    }
    // Copies the live records to Temp.Wk3 beside the file, which then replaces it.
    static platform::Status Pack(const std::filesystem::path& path);
};

} // namespace kori::store
