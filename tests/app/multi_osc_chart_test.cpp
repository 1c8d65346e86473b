// The multi-oscillator chart: the cut of the area, the panels of a set in one stream, the
// refusal of an empty set, and the window's model stepping the list as the chart window does.
#include "app/multi_osc_chart.h"
#include "chart/chart_defaults.h"
#include "chart/saved_chart.h"
#include "chart/screen_player.h"
#include "osc/osc_identifiers.h"
#include "platform/files.h"
#include "platform/text.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

#include <sstream>

using namespace kori;

namespace {

osc::MultiOscSet Set(std::array<std::string, 5> slots) {
    osc::MultiOscSet s;
    s.Slots = std::move(slots);
    return s;
}

std::vector<std::string> StreamLines(const std::filesystem::path& path) {
    std::vector<std::string> out;
    std::istringstream in(platform::ReadWholeFile(path).value_or(""));
    for (std::string line; std::getline(in, line);) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        out.push_back(line);
    }
    return out;
}

std::vector<std::string> Fields(const std::string& line) {
    std::vector<std::string> f;
    std::string cur;
    for (char c : line) {
        if (c == ',') {
            f.push_back(cur);
            cur.clear();
        } else {
            cur += c;
        }
    }
    f.push_back(cur);
    return f;
}

struct MultiChart : ::testing::Test {
    test::SampleSession s;
    app::ChartJob job;

    MultiChart() {
        job.Name = s.Name("KRM");
        job.Defaults = chart::LoadChartDefaults(s.session.ini());
        job.Request.ChartStyle = 'B';
        job.Request.ChartPeriod = 'A';
        job.Request.BarSpacing = 4;
    }
};

} // namespace

TEST(MultiOscLayout, PriceShareShrinksToFortyPercentAndPanelsFillTheRest) {
    // One panel: the chart window's cut, 3/10 of 700 under the price chart.
    auto one = app::SplitMultiOscArea(700, 1);
    EXPECT_EQ(one.PriceHeight, 490);
    ASSERT_EQ(one.Panels.size(), 1u);
    EXPECT_EQ(one.Panels[0].Top, 490);
    EXPECT_EQ(one.Panels[0].Height, 210);
    // Two panels: 40 % price, then 210 each.
    auto two = app::SplitMultiOscArea(700, 2);
    EXPECT_EQ(two.PriceHeight, 280);
    EXPECT_EQ(two.Panels[1].Top, 490);
    // Five panels of 481 rows: price 192, then 57 each and the last takes the remaining 61.
    auto five = app::SplitMultiOscArea(481, 5);
    EXPECT_EQ(five.PriceHeight, 192);
    ASSERT_EQ(five.Panels.size(), 5u);
    EXPECT_EQ(five.Panels[1].Top, 249);
    EXPECT_EQ(five.Panels[4].Top, 420);
    EXPECT_EQ(five.Panels[4].Height, 61);
}

TEST(MultiOscSets, NoneAndUnknownSlotsAreSkippedAndTheSlowStochasticKeepsItsFlag) {
    const auto panels =
        app::MultiOscPanels(Set({"None", "Stochastic (Slow)", " RSI ", "Bogus", "ROC and FX"}));
    ASSERT_EQ(panels.size(), 3u);
    EXPECT_EQ(panels[0].OscName, "STO");
    EXPECT_TRUE(panels[0].SlowStochastic);
    EXPECT_EQ(panels[1].OscName, "RSI");
    EXPECT_EQ(panels[2].OscName, "R/F");
    EXPECT_FALSE(osc::FindMultiOscChoice("None"));
    EXPECT_FALSE(osc::FindMultiOscChoice("rsi")) << "names are matched as the list spells them";
}

TEST_F(MultiChart, EachFilledSlotDrawsItsFramedPanelInItsBandOfOneStream) {
    platform::RecordingSurface area(1000, 700);
    chart::Chart c;
    const auto set = Set({"RSI", "None", "Williams %R", "None", "None"});
    const auto out = app::BuildMultiOscChart(s.session, job, 1, set, c, area);
    ASSERT_TRUE(out.Status.ok()) << out.Status.message();
    EXPECT_EQ(out.PriceHeight, 280);
    ASSERT_EQ(out.Panels.size(), 2u);
    EXPECT_EQ(out.Panels[0].Choice.OscName, "RSI");
    EXPECT_EQ(out.Panels[1].Choice.OscName, "WMS");
    EXPECT_EQ(out.Panels[0].Outcome, osc::OscOutcome::Drawn);
    EXPECT_EQ(out.Panels[1].Outcome, osc::OscOutcome::Drawn);
    EXPECT_LE(c.PlotBottom, 280) << "the price chart stays in its band";

    // Panel frames: a "B" line from (5, 2 % of the band) to (PlotRight, 98 %), offset by the
    // band's top: 280 + 4 and 280 + 206 for the first, 490 + 4 and 490 + 206 for the second.
    int frames = 0;
    std::vector<double> frameTops;
    for (const auto& line : StreamLines(app::ChartStreamPath(s.session))) {
        const auto f = Fields(line);
        if (f[0] != "B" || f.size() < 6 || platform::Val(f[1]) != 5) continue;
        ++frames;
        frameTops.push_back(platform::Val(f[2]));
        EXPECT_EQ(platform::Val(f[3]), c.PlotRight);
        EXPECT_EQ(platform::Val(f[4]) - platform::Val(f[2]), 202);
    }
    EXPECT_EQ(frames, 2);
    EXPECT_EQ(frameTops, (std::vector<double>{284, 494}));
    // The titles stand in their panels, in stream order after the price chart.
    const auto lines = StreamLines(app::ChartStreamPath(s.session));
    std::size_t rsi = lines.size(), wms = lines.size();
    for (std::size_t i = 0; i < lines.size(); ++i) {
        if (lines[i].rfind("T,", 0) != 0) continue;
        const auto f = Fields(lines[i]);
        if (f[4].find("Relative Strength") != std::string::npos && rsi == lines.size()) {
            rsi = i;
            EXPECT_EQ(platform::Val(f[3]), 286);
        }
        if (f[4].find("Williams") != std::string::npos && wms == lines.size()) {
            wms = i;
            EXPECT_EQ(platform::Val(f[3]), 496);
        }
    }
    ASSERT_LT(rsi, lines.size());
    ASSERT_LT(wms, lines.size());
    EXPECT_LT(rsi, wms);
}

TEST_F(MultiChart, AnAllNoneSetIsRefusedAndWritesNothing) {
    platform::RecordingSurface area(1000, 700);
    chart::Chart c;
    (void)platform::WriteFileAtomic(app::ChartStreamPath(s.session), "L,1,1,2,2,0\r\n");
    const auto out = app::BuildMultiOscChart(s.session, job, 2, osc::MultiOscSet{}, c, area);
    EXPECT_FALSE(out.Status.ok());
    EXPECT_EQ(out.Status.message(), app::EmptyMultiOscSetMessage(2));
    EXPECT_NE(out.Status.message().find("Multi-Osc 2"), std::string::npos);
    EXPECT_TRUE(area.calls().empty());
    EXPECT_EQ(platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or(""),
              "L,1,1,2,2,0\r\n");
}

TEST_F(MultiChart, ASavedMultiChartPlaysBackWithEveryPanel) {
    platform::RecordingSurface area(1000, 700);
    chart::Chart c;
    const auto set = Set({"MACD", "RSI", "OBV", "None", "Volatility"});
    ASSERT_TRUE(app::BuildMultiOscChart(s.session, job, 1, set, c, area).Status.ok());
    const auto saved = s.root.path() / "KRM.cht";
    ASSERT_EQ(chart::SaveChartAs(saved.string(), app::ChartStreamPath(s.session), s.dialogs),
              chart::SaveChartResult::Saved);
    platform::RecordingSurface played(1000, 700);
    ASSERT_TRUE(chart::DisplaySavedChart(saved.string(), played, s.session.palette, s.session.fonts,
                                         s.dialogs));
    // Each of the four panels has its frame in the played picture, in its own band.
    const auto layout = app::SplitMultiOscArea(700, 4);
    for (const auto& band : layout.Panels) {
        const double top = band.Top + std::round(0.02 * band.Height);
        bool found = false;
        for (const auto& call : played.calls())
            if (call.rfind("Box 5," + std::to_string(static_cast<int>(top)) + ",", 0) == 0)
                found = true;
        EXPECT_TRUE(found) << "no panel frame at y " << top;
    }
    const auto reach = chart::MeasureStream(saved);
    EXPECT_GT(reach.Bottom, 650);
    EXPECT_LE(reach.Bottom, 700);
}

TEST_F(MultiChart, TheModelStepsTheListAsTheChartWindowAndWritesItsOwnStream) {
    app::ChartState state;
    state.Defaults = job.Defaults;
    state.Request = job.Request;
    state.Request.ListMode = 1;
    platform::Status why;
    const auto krm = store::FindCode(s.session.folders.DataFolder, "KRM", why);
    ASSERT_TRUE(krm);
    state.Request.ListPosition = static_cast<std::int16_t>(krm->RecordNumber - 1);
    app::MultiOscChartModel model(s.session, state, 1);
    EXPECT_FALSE(model.SetSet(3));
    EXPECT_EQ(model.set(), 1);

    ASSERT_TRUE(model.NextChart(1));
    EXPECT_EQ(model.Code(), "KRM");
    ASSERT_TRUE(model.NextChart(1));
    EXPECT_EQ(state.Request.ListPosition, krm->RecordNumber + 1);
    ASSERT_TRUE(model.NextChart(-1));
    EXPECT_EQ(model.Code(), "KRM");

    // The sample's set 1 has three oscillators.
    platform::RecordingSurface area(1000, 700);
    (void)platform::WriteFileAtomic(app::ChartStreamPath(s.session), "L,1,1,2,2,0\r\n");
    const auto out = model.Build(area);
    ASSERT_TRUE(out.Status.ok()) << out.Status.message();
    EXPECT_EQ(out.Panels.size(), 3u);
    EXPECT_TRUE(s.session.chartStream.empty()) << "the stream override ends with the build";
    EXPECT_FALSE(StreamLines(model.StreamPath()).empty());
    EXPECT_EQ(platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or(""),
              "L,1,1,2,2,0\r\n")
        << "the chart window's TCht.Tmp is not this window's";

    // An emptied set is told under the window's title.
    osc::SaveMultiOscSet(s.settings, 2, osc::MultiOscSet{});
    ASSERT_TRUE(model.SetSet(2));
    EXPECT_FALSE(model.Build(area).Status.ok());
    ASSERT_FALSE(s.dialogs.shown().empty());
    EXPECT_EQ(s.dialogs.shown().back().title, app::kMultiOscTitle);
}
