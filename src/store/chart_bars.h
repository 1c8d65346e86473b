#pragma once
// The bars of the chart as a load leaves them: daily records, or weekly and monthly bars
// folded from them. Every drawing routine, overlay and oscillator reads these.
#include "platform/issues.h"

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

struct ChartBar {
    std::array<char, 8> Date{' ', ' ', ' ', ' ',
                             ' ', ' ', ' ', ' '}; // "yyyymmdd"; blank on a no-trade bar
    float Open = 0;
    float High = 0;
    float Low = 0;
    float Close = 0;
    std::int32_t Volume = 0;
    std::int16_t Note = 0; // record number of a price record with an adjustment factor, else 0

    std::string_view DateText() const { return {Date.data(), Date.size()}; }
    void SetDate(std::string_view yyyymmdd) {
        Date.fill(' ');
        for (std::size_t i = 0; i < Date.size() && i < yyyymmdd.size(); ++i)
            Date[i] = yyyymmdd[i];
    }
};

// Results of a load, read by the chart engine and the oscillators.
struct LoadResults {
    float HighestPrice = -100000.0f;
    float LowestPrice = 100000.0f;
    std::int32_t HighestVolume = 0;
    std::int32_t LowestVolume = 100000000;
    std::int32_t AverageVolume = 0;
    bool VolumesPresent = false;
};

// ChartBars with LastBar (bar count - 1; -1 when nothing was loaded).
struct ChartSeries {
    std::vector<ChartBar> ChartBars;
    std::int16_t LastBar = -1;
    LoadResults Results;
    // Records the load could not take as they stood (a price that is not a finite number).
    platform::Issues Issues;
};

} // namespace kori::store
