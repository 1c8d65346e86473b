#include "chart/print_chart.h"

#include "chart/chart_defaults.h"
#include "platform/text.h"

#include <cmath>
#include <cstdint>
#include <optional>

namespace kori::chart {

namespace {

using platform::LineStyle;

constexpr int kNormalWidth = 1;
constexpr int kLargeDotWidth = 3;

// Text, and lines drawn at the normal width; heavy lines, fills and dots are the rest.
bool IsTextOrThinLine(char letter) {
    switch (letter) {
    case 'T':
    case 'S':
    case 'Z':
    case 'B':
    case 'L':
    case 'M':
    case 'D':
    case 'E':
    case 'V':
        return true;
    default:
        return false;
    }
}

std::int32_t Round32(double v) {
    const double r = std::nearbyint(v);
    if (!(r >= -2147483648.0)) return INT32_MIN;
    if (!(r <= 2147483647.0)) return INT32_MAX;
    return static_cast<std::int32_t>(r);
}

std::int32_t IniInt32(const std::string& text) {
    return Round32(platform::Val(text));
}

// Paper coordinates are 32-bit: a product beyond them is a run-time failure.
std::optional<double> Whole32(double v) {
    const double r = std::nearbyint(v);
    if (!(r >= -2147483648.0 && r <= 2147483647.0)) return std::nullopt;
    return r;
}

class PaperPlay {
public:
    PaperPlay(const PaperJob& job, const PrintSettings& settings, double scaleX, double scaleY)
        : m_page(job.Printer), m_job(job), m_settings(settings), m_scaleX(scaleX),
          m_scaleY(scaleY) {}

    void UseFont1() {
        m_page.SetFontName(m_job.Fonts.Font1);
        m_page.SetFontBold(m_job.Fonts.Bold1);
    }

    // False on a run-time failure.
    bool Play(Instruction in) {
        in.Colour = PrintColourOf(in.Letter, in.Colour, m_settings, m_job.Palette);
        switch (in.Letter) {
        case 'T':
            Text(in);
            return true;
        case 'S':
            Title(in);
            return true;
        case 'Z':
            Emphasised(in);
            return true;
        case 'P':
            return Dot(in, m_settings.PrintLineWidth);
        case 'K':
            return Dot(in, kLargeDotWidth);
        default:
            return Shape(in);
        }
    }

private:
    void Place(const Instruction& in) {
        m_page.SetFontSize(in.Size);
        m_page.SetForeColour(in.Colour);
        m_page.SetTextPosition(in.X1 * m_scaleX, in.Y1 * m_scaleY);
        m_page.PrintText(in.Text);
    }

    void Text(const Instruction& in) {
        if (platform::Trim(in.Text).empty()) return;
        if (m_settings.PrintBold) m_page.SetFontBold(true);
        Place(in);
    }

    void Title(const Instruction& in) {
        if (platform::Trim(in.Text).empty()) return;
        m_page.SetFontName(m_job.Fonts.Font2);
        m_page.SetFontBold(false);
        Place(in);
        UseFont1();
        m_page.SetLineStyle(LineStyle::Solid);
        m_page.SetLineWidth(kNormalWidth);
    }

    void Emphasised(const Instruction& in) {
        m_page.SetFontBold(true);
        m_page.SetFontItalic(true);
        Place(in);
        m_page.SetFontItalic(false);
        m_page.SetFontBold(false);
    }

    // Points are zero-length lines at the given width.
    bool Dot(const Instruction& in, int width) {
        const auto x = Whole32(in.X1 * m_scaleX), y = Whole32(in.Y1 * m_scaleY);
        if (!x || !y) return false;
        m_page.SetLineWidth(width);
        m_page.Line(*x, *y, *x, *y, in.Colour);
        m_page.SetLineWidth(kNormalWidth);
        return true;
    }

    bool Shape(const Instruction& in) {
        const auto x1 = Whole32(in.X1 * m_scaleX), y1 = Whole32(in.Y1 * m_scaleY);
        const auto x2 = Whole32(in.X2 * m_scaleX), y2 = Whole32(in.Y2 * m_scaleY);
        if (!x1 || !y1 || !x2 || !y2) return false;
        const double a = *x1, b = *y1, c = *x2, d = *y2;
        switch (in.Letter) {
        case 'B':
            m_page.SetLineWidth(kNormalWidth);
            m_page.Box(a, b, c, d, in.Colour);
            break;
        case 'F':
            m_page.FilledBox(a, b, c, d, in.Colour);
            break;
        case 'C':
            m_page.FilledBox(a, b, c, d, in.Colour);
            m_page.SetLineWidth(kNormalWidth);
            break;
        case 'X':
            m_page.SetLineWidth(kNormalWidth);
            m_page.FilledBox(a, b, c, d, in.Colour);
            m_page.SetLineWidth(kNormalWidth);
            break;
        case 'H':
            m_page.SetLineWidth(m_settings.PrintLineWidth);
            Styled(LineStyle::Solid, a, b, c, d, in.Colour);
            m_page.SetLineWidth(kNormalWidth);
            break;
        case 'D':
        case 'E':
            Thin(LineStyle::Dash, a, b, c, d, in.Colour);
            break;
        case 'V':
            Thin(LineStyle::Dot, a, b, c, d, in.Colour);
            break;
        default:
            Thin(LineStyle::Solid, a, b, c, d, in.Colour);
            break; // "L" "M"
        }
        return true;
    }

    void Thin(LineStyle style, double a, double b, double c, double d, platform::Colour colour) {
        m_page.SetLineWidth(kNormalWidth);
        Styled(style, a, b, c, d, colour);
    }

    // A broken line returns to solid after it.
    void Styled(LineStyle style, double a, double b, double c, double d, platform::Colour colour) {
        m_page.SetLineStyle(style);
        m_page.Line(a, b, c, d, colour);
        if (style != LineStyle::Solid) m_page.SetLineStyle(LineStyle::Solid);
    }

    platform::Printer& m_page;
    const PaperJob& m_job;
    const PrintSettings& m_settings;
    double m_scaleX, m_scaleY;
};

// The first print of a run centres the chart on the paper; later prints keep that origin.
void CentreOnFirstPrint(const PaperJob& job, PrintSettings& s, double scaleX, double scaleY) {
    if (s.PageLeft != 0 && s.PageTop != 0) return;
    const double chartW = job.AreaWidth * scaleX;
    const double chartH = job.AreaHeight * scaleY;
    s.PageTop = Round32(-(job.Printer.Height() - chartH) / 2);
    s.PageLeft = Round32(-(job.Printer.Width() - chartW) / 2);
}

PlayOutcome PlayAll(StreamReader& reader, PaperPlay& play) {
    bool played = false;
    Instruction in;
    for (;;) {
        switch (reader.Next(in)) {
        case StreamReader::Result::End:
            return played ? PlayOutcome::Played : PlayOutcome::NothingPlayed;
        case StreamReader::Result::Malformed:
            return PlayOutcome::Malformed;
        case StreamReader::Result::Unreadable:
            return PlayOutcome::Unreadable;
        case StreamReader::Result::Instruction:
            break;
        }
        if (!play.Play(in)) return PlayOutcome::Malformed;
        played = true;
    }
}

} // namespace

PrintSettings LoadPrintSettings(const platform::IniFile& ini) {
    const ChartDefaults d = LoadChartDefaults(ini);
    PrintSettings s;
    s.PrintScale = d.PrintScale;
    s.PrintLineWidth = d.PrintLineWidth;
    s.PrintOrientation = IniInt16(ini.Read("ChtPage", "Orient"));
    s.PageTop = IniInt32(ini.Read("ChtPage", "PPTop"));
    s.PageLeft = IniInt32(ini.Read("ChtPage", "PPLft"));
    return s;
}

std::int16_t PrintScaleFactor(double twipsPerPixel, float printScale) {
    const double v = std::nearbyint(twipsPerPixel * static_cast<double>(printScale));
    if (!(v >= -32768.0)) return INT16_MIN;
    if (!(v <= 32767.0)) return INT16_MAX;
    return static_cast<std::int16_t>(v);
}

bool NearWhite(platform::Colour colour) {
    constexpr int kPale = 192; // light grey, entry 7 of the standard colours, and above
    return platform::Red(colour) >= kPale && platform::Green(colour) >= kPale &&
           platform::Blue(colour) >= kPale;
}

platform::Colour PrintColourOf(char letter, platform::Colour colour, const PrintSettings& settings,
                               const platform::Palette& palette) {
    if (settings.PrintColour != 1) return palette[0];
    if (colour == palette[15] || colour == palette[7] || NearWhite(colour)) return palette[0];
    if (settings.PrintColourLines == 1 && IsTextOrThinLine(letter)) return palette[0];
    return colour;
}

PlayOutcome PlayOnPaper(StreamReader& reader, const PaperJob& job, PrintSettings& settings) {
    platform::Printer& page = job.Printer;
    if (job.StatusBar) job.StatusBar->SetStatus(kPrintingStatus);
    if (settings.PrintOrientation == platform::kPortrait ||
        settings.PrintOrientation == platform::kLandscape)
        page.SetOrientation(settings.PrintOrientation);
    if (job.Pointer) job.Pointer->SetBusy(true);

    const double scaleX = PrintScaleFactor(page.TwipsPerPixelX(), settings.PrintScale);
    const double scaleY = PrintScaleFactor(page.TwipsPerPixelY(), settings.PrintScale);
    CentreOnFirstPrint(job, settings, scaleX, scaleY);
    page.SetScaleOrigin(settings.PageLeft, settings.PageTop);

    PaperPlay play(job, settings, scaleX, scaleY);
    play.UseFont1();
    page.SetFontSize(job.Fonts.Size1);
    page.SetFontItalic(false);
    page.SetLineStyle(LineStyle::Solid);
    page.SetLineWidth(kNormalWidth);
    if (settings.PrintLineWidth < 1 || settings.PrintLineWidth > 10) settings.PrintLineWidth = 2;

    PlayOutcome outcome = PlayAll(reader, play);
    if (!page.EndDoc()) outcome = PlayOutcome::PrinterFailed;
    if (job.StatusBar) job.StatusBar->SetStatus(job.StatusToRestore);
    if (job.Pointer) job.Pointer->SetBusy(false);
    return outcome;
}

PlayOutcome PrintChart(const std::filesystem::path& source, const PaperJob& job,
                       PrintSettings& settings) {
    StreamReader reader(source);
    return PlayOnPaper(reader, job, settings);
}

} // namespace kori::chart
