#pragma once
// The running list of market maintenance items (Adjust.Lst): filled from each day's bulletins
// after a download update, marked by the user, and carried out on the name file and the price
// files. Every file is replaced beside-and-rename, so a run stopped anywhere leaves each file as
// it was before its item or as it is after it.
#include "adjust/bulletin_filter.h"
#include "platform/progress.h"
#include "platform/status.h"

#include <array>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::adjust {

inline constexpr std::string_view kListFile = "Adjust.Lst";
inline constexpr std::string_view kListScratch = "Adjust.Tmp";
inline constexpr std::string_view kCheckingList = "Checking and updating adjustments list.";
inline constexpr std::string_view kItemsAddedTitle = "Adjustment List";
inline constexpr std::string_view kItemsAdded =
    "There have been maintenance items added to the Adjustment List";
inline constexpr std::size_t kMaxFields = 15;
inline constexpr std::size_t kTrimAt = 16000; // a list this long ...
inline constexpr std::size_t kTrimTo = 10000; // ... keeps its newest lines only

// One line of the list, its comma-separated fields (at most 15; the last keeps any further
// commas). Fields are numbered from 1 as the users know them.
struct ListItem {
    std::vector<std::string> Fields;

    std::string Field(std::size_t n) const; // "" when absent
    void SetField(std::size_t n, std::string value);
    std::string Action() const { return Field(1); }
    std::string Code() const { return Field(2); }
    std::string Indicator() const { return Field(5); }
    std::string Line() const;
};

ListItem ParseListLine(std::string_view line);
// Sort rank of an action: NI 1, NC 2, DC 3, SP 4, BI 5, PC 6, DI 7, anything else 8.
int ActionRank(std::string_view action);
// Stable: items of the same rank keep their order.
void SortByRank(std::vector<ListItem>& items);

// The list of a data folder; an absent file is an empty list.
platform::Status ReadAdjustmentList(std::string_view folder, std::vector<ListItem>& items);
// Replaces the list through Adjust.Tmp.
platform::Status WriteAdjustmentList(std::string_view folder, const std::vector<ListItem>& items);

// ---- Filling the list from a day's bulletins -----------------------------------------------

struct BulletinKind {
    std::string_view Input; // after the date stem: ".Asx.Btn" ...
    std::string_view Copy;  // ".Asx.Btx" ...
    bool WarrantFilter;
};
// In the order they are processed.
const std::array<BulletinKind, 6>& BulletinKinds();

struct ListSettings {
    std::string In, Out;       // the download program's folders; blank or "unknown": no run
    std::string OptionsFolder; // the options data folder, for the options-library test
    bool NoWarrants = false;
    bool NoShortNames = false;
    DividendRule Divs = DividendRule::Leave;
};

struct ListUpdate {
    int BulletinsFiltered = 0;
    int LinesAdded = 0;
    bool NewItems = false; // the list gained lines: the user is told after the update
    bool Trimmed = false;
};

// An options library exists when the options folder is not the default data folder and its
// Names.dat holds more than 10 records.
bool HasOptionsLibrary(std::string_view optionsFolder);

// `UpdateAdjustmentsList`: each bulletin of the day whose copy in Out is still absent is
// filtered into `folder`'s Adjust.Lst and then copied, the copy marking the day as done; then
// a list of 16,000 lines or more keeps its newest 10,000.
platform::Status UpdateAdjustmentsList(std::string_view folder, std::string_view dateStem,
                                       const ListSettings& settings, platform::Progress& progress,
                                       ListUpdate& out);

// ---- Carrying the items out ----------------------------------------------------------------

// The folder of each data type, in the order of the folder list (stocks, indices, futures,
// overseas, options, UK stocks, UK indices, Liffe).
using DataFolders = std::array<std::string, 8>;

struct MakeSettings {
    int DataService = 4;
    std::string DataFolder;    // the list's folder; every item's folder outside service 3
    DataFolders Folders;       // service 3: the folder by market tag
    std::string ChtMiscFolder; // chart notes and trendlines
    std::string NoteColour;    // written into rescaled chart notes
    std::string Today;         // "yyyymmdd"
    // Volume powers of ten for price corrections: per market tag ("IDX", "OVS") and, for
    // overseas securities, per code. Absent: 1.
    std::function<double(std::string_view tag)> MarketVolumeScale;
    std::function<double(std::string_view code)> OverseasVolumeScale;
    // Told of the row about to be processed (the window keeps it in view).
    std::function<void(std::size_t row)> OnRow;
};

struct MakeReport {
    std::vector<std::string> Messages; // "Adjustment :" ..., "Name Change :" ..., "Removal :" ...
    int ItemsRun = 0;
    int ItemsRemoved = 0;
    bool NameFileCompacted = false;
};

// A power of ten stored as -4 to 4 as a volume multiplier (0 gives 1, -1 gives 0.1 ...).
double PowerOfTen(int power);

// Folder of an item by its market tag (field 3); empty when none is defined.
std::string FolderForItem(const MakeSettings& s, const ListItem& item);

// `MakeAdjustments`: runs every Y item, marks it D, marks stale unprocessed listings D, compacts
// the name file after code changes and delistings (Names.bak, TempName.dat), re-links the chart
// lists, drops the D items, rewrites the list and removes the *.Old files. `items` is left as
// the list now stands.
platform::Status MakeAdjustments(const MakeSettings& settings, std::vector<ListItem>& items,
                                 platform::Progress& progress, MakeReport& report);

// One item on its folder (open for the tests); the message, empty when nothing was done.
platform::Status RunItem(const MakeSettings& settings, const ListItem& item,
                         std::string_view folder, std::string& message, bool& nameFileChanged);

// A date of the list ("ddMMMyy" or "yyyymmdd") as "yyyymmdd"; empty when it is not a date.
std::string ListDate(std::string_view text);

} // namespace kori::adjust
