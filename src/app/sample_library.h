#pragma once
// An invented, deterministic library so that every window has something real to show: several
// dozen securities of every record type with six years of weekday prices, classes, sectors and
// three chart lists. Nothing in it comes from real market data.
#include "platform/settings_store.h"
#include "platform/status.h"

#include <array>
#include <string>
#include <vector>

namespace kori::app {

struct SampleSummary {
    int Securities = 0;
    int Records = 0;
    std::string LastDate;
};

// Writes Names.dat, the price files and the lists into `dataFolder`, IndClass.dat and
// Gics.dat into `systemFolder`, and the list names into the settings store.
platform::Status MakeSampleLibrary(const std::string& systemFolder, const std::string& dataFolder,
                                   platform::SettingsStore& settings, SampleSummary& summary);

// Day files waiting in `downloadFolder` for the "Other Internet data " service (names in the
// form DDMMMYY.D), made from the sample's last records: the next trading day (a new security,
// a corrected volume, one security missing so it gets a filler), the last day again (a
// replace), a day inside the history (an insert) and a newer file with a line one field short.
// Returns the names made, oldest first.
platform::Status MakeSampleDayFiles(const std::string& dataFolder,
                                    const std::string& downloadFolder,
                                    std::vector<std::string>& made);

// The download program's table of security details for the sample's securities of record
// type 4, in `inFolder` as SecurityDetails.Asx.Stk: with a row for "PRN" and one line longer
// than a details record holds. Invented figures, like the prices.
platform::Status MakeSampleSecurityDetails(const std::string& dataFolder,
                                           const std::string& inFolder);

// The bundle service's layout: a folder a market segment below `rootFolder` (the stocks are the
// data folder itself), each with its own Names.dat and price files, their eight paths in the
// order of ChtPaths.lst, and the next trading day's bundle waiting in `downloadFolder`.
platform::Status MakeSampleBundle(const std::string& rootFolder, const std::string& dataFolder,
                                  const std::string& downloadFolder,
                                  std::array<std::string, 8>& segmentFolders,
                                  std::vector<std::string>& made);

// The maintenance bulletin of the waiting day (23NOV26.Asx.Btn) in `inFolder`: a listing, a
// code change onto a code with data, a delisting, a bonus issue, a consolidation, a dividend, a
// price correction, and a warrant and an option line the filter drops. The day files' prices
// for those securities already follow the issues.
platform::Status MakeSampleBulletins(const std::string& dataFolder, const std::string& inFolder);

} // namespace kori::app
