#include "app/multi_osc_chart.h"

#include "app/osc_service.h"
#include "osc/osc_panel.h"
#include "platform/sub_surface.h"
#include "platform/text.h"

#include <algorithm>

namespace kori::app {

std::string MultiOscCaption(int set) {
    return std::string(kMultiOscTitle) + " - Set " + std::to_string(set);
}

bool MultiOscSetValid(int set) {
    return set == 1 || set == 2;
}

std::string EmptyMultiOscSetMessage(int set) {
    return "There are no oscillators in " + osc::MultiOscKey(set) +
           ". Choose them in MultiOsc Setup.";
}

std::vector<osc::OscChoice> MultiOscPanels(const osc::MultiOscSet& set) {
    std::vector<osc::OscChoice> out;
    for (const auto& slot : set.Slots)
        if (auto choice = osc::FindMultiOscChoice(slot)) out.push_back(*choice);
    return out;
}

MultiOscLayout SplitMultiOscArea(int areaHeight, int panels) {
    MultiOscLayout out;
    if (panels <= 0) {
        out.PriceHeight = areaHeight;
        return out;
    }
    if (panels == 1) {
        const osc::PanelSplit one = osc::SplitChartArea(areaHeight);
        out.PriceHeight = one.PriceHeight;
        out.Panels.push_back({one.PriceHeight, one.PanelHeight});
        return out;
    }
    // Each further panel takes 30 % from the price chart until it is down to 40 %.
    const int pricePercent = std::max(40, 100 - 30 * panels);
    out.PriceHeight = areaHeight * pricePercent / 100;
    const int each = (areaHeight - out.PriceHeight) / panels;
    int top = out.PriceHeight;
    for (int i = 0; i < panels; ++i) {
        const int height = i + 1 == panels ? areaHeight - top : each;
        out.Panels.push_back({top, height});
        top += height;
    }
    return out;
}

namespace {

// The price chart of the multi chart: never split, never point and figure (oscillators need
// bars), the MACD of the set (if any) taking the averages' place as on the single chart.
ChartJob PriceJob(const ChartJob& job, const std::vector<osc::OscChoice>& panels) {
    ChartJob own = job;
    own.Lower.reset();
    auto& r = own.Request;
    r.SplitMode = false;
    if (r.ChartStyle == 'P') r.ChartStyle = 'B';
    ApplyAveragePeriods(r, own.Defaults);
    r.SecondPanelShowing = true;
    const std::string asked = platform::Trim(r.AutoOscCode);
    const bool parabolic = r.AutoOsc && (asked == "PARA" || asked == "PARAV");
    if (!parabolic) {
        const bool macd = std::any_of(panels.begin(), panels.end(),
                                      [](const osc::OscChoice& c) { return c.OscName == "MACD"; });
        r.AutoOsc = macd;
        r.AutoOscCode = macd ? "MACD" : "";
        r.AutoOscSlow = false;
    }
    return own;
}

} // namespace

MultiOscOutcome BuildMultiOscChart(Session& session, const ChartJob& job, int setNumber,
                                   const osc::MultiOscSet& set, chart::Chart& chart,
                                   platform::Surface& area, const PanelOptions& options) {
    MultiOscOutcome out;
    const std::vector<osc::OscChoice> panels = MultiOscPanels(set);
    if (panels.empty()) {
        out.Status = platform::Status::Error(EmptyMultiOscSetMessage(setNumber));
        return out;
    }
    const ChartJob own = PriceJob(job, panels);
    const int height = static_cast<int>(area.ScaleHeight());
    const MultiOscLayout layout = SplitMultiOscArea(height, static_cast<int>(panels.size()));
    // The page centres the price chart and all its panels together on paper.
    if (own.Page) own.Page->SecondPanelHeight = height - layout.PriceHeight;
    platform::SubSurface priceArea(area, 0, layout.PriceHeight);
    const ChartContext context = ChartContext::Of(session, own.WriteStream, options.Dialogs);
    out.Status = BuildSecurityChart(context, own, chart, priceArea);
    out.PriceHeight = layout.PriceHeight;
    if (!out.Status) return out;

    for (std::size_t i = 0; i < panels.size(); ++i) {
        const MultiOscBand band = layout.Panels[i];
        platform::SubSurface panelArea(area, band.Top, band.Height);
        // A panel shows empty when its routine draws nothing.
        panelArea.SetBackColour(session.palette[osc::oscpal::Background]);
        panelArea.Clear();
        OscPanelJob panel;
        panel.OscName = std::string(panels[i].OscName);
        panel.SlowStochastic = panels[i].SlowStochastic;
        panel.PanelOffset = band.Top;
        panel.PriceSurface = &priceArea;
        panel.Settings = options.Settings;
        const osc::OscOutcome drawn = DrawSecurityOscillator(session, own, chart, panel, panelArea);
        out.Panels.push_back({panels[i], band, drawn});
    }
    // The panels are appended after the price chart: a failed write leaves a torn stream.
    if (own.WriteStream) out.Status = chart.Stream.status();
    return out;
}

MultiOscChartModel::MultiOscChartModel(Session& session, ChartState& state, int set)
    : m_session(session), m_state(state), m_walk(session), m_set(MultiOscSetValid(set) ? set : 1),
      m_chart(std::make_unique<chart::Chart>()) {}

bool MultiOscChartModel::SetSet(int set) {
    if (!MultiOscSetValid(set)) return false;
    m_set = set;
    return true;
}

osc::MultiOscSet MultiOscChartModel::Slots() const {
    return osc::LoadMultiOscSet(m_session.services().settings, m_set);
}

bool MultiOscChartModel::NextChart(int delta) {
    const auto r = StepChartList(m_session, m_walk, m_state, delta);
    if (!r) return false;
    m_name = *r;
    m_haveName = true;
    return true;
}

void MultiOscChartModel::ShowSecurity(const store::NameRecord& name) {
    m_name = name;
    m_haveName = true;
}

std::string MultiOscChartModel::Code() const {
    return platform::Trim(m_name.Code);
}

std::filesystem::path MultiOscChartModel::StreamPath() const {
    return TempFolder(m_session) / "TMulti.Tmp";
}

namespace {

// Points the session's chart stream at this window's file while a build writes it.
class StreamOverride {
public:
    StreamOverride(Session& session, std::filesystem::path path)
        : m_session(session), m_before(session.chartStream) {
        m_session.chartStream = std::move(path);
    }
    ~StreamOverride() { m_session.chartStream = m_before; }
    StreamOverride(const StreamOverride&) = delete;
    StreamOverride& operator=(const StreamOverride&) = delete;

private:
    Session& m_session;
    std::filesystem::path m_before;
};

} // namespace

MultiOscOutcome MultiOscChartModel::Build(platform::Surface& area) {
    *m_chart = chart::Chart{};
    m_last = MultiOscOutcome{};
    if (!m_haveName) {
        m_last.Status = platform::Status::Error("No security in hand");
        return m_last;
    }
    ChartJob job;
    job.Name = m_name;
    job.Request = m_state.Request;
    job.Defaults = m_state.Defaults;
    job.Page = &m_page;
    TellingDialogs dialogs(m_session.dialogs());
    PanelOptions options;
    options.Dialogs = &dialogs;
    {
        const StreamOverride stream(m_session, StreamPath());
        m_last = BuildMultiOscChart(m_session, job, m_set, Slots(), *m_chart, area, options);
    }
    if (!m_last.Status && !dialogs.told())
        m_session.dialogs().MsgBox(m_last.Status.message(), kMultiOscTitle);
    return m_last;
}

} // namespace kori::app
