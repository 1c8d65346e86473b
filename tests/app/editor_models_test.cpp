#include "app/data_form_model.h"
#include "app/name_form_model.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/master_list.h"
#include "store/name_file.h"
#include "store/store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori;
using kori::test::Bytes;
using kori::test::Day;
using kori::test::Name;
using kori::test::TempRoot;

namespace {

struct NameEditor {
    TempRoot root;
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    platform::IniFile ini{root.path() / "Kori.ini"};
    app::NameFormModel model{root.folder(), root.folder(), 2, dialogs, progress, ini};

    void Write(const std::vector<store::NameRecord>& names) {
        ASSERT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).WriteAll(names).ok());
    }
    std::vector<std::string> SavedCodes() {
        std::vector<store::NameRecord> names;
        EXPECT_TRUE(store::NameFile(store::NameFile::PathIn(root.folder())).ReadAll(names).ok());
        std::vector<std::string> out;
        for (const auto& n : names)
            out.push_back(n.TrimmedCode());
        return out;
    }
};

std::filesystem::path RootFile(NameEditor& e, const char* name) {
    return platform::ResolveIn(e.root.folder(), name);
}

} // namespace

TEST(NameFormModel, TypeSixAtTheCellTypeZeroAtTheSave) {
    NameEditor e;
    e.Write({Name("AAA", "Alpha"), Name("BBB", "Beta")});
    ASSERT_TRUE(e.model.ShowNames());
    auto& grid = e.model.grid();
    const auto v = grid.SetCell(0, store::kNameType, "6");
    EXPECT_FALSE(v.Accepted);
    EXPECT_EQ(v.Message, "Record Type must be either 1,2,3,4 or 5");
    EXPECT_EQ(v.Title, "Record Type");
    grid.SetCell(1, store::kNameType, "0"); // refused too, but kept as typed
    EXPECT_FALSE(e.model.SaveNames());
    ASSERT_TRUE(e.model.refusal());
    EXPECT_EQ(e.model.refusal()->Row, 0); // the 6 stands first
    grid.SetCell(0, store::kNameType, "4");
    EXPECT_FALSE(e.model.SaveNames());
    EXPECT_EQ(e.model.refusal()->Row, 1);
    EXPECT_EQ(e.dialogs.messages().back(), "Record Type must be entered");
    EXPECT_EQ(e.dialogs.shown().back().title, "Name File");
    // The Rec column keeps its number.
    EXPECT_TRUE(grid.SetCell(0, store::kNameRec, "9").Revert);
    EXPECT_EQ(grid.cell(0, store::kNameRec), "1");
}

TEST(NameFormModel, BlankRowInTheMiddleClosesUpOnSave) {
    NameEditor e;
    e.Write({Name("AAA", "Alpha"), Name("BBB", "Beta")});
    ASSERT_TRUE(e.model.ShowNames());
    auto& grid = e.model.grid();
    const int added = e.model.AddRow();
    EXPECT_EQ(added, 2);
    grid.SetCell(added, store::kNameCode, "ccc");
    grid.SetCell(added, store::kNameType, "5");
    grid.InsertRow(1); // a blank row between AAA and BBB
    ASSERT_TRUE(e.model.SaveNames());
    EXPECT_EQ(e.SavedCodes(), (std::vector<std::string>{"AAA", "BBB", "CCC"}));
    EXPECT_EQ(grid.rowCount(), 3);
    EXPECT_EQ(grid.cell(2, store::kNameRec), "3");
    EXPECT_FALSE(grid.changed());
    EXPECT_TRUE(platform::FileExists(e.root.path() / "names.bak"));
}

TEST(NameFormModel, EmptyFileWarrantsAndClosingQuestion) {
    NameEditor e;
    EXPECT_FALSE(e.model.ShowNames());
    EXPECT_EQ(e.dialogs.messages().back(), "There are no records in Names.dat");
    EXPECT_EQ(e.dialogs.shown().back().title, "Name File List");

    auto w = Name("ABCWXY", "warrant");
    w.Category = 84;
    e.Write({Name("AAA", "Alpha"), w});
    ASSERT_TRUE(e.model.ShowNames());
    e.dialogs.QueueAnswer(platform::Answer::Ok);
    EXPECT_EQ(e.model.DeleteWarrants(), 1);
    EXPECT_EQ(e.dialogs.shown()[1].text,
              "Warrants will be deleted from the Name File.\nDo you want to continue ?");
    EXPECT_EQ(e.dialogs.messages().back(), "1 Warrants removed");
    EXPECT_EQ(e.ini.ReadRaw("Download", "NoWarrants"), "true");
    // Leaving with changes asks; "No" leaves the file as it was.
    e.dialogs.QueueAnswer(platform::Answer::No);
    EXPECT_TRUE(e.model.Close());
    EXPECT_EQ(e.dialogs.messages().back(), "File has changed. SAVE Changes?");
    EXPECT_EQ(e.SavedCodes(), (std::vector<std::string>{"AAA", "ABCWXY"}));
}

TEST(NameFormModel, DuplicatesAfterTheSortAndDeleteRows) {
    NameEditor e;
    e.Write({Name("BBB", "1"), Name("AAA", "2"), Name("BBB", "3"), Name("CCC", "4")});
    ASSERT_TRUE(e.model.ShowNames());
    e.dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_EQ(e.model.Dupnames(), 1);
    EXPECT_EQ(e.dialogs.messages().front(),
              "Name file needs to be sorted by code to proceed. OK to sort list ?");
    EXPECT_EQ(e.dialogs.messages().back(), "1 duplicate entries removed");
    EXPECT_EQ(e.model.grid().rowCount(), 3);
    EXPECT_FALSE(e.model.DeleteRows(0, 1));
    EXPECT_EQ(e.dialogs.messages().back(), "Only transactions can be deleted");
    e.dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(e.model.DeleteRows(2, 3));
    EXPECT_EQ(e.dialogs.messages().back(), "Delete items 2 to 3");
    EXPECT_EQ(e.model.grid().rowCount(), 1);
}

TEST(NameFormModel, AFullNameFileOf32767Records) {
    NameEditor e;
    std::vector<store::NameRecord> names;
    for (int i = 0; i < 32767; ++i)
        names.push_back(Name(("N" + std::to_string(32767 - i)).c_str(), "x"));
    e.Write(names);
    ASSERT_TRUE(e.model.ShowNames());
    EXPECT_EQ(e.model.grid().rowCount(), 32767);
    ASSERT_TRUE(e.model.Sort(store::NameSortOrder::Code));
    EXPECT_EQ(e.model.grid().cell(0, store::kNameCode), "N1");
    EXPECT_EQ(e.model.grid().cell(32766, store::kNameRec), "32767");
    // One more row cannot be saved: the file would pass its limit; the old file stays.
    const int added = e.model.AddRow();
    e.model.grid().SetCell(added, store::kNameCode, "ONEMOR");
    e.model.grid().SetCell(added, store::kNameType, "4");
    EXPECT_FALSE(e.model.SaveNames());
    EXPECT_EQ(e.dialogs.shown().back().title, "Saving Data");
    EXPECT_EQ(e.SavedCodes().size(), 32767u);
}

TEST(DataFormModel, ColumnsRefusedVolModAndSaveWithTempWrk) {
    TempRoot root;
    root.Write("ABC.WDT",
               Bytes({Day("20240101", 1, 2, 1, 1.5f, 1000), Day("20240102", 1.5f, 2, 1, 2, 0)}));
    platform::ScriptedDialogs dialogs;
    platform::NullProgress progress;
    const auto file = app::DataFileForCode(root.folder(), "abc", dialogs);
    ASSERT_TRUE(file);
    app::DataFormModel m(*file, "abc", dialogs, progress);
    ASSERT_TRUE(m.ShowData());
    auto& g = m.grid();
    auto v = g.SetCell(0, store::kDataAdjFactor, "2");
    EXPECT_FALSE(v.Accepted);
    EXPECT_EQ(v.Message, "Cannot edit this column");
    EXPECT_EQ(g.cell(0, store::kDataAdjFactor), "0");
    v = g.SetCell(1, store::kDataHigh, "abc");
    EXPECT_EQ(v.Message, "Data must be numeric");
    EXPECT_FALSE(m.SaveData()); // the refused cell stops the save
    g.SetCell(1, store::kDataHigh, "2.5");
    EXPECT_FALSE(m.AdjustVolumes(1, 2, std::nullopt, maint::VolOp::Divide, 10));
    EXPECT_EQ(dialogs.messages().back(), "No data item to Adjust");
    ASSERT_TRUE(m.AdjustVolumes(1, 2, maint::VolItem::Volume, maint::VolOp::Divide, 10));
    EXPECT_EQ(g.cell(0, store::kDataVolume), "100");
    EXPECT_EQ(g.cell(1, store::kDataVolume), "0");
    const std::string before = root.Read("ABC.WDT");
    ASSERT_TRUE(m.SaveData());
    EXPECT_EQ(root.Read("Temp.WRK"), before);
    EXPECT_EQ(root.Read("ABC.WDT"),
              Bytes({Day("20240101", 1, 2, 1, 1.5f, 100), Day("20240102", 1.5f, 2.5f, 1, 2, 0)}));
    dialogs.QueueAnswer(platform::Answer::Yes);
    EXPECT_TRUE(m.DeleteRows(1, 1));
    EXPECT_EQ(dialogs.messages().back(), "Delete row 1 ?");
    EXPECT_EQ(g.cell(0, store::kDataRec), "1");
    dialogs.QueueAnswer(platform::Answer::No);
    EXPECT_TRUE(m.Close());
    EXPECT_EQ(dialogs.messages().back(), "Data File has changed\nSAVE ABC?");
}

TEST(NameFormModel, UpdatesFromTheMasterListUnderlyingStockAndDownloadedSectors) {
    NameEditor e;
    auto bhp = Name("BHP", "old name");
    bhp.IndustryClass = "121";
    auto option = Name("BHPKO6", "BHP DEC CALL");
    option.IndustryClass = "000";
    auto warrant = Name("BHPWOZ", "warrant");
    auto orphan = Name("ZZZWXY", "no underlying");
    e.Write({bhp, option, warrant, orphan, Name("KRM", "Karoo")});
    ASSERT_TRUE(e.model.ShowNames());

    // Without a master list nothing changes and the user is told where to get one.
    EXPECT_EQ(e.model.UpdateNames(), -1);
    EXPECT_EQ(e.dialogs.messages().back(),
              "KORI Master list is missing\nDownload from the KORI web page");
    // 62-byte records: code, blanks, name; a comma in a name cannot reach the cell.
    const auto record = [](std::string text) {
        text.resize(store::kMasterRecord, ' ');
        return text;
    };
    ASSERT_TRUE(
        platform::WriteFileAtomic(RootFile(e, "KoriName.Mas"), record("BHP   BHP GROUP, LIMITED") +
                                                                   record("XYZ   NOT IN THE FILE") +
                                                                   record("KRM   Karoo"))
            .ok());
    EXPECT_EQ(e.model.UpdateNames(), 1); // KRM already carries its master name
    EXPECT_EQ(e.model.grid().cell(0, store::kNameName), "BHP GROUP LIMITED");
    EXPECT_EQ(e.dialogs.messages().back(), "1 names updated from the master list");

    // The option and the warrant take BHP's class; a code without its stock keeps its own.
    EXPECT_EQ(e.model.UpdateIC_from_Stock(), 2);
    EXPECT_EQ(e.model.grid().cell(1, store::kNameIndustry), "121");
    EXPECT_EQ(e.model.grid().cell(2, store::kNameIndustry), "121");
    EXPECT_EQ(e.model.grid().cell(3, store::kNameIndustry), "");
    EXPECT_EQ(e.model.UpdateIC_from_Stock(), 0);

    // Sectors come from the downloaded details' GICS column, formatted to four digits.
    EXPECT_EQ(e.model.UpdateGICS(), -1);
    EXPECT_EQ(e.dialogs.messages().back(),
              "The downloaded security details hold no GICS sector column");
    ASSERT_TRUE(platform::WriteFileAtomic(RootFile(e, "STKHeader.txt"),
                                          "CODE,SHORTDESCRIPTION,GICSSECTORCODE\r\n"
                                          "CODE,Description,GICSSECTORCODE\r\n")
                    .ok());
    const auto details = [](std::string code, std::string rest) {
        code.resize(6, ' ');
        rest.resize(306, ' ');
        return code + rest;
    };
    ASSERT_TRUE(platform::WriteFileAtomic(RootFile(e, "SecurityDetails.Stx"),
                                          details("BHP", "BHP GROUP,1510") +
                                              details("KRM", "KAROO,abc") +
                                              details("ZZZWXY", "WARRANT,0"))
                    .ok());
    EXPECT_EQ(e.model.UpdateGICS(), 1);
    EXPECT_EQ(e.model.grid().cell(0, store::kNameGics), "1510");
    EXPECT_EQ(platform::Trim(e.model.grid().cell(4, store::kNameGics)), ""); // not digits
    EXPECT_EQ(e.dialogs.messages().back(), "1 GICS sectors updated");
    EXPECT_TRUE(e.model.grid().changed());
}
