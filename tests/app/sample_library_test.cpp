#include "app/sample_library.h"
#include "platform/files.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

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
        EXPECT_EQ(recs.back().Date, "20261120");
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
