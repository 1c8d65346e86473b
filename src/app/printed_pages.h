#pragma once
// Text listings on paper: the lines of a report cut into pages, each page under a head that it
// repeats (a title, a "continued", a page number) and with an optional line at its foot. The
// printer side only draws the lines it is given, so the cutting is tested without a printer.
#include <functional>
#include <string>
#include <vector>

namespace kori::app {

struct PrintedLine {
    std::string Text;
    bool Centred = false, Bold = false, Underline = false;
};

struct PrintedPage {
    std::vector<PrintedLine> Lines;
    std::string Foot; // empty: none
    // Where the tab-separated cells of a line start, in widths of a digit; empty: no tabs.
    std::vector<int> TabStops;
};

// Columns of a printed table: each cell cut to its column's width less one, the cells of a line
// joined by tabs, so that a proportional font still lines them up under their headings.
struct PrintedColumns {
    std::vector<int> Widths; // in widths of a digit
    std::string Line(const std::vector<std::string>& cells) const;
    std::vector<int> Stops() const;
};

// `head(page)` gives the head of page `page` (from 1); each page then takes body lines until it
// holds `linesPerPage` lines, at least one body line a page however long the head. No body
// lines: no pages.
std::vector<PrintedPage> PaginateLines(const std::vector<std::string>& body, int linesPerPage,
                                       const std::function<std::vector<PrintedLine>(int)>& head,
                                       const std::function<std::string(int)>& foot = {});

} // namespace kori::app
