#include "chart/screen_player.h"

#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace kori::chart {

namespace {

constexpr int kBackgroundEntry = 17; // background of a cleared plot
constexpr int kLabelEntry = 27;      // text colour between drawings

// Line, box and point coordinates are 16-bit chart units on the screen: a number beyond them
// fails the play-back as a run-time failure would.
std::optional<double> Whole(double v) {
    const double r = std::nearbyint(v);
    if (!(r >= -32768.0 && r <= 32767.0)) return std::nullopt;
    return r;
}

class ScreenPlay {
public:
    ScreenPlay(platform::Surface& area, const platform::Palette& palette,
               const platform::ChartFonts& fonts)
        : m_area(area), m_palette(palette), m_fonts(fonts) {}

    void UseFont1() {
        m_area.SetFontName(m_fonts.Font1);
        m_area.SetFontBold(m_fonts.Bold1);
    }

    // False on a run-time failure; `handled` tells whether the letter plays on the screen.
    bool Play(const Instruction& in, bool& handled) {
        handled = true;
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
        case 'X':
        case 'K':
            handled = false;
            return true; // paper only
        case 'P':
            return Point(in);
        default:
            return Shape(in);
        }
    }

private:
    void Place(const Instruction& in) {
        m_area.SetForeColour(in.Colour);
        m_area.SetTextPosition(in.X1, in.Y1);
        m_area.PrintText(in.Text);
    }

    void Text(const Instruction& in) {
        m_area.SetFontSize(in.Size);
        Place(in);
        m_area.SetForeColour(m_palette[kLabelEntry]);
    }

    void Title(const Instruction& in) {
        if (platform::Trim(in.Text).empty()) return;
        m_area.SetFontName(m_fonts.Font2);
        m_area.SetFontBold(false);
        m_area.SetFontSize(in.Size);
        Place(in);
        UseFont1();
        m_area.SetLineStyle(platform::LineStyle::Solid);
    }

    void Emphasised(const Instruction& in) {
        m_area.SetFontSize(in.Size);
        m_area.SetFontBold(true);
        m_area.SetFontItalic(true);
        Place(in);
        m_area.SetFontItalic(false);
        m_area.SetFontBold(false);
    }

    bool Point(const Instruction& in) {
        const auto x = Whole(in.X1), y = Whole(in.Y1);
        if (!x || !y) return false;
        m_area.Point(*x, *y, in.Colour);
        return true;
    }

    bool Shape(const Instruction& in) {
        const auto x1 = Whole(in.X1), y1 = Whole(in.Y1), x2 = Whole(in.X2), y2 = Whole(in.Y2);
        if (!x1 || !y1 || !x2 || !y2) return false;
        switch (in.Letter) {
        case 'B':
            m_area.Box(*x1, *y1, *x2, *y2, in.Colour);
            break;
        case 'F':
        case 'C':
            m_area.FilledBox(*x1, *y1, *x2, *y2, in.Colour);
            break;
        case 'D':
        case 'E':
            StyledLine(platform::LineStyle::Dash, *x1, *y1, *x2, *y2, in.Colour);
            break;
        case 'V':
            m_area.SetLineWidth(1);
            StyledLine(platform::LineStyle::Dot, *x1, *y1, *x2, *y2, in.Colour);
            break;
        default:
            m_area.Line(*x1, *y1, *x2, *y2, in.Colour);
            break; // "H" "L" "M"
        }
        return true;
    }

    void StyledLine(platform::LineStyle style, double x1, double y1, double x2, double y2,
                    platform::Colour colour) {
        m_area.SetLineStyle(style);
        m_area.Line(x1, y1, x2, y2, colour);
        m_area.SetLineStyle(platform::LineStyle::Solid);
    }

    platform::Surface& m_area;
    const platform::Palette& m_palette;
    const platform::ChartFonts& m_fonts;
};

} // namespace

PlayOutcome PlayOnScreen(StreamReader& reader, platform::Surface& area,
                         const platform::Palette& palette, const platform::ChartFonts& fonts) {
    ScreenPlay play(area, palette, fonts);
    play.UseFont1();
    area.SetFontSize(fonts.Size1);
    area.SetFontItalic(false);
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
        bool handled = false;
        if (!play.Play(in, handled)) return PlayOutcome::Malformed;
        played = played || handled;
    }
}

StreamReach MeasureStream(const std::filesystem::path& path) {
    constexpr double kTextLine = 14; // room under a text's top for one line of chart text
    StreamReach reach;
    StreamReader reader(path);
    Instruction in;
    while (reader.Next(in) == StreamReader::Result::Instruction) {
        const bool text = IsTextLetter(in.Letter);
        const bool dot = IsDotLetter(in.Letter);
        const double right = text || dot ? in.X1 : std::max(in.X1, in.X2);
        const double bottom = text ? in.Y1 + kTextLine : dot ? in.Y1 : std::max(in.Y1, in.Y2);
        reach.Right = std::max(reach.Right, right);
        reach.Bottom = std::max(reach.Bottom, bottom);
    }
    return reach;
}

bool ShowSavedChart(const std::filesystem::path& path, platform::Surface& area,
                    const platform::Palette& palette, const platform::ChartFonts& fonts,
                    platform::Dialogs& dialogs) {
    dialogs.SetBusy(true);
    area.SetLineWidth(1);
    area.SetBackColour(palette[kBackgroundEntry]);
    area.Clear();
    StreamReader reader(path);
    const PlayOutcome outcome = PlayOnScreen(reader, area, palette, fonts);
    dialogs.SetBusy(false);
    if (outcome == PlayOutcome::Played) return true;
    dialogs.MsgBox(kFormatInvalidText, kShowSavedChartTitle, platform::Buttons::Ok,
                   platform::Icon::Exclamation);
    return false;
}

} // namespace kori::chart
