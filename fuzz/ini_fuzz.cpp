// Kori.ini: every reader of its sections over any file.
#include "chart/chart_defaults.h"
#include "chart/chart_request.h"
#include "chart/print_chart.h"
#include "fuzz_input.h"
#include "osc/osc_settings.h"
#include "platform/ini_file.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kori;
    const platform::IniFile ini(fuzz::InputFile("Kori.ini", data, size));
    (void)chart::LoadChartDefaults(ini);
    chart::ChartRequest r;
    chart::LoadChartRequestSettings(ini, r);
    (void)chart::LoadPrintSettings(ini);
    (void)osc::ReadOscSettings(ini);
    (void)ini.Section("Paths");
    (void)ini.ReadRaw("OscDef", "RsiP");
    return 0;
}
