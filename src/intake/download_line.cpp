#include "intake/download_line.h"

#include "platform/text.h"
#include "store/name_record.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <limits>

namespace kori::intake {

int CountCommas(std::string_view line) {
    return static_cast<int>(std::count(line.begin(), line.end(), ','));
}

std::vector<std::string> SplitFields(std::string_view line) {
    std::vector<std::string> fields;
    std::string field;
    bool quoted = false;
    for (const char c : line) {
        if (c == '"') {
            quoted = !quoted;
        } else if (c == ',' && !quoted) {
            fields.push_back(platform::Trim(field));
            field.clear();
        } else {
            field += c;
        }
    }
    fields.push_back(platform::Trim(field));
    return fields;
}

namespace {

std::int32_t ToInt32(double v) {
    // The volume column is 32-bit: a figure beyond it is held at its limit, never wrapped.
    const double r = std::nearbyint(v);
    if (!(r == r)) return 0;
    if (r >= static_cast<double>(std::numeric_limits<std::int32_t>::max()))
        return std::numeric_limits<std::int32_t>::max();
    if (r <= static_cast<double>(std::numeric_limits<std::int32_t>::min()))
        return std::numeric_limits<std::int32_t>::min();
    return static_cast<std::int32_t>(r);
}

} // namespace

DownloadLine ParseDownloadLine(std::string_view line) {
    const auto f = SplitFields(line);
    auto at = [&](std::size_t i) -> std::string_view {
        return i < f.size() ? std::string_view(f[i]) : std::string_view();
    };
    DownloadLine d;
    d.Code = std::string(at(0));
    d.Date = std::string(at(1));
    d.Open = static_cast<float>(platform::Val(at(2)));
    d.High = static_cast<float>(platform::Val(at(3)));
    d.Low = static_cast<float>(platform::Val(at(4)));
    d.Close = static_cast<float>(platform::Val(at(5)));
    d.Volume = ToInt32(platform::Val(at(6)));
    d.Spare = platform::Val(at(7));
    d.OptType = platform::Upper(at(8));
    return d;
}

std::vector<std::string_view> SplitLines(std::string_view text) {
    std::vector<std::string_view> lines;
    std::size_t start = 0;
    while (start < text.size()) {
        std::size_t end = text.find('\n', start);
        const bool last = end == std::string_view::npos;
        if (last) end = text.size();
        std::string_view line = text.substr(start, end - start);
        if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
        lines.push_back(line);
        if (last) break;
        start = end + 1;
    }
    return lines;
}

std::string ArrivalCode(std::string_view delivered) {
    const std::string code = platform::Trim(delivered.substr(0, 6));
    if (code.empty()) return code;
    return platform::Trim(store::PadCode(code));
}

bool IsEightDigitDate(std::string_view date) {
    return date.size() == 8 &&
           std::all_of(date.begin(), date.end(), [](char c) { return c >= '0' && c <= '9'; });
}

std::int16_t NewEquityCategory(std::string_view code) {
    if (code.size() != 6) return 1;
    switch (std::toupper(static_cast<unsigned char>(code[3]))) {
    case 'E':
        return 86;
    case 'I':
        return 87;
    case 'W':
        return 84;
    default:
        return 88;
    }
}

} // namespace kori::intake
