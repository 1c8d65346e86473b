#pragma once
// The Watchlist window: which list is shown, its rows worked out and sorted, and the changes
// to the lists, each saved to Watchlists.txt at once.
#include "app/grid_model.h"
#include "app/session.h"
#include "scan/watchlist.h"

#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kWatchlistTitle = "Watchlist";

// The window's size and column widths in the window store ("WatchWth", "WatchHgt" in twips,
// "WatchCols" the widths in twips joined by commas); zeros and an empty list where nothing is
// stored or a value does not read as a size.
struct WatchWindowPlace {
    int Width = 0;
    int Height = 0;
    std::vector<int> Columns;
};
WatchWindowPlace LoadWatchWindowPlace(const platform::SettingsStore& store);
void SaveWatchWindowPlace(platform::SettingsStore& store, const WatchWindowPlace& place);

class WatchlistForm {
public:
    explicit WatchlistForm(Session& session);

    // Reads the file again; the lines it could not use are in issues().
    void Load();
    const platform::Issues& issues() const { return m_issues; }
    const scan::WatchlistBook& book() const { return m_book; }

    std::vector<std::string> ListNames() const;
    // -1 when there is no list.
    int current() const { return m_current; }
    // Shows a list and works out its rows.
    void Choose(int index);
    // Works the shown list out again (after an update, say).
    void Refresh();
    const std::vector<scan::WatchRow>& rows() const { return m_rows; }

    GridModel Grid() const;
    // The same column again turns the order round.
    void Sort(int column);
    int sortColumn() const { return m_sortColumn; }
    bool ascending() const { return m_ascending; }

    // Each change is saved at once; a refused or failed one leaves the lists as they were.
    platform::Status NewList(const std::string& name); // and shows it
    platform::Status RenameList(const std::string& name);
    platform::Status DeleteList();
    platform::Status AddCode(scan::WatchEntry entry);
    platform::Status RemoveRow(int row);
    // The chart window's security into the shown list, or into a first list made for it; a
    // code already there is left as it is.
    platform::Status AddFromChart(const std::string& code);

    // The code of a row, for its chart; empty when there is no such row.
    std::string CodeAt(int row) const;
    // The row that shows a code, -1 when none.
    int RowOf(const std::string& code) const;
    std::string Csv() const { return scan::WatchCsv(m_rows); }

private:
    platform::Status Save(const scan::WatchlistBook& before);
    std::string CurrentName() const;

    Session& m_session;
    scan::WatchlistBook m_book;
    platform::Issues m_issues;
    int m_current = -1;
    std::vector<scan::WatchRow> m_rows;
    int m_sortColumn = -1;
    bool m_ascending = true;
};

} // namespace kori::app
