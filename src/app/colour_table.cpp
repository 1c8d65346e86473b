#include "app/colour_table.h"

#include "platform/files.h"
#include "platform/text.h"

#include <charconv>
#include <limits>
#include <sstream>

namespace kori::app {

using platform::Palette;
using platform::Status;

namespace {

// Palette numbers of the built-in role colours, entries 16 to 48 in turn, by scheme. Black is
// the table every install starts with (16 to 44 as given; 45 to 48, the oscillator lines, as
// the starting palette has them). White and Blue keep each role in a colour that shows on their
// background: dark inks on white, light ones on blue.
using SchemeRoles = std::array<int, platform::kPaletteSize - kFirstRole>;
constexpr SchemeRoles kBlackRoles = {3,  0,  15, 14, 10, 12, 14, 2,  6,  13, 14,
                                     7,  4,  12, 10, 11, 14, 2,  11, 8,  10, 11,
                                     10, 11, 14, 14, 6,  12, 10, 10, 14, 11, 13};
constexpr SchemeRoles kWhiteRoles = {1, 15, 0, 6, 2, 4, 1, 5, 6, 8, 1, 0, 4, 12, 2, 3, 5,
                                     9, 3,  7, 2, 3, 2, 3, 4, 5, 6, 4, 1, 1, 4,  2, 5};
constexpr SchemeRoles kBlueRoles = {11, 1,  15, 14, 10, 12, 11, 14, 13, 8,  14,
                                    15, 12, 12, 10, 11, 14, 13, 11, 8,  10, 11,
                                    10, 11, 14, 14, 13, 12, 10, 10, 14, 11, 13};

const SchemeRoles& BuiltInRoles(std::string_view fileName) {
    if (fileName == "koriclr.WHT") return kWhiteRoles;
    if (fileName == "koriclr.BLU") return kBlueRoles;
    return kBlackRoles;
}

// A whole number that fits a colour value (negative values are kept as their 32-bit form).
std::optional<platform::Colour> ColourNumber(const std::string& line) {
    const std::string t = platform::Trim(line);
    long long v = 0;
    const auto* end = t.data() + t.size();
    const auto [ptr, ec] = std::from_chars(t.data(), end, v);
    if (t.empty() || ec != std::errc() || ptr != end) return std::nullopt;
    if (v < std::numeric_limits<std::int32_t>::min() ||
        v > std::numeric_limits<std::uint32_t>::max())
        return std::nullopt;
    return static_cast<platform::Colour>(v);
}

std::string Le16(std::int16_t v) {
    const auto u = static_cast<std::uint16_t>(v);
    return {static_cast<char>(u & 0xFF), static_cast<char>(u >> 8)};
}

std::int16_t ReadLe16(const std::string& bytes, std::size_t at) {
    const auto lo = static_cast<unsigned char>(at < bytes.size() ? bytes[at] : 0);
    const auto hi = static_cast<unsigned char>(at + 1 < bytes.size() ? bytes[at + 1] : 0);
    return static_cast<std::int16_t>(static_cast<std::uint16_t>(lo | (hi << 8)));
}

} // namespace

const std::array<std::string_view, kRoleCount>& ColourRoleNames() {
    static constexpr std::array<std::string_view, kRoleCount> names = {"Background",
                                                                       "Chart title",
                                                                       "Scales / text",
                                                                       "Border",
                                                                       "Chart lines",
                                                                       "Candle / P&F down",
                                                                       "Average 1",
                                                                       "Average 2",
                                                                       "Average 3",
                                                                       "Volume bars",
                                                                       "Trendlines",
                                                                       "Adjustments",
                                                                       "Moving grid",
                                                                       "Fixed grid lines",
                                                                       "Reversal",
                                                                       "Key reversal",
                                                                       "Hook reversal",
                                                                       "Open-close rev",
                                                                       "Pivot point",
                                                                       "Oscillator Line 1",
                                                                       "Oscillator Line 2",
                                                                       "Oscillator Line 3",
                                                                       "Oscillator Line 4",
                                                                       "Osc/Indicator UP",
                                                                       "Osc/Indicator DOWN",
                                                                       "Bands",
                                                                       "MACD",
                                                                       "Volatility 1",
                                                                       "Volatility 2",
                                                                       "MMA (Short)",
                                                                       "MMA (Long)",
                                                                       "End of year marker"};
    return names;
}

std::optional<int> ReadColourFile(const std::string& path, Palette& palette) {
    const auto content = platform::ReadWholeFile(platform::ResolvePath(path));
    if (!content) return std::nullopt;
    std::istringstream in(*content);
    std::string line;
    int read = 0;
    while (read < platform::kPaletteSize && std::getline(in, line)) {
        if (platform::Trim(line).empty()) continue;
        const auto colour = ColourNumber(line);
        if (!colour) break; // junk: keep what was read so far
        palette[static_cast<std::size_t>(read++)] = *colour;
    }
    return read;
}

Status WriteColourFile(const std::string& path, const Palette& palette) {
    std::string out;
    for (const auto c : palette)
        out += std::to_string(c) + "\r\n";
    return platform::WriteFileAtomic(platform::ResolvePath(path), out);
}

std::optional<std::string> SchemeFileName(std::string_view scheme) {
    if (platform::EqualsNoCase(scheme, "Black")) return "koriclr.BLK";
    if (platform::EqualsNoCase(scheme, "White")) return "koriclr.WHT";
    if (platform::EqualsNoCase(scheme, "Blue")) return "koriclr.BLU";
    return std::nullopt;
}

Palette StartingPalette() {
    Palette p{};
    for (std::size_t i = 0; i < platform::kStandardColours.size(); ++i)
        p[i] = platform::kStandardColours[i];
    p[45] = platform::kStandardColours[10]; // light green
    p[46] = platform::kStandardColours[14]; // yellow
    p[47] = platform::kStandardColours[11]; // light cyan
    p[48] = platform::kStandardColours[13]; // light magenta
    return p;
}

Status ApplyColourScheme(std::string_view scheme, const std::string& systemFolder,
                         Palette& palette) {
    const auto name = SchemeFileName(scheme);
    if (!name) return Status::Error("Unknown colour scheme " + std::string(scheme));
    for (std::size_t i = 0; i < platform::kStandardColours.size(); ++i)
        palette[i] = platform::kStandardColours[i];
    const auto schemeFile = platform::ResolveIn(systemFolder, *name);
    if (!platform::FileExists(schemeFile) || !ReadColourFile(schemeFile.string(), palette)) {
        const SchemeRoles& roles = BuiltInRoles(*name);
        for (std::size_t i = 0; i < roles.size(); ++i)
            palette[kFirstRole + i] =
                platform::kStandardColours[static_cast<std::size_t>(roles[i])];
    }
    return WriteColourFile(platform::ResolveIn(systemFolder, "koriclr.dat").string(), palette);
}

Status SaveColourScheme(std::string_view scheme, const std::string& systemFolder,
                        const Palette& palette) {
    const auto name = SchemeFileName(scheme);
    if (!name) return Status::Error("Unknown colour scheme " + std::string(scheme));
    return WriteColourFile(platform::ResolveIn(systemFolder, *name).string(), palette);
}

std::optional<PrinterColours> ReadPrinterFile(const std::string& path) {
    const auto bytes = platform::ReadWholeFile(platform::ResolvePath(path));
    if (!bytes || bytes->empty()) return std::nullopt;
    // A short record reads its missing bytes as zeros.
    return PrinterColours{ReadLe16(*bytes, 0), ReadLe16(*bytes, 2)};
}

Status WritePrinterFile(const std::string& path, PrinterColours colours) {
    const auto resolved = platform::ResolvePath(path);
    std::string bytes = platform::ReadWholeFile(resolved).value_or("");
    // Record 1 is rewritten; any records after it stay.
    const std::string record = Le16(colours.PrintColour) + Le16(colours.PrintColourLines);
    if (bytes.size() < record.size()) bytes.resize(record.size(), '\0');
    bytes.replace(0, record.size(), record);
    return platform::WriteFileAtomic(resolved, bytes);
}

PrinterColours AskPrinterColours(platform::Dialogs& dialogs) {
    using platform::Answer;
    using platform::Buttons;
    using platform::Icon;
    if (dialogs.MsgBox(" Do you have a Colour Printer ?", "Printer", Buttons::YesNo,
                       Icon::Question) != Answer::Yes)
        return {0, 1};
    const bool whiteAsBlack = dialogs.MsgBox("Print the colour WHITE as BLACK ?", "Chart Printing",
                                             Buttons::YesNo, Icon::Question) == Answer::Yes;
    return {1, static_cast<std::int16_t>(whiteAsBlack ? 1 : 0)};
}

} // namespace kori::app
