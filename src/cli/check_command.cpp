// kori check: the data check over a chart list, the name file or another data folder.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "maint/data_check.h"
#include "maint/name_check.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <memory>

namespace kori::cli {

namespace {

struct CheckOptions {
    std::string list = "full";
    std::string folder;
    std::optional<int> gap;
    std::optional<int> stopped;
    std::optional<double> move;
    bool json = false;
    bool csv = false;
};

store::SecurityList ListToCheck(const CheckOptions& o, const app::Session& session) {
    store::SecurityList list{session.folders.DataFolder, 0};
    if (!o.folder.empty()) {
        list.DataFolder = o.folder;
        if (list.DataFolder.back() != '/') list.DataFolder += '/';
    }
    if (platform::Upper(o.list) != "FULL") list.Letter = platform::Upper(o.list)[0];
    if (!platform::FileExists(store::NameFile::PathIn(list.DataFolder)))
        throw CliError{"No name file in " + list.DataFolder};
    return list;
}

} // namespace

void AddCheckCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("check",
                                   "Check the data for errors and securities that stopped trading");
    auto o = std::make_shared<CheckOptions>();
    cmd->add_option("--list", o->list, "full (the name file) or a chart list A..K, Z")
        ->check(CLI::IsMember({"full", "A", "B", "C", "D", "E", "F", "G", "H", "I", "J", "K", "Z"},
                              CLI::ignore_case));
    cmd->add_option("--folder", o->folder, "Another data folder to check (its whole name file)")
        ->option_text("DIR");
    cmd->add_option("--gap", o->gap, "Weekdays without a record that count as a gap")
        ->check(CLI::Range(1, 9999));
    cmd->add_option("--stopped", o->stopped,
                    "Weekdays behind the library's latest date that count as stopped")
        ->check(CLI::Range(1, 9999));
    cmd->add_option("--move", o->move, "Overnight move in per cent that needs an adjustment")
        ->check(CLI::Range(1.0, 10000.0));
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->add_flag("--csv", o->csv, "The report as CSV");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const auto list = ListToCheck(*o, session);
        auto settings = maint::LoadDataCheckSettings(session.services().settings);
        if (o->gap) settings.GapWeekdays = *o->gap;
        if (o->stopped) settings.StoppedWeekdays = *o->stopped;
        if (o->move) settings.MoveAlertPercent = *o->move;
        const auto result = maint::CheckLibrary(list, settings, session.services().progress);
        if (!result.Status) throw CliError{result.Status.message()};
        if (o->csv) {
            ctx.out << maint::FindingsCsv(result.Findings);
        } else if (o->json) {
            json rows = json::array();
            for (const auto& f : result.Findings)
                rows.push_back({{"code", TextJson(f.Code)},
                                {"name", TextJson(f.Name)},
                                {"date", TextJson(f.Date)},
                                {"record", f.Record},
                                {"finding", f.What},
                                {"detail", TextJson(f.Detail)}});
            json out = {{"checked", result.Checked},
                        {"latest_date", result.LatestDate},
                        {"cancelled", result.Cancelled},
                        {"findings", rows}};
            ctx.out << out.dump(2) << "\n";
        } else {
            for (const auto& f : result.Findings)
                ctx.out << Printf(
                    "%-6s %-10s %6d  %-30s %s\n", f.Code.c_str(),
                    (f.Date.empty() ? "" : platform::DateTextToDisplay(f.Date)).c_str(), f.Record,
                    f.What.c_str(), f.Detail.c_str());
            ctx.out << Printf("%d securities checked, %zu findings\n", result.Checked,
                              result.Findings.size());
        }
        if (result.Cancelled) throw CliError{"Check cancelled", 3};
    });
}

// kori check-names: the name file against the price files of the data folder, and the two
// remedies of the window after it.
void AddCheckNamesCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("check-names",
                                   "Check the name file against the price files of the folder");
    struct Options {
        bool fix = false;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_flag("--fix", o->fix,
                  "Add name records for price files without one (type 4, name blank) and remove "
                  "entries without a price file");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const std::string folder = session.folders.DataFolder;
        auto result = maint::CheckNameFile(folder);
        if (!result.Status) throw CliError{result.Status.message()};
        maint::NameFixResult fixed;
        if (o->fix) {
            fixed = maint::FixNameFile(folder, true, true, session.services().progress);
            if (!fixed.Status) throw CliError{fixed.Status.message()};
        }
        if (o->json) {
            json rows = json::array();
            for (const auto& f : result.Findings)
                rows.push_back({{"code", TextJson(f.Code)},
                                {"record", f.Record},
                                {"finding", f.What},
                                {"detail", TextJson(f.Detail)}});
            json out = {{"records", result.Records},
                        {"price_files", result.PriceFiles},
                        {"findings", rows}};
            if (o->fix) out["fixed"] = {{"added", fixed.Added}, {"removed", fixed.Removed}};
            ctx.out << out.dump(2) << "\n";
            return;
        }
        for (const auto& f : result.Findings)
            ctx.out << Printf("%-8s %6d  %-24s %s\n", f.Code.c_str(), f.Record, f.What.c_str(),
                              f.Detail.c_str());
        ctx.out << Printf("%d name records, %d price files, %zu findings\n", result.Records,
                          result.PriceFiles, result.Findings.size());
        if (o->fix)
            ctx.out << Printf("%d name records added, %d entries without data removed\n",
                              fixed.Added, fixed.Removed);
    });
}

} // namespace kori::cli
