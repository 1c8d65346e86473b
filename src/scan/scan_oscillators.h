#pragma once
// The oscillators of the price-and-oscillator scan, worked by the scan itself on the last bars
// of a file: each gives the position of the last bar (`Cur`), of the bar before (`Prev`) and of
// its two reference lines on a notional panel whose bottom is position 141, with y growing
// downward as on a chart, so that one table of indications serves all five.
#include "scan/scan_common.h"

#include <array>
#include <cstdint>
#include <optional>
#include <string_view>

namespace kori::scan {

struct OscPositions {
    int Cur = 0, Prev = 0, OBLine = 0, OSLine = 0;
};

enum class OscOutcome {
    Positions, // the positions were found
    None,      // the oscillator gives no indication on this file
    NeedMore,  // the bars held do not reach back far enough: read the whole file
};

struct OscReading {
    OscOutcome Outcome = OscOutcome::None;
    OscPositions Positions;
};

enum class ScanOsc { Stochastic, Williams, ROC, MM, RSI };
inline constexpr std::array<ScanOsc, 5> kScanOscs = {ScanOsc::Stochastic, ScanOsc::Williams,
                                                     ScanOsc::ROC, ScanOsc::MM, ScanOsc::RSI};
// Column names: "STO", "WMS", "ROC", "MM", "RSI".
std::string_view OscColumn(ScanOsc osc);

// Bars the oscillator needs at the end of the file for `period` (0: the whole file).
int OscBarsWanted(ScanOsc osc, int period);

// `period` is the setting as read: StochK, WmsA, RocP (for both ROC and MM) or RsiP (0 there
// means 21). `closeOnly`: a record type without bars (1 to 3) takes closes for the extremes.
OscReading ReadOscillator(ScanOsc osc, const DailyTail& bars, int period, bool closeOnly);

// The indication of a pair of positions, or empty.
std::string_view Indication(const OscPositions& p);

// Which of the four indication boxes are ticked.
struct IndicationChoice {
    bool OB = false, OS = false, CutOB = false, CutOS = false;
    bool Any() const { return OB || OS || CutOB || CutOS; }
};
// An indication is kept only when a box that asks for it is ticked.
bool Kept(std::string_view indication, const IndicationChoice& choice);

} // namespace kori::scan
