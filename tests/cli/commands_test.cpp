// The kori commands run in-process over one sample library: their output and exit status.
#include "cli/kori_run.h"
#include "store/name_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <fstream>
#include <limits>

namespace kori::test {
namespace {

using json = nlohmann::ordered_json;

std::string ReadFile(const std::filesystem::path& p) {
    std::ifstream in(p, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), {}};
}

int CountLinesStarting(const std::string& text, const std::string& prefix) {
    int n = 0;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);)
        if (line.rfind(prefix, 0) == 0) ++n;
    return n;
}

std::vector<std::string> Keys(const json& object) {
    std::vector<std::string> keys;
    for (auto it = object.begin(); it != object.end(); ++it)
        keys.push_back(it.key());
    return keys;
}

class KoriCommands : public testing::Test {
protected:
    static void SetUpTestSuite() {
        s_dir = new TempRoot;
        const auto r = RunKoriWith({"init", "--sample", "--root", Root()});
        ASSERT_EQ(r.status, 0) << r.err;
        ASSERT_NE(r.out.find("Sample library: "), std::string::npos) << r.out;
    }
    static void TearDownTestSuite() {
        delete s_dir;
        s_dir = nullptr;
    }
    static std::string Root() { return (s_dir->path() / "k").string(); }
    static std::string Out(const std::string& name) { return (s_dir->path() / name).string(); }

    // The command with --root of the sample library.
    static KoriResult Kori(std::vector<std::string> args) {
        args.push_back("--root");
        args.push_back(Root());
        return RunKoriWith(std::move(args));
    }
    // The stream of one chart build, as --stream copies it.
    static std::string Stream(std::vector<std::string> args) {
        const auto path = Out("s.cht");
        std::filesystem::remove(path);
        args.insert(args.begin(), {"chart", "KRM", "--stream", path});
        const auto r = Kori(args);
        EXPECT_EQ(r.status, 0) << r.err;
        return ReadFile(path);
    }

    static TempRoot* s_dir;
};
TempRoot* KoriCommands::s_dir = nullptr;

TEST_F(KoriCommands, AboutNamesTheVersionAndTheFolders) {
    const auto r = Kori({"about"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out.rfind("KORI Charting\nVersion 8.0\n", 0), 0u) << r.out;
    EXPECT_NE(r.out.find("Install root: " + Root() + "\n"), std::string::npos) << r.out;
    EXPECT_NE(r.out.find("Data folder: " + Root() + "/data/"), std::string::npos) << r.out;
    EXPECT_EQ(RunKoriWith({"--version"}).out, "kori 8.0\n");
}

TEST_F(KoriCommands, NamesInThreeFormats) {
    const auto codes = Kori({"names", "--codes"});
    ASSERT_EQ(codes.status, 0);
    EXPECT_GE(std::count(codes.out.begin(), codes.out.end(), '\n'), 40);
    const auto asJson = Kori({"names", "--json"});
    ASSERT_EQ(asJson.status, 0);
    const auto names = json::parse(asJson.out);
    ASSERT_TRUE(names.is_array());
    EXPECT_EQ(Keys(names.at(0)), (std::vector<std::string>{
                                     "record", "status", "code", "type", "name", "other_details",
                                     "base", "top", "pf_increment", "scale_step", "percent_band_up",
                                     "percent_band_down", "bollinger_period", "bollinger_width",
                                     "category", "id", "industry_class", "gics_sector"}));
    bool xao = false;
    for (const auto& n : names)
        xao = xao || n.at("code") == "XAO";
    EXPECT_TRUE(xao);
    const auto table = Kori({"names"});
    ASSERT_EQ(table.status, 0);
    EXPECT_EQ(table.out.rfind("  Rec  Code   Type  Name", 0), 0u) << table.out;
    EXPECT_NE(table.out.find(" securities in "), std::string::npos);
}

TEST_F(KoriCommands, BarsKeepTheirFieldsAndRefuseBadRanges) {
    const auto r = Kori({"bars", "XAO", "--period", "W", "--first", "1500", "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto bars = json::parse(r.out);
    EXPECT_EQ(Keys(bars), (std::vector<std::string>{"code", "period", "first_record", "last_record",
                                                    "last_bar", "highest_price", "lowest_price",
                                                    "highest_volume", "lowest_volume",
                                                    "average_volume", "volumes_present", "bars"}));
    EXPECT_EQ(bars.at("bars").back().at("date").get<std::string>().substr(0, 7), "2026112");

    const auto table = Kori({"bars", "krm", "--last", "3"});
    ASSERT_EQ(table.status, 0);
    EXPECT_NE(table.out.find("records 1 to 3, 3 bars"), std::string::npos) << table.out;

    const auto unknown = Kori({"bars", "NOSUCH"});
    EXPECT_EQ(unknown.status, 1);
    EXPECT_EQ(unknown.err, "kori: No File For That Name: NOSUCH\n");
    EXPECT_TRUE(unknown.out.empty());
    EXPECT_NE(Kori({"bars", "KRM", "--first", "0"}).status, 0);
}

TEST_F(KoriCommands, ListsShowNamesAndCodes) {
    const auto r = Kori({"lists"});
    ASSERT_EQ(r.status, 0);
    EXPECT_NE(r.out.find("A  Banks and Finance: HBK"), std::string::npos) << r.out;
    const auto asJson = json::parse(Kori({"lists", "--json"}).out);
    ASSERT_EQ(asJson.size(), 11u); // lists A to K
    EXPECT_EQ(Keys(asJson.at(0)), (std::vector<std::string>{"list", "name", "codes"}));
}

TEST_F(KoriCommands, ScaleNeedsNoLibrary) {
    const auto r = RunKoriWith({"scale", "--high", "12.34", "--low", "9.8", "--json"});
    ASSERT_EQ(r.status, 0);
    EXPECT_EQ(Keys(json::parse(r.out)),
              (std::vector<std::string>{"chart_base", "chart_ceiling", "grid_step", "grid_count"}));
    const auto text = RunKoriWith({"scale", "--high", "12.34", "--low", "9.8"});
    EXPECT_EQ(text.out.rfind("Base ", 0), 0u);
}

TEST_F(KoriCommands, UsageErrorsAndMissingLibraries) {
    const auto none = RunKoriWith({"names", "--root", Out("none")});
    EXPECT_EQ(none.status, 1);
    EXPECT_NE(none.err.find("kori init --sample --root"), std::string::npos) << none.err;
    const auto noCommand = RunKoriWith({});
    EXPECT_NE(noCommand.status, 0);
    const auto badStyle = Kori({"chart", "KRM", "--style", "Z"});
    EXPECT_NE(badStyle.status, 0);
    EXPECT_FALSE(badStyle.err.empty());
    const auto version = RunKoriWith({"--version"});
    EXPECT_EQ(version.status, 0);
    EXPECT_EQ(version.out, "kori 8.0\n");
}

TEST_F(KoriCommands, ChartWritesEveryOutputAndItsNumbers) {
    const auto r = Kori({"chart", "krm", "--png", Out("a.png"), "--pdf", Out("a.pdf"), "--svg",
                         Out("a.svg"), "--stream", Out("a.cht"), "--json"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(Keys(json::parse(r.out)),
              (std::vector<std::string>{"first_record", "last_record", "last_bar", "plot_left",
                                        "plot_right", "plot_top", "plot_bottom", "chart_base",
                                        "chart_ceiling", "grid_step", "grid_count", "max_high",
                                        "min_low"}));
    EXPECT_EQ(ReadFile(Out("a.png")).substr(1, 3), "PNG");
    EXPECT_EQ(ReadFile(Out("a.pdf")).substr(0, 4), "%PDF");
    EXPECT_NE(ReadFile(Out("a.svg")).find("<svg"), std::string::npos);
    EXPECT_NE(ReadFile(Out("a.cht")).find("KRM"), std::string::npos);
    EXPECT_EQ(RunKoriWith({"play", Out("a.cht"), "--png", Out("b.png")}).status, 0);

    const auto daily = json::parse(Kori({"chart", "KRM", "--json"}).out);
    const auto weekly = json::parse(Kori({"chart", "KRM", "--period", "W", "--json"}).out);
    EXPECT_LT(weekly.at("last_bar").get<int>(), daily.at("last_bar").get<int>());
    const auto unknown = Kori({"chart", "NOSUCH", "--json"});
    EXPECT_EQ(unknown.status, 1);
    EXPECT_TRUE(unknown.out.empty());
}

TEST_F(KoriCommands, OverlaysAddTheirLines) {
    const int plain = CountLinesStarting(Stream({}), "L,");
    const auto averages = Stream({"--ma1", "10", "--ma2", "30"});
    EXPECT_GT(CountLinesStarting(averages, "L,"), plain + 300);
    EXPECT_GT(CountLinesStarting(averages, "H,"), CountLinesStarting(Stream({}), "H,"));
    const auto para = Stream({"--ma1", "10", "--para"});
    EXPECT_EQ(CountLinesStarting(para, "L,"), plain) << "averages drawn under the parabolic";
    EXPECT_GT(CountLinesStarting(para, "K,"), 0);
    EXPECT_NE(para.find("Parabolic last stop : "), std::string::npos);
    EXPECT_GT(CountLinesStarting(Stream({"--bands", "bollinger"}), "L,"), plain + 300);
    EXPECT_GT(CountLinesStarting(Stream({"--mma"}), "L,"), plain + 3000);
    EXPECT_NE(Stream({"--swing", "NORM"}).find("Daily Swing  -  Standard"), std::string::npos);
    EXPECT_NE(Stream({"--swing", "XDay:5"}).find("Daily Swing 5 - DAY"), std::string::npos);
    const auto refused = Kori({"chart", "KRM", "--swing", "XDay:31"});
    EXPECT_NE(refused.status, 0);
    EXPECT_NE(refused.err.find("Incorrect values entered"), std::string::npos) << refused.err;
    const auto pf = Stream({"--style", "P", "--reversal", "3", "--box-value", "0.05"});
    EXPECT_NE(pf.find("Box Value = 0.05"), std::string::npos);
    EXPECT_GT(CountLinesStarting(pf, "X,"), 0);
}

TEST_F(KoriCommands, SplitChartHasBothTitlesAndRefusesWhatCannotSplit) {
    const auto r = Kori(
        {"chart", "alx", "--split", "krm:w", "--pdf", Out("s.pdf"), "--stream", Out("split.cht")});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto stream = ReadFile(Out("split.cht"));
    EXPECT_EQ(CountLinesStarting(stream, "T, 9.75, 20, 12,ALX,"), 1);
    EXPECT_EQ(CountLinesStarting(stream, "T, 9.75, 20, 359,KRM,"), 1);
    EXPECT_NE(stream.find("WEEKLY - "), std::string::npos);
    for (const std::vector<std::string> bad : {std::vector<std::string>{"--split", "NOSUCH"},
                                               {"--split", "KRM:X"},
                                               {"--split", "KRM", "--style", "P"},
                                               {"--split", "KRM", "--osc", "RSI"}}) {
        std::vector<std::string> args{"chart", "ALX", "--json"};
        args.insert(args.end(), bad.begin(), bad.end());
        const auto refused = Kori(args);
        EXPECT_NE(refused.status, 0) << bad[1];
        EXPECT_TRUE(refused.out.empty()) << bad[1];
    }
}

TEST_F(KoriCommands, IndicatorHeadersAndRefusals) {
    const auto r = Kori({"indicator", "MACD", "KRM", "--first", "11", "--last", "260", "--csv"});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out.substr(0, r.out.find('\n')), "index,date,ema1,ema2,macd,signal");
    EXPECT_EQ(std::count(r.out.begin(), r.out.end(), '\n'), 251);
    EXPECT_NE(Kori({"indicator", "RSI", "KRM", "--set", "NoSuchKey=1", "--csv"}).status, 0);
    EXPECT_NE(Kori({"indicator", "RSI", "KRM"}).status, 0) << "no --csv";
}

TEST_F(KoriCommands, EachRunBuildsIntoItsOwnStreamAndRemovesIt) {
    // The desktop program's stream is left alone, and no stream of a run stays behind.
    const auto temp = std::filesystem::path(Root()) / "temp";
    std::filesystem::create_directories(temp);
    {
        std::ofstream window(temp / "TCht.Tmp", std::ios::binary | std::ios::trunc);
        window << "the chart window's own stream\r\n";
    }
    const auto r = Kori({"chart", "HBK", "--pdf", Out("own.pdf"), "--stream", Out("own.cht")});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(ReadFile(temp / "TCht.Tmp"), "the chart window's own stream\r\n");
    EXPECT_EQ(ReadFile(Out("own.cht")).find("the chart window"), std::string::npos);
    EXPECT_NE(ReadFile(Out("own.cht")).find("HBK"), std::string::npos);
    EXPECT_EQ(FilesIn(temp), std::vector<std::string>{"TCht.Tmp"}) << "something left behind";
}

TEST_F(KoriCommands, JsonExportsCarryOddValuesAsUtf8TextAndNull) {
    // A copy of the library whose first security has a Latin-1 name and a base that is not a
    // number: normal bytes for these files, and no reason to lose the whole export.
    const auto root = s_dir->path() / "odd";
    std::filesystem::copy(Root(), root, std::filesystem::copy_options::recursive);
    const auto names = json::parse(Kori({"names", "--json"}).out);
    store::NameFile file(store::NameFile::PathIn((root / "data").string() + "/"));
    ASSERT_TRUE(file.Open().ok());
    store::NameRecord rec;
    ASSERT_TRUE(file.Read(1, rec).ok());
    rec.Name = "Soci\xE9t\xE9 G\xE9n\xE9rale";
    rec.Base = std::numeric_limits<float>::quiet_NaN();
    rec.Top = std::numeric_limits<float>::infinity();
    ASSERT_TRUE(file.Write(1, rec).ok());

    const auto r = RunKoriWith(
        {"names", "--json", "--root", root.string(), "--data", (root / "data").string()});
    ASSERT_EQ(r.status, 0) << r.err;
    const auto odd = json::parse(r.out);
    ASSERT_EQ(odd.size(), names.size());
    EXPECT_EQ(odd.at(0).at("name"), "Soci\u00e9t\u00e9 G\u00e9n\u00e9rale");
    EXPECT_TRUE(odd.at(0).at("base").is_null());
    EXPECT_TRUE(odd.at(0).at("top").is_null());
    EXPECT_EQ(odd.at(1), names.at(1));

    const auto scale = RunKoriWith({"scale", "--high", "nan", "--low", "1", "--json"});
    EXPECT_EQ(scale.status, 0) << scale.err;
    EXPECT_EQ(Keys(json::parse(scale.out)).size(), 4u);
}

} // namespace
} // namespace kori::test
