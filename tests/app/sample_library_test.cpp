#include "app/sample_library.h"
#include "maint/data_check.h"
#include "platform/files.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

#include <map>
#include <set>

using namespace kori;

TEST(SampleLibrary, CoversEveryRecordTypeAndIsTheSameEveryTime) {
    test::TempRoot a, b;
    platform::SettingsStore sa(a.path() / "s.ini"), sb(b.path() / "s.ini");
    app::SampleSummary summary;
    ASSERT_TRUE(app::MakeSampleLibrary(a.folder(), a.folder() + "data/", sa, summary).ok());
    ASSERT_TRUE(app::MakeSampleLibrary(b.folder(), b.folder() + "data/", sb, summary).ok());
    EXPECT_GE(summary.Securities, 40);
    EXPECT_EQ(summary.LastDate, "20261120");

    std::vector<store::NameRecord> names;
    store::NameFile nf(store::NameFile::PathIn(a.folder() + "data/"));
    ASSERT_TRUE(nf.ReadAll(names).ok());
    std::set<int> types;
    int warrants = 0;
    bool adjusted = false, noTrade = false;
    for (const auto& n : names) {
        types.insert(n.RecordType);
        if (n.TrimmedCode().size() == 6 && n.Category == 84) ++warrants;
        store::PriceFile pf(store::PriceFile::PathFor(a.folder() + "data/", n.Code));
        ASSERT_TRUE(pf.Open().ok());
        std::vector<store::PriceRecord> recs;
        ASSERT_TRUE(pf.ReadAll(recs).ok());
        ASSERT_FALSE(recs.empty()) << n.TrimmedCode();
        // The damaged histories are there for the data check to find; the old code stopped.
        if (n.TrimmedCode() == "FLT") continue;
        if (n.TrimmedCode() != "BRX") EXPECT_EQ(recs.back().Date, "20261120");
        for (std::size_t i = 0; i < recs.size(); ++i) {
            if (recs[i].AdjFactor != 0) adjusted = true;
            if (recs[i].Close == 0) noTrade = true;
            if (i > 0) ASSERT_LT(recs[i - 1].Date, recs[i].Date) << "dates ascend";
            if (n.RecordType >= 4 && recs[i].Close != 0)
                ASSERT_TRUE(recs[i].Low <= recs[i].Close && recs[i].Close <= recs[i].High);
        }
    }
    EXPECT_EQ(types, (std::set<int>{1, 2, 3, 4, 5}));
    EXPECT_GE(warrants, 2);
    EXPECT_TRUE(adjusted);
    EXPECT_TRUE(noTrade);
    EXPECT_EQ(platform::ReadWholeFile(a.path() / "data/KRM.WDT"),
              platform::ReadWholeFile(b.path() / "data/KRM.WDT"));
    std::vector<store::ChartListEntry> listA;
    ASSERT_TRUE(store::ReadList(store::ListPath(a.folder() + "data/", 'A'), listA).ok());
    EXPECT_EQ(listA.size(), 5u);
    EXPECT_EQ(store::GetSubLists(sa)[0], "Banks and Finance");
    EXPECT_TRUE(platform::FileHasData(a.path() / "IndClass.dat"));
}

// The sample carries damage of every kind the data check knows, in its own securities, so a
// new user sees the check and the repair tools at work.
TEST(SampleLibrary, TheDataCheckFindsThePlantedDamage) {
    test::TempRoot a;
    platform::SettingsStore settings(a.path() / "s.ini");
    app::SampleSummary summary;
    const std::string data = a.folder() + "data/";
    ASSERT_TRUE(app::MakeSampleLibrary(a.folder(), data, settings, summary).ok());
    platform::NullProgress progress;
    const auto result = maint::CheckLibrary({data, 0}, {}, progress);
    ASSERT_TRUE(result.Status.ok());
    std::map<std::string, std::set<std::string>> found;
    for (const auto& f : result.Findings)
        found[f.Code].insert(f.What);
    namespace fd = maint::finding;
    EXPECT_EQ(found["FLT"],
              (std::set<std::string>{std::string(fd::Duplicated), std::string(fd::Weekend),
                                     std::string(fd::OutOfOrder), std::string(fd::HighBelowLow),
                                     std::string(fd::CloseOutside), std::string(fd::ZeroPrice),
                                     std::string(fd::NegativeVolume)}));
    EXPECT_EQ(found["BRX"], std::set<std::string>{std::string(fd::Stopped)});
    EXPECT_EQ(found["GAP"], std::set<std::string>{std::string(fd::Gap)});
    EXPECT_EQ(found["PARUP"], std::set<std::string>{std::string(fd::MissedAdjustment)});
    EXPECT_FALSE(found.count("KRM")) << "the sound histories stay clean";
    for (const char* old : {"ALX.Old", "KRM.Old", "HBK.Old"})
        EXPECT_TRUE(platform::FileExists(platform::ResolveIn(data, old))) << old;
}
