// kori watchlist in-process over a sample library: the lists, a list's rows worked out, and the
// changes and refusals of --add and --remove.
#include "cli/kori_run.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using json = nlohmann::ordered_json;

class WatchlistCommand : public SampleRootSuite {
protected:
    static json Json(std::vector<std::string> args) {
        args.push_back("--json");
        const auto r = Kori(std::move(args));
        EXPECT_EQ(r.status, 0) << r.err;
        return json::parse(r.out);
    }
    static json Row(const json& rows, const std::string& code) {
        for (const auto& row : rows)
            if (row.at("code") == code) return row;
        ADD_FAILURE() << code << " not in the rows";
        return json::object();
    }
};

TEST_F(WatchlistCommand, ListsTheSampleListsAndWorksOutARow) {
    const auto lists = Json({"watchlist"});
    ASSERT_EQ(lists.size(), 2u);
    EXPECT_EQ(lists[0].at("name"), "Portfolio");
    EXPECT_EQ(lists[0].at("count"), 4);
    EXPECT_EQ(lists[1].at("name"), "Speculative");

    const auto rows = Json({"watchlist", "portfolio"});
    ASSERT_EQ(rows.size(), 4u);
    // FRG was bought 10% above the last close, 1500 of them; its target is the day's low.
    const auto frg = Row(rows, "FRG");
    const double close = frg.at("close"), entry = frg.at("entry_price");
    EXPECT_NEAR(entry, close * 1.1, 0.006);
    EXPECT_NEAR(frg.at("since_entry").get<double>(), close - entry, 1e-9);
    EXPECT_NEAR(frg.at("since_entry_pct").get<double>(), -100.0 / 11, 0.5);
    EXPECT_NEAR(frg.at("value").get<double>(), 1500 * close, 1e-6);
    EXPECT_EQ(frg.at("name"), "Forge Gas Pipelines");
    EXPECT_EQ(frg.at("last_date").get<std::string>().size(), 8u);
    EXPECT_NE(frg.at("target").get<std::string>().find("target reached UP"), std::string::npos);
    EXPECT_NE(Row(rows, "GLN").at("target").get<std::string>().find("target exceeded UP"),
              std::string::npos);
    EXPECT_TRUE(Row(rows, "HBK").at("target").is_null());
    const auto twr = Row(rows, "TWR");
    EXPECT_TRUE(twr.at("entry_price").is_null());
    EXPECT_TRUE(twr.at("value").is_null());

    const auto text = Kori({"watchlist", "Portfolio"});
    ASSERT_EQ(text.status, 0) << text.err;
    EXPECT_NE(text.out.find("FRG"), std::string::npos);
    EXPECT_NE(text.out.find("waiting for the target"), std::string::npos);
}

TEST_F(WatchlistCommand, AddMakesTheListAndRefusalsExitNonZero) {
    auto r = Kori({"watchlist", "Fresh", "--add", "zzz@1.5", "--add", "KRM", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto rows = json::parse(r.out);
    ASSERT_EQ(rows.size(), 2u);
    EXPECT_EQ(rows[0].at("problem"), "not in the name file, no price file");
    EXPECT_EQ(rows[0].at("entry_price"), 1.5);
    EXPECT_TRUE(rows[0].at("close").is_null());
    EXPECT_FALSE(rows[1].at("close").is_null());

    r = Kori({"watchlist", "Fresh", "--add", "KRM"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("KRM is already in Fresh"), std::string::npos) << r.err;
    r = Kori({"watchlist", "Fresh", "--remove", "BHP"});
    EXPECT_NE(r.status, 0);
    r = Kori({"watchlist", "Nowhere"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("No watchlist named Nowhere"), std::string::npos);
    r = Kori({"watchlist", "--add", "BHP"});
    EXPECT_NE(r.status, 0);

    ASSERT_EQ(Kori({"watchlist", "Fresh", "--remove", "ZZZ"}).status, 0);
    EXPECT_EQ(Json({"watchlist", "Fresh"}).size(), 1u);

    // Three lists now; seven more make ten, and the eleventh is refused.
    for (int i = 4; i <= 10; ++i)
        ASSERT_EQ(Kori({"watchlist", "L" + std::to_string(i), "--add", "KRM"}).status, 0);
    r = Kori({"watchlist", "L11", "--add", "KRM"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("no more than 10"), std::string::npos) << r.err;
    EXPECT_EQ(Json({"watchlist"}).size(), 10u);
}

} // namespace
} // namespace kori::test
