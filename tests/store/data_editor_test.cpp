#include "platform/files.h"
#include "platform/progress.h"
#include "store/data_editor.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

using namespace kori::store;
using kori::test::Bytes;
using kori::test::Day;
using kori::test::TempRoot;

namespace {
kori::platform::NullProgress g_progress;
}

TEST(DataEditorLoad, RowNumberIsRecordNumberAndMessagesForNoData) {
    TempRoot root;
    auto first = Day("20240102", 1, 2, 0.5f, 1.5f, 100);
    first.Flag = "I";
    first.Reserved = "abc";
    root.Write("ABC.WDT", Bytes({first, Day("20240103", 1.5f, 2.25f, 1, 2, 200, 0.5f)}));
    const auto load = LoadDataRows(root.path() / "ABC.WDT", "ABC", g_progress);
    ASSERT_TRUE(load.Ok);
    ASSERT_EQ(load.Rows.size(), 2u);
    EXPECT_EQ(load.Rows[0][kDataRec], "1");
    EXPECT_EQ(load.Rows[1][kDataRec], "2");
    EXPECT_EQ(load.Rows[1][kDataDate], "20240103");
    EXPECT_EQ(load.Rows[1][kDataHigh], "2.25");
    EXPECT_EQ(load.Rows[1][kDataVolume], "200");
    EXPECT_EQ(load.Rows[1][kDataAdjFactor], "0.5");
    EXPECT_EQ(load.Rows[0][kDataFlag], "I");

    const auto missing = LoadDataRows(root.path() / "XYZ.WDT", "XYZ", g_progress);
    EXPECT_FALSE(missing.Ok);
    EXPECT_EQ(missing.Message, "XYZ.WDT NOT FOUND");
    EXPECT_EQ(missing.Title, "Data File");
    root.Write("NIL.WDT", "");
    EXPECT_EQ(LoadDataRows(root.path() / "NIL.WDT", "NIL", g_progress).Message,
              "No data on file for NIL");
}

TEST(DataEditorCells, NumericColumnsAndTheirMessages) {
    auto r = CheckDataCell(kDataHigh, "1.2x");
    EXPECT_FALSE(r.Accepted);
    EXPECT_EQ(r.Message, "Data must be numeric");
    EXPECT_EQ(r.Title, "Data");
    EXPECT_FALSE(CheckDataCell(kDataClose, "").Accepted);
    EXPECT_FALSE(CheckDataCell(kDataOpen, "nan").Accepted);
    EXPECT_FALSE(CheckDataCell(kDataLow, "Infinity").Accepted);
    EXPECT_FALSE(CheckDataCell(kDataVolume, "3000000000").Accepted);
    EXPECT_TRUE(CheckDataCell(kDataVolume, " 12 ").Accepted);
    EXPECT_TRUE(CheckDataCell(kDataDate, "2024x").Accepted); // the date passes as it stands
}

TEST(DataEditorLoad, NotANumberPricesAreShownReportedAndRefused) {
    TempRoot root;
    auto bad = Day("20240102", 1, 2, 1, 1, 10);
    bad.High = std::numeric_limits<float>::quiet_NaN();
    bad.Close = std::numeric_limits<float>::infinity();
    root.Write("BAD.WDT", Bytes({Day("20240101", 1, 1, 1, 1, 1), bad}));
    const auto load = LoadDataRows(root.path() / "BAD.WDT", "BAD", g_progress);
    ASSERT_TRUE(load.Ok);
    EXPECT_EQ(load.Rows[1][kDataHigh], "NaN");
    EXPECT_EQ(load.Rows[1][kDataClose], "Infinity");
    ASSERT_EQ(load.Issues.size(), 1u);
    EXPECT_EQ(load.Issues[0].record, 2);
    EXPECT_FALSE(CheckDataCell(kDataHigh, load.Rows[1][kDataHigh]).Accepted);
}

TEST(DataEditorSave, WritesEveryFieldKeepsTempWrkAndSurvivesAFailedWriter) {
    TempRoot root;
    auto first = Day("20240102", 1, 2, 0.5f, 1.5f, 100);
    first.Flag = "I";
    root.Write("ABC.WDT", Bytes({first, Day("20240103", 1.5f, 2.25f, 1, 2, 200, 0.5f)}));
    const std::string before = root.Read("ABC.WDT");
    auto load = LoadDataRows(root.path() / "ABC.WDT", "ABC", g_progress);
    ASSERT_TRUE(load.Ok);
    // Unchanged rows write the same bytes back.
    ASSERT_TRUE(SaveDataRows(root.path() / "ABC.WDT", load.Rows, g_progress).ok());
    EXPECT_EQ(root.Read("ABC.WDT"), before);
    EXPECT_EQ(root.Read("Temp.WRK"), before);

    load.Rows[1][kDataClose] = "2.5";
    load.Rows[1][kDataVolume] = "250";
    {
        kori::platform::ScopedWriteFailure fail(60);
        EXPECT_FALSE(SaveDataRows(root.path() / "ABC.WDT", load.Rows, g_progress).ok());
    }
    EXPECT_EQ(root.Read("ABC.WDT"), before);
    EXPECT_EQ(kori::test::FilesIn(root.path()), (std::vector<std::string>{"ABC.WDT", "Temp.WRK"}));

    ASSERT_TRUE(SaveDataRows(root.path() / "ABC.WDT", load.Rows, g_progress).ok());
    EXPECT_EQ(root.Read("Temp.WRK"), before);
    auto expected = Day("20240103", 1.5f, 2.25f, 1, 2.5f, 250, 0.5f);
    EXPECT_EQ(root.Read("ABC.WDT"), Bytes({first, expected}));
}

TEST(DataEditorSort, DateOrderThroughTempWk2) {
    TempRoot root;
    const auto a = Day("20240105", 1, 1, 1, 1, 1), b = Day("20240103", 2, 2, 2, 2, 2),
               c = Day("20240104", 3, 3, 3, 3, 3);
    root.Write("ABC.WDT", Bytes({a, b, c}));
    auto load = LoadDataRows(root.path() / "ABC.WDT", "ABC", g_progress);
    std::vector<TextRow> sorted;
    ASSERT_TRUE(SortDataRows(root.path() / "ABC.WDT", load.Rows, g_progress, sorted).ok());
    EXPECT_EQ(root.Read("ABC.WDT"), Bytes({b, c, a}));
    ASSERT_EQ(sorted.size(), 3u);
    EXPECT_EQ(sorted[0][kDataRec], "1");
    EXPECT_EQ(sorted[0][kDataDate], "20240103");
    EXPECT_EQ(kori::test::FilesIn(root.path()), (std::vector<std::string>{"ABC.WDT"}));
    {
        kori::platform::ScopedWriteFailure fail(10);
        EXPECT_FALSE(SortDataRows(root.path() / "ABC.WDT", load.Rows, g_progress, sorted).ok());
    }
    EXPECT_EQ(root.Read("ABC.WDT"), Bytes({b, c, a}));
}
