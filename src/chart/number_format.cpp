#include "chart/number_format.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>

namespace kori::chart {

namespace {

struct Pattern {
    int minInt = 0;  // '0's before the point
    int minFrac = 0; // leading '0's after the point
    int maxFrac = 0; // all digit places after the point
    bool point = false;
    bool grouping = false;
};

Pattern Parse(std::string_view p) {
    Pattern r;
    bool frac = false;
    for (char c : p) {
        if (c == '.') {
            frac = true;
            r.point = true;
        } else if (c == ',' && !frac) {
            r.grouping = true;
        } else if (c == '0' || c == '#') {
            if (!frac) {
                if (c == '0') ++r.minInt;
            } else {
                if (c == '0' && r.maxFrac == r.minFrac) ++r.minFrac;
                ++r.maxFrac;
            }
        }
    }
    return r;
}

// Digits of |value| rounded half away from zero to `decimals` places, from its decimal form
// with `significant` digits: integer part and exactly `decimals` fraction digits.
void RoundedDigits(double value, int significant, int decimals, std::string& whole,
                   std::string& fraction) {
    char buf[64];
    std::snprintf(buf, sizeof buf, "%.*e", significant - 1, std::fabs(value));
    const std::string s(buf);
    const std::size_t e = s.find('e');
    std::string mant;
    for (std::size_t i = 0; i < e; ++i)
        if (s[i] != '.') mant += s[i];
    const int exp10 = std::atoi(s.c_str() + e + 1);
    // digits[k] has weight 10^(exp10 - k); lay them out around the point.
    const int intLen = exp10 + 1;
    std::string digits = mant;
    int pointAt = intLen; // index in `digits` where the point falls
    if (pointAt <= 0) {
        digits.insert(0, static_cast<std::size_t>(1 - pointAt), '0');
        pointAt = 1;
    }
    const int want = pointAt + decimals;
    if (static_cast<int>(digits.size()) < want + 1)
        digits.append(static_cast<std::size_t>(want + 1 - static_cast<int>(digits.size())), '0');
    const bool up = digits[static_cast<std::size_t>(want)] >= '5';
    digits.resize(static_cast<std::size_t>(want));
    if (up) {
        int i = want - 1;
        while (i >= 0 && digits[static_cast<std::size_t>(i)] == '9')
            digits[static_cast<std::size_t>(i--)] = '0';
        if (i >= 0) {
            ++digits[static_cast<std::size_t>(i)];
        } else {
            digits.insert(digits.begin(), '1');
            ++pointAt;
        }
    }
    whole = digits.substr(0, static_cast<std::size_t>(pointAt));
    fraction = digits.substr(static_cast<std::size_t>(pointAt));
    const std::size_t nz = whole.find_first_not_of('0');
    whole = nz == std::string::npos ? "" : whole.substr(nz);
}

std::string Group(const std::string& whole) {
    std::string out;
    const std::size_t n = whole.size();
    for (std::size_t i = 0; i < n; ++i) {
        if (i > 0 && (n - i) % 3 == 0) out += ',';
        out += whole[i];
    }
    return out;
}

std::string Format(double value, int significant, std::string_view pattern) {
    if (!std::isfinite(value)) return std::to_string(value);
    const Pattern p = Parse(pattern);
    std::string whole, fraction;
    RoundedDigits(value, significant, p.maxFrac, whole, fraction);
    while (static_cast<int>(fraction.size()) > p.minFrac && fraction.back() == '0')
        fraction.pop_back();
    if (static_cast<int>(whole.size()) < p.minInt)
        whole.insert(0, static_cast<std::size_t>(p.minInt) - whole.size(), '0');
    if (p.grouping) whole = Group(whole);
    const bool zero = whole.find_first_not_of("0,") == std::string::npos &&
                      fraction.find_first_not_of('0') == std::string::npos;
    std::string out = (value < 0 && !zero) ? "-" : "";
    out += whole;
    if (p.point) out += "." + fraction; // the point stands even with no digits after it
    return out;
}

} // namespace

std::string FormatNumber(double value, std::string_view pattern) {
    return Format(value, 15, pattern);
}

std::string FormatNumber(float value, std::string_view pattern) {
    return Format(static_cast<double>(value), 7, pattern);
}

} // namespace kori::chart
