#include "store/chart_list_relink.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/name_file.h"

#include <unordered_map>

namespace kori::store {

using platform::Status;

namespace {
bool Same(const std::vector<ChartListEntry>& a, const std::vector<ChartListEntry>& b) {
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if (a[i].NameRecord != b[i].NameRecord || a[i].Code != b[i].Code) return false;
    return true;
}
} // namespace

RelinkResult RelinkChartLists(std::string_view dataFolder, platform::Progress& progress) {
    RelinkResult result;
    std::vector<NameRecord> names;
    NameFile nameFile(NameFile::PathIn(dataFolder));
    if (platform::FileExists(nameFile.path()))
        if (result.Status = nameFile.ReadAll(names); !result.Status) return result;
    if (names.size() < 2) return result;

    // The first record of each six-character code, as a search from record 1 finds it.
    std::unordered_map<std::string, std::int16_t> firstOf;
    for (std::size_t i = names.size(); i-- > 0;)
        firstOf[platform::PadRight(names[i].Code, 6)] = static_cast<std::int16_t>(i + 1);

    progress.SetStatus(kRelinkStatus);
    for (std::size_t li = 0; li + 1 < kListLetters.size(); ++li) { // A to K, not Z
        progress.Yield();
        if (progress.Cancelled()) {
            result.Cancelled = true;
            break;
        }
        const auto path = ListPath(dataFolder, kListLetters[li]);
        if (!platform::FileExists(path)) continue;
        std::vector<ChartListEntry> entries;
        if (result.Status = ReadList(path, entries); !result.Status) return result;
        if (entries.empty()) continue;
        // Long lists move the bar by entry; short ones show it full.
        progress.SetRange(entries.size() > 2 ? static_cast<long long>(entries.size()) : 1);
        std::vector<ChartListEntry> kept;
        for (std::size_t e = 0; e < entries.size(); ++e) {
            if (entries.size() > 2) progress.SetValue(static_cast<long long>(e + 1));
            ChartListEntry entry = entries[e];
            entry.NameRecord = 0;
            if (const auto it = firstOf.find(platform::PadRight(entry.Code, 6));
                it != firstOf.end())
                entry.NameRecord = it->second;
            if (entry.NameRecord > 0) kept.push_back(entry);
        }
        if (entries.size() <= 2) progress.SetValue(1);
        if (kept.empty() || Same(kept, entries)) continue;
        RecordFile<ChartListEntry> list(path);
        if (result.Status = list.WriteAll(kept, {"SubList.tmp", ""}); !result.Status) return result;
        ++result.ListsRewritten;
    }
    return result;
}

} // namespace kori::store
