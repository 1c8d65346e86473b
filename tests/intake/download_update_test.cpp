// The update from a day file, worked by hand on libraries of a few records.
#include "intake_test_library.h"
#include "platform/date_text.h"

#include "intake/download_list.h"
#include "platform/text.h"

#include <fstream>

namespace kori::test {
namespace {

using intake::FileState;
using platform::Answer;

// Three securities on file to 20240103, one class-95 entry, no options.
struct DayLibrary : IntakeLibrary {
    DayLibrary() {
        Names({NameOf("AAA"), NameOf("BBB"), NameOf("CCC"), NameOf("DDD", 4, 95)});
        Prices("AAA",
               {Rec("20240102", 1, 1.1f, 0.9f, 1, 100), Rec("20240103", 1, 1.2f, 1, 1.1f, 200)});
        Prices("BBB",
               {Rec("20240102", 2, 2, 2, 2, 300), Rec("20240103", 2, 2.1f, 1.9f, 2.05f, 400)});
        Prices("CCC", {Rec("20240102", 5, 5, 5, 5, 10), Rec("20240103", 5, 5.5f, 4.5f, 5.25f, 20)});
        Prices("DDD", {Rec("20240103", 7, 7, 7, 7, 1)});
    }
};

void ExpectRecord(const store::PriceRecord& r, const char* date, float o, float h, float l, float c,
                  int v) {
    EXPECT_EQ(r.Date, date);
    EXPECT_FLOAT_EQ(r.Open, o);
    EXPECT_FLOAT_EQ(r.High, h);
    EXPECT_FLOAT_EQ(r.Low, l);
    EXPECT_FLOAT_EQ(r.Close, c);
    EXPECT_EQ(r.Volume, v);
}

TEST(DownloadUpdate, NormalDayAppendsCreatesCorrectsAndFills) {
    DayLibrary lib;
    lib.DayFile("04JAN24.D", "AAA,20240104,1.1,1.3,1.0,1.2,1000,0\n"
                             "BBB,20240104,2.05,2.5,2,2.2,5000,4500\n"
                             "NEW,20240104,0.5,0.6,0.4,0.55,300,0\n"
                             "AUX,20240104,1,1,1,1,10,0\n");
    const auto r = lib.Run("04JAN24.D");
    ASSERT_EQ(r.Files.size(), 1u);
    EXPECT_EQ(r.Files[0].State, FileState::Normal);
    EXPECT_EQ(r.Files[0].Records, 4);
    EXPECT_EQ(r.Files[0].NewSecurities, 2);
    EXPECT_EQ(r.Files[0].Fillers, 1); // CCC; DDD is of class 95
    EXPECT_EQ(r.Files[0].RenamedTo, "04JAN24.DX");
    EXPECT_TRUE(r.RemoveItem);
    EXPECT_TRUE(lib.dialogs.messages().empty());

    auto aaa = lib.Read("AAA");
    ASSERT_EQ(aaa.size(), 3u);
    ExpectRecord(aaa[2], "20240104", 1.1f, 1.3f, 1.0f, 1.2f, 1000);
    EXPECT_EQ(aaa[2].Flag, " ");
    auto bbb = lib.Read("BBB");
    ASSERT_EQ(bbb.size(), 3u);
    EXPECT_EQ(bbb[1].Volume, 4500); // yesterday's volume corrected from the spare field
    ExpectRecord(bbb[2], "20240104", 2.05f, 2.5f, 2, 2.2f, 5000);
    auto ccc = lib.Read("CCC");
    ASSERT_EQ(ccc.size(), 3u);
    ExpectRecord(ccc[2], "20240104", 5.25f, 5.25f, 5.25f, 5.25f, 0);
    EXPECT_EQ(lib.Read("DDD").size(), 1u);
    ASSERT_EQ(lib.Read("1AUX").size(), 1u);

    const auto names = lib.ReadNames();
    ASSERT_EQ(names.size(), 6u);
    EXPECT_EQ(names[4].TrimmedCode(), "NEW");
    EXPECT_EQ(names[4].RecordType, 4);
    EXPECT_EQ(names[4].Category, 1);
    EXPECT_EQ(platform::Trim(names[4].Name), "");
    EXPECT_FLOAT_EQ(names[4].ScaleStep, 0.05f);
    EXPECT_EQ(names[5].TrimmedCode(), "1AUX");
    EXPECT_FALSE(lib.Waiting("04JAN24.D"));
    EXPECT_TRUE(lib.Waiting("04JAN24.DX"));
}

TEST(DownloadUpdate, WindowsLineEndsAndBlankLinesReadAsPlainLines) {
    DayLibrary lib;
    lib.DayFile("04JAN24.D", "AAA,20240104,1.1,1.3,1.0,1.2,1000,0\r\n\r\n"
                             "BBB,20240104,2,2.5,2,2.2,5000,0\r\n");
    const auto r = lib.Run("04JAN24.D");
    EXPECT_EQ(r.Files.at(0).Records, 2);
    ExpectRecord(lib.Read("BBB")[2], "20240104", 2, 2.5f, 2, 2.2f, 5000);
    EXPECT_EQ(lib.Read("AAA")[2].Volume, 1000);
}

TEST(DownloadUpdate, ReRunAsksOnceThenReplacesInPlace) {
    DayLibrary lib;
    lib.DayFile("03JAN24.D", "AAA,20240103,9,9,9,9,9,0\nBBB,20240103,8,8,8,8,8,0\n");
    lib.dialogs.QueueAnswer(Answer::Ok);
    const auto r = lib.Run("03JAN24.D");
    ASSERT_EQ(lib.dialogs.shown().size(), 1u);
    EXPECT_EQ(
        lib.dialogs.shown()[0].text,
        " There is already data on file with this date\n  New data will replace the old data");
    EXPECT_EQ(lib.dialogs.shown()[0].title, lib.settings.DataFolder);
    EXPECT_EQ(r.Files.at(0).State, FileState::Replace);
    EXPECT_EQ(r.Files[0].Fillers, 0); // no fill outside a normal day
    const auto aaa = lib.Read("AAA");
    ASSERT_EQ(aaa.size(), 2u);
    ExpectRecord(aaa[1], "20240103", 9, 9, 9, 9, 9);
    ExpectRecord(aaa[0], "20240102", 1, 1.1f, 0.9f, 1, 100);
    EXPECT_EQ(lib.Read("CCC").size(), 2u);
}

TEST(DownloadUpdate, CancelledQuestionLeavesEverythingWaiting) {
    DayLibrary lib;
    lib.DayFile("03JAN24.D", "AAA,20240103,9,9,9,9,9,0\n");
    const std::string before = lib.root.Read("data/AAA.WDT");
    lib.dialogs.QueueAnswer(Answer::Cancel);
    const auto r = lib.Run("03JAN24.D");
    EXPECT_EQ(r.Files.at(0).State, FileState::Cancelled);
    EXPECT_FALSE(r.RemoveItem);
    EXPECT_EQ(lib.root.Read("data/AAA.WDT"), before);
    EXPECT_TRUE(lib.Waiting("03JAN24.D"));
}

TEST(DownloadUpdate, InsertGoesIntoDateOrder) {
    IntakeLibrary lib;
    lib.Names({NameOf("AAA"), NameOf("BBB")});
    lib.Prices("AAA", {Rec("20240102", 1, 1, 1, 1, 1), Rec("20240103", 2, 2, 2, 2, 2),
                       Rec("20240105", 3, 3, 3, 3, 3)});
    lib.Prices("BBB", {Rec("20240102", 1, 1, 1, 1, 1), Rec("20240104", 6, 6, 6, 6, 6),
                       Rec("20240105", 3, 3, 3, 3, 3)});
    lib.DayFile("04JAN24.D", "AAA,20240104,4,4,4,4,4,33\nBBB,20240104,5,5,5,5,5,0\n");
    lib.dialogs.QueueAnswer(Answer::Ok);
    const auto r = lib.Run("04JAN24.D");
    EXPECT_EQ(r.Files.at(0).State, FileState::Insert);
    EXPECT_EQ(lib.dialogs.shown().at(0).text,
              " There is already data on file LATER than this date\n This procedure will insert "
              "the data in the correct position \n The update will take a little longer than "
              "usual");
    const auto aaa = lib.Read("AAA");
    ASSERT_EQ(aaa.size(), 4u);
    EXPECT_EQ(aaa[1].Date, "20240103");
    EXPECT_EQ(aaa[1].Volume, 33); // the record before the insert takes the correction
    ExpectRecord(aaa[2], "20240104", 4, 4, 4, 4, 4);
    EXPECT_EQ(aaa[3].Date, "20240105");
    // In an insert run an equal date is passed over: the record goes in beside it.
    const auto bbb = lib.Read("BBB");
    ASSERT_EQ(bbb.size(), 4u);
    EXPECT_EQ(bbb[0].Date, "20240104"); // ahead of record 1, as the rule has it
    EXPECT_FLOAT_EQ(bbb[0].Close, 5);
}

// Far back in a long file: the search reads back over many records, and the records on both
// sides of the new one, the volume correction and the file's head all come out right.
TEST(DownloadUpdate, InsertFarBackInALongFileKeepsEveryOtherRecord) {
    IntakeLibrary lib;
    lib.Names({NameOf("LNG")});
    std::vector<store::PriceRecord> old;
    const auto first = *platform::DaySerial("20200101");
    std::vector<std::string> dates;
    for (int i = 0; i < 300; ++i) { // every second day
        dates.push_back(*platform::DateTextFromSerial(first + 2 * i));
        old.push_back(Rec(dates.back().c_str(), 1, 2, 0.5f, static_cast<float>(i), i));
    }
    lib.Prices("LNG", old);
    const std::string day = *platform::DateTextFromSerial(first + 2 * 19 + 1); // after the 20th
    lib.DayFile("02FEB20.D", "LNG," + day + ",7,8,6,7.5,77,1234\n");
    lib.dialogs.QueueAnswer(Answer::Ok);
    const auto r = lib.Run("02FEB20.D", day);
    ASSERT_EQ(r.Files.at(0).State, FileState::Insert);
    const auto now = lib.Read("LNG");
    ASSERT_EQ(now.size(), 301u);
    for (int i = 0; i < 19; ++i) {
        EXPECT_EQ(now[i].Date, dates[i]) << i;
        EXPECT_EQ(now[i].Volume, i) << i;
    }
    EXPECT_EQ(now[19].Date, dates[19]);
    EXPECT_EQ(now[19].Volume, 1234) << "the day before takes the corrected volume";
    ExpectRecord(now[20], day.c_str(), 7, 8, 6, 7.5f, 77);
    for (int i = 20; i < 300; ++i) {
        EXPECT_EQ(now[i + 1].Date, dates[i]) << i;
        EXPECT_FLOAT_EQ(now[i + 1].Close, static_cast<float>(i)) << i;
    }
}

TEST(FindInsertPosition, FollowsTheTable) {
    const std::vector<double> d = {10, 20, 30};
    using P = intake::InsertPosition;
    auto at = [&](double v, FileState s) {
        const P p = intake::FindInsertPosition(d, v, s);
        return std::pair(p.Position, p.Overwrite);
    };
    EXPECT_EQ(at(25, FileState::Insert), std::pair(3, false));
    EXPECT_EQ(at(40, FileState::Insert), std::pair(4, false));
    EXPECT_EQ(at(20, FileState::Replace), std::pair(2, true));
    EXPECT_EQ(at(30, FileState::Replace), std::pair(3, true));
    EXPECT_EQ(at(5, FileState::Insert), std::pair(1, false));
    // Later than record 1 but earlier than record 2: ahead of record 1, out of order.
    EXPECT_EQ(at(15, FileState::Insert), std::pair(1, false));
    EXPECT_EQ(at(20, FileState::Insert), std::pair(1, false));
    EXPECT_EQ(intake::FindInsertPosition({10}, 20, FileState::Insert).Position, 1);
}

TEST(DownloadUpdate, AdvanceDeclineCarriesItsRunningTotalThroughAnInsert) {
    IntakeLibrary lib;
    lib.settings.DataService = 1; // the service that reads each security's record type
    lib.Names({NameOf("ADV", 3)});
    lib.Prices("ADV", {Rec("20240102", 0, 10, 5, 100, 0), Rec("20240103", 0, 8, 4, 104, 0),
                       Rec("20240105", 0, 6, 7, 103, 0)});
    lib.DayFile("04JAN24.D", "ADV,20240104,0,12,3,0,0,0\n");
    std::vector<std::string> calls;
    lib.hooks.UpdateAdjustmentsList = [&](const std::string& folder, const std::string& stem) {
        calls.push_back(folder + "|" + stem);
    };
    lib.hooks.RefreshSecurityDetails = [&] { calls.push_back("details"); };
    lib.hooks.RefreshSecurityProperties = [&] { calls.push_back("properties"); };
    lib.dialogs.QueueAnswer(Answer::Ok);
    const auto r = lib.Run("04JAN24.D");
    EXPECT_EQ(r.Files.at(0).State, FileState::Insert);
    const auto adv = lib.Read("ADV");
    ASSERT_EQ(adv.size(), 4u);
    ExpectRecord(adv[2], "20240104", 0, 12, 3, 113, 0); // 104 + 12 - 3
    EXPECT_FLOAT_EQ(adv[3].Close, 112);                 // 113 + 6 - 7
    EXPECT_FLOAT_EQ(adv[1].Close, 104);
    EXPECT_EQ(calls, (std::vector<std::string>{lib.settings.DataFolder + "|04JAN24", "details",
                                               "properties"}));
    EXPECT_EQ(r.Files[0].RenamedTo, "04JAN24.DX");
}

TEST(DownloadUpdate, AdvanceDeclineAppendAndNoFillUnderTheFirstService) {
    IntakeLibrary lib;
    lib.settings.DataService = 1;
    lib.Names({NameOf("ADV", 3), NameOf("ZZZ")});
    lib.Prices("ADV", {Rec("20240103", 0, 8, 4, 104, 0)});
    lib.Prices("ZZZ", {Rec("20240103", 1, 1, 1, 1, 1)});
    lib.DayFile("04JAN24.D", "ADV,20240104,7,12,3,0,55,0\n");
    const auto r = lib.Run("04JAN24.D");
    ExpectRecord(lib.Read("ADV")[1], "20240104", 0, 12, 3, 113, 55);
    EXPECT_EQ(r.Files.at(0).Fillers, 0);
    EXPECT_EQ(lib.Read("ZZZ").size(), 1u);
}

TEST(DownloadUpdate, BadLinesStopTheFileBeforeAnythingIsWritten) {
    struct Case {
        std::string text, expect;
    };
    const std::vector<Case> cases = {
        {"AAA,20240104,1,1,1,1,1,0\nBBB,20240104,1,1,1,1,1\n", "BBB,20240104,1,1,1,1,1\n\n"},
        {"AAA,20240104,1,1,1,1,1,0\nBBB,20240104,1,1,1,1,1,0,9\n", "BBB,20240104,1,1,1,1,1,0,9"},
        {"AAA,20240104,1,1,1,1,1,0\nBBB,2024014,1,1,1,1,1,0\n", "is not 8 digits"},
    };
    for (const auto& c : cases) {
        DayLibrary lib;
        const std::string before = lib.root.Read("data/AAA.WDT");
        lib.DayFile("04JAN24.D", c.text);
        const auto r = lib.Run("04JAN24.D");
        EXPECT_EQ(r.Files.at(0).State, FileState::Cancelled);
        ASSERT_EQ(lib.dialogs.shown().size(), 1u);
        EXPECT_EQ(lib.dialogs.shown()[0].title, "Download Data Update");
        EXPECT_NE(lib.dialogs.shown()[0].text.find(c.expect), std::string::npos)
            << lib.dialogs.shown()[0].text;
        EXPECT_EQ(lib.root.Read("data/AAA.WDT"), before);
        EXPECT_EQ(lib.ReadNames().size(), 4u);
        EXPECT_TRUE(lib.Waiting("04JAN24.D"));
    }
    DayLibrary lib;
    lib.DayFile("04JAN24.D", "AAA,20240104,1,1,1,1,1\n");
    (void)lib.Run("04JAN24.D");
    EXPECT_EQ(lib.dialogs.shown().at(0).text,
              " There is a problem with " + lib.settings.DownloadFolder +
                  "04JAN24.D\n There is an incorrect number of fields in the record\n There "
                  "should be 7 commas seperating 8 fields\n code,date,open,high,low,close,vol,"
                  "spare\nMAKE SURE THE DOWNLOADED DATA IS SET UP FOR KORI FORMAT\n The first "
                  "incorrect record found was \nAAA,20240104,1,1,1,1,1\n\nCorrect and retry");
}

TEST(DownloadUpdate, AFileUnderEightBytesIsEmpty) {
    DayLibrary lib;
    lib.DayFile("04JAN24.D", "A,1,2\n");
    const auto r = lib.Run("04JAN24.D");
    EXPECT_EQ(r.Files.at(0).State, FileState::Cancelled);
    EXPECT_EQ(lib.dialogs.shown().at(0).text,
              "There is no data in " + lib.settings.DownloadFolder + "04JAN24.D\n");
    EXPECT_EQ(lib.dialogs.shown()[0].title, "Data Update");
    EXPECT_TRUE(lib.Waiting("04JAN24.D"));
}

TEST(DownloadUpdate, FieldsReadAsTheClassicConversionReadsThem) {
    DayLibrary lib;
    lib.settings.VolumeDivisor = 1000;
    lib.DayFile("04JAN24.D", "\"AAA\",20240104,abc,1.5x,,1.2,1999,0\n"
                             "BBB,20240104,1,1,1,1,12e3,0\n");
    (void)lib.Run("04JAN24.D");
    ExpectRecord(lib.Read("AAA").at(2), "20240104", 0, 1.5f, 0, 1.2f, 1); // 1999 / 1000
    EXPECT_EQ(lib.Read("BBB").at(2).Volume, 12);
}

TEST(DownloadUpdate, WarrantFilterAndUpdateList) {
    {
        IntakeLibrary lib;
        lib.settings.NoWarrants = true;
        // The fourth letter W, I, E, X, S or D marks a warrant; a 5-character code never is one.
        lib.DayFile("04JAN24.D", "ABCWXY,20240104,1,1,1,1,1,0\nABCKEF,20240104,1,1,1,1,1,0\n"
                                 "ABCWX,20240104,1,1,1,1,1,0\nABCDEF,20240104,1,1,1,1,1,0\n");
        const auto r = lib.Run("04JAN24.D");
        EXPECT_EQ(r.Files.at(0).Records, 2);
        EXPECT_FALSE(platform::FileExists(lib.settings.DataFolder + "ABCWXY.WDT"));
        EXPECT_TRUE(platform::FileExists(lib.settings.DataFolder + "ABCKEF.WDT"));
        EXPECT_FALSE(platform::FileExists(lib.settings.DataFolder + "ABCDEF.WDT"));
        EXPECT_TRUE(platform::FileExists(lib.settings.DataFolder + "ABCWX.WDT"));
    }
    {
        IntakeLibrary lib;
        lib.settings.UpdateAll = false;
        lib.root.Write("system/Update.Lst", " bbb ,5,Bee\r\nCCC,1,Cee\r\n");
        lib.DayFile("04JAN24.D", "AAA,20240104,1,1,1,1,1,0\nBBB,20240104,1,1,1,1,1,0\n");
        (void)lib.Run("04JAN24.D");
        EXPECT_FALSE(platform::FileExists(lib.settings.DataFolder + "AAA.WDT"));
        EXPECT_TRUE(platform::FileExists(lib.settings.DataFolder + "BBB.WDT"));
    }
}

TEST(DownloadUpdate, AFullPriceFileIsRefusedAndTheOthersGoIn) {
    DayLibrary lib;
    std::vector<store::PriceRecord> full(32767, Rec("20240103", 1, 1, 1, 1, 1));
    lib.Prices("BBB", full);
    lib.DayFile("04JAN24.D", "AAA,20240104,1,1,1,3,1,0\nBBB,20240104,1,1,1,1,1,0\n");
    const auto r = lib.Run("04JAN24.D");
    EXPECT_FALSE(r.Failed);
    EXPECT_EQ(lib.Read("AAA").size(), 3u);
    EXPECT_EQ(platform::FileSizeOr0(lib.settings.DataFolder + "BBB.WDT"), 32767u * 50);
    ASSERT_FALSE(lib.dialogs.shown().empty());
    EXPECT_EQ(lib.dialogs.shown()[0].text,
              "BBB.WDT holds 32767 records; a file can hold at most 32767. BBB was not updated.");
    EXPECT_EQ(lib.Read("CCC").size(), 3u); // filled all the same
}

TEST(DownloadUpdate, AnUnwritableDataFolderStopsWithTheFileNamed) {
    IntakeLibrary lib;
    lib.root.Write("blocker", "x");
    lib.settings.DataFolder = lib.root.folder() + "blocker/data/"; // under a plain file
    lib.DayFile("04JAN24.D", "NEW,20240104,1,1,1,1,1,0\n");
    const auto r = lib.Run("04JAN24.D");
    EXPECT_TRUE(r.Failed);
    ASSERT_EQ(lib.dialogs.shown().size(), 1u);
    EXPECT_EQ(lib.dialogs.shown()[0].title, "Downloaded Data");
    EXPECT_NE(lib.dialogs.shown()[0].text.find(lib.settings.DataFolder + "Names.dat"),
              std::string::npos);
    EXPECT_TRUE(lib.Waiting("04JAN24.D"));
}

// A progress that asks to stop at its first yield.
class StopAtYield : public platform::NullProgress {
public:
    void Yield() override { RequestCancel(); }
};

TEST(DownloadUpdate, TheCancelFlagStopsBetweenRecords) {
    IntakeLibrary lib;
    StopAtYield stop;
    lib.settings.RefreshFreq = 10;
    std::string text;
    for (int i = 0; i < 30; ++i)
        text += "C" + std::to_string(100 + i) + ",20240104,1,1,1,1,1,0\n";
    lib.DayFile("04JAN24.D", text);
    intake::UpdateHost host{lib.dialogs, stop, nullptr, nullptr};
    const auto r =
        intake::RunDownloadUpdate(lib.settings, host, lib.hooks, "04JAN24.D", "20240104", false);
    EXPECT_TRUE(r.Stopped);
    EXPECT_EQ(r.Files.at(0).Records, 10); // the yield after the tenth record
    EXPECT_EQ(lib.ReadNames().size(), 10u);
    EXPECT_TRUE(lib.Waiting("04JAN24.D"));
}

TEST(DownloadUpdate, RefreshFrequencyOutOfRangeBecomesFifty) {
    IntakeLibrary lib;
    lib.settings.RefreshFreq = 8;
    platform::IniFile ini(lib.root.path() / "Kori.ini");
    lib.DayFile("04JAN24.D", "AAA,20240104,1,1,1,1,1,0\n");
    intake::UpdateHost host{lib.dialogs, lib.progress, nullptr, &ini};
    (void)intake::RunDownloadUpdate(lib.settings, host, lib.hooks, "04JAN24.D", "20240104", false);
    EXPECT_EQ(lib.settings.RefreshFreq, 50);
    EXPECT_EQ(ini.Read("Download", "RefreshFreq"), "50");
}

} // namespace
} // namespace kori::test
