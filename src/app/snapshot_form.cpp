#include "app/snapshot_form.h"

#include "platform/date_text.h"
#include "platform/number_format.h"
#include "store/chart_list.h"

#include <algorithm>
#include <optional>

namespace kori::app {

namespace {

enum Column {
    kCode,
    kName,
    kDate,
    kClose,
    kChange,
    kPercent,
    kVolume,
    kRsi,
    kStochastic,
    kMacd,
    kAverage1,
    kAverage2,
    kHigh,
    kLow,
    kColumns
};

std::optional<double> Figure(const scan::SnapshotRow& r, int column) {
    switch (column) {
    case kClose:
        return r.Close;
    case kChange:
        return r.Change;
    case kPercent:
        return r.ChangePercent;
    case kVolume:
        return r.VolumeRatio;
    case kRsi:
        return r.Rsi;
    case kStochastic:
        return r.StochasticK;
    case kMacd:
        return r.MacdAboveSignal ? std::optional<double>(*r.MacdAboveSignal ? 1 : 0) : std::nullopt;
    case kAverage1:
        return r.AboveAverage1;
    case kAverage2:
        return r.AboveAverage2;
    case kHigh:
        return r.YearHigh;
    case kLow:
        return r.YearLow;
    default:
        return std::nullopt;
    }
}

std::string Cell(std::optional<double> v, const char* format) {
    return v ? platform::Format(*v, format) : std::string();
}

} // namespace

SnapshotForm::SnapshotForm(Session& session) : m_session(session) {
    m_captions.push_back("Full List (Names.Dat)");
    for (auto& c : store::ListChoices(session.services().settings, true))
        m_captions.push_back(std::move(c));
}

const scan::SnapshotResult& SnapshotForm::Run(platform::Progress& progress) {
    const store::SecurityList list{
        m_session.folders.DataFolder,
        ListIndex <= 0 ? '\0' : store::ListLetterOfMode(store::ModeOfChoice(ListIndex - 1))};
    m_result = scan::TakeSnapshot(list, scan::SnapshotSettingsFrom(m_session.ini()), progress);
    if (m_sortColumn >= 0) {
        m_ascending = !m_ascending; // Sort turns it back
        Sort(m_sortColumn);
    }
    return m_result;
}

std::vector<std::string> SnapshotForm::Headers() {
    return {"Code", "Name", "Date", "Close",       "Change",      "Change %",   "Vol/Avg",
            "RSI",  "%K",   "MACD", "Close/Av1 %", "Close/Av2 %", "52-Wk High", "52-Wk Low"};
}

GridModel SnapshotForm::Grid() const {
    GridModel grid(Headers());
    std::vector<GridModel::Row> rows;
    rows.reserve(m_result.Rows.size());
    for (const auto& r : m_result.Rows)
        rows.push_back(
            {r.Code, r.Name,
             platform::IsValidDateText(r.Date) ? platform::DateTextToDisplay(r.Date) : r.Date,
             platform::Format(r.Close, "0.000"), Cell(r.Change, "0.000"),
             Cell(r.ChangePercent, "0.00"), Cell(r.VolumeRatio, "0.00"), Cell(r.Rsi, "0.0"),
             Cell(r.StochasticK, "0.0"),
             r.MacdAboveSignal ? (*r.MacdAboveSignal ? "above" : "below") : "",
             Cell(r.AboveAverage1, "0.00"), Cell(r.AboveAverage2, "0.00"),
             platform::Format(r.YearHigh, "0.000") + (r.NewHigh ? " new" : ""),
             platform::Format(r.YearLow, "0.000") + (r.NewLow ? " new" : "")});
    grid.LoadInForm(std::move(rows));
    return grid;
}

void SnapshotForm::Sort(int column) {
    if (column < 0 || column >= kColumns) return;
    m_ascending = column == m_sortColumn ? !m_ascending : true;
    m_sortColumn = column;
    const bool up = m_ascending;
    auto& rows = m_result.Rows;
    if (column == kCode || column == kName || column == kDate) {
        const auto text = [column](const scan::SnapshotRow& r) -> const std::string& {
            return column == kCode ? r.Code : column == kName ? r.Name : r.Date;
        };
        std::stable_sort(rows.begin(), rows.end(), [&](const auto& a, const auto& b) {
            return up ? text(a) < text(b) : text(b) < text(a);
        });
        return;
    }
    std::stable_sort(rows.begin(), rows.end(), [&](const auto& a, const auto& b) {
        const auto x = Figure(a, column), y = Figure(b, column);
        if (!x || !y) return x.has_value() && !y.has_value(); // no figure: last either way
        return up ? *x < *y : *y < *x;
    });
}

std::string SnapshotForm::BreadthLine() const {
    const auto& b = m_result.Market;
    return "Advances " + std::to_string(b.Advances) + "   Declines " + std::to_string(b.Declines) +
           "   Unchanged " + std::to_string(b.Unchanged) + "   New highs " +
           std::to_string(b.NewHighs) + "   New lows " + std::to_string(b.NewLows);
}

} // namespace kori::app
