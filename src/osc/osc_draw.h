#pragma once
// The drawing of the oscillator panels: the dispatch on the identifier, and one routine a
// panel that draws the computed series into the surface and the stream.
#include "chart/chart.h"
#include "osc/osc_panel.h"
#include "osc/osc_settings.h"
#include "platform/surface.h"

#include <string_view>

namespace kori::osc {

enum class OscOutcome {
    Drawn,        // the routine ran (it may have stopped early, as its rules say)
    NotSet,       // its first period is 0: nothing drawn
    NotValid,     // a period out of its range (or negative): message shown, nothing drawn
    OnPriceChart, // "PARA", "PARAV": the overlays draw them
    DailyOnly,    // "RMO" on a weekly or monthly chart: message shown, panel not wanted
    Unknown,      // no such identifier
    Failed,       // a run-time failure, shown as the chart shows it
};

// The dispatcher, the one entry point of the chart window and the CLI: `chart` is the price
// chart just built (its bars, BarSpacing, PlotRight, price map and stream), `panel` the
// surface of the oscillator panel. "R/F" draws ROC, then FX over it. Making the panel show
// and redrawing the price chart short beforehand is the window's part.
OscOutcome ShowOscillator(chart::Chart& chart, std::string_view oscName, char chartPeriod,
                          const OscDef& def, const OscDrawInputs& in, platform::Surface& panel);

// The routines, each on its own (for the benchmarks and tests). `secondOsc`: drawn over the
// panel of the first routine of a pair.
void OscRSI(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s);
void OscStochFX(chart::Chart& c, std::string_view oscName, const OscDef& d, char period,
                const OscDrawInputs& in, platform::Surface& s, bool secondOsc);
void OscROC(chart::Chart& c, std::string_view oscName, const OscDef& d, char period,
            const OscDrawInputs& in, platform::Surface& s);
void OscMomentum(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                 platform::Surface& s);
void OscMACD(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
             platform::Surface& s);
void OscCoppock(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                platform::Surface& s);
void OscElderRay(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                 platform::Surface& s);
void OscATR(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s);
void OscVolatility(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                   platform::Surface& s);
void OscOBV(chart::Chart& c, const OscDrawInputs& in, platform::Surface& s, bool secondOsc);
void OscDirectional(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                    platform::Surface& s);
void OscWilliams(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                 platform::Surface& s);
void OscHolyGrail(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
                  platform::Surface& s);
void OscRMO(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s);
void OscRMX(chart::Chart& c, const OscDef& d, char period, const OscDrawInputs& in,
            platform::Surface& s);

} // namespace kori::osc
