#include "scan/snapshot.h"

#include "chart/chart_defaults.h"
#include "osc/osc_compute.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/load_chart_series.h"
#include "store/price_file.h"
#include "store/two_thread_walk.h"

#include <algorithm>
#include <array>
#include <mutex>

namespace kori::scan {

namespace {

std::optional<double> LastValue(const std::optional<osc::OscTable>& table, std::size_t column) {
    if (!table || table->RowCount() == 0 || column >= table->columns.size()) return std::nullopt;
    return table->Row(table->RowCount() - 1)[column];
}

std::optional<double> Average(const std::vector<float>& closes, int period, bool exponential) {
    const auto n = closes.size();
    if (period < 1 || n < static_cast<std::size_t>(period)) return std::nullopt;
    if (!exponential) {
        double sum = 0;
        for (std::size_t i = n - static_cast<std::size_t>(period); i < n; ++i)
            sum += closes[i];
        return sum / period;
    }
    // Seeded with the simple average of the first period, then weighted 2 / (period + 1).
    double ema = 0;
    for (int i = 0; i < period; ++i)
        ema += closes[static_cast<std::size_t>(i)];
    ema /= period;
    const double k = 2.0 / (period + 1);
    for (std::size_t i = static_cast<std::size_t>(period); i < n; ++i)
        ema += k * (closes[i] - ema);
    return ema;
}

std::optional<double> PercentAbove(double close, std::optional<double> average) {
    if (!average || *average <= 0) return std::nullopt;
    return (close - *average) / *average * 100;
}

} // namespace

SnapshotSettings SnapshotSettingsFrom(const platform::IniFile& ini) {
    SnapshotSettings s;
    s.Oscillators = osc::ReadOscSettings(ini);
    for (const char* name : {"RSI", "STO", "MACD"})
        osc::FillOscDefaults(s.Oscillators, name, false);
    const auto defaults = chart::LoadChartDefaults(ini);
    s.Average1 = defaults.MAPeriod1Daily;
    s.Average2 = defaults.MAPeriod2Daily;
    s.Exponential = defaults.MAExponential;
    return s;
}

std::optional<SnapshotRow> SnapshotOf(const store::NameRecord& name, std::string_view records,
                                      int firstRecord, const SnapshotSettings& settings) {
    store::SeriesRequest request;
    request.FirstRecord = static_cast<std::int16_t>(firstRecord);
    request.LastRecord = static_cast<std::int16_t>(
        firstRecord + static_cast<int>(records.size() / store::PriceRecord::kSize) - 1);
    request.RecordType = name.RecordType;
    store::ChartSeries series;
    if (!store::LoadChartSeriesFromBytes(records, request, name.TrimmedCode(), series) ||
        series.LastBar < 0)
        return std::nullopt;
    const auto& bars = series.ChartBars;
    const std::size_t count = static_cast<std::size_t>(series.LastBar) + 1;

    // The traded closes, oldest first; no-trade records (close 0) take no part.
    std::vector<float> closes;
    closes.reserve(count);
    for (std::size_t i = 0; i < count; ++i)
        if (bars[i].Close > 0) closes.push_back(bars[i].Close);
    if (closes.empty()) return std::nullopt;

    SnapshotRow row;
    row.Code = name.TrimmedCode();
    row.Name = platform::Trim(name.Name);
    std::size_t lastTraded = count - 1;
    while (bars[lastTraded].Close <= 0)
        --lastTraded; // a traded close exists: `closes` is not empty
    const auto& last = bars[lastTraded];
    row.Date = std::string(last.DateText());
    row.Close = closes.back();
    if (closes.size() >= 2) {
        const double previous = closes[closes.size() - 2];
        row.Change = row.Close - previous;
        if (previous > 0) row.ChangePercent = *row.Change / previous * 100;
    }
    if (lastTraded >= 1 && last.Volume > 0) {
        const std::size_t from = lastTraded > static_cast<std::size_t>(kVolumeAverageBars)
                                     ? lastTraded - kVolumeAverageBars
                                     : 0;
        double sum = 0;
        for (std::size_t i = from; i < lastTraded; ++i)
            sum += bars[i].Volume;
        const double mean = sum / static_cast<double>(lastTraded - from);
        if (mean > 0) row.VolumeRatio = last.Volume / mean;
    }
    // The year's range, and whether the last bar went beyond what the bars before it reached.
    const std::size_t yearFrom =
        lastTraded >= static_cast<std::size_t>(kYearBars) ? lastTraded + 1 - kYearBars : 0;
    const bool closeOnly = store::IsCloseOnly(name.RecordType);
    const auto highOf = [&](const store::ChartBar& b) { return closeOnly ? b.Close : b.High; };
    const auto lowOf = [&](const store::ChartBar& b) { return closeOnly ? b.Close : b.Low; };
    std::optional<double> beforeHigh, beforeLow;
    for (std::size_t i = yearFrom; i < lastTraded; ++i) {
        if (bars[i].Close <= 0) continue;
        beforeHigh = std::max(beforeHigh.value_or(highOf(bars[i])), double{highOf(bars[i])});
        if (lowOf(bars[i]) > 0)
            beforeLow = std::min(beforeLow.value_or(lowOf(bars[i])), double{lowOf(bars[i])});
    }
    row.NewHigh = beforeHigh && highOf(last) > *beforeHigh;
    row.NewLow = beforeLow && lowOf(last) > 0 && lowOf(last) < *beforeLow;
    row.YearHigh = std::max(beforeHigh.value_or(highOf(last)), double{highOf(last)});
    row.YearLow = lowOf(last) > 0 ? std::min(beforeLow.value_or(lowOf(last)), double{lowOf(last)})
                                  : beforeLow.value_or(0);

    osc::OscInputs inputs;
    inputs.RecordType = name.RecordType;
    row.Rsi = LastValue(osc::ComputeOscillator("RSI", series, settings.Oscillators, inputs), 0);
    row.StochasticK =
        LastValue(osc::ComputeOscillator("STO", series, settings.Oscillators, inputs), 0);
    const auto macd = osc::ComputeOscillator("MACD", series, settings.Oscillators, inputs);
    if (macd) {
        const auto& cols = macd->columns;
        const auto at = [&](std::string_view c) {
            return static_cast<std::size_t>(std::find(cols.begin(), cols.end(), c) - cols.begin());
        };
        const auto line = LastValue(macd, at("macd"));
        const auto signal = LastValue(macd, at("signal"));
        if (line && signal) row.MacdAboveSignal = *line > *signal;
    }
    row.AboveAverage1 =
        PercentAbove(row.Close, Average(closes, settings.Average1, settings.Exponential));
    row.AboveAverage2 =
        PercentAbove(row.Close, Average(closes, settings.Average2, settings.Exponential));
    return row;
}

SnapshotResult TakeSnapshot(const store::SecurityList& list, const SnapshotSettings& settings,
                            platform::Progress& progress) {
    SnapshotResult result;
    // Each security's row lands at its place in the walk, whichever thread worked it.
    std::vector<std::optional<SnapshotRow>> rows;
    std::mutex grow;
    std::array<std::string, 2> buffers;
    progress.SetStatus("Taking the snapshot");
    const auto walk =
        store::WalkOnTwoThreads(list, progress, [&](int thread, const store::WalkItem& item) {
            auto& bytes = buffers[static_cast<std::size_t>(thread)];
            const int first = std::max(1, item.PriceRecords - kSnapshotRecords + 1);
            if (!store::ReadPriceRecords(item.PriceFile, first, item.PriceRecords, bytes)) return;
            auto row = SnapshotOf(item.Name, bytes, first, settings);
            std::lock_guard lock(grow);
            if (rows.size() < static_cast<std::size_t>(item.Position))
                rows.resize(static_cast<std::size_t>(item.Position));
            rows[static_cast<std::size_t>(item.Position - 1)] = std::move(row);
        });
    result.Status = walk.Status;
    result.Cancelled = walk.Cancelled;
    result.Issues = walk.Issues;
    for (auto& r : rows) {
        if (!r) continue;
        auto& b = result.Market;
        if (r->Change && *r->Change > 0)
            ++b.Advances;
        else if (r->Change && *r->Change < 0)
            ++b.Declines;
        else if (r->Change)
            ++b.Unchanged;
        if (r->NewHigh) ++b.NewHighs;
        if (r->NewLow) ++b.NewLows;
        result.Rows.push_back(std::move(*r));
    }
    return result;
}

std::string SnapshotCsv(const SnapshotResult& result) {
    std::string out = "Code,Name,Date,Close,Change,Change %,Volume/Average,RSI,%K,MACD,"
                      "Close/Average 1 %,Close/Average 2 %,52-Week High,52-Week Low\n";
    auto number = [](std::optional<double> v, const char* format) {
        return v ? platform::Format(*v, format) : std::string();
    };
    for (const auto& r : result.Rows) {
        std::string name = r.Name;
        std::replace(name.begin(), name.end(), ',', ' ');
        out += r.Code + "," + name + "," + r.Date + "," + number(r.Close, "0.000") + "," +
               number(r.Change, "0.000") + "," + number(r.ChangePercent, "0.00") + "," +
               number(r.VolumeRatio, "0.00") + "," + number(r.Rsi, "0.0") + "," +
               number(r.StochasticK, "0.0") + "," +
               (r.MacdAboveSignal ? (*r.MacdAboveSignal ? "above" : "below") : "") + "," +
               number(r.AboveAverage1, "0.00") + "," + number(r.AboveAverage2, "0.00") + "," +
               number(r.YearHigh, "0.000") + "," + number(r.YearLow, "0.000") + "\n";
    }
    return out;
}

} // namespace kori::scan
