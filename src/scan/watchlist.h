#pragma once
// Watchlists: up to ten named lists of securities the user follows, each row a code with what
// the user paid and holds, worked against the last days of its price file.
//
// The lists live in Watchlists.txt in the install root, a plain text file:
//
//   # a line that starts with '#' is a comment; blank lines are skipped
//   [Name of the list]
//   CODE,entry date,entry price,quantity,note
//
// A "[...]" line opens a list; each line after it until the next list is one row. Only the code
// is required: "BHP" alone is a row, and so is "BHP,20240105,45.2,100,bought on the dip". The
// entry date is "yyyymmdd", the price and quantity plain decimal numbers, and the note is the
// rest of the line, commas and all. Reading is tolerant: a line that cannot be used (a row
// before any list, a bad code, date or number, an eleventh list, a list named twice) is
// reported as an issue with its line number and left out; the rest is read.
#include "platform/issues.h"
#include "platform/status.h"
#include "scan/snapshot.h"
#include "store/targets_file.h"

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::scan {

inline constexpr int kMaxWatchlists = 10;
inline constexpr std::size_t kMaxWatchlistName = 30;
inline constexpr std::string_view kWatchlistsFile = "Watchlists.txt";
// The list a code goes to when there is none yet.
inline constexpr std::string_view kFirstWatchlist = "Watchlist";

struct WatchEntry {
    std::string Code;      // upper case, as typed
    std::string EntryDate; // "yyyymmdd" or empty
    std::optional<double> EntryPrice, Quantity;
    std::string Note;
};

struct Watchlist {
    std::string Name;
    std::vector<WatchEntry> Entries;
};

class WatchlistBook {
public:
    std::vector<Watchlist> Lists;

    // Watchlists.txt in the install root, found whatever the case of its name.
    static std::filesystem::path PathIn(std::string_view systemFolder);
    // An absent file is an empty book; bad lines go to `issues`.
    static WatchlistBook Read(const std::filesystem::path& file, platform::Issues& issues);
    static WatchlistBook Parse(std::string_view text, const std::string& fileName,
                               platform::Issues& issues);
    std::string Text() const;
    // Written beside the old file and renamed over it.
    platform::Status Write(const std::filesystem::path& file) const;

    // By name, blanks and case aside; null when absent.
    Watchlist* Find(std::string_view name);
    const Watchlist* Find(std::string_view name) const;

    platform::Status AddList(std::string_view name);
    platform::Status RenameList(std::string_view from, std::string_view to);
    platform::Status DeleteList(std::string_view name);
    // The code once in a list: a second add of the same code is refused.
    platform::Status AddEntry(std::string_view list, WatchEntry entry);
    platform::Status RemoveEntry(std::string_view list, std::string_view code);
};

// "CODE" or "CODE@PRICE" of the command line; an error for a bad code or price.
platform::Status ParseWatchAdd(std::string_view text, WatchEntry& entry);
// A whole entry checked as the file would check it (code, date, numbers), upper-casing the code.
platform::Status CheckWatchEntry(WatchEntry& entry);

// One row worked out: the last traded day and the year's range as the snapshot has them, the
// entry against the last close, and the targets of Targets.txt that the last record met.
struct WatchRow {
    WatchEntry Entry;
    std::string Name;
    std::string Problem; // "not in the name file", "no price file": why figures are missing
    std::string Date;    // "yyyymmdd" of the last traded record
    std::optional<double> Close, Change, ChangePercent, VolumeRatio;
    std::optional<double> SinceEntry, SinceEntryPercent, Value;
    std::optional<double> YearHigh, YearLow;
    std::string Target; // "1.50 target reached UP", lines joined by "; "
};

std::vector<WatchRow> ComputeWatchlist(const Watchlist& list, std::string_view dataFolder,
                                       const std::vector<store::TargetLine>& targets,
                                       const SnapshotSettings& settings);

enum WatchColumn {
    kWatchCode,
    kWatchName,
    kWatchDate,
    kWatchClose,
    kWatchChange,
    kWatchChangePercent,
    kWatchVolumeRatio,
    kWatchEntryDate,
    kWatchEntryPrice,
    kWatchQuantity,
    kWatchSinceEntry,
    kWatchSinceEntryPercent,
    kWatchValue,
    kWatchHigh,
    kWatchLow,
    kWatchTarget,
    kWatchNote,
    kWatchColumns
};

std::vector<std::string> WatchHeaders();
// The row as the grid shows it, one text a column; a missing figure is empty.
std::vector<std::string> WatchCells(const WatchRow& row);
// Figures as numbers, empties last whichever way; text columns as text. Stable.
void SortWatchRows(std::vector<WatchRow>& rows, int column, bool ascending);
std::string WatchCsv(const std::vector<WatchRow>& rows);

} // namespace kori::scan
