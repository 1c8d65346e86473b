#pragma once
// Dates as the files hold them: 8-character text "yyyymmdd", compared as text or as numbers.
// The three display conversions work by character position and check nothing, so a bad date
// goes through as bad text; the calendar routines below say when a date is unusable.
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kori::platform {

// "yyyymmdd" -> "dd/mm/yyyy": characters 7-8, '/', 5-6, '/', 1-4.
std::string DateTextToDisplay(std::string_view yyyymmdd);
// "yyyymmdd" -> "dd/mm/yy": characters 7-8, '/', 5-6, '/', 3-4.
std::string DateTextToShort(std::string_view yyyymmdd);
// "dd/mm/yyyy" -> "yyyymmdd": characters 7-10, 4-5, 1-2.
std::string DateDisplayToText(std::string_view ddmmyyyy);

struct CivilDate {
    int year = 0;
    int month = 0;
    int day = 0;
};

int DaysInMonth(int year, int month);
// Eight digits forming a calendar date of the years 1 to 9999.
bool IsValidDateText(std::string_view yyyymmdd);
std::optional<CivilDate> ParseDateText(std::string_view yyyymmdd);
std::string DateText(CivilDate date); // "yyyymmdd"

// Day of the week, Sunday = 1 ... Saturday = 7; nullopt when the text is not a date.
std::optional<int> Weekday(std::string_view yyyymmdd);

// Day numbers for date arithmetic: days since 30 December 1899 (the classic date serial, so
// 1 January 1900 is 2). Both ways; nullopt when the text or the number is not a usable date.
std::optional<std::int32_t> DaySerial(std::string_view yyyymmdd);
std::optional<std::string> DateTextFromSerial(std::int32_t serial);

} // namespace kori::platform
