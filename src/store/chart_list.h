#pragma once
// Chart lists: the user's own orders of securities, SubListA.Dat .. SubListK.Dat and the scan
// list SubListZ.Dat beside Names.dat, each entry a name-file record number and a code.
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "platform/status.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

struct ChartListEntry {
    static constexpr std::size_t kSize = 8;
    std::int16_t NameRecord = 0;
    std::string Code; // 6

    std::array<char, kSize> Encode() const;
    static ChartListEntry Decode(const char* bytes);
};

// List mode 2..11 are the lists A..K (no I), 12 the list Z.
inline constexpr std::array<char, 11> kListLetters = {'A', 'B', 'C', 'D', 'E', 'F',
                                                      'G', 'H', 'J', 'K', 'Z'};
// Letter of a list mode, or 0 for the full list and modes out of range.
char ListLetterOfMode(int listMode);
std::filesystem::path ListPath(std::string_view dataFolder, char letter);

platform::Status ReadList(const std::filesystem::path& path, std::vector<ChartListEntry>& out);
platform::Status WriteList(const std::filesystem::path& path, const std::vector<ChartListEntry>& entries);

// Display names of the ten user lists ("Chart List A" ... by default).
std::array<std::string, 10> GetSubLists(const platform::SettingsStore& store);
void SaveSLNames(platform::SettingsStore& store, const std::array<std::string, 10>& names);

// Saves a list from a box of codes: each non-blank line found in Names.dat (trimmed compare,
// first match) becomes an entry; codes not found are dropped in silence.
platform::Status SaveListFromCodes(std::string_view dataFolder, char letter,
                                   const std::vector<std::string>& codes);

// Re-links every user list to the record numbers of the name file as it now stands. Stops
// between lists when the progress reports a cancel. Returns the number of lists rewritten.
int RelinkLists(std::string_view dataFolder, platform::Progress& progress);

// A line of an imported text file is a code when it has 1 to 6 letters or digits only.
bool IsImportableCode(std::string_view line);

// Builds TmpNames.tmp in the data folder: the name records of a list in its order, each with
// Base holding its record number. Entries out of range are skipped.
platform::Status BuildTmpNames(std::string_view dataFolder, std::string_view listFileName);

// " There are no records in <name> for this folder." ... the message of an empty list.
std::string EmptyListMessage(std::string_view displayName);
std::string EmptyListTitle(std::string_view dataFolder);

} // namespace kori::store
