// kori adjust in-process over the sample library, on a small history of known prices.
#include "cli/kori_run.h"
#include "platform/files.h"
#include "store/price_file.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using json = nlohmann::ordered_json;

class KoriAdjust : public SampleRootSuite {
protected:
    static std::filesystem::path File() {
        return store::PriceFile::PathFor(Root() + "/data/", "KRM");
    }
    // Four days of KRM at 2.50 with 1000 shares a day, 2, 3, 4 and 8 January 2024.
    void SetUp() override {
        ASSERT_FALSE(File().empty());
        ASSERT_TRUE(platform::WriteFileAtomic(
                        File(), Bytes({Day("20240102", 2.5f, 2.5f, 2.5f, 2.5f, 1000),
                                       Day("20240103", 2.5f, 2.5f, 2.5f, 2.5f, 1000),
                                       Day("20240104", 2.5f, 2.5f, 2.5f, 2.5f, 1000),
                                       Day("20240108", 2.5f, 2.5f, 2.5f, 2.5f, 1000)}))
                        .ok());
    }
    static std::vector<store::PriceRecord> Records() {
        store::PriceFile f(File());
        std::vector<store::PriceRecord> r;
        EXPECT_TRUE(f.ReadAll(r).ok());
        return r;
    }
};

TEST_F(KoriAdjust, BonusIssueThenRemoval) {
    auto r = Kori({"adjust", "krm", "--bonus", "1:4", "--date", "4/1/24", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(json::parse(r.out),
              json::parse(R"({"code":"KRM","record":3,"date":"20240104","factor":0.8,)"
                          R"("note":"bi1:4"})"));
    auto recs = Records();
    EXPECT_EQ(recs[0].Close, 2.0f);
    EXPECT_EQ(recs[2].Volume, 800);
    EXPECT_EQ(recs[3].Close, 2.5f);

    r = Kori({"adjust", "KRM", "--remove"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out.rfind("Latest adjustment removed for KRM", 0), 0u) << r.out;
    recs = Records();
    EXPECT_EQ(recs[0].Close, 2.5f);
    EXPECT_EQ(recs[0].Volume, 800);

    r = Kori({"adjust", "KRM", "--remove"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("File has not previously been adjusted"), std::string::npos) << r.err;
}

TEST_F(KoriAdjust, EveryKindAndRemovalOfAllNewestFirst) {
    // 2.50 less a dividend of 12.5 cents: 0.95 to the 3rd; then a split of 2 for 1 to the 8th.
    auto r = Kori({"adjust", "KRM", "--dividend", "0.125", "--date", "3-1-2024", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(json::parse(r.out)["note"], "dv0.125");
    EXPECT_EQ(json::parse(r.out)["factor"], 0.95);
    r = Kori({"adjust", "KRM", "--split", "2:1", "--date", "8/1/24"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(Records()[0].Close, 1.1875f); // 2.5 x 0.95 x 0.5

    r = Kori({"adjust", "KRM", "--remove", "--all", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto removed = json::parse(r.out);
    ASSERT_EQ(removed.size(), 2u);
    EXPECT_EQ(removed[0]["record"], 4);
    EXPECT_EQ(removed[0]["note"], "ss2:1");
    EXPECT_EQ(removed[1]["record"], 2);
    EXPECT_EQ(Records()[0].Close, 2.5f);

    // Cash 1 for 4 at 2.00 and a call of 25 cents: 0.96, then 1.1.
    r = Kori({"adjust", "KRM", "--cash", "1:4@2", "--date", "4/1/24", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(json::parse(r.out)["note"], "ci1:4 @ 2");
    EXPECT_EQ(Records()[0].Close, 2.4f);
    r = Kori({"adjust", "KRM", "--call", "0.25", "--date", "4/1/24", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(json::parse(r.out)["factor"], 1.104167) << r.out; // 0.25 / 2.4 + 1, six decimals
}

TEST_F(KoriAdjust, ADateNotOnFileTakesTheDayBeforeAndSaysSo) {
    const auto r = Kori({"adjust", "KRM", "--dividend", "0.5", "--date", "6/1/24", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(json::parse(r.out)["record"], 3);
    EXPECT_EQ(r.err,
              "No close price on file for 6/1/24\n Nearest date prior is 4/1/24\n Close price is "
              "2.50\n");
}

TEST_F(KoriAdjust, RefusalsChangeNothing) {
    const std::string before = *platform::ReadWholeFile(File());
    struct Case {
        std::vector<std::string> args;
        const char* says;
    } cases[] = {
        {{"adjust", "ADVDEC", "--bonus", "1:4", "--date", "4/1/24"},
         " Only Record Types 4 and 5 can be adjusted"},
        {{"adjust", "NOSUCH", "--bonus", "1:4", "--date", "4/1/24"}, "No File For That Name"},
        {{"adjust", "KRM", "--bonus", "1:4", "--date", "31/2/24"},
         " Use  /   or  -  to separate day/month/year\n eg.  2/10/93"},
        {{"adjust", "KRM", "--bonus", "1:4", "--date", ""}, " Date must be entered"},
        {{"adjust", "KRM", "--bonus", "0:4", "--date", "4/1/24"}, "Data incomplete"},
        {{"adjust", "KRM", "--bonus", "1:x", "--date", "4/1/24"}, "not a number"},
        {{"adjust", "KRM", "--bonus", "1:4", "--split", "1:2", "--date", "4/1/24"}, "Give one of"},
        {{"adjust", "KRM", "--dividend", "3", "--date", "4/1/24"}, "below 0"},
        {{"adjust", "KRM", "--bonus", "1:4", "--date", "2/1/24"}, "nothing to adjust"},
        {{"adjust", "KRM", "--remove"}, "File has not previously been adjusted"},
    };
    for (const auto& c : cases) {
        const auto r = Kori(c.args);
        EXPECT_NE(r.status, 0) << c.args[1];
        EXPECT_NE(r.err.find(c.says), std::string::npos) << r.err;
    }
    EXPECT_EQ(*platform::ReadWholeFile(File()), before);
}

} // namespace
} // namespace kori::test
