// The other text and small files: price targets, the printer answers, the data paths list and
// trendline files.
#include "app/colour_table.h"
#include "app/folder_config.h"
#include "chart/targets.h"
#include "fuzz_input.h"
#include "store/trendline_file.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kori;
    const auto path = fuzz::InputFile("any.txt", data, size);
    (void)chart::ReadTargetPrices(path, "KRM");
    (void)app::ReadPrinterFile(path.string());
    (void)app::ReadChartPathsFile(path.string());
    (void)store::TrendlineFile::ReadAll(path);
    return 0;
}
