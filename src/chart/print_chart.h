#pragma once
// Printing: the stream played onto paper. Nothing is drawn from market data, so the page is
// the chart on show, with the differences the letters carry: "X" and "K" appear only here,
// "H" and "P" take the print line width, and the colour rule can turn the chart black.
#include "chart/stream_reader.h"
#include "platform/dialogs.h"
#include "platform/ini_file.h"
#include "platform/palette.h"
#include "platform/printer.h"
#include "platform/progress.h"

#include <cstdint>
#include <filesystem>
#include <string>

namespace kori::chart {

inline constexpr const char* kPrintingStatus = "PRINTING - WAIT";

struct PrintSettings {
    float PrintScale = 1.5f;           // "EFact": enlargement on paper
    std::int16_t PrintLineWidth = 2;   // "Line Width": "H" and "P"; 1 to 10, otherwise 2
    std::int16_t PrintOrientation = 0; // 1 portrait, 2 landscape; else the printer's own
    int PrintColour = 1;               // 1 colour, otherwise black
    int PrintColourLines = 0;          // 1: text and thin lines print black, the rest in colour
    bool PrintBold = false;            // chart text prints bold
    // Printer origin in printer units. Either one 0 centres the chart on the next print,
    // which keeps the values it worked out for the rest of the run.
    std::int32_t PageLeft = 0, PageTop = 0;
};

// "EFact" and "Line Width" of [Charts]; "PPLft", "PPTop" and "Orient" of [ChtPage].
PrintSettings LoadPrintSettings(const platform::IniFile& ini);

struct PaperJob {
    platform::Printer& Printer;
    const platform::Palette& Palette;
    const platform::ChartFonts& Fonts;
    double AreaWidth = 0, AreaHeight = 0; // the chart area's own size as the stream was built
    platform::Progress* StatusBar = nullptr;
    std::string StatusToRestore;          // the status text the print interrupts
    platform::Dialogs* Pointer = nullptr; // busy pointer while printing
};

// Chart units to printer units: twips per pixel times the print scale, as a 16-bit integer.
std::int16_t PrintScaleFactor(double twipsPerPixel, float printScale);

// True for white, light grey and anything as pale: it would vanish on white paper.
bool NearWhite(platform::Colour colour);

// The colour a stream line of `letter` prints in. Black printers print everything in entry 0.
// On a colour printer nothing pale reaches the paper (entry 0 instead), and with
// PrintColourLines 1 text and thin lines go black too, while heavy lines, fills and dots keep
// their colours.
platform::Colour PrintColourOf(char letter, platform::Colour colour, const PrintSettings& settings,
                               const platform::Palette& palette);

// `PrintChart`: plays `source` (TCht.Tmp or a saved chart) onto the printer and ends the
// document. A failure on the way ends the print where it stands; what was drawn is printed.
// An empty stream prints a blank page.
PlayOutcome PrintChart(const std::filesystem::path& source, const PaperJob& job,
                       PrintSettings& settings);
// The same over a reader already open.
PlayOutcome PlayOnPaper(StreamReader& reader, const PaperJob& job, PrintSettings& settings);

} // namespace kori::chart
