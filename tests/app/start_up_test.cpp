#include "app/colour_table.h"
#include "app/folder_config.h"
#include "app/instance_lock.h"
#include "app/start_up.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::app;
using kori::platform::Answer;
using kori::platform::FileExists;
using kori::test::TempRoot;

namespace {

// An install root with scripted dialogs and a session over it.
struct StartUp : ::testing::Test {
    TempRoot root;
    kori::platform::ScriptedDialogs dialogs;
    kori::platform::NullProgress progress;
    kori::platform::SettingsStore settings{root.path() / "settings.ini"};
    kori::platform::FixedClock clock{"20240305"};
    Session session{root.path(), {dialogs, progress, settings, clock}};

    std::string Ini(const char* section, const char* key) {
        return session.ini().Read(section, key);
    }
    void Set(const char* section, const char* key, const std::string& value) {
        ASSERT_TRUE(session.ini().Write(section, key, value));
    }
    // A Kori.ini that already knows its install, so start-up reads rather than resets.
    void KnownInstall() {
        Set("KoriDisk", "KoriDrv", "/t");
        Set("KoriPaths", "System", root.folder());
    }
};

} // namespace

TEST_F(StartUp, MissingIniSetsTheFoldersFromTheRootAndWritesThem) {
    dialogs.QueueAnswer(Answer::No); // no colour printer
    InitialiseSession(session, "");
    const std::string sys = root.folder();
    EXPECT_EQ(Ini("KoriPaths", "System"), sys);
    EXPECT_EQ(Ini("KoriPaths", "ChtData"), sys + "data/");
    EXPECT_EQ(Ini("KoriPaths", "ChtBackUp"), sys + "chtbak/");
    EXPECT_EQ(Ini("KoriPaths", "PFMData"), sys + "pfdata/");
    EXPECT_EQ(Ini("KoriPaths", "PFMBackUp"), sys + "pfbak/");
    EXPECT_EQ(Ini("Download", "DLPath"), sys + "download/Out/");
    EXPECT_EQ(Ini("Download", "DataService"), "0");
    EXPECT_EQ(Ini("KoriDisk", "KoriDrv"), sys.substr(0, 2));
    EXPECT_TRUE(InstallRootKnown(session.ini()));

    EXPECT_EQ(session.folders.DataFolder, sys + "data/");
    EXPECT_TRUE(FileExists(sys + "chtmisc/"));
    EXPECT_TRUE(FileExists(sys + "chtsave/"));
    EXPECT_EQ(session.palette[16], kori::platform::kStandardColours[3]); // scheme "Black"
    EXPECT_TRUE(FileExists(sys + "koriclr.dat"));
    EXPECT_EQ(root.Read("koriprn.dat"), std::string("\x00\x00\x01\x00", 4));
    EXPECT_EQ(session.zoom, 100);
    EXPECT_FALSE(session.pathsMissing);
    // The oscillator lines, beyond the built-in role colours, still show on a dark panel.
    EXPECT_NE(session.palette[45], session.palette[0]);
    kori::platform::Palette written{};
    ASSERT_TRUE(ReadColourFile(sys + "koriclr.dat", written));
    EXPECT_EQ(written[45], session.palette[45]);
    // Oscillator settings are there to draw with, and the index is the comparison file.
    EXPECT_EQ(Ini("OscDef", "RsiP"), "14");
    EXPECT_EQ(Ini("OscDef", "CompFile"), sys + "data/XAO.WDT");
}

TEST_F(StartUp, OscillatorSettingsOfAnExistingInstallAreLeftAsTheyAre) {
    KnownInstall();
    Set("OscDef", "RsiP", "0"); // switched off on purpose
    Set("OscDef", "StochK", "9");
    dialogs.QueueAnswer(Answer::No);
    InitialiseSession(session, "");
    EXPECT_EQ(Ini("OscDef", "RsiP"), "0");
    EXPECT_EQ(Ini("OscDef", "StochK"), "9");
    EXPECT_EQ(Ini("OscDef", "Md1"), "unknown");
}

TEST_F(StartUp, AKnownInstallKeepsItsPathsAndAStaleDriveResetsThem) {
    KnownInstall();
    Set("KoriPaths", "ChtData", "/srv/market");
    root.Write("koriprn.dat", std::string("\x01\x00\x01\x00", 4));
    InitialiseSession(session, "");
    EXPECT_EQ(session.folders.DataFolder, "/srv/market/");
    EXPECT_EQ(Ini("KoriPaths", "ChtData"), "/srv/market");
    EXPECT_TRUE(dialogs.shown().empty()); // printer file present: no questions
    EXPECT_EQ(session.printer.PrintColour, 1);

    Set("KoriDisk", "KoriDrv", "ok"); // the drive is not known: back to the root's folders
    InitialiseSession(session, "");
    EXPECT_EQ(session.folders.DataFolder, root.folder() + "data/");
    EXPECT_EQ(Ini("KoriPaths", "ChtData"), root.folder() + "data/");
}

TEST_F(StartUp, AShortColourFileIsKeptAsItIs) {
    KnownInstall();
    root.Write("koriprn.dat", std::string("\x00\x00\x01\x00", 4));
    root.Write("koriclr.dat", "255\n65280\n");
    InitialiseSession(session, "");
    EXPECT_EQ(session.palette[0], 255u);
    EXPECT_EQ(session.palette[1], 65280u);
    EXPECT_EQ(session.palette[16], 0u); // not read, not filled by a scheme
    EXPECT_EQ(root.Read("koriclr.dat"), "255\n65280\n");
}

TEST_F(StartUp, CommandLineWordsAreComparedExactlyAfterTrimming) {
    auto s = ParseCommandLine(" RM ");
    EXPECT_TRUE(s.RM);
    EXPECT_FALSE(s.GD);
    s = ParseCommandLine("GD");
    EXPECT_TRUE(s.GD);
    EXPECT_TRUE(s.RM);
    EXPECT_TRUE(ParseCommandLine("A").A);
    EXPECT_TRUE(ParseCommandLine("N").N);
    for (const char* other : {"rm", "RM A", "X", ""}) {
        s = ParseCommandLine(other);
        EXPECT_FALSE(s.RM || s.A || s.N || s.GD) << other;
    }
}

TEST_F(StartUp, IndicesFolderComesFromChtPathsOnlyForServiceThree) {
    KnownInstall();
    Set("KoriPaths", "ChtData", "/lib/stocks/");
    Set("Download", "DataService", "3");
    session.ReadFolders();
    EXPECT_EQ(session.folders.IndicesFolder, "/lib/stocks/"); // no ChtPaths.lst

    root.Write("ChtPaths.lst", "header\r\n/lib/stk\r\n/lib/idx\r\n\r\n/lib/wcm/\r\n");
    session.ReadFolders();
    EXPECT_EQ(session.chartDataPaths[0], "/lib/stk/");
    EXPECT_EQ(session.folders.IndicesFolder, "/lib/idx/");
    EXPECT_EQ(session.chartDataPaths[2], "");
    EXPECT_EQ(session.chartDataPaths[3], "/lib/wcm/");
    EXPECT_EQ(session.chartDataPaths[7], "");

    Set("Download", "DataService", "1");
    session.ReadFolders();
    EXPECT_EQ(session.folders.IndicesFolder, "/lib/stocks/");
}

TEST_F(StartUp, PendingFilesMessageByDataService) {
    KnownInstall();
    session.ReadFolders();
    ASSERT_TRUE(kori::platform::CreateFolderPath(session.folders.DownloadFolder));
    session.download.DataService = 2;
    EXPECT_FALSE(OfferPendingUpdate(session)); // nothing waiting
    EXPECT_TRUE(dialogs.shown().empty());

    root.Write("download/Out/15JAN08.D", "x");
    session.download.DataService = 0;
    EXPECT_FALSE(OfferPendingUpdate(session)); // service 0 makes no test
    EXPECT_TRUE(dialogs.shown().empty());

    session.download.DataService = 2;
    dialogs.QueueAnswer(Answer::Cancel);
    EXPECT_FALSE(OfferPendingUpdate(session));
    dialogs.QueueAnswer(Answer::Ok);
    EXPECT_TRUE(OfferPendingUpdate(session));
    ASSERT_EQ(dialogs.shown().size(), 2u);
    EXPECT_EQ(dialogs.shown()[0].text, " There are some BOURSE files to update into KORI");
    EXPECT_EQ(dialogs.shown()[0].title, "Downloaded Data");

    session.download.DataService = 3;
    EXPECT_TRUE(OfferPendingUpdate(session));
    EXPECT_EQ(dialogs.shown().back().text, " There are some KORI/Zevot files to update into KORI");
    session.download.DataService = 5;
    EXPECT_TRUE(OfferPendingUpdate(session));
    EXPECT_EQ(dialogs.shown().back().text,
              " There are some EIS downloaded files to update into KORI");
}

TEST_F(StartUp, OnlyDotDFilesArePending) {
    root.Write("dl/15JAN08.txt", "x");
    root.Write("dl/sub.d/keep", "x"); // a folder named like an update file
    EXPECT_FALSE(HasPendingUpdateFiles(root.folder() + "dl/"));
    EXPECT_FALSE(HasPendingUpdateFiles(root.folder() + "absent/"));
    root.Write("dl/980915.d", "x");
    EXPECT_TRUE(HasPendingUpdateFiles(root.folder() + "dl/"));
}

TEST(InstanceLock, ASecondHolderIsToldAndRefused) {
    TempRoot root;
    kori::platform::ScriptedDialogs dialogs;
    std::unique_ptr<InstanceLock> first;
    ASSERT_TRUE(CheckSingleInstance(root.path(), dialogs, first));
    ASSERT_NE(first, nullptr);
    EXPECT_TRUE(dialogs.shown().empty());

    std::unique_ptr<InstanceLock> second;
    EXPECT_FALSE(CheckSingleInstance(root.path(), dialogs, second));
    EXPECT_EQ(second, nullptr);
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text, "You already have this application running.");
    EXPECT_EQ(dialogs.shown()[0].title, "Kori Charting 8");

    first.reset(); // the first copy ends
    EXPECT_TRUE(CheckSingleInstance(root.path(), dialogs, second));
    EXPECT_NE(second, nullptr);
}
