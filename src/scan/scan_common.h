#pragma once
// What the scans share: their messages, the filters of the name record, the price range, the
// rise and fall tests, the daily bars of the last part of a price file, and the scan list Z.
#include "platform/status.h"
#include "store/name_record.h"

#include <cstdint>
#include <filesystem>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace kori::scan {

// A message box of a scan: text and title as the window shows them.
struct ScanMessage {
    std::string Text;
    std::string Title;
};

inline constexpr std::string_view kCheckingData = "Checking Data - WAIT";

// Whole text is a number (blanks around it allowed): what the windows' boxes must hold.
bool IsNumericText(std::string_view text);

// "By closing price range": Min and Max as typed.
struct PriceRange {
    bool On = false;
    std::string Min, Max;
    // Both boxes hold numbers (checked only when the range is on).
    bool Valid() const;
    // The close lies from Min to Max; always true when the range is off.
    bool Holds(float close) const;
};

// "Check only Industry Class ": a chosen class ending in "0" is a whole group (the first two
// digits, and the record's class must have exactly three characters); any other is compared
// whole, both trimmed.
bool ClassMatches(std::string_view chosen, std::string_view recordClass);
// The class box: numeric and three characters. Nullopt when it passes.
enum class ClassProblem { None, NotNumeric, NotThreeDigits };
ClassProblem CheckClass(std::string_view chosen);

// Codes of six characters are warrants.
bool IsWarrant(const store::NameRecord& r);

// Prices are 32-bit floats: "at least" a percentage is judged to their precision, so a close
// exactly the given percentage up (as typed in cents) passes.
bool RoseBy(float previous, float last, double percent);
bool FellBy(float previous, float last, double percent);
// (last - previous) / previous x 100.
double ChangePercent(float previous, float last);

// Daily bars of the last part of a price file as the chart's daily load leaves them (no-trade
// records from the third bar on take the close before them; a missing high on a security
// with bars stands at the close), held from bar `First` to the last bar.
struct DailyTail {
    int First = 0;    // bar number (0-based) of element 0
    int BarCount = 0; // bars in the whole file
    std::vector<float> Close, High, Low;
    std::vector<std::int32_t> Volume;

    int Last() const { return BarCount - 1; }
    float CloseAt(int bar) const { return Close[static_cast<std::size_t>(bar - First)]; }
    float HighAt(int bar) const { return High[static_cast<std::size_t>(bar - First)]; }
    float LowAt(int bar) const { return Low[static_cast<std::size_t>(bar - First)]; }
};

// Reads at least the last `wanted` bars of a price file of `records` records (all of them when
// `wanted` is 0 or too many) with one read into `buffer`. A no-trade record at the start of the
// part read takes its close from further back; when that lies outside the part, the whole file
// is read instead.
platform::Status ReadDailyTail(const std::filesystem::path& file, int records, int wanted,
                               std::int16_t recordType, std::string& buffer, DailyTail& tail);

// Folds raw records (bar `firstBar` first) into `tail`; false when the first bars are no-trade
// records whose close lies before the bytes given.
bool FoldDailyTail(std::string_view bytes, int firstBar, int barCount, std::int16_t recordType,
                   DailyTail& tail);

// One entry of the scan list: record number in Names.dat and code.
struct ListedCode {
    int NameRecord = 0;
    std::string Code;
};

// Writes SubListZ.Dat whole (through the scratch gate) with the codes found.
platform::Status StoreScanList(std::string_view dataFolder, const std::vector<ListedCode>& codes);

// The temporary folder below the system folder, where the scan reports go.
std::filesystem::path ScanTempFolder(std::string_view systemFolder);

} // namespace kori::scan
