#include "store/load_chart_series.h"
#include "store/name_record.h"

#include "store/price_file.h"
#include "store/record_codec.h"

#include <algorithm>
#include <cstring>
#include <limits>

namespace kori::store {

using platform::Status;

namespace {

// The fields of a record the load reads, straight from the buffer.
struct Raw {
    const char* date;
    float open, high, low, close;
    std::int32_t volume;
    float adjFactor;
};

inline Raw Decode(const char* p) {
    Raw r;
    r.date = p;
    std::memcpy(&r.open, p + 8, 4);
    std::memcpy(&r.high, p + 12, 4);
    std::memcpy(&r.low, p + 16, 4);
    std::memcpy(&r.close, p + 20, 4);
    std::memcpy(&r.volume, p + 24, 4);
    std::memcpy(&r.adjFactor, p + 28, 4);
    return r;
}

// A price that is infinite or not a number: exponent bits all set.
inline bool NotFinite(float v) {
    std::uint32_t bits;
    std::memcpy(&bits, &v, sizeof bits);
    return (bits & 0x7f800000u) == 0x7f800000u;
}

// A record with a price that is not a finite number is taken as a no-trade record (close 0),
// and the file and record are reported.
inline void CheckPrices(Raw& r, int recordNumber, std::string_view fileName,
                        platform::Issues& issues) {
    if (!NotFinite(r.open) && !NotFinite(r.high) && !NotFinite(r.low) && !NotFinite(r.close))
        return;
    r.open = r.high = r.low = r.close = 0;
    issues.push_back({platform::Severity::Warning,
                      "Record " + std::to_string(recordNumber) + " of " + std::string(fileName) +
                          " holds a price that is not a number; it is read as a no-trade record",
                      std::string(fileName), recordNumber});
}

inline int Digit(char c) {
    return c >= '0' && c <= '9' ? c - '0' : -1;
}

// Sunday 1 .. Saturday 7, or 0 for text that is not a date.
int WeekdayOf(const char* d) {
    int v[8];
    for (int i = 0; i < 8; ++i)
        if ((v[i] = Digit(d[i])) < 0) return 0;
    int y = v[0] * 1000 + v[1] * 100 + v[2] * 10 + v[3];
    const int m = v[4] * 10 + v[5];
    const int day = v[6] * 10 + v[7];
    if (m < 1 || m > 12 || day < 1 || day > 31 || y < 1) return 0;
    static const int t[] = {0, 3, 2, 5, 0, 3, 5, 1, 4, 6, 2, 4};
    if (m < 3) y -= 1;
    return (y + y / 4 - y / 100 + y / 400 + t[m - 1] + day) % 7 + 1;
}

struct Loader {
    ChartSeries& s;
    const SeriesRequest& req;
    LoadResults& res;
    std::int64_t volumeSum = 0;
    std::int32_t volumeCount = 0;
    std::int32_t lastIndex = -1;
    float previousClose = 0;

    // Period accumulators.
    bool pending = false;
    int days = 0;
    int weekday = 0;
    float pOpen = 0, pHigh = 0, pLow = 100000, pClose = 0;
    std::int64_t pVolume = 0;
    std::int16_t pLink = 0;
    const char* pDate = nullptr;
    float lastNonZeroClose = 0;

    void CountVolume(std::int32_t v) {
        if (!req.WantVolume || v == 0) return;
        ++volumeCount;
        res.LowestVolume = std::min(res.LowestVolume, v);
        res.HighestVolume = std::max(res.HighestVolume, v);
        volumeSum += v;
    }

    void Store(const Raw& r, int recordNumber) {
        ChartBar& bar = s.ChartBars[static_cast<std::size_t>(lastIndex)];
        if (r.adjFactor != 0) bar.Note = static_cast<std::int16_t>(recordNumber);
        // Deliberately the bar index against the first record number: a chart that starts at
        // record 200 keeps its zero closes for its first 200 bars.
        if (r.close == 0 && lastIndex > req.FirstRecord) {
            bar.Open = bar.High = bar.Low = bar.Close = previousClose;
            bar.Date.fill(' ');
            bar.Volume = 0;
        } else {
            std::memcpy(bar.Date.data(), r.date, 8);
            bar.Open = r.open;
            bar.High = r.high;
            bar.Low = r.low;
            bar.Close = r.close;
            bar.Volume = r.volume;
        }
        previousClose = bar.Close;
        if (r.high == 0 && !IsCloseOnly(req.RecordType)) bar.Open = bar.High = bar.Low = bar.Close;
        const bool closeOnly = req.RecordType == 3;
        res.HighestPrice =
            std::max(res.HighestPrice, (r.high == 0 || closeOnly) ? r.close : r.high);
        if (r.low == 0 || closeOnly) {
            if (r.close != 0) res.LowestPrice = std::min(res.LowestPrice, r.close);
        } else {
            res.LowestPrice = std::min(res.LowestPrice, r.low);
        }
        CountVolume(r.volume);
    }

    void Accumulate(const Raw& r, int recordNumber) {
        if (weekday == 1 || pOpen == 0) pOpen = r.open;
        pDate = r.date;
        const bool closeOnly = IsCloseOnly(req.RecordType);
        const float hi = closeOnly ? r.close : r.high;
        const float lo = closeOnly ? r.close : r.low;
        if (hi > pHigh) pHigh = hi;
        if (lo != 0 && lo < pLow) pLow = lo;
        pClose = r.close;
        if (pClose != 0) lastNonZeroClose = pClose;
        pVolume += req.Period == 'M' ? r.volume / 100 : r.volume;
        pLink = r.adjFactor != 0 ? static_cast<std::int16_t>(recordNumber) : std::int16_t{0};
        pending = true;
        ++days;
    }

    void Flush(const Raw& current) {
        ChartBar& bar = s.ChartBars[static_cast<std::size_t>(lastIndex)];
        if (pClose != 0) {
            if (req.RecordType == 3) {
                std::memcpy(bar.Date.data(), current.date, 8);
                bar.Open = bar.High = bar.Low = bar.Close = pClose;
            } else {
                std::memcpy(bar.Date.data(), pDate, 8);
                bar.Open = pOpen;
                bar.High = pHigh;
                bar.Low = pLow;
                bar.Close = pClose;
            }
        } else {
            std::memcpy(bar.Date.data(), current.date, 8);
            bar.Open = pOpen != 0 ? pOpen : lastNonZeroClose;
            bar.High = pHigh != 0 ? pHigh : lastNonZeroClose;
            bar.Low = pLow != 0 ? pLow : lastNonZeroClose;
            bar.Close = lastNonZeroClose;
        }
        bar.Volume = static_cast<std::int32_t>(
            std::clamp<std::int64_t>(pVolume, std::numeric_limits<std::int32_t>::min(),
                                     std::numeric_limits<std::int32_t>::max()));
        bar.Note = pLink;
        res.HighestPrice = std::max(res.HighestPrice, bar.High);
        if (bar.Low != 0) res.LowestPrice = std::min(res.LowestPrice, bar.Low);
        CountVolume(bar.Volume);
        pending = false;
        days = 0;
        weekday = 0;
        pOpen = 0;
        pHigh = 0;
        pLow = 100000;
        pVolume = 0;
    }

    void SettleVolumes() {
        if (!req.WantVolume) {
            res.HighestVolume = 0;
            res.LowestVolume = 0;
            res.VolumesPresent = false;
        } else if (volumeCount == 0) {
            res.VolumesPresent = false;
        } else if (res.HighestVolume == res.LowestVolume && res.HighestVolume == 0) {
            res.VolumesPresent = false;
        } else if (res.HighestVolume == res.LowestVolume) {
            // A flat volume still gets a panel: the bars stand at a third of its height.
            res.LowestVolume = 1;
            res.HighestVolume *= 3;
            res.AverageVolume = res.HighestVolume;
            res.VolumesPresent = true;
        } else {
            res.AverageVolume = static_cast<std::int32_t>(volumeSum / volumeCount);
            res.VolumesPresent = true;
        }
    }
};

} // namespace

Status SetRecordRange(SeriesRequest& q, long long first, long long last, int count,
                      std::string_view fileName) {
    if (last == 0) last = count;
    if (first < 1 || last < first || last > count)
        return Status::Error("Records " + std::to_string(first) + " to " + std::to_string(last) +
                             " are not in " + std::string(fileName) + " (1 to " +
                             std::to_string(count) + ")");
    q.FirstRecord = static_cast<std::int16_t>(first);
    q.LastRecord = static_cast<std::int16_t>(last);
    return Status::Ok();
}

Status LoadChartSeriesFromBytes(std::string_view bytes, const SeriesRequest& req,
                                std::string_view fileName, ChartSeries& s) {
    s.Results = LoadResults{};
    s.Issues.clear();
    const int count = req.LastRecord - req.FirstRecord + 1;
    s.ChartBars.assign(static_cast<std::size_t>(std::max(count, 0)), ChartBar{});
    s.LastBar = -1;
    if (req.Period != 'A' && req.Period != 'W' && req.Period != 'M') return Status::Ok();
    if (count <= 0) return Status::Ok();
    if (bytes.size() < static_cast<std::size_t>(count) * PriceRecord::kSize)
        return Status::Error("Too few records read from " + std::string(fileName));

    Loader L{s, req, s.Results};
    int previousWeekday = 0;
    std::string heldKey;
    Raw r{};
    for (int i = 0; i < count; ++i) {
        const int recordNumber = req.FirstRecord + i;
        r = Decode(bytes.data() + static_cast<std::size_t>(i) * PriceRecord::kSize);
        CheckPrices(r, recordNumber, fileName, s.Issues);
        if (req.Period == 'A') {
            ++L.lastIndex;
            L.Store(r, recordNumber);
        } else if (req.Period == 'W') {
            const int wd = WeekdayOf(r.date);
            if (wd == 0)
                return Status::Error("Record " + std::to_string(recordNumber) + " of " +
                                     std::string(fileName) + " has no valid date: \"" +
                                     std::string(r.date, 8) + "\"");
            if (wd < previousWeekday) {
                ++L.lastIndex;
                L.Flush(r);
            }
            L.weekday = wd;
            L.Accumulate(r, recordNumber);
            previousWeekday = wd;
        } else {
            const std::string key(r.date, 6);
            const bool rolled = !heldKey.empty() && key > heldKey;
            heldKey = key;
            if (rolled) {
                ++L.lastIndex;
                L.Flush(r);
            }
            L.Accumulate(r, recordNumber);
        }
    }
    if (req.Period != 'A' && L.pending) {
        ++L.lastIndex;
        L.Flush(r);
    }
    L.SettleVolumes();
    s.LastBar = static_cast<std::int16_t>(L.lastIndex);
    return Status::Ok();
}

Status LoadChartSeries(const std::string& priceFilePath, const SeriesRequest& req, ChartSeries& s) {
    PriceFile file(priceFilePath);
    if (auto st = file.Open(); !st) return st;
    std::string bytes;
    if (auto st = file.ReadRange(req.FirstRecord, req.LastRecord, bytes); !st) return st;
    return LoadChartSeriesFromBytes(bytes, req, file.path().filename().string(), s);
}

} // namespace kori::store
