#include "platform/files.h"
#include "scan/chart_scans.h"
#include "scan_rig.h"
#include "store/chart_list.h"

#include <gtest/gtest.h>

using namespace kori::scan;
using kori::test::RecordingProgress;
using kori::test::RigSecurity;
using kori::test::TempRoot;
using kori::test::WriteRig;

namespace {

template <class Result> std::vector<std::string> CodesOf(const Result& r) {
    std::vector<std::string> out;
    for (const auto& row : r.Rows)
        out.push_back(row.Code);
    return out;
}

std::vector<float> Repeat(float v, int n) {
    return std::vector<float>(static_cast<std::size_t>(n), v);
}

} // namespace

TEST(ChtScan2, VolumeOverTheMeanOfTheLastDaysIncludingTheLast) {
    TempRoot root;
    // Ten days: nine of 100 and a last of V. The mean counts V: 2100 is exactly 600% over it.
    auto vols = [](std::int32_t last) {
        std::vector<std::int32_t> v(9, 100);
        v.push_back(last);
        return v;
    };
    RigSecurity exact{"EXACT", Repeat(1, 10)};
    exact.Volumes = vols(2100);
    RigSecurity more{"MORE", Repeat(1, 10)};
    more.Volumes = vols(2200); // mean 310, needs 2170: 30 over
    RigSecurity less{"LESS", Repeat(1, 10)};
    less.Volumes = vols(2099);
    WriteRig(root, {exact, more, less});
    Scan2Options o;
    o.Volume = true;
    o.VolumePercent = "600";
    o.VolumeDays = "10";
    o.ReportFolder = root.folder();
    RecordingProgress progress;
    const auto r = RunScan2(root.folder(), o, progress);
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"EXACT", "MORE"}));
    EXPECT_EQ(r.Rows[0].VolUp, 0);
    EXPECT_EQ(r.Rows[1].VolUp, 30);
    EXPECT_EQ(r.Selection, "B");
    EXPECT_EQ(r.Message->Text, "The codes have been stored in Chart Scan Results list\n"
                               " This list can be selected for viewing\n from the\n"
                               " Chart Selection Window.");
    EXPECT_EQ(r.Message->Title, " Chart Scan 2");
    const std::string report = root.Read("ChtScan2.txt");
    EXPECT_EQ(report, Scan2Line(r.Rows[0]) + "\r\n" + Scan2Line(r.Rows[1]) + "\r\n");
    // Days of 0: the volume test cannot pass.
    o.VolumeDays = "0";
    EXPECT_EQ(RunScan2(root.folder(), o, progress).Message->Text, kNoRecordsFound);
}

TEST(ChtScan2, EveryTickedLetterMustPass) {
    TempRoot root;
    WriteRig(root, {{"CHEAP", {0.50f, 0.60f}}, {"DEAR", {5.00f, 6.00f}}, {"SLOW", {0.50f, 0.51f}}});
    Scan2Options o;
    o.Frame.Range = {true, "0.005", "1.00"};
    o.Price = true;
    o.PricePercent = "10";
    RecordingProgress progress;
    auto r = RunScan2(root.folder(), o, progress);
    EXPECT_EQ(r.Selection, "AC");
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"CHEAP"}));
    EXPECT_NEAR(*r.Rows[0].Change, 20.0, 1e-4);
    o.Price = false;
    r = RunScan2(root.folder(), o, progress);
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"CHEAP", "SLOW"}));
}

TEST(ChtScan2, Validation) {
    Scan2Options o;
    auto m = ValidateScan2(o);
    EXPECT_EQ(m->Text, "No selection made");
    EXPECT_EQ(m->Title, "Selection criteria");
    o.Frame.Range = {true, "x", "1"};
    EXPECT_EQ(ValidateScan2(o)->Text, "Price values invalid");
    EXPECT_EQ(ValidateScan2(o)->Title, "Closing Price Range");
    o.Frame.Range.Min = "0";
    o.Volume = true;
    o.VolumeDays = "ten";
    EXPECT_EQ(ValidateScan2(o)->Text, "Volume percentage increases invalid");
    o.VolumeDays = "10";
    o.Price = true;
    o.PricePercent = "";
    EXPECT_EQ(ValidateScan2(o)->Title, "Price Percentage Increases/decreases");
    o.PricePercent = "5";
    o.Frame.ClassOn = true;
    o.Frame.Class = "1";
    EXPECT_EQ(ValidateScan2(o)->Text, "Industry Class invalid");
    o.Frame.Class = "100";
    EXPECT_FALSE(ValidateScan2(o));
}

TEST(ChtScan3, TheLastThreeDirectionsDecide) {
    EXPECT_EQ(BreakOf("UUU", true, true), "");
    EXPECT_EQ(BreakOf("DUU", true, false), "UP");
    EXPECT_EQ(BreakOf("DUU", false, true), "");
    EXPECT_EQ(BreakOf("UDD", false, true), "DOWN");
    EXPECT_EQ(BreakOf("UUD", true, true), "DOWN");
    EXPECT_EQ(BreakOf("DDD", true, true), "");
}

TEST(ChtScan3, BreaksOfTheParabolicFromTheRecords) {
    // Thirty rising days set the stop under the prices; a last day far below the stop turns it
    // down on the last record only. The mirror image turns it up.
    std::vector<float> rise, fall;
    for (int i = 0; i < 30; ++i) {
        rise.push_back(1.0f + 0.1f * static_cast<float>(i));
        fall.push_back(4.0f - 0.1f * static_cast<float>(i));
    }
    rise.push_back(0.5f);
    fall.push_back(8.0f);
    RigSecurity up{"RISE", rise}, down{"FALL", fall}, steady{"STEADY", {}};
    steady.Closes.assign(rise.begin(), rise.end() - 1);
    TempRoot root;
    WriteRig(root, {up, down, steady});
    auto dirs = [&](const char* code) {
        return LastParabolicDirections(root.Read(std::string(code) + ".WDT"));
    };
    EXPECT_EQ(dirs("RISE"), "UUD");
    EXPECT_EQ(dirs("FALL"), "DDU");
    EXPECT_EQ(dirs("STEADY"), "UUU");
    Scan3Options o;
    o.Up = o.Down = true;
    RecordingProgress progress;
    auto r = RunScan3(root.folder(), o, progress);
    ASSERT_EQ(CodesOf(r), (std::vector<std::string>{"RISE", "FALL"}));
    EXPECT_EQ(r.Rows[0].Direction, "DOWN");
    EXPECT_EQ(r.Rows[1].Direction, "UP");
    EXPECT_EQ(r.Message->Title, " Chart Scan 3");
    EXPECT_EQ(r.Message->Text, "The codes have been stored in Chart Scan list Z\n"
                               " The list can be selected for viewing\n from the\n"
                               " Chart Selection Window.");
    o.Down = false;
    r = RunScan3(root.folder(), o, progress);
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"FALL"}));
}

TEST(ChtScan3, Validation) {
    Scan3Options o;
    auto m = ValidateScan3(o);
    EXPECT_EQ(m->Text, "Either Look for break UP  or Look for break DOWN need to be selected");
    EXPECT_EQ(m->Title, "Break Parabolic");
    o.Up = true;
    o.CategoryOn = true;
    o.Category = "abc";
    EXPECT_EQ(ValidateScan3(o)->Text, "Invalid Category");
    EXPECT_EQ(ValidateScan3(o)->Title, "Category Selected");
    o.Category = "84";
    EXPECT_FALSE(ValidateScan3(o));
}

TEST(ChtScan6, GapOfHalfAPerCentListedJustOverNot) {
    // Averages of 2 and 4: long mean 100.5 over a short mean of 100 is a gap of 0.5.
    TempRoot root;
    WriteRig(root, {{"HALF", {101, 101, 100, 100}},
                    {"OVER", {101.02f, 101.02f, 100, 100}},
                    {"SHORT", {100, 100, 100}},
                    {"FIVE", {100, 100, 100, 100}},
                    {"ABOVE", {100, 100, 101, 101}}});
    Scan6Options o;
    o.Av1D = 4;
    o.Av2D = 2;
    o.ReportFolder = root.folder();
    RecordingProgress progress;
    auto r = RunScan6(root.folder(), o, progress);
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"HALF", "FIVE", "ABOVE"}));
    EXPECT_DOUBLE_EQ(r.Rows[0].Gap, 0.5);
    EXPECT_DOUBLE_EQ(r.Rows[1].Gap, 0);
    // The short mean above the long: (101 - 100.5) / 100.5, to four places.
    EXPECT_DOUBLE_EQ(r.Rows[2].Gap, 0.4975);
    EXPECT_EQ(root.Read("ChtScan6.txt"), "HALF\t100.00\t0.5\tName of HALF\t121\r\n"
                                         "FIVE\t100.00\t0.0\tName of FIVE\t121\r\n"
                                         "ABOVE\t101.00\t0.5\tName of ABOVE\t121\r\n");
    EXPECT_EQ(r.Message->Title, " Chart Scan 2");
    o.CodeLength = "4";
    r = RunScan6(root.folder(), o, progress);
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"HALF", "FIVE"}));
}

TEST(ChtScan6, StopsAfterRecordFourHundred) {
    TempRoot root;
    std::vector<RigSecurity> list;
    for (int i = 1; i <= 401; ++i) {
        RigSecurity s{"C" + std::to_string(i), {}};
        s.Type = 1; // not taken: only type 4 goes on
        list.push_back(s);
    }
    list[399].Type = 4; // record 400
    list[399].Closes = {100, 100, 100, 100};
    list[400].Type = 4; // record 401
    list[400].Closes = {100, 100, 100, 100};
    WriteRig(root, list);
    Scan6Options o;
    o.Av1D = 2;
    o.Av2D = 4;
    RecordingProgress progress;
    const auto r = RunScan6(root.folder(), o, progress);
    EXPECT_EQ(CodesOf(r), (std::vector<std::string>{"C400"}));
    EXPECT_EQ(progress.range, 401); // the bar is set to the true count
    EXPECT_EQ(progress.last, 400);
}

TEST(ChtScan6, AveragesMustBeSetAndDiffer) {
    Scan6Options o;
    o.Av1D = 10;
    o.Av2D = 10;
    auto m = ValidateScan6(o);
    ASSERT_TRUE(m);
    EXPECT_EQ(m->Text, "Averages not set - Set averages in Chart Defaults  and re-try");
    EXPECT_EQ(m->Title, "Average Crossover Scan");
    o.Av2D = 0;
    EXPECT_TRUE(ValidateScan6(o));
    o.Av2D = 30;
    EXPECT_FALSE(ValidateScan6(o));
}

TEST(ChtScan6, GapRule) {
    EXPECT_DOUBLE_EQ(AverageGap(100.5, 100), 0.5);
    // Whichever is on top, the gap is taken over the smaller mean.
    EXPECT_DOUBLE_EQ(AverageGap(100, 100.5), 0.5);
    EXPECT_DOUBLE_EQ(AverageGap(100.5, 101), 0.4975);
    EXPECT_DOUBLE_EQ(AverageGap(100.51, 100), 0.51);
}
