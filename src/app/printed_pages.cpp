#include "app/printed_pages.h"

#include <algorithm>

namespace kori::app {

std::vector<PrintedPage> PaginateLines(const std::vector<std::string>& body, int linesPerPage,
                                       const std::function<std::vector<PrintedLine>(int)>& head,
                                       const std::function<std::string(int)>& foot) {
    std::vector<PrintedPage> pages;
    std::size_t next = 0;
    while (next < body.size()) {
        PrintedPage page;
        const int number = static_cast<int>(pages.size()) + 1;
        if (head) page.Lines = head(number);
        const auto room = static_cast<std::size_t>(
            std::max(1, linesPerPage - static_cast<int>(page.Lines.size())));
        const std::size_t end = std::min(body.size(), next + room);
        for (; next < end; ++next)
            page.Lines.push_back({body[next]});
        if (foot) page.Foot = foot(number);
        pages.push_back(std::move(page));
    }
    return pages;
}

std::string PrintedColumns::Line(const std::vector<std::string>& cells) const {
    std::string line;
    for (std::size_t c = 0; c < cells.size() && c < Widths.size(); ++c) {
        if (c > 0) line += '\t';
        line += cells[c].substr(0, static_cast<std::size_t>(std::max(1, Widths[c] - 1)));
    }
    return line;
}

std::vector<int> PrintedColumns::Stops() const {
    std::vector<int> stops;
    int at = 0;
    for (int w : Widths) {
        stops.push_back(at);
        at += w;
    }
    return stops;
}

} // namespace kori::app
