// Price records: every record decoded, and the series the chart loads folded at each period.
#include "fuzz_input.h"
#include "store/load_chart_series.h"
#include "store/price_file.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kori;
    if (size < 1) return 0;
    // The first byte picks the request; the rest is the file.
    const std::uint8_t pick = data[0];
    const auto bytes = fuzz::Bytes(data + 1, size - 1);
    const std::size_t records = bytes.size() / store::PriceRecord::kSize;
    for (std::size_t i = 0; i < records; ++i)
        (void)store::PriceRecord::Decode(bytes.data() + i * store::PriceRecord::kSize);
    if (records < 1 || records > 32767) return 0;
    store::SeriesRequest q;
    q.FirstRecord = static_cast<std::int16_t>(1 + (pick >> 4) % records);
    q.LastRecord = static_cast<std::int16_t>(records);
    q.Period = "AWM"[pick % 3];
    q.WantVolume = (pick & 4) != 0;
    q.RecordType = static_cast<std::int16_t>(pick & 8 ? 3 : 4);
    const auto window =
        bytes.substr((static_cast<std::size_t>(q.FirstRecord) - 1) * store::PriceRecord::kSize);
    store::ChartSeries series;
    (void)store::LoadChartSeriesFromBytes(window, q, "FUZZ.WDT", series);
    const auto path = fuzz::InputFile("FUZZ.WDT", data + 1, size - 1);
    store::ChartSeries again;
    (void)store::LoadChartSeries(path.string(), q, again);
    return 0;
}
