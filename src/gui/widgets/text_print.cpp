#include "gui/widgets/text_print.h"

#include <QFontMetrics>
#include <QPainter>
#include <QPrinter>

namespace kori::gui {

bool PrintTextPages(QPrinter& printer, const QFont& font,
                    const std::function<std::vector<app::PrintedPage>(int)>& pages) {
    QPainter painter;
    if (!painter.begin(&printer)) return false;
    painter.setFont(font);
    const QRect area = painter.viewport();
    const QFontMetrics metrics(painter.font(), painter.device());
    const int lineHeight = std::max(1, metrics.lineSpacing());
    // One line of the page is kept for its foot.
    const int linesPerPage = std::max(4, area.height() / lineHeight - 2);
    const auto cut = pages(linesPerPage);
    if (cut.empty()) {
        painter.end();
        return false;
    }
    for (std::size_t p = 0; p < cut.size(); ++p) {
        if (p > 0) printer.newPage();
        int y = metrics.ascent();
        for (const auto& line : cut[p].Lines) {
            QFont f = font;
            f.setBold(line.Bold);
            f.setUnderline(line.Underline);
            painter.setFont(f);
            const QString text =
                QString::fromLatin1(line.Text.data(), static_cast<qsizetype>(line.Text.size()));
            const int x =
                line.Centred
                    ? (area.width() - QFontMetrics(f, painter.device()).horizontalAdvance(text)) / 2
                    : 0;
            painter.drawText(x, y, text);
            y += lineHeight;
        }
        if (!cut[p].Foot.empty()) {
            painter.setFont(font);
            const QString foot = QString::fromStdString(cut[p].Foot);
            painter.drawText((area.width() - metrics.horizontalAdvance(foot)) / 2,
                             area.height() - metrics.descent(), foot);
        }
    }
    return painter.end();
}

} // namespace kori::gui
