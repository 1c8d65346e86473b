#include "maint/text_export.h"

#include "store/name_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <cstdlib>

namespace kori::maint {
namespace {

store::PriceRecord Day(std::string date, float c, int v = 100) {
    store::PriceRecord r;
    r.Date = std::move(date);
    r.Open = c - 0.01f;
    r.High = c + 0.1f;
    r.Low = c - 0.1f;
    r.Close = c;
    r.Volume = v;
    return r;
}

TEST(PriceText, ShortestTextThatReadsBackToTheSameFloat) {
    for (const float v : {1.41f, 0.005f, 7031.0f, 1234.5677f, 0.1f, 3.4e38f}) {
        const std::string t = PriceText(v);
        EXPECT_EQ(std::strtof(t.c_str(), nullptr), v) << t;
        EXPECT_EQ(static_cast<float>(std::strtod(t.c_str(), nullptr)), v) << t;
    }
    EXPECT_EQ(PriceText(1.41f), "1.41");
    EXPECT_EQ(PriceText(7031.0f), "7031");
    EXPECT_EQ(PriceText(0.0f), "0");
}

TEST(HistoryCsv, KeepsTheRangeAndSkipsRecordsWithoutADate) {
    const std::vector<store::PriceRecord> recs = {Day("20261118", 1.5f), Day("20261119", 1.25f),
                                                  Day("2026111X", 9.0f), Day("20261120", 1.0f)};
    EXPECT_EQ(HistoryCsv("KRM", recs, {"20261119", "20261120"}, false),
              "Date,Open,High,Low,Close,Volume\n"
              "2026-11-19,1.24,1.35,1.15,1.25,100\n"
              "2026-11-20,0.99,1.1,0.9,1,100\n");
    EXPECT_EQ(HistoryCsv("A,B", {Day("20261120", 2.0f, 7)}, {}, true),
              "Code,Date,Open,High,Low,Close,Volume\n\"A,B\",2026-11-20,1.99,2.1,1.9,2,7\n");
}

TEST(DayFiles, OneFileADayInTheDownloadLineFormat) {
    EXPECT_EQ(DayFileName("20080115"), "15JAN08.D");
    EXPECT_EQ(DayFileName("20261201"), "01DEC26.D");
    EXPECT_EQ(DayFileName("2026130X"), "");
    DayFiles days;
    days.Add("AAA", {Day("20261119", 1.0f), Day("20261120", 2.0f, 5)}, {"20261119", ""});
    days.Add("BBB", {Day("20261120", 3.0f, 0)}, {});
    test::TempRoot root;
    std::vector<std::string> written;
    ASSERT_TRUE(days.WriteTo(root.path() / "out", &written));
    EXPECT_EQ(written, (std::vector<std::string>{"19NOV26.D", "20NOV26.D"}));
    EXPECT_EQ(root.Read("out/20NOV26.D"),
              "AAA,20261120,1.99,2.1,1.9,2,5,0\nBBB,20261120,2.99,3.1,2.9,3,0,0\n");
}

class ClosesTest : public testing::Test {
protected:
    void Add(const char* code, const std::vector<store::PriceRecord>& recs) {
        store::NameFile names(store::NameFile::PathIn(root.folder()));
        ASSERT_TRUE(names.Open());
        store::NameRecord n;
        n.Code = store::PadCode(code);
        n.Name = std::string("Name ") + code;
        ASSERT_TRUE(names.Append(n));
        store::PriceFile file(root.path() / (std::string(code) + ".WDT"));
        ASSERT_TRUE(file.WriteAll(recs));
    }
    test::TempRoot root;
    platform::NullProgress progress;
};

TEST_F(ClosesTest, TheLatestDayByDefaultAndAnyDayAsked) {
    // A long history, so that an early day lies before the tail read first.
    std::vector<store::PriceRecord> longHistory;
    for (int i = 1; i <= 28; ++i) {
        char d[9];
        std::snprintf(d, sizeof d, "202610%02d", i);
        longHistory.push_back(Day(d, static_cast<float>(i)));
    }
    for (int i = 1; i <= 20; ++i) {
        char d[9];
        std::snprintf(d, sizeof d, "202611%02d", i);
        longHistory.push_back(Day(d, static_cast<float>(100 + i)));
    }
    longHistory.insert(longHistory.end(), 40, Day("20261120", 120.0f)); // pads the tail
    Add("LNG", longHistory);
    Add("OLD", {Day("20261002", 5.5f, 9)});
    Add("NIL", {Day("20261119", 0.0f, 0), Day("20261120", 0.0f, 0)}); // no trade at all

    const auto latest = ExportCloses({root.folder(), 0}, "", progress);
    ASSERT_TRUE(latest.Status) << latest.Status.message();
    EXPECT_EQ(latest.Date, "20261120");
    EXPECT_EQ(latest.Csv, "Code,Name,Date,Close,Volume\nLNG,Name LNG,2026-11-20,120,100\n");
    EXPECT_EQ(latest.NotTraded, 2);

    const auto early = ExportCloses({root.folder(), 0}, "20261002", progress);
    EXPECT_EQ(early.Csv, "Code,Name,Date,Close,Volume\nLNG,Name LNG,2026-10-02,2,100\n"
                         "OLD,Name OLD,2026-10-02,5.5,9\n");
    EXPECT_FALSE(ExportCloses({root.folder(), 0}, "20261302", progress).Status);
}

} // namespace
} // namespace kori::maint
