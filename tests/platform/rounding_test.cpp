#include "platform/rounding.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

using namespace kori::platform;

TEST(Rounding, HalvesGoToTheEvenNeighbour) {
    EXPECT_EQ(RoundHalfEven(0.5), 0.0);
    EXPECT_EQ(RoundHalfEven(1.5), 2.0);
    EXPECT_EQ(RoundHalfEven(2.5), 2.0);
    EXPECT_EQ(RoundHalfEven(-2.5), -2.0);
    EXPECT_EQ(RoundHalfEven(-3.5), -4.0);
    EXPECT_EQ(RoundHalfEven(2.5000001), 3.0);
    EXPECT_EQ(RoundHalfEven(-0.4), 0.0);
    EXPECT_EQ(RoundHalfEven(0.125, 2), 0.12);
    EXPECT_EQ(RoundHalfEven(0.375, 2), 0.38);
    EXPECT_DOUBLE_EQ(RoundHalfEven(1.23456, 4), 1.2346);
}

TEST(Rounding, CIntRoundsHalfEvenAndReportsOverflow) {
    EXPECT_EQ(CInt(2.5), 2);
    EXPECT_EQ(CInt(3.5), 4);
    EXPECT_EQ(CInt(-1.5), -2);
    EXPECT_EQ(CInt(32767.4), 32767);
    EXPECT_FALSE(CInt(32767.5).has_value()); // 32768 after rounding
    EXPECT_EQ(CInt(-32768.5), -32768);       // the even neighbour is still in range
    EXPECT_FALSE(CInt(-32769).has_value());
    EXPECT_FALSE(CInt(std::nan("")).has_value());
    EXPECT_EQ(CLng(70000.5), 70000);
    EXPECT_FALSE(CLng(3e9).has_value());
}

TEST(Rounding, IntegerParts) {
    EXPECT_EQ(Fix(-2.5), -2.0);
    EXPECT_EQ(Int(-2.5), -3.0);
    EXPECT_EQ(Fix(2.9), 2.0);
    EXPECT_EQ(FixToInt16(32767.9), 32767);
    EXPECT_EQ(FixToInt16(-32768.9), -32768);
    EXPECT_FALSE(FixToInt16(32768.0).has_value());
    EXPECT_EQ(FixToInt32(-7.99), -7);
}

// The quick path for values clear of a tie agrees with the decimal digits everywhere.
TEST(Money, ConversionsNearAndFarFromTies) {
    EXPECT_EQ(Money::FromDouble(1.00004999)->raw(), 10000);
    EXPECT_EQ(Money::FromDouble(1.00005001)->raw(), 10001);
    EXPECT_EQ(Money::FromDouble(-1.00005001)->raw(), -10001);
    EXPECT_EQ(Money::FromDouble(0.00025)->raw(), 2); // a tie goes to the even
    EXPECT_EQ(Money::FromDouble(0.00035)->raw(), 4);
    EXPECT_EQ(Money::FromDouble(214748.36475)->raw(), 2147483648); // past the quick path
    for (int i = -3000; i <= 3000; ++i) {
        const double v = i * 0.000137;
        const auto m = Money::FromDouble(v);
        ASSERT_TRUE(m);
        EXPECT_NEAR(static_cast<double>(m->raw()), v * 10000, 0.5 + 1e-9) << v;
    }
}

TEST(Money, WholeNumberArithmeticIsRoundedAndChecked) {
    const auto over = [](std::int64_t raw, std::int64_t n) {
        return Money::FromRaw(raw).DividedBy(n)->raw();
    };
    EXPECT_EQ(over(5, 2), 2);
    EXPECT_EQ(over(7, 2), 4);
    EXPECT_EQ(over(-5, 2), -2);
    EXPECT_EQ(over(5, -2), -2);
    EXPECT_EQ(over(20666, 3), 6889);
    EXPECT_FALSE(Money::FromRaw(1).DividedBy(std::int64_t{0}).has_value());
    EXPECT_EQ(Money::FromDouble(10.9f - 10.2f)->raw(), 7000); // the float 0.6999998 is 0.7
    const Money big = Money::FromRaw(std::numeric_limits<std::int64_t>::max() / 2 + 1);
    EXPECT_FALSE(big.Times(std::int64_t{2}).has_value());
    EXPECT_FALSE(big.Plus(big).has_value());
    EXPECT_EQ(Money::FromRaw(3).Times(std::int64_t{-4})->raw(), -12);
    // A price too large for currency, or not a number, is refused rather than wrapped.
    EXPECT_FALSE(Money::FromDouble(1e30).has_value());
    EXPECT_FALSE(Money::FromDouble(std::nan("")).has_value());
}

TEST(Money, FourDecimalsWithTiesToEven) {
    EXPECT_EQ(Money::FromDouble(1.23456)->raw(), 12346);
    EXPECT_EQ(Money::FromDouble(0.00005)->raw(), 0); // half a unit goes to the even 0
    EXPECT_EQ(Money::FromDouble(0.00015)->raw(), 2); // a tie as typed, not as held in binary
    EXPECT_EQ(Money::FromDouble(-0.00025)->raw(), -2);
    EXPECT_EQ(Money::FromDouble(922337203685477.0)->raw(), 9223372036854770000);
    EXPECT_EQ(Money::FromDouble(-2.5)->raw(), -25000);
    EXPECT_FALSE(Money::FromDouble(1e15).has_value());
    EXPECT_FALSE(Money::FromDouble(std::numeric_limits<double>::infinity()).has_value());

    const Money a = Money::FromRaw(15000);              // 1.5
    const Money b = Money::FromRaw(3);                  // 0.0003
    EXPECT_EQ(a.Times(b)->raw(), 4);                    // 0.00045 -> 0.0004
    EXPECT_EQ(Money::FromRaw(5000).Times(b)->raw(), 2); // 0.00015 -> 0.0002
    EXPECT_EQ((-a).Times(b)->raw(), -4);
    EXPECT_FALSE(Money::FromRaw(std::numeric_limits<std::int64_t>::max())
                     .Times(Money::FromRaw(20000))
                     .has_value());
    EXPECT_EQ((a + b).raw(), 15003);
    EXPECT_EQ((a - b).ToDouble(), 1.4997);
    EXPECT_DOUBLE_EQ(*a.DividedBy(Money::FromRaw(30000)), 0.5);
    EXPECT_FALSE(a.DividedBy(Money{}).has_value());
    EXPECT_LT(b, a);
}
