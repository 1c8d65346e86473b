#include "store/master_list.h"

#include "platform/files.h"
#include "platform/text.h"

namespace kori::store {

using platform::Trim;

std::optional<std::vector<std::string>> ReadMasterRecords(std::string_view systemFolder) {
    const auto bytes = platform::ReadWholeFile(platform::ResolveIn(systemFolder, kMasterFile));
    if (!bytes) return std::nullopt;
    std::vector<std::string> records;
    for (std::size_t at = 0; at + kMasterRecord <= bytes->size(); at += kMasterRecord) {
        std::string record = bytes->substr(at, kMasterRecord);
        while (!record.empty() && (record.back() == '\n' || record.back() == '\r'))
            record.pop_back();
        records.push_back(platform::TrimRight(record));
    }
    return records;
}

MasterEntry ParseMasterRecord(std::string_view record) {
    const std::string text = Trim(record);
    const auto blank = text.find(' ');
    MasterEntry e;
    e.Code = platform::Upper(text.substr(0, blank == std::string::npos ? text.size() : blank));
    if (blank != std::string::npos) e.Name = Trim(text.substr(blank));
    return e;
}

std::map<std::string, std::string> MasterNames(const std::vector<std::string>& records) {
    std::map<std::string, std::string> names;
    for (const auto& r : records)
        if (auto e = ParseMasterRecord(r); !e.Code.empty())
            names.emplace(std::move(e.Code), std::move(e.Name));
    return names;
}

} // namespace kori::store
