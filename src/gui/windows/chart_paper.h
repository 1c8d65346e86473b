#pragma once
// The chart windows on paper: the printer colours of koriprn.dat, asked for once when the file
// is missing, and a chart stream played on a printer at the size it has on screen.
#include "app/session.h"
#include "chart/print_chart.h"

#include <QSize>

#include <filesystem>
#include <optional>

class QPrinter;

namespace kori::gui {

void EnsurePrinterColours(app::Session& session);

// Plays `stream` on `printer` under the session's printer colours, the print settings read into
// `settings` on first use; false, after telling the user, when the printer failed.
bool PrintChartStream(app::Session& session, std::optional<chart::PrintSettings>& settings,
                      const std::filesystem::path& stream, QPrinter& printer, QSize shown);

} // namespace kori::gui
