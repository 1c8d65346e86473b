#include "store/security_walk.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <algorithm>
#include <sys/stat.h>

namespace kori::store {

using platform::Issue;
using platform::Severity;
using platform::Status;

namespace {

// The name-file record numbers of the walk, in order: every record of the name file, or the
// records TmpNames.tmp holds for a chart list (its Base field carries the number).
Status WalkOrder(const SecurityList& list, std::int16_t nameCount, std::vector<int>& order) {
    order.clear();
    if (list.Letter == 0) {
        for (int n = 1; n <= nameCount; ++n)
            order.push_back(n);
        return Status::Ok();
    }
    const auto listPath = ListPath(list.DataFolder, list.Letter);
    std::int16_t entries = 0;
    if (auto s = CountRecords(listPath, ChartListEntry::kSize, entries); !s) return s;
    if (auto s = BuildTmpNames(list.DataFolder, listPath.filename().string()); !s) return s;
    std::vector<NameRecord> tmp;
    NameFile tmpNames(platform::ResolveIn(list.DataFolder, "TmpNames.tmp"));
    if (auto s = tmpNames.ReadAll(tmp); !s) return s;
    for (const auto& r : tmp)
        if (r.Base >= 1 && r.Base <= nameCount) order.push_back(static_cast<int>(r.Base));
    return Status::Ok();
}

// The price file of a code: the name as the walk builds it when that file is there (one stat,
// no directory search), else whatever the case-insensitive search finds.
std::filesystem::path PriceFileOf(const std::string& folderWithSlash, const std::string& code,
                                  struct stat& st, bool& found) {
    std::filesystem::path path(folderWithSlash + code + ".WDT");
    found = ::stat(path.c_str(), &st) == 0;
    if (found) return path;
    path = platform::ResolvePath(path);
    found = ::stat(path.c_str(), &st) == 0;
    return path;
}

// Why a price file cannot be walked, as an issue; nullopt when it can. A length that is not a
// whole number of records is reported and the whole records are still read. Everything comes
// from the one stat the walk made: a market of thousands of files is walked at the speed of
// the file system, not of repeated look-ups.
std::optional<Issue> PriceFileIssue(WalkItem& item, bool found, const struct stat& st,
                                    platform::Issues& issues) {
    const std::string name = item.PriceFile.filename().string();
    if (!found) return Issue{Severity::Warning, "No price file " + name, name, 0};
    const auto size = S_ISREG(st.st_mode) ? static_cast<std::uintmax_t>(st.st_size) : 0;
    if (size == 0) return Issue{Severity::Warning, name + " holds no records", name, 0};
    if (auto s = CountRecordsOfLength(size, PriceRecord::kSize, name, item.PriceRecords); !s)
        return Issue{Severity::Error, s.message(), name, 0};
    if (size % PriceRecord::kSize != 0)
        issues.push_back({Severity::Warning,
                          name + " ends in part of a record; the part is not read", name,
                          item.PriceRecords + 1});
    return std::nullopt;
}

} // namespace

WalkResult ForEachSecurity(const SecurityList& list, platform::Progress& progress,
                           const WalkVisitor& visit) {
    WalkResult result;
    NameFile nameFile(NameFile::PathIn(list.DataFolder));
    std::vector<NameRecord> names;
    if (platform::FileExists(nameFile.path()))
        if (result.Status = nameFile.ReadAll(names); !result.Status) return result;
    std::vector<int> order;
    const auto nameCount = static_cast<std::int16_t>(names.size());
    if (result.Status = WalkOrder(list, nameCount, order); !result.Status) return result;

    const int count = static_cast<int>(order.size());
    const int stopAfter = list.StopAfter > 0 ? std::min(list.StopAfter, count) : count;
    const std::string folder = platform::FolderWithSlash(list.DataFolder);
    progress.SetRange(count);
    for (int i = 0; i < stopAfter; ++i) {
        progress.SetValue(i + 1);
        progress.Yield();
        if (progress.Cancelled()) {
            result.Cancelled = true;
            break;
        }
        WalkItem item;
        item.Position = i + 1;
        item.Count = count;
        item.NameRecordNumber = order[static_cast<std::size_t>(i)];
        item.Name = names[static_cast<std::size_t>(item.NameRecordNumber - 1)];
        const std::string code = item.Name.TrimmedCode();
        if (!IsValidCode(code)) {
            result.Issues.push_back({Severity::Error,
                                     "Invalid Code \"" + code + "\" in record " +
                                         std::to_string(item.NameRecordNumber) + " of Names.dat",
                                     "Names.dat", item.NameRecordNumber});
            continue;
        }
        struct stat st {};
        bool found = false;
        item.PriceFile = PriceFileOf(folder, code, st, found);
        if (auto issue = PriceFileIssue(item, found, st, result.Issues)) {
            result.Issues.push_back(std::move(*issue));
            continue;
        }
        ++result.Visited;
        if (visit(item) == WalkStep::Stop) {
            result.Stopped = true;
            break;
        }
    }
    return result;
}

} // namespace kori::store
