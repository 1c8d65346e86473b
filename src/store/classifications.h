#pragma once
// IndClass.dat and Gics.dat: words for the classification digits of a name record, and the
// walks over one class or group that chart selection makes.
#include "platform/status.h"
#include "store/name_record.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

// "unknown" when the file is missing, nothing matches, or the text found is empty.
std::string ClassNameOf(std::string_view systemFolder, std::string_view classId);
// Sector "_" sub-sector, with the same "unknown" rules.
std::string SectorNameOf(std::string_view systemFolder, std::string_view gicsCode);

// Next record (1-based) after `fromPosition` whose class matches the request: a request
// ending in "0" is a group (first two characters, three-character classes only); any other
// is exact. 0 when none is left or the request is empty.
int FindNextClassRecord(const std::vector<NameRecord>& names, int fromPosition,
                        std::string_view request, bool gics);

// The editor's rules for a code cell: empty passes, a number comes back formatted with
// `digits` digits, anything else is refused (nullopt).
std::optional<std::string> CheckClassId(std::string_view cell, int digits);

// Rows of the editor grid: code, then one (IndClass) or two (Gics) texts.
using ClassRow = std::vector<std::string>;
std::vector<ClassRow> ReadClassFile(std::string_view systemFolder, std::string_view fileName,
                                    std::size_t fields);
// Rewrites the file from the rows; rows without a code or first text are dropped.
platform::Status WriteClassFile(std::string_view systemFolder, std::string_view fileName,
                                const std::vector<ClassRow>& rows);

} // namespace kori::store
