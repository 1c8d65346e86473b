#pragma once
// Test helpers for chart builds: daily price records held in memory, loaded with the daily
// rules of the chart load (no weekly or monthly folding), and a stream reader.
#include "chart/price_source.h"
#include "platform/palette.h"
#include "support/temp_root.h"

#include <algorithm>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace kori::test {

struct DayRecord {
    std::string Date;
    float Open = 0, High = 0, Low = 0, Close = 0;
    std::int32_t Volume = 0;
    std::string AdjDesc; // a non-empty text marks a record with a note
};

class MemorySource : public chart::PriceSource {
public:
    std::vector<DayRecord> Records;
    std::string Name = "BHP.WDT";
    store::SeriesRequest LastLoad;

    std::string FileName() const override { return Name; }
    std::int16_t RecordCount() override { return static_cast<std::int16_t>(Records.size()); }
    std::string DateOf(std::int16_t rec) override { return At(rec).Date; }
    std::string NoteText(std::int16_t rec) override { return At(rec).AdjDesc; }

    platform::Status Load(const store::SeriesRequest& req, store::ChartSeries& s) override {
        LastLoad = req;
        s = store::ChartSeries{};
        std::int64_t sum = 0;
        int counted = 0;
        auto& r = s.Results;
        for (int rec = req.FirstRecord; rec <= req.LastRecord; ++rec) {
            const DayRecord& d = At(static_cast<std::int16_t>(rec));
            store::ChartBar b;
            b.SetDate(d.Date);
            b.Open = d.Open;
            b.High = d.High;
            b.Low = d.Low;
            b.Close = d.Close;
            b.Volume = d.Volume;
            if (!d.AdjDesc.empty()) b.Note = static_cast<std::int16_t>(rec);
            s.ChartBars.push_back(b);
            r.HighestPrice = std::max(r.HighestPrice, d.High == 0 ? d.Close : d.High);
            const float low = d.Low == 0 ? d.Close : d.Low;
            if (low != 0) r.LowestPrice = std::min(r.LowestPrice, low);
            if (req.WantVolume && d.Volume != 0) {
                ++counted;
                sum += d.Volume;
                r.LowestVolume = std::min(r.LowestVolume, d.Volume);
                r.HighestVolume = std::max(r.HighestVolume, d.Volume);
            }
        }
        s.LastBar = static_cast<std::int16_t>(req.LastRecord - req.FirstRecord);
        SettleVolumes(req.WantVolume, counted, sum, r);
        return platform::Status::Ok();
    }

private:
    const DayRecord& At(std::int16_t rec) const {
        return Records[static_cast<std::size_t>(rec - 1)];
    }

    static void SettleVolumes(bool wanted, int counted, std::int64_t sum, store::LoadResults& r) {
        if (!wanted) {
            r.HighestVolume = r.LowestVolume = 0;
            r.VolumesPresent = false;
        } else if (counted == 0) {
            r.VolumesPresent = false;
        } else if (r.HighestVolume == r.LowestVolume) {
            r.LowestVolume = 1;
            r.HighestVolume *= 3;
            r.AverageVolume = r.HighestVolume;
            r.VolumesPresent = true;
        } else {
            r.AverageVolume = static_cast<std::int32_t>(sum / counted);
            r.VolumesPresent = true;
        }
    }
};

// Palette whose colour values are the entry numbers, so stream lines name their entries.
inline platform::Palette NumberedPalette() {
    platform::Palette p{};
    for (std::size_t i = 0; i < p.size(); ++i)
        p[i] = static_cast<platform::Colour>(i);
    return p;
}

inline std::vector<std::string> ReadLines(const std::filesystem::path& path) {
    std::ifstream in(path, std::ios::binary);
    std::vector<std::string> lines;
    std::string line;
    while (std::getline(in, line)) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        lines.push_back(line);
    }
    return lines;
}

// True when `run` stands in `lines` as consecutive lines.
inline bool HasRun(const std::vector<std::string>& lines, const std::vector<std::string>& run) {
    if (run.empty() || run.size() > lines.size()) return false;
    for (std::size_t i = 0; i + run.size() <= lines.size(); ++i)
        if (std::equal(run.begin(), run.end(), lines.begin() + static_cast<std::ptrdiff_t>(i)))
            return true;
    return false;
}

inline std::vector<std::string> Starting(const std::vector<std::string>& lines,
                                         std::string_view prefix) {
    std::vector<std::string> out;
    for (const auto& l : lines)
        if (l.rfind(prefix, 0) == 0) out.push_back(l);
    return out;
}

} // namespace kori::test
