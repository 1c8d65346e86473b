// The company details table: loading with its display conversions, the price figures worked
// out beside each row, and the columns the user hid.
#include "app/fundamentals_form.h"
#include "maint/security_details.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

struct FundamentalsTest : testing::Test {
    FundamentalsTest() {
        session.ReadFolders();
        std::filesystem::create_directories(session.folders.DataFolder);
    }
    void Details() {
        const std::string in = root.folder() + "In/";
        std::filesystem::create_directories(in);
        // Columns 10 (issue), 14 (earnings), 15 (dividend) and 18 (dividend type) matter here.
        root.Write("In/SecurityDetails.Asx.Stk",
                   "CODE,DESC,TYPE,F4,F5,F6,F7,F8,F9,ISSUE,F11,F12,F13,EPS,DPS,F16,F17,DTYPE\r\n"
                   "AAA,ALPHA,ORD,x,x,x,x,x,x,1234.6,x,x,x,0.5,0.2,x,x,I\r\n"
                   "BBB,BETA,ORD,x,x,x,x,x,x,10,x,x,x,0.4,0,x,x,F\r\n"
                   "CCC,GAMMA,ORD,x,x,x,x,x,x,10,x,x,x,0.4,0.1,x,x,Q\r\n"
                   "PRN,PERENTI,ORD,x,x,x,x,x,x,10,x,x,x,1,1,x,x,F\r\n");
        ASSERT_TRUE(maint::RefreshSecurityDetails(session.folders.SystemFolder, in).Status);
    }
    void Prices(const char* code, std::vector<float> closes) {
        std::vector<store::PriceRecord> recs;
        for (float c : closes) {
            store::PriceRecord r;
            r.Date = "20261120";
            r.Open = r.High = r.Low = r.Close = c;
            recs.push_back(r);
        }
        store::PriceFile f(store::PriceFile::PathFor(session.folders.DataFolder, code));
        ASSERT_TRUE(f.WriteAll(recs).ok());
    }
    test::TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::SettingsStore settings{root.path() / "settings.ini"};
    platform::FixedClock clock{"20261123"};
    Session session{root.path(), {dialogs, progress, settings, clock}};
};

TEST_F(FundamentalsTest, NoDetailsSaysSoAndTheMenuStaysOff) {
    FundamentalsForm f(session);
    session.download.DataService = 3;
    EXPECT_FALSE(f.Available());
    EXPECT_FALSE(f.Load());
    EXPECT_EQ(dialogs.shown().at(0).text, "There is no fundamental data");
    EXPECT_EQ(dialogs.shown().at(0).title, "ASX Security Data");
    Details();
    EXPECT_TRUE(f.Available());
    session.download.DataService = 4;
    EXPECT_FALSE(f.Available());
}

TEST_F(FundamentalsTest, RowsConvertedAndFiguresWorkedOutFromTheLastClose) {
    Details();
    Prices("AAA", {3, 4});
    Prices("BBB", {});   // an empty price file: no price, so no ratio
    Prices("PRNX", {5}); // passed over
    FundamentalsForm f(session);
    ASSERT_TRUE(f.Load());
    ASSERT_EQ(f.headers().size(), 22u);
    EXPECT_EQ(f.headers()[18], "Price $");
    EXPECT_EQ(f.headers()[21], "GICS");
    EXPECT_EQ(f.priceColumn(), 18);
    ASSERT_EQ(f.rows().size(), 4u);
    const auto& a = f.rows()[0];
    EXPECT_EQ(a[0], "AAA");
    EXPECT_EQ(a[9], "1235") << "field 10 as a whole number";
    EXPECT_EQ(a[17], "Interim");
    EXPECT_EQ(f.rows()[1][17], "Final");
    EXPECT_EQ(f.rows()[2][17], "Q");
    EXPECT_EQ(f.rows()[3][0], "PRNX");

    f.ShowFigures();
    // 4 / 0.5 = 8; 0.2 / 4 x 100 = 5.
    EXPECT_EQ(std::vector<std::string>(a.begin() + 18, a.begin() + 21),
              (std::vector<std::string>{"4.00", "008.0", "005.0"}));
    const auto& b = f.rows()[1];
    EXPECT_EQ(std::vector<std::string>(b.begin() + 18, b.begin() + 21),
              (std::vector<std::string>{"", "n/a", ""}));
    const auto& c = f.rows()[2]; // no price file at all
    EXPECT_EQ(std::vector<std::string>(c.begin() + 18, c.begin() + 21),
              (std::vector<std::string>{"", "", ""}));
    const auto& p = f.rows()[3];
    EXPECT_EQ(std::vector<std::string>(p.begin() + 18, p.begin() + 21),
              (std::vector<std::string>{"", "", ""}));
}

TEST_F(FundamentalsTest, ClassesScanListAndTransferToTheNameFile) {
    Details();
    auto bbb = store::NameRecord{};
    bbb.Code = "BBB";
    bbb.Name = "Beta";
    bbb.IndustryClass = "7";
    auto aaa = bbb;
    aaa.Code = "AAA";
    aaa.Name = "Alpha";
    aaa.IndustryClass = "";
    aaa.OtherDetails = "keep me";
    const std::string data = session.folders.DataFolder;
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(data)).WriteAll({bbb, aaa}).ok());
    FundamentalsForm f(session);
    ASSERT_TRUE(f.Load());

    f.ShowIndustryClasses();
    f.ShowIndustryClasses(); // the column comes once
    ASSERT_EQ(f.headers().size(), 23u);
    EXPECT_EQ(f.headers()[22], "Ind Class");
    EXPECT_EQ(f.priceColumn(), 18);
    EXPECT_EQ(f.rows()[1][22], "007");
    EXPECT_EQ(f.rows()[0][22], "") << "a blank class stays blank";
    EXPECT_EQ(f.rows()[2][22], "") << "not in the name file";

    // Rows 0 and 1 are in the name file, row 2 (CCC) is not; the list grows at its end.
    ASSERT_TRUE(store::WriteList(store::ListPath(data, 'Z'), {{5, "OLD"}}).ok());
    EXPECT_EQ(f.AddToScanList({0, 1, 2, 99}), 2);
    std::vector<store::ChartListEntry> list;
    ASSERT_TRUE(store::ReadList(store::ListPath(data, 'Z'), list).ok());
    ASSERT_EQ(list.size(), 3u);
    EXPECT_EQ(list[1].NameRecord, 2);
    EXPECT_EQ(platform::Trim(list[1].Code), "AAA");
    EXPECT_EQ(list[2].NameRecord, 1);

    // A heading click without the menu item first does nothing.
    EXPECT_EQ(f.HeadingClicked(17), -1);
    f.BeginTransfer();
    EXPECT_EQ(dialogs.shown().back().title, "Transfer to Name File");
    EXPECT_EQ(dialogs.shown().back().text,
              "Click the description of the data that you want transferred to the Other "
              "Details section of the Name file");
    EXPECT_EQ(f.HeadingClicked(17), 2); // "Interim" for AAA, "Final" for BBB
    EXPECT_FALSE(f.transferPending());
    std::vector<store::NameRecord> names;
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(data)).ReadAll(names).ok());
    EXPECT_EQ(platform::Trim(names[0].OtherDetails), "Final");
    EXPECT_EQ(platform::Trim(names[1].OtherDetails), "Interim");
    EXPECT_EQ(platform::Trim(names[1].Name), "Alpha") << "the rest of the record kept";
    EXPECT_TRUE(platform::FileExists(platform::ResolveIn(data, "names.bak")));
}

TEST_F(FundamentalsTest, HiddenColumnsStayHiddenUntilAllAreShown) {
    Details();
    {
        FundamentalsForm f(session);
        ASSERT_TRUE(f.Load());
        f.HideColumn(2);
        f.HideColumn(99); // no such column: nothing
        EXPECT_TRUE(f.hidden(2));
    }
    FundamentalsForm again(session);
    ASSERT_TRUE(again.Load());
    EXPECT_TRUE(again.hidden(2));
    EXPECT_FALSE(again.hidden(1));
    again.ShowAllColumns();
    FundamentalsForm third(session);
    ASSERT_TRUE(third.Load());
    EXPECT_FALSE(third.hidden(2));
}

TEST(FundamentalsDisplay, FieldConversions) {
    EXPECT_EQ(FundamentalsForm::DisplayField(26, "150000"), "1.50");
    EXPECT_EQ(FundamentalsForm::DisplayField(27, "123456"), "1.235");
    EXPECT_EQ(FundamentalsForm::DisplayField(28, "20261105"), "05Nov26");
    EXPECT_EQ(FundamentalsForm::DisplayField(31, "Y"), "YES");
    EXPECT_EQ(FundamentalsForm::DisplayField(32, "N"), "NO");
    EXPECT_EQ(FundamentalsForm::DisplayField(33, "25000"), "2.5");
    EXPECT_EQ(FundamentalsForm::DisplayField(5, " text "), "text");
}

} // namespace
} // namespace kori::app
