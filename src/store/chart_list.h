#pragma once
// Chart lists: the user's own orders of securities, SubListA.Dat .. SubListK.Dat and the scan
// list SubListZ.Dat beside Names.dat, each entry a name-file record number and a code.
#include "platform/progress.h"
#include "platform/settings_store.h"
#include "platform/status.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <optional>
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
platform::Status WriteList(const std::filesystem::path& path,
                           const std::vector<ChartListEntry>& entries);

// Display names of the ten user lists ("Chart List A" ... by default).
std::array<std::string, 10> GetSubLists(const platform::SettingsStore& store);
void SaveSLNames(platform::SettingsStore& store, const std::array<std::string, 10>& names);

// Saves a list from a box of codes: each non-blank line found in Names.dat (trimmed compare,
// first match) becomes an entry; codes not found are dropped, and given in `dropped` for the
// window to tell the user.
platform::Status SaveListFromCodes(std::string_view dataFolder, char letter,
                                   const std::vector<std::string>& codes,
                                   std::vector<std::string>* dropped = nullptr);

// A line of an imported text file is a code when it has 1 to 6 letters or digits only.
bool IsImportableCode(std::string_view line);

// Builds TmpNames.tmp in the data folder: the name records of a list in its order, each with
// Base holding its record number. Entries out of range are skipped.
platform::Status BuildTmpNames(std::string_view dataFolder, std::string_view listFileName);

// `ShowList`: the trimmed codes of a list in its order. An absent list file is created empty,
// as opening it for the editors does.
platform::Status ShowList(std::string_view dataFolder, char letter,
                          std::vector<std::string>& codes);
// `StockList`: every trimmed code of Names.dat in file order (empty when there is no file).
std::vector<std::string> StockList(std::string_view dataFolder);
// The lines of a text file to import. Each line, its line end dropped, is trimmed and
// upper-cased (codes are upper case in the name file) before IsImportableCode; the lines that
// pass are the codes in file order, the other non-blank lines are refused, as read.
struct ImportedCodes {
    std::vector<std::string> Codes;
    std::vector<std::string> Refused;
};
// Nullopt when the file cannot be read.
std::optional<ImportedCodes> ReadImportFile(const std::filesystem::path& file);
// The codes alone.
std::optional<std::vector<std::string>> ReadImportCodes(const std::filesystem::path& file);
// The message that lists refused lines or codes to the user, under `heading`.
std::string RefusedCodesMessage(std::string_view heading, const std::vector<std::string>& refused);
inline constexpr std::string_view kImportRefusedHeading =
    "These lines are not codes (1 to 6 letters or digits) and were not imported:";
inline constexpr std::string_view kSaveDroppedHeading =
    "These codes are not in the name file and were left out of the list:";

// Display names of the lists a chooser offers: the ten user lists, and "Chart List Z" after
// them when `withZ` (the utilities may show the scan list).
std::vector<std::string> ListChoices(const platform::SettingsStore& store, bool withZ);
// List mode (2..12) of a chooser row, and back; 0 / -1 when out of range.
int ModeOfChoice(int row);
int ChoiceOfMode(int listMode);

// The box of codes an editor holds for one list between loading and SAVE: the order is the
// user's, duplicates stay, and every change marks it changed until it is saved or reloaded.
class ChartListBox {
public:
    platform::Status Load(std::string_view dataFolder, char letter);
    // SaveSubList: codes not in Names.dat are dropped (and given in `dropped`); the box then
    // shows the list as saved.
    platform::Status Save(std::string_view dataFolder, std::vector<std::string>* dropped = nullptr);

    char letter() const { return m_letter; }
    bool changed() const { return m_changed; }
    const std::vector<std::string>& codes() const { return m_codes; }

    // Inserts at `index` (appends when out of range); the code is trimmed, blanks are refused.
    bool Insert(std::size_t index, std::string_view code);
    bool Add(std::string_view code) { return Insert(m_codes.size(), code); }
    // Appends a code the box does not hold yet (a copy from another list); false otherwise.
    bool AddIfAbsent(std::string_view code);
    bool Remove(std::size_t index);
    void Clear();
    // Moves one code to another place; false when either index is out of range.
    bool Move(std::size_t from, std::size_t to);

private:
    char m_letter = 0;
    bool m_changed = false;
    std::vector<std::string> m_codes;
};

// The refusals of the list utilities and the question of a list left with changes.
inline constexpr std::string_view kListsSame = "Lists cannot be same";
inline constexpr std::string_view kBothListsShown = "Both lists must be displayed";
inline constexpr std::string_view kUtilitiesTitle = "Chart List Utilities";
std::string
ListChangedQuestion(std::string_view displayName); // name + " has changed. SAVE Changes?"

// " There are no records in <name> for this folder." ... the message of an empty list.
std::string EmptyListMessage(std::string_view displayName);
std::string EmptyListTitle(std::string_view dataFolder);

} // namespace kori::store
