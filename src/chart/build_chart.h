#pragma once
// `BuildChart`: a chart request and a price file into a finished chart on a surface, with the
// stream written as it draws. First half: geometry, window of records, load, scale. Second
// half: DrawLoadedChart. A split chart builds its lower half straight after the upper one.
#include "chart/chart.h"
#include "chart/chart_defaults.h"
#include "chart/chart_request.h"
#include "chart/price_source.h"
#include "platform/dialogs.h"
#include "platform/palette.h"
#include "platform/status.h"
#include "platform/surface.h"

#include <filesystem>
#include <functional>

namespace kori::chart {

// The printer origin that centres a chart on paper, worked out once per run at the end of
// the first build that has a printer to ask.
struct PrinterPage {
    bool Known = false;
    double TwipsPerPixelX = 15, TwipsPerPixelY = 15;
    double Width = 0, Height = 0; // printable size in printer units
    double SecondPanelHeight = 0; // height of the oscillator panel when it shows
    std::int32_t PageLeft = 0, PageTop = 0;
};

// The lower half of a split: its own security and period, built on the same area and into the
// same stream straight after the upper half. Without it the lower half repeats the upper.
struct SplitLowerHalf {
    const ChartName* Name = nullptr;
    PriceSource* Source = nullptr;
    char ChartPeriod = 'A';
};

struct ChartBuild {
    const ChartRequest& Request; // read only: a split's halves work on their own copies
    const ChartDefaults& Defaults;
    const ChartName& Name;
    const platform::Palette& Palette;
    const platform::ChartFonts& Fonts;
    platform::Dialogs& Dialogs;
    std::filesystem::path StreamPath; // TCht.Tmp in the temporary folder
    bool PrintBold = false;
    std::int32_t VolumeDivisor = 1;
    PrinterPage* Page = nullptr;
    // Overlays, trendlines and target lines go on after the trailing labels, into the same
    // stream while it is still open. The request is the one of the half in hand.
    std::function<void(Chart&, const ChartRequest&, platform::Surface&)> DrawOverlays;
    const SplitLowerHalf* Lower = nullptr; // read only while SplitMode is set
};

platform::Status BuildChart(Chart& chart, const ChartBuild& build, PriceSource& source,
                            platform::Surface& surface);

// The first build of a run fills the page origin; later builds leave it.
void WorkOutPrinterMargins(PrinterPage& page, double areaWidth, double areaHeight,
                           float printScale);

} // namespace kori::chart
