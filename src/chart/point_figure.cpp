#include "chart/point_figure.h"

#include "chart/draw_date_axis.h"
#include "chart/draw_frame.h"
#include "chart/draw_price_chart.h"
#include "chart/scale.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace kori::chart {

std::int16_t PFReversal(std::int16_t barSpacing) {
    return barSpacing >= 2 && barSpacing <= 6 ? barSpacing : std::int16_t{2};
}

float AutoBoxValue(float chartBase, float chartCeiling, int rows) {
    if (rows <= 0) return 0;
    const float raw = (chartCeiling - chartBase) / static_cast<float>(rows);
    return std::nearbyint(raw * 1000) / 1000;
}

namespace {

bool IsNumber(const std::string& text) {
    char* end = nullptr;
    std::strtod(text.c_str(), &end);
    return end != text.c_str() && *end == '\0';
}

int RowsOf(const Chart& c) {
    return static_cast<int>(
        std::nearbyint(static_cast<double>(c.PlotBottom - c.PlotTop) / pf::CellSize));
}

} // namespace

float AskBoxValue(platform::Dialogs& dialogs, float proposal) {
    const std::string shown = platform::FloatText(proposal);
    // A user who keeps typing text is asked again; after a few tries the proposal stands.
    for (int attempt = 0; attempt < 5; ++attempt) {
        const auto answer = dialogs.InputBox(
            "Box value (leave blank or type A for automatic):", pf::DialogTitle, shown);
        if (!answer) return proposal;
        const std::string text = platform::Trim(*answer);
        if (text.empty() || text == "A" || text == "a") return proposal;
        if (IsNumber(text)) return static_cast<float>(platform::Val(text));
        dialogs.MsgBox("The box value must be a number.", pf::DialogTitle);
    }
    return proposal;
}

int PFColumns::RowOf(float price) const {
    const double row = std::nearbyint((static_cast<double>(price) - m_base) / m_box);
    return static_cast<int>(std::clamp(row, -double{pf::MaxRows}, double{pf::MaxRows}));
}

void PFColumns::Add(bool rising) {
    m_lastBox = rising ? m_lastBox + m_box : m_lastBox - m_box;
    if (onBox) onBox({m_column, RowOf(m_lastBox), rising, false});
    m_direction = rising ? 'U' : 'D';
    ++m_boxesInColumn;
    m_stage = 2;
}

void PFColumns::Move(float close, int bar, bool rising) {
    const float sign = rising ? 1.0f : -1.0f;
    const char same = rising ? 'U' : 'D';
    // Bounded twice over: a step that no longer moves the float (a box below its precision at
    // that price) ends the move, and no move adds more boxes than a chart has rows.
    for (int boxes = 0; boxes <= pf::MaxRows; ++boxes) {
        const float next = m_lastBox + sign * m_box;
        if (next == m_lastBox) return;
        if (rising ? !(close >= next) : !(close <= next)) return;
        if (m_stage == 1 || m_direction == same) {
            Add(rising);
            continue;
        }
        const float target = m_lastBox + sign * static_cast<float>(m_reversal) * m_box;
        const bool reached = rising ? close >= target : close <= target;
        if (!reached) return;
        if (m_boxesInColumn == 2) {
            // A column of one step turns round in place.
            Add(rising);
            continue;
        }
        ++m_column;
        if (onColumn) onColumn(m_column, bar);
        m_boxesInColumn = 1;
        Add(rising);
    }
}

void PFColumns::Close(float close, int bar) {
    if (close == 0 || !std::isfinite(close)) return;
    if (m_stage == 0) {
        m_lastBox = close;
        m_column = 1;
        if (onColumn) onColumn(1, bar);
        if (onBox) onBox({1, RowOf(close), true, true});
        m_stage = 1;
        return;
    }
    if (close < m_lastBox)
        Move(close, bar, false);
    else if (close > m_lastBox)
        Move(close, bar, true);
}

std::vector<int> CountColumns(const std::vector<float>& closes, float chartBase, float boxValue,
                              std::int16_t reversal) {
    std::vector<int> starts;
    PFColumns run(chartBase, boxValue, reversal);
    run.onColumn = [&starts](int, int bar) { starts.push_back(bar); };
    for (std::size_t i = 0; i < closes.size(); ++i)
        run.Close(closes[i], static_cast<int>(i));
    return starts;
}

std::optional<float> PFRangeProblem(const std::vector<float>& closes, float boxValue) {
    float lo = 0, hi = 0;
    bool any = false;
    for (float close : closes) {
        if (close == 0 || !std::isfinite(close)) continue;
        lo = any ? std::min(lo, close) : close;
        hi = any ? std::max(hi, close) : close;
        any = true;
    }
    if (!any) return std::nullopt;
    const float top = std::max(std::fabs(lo), std::fabs(hi));
    const bool steps = std::nextafter(top, INFINITY) - top <= boxValue;
    const bool fits = (static_cast<double>(hi) - lo) / boxValue <= pf::MaxRows;
    if (boxValue > 0 && steps && fits) return std::nullopt;
    return top;
}

std::string PFLabel(float value, std::int16_t recordType) {
    if (value > 0 && value < 0.1f)
        return platform::FormatSingle(value, ".00#", platform::ZeroSign::Dropped);
    if (recordType == 4)
        return platform::FormatSingle(value, "####.00", platform::ZeroSign::Dropped);
    return platform::FormatSingle(value, "######", platform::ZeroSign::Dropped);
}

namespace {

class PFDrawing {
public:
    PFDrawing(ChartPainter& p, float boxValue)
        : m_p(p), m_c(p.chart), m_box(boxValue), m_rows(RowsOf(p.chart)), m_axis(p) {}

    void FrameAndLabels() {
        m_p.Box(m_c.PlotLeft, m_c.PlotTop, m_c.PlotRight, m_c.PlotBottom, pal::Frame);
        const int rows12 = m_rows / 12;
        const TextFont f1 = m_p.Font1();
        for (int n = 0; n <= 12; ++n) {
            const float value = static_cast<float>(n * rows12) * m_box + m_c.ChartBase;
            const double y = m_c.PlotBottom - rows12 * pf::CellSize * n;
            m_p.Line('L', m_c.PlotRight, y, m_c.PlotRight + 5, y, pal::Frame);
            if (m_p.in.Defaults.ShowPriceGrid && n > 0 && y > m_c.PlotTop) {
                // The stream line lies at y 0: on paper these lines print on the top edge.
                m_p.DottedScreen(m_c.PlotLeft, y, m_c.PlotRight, y, pal::Grid);
                m_p.stream.Shape('V', m_c.PlotLeft, 0, m_c.PlotRight, 0, m_p.Col(pal::Grid));
            }
            const std::string label = PFLabel(value, m_p.in.Name.RecordType);
            const double x = m_c.PlotRight + 5 + 40 - m_p.Width(label, f1);
            m_p.ScreenText(x, y - 6, label, pal::Labels, f1);
            m_p.stream.Text('T', m_p.in.Fonts.Size1, x, y - (m_p.in.PrintBold ? 12 : 6), label,
                            m_p.Col(pal::Labels));
        }
    }

    void BoxValueText() {
        const std::string text = "Box Value = " + platform::FloatText(m_box);
        const double y = m_c.PlotTop - 16;
        m_p.ScreenText(250, y, text, pal::Frame, m_p.Font1());
        m_p.stream.Text('T', 8.25, 300, y, text, m_p.Col(pal::Frame));
    }

    void Run(const std::vector<float>& closes, int firstBar, std::int16_t reversal) {
        PFColumns run(m_c.ChartBase, m_box, reversal);
        m_boxX = m_c.PlotLeft + pf::CellSize;
        run.onColumn = [this](int column, int) {
            if (column == 1) return;
            m_boxX += pf::CellSize;
            if (m_boxX > m_c.PlotRight - 8) Restart();
        };
        run.onBox = [this](const PFBox& b) { DrawBox(b); };
        const auto& bars = m_c.ChartBars();
        for (std::size_t i = static_cast<std::size_t>(firstBar); i < closes.size(); ++i) {
            if (closes[i] == 0 || !std::isfinite(closes[i])) continue;
            DateMark(bars[i].DateText());
            run.Close(closes[i], static_cast<int>(i));
        }
    }

private:
    // The columns reached the right edge: wipe the plot and carry on from the left.
    void Restart() {
        m_p.screen.FilledBox(m_c.PlotLeft, m_c.PlotTop, m_c.PlotRight, m_c.PlotBottom,
                             m_p.Col(pf::Wipe));
        m_p.stream.Shape('F', m_c.PlotLeft, m_c.PlotTop, m_c.PlotRight, m_c.PlotBottom,
                         m_p.Col(pf::Wipe));
        FrameAndLabels();
        m_boxX = m_c.PlotLeft + pf::CellSize;
    }

    // A new month (yyyymm) ticks the date axis; a new year marks the next box.
    void DateMark(std::string_view date) {
        const std::string_view month = date.substr(0, 6);
        if (month == m_lastMonth) return;
        if (!m_lastMonth.empty() && month.substr(0, 4) != m_lastMonth.substr(0, 4))
            m_monthMarker = true;
        m_lastMonth.assign(month);
        m_axis.Bar(m_boxX, date);
    }

    void DrawBox(const PFBox& b) {
        const double y = m_c.PlotBottom - pf::CellSize * static_cast<double>(b.Row);
        const double x1 = m_boxX - pf::BoxHalf, x2 = m_boxX + pf::BoxHalf;
        const double y1 = y - pf::BoxHalf, y2 = y + pf::BoxHalf;
        if (!b.First && m_monthMarker) {
            // The first box of a year stands out.
            m_monthMarker = false;
            m_p.screen.FilledBox(x1, y1, x2, y2, m_p.Col(pf::MonthBox));
            m_p.stream.Shape('F', x1, y1, x2, y2, m_p.Col(pf::MonthBox));
            return;
        }
        if (b.Rising) {
            // Filled on the screen, an outline on paper.
            m_p.screen.FilledBox(x1, y1, x2, y2, m_p.Col(pal::Bars));
            m_p.stream.Shape('B', x1, y1, x2, y2, m_p.Col(pal::Bars));
        } else {
            // An outline on the screen, filled on paper ("X" is paper only).
            m_p.screen.Box(x1, y1, x2, y2, m_p.Col(pf::FallingBox));
            m_p.stream.Shape('X', x1, y1, x2, y2, m_p.Col(pf::FallingBox));
        }
    }

    ChartPainter& m_p;
    Chart& m_c;
    float m_box;
    int m_rows;
    DateAxis m_axis;
    double m_boxX = 0;
    std::string m_lastMonth;
    bool m_monthMarker = false;
};

platform::Status ScaleFailure(Chart& c, const DrawInputs& in, platform::Dialogs& dialogs) {
    c.Failed = true;
    dialogs.Beep();
    const std::string text = ManualScaleMessage(in.Name.Code);
    dialogs.MsgBox(text, "Chart Display");
    return platform::Status::Error(text);
}

float SettleBoxValue(const Chart& c, const DrawInputs& in, platform::Dialogs& dialogs, int rows) {
    const float automatic = AutoBoxValue(c.ChartBase, c.ChartCeiling, rows);
    float box = automatic;
    if (!in.Request.PFAuto) {
        if (in.Defaults.AutoScale)
            box = in.Name.PFIncrement > 0 ? in.Name.PFIncrement : automatic;
        else
            box = AskBoxValue(dialogs, automatic);
    }
    return box < pf::MinimumBox ? pf::MinimumBox : box;
}

} // namespace

platform::Status DrawPointFigureChart(Chart& c, const DrawInputs& inputs, const PlotGeometry& g,
                                      platform::Dialogs& dialogs, platform::Surface& surface) {
    // No volume panel, no log scale and no turning over on a point-and-figure chart.
    ChartRequest request = inputs.Request;
    request.ShowVolume = false;
    request.UpsideDown = false;
    ChartDefaults defaults = inputs.Defaults;
    defaults.LogBars = defaults.LogLine = false;
    const DrawInputs pfIn{request,      defaults,         inputs.Name,          inputs.Palette,
                          inputs.Fonts, inputs.PrintBold, inputs.VolumeDivisor, inputs.Notes};
    if (auto s = SettleLoadedChart(c, pfIn, g, dialogs); !s) return s;
    if (c.ChartBase == 0 || c.ChartCeiling == 0) return ScaleFailure(c, pfIn, dialogs);
    if (request.ChartSlot < 2) {
        surface.SetBackColour(inputs.Palette[pf::Wipe]);
        surface.Clear();
    }
    surface.SetLineWidth(1);
    std::vector<float> closes;
    const auto& bars = c.ChartBars();
    for (int i = 0; i <= c.LastBar() && i < static_cast<int>(bars.size()); ++i)
        closes.push_back(bars[static_cast<std::size_t>(i)].Close);

    float box = SettleBoxValue(c, pfIn, dialogs, RowsOf(c));
    if (const auto top = PFRangeProblem(closes, box)) {
        // Boxes too small for the prices: the automatic value takes over when it can draw
        // them; otherwise nothing is drawn. Either way the user is told.
        const float automatic =
            std::max(AutoBoxValue(c.ChartBase, c.ChartCeiling, RowsOf(c)), pf::MinimumBox);
        const std::string why = "Box value " + platform::FloatText(box) +
                                " is too small for prices up to " + platform::FloatText(*top);
        if (PFRangeProblem(closes, automatic)) {
            c.Failed = true;
            const std::string text = why + ": " + platform::Trim(inputs.Name.Code) +
                                     " cannot be drawn as point and figure.";
            dialogs.MsgBox(text, pf::DialogTitle);
            return platform::Status::Error(text);
        }
        dialogs.MsgBox(why + ": the box value " + platform::FloatText(automatic) +
                           " is used instead.",
                       pf::DialogTitle);
        box = automatic;
    }
    ChartPainter p(c, pfIn, surface);
    c.ChartCeiling = box; // the ceiling carries the box value from here on
    c.Map.PreparePointFigure(c.ChartBase, box, c.PlotBottom, pf::CellSize); // for the tools
    PFDrawing pfDraw(p, box);
    DrawHeading(p);
    pfDraw.FrameAndLabels();
    pfDraw.BoxValueText();

    const std::int16_t reversal = PFReversal(inputs.Request.BarSpacing);
    const std::vector<int> starts = CountColumns(closes, c.ChartBase, box, reversal);
    const int fit = (c.PlotRight - c.PlotLeft - defaults.BlankRight) / pf::CellSize;
    const int made = static_cast<int>(starts.size());
    const int startColumn = std::max(1, made - (fit - 10));
    int firstBar = 0;
    if (startColumn <= made)
        firstBar = std::max(0, starts[static_cast<std::size_t>(startColumn - 1)] - 1);
    pfDraw.Run(closes, firstBar, reversal);
    return platform::Status::Ok();
}

} // namespace kori::chart
