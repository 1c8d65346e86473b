#include "platform/files.h"
#include "store/trendline_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <algorithm>

using namespace kori::store;

TEST(TrendlineFile, RecordsRoundTripAndDeletedPlacesAreReusedThenPacked) {
    kori::test::TempRoot root;
    const auto path = TrendlineFile::PathFor(root.folder(), "BHP");
    TrendRecord r{0, 'A', "20261102", 12.5f, "X310", 14.0f};
    kori::platform::Status s;
    EXPECT_EQ(TrendlineFile::AddRecord(path, r, s), 1);
    r.Period = 'W';
    EXPECT_EQ(TrendlineFile::AddRecord(path, r, s), 2);
    EXPECT_EQ(std::filesystem::file_size(path), 54u);
    ASSERT_TRUE(TrendlineFile::DeleteRecord(path, 1).ok());
    auto all = TrendlineFile::ReadAll(path);
    ASSERT_EQ(all.size(), 2u);
    EXPECT_TRUE(all[0].deleted());
    EXPECT_EQ(all[0].PriceA, 0.0f);
    EXPECT_EQ(all[1].DateB, "X310    ");
    EXPECT_EQ(all[1].PriceA, 12.5f);
    r.Period = 'M';
    EXPECT_EQ(TrendlineFile::AddRecord(path, r, s), 1) << "a deleted place is reused";
    ASSERT_TRUE(TrendlineFile::DeleteRecord(path, 2).ok());
    ASSERT_TRUE(TrendlineFile::Pack(path).ok());
    all = TrendlineFile::ReadAll(path);
    ASSERT_EQ(all.size(), 1u);
    EXPECT_EQ(all[0].Period, 'M');
    EXPECT_EQ(kori::test::FilesIn(root.path()), std::vector<std::string>{"BHP.TND"})
        << "no scratch file is left";
}

TEST(TrendlineFile, AFailedPackLeavesTheFileWholeAndNoScratchBehind) {
    kori::test::TempRoot root;
    const auto path = TrendlineFile::PathFor(root.folder(), "BHP");
    kori::platform::Status s;
    TrendRecord r{0, 'A', "20261102", 12.5f, "20261110", 14.0f};
    for (int i = 0; i < 3; ++i)
        ASSERT_EQ(TrendlineFile::AddRecord(path, r, s), i + 1);
    ASSERT_TRUE(TrendlineFile::DeleteRecord(path, 2).ok());
    const auto before = root.Read("BHP.TND");
    {
        kori::platform::ScopedWriteFailure fail(10);
        EXPECT_FALSE(TrendlineFile::Pack(path).ok());
    }
    EXPECT_EQ(root.Read("BHP.TND"), before);
    EXPECT_EQ(kori::test::FilesIn(root.path()), std::vector<std::string>{"BHP.TND"});
    ASSERT_TRUE(TrendlineFile::Pack(path).ok()) << "the fault ends with its scope";
    EXPECT_EQ(TrendlineFile::ReadAll(path).size(), 2u);
}
