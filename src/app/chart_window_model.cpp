#include "app/chart_window_model.h"

#include "maint/security_details.h"
#include "store/price_file.h"

#include "app/chart_window_tools.h"
#include "chart/chart_tools.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>

namespace kori::app {

namespace {

constexpr int kFibTimeLineEntry = 21;
constexpr int kMinBarSpacing = 1;
constexpr int kMaxBarSpacing = 30;

// "d/m/yy" for the read-outs.
std::string ShortDate(const std::string& yyyymmdd) {
    const auto d = platform::ParseDateText(yyyymmdd);
    if (!d) return yyyymmdd;
    return std::to_string(d->day) + "/" + std::to_string(d->month) + "/" + yyyymmdd.substr(2, 2);
}

} // namespace

std::optional<store::NameRecord> StepChartList(Session& session, ChartWalk& walk, ChartState& state,
                                               int delta) {
    if (!walk.Open(state.Request)) {
        session.dialogs().MsgBox(walk.status().message(), "Chart Display");
        return std::nullopt;
    }
    const bool classWalk = (state.ClassWalk || state.GicsWalk) && state.Request.ListMode == 1;
    if (!classWalk) return StepChart(walk, state.Request, delta);
    return StepClassChart(walk, state.Request, delta,
                          state.GicsWalk ? state.GicsCode : state.ClassCode, state.GicsWalk,
                          session.dialogs());
}

ChartWindowModel::ChartWindowModel(Session& session, ChartState& state)
    : m_session(session), m_state(state), m_walk(session),
      m_chart(std::make_unique<chart::Chart>()) {}

std::string ChartWindowModel::Code() const {
    return platform::Trim(m_name.Code);
}

std::vector<std::string> ChartWindowModel::SecurityDetailsText() const {
    const std::string& system = m_session.folders.SystemFolder;
    if (!m_haveName || !maint::SecurityDetailsAvailable(m_session.download.DataService, system))
        return {};
    const auto details = maint::LookUpSecurityDetails(system, Code());
    if (!details) return {};
    double close = 0;
    store::PriceFile f(store::PriceFile::PathFor(m_session.folders.DataFolder, Code()));
    store::PriceRecord last;
    if (f.Open() && f.Count() > 0 && f.Read(f.Count(), last)) close = last.Close;
    return maint::DetailsTextBox(maint::ReadDetailsHeader(system), *details, close);
}

void ChartWindowModel::LeaveChart() {
    // Trendlines that changed are packed when the chart goes.
    if (m_trendChanged && m_haveName) (void)PackTrendlines(m_session, Code());
    m_trendChanged = false;
}

bool ChartWindowModel::NextChart(int delta) {
    LeaveChart();
    const auto r = StepChartList(m_session, m_walk, m_state, delta);
    if (!r) return false;
    m_name = *r;
    m_haveName = true;
    m_state.Split.AfterNextChart(delta);
    if (delta != 0) m_endDate.reset();
    return true;
}

ChartOutcome ChartWindowModel::Build(platform::Surface& area, bool keepToolLines) {
    m_clickStage = 0;
    m_moving = -1;
    m_showingSaved = false;
    m_trendEnds.clear();
    *m_chart = chart::Chart{}; // in place: the window's references to the chart stay good
    m_last = ChartOutcome{};
    if (!m_haveName) {
        m_last.Status = platform::Status::Error("No security in hand");
        return m_last;
    }
    std::string kept;
    if (keepToolLines) kept = platform::ReadWholeFile(ChartLinesPath(m_session)).value_or("");
    ClearChartLines(m_session);

    ChartJob job;
    job.Name = m_name;
    job.Request = m_state.Request;
    if (m_endDate) {
        job.Request.ByFinishDate = true;
        job.Request.FinishDate = *m_endDate;
    }
    job.Defaults = m_state.Defaults;
    job.Page = &m_page;
    // A split fills the whole area with its two charts: no oscillator panel under them.
    m_splitShown = m_state.Split.Applies(job.Request);
    if (m_splitShown) {
        m_state.Split.Apply(job.Request);
        job.Lower = m_state.Split.Lower();
    }
    const std::string code = Code();
    job.DrawOverlays = [this, code](chart::Chart& c, const chart::ChartRequest& half,
                                    platform::Surface& s) {
        if (m_overlayHook) m_overlayHook(c, half, s);
        // Trendlines and notes belong to one security's single chart.
        if (half.SplitMode) return;
        m_trendEnds = DrawChartLines(m_session, c, half, code, s);
        DrawTextNotes(m_session, c, half, code, s);
    };

    TellingDialogs dialogs(m_session.dialogs());
    PanelOptions options;
    options.Dialogs = &dialogs;
    m_last = BuildChartWithPanel(m_session, job, *m_chart, area, options);
    if (!m_last.Status && !dialogs.told())
        m_session.dialogs().MsgBox(m_last.Status.message(), "Chart Display");
    if (m_last.Status && !kept.empty()) {
        // Lines of the tools drawn on this chart come back over it and into its stream.
        (void)platform::AppendToFile(ChartLinesPath(m_session), kept);
        ReplayChartLines(m_session, area);
        (void)platform::AppendToFile(ChartStreamPath(m_session), kept);
    }
    return m_last;
}

int ChartWindowModel::PriceRecordCount() const {
    return m_haveName ? app::PriceRecordCount(m_session, Code()) : 0;
}

bool ChartWindowModel::SetStyle(char style) {
    auto& r = m_state.Request;
    r.ChartStyle = style;
    if (style == 'P') {
        r.ChartPeriod = 'A';
        r.AutoOsc = false;
        r.ChartBands = 0;
    }
    if (style == 'C' && r.BarSpacing < 3) r.BarSpacing = 3;
    if (m_tool == ChartTool::Zoom && style != 'B' && style != 'C') m_tool = ChartTool::None;
    return m_haveName;
}

bool ChartWindowModel::SetPeriod(char period) {
    if (m_state.Request.ChartStyle == 'P') return false;
    m_state.Request.ChartPeriod = period;
    return m_haveName;
}

bool ChartWindowModel::StepEnd(char unit, int direction) {
    if (!m_haveName || m_chart->LastBar() < 0) return false;
    const std::string shown(
        m_chart->ChartBars()[static_cast<std::size_t>(m_chart->LastBar())].DateText());
    const std::string next = chart::AddCalendarPeriods(shown, unit, direction);
    const int count = PriceRecordCount();
    const std::string latest = PriceRecordDate(m_session, Code(), count);
    if (direction > 0 && !latest.empty() && next >= latest)
        m_endDate.reset();
    else
        m_endDate = next;
    return true;
}

bool ChartWindowModel::EndAtRecord(int record) {
    if (!m_haveName) return false;
    const int count = PriceRecordCount();
    if (record < 1 || record > count) return false;
    if (record == count) {
        m_endDate.reset();
        return true;
    }
    const std::string date = PriceRecordDate(m_session, Code(), record);
    if (date.empty()) return false;
    m_endDate = date;
    return true;
}

bool ChartWindowModel::ScrollBars(int bars) {
    if (!m_haveName || m_chart->LastBar() < 0 || bars == 0) return false;
    const int count = PriceRecordCount();
    const int last = m_chart->LastRecord > 0 ? m_chart->LastRecord : count;
    const int target = std::clamp(last + bars, 1, count);
    if (target == last) return false;
    return EndAtRecord(target);
}

bool ChartWindowModel::ChangeBarSpacing(int steps) {
    auto& r = m_state.Request;
    const int now = r.BarSpacing == 0 ? 2 : r.BarSpacing;
    const int lowest = r.ChartStyle == 'C' ? 3 : kMinBarSpacing;
    const int next = std::clamp(now + steps, lowest, kMaxBarSpacing);
    if (next == now || r.ChartStyle == 'P') return false;
    r.BarSpacing = static_cast<std::int16_t>(next);
    return m_haveName;
}

ChartEffects ChartWindowModel::SetTool(ChartTool tool) {
    ChartEffects fx;
    if (tool == ChartTool::Zoom && m_state.Request.ChartStyle != 'B' &&
        m_state.Request.ChartStyle != 'C') {
        m_session.dialogs().MsgBox("Zoom only available on Bar & Candlestick charts", "Zoom");
        tool = ChartTool::None;
    }
    if (tool == ChartTool::Erase)
        m_session.dialogs().MsgBox(
            "To delete a trendline, click that trendline with your RIGHT mouse button",
            "Trendlines");
    m_tool = tool;
    m_clickStage = 0;
    m_moving = -1;
    m_leftDown = false;
    fx.ClearRubber = true;
    if (m_tool == ChartTool::FibRetracement) fx.Panes = std::vector<std::string>{};
    return fx;
}

bool ChartWindowModel::ToolsQuiet() const {
    return !m_haveName || m_showingSaved || m_splitShown || m_chart->LastBar() < 0;
}

bool ChartWindowModel::InPanel(double y) const {
    return m_last.PanelShown && y >= m_last.PriceHeight;
}

void ChartWindowModel::Paint(platform::Surface& picture, const std::vector<chart::Segment>& lines) {
    for (const auto& seg : lines)
        RecordChartLine(m_session, picture, seg);
}

ChartEffects ChartWindowModel::MouseMove(double x, double y, bool leftHeld) {
    ChartEffects fx;
    if (ToolsQuiet()) return fx;
    if ((m_tool == ChartTool::Trendline && leftHeld && m_leftDown) || m_moving >= 0) {
        const double ax = m_moving >= 0 ? m_fixedX : m_downX;
        const double ay = m_moving >= 0 ? m_fixedY : m_downY;
        fx.Rubber = RubberBand{ax, ay, x, y};
        return fx;
    }
    const bool closeOnly = IsCloseOnly(m_name.RecordType);
    if (leftHeld && m_tool == ChartTool::None)
        fx.Panes = RiseFallReadout(*m_chart, m_downX, x);
    else if (m_tool != ChartTool::FibRetracement && m_tool != ChartTool::DayCount)
        fx.Panes = CursorReadout(*m_chart, x, closeOnly);
    if (m_tool == ChartTool::None && !InPanel(y)) {
        const int bar = BarUnder(*m_chart, x);
        if (bar >= 0) fx.Crosshair = m_chart->PlotLeft + bar * m_chart->BarSpacing;
    }
    return fx;
}

ChartEffects ChartWindowModel::FibonacciClick(double y) {
    ChartEffects fx;
    const double price = m_chart->YToPrice(y);
    if (price <= 0) return fx;
    if (m_clickStage == 0) {
        m_fibStart = price;
        m_clickStage = 1;
        fx.Panes = std::vector<std::string>{"Start  " + ReadoutPrice(price)};
        return fx;
    }
    m_clickStage = 0;
    const auto levels = chart::FibonacciLevels(m_fibStart, price);
    const double rise = price - m_fibStart;
    const std::string riseText =
        "Rise   " +
        platform::Trim(platform::Format(rise, "#####.00#", platform::ZeroSign::Dropped));
    if (levels.empty()) {
        // A fall ends the tool with no lines; the panes say how to draw one.
        fx.Panes = std::vector<std::string>{"Start  " + ReadoutPrice(m_fibStart),
                                            "End   " + ReadoutPrice(price), riseText,
                                            "No levels: click the low first, then the high"};
        m_tool = ChartTool::None;
        return fx;
    }
    std::vector<std::string> panes = {"End   " + ReadoutPrice(price), riseText};
    for (const auto& l : levels)
        panes.push_back(l.StatusText + ReadoutPrice(l.Price));
    fx.Panes = panes;
    return fx;
}

ChartEffects ChartWindowModel::MousePress(double x, double y, ChartButton button,
                                          platform::Surface& picture) {
    ChartEffects fx;
    if (ToolsQuiet()) return fx;
    if (InPanel(y)) return fx; // the price tools work on the price chart only
    m_downX = x;
    m_downY = y;
    m_leftDown = button == ChartButton::Left;
    const auto& req = m_state.Request;
    const std::string code = Code();
    if (button == ChartButton::Right && m_tool != ChartTool::Gann) {
        const int i = chart::NearestTrendline(m_trendEnds, x, y);
        if (i < 0) return fx;
        const auto e = m_trendEnds[static_cast<std::size_t>(i)];
        if (m_tool == ChartTool::Erase) {
            if (EraseTrendline(m_session, code, e.RecordNumber)) {
                m_trendChanged = true;
                fx.Rebuild = true;
            }
            return fx;
        }
        if (m_tool == ChartTool::Trendline) {
            // The end nearer the click moves; the other stays.
            const bool moveA = std::hypot(x - e.xA, y - e.yA) < std::hypot(x - e.xB, y - e.yB);
            m_moving = i;
            m_fixedX = moveA ? e.xB : e.xA;
            m_fixedY = moveA ? e.yB : e.yA;
        }
        return fx;
    }
    const auto frame = ToolFrameOf(*m_chart, req);
    switch (m_tool) {
    case ChartTool::FibRetracement: {
        const double start = m_fibStart;
        const int stage = m_clickStage;
        fx = FibonacciClick(y);
        if (stage == 1 && m_tool == ChartTool::FibRetracement && fx.Panes) {
            const auto levels = chart::FibonacciLevels(start, m_chart->YToPrice(y));
            Paint(picture, chart::FibonacciLines(frame, x, levels));
            fx.PictureChanged = true;
        }
        return fx;
    }
    case ChartTool::FibTimeLines: {
        const int bar = BarUnder(*m_chart, x);
        if (bar < 0) return fx;
        std::vector<chart::Segment> lines;
        for (double lx : chart::FibTimeLines(frame, bar, m_calendarLines))
            lines.push_back({lx, static_cast<double>(m_chart->PlotTop), lx,
                             static_cast<double>(m_chart->PlotBottom), kFibTimeLineEntry, 'D'});
        Paint(picture, lines);
        fx.PictureChanged = true;
        return fx;
    }
    case ChartTool::Gann:
        Paint(picture, chart::GannFan(frame, x, y, button == ChartButton::Left));
        fx.PictureChanged = true;
        return fx;
    case ChartTool::Text:
        return TextNote(x, y);
    case ChartTool::Zoom:
        fx.ZoomAt = std::pair{x, y};
        return fx;
    case ChartTool::DayCount: {
        const int bar = BarUnder(*m_chart, x);
        if (bar < 0) return fx;
        if (m_clickStage == 0) {
            m_countFromX = x;
            m_clickStage = 1;
            fx.Panes = std::vector<std::string>{
                "From  " + ShortDate(std::string(
                               m_chart->ChartBars()[static_cast<std::size_t>(bar)].DateText()))};
            return fx;
        }
        m_clickStage = 0;
        fx.Panes = DayCountReadout(*m_chart, m_countFromX, x);
        return fx;
    }
    default:
        return fx;
    }
}

ChartEffects ChartWindowModel::TextNote(double x, double y) {
    ChartEffects fx;
    if (m_chart->YToPrice(y) <= 0) return fx;
    const auto text =
        m_session.dialogs().InputBox("Text - Enter text required - Press ENTER to Save", "Text");
    if (!text || platform::Trim(*text).empty()) return fx;
    if (text->find(',') != std::string::npos)
        // The note file and the chart stream separate their fields with commas.
        m_session.dialogs().MsgBox("Commas separate the fields of a note, so they are left out "
                                   "of the text.",
                                   "Text");
    if (AddTextNote(m_session, *m_chart, m_state.Request, Code(), x, y, *text)) {
        // A note is not a new chart: the Fibonacci and Gann lines on it stay.
        fx.Rebuild = true;
        fx.KeepToolLines = true;
    }
    return fx;
}

ChartEffects ChartWindowModel::MouseRelease(double x, double y, ChartButton button,
                                            platform::Surface& picture) {
    ChartEffects fx;
    if (!m_haveName || m_showingSaved || m_splitShown) return fx;
    fx.ClearRubber = true;
    const auto& req = m_state.Request;
    if (m_moving >= 0 && button == ChartButton::Right) {
        const int record = m_trendEnds[static_cast<std::size_t>(m_moving)].RecordNumber;
        m_moving = -1;
        if (MoveTrendline(m_session, *m_chart, req, Code(), record, m_fixedX, m_fixedY, x, y)) {
            m_trendChanged = true;
            fx.Rebuild = true;
        }
        return fx;
    }
    if (m_tool == ChartTool::Trendline && button == ChartButton::Left && m_leftDown) {
        m_leftDown = false;
        if (AddTrendline(m_session, *m_chart, req, Code(), picture, m_downX, m_downY, x, y)) {
            fx.PictureChanged = true;
            // The new line is found by a right click like the replayed ones.
            m_trendEnds = TrendEndsOf(m_session, *m_chart, req, Code());
        }
    }
    m_leftDown = false;
    return fx;
}

bool ChartWindowModel::RemoveAllTrendlines() {
    if (!m_haveName || !app::RemoveAllTrendlines(m_session, Code())) return false;
    m_trendChanged = false;
    return true;
}

ChartEffects ChartWindowModel::DoubleClick(double x, double y) {
    (void)x;
    ChartEffects fx;
    if (ToolsQuiet()) return fx;
    fx.OscSettings = InPanel(y);
    return fx;
}

} // namespace kori::app
