#pragma once
// The name file held against the price files of its folder: name records with no price file,
// price files with no name record, codes entered twice, codes not in upper case. The two
// remedies (add the missing name records, remove the entries without data) rewrite the name
// file the way the name editor saves it, back-up and chart-list re-linking included. Entries
// marked deleted are neither reported nor written again.
#include "platform/progress.h"
#include "platform/status.h"

#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

namespace name_finding {
inline constexpr std::string_view NoPriceFile = "No price file";
inline constexpr std::string_view NoNameRecord = "No name record";
inline constexpr std::string_view Duplicated = "Code duplicated";
inline constexpr std::string_view NotUpperCase = "Code not in upper case";
} // namespace name_finding

struct NameFileFinding {
    std::string Code;   // as the name record holds it, or the price file's base name
    int Record = 0;     // 1-based; 0 for a price file without a name record
    std::string What;   // one of name_finding
    std::string Detail; // the file, the earlier record, ...

    friend bool operator==(const NameFileFinding&, const NameFileFinding&) = default;
};

struct NameCheckResult {
    platform::Status Status;
    std::vector<NameFileFinding> Findings; // name records in file order, then price files by name
    int Records = 0;                       // name records read, deleted ones included
    int PriceFiles = 0;

    int Count(std::string_view what) const;
};

NameCheckResult CheckNameFile(std::string_view dataFolder);

struct NameFixResult {
    platform::Status Status;
    int Added = 0;
    int Removed = 0;
};

// Reads the folder again and rewrites the name file once: new entries (type 4, name blank) at
// the end for price files without one when `addMissing`, entries whose price file is missing
// dropped when `removeWithoutData`. Nothing is written when there is nothing to do.
NameFixResult FixNameFile(std::string_view dataFolder, bool addMissing, bool removeWithoutData,
                          platform::Progress& progress);

} // namespace kori::maint
