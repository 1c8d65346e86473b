#include "gui/windows/chart_paper.h"

#include "app/colour_table.h"
#include "gui/services/qt_printer.h"

namespace kori::gui {

void EnsurePrinterColours(app::Session& session) {
    const std::string path = session.folders.SystemFolder + "koriprn.dat";
    if (auto colours = app::ReadPrinterFile(path)) {
        session.printer = *colours;
        return;
    }
    session.printer = app::AskPrinterColours(session.dialogs());
    (void)app::WritePrinterFile(path, session.printer);
}

bool PrintChartStream(app::Session& session, std::optional<chart::PrintSettings>& settings,
                      const std::filesystem::path& stream, QPrinter& printer, QSize shown) {
    EnsurePrinterColours(session);
    if (!settings) settings = chart::LoadPrintSettings(session.ini());
    settings->PrintColour = session.printer.PrintColour;
    settings->PrintColourLines = session.printer.PrintColourLines;
    QtPrinter paper(printer);
    chart::PaperJob job{paper, session.palette, session.fonts, static_cast<double>(shown.width()),
                        static_cast<double>(shown.height())};
    if (chart::PrintChart(stream, job, *settings) == chart::PlayOutcome::PrinterFailed) {
        session.dialogs().MsgBox("The chart could not be printed", "Print Chart");
        return false;
    }
    return true;
}

} // namespace kori::gui
