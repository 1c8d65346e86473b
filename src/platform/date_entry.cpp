#include "platform/date_entry.h"

#include "platform/date_text.h"
#include "platform/text.h"

#include <cctype>
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

std::string DateTextToEntry(std::string_view yyyymmdd) {
    const auto date = ParseDateText(yyyymmdd);
    if (!date) return {};
    return std::to_string(date->day) + "/" + std::to_string(date->month) + "/" +
           std::string(yyyymmdd.substr(2, 2));
}

} // namespace kori::platform
