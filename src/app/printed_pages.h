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
};

// `head(page)` gives the head of page `page` (from 1); each page then takes body lines until it
// holds `linesPerPage` lines, at least one body line a page however long the head. No body
// lines: no pages.
std::vector<PrintedPage> PaginateLines(const std::vector<std::string>& body, int linesPerPage,
                                       const std::function<std::vector<PrintedLine>(int)>& head,
                                       const std::function<std::string(int)>& foot = {});

} // namespace kori::app
