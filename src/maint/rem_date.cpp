#include "maint/rem_date.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/security_walk.h"

#include <cstdio>

namespace kori::maint {

namespace rt = rem_date_text;
using platform::Trim;

std::optional<std::string> DateToRemove(std::string_view text) {
    const std::string t = Trim(text);
    int d = 0, m = 0, y = 0;
    char tail = 0;
    if (std::sscanf(t.c_str(), "%d/%d/%d%c", &d, &m, &y, &tail) != 3) return std::nullopt;
    if (y < 1000 || y > 9999) return std::nullopt;
    const std::string date = platform::DateText({y, m, d});
    if (!platform::IsValidDateText(date) || m < 1 || m > 12 || d < 1 ||
        d > platform::DaysInMonth(y, m))
        return std::nullopt;
    return date;
}

std::vector<store::PriceRecord> WithoutDate(const std::vector<store::PriceRecord>& records,
                                            std::string_view date, RemoveWhich which) {
    std::vector<store::PriceRecord> out;
    out.reserve(records.size());
    std::size_t latest = records.size();
    if (which == RemoveWhich::Latest)
        for (std::size_t i = records.size(); i-- > 0;)
            if (Trim(records[i].Date) == date) {
                latest = i;
                break;
            }
    for (std::size_t i = 0; i < records.size(); ++i) {
        const bool dated = Trim(records[i].Date) == date;
        if (which == RemoveWhich::All ? dated : i == latest) continue;
        out.push_back(records[i]);
    }
    return out;
}

RepairResult RemDate(std::string_view folderIn, std::string_view ddmmyyyy, RemoveWhich which,
                     platform::Dialogs& dialogs, platform::Progress& progress) {
    RepairResult result;
    const std::string folder = platform::FolderWithSlash(folderIn);
    if (Trim(ddmmyyyy).empty()) {
        dialogs.MsgBox(rt::kDateMissing, rt::kTitle);
        return result;
    }
    const auto date = DateToRemove(ddmmyyyy);
    if (!date) {
        dialogs.MsgBox(rt::kBadDate, rt::kTitle);
        return result;
    }
    if (!FolderWritable(folder)) {
        dialogs.MsgBox(NotWritableMessage(folder), rt::kTitle);
        return result;
    }
    const std::string shown = Trim(ddmmyyyy);
    const auto walk =
        store::ForEachSecurity({folder, 0}, progress, [&](const store::WalkItem& item) {
            progress.SetStatus("Removing " + shown + " from " + item.Name.TrimmedCode());
            store::PriceFile file(item.PriceFile);
            std::vector<store::PriceRecord> records;
            if (auto s = file.ReadAll(records); !s) {
                result.Issues.push_back({platform::Severity::Error, s.message(),
                                         item.PriceFile.filename().string(), 0});
                return store::WalkStep::Continue;
            }
            const auto kept = WithoutDate(records, *date, which);
            if (kept.size() == records.size()) return store::WalkStep::Continue;
            if (auto s = file.WriteAll(kept, {"Temp.Tmp", ""}); !s)
                result.Issues.push_back({platform::Severity::Error, s.message(),
                                         item.PriceFile.filename().string(), 0});
            else
                ++result.FilesChanged;
            return store::WalkStep::Continue;
        });
    if (!walk.Status) {
        dialogs.MsgBox(walk.Status.message(), rt::kTitle);
        return result;
    }
    result.Issues.insert(result.Issues.begin(), walk.Issues.begin(), walk.Issues.end());
    result.Cancelled = walk.Cancelled;
    result.Done = !walk.Cancelled;
    return result;
}

} // namespace kori::maint
