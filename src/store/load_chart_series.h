#pragma once
// LoadChartSeries: daily records of a price file into chart bars, daily, weekly or monthly.
#include "platform/status.h"
#include "store/chart_bars.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace kori::store {

struct SeriesRequest {
    std::int16_t FirstRecord = 1;
    std::int16_t LastRecord = 0;
    char Period = 'A'; // 'A' daily, 'W' weekly, 'M' monthly
    bool WantVolume = true;
    std::int16_t RecordType = 4;
};

// Sets the records first..last of a file of `count` records into a request; `last` 0 means
// the last record. Numbers are checked before they are narrowed to the 16 bits of a record
// number: a range outside 1..count is refused with a message naming the file.
platform::Status SetRecordRange(SeriesRequest& request, long long first, long long last, int count,
                                std::string_view fileName);

// Folds the records first..last held in `bytes` (50 bytes each, record FirstRecord first).
// `fileName` names the file in an error about a malformed date.
platform::Status LoadChartSeriesFromBytes(std::string_view bytes, const SeriesRequest& request,
                                          std::string_view fileName, ChartSeries& series);

// Opens the price file, reads the window in one read and folds it.
platform::Status LoadChartSeries(const std::string& priceFilePath, const SeriesRequest& request,
                                 ChartSeries& series);

} // namespace kori::store
