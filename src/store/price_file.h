#pragma once
// <code>.WDT: the daily records of one security, 50 bytes each, oldest first.
#include "platform/status.h"
#include "store/record_file.h"

#include <array>
#include <cstdint>
#include <cstring>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

struct PriceRecord {
    static constexpr std::size_t kSize = 50;

    std::string Date = "        ";                // "yyyymmdd"
    float Open = 0, High = 0, Low = 0, Close = 0; // close 0 marks a no-trade record
    std::int32_t Volume = 0;
    float AdjFactor = 0;
    std::string AdjDesc;    // 14
    std::string Flag = " "; // "I" from an intraday update
    std::string Reserved;   // 3, written blank

    std::array<char, kSize> Encode() const;
    static PriceRecord Decode(const char* bytes);
};

class PriceFile : public RecordFile<PriceRecord> {
public:
    using RecordFile::RecordFile;
    // <DataFolder><code>.WDT, found whatever its case; empty for a code that is not valid.
    static std::filesystem::path PathFor(std::string_view dataFolder, std::string_view code);
    // Opens a price file to read from: "No Data for <file>" when it is missing or holds no
    // record, the message of the record limit when it holds too many.
    platform::Status OpenWithData();
};

// The raw bytes of records `first` to `last` (1-based, inclusive) of a price file, in one open
// and one read into `bytes`, whose storage is reused: the walks over the whole market read
// thousands of files this way without allocating for each.
platform::Status ReadPriceRecords(const std::filesystem::path& file, int first, int last,
                                  std::string& bytes);

// Fields of a record straight from its bytes, for the walks that only need a figure or two.
inline constexpr std::size_t kOpenAt = 8, kHighAt = 12, kLowAt = 16, kCloseAt = 20, kVolumeAt = 24;
inline float PriceField(const char* record, std::size_t offset) {
    float v;
    std::memcpy(&v, record + offset, sizeof v);
    return v;
}
inline std::int32_t PriceVolume(const char* record) {
    std::int32_t v;
    std::memcpy(&v, record + kVolumeAt, sizeof v);
    return v;
}

} // namespace kori::store
