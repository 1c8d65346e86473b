#include "app/chart_selection.h"
#include "app/chart_service.h"
#include "store/name_file.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

using namespace kori;
using platform::Answer;

namespace {

struct Selection : ::testing::Test {
    test::SampleSession s;
    app::ChartState state;
    app::ChartSelection sel{s.session, state};

    void Set(const char* key, const std::string& value) {
        s.session.ini().Write("Charts", key, value);
    }
    std::string Ini(const char* key) { return s.session.ini().Read("Charts", key); }
    int Beeps() const {
        int n = 0;
        for (const auto& d : s.dialogs.shown())
            n += d.kind == "beep";
        return n;
    }
};

} // namespace

TEST_F(Selection, FirstLoadReadsTheSettingsWithTheirLimitsAndShowsRecordOne) {
    Set("Type", "B");
    Set("Spacing", "0");
    Set("Period", "Q");
    ASSERT_TRUE(sel.Load());
    const auto& f = sel.form();
    EXPECT_EQ(f.Spacing, 2);
    EXPECT_EQ(f.PeriodIndex, 0);
    EXPECT_EQ(f.ListCaption, " FULL LIST   (Names.Dat)");
    EXPECT_EQ(f.Position, 1);
    EXPECT_EQ(f.Count, 54);
    // Record 1 is an index (type 1): it cannot be a bar chart whatever Type says.
    EXPECT_EQ(f.Code, "XAO");
    EXPECT_EQ(f.StyleIndex, 2);
    EXPECT_EQ(f.FinishText, "LATEST");
    EXPECT_TRUE(state.SettingsLoaded);
    sel.ShowChart();
    EXPECT_EQ(state.Request.ChartStyle, 'L');
    EXPECT_EQ(state.Request.ListPosition, 0);
}

TEST_F(Selection, SpacingAboveTenInTheSettingsAlsoGivesTwo) {
    Set("Spacing", "11");
    ASSERT_TRUE(sel.Load());
    EXPECT_EQ(sel.form().Spacing, 2);
}

TEST_F(Selection, ALowerCaseCodeFindsTheRecordAndShowChartLeavesThePositionOneShort) {
    Set("Type", "C");
    Set("Period", "W");
    Set("Spacing", "40");
    ASSERT_TRUE(sel.Load());
    ASSERT_TRUE(sel.TypeCode("krm"));
    EXPECT_EQ(sel.form().Code, "KRM");
    EXPECT_EQ(sel.form().Position, 4);
    EXPECT_EQ(state.Request.ChartPeriod, 'A'); // typing a code goes back to daily
    EXPECT_EQ(sel.form().StyleIndex, 1);       // KRM is type 4: the request's style stands
    sel.ShowChart();
    EXPECT_EQ(state.Request.ListPosition, 3);
    EXPECT_EQ(Ini("Type"), "C");
    EXPECT_EQ(Ini("Period"), "A");
    EXPECT_EQ(Ini("Spacing"), "2"); // 40 read as 2; only typing enforces the candle minimum
}

TEST_F(Selection, AnUnknownCodeAsksAndTheNearestIsTheFirstInFileOrderNotBelowIt) {
    ASSERT_TRUE(sel.Load());
    ASSERT_TRUE(sel.TypeCode("krm"));
    s.dialogs.clear();
    s.dialogs.QueueAnswer(Answer::No);
    EXPECT_FALSE(sel.TypeCode("zzq"));
    ASSERT_EQ(s.dialogs.messages().size(), 1u);
    EXPECT_EQ(s.dialogs.messages()[0], "No record on file for that code - Find nearest code ?");
    EXPECT_EQ(s.dialogs.shown()[0].title, "Chart Selection");
    EXPECT_EQ(sel.form().Code, "KRM"); // "No" leaves the record in hand

    // "HB" pads to "HB    ": the file walk meets XAO first, and "XAO" is not below "HB ".
    s.dialogs.QueueAnswer(Answer::Yes);
    EXPECT_FALSE(sel.TypeCode("hb"));
    EXPECT_EQ(sel.form().Position, 1);
    // Nothing is at or above "ZZQ": the record in hand stays.
    s.dialogs.QueueAnswer(Answer::Yes);
    EXPECT_FALSE(sel.TypeCode("zzq"));
    EXPECT_EQ(sel.form().Position, 1);
    EXPECT_FALSE(sel.TypeCode("   ")); // an empty field does nothing
}

TEST_F(Selection, ScrollBarAndSpacingWrap) {
    ASSERT_TRUE(sel.Load());
    sel.ScrollTo(10);
    EXPECT_EQ(sel.form().Position, 10);
    EXPECT_EQ(Beeps(), 0);
    sel.ScrollTo(55);
    EXPECT_EQ(sel.form().Position, 1);
    EXPECT_EQ(Beeps(), 1);

    sel.TypeSpacingValue(10);
    sel.StepSpacing(1);
    EXPECT_EQ(sel.form().Spacing, 1);
    sel.StepSpacing(-1);
    EXPECT_EQ(sel.form().Spacing, 10);
    sel.TypeSpacingValue(0);
    EXPECT_EQ(sel.form().Spacing, 2);
    sel.TypeSpacingValue(25);
    EXPECT_EQ(sel.form().Spacing, 20);

    sel.ScrollTo(4); // a type 4 security can be drawn as candlesticks
    sel.ChooseStyle(1);
    EXPECT_EQ(sel.form().Spacing, 20);
    sel.TypeSpacingValue(1);
    EXPECT_EQ(sel.form().Spacing, 3);
    sel.StepSpacing(-1);
    EXPECT_EQ(sel.form().Spacing, 3);
    EXPECT_EQ(Beeps(), 2);
}

TEST_F(Selection, PointAndFigureForcesDailyDropsTheOscillatorAndTheFinishDate) {
    ASSERT_TRUE(sel.Load());
    sel.ScrollTo(4);
    sel.ChoosePeriod(1);
    sel.ChooseOscillator(14); // RSI
    EXPECT_TRUE(state.Request.AutoOsc);
    EXPECT_EQ(state.Request.AutoOscCode, "RSI");
    ASSERT_TRUE(sel.FinishDateClicked());
    ASSERT_TRUE(sel.SetFinishDate("9/4/95"));
    EXPECT_EQ(sel.form().FinishText, "9/4/95");
    sel.ChooseStyle(3);
    const auto& f = sel.form();
    EXPECT_EQ(f.SpacingCaption, "Point Reversal");
    EXPECT_EQ(f.PeriodIndex, 0);
    EXPECT_FALSE(f.ChoosersEnabled);
    EXPECT_FALSE(state.Request.AutoOsc);
    EXPECT_EQ(f.FinishText, "LATEST");
    EXPECT_FALSE(state.Request.ByFinishDate);
    EXPECT_FALSE(sel.FinishDateClicked()); // no finish date on point and figure
    sel.ChoosePeriod(2);
    EXPECT_EQ(state.Request.ChartPeriod, 'A');
    sel.ChooseStyle(0);
    EXPECT_TRUE(sel.form().ChoosersEnabled);
    EXPECT_EQ(sel.form().SpacingCaption, "Chart Spacing");
}

TEST_F(Selection, FinishDatesAreDayMonthYear) {
    EXPECT_EQ(app::ParseFinishDate("9/4/95"), "19950409");
    EXPECT_EQ(app::ParseFinishDate("29/9/95"), "19950929");
    EXPECT_EQ(app::ParseFinishDate("1/1/29"), "20290101");
    EXPECT_EQ(app::ParseFinishDate("1/1/30"), "19300101");
    EXPECT_EQ(app::ParseFinishDate("29/2/2024"), "20240229");
    EXPECT_FALSE(app::ParseFinishDate("29/2/23"));
    EXPECT_FALSE(app::ParseFinishDate("31/4/95"));
    EXPECT_FALSE(app::ParseFinishDate("4-9-95"));
    EXPECT_FALSE(app::ParseFinishDate("9/4/995"));
    EXPECT_FALSE(app::ParseFinishDate("LATEST"));

    ASSERT_TRUE(sel.Load());
    sel.ScrollTo(4);
    EXPECT_FALSE(sel.SetFinishDate("31/2/95"));
    EXPECT_EQ(s.dialogs.messages().back(), "Date must be entered as d/m/yy eg. 9/4/95 or 29/9/95");
    EXPECT_EQ(s.dialogs.shown().back().title, "Date");
    ASSERT_TRUE(sel.SetFinishDate("3/11/26"));
    EXPECT_TRUE(state.Request.ByFinishDate);
    EXPECT_EQ(state.Request.FinishDate, "20261103");
    // A click on a set date goes back to the latest; cancelling the window does the same.
    EXPECT_FALSE(sel.FinishDateClicked());
    EXPECT_EQ(sel.form().FinishText, "LATEST");
    EXPECT_FALSE(state.Request.ByFinishDate);
    ASSERT_TRUE(sel.SetFinishDate(std::nullopt));
    EXPECT_EQ(sel.form().FinishText, "LATEST");
}

TEST_F(Selection, BandValuesAreCheckedAndWrittenToTheNameRecord) {
    ASSERT_TRUE(sel.Load());
    ASSERT_TRUE(sel.TypeCode("ALX"));
    EXPECT_FALSE(sel.ChooseBands(1, std::pair{101, 5}));
    EXPECT_EQ(s.dialogs.messages().back(), "Values must be between 0 - 100");
    EXPECT_EQ(s.dialogs.shown().back().title, "Bands");
    EXPECT_EQ(sel.form().BandIndex, 0);
    ASSERT_TRUE(sel.ChooseBands(1, std::pair{7, 9}));
    EXPECT_EQ(state.Request.ChartBands, 1);
    kori::platform::Status why;
    const auto found = kori::store::FindCode(s.session.folders.DataFolder, "ALX", why);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->Record.PercentBandUp, 7);
    EXPECT_EQ(found->Record.PercentBandDown, 9);
}

TEST_F(Selection, ChartListsAndTheEmptyListFallback) {
    ASSERT_TRUE(sel.Load());
    sel.ChangeList(2, "Banks and Finance");
    EXPECT_TRUE(state.ListChanged);
    sel.Activate();
    EXPECT_FALSE(state.ListChanged);
    EXPECT_EQ(sel.form().ListCaption, " Banks and Finance");
    EXPECT_EQ(sel.form().Count, 5);
    EXPECT_EQ(sel.form().Code, "HBK");

    // List K has no file: the message, and back to the full list.
    sel.ChangeList(11, "Chart List K");
    sel.Activate();
    EXPECT_EQ(state.Request.ListMode, 1);
    EXPECT_EQ(sel.form().ListCaption, " FULL LIST   (Names.Dat)");
    EXPECT_EQ(sel.form().Count, 54);
    EXPECT_FALSE(s.dialogs.messages().empty());
}

TEST_F(Selection, CloseWritesOnlyValidValues) {
    Set("Spacing", "4");
    ASSERT_TRUE(sel.Load());
    sel.TypeSpacingValue(15);
    sel.Close();
    EXPECT_EQ(Ini("Spacing"), "4");
    EXPECT_EQ(Ini("Bands"), "unknown");
    EXPECT_EQ(Ini("AutoOsc"), "False");
    sel.TypeSpacingValue(6);
    sel.Close();
    EXPECT_EQ(Ini("Spacing"), "6");
}

TEST(SearchByName, FindsCodeOrNameFromThePositionOn) {
    std::vector<store::NameRecord> names(4);
    names[0].Code = "AAA   ";
    names[0].Name = "Harbour Mining";
    names[1].Code = "HBR   ";
    names[1].Name = "Other";
    names[2].Code = "CCC   ";
    names[2].Name = "Nothing";
    names[3].Code = "DDD   ";
    names[3].Name = "Old harbour Trust";
    EXPECT_EQ(app::FindNextMatch(names, 0, "harb"), 1);
    EXPECT_EQ(app::FindNextMatch(names, 1, "harb"), 4);
    EXPECT_EQ(app::FindNextMatch(names, 1, "hbr"), 2);
    EXPECT_EQ(app::FindNextMatch(names, 4, "harb"), 0);
    EXPECT_EQ(app::FindNextMatch(names, 0, " "), 0);
}

TEST_F(Selection, ClassWalksStepThroughOneClassOrGroupOfTheFullList) {
    ASSERT_TRUE(sel.Load());
    sel.SetClassWalk(false, true);
    ASSERT_TRUE(sel.SetClassCode(false, "121"));
    EXPECT_EQ(sel.form().Code, "KRM");
    EXPECT_EQ(state.Request.ChartStyle, 'B'); // a class walk shows stocks as bars
    ASSERT_TRUE(sel.FindNextClass());
    EXPECT_EQ(sel.form().Code, "ALX");
    ASSERT_TRUE(sel.FindNextClass());
    EXPECT_EQ(sel.form().Code, "CPR"); // BWG is 122
    // The scroll bar walks the class too: from position 5 the next of the class is CPR.
    sel.ScrollTo(6);
    EXPECT_EQ(sel.form().Code, "CPR");

    // "120" is the group 12x.
    ASSERT_TRUE(sel.SetClassCode(false, "120"));
    std::vector<std::string> group = {sel.form().Code};
    for (int i = 0; i < 4 && sel.FindNextClass(); ++i)
        group.push_back(sel.form().Code);
    EXPECT_EQ(group, (std::vector<std::string>{"KRM", "ALX", "BWG", "CPR", "DLT"}));

    s.dialogs.clear();
    EXPECT_FALSE(sel.SetClassCode(false, "999"));
    EXPECT_EQ(s.dialogs.messages().back(), "Industry Classification invalid");
    EXPECT_EQ(s.dialogs.shown().back().title, "Analysis");
    EXPECT_FALSE(state.ClassWalk);

    EXPECT_FALSE(sel.SetClassCode(true, ""));
    EXPECT_EQ(s.dialogs.messages().back(), "GICS Classification invalid");
    EXPECT_EQ(s.dialogs.shown().back().title, "Chart Select");
    ASSERT_TRUE(sel.SetClassCode(true, "1010"));
    EXPECT_EQ(sel.form().Code, "EMB");
    EXPECT_TRUE(state.GicsWalk);
    EXPECT_FALSE(state.ClassWalk);

    // Choosing a list drops the walks.
    sel.ChangeList(2, "Banks and Finance");
    sel.Activate();
    EXPECT_FALSE(state.GicsWalk);
}

TEST_F(Selection, TheChartWindowsClassStepWrapsBothWays) {
    ASSERT_TRUE(sel.Load());
    auto& r = state.Request;
    r.ListPosition = 4; // KRM, class 121
    const auto back = app::StepClassChart(sel.walk(), r, -1, "121", false, s.dialogs);
    ASSERT_TRUE(back);
    EXPECT_EQ(back->IndustryClass, "121");
    EXPECT_GT(r.ListPosition, 4); // before the first of the class comes the last
    const auto again = app::StepClassChart(sel.walk(), r, 1, "121", false, s.dialogs);
    ASSERT_TRUE(again);
    EXPECT_EQ(again->TrimmedCode(), "KRM");
    EXPECT_FALSE(app::StepClassChart(sel.walk(), r, 1, "998", false, s.dialogs));
    EXPECT_EQ(s.dialogs.messages().back(),
              "No records on file for that Industry classification or group");
}

TEST_F(Selection, BackFromTheChartWindowTheChoosersFollowTheStyleItLeft) {
    ASSERT_TRUE(sel.Load());
    sel.ChooseStyle(3); // point and figure
    EXPECT_FALSE(sel.form().ChoosersEnabled);
    sel.ShowChart();
    // "Bar" in the chart window's toolbar, then back to the selection.
    state.Request.ChartStyle = 'B';
    state.Request.AutoOsc = true;
    state.Request.AutoOscCode = "RSI";
    sel.Activate();
    EXPECT_EQ(sel.form().StyleIndex, 0);
    EXPECT_TRUE(sel.form().ChoosersEnabled);
    EXPECT_EQ(sel.form().OscIndex, app::OscChoiceOf(state.Request));
    // And the other way: a chart left as point and figure disables them again.
    state.Request.ChartStyle = 'P';
    sel.Activate();
    EXPECT_FALSE(sel.form().ChoosersEnabled);
}

TEST_F(Selection, TheBandValuesAreAskedAboutTheCodeTypedNotTheOneShown) {
    ASSERT_TRUE(sel.Load());
    const std::string shown = sel.form().Code;
    ASSERT_NE(shown, "KRM");
    EXPECT_TRUE(sel.TakeTypedCode(shown)) << "the code shown needs nothing";
    EXPECT_EQ(sel.form().Code, shown);
    EXPECT_TRUE(sel.TakeTypedCode(" krm "));
    ASSERT_TRUE(sel.Current());
    EXPECT_EQ(sel.Current()->TrimmedCode(), "KRM");
    ASSERT_TRUE(sel.ChooseBands(1, std::pair{4, 6}));
    platform::Status why;
    EXPECT_EQ(store::FindCode(s.session.folders.DataFolder, "KRM", why)->Record.PercentBandUp, 4);
}
