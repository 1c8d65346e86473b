// kori update over the sample library's waiting day files, in-process.
#include "kori_run.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace kori::test {
namespace {

using json = nlohmann::json;

// Securities of type 4 below class 90 with no line in a day file: the ones the fill reaches.
int NotTraded(const std::string& root, const std::string& dayFile) {
    std::vector<store::NameRecord> names;
    store::NameFile nf(store::NameFile::PathIn(root + "/data/"));
    EXPECT_TRUE(nf.ReadAll(names).ok());
    const auto text = platform::ReadWholeFile(dayFile).value_or("");
    int n = 0;
    for (const auto& r : names)
        if (r.RecordType == 4 && r.Category <= 89 &&
            text.find("\n" + r.TrimmedCode() + ",") == std::string::npos &&
            !text.starts_with(r.TrimmedCode() + ","))
            ++n;
    return n;
}

struct SampleRoot {
    TempRoot dir;
    std::string root = (dir.path() / "k").string();
    explicit SampleRoot(std::vector<std::string> extra = {}) {
        std::vector<std::string> args = {"init", "--sample", "--root", root};
        args.insert(args.end(), extra.begin(), extra.end());
        const auto r = RunKoriWith(args);
        EXPECT_EQ(r.status, 0) << r.err;
    }
    KoriResult Update(std::vector<std::string> args) const {
        args.insert(args.begin(), "update");
        args.push_back("--root");
        args.push_back(root);
        return RunKoriWith(args);
    }
    std::string Download(const std::string& name) const { return root + "/download/Out/" + name; }
    std::vector<store::PriceRecord> Prices(const std::string& code,
                                           const std::string& folder = "data") const {
        std::vector<store::PriceRecord> r;
        store::PriceFile pf(store::PriceFile::PathFor(root + "/" + folder + "/", code));
        EXPECT_TRUE(pf.ReadAll(r).ok());
        return r;
    }
};

TEST(UpdateCommand, WithoutYesTheQuestionIsCancelledAndTheFileWaits) {
    SampleRoot s;
    const auto before = platform::ReadWholeFile(s.root + "/data/KRM.WDT");
    const auto r = s.Update({"--json"});
    EXPECT_EQ(r.status, 3) << r.err;
    const auto j = json::parse(r.out);
    ASSERT_EQ(j["files"].size(), 1u);
    EXPECT_EQ(j["files"][0]["file"], "14NOV26.D"); // the oldest
    EXPECT_EQ(j["files"][0]["state"], "cancelled");
    EXPECT_TRUE(j["files"][0]["renamed_to"].is_null());
    EXPECT_NE(r.err.find("There is already data on file LATER than this date"), std::string::npos);
    EXPECT_EQ(platform::ReadWholeFile(s.root + "/data/KRM.WDT"), before);
    EXPECT_TRUE(platform::FileExists(s.Download("14NOV26.D")));
}

TEST(UpdateCommand, AllWithYesWalksTheSampleDays) {
    SampleRoot s;
    const auto krm = s.Prices("KRM");
    const auto ocr = s.Prices("OCR");
    const int notTraded = NotTraded(s.root, s.Download("23NOV26.D"));
    EXPECT_GE(notTraded, 1); // OCR at least
    const auto r = s.Update({"--all", "--yes", "--json"});
    EXPECT_EQ(r.status, 3) << r.err; // the last file is one field short
    const auto j = json::parse(r.out);
    ASSERT_EQ(j["files"].size(), 4u);
    const std::vector<std::string> keys = {"file",           "segment", "state",     "records",
                                           "new_securities", "fillers", "renamed_to"};
    std::vector<std::string> got;
    for (auto it = j["files"][0].begin(); it != j["files"][0].end(); ++it)
        got.push_back(it.key());
    std::sort(got.begin(), got.end());
    auto want = keys;
    std::sort(want.begin(), want.end());
    EXPECT_EQ(got, want);
    EXPECT_EQ(j["files"][0]["state"], "insert");
    EXPECT_EQ(j["files"][1]["state"], "replace");
    EXPECT_EQ(j["files"][2]["state"], "normal");
    EXPECT_EQ(j["files"][2]["new_securities"], 1);
    EXPECT_EQ(j["files"][2]["fillers"], notTraded);
    EXPECT_EQ(j["files"][2]["renamed_to"], "23NOV26.DX");
    EXPECT_EQ(j["files"][3]["state"], "cancelled");
    EXPECT_TRUE(platform::FileExists(s.Download("24NOV26.D")));
    // The targets are tested on the new last days: each alert names a security of the targets.
    ASSERT_TRUE(j["alerts"].is_array());
    for (const auto& a : j["alerts"])
        EXPECT_NE(a.get<std::string>().find(" - target "), std::string::npos) << a;

    // KRM: one record inserted on Saturday the 14th, Friday's record replaced, Monday appended.
    const auto after = s.Prices("KRM");
    ASSERT_EQ(after.size(), krm.size() + 2);
    for (std::size_t i = 1; i < after.size(); ++i)
        ASSERT_LT(after[i - 1].Date, after[i].Date);
    EXPECT_NE(std::find_if(after.begin(), after.end(),
                           [](const auto& p) { return p.Date == "20261114"; }),
              after.end());
    EXPECT_EQ(after.back().Date, "20261123");
    // Friday's volume: replaced with +1000, then corrected by Monday's line to +125000.
    EXPECT_EQ(after[after.size() - 2].Volume, krm.back().Volume + 125000);
    // OCR did not trade on Monday: a flat record at its last close.
    const auto ocrAfter = s.Prices("OCR");
    ASSERT_EQ(ocrAfter.size(), ocr.size() + 1);
    EXPECT_EQ(ocrAfter.back().Date, "20261123");
    EXPECT_FLOAT_EQ(ocrAfter.back().High, ocr.back().Close);
    EXPECT_EQ(ocrAfter.back().Volume, 0);
    platform::Status why;
    EXPECT_TRUE(store::FindCode(s.root + "/data/", "NEWCO", why).has_value());
}

TEST(UpdateCommand, NamedFilesAndPlainOutput) {
    SampleRoot s;
    const int notTraded = NotTraded(s.root, s.Download("23NOV26.D"));
    const auto r = s.Update({"23nov26.d"});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out.substr(0, r.out.find('\n') + 1),
              "23NOV26.D: normal, 42 records, 1 new securities, " + std::to_string(notTraded) +
                  " fillers, renamed to 23NOV26.DX\n");
    const auto none = s.Update({"01JAN26.D"});
    EXPECT_EQ(none.status, 1);
    EXPECT_NE(none.err.find("No waiting day file 01JAN26.D"), std::string::npos) << none.err;
}

TEST(UpdateCommand, TheBundleGoesToTheSegmentFolders) {
    SampleRoot s({"--service", "3"});
    const auto r = s.Update({"--json"});
    EXPECT_EQ(r.status, 0) << r.err;
    const auto j = json::parse(r.out);
    std::vector<std::string> segments;
    for (const auto& f : j["files"])
        segments.push_back(f["segment"]);
    EXPECT_EQ(segments,
              (std::vector<std::string>{"INDICES", "OVERSEAS", "EQUITIES", "FUTURES", "OPTIONS"}));
    EXPECT_EQ(s.Prices("XAO", "indices").back().Date, "20261123");
    EXPECT_EQ(s.Prices("APZ6", "futures").back().Date, "20261123");
    EXPECT_FALSE(platform::FileExists(s.Download("23NOV26.d")));
    EXPECT_TRUE(platform::FileExists(s.Download("23NOV26.dsu")));
    std::vector<store::NameRecord> options;
    store::NameFile nf(store::NameFile::PathIn(s.root + "/options/"));
    ASSERT_TRUE(nf.ReadAll(options).ok());
    ASSERT_EQ(options.size(), 4u);
    EXPECT_EQ(platform::Trim(options[2].Name), "DETAILS INCOMPLETE - CHECK");
    EXPECT_EQ(platform::Trim(options[3].OtherDetails), "0C17/12/26");
}

} // namespace
} // namespace kori::test
