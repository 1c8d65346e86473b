#pragma once
// NameRecord: one 96-byte entry of Names.dat, the index of the library.
#include <array>
#include <cstdint>
#include <string>
#include <string_view>

namespace kori::store {

// Types 1 to 3 carry a close only: they chart as lines and their highs and lows stand in
// from the close. Bars need a type of 4 or more, so any other type counts as closes only too.
constexpr bool IsCloseOnly(int recordType) {
    return recordType < 4;
}

struct NameRecord {
    static constexpr std::size_t kSize = 96;
    static constexpr std::size_t kNameWidth = 35;
    static constexpr std::size_t kOtherDetailsWidth = 15;

    std::int16_t Status = 0;     // 0 ordinary, 1 deleted, 9 dealt with by the adjustment run
    std::string Code;            // 6, upper case; also the price file's base name
    std::int16_t RecordType = 4; // 1..5
    std::string Name;            // 35
    std::string OtherDetails;    // 15
    float Base = 0;              // manual scale bottom (record number in TmpNames.tmp)
    float Top = 0;
    float PFIncrement = 0;
    float ScaleStep = 0.05f;
    std::int16_t PercentBandUp = 0;
    std::int16_t PercentBandDown = 0;
    std::int16_t BollingerPeriod = 0;
    std::int16_t BollingerWidth = 0;
    std::int16_t Category = 0;
    std::string Id;            // 1
    std::string IndustryClass; // 3
    std::string GicsSector;    // 4
    std::string Reserved;      // 2

    std::array<char, kSize> Encode() const;
    static NameRecord Decode(const char* bytes);

    std::string TrimmedCode() const;
    // Band values as the chart reads them: outside 1 to 100 means 5.
    std::int16_t BandUp() const {
        return PercentBandUp >= 1 && PercentBandUp <= 100 ? PercentBandUp : 5;
    }
    std::int16_t BandDown() const {
        return PercentBandDown >= 1 && PercentBandDown <= 100 ? PercentBandDown : 5;
    }
};

// A code can name a price file: one to six characters after trimming, none of them a blank, a
// control character, a path separator, a dot or a colon, so it never reaches outside its folder.
bool IsValidCode(std::string_view code);

// A code as the file stores it: upper case, padded to six; "PRN" and "AUX" in their safe forms.
std::string PadCode(std::string_view code);

} // namespace kori::store
