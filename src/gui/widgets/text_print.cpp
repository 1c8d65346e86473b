#include "gui/widgets/text_print.h"

#include <QFontMetrics>
#include <QPainter>
#include <QPrinter>

#include <algorithm>

namespace kori::gui {

namespace {

QString Latin1(const std::string& s) {
    return QString::fromLatin1(s.data(), static_cast<qsizetype>(s.size()));
}

QFont LineFont(const QFont& base, const app::PrintedLine& line) {
    QFont f = base;
    f.setBold(line.Bold);
    f.setUnderline(line.Underline);
    return f;
}

// Draws one line from y (its base line), or only measures it when `painter` is null; the x of
// its right end. Tab-separated cells start at their stops, in widths of a digit.
int LayLine(QPainter* painter, QPaintDevice* device, const QFont& base,
            const app::PrintedLine& line, const std::vector<int>& stops, int pageWidth, int y) {
    const QFont f = LineFont(base, line);
    const QFontMetrics m(f, device);
    const QString text = Latin1(line.Text);
    if (painter) painter->setFont(f);
    if (stops.empty() || !text.contains(QLatin1Char('\t'))) {
        const int width = m.horizontalAdvance(text);
        const int x = line.Centred ? std::max(0, (pageWidth - width) / 2) : 0;
        if (painter) painter->drawText(x, y, text);
        return x + width;
    }
    const int digit = m.horizontalAdvance(QLatin1Char('0'));
    const QStringList cells = text.split(QLatin1Char('\t'));
    int right = 0;
    for (qsizetype i = 0; i < cells.size(); ++i) {
        const int x = stops[static_cast<std::size_t>(
                          std::min<qsizetype>(i, static_cast<qsizetype>(stops.size()) - 1))] *
                      digit;
        if (painter) painter->drawText(x, y, cells[i]);
        right = std::max(right, x + m.horizontalAdvance(cells[i]));
    }
    return right;
}

int Widest(QPaintDevice* device, const QFont& font, const std::vector<app::PrintedPage>& pages,
           int pageWidth) {
    int widest = 0;
    for (const auto& page : pages)
        for (const auto& line : page.Lines)
            widest =
                std::max(widest, LayLine(nullptr, device, font, line, page.TabStops, pageWidth, 0));
    return widest;
}

void Scale(QFont& font, double factor) {
    if (font.pointSizeF() > 0)
        font.setPointSizeF(std::max(4.0, font.pointSizeF() * factor));
    else if (font.pixelSize() > 0)
        font.setPixelSize(std::max(4, static_cast<int>(font.pixelSize() * factor)));
}

} // namespace

bool PrintTextPages(QPrinter& printer, const QFont& font,
                    const std::function<std::vector<app::PrintedPage>(int)>& pages) {
    QPainter painter;
    if (!painter.begin(&printer)) return false;
    const QRect area = painter.viewport();
    QFont base = font;
    std::vector<app::PrintedPage> cut;
    int lineHeight = 1;
    // A report wider than the paper prints smaller rather than cut off at the edge; the pages
    // are cut again for the lines the smaller font fits.
    for (int attempt = 0; attempt < 4; ++attempt) {
        const QFontMetrics metrics(base, painter.device());
        lineHeight = std::max(1, metrics.lineSpacing());
        // Two lines of the page are kept for its foot.
        cut = pages(std::max(4, area.height() / lineHeight - 2));
        const int widest = Widest(painter.device(), base, cut, area.width());
        if (cut.empty() || widest <= area.width()) break;
        Scale(base, 0.97 * area.width() / widest);
    }
    if (cut.empty()) {
        painter.end();
        return false;
    }
    const QFontMetrics metrics(base, painter.device());
    for (std::size_t p = 0; p < cut.size(); ++p) {
        if (p > 0) printer.newPage();
        int y = metrics.ascent();
        for (const auto& line : cut[p].Lines) {
            LayLine(&painter, painter.device(), base, line, cut[p].TabStops, area.width(), y);
            y += lineHeight;
        }
        if (!cut[p].Foot.empty()) {
            painter.setFont(base);
            const QString foot = Latin1(cut[p].Foot);
            painter.drawText((area.width() - metrics.horizontalAdvance(foot)) / 2,
                             area.height() - metrics.descent(), foot);
        }
    }
    return painter.end();
}

} // namespace kori::gui
