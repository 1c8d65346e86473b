#include "platform/rounding.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <string>

namespace kori::platform {

namespace {

template <typename T> std::optional<T> Fit(double whole) {
    if (std::isnan(whole)) return std::nullopt;
    if (whole < static_cast<double>(std::numeric_limits<T>::min()) ||
        whole > static_cast<double>(std::numeric_limits<T>::max()))
        return std::nullopt;
    return static_cast<T>(whole);
}

__extension__ typedef __int128 Wide;

// a / b for b > 0, halves to even.
Wide DivideHalfEven(Wide a, Wide b) {
    Wide q = a / b;
    Wide r = a % b;
    if (r < 0) r = -r;
    const Wide twice = 2 * r;
    const bool away = twice > b || (twice == b && q % 2 != 0);
    if (away) q += a < 0 ? -1 : 1;
    return q;
}

} // namespace

double RoundHalfEven(double x) {
    if (!std::isfinite(x)) return x;
    const double lower = std::floor(x);
    const double diff = x - lower;
    if (diff < 0.5) return lower;
    if (diff > 0.5) return lower + 1.0;
    return std::fmod(lower, 2.0) == 0.0 ? lower : lower + 1.0;
}

double RoundHalfEven(double x, int decimals) {
    const double scale = std::pow(10.0, decimals);
    return RoundHalfEven(x * scale) / scale;
}

std::optional<std::int16_t> CInt(double x) {
    return Fit<std::int16_t>(RoundHalfEven(x));
}
std::optional<std::int32_t> CLng(double x) {
    return Fit<std::int32_t>(RoundHalfEven(x));
}

double Fix(double x) {
    return std::trunc(x);
}
double Int(double x) {
    return std::floor(x);
}

std::optional<std::int16_t> FixToInt16(double x) {
    return Fit<std::int16_t>(Fix(x));
}
std::optional<std::int32_t> FixToInt32(double x) {
    return Fit<std::int32_t>(Fix(x));
}

std::optional<Money> Money::FromDecimalDigits(double value) {
    if (!std::isfinite(value)) return std::nullopt;
    // Work on the 15 significant decimal digits of the value, so that 0.00015 is the tie it
    // was typed as and not the 1.4999... that its binary form times 10000 gives.
    char buf[64];
    std::snprintf(buf, sizeof buf, "%.14e", std::fabs(value));
    const std::string text(buf);
    const auto e = text.find('e');
    std::string digits;
    for (std::size_t i = 0; i < e; ++i)
        if (text[i] != '.') digits += text[i];
    const long whole = std::strtol(text.c_str() + e + 1, nullptr, 10) + 1 + 4; // digits kept
    if (whole > 19) return std::nullopt;
    if (value == 0.0 || whole < 0) return Money();
    const auto keep = static_cast<std::size_t>(whole);
    std::string kept = digits.substr(0, std::min(keep, digits.size()));
    kept.append(keep - kept.size(), '0');
    const std::string rest = keep < digits.size() ? digits.substr(keep) : "";
    std::string half(rest.size(), '0'); // the remainder that is exactly one half
    if (!half.empty()) half.front() = '5';
    unsigned long long units = kept.empty() ? 0 : std::stoull(kept);
    const int cmp = rest.empty() ? -1 : rest.compare(half);
    if (cmp > 0 || (cmp == 0 && units % 2 == 1)) ++units;
    if (units > static_cast<unsigned long long>(std::numeric_limits<std::int64_t>::max()))
        return std::nullopt;
    const auto raw = static_cast<std::int64_t>(units);
    return Money(value < 0 ? -raw : raw);
}

std::optional<Money> Money::Times(Money o) const {
    const Wide product = DivideHalfEven(static_cast<Wide>(m_raw) * o.m_raw, kScale);
    if (product > std::numeric_limits<std::int64_t>::max() ||
        product < std::numeric_limits<std::int64_t>::min())
        return std::nullopt;
    return Money(static_cast<std::int64_t>(product));
}

std::optional<double> Money::DividedBy(Money o) const {
    if (o.m_raw == 0) return std::nullopt;
    return static_cast<double>(m_raw) / static_cast<double>(o.m_raw);
}

} // namespace kori::platform
