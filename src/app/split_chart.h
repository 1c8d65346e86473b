#pragma once
// A split chart: the security in hand in the upper half of the chart area, a second security
// chosen in Chart2, at its own period, in the lower half. The rules of when a split is drawn
// and when the chart window goes back to a single chart live here, out of the windows.
#include "app/session.h"
#include "chart/chart_request.h"
#include "platform/dialogs.h"
#include "store/name_record.h"

#include <optional>
#include <string_view>

namespace kori::app {

struct SecondChart {
    store::NameRecord Name;
    char ChartPeriod = 'A'; // 'A' daily, 'W' weekly, 'M' monthly
};

// Chart2's OK: the code in any case, with blanks around it, and the period by its place in
// "Daily", "Weekly", "Monthly". An unknown code is told under "Second Chart" and gives nullopt.
std::optional<SecondChart> ChooseSecondChart(const Session& session, std::string_view codeText,
                                             int periodIndex, platform::Dialogs& dialogs);

class SplitChart {
public:
    // A chart on show is split at once; with none on show the choice waits for the next one.
    void Choose(SecondChart lower, bool chartOnShow);
    // Back to a single chart.
    void End();
    // The next-chart command moved by `delta`: a step to another security ends the split,
    // unless the split was waiting for this very chart.
    void AfterNextChart(int delta);
    bool Chosen() const { return m_lower.has_value(); }
    const std::optional<SecondChart>& Lower() const { return m_lower; }
    // Whether the chart of `request` is drawn split. Point and figure fills the whole area and
    // is never split.
    bool Applies(const chart::ChartRequest& request) const;
    // Sets the split flags of a request about to be built (the builder clears them again).
    void Apply(chart::ChartRequest& request) const;

private:
    std::optional<SecondChart> m_lower;
    bool m_waiting = false;
};

} // namespace kori::app
