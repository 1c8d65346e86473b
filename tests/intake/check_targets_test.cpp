// The alerts after an update: each target against the last day of its security.
#include "intake/check_targets.h"
#include "store/price_file.h"
#include "support/temp_root.h"

#include "../store/store_builders.h"

#include <gtest/gtest.h>

namespace kori::intake {
namespace {

using test::Bytes;
using test::Day;
using test::TempRoot;

class CheckTargetsTest : public testing::Test {
protected:
    void SetUp() override {
        // The last day of AAA runs from 1.20 to 1.35 and closes at 1.22.
        root.Write("AAA.WDT", Bytes({Day("20240103", 1.0f, 1.6f, 0.9f, 1.5f, 100),
                                     Day("20240104", 1.3f, 1.35f, 1.2f, 1.22f, 100)}));
    }
    std::vector<std::string> Check(const std::string& targets) {
        return CheckTargets(root.Write("Targets.txt", targets), root.folder());
    }
    TempRoot root;
};

TEST_F(CheckTargetsTest, UpTargets) {
    // 1.30 lies in the day's range though the close (1.22) is below it: reached.
    EXPECT_EQ(Check("AAA,1.30,U\r\n"), std::vector<std::string>{"AAA - target reached UP"});
    // 1.00 is below the whole range and the close is above it: exceeded.
    EXPECT_EQ(Check("AAA,1.00,U\r\n"), std::vector<std::string>{"AAA - target exceeded UP"});
    // 1.50 was reached on the day before, not on the last day, and the close is below: nothing.
    EXPECT_TRUE(Check("AAA,1.50,U\r\n").empty());
}

TEST_F(CheckTargetsTest, DownTargets) {
    EXPECT_EQ(Check("AAA,1.25,D\r\n"), std::vector<std::string>{"AAA - target reached DOWN"});
    EXPECT_EQ(Check("AAA,1.40,D\r\n"), std::vector<std::string>{"AAA - target exceeded DOWN"});
    EXPECT_TRUE(Check("AAA,1.10,D\r\n").empty()); // close above a target below the range
}

TEST_F(CheckTargetsTest, RangeEndsCountAsReachedInTheFloatWidth) {
    // The low is the 32-bit float nearest 1.2; typed as "1.2" the target still touches it.
    EXPECT_EQ(Check("AAA,1.2,U\r\nAAA,1.35,D\r\n"),
              (std::vector<std::string>{"AAA - target reached UP", "AAA - target reached DOWN"}));
}

TEST_F(CheckTargetsTest, TwoLinesOfOneSecurityMissingFilesAndOddDirections) {
    root.Write("EMPTY.WDT", "");
    const auto alerts = Check("ZZZ,1.00,U\r\n"   // no price file: skipped
                              "EMPTY,1.00,U\r\n" // no record: skipped
                              "AAA,1.00,U\r\n"   // exceeded UP
                              "AAA,9.00,X\r\n"   // neither U nor D: nothing
                              "AAA,2.00,D\r\n"); // exceeded DOWN
    EXPECT_EQ(alerts,
              (std::vector<std::string>{"AAA - target exceeded UP", "AAA - target exceeded DOWN"}));
    EXPECT_EQ(JoinAlerts(alerts), "AAA - target exceeded UP\r\nAAA - target exceeded DOWN");
}

TEST_F(CheckTargetsTest, NoTargetsFileSaysNothing) {
    EXPECT_TRUE(CheckTargets(root.path() / "Targets.txt", root.folder()).empty());
    EXPECT_EQ(JoinAlerts({}), "");
}

} // namespace
} // namespace kori::intake
