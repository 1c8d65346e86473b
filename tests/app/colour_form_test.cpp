// The colours window's items against a chart built from the sample library: an item painted
// in a colour changes what it names, and nothing else; its swatch shows the chart's colour;
// the three schemes give three different charts.
#include "app/chart_service.h"
#include "app/colour_form.h"
#include "app/colour_table.h"
#include "app/osc_service.h"
#include "osc/osc_panel.h"
#include "platform/sub_surface.h"
#include "store/name_file.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

using namespace kori;

namespace {

constexpr int kPicked = 5;                                 // the colour clicked: magenta,
constexpr platform::Colour kMark = platform::Rgb(1, 2, 3); // made unique for the test
constexpr std::string_view kMarkText = "#197121";          // kMark as the surface records it

struct Colours : ::testing::Test {
    test::SampleSession s;
    const platform::Palette original = s.session.palette; // the sample's black scheme

    // The chart of KRM with both averages, Bollinger bands, the price grid and, when asked, an
    // oscillator panel, built in `palette`; the surface's calls.
    std::vector<std::string> Build(const platform::Palette& palette, char style = 'B',
                                   const std::string& oscName = "", bool mma = false) {
        s.session.palette = palette;
        app::ChartJob job;
        job.Name = s.Name("KRM");
        job.Defaults = chart::LoadChartDefaults(s.session.ini());
        job.Defaults.ShowPriceGrid = true;
        job.Request.ChartStyle = style;
        job.Request.ChartPeriod = 'A';
        job.Request.BarSpacing = 4;
        job.Request.AvOne = job.Request.AvTwo = true;
        job.Request.MMAOn = mma;
        job.Request.ChartBands = 2;
        job.WriteStream = false;
        platform::RecordingSurface area(1000, 700);
        chart::Chart c;
        if (oscName.empty()) {
            EXPECT_TRUE(app::BuildSecurityChart(s.session, job, c, area).ok());
            return area.calls();
        }
        const osc::PanelSplit split = osc::SplitChartArea(700);
        platform::SubSurface price(area, 0, split.PriceHeight);
        platform::SubSurface panel(area, split.PriceHeight, split.PanelHeight);
        job.Request.SecondPanelShowing = job.Request.AutoOsc = true;
        job.Request.AutoOscCode = oscName;
        EXPECT_TRUE(app::BuildSecurityChart(s.session, job, c, price).ok());
        app::OscPanelJob pj;
        pj.OscName = oscName;
        pj.PanelOffset = split.PriceHeight;
        app::DrawSecurityOscillator(s.session, job, c, pj, panel);
        return area.calls();
    }

    platform::Palette Marked() const {
        platform::Palette p = original;
        p[kPicked] = kMark;
        return p;
    }

    // The table after the item of `name` took the picked colour.
    platform::Palette Painted(std::string_view name) {
        app::ColourForm form(Marked());
        form.PickColour(kPicked);
        const auto& items = app::ColourItems();
        for (std::size_t i = 0; i < items.size(); ++i)
            if (items[i].Name == name) EXPECT_TRUE(form.PaintItem(i));
        return form.table();
    }
};

// Calls that start with `kind` and are drawn in the marked colour.
int CountMarked(const std::vector<std::string>& calls, std::string_view kind) {
    int n = 0;
    for (const auto& c : calls)
        if (c.rfind(kind, 0) == 0 && c.find(kMarkText) != std::string::npos) ++n;
    return n;
}

TEST_F(Colours, AnItemChangesOnlyTheEntriesItStandsFor) {
    const platform::Palette before = Marked();
    const auto& items = app::ColourItems();
    ASSERT_EQ(items.size(), static_cast<std::size_t>(app::kRoleCount));
    std::vector<int> seen;
    for (std::size_t i = 0; i < items.size(); ++i) {
        app::ColourForm form(before);
        EXPECT_FALSE(form.PaintItem(i)) << "no colour clicked yet";
        form.PickColour(kPicked);
        ASSERT_TRUE(form.PaintItem(i));
        for (int e = 0; e < platform::kPaletteSize; ++e) {
            const bool own = std::find(items[i].Entries.begin(), items[i].Entries.end(), e) !=
                             items[i].Entries.end();
            EXPECT_EQ(form.table()[e], own ? kMark : before[e]) << items[i].Name << " entry " << e;
        }
        EXPECT_EQ(form.ItemColour(i), kMark) << "the swatch shows what the chart gets";
        seen.insert(seen.end(), items[i].Entries.begin(), items[i].Entries.end());
    }
    std::sort(seen.begin(), seen.end());
    EXPECT_EQ(std::adjacent_find(seen.begin(), seen.end()), seen.end()) << "two items, one entry";
}

TEST_F(Colours, EachItemPaintsWhatItNamesOnABuiltChart) {
    const platform::Palette plain = Marked();
    ASSERT_EQ(CountMarked(Build(plain), ""), 0);

    // Background: the plot is cleared in it; the frame stays as it was.
    auto calls = Build(Painted("Background"));
    EXPECT_EQ(CountMarked(calls, "Clear"), 1);
    EXPECT_EQ(CountMarked(calls, "Box"), 0);
    EXPECT_EQ(CountMarked(calls, "Line"), 0);

    calls = Build(Painted("Border"));
    EXPECT_EQ(CountMarked(calls, "Box"), 2) << "the price and volume frames";
    EXPECT_EQ(CountMarked(calls, "Clear"), 0);

    calls = Build(Painted("Chart title"));
    EXPECT_EQ(CountMarked(calls, "Text 20,2 "), 1);

    calls = Build(Painted("Scales / text"));
    EXPECT_GT(CountMarked(calls, "Text"), 5) << "price and volume labels";
    EXPECT_EQ(CountMarked(calls, "Text 20,2 "), 0);

    const int bars = CountMarked(Build(Painted("Chart lines")), "Line");
    EXPECT_GT(bars, 200) << "a high-low line and two ticks a bar";

    EXPECT_GT(CountMarked(Build(Painted("Candle / P&F down"), 'C'), "FilledBox"), 20);
    EXPECT_GT(CountMarked(Build(Painted("Average 1")), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("Average 2")), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("Average 3")), "Point"), 100) << "the ten-bar trace";
    EXPECT_GT(CountMarked(Build(Painted("Volume bars")), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("Bands")), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("Fixed grid lines")), "Line"), 3);
    EXPECT_GE(CountMarked(Build(Painted("End of year marker")), "Line"), 1);
    EXPECT_GT(CountMarked(Build(Painted("MMA (Short)"), 'B', "", true), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("MMA (Long)"), 'B', "", true), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("Oscillator Line 1"), 'B', "RSI"), "Line"), 100);
    EXPECT_GT(CountMarked(Build(Painted("Osc/Indicator UP"), 'B', "DM"), "Line"), 10);
    EXPECT_GT(CountMarked(Build(Painted("Osc/Indicator DOWN"), 'B', "DM"), "Line"), 10);
}

TEST_F(Colours, TheThreeSchemesGiveThreeCharts) {
    const std::string sys = s.session.folders.SystemFolder;
    std::vector<platform::Colour> backgrounds;
    for (const char* scheme : {"Black", "White", "Blue"}) {
        app::ColourForm form(s.session.palette);
        ASSERT_TRUE(form.ApplyScheme(scheme, sys).ok());
        EXPECT_EQ(form.scheme(), scheme);
        const auto calls = Build(form.table());
        const std::string clear = "Clear #" + std::to_string(form.table()[17]);
        EXPECT_NE(std::find(calls.begin(), calls.end(), clear), calls.end()) << scheme;
        backgrounds.push_back(form.table()[17]);
        // Bars and labels stand out from the background in every scheme.
        EXPECT_NE(form.table()[18], form.table()[17]) << scheme;
        EXPECT_NE(form.table()[27], form.table()[17]) << scheme;
        EXPECT_NE(form.table()[22], form.table()[17]) << scheme;
        EXPECT_NE(form.table()[45], form.table()[17]) << scheme;
        platform::Palette written{};
        ASSERT_EQ(app::ReadColourFile(sys + "koriclr.dat", written), platform::kPaletteSize);
        EXPECT_EQ(written, form.table()) << scheme;
    }
    EXPECT_EQ(backgrounds, (std::vector<platform::Colour>{platform::kStandardColours[0],
                                                          platform::kStandardColours[15],
                                                          platform::kStandardColours[1]}));
}

} // namespace
