#include "chart/file_price_source.h"

#include "store/load_chart_series.h"
#include "store/price_file.h"

namespace kori::chart {

FilePriceSource::FilePriceSource(std::filesystem::path path) : m_path(std::move(path)) {}

platform::Status FilePriceSource::Open() {
    store::PriceFile file(m_path);
    m_count = 0;
    m_bytes.clear();
    if (auto s = file.Open(); !s) return s;
    m_path = file.path();
    if (auto s = file.ReadRange(1, file.Count(), m_bytes); !s) return s;
    m_count = file.Count();
    return platform::Status::Ok();
}

std::string FilePriceSource::FileName() const {
    return m_path.filename().string();
}

const char* FilePriceSource::Record(std::int16_t record) const {
    if (record < 1 || record > m_count) return nullptr;
    return m_bytes.data() + static_cast<std::size_t>(record - 1) * store::PriceRecord::kSize;
}

std::string FilePriceSource::DateOf(std::int16_t record) {
    const char* p = Record(record);
    return p ? std::string(p, 8) : std::string();
}

std::string FilePriceSource::NoteText(std::int16_t record) {
    const char* p = Record(record);
    return p ? std::string(p + 32, 14) : std::string();
}

platform::Status FilePriceSource::Load(const store::SeriesRequest& r, store::ChartSeries& series) {
    const char* first = Record(r.FirstRecord);
    if (!first || !Record(r.LastRecord) || r.LastRecord < r.FirstRecord)
        return platform::Status::Error("Records " + std::to_string(r.FirstRecord) + " to " +
                                       std::to_string(r.LastRecord) + " are not in " + FileName());
    const std::size_t size =
        static_cast<std::size_t>(r.LastRecord - r.FirstRecord + 1) * store::PriceRecord::kSize;
    return store::LoadChartSeriesFromBytes(std::string_view(first, size), r, FileName(), series);
}

} // namespace kori::chart
