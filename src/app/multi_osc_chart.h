#pragma once
// The multi-oscillator chart: the price chart on top and the oscillators of one of the two
// sets of "MultiOsc Setup" stacked beneath it, each in a panel of its own, all in one stream so
// that the screen, the printed page, a saved chart and `kori play` show the whole picture. The
// model walks the chart list as the chart window does and builds the chart in hand.
#include "app/chart_build.h"
#include "app/chart_navigation.h"
#include "app/chart_selection.h"
#include "app/chart_service.h"
#include "app/chart_window_model.h"
#include "app/session.h"
#include "chart/chart.h"
#include "osc/osc_draw.h"
#include "osc/osc_identifiers.h"
#include "platform/status.h"
#include "platform/surface.h"
#include "store/name_record.h"

#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

inline constexpr const char* kMultiOscTitle = "Multi Oscillator Chart";

// The caption of the window for a set: "Multi Oscillator Chart - Set 1".
std::string MultiOscCaption(int set);
// Whether `set` names one of the two sets.
bool MultiOscSetValid(int set);
// Why a set draws nothing: every slot is "None" (or holds a name the list does not offer).
std::string EmptyMultiOscSetMessage(int set);

// The oscillators of a set in slot order, "None" and unknown slots skipped.
std::vector<osc::OscChoice> MultiOscPanels(const osc::MultiOscSet& set);

// Where the area is cut: the price chart on top, then equal panels (the last takes what the
// division leaves). One panel is cut as the chart window cuts it; more panels take a larger
// share, and the price chart keeps at least 40 %.
struct MultiOscBand {
    int Top = 0, Height = 0;
};
struct MultiOscLayout {
    int PriceHeight = 0;
    std::vector<MultiOscBand> Panels;
};
MultiOscLayout SplitMultiOscArea(int areaHeight, int panels);

struct MultiOscPanel {
    osc::OscChoice Choice;
    MultiOscBand Band;
    osc::OscOutcome Outcome = osc::OscOutcome::Drawn;
};

struct MultiOscOutcome {
    platform::Status Status;
    int PriceHeight = 0;
    std::vector<MultiOscPanel> Panels;
};

// Builds the price chart of `job` and the panels of `set` onto `area`, into the stream of the
// session. The job is read, never changed; a split or a panel it asks for is not drawn here.
// A set with no oscillator is refused with `EmptyMultiOscSetMessage`.
MultiOscOutcome BuildMultiOscChart(Session& session, const ChartJob& job, int setNumber,
                                   const osc::MultiOscSet& set, chart::Chart& chart,
                                   platform::Surface& area, const PanelOptions& options = {});

// The multi-oscillator window's state: the set on show, the walk over the list in use, the
// security in hand and its chart. The stream is a file of its own beside TCht.Tmp, so the chart
// window's picture, printout and saved charts are never this window's.
class MultiOscChartModel {
public:
    MultiOscChartModel(Session& session, ChartState& state, int set = 1);

    int set() const { return m_set; }
    // Set 1 or 2; false (and no change) for any other number.
    bool SetSet(int set);
    // The slots of the set as the settings store holds them now.
    osc::MultiOscSet Slots() const;

    // The next-chart command, stepping the list exactly as the chart window does.
    bool NextChart(int delta);
    // Takes the security of the chart window (or any name record) as the one in hand.
    void ShowSecurity(const store::NameRecord& name);
    bool haveSecurity() const { return m_haveName; }
    const store::NameRecord& current() const { return m_name; }
    std::string Code() const;

    // Builds the chart in hand onto `area`. A failure that no message told yet (an empty set
    // among them) is shown under kMultiOscTitle.
    MultiOscOutcome Build(platform::Surface& area);
    const MultiOscOutcome& lastBuild() const { return m_last; }
    const chart::Chart& chart() const { return *m_chart; }
    std::filesystem::path StreamPath() const;

private:
    Session& m_session;
    ChartState& m_state;
    ChartWalk m_walk;
    int m_set = 1;
    store::NameRecord m_name;
    bool m_haveName = false;
    std::unique_ptr<chart::Chart> m_chart;
    chart::PrinterPage m_page;
    MultiOscOutcome m_last;
};

} // namespace kori::app
