#pragma once
// The oscillator panel every routine draws into: its rectangle in chart units, the common
// start (background, frame, title), the fixed and symmetric scales, reference lines with their
// labels, and the stream positions that put the panel under the price chart in one stream.
#include "chart/chart.h"
#include "osc/osc_settings.h"
#include "platform/dialogs.h"
#include "platform/palette.h"
#include "platform/surface.h"

#include <cmath>
#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>

namespace kori::osc {

// Palette entries of the panels.
namespace oscpal {
inline constexpr int Frame = 16, Background = 17, Text = 27, Series1 = 38, Series2 = 40, Line1 = 45,
                     Line2 = 46, PairLine1 = 47, PairLine2 = 48;
}

// What the caller hands to the drawing of a panel besides the chart and the settings.
struct OscDrawInputs {
    OscDrawInputs(const platform::Palette& palette, const platform::ChartFonts& fonts,
                  platform::Dialogs& dialogs)
        : Palette(palette), Fonts(fonts), Dialogs(dialogs) {}

    const platform::Palette& Palette;
    const platform::ChartFonts& Fonts;
    platform::Dialogs& Dialogs;
    // The stream the price chart was written to; the panel appends to it. Empty, or
    // RedrawOnly on the chart: nothing is written.
    std::filesystem::path StreamPath;
    double DisplayScale = 1;         // the chart window's "Zoom" / 100
    double PanelOffset = 0;          // top of the panel within the chart page, in stream units
    std::string TargetName = "CHTS"; // "ANAL" (the scan window) keeps the price chart clean
    bool SlowStochastic = false;
    bool ShowStochSignals = false; // the start-up words "RM" and "GD": crossing marks on STO
    // The surface the price chart is on, for the classic MACD lines; none: they are not drawn.
    platform::Surface* PriceSurface = nullptr;
    // RMO and RMX: the comparison file's records and its code, and every record of the
    // security's own file (RMO); without the comparison file they draw nothing.
    const store::ChartSeries* CompareFile = nullptr;
    std::string CompareCode;
    const store::ChartSeries* SecurityFile = nullptr;
    std::int16_t RecordType = 4;
};

// The panel's rectangle while a routine draws, and the flag of the second routine of "R/F".
struct OscPanel {
    std::int16_t OscTop = 0, OscBottom = 0, OscLeft = 5, OscRight = 0;
    bool SecondOsc = false;
};

// The title's form of a number: a plain number-to-text, so a positive number keeps its blank.
std::string TitleNumber(double v);

// Draws on the panel surface and writes the same to the stream at y / DisplayScale +
// PanelOffset. The stream is opened for appending on construction and closed on
// destruction, so a routine leaves it closed however it ends.
class OscPainter {
public:
    OscPainter(chart::Chart& c, const OscDrawInputs& in, platform::Surface& surface);
    ~OscPainter();
    OscPainter(const OscPainter&) = delete;
    OscPainter& operator=(const OscPainter&) = delete;

    platform::Colour Col(int entry) const;
    // Stream positions keep quarters of a unit, finer than screen or paper can show; a
    // quarter is exact in binary, so the numbers stay short and quick to write.
    static double StreamUnits(double v) { return std::nearbyint(v * 4) / 4; }
    double StreamY(double y) const { return StreamUnits(y / m_in.DisplayScale + m_in.PanelOffset); }

    void Line(char letter, double x1, double y1, double x2, double y2, int entry);
    void Dotted(double x1, double y1, double x2, double y2, int entry); // "V"
    void Dashed(double x1, double y1, double x2, double y2, int entry); // "E"
    void Box(double x1, double y1, double x2, double y2, int entry);    // "B"
    // Text with its top left at (x, y) on the screen, and at (streamX, y) in the stream.
    void Text(double x, double y, std::string_view text, int entry);
    void Text(double x, double streamX, double y, std::string_view text, int entry);
    double Width(std::string_view text);

    // Lines on the price chart (classic MACD): its own surface, stream positions unchanged.
    void PriceLine(char letter, double x1, double y1, double x2, double y2, platform::Colour c);

    chart::Chart& chart;
    const OscDrawInputs& in() const { return m_in; }
    platform::Surface& screen;

private:
    const OscDrawInputs& m_in;
};

// The common preparation: background (unless the panel is already there for the second
// routine), and the rectangle. `wholeNumberHalves` is the stochastic's integer division.
OscPanel SetOscPanel(OscPainter& p, bool secondOsc, bool wholeNumberHalves = false);

// Frame (unless SecondOsc) and title; the title of a second routine stands further right.
void DrawFrameAndTitle(OscPainter& p, const OscPanel& panel, std::string_view title,
                       bool frame = true);
void DrawTitle(OscPainter& p, const OscPanel& panel, std::string_view title);

// A reference line across the panel at y, and its label right of it at OscRight + (room -
// label width), 6 units above the line. An empty label draws the line only.
void ReferenceLine(OscPainter& p, const OscPanel& panel, double y, std::string_view label,
                   double room = 25, char letter = 'L');

// The fixed scale of the 0 to 100 oscillators.
struct FixedScale {
    double Span = 0, Unit = 0;
    double Y(const OscPanel& panel, double v) const { return (panel.OscBottom - 10) - v * Unit; }
};
FixedScale MakeFixedScale(const OscPanel& panel);

// The symmetric scale about zero: Hi and Lo made equal and opposite; Per value units a unit.
struct SymmetricScale {
    double Hi = 0, Lo = 0, Per = 0;
    double Y(const OscPanel& panel, double v) const {
        return (panel.OscBottom - 10) - (v - Lo) / Per;
    }
};
void MakeSymmetric(double& hi, double& lo);
SymmetricScale MakeSymmetricScale(const OscPanel& panel, double hi, double lo);

// A routine's run-time failure as the chart shows it: out of memory, or any other with its
// number and text.
void ShowOscFailure(platform::Dialogs& dialogs, int number, std::string_view text);

// How the chart area is shared when the panel shows: the price chart keeps the top part,
// the panel the rest. The chart window and the CLI use the same split.
struct PanelSplit {
    int PriceHeight = 0, PanelHeight = 0;
};
PanelSplit SplitChartArea(int areaHeight);

} // namespace kori::osc
