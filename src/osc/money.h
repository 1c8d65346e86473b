#pragma once
// Currency: a 64-bit count of ten-thousandths. Conversions round to the nearest ten-thousandth,
// ties to even, so small prices stay exact where a float would drift.
#include <cmath>
#include <compare>
#include <cstdint>

namespace kori::osc {

struct Money {
    std::int64_t Raw = 0; // ten-thousandths

    static Money FromDouble(double v) {
        return Money{static_cast<std::int64_t>(std::nearbyint(v * 10000.0))};
    }
    double ToDouble() const { return static_cast<double>(Raw) / 10000.0; }
    float ToFloat() const { return static_cast<float>(ToDouble()); }

    friend auto operator<=>(Money, Money) = default;
    friend Money operator+(Money a, Money b) { return Money{a.Raw + b.Raw}; }
    friend Money operator-(Money a, Money b) { return Money{a.Raw - b.Raw}; }
    friend Money operator*(Money a, std::int64_t n) { return Money{a.Raw * n}; }
    // Division by a whole number, rounded to the nearest ten-thousandth, ties to even.
    friend Money operator/(Money a, std::int64_t n) {
        std::int64_t q = a.Raw / n;
        const std::int64_t r = a.Raw % n;
        const std::int64_t twice = 2 * (r < 0 ? -r : r);
        const std::int64_t absN = n < 0 ? -n : n;
        const bool negative = (a.Raw < 0) != (n < 0);
        if (twice > absN || (twice == absN && (q % 2 != 0))) q += negative ? -1 : 1;
        return Money{q};
    }
};

} // namespace kori::osc
