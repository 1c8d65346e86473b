#pragma once
// chtScan1: walks the securities of the full list or a chart list and keeps those whose last
// close moved by a set percentage, or whose oscillators give an indication on the last bars.
// The finds go to the scan list Z.
#include "osc/osc_settings.h"
#include "platform/issues.h"
#include "platform/progress.h"
#include "scan/scan_common.h"
#include "scan/scan_oscillators.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace kori::scan {

struct Scan1Options {
    char List = 0; // 0: "Full List (Names.dat)"; else the chart list's letter
    bool Rise = false;
    std::string RisePercent = "10";
    bool Fall = false;
    std::string FallPercent = "10";
    PriceRange Range{false, "0.50", "5.00"};
    bool CategoryOn = false;
    std::string Category;
    bool ClassOn = false;
    std::string Class;
    bool NoWarrants = false;
    std::array<bool, 5> Osc{}; // in the order of kScanOscs
    IndicationChoice Indications;
};

struct Scan1Row {
    int NameRecord = 0;
    std::string Code, Name;
    float Close = 0;
    std::string Move; // "U", "D" or ""
    std::optional<double> Change;
    std::array<std::string, 5> Indications; // kept indications, by kScanOscs
    bool All = false;                       // matches every ticked selection
};

struct Scan1Result {
    platform::Status Status; // the walk could not start, or the list could not be written
    std::vector<Scan1Row> Rows;
    std::string LastDate; // "yyyymmdd", the latest last date met
    std::optional<ScanMessage> Message;
    bool Cancelled = false;
    platform::Issues Issues;
};

inline constexpr std::string_view kScan1AllLabel =
    "Indicates stocks that match ALL of the scan selections";

// The checks of "Proceed"; nullopt when the choices pass. Periods come from the daily settings.
std::optional<ScanMessage> ValidateScan1(const Scan1Options& o, const osc::OscDef& def);

// The walk; expects choices that passed ValidateScan1. A cancel keeps the rows found so far and
// leaves the scan list as it was.
Scan1Result RunScan1(std::string_view dataFolder, const Scan1Options& o, const osc::OscDef& def,
                     platform::Progress& progress);

// Period the scan uses for an oscillator: StochK, WmsA, RocP (ROC and MM), RsiP.
int ScanPeriod(ScanOsc osc, const osc::OscDef& def);

} // namespace kori::scan
