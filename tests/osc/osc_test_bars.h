#pragma once
// Small hand-made bar series for the oscillator tests.
#include "store/chart_bars.h"

#include <array>
#include <cstdint>
#include <initializer_list>

namespace kori::test {

// Bars whose open, high, low and close are all the given close.
inline store::ChartSeries CloseBars(std::initializer_list<float> closes) {
    store::ChartSeries s;
    for (float c : closes) {
        store::ChartBar b;
        b.Open = b.High = b.Low = b.Close = c;
        s.ChartBars.push_back(b);
    }
    s.LastBar = static_cast<std::int16_t>(s.ChartBars.size() - 1);
    return s;
}

// Bars of high, low, close (open = close), with an optional volume.
inline store::ChartSeries HlcBars(std::initializer_list<std::array<float, 3>> bars,
                                  std::initializer_list<std::int32_t> volumes = {}) {
    store::ChartSeries s;
    for (const auto& hlc : bars) {
        store::ChartBar b;
        b.High = hlc[0];
        b.Low = hlc[1];
        b.Open = b.Close = hlc[2];
        s.ChartBars.push_back(b);
    }
    std::size_t i = 0;
    for (std::int32_t v : volumes)
        s.ChartBars[i++].Volume = v;
    s.LastBar = static_cast<std::int16_t>(s.ChartBars.size() - 1);
    return s;
}

} // namespace kori::test
