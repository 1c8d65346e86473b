#pragma once
// The date axis under the chart (`DrawDateTick`): ticks every fourth 8-unit column at most,
// month letters on daily charts, two-digit years and, on daily charts, year lines. A label
// that would print over the label before it is left out (its tick stays): a year forces a tick
// however close the last one, and a point-and-figure column can hold many months.
#include "chart/draw_context.h"

#include <string>
#include <string_view>

namespace kori::chart {

class DateAxis {
public:
    explicit DateAxis(ChartPainter& p) : m_p(p) {}
    // Called for every bar drawn, with its x and "yyyymmdd" date.
    void Bar(double x, std::string_view date);

private:
    void Tick(double x, bool yearChanged, std::string_view date, int month);

    ChartPainter& m_p;
    bool m_started = false;
    long m_lastCol8 = 0;
    int m_lastMonth = 0;
    std::string m_lastYear;
    double m_labelEnd = -1e9; // right end of the last label printed
};

} // namespace kori::chart
