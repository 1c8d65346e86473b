#include "chart/draw_frame.h"

#include "platform/number_format.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>

namespace kori::chart {

namespace {

std::int16_t BandPercent(std::int16_t v) {
    return (v >= 1 && v <= 100) ? v : std::int16_t{5};
}

const char* PeriodWord(char period) {
    if (period == 'W') return "WEEKLY";
    if (period == 'M') return "MONTHLY";
    return "DAILY";
}

void DrawTitle(ChartPainter& p) {
    const ChartRequest& r = p.in.Request;
    const Chart& c = p.chart;
    const std::string code = platform::Trim(p.in.Name.Code);
    if (r.ChartSlot >= 1 || r.SplitMode) {
        const double x = r.ChartSlot >= 1 ? (r.ChartSlot - 1) * 60.0 : 4.0 * c.PlotLeft;
        const double y = r.ChartSlot >= 1 ? 2.0 : c.TitleTop + 2.0;
        TextFont f = p.Font1();
        f.Size = 9.75;
        p.ScreenText(x, y, code, pal::Heading, f);
        p.stream.Text('T', 9.75, x, y, code, p.Col(pal::Heading));
        return;
    }
    const std::string title = platform::PadRight(p.in.Name.Code, 6) +
                              (p.in.PrintBold ? "  " : "    ") +
                              platform::PadRight(p.in.Name.Name, 35);
    p.ScreenText(20, 2, title, pal::Heading, p.Font1());
    p.StreamT(20, 2, title, pal::Heading);
    const std::string details = platform::PadRight(p.in.Name.OtherDetails, 15);
    if (platform::Trim(details).empty()) return;
    const double y = 2 + p.screen.TextHeight(title);
    p.ScreenText(20, y, details, pal::Heading, p.Font1());
    p.stream.Text('T', 8.25, 20, y, std::string(15, ' ') + details, p.Col(pal::Heading));
}

void DrawVolumeScale(ChartPainter& p) {
    const Chart& c = p.chart;
    const double step = std::nearbyint((c.VolBottom - c.VolTop) / 4.0);
    const TextFont f2 = p.Font2();
    for (int n = 0; n <= 3; ++n) {
        const double y = c.VolBottom - n * step;
        if (n > 0) p.Dotted(c.PlotRight, y, c.PlotRight + 2, y, pal::Notes);
        if (!c.Volumes.ready()) continue;
        const std::string label = VolumeLabel(c.Volumes.YToVolume(y));
        const double x = c.PlotRight + 30 - p.Width(label, f2);
        p.ScreenText(x, y - 4, label, pal::Labels, f2);
        p.stream.Text('S', f2.Size, x, y - 4, label, p.Col(pal::Labels));
    }
    // "VOL" down the right edge, one letter a division, under the divisor's code.
    const std::int32_t d = p.in.VolumeDivisor;
    const char* code = d == 10      ? "10"
                       : d == 100   ? "100"
                       : d == 1000  ? "K"
                       : d == 10000 ? "10K"
                                    : "";
    const char* letters[] = {code, "V", "O", "L"};
    for (int i = 0; i < 4; ++i) {
        if (!*letters[i]) continue;
        const double x = c.PlotRight + 44 - p.Width(letters[i], f2) / 2;
        const double y = c.VolBottom - (4 - i) * step;
        p.ScreenText(x, y, letters[i], pal::Labels, f2);
        p.stream.Text('S', f2.Size, x, y, letters[i], p.Col(pal::Labels));
    }
}

// A base of 0.001 stands for 0 once past the first line, so the labels run 0, step, ...
float GridValue(const Chart& c, int n) {
    const float base = (n > 0 && c.ChartBase == 0.001f) ? 0.0f : c.ChartBase;
    return base + static_cast<float>(n) * c.GridStep;
}

void DrawPriceLine(ChartPainter& p, int n, float value, std::int16_t y, bool& skip) {
    const Chart& c = p.chart;
    p.Line('L', c.PlotRight, y, c.PlotRight + 4, y, pal::Frame);
    if (LabelShows(n, c.GridCount, skip)) {
        const std::string label =
            PriceLabel(value, c.ChartCeiling - c.ChartBase, p.in.Name.RecordType);
        const TextFont f1 = p.Font1();
        const double x = c.PlotRight + 5 + 40 - p.Width(label, f1);
        p.ScreenText(x, y - 6, label, pal::Labels, f1);
        p.stream.Text('T', p.in.Fonts.Size1, x, y - (p.in.PrintBold ? 12 : 6), label,
                      p.Col(pal::Labels));
    }
    if (!p.in.Defaults.ShowPriceGrid || n == 0) return;
    p.Dotted(c.PlotLeft, y, c.PlotRight, y, pal::Grid);
    if (p.in.Defaults.MidGrid != 0) {
        const std::int16_t mid =
            c.PriceToY((static_cast<float>(n) - 0.5f) * c.GridStep + c.ChartBase);
        p.Dotted(c.PlotLeft, mid, c.PlotRight, mid, pal::Grid);
    }
}

void DrawVerticalGrid(ChartPainter& p) {
    const Chart& c = p.chart;
    const ChartDefaults& d = p.in.Defaults;
    if (p.in.Request.DateGrid || !d.ShowPriceGrid || !(d.VerticalGridSpace > 0)) return;
    const double step = c.BarSpacing * d.VerticalGridSpace;
    if (!(step >= 1)) return;
    for (double x = c.PlotLeft + step; x <= c.PlotRight; x += step)
        p.Dotted(x, c.PlotTop, x, c.PlotBottom, pal::Grid);
}

} // namespace

std::string VolumeLabel(double volume) {
    const double v = std::max(0.0, volume);
    if (v < 10000) return platform::Format(v, "0", platform::ZeroSign::Dropped);
    if (v < 1e6) return platform::Format(v / 1e3, "0", platform::ZeroSign::Dropped) + "K";
    if (v < 1e7) return platform::Format(v / 1e6, "0.0", platform::ZeroSign::Dropped) + "M";
    if (v < 1e9) return platform::Format(v / 1e6, "0", platform::ZeroSign::Dropped) + "M";
    return platform::Format(v / 1e9, "0.0", platform::ZeroSign::Dropped) + "G";
}

std::string HeadingLine(const ChartRequest& r, const ChartName& name, bool logarithmic,
                        bool lineChart) {
    std::string s = PeriodWord(r.ChartPeriod);
    if (logarithmic)
        s += lineChart ? " - LOGARITHMIC - " : " - LOGARITHMIC -";
    else
        s += " - ARITHMETIC -";
    if (r.UpsideDown) s += std::string(20, ' ') + "UPSIDE-DOWN CHART";
    if (r.ChartBands == 1) {
        s += std::string(6, ' ') + "Percentage Bands  &" +
             platform::Str(BandPercent(name.PercentBandUp)) + "%    -" +
             platform::Str(BandPercent(name.PercentBandDown)) + "%";
        return s;
    }
    for (const std::string* avg : {&r.AverageName1, &r.AverageName2})
        if (*avg != "unknown") s += std::string(6, ' ') + *avg;
    return s;
}

std::string PriceLabel(float value, float range, std::int16_t recordType) {
    if (value >= 0 && value <= 0.2f)
        return platform::FormatSingle(value, ".00#", platform::ZeroSign::Dropped);
    if (recordType == 5)
        return platform::FormatSingle(value, "######", platform::ZeroSign::Dropped);
    return platform::FormatSingle(value, range > 0.1f ? "###.00" : "###.00#",
                                  platform::ZeroSign::Dropped);
}

bool LabelShows(int n, int gridCount, bool& skip) {
    const bool thinning = gridCount >= 13 || n >= 7;
    const bool shows = !thinning || !skip;
    skip = !skip;
    return shows;
}

void DrawHeading(ChartPainter& p) {
    DrawTitle(p);
    const Chart& c = p.chart;
    const std::string line = HeadingLine(p.in.Request, p.in.Name, c.Logarithmic, c.Style == 'L');
    double x = c.PlotLeft + 2, y = c.TitleTop - 18;
    if (y < 0) {
        // The upper half of a split has no room above its plot: the line follows the code.
        const TextFont f = p.Font1();
        x = 4.0 * c.PlotLeft + p.Width(platform::Trim(p.in.Name.Code) + "    ", {1, 9.75, f.Bold});
        y = c.TitleTop + 2;
    }
    p.ScreenText(x, y, line, pal::Heading, p.Font1(true));
    p.StreamT(x, y, line, pal::Heading);
}

void DrawGrid(ChartPainter& p) {
    const Chart& c = p.chart;
    p.Box(c.PlotLeft - 1, c.PlotTop, c.PlotRight, c.PlotBottom, pal::Frame);
    if (c.HasVolume) {
        p.Box(c.PlotLeft - 1, c.VolTop, c.PlotRight, c.VolBottom, pal::Frame);
        DrawVolumeScale(p);
    }
    if (c.GridStep > 0) {
        bool skip = false;
        for (int n = 0; n <= c.GridCount; ++n) {
            const float value = GridValue(c, n);
            const std::int16_t y = c.PriceToY(value);
            // Upside down, the lines run downwards and stop past the ceiling.
            if (p.in.Request.UpsideDown && y > c.PlotTop) break;
            DrawPriceLine(p, n, value, y, skip);
        }
    }
    DrawVerticalGrid(p);
}

} // namespace kori::chart
