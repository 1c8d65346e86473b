#include "chart/draw_date_axis.h"

#include "platform/text.h"

#include <cmath>

namespace kori::chart {

void DateAxis::Bar(double x, std::string_view date) {
    if (m_p.in.Request.ChartSlot > 1) return;
    // A no-trade bar has no date and marks nothing.
    if (date.size() < 8 || platform::Trim(date).empty()) return;
    const int month = static_cast<int>(platform::Val(date.substr(4, 2)));
    const std::string year(date.substr(0, 4));
    const long col8 = std::lround(std::nearbyint(x / 8));
    if (!m_started) {
        m_started = true;
        m_lastCol8 = col8;
        m_lastMonth = month;
        m_lastYear = year;
        return;
    }
    const bool daily = m_p.in.Request.ChartPeriod == 'A';
    if (daily && month == m_lastMonth) return;
    const bool yearChanged = year != m_lastYear;
    m_lastMonth = month;
    m_lastYear = year;
    if (col8 - m_lastCol8 < 4 && !yearChanged) return;
    m_lastCol8 = col8;
    Tick(x, yearChanged, date, month);
}

void DateAxis::Tick(double x, bool yearChanged, std::string_view date, int month) {
    const Chart& c = m_p.chart;
    const ChartRequest& r = m_p.in.Request;
    const bool daily = r.ChartPeriod == 'A';
    if (daily || yearChanged || c.Style == 'P' || r.DateGrid)
        m_p.Line('L', x, c.VolBottom, x, c.VolBottom + 5, pal::Labels);
    std::string label;
    if (yearChanged) {
        if (daily && x > 4) {
            // Dotted on the screen, dashed on paper.
            m_p.DottedScreen(x, c.PlotTop, x, c.VolBottom + 2, pal::YearLine);
            m_p.stream.Shape('D', x, c.PlotTop, x, c.VolBottom + 2, m_p.Col(pal::Labels));
        }
        label = std::string(date.substr(2, 2));
    } else if (daily && month >= 1 && month <= 12) {
        label = std::string(1, "JFMAMJJASOND"[month - 1]);
    }
    if (label.empty()) return;
    constexpr double kGap = 2;
    if (x < m_labelEnd + kGap) return;
    m_labelEnd = x + m_p.Width(label, m_p.Font1());
    m_p.ScreenText(x, c.VolBottom + 2, label, pal::Labels, m_p.Font1());
    m_p.StreamT(x, c.VolBottom + 2, label, pal::Labels);
}

} // namespace kori::chart
