#pragma once
// Average True Range ("ATR", in currency, averaged with a P + 1 divisor), Volatility ("VTY",
// the bar's range as a per cent of its close, with a plain mean) and On-Balance Volume ("OBV").
#include "osc/osc_series.h"
#include "platform/rounding.h"

namespace kori::osc {

using platform::Money;

struct AtrResult {
    Series<Money> tr;  // from bar 1; none from a bar whose range currency cannot hold
    Series<Money> atr; // stored bars: from P + 1 while the ATR before was not 0
    // Every non-zero true range alike: the routine's scale is 0 and it stops before averaging.
    bool NoSpread = false;
};
struct VolatilityResult {
    Series<float> figure; // per cent; a later bar without a positive figure reads 1
    Series<float> mean;   // from the P-th bar with a figure
};
struct ObvResult {
    Series<std::int32_t> obv;  // bars where neither this close nor the one before is 0
    bool NoVolumeData = false; // "No Volume Data": the panel stops; the stored 100000s stand
};

AtrResult ComputeATR(const store::ChartSeries& series, std::int16_t period);
VolatilityResult ComputeVolatility(const store::ChartSeries& series, std::int16_t period);
ObvResult ComputeOBV(const store::ChartSeries& series);

} // namespace kori::osc
