// kori check over a sample library with faults put into it.
#include "cli/kori_run.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using json = nlohmann::ordered_json;

class KoriCheck : public testing::Test {
protected:
    void SetUp() override {
        ASSERT_EQ(RunKoriWith({"init", "--sample", "--root", Root()}).status, 0);
    }
    std::string Root() const { return (dir.path() / "k").string(); }
    KoriResult Kori(std::vector<std::string> args) const {
        args.insert(args.end(), {"--root", Root()});
        return RunKoriWith(std::move(args));
    }
    // Record `n` of KRM's history changed by `edit`.
    template <typename Edit> void EditKrm(int n, Edit edit) {
        store::PriceFile f(dir.path() / "k" / "data" / "KRM.WDT");
        ASSERT_TRUE(f.Open());
        store::PriceRecord r;
        ASSERT_TRUE(f.Read(n, r));
        edit(r);
        ASSERT_TRUE(f.Write(n, r));
    }
    TempRoot dir;
};

TEST_F(KoriCheck, TheSampleIsSoundAndPlantedFaultsAreFound) {
    const auto clean = Kori({"check", "--json"});
    ASSERT_EQ(clean.status, 0) << clean.err;
    const auto before = json::parse(clean.out);
    EXPECT_GT(before["checked"].get<int>(), 10);
    const auto findingsBefore = before["findings"].size();

    EditKrm(20, [](store::PriceRecord& r) { r.High = r.Low - 1; });
    EditKrm(30, [](store::PriceRecord& r) { r.Volume = -7; });
    const auto r = Kori({"check", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto after = json::parse(r.out);
    ASSERT_EQ(after["findings"].size(), findingsBefore + 2) << r.out;
    std::vector<std::string> krm;
    for (const auto& f : after["findings"])
        if (f["code"] == "KRM")
            krm.push_back(std::to_string(f["record"].get<int>()) + " " +
                          f["finding"].get<std::string>());
    EXPECT_EQ(krm, (std::vector<std::string>{"20 High below low", "30 Negative volume"}));
    const auto& first = after["findings"][0];
    std::vector<std::string> keys;
    for (auto it = first.begin(); it != first.end(); ++it)
        keys.push_back(it.key());
    EXPECT_EQ(keys,
              (std::vector<std::string>{"code", "name", "date", "record", "finding", "detail"}));

    const auto csv = Kori({"check", "--csv", "--list", "full"});
    EXPECT_EQ(csv.out.rfind("Code,Name,Date,Record,Finding,Detail\n", 0), 0u);
    EXPECT_NE(csv.out.find(",20,High below low,"), std::string::npos) << csv.out;
}

TEST_F(KoriCheck, AnExportedHistoryImportsBackUnchanged) {
    const auto csv = (dir.path() / "krm.csv").string();
    ASSERT_EQ(Kori({"export", "data", "KRM", "-o", csv}).status, 0);
    const auto imported = Kori({"import", csv, "--code", "KRMCPY", "--name", "Copy of KRM"});
    ASSERT_EQ(imported.status, 0) << imported.err;
    const auto original = Kori({"export", "data", "KRM"});
    const auto copy = Kori({"export", "data", "KRMCPY"});
    ASSERT_EQ(copy.status, 0) << copy.err;
    EXPECT_GT(original.out.size(), 1000u);
    EXPECT_EQ(copy.out, original.out);
}

TEST_F(KoriCheck, RefusesAFolderWithoutANameFile) {
    const auto r = Kori({"check", "--folder", dir.path().string()});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("No name file in"), std::string::npos) << r.err;
}

TEST_F(KoriCheck, CheckNamesReportsThenFixesTheNameFile) {
    const auto data = dir.path() / "k" / "data";
    std::filesystem::copy_file(data / "KRM.WDT", data / "NEWONE.WDT");
    const auto r = Kori({"check-names", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto report = json::parse(r.out);
    ASSERT_EQ(report["findings"].size(), 1u) << r.out;
    EXPECT_EQ(report["findings"][0]["code"], "NEWONE");
    EXPECT_EQ(report["findings"][0]["finding"], "No name record");
    EXPECT_EQ(report["findings"][0]["record"], 0);
    EXPECT_FALSE(report.contains("fixed"));

    const auto fixed = Kori({"check-names", "--fix"});
    ASSERT_EQ(fixed.status, 0) << fixed.err;
    EXPECT_NE(fixed.out.find("1 name records added, 0 entries without data removed"),
              std::string::npos)
        << fixed.out;
    const auto again = json::parse(Kori({"check-names", "--json"}).out);
    EXPECT_TRUE(again["findings"].empty());
    EXPECT_EQ(again["records"], report["records"].get<int>() + 1);
}

} // namespace
} // namespace kori::test
