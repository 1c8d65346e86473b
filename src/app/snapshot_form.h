#pragma once
// The current snapshot window: which securities, the walk, the grid in the order the user
// sorts it, the breadth line, and the way to a row's chart.
#include "app/grid_model.h"
#include "app/session.h"
#include "scan/snapshot.h"

#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kSnapshotTitle = "Current Snapshot";

class SnapshotForm {
public:
    explicit SnapshotForm(Session& session);

    // "Full List (Names.Dat)", then the chart lists by their names and the scan list Z.
    const std::vector<std::string>& listCaptions() const { return m_captions; }
    int ListIndex = 0;

    // Walks the list with the library's own oscillator and average settings.
    const scan::SnapshotResult& Run(platform::Progress& progress);
    const scan::SnapshotResult& result() const { return m_result; }

    static std::vector<std::string> Headers();
    GridModel Grid() const;
    // Sorts by a column; the same column again turns the order round. Figures sort as
    // numbers, rows without a figure last; text columns sort as text.
    void Sort(int column);
    int sortColumn() const { return m_sortColumn; }
    bool ascending() const { return m_ascending; }

    // "Advances 25   Declines 21   Unchanged 3   New highs 7   New lows 3".
    std::string BreadthLine() const;
    std::string Csv() const { return scan::SnapshotCsv(m_result); }

private:
    Session& m_session;
    std::vector<std::string> m_captions;
    scan::SnapshotResult m_result;
    int m_sortColumn = -1;
    bool m_ascending = true;
};

} // namespace kori::app
