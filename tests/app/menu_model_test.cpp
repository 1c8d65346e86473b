#include "app/menu_model.h"

#include <gtest/gtest.h>

using namespace kori::app;

namespace {
std::vector<std::string> VisibleCaptions(const std::vector<MenuItem>& tops, const char* top) {
    std::vector<std::string> r;
    for (const auto& t : tops)
        if (t.name == top)
            for (const auto& i : t.items)
                if (i.visible) r.push_back(i.caption);
    return r;
}
} // namespace

TEST(MenuModel, DataServiceZeroLeavesOnlySettingsAndUpdateInTheDownloadMenu) {
    auto tops = BuildMenuTree();
    ApplyMenuConditions(tops, MenuConditions{0, false, false, false});
    EXPECT_EQ(VisibleCaptions(tops, "mnuAComms"),
              (std::vector<std::string>{"Download Se&ttings", "&Downloaded Data Update"}));
}

TEST(MenuModel, ItemsFollowTheDataService) {
    auto tops = BuildMenuTree();
    ApplyMenuConditions(tops, MenuConditions{2, false, false, false});
    EXPECT_TRUE(FindItem(tops, "mnuBourse")->visible);
    EXPECT_FALSE(FindItem(tops, "mnuZEVOT")->visible);
    EXPECT_FALSE(FindItem(tops, "mnuMveData")->enabled);

    ApplyMenuConditions(tops, MenuConditions{3, true, false, false});
    EXPECT_FALSE(FindItem(tops, "mnuBourse")->visible);
    EXPECT_FALSE(FindItem(tops, "mnuZEVOT")->visible) << "the word A hides the download program";
    EXPECT_TRUE(FindItem(tops, "mnuCollectData")->visible);
    EXPECT_TRUE(FindItem(tops, "mnuMveData")->enabled);
}

TEST(MenuModel, FilePresenceSteersDetailsAndMaxScan) {
    auto tops = BuildMenuTree();
    ApplyMenuConditions(tops, MenuConditions{1, false, false, false});
    EXPECT_FALSE(FindItem(tops, "mnuMaxScan")->visible);
    EXPECT_FALSE(FindItem(tops, "mnuFundamtl")->enabled);
    ApplyMenuConditions(tops, MenuConditions{1, false, true, true});
    EXPECT_TRUE(FindItem(tops, "mnuMaxScan")->visible);
    EXPECT_TRUE(FindItem(tops, "mnuFundamtl")->enabled);
}

TEST(MenuModel, ModalToolsHideTheTopsAndEndingKeepsThemHidden) {
    auto tops = BuildMenuTree();
    const MenuConditions c{1, false, false, false};
    SetModalToolRunning(tops, true, c, false);
    EXPECT_FALSE(FindItem(tops, "mnTools")->visible);
    EXPECT_TRUE(FindItem(tops, "mnuHelp")->visible);
    SetModalToolRunning(tops, false, c, false);
    EXPECT_TRUE(FindItem(tops, "mnTools")->visible);
}

TEST(MenuModel, UnbuiltItemsAndEmptyMenusAreLeftOut) {
    auto tops = BuildMenuTree();
    KeepAvailable(tops,
                  [](const std::string& n) { return n == "mnuChartDisplay" || n == "mnuExit"; });
    ASSERT_EQ(tops.size(), 1u);
    EXPECT_EQ(tops[0].name, "mnuFile");
    ASSERT_NE(FindItem(tops, "mnuChartDisplay"), nullptr);
    EXPECT_EQ(FindItem(tops, "mnuViewNames"), nullptr);
}
