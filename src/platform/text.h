#pragma once
// Text helpers shared by every module: trimming, fixed-width fields, and the classic
// number-to-text (Str) and text-to-number (Val) conversions the file formats rely on.
#include <string>
#include <string_view>

namespace kori::platform {

std::string Trim(std::string_view s);
std::string TrimRight(std::string_view s);
std::string TrimLeft(std::string_view s);
std::string Upper(std::string_view s);
std::string Lower(std::string_view s);
bool EqualsNoCase(std::string_view a, std::string_view b);

// The files' single-byte text (Latin-1) as UTF-8, for outputs that must be UTF-8.
std::string Latin1ToUtf8(std::string_view text);
void AppendLatin1AsUtf8(std::string& out, char ch);

// Left-justified, blank-padded, cut to exactly `width` characters.
std::string PadRight(std::string_view s, std::size_t width);

// Number to text as the classic Str: a non-negative number gets one leading blank, no
// trailing zeros, no leading zero before the point (" .5"), exponent form for very large or
// small magnitudes. The float overload keeps 7 significant digits, the double one 15.
std::string Str(double value);
std::string StrSingle(float value);

// Text to number as the classic Val: leading blanks skipped, the longest leading number
// read (sign, digits, point, exponent; "&H" hex), anything else reads 0.
double Val(std::string_view text);

// The whole text, blanks aside, is one decimal number: a sign, digits with at most one point
// (at least one digit) and an exponent ("1.5", "-.25", "2e3"). What a field that must hold a
// number accepts; Val alone would read "1.5x" as 1.5.
bool IsNumber(std::string_view text);

// Shortest text that reads back to the same 32-bit float ("0.1", "12.5", "1e+20").
std::string FloatText(float value);

} // namespace kori::platform
