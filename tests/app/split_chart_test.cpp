#include "app/chart_service.h"
#include "app/split_chart.h"
#include "chart/stream_reader.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

#include <fstream>
#include <sstream>

using namespace kori;

namespace {

struct Split : ::testing::Test {
    test::SampleSession s;
    platform::RecordingSurface area{1000, 700};

    app::ChartJob Job(std::string_view code, char period) {
        app::ChartJob job;
        kori::platform::Status why;
        const auto found = kori::store::FindCode(s.session.folders.DataFolder, code, why);
        EXPECT_TRUE(found);
        if (found) job.Name = found->Record;
        job.Defaults = chart::LoadChartDefaults(s.session.ini());
        job.Request.ChartStyle = 'B';
        job.Request.ChartPeriod = period;
        job.Request.BarSpacing = 4;
        return job;
    }
    std::vector<std::string> Lines() {
        std::vector<std::string> out;
        std::istringstream in(
            platform::ReadWholeFile(app::ChartStreamPath(s.session)).value_or(""));
        for (std::string line; std::getline(in, line);) {
            if (!line.empty() && line.back() == '\r') line.pop_back();
            out.push_back(line);
        }
        return out;
    }
    // The y of each target line: "L" from PlotLeft (5) to PlotRight (1000 x 99% - 42 = 948).
    std::vector<double> TargetYs() {
        std::vector<double> ys;
        for (const auto& l : Lines()) {
            chart::StreamFields f;
            if (l.rfind("L,", 0) != 0 || !chart::SplitStreamLine(l, f)) continue;
            if (platform::Val(f[1]) == 5 && platform::Val(f[3]) == 948 && f[2] == f[4])
                ys.push_back(platform::Val(f[2]));
        }
        return ys;
    }
    float LastClose(std::string_view code, char period) {
        app::ChartJob job = Job(code, period);
        job.WriteStream = false;
        chart::Chart c;
        EXPECT_TRUE(app::BuildSecurityChart(s.session, job, c, area).ok());
        return c.ChartLastClose;
    }
};

} // namespace

TEST_F(Split, SecondChartIsChosenByCodeInAnyCaseAndPeriod) {
    EXPECT_FALSE(app::ChooseSecondChart(s.session, "zzz", 0, s.dialogs));
    EXPECT_FALSE(app::ChooseSecondChart(s.session, "   ", 0, s.dialogs));
    ASSERT_EQ(s.dialogs.shown().size(), 2u);
    EXPECT_EQ(s.dialogs.shown()[0].text, "No record on file for that code");
    EXPECT_EQ(s.dialogs.shown()[0].title, "Second Chart");

    const auto weekly = app::ChooseSecondChart(s.session, " krm ", 1, s.dialogs);
    ASSERT_TRUE(weekly);
    EXPECT_EQ(weekly->Name.TrimmedCode(), "KRM");
    EXPECT_EQ(weekly->ChartPeriod, 'W');
    EXPECT_EQ(app::ChooseSecondChart(s.session, "KRM", 2, s.dialogs)->ChartPeriod, 'M');
    EXPECT_EQ(app::ChooseSecondChart(s.session, "KRM", -1, s.dialogs)->ChartPeriod, 'A');
    EXPECT_EQ(s.dialogs.shown().size(), 2u);
}

TEST(SplitChart, LastsUntilTheNextChartCommandStepsOn) {
    chart::ChartRequest bars;
    bars.ChartStyle = 'B';
    app::SecondChart lower;
    lower.Name.Code = "KRM   ";
    lower.ChartPeriod = 'W';

    app::SplitChart split;
    EXPECT_FALSE(split.Applies(bars));
    split.Choose(lower, true);
    EXPECT_TRUE(split.Applies(bars));
    split.Apply(bars);
    EXPECT_TRUE(bars.SplitMode);
    EXPECT_EQ(bars.SplitHalf, 1);
    split.AfterNextChart(0); // "=" redraws the same security: still split
    EXPECT_TRUE(split.Applies(bars));
    split.AfterNextChart(1);
    EXPECT_FALSE(split.Chosen());
    split.Apply(bars);
    EXPECT_FALSE(bars.SplitMode);

    // Chosen with no chart on show: the split waits for the chart that comes up next and
    // ends with the step after it.
    split.Choose(lower, false);
    EXPECT_FALSE(split.Applies(bars));
    split.AfterNextChart(1);
    EXPECT_TRUE(split.Applies(bars));
    split.AfterNextChart(-1);
    EXPECT_FALSE(split.Chosen());

    // Point and figure and the pages of several charts are never split; "Single Chart" ends it.
    split.Choose(lower, true);
    chart::ChartRequest pf;
    pf.ChartStyle = 'P';
    pf.SplitMode = true;
    EXPECT_FALSE(split.Applies(pf));
    split.Apply(pf);
    EXPECT_FALSE(pf.SplitMode);
    chart::ChartRequest page;
    page.ChartSlot = 2;
    EXPECT_FALSE(split.Applies(page));
    split.End();
    EXPECT_FALSE(split.Applies(bars));
}

TEST_F(Split, LowerHalfIsTheSecondSecurityAtItsPeriodInTheSameStream) {
    // A target of each security at its last close: each must land inside its own half.
    const float alx = LastClose("ALX", 'A');
    const float krm = LastClose("KRM", 'W');
    {
        std::ofstream t(std::filesystem::path(s.session.folders.SystemFolder) / "Targets.txt");
        t << "ALX," << platform::FormatSingle(alx, "0.00#") << ",U\r\n"
          << "KRM," << platform::FormatSingle(krm, "0.00#") << ",D\r\n";
    }
    app::ChartJob job = Job("ALX", 'A');
    app::SplitChart split;
    split.Choose(*app::ChooseSecondChart(s.session, "KRM", 1, s.dialogs), true);
    split.Apply(job.Request);
    job.Lower = split.Lower();
    chart::Chart c;
    ASSERT_TRUE(app::BuildSecurityChart(s.session, job, c, area).ok());
    EXPECT_TRUE(job.Request.SplitMode) << "the job is read, not changed";
    EXPECT_EQ(job.Request.SplitHalf, 1);
    EXPECT_EQ(job.Request.ChartPeriod, 'A');

    const auto lines = Lines();
    std::vector<std::string> titles, headings;
    for (const auto& l : lines) {
        if (l.rfind("T, 9.75,", 0) == 0) titles.push_back(l.substr(0, l.rfind(',')));
        if (l.find("- ARITHMETIC -") != std::string::npos) headings.push_back(l);
    }
    // Upper plot from 10 to 700 x 46% = 322, lower from 357 to 665; titles at top + 2.
    EXPECT_EQ(titles, (std::vector<std::string>{"T, 9.75, 20, 12,ALX", "T, 9.75, 20, 359,KRM"}));
    ASSERT_EQ(headings.size(), 2u);
    EXPECT_NE(headings[0].find("DAILY"), std::string::npos);
    EXPECT_EQ(headings[1].rfind("T, 8.25, 7, 339,WEEKLY", 0), 0u);
    // The lower half ends the build: the chart numbers are the lower one's.
    EXPECT_EQ(c.PlotTop, 357);
    EXPECT_FLOAT_EQ(c.ChartLastClose, krm);

    const auto ys = TargetYs();
    ASSERT_EQ(ys.size(), 2u);
    EXPECT_GE(ys[0], 10);
    EXPECT_LE(ys[0], 322);
    EXPECT_GE(ys[1], 357);
    EXPECT_LE(ys[1], 665);
}

TEST_F(Split, LowerSecurityWithoutPriceFileIsReported) {
    app::ChartJob job = Job("ALX", 'A');
    app::SecondChart lower = *app::ChooseSecondChart(s.session, "KRM", 0, s.dialogs);
    std::filesystem::remove(store::PriceFile::PathFor(s.session.folders.DataFolder, "KRM"));
    job.Request.SplitMode = true;
    job.Lower = lower;
    chart::Chart c;
    EXPECT_FALSE(app::BuildSecurityChart(s.session, job, c, area).ok());
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].title, "Chart Display");
}
