#include "platform/date_text.h"

#include <gtest/gtest.h>

using namespace kori::platform;

TEST(DateText, ConversionsGoByPositionWithoutChecking) {
    EXPECT_EQ(DateTextToDisplay("20240305"), "05/03/2024");
    EXPECT_EQ(DateTextToShort("20240305"), "05/03/24");
    EXPECT_EQ(DateDisplayToText("05/03/2024"), "20240305");
    // Bad input goes through as bad text, cut to what is there.
    EXPECT_EQ(DateTextToDisplay("2024"), "//2024");
    EXPECT_EQ(DateTextToShort(""), "//");
    EXPECT_EQ(DateDisplayToText("5/3/24"), "/25/");
    EXPECT_EQ(DateTextToDisplay("20241399"), "99/13/2024");
}

TEST(DateText, ValidDatesKnowLeapYears) {
    EXPECT_TRUE(IsValidDateText("20000229"));
    EXPECT_TRUE(IsValidDateText("20240229"));
    EXPECT_FALSE(IsValidDateText("19000229"));
    EXPECT_FALSE(IsValidDateText("20230229"));
    EXPECT_FALSE(IsValidDateText("20241301"));
    EXPECT_FALSE(IsValidDateText("20240100"));
    EXPECT_FALSE(IsValidDateText("2024010"));
    EXPECT_FALSE(IsValidDateText("2024-1-1"));
}

TEST(DateText, WeekdayCountsFromSunday) {
    EXPECT_EQ(Weekday("20240303"), 1); // Sunday
    EXPECT_EQ(Weekday("20240305"), 3); // Tuesday
    EXPECT_EQ(Weekday("20240309"), 7); // Saturday
    EXPECT_EQ(Weekday("19000101"), 2); // Monday
    EXPECT_EQ(Weekday("19691231"), 4); // Wednesday, before the internal epoch
    EXPECT_FALSE(Weekday("20240230").has_value());
    EXPECT_FALSE(Weekday("        ").has_value());
    EXPECT_FALSE(Weekday("").has_value());
}

TEST(DateText, DaySerialBothWays) {
    EXPECT_EQ(DaySerial("18991230"), 0);
    EXPECT_EQ(DaySerial("19000101"), 2);
    EXPECT_EQ(DaySerial("20000101"), 36526);
    EXPECT_EQ(*DaySerial("20240305") - *DaySerial("20240228"), 6); // through 29 February
    EXPECT_EQ(DateTextFromSerial(36526), "20000101");
    EXPECT_EQ(DateTextFromSerial(*DaySerial("20231231") + 1), "20240101");
    EXPECT_EQ(DateTextFromSerial(-1), "18991229");
    EXPECT_FALSE(DaySerial("2024").has_value());
    EXPECT_FALSE(DateTextFromSerial(3'000'000).has_value()); // beyond the year 9999
}
