// The oscillator panel: its rectangle, frame and title, the scales and reference lines, the
// stream positions under the price chart, and a few routines' lines worked out by hand.
#include "osc/osc_draw.h"
#include "osc/osc_panel.h"
#include "osc_test_bars.h"
#include "platform/sub_surface.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <fstream>
#include <sstream>

namespace kori::osc {
namespace {

platform::Palette NumberedPalette() {
    platform::Palette p{};
    for (std::size_t i = 0; i < p.size(); ++i)
        p[i] = static_cast<platform::Colour>(i);
    return p;
}

using Seg = std::array<double, 4>;

// The lines the surface drew in palette entry `entry` (the palette numbers its colours).
std::vector<Seg> LinesIn(const platform::RecordingSurface& s, int entry) {
    std::vector<Seg> out;
    const std::string tail = " #" + std::to_string(entry);
    for (const std::string& call : s.calls()) {
        if (call.rfind("Line ", 0) != 0 || call.size() < tail.size() ||
            call.compare(call.size() - tail.size(), tail.size(), tail) != 0)
            continue;
        Seg seg{};
        std::sscanf(call.c_str() + 5, "%lf,%lf,%lf,%lf", &seg[0], &seg[1], &seg[2], &seg[3]);
        out.push_back(seg);
    }
    return out;
}

bool HasCall(const platform::RecordingSurface& s, std::string_view prefix) {
    for (const std::string& call : s.calls())
        if (call.rfind(prefix, 0) == 0) return true;
    return false;
}

std::vector<std::string> TextsOf(const platform::RecordingSurface& s) {
    std::vector<std::string> out;
    for (const std::string& call : s.calls())
        if (call.rfind("Text ", 0) == 0) out.push_back(call);
    return out;
}

bool AnyTextEndsWith(const platform::RecordingSurface& s, std::string_view text) {
    for (const std::string& t : TextsOf(s))
        if (t.find(std::string("\"") + std::string(text) + "\"") != std::string::npos ||
            t.find(text) != std::string::npos)
            return true;
    return false;
}

struct PanelRig {
    test::TempRoot root;
    platform::Palette palette = NumberedPalette();
    platform::ChartFonts fonts;
    platform::ScriptedDialogs dialogs;
    chart::Chart chart;
    OscDef def;
    OscDrawInputs in{palette, fonts, dialogs};
    platform::RecordingSurface panel{1000, 220};

    explicit PanelRig(store::ChartSeries s) {
        chart.Series = std::move(s);
        chart.BarSpacing = 2;
        chart.PlotRight = 900;
        in.StreamPath = root.path() / "TCht.Tmp";
        std::ofstream(in.StreamPath).put('\n'); // the price chart's part, already there
    }

    std::vector<std::string> Stream() const {
        std::ifstream f(in.StreamPath);
        std::vector<std::string> lines;
        for (std::string line; std::getline(f, line);) {
            if (!line.empty() && line.back() == '\r') line.pop_back();
            if (!line.empty()) lines.push_back(line);
        }
        return lines;
    }
};

store::ChartSeries Rising(int bars) {
    store::ChartSeries s;
    for (int i = 0; i < bars; ++i) {
        store::ChartBar b;
        b.Close = b.Open = 10.0f + static_cast<float>(i % 7) + 0.1f * static_cast<float>(i);
        b.High = b.Close + 0.5f;
        b.Low = b.Close - 0.5f;
        b.Volume = 1000 + i;
        s.ChartBars.push_back(b);
    }
    s.LastBar = static_cast<std::int16_t>(bars - 1);
    return s;
}

TEST(OscPanelTest, RectangleRoundsOrDividesWholeNumbers) {
    PanelRig rig(Rising(30));
    rig.panel.Resize(1000, 175);
    OscPainter p(rig.chart, rig.in, rig.panel);
    const OscPanel rounded = SetOscPanel(p, false);
    EXPECT_EQ(rounded.OscTop, 4);      // 3.5 to even
    EXPECT_EQ(rounded.OscBottom, 172); // 171.5 to even
    EXPECT_EQ(rounded.OscLeft, 5);
    EXPECT_EQ(rounded.OscRight, 900);
    const OscPanel divided = SetOscPanel(p, false, true); // the stochastic's integer division
    EXPECT_EQ(divided.OscTop, 3);
    EXPECT_EQ(divided.OscBottom, 171);
}

TEST(OscPanelTest, StreamGoesUnderThePriceChartAtTheDisplayScale) {
    PanelRig rig(Rising(40));
    rig.def.RsiP = 14;
    rig.in.DisplayScale = 2;
    rig.in.PanelOffset = 500;
    EXPECT_EQ(ShowOscillator(rig.chart, "RSI", 'A', rig.def, rig.in, rig.panel), OscOutcome::Drawn);
    const auto lines = rig.Stream();
    ASSERT_GE(lines.size(), 2u);
    // Panel 4 to 216 on the screen: 4 / 2 + 500 and 216 / 2 + 500 in the stream.
    EXPECT_EQ(lines[0], "B, 5, 502, 900, 608, 16");
    // The title keeps the blank of the number, stands at OscLeft + 2, OscTop + 2.
    EXPECT_EQ(lines[1], "T, 8.25, 7, 503,Relative Strength Index Oscillator ( 14 Period), 27");
    EXPECT_FALSE(rig.chart.Stream.isOpen());
}

TEST(OscPanelTest, PeriodZeroDrawsNothingAndPanelWithoutHeightOnlyFrameAndTitle) {
    PanelRig rig(Rising(40));
    EXPECT_EQ(ShowOscillator(rig.chart, "RSI", 'A', rig.def, rig.in, rig.panel),
              OscOutcome::NotSet);
    EXPECT_TRUE(rig.panel.calls().empty());
    EXPECT_TRUE(rig.dialogs.shown().empty());

    rig.def.RsiP = 14;
    rig.panel.Resize(1000, 20); // OscTop 0, OscBottom 20: Span 0, Unit 0
    ShowOscillator(rig.chart, "RSI", 'A', rig.def, rig.in, rig.panel);
    EXPECT_TRUE(HasCall(rig.panel, "Box 5,0,900,20 #16"));
    EXPECT_EQ(TextsOf(rig.panel).size(), 1u);
    EXPECT_TRUE(LinesIn(rig.panel, 16).empty());
    EXPECT_TRUE(LinesIn(rig.panel, 45).empty());
}

TEST(OscPanelTest, DispatchGuardsAndOverlays) {
    PanelRig rig(Rising(40));
    rig.def.RmoP = 30;
    EXPECT_EQ(ShowOscillator(rig.chart, "RMO", 'W', rig.def, rig.in, rig.panel),
              OscOutcome::DailyOnly);
    ASSERT_EQ(rig.dialogs.shown().size(), 1u);
    EXPECT_EQ(rig.dialogs.shown()[0].text, "RMO only available on Daily Charts");
    EXPECT_EQ(rig.dialogs.shown()[0].title, "RMO");
    EXPECT_EQ(ShowOscillator(rig.chart, "PARA", 'A', rig.def, rig.in, rig.panel),
              OscOutcome::OnPriceChart);
    EXPECT_EQ(ShowOscillator(rig.chart, "XYZ", 'A', rig.def, rig.in, rig.panel),
              OscOutcome::Unknown);
    EXPECT_TRUE(rig.panel.calls().empty());
}

TEST(OscPanelTest, RocAndFxShareOneFrameAndFxTitleStandsFurtherRight) {
    PanelRig rig(Rising(80));
    rig.def.RocP = 5;
    rig.def.RocA = 3;
    rig.def.FXF = 10;
    rig.def.FXX = 4;
    ShowOscillator(rig.chart, "R/F", 'A', rig.def, rig.in, rig.panel);
    int boxes = 0, clears = 0;
    for (const auto& c : rig.panel.calls()) {
        boxes += c.rfind("Box ", 0) == 0;
        clears += c.rfind("Clear", 0) == 0;
    }
    EXPECT_EQ(boxes, 1);
    EXPECT_EQ(clears, 1);
    const auto lines = rig.Stream();
    int frames = 0;
    bool fxTitle = false, rocTitle = false;
    for (const auto& l : lines) {
        frames += l.rfind("B,", 0) == 0;
        // Without RFAve the ROC title stops at the period; FX stands at OscLeft + 250.
        rocTitle |= l.find(", 7, ") != std::string::npos &&
                    l.find("Rate of Change Oscillator ( 5 Period), 27") != std::string::npos;
        fxTitle |= l.rfind("T, 8.25, 255, ", 0) == 0 &&
                   l.find("FX Oscillator (F= 10 Period  X= 4 Period)") != std::string::npos;
    }
    EXPECT_EQ(frames, 1);
    EXPECT_TRUE(rocTitle);
    EXPECT_TRUE(fxTitle);
    // FX inside the pair draws in 47 only: without RFAve its second line is off.
    EXPECT_FALSE(LinesIn(rig.panel, 47).empty());
    EXPECT_TRUE(LinesIn(rig.panel, 48).empty());
    EXPECT_TRUE(LinesIn(rig.panel, 46).empty()); // no ROC average either
    // The FX title is further right on the screen than in the stream.
    EXPECT_TRUE(AnyTextEndsWith(rig.panel, "Text 295,"));
}

TEST(OscPanelTest, RsiLineWorkedByHand) {
    // P = 3: the window of bar i is the pairs (i-3, i-2) and (i-2, i-1). Bar 3: up 2, down 1;
    // bars 4 and 5 the same mix, RSI 66.67; bar 6: down 1, up 4, RSI 80. Points stand from
    // bar 2 on, the first segment ends at bar 5.
    PanelRig rig(test::CloseBars({10, 12, 11, 13, 12, 16, 15}));
    rig.def.RsiP = 3;
    ShowOscillator(rig.chart, "RSI", 'A', rig.def, rig.in, rig.panel);
    const auto segs = LinesIn(rig.panel, 45);
    ASSERT_EQ(segs.size(), 2u);
    // Panel 4 to 216: Span 192, Unit 1.92, y = 206 - RSI x 1.92.
    const double y67 = 206 - (100 - 100 / 3.0) * 1.92, y80 = 206 - 80 * 1.92;
    EXPECT_DOUBLE_EQ(segs[0][0], 13); // bar 4
    EXPECT_NEAR(segs[0][1], y67, 1e-3);
    EXPECT_DOUBLE_EQ(segs[0][2], 15);
    EXPECT_NEAR(segs[0][3], y67, 1e-3);
    EXPECT_DOUBLE_EQ(segs[1][2], 17);
    EXPECT_NEAR(segs[1][3], y80, 1e-3);
    // Reference lines at shares of Span from OscTop + 10: 14 + 57.6, 14 + 134.4, 14 + 96.
    const auto refs = LinesIn(rig.panel, 16);
    ASSERT_EQ(refs.size(), 3u);
    EXPECT_EQ(refs[0][1], 72);
    EXPECT_EQ(refs[1][1], 148);
    EXPECT_EQ(refs[2][1], 110);
}

TEST(OscPanelTest, SymmetricScaleKeepsZeroInTheMiddle) {
    OscPanel panel;
    panel.OscTop = 4;
    panel.OscBottom = 216;
    const SymmetricScale s = MakeSymmetricScale(panel, 80, -20);
    EXPECT_EQ(s.Hi, 80);
    EXPECT_EQ(s.Lo, -80);
    EXPECT_DOUBLE_EQ(s.Per, 160.0 / 192);
    EXPECT_DOUBLE_EQ(s.Y(panel, 0), 206 - 96);
    const SymmetricScale t = MakeSymmetricScale(panel, 5, -30);
    EXPECT_EQ(t.Hi, 30);
    EXPECT_EQ(t.Lo, -30);
    EXPECT_EQ(MakeSymmetricScale(panel, 0, 0).Per, 0);
}

TEST(OscPanelTest, FlatChartStopsMomentumAfterTheTitle) {
    PanelRig rig(test::CloseBars({5, 5, 5, 5, 5, 5, 5, 5, 5, 5}));
    rig.def.MMA = 3;
    ShowOscillator(rig.chart, "MOM", 'A', rig.def, rig.in, rig.panel);
    const auto texts = TextsOf(rig.panel);
    ASSERT_EQ(texts.size(), 1u);
    EXPECT_NE(texts[0].find("Momentum Oscillator ( 3 Period)   0 Ave"), std::string::npos);
    EXPECT_TRUE(LinesIn(rig.panel, 16).empty());
}

TEST(OscPanelTest, FxUpsideDownSwapsLabelsNotLines) {
    PanelRig rig(Rising(60));
    rig.def.FXF = 10;
    rig.def.FXX = 5;
    ShowOscillator(rig.chart, "FX", 'A', rig.def, rig.in, rig.panel);
    const auto upright = LinesIn(rig.panel, 16);
    const auto uprightTexts = TextsOf(rig.panel);
    rig.def.FXRev = true;
    rig.panel.ClearCalls();
    ShowOscillator(rig.chart, "FX", 'A', rig.def, rig.in, rig.panel);
    EXPECT_EQ(LinesIn(rig.panel, 16), upright);
    // Panel 4 to 215 by whole-number division, Span 195 - 24 = 171: value 25 stands at
    // 195 - 25 x 171 / 100 = 152.25.
    ASSERT_EQ(upright.size(), 2u);
    EXPECT_EQ(upright[0][1], 152);
    const auto texts = TextsOf(rig.panel);
    ASSERT_GE(texts.size(), 3u);
    EXPECT_NE(uprightTexts[1].find(" 25%"), std::string::npos);
    EXPECT_NE(texts[1].find(" 75%"), std::string::npos);
}

TEST(OscPanelTest, NoVolumeDataMessage) {
    PanelRig rig(test::CloseBars({5, 6, 7, 6, 5, 6}));
    ShowOscillator(rig.chart, "OBV", 'A', rig.def, rig.in, rig.panel);
    EXPECT_TRUE(AnyTextEndsWith(rig.panel, "No Volume Data"));
    bool streamed = false;
    for (const auto& l : rig.Stream())
        streamed |= l == "T, 8.25, 7, 34,No Volume Data, 27";
    EXPECT_TRUE(streamed);
}

TEST(OscPanelTest, ClassicMacdLinesGoOnThePriceChartUnlessSwitchedOff) {
    PanelRig rig(Rising(120));
    rig.chart.Map = chart::PriceMap{};
    rig.def.Md1 = 3;
    rig.def.Md2 = 5;
    rig.def.Md3 = 2;
    platform::RecordingSurface price(1000, 500);
    rig.in.PriceSurface = &price;
    ShowOscillator(rig.chart, "MACD", 'A', rig.def, rig.in, rig.panel);
    EXPECT_FALSE(price.calls().empty());
    const auto histogram = LinesIn(rig.panel, 45);
    // From bar P1 + P2 + P3 = 10 to bar 119, one bar each.
    EXPECT_EQ(histogram.size(), 110u);

    price.ClearCalls();
    rig.def.NoClassicMACD = true;
    rig.panel.ClearCalls();
    ShowOscillator(rig.chart, "MACD", 'A', rig.def, rig.in, rig.panel);
    EXPECT_TRUE(price.calls().empty());
    EXPECT_EQ(LinesIn(rig.panel, 45), histogram);

    rig.def.NoClassicMACD = false;
    rig.in.TargetName = "anal";
    ShowOscillator(rig.chart, "MACD", 'A', rig.def, rig.in, rig.panel);
    EXPECT_TRUE(price.calls().empty());
}

TEST(OscPanelTest, FailureMessages) {
    platform::ScriptedDialogs d;
    ShowOscFailure(d, 480, "");
    ShowOscFailure(d, 6, "Overflow");
    ASSERT_EQ(d.shown().size(), 2u);
    EXPECT_EQ(d.shown()[0].text, "There is not enough memory to complete all pages display. "
                                 "Please ring KORI if this message appears often.");
    EXPECT_EQ(d.shown()[1].text, "There is an unexpected error No. 6\nOverflow");
    EXPECT_EQ(d.shown()[1].title, "Chart Display");
}

TEST(OscPanelTest, ZeroClosesAndPeriodsLongerThanTheChart) {
    // Zero closes in the middle of the chart and periods beyond its end: every routine draws
    // its frame; with the long periods none has a line, except the Volatility bars, which
    // stand from bar 0 whatever the period of their mean.
    auto zeros = Rising(60);
    for (int i : {0, 7, 8, 30})
        zeros.ChartBars[static_cast<std::size_t>(i)].Close = 0;
    for (const auto* name : {"ATR", "STO", "FX", "ROC", "R/F", "RSI", "MACD", "WMS", "ERY", "MOM",
                             "DM", "JHG", "COP", "VTY", "OBV"}) {
        for (bool longPeriods : {false, true}) {
            PanelRig rig(zeros);
            for (const auto& k : OscPeriodKeys())
                rig.def.*k.DailyField = longPeriods      ? std::int16_t{200}
                                        : k.DefaultDaily ? k.DefaultDaily
                                                         : std::int16_t{5};
            EXPECT_EQ(ShowOscillator(rig.chart, name, 'A', rig.def, rig.in, rig.panel),
                      OscOutcome::Drawn)
                << name;
            EXPECT_TRUE(HasCall(rig.panel, "Box 5,4,900,21")) << name; // 215 for STO and FX
            if (longPeriods && std::string_view(name) != "VTY")
                EXPECT_TRUE(LinesIn(rig.panel, 45).empty()) << name;
            if (!longPeriods && std::string_view(name) != "OBV")
                EXPECT_FALSE(LinesIn(rig.panel, std::string_view(name) == "R/F"   ? 47
                                                : std::string_view(name) == "ERY" ? 38
                                                                                  : 45)
                                 .empty())
                    << name;
        }
    }
}

TEST(SubSurfaceTest, MovesDrawingIntoItsBand) {
    platform::RecordingSurface whole(300, 200);
    platform::SubSurface band(whole, 140, 60);
    EXPECT_EQ(band.ScaleHeight(), 60);
    EXPECT_EQ(band.ScaleWidth(), 300);
    band.SetBackColour(7);
    band.Clear();
    band.Line(1, 2, 3, 4, 9);
    band.SetTextPosition(5, 6);
    ASSERT_EQ(whole.calls().size(), 2u);
    EXPECT_EQ(whole.calls()[0], "FilledBox 0,140,300,200 #7");
    EXPECT_EQ(whole.calls()[1], "Line 1,142,3,144 #9");
}

} // namespace
} // namespace kori::osc

namespace kori::osc {
namespace {

TEST(OscPanelTest, StochasticCrossingMarksOnThePriceChart) {
    // Down 20 bars, up 20, down 20: the %D line leaves the bottom zone on the way up (a buy
    // mark) and the top zone on the way down (a sell mark).
    store::ChartSeries s;
    float close = 50;
    for (int i = 0; i < 60; ++i) {
        close += i < 20 || i >= 40 ? -1.0f : 1.0f;
        store::ChartBar b;
        b.Open = b.High = b.Low = b.Close = close;
        s.ChartBars.push_back(b);
    }
    s.LastBar = 59;
    PanelRig rig(s);
    rig.def.StochK = 5;
    rig.def.StochD = 3;
    platform::RecordingSurface price(1000, 500);
    rig.in.PriceSurface = &price;
    ShowOscillator(rig.chart, "STO", 'A', rig.def, rig.in, rig.panel);
    EXPECT_TRUE(price.calls().empty()); // only with the start-up words that ask for them

    rig.in.ShowStochSignals = true;
    ShowOscillator(rig.chart, "STO", 'A', rig.def, rig.in, rig.panel);
    const auto buy = LinesIn(price, 10), sell = LinesIn(price, 12);
    ASSERT_EQ(buy.size(), 3u);
    ASSERT_EQ(sell.size(), 3u);
    EXPECT_EQ(buy[0][3], 40);
    EXPECT_EQ(sell[0][3], 48);
    EXPECT_LT(buy[0][0], sell[0][0]);
    // The marks stand on bars of the turn: after bar 20 and after bar 40.
    EXPECT_GT(buy[0][0], 20 * 2);
    EXPECT_GT(sell[0][0], 40 * 2);
    EXPECT_LT(sell[0][0], 50 * 2);
}

} // namespace
} // namespace kori::osc

namespace kori::osc {
namespace {

TEST(OscPanelTest, WilliamsShowsTheMeanOfThreePositions) {
    // P = 2: %R stands from bar 2 (not 1): bars 2 to 7 give 0, 100, 100, 50, 0, 66.7; at
    // 14 + %R x 1.92 rounded the positions are 14, 206, 206, 110, 14, 142, and their
    // three-bar means 142, 174, 110, 89 at bars 4 to 7. The line joins the means from the
    // third on.
    PanelRig rig(test::HlcBars({{10, 8, 9},
                                {11, 9, 10},
                                {12, 10, 12},
                                {12, 10, 10},
                                {11, 9, 9},
                                {13, 9, 11},
                                {13, 11, 13},
                                {14, 12, 12}}));
    rig.def.WmsA = 2;
    ShowOscillator(rig.chart, "WMS", 'A', rig.def, rig.in, rig.panel);
    const auto segs = LinesIn(rig.panel, 45);
    ASSERT_EQ(segs.size(), 2u);
    EXPECT_EQ(segs[0], (Seg{15, 174, 17, 110}));
    EXPECT_EQ(segs[1], (Seg{17, 110, 19, 89}));
    // "o/b" at the top tenth of Span, "o/s" at the bottom tenth.
    const auto refs = LinesIn(rig.panel, 16);
    ASSERT_EQ(refs.size(), 2u);
    EXPECT_EQ(refs[0][1], 33);  // 14 + 19.2
    EXPECT_EQ(refs[1][1], 187); // 14 + 172.8
}

TEST(OscPanelTest, CoppockAndObvStepAfterTheirTest) {
    // These two routines start at OscLeft for bar 1, one bar left of the others.
    store::ChartSeries s = Rising(80);
    PanelRig rig(s);
    ShowOscillator(rig.chart, "OBV", 'A', rig.def, rig.in, rig.panel);
    std::vector<Seg> obv = LinesIn(rig.panel, 38);
    for (const auto& seg : LinesIn(rig.panel, 40))
        obv.push_back(seg);
    ASSERT_FALSE(obv.empty());
    double leftmost = 1e9;
    for (const auto& seg : obv)
        leftmost = std::min(leftmost, seg[0]);
    EXPECT_EQ(leftmost, 5); // bar 1
}

} // namespace
} // namespace kori::osc

namespace kori::osc {
namespace {

TEST(OscPanelTest, SlowStochasticSecondLineBeginsAfterBothPeriods) {
    PanelRig rig(Rising(40));
    rig.def.StochK = 5;
    rig.def.StochD = 3;
    ShowOscillator(rig.chart, "STO", 'A', rig.def, rig.in, rig.panel);
    // Fast: both lines from the second bar with a figure, bar K + 2 = 7 (x 19).
    ASSERT_FALSE(LinesIn(rig.panel, 46).empty());
    EXPECT_EQ(LinesIn(rig.panel, 45).front()[2], 19);
    EXPECT_EQ(LinesIn(rig.panel, 46).front()[2], 19);
    rig.panel.ClearCalls();
    rig.in.SlowStochastic = true;
    ShowOscillator(rig.chart, "STO", 'A', rig.def, rig.in, rig.panel);
    EXPECT_TRUE(
        AnyTextEndsWith(rig.panel, "SLOW Stochastic Oscillator (K= 5 Period  D= 3 Period)"));
    // Slow: the smoothed line leads in the first colour; the second smoothing joins after
    // K + D bars, from bar 8 to bar 9 (x 21 to 23).
    EXPECT_EQ(LinesIn(rig.panel, 45).front()[2], 19);
    EXPECT_EQ(LinesIn(rig.panel, 46).front()[0], 21);
    EXPECT_EQ(LinesIn(rig.panel, 46).front()[2], 23);
}

} // namespace
} // namespace kori::osc

namespace kori::osc {
namespace {

TEST(OscPanelTest, RateOfChangeOnItsSymmetricScaleByHand) {
    // P = 1: ROC of bars 2 to 5 against the current close: 20, -25, -25, 20; bars 0 and 1
    // hold 0. Hi 20, Lo -25 become 25 and -25: Per 50 / 192, y = 206 - (v + 25) x 3.84.
    PanelRig rig(test::CloseBars({100, 100, 125, 100, 80, 100}));
    rig.def.RocP = 1;
    rig.def.RocA = 2;
    ShowOscillator(rig.chart, "ROC", 'A', rig.def, rig.in, rig.panel);
    const auto refs = LinesIn(rig.panel, 16);
    ASSERT_EQ(refs.size(), 3u);
    EXPECT_EQ(refs[0][1], 110); // 0
    EXPECT_EQ(refs[1][1], 33);  // round(0.8 x 25) = 20 -> 33.2
    EXPECT_EQ(refs[2][1], 187); // -20 -> 186.8
    EXPECT_TRUE(AnyTextEndsWith(rig.panel, "[  0%]"));
    EXPECT_TRUE(AnyTextEndsWith(rig.panel, "[+80%]"));
    EXPECT_TRUE(AnyTextEndsWith(rig.panel, "[-80%]"));
    EXPECT_TRUE(AnyTextEndsWith(rig.panel, "[Rate of Change Oscillator ( 1 Period)   2 Ave]"));
    // The line from bar 2 on, from the bar before.
    EXPECT_EQ(LinesIn(rig.panel, 45),
              (std::vector<Seg>{
                  {7, 110, 9, 33}, {9, 33, 11, 206}, {11, 206, 13, 206}, {13, 206, 15, 33}}));
    // The average of the last two positions, rounded half to even: 110, 71.5, 119.5, 206,
    // 119.5 -> 110, 72, 120, 206, 120, joined from the second average on.
    EXPECT_EQ(LinesIn(rig.panel, 46),
              (std::vector<Seg>{
                  {7, 110, 9, 72}, {9, 72, 11, 120}, {11, 120, 13, 206}, {13, 206, 15, 120}}));
}

} // namespace
} // namespace kori::osc

namespace kori::osc {

// A negative period would count back before the first bar: refused with the window's message
// whatever the target, before anything is drawn. In the chart window the range check runs too.
TEST(OscPanelTest, NegativeAndOutOfRangePeriodsAreRefused) {
    const struct {
        const char* name;
        std::int16_t OscDef::*field;
        std::int16_t value;
        const char* target;
    } cases[] = {
        {"STO", &OscDef::StochK, -7, "CHTS"}, {"STO", &OscDef::StochK, -7, "ANAL"},
        {"STO", &OscDef::StochD, -1, "ANAL"}, {"FX", &OscDef::FXX, -3, "ANAL"},
        {"DM", &OscDef::DMA, -2, "ANAL"},     {"R/F", &OscDef::FXF, -5, "ANAL"},
        {"ROC", &OscDef::RocA, -4, "CHTS"},   {"STO", &OscDef::StochK, 500, "CHTS"},
    };
    for (const auto& c : cases) {
        PanelRig rig(Rising(60));
        for (const auto& k : OscPeriodKeys())
            rig.def.*k.DailyField = k.DefaultDaily ? k.DefaultDaily : std::int16_t{5};
        rig.def.*c.field = c.value;
        rig.in.TargetName = c.target;
        EXPECT_EQ(ShowOscillator(rig.chart, c.name, 'A', rig.def, rig.in, rig.panel),
                  OscOutcome::NotValid)
            << c.name << " " << c.value;
        EXPECT_EQ(rig.dialogs.messages(),
                  std::vector<std::string>{std::string(c.name) + " Oscillator values not valid"});
        EXPECT_TRUE(rig.panel.calls().empty()) << c.name;
    }
    // Outside the chart window the range check does not run: a long period still draws.
    PanelRig rig(Rising(60));
    rig.def.StochK = 500;
    rig.def.StochD = 3;
    rig.in.TargetName = "ANAL";
    EXPECT_EQ(ShowOscillator(rig.chart, "STO", 'A', rig.def, rig.in, rig.panel), OscOutcome::Drawn);
}

} // namespace kori::osc
