#include "app/help_index.h"

#include "app/menu_model.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <set>

using namespace kori;
using namespace kori::app;

namespace {
std::vector<std::string> Ids(const std::vector<const HelpPage*>& pages) {
    std::vector<std::string> r;
    for (const auto* p : pages)
        r.push_back(p->id);
    return r;
}

void CollectOpens(const std::vector<MenuItem>& items, std::set<std::string>& out) {
    for (const auto& i : items) {
        if (i.items.empty()) out.insert(i.opens);
        CollectOpens(i.items, out);
    }
}
} // namespace

TEST(HelpIndex, PagesAreUniqueAndEachWindowBelongsToOnePage) {
    std::set<std::string> ids;
    std::set<std::string> windows;
    for (const auto& p : HelpPages()) {
        EXPECT_TRUE(ids.insert(p.id).second) << "page twice: " << p.id;
        EXPECT_FALSE(p.title.empty()) << p.id;
        for (const auto& w : p.windows)
            EXPECT_TRUE(windows.insert(w).second) << "window on two pages: " << w;
    }
    EXPECT_EQ(HelpPages().front().id, kHelpContentsId);
}

TEST(HelpIndex, EveryWindowTheMenusOpenHasItsOwnPage) {
    // Items that start another program or a system dialog, or only flip a setting, have no
    // window of their own to document.
    const std::set<std::string> noWindow{"Exit",          "PrinterDialog", "KoriDownload",
                                         "KoriMaxScan",   "KoriMMA",       "Bourse",
                                         "PrinterColour", "ToggleTips",    "AboutDownload"};
    std::set<std::string> opens;
    CollectOpens(BuildMenuTree(), opens);
    for (const auto& o : opens) {
        if (noWindow.count(o)) continue;
        // Each window is named after what opens it; the help browser is the exception.
        EXPECT_TRUE(HasOwnHelpPage(o == "Help" ? "HelpBrowser" : o)) << o;
    }
    // Windows reached from other windows, and the two new windows.
    for (const char* w : {"Chts", "DataCodeEntry", "DataStat", "AdjOpts", "ZoomKori", "Search",
                          "FinDate", "Watchlist", "MultiOscChart", "Tips", "AbtKori", "ColNew",
                          "MultiOsc", "Scales", "OscFrm"})
        EXPECT_TRUE(HasOwnHelpPage(w)) << w;
}

TEST(HelpIndex, WindowLookupFallsBackToTheContents) {
    EXPECT_EQ(HelpPageForWindow("ChtSel").id, "chart-selection");
    EXPECT_EQ(HelpPageForWindow("DataCodeEntry").id, "data-file");
    EXPECT_EQ(HelpPageForWindow("MultiOscChart").id, "multi-osc");
    EXPECT_EQ(HelpPageForWindow("NoSuchWindow").id, "contents");
    EXPECT_EQ(HelpPageForWindow("").id, "contents");
    // The main window is covered by the contents, which is not a page "of its own".
    EXPECT_FALSE(HasOwnHelpPage("Main"));
    // Names are matched exactly: the scan window's lower-case name is not another's.
    EXPECT_EQ(HelpPageForWindow("chtScan1").id, "scan1");
    EXPECT_EQ(HelpPageForWindow("ChtScan1").id, "contents");
    EXPECT_EQ(FindHelpPage("nope"), nullptr);
}

TEST(HelpSearch, MatchesWordStartsInTitlesAndKeywordsIgnoringCase) {
    EXPECT_EQ(Ids(SearchHelp("watchlist")), std::vector<std::string>{"watchlist"});
    // A word start: "parab" finds the parabolic scan; the middle of a word does not.
    EXPECT_EQ(Ids(SearchHelp("PARAB")), std::vector<std::string>{"scan3"});
    EXPECT_TRUE(SearchHelp("arabolic").empty());
    // Every word must match: "scan volume" is the volume scan only, not every scan.
    EXPECT_EQ(Ids(SearchHelp("scan volume")), std::vector<std::string>{"scan2"});
    const auto scans = Ids(SearchHelp("scan"));
    EXPECT_GE(scans.size(), 4u);
    EXPECT_TRUE(SearchHelp("").empty());
    EXPECT_TRUE(SearchHelp("  ,. ").empty());
    EXPECT_TRUE(SearchHelp("zzzz").empty());
}

TEST(Tips, StepForwardAndBackWithWrapAround) {
    const auto n = Tips::All().size();
    ASSERT_GE(n, 10u);
    ASSERT_LE(n, 20u);
    Tips t;
    EXPECT_EQ(t.Current(), Tips::All()[0]);
    t.Previous();
    EXPECT_EQ(t.Index(), n - 1);
    t.Next();
    t.Next();
    EXPECT_EQ(t.Index(), 1u);
    Tips late(n + 2); // a kept place beyond the list (the list got shorter) wraps
    EXPECT_EQ(late.Index(), 2u);
}

TEST(Tips, StartupSettingDefaultsOnAndToggles) {
    test::TempRoot root;
    platform::SettingsStore store(root.path() / "settings.ini");
    EXPECT_TRUE(ShowTipsAtStartup(store));
    EXPECT_FALSE(ToggleShowTipsAtStartup(store));
    EXPECT_EQ(store.Get(kShowTipsKey, "unset"), "False");
    // It is kept: a new store over the same file reads it back.
    platform::SettingsStore again(root.path() / "settings.ini");
    EXPECT_FALSE(ShowTipsAtStartup(again));
    EXPECT_TRUE(ToggleShowTipsAtStartup(again));
    EXPECT_EQ(again.Get(kShowTipsKey, "unset"), "True");
    again.Save(kShowTipsKey, " false ");
    EXPECT_FALSE(ShowTipsAtStartup(again));
    again.Save(kShowTipsKey, "unknown"); // anything but False leaves tips on
    EXPECT_TRUE(ShowTipsAtStartup(again));
}
