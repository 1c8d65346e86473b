#pragma once
// The number rules the file formats and charts were built on: rounding to nearest with halves
// to even, the classic conversions to 16- and 32-bit integers (which report an overflow rather
// than wrap), integer parts, and a fixed-point currency of four decimals.
#include <compare>
#include <cstdint>
#include <optional>

namespace kori::platform {

// Nearest whole number, halves to the even one (2.5 -> 2, 3.5 -> 4, -2.5 -> -2), whatever the
// floating-point rounding mode in force.
double RoundHalfEven(double x);
// To `decimals` places, halves to even, on the scaled binary value (so 2.675, held as
// 2.67499..., gives 2.67).
double RoundHalfEven(double x, int decimals);

// Classic CInt and CLng: round half to even, then fit the width; nullopt when it does not fit
// (or for NaN), where the classic routine raised an overflow.
std::optional<std::int16_t> CInt(double x);
std::optional<std::int32_t> CLng(double x);

// Integer parts: Fix truncates toward zero, Int floors (Int(-2.5) is -3, Fix(-2.5) is -2).
double Fix(double x);
double Int(double x);
// Fix, then fit the width; nullopt when it does not fit.
std::optional<std::int16_t> FixToInt16(double x);
std::optional<std::int32_t> FixToInt32(double x);

// Currency: a 64-bit count of ten-thousandths. Conversions and products round ties to even.
class Money {
public:
    static constexpr std::int64_t kScale = 10000;

    constexpr Money() = default;
    static constexpr Money FromRaw(std::int64_t tenThousandths) { return Money(tenThousandths); }
    // Rounded to four decimals on the decimal digits of the value (15 significant), halves to
    // even; nullopt when the value is out of range or not a number.
    static std::optional<Money> FromDouble(double value) {
        Money m;
        if (!TryFromDouble(value, m)) return std::nullopt;
        return m;
    }
    // The same conversion into `out`, false when it cannot be held. For loops over every bar:
    // GCC passes an optional result through memory, which costs more than the conversion.
    static bool TryFromDouble(double value, Money& out) {
        // Most prices are nowhere near a tie: below 2^31 ten-thousandths the binary product
        // is within 1e-6 of the decimal value, so one clear of the half by more than 1e-4
        // rounds the same either way, without working out the decimal digits.
        const double scaled = (value < 0 ? -value : value) * kScale;
        if (scaled < 2147483648.0) { // false for a value that is not a number
            // Adding and taking away 2^52 rounds to the nearest whole number, halves to even,
            // in one short chain of instructions.
            const double nearest = (scaled + 0x1p52) - 0x1p52;
            const double off = scaled - nearest;
            if (off > -0.4999 && off < 0.4999) {
                const auto raw = static_cast<std::int64_t>(nearest);
                out = Money(value < 0 ? -raw : raw);
                return true;
            }
        }
        const auto slow = FromDecimalDigits(value);
        if (slow) out = *slow;
        return slow.has_value();
    }

    constexpr std::int64_t raw() const { return m_raw; }
    double ToDouble() const { return static_cast<double>(m_raw) / kScale; }

    constexpr Money operator+(Money o) const { return Money(m_raw + o.m_raw); }
    constexpr Money operator-(Money o) const { return Money(m_raw - o.m_raw); }
    constexpr Money operator-() const { return Money(-m_raw); }
    // Product rounded to four decimals, halves to even; nullopt on overflow.
    std::optional<Money> Times(Money o) const;
    // Quotient as a double, as mixed currency arithmetic gives it; nullopt for a zero divisor.
    std::optional<double> DividedBy(Money o) const;
    // By a whole number: the product, nullopt on overflow; the quotient rounded to four
    // decimals, halves to even, nullopt for a zero divisor.
    // Inline: the averages of the oscillators run these once a bar.
    std::optional<Money> Times(std::int64_t n) const {
        std::int64_t product = 0;
        if (__builtin_mul_overflow(m_raw, n, &product)) return std::nullopt;
        return Money(product);
    }
    std::optional<Money> DividedBy(std::int64_t n) const {
        if (n == 0) return std::nullopt;
        if (n == -1 && m_raw == INT64_MIN) return std::nullopt;
        std::int64_t q = m_raw / n;
        const std::int64_t r = m_raw % n;
        // Twice the remainder against the divisor, in unsigned so neither can overflow.
        const std::uint64_t twice =
            2 * (r < 0 ? static_cast<std::uint64_t>(-(r + 1)) + 1 : static_cast<std::uint64_t>(r));
        const std::uint64_t absN =
            n < 0 ? static_cast<std::uint64_t>(-(n + 1)) + 1 : static_cast<std::uint64_t>(n);
        if (twice > absN || (twice == absN && q % 2 != 0)) q += (m_raw < 0) != (n < 0) ? -1 : 1;
        return Money(q);
    }
    // Sum, nullopt on overflow.
    std::optional<Money> Plus(Money o) const {
        std::int64_t sum = 0;
        if (__builtin_add_overflow(m_raw, o.m_raw, &sum)) return std::nullopt;
        return Money(sum);
    }
    float ToFloat() const { return static_cast<float>(ToDouble()); }

    constexpr auto operator<=>(const Money&) const = default;

private:
    static std::optional<Money> FromDecimalDigits(double value);
    constexpr explicit Money(std::int64_t raw) : m_raw(raw) {}
    std::int64_t m_raw = 0;
};

} // namespace kori::platform
