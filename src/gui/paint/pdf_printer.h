#pragma once
// The printed page as a PDF document: A4, portrait or landscape, at 600 dots an inch. Printer
// units are those dots, so a dot is 2.4 twips; the page starts on the first drawing call. The
// document is made in memory and goes to disk through the safe write at the end, so the target
// takes it only whole: a painter that fails to end or a failed write leaves the old file.
#include "gui/paint/qt_surface.h"
#include "platform/printer.h"

#include <QBuffer>
#include <QByteArray>
#include <QPainter>
#include <QPdfWriter>

#include <filesystem>
#include <optional>

namespace kori::gui {

class PdfPrinter : public platform::Printer {
public:
    explicit PdfPrinter(const std::filesystem::path& path, int dotsPerInch = 600);
    // A document kept in memory only: EndDoc finishes it, the caller decides whether to keep it.
    PdfPrinter() : PdfPrinter(std::filesystem::path()) {}
    ~PdfPrinter() override;
    PdfPrinter(const PdfPrinter&) = delete;
    PdfPrinter& operator=(const PdfPrinter&) = delete;

    void SetOrientation(int orientation) override;
    int Orientation() const override { return m_orientation; }
    void SetScaleOrigin(double left, double top) override;
    double Width() const override;
    double Height() const override;
    double TwipsPerPixelX() const override { return 1440.0 / m_dpi; }
    double TwipsPerPixelY() const override { return 1440.0 / m_dpi; }
    void NewPage() override;
    platform::Status EndDoc() override;
    // The finished document (after EndDoc).
    std::string_view Document() const {
        return {m_bytes.constData(), static_cast<std::size_t>(m_bytes.size())};
    }

    void Clear() override;
    void SetBackColour(platform::Colour c) override;
    void SetLineWidth(int width) override;
    void SetLineStyle(platform::LineStyle style) override;
    void SetForeColour(platform::Colour c) override;
    void Line(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void Box(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void FilledBox(double x1, double y1, double x2, double y2, platform::Colour c) override;
    void Point(double x, double y, platform::Colour c) override;
    void SetFontName(std::string_view name) override;
    void SetFontSize(double points) override;
    void SetFontBold(bool bold) override;
    void SetFontItalic(bool italic) override;
    void SetTextPosition(double x, double y) override;
    void PrintText(std::string_view text) override;
    double TextWidth(std::string_view text) override;
    double TextHeight(std::string_view text) override;

private:
    QtSurface& Page(); // begins the document on first use
    void ApplyOrigin();

    std::filesystem::path m_path;
    QByteArray m_bytes;
    QBuffer m_buffer{&m_bytes};
    int m_dpi;
    int m_orientation = platform::kPortrait;
    double m_originLeft = 0, m_originTop = 0;
    QPdfWriter m_writer;
    QPainter m_painter;
    std::optional<QtSurface> m_page;
    bool m_failed = false;
    bool m_ended = false;
    platform::Status m_result = platform::Status::Ok();
};

} // namespace kori::gui
