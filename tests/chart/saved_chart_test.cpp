#include "chart/saved_chart.h"
#include "chart/screen_player.h"
#include "platform/files.h"
#include "player_rig.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::chart {
namespace {

using Strings = std::vector<std::string>;

constexpr std::string_view kStream = "H,1,2,3,4,255\r\nT,8.25,5,6,Two  blanks,0\r\n";

struct SaveRig {
    test::TempRoot root;
    platform::ScriptedDialogs dialogs;
    std::filesystem::path stream = root.Write("TCht.Tmp", kStream);
    std::string Target(std::string_view name) const { return root.folder() + std::string(name); }
};

TEST(SavedChart, NameChecks) {
    SaveRig rig;
    EXPECT_EQ(SaveChartAs("CANCEL", rig.stream, rig.dialogs), SaveChartResult::Cancelled);
    EXPECT_EQ(SaveChartAs("NOGOOD", rig.stream, rig.dialogs), SaveChartResult::Refused);
    EXPECT_EQ(SaveChartAs(rig.Target("bhp.txt"), rig.stream, rig.dialogs),
              SaveChartResult::Refused);
    EXPECT_EQ(SaveChartAs("cht", rig.stream, rig.dialogs), SaveChartResult::Refused);
    EXPECT_EQ(rig.dialogs.messages(), (Strings{"File name invalid", "File extension must be .cht",
                                               "File extension must be .cht"}));
    EXPECT_EQ(rig.dialogs.shown()[0].title, "Save Chart");
    EXPECT_FALSE(platform::FileExists(rig.Target("bhp.txt")));

    EXPECT_TRUE(HasChartExtension("a.CHT"));
    EXPECT_TRUE(HasChartExtension("a.cHt"));
    EXPECT_FALSE(HasChartExtension("a.chtx"));
    EXPECT_EQ(ProposedChartName("/k/chtsave", " BHP "), "/k/chtsave/BHP.cht");
}

TEST(SavedChart, SavingIsAByteCopyOfTheStream) {
    SaveRig rig;
    EXPECT_EQ(SaveChartAs(rig.Target("BHP.Cht"), rig.stream, rig.dialogs), SaveChartResult::Saved);
    EXPECT_EQ(rig.root.Read("BHP.Cht"), kStream);
    ASSERT_EQ(rig.dialogs.shown().size(), 1u);
    EXPECT_EQ(rig.dialogs.shown()[0].text, " CHART SAVED ");
    EXPECT_EQ(rig.dialogs.shown()[0].title, "Save Chart");
}

TEST(SavedChart, AnExistingFileIsOnlyReplacedWhenTheUserSaysSo) {
    SaveRig rig;
    rig.root.Write("BHP.cht", "old");
    rig.dialogs.QueueAnswer(platform::Answer::Cancel);
    // The resolver finds the file whatever the case of the name typed.
    EXPECT_EQ(SaveChartAs(rig.Target("bhp.CHT"), rig.stream, rig.dialogs),
              SaveChartResult::Cancelled);
    EXPECT_EQ(rig.root.Read("BHP.cht"), "old");
    ASSERT_EQ(rig.dialogs.shown().size(), 1u);
    EXPECT_EQ(rig.dialogs.shown()[0].text, rig.Target("bhp.CHT") + " already exists - Overwrite");
    EXPECT_EQ(rig.dialogs.shown()[0].buttons, platform::Buttons::OkCancel);

    rig.dialogs.QueueAnswer(platform::Answer::Ok);
    EXPECT_EQ(SaveChartAs(rig.Target("bhp.CHT"), rig.stream, rig.dialogs), SaveChartResult::Saved);
    EXPECT_EQ(rig.root.Read("BHP.cht"), kStream);
}

TEST(SavedChart, AFailedSaveLeavesTheOldFileWhole) {
    SaveRig rig;
    rig.root.Write("BHP.cht", "the chart saved last week");
    const auto result = [&] {
        platform::ScopedWriteFailure fail(5);
        return SaveChartAs(rig.Target("BHP.cht"), rig.stream, rig.dialogs);
    }();
    EXPECT_EQ(result, SaveChartResult::NotSaved);
    EXPECT_EQ(rig.root.Read("BHP.cht"), "the chart saved last week");
    EXPECT_EQ(rig.dialogs.messages().back(), " CHART NOT SAVED ");

    // No stream to copy: nothing saved either.
    EXPECT_EQ(SaveChartAs(rig.Target("new.cht"), rig.root.path() / "none.tmp", rig.dialogs),
              SaveChartResult::NotSaved);
    EXPECT_FALSE(platform::FileExists(rig.Target("new.cht")));
}

TEST(SavedChart, DisplayChecksTheExtensionThenPlaysTheFile) {
    SaveRig rig;
    platform::RecordingSurface area;
    const auto palette = test::PlayerPalette();
    const auto fonts = test::PlayerFonts(false);
    rig.root.Write("BHP.CHT", kStream);

    EXPECT_FALSE(DisplaySavedChart(rig.Target("BHP.txt"), area, palette, fonts, rig.dialogs));
    ASSERT_EQ(rig.dialogs.shown().size(), 1u);
    EXPECT_EQ(rig.dialogs.shown()[0].text, "File extension must be .cht");
    EXPECT_EQ(rig.dialogs.shown()[0].title, "Saved Charts");
    EXPECT_TRUE(area.calls().empty());

    EXPECT_TRUE(DisplaySavedChart(rig.Target("bhp.cht"), area, palette, fonts, rig.dialogs));
    EXPECT_EQ(area.calls(), (Strings{"Width 1", "Clear #1017", "Line 1,2,3,4 #255",
                                     "Text 5,6 size 8.25 #0 [Two  blanks]"}));
    EXPECT_EQ(rig.dialogs.shown().size(), 1u);
}

} // namespace
} // namespace kori::chart
