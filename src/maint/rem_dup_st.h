#pragma once
// RemDupST: every price file of a folder's name file brought into date order, then one pass
// that drops one record of each pair of equal dates: the earlier stays unless its volume is 0.
#include "maint/repair_result.h"
#include "platform/progress.h"

#include <string>
#include <string_view>

namespace kori::maint {

namespace rem_dup_text {
inline constexpr std::string_view kSorting = "      Sorting ";
inline constexpr std::string_view kRemoving = "      Removing Duplicates ";
inline constexpr std::string_view kCompleted = "COMPLETED ";
} // namespace rem_dup_text

// The whole records of one price file (its bytes) in date order, by the numeric value of the
// date, records of one date in the order they stood.
std::string SortRecordsByDate(std::string_view bytes);
// The one pass over records in date order: with a skip flag, clear at the start, for i from 1
// to the last: a set flag is cleared and i passes; the last record is written; a record whose
// trimmed date differs from the next one's is written; of two equal dates the first is written
// unless its volume is 0, else the second, and the flag is set. Files of fewer than 2 records
// stay as they are.
std::string RemoveDuplicateDates(std::string_view sortedBytes);

// Walks the name file of `folder`; a file is rewritten (through Temp.Tmp) only when sorting or
// the pass changed it.
RepairResult RemDupST(std::string_view folder, platform::Progress& progress);

} // namespace kori::maint
