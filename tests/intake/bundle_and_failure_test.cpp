// The day bundle split by market, and runs cut short by a failing disk.
#include "intake/download_list.h"
#include "intake_test_library.h"

#include "platform/settings_store.h"
#include "platform/text.h"

#include <fstream>
#include <functional>
#include <map>
#include <set>

namespace kori::test {
namespace {

using intake::FileState;
using platform::Answer;

struct BundleLibrary : IntakeLibrary {
    std::string idx = Folder("idx"), stk = Folder("stk"), opt = Folder("opt");
    BundleLibrary() {
        settings.DataService = 3;
        for (const char* f : {"idx", "stk", "opt"})
            std::filesystem::create_directory(root.path() / f);
        settings.SegmentFolders[intake::kIndicesFolder] = idx;
        settings.SegmentFolders[intake::kStocksFolder] = stk;
        settings.SegmentFolders[intake::kOptionsFolder] = opt;
        Names({NameOf("XAO", 1)}, idx);
        Prices("XAO", {Rec("20240103", 0, 0, 0, 7000, 0)}, idx);
        Names({NameOf("AAA"), NameOf("BBB")}, stk);
        Prices("AAA", {Rec("20240103", 1, 1, 1, 1, 1)}, stk);
        Prices("BBB", {Rec("20240103", 2, 2, 2, 2, 2)}, stk);
        auto old = NameOf("OLDOPT"), bad = NameOf("BADOPT"), live = NameOf("LIVOPT");
        old.OtherDetails = "0P2/1/24";
        live.OtherDetails = "0C20/3/24";
        Names({old, bad, live}, opt);
        for (const char* c : {"OLDOPT", "BADOPT", "LIVOPT"})
            Prices(c, {Rec("20240103", 0.1f, 0.1f, 0.1f, 0.1f, 1)}, opt);
    }
};

TEST(BundleUpdate, SegmentsGoToTheirFoldersInTableOrder) {
    BundleLibrary lib;
    lib.DayFile("04JAN24.d", "bundle");
    lib.DayFile("04JAN24.dop", "NEWOPT,20240104,0.1,0.2,0.05,0.15,10,30,P\n");
    lib.DayFile("04JAN24.dsu", "AAA,20240104,1,2,1,2,5,0\nABCWAA,20240104,1,1,1,1,1,0\n"
                               "abceff,20240104,1,1,1,1,1,0\nABCIQQ,20240104,1,1,1,1,1,0\n"
                               "ABCDEF,20240104,1,1,1,1,1,0\nABCDE,20240104,1,1,1,1,1,0\n");
    lib.DayFile("04JAN24.dov", "DJIEZ,20240104,1,1,1,1,1,0\n");
    lib.DayFile("04JAN24.dix", "XAO,20240104,0,0,0,7050,0,0\nXNEW,20240104,1,1,1,1,0,0\n");
    std::vector<std::string> calls;
    lib.hooks.UpdateAdjustmentsList = [&](const std::string& f, const std::string& stem) {
        calls.push_back(f + "|" + stem);
    };
    lib.hooks.RefreshSecurityDetails = [&] { calls.push_back("details"); };
    // Dated as the update list dates it, so an option of 2024 expires in a run of 2024.
    const auto r = lib.Run("04JAN24.d", intake::UpdateDateFromItem("04JAN24.d", "20991231"));

    ASSERT_EQ(r.Files.size(), 3u);
    EXPECT_EQ(r.Files[0].Segment, "INDICES ");
    EXPECT_EQ(r.Files[1].Segment, "EQUITIES ");
    EXPECT_EQ(r.Files[2].Segment, "OPTIONS ");
    EXPECT_EQ(r.Files[0].Fillers, 0); // indices are not filled
    EXPECT_EQ(r.Files[1].Fillers, 1); // BBB
    EXPECT_EQ(r.Files[2].Fillers, 1); // LIVOPT
    ASSERT_EQ(lib.dialogs.shown().size(), 1u);
    EXPECT_EQ(lib.dialogs.shown()[0].text,
              "Overseas folder has not been set. Use Folder Locations to set the folder.");
    EXPECT_EQ(lib.dialogs.shown()[0].title, "Data Folders");

    const auto idxNames = lib.ReadNames(lib.idx);
    ASSERT_EQ(idxNames.size(), 2u);
    EXPECT_EQ(idxNames[1].TrimmedCode(), "XNEW");
    EXPECT_EQ(idxNames[1].RecordType, 5);
    EXPECT_EQ(idxNames[1].Id, "X");
    EXPECT_EQ(idxNames[1].Category, 1);

    const auto stkNames = lib.ReadNames(lib.stk);
    ASSERT_EQ(stkNames.size(), 7u);
    const std::vector<std::pair<std::string, int>> classes = {
        {"ABCWAA", 84}, {"ABCEFF", 86}, {"ABCIQQ", 87}, {"ABCDEF", 88}, {"ABCDE", 1}};
    for (std::size_t i = 0; i < classes.size(); ++i) {
        EXPECT_EQ(stkNames[i + 2].TrimmedCode(), classes[i].first);
        EXPECT_EQ(stkNames[i + 2].Category, classes[i].second) << classes[i].first;
        EXPECT_EQ(stkNames[i + 2].Id, "S");
        EXPECT_EQ(stkNames[i + 2].RecordType, 4);
    }
    EXPECT_EQ(lib.Read("BBB", lib.stk).at(1).Date, "20240104");

    const auto optNames = lib.ReadNames(lib.opt);
    ASSERT_EQ(optNames.size(), 4u);
    EXPECT_EQ(platform::Trim(optNames[0].Name), "**EXPIRED**");
    EXPECT_EQ(platform::Trim(optNames[1].Name), "DETAILS INCOMPLETE - CHECK");
    EXPECT_EQ(platform::Trim(optNames[2].Name), "LIVOPT Ltd");
    EXPECT_EQ(platform::Trim(optNames[3].OtherDetails), "0P3/2/24"); // 4 January + 30 days
    EXPECT_EQ(optNames[3].Id, "P");
    EXPECT_EQ(lib.Read("LIVOPT", lib.opt).size(), 2u);
    EXPECT_EQ(lib.Read("OLDOPT", lib.opt).size(), 1u);
    // The option's days never correct a volume.
    EXPECT_EQ(lib.Read("NEWOPT", lib.opt).at(0).Volume, 10);

    EXPECT_FALSE(lib.Waiting("04JAN24.d"));
    EXPECT_TRUE(lib.Waiting("04JAN24.dsu"));
    EXPECT_EQ(r.CurrentDataFolder, lib.stk);
    EXPECT_EQ(calls, (std::vector<std::string>{lib.stk + "|04JAN24", "details"}));
}

TEST(BundleUpdate, IntradayReplaceAsksNothingAndFlagsTheRecords) {
    BundleLibrary lib;
    platform::SettingsStore store(lib.root.path() / "settings.ini");
    store.Save("IntraDay", " 03jan24 ");
    lib.DayFile("03JAN24.d", "bundle");
    lib.DayFile("03JAN24.dix", "XAO,20240103,0,0,0,7010,0,0\n");
    lib.DayFile("03JAN24.dsu", "AAA,20240103,3,3,3,3,3,0\n");
    int refreshes = 0;
    lib.hooks.RefreshSecurityDetails = [&] { ++refreshes; };
    intake::UpdateHost host{lib.dialogs, lib.progress, &store, nullptr};
    const auto r =
        intake::RunDownloadUpdate(lib.settings, host, lib.hooks, "03JAN24.d", "20240103", false);
    EXPECT_TRUE(lib.dialogs.shown().empty());
    EXPECT_EQ(r.Files.at(0).State, FileState::Replace);
    const auto xao = lib.Read("XAO", lib.idx);
    ASSERT_EQ(xao.size(), 1u);
    EXPECT_FLOAT_EQ(xao[0].Close, 7010);
    EXPECT_EQ(xao[0].Flag, "I");
    EXPECT_EQ(lib.Read("AAA", lib.stk).at(0).Flag, "I");
    EXPECT_EQ(refreshes, 0);
}

TEST(BundleUpdate, SharedStocksAndIndicesFolderAsksOnce) {
    BundleLibrary lib;
    lib.settings.SegmentFolders[intake::kIndicesFolder] = lib.stk;
    lib.Names({NameOf("AAA"), NameOf("XAO", 1)}, lib.stk);
    lib.Prices("XAO", {Rec("20240103", 0, 0, 0, 7000, 0)}, lib.stk);
    lib.DayFile("03JAN24.d", "bundle");
    lib.DayFile("03JAN24.dix", "XAO,20240103,0,0,0,7010,0,0\n");
    lib.DayFile("03JAN24.dsu", "AAA,20240103,3,3,3,3,3,0\n");
    lib.dialogs.QueueAnswer(Answer::Ok);
    const auto r = lib.Run("03JAN24.d", "20240103");
    ASSERT_EQ(lib.dialogs.shown().size(), 1u);
    EXPECT_EQ(lib.dialogs.shown()[0].title, lib.stk + "INDICES ");
    EXPECT_EQ(r.Files.at(1).State, FileState::Replace);
    EXPECT_FLOAT_EQ(lib.Read("AAA", lib.stk).at(0).Close, 3);
}

TEST(BundleUpdate, NoFoldersAtAllStopsTheRun) {
    IntakeLibrary lib;
    lib.settings.DataService = 3;
    lib.DayFile("04JAN24.d", "bundle");
    const auto r = lib.Run("04JAN24.d");
    EXPECT_TRUE(r.Files.empty());
    EXPECT_EQ(lib.dialogs.shown().at(0).text,
              "Separate data folders for data have not been defined. Select Folder Locations "
              "option and define data folders.");
    EXPECT_TRUE(lib.Waiting("04JAN24.d"));
}

TEST(BundleUpdate, AnEmptySegmentIsReportedAndTheLaterOnesStillRun) {
    BundleLibrary lib;
    lib.DayFile("04JAN24.d", "bundle");
    lib.DayFile("04JAN24.dix", "");
    lib.DayFile("04JAN24.dsu", "AAA,20240104,1,2,1,2,5,0\n");
    const auto r = lib.Run("04JAN24.d");
    ASSERT_EQ(r.Files.size(), 2u);
    EXPECT_EQ(r.Files[0].State, FileState::Cancelled);
    EXPECT_EQ(lib.dialogs.shown().at(0).text,
              "There is no data in " + lib.settings.DownloadFolder +
                  "04JAN24.dix\nUse Unzip/Convert Data in KORI Downloader to reprocess");
    EXPECT_EQ(lib.Read("AAA", lib.stk).size(), 2u);
}

// --- A disk that fills up part way ------------------------------------------------------------

struct Scenario {
    const char* name;
    std::function<void(IntakeLibrary&)> build;
};

std::map<std::string, std::string> DataFiles(const IntakeLibrary& lib) {
    std::map<std::string, std::string> files;
    for (const auto& f : FilesIn(lib.settings.DataFolder))
        files[f] = lib.root.Read("data/" + f);
    return files;
}

const std::vector<Scenario>& Scenarios() {
    static const std::vector<Scenario> list = {
        {"normal day",
         [](IntakeLibrary& lib) {
             lib.Names({NameOf("AAA"), NameOf("BBB"), NameOf("CCC")});
             for (const char* c : {"AAA", "BBB", "CCC"})
                 lib.Prices(c, {Rec("20240102", 1, 1, 1, 1, 1), Rec("20240103", 2, 2, 2, 2, 2)});
             lib.DayFile("04JAN24.D", "AAA,20240104,3,3,3,3,3,0\nNEW1,20240104,1,1,1,1,1,0\n"
                                      "BBB,20240104,4,4,4,4,4,77\nNEW2,20240104,1,1,1,1,1,0\n");
         }},
        {"insert day",
         [](IntakeLibrary& lib) {
             lib.Names({NameOf("AAA"), NameOf("BBB")});
             for (const char* c : {"AAA", "BBB"})
                 lib.Prices(c, {Rec("20240102", 1, 1, 1, 1, 1), Rec("20240103", 2, 2, 2, 2, 2),
                                Rec("20240105", 5, 5, 5, 5, 5)});
             lib.DayFile("04JAN24.D", "AAA,20240104,3,3,3,3,3,0\nNEW1,20240104,1,1,1,1,1,0\n"
                                      "BBB,20240104,4,4,4,4,4,0\n");
             lib.dialogs.QueueAnswer(Answer::Ok);
         }},
    };
    return list;
}

TEST(UpdateOnAFailingDisk, EveryFileIsOldOrNewAndNothingHalfWritten) {
    for (const auto& sc : Scenarios()) {
        IntakeLibrary clean;
        sc.build(clean);
        const auto original = DataFiles(clean);
        long long total = 0;
        {
            platform::ScopedWriteBudget unlimited(1LL << 40);
            const auto r = clean.Run("04JAN24.D");
            ASSERT_FALSE(r.Failed) << sc.name;
            total = platform::ScopedWriteBudget::Used();
        }
        const auto final = DataFiles(clean);
        ASSERT_GT(total, 0);
        int failures = 0;
        for (long long n = 0; n < total; n += 29) {
            IntakeLibrary lib;
            sc.build(lib);
            intake::RunResult r;
            {
                platform::ScopedWriteBudget budget(n);
                r = lib.Run("04JAN24.D");
            }
            ASSERT_TRUE(r.Failed) << sc.name << " budget " << n;
            ++failures;
            ASSERT_FALSE(lib.dialogs.shown().empty());
            const auto& last = lib.dialogs.shown().back();
            EXPECT_EQ(last.title, "Downloaded Data");
            EXPECT_NE(last.text.find(lib.settings.DataFolder), std::string::npos) << last.text;
            // The day file is renamed once its records are in; only the fillers come after.
            EXPECT_TRUE(lib.Waiting("04JAN24.D") ||
                        (lib.Waiting("04JAN24.DX") && r.Files.at(0).Records == 4));
            for (const auto& [file, bytes] : DataFiles(lib)) {
                ASSERT_TRUE(final.count(file)) << sc.name << " left " << file;
                if (file == "Names.dat") {
                    EXPECT_EQ(bytes.size() % 96, 0u);
                    EXPECT_EQ(final.at(file).compare(0, bytes.size(), bytes), 0);
                    continue;
                }
                const bool old = original.count(file) && original.at(file) == bytes;
                // A new security's file may stand empty when its first record did not fit.
                const bool fresh = !original.count(file) && bytes.empty();
                EXPECT_TRUE(old || fresh || bytes == final.at(file))
                    << sc.name << " budget " << n << ": " << file << " is neither old nor new";
            }
        }
        EXPECT_GT(failures, 3);
    }
}

} // namespace
} // namespace kori::test
