#pragma once
// The builder's view of a price file on disk: the whole file is read once and every later
// question (count, dates, notes, loads) is answered from memory.
#include "chart/price_source.h"

#include <filesystem>
#include <string>

namespace kori::chart {

class FilePriceSource : public PriceSource {
public:
    explicit FilePriceSource(std::filesystem::path path);

    // Reads the file; a missing, unreadable or oversized file reads as empty, with the reason
    // kept for the caller.
    platform::Status Open();

    std::string FileName() const override;
    std::int16_t RecordCount() override { return m_count; }
    std::string DateOf(std::int16_t record) override;
    std::string NoteText(std::int16_t record) override;
    platform::Status Load(const store::SeriesRequest& request, store::ChartSeries& series) override;

private:
    const char* Record(std::int16_t record) const;
    std::filesystem::path m_path;
    std::string m_bytes;
    std::int16_t m_count = 0;
};

} // namespace kori::chart
