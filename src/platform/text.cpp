#include "platform/text.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstdlib>

namespace kori::platform {

namespace {
bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\0';
}

// Formats with `digits` significant digits in the classic style.
std::string ClassicStr(double value, int digits) {
    if (value == 0.0 || std::isnan(value)) return " 0";
    char buf[64];
    const double mag = std::fabs(value);
    const int exp10 = static_cast<int>(std::floor(std::log10(mag)));
    std::string body;
    if (exp10 >= digits || exp10 < -digits) {
        std::snprintf(buf, sizeof buf, "%.*E", digits - 1, mag);
        std::string s(buf);
        const auto e = s.find('E');
        std::string mant = s.substr(0, e);
        std::string ex = s.substr(e + 1);
        if (mant.find('.') != std::string::npos) {
            while (!mant.empty() && mant.back() == '0')
                mant.pop_back();
            if (!mant.empty() && mant.back() == '.') mant.pop_back();
        }
        // Exponent as "E+20" / "E-05": sign always, at least two digits.
        const char sign = ex[0];
        std::string digitsPart = ex.substr(1);
        while (digitsPart.size() > 2 && digitsPart[0] == '0')
            digitsPart.erase(0, 1);
        body = mant + "E" + sign + digitsPart;
    } else {
        const int decimals = std::max(0, digits - 1 - exp10);
        std::snprintf(buf, sizeof buf, "%.*f", decimals, mag);
        body = buf;
        if (body.find('.') != std::string::npos) {
            while (!body.empty() && body.back() == '0')
                body.pop_back();
            if (!body.empty() && body.back() == '.') body.pop_back();
        }
        if (body.size() > 1 && body[0] == '0' && body[1] == '.') body.erase(0, 1);
        if (body.empty() || body == "0") return " 0";
    }
    return (value < 0 ? "-" : " ") + body;
}
} // namespace

std::string TrimLeft(std::string_view s) {
    std::size_t b = 0;
    while (b < s.size() && IsBlank(s[b]))
        ++b;
    return std::string(s.substr(b));
}

std::string TrimRight(std::string_view s) {
    std::size_t e = s.size();
    while (e > 0 && IsBlank(s[e - 1]))
        --e;
    return std::string(s.substr(0, e));
}

void AppendLatin1AsUtf8(std::string& out, char ch) {
    const auto u = static_cast<unsigned char>(ch);
    if (u < 0x80) {
        out += ch;
        return;
    }
    out += static_cast<char>(0xC0 | (u >> 6));
    out += static_cast<char>(0x80 | (u & 0x3F));
}

std::string Latin1ToUtf8(std::string_view text) {
    std::string r;
    r.reserve(text.size());
    for (char ch : text)
        AppendLatin1AsUtf8(r, ch);
    return r;
}

std::string Trim(std::string_view s) {
    return TrimLeft(TrimRight(s));
}

std::string Upper(std::string_view s) {
    std::string r(s);
    for (auto& c : r)
        c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
    return r;
}

std::string Lower(std::string_view s) {
    std::string r(s);
    for (auto& c : r)
        c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return r;
}

bool EqualsNoCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if (std::tolower(static_cast<unsigned char>(a[i])) !=
            std::tolower(static_cast<unsigned char>(b[i])))
            return false;
    return true;
}

std::string PadRight(std::string_view s, std::size_t width) {
    std::string r(s.substr(0, std::min(s.size(), width)));
    r.resize(width, ' ');
    return r;
}

std::string Str(double value) {
    return ClassicStr(value, 15);
}

std::string StrSingle(float value) {
    return ClassicStr(static_cast<double>(value), 7);
}

bool IsNumber(std::string_view text) {
    const std::string t = Trim(text);
    std::size_t i = 0;
    const auto digitsAt = [&t](std::size_t& at) {
        const std::size_t from = at;
        while (at < t.size() && std::isdigit(static_cast<unsigned char>(t[at])))
            ++at;
        return at - from;
    };
    if (i < t.size() && (t[i] == '-' || t[i] == '+')) ++i;
    std::size_t digits = digitsAt(i);
    if (i < t.size() && t[i] == '.') {
        ++i;
        digits += digitsAt(i);
    }
    if (digits == 0) return false;
    if (i < t.size() && (t[i] == 'e' || t[i] == 'E')) {
        ++i;
        if (i < t.size() && (t[i] == '-' || t[i] == '+')) ++i;
        if (digitsAt(i) == 0) return false;
    }
    return i == t.size();
}

double Val(std::string_view text) {
    std::size_t i = 0;
    while (i < text.size() && IsBlank(text[i]))
        ++i;
    if (i + 1 < text.size() && text[i] == '&' && (text[i + 1] == 'H' || text[i + 1] == 'h')) {
        // In a double: a hex run longer than any integer holds must not overflow.
        double v = 0;
        std::size_t j = i + 2;
        while (j < text.size() && std::isxdigit(static_cast<unsigned char>(text[j]))) {
            v = v * 16 + std::stoi(std::string(1, text[j]), nullptr, 16);
            ++j;
        }
        return v;
    }
    std::string num;
    if (i < text.size() && (text[i] == '-' || text[i] == '+')) num += text[i++];
    bool digits = false;
    while (i < text.size() && std::isdigit(static_cast<unsigned char>(text[i]))) {
        num += text[i++];
        digits = true;
    }
    if (i < text.size() && text[i] == '.') {
        num += text[i++];
        while (i < text.size() && std::isdigit(static_cast<unsigned char>(text[i]))) {
            num += text[i++];
            digits = true;
        }
    }
    if (!digits) return 0.0;
    if (i < text.size() && (text[i] == 'E' || text[i] == 'e' || text[i] == 'D' || text[i] == 'd')) {
        std::string ex = "e";
        std::size_t j = i + 1;
        if (j < text.size() && (text[j] == '-' || text[j] == '+')) ex += text[j++];
        bool exDigits = false;
        while (j < text.size() && std::isdigit(static_cast<unsigned char>(text[j]))) {
            ex += text[j++];
            exDigits = true;
        }
        if (exDigits) num += ex;
    }
    return std::strtod(num.c_str(), nullptr);
}

std::string FloatText(float value) {
    char buf[32];
    auto res = std::to_chars(buf, buf + sizeof buf, value);
    return std::string(buf, res.ptr);
}

} // namespace kori::platform
