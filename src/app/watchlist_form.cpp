#include "app/watchlist_form.h"

#include "platform/text.h"
#include "store/targets_file.h"

#include <algorithm>

namespace kori::app {

WatchlistForm::WatchlistForm(Session& session) : m_session(session) {
    Load();
}

void WatchlistForm::Load() {
    m_issues.clear();
    m_book = scan::WatchlistBook::Read(scan::WatchlistBook::PathIn(m_session.folders.SystemFolder),
                                       m_issues);
    Choose(m_book.Lists.empty() ? -1 : std::max(0, m_current));
}

std::vector<std::string> WatchlistForm::ListNames() const {
    std::vector<std::string> names;
    for (const auto& l : m_book.Lists)
        names.push_back(l.Name);
    return names;
}

std::string WatchlistForm::CurrentName() const {
    return m_current >= 0 && m_current < static_cast<int>(m_book.Lists.size())
               ? m_book.Lists[static_cast<std::size_t>(m_current)].Name
               : std::string();
}

void WatchlistForm::Choose(int index) {
    m_current = index >= 0 && index < static_cast<int>(m_book.Lists.size()) ? index : -1;
    Refresh();
}

void WatchlistForm::Refresh() {
    m_rows.clear();
    if (m_current < 0) return;
    m_rows = scan::ComputeWatchlist(
        m_book.Lists[static_cast<std::size_t>(m_current)], m_session.folders.DataFolder,
        store::ReadTargetsFile(store::TargetsFilePath(m_session.folders.SystemFolder)),
        scan::SnapshotSettingsFrom(m_session.ini()));
    if (m_sortColumn >= 0) scan::SortWatchRows(m_rows, m_sortColumn, m_ascending);
}

GridModel WatchlistForm::Grid() const {
    GridModel grid(scan::WatchHeaders());
    std::vector<GridModel::Row> rows;
    rows.reserve(m_rows.size());
    for (const auto& r : m_rows)
        rows.push_back(scan::WatchCells(r));
    grid.LoadInForm(std::move(rows));
    return grid;
}

void WatchlistForm::Sort(int column) {
    if (column < 0 || column >= scan::kWatchColumns) return;
    m_ascending = column == m_sortColumn ? !m_ascending : true;
    m_sortColumn = column;
    scan::SortWatchRows(m_rows, column, m_ascending);
}

platform::Status WatchlistForm::Save(const scan::WatchlistBook& before) {
    auto s = m_book.Write(scan::WatchlistBook::PathIn(m_session.folders.SystemFolder));
    if (!s) m_book = before;
    return s;
}

platform::Status WatchlistForm::NewList(const std::string& name) {
    const auto before = m_book;
    if (auto s = m_book.AddList(name); !s) return s;
    if (auto s = Save(before); !s) return s;
    Choose(static_cast<int>(m_book.Lists.size()) - 1);
    return platform::Status::Ok();
}

platform::Status WatchlistForm::RenameList(const std::string& name) {
    if (m_current < 0) return platform::Status::Error("There is no watchlist to rename");
    const auto before = m_book;
    if (auto s = m_book.RenameList(CurrentName(), name); !s) return s;
    return Save(before);
}

platform::Status WatchlistForm::DeleteList() {
    if (m_current < 0) return platform::Status::Error("There is no watchlist to delete");
    const auto before = m_book;
    if (auto s = m_book.DeleteList(CurrentName()); !s) return s;
    if (auto s = Save(before); !s) return s;
    Choose(std::min(m_current, static_cast<int>(m_book.Lists.size()) - 1));
    return platform::Status::Ok();
}

platform::Status WatchlistForm::AddCode(scan::WatchEntry entry) {
    if (m_current < 0) return platform::Status::Error("Make a watchlist first");
    const auto before = m_book;
    if (auto s = m_book.AddEntry(CurrentName(), std::move(entry)); !s) return s;
    if (auto s = Save(before); !s) return s;
    Refresh();
    return platform::Status::Ok();
}

platform::Status WatchlistForm::RemoveRow(int row) {
    const auto code = CodeAt(row);
    if (code.empty()) return platform::Status::Error("Choose a row to remove");
    const auto before = m_book;
    if (auto s = m_book.RemoveEntry(CurrentName(), code); !s) return s;
    if (auto s = Save(before); !s) return s;
    Refresh();
    return platform::Status::Ok();
}

platform::Status WatchlistForm::AddFromChart(const std::string& code) {
    if (m_current < 0) {
        if (auto s = NewList(std::string(scan::kFirstWatchlist)); !s) return s;
    }
    scan::WatchEntry entry;
    entry.Code = code;
    if (auto s = scan::CheckWatchEntry(entry); !s) return s;
    if (RowOf(entry.Code) >= 0) return platform::Status::Ok();
    return AddCode(std::move(entry));
}

std::string WatchlistForm::CodeAt(int row) const {
    return row >= 0 && row < static_cast<int>(m_rows.size())
               ? m_rows[static_cast<std::size_t>(row)].Entry.Code
               : std::string();
}

int WatchlistForm::RowOf(const std::string& code) const {
    for (std::size_t i = 0; i < m_rows.size(); ++i)
        if (m_rows[i].Entry.Code == code) return static_cast<int>(i);
    return -1;
}

namespace {
// A stored size: a whole number of twips from one pixel up to a large screen.
int Twips(std::string_view text) {
    const std::string t = platform::Trim(text);
    if (t.empty() || t.find_first_not_of("0123456789") != std::string::npos || t.size() > 6)
        return 0;
    const int v = std::stoi(t);
    return v >= 15 && v <= 200000 ? v : 0;
}
} // namespace

WatchWindowPlace LoadWatchWindowPlace(const platform::SettingsStore& store) {
    WatchWindowPlace place;
    place.Width = Twips(store.Get("WatchWth", ""));
    place.Height = Twips(store.Get("WatchHgt", ""));
    const std::string cols = store.Get("WatchCols", "");
    std::size_t start = 0;
    while (start <= cols.size() && !cols.empty()) {
        const std::size_t comma = std::min(cols.find(',', start), cols.size());
        const int w = Twips(std::string_view(cols).substr(start, comma - start));
        if (w == 0) return {place.Width, place.Height, {}}; // one bad width spoils the row
        place.Columns.push_back(w);
        start = comma + 1;
    }
    return place;
}

void SaveWatchWindowPlace(platform::SettingsStore& store, const WatchWindowPlace& place) {
    store.Save("WatchWth", std::to_string(place.Width));
    store.Save("WatchHgt", std::to_string(place.Height));
    std::string cols;
    for (const int w : place.Columns)
        cols += (cols.empty() ? "" : ",") + std::to_string(w);
    store.Save("WatchCols", cols);
}

} // namespace kori::app
