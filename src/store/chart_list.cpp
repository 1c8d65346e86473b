#include "store/chart_list.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/record_codec.h"
#include "store/record_file.h"

#include <algorithm>
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

Status SaveListFromCodes(std::string_view dataFolder, char letter,
                         const std::vector<std::string>& codes, std::vector<std::string>* dropped) {
    std::vector<NameRecord> names;
    NameFile nf(NameFile::PathIn(dataFolder));
    if (auto s = nf.Open(); !s) return s;
    if (auto s = nf.ReadAll(names); !s) return s;
    std::vector<ChartListEntry> entries;
    for (const auto& line : codes) {
        const std::string code = platform::Trim(line);
        if (code.empty()) continue;
        bool found = false;
        for (std::size_t i = 0; i < names.size() && !found; ++i) {
            if (platform::Trim(names[i].Code) == code) {
                entries.push_back({static_cast<std::int16_t>(i + 1), code});
                found = true;
            }
        }
        if (!found && dropped) dropped->push_back(code);
    }
    return WriteList(ListPath(dataFolder, letter), entries);
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

Status ShowList(std::string_view dataFolder, char letter, std::vector<std::string>& codes) {
    codes.clear();
    const auto path = ListPath(dataFolder, letter);
    if (!platform::FileExists(path))
        if (auto s = WriteList(path, {}); !s) return s;
    std::vector<ChartListEntry> entries;
    if (auto s = ReadList(path, entries); !s) return s;
    for (const auto& e : entries)
        codes.push_back(platform::Trim(e.Code));
    return Status::Ok();
}

std::vector<std::string> StockList(std::string_view dataFolder) {
    std::vector<std::string> codes;
    const auto path = NameFile::PathIn(dataFolder);
    std::vector<NameRecord> names;
    if (!platform::FileExists(path) || !NameFile(path).ReadAll(names)) return codes;
    for (const auto& n : names)
        codes.push_back(platform::Trim(n.Code));
    return codes;
}

std::optional<ImportedCodes> ReadImportFile(const std::filesystem::path& file) {
    const auto content = platform::ReadWholeFile(file);
    if (!content) return std::nullopt;
    ImportedCodes out;
    std::size_t start = 0;
    while (start < content->size()) {
        std::size_t end = content->find_first_of("\r\n", start);
        if (end == std::string::npos) end = content->size();
        const std::string_view line(content->data() + start, end - start);
        const std::string code = platform::Upper(platform::Trim(line));
        if (IsImportableCode(code))
            out.Codes.push_back(code);
        else if (!code.empty())
            out.Refused.emplace_back(line);
        // A line ends at CR, LF or CR LF.
        start = end + 1;
        if (end < content->size() && (*content)[end] == '\r' && start < content->size() &&
            (*content)[start] == '\n')
            ++start;
    }
    return out;
}

std::optional<std::vector<std::string>> ReadImportCodes(const std::filesystem::path& file) {
    auto read = ReadImportFile(file);
    if (!read) return std::nullopt;
    return std::move(read->Codes);
}

std::string RefusedCodesMessage(std::string_view heading, const std::vector<std::string>& refused) {
    constexpr std::size_t kShown = 20; // a long list is cut: the box must fit the screen
    std::string text(heading);
    for (std::size_t i = 0; i < refused.size() && i < kShown; ++i)
        text += "\n" + refused[i];
    if (refused.size() > kShown)
        text += "\n... and " + std::to_string(refused.size() - kShown) + " more";
    return text;
}

std::vector<std::string> ListChoices(const platform::SettingsStore& store, bool withZ) {
    const auto names = GetSubLists(store);
    std::vector<std::string> choices(names.begin(), names.end());
    if (withZ) choices.emplace_back("Chart List Z");
    return choices;
}

int ModeOfChoice(int row) {
    return row >= 0 && row < static_cast<int>(kListLetters.size()) ? row + 2 : 0;
}

int ChoiceOfMode(int listMode) {
    return ListLetterOfMode(listMode) != 0 ? listMode - 2 : -1;
}

Status ChartListBox::Load(std::string_view dataFolder, char letter) {
    m_letter = letter;
    m_changed = false;
    return ShowList(dataFolder, letter, m_codes);
}

Status ChartListBox::Save(std::string_view dataFolder, std::vector<std::string>* dropped) {
    if (m_letter == 0) return Status::Error("No chart list is displayed");
    if (auto s = SaveListFromCodes(dataFolder, m_letter, m_codes, dropped); !s) return s;
    return Load(dataFolder, m_letter);
}

bool ChartListBox::AddIfAbsent(std::string_view code) {
    const std::string c = platform::Trim(code);
    if (std::find(m_codes.begin(), m_codes.end(), c) != m_codes.end()) return false;
    return Add(c);
}

bool ChartListBox::Insert(std::size_t index, std::string_view code) {
    std::string c = platform::Trim(code);
    if (c.empty()) return false;
    m_codes.insert(m_codes.begin() + static_cast<std::ptrdiff_t>(std::min(index, m_codes.size())),
                   std::move(c));
    m_changed = true;
    return true;
}

bool ChartListBox::Remove(std::size_t index) {
    if (index >= m_codes.size()) return false;
    m_codes.erase(m_codes.begin() + static_cast<std::ptrdiff_t>(index));
    m_changed = true;
    return true;
}

void ChartListBox::Clear() {
    if (!m_codes.empty()) m_changed = true;
    m_codes.clear();
}

bool ChartListBox::Move(std::size_t from, std::size_t to) {
    if (from >= m_codes.size() || to >= m_codes.size()) return false;
    if (from == to) return true;
    std::string c = std::move(m_codes[from]);
    m_codes.erase(m_codes.begin() + static_cast<std::ptrdiff_t>(from));
    m_codes.insert(m_codes.begin() + static_cast<std::ptrdiff_t>(to), std::move(c));
    m_changed = true;
    return true;
}

std::string ListChangedQuestion(std::string_view displayName) {
    return std::string(displayName) + " has changed. SAVE Changes?";
}

std::string EmptyListMessage(std::string_view displayName) {
    return " There are no records in " + std::string(displayName) + " for this folder." + "\n" +
           " At Main Menu click EDIT / Edit Chart Lists to create your special interest list";
}

std::string EmptyListTitle(std::string_view dataFolder) {
    return "Chart Lists  " + std::string(dataFolder);
}

} // namespace kori::store
