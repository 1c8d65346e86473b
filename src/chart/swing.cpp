#include "chart/swing.h"

#include "platform/text.h"

#include <cmath>

namespace kori::chart {

namespace {
// Prices are 32-bit floats: a move of exactly V cents must not miss by the last bit.
constexpr double kPriceSlack = 1e-6;
} // namespace

void SwingSwitch::Set(ChartRequest& r, bool on) {
    if (on == r.SwingOn) return;
    r.SwingOn = on;
    if (on) {
        m_savedSpacing = r.BarSpacing;
        r.ChartStyle = 'B';
        if (r.BarSpacing < 3) r.BarSpacing = 3;
    } else if (m_savedSpacing > 0) {
        r.BarSpacing = m_savedSpacing;
    }
}

float AverageSwing(const std::vector<store::ChartBar>& bars, std::int16_t recordType) {
    int dir = 0;
    const store::ChartBar* first = nullptr;
    float lastHigh = 0, lastLow = 0, extreme = 0, lastTurn = 0;
    double total = 0;
    int count = 0;
    auto turn = [&](float at) {
        if (at != lastTurn) {
            total += std::fabs(static_cast<double>(at) - lastTurn);
            ++count;
        }
        lastTurn = at;
    };
    for (const store::ChartBar& b : bars) {
        if (b.High == 0 || b.Low == 0 || b.Open == 0) continue;
        if (!first) {
            first = &b;
            continue;
        }
        if (dir == 0) {
            if (b.High > first->High && b.Low > first->Low) {
                dir = 1;
                lastTurn = extreme = b.High;
            } else if (b.High < first->High && b.Low < first->Low) {
                dir = 2;
                lastTurn = extreme = b.Low;
            } else {
                continue;
            }
        } else if (dir == 1) {
            if (b.High > lastHigh) {
                extreme = b.High;
            } else if (b.High < lastHigh && b.Low < lastLow) {
                turn(extreme);
                dir = 2;
                extreme = b.Low;
            }
        } else {
            if (b.Low < lastLow) {
                extreme = b.Low;
            } else if (b.High > lastHigh && b.Low > lastLow) {
                turn(extreme);
                dir = 1;
                extreme = b.High;
            }
        }
        lastHigh = b.High;
        lastLow = b.Low;
    }
    if (count == 0) return 5;
    const double mean = total / count;
    if (recordType == 5) return static_cast<float>(mean);
    if (recordType == 4) return static_cast<float>(mean * 100);
    return 5;
}

std::string SwingTitleText(char chartPeriod, SwingMethod method, float value) {
    std::string lead = chartPeriod == 'W'   ? "Weekly Swing "
                       : chartPeriod == 'M' ? "Monthly Swing "
                                            : "Daily Swing ";
    const std::string v = platform::FloatText(value);
    if (method == SwingMethod::XDay) return lead + v + " - DAY";
    if (method == SwingMethod::XPoint) return lead + v + " - POINT";
    if (method == SwingMethod::XPointAuto) return lead + v + " - Point(Auto)";
    return lead + " -  Standard";
}

SwingChart::SwingChart(ChartPainter& p) : m_p(p) {
    const ChartRequest& r = p.in.Request;
    m_method = r.SwingMethod;
    m_value = SwingValueOf(m_method, r.SwingValue);
    m_panel = p.chart.SidePanelLeft > 0;
}

void SwingChart::Title() {
    if (m_method == SwingMethod::XPointAuto)
        m_value = std::floor(
            std::floor(AverageSwing(m_p.chart.ChartBars(), m_p.in.Name.RecordType)) * 0.75f);
    const std::string text = SwingTitleText(m_p.in.Request.ChartPeriod, m_method, m_value);
    const Chart& c = m_p.chart;
    m_p.ScreenText(m_swingX, c.PlotTop + 4, text, pal::SwingTitle, m_p.Font1());
    m_p.stream.Text('T', m_p.in.Fonts.Size1, m_swingX, c.PlotTop + 12, text,
                    m_p.Col(pal::SwingTitle));
}

void SwingChart::Follow(const SwingBar& b) {
    m_highY = b.HighY;
    m_lowY = b.LowY;
    m_closeY = b.CloseY;
}

void SwingChart::Carry(std::int16_t y) {
    m_legY = y;
    if (!m_drawing) return;
    const int entry = m_dir == 2 ? pal::SwingDown : pal::SwingUp;
    const std::int16_t from = m_legDrawn ? m_drawnY : m_turnY;
    if (from != y || !m_legDrawn) m_p.Line('H', m_swingX, from, m_swingX, y, entry);
    m_drawnY = y;
    m_legDrawn = true;
}

void SwingChart::Turn(int dir, std::int16_t y) {
    // The leg that ends here is drawn to its end first.
    if (m_drawing && !m_legDrawn && (m_dir == 1 || m_dir == 2)) Carry(m_legY);
    const double x = m_panel ? m_swingX + (m_drawing ? m_p.chart.BarSpacing : 0) : m_barX;
    const int entry = dir == 2 ? pal::SwingDown : pal::SwingUp;
    if (m_drawing && x != m_swingX) m_p.Line('H', m_swingX, m_legY, x, m_legY, entry);
    m_swingX = x;
    m_turnY = m_legY;
    m_dir = dir;
    m_legDrawn = false;
    ++m_legs;
    Carry(y);
}

void SwingChart::Start(const SwingBar& b) {
    if (b.HighY < m_highY && b.LowY < m_lowY) {
        m_legY = m_turnY = m_lowY;
        m_dir = 1;
        m_lastPrice = b.High;
        Follow(b);
        Carry(b.HighY);
    } else if (b.HighY > m_highY && b.LowY > m_lowY) {
        m_legY = m_turnY = m_highY;
        m_dir = 2;
        m_lastPrice = b.Low;
        Follow(b);
        Carry(b.LowY);
    }
}

void SwingChart::Norm(const SwingBar& b) {
    const bool higherHigh = b.HighY<m_highY, lowerHigh = b.HighY> m_highY;
    const bool higherLow = b.LowY<m_lowY, lowerLow = b.LowY> m_lowY;
    switch (m_dir) {
    case 1:
        if (higherHigh && !lowerLow) {
            Carry(b.HighY);
            Follow(b);
        } else if (lowerHigh && lowerLow) {
            Turn(2, b.LowY);
            Follow(b);
        } else if (higherHigh && lowerLow) {
            m_dir = 4;
            Follow(b);
        }
        break;
    case 2:
        if (lowerLow && !higherHigh) {
            Carry(b.LowY);
            Follow(b);
        } else if (higherHigh && higherLow) {
            Turn(1, b.HighY);
            Follow(b);
        } else if (higherHigh && lowerLow) {
            m_dir = 5;
            Follow(b);
        }
        break;
    case 4:
    case 5:
        // Only a bar that leaves the outside bar's range on both ends decides.
        if (lowerHigh && lowerLow) {
            const bool wasUp = m_dir == 4;
            m_dir = wasUp ? 1 : 2;
            if (wasUp) {
                Carry(m_highY); // the outside bar's high is the last turn
                Turn(2, b.LowY);
            } else {
                Carry(b.LowY);
            }
            Follow(b);
        } else if (higherHigh && higherLow) {
            const bool wasDown = m_dir == 5;
            m_dir = wasDown ? 2 : 1;
            if (wasDown) {
                Carry(m_lowY);
                Turn(1, b.HighY);
            } else {
                Carry(b.HighY);
            }
            Follow(b);
        }
        break;
    default:
        break;
    }
}

void SwingChart::XDay(const SwingBar& b) {
    const int n = static_cast<int>(m_value);
    if (m_dir == 1) {
        if (b.HighY < m_highY) {
            Carry(b.HighY);
            m_days = 0;
            Follow(b);
        } else if (b.LowY > m_lowY) {
            if (m_days >= n - 1) {
                Turn(2, b.LowY);
                m_days = 0;
                Follow(b);
            } else {
                ++m_days;
            }
        }
    } else if (m_dir == 2) {
        if (b.LowY > m_lowY) {
            Carry(b.LowY);
            m_days = 0;
            Follow(b);
        } else if (b.HighY < m_highY) {
            if (m_days >= n - 1) {
                Turn(1, b.HighY);
                m_days = 0;
                Follow(b);
            } else {
                ++m_days;
            }
        }
    }
}

void SwingChart::XPoint(const SwingBar& b) {
    const double unit = m_p.in.Name.RecordType == 5 ? 1 : 100;
    const double needed = static_cast<double>(m_value) / unit;
    if (m_dir == 1) {
        if (b.HighY < m_highY) {
            Carry(b.HighY);
            m_lastPrice = b.High;
            Follow(b);
        } else if (static_cast<double>(m_lastPrice) - b.Low >= needed - kPriceSlack &&
                   b.LowY > m_lowY) {
            Turn(2, b.LowY);
            m_lastPrice = b.Low;
            Follow(b);
        }
    } else if (m_dir == 2) {
        if (b.LowY > m_lowY) {
            Carry(b.LowY);
            m_lastPrice = b.Low;
            Follow(b);
        } else if (static_cast<double>(b.High) - m_lastPrice >= needed - kPriceSlack &&
                   b.HighY < m_highY) {
            Turn(1, b.HighY);
            m_lastPrice = b.High;
            Follow(b);
        }
    }
}

void SwingChart::Bar(int index, double barX, const SwingBar& bar) {
    m_barX = barX;
    if (index == 0 || m_seen == 0) {
        // A new chart: the state starts afresh and the title goes first.
        m_dir = 0;
        m_days = 0;
        m_legs = 0;
        m_legDrawn = false;
        m_drawing = false;
        m_swingX = m_panel ? m_p.chart.SidePanelLeft : barX;
        Title();
        Follow(bar);
        m_lastPrice = bar.Close;
        m_seen = 1;
        return;
    }
    // Legs are drawn only once three bars have passed; those three seed the state.
    m_drawing = ++m_seen > 3;
    if (m_dir == 0) {
        Start(bar);
        return;
    }
    if (m_method == SwingMethod::Norm)
        Norm(bar);
    else if (m_method == SwingMethod::XDay)
        XDay(bar);
    else
        XPoint(bar);
}

} // namespace kori::chart
