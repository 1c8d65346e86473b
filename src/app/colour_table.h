#pragma once
// The chart colour table: koriclr.dat, the three colour schemes, and the printer colour
// answers kept in koriprn.dat. All files lie in the SystemFolder.
#include "platform/dialogs.h"
#include "platform/palette.h"
#include "platform/status.h"

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kori::app {

inline constexpr int kFirstRole = 16;
inline constexpr int kRoleCount = 32;

// The table a session starts from, before koriclr.dat or a scheme is read: the standard
// colours, and for the oscillator lines (45 to 48), which the built-in role colours do not
// reach, colours that show on a dark panel. Whatever a file or scheme gives replaces these.
platform::Palette StartingPalette();

// The role names in the order the colours window shows them, from entry 16 on.
const std::array<std::string_view, kRoleCount>& ColourRoleNames();

// Entries 0 to 48 in order, one number a line. Reading stops at the end of the file or at a
// line that is not a whole number: entries not read keep what they held. Returns how many
// entries were read; nullopt when the file cannot be opened.
std::optional<int> ReadColourFile(const std::string& path, platform::Palette& palette);
platform::Status WriteColourFile(const std::string& path, const platform::Palette& palette);

// "Black", "White" or "Blue" and its file name (koriclr.BLK, .WHT, .BLU); nullopt otherwise.
std::optional<std::string> SchemeFileName(std::string_view scheme);

// Applies a scheme: the standard colours into 0 to 15, then the scheme file from the
// SystemFolder when there is one, else the scheme's built-in role colours for 16 to 48 (a
// black, a white and a blue background); then writes koriclr.dat. Entries a scheme file does
// not give keep their values.
platform::Status ApplyColourScheme(std::string_view scheme, const std::string& systemFolder,
                                   platform::Palette& palette);
// "SAVE DEFAULT COLOURS": the current table becomes the scheme's file.
platform::Status SaveColourScheme(std::string_view scheme, const std::string& systemFolder,
                                  const platform::Palette& palette);

// koriprn.dat: one record of two 16-bit values.
struct PrinterColours {
    std::int16_t PrintColour = 0;      // 1 colour printer, 0 black
    std::int16_t PrintColourLines = 1; // the answer to "Print the colour WHITE as BLACK ?"
};

// Record 1 of the file; nullopt when the file is missing or empty.
std::optional<PrinterColours> ReadPrinterFile(const std::string& path);
platform::Status WritePrinterFile(const std::string& path, PrinterColours colours);
// The two printer questions: a colour printer gives 1 and the white-as-black answer (1 or 0);
// no colour printer gives 0 and 1.
PrinterColours AskPrinterColours(platform::Dialogs& dialogs);

} // namespace kori::app
