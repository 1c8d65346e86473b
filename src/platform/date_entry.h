#pragma once
// A date typed by the user as day, month and year ("2/10/93", "02-10-1993"): the check every
// window that takes a typed date makes, and its messages.
#include <string>
#include <string_view>

namespace kori::platform {

struct EnteredDate {
    bool Ok = false;
    std::string Text;    // "yyyymmdd"
    std::string Display; // "d/m/yy", as the field then shows it
    std::string Message; // lines joined by "\n" when refused
    std::string Title;
};

inline constexpr std::string_view kDateEntryTitle = "Incorrect Date Format ";

// Blank: " Date must be entered". Otherwise exactly two separators, "/" or "-"; the first at
// character 2 after a day 1 to 9, or at character 3 after a day 0 to 31. The parts must then
// make a calendar date (a month 1 to 12, a day the month has; a year of two digits is 1930 to
// 2029). Any failure: " Use  /   or  -  to separate day/month/year" and " eg.  2/10/93",
// under "Incorrect Date Format ".
EnteredDate CheckEnteredDate(std::string_view typed);

// "yyyymmdd" as the date fields show it: "d/m/yy". Empty for a text that is not a date.
std::string DateTextToEntry(std::string_view yyyymmdd);

} // namespace kori::platform
