#pragma once
// The rules of the name-file editor over rows of cell texts: what each cell accepts, what a
// save checks and writes, the four sort orders and the clean-ups of the menu. The rows carry,
// after the shown columns, the fields the grid does not show, so that a save or a sort writes
// them back as they were read.
#include "platform/ini_file.h"
#include "platform/progress.h"
#include "platform/status.h"
#include "store/name_record.h"

#include <array>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

using TextRow = std::vector<std::string>;

// Shown columns of the grid, then the hidden ones.
enum NameColumn : int {
    kNameRec,
    kNameCode,
    kNameType,
    kNameCat,
    kNameIndustry,
    kNameGics,
    kNameName,
    kNameOther,
    kNameBase,
    kNameTop,
    kNamePFInc,
    kNameId,
    kNameShownColumns,
    kNameStatus = kNameShownColumns,
    kNameScaleStep,
    kNameBandUp,
    kNameBandDown,
    kNameBollingerPeriod,
    kNameBollingerWidth,
    kNameReserved,
    kNameAllColumns
};
inline constexpr int kNameHiddenColumns = kNameAllColumns - kNameShownColumns;

std::vector<std::string> NameGridHeaders();

// The answer to a cell the user left: the text to keep, or the message and its title.
struct CellRule {
    bool Accepted = true;
    std::string Text;
    std::string Message;
    std::string Title;
};

CellRule CheckNameCell(int column, const std::string& text);

// One record as a row (shown and hidden cells), and back. Numbers read by their value; the
// code upper-cased, texts trimmed.
TextRow NameRowOf(const NameRecord& record, int recordNumber);
NameRecord NameRecordOf(const TextRow& row);

// The check of every row before a save: a row with a type but no code, or a code without a
// type of 1 to 5, stops the save at that cell. Rows with neither pass.
struct RowRefusal {
    int Row = 0; // 0-based
    int Column = 0;
    std::string Message;
    std::string Title;
};
std::optional<RowRefusal> CheckNameRows(const std::vector<TextRow>& rows);

// The records a save writes: one a row with a code (blank-code rows close up), `Status` 0, the
// hidden fields as the row carries them.
std::vector<NameRecord> NameRecordsToSave(const std::vector<TextRow>& rows);

// Writes Names.dat beside the old one and renames it over it, the old content kept as
// names.bak first. On failure the old file stands and the message says why.
platform::Status SaveNameFile(std::string_view dataFolder, const std::vector<NameRecord>& records);

enum class NameSortOrder { Code, Category, Industry, Gics };

using NameSortKey = std::array<char, 12>;
NameSortKey SortKeyOf(const NameRecord& record, NameSortOrder order);

// The records in key order, those with `Status` 1 left out.
std::vector<NameRecord> SortNameRecords(const std::vector<NameRecord>& records,
                                        NameSortOrder order);

// The sort as the editor runs it through its scratch files in the data folder: the grid's
// records to Temp.WK2, sorted into Temp.Wk1, which then takes Temp.WK2's place; `sorted` is read
// back from it. Progress shows 40, 60 and 95 percent.
platform::Status SortNamesThroughFiles(std::string_view dataFolder,
                                       const std::vector<NameRecord>& records, NameSortOrder order,
                                       platform::Progress& progress,
                                       std::vector<NameRecord>& sorted);

// Whether the rows stand in order of their trimmed codes.
bool RowsInCodeOrder(const std::vector<TextRow>& rows);
// Of adjacent rows with equal codes the first stays; the number removed.
int RemoveDuplicateCodes(std::vector<TextRow>& rows);
// Rows with a six-character code and a category of 80 to 89; the number removed.
int RemoveWarrantRows(std::vector<TextRow>& rows);
// After the warrants went: the download is told to leave them out. The second key keeps the
// blank at its end, as the download settings have always been written here.
void WriteNoWarrantKeys(platform::IniFile& ini);
// Rows whose other details read "**EXPIRED**"; the number removed.
int RemoveExpiredOptionRows(std::vector<TextRow>& rows);
// Base, Top and PF Inc empty in every row.
void CleanOptionalDetails(std::vector<TextRow>& rows);
// Each word upper-case first, lower-case rest.
std::string TitleCase(std::string_view text);
void TitleCaseNames(std::vector<TextRow>& rows);
// "gd Special": other details of an option rebuilt from its name: its expiry as "d/m/yy", its
// strike, and "OC" or "OP" for the words "CALL" and "PUT". Nullopt for a name that is not an
// option's (no "CALL" or "PUT" word).
std::optional<std::string> OptionDetailsFromName(std::string_view name);
// The rows changed.
int RefreshOptionDetails(std::vector<TextRow>& rows);

// "Update Names from KORI Master list": each row whose trimmed code has an entry in `master`
// (code to name) takes that name, cut to the field and with commas dropped, so that the cell
// rules still hold. The number of rows changed.
int UpdateNamesFromMaster(std::vector<TextRow>& rows,
                          const std::map<std::string, std::string>& master);
// "Update Indust.Classifications from underlying stock": a derived security (a code longer
// than three characters whose first three are the code of another row, as options and warrants
// are coded) takes the industry class of that underlying row when the underlying has one. The
// number of rows changed.
int CopyClassFromUnderlying(std::vector<TextRow>& rows);
// "Update GICS Sectors from download": each row whose code has a numeric, non-zero sector in
// `sectors` (code to sector digits) takes it formatted "0000". The number of rows changed.
int UpdateGicsSectors(std::vector<TextRow>& rows,
                      const std::map<std::string, std::string>& sectors);

// A category typed into the prompt: 0 to 99. A record type: 4 or 5.
std::optional<std::int16_t> CategoryAnswer(std::string_view text);
std::optional<std::int16_t> RecordTypeAnswer(std::string_view text);

// Texts of the editor.
namespace name_text {
inline constexpr std::string_view kTypeRange = "Record Type must be either 1,2,3,4 or 5";
inline constexpr std::string_view kTypeTitle = "Record Type";
inline constexpr std::string_view kCategoryRange = "Category range 0 - 99";
inline constexpr std::string_view kCategoryTitle = "Category";
inline constexpr std::string_view kClassRange = "Industry Classification range 0  to 999";
inline constexpr std::string_view kClassTitle = "Industry Classification";
inline constexpr std::string_view kNoCommas =
    "Commas NOT to be used in Name or Other Details columns";
inline constexpr std::string_view kNameTitle = "Name";
inline constexpr std::string_view kCodeMissing = "Code must be entered";
inline constexpr std::string_view kTypeMissing = "Record Type must be entered";
inline constexpr std::string_view kFileTitle = "Name File";
inline constexpr std::string_view kSaveFailed = "Unable to save data";
inline constexpr std::string_view kSaveTitle = "Saving Data";
inline constexpr std::string_view kSortFirst =
    "Name file needs to be sorted by code to proceed. OK to sort list ?";
inline constexpr std::string_view kDuplicatesRemoved = " duplicate entries removed";
inline constexpr std::string_view kWarrantsWarning = "Warrants will be deleted from the Name File.";
inline constexpr std::string_view kContinue = "Do you want to continue ?";
inline constexpr std::string_view kWarrantsTitle = "Warrants";
inline constexpr std::string_view kWarrantsRemoved = " Warrants removed";
inline constexpr std::string_view kExpired = "**EXPIRED**";
inline constexpr std::string_view kUnexpected = "There is an unexpected error - ";
inline constexpr std::string_view kCurrentCategory = "Current category is ";
inline constexpr std::string_view kEnterCategory = "      Enter the category number required";
inline constexpr std::string_view kCategoryPromptTitle = "Change Category";
inline constexpr std::string_view kCurrentType = "Current record type is ";
inline constexpr std::string_view kEnterType =
    "      Enter the record type required (either 4 or 5)";
inline constexpr std::string_view kTypePromptTitle = "Change Record Type";
inline constexpr std::string_view kCleanQuestion =
    "Select OK to remove all settings from optional Base, Top and PFIncrement columns";
inline constexpr std::string_view kChangedQuestion = "File has changed. SAVE Changes?";
inline constexpr std::string_view kNoRecords = "There are no records in ";
inline constexpr std::string_view kNoRecordsTitle = "Name File List";
inline constexpr std::string_view kCaption = "NAMES.DAT";
inline constexpr std::string_view kNamesUpdated = " names updated from the master list";
inline constexpr std::string_view kClassesUpdated = " industry classifications updated";
inline constexpr std::string_view kSectorsUpdated = " GICS sectors updated";
inline constexpr std::string_view kNoSectorColumn =
    "The downloaded security details hold no GICS sector column";
inline constexpr std::string_view kNoTradeCaption =
    "NAMES.DAT         During update a NoTrade record will NOT be added to stock categories 90 "
    "to 99 ";
} // namespace name_text

// Texts the row deletion of both editors shares.
namespace delete_text {
inline constexpr std::string_view kRow = "Delete row ";
inline constexpr std::string_view kRowEnd = " ?";
inline constexpr std::string_view kItems = "Delete items ";
inline constexpr std::string_view kTo = " to ";
inline constexpr std::string_view kTitle = "Delete Rows";
inline constexpr std::string_view kOnlyTransactions = "Only transactions can be deleted";
inline constexpr std::string_view kTransactionTitle = "Delete Transaction";
} // namespace delete_text

// The question before rows first..last (1-based, as numbered in the grid) are deleted.
std::string DeleteRowsQuestion(int first, int last);

} // namespace kori::store
