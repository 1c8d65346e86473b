#include "maint/asx_chg.h"
#include "maint/move_files.h"
#include "maint/old_files.h"
#include "maint/rem_date.h"
#include "maint/rem_dup_st.h"
#include "maint/vol_mod.h"
#include "platform/dialogs.h"
#include "platform/files.h"
#include "store/chart_list.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <sys/stat.h>

using namespace kori;
using namespace kori::maint;
using kori::test::Bytes;
using kori::test::Day;
using kori::test::Name;
using kori::test::TempRoot;

namespace {

platform::NullProgress g_progress;

void WriteNames(const TempRoot& root, const std::vector<const char*>& codes) {
    std::vector<store::NameRecord> names;
    for (const char* c : codes)
        names.push_back(Name(c, c));
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).WriteAll(names).ok());
}

std::vector<std::string> NameCodes(const std::string& folder) {
    std::vector<store::NameRecord> names;
    EXPECT_TRUE(store::NameFile(store::NameFile::PathIn(folder)).ReadAll(names).ok());
    std::vector<std::string> out;
    for (const auto& n : names)
        out.push_back(n.TrimmedCode());
    return out;
}

// A folder no one may write in, the super-user included; false where the system cannot make one.
bool MakeUnwritable(const std::filesystem::path& dir) {
    ::chmod(dir.c_str(), 0555);
    if (!FolderWritable(dir)) return true;
    const std::string cmd = "chattr +i '" + dir.string() + "' 2>/dev/null";
    return std::system(cmd.c_str()) == 0 && !FolderWritable(dir);
}
void MakeWritable(const std::filesystem::path& dir) {
    const std::string cmd = "chattr -i '" + dir.string() + "' 2>/dev/null";
    (void)std::system(cmd.c_str());
    ::chmod(dir.c_str(), 0755);
}

} // namespace

TEST(RemDupST, OnePassDropsOneOfEachPair) {
    const auto a = Day("20240101", 1, 1, 1, 1, 5), b0 = Day("20240102", 2, 2, 2, 2, 0),
               b7 = Day("20240102", 2, 2, 2, 2, 7), c = Day("20240103", 3, 3, 3, 3, 9);
    EXPECT_EQ(RemoveDuplicateDates(Bytes({a, b0, b7, c})), Bytes({a, b7, c}));
    // The earlier of two stays unless its volume is 0.
    const auto b5 = Day("20240102", 2, 2, 2, 2, 5);
    EXPECT_EQ(RemoveDuplicateDates(Bytes({a, b5, b7, c})), Bytes({a, b5, c}));
    // Three equal dates: the third is compared with what follows and stays too.
    const auto b1 = Day("20240102", 1, 1, 1, 1, 1);
    EXPECT_EQ(RemoveDuplicateDates(Bytes({b1, b5, b7})), Bytes({b1, b7}));
    EXPECT_EQ(RemoveDuplicateDates(Bytes({a})), Bytes({a}));
    // Sorting keeps records of one date in the order they stood.
    EXPECT_EQ(SortRecordsByDate(Bytes({c, b5, a, b7})), Bytes({a, b5, b7, c}));
}

TEST(RemDupST, WalksTheFolderAndRewritesOnlyWhatChanged) {
    TempRoot root;
    WriteNames(root, {"AAA", "BBB", "NOFILE"});
    const auto a = Day("20240101", 1, 1, 1, 1, 5), b0 = Day("20240102", 2, 2, 2, 2, 0),
               b7 = Day("20240102", 2, 2, 2, 2, 7), c = Day("20240103", 3, 3, 3, 3, 9);
    root.Write("AAA.WDT", Bytes({c, a, b0, b7}));
    root.Write("BBB.WDT", Bytes({a, c}));
    const auto result = RemDupST(root.folder(), g_progress);
    EXPECT_TRUE(result.Done);
    EXPECT_EQ(result.FilesChanged, 1);
    EXPECT_EQ(root.Read("AAA.WDT"), Bytes({a, b7, c}));
    EXPECT_EQ(root.Read("BBB.WDT"), Bytes({a, c}));
    ASSERT_EQ(result.Issues.size(), 1u); // the missing NOFILE.WDT
    EXPECT_EQ(result.Issues[0].file, "NOFILE.WDT");
}

TEST(RemDupST, AFolderThatIsNotWritableChangesNothing) {
    TempRoot root;
    WriteNames(root, {"AAA"});
    const auto a = Day("20240101", 1, 1, 1, 1, 5);
    root.Write("AAA.WDT", Bytes({a, a}));
    if (!MakeUnwritable(root.path())) GTEST_SKIP() << "cannot make a folder read-only here";
    const auto result = RemDupST(root.folder(), g_progress);
    platform::ScriptedDialogs dialogs;
    const auto removed = RemDate(root.folder(), "1/1/2024", RemoveWhich::All, dialogs, g_progress);
    MakeWritable(root.path());
    EXPECT_FALSE(result.Done);
    ASSERT_EQ(result.Issues.size(), 1u);
    EXPECT_NE(result.Issues[0].text.find("read-only"), std::string::npos);
    EXPECT_FALSE(removed.Done);
    ASSERT_EQ(dialogs.messages().size(), 1u);
    EXPECT_NE(dialogs.messages()[0].find("Nothing was changed"), std::string::npos);
    EXPECT_EQ(root.Read("AAA.WDT"), Bytes({a, a}));
}

TEST(RemDate, LatestTakesTheLaterOfTwoAllTakesBoth) {
    const auto a = Day("20240101", 1, 1, 1, 1, 1), b = Day("20240102", 2, 2, 2, 2, 2),
               b2 = Day("20240102", 3, 3, 3, 3, 3), c = Day("20240103", 4, 4, 4, 4, 4);
    const std::vector<store::PriceRecord> recs = {a, b, c, b2};
    EXPECT_EQ(Bytes(WithoutDate(recs, "20240102", RemoveWhich::Latest)), Bytes({a, b, c}));
    EXPECT_EQ(Bytes(WithoutDate(recs, "20240102", RemoveWhich::All)), Bytes({a, c}));
    EXPECT_EQ(DateToRemove("2/1/2024"), "20240102");
    EXPECT_EQ(DateToRemove("02/01/2024"), "20240102");
    EXPECT_FALSE(DateToRemove("31/2/2024"));
    EXPECT_FALSE(DateToRemove("2024-01-02"));
}

TEST(RemDate, OverTheFolderWithItsMessages) {
    TempRoot root;
    WriteNames(root, {"AAA", "EMPTY"});
    const auto a = Day("20240101", 1, 1, 1, 1, 1), b = Day("20240102", 2, 2, 2, 2, 2),
               b2 = Day("20240102", 3, 3, 3, 3, 3);
    root.Write("AAA.WDT", Bytes({a, b, b2}));
    root.Write("EMPTY.WDT", "");
    platform::ScriptedDialogs dialogs;
    EXPECT_FALSE(RemDate(root.folder(), " ", RemoveWhich::All, dialogs, g_progress).Done);
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text, "Date to remove must be entered.");
    EXPECT_EQ(dialogs.shown()[0].title, "Remove Selected Data");
    const auto r =
        RemDate(root.path().string(), "02/01/2024", RemoveWhich::Latest, dialogs, g_progress);
    EXPECT_TRUE(r.Done);
    EXPECT_EQ(r.FilesChanged, 1);
    EXPECT_EQ(root.Read("AAA.WDT"), Bytes({a, b}));
    EXPECT_EQ(root.Read("EMPTY.WDT"), "");
    EXPECT_FALSE(platform::FileExists(root.path() / "Temp.Tmp"));
}

TEST(AsxChg, BothFilesBecomeOneUnderTheNewCodeOldDataFirst) {
    TempRoot root;
    WriteNames(root, {"XYZ", "OLD"});
    const auto o1 = Day("20240101", 1, 1, 1, 1, 1), o2 = Day("20240102", 2, 2, 2, 2, 2),
               n1 = Day("20240103", 3, 3, 3, 3, 3);
    root.Write("OLD.WDT", Bytes({o1, o2}));
    root.Write("NEW.WDT", Bytes({n1}));
    platform::ScriptedDialogs dialogs;
    dialogs.QueueAnswer(platform::Answer::Yes);
    const auto r = AsxChg(root.folder(), "old", "new", dialogs, g_progress);
    EXPECT_TRUE(r.Done);
    EXPECT_EQ(dialogs.messages(),
              (std::vector<std::string>{"Do you want data for OLD renamed to NEW?"}));
    EXPECT_EQ(root.Read("NEW.WDT"), Bytes({o1, o2, n1}));
    EXPECT_FALSE(platform::FileExists(root.path() / "OLD.WDT"));
    EXPECT_EQ(NameCodes(root.folder()), (std::vector<std::string>{"XYZ", "NEW"}));
}

TEST(AsxChg, RenameAloneAndEveryRefusal) {
    TempRoot root;
    WriteNames(root, {"XYZ"});
    root.Write("OLD.WDT", Bytes({Day("20240101", 1, 1, 1, 1, 1)}));
    platform::ScriptedDialogs dialogs;
    EXPECT_FALSE(AsxChg(root.folder(), "", "NEW", dialogs, g_progress).Done);
    EXPECT_FALSE(AsxChg(root.folder(), "OLD", "../X", dialogs, g_progress).Done);
    EXPECT_FALSE(AsxChg(root.folder(), "NONE", "NEW", dialogs, g_progress).Done);
    dialogs.QueueAnswer(platform::Answer::No);
    EXPECT_FALSE(AsxChg(root.folder(), "OLD", "NEW", dialogs, g_progress).Done);
    dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(AsxChg(root.folder(), "OLD", "NEW", dialogs, g_progress).Done);
    const auto& shown = dialogs.shown();
    ASSERT_EQ(shown.size(), 6u);
    EXPECT_EQ(shown[0].text, "Invalid Code");
    EXPECT_EQ(shown[0].title, "Old ASX Code");
    EXPECT_EQ(shown[1].title, "New ASX Code");
    EXPECT_EQ(shown[2].text, "Cannot find " + root.folder() + "NONE.WDT");
    EXPECT_EQ(shown[2].title, "File details");
    EXPECT_EQ(shown[5].text, "Data file renamed but was unable to find entry for OLD");
    EXPECT_TRUE(platform::FileExists(root.path() / "NEW.WDT"));
    EXPECT_FALSE(platform::FileExists(root.path() / "OLD.WDT"));
}

TEST(VolMod, WholeNumberVolumesFloatPricesZerosStay) {
    EXPECT_EQ(VolModCell("1234", VolItem::Volume, VolOp::Divide, 10), "123");
    EXPECT_EQ(VolModCell("1234", VolItem::Volume, VolOp::Multiply, 100), "123400");
    EXPECT_FALSE(VolModCell("0", VolItem::Volume, VolOp::Multiply, 100));
    EXPECT_FALSE(VolModCell("30000000", VolItem::Volume, VolOp::Multiply, 100)); // too large
    EXPECT_EQ(VolModCell("1.5", VolItem::Close, VolOp::Multiply, 10), "15.0");
    EXPECT_EQ(VolModCell("1.25", VolItem::High, VolOp::Divide, 100), ".0125");
    EXPECT_EQ(VolModRefusal(std::nullopt, VolOp::Divide), "No data item to Adjust");
    EXPECT_EQ(VolModRefusal(VolItem::Low, VolOp::None),
              "Multiply or Divide option must be selected");
    EXPECT_EQ(VolModRangeText(3, 7), "Modify records 3 to 7");
    EXPECT_EQ(VolModRangeText(3, 3), "Modify record 3");
    EXPECT_EQ(VolItemNamed("volume"), VolItem::Volume);
}

TEST(OldFiles, DumpOldAndResetFA) {
    TempRoot root;
    root.Write("A.Old", "x");
    root.Write("B.OLD", "y");
    root.Write("C.WDT", "z");
    EXPECT_EQ(OldFiles(root.folder()).size(), 2u);
    const auto r = DumpOld(root.folder(), g_progress);
    EXPECT_EQ(r.FilesChanged, 2);
    EXPECT_EQ(kori::test::FilesIn(root.path()), (std::vector<std::string>{"C.WDT"}));
    EXPECT_EQ(NoOldFilesMessage("/d/"), " There are no '.Old' files in /d/");

    ::chmod((root.path() / "C.WDT").c_str(), 0444);
    const auto reset = ResetFA(root.folder(), g_progress);
    EXPECT_TRUE(reset.Done);
    EXPECT_EQ(reset.FilesChanged, 1);
    struct stat st {};
    ASSERT_EQ(::stat((root.path() / "C.WDT").c_str(), &st), 0);
    EXPECT_TRUE(st.st_mode & S_IWUSR);
}

TEST(MoveFiles, MoveAloneCarriesTheNameRecordAndRelinksTheSource) {
    TempRoot src, dst;
    WriteNames(src, {"AAA", "MOV", "CCC"});
    WriteNames(dst, {"ZZZ"});
    ASSERT_TRUE(store::WriteList(store::ListPath(src.folder(), 'A'), {{3, "CCC"}}).ok());
    const auto bytes = Bytes({Day("20240101", 1, 1, 1, 1, 1)});
    src.Write("MOV.WDT", bytes);
    platform::ScriptedDialogs dialogs;
    const auto r = MoveFiles(src.folder(), dst.folder(), "MOV.WDT", dialogs, g_progress);
    EXPECT_TRUE(r.Done);
    EXPECT_TRUE(dialogs.shown().empty());
    EXPECT_EQ(dst.Read("MOV.WDT"), bytes);
    EXPECT_FALSE(platform::FileExists(src.path() / "MOV.WDT"));
    EXPECT_EQ(NameCodes(src.folder()), (std::vector<std::string>{"AAA", "CCC"}));
    EXPECT_EQ(NameCodes(dst.folder()), (std::vector<std::string>{"ZZZ", "MOV"}));
    std::vector<store::ChartListEntry> list;
    ASSERT_TRUE(store::ReadList(store::ListPath(src.folder(), 'A'), list).ok());
    EXPECT_EQ(list.at(0).NameRecord, 2);
    EXPECT_EQ(WdtFiles(dst.folder()), (std::vector<std::string>{"MOV.WDT"}));
}

TEST(MoveFiles, NamesakeMergesByDateKeepsOldAndSameFolderIsRefused) {
    TempRoot src, dst;
    WriteNames(src, {"MOV"});
    WriteNames(dst, {"MOV"});
    const auto d1 = Day("20240101", 1, 1, 1, 1, 1), d3 = Day("20240103", 3, 3, 3, 3, 3),
               s2 = Day("20240102", 2, 2, 2, 2, 2), s3 = Day("20240103", 9, 9, 9, 9, 9);
    dst.Write("MOV.WDT", Bytes({d1, d3}));
    src.Write("MOV.WDT", Bytes({s3, s2}));
    platform::ScriptedDialogs dialogs;
    EXPECT_FALSE(MoveFiles(src.folder(), src.path().string(), "MOV", dialogs, g_progress).Done);
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text,
              "You have the same folder selected for both Source and Destination");
    EXPECT_EQ(dialogs.shown()[0].title, "Error");
    EXPECT_TRUE(MoveFiles(src.folder(), dst.folder(), "MOV", dialogs, g_progress).Done);
    EXPECT_EQ(dst.Read("MOV.WDT"), Bytes({d1, s2, s3}));
    EXPECT_EQ(dst.Read("MOV.Old"), Bytes({d1, d3}));
    EXPECT_EQ(NameCodes(dst.folder()), (std::vector<std::string>{"MOV"}));
    EXPECT_TRUE(NameCodes(src.folder()).empty());
}
