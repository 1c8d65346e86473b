#include "intake/download_list.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <utility>

namespace kori::intake {

namespace fs = std::filesystem;
using platform::Upper;
using platform::Val;

namespace {

constexpr std::array<std::string_view, 12> kMonths = {"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                                                      "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};

// Characters `from` (1-based) for `count`, or what there is of them.
std::string_view Mid(std::string_view s, std::size_t from, std::size_t count) {
    if (from - 1 >= s.size()) return {};
    return s.substr(from - 1, count);
}

int MonthNumber(std::string_view letters) {
    const std::string u = Upper(letters);
    for (std::size_t i = 0; i < kMonths.size(); ++i)
        if (kMonths[i] == u) return static_cast<int>(i) + 1;
    return 0;
}

std::string TwoDigits(int n) {
    return std::string(1, static_cast<char>('0' + n / 10 % 10)) + static_cast<char>('0' + n % 10);
}

bool HasExtension(const fs::path& p, std::string_view ext) {
    return platform::EqualsNoCase(p.extension().string(), ext);
}

// The names of plain files in the folder whose extension is `ext` in any case.
std::vector<std::string> FilesWithExtension(const std::string& folder, std::string_view ext) {
    std::vector<std::string> names;
    std::error_code ec;
    for (fs::directory_iterator it(platform::NormalisePath(folder), ec), end; !ec && it != end;
         it.increment(ec)) {
        if (it->is_regular_file(ec) && HasExtension(it->path(), ext))
            names.push_back(it->path().filename().string());
    }
    return names;
}

// Shell sort, the gap halved each pass: the lists are a few hundred names at most.
void ShellSort(std::vector<std::pair<std::string, std::string>>& items) {
    for (std::size_t gap = items.size() / 2; gap > 0; gap /= 2)
        for (std::size_t i = gap; i < items.size(); ++i)
            for (std::size_t j = i; j >= gap && items[j - gap].first > items[j].first; j -= gap)
                std::swap(items[j - gap], items[j]);
}

struct NameForm {
    std::string_view Format;
    std::string_view Extension;
    std::size_t Length;
    std::size_t Day, Month, Year; // 1-based positions of two characters each
};

constexpr std::array<NameForm, 6> kForms = {{
    {"YYMMDD.D", ".D", 8, 5, 3, 1},
    {"YYMMDD.ASX", ".ASX", 10, 5, 3, 1},
    {"DDMMYY.D", ".D", 8, 1, 3, 5},
    {"DDMMYY.ASX", ".ASX", 10, 1, 3, 5},
    {"DDMMYYYY.D", ".D", 10, 1, 3, 7},
    {"YYYYMMDD.D", ".D", 10, 7, 5, 3},
}};

bool OnlyNameCharacters(std::string_view name) {
    return std::all_of(name.begin(), name.end(), [](unsigned char c) {
        return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') ||
               c == '.';
    });
}

void RenameToDayForm(const std::string& folder, const NameForm& form) {
    for (const auto& name : FilesWithExtension(folder, form.Extension)) {
        if (name.size() != form.Length || !OnlyNameCharacters(name)) continue;
        const auto month = static_cast<int>(Val(Mid(name, form.Month, 2)));
        if (month < 1 || month > 12) continue;
        const std::string target = std::string(Mid(name, form.Day, 2)) +
                                   std::string(kMonths[static_cast<std::size_t>(month - 1)]) +
                                   std::string(Mid(name, form.Year, 2)) + ".d";
        const fs::path from = fs::path(platform::NormalisePath(folder)) / name;
        const fs::path to = fs::path(platform::NormalisePath(folder)) / target;
        std::error_code ec;
        if (fs::exists(to, ec)) fs::remove(to, ec);
        fs::rename(from, to, ec);
    }
}

} // namespace

std::string DownloadSortKey(std::string_view name) {
    const std::string_view yy = Mid(name, 6, 2);
    const double year = Val(yy);
    const std::string century = (year > -1 && year < 30) ? "20" : "19";
    return century + std::string(yy) + TwoDigits(MonthNumber(Mid(name, 3, 3))) +
           std::string(Mid(name, 1, 2)) + std::string(name.size() >= 8 ? name.substr(7) : "");
}

bool NormaliseInternetFileNames(const std::string& downloadFolder, std::string_view format,
                                platform::Dialogs& dialogs) {
    const std::string f = Upper(platform::Trim(format));
    if (f == "DDMMMYY.D") return true;
    if (f.empty() || f == "UNKNOWN") {
        dialogs.MsgBox("File name format not set\nSet format in Modify Download Details, and retry",
                       "Download");
        return false;
    }
    for (const auto& form : kForms) {
        if (form.Format != f) continue;
        RenameToDayForm(downloadFolder, form);
        return true;
    }
    dialogs.MsgBox("The internet data FILE NAMES are not in the correct format. Select Modify "
                   "Download Details and select the correct file name format",
                   "Downloaded Data");
    return false;
}

std::vector<std::string> BuildDownloadFileList(const std::string& downloadFolder, int dataService,
                                               std::string_view internetFormat,
                                               platform::Dialogs& dialogs) {
    if (dataService == 4 && !NormaliseInternetFileNames(downloadFolder, internetFormat, dialogs))
        return {};
    std::vector<std::pair<std::string, std::string>> items;
    for (auto& name : FilesWithExtension(downloadFolder, ".D"))
        items.emplace_back(DownloadSortKey(name), std::move(name));
    if (items.empty()) {
        dialogs.MsgBox(" There are no downloaded files to update. ", "Downloaded Data ");
        return {};
    }
    ShellSort(items);
    std::vector<std::string> list;
    for (auto& item : items)
        list.push_back(std::move(item.second));
    return list;
}

std::string UpdateDateFromItem(std::string_view item, const std::string& today) {
    const std::string t = platform::Trim(item);
    if (t.size() != 9) return today;
    const int day = static_cast<int>(Val(Mid(t, 1, 2)));
    const int month = MonthNumber(Mid(t, 3, 3));
    const int yy = static_cast<int>(Val(Mid(t, 6, 2)));
    const platform::CivilDate date{(yy < 20 ? 2000 : 1900) + yy, month, day};
    const std::string text = platform::DateText(date);
    // A name that does not read as a calendar date dates its records today.
    if (!platform::IsValidDateText(text)) return today;
    return platform::DateText({ShortDateYear(yy), month, day});
}

int ShortDateYear(int yy) {
    return yy + (yy < 30 ? 2000 : 1900);
}

} // namespace kori::intake
