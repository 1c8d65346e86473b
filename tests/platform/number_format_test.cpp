#include "platform/number_format.h"

#include <gtest/gtest.h>

using kori::platform::Format;
using kori::platform::FormatDate;
using kori::platform::FormatSingle;
using kori::platform::ZeroSign;

namespace {

struct NumberCase {
    double value;
    const char* pattern;
    const char* expected;
};

// Every pattern the program shows figures with, plus the corners of the rules.
constexpr NumberCase kNumberCases[] = {
    // trailing '#' places drop zeros, '0' places keep them; rounding of the last shown digit
    {1.5, "0.00#", "1.50"},
    {1.2345, "0.00#", "1.235"},
    {0, "0.00#", "0.00"},
    {-2.5, "0.00#", "-2.50"},
    {1.005, "0.00", "1.01"}, // rounded on the decimal digits, not the binary value
    {0.95, "0.0", "1.0"},
    {9.9999, "0.00", "10.00"}, // carry into a new integer digit
    {2.5, "0", "3"},           // halves go away from zero here, unlike CInt
    {-2.5, "0", "-3"},
    {-0.001, "0.00", "-0.00"}, // the sign stays on a value that rounds to zero
    // leading '#' places show no zero
    {123.4567, "#####.00#", "123.457"},
    {0.5, "#####.00#", ".50"},
    {0.0567, ".00#", ".057"},
    {0.05, ".00#", ".05"},
    {5.25, ".00", "5.25"}, // integer digits shown with no integer place
    {0.456, "#.00", ".46"},
    {12.3, "#####0.00", "12.30"},
    {0.0049, "#####0.00", "0.00"},
    {1234.5, "####.00", "1234.50"},
    {-3.456, "####.00", "-3.46"},
    {12.5, "####.0###", "12.5"},
    {1.23456789, "#####.######", "1.234568"},
    {12.3456, "###.00", "12.35"},
    {7.25, "#0.00#", "7.25"},
    {0.1, "###.00#", ".10"},
    {1234567.891, "######.00", "1234567.89"},
    {-0.0004, "0.000", "-0.000"},
    {2.71828, "0.0000", "2.7183"},
    {14.96, "0.0", "15.0"},
    {99999.5, "#####", "100000"},
    // integers
    {0, "######", ""},
    {12345.6, "######", "12346"},
    {1234.5, "######0", "1235"},
    {0, "###0", "0"},
    {3, "###0", "3"},
    {0, "#", ""},
    {12, "000", "012"},
    {1234, "000", "1234"}, // more digits than places are all shown
    {7, "0000", "0007"},
    {12.34, "000.0", "012.3"},
    {12.25, "####0.0", "12.3"},
    // '#' before the point keeps the point even with no digits after it
    {5, "##.#", "5."},
    {0.04, "##.#", "."},
    {12.34, "##.#", "12.3"},
    {12345.678, "##.#", "12345.7"},
    // grouping and scaling by thousands
    {1234567, "#,###", "1,234,567"},
    {999.5, "#,###", "1,000"},
    {123, "#,###", "123"},
    {0, "#,###", ""},
    {-1234, "#,###", "-1,234"},
    {1234567, "#,##0,", "1,235"},
    // percent
    {0.1234, "0.0%", "12.3%"},
    {0.05, "#.0%", "5.0%"},
    {0.004, "#.0%", ".4%"},
    {0.12345, "0.00 %", "12.35 %"},
    {-0.5, "0%", "-50%"},
    // literals, escapes and sections
    {12.25, "$0.00", "$12.25"},
    {-12.25, "$0.00", "-$12.25"},
    {5, "0\\k", "5k"},
    {5, "\"Qty \"0", "Qty 5"},
    {-5, "0;(0)", "(5)"},
    {0, "0;(0);\"nil\"", "nil"},
    // no pattern: general form
    {0.5, "", "0.5"},
    {-12.25, "", "-12.25"},
};

} // namespace

TEST(Format, NumberPatterns) {
    for (const auto& c : kNumberCases)
        EXPECT_EQ(Format(c.value, c.pattern), c.expected)
            << "Format(" << c.value << ", \"" << c.pattern << "\")";
}

TEST(Format, SinglesUseTheirOwnSevenDigits) {
    // 0.145f is 0.1449999958... as a double: the single rounds up, its double expansion down.
    EXPECT_EQ(FormatSingle(0.145f, "0.00"), "0.15");
    EXPECT_EQ(Format(static_cast<double>(0.145f), "0.00"), "0.14");
    EXPECT_EQ(FormatSingle(1.1f, "#####.00#"), "1.10");
}

// Chart labels drop the sign of a negative that shows as zero; a figure that shows digits
// keeps it, and so does everything else by default.
TEST(Format, ZeroSignDroppedOnRequest) {
    constexpr auto dropped = ZeroSign::Dropped;
    EXPECT_EQ(Format(-0.001, "0.00", dropped), "0.00");
    EXPECT_EQ(Format(-0.04, "##.#", dropped), ".");
    EXPECT_EQ(Format(-0.3, "######", dropped), "");
    EXPECT_EQ(Format(-0.0001, "0.0000", dropped), "-0.0001");
    EXPECT_EQ(Format(-3.456, "0.00", dropped), "-3.46");
    EXPECT_EQ(FormatSingle(-1e-7f, ".00#", dropped), ".00");
    EXPECT_EQ(FormatSingle(-2.675f, "#####0.00", dropped), "-2.68");
    EXPECT_EQ(Format(-0.001, "0.00"), "-0.00");
    EXPECT_EQ(FormatSingle(-1e-7f, ".00#"), "-.00");
}

TEST(Format, DatePatterns) {
    struct DateCase {
        const char* date;
        const char* pattern;
        const char* expected;
    };
    constexpr DateCase cases[] = {
        {"20240305", "Medium Date", "05-Mar-24"},
        {"20240305", "ddMMMyy", "05Mar24"},
        {"20240305", "d/m/yy", "5/3/24"},
        {"20240305", "dd/mm/yyyy", "05/03/2024"},
        {"19991231", "d/m/yy", "31/12/99"},
        {"20240305", "dddd d mmmm yyyy", "Tuesday 5 March 2024"},
        {"20000229", "ddd dd-mmm-yyyy", "Tue 29-Feb-2000"},
        {"20230229", "dd/mm/yyyy", ""}, // not a calendar date
        {"2024030", "dd/mm/yyyy", ""},
        {"2024a305", "dd/mm/yyyy", ""},
    };
    for (const auto& c : cases)
        EXPECT_EQ(FormatDate(c.date, c.pattern), c.expected) << c.date << " " << c.pattern;
}
