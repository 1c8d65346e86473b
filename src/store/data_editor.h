#pragma once
// The rules of the data-file editor over rows of cell texts: one row a record, row number =
// record number, with the fields the grid does not show (`Flag`, `Reserved`) carried after the
// shown cells so a save writes them back as they were read.
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/status.h"
#include "store/name_editor.h"
#include "store/price_file.h"

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

enum DataColumn : int {
    kDataRec,
    kDataDate,
    kDataOpen,
    kDataHigh,
    kDataLow,
    kDataClose,
    kDataVolume,
    kDataAdjFactor,
    kDataAdjDesc,
    kDataShownColumns,
    kDataFlag = kDataShownColumns,
    kDataReserved,
    kDataAllColumns
};
inline constexpr int kDataHiddenColumns = kDataAllColumns - kDataShownColumns;

std::vector<std::string> DataGridHeaders();

// Columns 3 to 7 numeric (the volume a whole number that fits the file), the date as it
// stands. The record number and the adjustment factor are not edited at all (the model refuses
// any change to them); here they pass.
CellRule CheckDataCell(int column, const std::string& text);

TextRow DataRowOf(const PriceRecord& record, int recordNumber);
PriceRecord PriceRecordOf(const TextRow& row);

// What loading a price file gives the editor: its rows in record order, or the message (and
// title) that says why there are none.
struct DataLoad {
    bool Ok = false;
    std::vector<TextRow> Rows;
    std::string Message;
    std::string Title;
    platform::Issues Issues; // records whose prices are not numbers
};
// `reportEvery` records move the progress (the window's bar moves each ten).
DataLoad LoadDataRows(const std::filesystem::path& file, std::string_view code,
                      platform::Progress& progress, int reportEvery = 10);

// Writes the rows as the file, row i at record i, beside the old file and renamed over it; the
// old content kept as Temp.WRK in the same folder first.
platform::Status SaveDataRows(const std::filesystem::path& file, const std::vector<TextRow>& rows,
                              platform::Progress& progress);

// The rows in order of the numeric value of their dates (the Shell sort; equal dates in any
// order), written as the file through Temp.Wk2 and read back into `sorted`.
platform::Status SortDataRows(const std::filesystem::path& file, const std::vector<TextRow>& rows,
                              platform::Progress& progress, std::vector<TextRow>& sorted);

namespace data_text {
inline constexpr std::string_view kNotFound = " NOT FOUND";
inline constexpr std::string_view kTitle = "Data File";
inline constexpr std::string_view kNoData = "No data on file for ";
inline constexpr std::string_view kCannotEdit = "Cannot edit this column";
inline constexpr std::string_view kCellTitle = "Data";
inline constexpr std::string_view kNotNumeric = "Data must be numeric";
inline constexpr std::string_view kSaving = "SAVING -  WAIT";
inline constexpr std::string_view kSavingLabel = "SAVING - WAIT";
inline constexpr std::string_view kSaveTitle = "SAVE DATA FILE ";
inline constexpr std::string_view kSaveFailed = "Unable to save data";
inline constexpr std::string_view kSorting = "NOW SORTING DATA FILE  -  WAIT";
inline constexpr std::string_view kChanged = "Data File has changed";
// "SAVE " + code + "?"
std::string SaveQuestion(std::string_view code);
} // namespace data_text

} // namespace kori::store
