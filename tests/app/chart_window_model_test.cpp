// The chart window's model without a widget: the walk, the end date of the chart in hand, the
// tools and what they leave behind, and the one chart-with-panel build.
#include "app/chart_build.h"
#include "app/chart_service.h"
#include "app/chart_window_model.h"
#include "app/chart_window_tools.h"
#include "chart/chart_defaults.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>

using namespace kori;

namespace {

int Count(const std::string& text, const std::string& prefix) {
    int n = 0;
    const std::string t = "\n" + text;
    for (std::size_t p = t.find("\n" + prefix); p != std::string::npos;
         p = t.find("\n" + prefix, p + 1))
        ++n;
    return n;
}

struct Model : ::testing::Test {
    test::SampleSession s;
    app::ChartState state;
    app::ChartWindowModel model{s.session, state};
    platform::RecordingSurface area{1000, 700};

    Model() {
        state.Defaults = chart::LoadChartDefaults(s.session.ini());
        state.Request.ChartStyle = 'B';
        state.Request.BarSpacing = 4;
    }
    // Steps onto `code` as the selection does: one short of it, then "fwd".
    void Show(std::string_view code) {
        platform::Status why;
        const auto found = store::FindCode(s.session.folders.DataFolder, code, why);
        ASSERT_TRUE(found);
        state.Request.ListMode = 1;
        state.Request.ListPosition = static_cast<std::int16_t>(found->RecordNumber - 1);
        ASSERT_TRUE(model.NextChart(1));
        ASSERT_EQ(model.Code(), std::string(code));
        Build();
    }
    void Build(bool keep = false) {
        area = platform::RecordingSurface{1000, 700};
        ASSERT_TRUE(model.Build(area, keep).Status.ok());
    }
    void Apply(const app::ChartEffects& fx) {
        if (fx.Rebuild) Build(fx.KeepToolLines);
    }
    app::ChartEffects Click(double x, double y, app::ChartButton b = app::ChartButton::Left) {
        auto fx = model.MousePress(x, y, b, area);
        Apply(fx);
        return fx;
    }
    double XOf(int bar) const { return model.chart().PlotLeft + bar * model.chart().BarSpacing; }
    std::string Lines() const {
        return platform::ReadWholeFile(app::ChartLinesPath(s.session)).value_or("");
    }
    std::string Stream() const {
        return platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or("");
    }
};

} // namespace

TEST_F(Model, AnEndDateMovedOnOneChartDoesNotFollowToTheNext) {
    Show("KRM");
    const int latest = model.PriceRecordCount();
    EXPECT_EQ(model.chart().LastRecord, latest);
    ASSERT_TRUE(model.StepEnd('M', -1));
    Build();
    EXPECT_LT(model.chart().LastRecord, latest);
    EXPECT_FALSE(state.Request.ByFinishDate) << "the selection's LATEST stands";
    // "=" redraws the same chart where it was.
    ASSERT_TRUE(model.NextChart(0));
    Build();
    EXPECT_LT(model.chart().LastRecord, latest);
    // The next chart, and back again, end at the latest data.
    ASSERT_TRUE(model.NextChart(1));
    Build();
    EXPECT_EQ(model.chart().LastRecord, model.PriceRecordCount());
    ASSERT_TRUE(model.NextChart(-1));
    Build();
    EXPECT_EQ(model.chart().LastRecord, latest);
    // A finish date the selection chose is kept for every chart.
    state.Request.ByFinishDate = true;
    state.Request.FinishDate = platform::Trim(app::PriceRecordDate(s.session, "KRM", latest - 100));
    ASSERT_TRUE(model.NextChart(0));
    Build();
    EXPECT_EQ(model.chart().LastRecord, latest - 100);
}

TEST_F(Model, TheWheelScrollsTheHistoryAndCtrlChangesTheSpacingWithinLimits) {
    Show("KRM");
    const int latest = model.PriceRecordCount();
    EXPECT_FALSE(model.ScrollBars(5)) << "nothing lies past the latest record";
    ASSERT_TRUE(model.ScrollBars(-10));
    Build();
    EXPECT_EQ(model.chart().LastRecord, latest - 10);
    ASSERT_TRUE(model.ScrollBars(10));
    EXPECT_FALSE(model.endDate()) << "back at the end is the latest chart again";

    ASSERT_TRUE(model.ChangeBarSpacing(2));
    EXPECT_EQ(state.Request.BarSpacing, 6);
    for (int i = 0; i < 40; ++i)
        model.ChangeBarSpacing(1);
    EXPECT_EQ(state.Request.BarSpacing, 30);
    for (int i = 0; i < 40; ++i)
        model.ChangeBarSpacing(-1);
    EXPECT_EQ(state.Request.BarSpacing, 1);
    state.Request.ChartStyle = 'C';
    model.ChangeBarSpacing(-1);
    EXPECT_EQ(state.Request.BarSpacing, 3) << "a candle chart never goes under 3";
    model.ChangeBarSpacing(-1);
    EXPECT_EQ(state.Request.BarSpacing, 3);
}

TEST_F(Model, ANoteKeepsTheFibonacciAndGannLinesAndSaysWhyCommasGo) {
    Show("KRM");
    const auto& c = model.chart();
    model.SetTool(app::ChartTool::FibRetracement);
    Click(XOf(40), c.PriceToY(c.MinLow));
    Click(XOf(90), c.PriceToY(c.MaxHigh));
    model.SetTool(app::ChartTool::Gann);
    Click(XOf(60), (c.PlotTop + c.PlotBottom) / 2.0);
    const int dashed = Count(Lines(), "D,");
    const int solid = Count(Lines(), "H,");
    ASSERT_EQ(dashed, 3);
    ASSERT_GT(solid, 0);

    model.SetTool(app::ChartTool::Text);
    s.dialogs.QueueInput(std::string("top, maybe"));
    const auto fx = Click(XOf(70), c.PriceToY(c.ChartBars()[70].Close));
    EXPECT_TRUE(fx.Rebuild);
    EXPECT_EQ(s.dialogs.shown().back().title, "Text");
    EXPECT_NE(s.dialogs.shown().back().text.find("Commas"), std::string::npos);
    const auto notes = platform::ReadWholeFile(app::NotesPath(s.session, "KRM")).value_or("");
    EXPECT_NE(notes.find(",top maybe,"), std::string::npos) << notes;
    // The lines are still in ChtLns.Tmp and in the new chart's stream, which prints and saves.
    EXPECT_EQ(Count(Lines(), "D,"), dashed);
    EXPECT_EQ(Count(Lines(), "H,"), solid);
    const std::string stream = Stream();
    EXPECT_NE(stream.find("top maybe"), std::string::npos);
    EXPECT_GE(Count(stream, "D,"), dashed);
    // A new chart starts without them.
    ASSERT_TRUE(model.NextChart(0));
    Build();
    EXPECT_EQ(Lines(), "");
}

TEST_F(Model, ANoteDatedBeforeTheFirstBarIsNotDrawnAtTheLeftEdge) {
    Show("KRM");
    const std::string first(model.chart().ChartBars()[0].DateText());
    {
        std::ofstream notes(app::NotesPath(s.session, "KRM"), std::ios::binary);
        notes << "T,8.25,19900102,1.5,too early,0\r\n"
              << "T,8.25," << first << ",1.5,first bar,0\r\n";
    }
    Build();
    const std::string stream = Stream();
    EXPECT_EQ(stream.find("too early"), std::string::npos);
    EXPECT_NE(stream.find("first bar"), std::string::npos);
}

TEST_F(Model, AFibonacciFromHighToLowSaysWhyItDrawsNothing) {
    Show("KRM");
    const auto& c = model.chart();
    model.SetTool(app::ChartTool::FibRetracement);
    Click(XOf(40), c.PriceToY(c.MaxHigh));
    const auto fx = Click(XOf(90), c.PriceToY(c.MinLow));
    ASSERT_TRUE(fx.Panes);
    EXPECT_NE(std::find_if(fx.Panes->begin(), fx.Panes->end(),
                           [](const std::string& p) { return p.find("low first") != p.npos; }),
              fx.Panes->end());
    EXPECT_EQ(Count(Lines(), "D,"), 0);
    EXPECT_EQ(model.tool(), app::ChartTool::None);
}

TEST_F(Model, TheCursorGivesADatedReadOutAndACrosshairOnlyWithoutATool) {
    Show("KRM");
    const auto& c = model.chart();
    auto fx = model.MouseMove(XOf(10), 100, false);
    ASSERT_TRUE(fx.Panes);
    ASSERT_FALSE(fx.Panes->empty());
    EXPECT_EQ((*fx.Panes)[0].rfind("Date  ", 0), 0u);
    ASSERT_TRUE(fx.Crosshair);
    EXPECT_EQ(*fx.Crosshair, XOf(10));
    model.SetTool(app::ChartTool::Trendline);
    fx = model.MouseMove(XOf(10), 100, false);
    EXPECT_FALSE(fx.Crosshair);
    (void)c;
}

TEST_F(Model, ToolsFollowTheirRulesAndEscapeLeavesThem) {
    Show("KRM");
    state.Request.ChartStyle = 'L';
    model.SetTool(app::ChartTool::Zoom);
    EXPECT_EQ(model.tool(), app::ChartTool::None);
    EXPECT_EQ(s.dialogs.messages().back(), "Zoom only available on Bar & Candlestick charts");
    state.Request.ChartStyle = 'B';
    model.SetTool(app::ChartTool::DayCount);
    Click(XOf(10), 200);
    EXPECT_EQ(model.clickStage(), 1);
    model.SetTool(app::ChartTool::None);
    EXPECT_EQ(model.clickStage(), 0);
    // A point-and-figure style drops the zoom it cannot do.
    model.SetTool(app::ChartTool::Zoom);
    EXPECT_EQ(model.tool(), app::ChartTool::Zoom);
    model.SetStyle('P');
    EXPECT_EQ(model.tool(), app::ChartTool::None);
}

TEST_F(Model, AGarbagePriceFileTellsTheUserWhyNoChartShows) {
    Show("KRM");
    const auto path = store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM");
    const auto size = platform::FileSizeOr0(path);
    ASSERT_GT(size, 0u);
    {
        // Garbage whose every float reads as the largest float there is: no scale spans it.
        std::string bytes;
        while (bytes.size() < size)
            bytes += std::string("\xff\xff\x7f\x7f", 4);
        std::ofstream out(path, std::ios::binary | std::ios::trunc);
        out << bytes.substr(0, static_cast<std::size_t>(size));
    }
    s.dialogs.clear();
    platform::RecordingSurface a(1000, 700);
    EXPECT_FALSE(model.Build(a).Status.ok());
    ASSERT_FALSE(s.dialogs.shown().empty());
    EXPECT_EQ(s.dialogs.shown().back().title, "Chart Display");
    EXPECT_EQ(s.dialogs.shown().back().text, "The chart has no usable price scale.");
    EXPECT_EQ(s.dialogs.shown().size(), 1u) << "told once";
}

TEST_F(Model, APanelDoubleClickAsksForTheOscillatorSettings) {
    state.Request.AutoOsc = true;
    state.Request.AutoOscCode = "RSI";
    Show("KRM");
    ASSERT_TRUE(model.panelShown());
    const int priceHeight = model.lastBuild().PriceHeight;
    EXPECT_TRUE(model.DoubleClick(XOf(10), priceHeight + 20).OscSettings);
    EXPECT_FALSE(model.DoubleClick(XOf(10), priceHeight - 20).OscSettings);
    // The price tools do nothing on the panel.
    model.SetTool(app::ChartTool::DayCount);
    Click(XOf(10), priceHeight + 20);
    EXPECT_EQ(model.clickStage(), 0);
}

// The one build behind the window, the CLI, the printout and the saved chart.
struct WithPanel : Model {
    app::ChartJob Job(std::string_view code, const char* osc, char period = 'A') {
        app::ChartJob job;
        platform::Status why;
        job.Name = store::FindCode(s.session.folders.DataFolder, code, why)->Record;
        job.Defaults = state.Defaults;
        job.Request.ChartStyle = 'B';
        job.Request.ChartPeriod = period;
        job.Request.BarSpacing = 4;
        if (osc) {
            job.Request.AutoOsc = true;
            job.Request.AutoOscCode = osc;
        }
        return job;
    }
};

TEST_F(WithPanel, ThePanelTakesTheBottomThreeTenthsAndThePageCentresBoth) {
    app::ChartJob job = Job("KRM", "RSI");
    chart::PrinterPage page;
    job.Page = &page;
    const app::ChartJob before = job;
    chart::Chart c;
    const auto out = app::BuildChartWithPanel(s.session, job, c, area);
    ASSERT_TRUE(out.Status.ok());
    EXPECT_TRUE(out.PanelShown);
    EXPECT_EQ(out.PriceHeight, 700 - 210);
    EXPECT_EQ(page.SecondPanelHeight, 210);
    EXPECT_TRUE(out.Request.SecondPanelShowing);
    EXPECT_EQ(out.Request.AvOnePeriod, state.Defaults.MAPeriod1Daily);
    // The job is read, not changed.
    EXPECT_FALSE(job.Request.SecondPanelShowing);
    EXPECT_EQ(job.Request.AvOnePeriod, before.Request.AvOnePeriod);
    // The price chart's plot ends inside its part of the area.
    EXPECT_LT(c.PlotBottom, out.PriceHeight);
}

TEST_F(WithPanel, RmoOnAWeeklyChartGivesTheWholeAreaBackToThePrices) {
    app::ChartJob job = Job("KRM", "RMO", 'W');
    chart::Chart c;
    const auto out = app::BuildChartWithPanel(s.session, job, c, area);
    ASSERT_TRUE(out.Status.ok());
    EXPECT_FALSE(out.PanelShown);
    EXPECT_EQ(out.Panel, osc::OscOutcome::DailyOnly);
    EXPECT_EQ(out.PriceHeight, 700);
    EXPECT_FALSE(out.Request.SecondPanelShowing);
    EXPECT_EQ(out.Request.AvOnePeriod, state.Defaults.MAPeriod1Long);
    EXPECT_EQ(s.dialogs.messages().back(), "RMO only available on Daily Charts");
}

TEST_F(WithPanel, NoPanelForTheParabolicPointAndFigureOrASplit) {
    app::ChartJob job = Job("KRM", "PARA");
    EXPECT_FALSE(app::PanelWanted(job.Request));
    job.Request.AutoOscCode = "RSI";
    EXPECT_TRUE(app::PanelWanted(job.Request));
    job.Request.ChartStyle = 'P';
    EXPECT_FALSE(app::PanelWanted(job.Request));
    job.Request.ChartStyle = 'B';
    job.Request.SplitMode = true;
    EXPECT_FALSE(app::PanelWanted(job.Request));
}
