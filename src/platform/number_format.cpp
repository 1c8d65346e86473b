#include "platform/number_format.h"

#include "platform/date_text.h"
#include "platform/text.h"

#include <array>
#include <cctype>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <vector>

namespace kori::platform {

namespace {

// ---- pattern parsing ------------------------------------------------------------------------

enum class Kind { Zero, Hash, Point, Comma, Percent, Literal };

struct Token {
    Kind kind;
    std::string text; // for literals
};

// Splits at ';' outside quotes and escapes.
std::vector<std::string> SplitSections(std::string_view pattern) {
    std::vector<std::string> sections(1);
    bool quoted = false;
    for (std::size_t i = 0; i < pattern.size(); ++i) {
        const char c = pattern[i];
        if (c == '"') quoted = !quoted;
        if (c == '\\' && !quoted && i + 1 < pattern.size()) {
            sections.back() += pattern.substr(i, 2);
            ++i;
            continue;
        }
        if (c == ';' && !quoted) {
            sections.emplace_back();
            continue;
        }
        sections.back() += c;
    }
    return sections;
}

std::vector<Token> Tokenise(std::string_view section) {
    std::vector<Token> tokens;
    bool seenPoint = false;
    for (std::size_t i = 0; i < section.size(); ++i) {
        const char c = section[i];
        switch (c) {
        case '0':
            tokens.push_back({Kind::Zero, {}});
            break;
        case '#':
            tokens.push_back({Kind::Hash, {}});
            break;
        case ',':
            tokens.push_back({Kind::Comma, {}});
            break;
        case '%':
            tokens.push_back({Kind::Percent, {}});
            break;
        case '.':
            // Only the first point is the decimal point; later ones are plain text.
            tokens.push_back({seenPoint ? Kind::Literal : Kind::Point, seenPoint ? "." : ""});
            seenPoint = true;
            break;
        case '\\':
            if (i + 1 < section.size())
                tokens.push_back({Kind::Literal, std::string(1, section[++i])});
            break;
        case '"': {
            const auto end = section.find('"', i + 1);
            const auto stop = end == std::string_view::npos ? section.size() : end;
            tokens.push_back({Kind::Literal, std::string(section.substr(i + 1, stop - i - 1))});
            i = stop;
            break;
        }
        default:
            tokens.push_back({Kind::Literal, std::string(1, c)});
        }
    }
    return tokens;
}

bool IsDigitPlace(const Token& t) {
    return t.kind == Kind::Zero || t.kind == Kind::Hash;
}

struct Layout {
    std::vector<Token> tokens;
    std::size_t pointAt;    // index of the point token, or tokens.size()
    std::string intPlaces;  // '0'/'#' of the integer places, in order
    std::string fracPlaces; // '0'/'#' of the fraction places, in order
    bool grouping = false;
    int scaleThousands = 0; // commas just before the point or the end
    bool percent = false;
};

// Commas in the integer part: between two digit places they turn grouping on; a run of commas
// after the last integer place (before the point or the end) divides by 1000 each.
void ReadCommas(Layout& l) {
    std::size_t lastIntPlace = l.pointAt;
    for (std::size_t i = 0; i < l.pointAt; ++i)
        if (IsDigitPlace(l.tokens[i])) lastIntPlace = i;
    bool placeBefore = false;
    for (std::size_t i = 0; i < l.pointAt; ++i) {
        const Token& t = l.tokens[i];
        if (IsDigitPlace(t)) placeBefore = true;
        if (t.kind != Kind::Comma) continue;
        if (lastIntPlace != l.pointAt && i > lastIntPlace)
            ++l.scaleThousands;
        else if (placeBefore)
            l.grouping = true;
    }
}

Layout Analyse(std::string_view section) {
    Layout l;
    l.tokens = Tokenise(section);
    l.pointAt = l.tokens.size();
    for (std::size_t i = 0; i < l.tokens.size(); ++i) {
        const Token& t = l.tokens[i];
        if (t.kind == Kind::Point) l.pointAt = i;
        if (t.kind == Kind::Percent) l.percent = true;
        if (!IsDigitPlace(t)) continue;
        const char place = t.kind == Kind::Zero ? '0' : '#';
        (i < l.pointAt ? l.intPlaces : l.fracPlaces) += place;
    }
    ReadCommas(l);
    return l;
}

// ---- digits of the value --------------------------------------------------------------------

struct Digits {
    std::string integer;  // no leading zeros; empty for a zero integer part
    std::string fraction; // exactly the number of fraction places
};

// Decimal digits of |value| with `significant` digits, rounded half away from zero to
// `decimals` places on that decimal text.
Digits DecimalDigits(double magnitude, int significant, std::size_t decimals) {
    Digits d;
    if (magnitude == 0.0 || !std::isfinite(magnitude)) {
        d.fraction.assign(decimals, '0');
        return d;
    }
    char buf[64];
    std::snprintf(buf, sizeof buf, "%.*e", significant - 1, magnitude);
    const std::string s(buf);
    const auto e = s.find('e');
    std::string mant;
    for (std::size_t i = 0; i < e; ++i)
        if (s[i] != '.') mant += s[i];
    long pointPos = std::strtol(s.c_str() + e + 1, nullptr, 10) + 1; // digits before the point
    const long keep = pointPos + static_cast<long>(decimals);
    if (keep < 0) {
        mant.clear();
    } else if (keep < static_cast<long>(mant.size())) {
        const bool up = mant[static_cast<std::size_t>(keep)] >= '5';
        mant.resize(static_cast<std::size_t>(keep));
        if (up) {
            long i = keep - 1;
            for (; i >= 0 && mant[static_cast<std::size_t>(i)] == '9'; --i)
                mant[static_cast<std::size_t>(i)] = '0';
            if (i >= 0) {
                ++mant[static_cast<std::size_t>(i)];
            } else {
                mant.insert(mant.begin(), '1');
                ++pointPos;
            }
        }
    }
    // Place the kept digits around the point.
    if (pointPos > 0) {
        const auto ip = static_cast<std::size_t>(pointPos);
        d.integer = mant.substr(0, std::min(ip, mant.size()));
        if (d.integer.size() < ip) d.integer.append(ip - d.integer.size(), '0');
        d.fraction = ip < mant.size() ? mant.substr(ip) : "";
    } else {
        d.fraction = std::string(static_cast<std::size_t>(-pointPos), '0') + mant;
    }
    d.fraction.resize(decimals, '0');
    const auto nz = d.integer.find_first_not_of('0');
    d.integer = nz == std::string::npos ? "" : d.integer.substr(nz);
    return d;
}

// ---- output ---------------------------------------------------------------------------------

struct Piece {
    std::string text;
    bool digit;
};

// The integer part: pieces for the tokens before the point, digits placed right-aligned.
std::vector<Piece> IntegerPieces(const Layout& l, const std::string& digits) {
    const std::size_t n = l.intPlaces.size();
    std::string extra;
    std::string padded = digits;
    if (padded.size() > n) {
        extra = padded.substr(0, padded.size() - n);
        padded = padded.substr(padded.size() - n);
    } else {
        padded.insert(0, n - padded.size(), '0');
    }
    const std::size_t firstZero = std::min(l.intPlaces.find('0'), n);
    const std::size_t firstShown = std::min(firstZero, n - std::min(n, digits.size()));

    std::vector<Piece> out;
    std::size_t place = 0;
    bool extraPlaced = false;
    for (std::size_t i = 0; i < l.pointAt; ++i) {
        const Token& t = l.tokens[i];
        if (IsDigitPlace(t)) {
            if (!extraPlaced) {
                for (char c : extra)
                    out.push_back({std::string(1, c), true});
                extraPlaced = true;
            }
            if (place >= firstShown) out.push_back({std::string(1, padded[place]), true});
            ++place;
        } else if (t.kind == Kind::Percent) {
            out.push_back({"%", false});
        } else if (t.kind == Kind::Literal) {
            out.push_back({t.text, false});
        }
    }
    if (!extraPlaced)
        for (char c : extra)
            out.push_back({std::string(1, c), true});
    return out;
}

std::string JoinIntegerPieces(const std::vector<Piece>& pieces, bool grouping) {
    int digitCount = 0;
    for (const auto& p : pieces)
        digitCount += p.digit ? 1 : 0;
    std::string out;
    int seen = 0;
    for (const auto& p : pieces) {
        out += p.text;
        if (!p.digit) continue;
        ++seen;
        const int left = digitCount - seen;
        if (grouping && left > 0 && left % 3 == 0) out += ',';
    }
    return out;
}

std::string FractionText(const Layout& l, const std::string& fraction) {
    const std::size_t lastZero = l.fracPlaces.rfind('0');
    const std::size_t lastNonZero = fraction.find_last_not_of('0');
    std::size_t shownCount = 0;
    if (lastZero != std::string::npos) shownCount = lastZero + 1;
    if (lastNonZero != std::string::npos) shownCount = std::max(shownCount, lastNonZero + 1);

    std::string out;
    std::size_t place = 0;
    for (std::size_t i = l.pointAt; i < l.tokens.size(); ++i) {
        const Token& t = l.tokens[i];
        if (t.kind == Kind::Point)
            out += '.';
        else if (t.kind == Kind::Percent)
            out += '%';
        else if (t.kind == Kind::Literal)
            out += t.text;
        else if (IsDigitPlace(t)) {
            if (place < shownCount) out += fraction[place];
            ++place;
        }
    }
    return out;
}

std::string FormatSection(double magnitude, std::string_view section, int significant) {
    const Layout l = Analyse(section);
    if (l.percent) magnitude *= 100.0;
    for (int i = 0; i < l.scaleThousands; ++i)
        magnitude /= 1000.0;
    const Digits d = DecimalDigits(magnitude, significant, l.fracPlaces.size());
    return JoinIntegerPieces(IntegerPieces(l, d.integer), l.grouping) + FractionText(l, d.fraction);
}

std::string GeneralNumber(double value, int significant) {
    const std::string s = Trim(significant > 7 ? Str(value) : StrSingle(static_cast<float>(value)));
    // The classic general form keeps the zero before the point that Str drops.
    const bool negative = s.starts_with('-');
    const std::string_view body = std::string_view(s).substr(negative ? 1 : 0);
    std::string out = negative ? "-" : "";
    if (body.starts_with('.')) out += '0';
    out += body;
    return out;
}

std::string FormatWith(double value, std::string_view pattern, int significant, ZeroSign zeroSign) {
    if (pattern.empty() || EqualsNoCase(pattern, "General Number"))
        return GeneralNumber(value, significant);
    const auto sections = SplitSections(pattern);
    const bool negative = value < 0;
    if (value == 0.0 && sections.size() >= 3 && !sections[2].empty())
        return FormatSection(0.0, sections[2], significant);
    if (negative && sections.size() >= 2 && !sections[1].empty())
        return FormatSection(-value, sections[1], significant);
    const std::string body = FormatSection(std::fabs(value), sections[0], significant);
    const bool shownAsZero = body.find_first_of("123456789") == std::string::npos;
    if (!negative || (zeroSign == ZeroSign::Dropped && shownAsZero)) return body;
    return "-" + body;
}

// ---- dates ----------------------------------------------------------------------------------

constexpr std::array<const char*, 12> kMonthNames = {
    "January", "February", "March",     "April",   "May",      "June",
    "July",    "August",   "September", "October", "November", "December"};
constexpr std::array<const char*, 7> kDayNames = {"Sunday",   "Monday", "Tuesday", "Wednesday",
                                                  "Thursday", "Friday", "Saturday"};

std::string TwoDigits(int v) {
    char buf[8];
    std::snprintf(buf, sizeof buf, "%02d", v % 100);
    return buf;
}

std::size_t RunLength(std::string_view s, std::size_t i) {
    std::size_t n = 1;
    const char c = static_cast<char>(std::tolower(static_cast<unsigned char>(s[i])));
    while (i + n < s.size() && std::tolower(static_cast<unsigned char>(s[i + n])) == c)
        ++n;
    return n;
}

std::string DayField(CivilDate d, std::size_t run) {
    if (run == 1) return std::to_string(d.day);
    if (run == 2) return TwoDigits(d.day);
    const int weekday = Weekday(DateText(d)).value_or(1);
    const std::string name = kDayNames[static_cast<std::size_t>(weekday - 1)];
    return run == 3 ? name.substr(0, 3) : name;
}

std::string MonthField(CivilDate d, std::size_t run) {
    if (run == 1) return std::to_string(d.month);
    if (run == 2) return TwoDigits(d.month);
    const std::string name = kMonthNames[static_cast<std::size_t>(d.month - 1)];
    return run == 3 ? name.substr(0, 3) : name;
}

std::string YearField(CivilDate d, std::size_t run) {
    if (run >= 3) {
        char buf[8];
        std::snprintf(buf, sizeof buf, "%04d", d.year);
        return buf;
    }
    return TwoDigits(d.year);
}

} // namespace

std::string Format(double value, std::string_view pattern, ZeroSign zeroSign) {
    return FormatWith(value, pattern, 15, zeroSign);
}

std::string FormatSingle(float value, std::string_view pattern, ZeroSign zeroSign) {
    return FormatWith(static_cast<double>(value), pattern, 7, zeroSign);
}

std::string FormatDate(std::string_view yyyymmdd, std::string_view pattern) {
    const auto parsed = ParseDateText(yyyymmdd);
    if (!parsed) return {};
    const CivilDate d = *parsed;
    if (EqualsNoCase(pattern, "Medium Date")) pattern = "dd-mmm-yy";
    std::string out;
    for (std::size_t i = 0; i < pattern.size();) {
        const char c = static_cast<char>(std::tolower(static_cast<unsigned char>(pattern[i])));
        const std::size_t run = (c == 'd' || c == 'm' || c == 'y') ? RunLength(pattern, i) : 1;
        if (c == 'd')
            out += DayField(d, std::min<std::size_t>(run, 4));
        else if (c == 'm')
            out += MonthField(d, std::min<std::size_t>(run, 4));
        else if (c == 'y')
            out += YearField(d, run);
        else
            out += pattern[i];
        i += run;
    }
    return out;
}

} // namespace kori::platform
