#pragma once
// A date typed by the user as day, month and year ("2/10/93", "02-10-1993"): the check every
// window that takes a typed date makes, and its messages.
// A date typed into an entry field ("d/m/yy", "d-m-yyyy"): the one rule every window that takes
// a day from the keyboard applies (adjustment entry, keyboard data entry), with the words the
// user sees when the text is refused.
#include <optional>
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
inline constexpr std::string_view kDateMustBeEntered = " Date must be entered";
inline constexpr std::string_view kDateSeparatorHelp =
    " Use  /   or  -  to separate day/month/year";
inline constexpr std::string_view kDateExample = " eg.  2/10/93";
inline constexpr std::string_view kDateFormatTitle = "Incorrect Date Format ";

struct EntryDate {
    std::string Shown; // "d/m/yy", what the field shows after the check
    std::string Text;  // "yyyymmdd", what the files hold
};

struct DateEntryCheck {
    std::optional<EntryDate> Date;
    // Set when the text is refused: the lines of the message (joined by line feeds) and its
    // title, ready for a message box.
    std::string Message;
    std::string Title;
};

// Checks a typed date. Blank text gives " Date must be entered". Otherwise there must be
// exactly two separators ('/' or '-'); the first stands after a one-digit day of 1 to 9 or a
// two-character day of 0 to 31; month and year must be numbers forming a real calendar day (a
// year of one or two digits is read as 1930-2029, four digits as written). Anything else gives
// the separator help and the example under "Incorrect Date Format ".
DateEntryCheck ParseEntryDate(std::string_view typed);

} // namespace kori::platform
