#pragma once
// One chart build on a RecordingSurface 400 x 1000 with a fixed manual scale, so that the
// numbers of a stream can be worked out by hand:
//   PlotLeft 5, PlotRight 396 - 42 = 354, PlotTop 130 (13%), PlotBottom 950 (95%);
//   scale 10 to 92 over 820 units: y = 950 - (price - 10) x 10.
// Palette entries are their own colour values, fonts 1 and 2 are 8 points.
#include "chart/build_chart.h"
#include "chart_test_source.h"
#include "platform/dialogs.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

namespace kori::test {

struct ChartRig {
    TempRoot root;
    platform::Palette palette = NumberedPalette();
    platform::ChartFonts fonts;
    chart::ChartDefaults defaults;
    chart::ChartName name;
    chart::ChartRequest request;
    platform::ScriptedDialogs dialogs;
    platform::RecordingSurface surface{400, 1000};
    MemorySource source;
    chart::Chart chart;
    std::filesystem::path streamPath = root.path() / "TCht.Tmp";
    bool printBold = false;
    std::int32_t volumeDivisor = 1;
    chart::PrinterPage* page = nullptr;

    ChartRig() {
        defaults.AutoScale = false;
        name.Code = "BHP";
        name.Name = "BHP GROUP";
        name.Base = 10;
        name.Top = 92;
        request.ShowVolume = false;
        request.BarSpacing = 10;
    }

    // A bar whose prices are given as y on the rig's scale is easier to reason about.
    static float P(int y) { return 10 + static_cast<float>(950 - y) / 10; }

    void Add(std::string date, float open, float high, float low, float close,
             std::int32_t volume = 0, std::string note = {}) {
        source.Records.push_back(
            {std::move(date), open, high, low, close, volume, std::move(note)});
    }

    platform::Status Build() {
        const chart::ChartBuild b{request, defaults,   name,      palette,       fonts,
                                  dialogs, streamPath, printBold, volumeDivisor, page};
        return chart::BuildChart(chart, b, source, surface);
    }
    std::vector<std::string> Lines() const { return ReadLines(streamPath); }
    const std::vector<std::string>& Calls() const { return surface.calls(); }
};

} // namespace kori::test
