#pragma once
// The update from downloaded day files: each waiting file is checked whole, then its records go
// into the price files of the target folder (new securities are added to Names.dat), and the
// securities that did not trade get a flat filler record.
//
// Writes keep every file whole: a record at the end of a price file or of Names.dat is one
// append; an insert, a replace, a corrected volume or a re-run advance/decline total rewrites
// the price file beside itself and renames it over the old one. A file error stops the update
// with a message that names the file; what was written before it stays valid.
#include "intake/download_line.h"
#include "platform/dialogs.h"
#include "platform/ini_file.h"
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "platform/status.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

namespace kori::intake {

enum class FileState { Normal = 0, Insert = 1, Replace = 2, Cancelled = 5 };
std::string_view StateName(FileState state); // "normal", "insert", "replace", "cancelled"

// The folders of the data types, in the order of ChtPaths.lst.
enum DataTypeFolder : std::size_t {
    kStocksFolder = 0,
    kIndicesFolder = 1,
    kFuturesFolder = 2,
    kOverseasFolder = 3,
    kOptionsFolder = 4,
    kUkStocksFolder = 5,
    kUkIndicesFolder = 6,
    kLiffeFolder = 7,
};

// One market segment of the service that delivers a bundle of files a day.
struct Segment {
    std::string_view Label;      // "INDICES " ...
    std::string_view Extension;  // ".dix" ...
    std::size_t Folder;          // index into the data-type folders
    std::int16_t RecordType;     // of a new security
    std::string_view Letter;     // market letter of a new security
    std::string_view FolderText; // message when the folder is not set; empty: skipped silently
};
const std::array<Segment, 8>& Segments();

struct UpdateSettings {
    int DataService = 4;
    std::string DownloadFolder; // all folders with a closing '/'
    std::string DataFolder;
    std::string SystemFolder;
    bool UpdateAll = true;
    bool NoWarrants = false;
    std::int32_t VolumeDivisor = 1;
    std::int16_t RefreshFreq = 50;
    std::array<std::string, 8> SegmentFolders; // ChtPaths.lst order; service 3 only
};

// What the update hands on to other parts of the system when a run ends (services 1 and 3).
// None is installed by default; an empty function is not called.
struct UpdateHooks {
    std::function<void(const std::string& folder, const std::string& dateStem)>
        UpdateAdjustmentsList;
    std::function<void()> RefreshSecurityDetails;
    std::function<void()> RefreshSecurityProperties;
};

struct UpdateHost {
    platform::Dialogs& Dialogs;
    platform::Progress& Progress;
    platform::SettingsStore* Store = nullptr; // IntraDay is read here
    platform::IniFile* Ini = nullptr;         // a corrected RefreshFreq is saved here
};

// What happened to one file (one segment of a bundle).
struct SegmentResult {
    std::string File; // the file's name
    std::string Segment;
    FileState State = FileState::Normal;
    int Records = 0; // records written into price files
    int NewSecurities = 0;
    int Fillers = 0;
    std::string RenamedTo; // name after the run, empty when not renamed
};

struct RunResult {
    std::vector<SegmentResult> Files;
    platform::Issues Issues; // securities refused and skipped, with the reason
    bool Failed = false;     // a file error stopped the update
    bool Stopped = false;    // the cancel flag stopped it
    bool RemoveItem = false; // the list item goes (no more files follow, not cancelled)
    std::string CurrentDataFolder;
    FileState LastState = FileState::Normal;
};

// Updates from one waiting file of the download folder (`fileName` as the list shows it).
// `updateDate` is "yyyymmdd" (see UpdateDateFromItem). `settings.RefreshFreq` is corrected in
// place when out of range.
RunResult RunDownloadUpdate(UpdateSettings& settings, const UpdateHost& host,
                            const UpdateHooks& hooks, const std::string& fileName,
                            const std::string& updateDate, bool moreFilesFollow);

// --- Steps, open for the tests and the benchmarks ---------------------------------------------

struct CheckInput {
    int DataService = 4;
    std::string Segment;      // empty outside the bundle service
    std::string TargetFolder; // the price files the decision reads
    bool OptionsFile = false;
    bool SharedStocksIndices = false;
    std::string DateStem;    // last 7 characters of the day's stem
    std::string IntraDay;    // the IntraDay setting as stored
    bool SkipPrompt = false; // carried from the previous segment of the run
};

struct CheckResult {
    FileState State = FileState::Normal;
    bool EmptyFile = false;
    bool IntraDay = false;
    bool SkipPrompt = false;
    std::vector<DownloadLine> Lines; // every line, parsed
    std::size_t StartLine = 0;       // the update starts here (after a blank code)
    std::string Error;               // why the file was refused, if it was (not a user's cancel)
};

// Reads the whole file, refuses it when any line has the wrong number of fields, and decides
// from one security how the day goes in. Writes nothing but the blank-line clean-up of service 4.
CheckResult CheckDownloadFile(const std::filesystem::path& path, const CheckInput& input,
                              platform::Dialogs& dialogs, platform::Progress& progress);

// Where a record of `newDate` goes in a file whose dates are `dates` (oldest first, not empty).
struct InsertPosition {
    int Position = 0;       // 1-based
    bool Overwrite = false; // write over the record there; else shift and insert (or append)
};
InsertPosition FindInsertPosition(const std::vector<double>& dates, double newDate,
                                  FileState state);
// The same walk over a file read by record number (1-based), so a long file is read only as far
// back as the walk goes.
InsertPosition FindInsertPosition(int count, const std::function<double(int)>& dateAt,
                                  double newDate, FileState state);

struct FillResult {
    platform::Status Status;
    int Fillers = 0;
    bool Cancelled = false;
};
// A flat record for every security of type 4 whose last record is older than `dayDate`; in an
// options folder, expired options are marked by name instead.
FillResult FillNoTradeDays(const std::string& folder, const std::string& dayDate,
                           const std::string& updateDate, bool optionsFile,
                           platform::Progress& progress);

} // namespace kori::intake
