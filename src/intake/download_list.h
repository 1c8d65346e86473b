#pragma once
// The waiting day files of the download folder: their names put into the one form
// "DDMMMYY.D", listed oldest first, and the update date taken from a list item.
#include "platform/dialogs.h"

#include <string>
#include <string_view>
#include <vector>

namespace kori::intake {

// Sort key of a waiting file's name: century, year, month number, day, then the rest from the
// eighth character ("15JAN08.D" -> "20080115.D"). Two-digit years 0 to 29 are of this century.
std::string DownloadSortKey(std::string_view fileName);

// Renames the day files of the other file-name forms to "DDMMMYY.d"; `format` is the setting
// InternetDLfmt. False, after the message, when the setting names no known form.
bool NormaliseInternetFileNames(const std::string& downloadFolder, std::string_view format,
                                platform::Dialogs& dialogs);

// The waiting files ("*.D", any case) oldest first. Service 4 first normalises the names. None
// waiting shows the message of an empty list.
std::vector<std::string> BuildDownloadFileList(const std::string& downloadFolder, int dataService,
                                               std::string_view internetFormat,
                                               platform::Dialogs& dialogs);

// The year of a two-digit year in a "d/m/yy" date as it is read back: below 30 in this century.
int ShortDateYear(int yy);

// The update date of a list item as "yyyymmdd"; anything but a trimmed item of 9 characters
// (DDMMMYY plus its extension) gives `today`. The name is taken as a calendar date with years
// below 20 in this century, but the date is held as "d/m/yy" and so read back as every other
// short date is (an option's expiry among them): a 2026 file dates its run 2026, not 1926.
std::string UpdateDateFromItem(std::string_view item, const std::string& today);

} // namespace kori::intake
