#include "platform/date_entry.h"

#include "platform/date_text.h"
#include "platform/text.h"

#include <cctype>
#include <optional>
#include <vector>

namespace kori::platform {

namespace {

bool AllDigits(std::string_view s) {
    if (s.empty()) return false;
    for (char c : s)
        if (!std::isdigit(static_cast<unsigned char>(c))) return false;
    return true;
}

int Number(std::string_view digits) {
    int n = 0;
    for (char c : digits)
        n = n * 10 + (c - '0');
    return n;
}

DateEntryCheck Refused(std::string_view message) {
    DateEntryCheck r;
    r.Message = std::string(message);
    r.Title = std::string(kDateFormatTitle);
    return r;
}

DateEntryCheck BadFormat() {
    return Refused(std::string(kDateSeparatorHelp) + "\n" + std::string(kDateExample));
}

bool IsSeparator(char c) {
    return c == '/' || c == '-';
}

std::optional<int> Digits(std::string_view s) {
    if (s.empty() || s.size() > 4) return std::nullopt;
    int v = 0;
    for (char c : s) {
        if (!std::isdigit(static_cast<unsigned char>(c))) return std::nullopt;
        v = v * 10 + (c - '0');
    }
    return v;
}

EnteredDate Refused() {
    EnteredDate d;
    d.Message = " Use  /   or  -  to separate day/month/year\n eg.  2/10/93";
    d.Title = std::string(kDateEntryTitle);
    return d;
}

} // namespace

EnteredDate CheckEnteredDate(std::string_view typed) {
    const std::string t = Trim(typed);
    if (t.empty()) {
        EnteredDate d;
        d.Message = " Date must be entered";
        d.Title = std::string(kDateEntryTitle);
        return d;
    }
    std::size_t first = std::string::npos, second = std::string::npos;
    int separators = 0;
    for (std::size_t i = 0; i < t.size(); ++i) {
        if (!IsSeparator(t[i])) continue;
        ++separators;
        if (first == std::string::npos)
            first = i;
        else if (second == std::string::npos)
            second = i;
    }
    if (separators != 2) return Refused();
    // The day before the first separator, by where that separator stands.
    const auto day = Digits(std::string_view(t).substr(0, first));
    if (!day) return Refused();
    if (first == 1 && !(*day > 0 && *day < 10)) return Refused();
    if (first == 2 && !(*day > -1 && *day < 32)) return Refused();
    if (first != 1 && first != 2) return Refused();

    const auto month = Digits(std::string_view(t).substr(first + 1, second - first - 1));
    const std::string_view yearText = std::string_view(t).substr(second + 1);
    auto year = Digits(yearText);
    if (!month || !year || (yearText.size() != 2 && yearText.size() != 4)) return Refused();
    if (yearText.size() == 2) *year += *year < 30 ? 2000 : 1900;
    if (*month < 1 || *month > 12 || *day < 1 || *day > DaysInMonth(*year, *month))
        return Refused();
    EnteredDate d;
    d.Ok = true;
    d.Text = DateText({*year, *month, *day});
    d.Display = DateTextToEntry(d.Text);
    return d;
}

std::string DateTextToEntry(std::string_view yyyymmdd) {
    const auto date = ParseDateText(yyyymmdd);
    if (!date) return {};
    const int yy = date->year % 100;
    return std::to_string(date->day) + "/" + std::to_string(date->month) + "/" +
           (yy < 10 ? "0" : "") + std::to_string(yy);
} // namespace

DateEntryCheck ParseEntryDate(std::string_view typed) {
    const std::string text = Trim(typed);
    if (text.empty()) return Refused(kDateMustBeEntered);

    std::vector<std::size_t> seps;
    for (std::size_t i = 0; i < text.size(); ++i)
        if (IsSeparator(text[i])) seps.push_back(i);
    if (seps.size() != 2) return BadFormat();

    // The day stands before the first separator: one character of 1 to 9, or two of 0 to 31.
    const std::string_view all(text);
    const std::string_view day = all.substr(0, seps[0]);
    if (seps[0] == 1) {
        const double v = Val(day);
        if (!(v > 0 && v < 10)) return BadFormat();
    } else if (seps[0] == 2) {
        const double v = Val(day);
        if (!(v > -1 && v < 32)) return BadFormat();
    } else {
        return BadFormat();
    }
    const std::string_view month = all.substr(seps[0] + 1, seps[1] - seps[0] - 1);
    const std::string_view year = all.substr(seps[1] + 1);
    if (!AllDigits(day) || !AllDigits(month) || !AllDigits(year)) return BadFormat();
    if (month.size() > 2 || (year.size() > 2 && year.size() != 4)) return BadFormat();

    int y = Number(year);
    if (year.size() <= 2) y += y < 30 ? 2000 : 1900;
    const CivilDate d{y, Number(month), Number(day)};
    const std::string yyyymmdd = DateText(d);
    if (!IsValidDateText(yyyymmdd)) return BadFormat();

    DateEntryCheck r;
    const std::string yy = yyyymmdd.substr(2, 2);
    r.Date = EntryDate{std::to_string(d.day) + "/" + std::to_string(d.month) + "/" + yy, yyyymmdd};
    return r;
}

} // namespace kori::platform
