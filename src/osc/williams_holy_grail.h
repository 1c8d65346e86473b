#pragma once
// Williams %R ("WMS"): the bar's close within the range of the last P bars; the panel smooths
// its positions, the figure here is the bar's own %R. Jones Holy Grail ("JHG"): the close less
// its 3-bar mean, its P-bar mean, and the P-bar mean of that.
#include "osc/osc_series.h"

namespace kori::osc {

struct WilliamsResult {
    Series<float> r; // from bar P; a window without range (or a high of 0) has none
};
struct HolyGrailResult {
    Series<float> col0; // close - 3-bar mean (the first two bars keep their close)
    Series<float> col1; // P-bar mean of col0, from bar P - 1
    Series<float> col2; // P-bar mean of col1, from bar 2P - 2
};

WilliamsResult ComputeWilliams(const store::ChartSeries& series, std::int16_t period,
                               std::int16_t recordType);
// Nothing unless LastBar is above P.
HolyGrailResult ComputeHolyGrail(const store::ChartSeries& series, std::int16_t period);

} // namespace kori::osc
