// The maintenance list: bulletins filtered into it once, its trim, each kind of item carried out
// on small files with results worked out by hand, and a run stopped by a full disk at every
// point leaving each file before or after its item.
#include "adjust/adjustment_list.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <map>
#include <set>

namespace kori::adjust {
namespace {

using store::PriceRecord;
using test::Day;
using test::Name;

std::vector<PriceRecord> FourDays() {
    return {Day("20260105", 2.0f, 2.1f, 1.9f, 2.0f, 1000),
            Day("20260106", 2.5f, 2.6f, 2.4f, 2.5f, 1000),
            Day("20260107", 2.5f, 2.6f, 2.4f, 2.5f, 1000),
            Day("20260108", 3.0f, 3.1f, 2.9f, 3.0f, 1000)};
}

void WriteHistory(const test::TempRoot& root, const char* code,
                  const std::vector<PriceRecord>& recs) {
    store::PriceFile f(store::PriceFile::PathFor(root.folder(), code));
    ASSERT_TRUE(f.WriteAll(recs));
}

std::vector<PriceRecord> History(const test::TempRoot& root, const char* code) {
    std::vector<PriceRecord> recs;
    store::PriceFile f(store::PriceFile::PathFor(root.folder(), code));
    EXPECT_TRUE(f.ReadAll(recs));
    return recs;
}

void WriteNames(const test::TempRoot& root, const std::vector<const char*>& codes) {
    std::vector<store::NameRecord> names;
    for (const char* c : codes)
        names.push_back(Name(c, "Name of security"));
    store::NameFile nf(store::NameFile::PathIn(root.folder()));
    ASSERT_TRUE(nf.WriteAll(names));
}

std::vector<std::string> Codes(const test::TempRoot& root) {
    std::vector<store::NameRecord> recs;
    store::NameFile nf(store::NameFile::PathIn(root.folder()));
    EXPECT_TRUE(nf.ReadAll(recs));
    std::vector<std::string> codes;
    for (const auto& r : recs)
        codes.push_back(r.TrimmedCode());
    return codes;
}

MakeSettings Settings(const test::TempRoot& root) {
    MakeSettings s;
    s.DataFolder = root.folder();
    s.Today = "20260110";
    return s;
}

std::vector<ListItem> Items(const std::vector<std::string>& lines) {
    std::vector<ListItem> items;
    for (const auto& l : lines)
        items.push_back(ParseListLine(l));
    return items;
}

// ---- The list file ----------------------------------------------------------------------

TEST(AdjustmentList, FieldsRanksAndSort) {
    auto item = ParseListLine("BI,KRM,05JAN26,0,N,05JAN26,1,4");
    EXPECT_EQ(item.Action(), "BI");
    EXPECT_EQ(item.Field(8), "4");
    EXPECT_EQ(item.Field(9), "");
    item.SetField(5, "Y");
    EXPECT_EQ(item.Line(), "BI,KRM,05JAN26,0,Y,05JAN26,1,4");
    // The fifteenth field keeps whatever commas follow.
    const auto wide = ParseListLine("A,2,3,4,5,6,7,8,9,10,11,12,13,14,15,16,17");
    EXPECT_EQ(wide.Fields.size(), kMaxFields);
    EXPECT_EQ(wide.Field(15), "15,16,17");

    EXPECT_EQ(ActionRank("NI"), 1);
    EXPECT_EQ(ActionRank("DI"), 7);
    EXPECT_EQ(ActionRank("NL"), 8);
    EXPECT_EQ(ActionRank("EN"), 8);
    auto items =
        Items({"DI,A", "EN,B", "NI,C", "BI,D", "NL,E", "NC,F", "BI,G", "SP,H", "DC,I", "PC,J"});
    SortByRank(items);
    std::string order;
    for (const auto& i : items)
        order += i.Code();
    EXPECT_EQ(order, "CFIHDGJABE"); // equal ranks keep their order
}

// ---- Filling the list -------------------------------------------------------------------

struct BulletinDay {
    test::TempRoot data, in, out;
    ListSettings settings;
    BulletinDay() {
        settings.In = in.folder();
        settings.Out = out.folder();
        settings.Divs = DividendRule::MarkN;
    }
    ListUpdate Run(const char* stem = "07JAN26") {
        platform::NullProgress progress;
        ListUpdate u;
        EXPECT_TRUE(UpdateAdjustmentsList(data.folder(), stem, settings, progress, u));
        return u;
    }
};

TEST(UpdateAdjustmentsList, EachBulletinIsFilteredOnceInTableOrder) {
    BulletinDay day;
    day.in.Write("07JAN26.Lif.Btn", "EN,LIF1,LIF.FUT,0,N\r\n");
    day.in.Write("07JAN26.Btn", "DC,ABC,SUM,0,N,07JAN26\r\n");
    day.in.Write("07JAN26.Asx.Btn", "BI,KRM,ASX.STK,0,N,07JAN26,1,4\r\n"
                                    "DI,KRM,ASX.STK,0,N,07JAN26,,,12.5\r\n");
    day.in.Write("07JAN26.Sfe.Btn", ""); // empty: neither filtered nor copied
    const auto u = day.Run();
    EXPECT_EQ(u.BulletinsFiltered, 3);
    EXPECT_EQ(u.LinesAdded, 4);
    EXPECT_TRUE(u.NewItems);
    EXPECT_EQ(day.data.Read("Adjust.Lst"), "BI,KRM,07JAN26,0,N,07JAN26,1,4\r\n"
                                           "DI,KRM,07JAN26,0,N,07JAN26,,,12.5\r\n"
                                           "DC,ABC,07JAN26,0,Y,07JAN26\r\n"
                                           "EN,LIF1,LIF,0,N\r\n");
    EXPECT_EQ(test::FilesIn(day.out.path()),
              (std::vector<std::string>{"07JAN26.Asx.Btx", "07JAN26.Btx", "07JAN26.Lif.Btx"}));
    // The copies mark the day as done: a second update adds nothing.
    const auto list = day.data.Read("Adjust.Lst");
    const auto again = day.Run();
    EXPECT_EQ(again.LinesAdded, 0);
    EXPECT_FALSE(again.NewItems);
    EXPECT_EQ(day.data.Read("Adjust.Lst"), list);
}

TEST(UpdateAdjustmentsList, NothingWithoutBothFoldersAndDividendsByOption) {
    BulletinDay day;
    day.in.Write("07JAN26.Asx.Btn", "DI,KRM,ASX.STK,0,N,07JAN26,,,12.5\r\n");
    day.settings.Out = "unknown";
    EXPECT_EQ(day.Run().BulletinsFiltered, 0);
    day.settings.Out = " ";
    EXPECT_EQ(day.Run().BulletinsFiltered, 0);
    day.settings.Out = day.out.folder();
    day.settings.Divs = DividendRule::Leave;
    const auto u = day.Run();
    EXPECT_EQ(u.BulletinsFiltered, 1);
    EXPECT_EQ(u.LinesAdded, 0);
    EXPECT_FALSE(platform::FileExists(day.data.path() / "Adjust.Lst"));
}

TEST(UpdateAdjustmentsList, ALongListKeepsItsNewestTenThousandLines) {
    BulletinDay day;
    std::string list;
    for (int i = 1; i <= 15999; ++i)
        list += "EN,C" + std::to_string(i) + ",X,0,N\r\n";
    day.data.Write("Adjust.Lst", list);
    day.in.Write("07JAN26.Btn", "EN,LAST,X,0,N\r\n");
    const auto u = day.Run();
    EXPECT_TRUE(u.Trimmed);
    std::vector<ListItem> items;
    ASSERT_TRUE(ReadAdjustmentList(day.data.folder(), items));
    ASSERT_EQ(items.size(), 10000u);
    EXPECT_EQ(items.front().Code(), "C6001"); // 16,000 lines less the first 6,000
    EXPECT_EQ(items.back().Code(), "LAST");
    EXPECT_FALSE(platform::FileExists(day.data.path() / "Adjust.Tmp"));
    // One line short of the mark stays whole.
    BulletinDay shorter;
    shorter.data.Write("Adjust.Lst", list.substr(list.find('\n') + 1));
    shorter.in.Write("07JAN26.Btn", "EN,LAST,X,0,N\r\n");
    EXPECT_FALSE(shorter.Run().Trimmed);
}

TEST(UpdateAdjustmentsList, OptionsLibraryNeedsElevenNamesOutsideTheDefaultFolder) {
    test::TempRoot opt;
    std::vector<const char*> codes(10, "OPT");
    WriteNames(opt, codes);
    EXPECT_FALSE(HasOptionsLibrary(opt.folder()));
    codes.push_back("OPT");
    WriteNames(opt, codes);
    EXPECT_TRUE(HasOptionsLibrary(opt.folder()));
    EXPECT_FALSE(HasOptionsLibrary("C:\\koriwin\\data\\"));
    EXPECT_FALSE(HasOptionsLibrary(""));
}

// ---- Carrying items out -----------------------------------------------------------------

TEST(MakeAdjustments, BonusSplitAndDividendScaleUpToTheDayBefore) {
    test::TempRoot root;
    WriteNames(root, {"KRM", "ALX", "DIV"});
    WriteHistory(root, "KRM", FourDays());
    WriteHistory(root, "ALX", FourDays());
    WriteHistory(root, "DIV", FourDays());
    auto items = Items({"BI,KRM,07JAN26,0,Y,07JAN26,1,4", "SP,ALX,08JAN26,0,Y,08JAN26,-1,2",
                        "DI,DIV,07JAN26,0,Y,20260107,,,12.5"});
    platform::NullProgress progress;
    MakeReport report;
    ASSERT_TRUE(MakeAdjustments(Settings(root), items, progress, report));
    EXPECT_EQ(report.Messages,
              (std::vector<std::string>{"Adjustment :KRM  bi", "Adjustment :ALX  ss",
                                        "Adjustment :DIV  dv0.125"}));
    EXPECT_TRUE(items.empty());
    EXPECT_EQ(root.Read("Adjust.Lst"), "");

    // Bonus 1 for 4 dated the 7th: records 1 and 2 times 0.8, volumes as they were.
    auto krm = History(root, "KRM");
    EXPECT_FLOAT_EQ(krm[0].Close, 1.6f);
    EXPECT_FLOAT_EQ(krm[0].High, 1.68f);
    EXPECT_FLOAT_EQ(krm[1].Close, 2.0f);
    EXPECT_EQ(krm[1].Volume, 1000);
    EXPECT_FLOAT_EQ(krm[1].AdjFactor, 0.8f);
    EXPECT_EQ(platform::Trim(krm[1].AdjDesc), "bi");
    EXPECT_FLOAT_EQ(krm[2].Close, 2.5f);
    EXPECT_EQ(krm[2].AdjFactor, 0.0f);
    // Consolidation -1 : 2 dated the 8th: 2 / 1, records 1 to 3.
    auto alx = History(root, "ALX");
    EXPECT_FLOAT_EQ(alx[2].Close, 5.0f);
    EXPECT_FLOAT_EQ(alx[0].Low, 3.8f);
    EXPECT_FLOAT_EQ(alx[3].Close, 3.0f);
    EXPECT_EQ(platform::Trim(alx[2].AdjDesc), "ss");
    // 12.5 cents on a close of 2.50: 1 - 0.05.
    auto div = History(root, "DIV");
    EXPECT_FLOAT_EQ(div[1].AdjFactor, 0.95f);
    EXPECT_FLOAT_EQ(div[1].Close, 2.375f);
    EXPECT_FLOAT_EQ(div[0].Close, 1.9f);
    EXPECT_EQ(platform::Trim(div[1].AdjDesc), "dv0.125");
}

TEST(MakeAdjustments, AnIssueRunTwiceIsAppliedOnceAndOneBeforeTheHistoryIsDropped) {
    test::TempRoot root;
    WriteNames(root, {"KRM"});
    WriteHistory(root, "KRM", FourDays());
    platform::NullProgress progress;
    MakeReport report;
    auto items = Items({"BI,KRM,07JAN26,0,Y,07JAN26,1,4"});
    ASSERT_TRUE(MakeAdjustments(Settings(root), items, progress, report));
    items = Items({"BI,KRM,07JAN26,0,Y,07JAN26,1,4",
                   // Dated on the second record: the record before it is the first.
                   "BI,KRM,06JAN26,0,Y,06JAN26,1,1",
                   // Nothing to divide.
                   "BI,KRM,07JAN26,0,Y,07JAN26,0,4", "BI,KRM,07JAN26,0,Y,07JAN26,2,-2",
                   "DI,KRM,07JAN26,0,Y,07JAN26,,,0", "BI,KRM,NOTADAY,0,Y,NOTADAY,1,4",
                   "BI,NOFILE,07JAN26,0,Y,07JAN26,1,4", "BI,SEVENCH,07JAN26,0,Y,07JAN26,1,4"});
    ASSERT_TRUE(MakeAdjustments(Settings(root), items, progress, report));
    EXPECT_TRUE(report.Messages.empty());
    EXPECT_TRUE(items.empty()); // every item is still marked D and leaves the list
    auto krm = History(root, "KRM");
    EXPECT_FLOAT_EQ(krm[1].Close, 2.0f);
    EXPECT_FLOAT_EQ(krm[0].Close, 1.6f);
}

TEST(MakeAdjustments, CodeChangeOntoACodeWithDataMerges) {
    test::TempRoot root;
    WriteNames(root, {"OLDC", "NEWC", "KEEP"});
    WriteHistory(root, "OLDC", FourDays());
    WriteHistory(root, "NEWC",
                 {Day("20260107", 9, 9, 9, 9, 9), Day("20260108", 8, 8, 8, 8, 8),
                  Day("20260109", 7, 7, 7, 7, 7)});
    const auto namesBefore = root.Read("Names.dat");
    auto items = Items({"NC,OLDC,07JAN26,0,Y,07JAN26,NEWC"});
    platform::NullProgress progress;
    MakeReport report;
    ASSERT_TRUE(MakeAdjustments(Settings(root), items, progress, report));
    EXPECT_EQ(report.Messages, std::vector<std::string>{"Name Change :OLDCto  NEWC"});
    EXPECT_TRUE(report.NameFileCompacted);
    const auto merged = History(root, "NEWC");
    ASSERT_EQ(merged.size(), 5u);
    EXPECT_EQ(merged[0].Date, "20260105");
    EXPECT_EQ(merged[1].Date, "20260106");
    EXPECT_EQ(merged[2].Date, "20260107");
    EXPECT_FLOAT_EQ(merged[2].Close, 9.0f);
    EXPECT_FLOAT_EQ(merged[4].Close, 7.0f);
    EXPECT_EQ(Codes(root), (std::vector<std::string>{"NEWC", "KEEP"}));
    // The back-up is the name file as the compaction found it: the old code's record marked 9.
    const auto bak = root.Read("Names.bak");
    ASSERT_EQ(bak.size(), namesBefore.size());
    EXPECT_EQ(bak[0], '\x09');
    EXPECT_EQ(bak.substr(1), namesBefore.substr(1));
    // tempdata.wdt and the .Old copies are gone at the end.
    EXPECT_EQ(test::FilesIn(root.path()),
              (std::vector<std::string>{"Adjust.Lst", "NEWC.WDT", "Names.bak", "Names.dat"}));
}

TEST(MakeAdjustments, CodeChangeToANewCodeRenamesAndDelistingRemoves) {
    test::TempRoot root;
    WriteNames(root, {"OLDC", "GONE", "KEEP"});
    WriteHistory(root, "OLDC", FourDays());
    WriteHistory(root, "GONE", FourDays());
    auto items = Items({"DC,GONE,07JAN26,0,Y,07JAN26", "NC,OLDC,07JAN26,0,Y,07JAN26,FRESH",
                        "DC,NOFILE,07JAN26,0,Y,07JAN26"});
    platform::NullProgress progress;
    MakeReport report;
    ASSERT_TRUE(MakeAdjustments(Settings(root), items, progress, report));
    EXPECT_EQ(report.Messages,
              (std::vector<std::string>{"Removal :GONE", "Name Change :OLDCto  FRESH"}));
    EXPECT_EQ(Codes(root), (std::vector<std::string>{"FRESH", "KEEP"}));
    EXPECT_EQ(History(root, "FRESH").size(), 4u);
    EXPECT_EQ(test::FilesIn(root.path()),
              (std::vector<std::string>{"Adjust.Lst", "FRESH.WDT", "Names.bak", "Names.dat"}));
}

TEST(MakeAdjustments, ListingsNameRecordsAndStaleListingsGo) {
    test::TempRoot root;
    WriteNames(root, {"KRM"});
    WriteHistory(root, "NEWL", FourDays());
    auto items =
        Items({"NL,KRM,07JAN26,0,Y,KAROO MINERALS LTD,ABC", "NI,NEWL,07JAN26,0,Y,NEW LISTING,XY",
               "NI,NOFILE,07JAN26,0,Y,NO FILE",
               // Not to run: older than 15 days goes, younger or odd stays.
               "NL,OLD1,20DEC25,0,N,OLD", "NI,NEW1,27DEC25,0,N,NEW", "NI,ODD1,32DEC25,0,N,ODD",
               "BI,OLD2,20DEC25,0,N,20DEC25,1,1", "ZZ,UNKNOWN,07JAN26,0,Y"});
    platform::NullProgress progress;
    MakeReport report;
    auto s = Settings(root); // today 10 Jan 2026: 15 days before is 26 Dec 2025
    ASSERT_TRUE(MakeAdjustments(s, items, progress, report));
    EXPECT_EQ(report.Messages,
              (std::vector<std::string>{"Adding KRM KAROO MINERALS LTD to Name File",
                                        "Adding NEWL NEW LISTING to Name File"}));
    std::vector<store::NameRecord> names;
    store::NameFile nf(store::NameFile::PathIn(root.folder()));
    ASSERT_TRUE(nf.ReadAll(names));
    ASSERT_EQ(names.size(), 2u);
    EXPECT_EQ(platform::Trim(names[0].Name), "KAROO MINERALS LTD");
    EXPECT_EQ(names[0].IndustryClass, "ABC");
    EXPECT_EQ(names[1].TrimmedCode(), "NEWL");
    EXPECT_EQ(names[1].RecordType, 4);
    EXPECT_FLOAT_EQ(names[1].ScaleStep, 0.05f);
    std::string left;
    for (const auto& i : items)
        left += i.Code() + " ";
    EXPECT_EQ(left, "NEW1 ODD1 OLD2 ");
    EXPECT_FALSE(report.NameFileCompacted); // no code change or delisting ran
}

TEST(MakeAdjustments, PriceCorrectionInCentsWithTheMarketsVolumeScale) {
    test::TempRoot root;
    WriteNames(root, {"KRM"});
    WriteHistory(root, "KRM", FourDays());
    auto s = Settings(root);
    s.MarketVolumeScale = [](std::string_view tag) { return tag == "IDX" ? PowerOfTen(1) : 1.0; };
    auto items = Items({"PC,KRM,07JAN26,0,Y,07JAN26,O:250.5 C:262 V:1500",
                        "PC,KRM,IDX,0,Y,20260108,V:20", "PC,KRM,07JAN26,0,Y,06JAN26,no tags"});
    platform::NullProgress progress;
    MakeReport report;
    ASSERT_TRUE(MakeAdjustments(s, items, progress, report));
    auto krm = History(root, "KRM");
    EXPECT_FLOAT_EQ(krm[2].Open, 2.505f);
    EXPECT_FLOAT_EQ(krm[2].High, 2.6f); // untagged values stay
    EXPECT_FLOAT_EQ(krm[2].Close, 2.62f);
    EXPECT_EQ(krm[2].Volume, 1500);
    EXPECT_EQ(krm[3].Volume, 200);
    EXPECT_FLOAT_EQ(krm[1].Close, 2.5f);
    EXPECT_DOUBLE_EQ(PowerOfTen(-1), 0.1);
    EXPECT_DOUBLE_EQ(PowerOfTen(0), 1);
}

TEST(MakeAdjustments, ServiceThreeTakesTheFolderByTag) {
    MakeSettings s;
    s.DataService = 3;
    s.Folders = {"/stk/", "/idx/", "", "/ovs/", "/opt/", "", "", ""};
    EXPECT_EQ(FolderForItem(s, ParseListLine("BI,A,07JAN26")), "/stk/");
    EXPECT_EQ(FolderForItem(s, ParseListLine("BI,A,WNT")), "/stk/");
    EXPECT_EQ(FolderForItem(s, ParseListLine("BI,A,IDX")), "/idx/");
    EXPECT_EQ(FolderForItem(s, ParseListLine("BI,A,OPT")), "/opt/");
    EXPECT_EQ(FolderForItem(s, ParseListLine("BI,A,SFE")), ""); // not defined: skipped
    s.DataService = 1;
    s.DataFolder = "/data/";
    EXPECT_EQ(FolderForItem(s, ParseListLine("BI,A,IDX")), "/data/");
    EXPECT_EQ(ListDate("07jan26"), "20260107");
    EXPECT_EQ(ListDate("20260231"), "");
    EXPECT_EQ(ListDate("7JAN26"), "");
}

// ---- A run stopped by a full disk -----------------------------------------------------------

struct Library {
    test::TempRoot root;
    Library() {
        WriteNames(root, {"KRM", "OLDC", "NEWC", "GONE"});
        WriteHistory(root, "KRM", FourDays());
        WriteHistory(root, "OLDC", FourDays());
        WriteHistory(root, "NEWC",
                     {Day("20260107", 9, 9, 9, 9, 9), Day("20260108", 8, 8, 8, 8, 8)});
        WriteHistory(root, "GONE", FourDays());
        root.Write("Adjust.Lst",
                   "NC,OLDC,07JAN26,0,Y,07JAN26,NEWC\r\nDC,GONE,07JAN26,0,Y,07JAN26\r\n"
                   "BI,KRM,07JAN26,0,Y,07JAN26,1,4\r\nDI,KRM,08JAN26,0,Y,08JAN26,,,10\r\n"
                   "PC,NEWC,07JAN26,0,Y,08JAN26,C:850\r\n");
    }
    platform::Status Run(std::size_t firstItems = 99) {
        std::vector<ListItem> items;
        if (auto st = ReadAdjustmentList(root.folder(), items); !st) return st;
        if (items.size() > firstItems) items.resize(firstItems);
        platform::NullProgress progress;
        MakeReport report;
        return MakeAdjustments(Settings(root), items, progress, report);
    }
    std::map<std::string, std::string> Prices() const {
        std::map<std::string, std::string> m;
        for (const char* code : {"KRM", "NEWC"})
            m[code] = root.Read(std::string(code) + ".WDT");
        return m;
    }
};

TEST(MakeAdjustments, AFullDiskLeavesEveryHistoryBeforeOrAfterAndARerunFinishes) {
    // NEWC and KRM each have two items: a file may stand after either of them.
    std::map<std::string, std::set<std::string>> allowed;
    for (std::size_t k = 0; k <= 5; ++k) {
        Library lib;
        ASSERT_TRUE(lib.Run(k));
        for (const auto& [code, bytes] : lib.Prices())
            allowed[code].insert(bytes);
    }
    Library after;
    long long total = 0;
    {
        platform::ScopedWriteBudget unlimited(1LL << 40);
        ASSERT_TRUE(after.Run());
        total = platform::ScopedWriteBudget::Used();
    }
    const auto done = after.Prices();
    ASSERT_GT(total, 0);
    const auto finalNames = after.root.Read("Names.dat");
    for (long long n = 0; n < total; n += 37) {
        Library lib;
        {
            platform::ScopedWriteBudget budget(n);
            EXPECT_FALSE(lib.Run()) << n;
        }
        for (const auto& [code, bytes] : lib.Prices())
            EXPECT_TRUE(allowed[code].count(bytes)) << code << " at " << n;
        // The same list run again on a whole disk ends where an undisturbed run ends.
        ASSERT_TRUE(lib.Run()) << n;
        EXPECT_EQ(lib.Prices(), done) << n;
        EXPECT_EQ(lib.root.Read("Names.dat"), finalNames) << n;
    }
}

} // namespace
} // namespace kori::adjust
