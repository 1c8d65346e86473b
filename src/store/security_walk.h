#pragma once
// ForEachSecurity: the one walk over the securities of the library, in the order of the name
// file or of one chart list, that the chart window, the scans, the update's no-trade fill, the
// statistics and the repair tools share.
//
// A chart list is walked as the routines that walk a name file walk one: TmpNames.tmp is built
// from the list (records in the list's order, entries out of range skipped) and walked in its
// order. Before any security is visited the name file and the list are checked against the
// 32,767-record limit; a file over it stops the walk with the one message of that limit.
// A security whose price file is missing, empty, too long or of a broken length is reported as
// an issue; only the first three keep it from being visited. The progress shows the position
// in the walk and its cancel flag is polled before every security.
#include "platform/issues.h"
#include "platform/progress.h"
#include "platform/status.h"
#include "store/name_record.h"

#include <filesystem>
#include <functional>
#include <string>

namespace kori::store {

// Which securities a walk goes through: the whole name file of a data folder (letter 0), or a
// chart list of it ('A' .. 'K', 'Z').
struct SecurityList {
    std::string DataFolder;
    char Letter = 0;
    // When above 0, the walk ends after this many places, whatever the count (the progress
    // still runs to the whole count): the later securities are not looked at at all.
    int StopAfter = 0;
};

// One security as the walk meets it.
struct WalkItem {
    int Position = 0;         // 1-based place in the walk
    int Count = 0;            // securities in the walk
    int NameRecordNumber = 0; // its record in Names.dat
    NameRecord Name;          // as Names.dat holds it
    std::filesystem::path PriceFile;
    std::int16_t PriceRecords = 0;
};

enum class WalkStep { Continue, Stop };

struct WalkResult {
    platform::Status Status; // an error when the walk could not start
    int Visited = 0;
    bool Cancelled = false;
    bool Stopped = false; // the visitor asked to stop
    platform::Issues Issues;
};

using WalkVisitor = std::function<WalkStep(const WalkItem&)>;

WalkResult ForEachSecurity(const SecurityList& list, platform::Progress& progress,
                           const WalkVisitor& visit);

} // namespace kori::store
