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
