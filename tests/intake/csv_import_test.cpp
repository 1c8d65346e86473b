// Histories from CSV files and day files: what is read, how it meets the file on disk, and
// that a fault anywhere leaves the library as it was.
#include "intake/csv_import.h"
#include "platform/csv_line.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "support/temp_root.h"

#include "../store/store_builders.h"

#include <gtest/gtest.h>

namespace kori::intake {
namespace {

using test::Bytes;
using test::Day;
using test::TempRoot;

std::vector<store::PriceRecord> OnFile(const TempRoot& root, const char* file) {
    std::vector<store::PriceRecord> out;
    EXPECT_TRUE(store::PriceFile(root.path() / file).ReadAll(out).ok());
    return out;
}

std::vector<store::NameRecord> Names(const TempRoot& root) {
    std::vector<store::NameRecord> out;
    EXPECT_TRUE(store::NameFile(root.path() / "Names.dat").ReadAll(out).ok());
    return out;
}

TEST(CsvLine, QuotesKeepSeparatorsAndDoubledQuotes) {
    EXPECT_EQ(platform::SplitQuoted("a, \"b,c\" ,\"say \"\"hi\"\"\",\r"),
              (std::vector<std::string>{"a", "b,c", "say \"hi\"", ""}));
    EXPECT_EQ(platform::SplitQuoted("1;\"2;3\"", ';'), (std::vector<std::string>{"1", "2;3"}));
    EXPECT_EQ(platform::CountSeparators("a,\"b,c\",d"), 2);
}

TEST(CsvHistoryRead, ColumnsInAnyOrderAndCaseDatesInThreeFormsSorted) {
    const auto h = ReadCsvHistory("\n"
                                  "VOLUME,close,Adj Close,Low,High,Open,date\r\n"
                                  "1500,1.25,1.20,1.10,1.30,1.15,2024-01-03\r\n"
                                  "\r\n"
                                  "900,1.20,1.15,1.05,1.22,1.12,20240102\r\n"
                                  "0,1.30,1.25,1.21,1.31,1.26,4/1/2024\r\n");
    ASSERT_TRUE(h.Error.empty()) << h.Error;
    ASSERT_EQ(h.Records.size(), 3u);
    EXPECT_EQ(h.Records[0].Date, "20240102");
    EXPECT_EQ(h.Records[1].Date, "20240103");
    EXPECT_EQ(h.Records[2].Date, "20240104");
    const auto& r = h.Records[1];
    EXPECT_EQ(r.Open, 1.15f);
    EXPECT_EQ(r.High, 1.30f);
    EXPECT_EQ(r.Low, 1.10f);
    EXPECT_EQ(r.Close, 1.25f) << "the adjusted close is not the close";
    EXPECT_EQ(r.Volume, 1500);
}

TEST(CsvHistoryRead, SemicolonsQuotesAndNoVolumeColumn) {
    const auto h = ReadCsvHistory("\"Date\";\"Open\";\"High\";\"Low\";\"Close\";\"Note\"\n"
                                  "\"2024-01-02\";\"2.5\";\"2.75\";\"2.4\";\"2.6\";\"ex; div\"\n");
    ASSERT_TRUE(h.Error.empty()) << h.Error;
    ASSERT_EQ(h.Records.size(), 1u);
    EXPECT_EQ(h.Records[0].High, 2.75f);
    EXPECT_EQ(h.Records[0].Volume, 0);
}

TEST(CsvHistoryRead, FaultsNameTheirLine) {
    auto h = ReadCsvHistory("Date,Open,High,Close,Volume\n2024-01-02,1,1,1,1\n");
    EXPECT_EQ(h.Error, "The column Low is missing from the header row");
    EXPECT_EQ(h.ErrorLine, 1);
    h = ReadCsvHistory("Date,Open,High,Low,Close\n2024-01-02,1,1,1,1\n2024-02-30,1,1,1,1\n");
    EXPECT_EQ(h.Error, "Line 3: \"2024-02-30\" is not a date");
    EXPECT_TRUE(h.Records.empty());
    h = ReadCsvHistory("Date,Open,High,Low,Close\n02/01/24,1,1,1,1\n");
    EXPECT_EQ(h.ErrorLine, 2) << "a two-digit year is not one of the forms";
    h = ReadCsvHistory("Date,Open,High,Low,Close\n2024-01-02,1,1,x,1\n");
    EXPECT_EQ(h.Error, "Line 2: the Low \"x\" is not a number");
    h = ReadCsvHistory("Date,Open,High,Low,Close\n2024-01-02,1,1\n");
    EXPECT_EQ(h.ErrorLine, 2);
    h = ReadCsvHistory("Date,Open,High,Low,Close,Volume\n2024-01-02,1,1,1,1,-5\n");
    EXPECT_EQ(h.Error, "Line 2: the volume \"-5\" is not a share count");
    h = ReadCsvHistory("Date,Open,High,Low,Close\n2024-01-03,1,1,1,1\n2024-01-02,1,1,1,1\n"
                       "20240103,2,2,2,2\n");
    EXPECT_EQ(h.Error, "Line 4: the date 03/01/2024 is already on line 2");
}

TEST(MergeHistoryRule, NewDatesAddedExistingKeptOrReplaced) {
    const std::vector<store::PriceRecord> onFile = {Day("20240102", 1, 1, 1, 1, 10),
                                                    Day("20240104", 4, 4, 4, 4, 40, 0.5f)};
    const std::vector<store::PriceRecord> incoming = {Day("20240103", 3, 3, 3, 3, 30),
                                                      Day("20240104", 9, 9, 9, 9, 90)};
    MergeCount c;
    auto merged = MergeHistory(onFile, incoming, false, c);
    EXPECT_EQ(c.Added, 1);
    EXPECT_EQ(c.Kept, 1);
    EXPECT_EQ(c.Total, 3);
    EXPECT_EQ(merged[1].Date, "20240103");
    EXPECT_EQ(merged[2].Close, 4.0f);
    merged = MergeHistory(onFile, incoming, true, c);
    EXPECT_EQ(c.Replaced, 1);
    EXPECT_EQ(merged[2].Close, 9.0f);
    EXPECT_EQ(merged[2].Volume, 90);
    EXPECT_EQ(merged[2].AdjFactor, 0.5f) << "the adjustment mark stays on its day";
}

class CsvImport : public testing::Test {
protected:
    void SetUp() override {
        root.Write("AAA.WDT", Bytes({Day("20240102", 1, 1.1f, 0.9f, 1, 10)}));
        auto n = test::Name("AAA", "Triple A");
        const auto b = n.Encode();
        root.Write("Names.dat", std::string(b.data(), b.size()));
    }
    ImportReport Import(const std::string& csv, ImportOptions o) {
        return ImportCsvFile(root.Write("in.csv", csv), root.folder(), o);
    }
    TempRoot root;
    const std::string csv = "Date,Open,High,Low,Close,Volume\n"
                            "2024-01-02,2,2.2,1.8,2.1,20\n"
                            "2024-01-03,3,3.3,2.7,3.1,30\n";
};

TEST_F(CsvImport, MergesIntoAnExistingSecurityWithoutANewName) {
    auto r = Import(csv, {"aaa", "", 4, false});
    ASSERT_TRUE(r.Ok) << r.Message;
    EXPECT_EQ(r.Message, "AAA: 2 records read; 1 added, 0 replaced, 1 already on file; 2 on file");
    auto recs = OnFile(root, "AAA.WDT");
    ASSERT_EQ(recs.size(), 2u);
    EXPECT_EQ(recs[0].Close, 1.0f);
    EXPECT_EQ(recs[1].Close, 3.1f);
    EXPECT_EQ(Names(root).size(), 1u);

    r = Import(csv, {"AAA", "", 4, true});
    ASSERT_TRUE(r.Ok) << r.Message;
    EXPECT_EQ(r.Count.Replaced, 2);
    EXPECT_EQ(OnFile(root, "AAA.WDT")[0].Close, 2.1f);
}

TEST_F(CsvImport, ANewSecurityGetsOneNameRecord) {
    const auto r = Import(csv, {"bbb", "Bee Holdings", 5, false});
    ASSERT_TRUE(r.Ok) << r.Message;
    EXPECT_EQ(r.NewNames, 1);
    EXPECT_EQ(OnFile(root, "BBB.WDT").size(), 2u);
    const auto names = Names(root);
    ASSERT_EQ(names.size(), 2u);
    const auto& n = names[1];
    EXPECT_EQ(n.TrimmedCode(), "BBB");
    EXPECT_EQ(platform::Trim(n.Name), "Bee Holdings");
    EXPECT_EQ(n.RecordType, 5);
    EXPECT_EQ(n.Category, 1);
    EXPECT_EQ(n.ScaleStep, 0.05f);
    EXPECT_EQ(n.Status, 0);
    EXPECT_EQ(platform::FileSizeOr0(root.path() / "Names.dat"), 192u);
}

TEST_F(CsvImport, RefusalsLeaveEverythingAsItWas) {
    const auto before = root.Read("AAA.WDT");
    auto r = Import("Date,Open,High,Low,Close\n2024-01-05,1,1,1,1\nsoon,1,1,1,1\n",
                    {"AAA", "", 4, true});
    EXPECT_FALSE(r.Ok);
    EXPECT_EQ(r.Message, "Line 3: \"soon\" is not a date; nothing was written");
    r = Import(csv, {"CCC", "Comma, Ltd", 4, false});
    EXPECT_EQ(r.Message, "The name must not hold a comma");
    r = Import(csv, {"A/B", "", 4, false});
    EXPECT_FALSE(r.Ok);
    {
        platform::ScopedWriteFailure fail(60);
        r = Import(csv, {"AAA", "", 4, true});
        EXPECT_FALSE(r.Ok);
        r = Import(csv, {"DDD", "", 4, false});
        EXPECT_FALSE(r.Ok);
    }
    EXPECT_EQ(root.Read("AAA.WDT"), before);
    EXPECT_FALSE(platform::FileExists(root.path() / "DDD.WDT"));
    EXPECT_EQ(Names(root).size(), 1u) << "no name without its price file";
    EXPECT_EQ(test::FilesIn(root.path()),
              (std::vector<std::string>{"AAA.WDT", "Names.dat", "in.csv"}));
}

TEST_F(CsvImport, AHistoryOverTheRecordLimitIsRefused) {
    std::string big = "Date,Open,High,Low,Close\n";
    const std::int32_t first = *platform::DaySerial("19000101");
    for (std::int32_t i = 0; i < 32767; ++i)
        big += *platform::DateTextFromSerial(first + i) + ",1,1,1,1\n";
    // With the record already on file (2 Jan 2024, after these dates) that is 32,768.
    const auto r = Import(big, {"AAA", "", 4, false});
    EXPECT_FALSE(r.Ok);
    EXPECT_EQ(r.Message, "AAA would hold 32768 records; a price file holds at most 32767");
    EXPECT_EQ(OnFile(root, "AAA.WDT").size(), 1u);
}

TEST(DayFilesImport, AFolderOfDaysForAFirstLoad) {
    TempRoot data, days;
    days.Write("02JAN24.D", "AAA,20240102,1,1.2,0.9,1.1,100,0\r\n"
                            "\"ABCWXY\",20240102,0.1,0.1,0.1,0.1,5,0\r\n"
                            "XOP,20240102,0.5,0.5,0.5,0.5,7,30,C\r\n");
    days.Write("03JAN24.D", "AAA,20240103,1.1,1.3,1.0,1.2,200,150\r\n"
                            ",20240103,1,1,1,1,1,0\r\n"
                            "PRN,20240103,2,2,2,2,2,0\r\n");
    days.Write("notes.txt", "not a day file");
    const auto r = ImportDayFiles(days.path(), data.folder(), false);
    ASSERT_TRUE(r.Ok) << r.Message;
    EXPECT_EQ(r.Read, 5);
    EXPECT_EQ(r.NewNames, 4);
    const auto aaa = OnFile(data, "AAA.WDT");
    ASSERT_EQ(aaa.size(), 2u);
    EXPECT_EQ(aaa[0].Volume, 150) << "the next day's spare field corrects the volume";
    EXPECT_EQ(aaa[1].Close, 1.2f);
    EXPECT_TRUE(platform::FileExists(data.path() / "PRNX.WDT"));
    const auto names = Names(data);
    ASSERT_EQ(names.size(), 4u); // in code order
    EXPECT_EQ(names[0].TrimmedCode(), "AAA");
    EXPECT_EQ(names[0].Category, 1);
    EXPECT_EQ(names[1].TrimmedCode(), "ABCWXY");
    EXPECT_EQ(names[1].Category, 84);
    EXPECT_EQ(names[2].TrimmedCode(), "PRNX");
    EXPECT_EQ(names[3].TrimmedCode(), "XOP");
    EXPECT_EQ(platform::Trim(names[3].OtherDetails), "0C1/2/24"); // 2 Jan + 30 days

    // Loaded again: every day is already on file; nothing new in the name file.
    const auto again = ImportDayFiles(days.path(), data.folder(), false);
    ASSERT_TRUE(again.Ok) << again.Message;
    EXPECT_EQ(again.Count.Kept, 5);
    EXPECT_EQ(again.NewNames, 0);
}

TEST(DayFilesImport, ABadLineAnywhereStopsTheLoadBeforeAnyWrite) {
    TempRoot data, days;
    days.Write("02JAN24.D", "AAA,20240102,1,1.2,0.9,1.1,100,0\r\n");
    days.Write("03JAN24.D", "AAA,20240103,1.1,1.3,1.0,1.2,200\r\n");
    auto r = ImportDayFiles(days.path(), data.folder(), false);
    EXPECT_FALSE(r.Ok);
    EXPECT_EQ(r.Message.rfind("03JAN24.D, line 1: an incorrect number of fields", 0), 0u)
        << r.Message;
    days.Write("03JAN24.D", "AAA,20240102,1.1,1.3,1.0,1.2,200,0\r\n");
    r = ImportDayFiles(days.path(), data.folder(), false);
    EXPECT_EQ(r.Message,
              "AAA has two lines for 02/01/2024 (02JAN24.D, line 1 and 03JAN24.D, line 1); "
              "nothing was written");
    EXPECT_TRUE(test::FilesIn(data.path()).empty());
}

} // namespace
} // namespace kori::intake
