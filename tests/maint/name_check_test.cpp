#include "maint/name_check.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori;
using namespace kori::maint;
using kori::test::Bytes;
using kori::test::Day;
using kori::test::Name;
using kori::test::TempRoot;

namespace {

platform::NullProgress g_progress;

void WriteNames(const TempRoot& root, std::vector<store::NameRecord> names) {
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).WriteAll(names).ok());
}

void WritePrices(const TempRoot& root, const std::string& file) {
    root.Write(file, Bytes({Day("20261120", 1, 2, 1, 1.5f, 100)}));
}

std::vector<store::NameRecord> ReadNames(const TempRoot& root) {
    std::vector<store::NameRecord> names;
    EXPECT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).ReadAll(names).ok());
    return names;
}

store::NameRecord Deleted(const char* code) {
    auto r = Name(code, "deleted");
    r.Status = 1;
    return r;
}

// A folder with one fault of each kind, and a deleted entry that must not count:
//   1 AAA  data        2 bbb  data (lower case)   3 CCC  no data
//   4 AAA  again       5 DDD  deleted, no data
//   EEE.wdt and PRNX.WDT without a name record; TOOLONGX.WDT cannot become a code.
void FaultyFolder(const TempRoot& root) {
    auto lower = Name("AAA", "Lower");
    lower.Code = "bbb   ";
    WriteNames(root, {Name("AAA", "Alpha"), lower, Name("CCC", "Gamma"), Name("AAA", "Again"),
                      Deleted("DDD")});
    for (const char* f : {"AAA.WDT", "BBB.WDT", "eee.wdt", "PRNX.WDT", "TOOLONGX.WDT"})
        WritePrices(root, f);
    root.Write("AAA.txt", "not a price file");
}

} // namespace

TEST(NameCheck, FindsEachKindOfFaultAndPassesOverDeletedEntries) {
    TempRoot root;
    FaultyFolder(root);
    const auto result = CheckNameFile(root.folder());
    ASSERT_TRUE(result.Status.ok()) << result.Status.message();
    EXPECT_EQ(result.Records, 5);
    EXPECT_EQ(result.PriceFiles, 5);
    const std::vector<NameFileFinding> expected = {
        {"bbb", 2, "Code not in upper case", "Upper case is BBB"},
        {"CCC", 3, "No price file", "CCC.WDT is missing"},
        {"AAA", 4, "Code duplicated", "Also record 1"},
        {"eee", 0, "No name record", "eee.wdt"},
        {"PRNX", 0, "No name record", "PRNX.WDT"},
        {"TOOLONGX", 0, "No name record",
         "TOOLONGX.WDT: the name is too long for a code of six letters"},
    };
    EXPECT_EQ(result.Findings, expected);
    EXPECT_EQ(result.Count(name_finding::NoNameRecord), 3);
}

TEST(NameCheck, ACleanFolderHasNoFindingsAndAMissingNameFileIsSaid) {
    TempRoot root;
    WriteNames(root, {Name("AAA", "Alpha")});
    WritePrices(root, "AAA.WDT");
    const auto clean = CheckNameFile(root.folder());
    ASSERT_TRUE(clean.Status.ok());
    EXPECT_TRUE(clean.Findings.empty());

    TempRoot empty;
    const auto none = CheckNameFile(empty.folder());
    EXPECT_FALSE(none.Status.ok());
    EXPECT_NE(none.Status.message().find("No name file"), std::string::npos);
}

TEST(NameCheckFix, AddsTypeFourEntriesAtTheEndAndRelinksTheLists) {
    TempRoot root;
    FaultyFolder(root);
    // List A points at CCC (record 3), which stays, and at the deleted DDD (record 5).
    ASSERT_TRUE(
        store::WriteList(store::ListPath(root.folder(), 'A'), {{5, "DDD"}, {3, "CCC"}, {1, "AAA"}})
            .ok());
    const std::string before = root.Read("Names.dat");

    const auto fixed = FixNameFile(root.folder(), true, false, g_progress);
    ASSERT_TRUE(fixed.Status.ok()) << fixed.Status.message();
    EXPECT_EQ(fixed.Added, 2); // EEE and PRNX; the long name cannot be a code
    EXPECT_EQ(fixed.Removed, 0);
    const auto names = ReadNames(root);
    ASSERT_EQ(names.size(), 6u); // the deleted entry is not written again
    EXPECT_EQ(names[4].TrimmedCode(), "EEE");
    EXPECT_EQ(names[4].RecordType, 4);
    EXPECT_EQ(platform::Trim(names[4].Name), "");
    EXPECT_EQ(names[5].TrimmedCode(), "PRNX");
    EXPECT_EQ(root.Read("names.bak"), before);
    std::vector<store::ChartListEntry> list;
    ASSERT_TRUE(store::ReadList(store::ListPath(root.folder(), 'A'), list).ok());
    ASSERT_EQ(list.size(), 2u); // DDD went with its deleted entry
    EXPECT_EQ(list[0].NameRecord, 3);
    EXPECT_EQ(list[1].NameRecord, 1);
    // Nothing left to add: the check agrees.
    EXPECT_EQ(CheckNameFile(root.folder()).Count(name_finding::NoNameRecord), 1);
}

TEST(NameCheckFix, RemovesEntriesWithoutDataAndTheListsFollow) {
    TempRoot root;
    FaultyFolder(root);
    ASSERT_TRUE(
        store::WriteList(store::ListPath(root.folder(), 'B'), {{3, "CCC"}, {4, "AAA"}}).ok());
    const auto fixed = FixNameFile(root.folder(), false, true, g_progress);
    ASSERT_TRUE(fixed.Status.ok());
    EXPECT_EQ(fixed.Removed, 1); // CCC; the deleted DDD is dropped without counting
    const auto names = ReadNames(root);
    ASSERT_EQ(names.size(), 3u);
    EXPECT_EQ(names[2].TrimmedCode(), "AAA");
    std::vector<store::ChartListEntry> list;
    ASSERT_TRUE(store::ReadList(store::ListPath(root.folder(), 'B'), list).ok());
    ASSERT_EQ(list.size(), 1u);
    EXPECT_EQ(list[0].Code.substr(0, 3), "AAA");
    EXPECT_EQ(list[0].NameRecord, 1); // the first AAA, as the re-linking takes it
}

TEST(NameCheckFix, NothingToDoWritesNothingAndAFailedWriteLeavesTheFile) {
    TempRoot root;
    WriteNames(root, {Name("AAA", "Alpha")});
    WritePrices(root, "AAA.WDT");
    const auto nothing = FixNameFile(root.folder(), true, true, g_progress);
    ASSERT_TRUE(nothing.Status.ok());
    EXPECT_FALSE(platform::FileExists(root.folder() + "names.bak"));

    WritePrices(root, "BBB.WDT");
    const std::string before = root.Read("Names.dat");
    {
        platform::ScopedWriteFailure fail(10);
        const auto failed = FixNameFile(root.folder(), true, true, g_progress);
        EXPECT_FALSE(failed.Status.ok());
        EXPECT_EQ(failed.Added, 0);
    }
    EXPECT_EQ(root.Read("Names.dat"), before);
}
