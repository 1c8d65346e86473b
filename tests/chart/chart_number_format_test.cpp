#include "chart/number_format.h"

#include <gtest/gtest.h>

using kori::chart::FormatNumber;

TEST(FormatNumber, LabelPatterns) {
    struct Case {
        double value;
        const char* pattern;
        const char* text;
    } cases[] = {
        {12.5, "###.00", "12.50"},
        {0.5, "###.00", ".50"},
        {1234.5, "###.00", "1234.50"},
        {0.125, "###.00#", ".125"},
        {0.12, "###.00#", ".12"},
        {1234.5, "######", "1235"},
        {0, "######", ""},
        {0.005, ".00#", ".005"},
        {0, ".00#", ".00"},
        {1.5, "0.00#", "1.50"},
        {0.25, "0.00#", "0.25"},
        {12.5, "#####.00#", "12.50"},
        {12.5, "#####", "13"},
        {2.2, "#####0.00", "2.20"},
        {0, "#####0.00", "0.00"},
        {1234567, "#,###", "1,234,567"},
        {-3.456, "0.00", "-3.46"},
        {999.996, "0.00", "1000.00"},
        {-0.001, "0.00", "0.00"},
        {7, "#.##", "7."},
    };
    for (const Case& c : cases)
        EXPECT_EQ(FormatNumber(c.value, c.pattern), c.text) << c.value;
}

TEST(FormatNumber, RoundsHalfAwayFromZeroOnThePrintedDigits) {
    // 2.675f is 2.67499995... in binary but prints as 2.675 with seven digits.
    EXPECT_EQ(FormatNumber(2.675f, "#####0.00"), "2.68");
    EXPECT_EQ(FormatNumber(-2.675f, "#####0.00"), "-2.68");
    EXPECT_EQ(FormatNumber(0.125, "0.00"), "0.13");
    EXPECT_EQ(FormatNumber(0.105f, "#####0.00"), "0.11");
}
