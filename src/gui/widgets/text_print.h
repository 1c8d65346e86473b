#pragma once
// Prints pages of text lines (app::PrintedPage) on a printer in one font: the listings and
// reports of the scan and statistics windows.
#include "app/printed_pages.h"

#include <QFont>

#include <functional>
#include <vector>

class QPrinter;

namespace kori::gui {

// `pages(linesPerPage)` cuts the report for the lines the page holds in `font`; false when
// there was nothing to print or the printer could not start.
bool PrintTextPages(QPrinter& printer, const QFont& font,
                    const std::function<std::vector<app::PrintedPage>(int)>& pages);

} // namespace kori::gui
