#include "platform/date_text.h"

#include <array>
#include <cstdio>

namespace kori::platform {

namespace {

// Classic Mid$: 1-based start, cut to what the text holds.
std::string_view Mid(std::string_view s, std::size_t start, std::size_t length) {
    if (start - 1 >= s.size()) return {};
    return s.substr(start - 1, length);
}

// Days from 1970-01-01 to a proleptic Gregorian date (H. Hinnant's civil algorithms).
std::int64_t DaysFromCivil(CivilDate d) {
    const std::int64_t y = d.year - (d.month <= 2 ? 1 : 0);
    const std::int64_t era = (y >= 0 ? y : y - 399) / 400;
    const std::int64_t yoe = y - era * 400;
    const std::int64_t mp = (d.month + 9) % 12;
    const std::int64_t doy = (153 * mp + 2) / 5 + d.day - 1;
    const std::int64_t doe = yoe * 365 + yoe / 4 - yoe / 100 + doy;
    return era * 146097 + doe - 719468;
}

CivilDate CivilFromDays(std::int64_t z) {
    z += 719468;
    const std::int64_t era = (z >= 0 ? z : z - 146096) / 146097;
    const std::int64_t doe = z - era * 146097;
    const std::int64_t yoe = (doe - doe / 1460 + doe / 36524 - doe / 146096) / 365;
    const std::int64_t doy = doe - (365 * yoe + yoe / 4 - yoe / 100);
    const std::int64_t mp = (5 * doy + 2) / 153;
    const auto day = static_cast<int>(doy - (153 * mp + 2) / 5 + 1);
    const auto month = static_cast<int>(mp < 10 ? mp + 3 : mp - 9);
    const auto year = static_cast<int>(yoe + era * 400 + (month <= 2 ? 1 : 0));
    return {year, month, day};
}

// 30 December 1899 counted from 1970-01-01.
constexpr std::int64_t kSerialEpoch = -25569;

} // namespace

std::string DateTextToDisplay(std::string_view d) {
    return std::string(Mid(d, 7, 2)) + "/" + std::string(Mid(d, 5, 2)) + "/" +
           std::string(Mid(d, 1, 4));
}

std::string DateTextToShort(std::string_view d) {
    return std::string(Mid(d, 7, 2)) + "/" + std::string(Mid(d, 5, 2)) + "/" +
           std::string(Mid(d, 3, 2));
}

std::string DateDisplayToText(std::string_view d) {
    return std::string(Mid(d, 7, 4)) + std::string(Mid(d, 4, 2)) + std::string(Mid(d, 1, 2));
}

int DaysInMonth(int year, int month) {
    static constexpr std::array<int, 12> days = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    if (month < 1 || month > 12) return 0;
    const bool leap = (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
    return month == 2 && leap ? 29 : days[static_cast<std::size_t>(month - 1)];
}

std::optional<CivilDate> ParseDateText(std::string_view text) {
    if (text.size() != 8) return std::nullopt;
    int v[3] = {0, 0, 0};
    for (std::size_t i = 0; i < 8; ++i) {
        if (text[i] < '0' || text[i] > '9') return std::nullopt;
        int& field = v[i < 4 ? 0 : (i < 6 ? 1 : 2)];
        field = field * 10 + (text[i] - '0');
    }
    const CivilDate d{v[0], v[1], v[2]};
    if (d.year < 1 || d.day < 1 || d.day > DaysInMonth(d.year, d.month)) return std::nullopt;
    return d;
}

bool IsValidDateText(std::string_view text) {
    return ParseDateText(text).has_value();
}

std::string DateText(CivilDate d) {
    char buf[16];
    std::snprintf(buf, sizeof buf, "%04d%02d%02d", d.year % 10000, d.month % 100, d.day % 100);
    return buf;
}

std::optional<int> Weekday(std::string_view text) {
    const auto d = ParseDateText(text);
    if (!d) return std::nullopt;
    // 1970-01-01 was a Thursday (5 with Sunday = 1).
    const std::int64_t days = DaysFromCivil(*d);
    return static_cast<int>(((days % 7 + 7 + 4) % 7) + 1);
}

std::optional<std::int32_t> DaySerial(std::string_view text) {
    const auto d = ParseDateText(text);
    if (!d) return std::nullopt;
    return static_cast<std::int32_t>(DaysFromCivil(*d) - kSerialEpoch);
}

std::optional<std::string> DateTextFromSerial(std::int32_t serial) {
    const CivilDate d = CivilFromDays(serial + kSerialEpoch);
    if (d.year < 1 || d.year > 9999) return std::nullopt;
    return DateText(d);
}

} // namespace kori::platform
