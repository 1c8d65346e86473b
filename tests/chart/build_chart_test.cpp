#include "chart/build_chart.h"
#include "chart_test_rig.h"

#include <cstdio>

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {
void AddDays(ChartRig& r, int count) {
    for (int i = 1; i <= count; ++i) {
        char date[16];
        std::snprintf(date, sizeof date, "2024%04d", i);
        r.Add(date, 15, 20, 12.5f, 17, 1000 + i);
    }
}
} // namespace

TEST(BuildChart, WindowEndsAtTheFinishDate) {
    ChartRig r;
    AddDays(r, 100);
    r.request.ByFinishDate = true;
    r.request.FinishDate = "20240060";
    ASSERT_TRUE(r.Build().ok());
    // 349 columns at 10 a bar: 34.9 -> 35 records back from record 60.
    EXPECT_EQ(r.chart.LastRecord, 60);
    EXPECT_EQ(r.chart.FirstRecord, 25);
    EXPECT_EQ(r.source.LastLoad.FirstRecord, 25);
    EXPECT_EQ(r.source.LastLoad.LastRecord, 60);
    EXPECT_EQ(r.chart.LastBar(), 35);
    EXPECT_TRUE(HasRun(r.Lines(), {"T, 8.25, 380, 2,Last date processed 60-00-24, 27"}));
}

TEST(BuildChart, EmptyFileShowsNoData) {
    ChartRig r;
    EXPECT_FALSE(r.Build().ok());
    ASSERT_EQ(r.dialogs.messages().size(), 1u);
    EXPECT_EQ(r.dialogs.messages()[0], "No Data for BHP.WDT");
    EXPECT_EQ(r.dialogs.shown()[0].title, "Chart Display");
    EXPECT_TRUE(r.Calls().empty());
}

TEST(BuildChart, ManualScaleWithoutEndsBeepsAndExplains) {
    ChartRig r;
    r.name.Base = 0;
    r.Add("20240304", 15, 20, 12.5f, 17);
    EXPECT_FALSE(r.Build().ok());
    const auto& shown = r.dialogs.shown();
    ASSERT_EQ(shown.size(), 2u);
    EXPECT_EQ(shown[0].kind, "beep");
    EXPECT_EQ(shown[1].text, ManualScaleMessage("BHP"));
    EXPECT_TRUE(r.chart.Failed);
    EXPECT_EQ(r.chart.ChartBase, 0);
    EXPECT_EQ(r.chart.ChartCeiling, 0);
    EXPECT_TRUE(r.Calls().empty());
    EXPECT_TRUE(r.Lines().empty()) << "the stream was started afresh and nothing written";
}

TEST(BuildChart, LogarithmicChartOfNegativeValuesIsRefused) {
    ChartRig r;
    r.defaults.AutoScale = true;
    r.defaults.LogBars = true;
    r.Add("20240304", -3, -1, -5, -2);
    EXPECT_FALSE(r.Build().ok());
    ASSERT_EQ(r.dialogs.shown().size(), 1u);
    EXPECT_EQ(r.dialogs.shown()[0].title, "Negative Values");
    EXPECT_EQ(r.dialogs.shown()[0].text,
              "You cannot display a Logarithmic chart when there are NEGATIVE values. Display "
              "the chart as an Arithmetic chart.");
    EXPECT_TRUE(r.Calls().empty()) << "the area stays as it was";
    // The same prices on an arithmetic scale draw.
    r.defaults.LogBars = false;
    EXPECT_TRUE(r.Build().ok());
}

TEST(BuildChart, DegenerateInputsEndTidily) {
    {
        ChartRig r; // equal manual ends: every price would divide by zero
        r.name.Base = r.name.Top = 5;
        r.Add("20240304", 15, 20, 12.5f, 17);
        EXPECT_FALSE(r.Build().ok());
        EXPECT_TRUE(r.dialogs.shown().empty());
        EXPECT_TRUE(r.Calls().empty());
    }
    {
        ChartRig r; // no area at all
        r.surface.Resize(0, 0);
        r.Add("20240304", 15, 20, 12.5f, 17);
        EXPECT_FALSE(r.Build().ok());
    }
    {
        ChartRig r; // no prices at all: an upside-down automatic scale, no bars, no crash
        r.defaults.AutoScale = true;
        for (int i = 0; i < 5; ++i)
            r.Add("2024030" + std::to_string(i + 1), 0, 0, 0, 0);
        EXPECT_TRUE(r.Build().ok());
        EXPECT_TRUE(Starting(r.Lines(), "H,").empty());
        EXPECT_EQ(r.chart.GridStep, 0);
    }
    {
        ChartRig r; // one flat price on a logarithmic line chart
        r.defaults.AutoScale = true;
        r.defaults.LogLine = true;
        r.name.RecordType = 2;
        r.Add("20240304", 0, 0.01f, 0, 0.01f);
        EXPECT_TRUE(r.Build().ok());
        EXPECT_EQ(r.chart.Style, 'L');
        EXPECT_TRUE(r.chart.Logarithmic);
    }
}

TEST(BuildChart, RepaintLeavesTheStreamAlone) {
    ChartRig r;
    r.Add("20240304", 15, 20, 12.5f, 17);
    {
        std::ofstream old(r.streamPath, std::ios::binary);
        old << "L,1,2,3,4,5\r\n";
    }
    r.chart.RedrawOnly = true;
    ASSERT_TRUE(r.Build().ok());
    EXPECT_FALSE(r.Calls().empty());
    EXPECT_EQ(r.Lines(), (std::vector<std::string>{"L,1,2,3,4,5"}));
}

TEST(BuildChart, SplitBuildsBothHalvesIntoOneStream) {
    ChartRig r;
    r.request.SplitMode = true;
    r.request.SplitHalf = 1;
    r.Add("20240304", 15, 20, 12.5f, 17);
    ASSERT_TRUE(r.Build().ok());
    EXPECT_FALSE(r.request.SplitMode);
    EXPECT_EQ(r.request.SplitHalf, 1);
    const auto titles = Starting(r.Lines(), "T, 9.75,");
    // Upper half from 10, lower half from 1000 x 51% = 510; the code at 4 x PlotLeft.
    EXPECT_EQ(titles,
              (std::vector<std::string>{"T, 9.75, 20, 12,BHP, 26", "T, 9.75, 20, 512,BHP, 26"}));
    EXPECT_TRUE(HasRun(r.Lines(), {"T, 8.25, 380, 512,Last date processed 04-03-24, 27"}));
    int clears = 0;
    for (const auto& c : r.Calls())
        clears += c.rfind("Clear", 0) == 0;
    EXPECT_EQ(clears, 1);
}

TEST(BuildChart, PrinterMarginsOncePerRun) {
    PrinterPage page;
    page.Width = 16000;
    page.Height = 12000;
    // 15 twips x 1.5 = 22.5 -> 22: the chart is 22000 x 15400 on paper.
    WorkOutPrinterMargins(page, 1000, 700, 1.5f);
    EXPECT_TRUE(page.Known);
    EXPECT_EQ(page.PageLeft, 3000);
    EXPECT_EQ(page.PageTop, 1700);

    ChartRig r;
    r.Add("20240304", 15, 20, 12.5f, 17);
    PrinterPage fresh;
    fresh.Width = 16000;
    fresh.Height = 12000;
    r.page = &fresh;
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(fresh.Known);
    EXPECT_EQ(fresh.PageLeft, -(16000 - 400 * 22) / 2);
    fresh.PageLeft = 7;
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(fresh.PageLeft, 7) << "worked out once per run";
}

TEST(BuildChart, OverlaysFollowTheTrailingLabelsInTheSameStream) {
    ChartRig r;
    r.Add("20240304", 15, 20, 12.5f, 17);
    ChartRequest& q = r.request;
    const ChartBuild b{q,
                       r.defaults,
                       r.name,
                       r.palette,
                       r.fonts,
                       r.dialogs,
                       r.streamPath,
                       false,
                       1,
                       nullptr,
                       [](Chart& c, kori::platform::Surface&) {
                           c.Stream.Shape('L', 5, c.PriceToY(15), 354, c.PriceToY(15), 20);
                       }};
    ASSERT_TRUE(BuildChart(r.chart, b, r.source, r.surface).ok());
    const auto lines = r.Lines();
    ASSERT_GE(lines.size(), 2u);
    EXPECT_EQ(lines[lines.size() - 2], "Z, 7, 269.4, 120,KORI\xA0"
                                       "Charting, 27");
    EXPECT_EQ(lines.back(), "L, 5, 900, 354, 900, 20");
}

TEST(BuildChart, SplitLowerHalfShowsItsOwnSecurityAndPeriod) {
    ChartRig r;
    r.request.SplitMode = true;
    r.Add("20240304", 15, 20, 12.5f, 17);
    kori::test::MemorySource lowerSource;
    lowerSource.Name = "RIO.WDT";
    lowerSource.Records.push_back({"20240308", 30, 40, 25, 35, 0, {}});
    ChartName lowerName = r.name;
    lowerName.Code = "RIO";
    const SplitLowerHalf lower{&lowerName, &lowerSource, 'W'};
    ChartBuild b{r.request,    r.defaults, r.name, r.palette, r.fonts, r.dialogs,
                 r.streamPath, false,      1,      nullptr,   {}};
    b.Lower = &lower;
    ASSERT_TRUE(BuildChart(r.chart, b, r.source, r.surface).ok());
    EXPECT_EQ(r.source.LastLoad.Period, 'A');
    EXPECT_EQ(lowerSource.LastLoad.Period, 'W');
    EXPECT_EQ(r.request.ChartPeriod, 'A') << "the period in hand comes back after the split";
    EXPECT_FALSE(r.request.SplitMode);
    const auto lines = r.Lines();
    EXPECT_EQ(Starting(lines, "T, 9.75,"),
              (std::vector<std::string>{"T, 9.75, 20, 12,BHP, 26", "T, 9.75, 20, 512,RIO, 26"}));
    // The lower heading 18 above its plot top of 510; the labels of the lower half at 512 and
    // 530 carry the lower security's last date and close.
    EXPECT_TRUE(HasRun(lines, {"T, 8.25, 7, 492,WEEKLY - ARITHMETIC -, 26"}));
    EXPECT_TRUE(HasRun(lines, {"T, 8.25, 380, 512,Last date processed 08-03-24, 27",
                               "T, 8.25, 380, 530,Closing Price : 35.00  (.00), 27"}));
    // An empty lower file is told by its own name; the request is left as a single chart at
    // the period in hand.
    kori::test::MemorySource empty;
    empty.Name = "RIO.WDT";
    const SplitLowerHalf none{&lowerName, &empty, 'M'};
    b.Lower = &none;
    r.request.SplitMode = true;
    EXPECT_FALSE(BuildChart(r.chart, b, r.source, r.surface).ok());
    EXPECT_EQ(r.dialogs.messages().back(), "No Data for RIO.WDT");
    EXPECT_FALSE(r.request.SplitMode);
    EXPECT_EQ(r.request.SplitHalf, 1);
    EXPECT_EQ(r.request.ChartPeriod, 'A');
    // Without a lower half of its own, the split repeats the security in hand.
    ChartRig same;
    same.request.SplitMode = true;
    same.Add("20240304", 15, 20, 12.5f, 17);
    ASSERT_TRUE(same.Build().ok());
    EXPECT_EQ(Starting(same.Lines(), "T, 9.75,").back(), "T, 9.75, 20, 512,BHP, 26");
}
