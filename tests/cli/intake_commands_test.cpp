// kori targets, kori entry and kori import run in-process over a sample library of their own.
#include "cli/kori_run.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using json = nlohmann::json;

class IntakeCommands : public testing::Test {
protected:
    void SetUp() override {
        const auto r = RunKoriWith({"init", "--sample", "--root", Root()});
        ASSERT_EQ(r.status, 0) << r.err;
    }
    std::string Root() const { return (dir.path() / "k").string(); }
    KoriResult Kori(std::vector<std::string> args) const {
        args.push_back("--root");
        args.push_back(Root());
        return RunKoriWith(std::move(args));
    }
    TempRoot dir;
};

TEST_F(IntakeCommands, SampleTargetsMeetTheLastDayInEachWay) {
    const std::vector<std::string> expected = {
        "FRG - target reached UP", "GLN - target exceeded UP", "TWR - target reached DOWN",
        "VNT - target exceeded DOWN"};
    const auto text = Kori({"targets"});
    ASSERT_EQ(text.status, 0) << text.err;
    EXPECT_EQ(text.out, "FRG - target reached UP\nGLN - target exceeded UP\n"
                        "TWR - target reached DOWN\nVNT - target exceeded DOWN\n");
    const auto asJson = Kori({"targets", "--json"});
    ASSERT_EQ(asJson.status, 0) << asJson.err;
    EXPECT_EQ(json::parse(asJson.out), (json{{"alerts", expected}}));

    std::filesystem::remove(dir.path() / "k" / "Targets.txt");
    const auto none = Kori({"targets", "--json"});
    ASSERT_EQ(none.status, 0);
    EXPECT_EQ(json::parse(none.out), (json{{"alerts", json::array()}}));
}

} // namespace
} // namespace kori::test

namespace kori::test {
namespace {

TEST_F(IntakeCommands, EntryAppendsOrRefusesWithTheWindowsMessages) {
    const auto ok = Kori({"entry", "krm", "--date", "23/11/26", "--open", "3.1", "--high", "3.3",
                          "--low", "3.0", "--close", "3.2", "--volume", "12000"});
    ASSERT_EQ(ok.status, 0) << ok.err;
    EXPECT_NE(ok.out.find("KRM: record "), std::string::npos) << ok.out;
    EXPECT_NE(ok.out.find("written for 23/11/26"), std::string::npos) << ok.out;
    const auto bars = json::parse(Kori({"bars", "KRM", "--json"}).out);
    EXPECT_EQ(bars["bars"].back()["date"], "20261123");
    EXPECT_EQ(bars["bars"].back()["volume"], 12000);

    const auto zeroLow = Kori({"entry", "KRM", "--date", "24/11/26", "--open", "3.1", "--high",
                               "3.3", "--low", "0", "--close", "3.2"});
    EXPECT_NE(zeroLow.status, 0);
    EXPECT_NE(zeroLow.err.find("Data Entry: Data should not be 0"), std::string::npos)
        << zeroLow.err;
    const auto badDate = Kori({"entry", "KRM", "--date", "24.11.26", "--close", "3"});
    EXPECT_NE(badDate.status, 0);
    EXPECT_NE(badDate.err.find("Use  /   or  -  to separate day/month/year"), std::string::npos);
    EXPECT_NE(Kori({"entry", "KRM", "--date", "24/11/26", "--rises", "3"}).status, 0);
    EXPECT_EQ(json::parse(Kori({"bars", "KRM", "--json"}).out)["last_bar"], bars["last_bar"])
        << "nothing written by the refusals";
}

TEST_F(IntakeCommands, EntryOfAnAdvanceDeclineDayNeedsTheRunningTotal) {
    const auto bars = json::parse(Kori({"bars", "ADVDEC", "--json"}).out);
    const double previous = bars["bars"].back()["close"];
    const auto total = [previous](double delta) {
        return std::to_string(static_cast<long long>(previous + delta));
    };
    const auto wrong = Kori({"entry", "ADVDEC", "--date", "23/11/26", "--rises", "300", "--falls",
                             "280", "--total", total(21)});
    EXPECT_NE(wrong.status, 0);
    EXPECT_NE(wrong.err.find("Advance/Decline Edit: Cumulative total must equal"),
              std::string::npos)
        << wrong.err;
    const auto right = Kori({"entry", "ADVDEC", "--date", "23/11/26", "--rises", "300", "--falls",
                             "280", "--total", total(20)});
    ASSERT_EQ(right.status, 0) << right.err;
    EXPECT_NE(Kori({"entry", "ADVDEC", "--date", "24/11/26", "--close", "5"}).status, 0);
}

} // namespace
} // namespace kori::test
