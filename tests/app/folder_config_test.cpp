#include "app/folder_config.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::app;
using kori::platform::Answer;
using kori::platform::FileExists;
using kori::test::TempRoot;

namespace {

struct FolderSetup : ::testing::Test {
    TempRoot root;
    kori::platform::ScriptedDialogs dialogs;
    kori::platform::NullProgress progress;
    kori::platform::SettingsStore settings{root.path() / "settings.ini"};
    kori::platform::FixedClock clock{"20240305"};
    Session session{root.path(), {dialogs, progress, settings, clock}};
};

} // namespace

TEST_F(FolderSetup, PathDetailsRefuseAnEmptyEntryAndAddTheSeparator) {
    PathDetails edited = CurrentPathDetails(session);
    edited.PFMBackUp = "  ";
    EXPECT_FALSE(SavePathDetails(session, edited));
    EXPECT_EQ(dialogs.messages(), std::vector<std::string>{"Directory paths must be entered"});
    EXPECT_FALSE(session.ini().exists());

    session.pathsMissing = true;
    edited.PFMBackUp = "/backup\\pf";
    edited.DataFolder = " /srv/data ";
    ASSERT_TRUE(SavePathDetails(session, edited));
    EXPECT_EQ(session.folders.PFMBackUp, "/backup/pf/");
    EXPECT_EQ(session.folders.DataFolder, "/srv/data/");
    EXPECT_EQ(session.folders.IndicesFolder, "/srv/data/");
    EXPECT_EQ(session.ini().Read("KoriPaths", "ChtData"), "/srv/data/");
    EXPECT_EQ(session.ini().Read("KoriPaths", "PFMBackUp"), "/backup/pf/");
    EXPECT_FALSE(session.pathsMissing);
    EXPECT_EQ(MainWindowCaption(session), "Kori Charting 8   -   Current Data Folder /srv/data/");
}

TEST_F(FolderSetup, MissingPathsQuestion) {
    session.folders.DataFolder = "/elsewhere/";
    dialogs.QueueAnswer(Answer::Yes);
    EXPECT_EQ(AskForMissingPaths(session), MissingPathsChoice::EnterPaths);
    EXPECT_EQ(session.folders.DataFolder, "/elsewhere/");
    EXPECT_EQ(dialogs.shown()[0].title, "No Paths selected");
    EXPECT_EQ(
        dialogs.shown()[0].text.rfind("Directory Paths are missing and must be re-entered. ", 0),
        0u);

    dialogs.QueueAnswer(Answer::Cancel);
    EXPECT_EQ(AskForMissingPaths(session), MissingPathsChoice::Exit);
    dialogs.QueueAnswer(Answer::No);
    EXPECT_EQ(AskForMissingPaths(session), MissingPathsChoice::UseDefaults);
    EXPECT_EQ(session.folders.DataFolder, root.folder() + "data/");
    EXPECT_EQ(session.ini().Read("KoriPaths", "ChtData"), root.folder() + "data/");
}

TEST_F(FolderSetup, DataPathsNeedOneFolderAndOfferToCreateTheMissing) {
    ChartDataPaths none;
    EXPECT_FALSE(SaveDataPaths(session, none));
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text, "At least one data folder must be entered");
    EXPECT_EQ(dialogs.shown()[0].title, "Chart Data Folders");
    EXPECT_FALSE(FileExists(root.path() / "ChtPaths.lst"));
    dialogs.clear();

    kori::platform::CreateFolder(root.path() / "stk");
    ChartDataPaths edited;
    edited[0] = root.folder() + "stk";
    edited[1] = root.folder() + "idx";
    edited[2] = root.folder() + "fut";
    dialogs.QueueAnswer(Answer::Yes); // create idx
    dialogs.QueueAnswer(Answer::No);  // leave fut
    session.download.DataService = 3;
    ASSERT_TRUE(SaveDataPaths(session, edited));
    ASSERT_EQ(dialogs.shown().size(), 2u); // stk exists: no question
    EXPECT_EQ(dialogs.shown()[0].text,
              "Directory " + root.folder() + "idx/ does not exist. Create this directory ?");
    EXPECT_EQ(dialogs.shown()[0].title, "Create Directory");
    EXPECT_TRUE(FileExists(root.path() / "idx"));
    EXPECT_FALSE(FileExists(root.path() / "fut"));
    EXPECT_EQ(session.folders.IndicesFolder, root.folder() + "idx/");

    const auto back = ReadChartPathsFile(root.folder() + "ChtPaths.lst");
    ASSERT_TRUE(back.has_value());
    EXPECT_EQ((*back)[0], root.folder() + "stk/");
    EXPECT_EQ((*back)[2], root.folder() + "fut/");
    EXPECT_EQ((*back)[7], "");
    EXPECT_EQ(root.Read("WMPaths.lst"), root.Read("ChtPaths.lst"));
}

TEST_F(FolderSetup, PickingNeedsANameFileWhateverItsCase) {
    const std::string before = session.folders.DataFolder;
    kori::platform::CreateFolder(root.path() / "lon");
    EXPECT_FALSE(PickDataFolder(session, root.folder() + "lon"));
    EXPECT_EQ(session.folders.DataFolder, before);
    EXPECT_EQ(session.ini().Read("KoriPaths", "ChtData"), "unknown");

    root.Write("lon/NAMES.DAT", "x");
    ASSERT_TRUE(PickDataFolder(session, root.folder() + "lon"));
    EXPECT_EQ(session.folders.DataFolder, root.folder() + "lon/");
    EXPECT_EQ(session.ini().Read("KoriPaths", "ChtData"), root.folder() + "lon/");
}
