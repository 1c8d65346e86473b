#pragma once
// What the builder needs of a security's price file: its length, the dates (for a finish
// date), the load of a window into chart bars, and the text of a note record.
#include "platform/status.h"
#include "store/chart_bars.h"
#include "store/load_chart_series.h"

#include <cstdint>
#include <string>

namespace kori::chart {

class PriceSource {
public:
    virtual ~PriceSource() = default;
    // The file as the user knows it, for "No Data for ".
    virtual std::string FileName() const = 0;
    virtual std::int16_t RecordCount() = 0;
    virtual std::string DateOf(std::int16_t record) = 0;
    // The 14-character adjustment text of a record that carries a note.
    virtual std::string NoteText(std::int16_t record) = 0;
    virtual platform::Status Load(const store::SeriesRequest& request,
                                  store::ChartSeries& series) = 0;
};

} // namespace kori::chart
