#pragma once
// RemDate: one date taken out of every price file of a folder's name file, every record of that
// date or only the latest one.
#include "maint/repair_result.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "store/price_file.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::maint {

namespace rem_date_text {
inline constexpr std::string_view kCaption = "Remove Specific Date";
inline constexpr std::string_view kAll = "Remove ALL instances of that date";
inline constexpr std::string_view kLatest = "Remove only the LATEST instance of that date";
inline constexpr std::string_view kDateMissing = "Date to remove must be entered.";
inline constexpr std::string_view kTitle = "Remove Selected Data";
inline constexpr std::string_view kBadDate = "Date must be entered as dd/mm/yyyy";
} // namespace rem_date_text

enum class RemoveWhich { All, Latest };

// "dd/mm/yyyy" (one-digit day and month allowed) as "yyyymmdd"; nullopt when not a date.
std::optional<std::string> DateToRemove(std::string_view ddmmyyyy);

// The records of one file without the date: every such record, or the last one.
std::vector<store::PriceRecord> WithoutDate(const std::vector<store::PriceRecord>& records,
                                            std::string_view yyyymmdd, RemoveWhich which);

// Walks the name file of `folder`, showing "Removing <date> from <code>", and rewrites each file
// that held the date through Temp.Tmp.
RepairResult RemDate(std::string_view folder, std::string_view ddmmyyyy, RemoveWhich which,
                     platform::Dialogs& dialogs, platform::Progress& progress);

} // namespace kori::maint
