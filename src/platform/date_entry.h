#pragma once
// A date typed into an entry field ("d/m/yy", "d-m-yyyy"): the one rule every window that takes
// a day from the keyboard applies (adjustment entry, keyboard data entry), with the words the
// user sees when the text is refused.
#include <optional>
#include <string>
#include <string_view>

namespace kori::platform {

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

// "yyyymmdd" as a date field shows it: "d/m/yy". Empty for a text that is not a date.
std::string DateTextToEntry(std::string_view yyyymmdd);

} // namespace kori::platform
