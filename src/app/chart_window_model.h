#pragma once
// The chart window's state and rules without a widget: the walk over the list, the security in
// hand, the chart built from it, the end date of that chart, and the mouse tools with their
// steps. The window feeds it commands and mouse events and carries out the effects it answers
// (status panes, a rebuild, a rubber band, a zoom); everything here runs headless.
#include "app/chart_build.h"
#include "app/chart_navigation.h"
#include "app/chart_selection.h"
#include "app/session.h"
#include "chart/chart.h"
#include "chart/chart_tools.h"
#include "platform/dialogs.h"
#include "platform/surface.h"
#include "store/name_record.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

// What the mouse is doing.
enum class ChartTool {
    None,
    Trendline,
    Erase, // delete a trendline with the right button
    FibRetracement,
    FibTimeLines,
    Gann,
    Text,
    DayCount,
    Zoom,
    AutoScroll,
};

enum class ChartButton { Left, Right, Other };

struct RubberBand {
    double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
};

// What the window must do after an event.
struct ChartEffects {
    bool Rebuild = false;       // build the chart again and show it
    bool KeepToolLines = false; // the rebuild keeps the lines the tools drew (not a new chart)
    std::optional<std::vector<std::string>> Panes; // new texts for the status panes
    bool PictureChanged = false;                   // lines went onto the picture
    std::optional<RubberBand> Rubber;              // show this line while dragging
    bool ClearRubber = false;
    std::optional<std::pair<double, double>> ZoomAt; // open the zoom window at this point
    bool OscSettings = false;                        // open the oscillator settings box
    std::optional<double> Crosshair;                 // x of the bar under the cursor
};

// Forwards to the session's dialogs and remembers whether a message box went up, so that a
// build that failed without a word can still tell the user why.
class TellingDialogs : public platform::Dialogs {
public:
    explicit TellingDialogs(platform::Dialogs& inner) : m_inner(inner) {}
    platform::Answer MsgBox(std::string_view text, std::string_view title,
                            platform::Buttons buttons, platform::Icon icon) override {
        m_told = true;
        return m_inner.MsgBox(text, title, buttons, icon);
    }
    std::optional<std::string> InputBox(std::string_view prompt, std::string_view title,
                                        std::string_view defaultText) override {
        return m_inner.InputBox(prompt, title, defaultText);
    }
    void Beep() override { m_inner.Beep(); }
    void SetBusy(bool busy) override { m_inner.SetBusy(busy); }
    bool told() const { return m_told; }

private:
    platform::Dialogs& m_inner;
    bool m_told = false;
};

// The next-chart command over the list of `state`, as every chart window steps it: the list is
// opened afresh (its failure told under "Chart Display"), a class or GICS walk steps within its
// class, any other list by position with a wrap at both ends. nullopt: nothing to show.
std::optional<store::NameRecord> StepChartList(Session& session, ChartWalk& walk, ChartState& state,
                                               int delta);

class ChartWindowModel {
public:
    using OverlayHook =
        std::function<void(chart::Chart&, const chart::ChartRequest&, platform::Surface&)>;

    ChartWindowModel(Session& session, ChartState& state);

    // The next-chart command: "fwd" +1, "rev" -1, "ref" 0 on the list in use. A step to another
    // chart (delta not 0) drops an end date the window moved, so the new chart ends where the
    // selection said.
    bool NextChart(int delta);
    bool haveSecurity() const { return m_haveName; }
    const store::NameRecord& current() const { return m_name; }
    std::string Code() const;
    // The text box of the security's details (issue size, PE ratio, yield) when the details
    // files are there and hold the security; empty otherwise.
    std::vector<std::string> SecurityDetailsText() const;

    // Builds the chart in hand onto `area` (price chart and, when wanted, the panel). A build
    // that fails without having told the user shows its message under "Chart Display".
    // `keepToolLines`: the lines drawn with the tools stay (a note was added, not a new chart).
    ChartOutcome Build(platform::Surface& area, bool keepToolLines = false);
    const chart::Chart& chart() const { return *m_chart; }
    chart::Chart& chart() { return *m_chart; }
    const ChartOutcome& lastBuild() const { return m_last; }
    bool panelShown() const { return m_last.PanelShown; }
    bool splitShown() const { return m_splitShown; }
    const std::vector<chart::TrendEnds>& trendEnds() const { return m_trendEnds; }
    void SetOverlayHook(OverlayHook hook) { m_overlayHook = std::move(hook); }

    // Toolbar commands that change the request; each answers whether a rebuild is due.
    bool SetStyle(char style);
    bool SetPeriod(char period);
    // Steps the chart's end by a day, week or month ('A', 'W', 'M'), forward or back.
    bool StepEnd(char unit, int direction);
    // The chart in hand ends at price record `record` (the scroll bar); false off the file.
    bool EndAtRecord(int record);
    // Back to the latest data for the chart in hand.
    void EndAtLatest() { m_endDate.reset(); }
    // The end date the window moved to, if any ("YYYYMMDD").
    const std::optional<std::string>& endDate() const { return m_endDate; }
    // Bar spacing up or down by one step within the limits of the chart defaults.
    bool ChangeBarSpacing(int steps);
    // The history moved by `bars` (the mouse wheel): negative goes back in time.
    bool ScrollBars(int bars);
    int PriceRecordCount() const;

    ChartEffects SetTool(ChartTool tool);
    // A tool key pressed again puts the tool down.
    ChartEffects ToggleTool(ChartTool tool) {
        return SetTool(m_tool == tool ? ChartTool::None : tool);
    }
    ChartTool tool() const { return m_tool; }
    int clickStage() const { return m_clickStage; }
    void SetCalendarTimeLines(bool calendar) { m_calendarLines = calendar; }
    bool calendarTimeLines() const { return m_calendarLines; }

    // The mouse over the chart, in chart units. `picture` is the picture on show, which the
    // tools draw onto; what they draw also goes to ChtLns.Tmp and TCht.Tmp.
    ChartEffects MouseMove(double x, double y, bool leftHeld);
    ChartEffects MousePress(double x, double y, ChartButton button, platform::Surface& picture);
    ChartEffects MouseRelease(double x, double y, ChartButton button, platform::Surface& picture);
    ChartEffects DoubleClick(double x, double y);

    // Leaving the chart packs trendlines that changed.
    void LeaveChart();
    // A saved chart is on show instead of a built one: the tools stay quiet until the next build.
    void ShowingSaved(bool on) { m_showingSaved = on; }
    bool showingSaved() const { return m_showingSaved; }
    bool trendChanged() const { return m_trendChanged; }
    // "Remove all trendlines for ...": after the warning, the file goes.
    bool RemoveAllTrendlines();

private:
    bool ToolsQuiet() const;
    bool InPanel(double y) const;
    ChartEffects FibonacciClick(double y);
    ChartEffects TextNote(double x, double y);
    void Paint(platform::Surface& picture, const std::vector<chart::Segment>& lines);

    Session& m_session;
    ChartState& m_state;
    ChartWalk m_walk;
    store::NameRecord m_name;
    bool m_haveName = false;
    std::unique_ptr<chart::Chart> m_chart;
    chart::PrinterPage m_page;
    ChartOutcome m_last;
    std::vector<chart::TrendEnds> m_trendEnds;
    bool m_trendChanged = false;
    bool m_splitShown = false;
    bool m_showingSaved = false;
    std::optional<std::string> m_endDate;
    OverlayHook m_overlayHook;

    ChartTool m_tool = ChartTool::None;
    int m_clickStage = 0;
    double m_downX = 0, m_downY = 0;
    bool m_leftDown = false;
    double m_fibStart = 0;
    double m_countFromX = 0;
    int m_moving = -1; // index in m_trendEnds of a line being moved
    double m_fixedX = 0, m_fixedY = 0;
    bool m_calendarLines = false;
};

} // namespace kori::app
