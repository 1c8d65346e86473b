// The list of waiting day files and the names of the other file forms.
#include "intake/download_list.h"
#include "platform/dialogs.h"
#include "platform/files.h"

#include "support/temp_root.h"
#include <algorithm>

#include <gtest/gtest.h>

namespace kori::test {
namespace {

TEST(DownloadList, OldestFirstWithTheCenturyPivotOfThirty) {
    TempRoot root;
    for (const char* f : {"15JAN08.D", "03FEB29.D", "01DEC30.D", "02jan08.d", "31DEC07.DX",
                          "05MAR08.dix", "notes.txt"})
        root.Write(f, "x");
    platform::ScriptedDialogs dialogs;
    const auto list = intake::BuildDownloadFileList(root.folder(), 1, "", dialogs);
    EXPECT_EQ(list, (std::vector<std::string>{"01DEC30.D", "02jan08.d", "15JAN08.D", "03FEB29.D"}));
    EXPECT_TRUE(dialogs.shown().empty());
    EXPECT_EQ(intake::DownloadSortKey("15JAN08.D"), "20080115.D");
    EXPECT_EQ(intake::DownloadSortKey("15jan30.d"), "19300115.d");
}

TEST(DownloadList, NoFilesSaysSo) {
    TempRoot root;
    platform::ScriptedDialogs dialogs;
    EXPECT_TRUE(intake::BuildDownloadFileList(root.folder(), 3, "", dialogs).empty());
    ASSERT_EQ(dialogs.shown().size(), 1u);
    EXPECT_EQ(dialogs.shown()[0].text, " There are no downloaded files to update. ");
    EXPECT_EQ(dialogs.shown()[0].title, "Downloaded Data ");
}

TEST(DownloadList, InternetFormsAreRenamedToTheDayForm) {
    struct Case {
        const char *format, *source;
    };
    const Case cases[] = {{"YYMMDD.D", "980915.D"},     {"yymmdd.asx", "980915.ASX"},
                          {"DDMMYY.D", "150998.D"},     {"DDMMYY.ASX", "150998.ASX"},
                          {"DDMMYYYY.D", "15091998.D"}, {" YYYYMMDD.D ", "19980915.D"}};
    for (const auto& c : cases) {
        TempRoot root;
        root.Write(c.source, "data");
        root.Write("15SEP98.d", "older"); // an existing target goes first
        root.Write("98-915.D", "x");      // a character other than digits and letters
        root.Write("9809150.D", "x");     // the wrong length
        platform::ScriptedDialogs dialogs;
        const auto list = intake::BuildDownloadFileList(root.folder(), 4, c.format, dialogs);
        EXPECT_EQ(root.Read("15SEP98.d"), "data") << c.format;
        EXPECT_FALSE(platform::FileExists(root.path() / c.source)) << c.format;
        EXPECT_NE(std::find(list.begin(), list.end(), "15SEP98.d"), list.end()) << c.format;
        EXPECT_TRUE(platform::FileExists(root.path() / "98-915.D"));
    }
}

TEST(DownloadList, AnUnknownFormLeavesTheListEmpty) {
    TempRoot root;
    root.Write("15SEP98.D", "x");
    platform::ScriptedDialogs dialogs;
    EXPECT_TRUE(intake::BuildDownloadFileList(root.folder(), 4, "MMDDYY.D", dialogs).empty());
    EXPECT_EQ(dialogs.shown().at(0).text,
              "The internet data FILE NAMES are not in the correct format. Select Modify Download "
              "Details and select the correct file name format");
    EXPECT_EQ(dialogs.shown()[0].title, "Downloaded Data");
    dialogs.clear();
    EXPECT_TRUE(intake::BuildDownloadFileList(root.folder(), 4, "unknown", dialogs).empty());
    EXPECT_EQ(dialogs.shown().at(0).title, "Download");
    // The day form itself needs no renaming.
    dialogs.clear();
    EXPECT_EQ(intake::BuildDownloadFileList(root.folder(), 4, "DDMMMYY.D", dialogs).size(), 1u);
}

TEST(DownloadList, UpdateDateIsReadBackLikeEveryShortDate) {
    EXPECT_EQ(intake::UpdateDateFromItem("15JAN19.D", "20261120"), "20190115");
    EXPECT_EQ(intake::UpdateDateFromItem(" 15jan20.d ", "20261120"), "20200115");
    EXPECT_EQ(intake::UpdateDateFromItem("23NOV26.D", "20261120"), "20261123");
    EXPECT_EQ(intake::UpdateDateFromItem("02MAR30.D", "20261120"), "19300302");
    EXPECT_EQ(intake::UpdateDateFromItem("29FEB00.D", "20261120"), "20000229");
    EXPECT_EQ(intake::UpdateDateFromItem("29FEB27.D", "20261120"), "20261120") << "no such day";
    EXPECT_EQ(intake::UpdateDateFromItem("15JAN19.DX", "20261120"), "20261120");
    EXPECT_EQ(intake::UpdateDateFromItem("45XYZ19.D", "20261120"), "20261120");
}

} // namespace
} // namespace kori::test
