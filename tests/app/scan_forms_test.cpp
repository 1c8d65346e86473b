// The scan and statistics windows' models: choices kept between uses, runs over the sample
// library and a small library counted by hand, deletions, and the printed pages.
#include "app/scan_forms.h"
#include "app/statistics_form.h"
#include "platform/files.h"
#include "platform/ini_file.h"
#include "platform/text.h"
#include "scan/scan_rig.h"
#include "store/chart_list.h"
#include "support/sample_session.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace kori::test {
namespace {

using app::PaginateLines;
using app::PrintedLine;

std::vector<std::string> Texts(const app::PrintedPage& page) {
    std::vector<std::string> out;
    for (const auto& l : page.Lines)
        out.push_back(l.Text);
    return out;
}

bool Has(const std::vector<std::string>& v, const std::string& s) {
    return std::find(v.begin(), v.end(), s) != v.end();
}

TEST(PrintedPages, PagesRepeatTheirHeadAndTakeWhatFitsBelowIt) {
    const std::vector<std::string> body = {"a", "b", "c", "d", "e"};
    auto head = [](int page) {
        return std::vector<PrintedLine>{{"T" + std::to_string(page)}, {"H"}};
    };
    // Four lines a page, two of them the head: two body lines a page, the last page short.
    auto pages = PaginateLines(body, 4, head, [](int p) { return "Page  " + std::to_string(p); });
    ASSERT_EQ(pages.size(), 3u);
    EXPECT_EQ(Texts(pages[0]), (std::vector<std::string>{"T1", "H", "a", "b"}));
    EXPECT_EQ(Texts(pages[2]), (std::vector<std::string>{"T3", "H", "e"}));
    EXPECT_EQ(pages[1].Foot, "Page  2");
    // A head as tall as the page still lets one body line through, so the report always ends.
    pages = PaginateLines(body, 2, head);
    ASSERT_EQ(pages.size(), 5u);
    EXPECT_EQ(pages[4].Lines.back().Text, "e");
    EXPECT_TRUE(pages[4].Foot.empty());
    EXPECT_TRUE(PaginateLines({}, 40, head).empty());
}

TEST(PrintedPages, TableColumnsAreCutToTheirWidthsAndStartWhereTheOnesBeforeEnd) {
    const app::PrintedColumns columns{{4, 8, 6}};
    EXPECT_EQ(columns.Line({"*", "ABCDEFGHIJ", "1.50", "dropped"}), "*\tABCDEFG\t1.50");
    EXPECT_EQ(columns.Stops(), (std::vector<int>{0, 4, 12}));
}

TEST(PrintedPages, ListingsSayContinuedAfterTheirFirstPage) {
    app::ScanListingLines listing{"HEAD", {"1", "2", "3", "4"}, {}};
    const auto pages = app::ListingPages("CHART SCAN 3 DATA", listing, 5);
    ASSERT_EQ(pages.size(), 2u);
    EXPECT_EQ(pages[0].Lines[0].Text, "CHART SCAN 3 DATA");
    EXPECT_EQ(pages[1].Lines[0].Text, "CHART SCAN 3 DATA  (continued)");
    EXPECT_EQ(pages[1].Lines[1].Text, "HEAD");
}

struct ScanForms : ::testing::Test {
    SampleSession s;

    std::vector<std::string> ListZ() const {
        std::vector<store::ChartListEntry> entries;
        EXPECT_TRUE(
            store::ReadList(store::ListPath(s.session.folders.DataFolder, 'Z'), entries).ok());
        std::vector<std::string> codes;
        for (const auto& e : entries)
            codes.push_back(platform::Trim(e.Code));
        return codes;
    }
};

TEST_F(ScanForms, Scan1StartsFromItsDefaultsAndKeepsEveryChoiceForTheNextUse) {
    {
        app::Scan1Form fresh(s.session);
        EXPECT_EQ(fresh.ListIndex, 0);
        EXPECT_EQ(fresh.listCaptions().front(), "Full List (Names.dat)");
        EXPECT_EQ(fresh.Options.RisePercent, "10");
        EXPECT_EQ(fresh.Options.FallPercent, "10");
        EXPECT_EQ(fresh.Options.Range.Min, "0.50");
        EXPECT_EQ(fresh.Options.Range.Max, "5.00");
        EXPECT_FALSE(fresh.Options.Rise || fresh.Options.Osc[4] || fresh.Options.Indications.Any());
    }
    app::Scan1Form form(s.session);
    form.ListIndex = 2;
    form.Options.Fall = true;
    form.Options.FallPercent = "15";
    form.Options.Range = {true, "0.10", "9"};
    form.Options.Osc[4] = true;
    form.Options.Indications.CutOS = true;
    form.Options.ClassOn = true;
    form.Options.Class = "120";
    form.SaveChoices();
    app::Scan1Form again(s.session);
    EXPECT_EQ(again.ListIndex, 2);
    EXPECT_TRUE(again.Options.Fall);
    EXPECT_EQ(again.Options.FallPercent, "15");
    EXPECT_TRUE(again.Options.Range.On);
    EXPECT_EQ(again.Options.Range.Min, "0.10");
    EXPECT_EQ(again.Options.Range.Max, "9");
    EXPECT_TRUE(again.Options.Osc[4]);
    EXPECT_FALSE(again.Options.Osc[0]);
    EXPECT_TRUE(again.Options.Indications.CutOS);
    EXPECT_FALSE(again.Options.Indications.OB);
    EXPECT_EQ(again.Options.Class, "120");
    // A list that is no longer offered falls back to the full list.
    s.settings.Save(platform::kAppName, "Scan1_Other", "List", "40");
    EXPECT_EQ(app::Scan1Form(s.session).ListIndex, 0);
}

TEST_F(ScanForms, Scan1FindsTheExactRiseFillsTheGridAndStoresListZ) {
    app::Scan1Form form(s.session);
    form.Options.RisePercent = "250";
    form.Options.Rise = true;
    const auto refused = form.Refusal();
    ASSERT_TRUE(refused);
    EXPECT_EQ(refused->Text, "Percentage Not valid - Valid Range 1 to 200 ");
    EXPECT_EQ(refused->Title, "Analysis");

    form.Options.RisePercent = "10";
    ASSERT_FALSE(form.Refusal());
    const auto& r = form.Run(s.progress);
    ASSERT_TRUE(r.Status.ok()) << r.Status.message();
    EXPECT_EQ(form.GridHeading(), "SCAN RESULTS        Date: 20/11/26");
    int ten = -1;
    for (int i = 0; i < form.grid().rowCount(); ++i)
        if (form.CodeAt(i) == "TENUP") ten = i;
    ASSERT_GE(ten, 0);
    // Only a rise was asked for and it came: the row matches every selection.
    EXPECT_EQ(form.grid().cell(ten, 0), "*");
    EXPECT_EQ(form.grid().cell(ten, 3), "2.20");
    EXPECT_EQ(form.grid().cell(ten, 4), "U");
    EXPECT_EQ(form.grid().cell(ten, 5), "10.00");
    std::vector<std::string> shown;
    for (int i = 0; i < form.grid().rowCount(); ++i)
        shown.push_back(form.CodeAt(i));
    EXPECT_EQ(ListZ(), shown);
    ASSERT_TRUE(r.Message);
    EXPECT_EQ(r.Message->Title, " Chart Scan");

    const auto pages = form.Pages(60);
    ASSERT_FALSE(pages.empty());
    EXPECT_EQ(pages[0].Lines[0].Text, "ANALYSIS RESULTS  Page 1");
    EXPECT_TRUE(pages[0].Lines[0].Bold);
    EXPECT_EQ(pages[0].Lines[1].Text, "SCAN RESULTS        Date: 20/11/26");
    // No oscillator was tested, so none has a printed column.
    EXPECT_EQ(pages[0].Lines[2].Text, "All\tCode\tName\tClose\tMove\tChange");
    EXPECT_EQ(pages[0].TabStops.size(), 6u);
}

TEST_F(ScanForms, Scan1DeletesRowsOnlyWhenTheQuestionIsAnsweredYes) {
    app::Scan1Form form(s.session);
    form.Options.Rise = form.Options.Fall = true;
    form.Options.RisePercent = form.Options.FallPercent = "1";
    form.Run(s.progress);
    const int rows = form.grid().rowCount();
    ASSERT_GE(rows, 3);
    const std::string second = form.CodeAt(1), fourth = form.CodeAt(3);

    s.dialogs.QueueAnswer(platform::Answer::No);
    EXPECT_FALSE(form.DeleteRows(0, 0, s.dialogs));
    EXPECT_EQ(form.grid().rowCount(), rows);
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].text, "Delete row 1 ?");
    EXPECT_EQ(s.dialogs.shown()[0].title, "Chart Scan");

    s.dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(form.DeleteRows(2, 0, s.dialogs)); // a range picked upwards
    EXPECT_EQ(s.dialogs.shown()[1].text, "Delete items 1 to 3");
    EXPECT_EQ(form.grid().rowCount(), rows - 3);
    EXPECT_EQ(form.CodeAt(0), fourth);
    EXPECT_NE(form.CodeAt(0), second);
    EXPECT_FALSE(form.DeleteRows(rows, rows + 2, s.dialogs)); // past the end: nothing asked
    EXPECT_EQ(s.dialogs.shown().size(), 2u);
}

TEST_F(ScanForms, ListingScansFindWhatTheSampleHoldsAndKeepTheirChoices) {
    {
        app::Scan2Form scan2(s.session);
        EXPECT_EQ(scan2.Options.VolumePercent, "600");
        EXPECT_EQ(scan2.Options.Frame.Range.Min, "0.005");
        ASSERT_TRUE(scan2.Refusal()); // nothing ticked
        EXPECT_EQ(scan2.Refusal()->Text, "No selection made");
        scan2.Options.Volume = true;
        scan2.Options.VolumeDays = "10";
        ASSERT_FALSE(scan2.Refusal());
        ASSERT_TRUE(scan2.Run(s.progress).Status.ok());
        EXPECT_TRUE(Has(scan2.listing().Codes, "VOLSP"));
        EXPECT_EQ(scan2.listing().Lines.size(), scan2.listing().Codes.size());
        EXPECT_EQ(scan2.listing().Heading, "Code   L/Price    Vol+   % +/-");
        EXPECT_EQ(ListZ(), scan2.listing().Codes);
        EXPECT_TRUE(app::Scan2Form(s.session).Options.Volume);
    }
    app::Scan3Form scan3(s.session);
    scan3.Options.Up = true;
    ASSERT_TRUE(scan3.Run(s.progress).Status.ok());
    EXPECT_TRUE(Has(scan3.listing().Codes, "PARUP"));
    EXPECT_FALSE(Has(scan3.listing().Codes, "PARDN"));
    app::Scan3Form again(s.session);
    EXPECT_TRUE(again.Options.Up);
    EXPECT_FALSE(again.Options.Down);
}

TEST_F(ScanForms, Scan6ReadsTheAveragesAtEachCheckAndPrintsAsItsSibling) {
    app::Scan6Form form(s.session);
    form.Options.CodeLength = "4";
    ASSERT_FALSE(form.Refusal());
    ASSERT_TRUE(form.Run(s.progress).Status.ok());
    ASSERT_TRUE(Has(form.listing().Codes, "AVGX"));
    EXPECT_EQ(form.FirstShownLine(), 0);
    const auto pages = form.Pages(50);
    ASSERT_EQ(pages.size(), 1u);
    EXPECT_EQ(pages[0].Lines[0].Text, "CHART SCAN 2 DATA");
    EXPECT_EQ(pages[0].Lines[1].Text, "Code   L/Price    Vol+   % +/-");
    EXPECT_EQ(app::Scan6Form(s.session).Options.CodeLength, "4");

    // The chart defaults changed while the window stayed open.
    ASSERT_TRUE(s.session.ini().Write("Charts", "Av1D", "15"));
    ASSERT_TRUE(s.session.ini().Write("Charts", "Av2D", "15"));
    const auto refused = form.Refusal();
    ASSERT_TRUE(refused);
    EXPECT_EQ(refused->Text, "Averages not set - Set averages in Chart Defaults  and re-try");
    EXPECT_EQ(refused->Title, "Average Crossover Scan");
}

// Seven securities whose last day is worked out by hand.
struct SmallMarket : ::testing::Test {
    SampleSession s;
    TempRoot rig;

    void SetUp() override {
        std::vector<RigSecurity> list = {
            {"UPA", {2.00f, 2.50f}},                           // +25 %
            {"DNA", {4.00f, 3.00f}},                           // -25 %
            {"UPB", {1.00f, 1.10f}},                           // +10 %
            {"FLAT", {1.50f, 1.50f}},                          // steady
            {"QUIET", {1.00f, 2.00f}, 4, 1, "121", {1000, 1}}, // volume 1: untraded
            {"ONE", {3.00f}},                                  // one record: not counted
            {"ZERO", {0.00f, 1.00f}},                          // a rise from 0: no row
        };
        WriteRig(rig, list);
        s.session.folders.DataFolder = rig.folder();
    }
};

TEST_F(SmallMarket, StatisticsCountsAndBlocksAsWorkedByHand) {
    app::StatisticsForm form(s.session);
    EXPECT_EQ(form.TopText, "20");
    form.TopText = "2";
    ASSERT_TRUE(form.Check(s.progress));
    const auto& c = form.statistics().Counters();
    EXPECT_EQ(c.Rises, 3);
    EXPECT_EQ(c.Falls, 1);
    EXPECT_EQ(c.Steady, 1);
    EXPECT_EQ(c.Traded, 5);
    EXPECT_EQ(c.Untraded, 1);
    EXPECT_EQ(app::StatisticsForm(s.session).TopText, "2");

    auto& g = form.grid();
    ASSERT_EQ(g.rowCount(), 2 + 6);
    EXPECT_EQ(g.cell(0, 1), "RISES");
    EXPECT_EQ(g.cell(0, 7), "FALLS");
    EXPECT_EQ(g.rows()[1], (app::GridModel::Row{"UPA", "Name of UPA", "2.00", "2.50", "25.00 %", "",
                                                "DNA", "Name of DNA", "4.00", "3.00", "-25.00 %"}));
    EXPECT_EQ(g.cell(2, 0), "UPB");
    EXPECT_EQ(g.cell(2, 4), "10.00 %");
    EXPECT_EQ(g.cell(2, 6), "UPB"); // the second from the end of three movers
    EXPECT_EQ(g.cell(3, 1), "Rises");
    EXPECT_EQ(g.cell(3, 2), "3");
    EXPECT_EQ(g.cell(7, 1), "Untraded");
    EXPECT_EQ(g.cell(7, 2), "1");
    EXPECT_EQ(form.CodeAt(1, 9), "DNA");
    EXPECT_EQ(form.CodeAt(1, 2), "UPA");
    EXPECT_EQ(form.CodeAt(3, 1), ""); // a counter row

    // "&Update Statistics" works from the rows in hand: a file gone since changes nothing.
    std::filesystem::remove(store::PriceFile::PathFor(rig.folder(), "UPA"));
    form.TopText = "";
    ASSERT_TRUE(form.Update(s.progress));
    EXPECT_EQ(g.rowCount(), 3 + 6); // 20 cut to the three movers
    EXPECT_EQ(g.cell(1, 0), "UPA");
    EXPECT_EQ(form.statistics().Counters().Rises, 3);

    const auto pages = form.Pages(60, "20261120");
    ASSERT_EQ(pages.size(), 1u);
    EXPECT_EQ(pages[0].Lines[0].Text, "STATISTICS");
    EXPECT_EQ(pages[0].Lines[1].Text, "20-Nov-26");
    EXPECT_EQ(pages[0].Lines[2].Text, "Top Movers by Percentage");
    EXPECT_TRUE(pages[0].Lines[2].Centred && pages[0].Lines[2].Bold && pages[0].Lines[2].Underline);
    EXPECT_EQ(pages[0].Foot, "Page  1");
}

TEST_F(SmallMarket, StatisticsWithoutANameFileSaysSo) {
    std::filesystem::remove(store::NameFile::PathIn(rig.folder()));
    app::StatisticsForm form(s.session);
    EXPECT_FALSE(form.Check(s.progress));
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].text, "There is no Name File ");
    EXPECT_EQ(s.dialogs.shown()[0].title, "Statistics");
    EXPECT_EQ(form.grid().rowCount(), 0);
}

TEST_F(ScanForms, AdvanceDeclineTotalsFromTheWindowAreStableAndRefuseABadBase) {
    app::ADTotalsForm form(s.session);
    ASSERT_TRUE(Has(form.codes(), "ADNEW"));
    EXPECT_FALSE(Has(form.codes(), "TENUP"));
    EXPECT_FALSE(form.CheckTotals()); // nothing picked yet
    s.dialogs.clear();

    ASSERT_TRUE(form.Pick("ADNEW"));
    EXPECT_EQ(form.name(), "New Advance Decline Series (sample)");
    ASSERT_TRUE(platform::IsNumber(form.BaseText)) << form.BaseText;
    const std::string base = form.BaseText;
    form.BaseText = "12a";
    EXPECT_FALSE(form.CheckTotals());
    ASSERT_EQ(s.dialogs.shown().size(), 1u);
    EXPECT_EQ(s.dialogs.shown()[0].text, "Base Value must be numeric");
    EXPECT_EQ(s.dialogs.shown()[0].title, "Base Value");

    const auto file = store::PriceFile::PathFor(s.session.folders.DataFolder, "ADNEW");
    form.BaseText = base;
    ASSERT_TRUE(form.CheckTotals());
    const auto once = platform::ReadWholeFile(file);
    const auto total = form.total();
    EXPECT_EQ(s.dialogs.shown().back().title, "Advance/Decline");
    EXPECT_NE(
        s.dialogs.shown().back().text.find("Cumulative Total at end is " + std::to_string(total)),
        std::string::npos);
    // Picked again, the base comes from the rewritten first record: the same file again.
    ASSERT_TRUE(form.Pick("ADNEW"));
    EXPECT_EQ(form.BaseText, base);
    ASSERT_TRUE(form.CheckTotals());
    EXPECT_EQ(platform::ReadWholeFile(file), once);
    EXPECT_EQ(form.total(), total);
}

} // namespace
} // namespace kori::test
