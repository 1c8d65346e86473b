#include "store/data_editor.h"

#include "platform/files.h"
#include "platform/rounding.h"
#include "platform/text.h"
#include "store/editor_cells.h"
#include "store/shell_sort.h"

#include <cmath>
#include <limits>

namespace kori::store {

using platform::Status;
using platform::Trim;
namespace dt = data_text;

std::string data_text::SaveQuestion(std::string_view code) {
    return "SAVE " + Trim(code) + "?";
}

std::vector<std::string> DataGridHeaders() {
    return {"Rec", "Date", "Open", "High", "Low", "Close", "Volume", "Adj.Factor", "Adj.Desc."};
}

CellRule CheckDataCell(int column, const std::string& text) {
    if (column < kDataOpen || column > kDataVolume) return {true, text, {}, {}};
    const auto v = CellNumber(text);
    if (!v) return {false, text, std::string(dt::kNotNumeric), std::string(dt::kCellTitle)};
    if (column == kDataVolume) {
        if (!platform::CLng(*v))
            return {false, text, "Volume must be a whole number up to 2147483647",
                    std::string(dt::kCellTitle)};
    } else if (std::fabs(*v) > static_cast<double>(std::numeric_limits<float>::max())) {
        return {false, text, "Price is too large for the file", std::string(dt::kCellTitle)};
    }
    return {true, Trim(text), {}, {}};
}

TextRow DataRowOf(const PriceRecord& r, int recordNumber) {
    TextRow row(kDataAllColumns);
    row[kDataRec] = std::to_string(recordNumber);
    row[kDataDate] = r.Date;
    row[kDataOpen] = CellFloat(r.Open);
    row[kDataHigh] = CellFloat(r.High);
    row[kDataLow] = CellFloat(r.Low);
    row[kDataClose] = CellFloat(r.Close);
    row[kDataVolume] = std::to_string(r.Volume);
    row[kDataAdjFactor] = CellFloat(r.AdjFactor);
    row[kDataAdjDesc] = Trim(r.AdjDesc);
    row[kDataFlag] = r.Flag;
    row[kDataReserved] = r.Reserved;
    return row;
}

namespace {
float PriceOf(const std::string& text) {
    if (const auto v = CellNumber(text)) return static_cast<float>(*v);
    return static_cast<float>(platform::Val(text));
}
} // namespace

PriceRecord PriceRecordOf(const TextRow& in) {
    TextRow row = in;
    row.resize(kDataAllColumns);
    PriceRecord r;
    r.Date = row[kDataDate];
    r.Open = PriceOf(row[kDataOpen]);
    r.High = PriceOf(row[kDataHigh]);
    r.Low = PriceOf(row[kDataLow]);
    r.Close = PriceOf(row[kDataClose]);
    const auto volume = CellNumber(row[kDataVolume]);
    r.Volume = volume ? platform::CLng(*volume).value_or(0) : 0;
    // The factor is never edited here: a value the file held (even one that is not a number)
    // goes back as it came.
    r.AdjFactor = row[kDataAdjFactor] == "NaN"         ? std::numeric_limits<float>::quiet_NaN()
                  : row[kDataAdjFactor] == "Infinity"  ? std::numeric_limits<float>::infinity()
                  : row[kDataAdjFactor] == "-Infinity" ? -std::numeric_limits<float>::infinity()
                                                       : PriceOf(row[kDataAdjFactor]);
    r.AdjDesc = row[kDataAdjDesc];
    if (!row[kDataFlag].empty()) r.Flag = row[kDataFlag];
    r.Reserved = row[kDataReserved];
    return r;
}

DataLoad LoadDataRows(const std::filesystem::path& file, std::string_view code,
                      platform::Progress& progress, int reportEvery) {
    DataLoad load;
    load.Title = std::string(dt::kTitle);
    if (!platform::FileExists(file)) {
        load.Message = file.filename().string() + std::string(dt::kNotFound);
        return load;
    }
    PriceFile pf(file);
    std::vector<PriceRecord> records;
    if (auto s = pf.ReadAll(records); !s) {
        load.Message = s.message();
        return load;
    }
    if (records.empty()) {
        load.Message = std::string(dt::kNoData) + Trim(code);
        return load;
    }
    const int n = static_cast<int>(records.size());
    progress.SetRange(n);
    load.Rows.resize(records.size());
    // From the last record to the first, as the grid is filled; the bar moves every few.
    for (int i = n; i >= 1; --i) {
        const PriceRecord& r = records[static_cast<std::size_t>(i - 1)];
        load.Rows[static_cast<std::size_t>(i - 1)] = DataRowOf(r, i);
        if (!std::isfinite(r.Open) || !std::isfinite(r.High) || !std::isfinite(r.Low) ||
            !std::isfinite(r.Close))
            load.Issues.push_back(
                {platform::Severity::Warning,
                 "Record " + std::to_string(i) + " holds a price that is not a number",
                 file.filename().string(), i});
        if (reportEvery > 0 && (n - i + 1) % reportEvery == 0) progress.SetValue(n - i + 1);
    }
    progress.SetValue(n);
    load.Ok = true;
    return load;
}

Status SaveDataRows(const std::filesystem::path& file, const std::vector<TextRow>& rows,
                    platform::Progress& progress) {
    progress.SetStatus(dt::kSaving);
    progress.SetRange(static_cast<long long>(rows.size()));
    std::vector<PriceRecord> records;
    records.reserve(rows.size());
    for (std::size_t i = 0; i < rows.size(); ++i) {
        records.push_back(PriceRecordOf(rows[i]));
        if ((i + 1) % 256 == 0) progress.SetValue(static_cast<long long>(i + 1));
    }
    PriceFile pf(platform::ResolvePath(file));
    if (auto s = pf.WriteAll(records, {"", "Temp.WRK"}); !s) return s;
    progress.SetValue(static_cast<long long>(rows.size()));
    return Status::Ok();
}

Status SortDataRows(const std::filesystem::path& file, const std::vector<TextRow>& rows,
                    platform::Progress& progress, std::vector<TextRow>& sorted) {
    progress.SetStatus(dt::kSorting);
    progress.SetRange(100);
    struct Entry {
        double Date;
        std::size_t Index;
    };
    std::vector<Entry> keys;
    keys.reserve(rows.size());
    for (std::size_t i = 0; i < rows.size(); ++i)
        keys.push_back({platform::Val(rows[i][kDataDate]), i});
    progress.SetValue(20);
    ShellSort(keys, [](const Entry& a, const Entry& b) { return a.Date < b.Date; });
    progress.SetValue(40);
    std::vector<PriceRecord> records;
    records.reserve(rows.size());
    for (const Entry& e : keys)
        records.push_back(PriceRecordOf(rows[e.Index]));
    PriceFile pf(platform::ResolvePath(file));
    if (auto s = pf.WriteAll(records, {"Temp.Wk2", ""}); !s) return s;
    progress.SetValue(60);
    std::vector<PriceRecord> back;
    if (auto s = pf.ReadAll(back); !s) return s;
    sorted.clear();
    sorted.reserve(back.size());
    for (std::size_t i = 0; i < back.size(); ++i)
        sorted.push_back(DataRowOf(back[i], static_cast<int>(i + 1)));
    return Status::Ok();
}

} // namespace kori::store
