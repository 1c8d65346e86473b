#include "store/classifications.h"
#include "store_builders.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::store;

TEST(Classifications, LookupsAndTheirUnknowns) {
    kori::test::TempRoot root;
    EXPECT_EQ(ClassNameOf(root.folder(), "120"), "unknown") << "no file";
    root.Write("IndClass.dat", "120,Banks\r\n121,\r\n7\r\n130,Mining,extra\r\n");
    root.Write("GICS.DAT", "1510,Materials,Chemicals\n4010,,\n");
    EXPECT_EQ(ClassNameOf(root.folder(), " 120 "), "Banks");
    EXPECT_EQ(ClassNameOf(root.folder(), "121"), "unknown") << "empty name";
    EXPECT_EQ(ClassNameOf(root.folder(), "7"), "unknown") << "a line without a comma";
    EXPECT_EQ(ClassNameOf(root.folder(), "130"), "Mining");
    EXPECT_EQ(SectorNameOf(root.folder(), "1510"), "Materials_Chemicals");
    EXPECT_EQ(SectorNameOf(root.folder(), "4010"), "unknown");
    EXPECT_EQ(SectorNameOf(root.folder(), "9999"), "unknown");
}

TEST(Classifications, GroupWalksTakeThreeCharacterClassesOnly) {
    auto rec = [](const char* cls) {
        NameRecord r = kori::test::Name("X", "x");
        r.IndustryClass = cls;
        return r;
    };
    const std::vector<NameRecord> names = {rec("121"), rec("12 "), rec("131"), rec("125"),
                                           rec("   ")};
    EXPECT_EQ(FindNextClassRecord(names, 0, "120", false), 1);
    EXPECT_EQ(FindNextClassRecord(names, 1, "120", false), 4) << "\"12\" is never in a group";
    EXPECT_EQ(FindNextClassRecord(names, 4, "120", false), 0);
    EXPECT_EQ(FindNextClassRecord(names, 0, "121", false), 1);
    EXPECT_EQ(FindNextClassRecord(names, 1, "121", false), 0);
    EXPECT_EQ(FindNextClassRecord(names, 0, "", false), 0);
}

TEST(Classifications, EditorRulesFormatIdsAndDropIncompleteRows) {
    EXPECT_EQ(CheckClassId("7", 3), "007");
    EXPECT_EQ(CheckClassId("15", 4), "0015");
    EXPECT_EQ(CheckClassId("", 3), "");
    EXPECT_FALSE(CheckClassId("1a", 3));
    kori::test::TempRoot root;
    ASSERT_TRUE(WriteClassFile(root.folder(), "IndClass.dat",
                               {{"007", " Gold "}, {"008", ""}, {"", "Orphan"}})
                    .ok());
    EXPECT_EQ(root.Read("IndClass.dat"), "007,Gold\r\n");
    const auto rows = ReadClassFile(root.folder(), "IndClass.dat", 2);
    ASSERT_EQ(rows.size(), 1u);
    EXPECT_EQ(rows[0][1], "Gold");
}
