#include "platform/text.h"

#include <gtest/gtest.h>

using namespace kori::platform;

TEST(Text, StrGivesTheClassicLeadingBlankAndNoLeadingZero) {
    EXPECT_EQ(Str(5), " 5");
    EXPECT_EQ(Str(-5), "-5");
    EXPECT_EQ(Str(0), " 0");
    EXPECT_EQ(Str(0.5), " .5");
    EXPECT_EQ(Str(-0.25), "-.25");
    EXPECT_EQ(Str(123.456), " 123.456");
    EXPECT_EQ(StrSingle(8.25f), " 8.25");
    EXPECT_EQ(StrSingle(0.1f), " .1"); // 7 digits hide the float's binary tail
    EXPECT_EQ(StrSingle(1e20f), " 1E+20");
    EXPECT_EQ(Str(1e-20), " 1E-20");
}

TEST(Text, ValReadsTheLeadingNumberElseZero) {
    EXPECT_EQ(Val("  12.5abc"), 12.5);
    EXPECT_EQ(Val("-3"), -3);
    EXPECT_EQ(Val(" .5"), 0.5);
    EXPECT_EQ(Val("abc"), 0);
    EXPECT_EQ(Val(""), 0);
    EXPECT_EQ(Val("1E3"), 1000);
    EXPECT_EQ(Val("1E"), 1);
    EXPECT_EQ(Val("&HFF"), 255);
    // Longer than any integer: a large number, not an overflow (caught by the fuzzing).
    EXPECT_EQ(Val("&H10000000000000000"), 18446744073709551616.0);
    EXPECT_EQ(Val("-"), 0);
}

TEST(Text, TrimPadAndCase) {
    EXPECT_EQ(Trim("  ab c \r\n"), "ab c");
    EXPECT_EQ(PadRight("BHP", 6), "BHP   ");
    EXPECT_EQ(PadRight("ABCDEFGH", 6), "ABCDEF");
    EXPECT_TRUE(EqualsNoCase("Names.DAT", "names.dat"));
    EXPECT_FALSE(EqualsNoCase("names.da", "names.dat"));
}

TEST(Text, FloatTextReadsBackToTheSameFloat) {
    for (float f : {0.1f, 12.345f, 1e20f, -3.5f, 0.0f, 123456.789f}) {
        EXPECT_EQ(std::stof(FloatText(f)), f) << FloatText(f);
    }
}

TEST(Text, IsNumberTakesOnlyAWholeNumber) {
    for (const char* yes : {"1", " 1.5 ", "-.25", "+3.", "2e3", "1.5E-2", "0"})
        EXPECT_TRUE(kori::platform::IsNumber(yes)) << yes;
    for (const char* no : {"", " ", ".", "-", "1.5x", "1,5", "1.2.3", "2e", "e3", "&H10", "1 2"})
        EXPECT_FALSE(kori::platform::IsNumber(no)) << no;
}
