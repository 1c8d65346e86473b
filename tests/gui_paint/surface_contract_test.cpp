// The drawing contract over the Qt targets: the chart area on an image, the PDF document and
// the printer the print dialog hands over, here one that prints to a PDF file.
#include "gui/paint/pdf_printer.h"
#include "gui/paint/qt_surface.h"
#include "gui/services/qt_printer.h"
#include "platform/files.h"
#include "support/surface_contract.h"
#include "support/temp_root.h"

#include <QPageSize>
#include <QPrinter>

#include <gtest/gtest.h>
#include <zlib.h>

#include <algorithm>
#include <cstdlib>
#include <regex>
#include <string>
#include <string_view>

namespace kori::test {
namespace {

// Colour distance, summed over the channels.
int Distance(QRgb pixel, platform::Colour c) {
    return std::abs(qRed(pixel) - platform::Red(c)) + std::abs(qGreen(pixel) - platform::Green(c)) +
           std::abs(qBlue(pixel) - platform::Blue(c));
}

// Every compressed stream of a PDF inflated and put end to end: the pages' drawing operators.
std::string PageContent(std::string_view pdf) {
    std::string all;
    for (std::size_t at = 0; (at = pdf.find("stream", at)) != std::string_view::npos;) {
        std::size_t start = at + 6;
        if (pdf.substr(start, 2) == "\r\n")
            start += 2;
        else if (start < pdf.size() && pdf[start] == '\n')
            ++start;
        else {
            at = start;
            continue;
        }
        const std::size_t end = pdf.find("endstream", start);
        if (end == std::string_view::npos) break;
        z_stream z{};
        if (inflateInit(&z) == Z_OK) {
            z.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(pdf.data() + start));
            z.avail_in = static_cast<uInt>(end - start);
            char buffer[16384];
            int rc = Z_OK;
            while (rc == Z_OK) {
                z.next_out = reinterpret_cast<Bytef*>(buffer);
                z.avail_out = sizeof buffer;
                rc = inflate(&z, Z_NO_FLUSH);
                all.append(buffer, sizeof buffer - z.avail_out);
            }
            inflateEnd(&z);
        }
        all += '\n';
        at = end + 9;
    }
    return all;
}

// A PDF shows a mark when its pages set the colour for the right kind of painting (strokes
// for lines and outlines, fills for areas, a text object for text) and then paint the shape
// there, in page units with the origin where it was left.
bool PdfShows(std::string_view pdf, const Drawn& d) {
    auto part = [](int v) { return v == 0 ? std::string("0") : v == 255 ? "1" : "[0-9.]+"; };
    const std::string rgb = "(^|\\s)" + part(platform::Red(d.colour)) + " " +
                            part(platform::Green(d.colour)) + " " + part(platform::Blue(d.colour));
    auto num = [](int v) { return std::to_string(v); };
    // Up to the shape without another colour for the same kind of painting in between.
    auto then = [](const char* op) { return std::string("(?:(?!") + op + ")[\\s\\S])*?"; };
    const int w = std::abs(d.x2 - d.x1), h = std::abs(d.y2 - d.y1);
    const int x = std::min(d.x1, d.x2), y = std::min(d.y1, d.y2);
    std::string pattern;
    switch (d.mark) {
    case Mark::Clear:
        pattern = rgb + " scn" + then("scn") + "\\s0 0 \\d+ \\d+ re\\s+f";
        break;
    case Mark::Line:
        pattern = rgb + " SCN" + then("SCN") + "\\s" + num(d.x1) + " " + num(d.y1) + " m\\s+" +
                  num(d.x2) + " " + num(d.y2) + " l\\s+S";
        break;
    case Mark::Box:
        pattern = rgb + " SCN" + then("SCN") + "\\s" + num(x) + " " + num(y) + " " + num(w) + " " +
                  num(h) + " re\\s+S";
        break;
    case Mark::FilledBox: // both corners inside
        pattern = rgb + " scn" + then("scn") + "\\s" + num(x) + " " + num(y) + " " + num(w + 1) +
                  " " + num(h + 1) + " re\\s+f";
        break;
    case Mark::Point:
        pattern = rgb + " scn" + then("scn") + "\\s" + num(d.x1) + " " + num(d.y1) + " 1 1 re\\s+f";
        break;
    case Mark::Text:
        pattern = rgb + " scn" + then("scn") + "BT\\s";
        break;
    }
    return std::regex_search(PageContent(pdf), std::regex(pattern));
}

int PdfPages(std::string_view pdf) {
    std::smatch m;
    const std::string text(pdf);
    if (!std::regex_search(text, m, std::regex("/Type\\s*/Pages[^>]*?/Count\\s+(\\d+)")) &&
        !std::regex_search(text, m, std::regex("/Count\\s+(\\d+)[^>]*?/Type\\s*/Pages")))
        return 0;
    return std::stoi(m[1].str());
}

bool PdfWhole(std::string_view pdf) {
    while (!pdf.empty() && (pdf.back() == '\n' || pdf.back() == '\r' || pdf.back() == ' '))
        pdf.remove_suffix(1);
    return pdf.starts_with("%PDF-") && pdf.ends_with("%%EOF") &&
           pdf.find("startxref") != std::string_view::npos;
}

} // namespace

template <> struct ContractSubject<gui::ImageSurface> {
    gui::ImageSurface target{200, 120};
    platform::Surface& surface() { return target; }
    static std::optional<std::pair<double, double>> MadeSize() { return {{200, 120}}; }
    static constexpr bool kClearErases = true;
    bool Shows(const Drawn& d) {
        const QImage& image = target.Finish();
        auto is = [&](int x, int y) { return Distance(image.pixel(x, y), d.colour) == 0; };
        switch (d.mark) {
        case Mark::Clear:
            return is(0, 119) && is(199, 119) && is(199, 0);
        case Mark::Line:
            return is(d.x1, d.y1) && is((d.x1 + d.x2) / 2, d.y1) && is(d.x2, d.y2);
        case Mark::Box: // an outline only
            return is(d.x1, (d.y1 + d.y2) / 2) && is(d.x2, (d.y1 + d.y2) / 2) &&
                   is((d.x1 + d.x2) / 2, d.y1) && !is((d.x1 + d.x2) / 2, (d.y1 + d.y2) / 2);
        case Mark::FilledBox:
            return is(d.x1, d.y1) && is(d.x2, d.y2) && is((d.x1 + d.x2) / 2, (d.y1 + d.y2) / 2);
        case Mark::Point:
            return is(d.x1, d.y1);
        case Mark::Text: { // ink in the colour below and right of the position, none above it
            int ink = 0;
            for (int y = std::max(d.y1 - 10, 0); y < std::min(d.y1 + 30, 120); ++y)
                for (int x = std::max(d.x1 - 10, 0); x < std::min(d.x1 + 40, 200); ++x)
                    if (Distance(image.pixel(x, y), d.colour) < 120) {
                        if (y < d.y1 || x < d.x1 - 1) return false;
                        ++ink;
                    }
            return ink > 5;
        }
        }
        return false;
    }
    FontState Font() {
        const QFont& f = target.font();
        return {f.family().toStdString(), f.pointSizeF(), f.bold(), f.italic()};
    }
};

// The document in memory.
template <> struct ContractSubject<gui::PdfPrinter> {
    gui::PdfPrinter target;
    platform::Printer& surface() { return target; }
    static std::optional<std::pair<double, double>> MadeSize() { return std::nullopt; }
    static constexpr bool kClearErases = false; // a later fill covers, the earlier stays
    bool Shows(const Drawn& d) {
        if (!target.EndDoc()) return false;
        return PdfShows(target.Document(), d);
    }
    int Pages() { return PdfPages(target.Document()); }
    bool Whole() { return PdfWhole(target.Document()); }
};

// The print dialog's "Print to PDF": a QPrinter writing a PDF file, on A4.
template <> struct ContractSubject<gui::QtPrinter> {
    TempRoot root;
    std::filesystem::path path = root.path() / "printed.pdf";
    QPrinter printer{QPrinter::HighResolution};
    std::optional<gui::QtPrinter> target;
    ContractSubject() {
        printer.setOutputFormat(QPrinter::PdfFormat);
        printer.setOutputFileName(QString::fromStdString(path.string()));
        printer.setPageSize(QPageSize(QPageSize::A4));
        target.emplace(printer);
    }
    platform::Printer& surface() { return *target; }
    static std::optional<std::pair<double, double>> MadeSize() { return std::nullopt; }
    static constexpr bool kClearErases = false;
    std::string Document() {
        const auto bytes = platform::ReadWholeFile(path);
        return bytes ? *bytes : std::string();
    }
    bool Shows(const Drawn& d) {
        if (!target->EndDoc()) return false;
        return PdfShows(Document(), d);
    }
    int Pages() { return PdfPages(Document()); }
    bool Whole() { return PdfWhole(Document()); }
};

using QtSurfaces = testing::Types<gui::ImageSurface, gui::PdfPrinter, gui::QtPrinter>;
INSTANTIATE_TYPED_TEST_SUITE_P(Qt, SurfaceContract, QtSurfaces);
using QtPrinters = testing::Types<gui::PdfPrinter, gui::QtPrinter>;
INSTANTIATE_TYPED_TEST_SUITE_P(Qt, PrinterContract, QtPrinters);

} // namespace kori::test
