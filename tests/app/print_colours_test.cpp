// Charts of the sample library, every style with its overlays and every oscillator panel,
// printed on a recording printer under both answers of a colour printer: nothing pale may
// reach white paper, and "white as black" turns text and thin lines black only.
#include "app/chart_service.h"
#include "app/osc_service.h"
#include "chart/print_chart.h"
#include "osc/osc_identifiers.h"
#include "osc/osc_panel.h"
#include "platform/printer.h"
#include "platform/sub_surface.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

#include <regex>

using namespace kori;

namespace {

struct PrintedChart : ::testing::Test {
    test::SampleSession s;

    app::ChartJob Job(std::string_view code, char style) {
        app::ChartJob job;
        job.Name = s.Name(code);
        job.Defaults = chart::LoadChartDefaults(s.session.ini());
        job.Request.ChartStyle = style;
        job.Request.ChartPeriod = 'A';
        job.Request.BarSpacing = style == 'P' ? 3 : 4;
        if (style != 'P') {
            job.Request.AvOne = job.Request.AvTwo = true;
            job.Request.ChartBands = 2;
        }
        return job;
    }

    // The chart of `job` with the panel `oscName` (none when empty) under it, into TCht.Tmp.
    void Build(app::ChartJob& job, const std::string& oscName) {
        platform::RecordingSurface area(1000, 700);
        chart::Chart c;
        if (oscName.empty()) {
            ASSERT_TRUE(app::BuildSecurityChart(s.session, job, c, area).ok());
            return;
        }
        const osc::PanelSplit split = osc::SplitChartArea(700);
        platform::SubSurface price(area, 0, split.PriceHeight);
        platform::SubSurface panel(area, split.PriceHeight, split.PanelHeight);
        job.Request.SecondPanelShowing = true;
        job.Request.AutoOsc = true;
        job.Request.AutoOscCode = oscName;
        ASSERT_TRUE(app::BuildSecurityChart(s.session, job, c, price).ok()) << oscName;
        app::OscPanelJob pj;
        pj.OscName = oscName;
        pj.PanelOffset = split.PriceHeight;
        pj.PriceSurface = &price;
        app::DrawSecurityOscillator(s.session, job, c, pj, panel);
    }

    // Every call of the printed page with the colour it drew in.
    std::vector<std::pair<std::string, platform::Colour>> Print(int colourLines) {
        platform::RecordingPrinter printer;
        chart::PrintSettings settings;
        settings.PrintColour = 1;
        settings.PrintColourLines = colourLines;
        const chart::PaperJob job{printer, s.session.palette, s.session.fonts, 1000, 700};
        EXPECT_EQ(chart::PrintChart(app::ChartStreamPath(s.session), job, settings),
                  chart::PlayOutcome::Played);
        std::vector<std::pair<std::string, platform::Colour>> out;
        static const std::regex colour(" #([0-9]+)");
        for (const std::string& call : printer.calls()) {
            std::smatch m;
            if (std::regex_search(call, m, colour))
                out.emplace_back(call, static_cast<platform::Colour>(std::stoul(m[1].str())));
        }
        return out;
    }

    void ExpectReadablePage(const std::string& what) {
        for (int lines : {0, 1}) {
            const auto page = Print(lines);
            ASSERT_FALSE(page.empty()) << what;
            bool colourKept = false;
            for (const auto& [call, c] : page) {
                EXPECT_FALSE(chart::NearWhite(c)) << what << " lines " << lines << ": " << call;
                if (lines == 1 && call.rfind("Text", 0) == 0)
                    EXPECT_EQ(c, s.session.palette[0]) << what << ": " << call;
                if (c != s.session.palette[0]) colourKept = true;
            }
            // A colour printer prints in colour under either answer.
            EXPECT_TRUE(colourKept) << what << " lines " << lines;
        }
    }
};

TEST_F(PrintedChart, EveryStyleWithOverlaysPrintsNothingPale) {
    // The sample palette has white bars, light grey labels and a black background.
    ASSERT_EQ(s.session.palette[18], s.session.palette[15]);
    ASSERT_EQ(s.session.palette[27], s.session.palette[7]);
    for (char style : {'B', 'C', 'L', 'P'}) {
        auto job = Job("KRM", style);
        Build(job, "");
        ExpectReadablePage(std::string("style ") + style);
    }
    auto para = Job("KRM", 'B');
    Build(para, "PARA");
    ExpectReadablePage("parabolic");
    auto line = Job("ADVDEC", 'L');
    Build(line, "");
    ExpectReadablePage("ADVDEC line");
}

TEST_F(PrintedChart, EveryOscillatorPanelPrintsNothingPale) {
    for (const auto& id : osc::OscIdentifiers()) {
        if (id.OnPriceChart) continue;
        auto job = Job("KRM", 'B');
        Build(job, std::string(id.OscName));
        ExpectReadablePage("panel " + std::string(id.OscName));
    }
}

} // namespace
