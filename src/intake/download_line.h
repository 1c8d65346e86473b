#pragma once
// One line of a downloaded day file: code, date, open, high, low, close, volume, spare and, in
// an options file, the option type. Fields are split with quotes honoured and read with the
// classic text-to-number conversion, so a field that is not a number reads as 0.
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kori::intake {

struct DownloadLine {
    std::string Code; // as delivered, untrimmed
    std::string Date; // "yyyymmdd" as it stands
    float Open = 0, High = 0, Low = 0, Close = 0;
    std::int32_t Volume = 0;
    double Spare = 0;    // yesterday's corrected volume, or an option's days to expiry
    std::string OptType; // "P" or "C", options files only
};

// Commas in the raw line: an ordinary line has 7, an options line 8.
int CountCommas(std::string_view line);
// The fields of a line, split at commas outside double quotes, quotes removed, blanks around a
// field dropped.
std::vector<std::string> SplitFields(std::string_view line);
DownloadLine ParseDownloadLine(std::string_view line);
// The lines of a file's text, each without its line end (LF or CR LF); no empty last line for a
// closing line end.
std::vector<std::string_view> SplitLines(std::string_view text);
// The code as it arrives: cut to 6 characters, trimmed, upper-cased, "PRN" as "PRNX" and "AUX"
// as "1AUX"; empty when blank.
std::string ArrivalCode(std::string_view delivered);
// A date field the files can hold: exactly eight digits.
bool IsEightDigitDate(std::string_view date);

// The category of a new equity from its code: a six-character code is sorted by its fourth
// letter (E 86, I 87, W 84, any other 88); shorter codes are ordinary shares, 1.
std::int16_t NewEquityCategory(std::string_view code);

} // namespace kori::intake
