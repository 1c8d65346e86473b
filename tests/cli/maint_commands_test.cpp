// kori data, kori repair and the maintenance options of kori names, in-process over a sample
// library of their own (they change it).
#include "cli/kori_run.h"
#include "platform/files.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <sys/stat.h>

namespace kori::test {
namespace {

class MaintCommands : public testing::Test {
protected:
    void SetUp() override {
        const auto r = RunKoriWith({"init", "--sample", "--root", Root()});
        ASSERT_EQ(r.status, 0) << r.err;
    }
    std::string Root() const { return (m_dir.path() / "k").string(); }
    std::string Data() const { return Root() + "/data/"; }
    KoriResult Kori(std::vector<std::string> args) const {
        args.push_back("--root");
        args.push_back(Root());
        return RunKoriWith(std::move(args));
    }
    std::vector<std::string> Codes() const {
        std::vector<store::NameRecord> names;
        EXPECT_TRUE(store::NameFile(store::NameFile::PathIn(Data())).ReadAll(names).ok());
        std::vector<std::string> out;
        for (const auto& n : names)
            out.push_back(n.TrimmedCode());
        return out;
    }
    void WritePrices(const std::string& code, const std::vector<store::PriceRecord>& records) {
        ASSERT_TRUE(
            store::PriceFile(store::PriceFile::PathFor(Data(), code)).WriteAll(records).ok());
    }
    std::string Read(const std::string& name) const {
        return platform::ReadWholeFile(Data() + name).value_or("<missing>");
    }

    TempRoot m_dir;
};

TEST_F(MaintCommands, NamesSortAndDedupeSaveAsTheEditorDoes) {
    const auto plain = Kori({"names"});
    ASSERT_EQ(plain.status, 0);
    ASSERT_TRUE(store::WriteList(store::ListPath(Data(), 'A'), {{4, "KRM"}}).ok());
    const auto sorted = Kori({"names", "--sort", "code", "--codes"});
    ASSERT_EQ(sorted.status, 0) << sorted.err;
    auto codes = Codes();
    EXPECT_TRUE(std::is_sorted(codes.begin(), codes.end()));
    EXPECT_TRUE(platform::FileExists(Data() + "names.bak"));
    std::vector<store::ChartListEntry> list;
    ASSERT_TRUE(store::ReadList(store::ListPath(Data(), 'A'), list).ok());
    const auto at = std::find(codes.begin(), codes.end(), "KRM") - codes.begin() + 1;
    EXPECT_EQ(list.at(0).NameRecord, at); // the list followed KRM to its new place

    // Two more copies of KRM: one duplicate pass leaves one.
    std::vector<store::NameRecord> names;
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(Data())).ReadAll(names).ok());
    names.push_back(names[static_cast<std::size_t>(at - 1)]);
    names.push_back(names[static_cast<std::size_t>(at - 1)]);
    ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(Data())).WriteAll(names).ok());
    const auto dedupe = Kori({"names", "--dedupe"});
    ASSERT_EQ(dedupe.status, 0) << dedupe.err;
    EXPECT_EQ(dedupe.out.rfind("2 duplicate entries removed\n", 0), 0u) << dedupe.out;
    EXPECT_EQ(Codes(), codes);
    EXPECT_EQ(Kori({"names", "--sort", "size"}).status != 0, true);
}

TEST_F(MaintCommands, DataShowsTheEditorsRows) {
    WritePrices("TST", {Day("20240102", 1, 2, 0.5f, 1.5f, 100), Day("20240103", 2, 3, 1, 2.5f, 7)});
    const auto text = Kori({"data", "TST"});
    ASSERT_EQ(text.status, 0) << text.err;
    EXPECT_NE(text.out.find("     2  20240103          2          3          1        2.5"),
              std::string::npos)
        << text.out;
    const auto js = Kori({"data", "tst", "--json"});
    ASSERT_EQ(js.status, 0);
    const auto rows = nlohmann::json::parse(js.out);
    ASSERT_EQ(rows.size(), 2u);
    EXPECT_EQ(rows[0]["Rec"], "1");
    EXPECT_EQ(rows[1]["Close"], "2.5");
    EXPECT_EQ(rows[1]["Volume"], "7");
    const auto missing = Kori({"data", "NOPE"});
    EXPECT_NE(missing.status, 0);
    EXPECT_NE(missing.err.find("NOPE.WDT NOT FOUND"), std::string::npos);
}

TEST_F(MaintCommands, DedupeRemoveDateAndVolumes) {
    const auto a = Day("20240101", 1, 1, 1, 1, 5), b0 = Day("20240102", 2, 2, 2, 2, 0),
               b7 = Day("20240102", 2, 2, 2, 2, 7), c = Day("20240103", 3, 3, 3, 3, 9);
    WritePrices("KRM", {a, b0, b7, c});
    auto r = Kori({"repair", "dedupe"});
    ASSERT_EQ(r.status, 0) << r.err;
    // KRM, and the sample's damaged history with its day twice.
    EXPECT_NE(r.out.find("2 files changed"), std::string::npos) << r.out;
    EXPECT_EQ(Read("KRM.WDT"), Bytes({a, b7, c}));

    WritePrices("KRM", {a, b7, c, b0});
    r = Kori({"repair", "remove-date", "2/1/2024", "--latest"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(Read("KRM.WDT"), Bytes({a, b7, c}));
    r = Kori({"repair", "remove-date", "", "--all"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Date to remove must be entered."), std::string::npos);
    EXPECT_NE(Kori({"repair", "remove-date", "2/1/2024"}).status, 0);

    r = Kori(
        {"repair", "volumes", "KRM", "--records", "1:2", "--divide", "10", "--item", "VOLUME"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "Modify records 1 to 2\n");
    EXPECT_EQ(Read("KRM.WDT"),
              Bytes({Day("20240101", 1, 1, 1, 1, 0), Day("20240102", 2, 2, 2, 2, 0), c}));
    EXPECT_EQ(Read("Temp.WRK"), Bytes({a, b7, c}));
    r = Kori({"repair", "volumes", "KRM", "--records", "1:1", "--times", "10"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("No data item to Adjust"), std::string::npos);
    r = Kori({"repair", "volumes", "KRM", "--records", "1:1", "--item", "close"});
    EXPECT_NE(r.err.find("Multiply or Divide option must be selected"), std::string::npos);
    r = Kori({"repair", "volumes", "KRM", "--records", "3:9", "--times", "10", "--item", "close"});
    EXPECT_NE(r.err.find("Records 3 to 9 are not in KRM.WDT"), std::string::npos);
}

TEST_F(MaintCommands, CodeChangeDumpOldWritableAndMove) {
    const auto before = Read("KRM.WDT");
    auto r = Kori({"repair", "code-change", "KRM", "KRN"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "Do you want data for KRM renamed to KRN?\n");
    EXPECT_EQ(Read("KRN.WDT"), before);
    auto codes = Codes();
    EXPECT_NE(std::find(codes.begin(), codes.end(), "KRN"), codes.end());
    r = Kori({"repair", "code-change", "KRM", "KRN"});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("Cannot find "), std::string::npos);

    for (const char* old : {"ALX.Old", "KRM.Old", "HBK.Old"}) // the sample's own
        std::filesystem::remove(Data() + old);
    r = Kori({"repair", "dump-old"});
    EXPECT_EQ(r.out, "There are no '.Old' files in " + Data() + "\n");
    ASSERT_TRUE(platform::WriteFileAtomic(Data() + "X.Old", "x").ok());
    r = Kori({"repair", "dump-old"});
    EXPECT_EQ(r.out, "Completed\n");
    EXPECT_FALSE(platform::FileExists(Data() + "X.Old"));

    const auto other = (m_dir.path() / "other").string();
    ASSERT_TRUE(platform::CreateFolder(other));
    r = Kori({"repair", "move", "KRN", "--from", Data(), "--to", other});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(platform::ReadWholeFile(other + "/KRN.WDT"), before);
    codes = Codes();
    EXPECT_EQ(std::find(codes.begin(), codes.end(), "KRN"), codes.end());
    r = Kori({"repair", "move", "KRN", "--from", other, "--to", other});
    EXPECT_NE(r.status, 0);
    EXPECT_NE(r.err.find("You have the same folder selected for both Source and Destination"),
              std::string::npos);

    ::chmod((other + "/KRN.WDT").c_str(), 0444);
    r = Kori({"repair", "writable", other});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_NE(r.out.find("1 files made writable"), std::string::npos) << r.out;
}

} // namespace
} // namespace kori::test
