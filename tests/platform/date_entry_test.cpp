// Typed dates: what is taken, in which century, and the messages of what is not.
#include "platform/date_entry.h"

#include <gtest/gtest.h>

namespace kori::platform {
namespace {

TEST(DateEntry, GoodDatesGiveFileTextAndTheShortForm) {
    const auto a = CheckEnteredDate(" 2/10/93 ");
    ASSERT_TRUE(a.Ok) << a.Message;
    EXPECT_EQ(a.Text, "19931002");
    EXPECT_EQ(a.Display, "2/10/93");
    EXPECT_EQ(CheckEnteredDate("02-10-2024").Text, "20241002");
    EXPECT_EQ(CheckEnteredDate("02-10-2024").Display, "2/10/24");
    EXPECT_EQ(CheckEnteredDate("31/12/29").Text, "20291231"); // two digits: 2029 ...
    EXPECT_EQ(CheckEnteredDate("1/1/30").Text, "19300101");   // ... and 1930
    EXPECT_EQ(CheckEnteredDate("29/2/24").Text, "20240229");  // a leap day
    EXPECT_EQ(DateTextToEntry("20260105"), "5/1/26");
    EXPECT_EQ(DateTextToEntry("2026010"), "");
}

TEST(DateEntry, RefusalsAndTheirMessages) {
    const auto blank = CheckEnteredDate("   ");
    EXPECT_FALSE(blank.Ok);
    EXPECT_EQ(blank.Message, " Date must be entered");
    for (const char* bad :
         {"2.10.93", "2/10", "2/10/93/1", "123/1/93", "0/1/93", "32/1/93", "a/1/93", "/1/93",
          "15/13/24", "15/0/24", "29/2/23", "1/1/993", "1/x/24"}) {
        const auto d = CheckEnteredDate(bad);
        EXPECT_FALSE(d.Ok) << bad;
        EXPECT_EQ(d.Message, " Use  /   or  -  to separate day/month/year\n eg.  2/10/93") << bad;
        EXPECT_EQ(d.Title, "Incorrect Date Format ") << bad;
    }
}

} // namespace
} // namespace kori::platform
