#pragma once
// The facts about every security that the download service delivers as a delimited table,
// turned into a file of fixed 312-byte records sorted by code with a first-letter index, so one
// security's details are found with one short read.
#include "platform/status.h"

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

inline constexpr std::size_t kDetailsRecord = 312;
inline constexpr std::size_t kDetailsCodeWidth = 6;

// The files of one market's table: the Australian one and the London one.
struct DetailsFiles {
    const char* Source;  // in the download program's In folder
    const char* Backup;  // the source once loaded
    const char* Header;  // keys and labels, in the system folder
    const char* Records; // the fixed records, in the system folder
    bool Index;          // whether Sdix1.inx is written
};
const DetailsFiles& AsxDetailsFiles();
const DetailsFiles& UkDetailsFiles();

// The display label of a key of the table's header; a key not known keeps its own text.
std::string DetailsLabel(std::string_view key, bool london);

struct RefreshResult {
    platform::Status Status;
    bool Loaded = false; // false: no source waiting (the normal case)
    int Records = 0;
};

// Loads the waiting table of `inFolder` into the system folder: the header file, the sorted
// records, the index; the source is renamed to its back-up name. Nothing when no table waits.
RefreshResult RefreshSecurityDetails(const std::string& systemFolder, const std::string& inFolder);
RefreshResult RefreshUKSecurityDetails(const std::string& systemFolder,
                                       const std::string& inFolder);

// True for the services of the download program (1, 3) when the records and the index exist.
bool SecurityDetailsAvailable(int dataService, const std::string& systemFolder);

struct SecurityDetails {
    std::string Code;                // trimmed, as stored ("PRNX" for "PRN")
    std::string Rest;                // the rest of the line, trimmed on the right
    std::vector<std::string> Fields; // Rest split at its commas (quotes kept together)
};
// The record of `code` (any case; "PRN" is looked up as "PRNX"), or nothing.
std::optional<SecurityDetails> LookUpSecurityDetails(const std::string& systemFolder,
                                                     std::string_view code);

// Every record of the details file in file order; empty when it is missing.
std::vector<SecurityDetails> ReadAllSecurityDetails(const std::string& systemFolder);

// The keys of the header file and their labels (two lines); empty when it is missing.
struct DetailsHeader {
    std::vector<std::string> Keys;
    std::vector<std::string> Labels;
};
DetailsHeader ReadDetailsHeader(const std::string& systemFolder, bool london = false);

// The text box of the chart window, from a security's details and its last close: issue size
// "Issued  " ("#,###"), "PE Ratio  " ("0.0") and "Yield  " ("#.0%"); a figure whose divisor is 0
// (or, for the ratio, without a price) shows "n/a". The keys of the header name the fields used.
std::vector<std::string> DetailsTextBox(const DetailsHeader& header, const SecurityDetails& details,
                                        double lastClose);

// The GICS sector digits of each security from the column whose header key names the GICS
// sector (a key holding "GICS"), keyed by the stored code; nullopt when the
// downloaded table has no such column.
std::optional<std::map<std::string, std::string>>
GicsSectorsFromDetails(const std::string& systemFolder);

} // namespace kori::maint
