#pragma once
// After the name file changed its order (a save or a sort of the editor, a repair that moved a
// record), the chart lists A to K are repaired: each entry takes the record number of the first
// name record whose six-character code equals its own; entries whose code left the name file
// are dropped. A list with no entry left is kept as it was.
#include "platform/progress.h"
#include "platform/status.h"

#include <string_view>

namespace kori::store {

inline constexpr std::string_view kRelinkStatus = "Checking SubLists";

struct RelinkResult {
    platform::Status Status;
    int ListsRewritten = 0;
    bool Cancelled = false;
};

// Nothing is done when Names.dat holds fewer than 2 records. The cancel flag is polled between
// lists. Each list is written beside the old one (SubList.tmp) and renamed over it.
RelinkResult RelinkChartLists(std::string_view dataFolder, platform::Progress& progress);

} // namespace kori::store
