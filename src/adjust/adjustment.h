#pragma once
// Capital-issue adjustments of a price history: the factor of each kind of issue, the choice of
// the last day the factor applies to, the rewrite of every record up to that day, and the
// removal of the most recent adjustment. No window here: the entry windows and the command line
// gather the inputs and show the words these routines return.
#include "platform/rounding.h"
#include "platform/status.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::adjust {

// Titles and texts the user sees.
inline constexpr std::string_view kAdjustTitle = "Adjust Data";
inline constexpr std::string_view kDataIncomplete = "Data incomplete";
inline constexpr std::string_view kRatioDataIncomplete = "Ratio Data incomplete";
inline constexpr std::string_view kOnlyTypes4And5 = " Only Record Types 4 and 5 can be adjusted";
inline constexpr std::string_view kAdjustmentsMadeTitle = "Data Adjustments";
inline constexpr std::string_view kNotAdjustedTitle = "Remove Adjustments";
inline constexpr std::string_view kNotAdjusted = "File has not previously been adjusted";
inline constexpr std::string_view kRemovedTitle = "Remove Adjustment";
inline constexpr std::string_view kRemoveNext = "Remove next adjustment ?";

// "B" bonus, "C" cash issue, "SS" share split, "CC" call on contributing shares, "D" dividend.
enum class AdjType { Bonus, Cash, Split, Call, Dividend };

std::string_view TypeLetters(AdjType type);              // "B", "C", "SS", "CC", "D"
std::optional<AdjType> TypeOf(std::string_view letters); // the reverse, any case

// What the entry window gathered. Ratio terms are 32-bit floats; cost and amount are currency.
struct AdjustmentTerms {
    AdjType Type = AdjType::Bonus;
    float RatioA = 0;                      // bonus/new shares for every ...
    float RatioB = 0;                      // ... shares held (old shares)
    std::optional<platform::Money> Cost;   // cash issue: price of a new share
    std::optional<platform::Money> Amount; // call or dividend per share
};

struct Factor {
    float Value = 0;  // after the six-decimal round trip
    std::string Note; // "bi1:4", "ci1:4 @ 1.5", "ss2:1", "cl.25"... as written to the record
};

// The factor of an issue on the close of the chosen day, rounded through "#####.######" into a
// 32-bit float, and the note. A missing input (a zero ratio term, no cost or amount, a zero
// close) gives "Data incomplete"; a factor below 0 (a dividend above the close) is refused.
std::optional<Factor> WorkOutFactor(const AdjustmentTerms& terms, float closeOnDay,
                                    platform::Status& why);

// A factor as the entry window holds it: formatted "#####.######" and read back into a float.
float SixDecimalFactor(double factor);

// A ratio term in a note: shortest text, no leading blank ("1", "2.5").
std::string TermText(float term);
// Currency in a note: shortest text with a leading zero ("1.5", "0.125", "2").
std::string MoneyText(platform::Money m);

// Ratio read-outs of the entry windows.
std::string BonusRatioText(std::string_view a, std::string_view b); // "Ratio of Bonus Issue is a:b"
std::string CashRatioText(std::string_view a, std::string_view b, std::string_view cost);

// ---- Choosing the day ---------------------------------------------------------------------

struct DateChoice {
    // The last record on or before the date, never record 1: 0 when there is none, and then
    // nothing else below is set.
    int Record = 0;
    int FirstShown = 0;             // record number of Lines[0]
    std::vector<std::string> Lines; // "d/m/yy" padded, three blanks, close "######.00"
    std::vector<std::string> Dates; // "yyyymmdd" of each line
    int Selected = -1;              // index into Lines of the chosen record
    std::string RecordDate;         // "yyyymmdd" of the chosen record
    float Close = 0;
    bool ExactDate = false;
    // "Close Price on d/m/yy is 2.50" when the date is on file; otherwise the lines of the box
    // "No close price on file for ...", " Nearest date prior is ...", " Close price is ...".
    std::string Message;
};

// `ChooseAdjustmentDate` over a price file: walks from record 2 while the dates are on or
// before `adjDate` ("yyyymmdd"), lists twenty records either side of the result.
platform::Status ChooseAdjustmentDate(std::string_view dataFolder, std::string_view code,
                                      std::string_view adjDate, DateChoice& out);
// The record an entry of the list stands for.
inline int RecordOfEntry(const DateChoice& c, int entry) {
    return c.FirstShown + entry;
}
std::string EntryLine(std::string_view yyyymmdd, float close);

// ---- Applying and removing ----------------------------------------------------------------

enum class VolumeRule {
    Scaled,  // the manual adjustment: volumes scaled with the prices
    Unscaled // the bulletin run: volumes left as they are
};

struct AdjustmentJob {
    std::string DataFolder;    // holds <code>.WDT
    std::string ChtMiscFolder; // holds <code>.txt notes and <code>.TND trendlines
    std::string Code;
    int AdjRecord = 0; // 1-based
    float AdjFactor = 0;
    std::string AdjNote;
    std::string NoteColour; // the colour written as the notes' sixth field
    VolumeRule Volumes = VolumeRule::Scaled;
};

struct Applied {
    std::string Date; // "yyyymmdd" of AdjRecord
    int RecordsScaled = 0;
};

// `ApplyAdjustment`: writes note and factor on AdjRecord, scales every record from it back to
// record 1 whose close is not 0 (prices to four decimals, ties to even; volumes by the rule),
// rewrites the file through a scratch file, then rescales the chart notes of the security (a
// failure there is ignored). Nothing is written when any value would not fit its field.
platform::Status ApplyAdjustment(const AdjustmentJob& job, Applied& out);

// "Adjustments made to" + line feed + code.
std::string AdjustmentsMadeText(std::string_view code);

// The chart notes `<code>.txt` of a security after an adjustment to `lastDate`: prices of notes
// dated on or before it scaled; the sixth field becomes `colour`. Failures are ignored.
void AdjustChartNotes(std::string_view chtMiscFolder, std::string_view code,
                      std::string_view lastDate, float factor, std::string_view colour);

// The trendlines of a security after an adjustment to `date`: each end dated on or before it
// has its price scaled (files of one record are left alone).
platform::Status ScaleTrendLines(std::string_view chtMiscFolder, std::string_view code,
                                 float factor, std::string_view date);

inline constexpr int kRemovalTableSize = 20;

struct Removed {
    int Entries = 0;  // adjustments found on file before this removal (0: none, nothing done)
    int Record = 0;   // the record whose adjustment was taken off
    float Factor = 0; // its factor
    std::string Date; // "yyyymmdd" of that record
    std::string Note; // the note it carried, trimmed
};

// `RemoveLatestAdjustment`, one step: finds the adjustments from record 2 up, takes the last,
// multiplies prices from it back to record 1 by 1/f and clears its note and factor. Volumes
// stay. More than twenty adjustments on file is refused, the file unchanged.
platform::Status RemoveLatestAdjustment(std::string_view dataFolder, std::string_view code,
                                        Removed& out);
std::string LatestRemovedText(std::string_view code); // "Latest adjustment removed for " + code

} // namespace kori::adjust
