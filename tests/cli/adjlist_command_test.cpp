// kori adjlist in-process: the sample's bulletin taken into the list by the update (the bundle
// service) or by --bulletins, and every item carried out so that the adjusted histories run on
// across the issue day without a step.
#include "cli/kori_run.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <cmath>

namespace kori::test {
namespace {

using json = nlohmann::json;

std::vector<store::PriceRecord> Records(const std::string& data, const char* code) {
    store::PriceFile f(store::PriceFile::PathFor(data, code));
    std::vector<store::PriceRecord> r;
    EXPECT_TRUE(f.ReadAll(r).ok()) << code;
    return r;
}

// Close of the issue day over the close of the day before.
double Step(const std::string& data, const char* code) {
    const auto r = Records(data, code);
    if (r.size() < 2) return 0;
    EXPECT_EQ(r.back().Date, "20261123") << code;
    return r[r.size() - 1].Close / r[r.size() - 2].Close;
}

TEST(KoriAdjList, TheUpdateFillsTheListAndApplyCarriesOutEveryItem) {
    TempRoot dir;
    const std::string root = (dir.path() / "k").string(), data = root + "/data/";
    auto run = [&](std::vector<std::string> args) {
        args.push_back("--root");
        args.push_back(root);
        return RunKoriWith(std::move(args));
    };
    ASSERT_EQ(run({"init", "--sample", "--service", "3"}).status, 0);
    auto r = run({"update", "--all", "--yes"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_NE(r.out.find("There have been maintenance items added to the Adjustment List"),
              std::string::npos);
    // Before the adjustments the issue day stands apart from the history.
    EXPECT_NEAR(Step(data, "KRM"), 0.8, 0.06);
    EXPECT_NEAR(Step(data, "PNS"), 2.0, 0.15);

    r = run({"adjlist", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto list = json::parse(r.out);
    std::string acts;
    for (const auto& item : list)
        acts += item["act"].get<std::string>() + item["adj"].get<std::string>() + " ";
    // The warrant without a price file and the option line were filtered out.
    EXPECT_EQ(acts, "NIY NLY NCY DCY BIY SPY DIY PCY ");

    r = run({"adjlist", "--apply"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "Adding NEWCO NEWCO MINING to Name File\n"
                     "Adding NEWCO NEWCASTLE EXP LTD ORD to Name File\n"
                     "Name Change :CPRto  CSW\n"
                     "Removal :HLT\n"
                     "Adjustment :KRM  bi\n"
                     "Adjustment :PNS  ss\n"
                     "Adjustment :HBK  dv0.85\n"
                     "Price Correction :BWG\n"
                     "8 items carried out, 0 left in the list\n");
    // Now each history runs on across the issue day: the day's own move only.
    for (const char* code : {"KRM", "PNS", "HBK", "CSW"})
        EXPECT_NEAR(Step(data, code), 1.0, 0.06) << code;
    EXPECT_EQ(run({"adjlist"}).out, "There is no bulletin data\n");

    // CPR's history continues under CSW, HLT is gone, NEWCO has its long name.
    const auto csw = Records(data, "CSW");
    EXPECT_GT(csw.size(), 1000u);
    EXPECT_FALSE(platform::FileExists(store::PriceFile::PathFor(data, "CPR")));
    EXPECT_FALSE(platform::FileExists(store::PriceFile::PathFor(data, "HLT")));
    platform::Status why;
    EXPECT_FALSE(store::FindCode(data, "CPR", why));
    EXPECT_FALSE(store::FindCode(data, "HLT", why));
    const auto newco = store::FindCode(data, "NEWCO", why);
    ASSERT_TRUE(newco);
    EXPECT_EQ(platform::Trim(newco->Record.Name), "NEWCASTLE EXP LTD ORD");
    EXPECT_TRUE(platform::FileExists(data + "Names.bak"));
}

class KoriAdjListDayFiles : public SampleRootSuite {};

TEST_F(KoriAdjListDayFiles, BulletinsAreTakenOnceAndBadDaysRefused) {
    auto r = Kori({"adjlist"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "There is no bulletin data\n");
    r = Kori({"adjlist", "--bulletins", "23nov26", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(json::parse(r.out),
              json::parse(R"({"bulletins":1,"lines_added":8,"trimmed":false})"));
    r = Kori({"adjlist", "--bulletins", "23NOV26"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "0 bulletins filtered, 0 items added to Adjust.Lst\n");
    for (const char* bad : {"2311", "32NOV26", "23XYZ26", "20261123"}) {
        r = Kori({"adjlist", "--bulletins", bad});
        EXPECT_NE(r.status, 0) << bad;
    }
    EXPECT_NE(Kori({"adjlist", "--bulletins", "23NOV26", "--apply"}).status, 0);
}

} // namespace
} // namespace kori::test
