#pragma once
// ChtScan2 (increases in volume), ChtScan3 (breaks of the parabolic stop) and ChtScan6 (two
// averages close together): three walks with the frame of the first scan, each listing its
// finds and storing them in the scan list Z.
#include "platform/issues.h"
#include "platform/progress.h"
#include "scan/scan_common.h"

#include <optional>
#include <string>
#include <vector>

namespace kori::scan {

// The frame the three share: price range (defaults 0.005 to 1.00) and industry class.
struct ScanFrame {
    PriceRange Range{false, "0.005", "1.00"};
    bool ClassOn = false;
    std::string Class;
};

struct ScanListing {
    platform::Status Status;
    std::optional<ScanMessage> Message;
    bool Cancelled = false;
    platform::Issues Issues;
};

// ---- Scan 2 ----
struct Scan2Options {
    char List = 0;
    ScanFrame Frame; // Frame.Range.On is criterion A
    bool NoWarrants = false;
    bool Volume = false; // criterion B
    std::string VolumePercent = "600";
    std::string VolumeDays = "10";
    bool Price = false; // criterion C
    std::string PricePercent = "10";
    std::string ReportFolder; // where ChtScan2.txt goes; empty: no report file
};

struct Scan2Row {
    int NameRecord = 0;
    std::string Code;
    float Close = 0;
    std::optional<long long> VolUp;
    std::optional<double> Change;
};

struct Scan2Result : ScanListing {
    std::string Selection; // "A", "AB", ...
    std::vector<Scan2Row> Rows;
};

std::optional<ScanMessage> ValidateScan2(const Scan2Options& o);
Scan2Result RunScan2(std::string_view dataFolder, const Scan2Options& o,
                     platform::Progress& progress);
// A line of the listing and of ChtScan2.txt under "Code   L/Price    Vol+   % +/-".
std::string Scan2Line(const Scan2Row& row);
inline constexpr std::string_view kScan2Heading = "Code   L/Price    Vol+   % +/-";
inline constexpr std::string_view kScan2Title = "CHART SCAN 2 DATA";

// ---- Scan 3 ----
struct Scan3Options {
    char List = 0;
    ScanFrame Frame;
    bool NoWarrants = false;
    bool Up = false, Down = false;
    bool CategoryOn = false;
    std::string Category;
};

struct Scan3Row {
    int NameRecord = 0;
    std::string Code;
    float Close = 0;
    std::string Direction; // "UP" or "DOWN"
};

struct Scan3Result : ScanListing {
    std::vector<Scan3Row> Rows;
};

std::optional<ScanMessage> ValidateScan3(const Scan3Options& o);
Scan3Result RunScan3(std::string_view dataFolder, const Scan3Options& o,
                     platform::Progress& progress);
// The direction of the parabolic after each of the last three records of `bytes` (raw price
// records, oldest first), ' ' where the stop was not above 0. The search starts 100 records
// before the end.
std::string LastParabolicDirections(std::string_view bytes);
// The break the three directions show: "UP", "DOWN" or empty (no change, or none wanted).
std::string BreakOf(std::string_view directions, bool up, bool down);
std::string Scan3Line(const Scan3Row& row);
inline constexpr std::string_view kScan3Heading = "Code   L/Price    Up / Down-";
inline constexpr std::string_view kScan3Title = "CHART SCAN 3 DATA";

// ---- Scan 6 ----
struct Scan6Options {
    ScanFrame Frame;
    std::string CodeLength = "All"; // "All", "3", "4", "5", "6"
    int Av1D = 0, Av2D = 0;         // the two daily averages of the chart defaults
    std::string ReportFolder;       // where ChtScan6.txt goes; empty: no report file
};

struct Scan6Row {
    int NameRecord = 0;
    std::string Code, Name, Class;
    float Close = 0;
    double Gap = 0;
};

struct Scan6Result : ScanListing {
    std::vector<Scan6Row> Rows;
};

// The walk stops after this many name records, whatever the file holds.
inline constexpr int kScan6RecordLimit = 400;

std::optional<ScanMessage> ValidateScan6(const Scan6Options& o);
Scan6Result RunScan6(std::string_view dataFolder, const Scan6Options& o,
                     platform::Progress& progress);
// (longer - shorter) / shorter x 100 of the two means, to four decimal places.
double AverageGap(double longAve, double shortAve);
// Code, last close, gap ("####0.0"), name and class, separated by tabs.
std::string Scan6Line(const Scan6Row& row);

// The closing words of Scans 2 and 6, and of Scan 3.
ScanMessage Scan2StoredMessage();
ScanMessage Scan3StoredMessage();
inline constexpr std::string_view kNoRecordsFound =
    "No records for the criteria selected were found";

} // namespace kori::scan
