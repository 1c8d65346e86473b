// The download settings windows' rules: the service and its proposed folder, the file-name form
// and divisor, the segments and their folders, and the update list with its option, backup and
// master list.
#include "app/download_settings_form.h"
#include "app/folder_config.h"
#include "platform/files.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::app {
namespace {

using platform::Answer;
using test::TempRoot;

struct DownloadSettingsTest : testing::Test {
    DownloadSettingsTest() { session.ReadFolders(); }
    void Reopen() { session.ReadFolders(); }
    TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::SettingsStore settings{root.path() / "settings.ini"};
    platform::FixedClock clock{"20261123"};
    Session session{root.path(), {dialogs, progress, settings, clock}};
};

TEST_F(DownloadSettingsTest, ModDetailsOpensOnTheStoredServiceAndForm) {
    auto& ini = session.ini();
    ini.Write("Download", "DataService", "4");
    ini.Write("Download", "InternetDLfmt", " yymmdd.asx ");
    ini.Write("Download", "DLPath", "/srv/net/");
    ini.Write("Download", "Volume divisor", "100");
    Reopen();
    ModDetailsForm f(session);
    EXPECT_EQ(f.service(), 1);
    EXPECT_TRUE(f.internetControlsShown());
    EXPECT_EQ(f.format(), 2);
    EXPECT_EQ(f.folder(), "/srv/net/");
    EXPECT_EQ(f.divisor(), "100");

    ini.Write("Download", "DataService", "2");
    ini.Write("Download", "InternetDLfmt", "D-M-Y");
    Reopen();
    ModDetailsForm other(session);
    EXPECT_EQ(other.service(), -1) << "a service with no item in the list";
    EXPECT_EQ(other.format(), -1);
    EXPECT_FALSE(other.internetControlsShown());
}

TEST_F(DownloadSettingsTest, ChoosingAServiceProposesItsFolderOnlyWhenNoneIsSet) {
    ModDetailsForm f(session);
    f.SetFolder(" ");
    f.ChooseService(0);
    EXPECT_EQ(f.folder(), root.folder() + "koriwin/download/Out/");
    EXPECT_FALSE(f.internetControlsShown());
    f.ChooseService(1); // a folder of 3 characters or more stays
    EXPECT_EQ(f.folder(), root.folder() + "koriwin/download/Out/");
    EXPECT_TRUE(f.internetControlsShown());
    f.SetFolder("C:");
    f.ChooseService(1);
    EXPECT_EQ(f.folder(), root.folder() + "NetData/");
    f.SetFolder("/x/");
    f.ChooseService(0);
    EXPECT_EQ(f.folder(), "/x/");
}

TEST_F(DownloadSettingsTest, ModDetailsSaveChecksTheFolderAndDivisorAndWritesTheKeys) {
    ModDetailsForm f(session);
    f.ChooseService(1);
    f.SetFolder("/srv/net");
    EXPECT_FALSE(f.Save());
    EXPECT_EQ(dialogs.shown().back().text, "Path must end with a backslash \\ ");
    EXPECT_EQ(dialogs.shown().back().title, "Download");
    EXPECT_EQ(session.ini().Read("Download", "DLPath"), "unknown") << "nothing written";

    EXPECT_FALSE(f.LeaveDivisor("7"));
    EXPECT_EQ(dialogs.shown().back().text,
              "Volume divisor can only be either 1, 10,  100,  1000  or 10000");
    EXPECT_EQ(dialogs.shown().back().title, "Volume Divisor");
    f.SetFolder("/srv/net\\");
    EXPECT_FALSE(f.Save()) << "the divisor is still 7";
    ASSERT_TRUE(f.LeaveDivisor("1000"));
    f.ChooseFormat(5);
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(session.ini().Read("Download", "DataService"), "4");
    EXPECT_EQ(session.ini().Read("Download", "InternetDLfmt"), "DDMMYYYY.D");
    EXPECT_EQ(session.ini().Read("Download", "Volume divisor"), "1000");
    EXPECT_EQ(session.download.VolumeDivisor, 1000);
    EXPECT_EQ(session.folders.DownloadFolder, "/srv/net/");

    // Any other service than the internet files clears the form; a third item stores 1.
    f.ChooseService(0);
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(session.ini().Read("Download", "DataService"), "3");
    EXPECT_NE(root.Read("Kori.ini").find("InternetDLfmt=\r\n"), std::string::npos)
        << root.Read("Kori.ini");
    f.ChooseService(-1);
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(session.download.DataService, 1);
}

TEST_F(DownloadSettingsTest, WizardTicksTheSegmentsWithAFolderAndSavesTheTickedOnes) {
    // Folders that exist, so saving asks to create only the new one.
    const std::string stk = root.folder() + "stk/", sfe = root.folder() + "sfe/",
                      opt = root.folder() + "opt/";
    for (const auto& f : {stk, sfe, opt})
        ASSERT_TRUE(platform::CreateFolder(f));
    ChartDataPaths paths;
    paths[0] = stk;
    paths[2] = sfe; // futures: the window's fourth row
    paths[4] = opt;
    ASSERT_TRUE(WriteChartPathsFile(session.folders.SystemFolder + "ChtPaths.lst", paths));
    DownloadWizardForm f(session);
    EXPECT_TRUE(f.received(0));
    EXPECT_FALSE(f.received(1));
    EXPECT_FALSE(f.received(2));
    EXPECT_TRUE(f.received(3));
    EXPECT_EQ(f.folder(3), sfe);
    EXPECT_TRUE(f.received(4));
    EXPECT_EQ(f.folder(4), opt);

    f.SetReceived(4, false); // its folder goes from the list
    f.SetReceived(2, true);
    EXPECT_FALSE(f.Save());
    EXPECT_EQ(dialogs.messages().back(), "Enter the folder for Overseas Indices etc.");
    f.SetFolder(2, (root.path() / "fut").string());
    dialogs.QueueAnswer(Answer::Yes); // create the missing folder
    ASSERT_TRUE(f.Save());
    const auto saved = ReadChartPathsFile(session.folders.SystemFolder + "ChtPaths.lst");
    ASSERT_TRUE(saved);
    EXPECT_EQ((*saved)[0], stk);
    EXPECT_EQ((*saved)[2], sfe);
    EXPECT_EQ((*saved)[3], root.folder() + "fut/") << "overseas, the fourth line of the list";
    EXPECT_EQ((*saved)[4], "");
    EXPECT_TRUE(platform::FileExists(root.path() / "fut"));
    EXPECT_EQ(dialogs.shown().back().title, "Create Directory");
}

TEST_F(DownloadSettingsTest, UpdateListLoadsTheListAndTheOptionAndChecksCells) {
    root.Write("Update.Lst", "bhp,1,BHP Ltd\r\nNAB,2,National, Bank\r\n\r\n");
    session.download.UpdateAll = true;
    session.download.NoWarrants = true;
    UpdateListForm f(session);
    f.Load();
    EXPECT_EQ(f.option(), UpdateListForm::kNoWarrants);
    auto& g = f.grid();
    EXPECT_EQ(g.headers(), (std::vector<std::string>{"ASX Code", "CAT.", "Name"}));
    ASSERT_EQ(g.rowCount(), 2);
    EXPECT_EQ(g.rows()[0], (GridModel::Row{"BHP", "1", "BHP Ltd"}));
    EXPECT_EQ(g.rows()[1], (GridModel::Row{"NAB", "2", "National, Bank"}))
        << "the name is the rest of the line";
    EXPECT_FALSE(f.changed());

    EXPECT_EQ(g.SetCell(0, 1, "100").Message, "Category must be in the range 0 to 99");
    EXPECT_EQ(g.SetCell(0, 1, "-1").Message, "Category must be in the range 0 to 99");
    EXPECT_EQ(g.SetCell(0, 1, "x").Message, "Category must be in the range 0 to 99");
    EXPECT_EQ(g.SetCell(0, 1, "07").Text, "7");
    EXPECT_EQ(g.SetCell(0, 2, "A,B").Message, "Commas cannot be used");
    EXPECT_EQ(g.SetCell(0, 0, "c,d").Message, "Commas cannot be used");
    EXPECT_EQ(g.SetCell(0, 0, " anz ").Text, "ANZ");
}

TEST_F(DownloadSettingsTest, ListedOnlyWithNoRowsRevertsToAllStocks) {
    root.Write("Update.Lst", "BHP,1,BHP Ltd\r\n");
    UpdateListForm f(session);
    f.Load();
    EXPECT_EQ(f.option(), UpdateListForm::kAllStocks);
    f.ChooseOption(UpdateListForm::kListedOnly);
    EXPECT_EQ(dialogs.shown().back().text,
              "IMPORTANT !! Selecting this option only allows the stocks in this list to be "
              "updated during the download process. ALL OTHER STOCKS ARE IGNORED. ");
    EXPECT_EQ(dialogs.shown().back().title, "Update List");
    dialogs.QueueAnswer(Answer::Yes);
    ASSERT_TRUE(f.DeleteRows(0, 0));
    EXPECT_EQ(dialogs.shown().back().text, "Delete row 1 ?");
    EXPECT_EQ(dialogs.shown().back().title, "Delete Rows");
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(dialogs.shown().back().text,
              "You have selected the option to update only stocks the stocks listed, but THERE "
              "ARE NO STOCKS LISTED. Your option will be reset to update All Stocks.");
    EXPECT_EQ(f.option(), UpdateListForm::kAllStocks);
    EXPECT_TRUE(session.download.UpdateAll);
    EXPECT_EQ(session.ini().Read("Download", "UpdateAll"), "True");
    EXPECT_EQ(session.ini().Read("Download", "NoWarrants"), "False");
    EXPECT_EQ(root.Read("Update.Lst"), "");
    EXPECT_EQ(root.Read("Update.Bak"), "BHP,1,BHP Ltd\r\n") << "the old list kept";
}

TEST_F(DownloadSettingsTest, RowsAddedAndDeletedAndTheListSavedWithItsOption) {
    UpdateListForm f(session);
    f.Load();
    dialogs.QueueInput("201");
    EXPECT_EQ(f.AddRows(), 0);
    dialogs.QueueInput("3");
    EXPECT_EQ(f.AddRows(), 3);
    EXPECT_EQ(dialogs.shown().back().text, "Enter number of rows to add (1 - 200)");
    EXPECT_EQ(dialogs.shown().back().title, "Add Blank Row/s to list");
    auto& g = f.grid();
    g.SetCell(0, 0, "krm");
    g.SetCell(0, 2, "Kormo");
    g.SetCell(2, 0, "zz1");
    g.SetCell(2, 1, "5");
    dialogs.QueueAnswer(Answer::No);
    EXPECT_FALSE(f.DeleteRows(2, 1));
    EXPECT_EQ(dialogs.shown().back().text, "Delete items 2 to 3");
    f.ChooseOption(UpdateListForm::kListedOnly);
    ASSERT_TRUE(f.Save());
    EXPECT_EQ(root.Read("Update.Lst"), "KRM,0,Kormo\r\nZZ1,5,\r\n") << "blank rows take nothing";
    EXPECT_FALSE(platform::FileExists(root.path() / "Update.Bak")) << "no list to keep before";
    EXPECT_FALSE(session.download.UpdateAll);
    EXPECT_FALSE(session.download.NoWarrants);
    EXPECT_FALSE(f.changed());
    EXPECT_TRUE(f.CanClose());

    g.SetCell(0, 1, "123");
    EXPECT_FALSE(f.Save()) << "a refused cell is not written";
    EXPECT_EQ(dialogs.messages().back(), "Category must be in the range 0 to 99");
    dialogs.QueueAnswer(Answer::Cancel);
    EXPECT_FALSE(f.CanClose());
    EXPECT_EQ(dialogs.shown().back().text, "File has changed. SAVE Changes?");
    dialogs.QueueAnswer(Answer::No);
    EXPECT_TRUE(f.CanClose());
}

TEST_F(DownloadSettingsTest, MasterListShownAsItsRecordsOrSaidMissing) {
    UpdateListForm missing(session);
    missing.Load();
    EXPECT_FALSE(missing.masterPresent());
    EXPECT_EQ(missing.masterLines(), (std::vector<std::string>{"KORI Master list is missing",
                                                               "Download from the KORI web page"}));
    EXPECT_EQ(missing.AddMasterItems({0}), 0);

    const auto record = [](std::string text) {
        text.resize(62, ' ');
        return text;
    };
    root.Write("KoriName.Mas",
               record("BHP   BHP GROUP LIMITED") + record("WES   WESFARMERS") + "short tail");
    UpdateListForm f(session);
    f.Load();
    ASSERT_TRUE(f.masterPresent());
    EXPECT_EQ(f.masterLines(),
              (std::vector<std::string>{"BHP   BHP GROUP LIMITED", "WES   WESFARMERS"}))
        << "a part record at the end is not one";
    EXPECT_EQ(f.AddMasterItems({1, 5}), 1);
    ASSERT_EQ(f.grid().rowCount(), 1);
    EXPECT_EQ(f.grid().rows()[0], (GridModel::Row{"WES", "0", "WESFARMERS"}));
    EXPECT_TRUE(f.changed());
}

} // namespace
} // namespace kori::app
