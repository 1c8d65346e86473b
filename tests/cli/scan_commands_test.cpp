// The scan commands in-process over a sample library: their JSON, the scan list they store and
// the refusals of the windows' checks.
#include "cli/kori_run.h"
#include "platform/files.h"
#include "platform/ini_file.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using json = nlohmann::ordered_json;

class ScanCommands : public SampleRootSuite {
protected:
    static std::string Data() { return Root() + "/data/"; }
    static json Json(std::vector<std::string> args) {
        args.push_back("--json");
        const auto r = Kori(std::move(args));
        EXPECT_EQ(r.status, 0) << r.err;
        return json::parse(r.out);
    }
    static const json* Row(const json& out, const std::string& code) {
        for (const auto& row : out.at("rows"))
            if (row.at("code") == code) return &row;
        return nullptr;
    }
    static std::vector<std::string> ListZ() {
        std::vector<store::ChartListEntry> entries;
        std::vector<std::string> codes;
        if (platform::FileExists(store::ListPath(Data(), 'Z')))
            EXPECT_TRUE(store::ReadList(store::ListPath(Data(), 'Z'), entries).ok());
        for (const auto& e : entries)
            codes.push_back(platform::Trim(e.Code));
        return codes;
    }
};

TEST_F(ScanCommands, Scan1FindsTheExactRiseAndTheOscillatorsAndStoresTheList) {
    const json out = Json({"scan1", "--rise", "10", "--osc", "STO,RSI", "--ob", "--os", "--set",
                           "StochK=10", "--set", "RsiP=14"});
    EXPECT_EQ(out.at("last_date"), "20261120");
    const json* ten = Row(out, "TENUP");
    ASSERT_NE(ten, nullptr) << out.dump();
    EXPECT_EQ(ten->at("move"), "U");
    EXPECT_NEAR(ten->at("change").get<double>(), 10.0, 1e-4);
    const json* hi = Row(out, "OBHI");
    ASSERT_NE(hi, nullptr);
    EXPECT_EQ(hi->at("indications").at("STO"), "OB");
    EXPECT_EQ(hi->at("move"), "");
    EXPECT_TRUE(hi->at("change").is_null());
    EXPECT_FALSE(hi->at("all")); // no rise on its last day
    const json* lo = Row(out, "OSLO");
    ASSERT_NE(lo, nullptr);
    EXPECT_EQ(lo->at("indications").at("STO"), "OS");
    EXPECT_EQ(lo->at("indications").at("RSI"), "OS");
    EXPECT_EQ(out.at("message"), "The codes have been stored in list Chart Scan Results List\n"
                                 " This list can be selected to view charts\n from the\n"
                                 " Chart Selection form.");
    std::vector<std::string> codes;
    for (const auto& row : out.at("rows"))
        codes.push_back(row.at("code"));
    EXPECT_EQ(ListZ(), codes);
}

TEST_F(ScanCommands, RefusalsGiveTheWindowsMessages) {
    auto r = Kori({"scan1", "--rise", "300"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Percentage Not valid - Valid Range 1 to 200"), std::string::npos);
    r = Kori({"scan1", "--osc", "WMS", "--ob", "--set", "WmsA=-3"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Invalid WILLIAMS %R Oscillator Values"), std::string::npos) << r.err;
    r = Kori({"scan2"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("No selection made"), std::string::npos);
    r = Kori({"scan3"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Either Look for break UP  or Look for break DOWN"), std::string::npos);
}

TEST_F(ScanCommands, Scans2And3FindTheSpikeAndTheBreaks) {
    json out = Json({"scan2", "--volume", "600:10"});
    const json* spike = Row(out, "VOLSP");
    ASSERT_NE(spike, nullptr) << out.dump();
    EXPECT_GT(spike->at("vol_up").get<long long>(), 0);
    EXPECT_TRUE(spike->at("change").is_null());
    EXPECT_TRUE(platform::FileHasData(Root() + "/temp/ChtScan2.txt"));

    out = Json({"scan3", "--up", "--down"});
    ASSERT_NE(Row(out, "PARUP"), nullptr) << out.dump();
    EXPECT_EQ(Row(out, "PARUP")->at("direction"), "UP");
    EXPECT_EQ(Row(out, "PARDN")->at("direction"), "DOWN");
    out = Json({"scan3", "--up"});
    EXPECT_EQ(Row(out, "PARDN"), nullptr);
}

TEST_F(ScanCommands, Scan6ListsTheAveragesTogetherAndStopsWhenTheyAreEqual) {
    const json out = Json({"scan6", "--code-length", "4"});
    const json* avg = Row(out, "AVGX");
    ASSERT_NE(avg, nullptr) << out.dump();
    EXPECT_EQ(avg->at("gap"), 0.0);
    EXPECT_EQ(avg->at("class"), "121");
    EXPECT_EQ(Row(out, "TENUP"), nullptr); // five characters

    std::filesystem::remove(store::ListPath(Data(), 'Z'));
    platform::IniFile ini(Root() + "/Kori.ini");
    ASSERT_TRUE(ini.Write("Charts", "Av2D", ini.Read("Charts", "Av1D")));
    const auto r = Kori({"scan6"});
    ASSERT_TRUE(ini.Write("Charts", "Av2D", "30"));
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Averages not set - Set averages in Chart Defaults  and re-try"),
              std::string::npos);
    EXPECT_FALSE(platform::FileExists(store::ListPath(Data(), 'Z')));
}

TEST_F(ScanCommands, StatisticsAndAdvanceDeclineTotals) {
    const json stats = Json({"stats", "--top", "3"});
    EXPECT_EQ(stats.at("traded").get<int>() + stats.at("untraded").get<int>(),
              stats.at("rises").get<int>() + stats.at("falls").get<int>() +
                  stats.at("steady").get<int>() + stats.at("untraded").get<int>());
    ASSERT_EQ(stats.at("top_rises").size(), 3u);
    EXPECT_EQ(stats.at("top_rises").at(0).at("code"), "PARUP");
    EXPECT_EQ(stats.at("top_falls").at(0).at("code"), "PARDN");
    const json& ten = stats.at("top_rises").at(2);
    EXPECT_EQ(ten.at("code"), "TENUP");
    EXPECT_EQ(ten.at("previous"), "2.00");
    EXPECT_EQ(ten.at("latest"), "2.20");
    EXPECT_NEAR(ten.at("percent").get<double>(), 10.0, 1e-9);

    const json first = Json({"adtotals", "ADNEW"});
    const std::string once = *platform::ReadWholeFile(Data() + "ADNEW.WDT");
    const json second = Json({"adtotals", "ADNEW"});
    EXPECT_EQ(*platform::ReadWholeFile(Data() + "ADNEW.WDT"), once);
    EXPECT_EQ(first.at("total"), second.at("total"));
    const auto r = Kori({"adtotals", "ADNEW", "--base", "abc"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Base Value must be numeric"), std::string::npos);
    EXPECT_NE(Kori({"adtotals", "TENUP"}).status, 0); // not a type 3 series
}

} // namespace
} // namespace kori::test
