#include "cli/paper/pdf_player.h"

#include "cli/paper/gui_app.h"
#include "gui/paint/pdf_printer.h"

namespace kori::cli {

chart::PlayOutcome PlayStreamToPdf(const std::filesystem::path& stream, PdfPage& page,
                                   std::string& document) {
    EnsureGuiApplication();
    gui::PdfPrinter printer;
    const chart::PaperJob job{printer, page.Palette, page.Fonts, page.Width, page.Height};
    const chart::PlayOutcome outcome = chart::PrintChart(stream, job, page.Settings);
    if (outcome == chart::PlayOutcome::Played) document = std::string(printer.Document());
    return outcome;
}

} // namespace kori::cli
