#include "platform/files.h"
#include "platform/ini_file.h"
#include "platform/progress.h"
#include "store/chart_list.h"
#include "store/chart_list_relink.h"
#include "store/name_editor.h"
#include "store/shell_sort.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>

using namespace kori::store;
using kori::test::Name;
using kori::test::TempRoot;

namespace {

std::vector<NameRecord> ReadNames(const TempRoot& root) {
    std::vector<NameRecord> out;
    EXPECT_TRUE(NameFile(NameFile::PathIn(root.folder())).ReadAll(out).ok());
    return out;
}

std::vector<std::string> Codes(const std::vector<NameRecord>& records) {
    std::vector<std::string> out;
    for (const auto& r : records)
        out.push_back(r.TrimmedCode());
    return out;
}

TextRow Row(const char* code, const char* type, const char* cat = "1") {
    TextRow r(kNameAllColumns);
    r[kNameCode] = code;
    r[kNameType] = type;
    r[kNameCat] = cat;
    return r;
}

} // namespace

TEST(ShellSort, GapSequenceEndsInOrderForEverySize) {
    std::mt19937 rng(7);
    for (int n : {0, 1, 2, 3, 4, 5, 9, 16, 17, 100, 1001}) {
        std::vector<int> v(static_cast<std::size_t>(n));
        for (auto& x : v)
            x = static_cast<int>(rng() % 50);
        auto expected = v;
        std::sort(expected.begin(), expected.end());
        ShellSort(v, [](int a, int b) { return a < b; });
        EXPECT_EQ(v, expected) << n;
    }
}

TEST(NameEditorCells, RangesMessagesAndForms) {
    auto r = CheckNameCell(kNameType, "6");
    EXPECT_FALSE(r.Accepted);
    EXPECT_EQ(r.Message, "Record Type must be either 1,2,3,4 or 5");
    EXPECT_EQ(r.Title, "Record Type");
    EXPECT_FALSE(CheckNameCell(kNameType, "0").Accepted);
    EXPECT_FALSE(CheckNameCell(kNameType, "4.5").Accepted);
    EXPECT_TRUE(CheckNameCell(kNameType, "5").Accepted);
    r = CheckNameCell(kNameCat, "100");
    EXPECT_EQ(r.Message, "Category range 0 - 99");
    EXPECT_EQ(r.Title, "Category");
    EXPECT_TRUE(CheckNameCell(kNameCat, "99").Accepted);
    r = CheckNameCell(kNameIndustry, "7");
    EXPECT_TRUE(r.Accepted);
    EXPECT_EQ(r.Text, "007");
    r = CheckNameCell(kNameIndustry, "1000");
    EXPECT_EQ(r.Message, "Industry Classification range 0  to 999");
    EXPECT_EQ(r.Title, "Industry Classification");
    r = CheckNameCell(kNameOther, "12/6/24, 4.50");
    EXPECT_EQ(r.Message, "Commas NOT to be used in Name or Other Details columns");
    EXPECT_EQ(r.Title, "Name");
    EXPECT_EQ(CheckNameCell(kNameCode, "bhp").Text, "BHP");
    EXPECT_FALSE(CheckNameCell(kNameBase, "abc").Accepted);
    EXPECT_FALSE(CheckNameCell(kNameTop, "inf").Accepted);
}

TEST(NameEditorSave, RowChecksStopAtTheCell) {
    // A blank row in the middle passes; a type without a code and a code with type 0 do not.
    std::vector<TextRow> rows = {Row("AAA", "4"), Row("", ""), Row("CCC", "5")};
    EXPECT_FALSE(CheckNameRows(rows));
    rows[1] = Row("", "4");
    auto refused = CheckNameRows(rows);
    ASSERT_TRUE(refused);
    EXPECT_EQ(refused->Row, 1);
    EXPECT_EQ(refused->Column, kNameCode);
    EXPECT_EQ(refused->Message, "Code must be entered");
    EXPECT_EQ(refused->Title, "Name File");
    rows[1] = Row("BBB", "0");
    refused = CheckNameRows(rows);
    ASSERT_TRUE(refused);
    EXPECT_EQ(refused->Column, kNameType);
    EXPECT_EQ(refused->Message, "Record Type must be entered");
}

TEST(NameEditorSave, BlankRowClosesUpHiddenFieldsStayBackupAndListsFollow) {
    TempRoot root;
    std::vector<NameRecord> names = {Name("AAA", "Alpha"), Name("BBB", "Beta"),
                                     Name("CCC", "Gamma")};
    names[2].ScaleStep = 0.25f;
    names[2].PercentBandUp = 7;
    names[2].BollingerWidth = 3;
    names[2].Reserved = "xy";
    names[2].Status = 9;
    ASSERT_TRUE(NameFile(NameFile::PathIn(root.folder())).WriteAll(names).ok());
    ASSERT_TRUE(WriteList(ListPath(root.folder(), 'A'), {{3, "CCC"}, {1, "AAA"}}).ok());
    const std::string before = root.Read("Names.dat");

    std::vector<TextRow> rows;
    for (std::size_t i = 0; i < names.size(); ++i)
        rows.push_back(NameRowOf(names[i], static_cast<int>(i + 1)));
    rows[1][kNameCode] = ""; // BBB blanked: the row closes up
    rows[1][kNameType] = "";
    ASSERT_FALSE(CheckNameRows(rows));
    const auto records = NameRecordsToSave(rows);
    ASSERT_TRUE(SaveNameFile(root.folder(), records).ok());
    kori::platform::NullProgress progress;
    const auto relink = RelinkChartLists(root.folder(), progress);
    ASSERT_TRUE(relink.Status.ok());
    EXPECT_EQ(relink.ListsRewritten, 1);

    const auto saved = ReadNames(root);
    EXPECT_EQ(Codes(saved), (std::vector<std::string>{"AAA", "CCC"}));
    EXPECT_EQ(saved[1].Status, 0);
    EXPECT_EQ(saved[1].ScaleStep, 0.25f);
    EXPECT_EQ(saved[1].PercentBandUp, 7);
    EXPECT_EQ(saved[1].BollingerWidth, 3);
    EXPECT_EQ(saved[1].Reserved, "xy");
    EXPECT_EQ(root.Read("names.bak"), before);
    std::vector<ChartListEntry> list;
    ASSERT_TRUE(ReadList(ListPath(root.folder(), 'A'), list).ok());
    ASSERT_EQ(list.size(), 2u);
    EXPECT_EQ(list[0].NameRecord, 2); // CCC moved from 3 to 2
    EXPECT_EQ(list[1].NameRecord, 1);
}

TEST(NameEditorSave, FailedWriteLeavesTheOldFileAndNothingBeside) {
    TempRoot root;
    ASSERT_TRUE(NameFile(NameFile::PathIn(root.folder()))
                    .WriteAll({Name("AAA", "Alpha"), Name("BBB", "Beta")})
                    .ok());
    const std::string before = root.Read("Names.dat");
    {
        kori::platform::ScopedWriteFailure fail(100);
        EXPECT_FALSE(SaveNameFile(root.folder(), {Name("ZZZ", "Zed")}).ok());
    }
    EXPECT_EQ(root.Read("Names.dat"), before);
    EXPECT_EQ(kori::test::FilesIn(root.path()), (std::vector<std::string>{"Names.dat"}));
}

TEST(NameEditorRelink, EntriesLeavingTheFileVanishAnEmptiedListStays) {
    TempRoot root;
    ASSERT_TRUE(NameFile(NameFile::PathIn(root.folder()))
                    .WriteAll({Name("AAA", "A"), Name("BBB", "B"), Name("AAA", "again")})
                    .ok());
    ASSERT_TRUE(WriteList(ListPath(root.folder(), 'B'), {{9, "GONE"}, {1, "BBB"}}).ok());
    ASSERT_TRUE(WriteList(ListPath(root.folder(), 'C'), {{4, "GONE"}}).ok());
    ASSERT_TRUE(WriteList(ListPath(root.folder(), 'D'), {{3, "AAA"}}).ok());
    kori::platform::NullProgress progress;
    ASSERT_TRUE(RelinkChartLists(root.folder(), progress).Status.ok());
    std::vector<ChartListEntry> b, c, d;
    ASSERT_TRUE(ReadList(ListPath(root.folder(), 'B'), b).ok());
    ASSERT_TRUE(ReadList(ListPath(root.folder(), 'C'), c).ok());
    ASSERT_TRUE(ReadList(ListPath(root.folder(), 'D'), d).ok());
    ASSERT_EQ(b.size(), 1u);
    EXPECT_EQ(b[0].NameRecord, 2);
    ASSERT_EQ(c.size(), 1u); // nothing survived: the stale entry stays
    EXPECT_EQ(c[0].NameRecord, 4);
    ASSERT_EQ(d.size(), 1u);
    EXPECT_EQ(d[0].NameRecord, 1); // the first record of the code wins
}

TEST(NameEditorSort, KeysOfTwelveCharacters) {
    NameRecord r = Name("ABC", "x", 4);
    r.Category = 5;
    r.IndustryClass = "12 ";
    r.GicsSector = "4510";
    auto text = [](const NameSortKey& k) { return std::string(k.begin(), k.end()); };
    EXPECT_EQ(text(SortKeyOf(r, NameSortOrder::Code)), "ABC         ");
    EXPECT_EQ(text(SortKeyOf(r, NameSortOrder::Category)), "0054ABC     ");
    EXPECT_EQ(text(SortKeyOf(r, NameSortOrder::Industry)), "12ABC       ");
    EXPECT_EQ(text(SortKeyOf(r, NameSortOrder::Gics)), "4510ABC     ");
}

TEST(NameEditorSort, OrdersDropDeletedAndGoThroughScratchFiles) {
    TempRoot root;
    NameRecord a = Name("ZED", "z", 4), b = Name("ALF", "a", 5), c = Name("MID", "m", 4),
               d = Name("DEL", "d", 4);
    a.Category = 2;
    b.Category = 2;
    c.Category = 1;
    d.Status = 1;
    std::vector<NameRecord> sorted;
    kori::platform::NullProgress progress;
    ASSERT_TRUE(SortNamesThroughFiles(root.folder(), {a, b, c, d}, NameSortOrder::Category,
                                      progress, sorted)
                    .ok());
    // 001 4 MID, 002 4 ZED, 002 5 ALF; DEL (Status 1) is gone.
    EXPECT_EQ(Codes(sorted), (std::vector<std::string>{"MID", "ZED", "ALF"}));
    EXPECT_EQ(Codes(SortNameRecords({a, b, c, d}, NameSortOrder::Code)),
              (std::vector<std::string>{"ALF", "MID", "ZED"}));
    EXPECT_TRUE(kori::platform::FileExists(root.path() / "Temp.WK2"));
    EXPECT_FALSE(kori::platform::FileExists(root.path() / "Temp.Wk1"));
    EXPECT_FALSE(kori::platform::FileExists(root.path() / "Names.dat")); // not touched
}

TEST(NameEditorSort, AFullNameFileOf32767Records) {
    TempRoot root;
    std::vector<NameRecord> names;
    for (int i = 32767; i >= 1; --i)
        names.push_back(Name(("C" + std::to_string(i)).c_str(), "n"));
    std::vector<NameRecord> sorted;
    kori::platform::NullProgress progress;
    ASSERT_TRUE(
        SortNamesThroughFiles(root.folder(), names, NameSortOrder::Code, progress, sorted).ok());
    ASSERT_EQ(sorted.size(), 32767u);
    EXPECT_EQ(sorted.front().TrimmedCode(), "C1");
    EXPECT_EQ(sorted[1].TrimmedCode(), "C10");
    EXPECT_EQ(sorted.back().TrimmedCode(), "C9999");
    names.push_back(Name("ONEMORE", "n"));
    EXPECT_FALSE(
        SortNamesThroughFiles(root.folder(), names, NameSortOrder::Code, progress, sorted).ok());
}

TEST(NameEditorCleanUps, DuplicatesWarrantsExpiredAndCase) {
    std::vector<TextRow> rows = {Row("AAA", "4"), Row("AAA", "4"), Row("BBB", "4"),
                                 Row("BBB", "4"), Row("BBB", "4"), Row("CCC", "4")};
    rows[1][kNameName] = "second AAA";
    EXPECT_EQ(RemoveDuplicateCodes(rows), 3);
    ASSERT_EQ(rows.size(), 3u);
    EXPECT_EQ(rows[0][kNameName], ""); // the first stays

    rows = {Row("ABCWXY", "4", "85"), Row("ABCWX", "4", "85"), Row("ABCDEF", "4", "90"),
            Row("ABCWXZ", "4", "80"), Row("ABCWXQ", "4", "89")};
    EXPECT_EQ(RemoveWarrantRows(rows), 3);
    ASSERT_EQ(rows.size(), 2u);
    EXPECT_EQ(rows[0][kNameCode], "ABCWX");
    EXPECT_EQ(rows[1][kNameCode], "ABCDEF");

    rows = {Row("OPT1", "4"), Row("OPT2", "4")};
    rows[0][kNameOther] = "**EXPIRED**";
    EXPECT_EQ(RemoveExpiredOptionRows(rows), 1);
    EXPECT_EQ(rows[0][kNameCode], "OPT2");

    EXPECT_EQ(TitleCase("bHP  BILLITON ltd"), "Bhp  Billiton Ltd");
    rows[0][kNameBase] = "1.5";
    CleanOptionalDetails(rows);
    EXPECT_EQ(rows[0][kNameBase], "");
}

TEST(NameEditorCleanUps, WarrantKeysKeepTheirBlank) {
    TempRoot root;
    root.Write("Kori.ini", "[Download]\nUpdateAll=true\n");
    kori::platform::IniFile ini(root.path() / "Kori.ini");
    WriteNoWarrantKeys(ini);
    const std::string text = root.Read("Kori.ini");
    EXPECT_NE(text.find("NoWarrants=true"), std::string::npos) << text;
    EXPECT_NE(text.find("UpdateAll =false"), std::string::npos) << text;
    EXPECT_NE(text.find("UpdateAll=true"), std::string::npos) << text;
}

TEST(NameEditorCleanUps, OptionDetailsFromNames) {
    EXPECT_EQ(OptionDetailsFromName("BHP 27JUN24 45.50 CALL"), "27/6/24 45.5 OC");
    EXPECT_EQ(OptionDetailsFromName("XYZ put 5/12/2025 3"), "5/12/25 3 OP");
    EXPECT_EQ(OptionDetailsFromName("ABC 1/12/2025 1234.125 CALL"), "1/12/25 OC");
    EXPECT_FALSE(OptionDetailsFromName("BHP BILLITON LIMITED"));
    EXPECT_EQ(DeleteRowsQuestion(4, 4), "Delete row 4 ?");
    EXPECT_EQ(DeleteRowsQuestion(2, 5), "Delete items 2 to 5");
}
