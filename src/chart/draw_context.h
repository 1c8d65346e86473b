#pragma once
// What every drawing step of the price chart shares: the request and settings it reads, the
// surface it paints and the stream it writes. Each drawing call is made on the surface and
// then, by the caller's choice of letter and position, written as one stream line; where the
// two differ (paper ticks, stream-less stop lines) the caller says so.
#include "chart/chart.h"
#include "chart/chart_defaults.h"
#include "chart/chart_request.h"
#include "chart/geometry.h"
#include "platform/palette.h"
#include "platform/surface.h"

#include <string_view>

namespace kori::chart {

class PriceSource;

struct DrawInputs {
    const ChartRequest& Request;
    const ChartDefaults& Defaults;
    const ChartName& Name;
    const platform::Palette& Palette;
    const platform::ChartFonts& Fonts;
    bool PrintBold = false;         // print option: chart text prints bold
    std::int32_t VolumeDivisor = 1; // "Volume divisor" of the download settings
    PriceSource* Notes = nullptr;   // fetches the text of note records; none: no note text
};

// Font of a piece of screen text.
struct TextFont {
    int Number = 1; // chart font 1 or 2
    double Size = 8;
    bool Bold = false;
    bool Italic = false;
};

// Palette entries the price chart draws in.
namespace pal {
inline constexpr int StopLine = 10, StopBroken = 11, PreviousStopBroken = 13, Frame = 16, Bars = 18,
                     Trace = 19, Volume = 22, Notes = 24, Heading = 26, Labels = 27,
                     DownCandle = 28, Reversal = 29, KeyReversal = 30, HookReversal = 31,
                     OpenCloseReversal = 32, PivotPoint = 33, YearLine = 34, Grid = 35;
}

// The price panel's frame as the frame box draws it, from PlotLeft - 1 to PlotRight.
PlotRect PlotFrame(const Chart& c);

class ChartPainter {
public:
    ChartPainter(Chart& c, const DrawInputs& inputs, platform::Surface& surface)
        : chart(c), in(inputs), screen(surface), stream(c.Stream) {}

    platform::Colour Col(int entry) const;

    // Solid line on the screen, then the stream line of `letter`.
    void Line(char letter, double x1, double y1, double x2, double y2, int entry);
    // Dotted line on the screen; "V" in the stream unless told otherwise.
    void DottedScreen(double x1, double y1, double x2, double y2, int entry);
    void Dotted(double x1, double y1, double x2, double y2, int entry);
    void Box(double x1, double y1, double x2, double y2, int entry); // outline, "B"
    // A line of an overlay: the part inside the price panel's frame is drawn and streamed,
    // the rest of it (a band beyond the scale, say) is not.
    void PlotLine(char letter, double x1, double y1, double x2, double y2, int entry);
    void PlotLine(char letter, double x1, double y1, double x2, double y2, platform::Colour colour);
    bool InPlot(double x, double y) const;

    TextFont Font1(bool bold) const;
    TextFont Font1() const { return Font1(in.Fonts.Bold1); }
    TextFont Font2() const;
    double Width(std::string_view text, const TextFont& f);
    // Text on the screen only; the text colour goes back to the label colour afterwards.
    void ScreenText(double x, double y, std::string_view text, int entry, const TextFont& f);
    // The common "T" of chart text: size 8.25 at the screen place with the bold print option
    // off; with it on, the size of chart font 1 at the place moved by (dxBold, dyBold).
    void StreamT(double x, double y, std::string_view text, int entry, double dxBold = 0,
                 double dyBold = 0);

    Chart& chart;
    const DrawInputs& in;
    platform::Surface& screen;
    StreamWriter& stream;
};

} // namespace kori::chart
