#include "app/chart_build.h"

#include "app/osc_service.h"
#include "osc/osc_identifiers.h"
#include "platform/sub_surface.h"
#include "platform/text.h"

namespace kori::app {

void ApplyAveragePeriods(chart::ChartRequest& r, const chart::ChartDefaults& d) {
    const bool longer = r.ChartPeriod != 'A';
    r.AvOnePeriod = longer ? d.MAPeriod1Long : d.MAPeriod1Daily;
    r.AvTwoPeriod = longer ? d.MAPeriod2Long : d.MAPeriod2Daily;
}

bool PanelWanted(const chart::ChartRequest& r) {
    if (!r.AutoOsc || r.AutoOscCode.empty() || r.SplitMode || r.ChartStyle == 'P') return false;
    const auto* id = osc::FindOscIdentifier(platform::Trim(r.AutoOscCode));
    return id != nullptr && !id->OnPriceChart;
}

osc::PanelSplit PanelSplitOf(int areaHeight) {
    return osc::SplitChartArea(areaHeight);
}

ChartOutcome BuildChartWithPanel(Session& session, const ChartJob& job, chart::Chart& chart,
                                 platform::Surface& area, const PanelOptions& options) {
    ChartOutcome out;
    ChartJob own = job;
    ApplyAveragePeriods(own.Request, own.Defaults);
    const bool wanted = PanelWanted(own.Request);
    own.Request.SecondPanelShowing = wanted;
    const ChartContext context = ChartContext::Of(session, own.WriteStream, options.Dialogs);
    const int height = static_cast<int>(area.ScaleHeight());
    if (!wanted) {
        out.Status = BuildSecurityChart(context, own, chart, area);
        out.PriceHeight = height;
        out.Request = own.Request;
        return out;
    }
    const osc::PanelSplit split = PanelSplitOf(height);
    // The page centres the price chart and the panel together on paper.
    if (own.Page) own.Page->SecondPanelHeight = split.PanelHeight;
    platform::SubSurface priceArea(area, 0, split.PriceHeight);
    platform::SubSurface panelArea(area, split.PriceHeight, split.PanelHeight);
    out.Status = BuildSecurityChart(context, own, chart, priceArea);
    out.PriceHeight = split.PriceHeight;
    out.Request = own.Request;
    if (!out.Status) return out;
    // The panel shows empty when its routine draws nothing.
    panelArea.SetBackColour(session.palette[osc::oscpal::Background]);
    panelArea.Clear();
    OscPanelJob panel;
    panel.OscName = platform::Trim(own.Request.AutoOscCode);
    panel.SlowStochastic = own.Request.AutoOscSlow;
    panel.PanelOffset = split.PriceHeight;
    panel.PriceSurface = &priceArea;
    panel.Settings = options.Settings;
    out.Panel = DrawSecurityOscillator(session, own, chart, panel, panelArea);
    if (*out.Panel != osc::OscOutcome::DailyOnly) {
        out.PanelShown = true;
        // The panel is appended to the stream after the price chart: a failed write there
        // leaves a torn stream, which the screen, the page and a saved chart must not use.
        if (own.WriteStream) out.Status = chart.Stream.status();
        return out;
    }
    // The price chart goes back to the whole area.
    own.Request.SecondPanelShowing = false;
    if (own.Page) own.Page->SecondPanelHeight = 0;
    area.Clear();
    chart = chart::Chart{};
    out.Status = BuildSecurityChart(context, own, chart, area);
    out.PriceHeight = height;
    out.Request = own.Request;
    return out;
}

} // namespace kori::app
