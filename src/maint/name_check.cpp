#include "maint/name_check.h"

#include "platform/text.h"
#include "store/chart_list_relink.h"
#include "store/name_editor.h"
#include "store/name_file.h"
#include "store/name_record.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <set>
#include <system_error>

namespace kori::maint {

namespace fs = std::filesystem;
using platform::Status;

namespace {

struct FolderState {
    platform::Status Status;
    std::vector<store::NameRecord> Records;
    std::map<std::string, std::string> PriceFiles; // upper-case base name -> file name
};

FolderState ReadFolder(std::string_view dataFolder) {
    FolderState state;
    const auto namePath = store::NameFile::PathIn(dataFolder);
    std::error_code ec;
    if (!fs::exists(namePath, ec)) {
        state.Status = Status::Error("No name file in " + std::string(dataFolder));
        return state;
    }
    store::NameFile names(namePath);
    if (auto s = names.Open(); !s) {
        state.Status = s;
        return state;
    }
    if (auto s = names.ReadAll(state.Records); !s) {
        state.Status = s;
        return state;
    }
    for (fs::directory_iterator it(fs::path(std::string(dataFolder)), ec), end; !ec && it != end;
         it.increment(ec)) {
        if (!it->is_regular_file(ec)) continue;
        const fs::path& p = it->path();
        if (platform::Upper(p.extension().string()) != ".WDT") continue;
        state.PriceFiles.emplace(platform::Upper(p.stem().string()), p.filename().string());
    }
    if (ec) state.Status = Status::Error("Cannot read the folder " + std::string(dataFolder));
    return state;
}

std::string UpperCode(const store::NameRecord& r) {
    return platform::Upper(r.TrimmedCode());
}

bool HasPriceFile(const FolderState& state, const store::NameRecord& r) {
    return store::IsValidCode(r.Code) && state.PriceFiles.count(UpperCode(r)) > 0;
}

} // namespace

int NameCheckResult::Count(std::string_view what) const {
    return static_cast<int>(std::count_if(Findings.begin(), Findings.end(),
                                          [&](const auto& f) { return f.What == what; }));
}

NameCheckResult CheckNameFile(std::string_view dataFolder) {
    NameCheckResult result;
    const FolderState state = ReadFolder(dataFolder);
    if (!state.Status) {
        result.Status = state.Status;
        return result;
    }
    result.Records = static_cast<int>(state.Records.size());
    result.PriceFiles = static_cast<int>(state.PriceFiles.size());
    std::map<std::string, int> firstRecord;
    std::set<std::string> named;
    for (std::size_t i = 0; i < state.Records.size(); ++i) {
        const auto& r = state.Records[i];
        if (r.Status == 1) continue;
        const int number = static_cast<int>(i) + 1;
        const std::string code = r.TrimmedCode();
        const std::string upper = platform::Upper(code);
        named.insert(upper);
        if (code != upper)
            result.Findings.push_back(
                {code, number, std::string(name_finding::NotUpperCase), "Upper case is " + upper});
        if (auto [at, fresh] = firstRecord.emplace(upper, number); !fresh)
            result.Findings.push_back({code, number, std::string(name_finding::Duplicated),
                                       "Also record " + std::to_string(at->second)});
        if (!HasPriceFile(state, r))
            result.Findings.push_back(
                {code, number, std::string(name_finding::NoPriceFile),
                 code.empty() ? std::string("The code is blank") : code + ".WDT is missing"});
    }
    for (const auto& [upper, file] : state.PriceFiles) {
        if (named.count(upper) > 0) continue;
        const std::string stem = fs::path(file).stem().string();
        result.Findings.push_back(
            {stem, 0, std::string(name_finding::NoNameRecord),
             store::IsValidCode(stem) ? file
                                      : file + ": the name is too long for a code of six letters"});
    }
    return result;
}

NameFixResult FixNameFile(std::string_view dataFolder, bool addMissing, bool removeWithoutData,
                          platform::Progress& progress) {
    NameFixResult result;
    const FolderState state = ReadFolder(dataFolder);
    if (!state.Status) {
        result.Status = state.Status;
        return result;
    }
    std::vector<store::NameRecord> kept;
    std::set<std::string> named;
    bool dropped = false;
    for (const auto& r : state.Records) {
        if (r.Status == 1) {
            dropped = true;
            continue;
        }
        if (removeWithoutData && !HasPriceFile(state, r)) {
            ++result.Removed;
            continue;
        }
        named.insert(UpperCode(r));
        kept.push_back(r);
    }
    if (addMissing) {
        for (const auto& [upper, file] : state.PriceFiles) {
            if (named.count(upper) > 0 || !store::IsValidCode(upper)) continue;
            if (kept.size() >= static_cast<std::size_t>(store::kMaxRecords)) {
                result.Status =
                    Status::Error("The name file is full: " + std::to_string(store::kMaxRecords) +
                                  " records. Nothing was changed.");
                result.Added = result.Removed = 0;
                return result;
            }
            store::NameRecord r;
            r.Code = store::PadCode(upper);
            r.RecordType = 4;
            kept.push_back(r);
            ++result.Added;
        }
    }
    if (result.Added == 0 && result.Removed == 0 && !dropped) return result;
    if (auto s = store::SaveNameFile(dataFolder, kept); !s) {
        result.Status = s;
        result.Added = result.Removed = 0;
        return result;
    }
    if (auto relink = store::RelinkChartLists(dataFolder, progress); !relink.Status)
        result.Status = relink.Status;
    return result;
}

} // namespace kori::maint
