#pragma once
// Number and date formatting by pattern, as the classic BASIC Format did it. Every label,
// grid cell and report line that shows a figure goes through here, so one set of rules holds.
//
// Number patterns:
//   0   a digit, always shown (leading and trailing zeros kept)
//   #   a digit, shown only when significant (no leading or trailing zeros)
//   .   the decimal point; it is shown even when no digit follows ("#.#" gives "5.")
//   ,   between digit places: group thousands; just before the point or the end: divide by 1000
//   %   multiply by 100 and show the sign where it stands
//   \c  the character c;  "text"  the text as it stands; any other character is kept as written
// A pattern may hold up to three sections split by ';': positive, negative, zero.
// The last shown digit is rounded half away from zero on the decimal digits of the value (15
// significant digits for a double, 7 for a single), so 1.005 with "0.00" gives "1.01".
// More integer digits than places are all shown. A negative value gets "-" in front of the
// whole text, even when it rounds to zero ("-0.00"), as the classic routine did.
// An empty pattern gives the value in general form ("0.5", "-12.25").
//
// Date patterns (letters in either case): d dd ddd dddd, m mm mmm mmmm, yy yyyy, other
// characters kept; named "Medium Date" is "dd-mmm-yy" ("05-Mar-24").
#include <string>
#include <string_view>

namespace kori::platform {

// Whether a negative value that shows as zero keeps its sign ("-0.00", the classic rule) or
// drops it ("0.00"). Chart labels drop it: their values come out of float arithmetic, where a
// line at zero may be computed a hair below it.
enum class ZeroSign { Kept, Dropped };

std::string Format(double value, std::string_view pattern, ZeroSign zeroSign = ZeroSign::Kept);
// For 32-bit float values: the digits are those of the single (7 significant), so a float
// 0.145 formats as "0.15" with "0.00", not from its longer double expansion.
std::string FormatSingle(float value, std::string_view pattern, ZeroSign zeroSign = ZeroSign::Kept);

// `yyyymmdd` is the 8-character date text of the files. A text that is not a calendar date
// gives an empty result.
std::string FormatDate(std::string_view yyyymmdd, std::string_view pattern);

} // namespace kori::platform
