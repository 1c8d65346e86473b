// kori details over the sample library: the waiting table loaded once, then looked up.
#include "kori_run.h"

#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using nlohmann::json;

class DetailsCommand : public SampleRootSuite {};

TEST_F(DetailsCommand, RefreshLoadsTheSampleTableOnceThenCodesAreFound) {
    const auto before = Kori({"details", "KRM"});
    EXPECT_NE(before.status, 0);
    EXPECT_NE(before.err.find("No security details for KRM"), std::string::npos) << before.err;

    const auto loaded = Kori({"details", "--refresh", "--json"});
    ASSERT_EQ(loaded.status, 0) << loaded.err;
    const auto l = json::parse(loaded.out);
    EXPECT_TRUE(l["loaded"].get<bool>());
    EXPECT_GT(l["records"].get<int>(), 2);
    const auto again = Kori({"details", "--refresh", "--json"});
    EXPECT_FALSE(json::parse(again.out)["loaded"].get<bool>()) << "the table was moved aside";

    const auto prn = Kori({"details", "prn", "--json"});
    ASSERT_EQ(prn.status, 0) << prn.err;
    const auto p = json::parse(prn.out);
    EXPECT_EQ(p["code"], "PRNX");
    EXPECT_EQ(p["fields"][0]["label"], "Description");
    EXPECT_EQ(p["fields"][0]["value"], "PERENNIAL RESOURCES");
    // No price file for it: the figures that need a price are n/a.
    EXPECT_EQ(p["text_box"], json::array({"Issued  52,000,000", "PE Ratio  n/a", "Yield  n/a"}));

    // The long line kept its first 306 characters after the code, and nothing after.
    const auto cut = json::parse(Kori({"details", "ZLONG", "--json"}).out);
    ASSERT_EQ(cut["fields"].size(), 1u);
    EXPECT_EQ(cut["fields"][0]["value"].get<std::string>().size(), 306u);

    const auto none = Kori({"details", "QQQ"});
    EXPECT_NE(none.status, 0);
    EXPECT_NE(none.err.find("No security details for QQQ"), std::string::npos);
}

} // namespace
} // namespace kori::test
