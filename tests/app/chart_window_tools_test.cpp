#include "app/chart_service.h"
#include "app/chart_window_tools.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/trendline_file.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

using namespace kori;

namespace {

struct Tools : ::testing::Test {
    test::SampleSession s;
    app::ChartJob job;
    chart::Chart chart;
    platform::RecordingSurface area{1000, 700};

    void Build(std::string_view code, char period) {
        kori::platform::Status why;
        const auto found = kori::store::FindCode(s.session.folders.DataFolder, code, why);
        ASSERT_TRUE(found);
        job = {};
        job.Name = found->Record;
        job.Defaults = chart::LoadChartDefaults(s.session.ini());
        job.Request.ChartStyle = 'B';
        job.Request.ChartPeriod = period;
        job.Request.BarSpacing = 4;
        const std::string c(code);
        job.DrawOverlays = [this, c](chart::Chart& ch, const chart::ChartRequest&,
                                     platform::Surface& surface) {
            ends = app::DrawChartLines(s.session, ch, job.Request, c, surface);
            notes = app::DrawTextNotes(s.session, ch, job.Request, c, surface);
        };
        chart = chart::Chart{};
        ASSERT_TRUE(app::BuildSecurityChart(s.session, job, chart, area));
        app::ClearChartLines(s.session);
    }
    std::string Stream() {
        return platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or("");
    }
    int HLines() {
        const std::string t = "\n" + Stream();
        int n = 0;
        for (std::size_t p = t.find("\nH,"); p != std::string::npos; p = t.find("\nH,", p + 1))
            ++n;
        return n;
    }
    std::string Lines() {
        return platform::ReadWholeFile(app::ChartLinesPath(s.session)).value_or("");
    }
    double XOf(int bar) const { return chart.PlotLeft + bar * chart.BarSpacing; }
    double YOfClose(int bar) const {
        return chart.PriceToY(chart.ChartBars()[static_cast<std::size_t>(bar)].Close);
    }

    std::vector<chart::TrendEnds> ends;
    int notes = 0;
};

} // namespace

TEST_F(Tools, ATrendlineLandsInTheFileAndStreamsAndComesBackOnItsPeriodOnly) {
    Build("KRM", 'W');
    const int weeklyH = HLines(); // the chart's own "H" lines
    Build("KRM", 'A');
    const int dailyH = HLines();
    EXPECT_TRUE(ends.empty());
    const int last = chart.LastBar();
    ASSERT_GT(last, 40);
    const double x1 = XOf(last - 40), y1 = YOfClose(last - 40);
    const double x2 = XOf(last - 5), y2 = YOfClose(last - 5);
    ASSERT_TRUE(app::AddTrendline(s.session, chart, job.Request, "KRM", area, x1, y1, x2, y2));

    const auto records = store::TrendlineFile::ReadAll(app::TrendlinePath(s.session, "KRM"));
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].Period, 'A');
    EXPECT_EQ(records[0].DateA,
              std::string(chart.ChartBars()[static_cast<std::size_t>(last - 40)].DateText()));
    EXPECT_EQ(records[0].DateB,
              std::string(chart.ChartBars()[static_cast<std::size_t>(last - 5)].DateText()));
    // One "H" line each in ChtLns.Tmp and at the end of TCht.Tmp.
    EXPECT_EQ(Lines().rfind("H,", 0), 0u);
    const std::string stream = Stream();
    EXPECT_NE(stream.find("\nH,", stream.size() - Lines().size() - 2), std::string::npos);

    // The same security again, daily: the line is replayed where it was drawn.
    Build("KRM", 'A');
    ASSERT_EQ(ends.size(), 1u);
    EXPECT_EQ(ends[0].RecordNumber, 1);
    EXPECT_DOUBLE_EQ(ends[0].xA, x1);
    EXPECT_DOUBLE_EQ(ends[0].xB, x2);
    EXPECT_EQ(HLines(), dailyH + 1);
    // Weekly: a daily line does not show.
    Build("KRM", 'W');
    EXPECT_TRUE(ends.empty());
    EXPECT_EQ(HLines(), weeklyH);
    // Another security has no lines.
    Build("ALX", 'A');
    EXPECT_TRUE(ends.empty());
}

TEST_F(Tools, AClickWithoutDragKeepsNoLineAndAnEndPastTheChartIsHeldNearTheEdge) {
    Build("KRM", 'A');
    const int last = chart.LastBar();
    const double x = XOf(last - 10), y = YOfClose(last - 10);
    EXPECT_FALSE(app::AddTrendline(s.session, chart, job.Request, "KRM", area, x, y, x, y));
    EXPECT_FALSE(platform::FileHasData(app::TrendlinePath(s.session, "KRM")));
    ASSERT_TRUE(app::AddTrendline(s.session, chart, job.Request, "KRM", area, x, y,
                                  chart.PlotRight + 200, y));
    const auto records = store::TrendlineFile::ReadAll(app::TrendlinePath(s.session, "KRM"));
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].DateB[0], 'X');
    EXPECT_EQ(platform::Val(records[0].DateB.substr(1)), chart.PlotRight + 10);
}

TEST_F(Tools, ErasedLinesStayAsBlankRecordsUntilPackedAndRemoveAllAsksFirst) {
    Build("KRM", 'A');
    const int last = chart.LastBar();
    for (int k : {30, 20, 10})
        ASSERT_TRUE(app::AddTrendline(s.session, chart, job.Request, "KRM", area, XOf(last - k),
                                      YOfClose(last - k), XOf(last - 2), YOfClose(last - 2)));
    ASSERT_TRUE(app::EraseTrendline(s.session, "KRM", 2));
    const auto path = app::TrendlinePath(s.session, "KRM");
    EXPECT_EQ(store::TrendlineFile::ReadAll(path).size(), 3u);
    Build("KRM", 'A');
    EXPECT_EQ(ends.size(), 2u);
    ASSERT_TRUE(app::PackTrendlines(s.session, "KRM"));
    EXPECT_EQ(store::TrendlineFile::ReadAll(path).size(), 2u);

    s.dialogs.QueueAnswer(platform::Answer::No);
    EXPECT_FALSE(app::RemoveAllTrendlines(s.session, "KRM"));
    EXPECT_TRUE(platform::FileExists(path));
    EXPECT_EQ(s.dialogs.messages().back(),
              "WARNING - All trendlines for KRM will be removed. Are you sure?");
    EXPECT_EQ(s.dialogs.shown().back().title, "Remove all Trendlines");
    s.dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(app::RemoveAllTrendlines(s.session, "KRM"));
    EXPECT_FALSE(platform::FileExists(path));
}

TEST_F(Tools, TextNotesKeepDateAndPriceAndReplayAtTheirBar) {
    Build("KRM", 'A');
    const int last = chart.LastBar();
    const double y = YOfClose(last - 3);
    ASSERT_TRUE(
        app::AddTextNote(s.session, chart, job.Request, "KRM", XOf(last - 3), y, "top, maybe"));
    // Right of the last bar the note takes the last bar's date.
    ASSERT_TRUE(
        app::AddTextNote(s.session, chart, job.Request, "KRM", chart.PlotRight + 50, y, "later"));
    const std::string text = platform::ReadWholeFile(app::NotesPath(s.session, "KRM")).value_or("");
    const std::string d3(chart.ChartBars()[static_cast<std::size_t>(last - 3)].DateText());
    const std::string dl(chart.ChartBars()[static_cast<std::size_t>(last)].DateText());
    EXPECT_EQ(text.rfind("T,8.25," + d3 + ",", 0), 0u) << text;
    EXPECT_NE(text.find(",top maybe,"), std::string::npos); // commas would break the line
    EXPECT_NE(text.find("T,8.25," + dl + ","), std::string::npos);
    Build("KRM", 'A');
    EXPECT_EQ(notes, 2);
    EXPECT_NE(Stream().find(",top maybe,"), std::string::npos);
}

TEST_F(Tools, ARepaintPlaysTheChartLinesBackAndANewChartEmptiesThem) {
    Build("KRM", 'A');
    app::RecordChartLine(s.session, area, {100, 100, 200, 100, 20, 'D'});
    app::RecordChartLine(s.session, area, {100, 120, 200, 140, 16, 'H'});
    platform::RecordingSurface repaint(1000, 700);
    EXPECT_EQ(app::ReplayChartLines(s.session, repaint), 2);
    app::ClearChartLines(s.session);
    EXPECT_EQ(app::ReplayChartLines(s.session, repaint), 0);
}
