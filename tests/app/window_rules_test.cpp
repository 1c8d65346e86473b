#include "app/window_rules.h"

#include "store/name_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::app;
using kori::test::TempRoot;
namespace chart = kori::chart;

TEST(WindowRules, LogoStandsCentredAcrossAndJustAboveTheMiddle) {
    // 1920 x 1080 screen, 420 x 220 logo: (1920-420)/2 = 750; 0.97*1080/2 - 110 = 413.8 -> 414.
    const auto p = LogoPosition(1920, 1080, 420, 220);
    EXPECT_EQ(p.left, 750);
    EXPECT_EQ(p.top, 414);
}

TEST(WindowRules, NumbersTypedInBoxes) {
    EXPECT_EQ(WholeNumber(" 12 "), 12);
    EXPECT_FALSE(WholeNumber("12.5"));
    EXPECT_FALSE(WholeNumber("12a"));
    EXPECT_FALSE(WholeNumber(""));
    EXPECT_DOUBLE_EQ(*TypedNumber("0.25"), 0.25);
    EXPECT_FALSE(TypedNumber("."));
    EXPECT_FALSE(TypedNumber("1,5"));
}

TEST(WindowRules, SmallWindowsRefuseValuesOutsideTheirBounds) {
    EXPECT_FALSE(LineWidthProblem("1"));
    EXPECT_FALSE(LineWidthProblem("10"));
    ASSERT_TRUE(LineWidthProblem("11"));
    EXPECT_TRUE(LineWidthProblem("0"));
    EXPECT_EQ(LineWidthProblem("x")->title, "Line Width");

    EXPECT_FALSE(BlankSpaceProblem("0"));
    EXPECT_TRUE(BlankSpaceProblem("-1"));
    EXPECT_FALSE(GridSpaceProblem("0")); // 0 turns the date grid off
    EXPECT_TRUE(GridSpaceProblem("101"));

    EXPECT_FALSE(StopLossProblem("0"));
    EXPECT_FALSE(StopLossProblem("12.5"));
    ASSERT_TRUE(StopLossProblem("100.01"));
    EXPECT_EQ(StopLossProblem("100.01")->text, "Invalid value - must be between 0 and 100");
    EXPECT_EQ(StopLossProblem("abc")->title, "Stop Loss");
}

TEST(WindowRules, EveryMMABoxMustBeNumeric) {
    std::array<std::string, 12> boxes;
    for (std::size_t i = 0; i < boxes.size(); ++i)
        boxes[i] = std::to_string(kori::chart::kDefaultMMAPeriods[i]);
    EXPECT_FALSE(MMAProblem(boxes));
    boxes[11] = "6o";
    ASSERT_TRUE(MMAProblem(boxes));
    EXPECT_EQ(MMAProblem(boxes)->title, "MMA Settings");
    boxes[11] = "";
    EXPECT_TRUE(MMAProblem(boxes));
}

TEST(WindowRules, StopLossPercentOfZeroMeansNoPercentStop) {
    kori::chart::ChartDefaults d;
    SetStopLoss(d, true, 0);
    EXPECT_TRUE(d.StopLossOn);
    EXPECT_FALSE(d.StopPercentOn);
    SetStopLoss(d, true, 7.5f);
    EXPECT_TRUE(d.StopPercentOn);
    EXPECT_FLOAT_EQ(d.StopPercent, 7.5f);
}

TEST(WindowRules, SwingValuesByMethod) {
    EXPECT_FALSE(SwingValueProblem(chart::SwingMethod::XDay, "1"));
    EXPECT_FALSE(SwingValueProblem(chart::SwingMethod::XDay, "30"));
    ASSERT_TRUE(SwingValueProblem(chart::SwingMethod::XDay, "31"));
    EXPECT_EQ(SwingValueProblem(chart::SwingMethod::XDay, "31")->text, "Incorrect values entered");
    EXPECT_EQ(SwingValueProblem(chart::SwingMethod::XDay, "0")->title, "Swing");
    EXPECT_FALSE(
        SwingValueProblem(chart::SwingMethod::XPoint, "250")); // points have no upper bound
    EXPECT_TRUE(SwingValueProblem(chart::SwingMethod::XPoint, "0.5"));
    EXPECT_FALSE(
        SwingValueProblem(chart::SwingMethod::Norm, "")); // the standard swing takes no value
}

TEST(WindowRules, SwingSettingsRoundTripAndDefaultByMethod) {
    TempRoot root;
    kori::platform::IniFile ini(root.path() / "Kori.ini");
    auto s = ReadSwingSettings(ini);
    EXPECT_EQ(s.SwingMethod, chart::SwingMethod::Norm);
    EXPECT_FLOAT_EQ(s.SwingValue, 9.0f);
    WriteSwingSettings(ini, {chart::SwingMethod::XDay, 5});
    s = ReadSwingSettings(ini);
    EXPECT_EQ(s.SwingMethod, chart::SwingMethod::XDay);
    EXPECT_FLOAT_EQ(s.SwingValue, 5.0f);
    (void)ini.Write("Charts", "SwingMethod", "xpoint");
    (void)ini.Write("Charts", "SwingValue", "junk");
    s = ReadSwingSettings(ini);
    EXPECT_EQ(s.SwingMethod, chart::SwingMethod::XPoint);
    EXPECT_FLOAT_EQ(s.SwingValue, 9.0f);
}

TEST(WindowRules, ScalesAreCheckedThenWrittenToTheNameRecord) {
    EXPECT_FALSE(ScalesProblem({"", "", ""})); // all automatic
    EXPECT_TRUE(ScalesProblem({"-1", "", ""}));
    EXPECT_TRUE(ScalesProblem({"2", "1.5", ""}));
    EXPECT_FALSE(ScalesProblem({"0", "1.5", "0.05"}));

    TempRoot root;
    kori::store::NameFile names(root.path() / "Names.dat");
    ASSERT_TRUE(names.Open());
    kori::store::NameRecord a, b;
    a.Code = "AAA";
    b.Code = "BBB";
    b.ScaleStep = 0;
    ASSERT_TRUE(names.Append(a));
    ASSERT_TRUE(names.Append(b));
    ASSERT_TRUE(SaveScales(root.folder(), 2, {"1.2", "3.4", "0.05"}));
    EXPECT_FALSE(SaveScales(root.folder(), 2, {"3", "1", ""}));
    kori::store::NameFile again(root.path() / "Names.dat");
    ASSERT_TRUE(again.Open());
    kori::store::NameRecord r;
    ASSERT_TRUE(again.Read(2, r));
    EXPECT_FLOAT_EQ(r.Base, 1.2f);
    EXPECT_FLOAT_EQ(r.Top, 3.4f);
    EXPECT_FLOAT_EQ(r.PFIncrement, 0.05f);
    EXPECT_FLOAT_EQ(r.ScaleStep, 0.05f);
    ASSERT_TRUE(again.Read(1, r));
    EXPECT_FLOAT_EQ(r.Base, 0.0f);                              // the other record is untouched
    EXPECT_FALSE(SaveScales(root.folder(), 3, {"1", "2", ""})); // no such record
}

TEST(WindowRules, OscillatorDialogLabelsAndTitles) {
    EXPECT_EQ(OscFieldLabel("StochK"), "Period K");
    EXPECT_EQ(OscFieldLabel("Md3"), "EMA 3 signal");
    EXPECT_EQ(OscFieldLabel("DMA"), "Period "); // with its blank, as the dialog has it
    EXPECT_EQ(OscFieldLabel("RsiP"), "RSI period");
    EXPECT_EQ(OscFieldLabel("HolyD"), "Period");
    EXPECT_EQ(OscDialogTitle("WMS"), "Williams %R");
    EXPECT_EQ(OscDialogTitle("RMO"), "RMO"); // no name in lists
}

TEST(WindowRules, AnUnsetCompareFileShowsEmpty) {
    EXPECT_EQ(CompareFileText("unknown"), "");
    EXPECT_EQ(CompareFileText(" /data/XAO.WDT "), "/data/XAO.WDT");
}

TEST(WindowRules, BoxValueAfterTheQuestion) {
    EXPECT_FLOAT_EQ(ResolveBoxValue(std::nullopt, 0.25f), 0.25f);
    EXPECT_FLOAT_EQ(ResolveBoxValue(BoxValueAnswer{true, 5}, 0.25f), 0.25f);
    EXPECT_FLOAT_EQ(ResolveBoxValue(BoxValueAnswer{false, 0.5f}, 0.25f), 0.5f);
    EXPECT_FLOAT_EQ(ResolveBoxValue(BoxValueAnswer{false, 0.001f}, 0.25f), 0.003f);
}

TEST(WindowRules, FontsNeedBothNamesAndSizesAndAreWrittenTwice) {
    FontSettings f;
    EXPECT_TRUE(FontsProblem(f)); // SFontSize reads "unknown" until chosen
    f.SFontSize = "7";
    EXPECT_FALSE(FontsProblem(f));
    f.CFont = " ";
    ASSERT_TRUE(FontsProblem(f));
    EXPECT_EQ(FontsProblem(f)->text, "Fonts and sizes must be selected for both");
    EXPECT_EQ(FontsProblem(f)->title, "Font Selection");

    TempRoot root;
    kori::platform::ScriptedDialogs dialogs;
    kori::platform::NullProgress progress;
    kori::platform::SettingsStore settings(root.path() / "settings.ini");
    kori::platform::FixedClock clock("20240305");
    Session session(root.path(), {dialogs, progress, settings, clock});
    SaveFonts(session, {"DejaVu Sans", "9", "Liberation Mono", "7"});
    EXPECT_EQ(session.ini().Read("Chart Fonts", "SFont"), "Liberation Mono");
    EXPECT_EQ(session.ini().Read("ChartFonts", "SFontSize"), "7");
    EXPECT_EQ(session.fonts.Font1, "DejaVu Sans");
    EXPECT_DOUBLE_EQ(session.fonts.Size2, 7.0);
}
