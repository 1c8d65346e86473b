// kori watchlist: the watchlists of the install root, one list's rows, and changes to them.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "platform/date_text.h"
#include "platform/text.h"
#include "scan/watchlist.h"
#include "store/targets_file.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

namespace {

json RowJson(const scan::WatchRow& r) {
    const auto number = [](std::optional<double> v) { return v ? json(*v) : json(); };
    const auto text = [](const std::string& s) { return s.empty() ? json() : TextJson(s); };
    return {{"code", TextJson(r.Entry.Code)},
            {"name", text(r.Name)},
            {"last_date", text(r.Date)},
            {"close", number(r.Close)},
            {"change", number(r.Change)},
            {"change_pct", number(r.ChangePercent)},
            {"volume_ratio", number(r.VolumeRatio)},
            {"entry_date", text(r.Entry.EntryDate)},
            {"entry_price", number(r.Entry.EntryPrice)},
            {"quantity", number(r.Entry.Quantity)},
            {"since_entry", number(r.SinceEntry)},
            {"since_entry_pct", number(r.SinceEntryPercent)},
            {"value", number(r.Value)},
            {"high_52w", number(r.YearHigh)},
            {"low_52w", number(r.YearLow)},
            {"target", text(r.Target)},
            {"note", text(r.Entry.Note)},
            {"problem", text(r.Problem)}};
}

void PrintRows(std::ostream& out, const std::vector<scan::WatchRow>& rows) {
    out << Printf("%-6s %-10s %9s %8s %7s %9s %8s %10s %9s %9s  %s\n", "Code", "Date", "Close",
                  "Change%", "Vol/Av", "Entry", "Since%", "Value", "52wHigh", "52wLow",
                  "Target / Note");
    for (const auto& r : rows) {
        const auto c = scan::WatchCells(r);
        const auto dash = [](const std::string& s) { return s.empty() ? std::string("-") : s; };
        std::string tail = r.Target;
        for (const auto* extra : {&r.Entry.Note, &r.Problem})
            if (!extra->empty()) tail += (tail.empty() ? "" : "; ") + *extra;
        out << Printf(
            "%-6s %-10s %9s %8s %7s %9s %8s %10s %9s %9s  %s\n", c[scan::kWatchCode].c_str(),
            dash(c[scan::kWatchDate]).c_str(), dash(c[scan::kWatchClose]).c_str(),
            dash(c[scan::kWatchChangePercent]).c_str(), dash(c[scan::kWatchVolumeRatio]).c_str(),
            dash(c[scan::kWatchEntryPrice]).c_str(), dash(c[scan::kWatchSinceEntryPercent]).c_str(),
            dash(c[scan::kWatchValue]).c_str(), dash(c[scan::kWatchHigh]).c_str(),
            dash(c[scan::kWatchLow]).c_str(), tail.c_str());
    }
}

} // namespace

void AddWatchlistCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("watchlist", "The watchlists, or one list's rows worked out");
    struct Options {
        std::string name;
        std::vector<std::string> add, remove;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("NAME", o->name, "The list to show or change");
    cmd->add_option("--add", o->add, "CODE or CODE@PRICE into the list (made when missing)");
    cmd->add_option("--remove", o->remove, "CODE out of the list");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const auto file = scan::WatchlistBook::PathIn(session.folders.SystemFolder);
        platform::Issues issues;
        auto book = scan::WatchlistBook::Read(file, issues);
        for (const auto& i : issues)
            ctx.err << i.file << " line " << i.record << ": " << i.text << "\n";
        if (o->name.empty()) {
            if (!o->add.empty() || !o->remove.empty())
                throw CliError{"Name the watchlist to change"};
            json lists = json::array();
            for (const auto& l : book.Lists) {
                if (o->json)
                    lists.push_back({{"name", TextJson(l.Name)}, {"count", l.Entries.size()}});
                else
                    ctx.out << l.Name << " (" << l.Entries.size() << ")\n";
            }
            if (o->json) ctx.out << lists.dump(2) << "\n";
            return;
        }
        if (!o->add.empty() || !o->remove.empty()) {
            if (!book.Find(o->name) && !o->add.empty())
                if (auto s = book.AddList(o->name); !s) throw CliError{s.message()};
            for (const auto& a : o->add) {
                scan::WatchEntry entry;
                if (auto s = scan::ParseWatchAdd(a, entry); !s) throw CliError{s.message()};
                if (auto s = book.AddEntry(o->name, entry); !s) throw CliError{s.message()};
            }
            for (const auto& r : o->remove)
                if (auto s = book.RemoveEntry(o->name, r); !s) throw CliError{s.message()};
            if (auto s = book.Write(file); !s) throw CliError{s.message()};
        }
        const auto* list = book.Find(o->name);
        if (!list) throw CliError{"No watchlist named " + platform::Trim(o->name)};
        const auto rows = scan::ComputeWatchlist(
            *list, session.folders.DataFolder,
            store::ReadTargetsFile(store::TargetsFilePath(session.folders.SystemFolder)),
            scan::SnapshotSettingsFrom(session.ini()));
        if (o->json) {
            json out = json::array();
            for (const auto& r : rows)
                out.push_back(RowJson(r));
            ctx.out << out.dump(2) << "\n";
        } else {
            PrintRows(ctx.out, rows);
        }
    });
}

} // namespace kori::cli
