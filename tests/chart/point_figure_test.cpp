#include "chart/point_figure.h"
#include "chart_test_rig.h"

#include <limits>

using namespace kori::chart;
using kori::test::ChartRig;
using kori::test::HasRun;
using kori::test::Starting;

namespace {

struct PFRun {
    std::vector<PFBox> boxes;
    std::vector<std::pair<int, int>> columns; // column, bar

    explicit PFRun(const std::vector<float>& closes, std::int16_t reversal = 3) {
        PFColumns pf(10, 1, reversal);
        pf.onBox = [this](const PFBox& b) { boxes.push_back(b); };
        pf.onColumn = [this](int c, int bar) { columns.push_back({c, bar}); };
        for (std::size_t i = 0; i < closes.size(); ++i)
            pf.Close(closes[i], static_cast<int>(i));
    }
};

std::string Describe(const std::vector<PFBox>& boxes) {
    std::string s;
    for (const auto& b : boxes)
        s += std::to_string(b.Column) + (b.Rising ? "+" : "-") + std::to_string(b.Row) + " ";
    return s;
}

} // namespace

TEST(PointFigureColumns, BoxesByInclusiveTests) {
    // Exactly one box up adds a box; a shade less does not; a close of 0 is skipped.
    EXPECT_EQ(Describe(PFRun({20, 21}).boxes), "1+10 1+11 ");
    EXPECT_EQ(Describe(PFRun({20, 20.99f, 0, 20}).boxes), "1+10 ");
    EXPECT_EQ(Describe(PFRun({20, 17.5f}).boxes), "1+10 1-9 1-8 ");
}

TEST(PointFigureColumns, Reversals) {
    // A column holding two boxes after its first (BoxesInColumn 2) turns round in place on a
    // three-box reversal.
    EXPECT_EQ(Describe(PFRun({20, 21, 22, 19}).boxes), "1+10 1+11 1+12 1-11 1-10 1-9 ");
    // A longer column moves right for the reversal, which fills all its boxes.
    const PFRun r({20, 21, 22, 23, 20});
    EXPECT_EQ(Describe(r.boxes), "1+10 1+11 1+12 1+13 2-12 2-11 2-10 ");
    EXPECT_EQ(r.columns, (std::vector<std::pair<int, int>>{{1, 0}, {2, 4}}));
    // Short of the reversal: nothing; a two-box reversal takes a smaller fall.
    EXPECT_EQ(Describe(PFRun({20, 21, 22, 23, 20.5f}).boxes), "1+10 1+11 1+12 1+13 ");
    EXPECT_EQ(Describe(PFRun({20, 21, 22, 23, 21}, 2).boxes), "1+10 1+11 1+12 1+13 2-12 2-11 ");
    // A reversal column is longer than one step, so the next reversal moves right again; a
    // fall of less than the reversal leaves the rising column to carry on.
    EXPECT_EQ(Describe(PFRun({20, 21, 22, 23, 20, 23}).boxes),
              "1+10 1+11 1+12 1+13 2-12 2-11 2-10 3+11 3+12 3+13 ");
    EXPECT_EQ(Describe(PFRun({20, 21, 22, 23, 22, 25}).boxes), "1+10 1+11 1+12 1+13 1+14 1+15 ");
}

TEST(PointFigureColumns, CountingPassAndSettings) {
    EXPECT_EQ(CountColumns({20, 21, 22, 23, 20, 23, 0}, 10, 1, 3), (std::vector<int>{0, 4, 5}));
    EXPECT_EQ(PFReversal(3), 3);
    EXPECT_EQ(PFReversal(7), 2);
    EXPECT_EQ(PFReversal(1), 2);
    EXPECT_FLOAT_EQ(AutoBoxValue(10, 92, 137), 0.599f);
    EXPECT_EQ(PFLabel(0.05f, 4), ".05");
    EXPECT_EQ(PFLabel(21, 4), "21.00");
    EXPECT_EQ(PFLabel(21, 5), "21");
}

namespace {

void PointFigureRig(ChartRig& r) {
    r.request.ChartStyle = 'P';
    r.request.BarSpacing = 3;
}

} // namespace

TEST(PointFigureChart, OneCloseGivesOneBoxAndTheLabels) {
    ChartRig r;
    PointFigureRig(r);
    r.dialogs.QueueInput(std::string("1"));
    r.Add("20240301", 50, 51, 49, 50);
    ASSERT_TRUE(r.Build().ok());
    // Manual scale: the box dialog asked, with the automatic value as the proposal.
    ASSERT_EQ(r.dialogs.shown().size(), 1u);
    EXPECT_EQ(r.dialogs.shown()[0].title, "Point and Figure");
    const auto lines = r.Lines();
    // Row 40 of a box of 1 over base 10: y 950 - 240 = 710, first column at x 5 + 6.
    EXPECT_EQ(Starting(lines, "B, 9,"), (std::vector<std::string>{"B, 9, 708, 13, 712, 18"}));
    EXPECT_TRUE(Starting(lines, "X,").empty());
    // Rows 137, 11 a label step: 13 ticks from 950 up by 66, labels 10.00, 21.00, ...
    EXPECT_EQ(Starting(lines, "L, 354, ").size(), 13u);
    EXPECT_TRUE(HasRun(lines, {"L, 354, 884, 359, 884, 16"}));
    const auto labels = Starting(lines, "T, 8, ");
    EXPECT_TRUE(std::any_of(labels.begin(), labels.end(),
                            [](const std::string& l) { return l.ends_with(",142.00, 27"); }));
    EXPECT_TRUE(HasRun(lines, {"T, 8.25, 300, 114,Box Value = 1, 16"}));
    EXPECT_EQ(r.chart.ChartCeiling, 1); // the ceiling carries the box value
    // The tools read whole boxes: 40 boxes over the base stand at 710, and a y reads the box
    // it lies in, counted up from the bottom.
    EXPECT_EQ(r.chart.PriceToY(50), 710);
    EXPECT_EQ(r.chart.PriceToY(50.4), 710);
    EXPECT_DOUBLE_EQ(r.chart.YToPrice(707), 50);
    EXPECT_DOUBLE_EQ(r.chart.YToPrice(711), 49);
}

TEST(PointFigureChart, BoxDialogAnswers) {
    {
        // Text is refused with a message and asked again; 0 takes the least box value.
        ChartRig r;
        PointFigureRig(r);
        r.dialogs.QueueInput(std::string("abc"));
        r.dialogs.QueueInput(std::string("0"));
        r.Add("20240301", 50, 51, 49, 50);
        ASSERT_TRUE(r.Build().ok());
        EXPECT_EQ(r.dialogs.messages(),
                  (std::vector<std::string>{"The box value must be a number."}));
        EXPECT_FLOAT_EQ(r.chart.ChartCeiling, 0.003f);
    }
    {
        // Blank ticks automatic; cancel keeps it too.
        for (std::optional<std::string> answer :
             {std::optional<std::string>(""), std::optional<std::string>()}) {
            ChartRig r;
            PointFigureRig(r);
            r.dialogs.QueueInput(answer);
            r.Add("20240301", 50, 51, 49, 50);
            ASSERT_TRUE(r.Build().ok());
            EXPECT_FLOAT_EQ(r.chart.ChartCeiling, 0.599f);
        }
    }
    {
        // Automatic scale: the security's own box value, no dialog.
        ChartRig r;
        PointFigureRig(r);
        r.defaults.AutoScale = true;
        r.name.PFIncrement = 0.5f;
        r.Add("20240301", 50, 51, 49, 50);
        r.Add("20240302", 50, 51, 49, 51);
        ASSERT_TRUE(r.Build().ok());
        EXPECT_TRUE(r.dialogs.shown().empty());
        EXPECT_FLOAT_EQ(r.chart.ChartCeiling, 0.5f);
    }
}

TEST(PointFigureChart, FallingBoxesAndGridQuirkOnPaper) {
    ChartRig r;
    PointFigureRig(r);
    r.defaults.ShowPriceGrid = true;
    r.dialogs.QueueInput(std::string("1"));
    r.Add("20240301", 50, 51, 49, 50);
    r.Add("20240302", 50, 51, 47, 48);
    ASSERT_TRUE(r.Build().ok());
    const auto lines = r.Lines();
    // Two falling boxes in the same column: outlines on the screen, "X" on paper.
    EXPECT_EQ(Starting(lines, "X,"),
              (std::vector<std::string>{"X, 9, 714, 13, 718, 28", "X, 9, 720, 13, 724, 28"}));
    EXPECT_TRUE(HasRun(r.Calls(), {"Box 9,714,13,718 #28"}));
    // Grid lines stand at their y on the screen but at y 0 in the stream.
    const auto grid = Starting(lines, "V,");
    ASSERT_EQ(grid.size(), 12u);
    EXPECT_EQ(grid[0], "V, 5, 0, 354, 0, 35");
}

TEST(PointFigureChart, NothingToDrawIsNoCrash) {
    ChartRig r;
    PointFigureRig(r);
    r.dialogs.QueueInput(std::string("1"));
    r.Add("20240301", 0, 0, 0, 0);
    r.Add("20240302", 0, 0, 0, 0);
    ASSERT_TRUE(r.Build().ok());
    EXPECT_TRUE(Starting(r.Lines(), "B, 9,").empty());
    ChartRig a;
    PointFigureRig(a);
    a.defaults.AutoScale = true;
    a.Add("20240301", 0, 0, 0, 0);
    // The automatic scale of no prices still has two ends: labels, no boxes.
    ASSERT_TRUE(a.Build().ok());
    EXPECT_TRUE(Starting(a.Lines(), "B, 9,").empty());
    EXPECT_EQ(Starting(a.Lines(), "L, 354, ").size(), 13u);
}

TEST(PointFigureChart, ColumnsReachingTheRightEdgeWipeAndStartAgain) {
    ChartRig r;
    PointFigureRig(r);
    // A negative blank lets more columns "fit" than the plot holds, so the drawing reaches
    // the right edge: the plot is wiped, framed and labelled again, and columns go on from
    // the left.
    r.defaults.BlankRight = -120;
    r.dialogs.QueueInput(std::string("1"));
    for (int i = 0; i < 80; ++i)
        r.Add("2024" + std::string(i / 28 + 1 < 10 ? "0" : "") + std::to_string(i / 28 + 1) +
                  (i % 28 + 1 < 10 ? "0" : "") + std::to_string(i % 28 + 1),
              20, 25, 19, i % 2 ? 24.0f : 20.0f);
    ASSERT_TRUE(r.Build().ok());
    const auto lines = r.Lines();
    const auto wipe = std::find(lines.begin(), lines.end(), "F, 5, 130, 354, 950, 17");
    ASSERT_NE(wipe, lines.end());
    EXPECT_EQ(*(wipe + 1), "B, 5, 130, 354, 950, 16");
    // After the wipe the next column stands at the first column's x again.
    const auto boxes = Starting(std::vector<std::string>(wipe, lines.end()), "B, 9,");
    const auto falls = Starting(std::vector<std::string>(wipe, lines.end()), "X, 9,");
    EXPECT_FALSE(boxes.empty() && falls.empty());
    // Nothing was drawn beyond the edge.
    for (const auto& l : Starting(lines, "X,"))
        EXPECT_LT(std::stoi(l.substr(3)), 354 - 8) << l;
}

// Every loop that steps by a box is bounded: a box below the float's precision at the price
// ends the move, a not-a-number close is skipped like a zero close.
TEST(PointFigureColumns, StepsThatCannotMoveEndTheMove) {
    PFColumns pf(0, 0.005f, 3);
    int boxes = 0;
    pf.onBox = [&boxes](const PFBox&) { ++boxes; };
    pf.Close(1e7f, 0);
    pf.Close(1e7f + 1.0f, 1); // 0.005 does not change a float of 1e7
    pf.Close(std::numeric_limits<float>::quiet_NaN(), 2);
    EXPECT_EQ(boxes, 1);
    EXPECT_FLOAT_EQ(pf.LastBox(), 1e7f);
    // A move longer than a chart has rows stops at that many boxes.
    PFColumns tall(0, 1, 3);
    boxes = 0;
    tall.onBox = [&boxes](const PFBox&) { ++boxes; };
    tall.Close(1, 0);
    tall.Close(1e6f, 1);
    EXPECT_EQ(boxes, 1 + pf::MaxRows + 1);
}

TEST(PointFigureColumns, RangeProblems) {
    EXPECT_FALSE(PFRangeProblem({1.5f, 2.5f, 0, 3}, 0.01f));
    EXPECT_FALSE(PFRangeProblem({0, std::numeric_limits<float>::quiet_NaN()}, 0.01f));
    EXPECT_EQ(PFRangeProblem({1.86f, 1e7f}, 0.053f), 1e7f); // too many rows
    EXPECT_EQ(PFRangeProblem({1e7f, 1e7f + 1}, 100.0f), std::nullopt);
    EXPECT_EQ(PFRangeProblem({1e7f, 1e7f + 2}, 0.5f), 1e7f + 2); // below the precision
    EXPECT_EQ(PFRangeProblem({-4, 4}, 0), 4.0f);
}

// One huge close among small prices used to step box by box for ever: now the chart is
// refused at once with a message naming the box value and the price.
TEST(PointFigureChart, BoxesTooSmallForThePricesAreRefused) {
    ChartRig r;
    PointFigureRig(r);
    r.dialogs.QueueInput(std::string("0.05"));
    r.Add("20240301", 2, 2, 2, 2);
    r.Add("20240302", 2, 2, 2, 1e7f);
    r.Add("20240303", 2, 2, 2, 2.1f);
    EXPECT_FALSE(r.Build().ok());
    EXPECT_TRUE(r.chart.Failed);
    ASSERT_EQ(r.dialogs.messages().size(), 1u);
    EXPECT_EQ(r.dialogs.messages()[0],
              "Box value 0.05 is too small for prices up to 1e+07: BHP cannot be drawn as "
              "point and figure.");
    EXPECT_TRUE(Starting(r.Lines(), "B, 9,").empty());
}

// A box value typed too small for the range gives way to the automatic one, with a message.
TEST(PointFigureChart, TooSmallATypedBoxTakesTheAutomaticValue) {
    ChartRig r;
    PointFigureRig(r);
    r.dialogs.QueueInput(std::string("0.001"));
    r.Add("20240301", 50, 51, 49, 50);
    r.Add("20240302", 50, 601, 49, 600);
    ASSERT_TRUE(r.Build().ok());
    ASSERT_EQ(r.dialogs.messages().size(), 1u);
    EXPECT_NE(r.dialogs.messages()[0].find("Box value 0.003 is too small for prices up to 600"),
              std::string::npos);
    EXPECT_GT(r.chart.ChartCeiling, 0.003f);
}
