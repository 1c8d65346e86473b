#pragma once
// The printed page as a PDF document. Drawing a page needs the desktop's painting libraries,
// which the kori tool does not load: `kori` hands a command that writes a PDF to its sibling
// program kori-paper, which is the same tool with the page printer set here.
#include "chart/print_chart.h"
#include "platform/palette.h"

#include <filesystem>
#include <string>

namespace kori::cli {

struct PdfPage {
    const platform::Palette& Palette;
    const platform::ChartFonts& Fonts;
    double Width, Height; // chart area the stream was made on
    chart::PrintSettings Settings;
};

// Plays `stream` onto one page; on Played, `document` holds the PDF.
using PdfPlayer = chart::PlayOutcome (*)(const std::filesystem::path& stream, PdfPage& page,
                                         std::string& document);

void SetPdfPlayer(PdfPlayer player);
// Throws CliError when this build has no page printer.
chart::PlayOutcome PlayPdf(const std::filesystem::path& stream, PdfPage& page,
                           std::string& document);

// For kori's main: whether the command line asks for a PDF, and the sibling that makes it.
bool AsksForPdf(int argc, const char* const* argv);
std::filesystem::path PaperProgramPath();

} // namespace kori::cli
