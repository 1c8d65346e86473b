#pragma once
// The walk over the list in use (the full name file or one chart list), the next-chart command
// of the chart window, and the cursor read-outs of the status bar.
#include "app/session.h"
#include "chart/chart.h"
#include "chart/chart_request.h"
#include "platform/dialogs.h"
#include "store/chart_list.h"
#include "store/name_record.h"

#include <optional>
#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kFullListCaption = " FULL LIST   (Names.Dat)";

// The full list or a chart list, read whole when opened; positions are 1-based.
class ChartWalk {
public:
    explicit ChartWalk(Session& session) : m_session(session) {}

    // Opens the list of `request.ListMode`. An empty or missing chart list shows the empty-list
    // message and falls back to the full list (ListMode 1, empty ListName). False when the
    // name file cannot be read at all; `status()` then says why (the record limit of the format
    // included), for the caller to show.
    bool Open(chart::ChartRequest& request, bool quiet = false);
    const platform::Status& status() const { return m_status; }
    int Count() const;
    int NameCount() const { return static_cast<int>(m_names.size()); }
    std::string Caption() const { return m_caption; }
    // The name record at a list position; nullopt out of range or on a broken link.
    std::optional<store::NameRecord> RecordAt(int position) const;
    // The name-file record number behind a list position (itself in the full list).
    int NameRecordNumberAt(int position) const;
    const std::vector<store::NameRecord>& names() const { return m_names; }

    // Rewrites the name record behind a list position in Names.dat and in memory.
    platform::Status WriteRecordAt(int position, const store::NameRecord& r);

private:
    Session& m_session;
    std::vector<store::NameRecord> m_names;
    std::vector<store::ChartListEntry> m_list; // empty in the full list
    bool m_fullList = true;
    std::string m_caption = kFullListCaption;
    platform::Status m_status;
};

// Record types 1 to 3 are close-only: they chart as lines whatever the style asked.
using store::IsCloseOnly;

// The next-chart command: steps `ListPosition` by `delta` (+1 "fwd", -1 "rev", 0 "ref") with a
// wrap at both ends and reads the record; nullopt when the list is empty. Close-only types are
// drawn as lines by the build itself, so the style asked for stands for the next security.
std::optional<store::NameRecord> StepChart(ChartWalk& walk, chart::ChartRequest& request,
                                           int delta);

// `FindNextChtIC` / `FindNextChtGICS`: the next (delta 1) or previous (delta -1) record of a
// class in the full list, wrapping round; with none on file, the message of the walk and
// nullopt.
std::optional<store::NameRecord> StepClassChart(ChartWalk& walk, chart::ChartRequest& request,
                                                int delta, std::string_view classCode, bool gics,
                                                platform::Dialogs& dialogs);

// Status-bar panes for the bar under x: "Open  ", "High  ", "Low  ", "Close  ", "Vol  " with
// their values, or "Close  " and "Vol  " for a close-only security. Empty off the bars.
std::vector<std::string> CursorReadout(const chart::Chart& chart, double x, bool closeOnly);
// While the left button is held: from the bar under `xDown` to the bar under x, "Rise  " (the
// highest high above the first close), "Fall  " (the first close above the lowest low),
// "Total  " (the last close less the first) and "Vol  " (the volume summed over the bars).
std::vector<std::string> RiseFallReadout(const chart::Chart& chart, double xDown, double x);
// The day count between the bars under two clicks: "Trading days  " (bars from the first to
// the second) and "Calendar days  " (days between their dates). Empty off the bars.
std::vector<std::string> DayCountReadout(const chart::Chart& chart, double xA, double xB);
// Index of the bar under x, or -1 off the bars.
int BarUnder(const chart::Chart& chart, double x);
// A price for the status bar: "#####.00#", with 0 as empty.
std::string ReadoutPrice(double price);

} // namespace kori::app

namespace kori::app {
// The price file of a code: how many records it holds, and the date of one (1-based); the
// scroll bar of the chart window walks these.
int PriceRecordCount(const Session& session, std::string_view code);
std::string PriceRecordDate(const Session& session, std::string_view code, int recordNumber);
} // namespace kori::app
