#include "store/security_walk.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"

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

// Why a price file cannot be walked, as an issue; nullopt when it can. A length that is not a
// whole number of records is reported and the whole records are still read.
std::optional<Issue> PriceFileIssue(WalkItem& item, platform::Issues& issues) {
    const std::string name = item.PriceFile.filename().string();
    // One look at the file: the walk meets thousands of them.
    std::error_code ec;
    const auto status = std::filesystem::status(item.PriceFile, ec);
    if (ec || !std::filesystem::exists(status))
        return Issue{Severity::Warning, "No price file " + name, name, 0};
    const auto size = std::filesystem::is_regular_file(status)
                          ? std::filesystem::file_size(item.PriceFile, ec)
                          : std::uintmax_t{0};
    if (ec || size == 0) return Issue{Severity::Warning, name + " holds no records", name, 0};
    const auto records = size / PriceRecord::kSize;
    if (records > static_cast<std::uintmax_t>(kMaxRecords))
        return Issue{Severity::Error,
                     name + " holds " + std::to_string(records) +
                         " records; a file can hold at most 32767.",
                     name, 0};
    item.PriceRecords = static_cast<std::int16_t>(records);
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
    progress.SetRange(count);
    for (int i = 0; i < count; ++i) {
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
        item.PriceFile = PriceFile::PathFor(list.DataFolder, code);
        if (auto issue = PriceFileIssue(item, result.Issues)) {
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
