#include "scan/watchlist.h"

#include "platform/files.h"
#include "scan_rig.h"

#include <gtest/gtest.h>

using namespace kori;
using namespace kori::scan;
using kori::test::RigSecurity;
using kori::test::TempRoot;

namespace {

SnapshotSettings Settings() {
    return SnapshotSettingsFrom(platform::IniFile("/nonexistent/x.ini"));
}

WatchEntry Entry(const char* code, std::optional<double> price = {}, std::optional<double> qty = {},
                 const char* note = "") {
    return {code, "", price, qty, note};
}

} // namespace

TEST(WatchlistFile, RoundTripKeepsListsRowsAndNotesWithCommas) {
    TempRoot root;
    WatchlistBook book;
    ASSERT_TRUE(book.AddList("Banks").ok());
    ASSERT_TRUE(book.AddList("Miners").ok());
    ASSERT_TRUE(book.AddEntry("banks", {"cba", "20240105", 101.5, 20, "long, hold"}).ok());
    ASSERT_TRUE(book.AddEntry("Banks", Entry("NAB")).ok());
    ASSERT_TRUE(book.AddEntry("Miners", Entry("BHP", 45.25)).ok());
    const auto file = WatchlistBook::PathIn(root.folder());
    ASSERT_TRUE(book.Write(file).ok());

    platform::Issues issues;
    const auto back = WatchlistBook::Read(file, issues);
    EXPECT_TRUE(issues.empty());
    ASSERT_EQ(back.Lists.size(), 2u);
    const auto& cba = back.Lists[0].Entries.at(0);
    EXPECT_EQ(back.Lists[0].Name, "Banks");
    EXPECT_EQ(cba.Code, "CBA");
    EXPECT_EQ(cba.EntryDate, "20240105");
    EXPECT_EQ(cba.EntryPrice, 101.5);
    EXPECT_EQ(cba.Quantity, 20);
    EXPECT_EQ(cba.Note, "long, hold");
    EXPECT_FALSE(back.Lists[0].Entries.at(1).EntryPrice.has_value());
    EXPECT_EQ(back.Lists[1].Entries.at(0).EntryPrice, 45.25);
    EXPECT_EQ(back.Text(), book.Text());
}

TEST(WatchlistFile, BadLinesAreReportedByNumberAndTheRestIsRead) {
    const std::string text = "BHP\r\n"               // 1: before any list
                             "[Main]\r\n"            // 2
                             "CBA,20241301\r\n"      // 3: no such month
                             "WBC,,abc\r\n"          // 4: price not a number
                             "B P\r\n"               // 5: blank inside the code
                             "NAB,,,-3\r\n"          // 6: quantity below 0
                             "ANZ,20240102,,,ok\r\n" // 7: good
                             "[main]\r\n"            // 8: the same name again
                             "RIO\r\n"               // 9: goes with the refused list
                             "[Broken\r\n";          // 10: not closed
    platform::Issues issues;
    const auto book = WatchlistBook::Parse(text, "Watchlists.txt", issues);
    ASSERT_EQ(book.Lists.size(), 1u);
    ASSERT_EQ(book.Lists[0].Entries.size(), 1u);
    EXPECT_EQ(book.Lists[0].Entries[0].Code, "ANZ");
    EXPECT_EQ(book.Lists[0].Entries[0].Note, "ok");
    std::vector<int> lines;
    for (const auto& i : issues)
        lines.push_back(i.record);
    EXPECT_EQ(lines, (std::vector<int>{1, 3, 4, 5, 6, 8, 10}));
    EXPECT_EQ(issues[0].file, "Watchlists.txt");
}

TEST(WatchlistFile, TenListsAtMostAndNamesAreChecked) {
    WatchlistBook book;
    for (int i = 1; i <= 10; ++i)
        ASSERT_TRUE(book.AddList("List " + std::to_string(i)).ok());
    const auto eleventh = book.AddList("List 11");
    EXPECT_FALSE(eleventh.ok());
    EXPECT_NE(eleventh.message().find("no more than 10"), std::string::npos);
    EXPECT_EQ(book.Lists.size(), 10u);
    EXPECT_FALSE(book.RenameList("List 1", "list 2").ok()); // another's name, case aside
    EXPECT_TRUE(book.RenameList("List 1", "LIST 1").ok());  // its own, in new case
    EXPECT_FALSE(book.RenameList("List 3", "a [b]").ok());
    ASSERT_TRUE(book.DeleteList("list 10").ok());
    EXPECT_TRUE(book.AddList("List 11").ok());

    // An eleventh list in a file is reported, not read.
    std::string text;
    for (int i = 1; i <= 11; ++i)
        text += "[L" + std::to_string(i) + "]\nBHP\n";
    platform::Issues issues;
    const auto read = WatchlistBook::Parse(text, "w", issues);
    EXPECT_EQ(read.Lists.size(), 10u);
    ASSERT_EQ(issues.size(), 1u);
    EXPECT_EQ(issues[0].record, 21);
}

TEST(WatchlistFile, RowsAddedOnceRemovedByCodeAndAFailedWriteKeepsTheOldFile) {
    TempRoot root;
    WatchlistBook book;
    ASSERT_TRUE(book.AddList("Main").ok());
    ASSERT_TRUE(book.AddEntry("Main", Entry("bhp")).ok());
    EXPECT_FALSE(book.AddEntry("Main", Entry("BHP")).ok());
    EXPECT_FALSE(book.AddEntry("Other", Entry("RIO")).ok());
    EXPECT_FALSE(book.AddEntry("Main", Entry("../x")).ok());
    const auto file = WatchlistBook::PathIn(root.folder());
    ASSERT_TRUE(book.Write(file).ok());
    const auto before = root.Read("Watchlists.txt");

    ASSERT_TRUE(book.RemoveEntry("main", "bhp").ok());
    EXPECT_FALSE(book.RemoveEntry("main", "bhp").ok());
    {
        platform::ScopedWriteFailure failing(5);
        EXPECT_FALSE(book.Write(file).ok());
    }
    EXPECT_EQ(root.Read("Watchlists.txt"), before);
    EXPECT_EQ(test::FilesIn(root.path()), std::vector<std::string>{"Watchlists.txt"});
}

TEST(WatchlistFile, CommandLineAddTakesCodeAndOptionalPrice) {
    WatchEntry e;
    ASSERT_TRUE(ParseWatchAdd("bhp@45.5", e).ok());
    EXPECT_EQ(e.Code, "BHP");
    EXPECT_EQ(e.EntryPrice, 45.5);
    ASSERT_TRUE(ParseWatchAdd("CBA", e).ok());
    EXPECT_FALSE(e.EntryPrice.has_value());
    EXPECT_FALSE(ParseWatchAdd("CBA@", e).ok());
    EXPECT_FALSE(ParseWatchAdd("CBA@1x", e).ok());
    EXPECT_FALSE(ParseWatchAdd("@2", e).ok());
}

namespace {

// 22 days: closes 2.00 a day on 1000 shares, one high of 2.50 and one low of 1.50 on the way,
// then a last day of 2.05 to 2.20 closing at 2.20 on 3000 shares.
RigSecurity Abc() {
    RigSecurity s{"ABC", std::vector<float>(22, 2.0f)};
    s.Volumes.assign(22, 1000);
    s.Highs.assign(22, 2.0f);
    s.Lows.assign(22, 2.0f);
    s.Highs[4] = 2.5f;
    s.Lows[9] = 1.5f;
    s.Closes[21] = 2.2f;
    s.Highs[21] = 2.2f;
    s.Lows[21] = 2.05f;
    s.Volumes[21] = 3000;
    return s;
}

} // namespace

TEST(WatchlistRows, ColumnsWorkedOutByHand) {
    TempRoot root;
    test::WriteRig(root, {Abc(), RigSecurity{"NOP", {}}});
    Watchlist list{"Main",
                   {{"ABC", "20260101", 1.6, 1000, "core"}, Entry("NOP"), Entry("ZZZ", 1.0, 5)}};
    const std::vector<store::TargetLine> targets{
        {"ABC", "2.15", "U"}, {"XYZ", "2.15", "U"}, {"abc", "2.00", "U"}, {"ABC", "1.90", "D"}};
    const auto rows = ComputeWatchlist(list, root.folder(), targets, Settings());
    ASSERT_EQ(rows.size(), 3u);

    const auto& abc = rows[0];
    EXPECT_EQ(abc.Name, "Name of ABC");
    EXPECT_TRUE(abc.Problem.empty());
    EXPECT_EQ(abc.Date, test::RigRecords(Abc()).back().Date);
    EXPECT_NEAR(*abc.Close, 2.2, 1e-6);
    EXPECT_NEAR(*abc.Change, 0.2, 1e-6);
    EXPECT_NEAR(*abc.ChangePercent, 10.0, 1e-4);
    EXPECT_NEAR(*abc.VolumeRatio, 3.0, 1e-9); // 3000 against the 20 days of 1000 before
    EXPECT_NEAR(*abc.SinceEntry, 0.6, 1e-6);
    EXPECT_NEAR(*abc.SinceEntryPercent, 37.5, 1e-4);
    EXPECT_NEAR(*abc.Value, 2200.0, 1e-3);
    EXPECT_NEAR(*abc.YearHigh, 2.5, 1e-6);
    EXPECT_NEAR(*abc.YearLow, 1.5, 1e-6);
    // 2.15 lies in the day's range; 2.00 is under the close; 1.90 down is not met.
    EXPECT_EQ(abc.Target, "2.15 target reached UP; 2.00 target exceeded UP");

    EXPECT_EQ(rows[1].Problem, "no price file");
    EXPECT_EQ(rows[1].Name, "Name of NOP");
    EXPECT_FALSE(rows[1].Close.has_value());
    EXPECT_EQ(rows[2].Problem, "not in the name file, no price file");
    EXPECT_FALSE(rows[2].SinceEntry.has_value());
    EXPECT_FALSE(rows[2].Value.has_value());
    EXPECT_EQ(WatchCells(rows[2])[kWatchName], "(not in the name file, no price file)");
}

TEST(WatchlistRows, APriceFileWithoutANameRecordStillGivesFigures) {
    TempRoot root;
    test::WriteRig(root, {Abc()});
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).WriteAll({}).ok());
    const auto rows = ComputeWatchlist({"M", {Entry("ABC")}}, root.folder(), {}, Settings());
    ASSERT_EQ(rows.size(), 1u);
    EXPECT_EQ(rows[0].Problem, "not in the name file");
    EXPECT_NEAR(*rows[0].Close, 2.2, 1e-6);
}

TEST(WatchlistRows, SortsFiguresAsNumbersTextAsTextBlanksLastEitherWay) {
    std::vector<WatchRow> rows(4);
    const char* codes[] = {"B", "A", "D", "C"};
    const std::optional<double> closes[] = {10.0, 9.5, std::nullopt, 100.0};
    for (int i = 0; i < 4; ++i) {
        rows[static_cast<std::size_t>(i)].Entry.Code = codes[i];
        rows[static_cast<std::size_t>(i)].Close = closes[i];
    }
    rows[1].Entry.Note = "x";
    const auto order = [&] {
        std::string s;
        for (const auto& r : rows)
            s += r.Entry.Code;
        return s;
    };
    SortWatchRows(rows, kWatchClose, true);
    EXPECT_EQ(order(), "ABCD"); // 9.5 < 10 < 100 as numbers, not as text
    SortWatchRows(rows, kWatchClose, false);
    EXPECT_EQ(order(), "CBAD");
    SortWatchRows(rows, kWatchCode, false);
    EXPECT_EQ(order(), "DCBA");
    SortWatchRows(rows, kWatchNote, true);
    EXPECT_EQ(order().front(), 'A'); // the one note first, the blanks after
}
