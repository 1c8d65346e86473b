#pragma once
// KoriName.Mas in the system folder: the download service's list of every security it
// delivers, fixed records of 62 bytes, each the code, blanks, then the name. The update list
// offers its records; the name editor takes names from it.
#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

inline constexpr std::size_t kMasterRecord = 62;
inline constexpr std::string_view kMasterFile = "KoriName.Mas";
inline constexpr std::string_view kMasterMissing = "KORI Master list is missing";
inline constexpr std::string_view kMasterDownload = "Download from the KORI web page";

// The records as text, trimmed on the right; nullopt when the file is missing. A record may
// close with its own line end, which is not part of its text; a short tail is ignored.
std::optional<std::vector<std::string>> ReadMasterRecords(std::string_view systemFolder);

struct MasterEntry {
    std::string Code; // upper case
    std::string Name;
};
// The code is the record's first word, the name what follows it.
MasterEntry ParseMasterRecord(std::string_view record);

// Code to name over every record with a code; the first record of a code wins.
std::map<std::string, std::string> MasterNames(const std::vector<std::string>& records);

} // namespace kori::store
