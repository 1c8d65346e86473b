#include "chart/draw_bars.h"

#include "chart/draw_date_axis.h"
#include "chart/price_source.h"
#include "chart/swing.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <array>
#include <cmath>
#include <optional>

namespace kori::chart {

namespace {

bool Outside(const BarYs& b, const BarYs& prev) {
    return b.High < prev.High && b.Low > prev.Low;
}

// Stop-loss colouring of bar charts; its read-out stays off the stream.
struct StopLoss {
    float Stop = 0;
    double StopX = 0;
    bool Broken = false;

    int Colour(const ChartDefaults& d, const store::ChartBar& bar, const BarYs& ys,
               const BarYs& prev, double x) {
        int entry = pal::Bars;
        if (Stop > 0 && bar.Close < Stop && !Broken) {
            Broken = true;
            Stop = 0;
            entry = pal::StopBroken;
        } else {
            Broken = false;
        }
        if (Outside(ys, prev)) {
            entry = pal::DownCandle;
            if (d.StopPercentOn && d.StopPercent >= 1 && d.StopPercent <= 100) {
                Stop = (100 - d.StopPercent) / 100 * bar.Low;
                StopX = x;
            }
        }
        return entry;
    }

    void ReadOut(ChartPainter& p) const {
        const Chart& c = p.chart;
        const TextFont f = p.Font1();
        if (Broken) {
            const std::string text = "PREVIOUS STOP BROKEN";
            p.ScreenText(c.PlotRight - p.Width(text, f), 30, text, pal::PreviousStopBroken, f);
        } else if (Stop > 0) {
            const std::int16_t y = c.PriceToY(Stop);
            p.screen.Line(StopX, y, c.PlotRight, y, p.Col(pal::StopLine));
            const std::string text =
                "Current Stop Loss : " +
                platform::FormatSingle(Stop, "0.00#", platform::ZeroSign::Dropped);
            p.ScreenText(c.PlotRight - p.Width(text, f), 30, text, pal::StopLine, f);
        }
    }
};

// The trace of the mean close y of the last ten bars (or its exponential form) under the
// averages.
struct TenBarTrace {
    std::array<std::int16_t, 10> Ring{};
    int Count = 0;
    float Y = 0;

    std::optional<std::int16_t> Next(std::int16_t closeY, bool exponential) {
        Ring[static_cast<std::size_t>(Count % 10)] = closeY;
        ++Count;
        if (Count < 10) return std::nullopt;
        if (!exponential || Count == 10) {
            int sum = 0;
            for (std::int16_t v : Ring)
                sum += v;
            Y = std::nearbyint(static_cast<float>(sum) / 10);
        } else {
            Y = std::nearbyint(static_cast<float>(closeY) * 2 / 11 + Y * (1 - 2.0f / 11));
        }
        return static_cast<std::int16_t>(Y);
    }
};

class BarLoop {
public:
    explicit BarLoop(ChartPainter& p) : m_p(p), m_c(p.chart), m_axis(p) {
        if (p.in.Request.SwingOn && p.in.Request.ChartSlot == 0) m_swing.emplace(p);
    }

    void Run() {
        const auto& bars = m_c.ChartBars();
        double x = m_c.PlotLeft;
        for (int i = 0; i <= m_c.LastBar() && i < static_cast<int>(bars.size()); ++i) {
            const store::ChartBar& bar = bars[static_cast<std::size_t>(i)];
            if (bar.High == 0) {
                // No column drawn; the close y of the bar before stands for it.
                m_c.BarCloseY[static_cast<std::size_t>(i)] =
                    i > 0 ? m_c.BarCloseY[static_cast<std::size_t>(i - 1)] : 0;
            } else {
                DrawOne(i, bar, x);
            }
            x += m_c.BarSpacing;
        }
        if (m_c.Style == 'B' && m_p.in.Defaults.StopLossOn) m_stop.ReadOut(m_p);
    }

private:
    BarYs YsOf(const store::ChartBar& b) const {
        return {m_c.PriceToY(b.High), m_c.PriceToY(b.Open), m_c.PriceToY(b.Low),
                m_c.PriceToY(b.Close)};
    }

    void DrawOne(int i, const store::ChartBar& bar, double x) {
        const BarYs ys = YsOf(bar);
        switch (m_c.Style) {
        case 'B':
            DrawBar(bar, ys, x);
            break;
        case 'C':
            DrawCandle(ys, x);
            break;
        default:
            DrawLinePoint(ys, x);
            break;
        }
        m_prev2 = m_prev;
        m_prev = ys;
        m_c.BarCloseY[static_cast<std::size_t>(i)] = ys.Close;
        DrawVolume(bar, x);
        DrawNote(bar, x);
        DrawTrace(ys, x);
        m_axis.Bar(x, bar.DateText());
        if (m_swing) m_swing->Bar(i, x, {ys.High, ys.Low, ys.Close, bar.High, bar.Low, bar.Close});
    }

    int BarEntry(const store::ChartBar& bar, const BarYs& ys, double x) {
        int entry = pal::Bars;
        if (!m_prev) return entry;
        if (m_p.in.Defaults.StopLossOn) entry = m_stop.Colour(m_p.in.Defaults, bar, ys, *m_prev, x);
        if (!m_p.in.Request.ShowReversals) return entry;
        const BarClass cls = ClassifyBar(ys, &*m_prev, m_prev2 ? &*m_prev2 : nullptr);
        if (cls.PivotOnPrevious && x - m_c.BarSpacing >= m_c.PlotLeft)
            m_p.screen.Line(x - m_c.BarSpacing, m_prev->Low, x - m_c.BarSpacing, m_prev->High,
                            m_p.Col(pal::PivotPoint));
        if (cls.Entry != pal::Bars || cls.PivotOnPrevious) entry = cls.Entry;
        return entry;
    }

    void DrawBar(const store::ChartBar& bar, const BarYs& ys, double x) {
        const int entry = BarEntry(bar, ys, x);
        const platform::Colour col = m_p.Col(entry);
        m_p.Line('H', x, ys.High, x, ys.Low, entry);
        const std::int16_t spacing = m_c.BarSpacing;
        if (spacing > 2) {
            // The paper bar has shorter ticks than the screen bar.
            m_p.screen.Line(x - 3, ys.Open, x, ys.Open, col);
            m_p.stream.Shape('H', x - 1.5, ys.Open, x, ys.Open, col);
            m_p.screen.Line(x, ys.Close, x + 3, ys.Close, col);
            m_p.stream.Shape('H', x, ys.Close, x + 1.5, ys.Close, col);
        } else if (spacing == 2) {
            m_p.screen.Point(x - 1, ys.Open, col);
            m_p.stream.Dot('P', x - 1, ys.Open, col);
            m_p.screen.Point(x + 1, ys.Close, col);
            m_p.stream.Dot('P', x + 1, ys.Close, col);
        }
    }

    void DrawCandle(const BarYs& ys, double x) {
        m_p.Line('H', x, ys.High, x, ys.Low, pal::Bars);
        if (ys.Close > ys.Open) {
            m_p.screen.FilledBox(x - 1, ys.Open, x + 1, ys.Close, m_p.Col(pal::DownCandle));
            m_p.stream.Shape('C', x - 1.5, ys.Open, x + 1.5, ys.Close, m_p.Col(pal::DownCandle));
        } else {
            // Solid on the screen, an outline on paper: the up candle prints hollow.
            m_p.screen.FilledBox(x - 1, ys.Open, x + 1, ys.Close, m_p.Col(pal::Bars));
            m_p.stream.Shape('B', x - 1.5, ys.Open, x + 1.5, ys.Close, m_p.Col(pal::Bars));
        }
    }

    void DrawLinePoint(const BarYs& ys, double x) {
        if (m_prev) m_p.Line('H', m_lineX, m_prev->Close, x, ys.Close, pal::Bars);
        m_lineX = x;
    }

    void DrawVolume(const store::ChartBar& bar, double x) {
        if (!m_c.HasVolume) return;
        if (const auto y = m_c.Volumes.VolumeToY(bar.Volume))
            m_p.Line('H', x, m_c.VolBottom, x, *y, pal::Volume);
    }

    void DrawNote(const store::ChartBar& bar, double x) {
        if (bar.Note == 0 || m_p.in.Request.ChartSlot != 0) return;
        const std::string text =
            platform::PadRight(m_p.in.Notes ? m_p.in.Notes->NoteText(bar.Note) : "", 14);
        m_p.DottedScreen(x, m_c.PlotTop, x, m_c.PlotBottom, pal::Notes);
        m_p.ScreenText(x, m_c.PlotTop + 2, platform::TrimRight(text), pal::Notes, m_p.Font1());
        if (m_p.in.PrintBold) return;
        m_p.stream.Shape('V', x, m_c.PlotTop, x, m_c.PlotBottom, m_p.Col(pal::Notes));
        m_p.stream.Text('T', 8.25, x, m_c.PlotTop + 2, text, m_p.Col(pal::Notes));
    }

    void DrawTrace(const BarYs& ys, double x) {
        const ChartRequest& r = m_p.in.Request;
        if (!(r.AvOne || r.AvTwo)) return;
        if (r.AutoOsc && r.AutoOscCode == "MACD" && m_p.in.Defaults.ClassicMACD) return;
        const auto y = m_trace.Next(ys.Close, m_p.in.Defaults.MAExponential);
        if (!y) return;
        m_p.screen.Point(x, *y, m_p.Col(pal::Trace));
        if (!m_p.in.PrintBold) m_p.stream.Dot('P', x, *y, m_p.Col(pal::Trace));
    }

    ChartPainter& m_p;
    Chart& m_c;
    DateAxis m_axis;
    StopLoss m_stop;
    TenBarTrace m_trace;
    std::optional<SwingChart> m_swing;
    std::optional<BarYs> m_prev, m_prev2;
    double m_lineX = 0;
};

} // namespace

BarClass ClassifyBar(const BarYs& b, const BarYs* prev, const BarYs* prev2) {
    BarClass cls;
    if (!prev) return cls;
    const BarYs& p = *prev;
    if (Outside(b, p) && (b.Close < p.High || b.Close > p.Low)) cls.Entry = pal::KeyReversal;
    if (b.High < p.High && b.Close > p.Close && b.Close < p.Low) cls.Entry = pal::Reversal;
    if (b.High > p.High && b.Low < p.Low) {
        const int m = p.Low - (p.Low - p.High) / 2;
        const int n = b.Low - (b.Low - b.High) / 2;
        if ((p.Close > m && b.Close < n) || (p.Close < m && b.Close > n))
            cls.Entry = pal::HookReversal;
    }
    if ((b.Low < p.High && b.Open < b.Close) || (b.High > p.Low && b.Open > b.Close))
        cls.Entry = pal::OpenCloseReversal;
    if (prev2) {
        const BarYs& q = *prev2;
        const bool peak = p.High < q.High && p.High < b.High && b.Close > p.Low && b.Close > q.Low;
        const bool trough = p.Low > q.Low && p.Low > b.Low && b.Close < p.High && b.Close < q.High;
        if (peak || trough) {
            cls.Entry = pal::Bars;
            cls.PivotOnPrevious = true;
        }
    }
    return cls;
}

void DrawBars(ChartPainter& p) {
    BarLoop loop(p);
    loop.Run();
}

} // namespace kori::chart
