#include "scan/watchlist.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <algorithm>
#include <cstdio>
#include <unordered_map>

namespace kori::scan {

namespace {

std::string Key(std::string_view name) {
    return platform::Upper(platform::Trim(name));
}

// Shortest plain text of a figure the user typed ("45.2", "100").
std::string NumberText(double v) {
    char text[32];
    std::snprintf(text, sizeof text, "%.10g", v);
    return text;
}

platform::Status CheckNumber(std::string_view text, const char* what, std::optional<double>& out) {
    const auto t = platform::Trim(text);
    if (t.empty()) {
        out.reset();
        return platform::Status::Ok();
    }
    if (!platform::IsNumber(t) || platform::Val(t) < 0)
        return platform::Status::Error("The " + std::string(what) + " \"" + t +
                                       "\" is not a number of 0 or more");
    out = platform::Val(t);
    return platform::Status::Ok();
}

platform::Status CheckName(std::string_view name) {
    const auto t = platform::Trim(name);
    if (t.empty()) return platform::Status::Error("A watchlist needs a name");
    if (t.size() > kMaxWatchlistName)
        return platform::Status::Error("A watchlist name has at most " +
                                       std::to_string(kMaxWatchlistName) + " characters");
    if (t.find_first_of("[]\r\n") != std::string::npos)
        return platform::Status::Error("A watchlist name cannot hold [ ] or a line break");
    return platform::Status::Ok();
}

std::vector<std::string> SplitRow(std::string_view line) {
    // Four fields at commas, the note the rest of the line.
    std::vector<std::string> fields;
    std::size_t from = 0;
    while (fields.size() < 4) {
        const auto comma = line.find(',', from);
        if (comma == std::string_view::npos) break;
        fields.emplace_back(line.substr(from, comma - from));
        from = comma + 1;
    }
    fields.emplace_back(line.substr(from));
    fields.resize(5);
    return fields;
}

std::optional<double> Difference(std::optional<double> a, std::optional<double> b) {
    if (!a || !b) return std::nullopt;
    return *a - *b;
}

} // namespace

platform::Status CheckWatchEntry(WatchEntry& e) {
    e.Code = platform::Upper(platform::Trim(e.Code));
    if (!store::IsValidCode(e.Code))
        return platform::Status::Error("\"" + e.Code + "\" is not a security code");
    e.EntryDate = platform::Trim(e.EntryDate);
    if (!e.EntryDate.empty() && !platform::IsValidDateText(e.EntryDate))
        return platform::Status::Error("The entry date \"" + e.EntryDate +
                                       "\" is not a date yyyymmdd");
    if (e.EntryPrice && *e.EntryPrice < 0)
        return platform::Status::Error("The entry price cannot be below 0");
    if (e.Quantity && *e.Quantity < 0)
        return platform::Status::Error("The quantity cannot be below 0");
    if (e.Note.find_first_of("\r\n") != std::string::npos)
        return platform::Status::Error("A note cannot hold a line break");
    return platform::Status::Ok();
}

platform::Status ParseWatchAdd(std::string_view text, WatchEntry& entry) {
    entry = {};
    const auto at = text.find('@');
    entry.Code = std::string(text.substr(0, at));
    if (at != std::string_view::npos) {
        if (auto s = CheckNumber(text.substr(at + 1), "entry price", entry.EntryPrice); !s)
            return s;
        if (!entry.EntryPrice)
            return platform::Status::Error("No price after @ in \"" + std::string(text) + "\"");
    }
    return CheckWatchEntry(entry);
}

std::filesystem::path WatchlistBook::PathIn(std::string_view systemFolder) {
    return platform::ResolveIn(systemFolder, kWatchlistsFile);
}

WatchlistBook WatchlistBook::Read(const std::filesystem::path& file, platform::Issues& issues) {
    if (!platform::FileExists(file)) return {};
    const auto text = platform::ReadWholeFile(file);
    if (!text) {
        issues.push_back(
            {platform::Severity::Error, "Cannot read the watchlists", file.filename().string(), 0});
        return {};
    }
    return Parse(*text, file.filename().string(), issues);
}

WatchlistBook WatchlistBook::Parse(std::string_view text, const std::string& fileName,
                                   platform::Issues& issues) {
    WatchlistBook book;
    Watchlist* current = nullptr;
    bool skipping = false; // inside a list that was refused: its rows go with it
    int number = 0;
    std::size_t from = 0;
    const auto bad = [&](std::string why) {
        issues.push_back({platform::Severity::Warning, std::move(why), fileName, number});
    };
    while (from <= text.size()) {
        auto end = text.find('\n', from);
        if (end == std::string_view::npos) end = text.size();
        std::string line(text.substr(from, end - from));
        from = end + 1;
        ++number;
        if (!line.empty() && line.back() == '\r') line.pop_back();
        const auto trimmed = platform::Trim(line);
        if (trimmed.empty() || trimmed[0] == '#') {
            if (end == text.size()) break;
            continue;
        }
        if (trimmed.front() == '[') {
            current = nullptr;
            skipping = true;
            const auto name = trimmed.size() >= 2 && trimmed.back() == ']'
                                  ? trimmed.substr(1, trimmed.size() - 2)
                                  : std::string("[");
            if (auto s = book.AddList(name); !s)
                bad(s.message() + ": the list and its rows are left out");
            else {
                current = &book.Lists.back();
                skipping = false;
            }
        } else if (!current) {
            if (!skipping) bad("A row before the first [list name] is left out");
        } else {
            auto f = SplitRow(line);
            WatchEntry e{f[0], f[1], std::nullopt, std::nullopt, f[4]};
            auto s = CheckNumber(f[2], "entry price", e.EntryPrice);
            if (s) s = CheckNumber(f[3], "quantity", e.Quantity);
            if (s) s = CheckWatchEntry(e);
            if (!s)
                bad(s.message() + ": the row is left out");
            else
                current->Entries.push_back(std::move(e));
        }
        if (end == text.size()) break;
    }
    return book;
}

std::string WatchlistBook::Text() const {
    std::string out = "# KORI Charting watchlists: [list name], then one row a line:\n"
                      "# code,entry date yyyymmdd,entry price,quantity,note\n";
    for (const auto& list : Lists) {
        out += "[" + list.Name + "]\n";
        for (const auto& e : list.Entries) {
            out += e.Code + "," + e.EntryDate + "," +
                   (e.EntryPrice ? NumberText(*e.EntryPrice) : "") + "," +
                   (e.Quantity ? NumberText(*e.Quantity) : "") + "," + e.Note + "\n";
        }
    }
    return out;
}

platform::Status WatchlistBook::Write(const std::filesystem::path& file) const {
    return platform::WriteFileAtomic(file, Text());
}

Watchlist* WatchlistBook::Find(std::string_view name) {
    const auto key = Key(name);
    for (auto& l : Lists)
        if (Key(l.Name) == key) return &l;
    return nullptr;
}

const Watchlist* WatchlistBook::Find(std::string_view name) const {
    return const_cast<WatchlistBook*>(this)->Find(name);
}

platform::Status WatchlistBook::AddList(std::string_view name) {
    if (auto s = CheckName(name); !s) return s;
    const auto t = platform::Trim(name);
    if (Find(t)) return platform::Status::Error("There is already a watchlist named " + t);
    if (static_cast<int>(Lists.size()) >= kMaxWatchlists)
        return platform::Status::Error("There can be no more than " +
                                       std::to_string(kMaxWatchlists) +
                                       " watchlists: delete one to make room for " + t);
    Lists.push_back({t, {}});
    return platform::Status::Ok();
}

platform::Status WatchlistBook::RenameList(std::string_view from, std::string_view to) {
    auto* list = Find(from);
    if (!list) return platform::Status::Error("No watchlist named " + platform::Trim(from));
    if (auto s = CheckName(to); !s) return s;
    const auto t = platform::Trim(to);
    if (auto* other = Find(t); other && other != list)
        return platform::Status::Error("There is already a watchlist named " + t);
    list->Name = t;
    return platform::Status::Ok();
}

platform::Status WatchlistBook::DeleteList(std::string_view name) {
    auto* list = Find(name);
    if (!list) return platform::Status::Error("No watchlist named " + platform::Trim(name));
    Lists.erase(Lists.begin() + (list - Lists.data()));
    return platform::Status::Ok();
}

platform::Status WatchlistBook::AddEntry(std::string_view listName, WatchEntry entry) {
    auto* list = Find(listName);
    if (!list) return platform::Status::Error("No watchlist named " + platform::Trim(listName));
    if (auto s = CheckWatchEntry(entry); !s) return s;
    for (const auto& e : list->Entries)
        if (e.Code == entry.Code)
            return platform::Status::Error(entry.Code + " is already in " + list->Name);
    list->Entries.push_back(std::move(entry));
    return platform::Status::Ok();
}

platform::Status WatchlistBook::RemoveEntry(std::string_view listName, std::string_view code) {
    auto* list = Find(listName);
    if (!list) return platform::Status::Error("No watchlist named " + platform::Trim(listName));
    const auto key = Key(code);
    auto& entries = list->Entries;
    const auto it =
        std::find_if(entries.begin(), entries.end(), [&](const auto& e) { return e.Code == key; });
    if (it == entries.end()) return platform::Status::Error(key + " is not in " + list->Name);
    entries.erase(it);
    return platform::Status::Ok();
}

std::vector<WatchRow> ComputeWatchlist(const Watchlist& list, std::string_view dataFolder,
                                       const std::vector<store::TargetLine>& targets,
                                       const SnapshotSettings& settings) {
    // The name file read once; the first record of a code wins, as in every lookup.
    std::vector<store::NameRecord> names;
    std::unordered_map<std::string, const store::NameRecord*> byCode;
    if (store::NameFile(store::NameFile::PathIn(dataFolder)).ReadAll(names))
        for (const auto& n : names)
            byCode.emplace(store::PadCode(n.TrimmedCode()), &n);

    std::vector<WatchRow> rows;
    rows.reserve(list.Entries.size());
    std::string bytes;
    for (const auto& entry : list.Entries) {
        WatchRow row;
        row.Entry = entry;
        const auto padded = store::PadCode(entry.Code);
        store::NameRecord name;
        if (const auto it = byCode.find(padded); it != byCode.end()) {
            name = *it->second;
            row.Name = platform::Trim(name.Name);
        } else {
            name.Code = platform::Trim(padded);
            row.Problem = "not in the name file";
        }
        const auto path = store::PriceFile::PathFor(dataFolder, platform::Trim(padded));
        std::int16_t count = 0;
        if (path.empty() || !platform::FileHasData(path) ||
            !store::CountRecords(path, store::PriceRecord::kSize, count) || count < 1) {
            row.Problem = row.Problem.empty() ? "no price file" : row.Problem + ", no price file";
            rows.push_back(std::move(row));
            continue;
        }
        const int first = std::max(1, count - kSnapshotRecords + 1);
        std::optional<SnapshotRow> day;
        if (store::ReadPriceRecords(path, first, count, bytes))
            day = SnapshotOf(name, bytes, first, settings);
        if (!day) {
            row.Problem =
                row.Problem.empty() ? "no traded price" : row.Problem + ", no traded price";
            rows.push_back(std::move(row));
            continue;
        }
        row.Date = day->Date;
        row.Close = day->Close;
        row.Change = day->Change;
        row.ChangePercent = day->ChangePercent;
        row.VolumeRatio = day->VolumeRatio;
        row.YearHigh = day->YearHigh;
        row.YearLow = day->YearLow;
        row.SinceEntry = Difference(row.Close, entry.EntryPrice);
        if (row.SinceEntry && *entry.EntryPrice > 0)
            row.SinceEntryPercent = *row.SinceEntry / *entry.EntryPrice * 100;
        if (entry.Quantity) row.Value = *entry.Quantity * *row.Close;
        // The targets are tested on the file's last record, as the alerts after an update are.
        const auto last =
            store::PriceRecord::Decode(bytes.data() + bytes.size() - store::PriceRecord::kSize);
        for (const auto& t : targets) {
            if (store::PadCode(t.Code) != padded) continue;
            const auto outcome = store::TargetOutcome(t, last);
            if (outcome.empty()) continue;
            if (!row.Target.empty()) row.Target += "; ";
            row.Target += platform::Trim(t.Target) + " " + outcome;
        }
        rows.push_back(std::move(row));
    }
    return rows;
}

std::vector<std::string> WatchHeaders() {
    return {"Code",    "Name",       "Date",        "Close",    "Change",      "Change %",
            "Vol/Avg", "Entry Date", "Entry Price", "Quantity", "Since Entry", "Since Entry %",
            "Value",   "52-Wk High", "52-Wk Low",   "Target",   "Note"};
}

namespace {

std::string Cell(std::optional<double> v, const char* format) {
    return v ? platform::Format(*v, format) : std::string();
}

std::optional<double> Figure(const WatchRow& r, int column) {
    switch (column) {
    case kWatchClose:
        return r.Close;
    case kWatchChange:
        return r.Change;
    case kWatchChangePercent:
        return r.ChangePercent;
    case kWatchVolumeRatio:
        return r.VolumeRatio;
    case kWatchEntryPrice:
        return r.Entry.EntryPrice;
    case kWatchQuantity:
        return r.Entry.Quantity;
    case kWatchSinceEntry:
        return r.SinceEntry;
    case kWatchSinceEntryPercent:
        return r.SinceEntryPercent;
    case kWatchValue:
        return r.Value;
    case kWatchHigh:
        return r.YearHigh;
    case kWatchLow:
        return r.YearLow;
    default:
        return std::nullopt;
    }
}

const std::string& Text(const WatchRow& r, int column) {
    switch (column) {
    case kWatchCode:
        return r.Entry.Code;
    case kWatchName:
        return r.Name;
    case kWatchDate:
        return r.Date;
    case kWatchEntryDate:
        return r.Entry.EntryDate;
    case kWatchTarget:
        return r.Target;
    default:
        return r.Entry.Note;
    }
}

bool IsFigure(int column) {
    return column == kWatchClose || column == kWatchChange || column == kWatchChangePercent ||
           column == kWatchVolumeRatio || column == kWatchEntryPrice || column == kWatchQuantity ||
           column == kWatchSinceEntry || column == kWatchSinceEntryPercent ||
           column == kWatchValue || column == kWatchHigh || column == kWatchLow;
}

std::string ShownDate(const std::string& date) {
    return platform::IsValidDateText(date) ? platform::DateTextToDisplay(date) : date;
}

} // namespace

std::vector<std::string> WatchCells(const WatchRow& r) {
    return {r.Entry.Code,
            r.Problem.empty() ? r.Name
                              : (r.Name.empty() ? "" : r.Name + " ") + "(" + r.Problem + ")",
            ShownDate(r.Date),
            Cell(r.Close, "0.000"),
            Cell(r.Change, "0.000"),
            Cell(r.ChangePercent, "0.00"),
            Cell(r.VolumeRatio, "0.00"),
            ShownDate(r.Entry.EntryDate),
            Cell(r.Entry.EntryPrice, "0.000"),
            Cell(r.Entry.Quantity, "0"),
            Cell(r.SinceEntry, "0.000"),
            Cell(r.SinceEntryPercent, "0.00"),
            Cell(r.Value, "0.00"),
            Cell(r.YearHigh, "0.000"),
            Cell(r.YearLow, "0.000"),
            r.Target,
            r.Entry.Note};
}

void SortWatchRows(std::vector<WatchRow>& rows, int column, bool ascending) {
    if (column < 0 || column >= kWatchColumns) return;
    if (IsFigure(column)) {
        std::stable_sort(rows.begin(), rows.end(), [&](const auto& a, const auto& b) {
            const auto x = Figure(a, column), y = Figure(b, column);
            if (!x || !y) return x.has_value() && !y.has_value();
            return ascending ? *x < *y : *y < *x;
        });
        return;
    }
    std::stable_sort(rows.begin(), rows.end(), [&](const auto& a, const auto& b) {
        const auto &x = Text(a, column), &y = Text(b, column);
        if (x.empty() || y.empty()) return !x.empty() && y.empty();
        return ascending ? x < y : y < x;
    });
}

std::string WatchCsv(const std::vector<WatchRow>& rows) {
    const auto line = [](const std::vector<std::string>& cells) {
        std::string out;
        for (std::size_t i = 0; i < cells.size(); ++i) {
            if (i > 0) out += ",";
            std::string c = cells[i];
            if (c.find_first_of(",\"") != std::string::npos) {
                std::string q = "\"";
                for (char ch : c)
                    q += ch == '"' ? std::string("\"\"") : std::string(1, ch);
                c = q + "\"";
            }
            out += c;
        }
        return out + "\n";
    };
    std::string out = line(WatchHeaders());
    for (const auto& r : rows)
        out += line(WatchCells(r));
    return out;
}

} // namespace kori::scan
