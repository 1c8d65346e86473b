#include "chart/swing.h"
#include "chart/targets.h"
#include "chart_test_rig.h"

#include <fstream>

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {

// Bars by high and low price; y = 950 - (price - 10) x 10 on the rig.
void AddBars(ChartRig& r, const std::vector<std::pair<float, float>>& hl) {
    int d = 1;
    for (auto [h, l] : hl) {
        r.Add("202403" + std::string(d < 10 ? "0" : "") + std::to_string(d), l, h, l, (h + l) / 2);
        ++d;
    }
}

void SwingRig(ChartRig& r, const char* method, float value = 0) {
    r.request.SwingOn = true;
    r.request.SwingMethod = ParseSwingMethod(method).value();
    r.request.SwingValue = value;
}

// Legs in the swing colours, in order.
std::vector<std::string> Legs(const ChartRig& r) {
    std::vector<std::string> out;
    for (const auto& l : Starting(r.Lines(), "H,"))
        if (l.ends_with(", 20") || l.ends_with(", 21")) out.push_back(l);
    return out;
}

// The first four bars rise: the up leg from the first low (y 650) to the fourth high (490)
// is drawn once three bars have passed, at the first bar's x.
const std::vector<std::pair<float, float>> kRise = {{50, 40}, {52, 42}, {54, 44}, {56, 46}};

} // namespace

TEST(Swing, NormTurnsOnALowerHighAndLowAndWaitsOutAnOutsideBar) {
    ChartRig r;
    SwingRig(r, "NORM");
    auto bars = kRise;
    bars.insert(bars.end(), {{53, 43}, {55, 41}, {54, 42}, {57, 45}});
    AddBars(r, bars);
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(Legs(r),
              (std::vector<std::string>{"H, 5, 650, 5, 490, 20",
                                        // bar 4: lower high and lower low, down at once
                                        "H, 5, 490, 45, 490, 21", "H, 45, 490, 45, 620, 21",
                                        // bar 5 outside (state 5), bar 6 inside; bar 7 leaves it
                                        // upwards: the leg goes down to the outside bar's low first
                                        "H, 45, 620, 45, 640, 21", "H, 45, 640, 75, 640, 20",
                                        "H, 75, 640, 75, 480, 20"}));
    EXPECT_TRUE(HasRun(r.Lines(), {"T, 8, 5, 142,Daily Swing  -  Standard, 27"}));
}

TEST(Swing, XDayCountsBarsAgainstTheSwing) {
    ChartRig r;
    SwingRig(r, "XDay", 2);
    auto bars = kRise;
    // A lower low counts one; the second lower low (count N - 1) turns the swing.
    bars.insert(bars.end(), {{55, 45}, {56, 46}, {55, 44}});
    AddBars(r, bars);
    ASSERT_TRUE(r.Build().ok());
    EXPECT_EQ(Legs(r), (std::vector<std::string>{"H, 5, 650, 5, 490, 20", "H, 5, 490, 65, 490, 21",
                                                 "H, 65, 490, 65, 610, 21"}));
    EXPECT_TRUE(HasRun(r.Lines(), {"T, 8, 5, 142,Daily Swing 2 - DAY, 27"}));
}

TEST(Swing, XPointTurnsOnAFallOfTheValue) {
    ChartRig r;
    SwingRig(r, "XPoint", 1100); // 11.00 for shares
    auto bars = kRise;
    bars.insert(bars.end(), {{55, 45.5f}, {54, 45}});
    AddBars(r, bars);
    ASSERT_TRUE(r.Build().ok());
    // 56 - 45.5 is short of 11; 56 - 45 is exactly 11 with a lower low: down.
    EXPECT_EQ(Legs(r), (std::vector<std::string>{"H, 5, 650, 5, 490, 20", "H, 5, 490, 55, 490, 21",
                                                 "H, 55, 490, 55, 600, 21"}));
}

TEST(Swing, NoLegsBeforeThreeBarsAndSidePanelStart) {
    ChartRig r;
    SwingRig(r, "NORM");
    AddBars(r, {{50, 40}, {52, 42}, {54, 44}});
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(Legs(r).empty());
}

TEST(Swing, AverageSwingAndTitles) {
    auto bar = [](float h, float l) {
        kori::store::ChartBar b;
        b.High = h;
        b.Low = l;
        b.Open = l;
        b.Close = h;
        return b;
    };
    // Start up at 12; turns at 14 (leg 2) and at 10 (leg 4): mean 3.
    const std::vector<kori::store::ChartBar> bars = {bar(10, 8),  bar(12, 10), bar(14, 12),
                                                     bar(13, 11), bar(12, 10), bar(13, 11)};
    EXPECT_FLOAT_EQ(AverageSwing(bars, 5), 3);
    EXPECT_FLOAT_EQ(AverageSwing(bars, 4), 300);
    EXPECT_FLOAT_EQ(AverageSwing(bars, 1), 5);
    EXPECT_FLOAT_EQ(AverageSwing({bar(10, 8), bar(10, 8)}, 5), 5);
    EXPECT_EQ(SwingTitleText('W', SwingMethod::XPoint, 9), "Weekly Swing 9 - POINT");
    EXPECT_EQ(SwingTitleText('M', SwingMethod::XPointAuto, 12), "Monthly Swing 12 - Point(Auto)");
}

// One home for the method: its name both ways, whether it takes a value, and its panel.
TEST(Swing, MethodsByName) {
    for (SwingMethod m : SwingMethods())
        EXPECT_EQ(ParseSwingMethod(SwingMethodName(m)), m);
    EXPECT_EQ(ParseSwingMethod(" xday "), SwingMethod::XDay);
    EXPECT_EQ(ParseSwingMethod("xpointauto"), SwingMethod::XPointAuto);
    EXPECT_FALSE(ParseSwingMethod("XWeek"));
    EXPECT_FALSE(ParseSwingMethod(""));
    EXPECT_EQ(SwingMethods().size(), 4u);
    EXPECT_EQ(SwingMethods().front(), SwingMethod::Norm);
    EXPECT_TRUE(SwingMethodTakesValue(SwingMethod::XDay));
    EXPECT_TRUE(SwingMethodTakesValue(SwingMethod::XPoint));
    EXPECT_FALSE(SwingMethodTakesValue(SwingMethod::XPointAuto));
    EXPECT_FALSE(SwingMethodTakesValue(SwingMethod::Norm));
    EXPECT_EQ(SwingSidePanel(SwingMethod::Norm), SidePanel::None);
    EXPECT_EQ(SwingSidePanel(SwingMethod::XPointAuto), SidePanel::XPointAuto);
    EXPECT_EQ(SwingSidePanel(SwingMethod::XDay), SidePanel::Other);
    EXPECT_EQ(SwingSidePanel(SwingMethod::XPoint), SidePanel::Other);
    EXPECT_TRUE(SwingValueValid(SwingMethod::Norm, -1)); // takes no value
    EXPECT_EQ(SwingValueOf(SwingMethod::XDay, 5), 5);
    EXPECT_EQ(SwingValueOf(SwingMethod::XPointAuto, -2), 9);
}

TEST(Swing, ValuesAndTheSwitch) {
    EXPECT_TRUE(SwingValueValid(SwingMethod::XDay, 30));
    EXPECT_FALSE(SwingValueValid(SwingMethod::XDay, 31));
    EXPECT_FALSE(SwingValueValid(SwingMethod::XDay, 0.5f));
    EXPECT_FALSE(SwingValueValid(SwingMethod::XPoint, 0.5f));
    EXPECT_TRUE(SwingValueValid(SwingMethod::XPoint, 500));
    EXPECT_EQ(SwingValueOf(SwingMethod::XDay, 0), 3);
    EXPECT_EQ(SwingValueOf(SwingMethod::XPoint, 0), 9);

    ChartRequest req;
    req.ChartStyle = 'C';
    req.BarSpacing = 2;
    SwingSwitch s;
    s.Set(req, true);
    EXPECT_EQ(req.ChartStyle, 'B');
    EXPECT_EQ(req.BarSpacing, 3);
    s.Set(req, false);
    EXPECT_EQ(req.BarSpacing, 2);
    req.BarSpacing = 5;
    s.Set(req, true);
    EXPECT_EQ(req.BarSpacing, 5);
}

TEST(TargetLines, FirstTwoLinesOfTheCodeWithinThePlot) {
    kori::test::TempRoot root;
    const auto file = root.path() / "Targets.txt";
    {
        std::ofstream out(file);
        out << "BHP,55.5,U\r\nXYZ,1,D\r\nBHP,95,D\r\nBHP,30,U\r\n";
    }
    EXPECT_EQ(ReadTargetPrices(file, "BHP"), (std::vector<float>{55.5f, 95}));
    EXPECT_TRUE(ReadTargetPrices(root.path() / "none.txt", "BHP").empty());

    ChartRig r;
    AddBars(r, {{50, 40}});
    const auto prices = ReadTargetPrices(file, "BHP");
    const ChartBuild b{r.request,
                       r.defaults,
                       r.name,
                       r.palette,
                       r.fonts,
                       r.dialogs,
                       r.streamPath,
                       r.printBold,
                       r.volumeDivisor,
                       nullptr,
                       [&](Chart& c, const ChartRequest&, kori::platform::Surface& s) {
                           DrawTargetLines(c, s, r.palette, prices);
                       }};
    ASSERT_TRUE(BuildChart(r.chart, b, r.source, r.surface).ok());
    // 55.5 is y 495; 95 lies above the plot (y 100) and is left out.
    const auto lines = Starting(r.Lines(), "L, 5, ");
    EXPECT_EQ(lines, (std::vector<std::string>{"L, 5, 495, 354, 495, 12"}));
}
