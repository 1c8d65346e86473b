#include "store/chart_list.h"
#include "store/name_file.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::store;
using kori::test::Name;

namespace {
void Names(const kori::test::TempRoot& root, std::vector<const char*> codes) {
    std::vector<NameRecord> recs;
    for (auto c : codes)
        recs.push_back(Name(c, c));
    NameFile f(NameFile::PathIn(root.folder()));
    ASSERT_TRUE(f.WriteAll(recs).ok());
}
} // namespace

TEST(ChartList, SavingFromCodesDropsUnknownsAndKeepsDuplicates) {
    kori::test::TempRoot root;
    Names(root, {"AAA", "BBB", "CCC"});
    ASSERT_TRUE(SaveListFromCodes(root.folder(), 'A', {" CCC ", "", "ZZZ", "AAA", "CCC"}).ok());
    std::vector<ChartListEntry> list;
    ASSERT_TRUE(ReadList(ListPath(root.folder(), 'A'), list).ok());
    ASSERT_EQ(list.size(), 3u);
    EXPECT_EQ(list[0].NameRecord, 3);
    EXPECT_EQ(list[1].NameRecord, 1);
    EXPECT_EQ(list[2].Code, "CCC   ");
}

TEST(ChartList, TmpNamesFollowTheListAndSkipEntriesPastTheEnd) {
    kori::test::TempRoot root;
    Names(root, {"AAA", "BBB"});
    ASSERT_TRUE(WriteList(ListPath(root.folder(), 'C'), {{2, "BBB"}, {7, "XXX"}, {1, "ZZZ"}}).ok());
    ASSERT_TRUE(BuildTmpNames(root.folder(), "SubListC.Dat").ok());
    NameFile tmp(root.path() / "TmpNames.tmp");
    ASSERT_TRUE(tmp.Open().ok());
    ASSERT_EQ(tmp.Count(), 2);
    NameRecord r;
    ASSERT_TRUE(tmp.Read(2, r).ok());
    EXPECT_EQ(r.TrimmedCode(), "AAA") << "the list's number is trusted over its code";
    EXPECT_EQ(r.Base, 1.0f);
}

TEST(ChartList, ImportFilterNamesAndModes) {
    EXPECT_TRUE(IsImportableCode("BHP"));
    EXPECT_TRUE(IsImportableCode("abc123"));
    EXPECT_FALSE(IsImportableCode("ABCDEFG"));
    EXPECT_FALSE(IsImportableCode("BH P"));
    EXPECT_FALSE(IsImportableCode(""));
    EXPECT_EQ(ListLetterOfMode(2), 'A');
    EXPECT_EQ(ListLetterOfMode(10), 'J');
    EXPECT_EQ(ListLetterOfMode(12), 'Z');
    EXPECT_EQ(ListLetterOfMode(1), 0);
    kori::test::TempRoot root;
    kori::platform::SettingsStore store(root.path() / "s.ini");
    auto names = GetSubLists(store);
    EXPECT_EQ(names[8], "Chart List J");
    names[0] = "Banks";
    SaveSLNames(store, names);
    EXPECT_EQ(GetSubLists(store)[0], "Banks");
    EXPECT_EQ(EmptyListMessage("Banks"),
              " There are no records in Banks for this folder.\n At Main Menu click EDIT / Edit "
              "Chart Lists to create your special interest list");
}

TEST(ChartList, ShowListCreatesAnAbsentListAndStockListFollowsTheNameFile) {
    kori::test::TempRoot root;
    EXPECT_TRUE(StockList(root.folder()).empty()) << "no name file";
    Names(root, {"AAA", "BB", "C1"});
    EXPECT_EQ(StockList(root.folder()), (std::vector<std::string>{"AAA", "BB", "C1"}));
    std::vector<std::string> codes{"stale"};
    ASSERT_TRUE(ShowList(root.folder(), 'D', codes).ok());
    EXPECT_TRUE(codes.empty());
    EXPECT_TRUE(std::filesystem::exists(root.path() / "SubListD.Dat"));
    ASSERT_TRUE(WriteList(ListPath(root.folder(), 'D'), {{3, "C1"}, {1, "AAA"}, {3, "C1"}}).ok());
    ASSERT_TRUE(ShowList(root.folder(), 'D', codes).ok());
    EXPECT_EQ(codes, (std::vector<std::string>{"C1", "AAA", "C1"}));
}

TEST(ChartList, ImportTrimsAndUpperCasesLinesThenKeepsOneToSixLettersOrDigits) {
    kori::test::TempRoot root;
    EXPECT_FALSE(ReadImportCodes(root.path() / "none.txt").has_value());
    // CR LF, bare LF and a last line without its end; lower case and blanks around a code are
    // no reason to lose it; a long one and punctuation are refused, a blank line is nothing.
    root.Write("codes.txt", "BHP\r\nanz\r\n\r\n CBA \r\nABCDEFG\nWES.AX\nQ1W2E3\rnab\t");
    const auto read = ReadImportFile(root.path() / "codes.txt");
    ASSERT_TRUE(read.has_value());
    EXPECT_EQ(read->Codes, (std::vector<std::string>{"BHP", "ANZ", "CBA", "Q1W2E3", "NAB"}));
    EXPECT_EQ(read->Refused, (std::vector<std::string>{"ABCDEFG", "WES.AX"}));
    EXPECT_EQ(ReadImportCodes(root.path() / "codes.txt"), read->Codes);
    EXPECT_EQ(RefusedCodesMessage("Not codes:", read->Refused), "Not codes:\nABCDEFG\nWES.AX");
}

TEST(ChartList, CopiesAddOnlyCodesTheBoxDoesNotHold) {
    ChartListBox box;
    EXPECT_TRUE(box.Add("KRM"));
    EXPECT_TRUE(box.AddIfAbsent("ALX"));
    EXPECT_FALSE(box.AddIfAbsent("KRM"));
    EXPECT_FALSE(box.AddIfAbsent(" ALX "));
    EXPECT_EQ(box.codes(), (std::vector<std::string>{"KRM", "ALX"}));
}

TEST(ChartList, ChoosersMapRowsToModesWithZAfterTheTen) {
    kori::test::TempRoot root;
    kori::platform::SettingsStore store(root.path() / "s.ini");
    EXPECT_EQ(ListChoices(store, false).size(), 10u);
    const auto withZ = ListChoices(store, true);
    ASSERT_EQ(withZ.size(), 11u);
    EXPECT_EQ(withZ.back(), "Chart List Z");
    EXPECT_EQ(ModeOfChoice(0), 2);
    EXPECT_EQ(ListLetterOfMode(ModeOfChoice(10)), 'Z');
    EXPECT_EQ(ModeOfChoice(11), 0);
    EXPECT_EQ(ModeOfChoice(-1), 0);
    EXPECT_EQ(ChoiceOfMode(11), 9);
    EXPECT_EQ(ChoiceOfMode(1), -1);
    EXPECT_EQ(ListChangedQuestion("Banks"), "Banks has changed. SAVE Changes?");
}

TEST(ChartList, ListBoxTracksChangesAndSavesWhatTheNameFileKnows) {
    kori::test::TempRoot root;
    Names(root, {"AAA", "BBB", "CCC"});
    ChartListBox box;
    EXPECT_FALSE(box.Save(root.folder()).ok()) << "no list displayed";
    ASSERT_TRUE(box.Load(root.folder(), 'E').ok());
    EXPECT_FALSE(box.changed());
    EXPECT_FALSE(box.Add("  ")) << "a blank code is not an entry";
    EXPECT_FALSE(box.changed());
    box.Add(" BBB ");
    box.Add("XXX");
    box.Insert(0, "CCC");
    box.Add("BBB");
    EXPECT_EQ(box.codes(), (std::vector<std::string>{"CCC", "BBB", "XXX", "BBB"}));
    EXPECT_TRUE(box.changed());
    EXPECT_TRUE(box.Move(0, 3));
    EXPECT_EQ(box.codes(), (std::vector<std::string>{"BBB", "XXX", "BBB", "CCC"}));
    EXPECT_FALSE(box.Move(0, 4));
    EXPECT_FALSE(box.Remove(9));
    ASSERT_TRUE(box.Save(root.folder()).ok());
    EXPECT_FALSE(box.changed());
    EXPECT_EQ(box.codes(), (std::vector<std::string>{"BBB", "BBB", "CCC"})) << "XXX dropped";
    std::vector<ChartListEntry> list;
    ASSERT_TRUE(ReadList(ListPath(root.folder(), 'E'), list).ok());
    ASSERT_EQ(list.size(), 3u);
    EXPECT_EQ(list[2].NameRecord, 3);
    box.Clear();
    EXPECT_TRUE(box.changed());
    ASSERT_TRUE(box.Load(root.folder(), 'E').ok());
    EXPECT_EQ(box.codes().size(), 3u) << "reloading forgets what was not saved";
    EXPECT_FALSE(box.changed());
}
