#include "platform/files.h"
#include "store/chart_list.h"
#include "store/security_walk.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <fstream>
#include <gtest/gtest.h>

using namespace kori::store;
using kori::platform::Severity;
using kori::test::Day;
using kori::test::Name;

namespace {

void WriteNames(const kori::test::TempRoot& root, const std::vector<const char*>& codes) {
    std::vector<NameRecord> names;
    for (const char* c : codes)
        names.push_back(Name(c, c));
    ASSERT_TRUE(NameFile(NameFile::PathIn(root.folder())).WriteAll(names).ok());
}

void WritePrices(const kori::test::TempRoot& root, const char* code, int records) {
    std::vector<PriceRecord> days(static_cast<std::size_t>(records),
                                  Day("20261102", 1, 2, 1, 2, 10));
    ASSERT_TRUE(PriceFile(PriceFile::PathFor(root.folder(), code)).WriteAll(days).ok());
}

struct Seen {
    std::vector<std::string> codes;
    std::vector<int> records;
    WalkVisitor Visitor() {
        return [this](const WalkItem& item) {
            codes.push_back(item.Name.TrimmedCode());
            records.push_back(item.NameRecordNumber);
            return WalkStep::Continue;
        };
    }
};

} // namespace

TEST(ForEachSecurity, WalksTheNameFileAndReportsPriceFilesItCannotUse) {
    kori::test::TempRoot root;
    WriteNames(root, {"AAA", "BBB", "CCC", "DDD", "../X"});
    WritePrices(root, "AAA", 3);
    root.Write("CCC.WDT", "");
    WritePrices(root, "DDD", 2);
    {
        std::ofstream out(root.path() / "DDD.WDT", std::ios::app | std::ios::binary);
        out << "torn";
    }
    root.Write("X.WDT", std::string(50, ' '));
    kori::platform::NullProgress progress;
    Seen seen;
    const auto r = ForEachSecurity({root.folder(), 0}, progress, seen.Visitor());
    ASSERT_TRUE(r.Status.ok()) << r.Status.message();
    EXPECT_EQ(seen.codes, (std::vector<std::string>{"AAA", "DDD"}));
    EXPECT_EQ(r.Visited, 2);
    ASSERT_EQ(r.Issues.size(), 4u);
    EXPECT_EQ(r.Issues[0].file, "BBB.WDT") << "missing";
    EXPECT_EQ(r.Issues[1].file, "CCC.WDT") << "empty";
    EXPECT_EQ(r.Issues[2].file, "DDD.WDT") << "a torn last record is read up to the tear";
    EXPECT_EQ(r.Issues[2].record, 3);
    EXPECT_EQ(r.Issues[3].file, "Names.dat") << "a code that is no file name is never a path";
    EXPECT_EQ(r.Issues[3].record, 5);
    EXPECT_EQ(r.Issues[3].severity, Severity::Error);
}

TEST(ForEachSecurity, WalksAChartListInItsOrderThroughTmpNames) {
    kori::test::TempRoot root;
    WriteNames(root, {"AAA", "BBB", "CCC"});
    for (const char* c : {"AAA", "BBB", "CCC"})
        WritePrices(root, c, 1);
    ASSERT_TRUE(
        WriteList(ListPath(root.folder(), 'B'), {{3, "CCC"}, {9, "GONE"}, {1, "AAA"}}).ok());
    kori::platform::NullProgress progress;
    Seen seen;
    const auto r = ForEachSecurity({root.folder(), 'B'}, progress, seen.Visitor());
    ASSERT_TRUE(r.Status.ok());
    EXPECT_EQ(seen.codes, (std::vector<std::string>{"CCC", "AAA"})) << "out of range skipped";
    EXPECT_EQ(seen.records, (std::vector<int>{3, 1}));
    EXPECT_TRUE(kori::platform::FileExists(root.path() / "TmpNames.tmp"));
}

TEST(ForEachSecurity, StopsOnCancelOrWhenTheVisitorSaysSo) {
    kori::test::TempRoot root;
    WriteNames(root, {"AAA", "BBB", "CCC"});
    for (const char* c : {"AAA", "BBB", "CCC"})
        WritePrices(root, c, 1);
    struct CancelAtTwo : kori::platform::NullProgress {
        void SetValue(long long v) override {
            if (v == 2) RequestCancel();
        }
    } progress;
    Seen seen;
    auto r = ForEachSecurity({root.folder(), 0}, progress, seen.Visitor());
    EXPECT_TRUE(r.Cancelled);
    EXPECT_EQ(seen.codes, std::vector<std::string>{"AAA"});

    kori::platform::NullProgress quiet;
    int visits = 0;
    r = ForEachSecurity({root.folder(), 0}, quiet, [&](const WalkItem&) {
        return ++visits == 2 ? WalkStep::Stop : WalkStep::Continue;
    });
    EXPECT_TRUE(r.Stopped);
    EXPECT_EQ(visits, 2);
}

TEST(ForEachSecurity, AFileOverTheRecordLimitStopsTheWalkWithTheOneMessage) {
    kori::test::TempRoot root;
    root.Write("Names.dat", std::string(96 * 32768, ' '));
    kori::platform::NullProgress progress;
    int visits = 0;
    auto r = ForEachSecurity({root.folder(), 0}, progress, [&](const WalkItem&) {
        ++visits;
        return WalkStep::Continue;
    });
    EXPECT_FALSE(r.Status.ok());
    EXPECT_EQ(r.Status.message(), "Names.dat holds 32768 records; a file can hold at most 32767.");
    EXPECT_EQ(visits, 0);

    WriteNames(root, {"AAA"});
    root.Write("SubListA.Dat", std::string(8 * 32768, '\0'));
    r = ForEachSecurity({root.folder(), 'A'}, progress,
                        [](const WalkItem&) { return WalkStep::Continue; });
    EXPECT_EQ(r.Status.message(),
              "SubListA.Dat holds 32768 records; a file can hold at most 32767.");
}
