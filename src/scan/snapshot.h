#pragma once
// The current snapshot: each security's last day beside its oscillators and averages, and the
// market's breadth, for a list or the whole name file. The oscillators are the charts' own
// computations at their daily settings, worked on the last records of each file as a chart of
// them would be.
#include "osc/osc_settings.h"
#include "platform/ini_file.h"
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/status.h"
#include "store/security_walk.h"

#include <optional>
#include <string>
#include <vector>

namespace kori::scan {

// Records read from the end of each file: a year of weeks for the 52-week range, and room for
// the oscillators and the averages to settle.
inline constexpr int kSnapshotRecords = 400;
inline constexpr int kYearBars = 260;
inline constexpr int kVolumeAverageBars = 20;

struct SnapshotSettings {
    osc::OscDef Oscillators;
    int Average1 = 10, Average2 = 30; // the chart defaults' daily averages
    bool Exponential = false;
};

// The oscillator settings of the library, an oscillator whose period is 0 there taking its
// default as the settings dialog would, and the chart defaults' two daily averages.
SnapshotSettings SnapshotSettingsFrom(const platform::IniFile& ini);

struct SnapshotRow {
    std::string Code, Name;
    std::string Date; // "yyyymmdd" of the last record
    double Close = 0;
    std::optional<double> Change, ChangePercent; // against the previous traded close
    std::optional<double> VolumeRatio;           // last volume / mean of the 20 before it
    std::optional<double> Rsi, StochasticK;
    std::optional<bool> MacdAboveSignal;
    std::optional<double> AboveAverage1, AboveAverage2; // close against each average, per cent
    double YearHigh = 0, YearLow = 0;
    bool NewHigh = false, NewLow = false; // the last bar made the year's extreme
};

struct Breadth {
    int Advances = 0, Declines = 0, Unchanged = 0, NewHighs = 0, NewLows = 0;
};

struct SnapshotResult {
    platform::Status Status;
    std::vector<SnapshotRow> Rows; // in walk order
    Breadth Market;
    bool Cancelled = false;
    platform::Issues Issues;
};

// One security from the bytes of its last records (50 bytes each).
std::optional<SnapshotRow> SnapshotOf(const store::NameRecord& name, std::string_view records,
                                      int firstRecord, const SnapshotSettings& settings);

SnapshotResult TakeSnapshot(const store::SecurityList& list, const SnapshotSettings& settings,
                            platform::Progress& progress);

// Header and one line a row, for export.
std::string SnapshotCsv(const SnapshotResult& result);

} // namespace kori::scan
