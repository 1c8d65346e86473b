// Targets.txt: the lines as the alerts and the chart read them, and the rewrite.
#include "platform/files.h"
#include "store/targets_file.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::store {
namespace {

using test::TempRoot;

bool Same(const TargetLine& a, const TargetLine& b) {
    return a.Code == b.Code && a.Target == b.Target && a.Direction == b.Direction;
}

TEST(TargetsFile, ReadsFieldsTrimmedSkipsBlankLinesAndIgnoresExtraSlots) {
    TempRoot root;
    const auto file = root.Write("Targets.txt",
                                 "BHP, 55.50 ,U\r\n\r\n  \r\nXYZ,1.25,D,note,more,and,more\nNAB\n");
    const auto lines = ReadTargetsFile(file);
    ASSERT_EQ(lines.size(), 3u);
    EXPECT_TRUE(Same(lines[0], {"BHP", "55.50", "U"}));
    EXPECT_TRUE(Same(lines[1], {"XYZ", "1.25", "D"}));
    EXPECT_TRUE(Same(lines[2], {"NAB", "", ""})); // missing slots read empty
    EXPECT_TRUE(ReadTargetsFile(root.path() / "absent.txt").empty());
}

TEST(TargetsFile, WritesLinesThatReadBackAndRefusesCommas) {
    TempRoot root;
    const auto file = root.path() / "Targets.txt";
    const std::vector<TargetLine> lines = {{"BHP", "55.50", "U"}, {"BHP", "40.00", "D"}};
    ASSERT_TRUE(WriteTargetsFile(file, lines).ok());
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,55.50,U\r\nBHP,40.00,D\r\n");
    const auto back = ReadTargetsFile(file);
    ASSERT_EQ(back.size(), 2u);
    EXPECT_TRUE(Same(back[1], lines[1]));

    const auto refused = WriteTargetsFile(file, {{"BHP", "1,5", "U"}});
    EXPECT_FALSE(refused.ok());
    EXPECT_EQ(refused.message(), "Commas cannot be used");
    EXPECT_EQ(root.Read("Targets.txt"), "BHP,55.50,U\r\nBHP,40.00,D\r\n");
}

TEST(TargetsFile, AFailingWriteLeavesTheOldFile) {
    TempRoot root;
    const auto file = root.Write("Targets.txt", "OLD,1.00,U\r\n");
    {
        platform::ScopedWriteFailure fail(4);
        EXPECT_FALSE(WriteTargetsFile(file, {{"NEW", "2.00", "D"}}).ok());
    }
    EXPECT_EQ(root.Read("Targets.txt"), "OLD,1.00,U\r\n");
    EXPECT_EQ(test::FilesIn(root.path()), std::vector<std::string>{"Targets.txt"});
}

} // namespace
} // namespace kori::store
