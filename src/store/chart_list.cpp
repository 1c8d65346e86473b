#include "store/chart_list.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/record_codec.h"
#include "store/record_file.h"

#include <cctype>

namespace kori::store {

using namespace codec;
using platform::Status;

std::array<char, ChartListEntry::kSize> ChartListEntry::Encode() const {
    std::array<char, kSize> b{};
    Put(b.data(), NameRecord);
    PutText(b.data() + 2, Code, 6);
    return b;
}

ChartListEntry ChartListEntry::Decode(const char* p) {
    ChartListEntry e;
    e.NameRecord = Get<std::int16_t>(p);
    e.Code = GetText(p + 2, 6);
    return e;
}

char ListLetterOfMode(int listMode) {
    if (listMode < 2 || listMode > 12) return 0;
    return kListLetters[static_cast<std::size_t>(listMode - 2)];
}

std::filesystem::path ListPath(std::string_view dataFolder, char letter) {
    return platform::ResolveIn(dataFolder, std::string("SubList") + letter + ".Dat");
}

Status ReadList(const std::filesystem::path& path, std::vector<ChartListEntry>& out) {
    return RecordFile<ChartListEntry>(path).ReadAll(out);
}

Status WriteList(const std::filesystem::path& path, const std::vector<ChartListEntry>& entries) {
    return RecordFile<ChartListEntry>(path).WriteAll(entries);
}

std::array<std::string, 10> GetSubLists(const platform::SettingsStore& store) {
    std::array<std::string, 10> names;
    for (std::size_t i = 0; i < names.size(); ++i) {
        const std::string letter(1, kListLetters[i]);
        names[i] = store.Get("SubList" + letter, "Chart List " + letter);
    }
    return names;
}

void SaveSLNames(platform::SettingsStore& store, const std::array<std::string, 10>& names) {
    for (std::size_t i = 0; i < names.size(); ++i)
        store.Save("SubList" + std::string(1, kListLetters[i]), platform::Trim(names[i]));
}

Status SaveListFromCodes(std::string_view dataFolder, char letter, const std::vector<std::string>& codes) {
    std::vector<NameRecord> names;
    NameFile nf(NameFile::PathIn(dataFolder));
    if (auto s = nf.Open(); !s) return s;
    if (auto s = nf.ReadAll(names); !s) return s;
    std::vector<ChartListEntry> entries;
    for (const auto& line : codes) {
        const std::string code = platform::Trim(line);
        if (code.empty()) continue;
        for (std::size_t i = 0; i < names.size(); ++i) {
            if (platform::Trim(names[i].Code) == code) {
                entries.push_back({static_cast<std::int16_t>(i + 1), code});
                break;
            }
        }
    }
    return WriteList(ListPath(dataFolder, letter), entries);
}

int RelinkLists(std::string_view dataFolder, platform::Progress& progress) {
    std::vector<NameRecord> names;
    NameFile nf(NameFile::PathIn(dataFolder));
    if (!nf.Open() || nf.Count() < 2 || !nf.ReadAll(names)) return 0;
    int rewritten = 0;
    progress.SetStatus("Checking SubLists");
    for (std::size_t l = 0; l + 1 < kListLetters.size(); ++l) { // A..K, not Z
        if (progress.Cancelled()) break;
        progress.Yield();
        const auto path = ListPath(dataFolder, kListLetters[l]);
        if (!platform::FileExists(path)) continue;
        std::vector<ChartListEntry> entries;
        if (!ReadList(path, entries) || entries.empty()) continue;
        progress.SetRange(entries.size() > 2 ? static_cast<long long>(entries.size()) : 1);
        std::vector<ChartListEntry> kept;
        for (std::size_t e = 0; e < entries.size(); ++e) {
            ChartListEntry entry = entries[e];
            entry.NameRecord = 0;
            const std::string wanted = platform::PadRight(entry.Code, 6);
            for (std::size_t i = 0; i < names.size(); ++i) {
                if (platform::PadRight(names[i].Code, 6) == wanted) {
                    entry.NameRecord = static_cast<std::int16_t>(i + 1);
                    break;
                }
            }
            if (entry.NameRecord > 0) kept.push_back(entry);
            if (entries.size() > 2) progress.SetValue(static_cast<long long>(e + 1));
        }
        // A list that lost every entry keeps its stale entries.
        if (!kept.empty() && WriteList(path, kept)) ++rewritten;
    }
    return rewritten;
}

bool IsImportableCode(std::string_view line) {
    if (line.empty() || line.size() > 6) return false;
    for (char c : line)
        if (!std::isalnum(static_cast<unsigned char>(c))) return false;
    return true;
}

Status BuildTmpNames(std::string_view dataFolder, std::string_view listFileName) {
    const auto tmp = platform::ResolveIn(dataFolder, "TmpNames.tmp");
    std::string out;
    const auto list = platform::ResolveIn(dataFolder, listFileName);
    std::vector<ChartListEntry> entries;
    std::vector<NameRecord> names;
    NameFile nf(NameFile::PathIn(dataFolder));
    if (platform::FileExists(list) && ReadList(list, entries) && !entries.empty() && nf.Open() &&
        nf.ReadAll(names)) {
        for (const auto& e : entries) {
            // The list's number is trusted; its code is not compared.
            if (e.NameRecord < 1 || static_cast<std::size_t>(e.NameRecord) > names.size()) continue;
            NameRecord r = names[static_cast<std::size_t>(e.NameRecord - 1)];
            r.Base = static_cast<float>(e.NameRecord);
            const auto b = r.Encode();
            out.append(b.data(), b.size());
        }
    }
    return platform::WriteFileAtomic(tmp, out);
}

std::string EmptyListMessage(std::string_view displayName) {
    return " There are no records in " + std::string(displayName) + " for this folder." + "\n" +
           " At Main Menu click EDIT / Edit Chart Lists to create your special interest list";
}

std::string EmptyListTitle(std::string_view dataFolder) {
    return "Chart Lists  " + std::string(dataFolder);
}

} // namespace kori::store
