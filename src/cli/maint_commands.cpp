// kori data, kori repair, and the sort and duplicate options of kori names: the editors' and
// the repair tools' rules from the command line. The command itself is the user's yes to the
// tools' questions; their messages are printed, and a refusal ends with a non-zero status.
#include "cli/maint_commands.h"
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "maint/asx_chg.h"
#include "maint/move_files.h"
#include "maint/old_files.h"
#include "maint/rem_date.h"
#include "maint/rem_dup_st.h"
#include "maint/vol_mod.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list_relink.h"
#include "store/data_editor.h"
#include "store/name_editor.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

using platform::Trim;

namespace {

// The tools' messages as the user would have seen them, one a line.
void PrintShown(const platform::ScriptedDialogs& dialogs, std::ostream& to) {
    for (const auto& s : dialogs.shown())
        if (s.kind == "msg") to << Trim(s.text) << "\n";
}

// Warnings the repair met, one a line on the error stream.
void PrintIssues(const platform::Issues& issues, std::ostream& err) {
    for (const auto& i : issues)
        err << "kori: " << (i.severity == platform::Severity::Error ? "error: " : "warning: ")
            << i.text << "\n";
}

// A finished repair prints its messages; a refused one prints them as the error.
void Finish(CliContext& ctx, const platform::ScriptedDialogs& dialogs,
            const maint::RepairResult& r) {
    PrintIssues(r.Issues, ctx.err);
    if (!r.Done) {
        std::ostringstream why;
        PrintShown(dialogs, why);
        std::string text = why.str();
        if (text.empty() && !r.Issues.empty()) text = r.Issues.back().text;
        if (text.empty()) text = r.Cancelled ? "cancelled" : "nothing was done";
        while (!text.empty() && text.back() == '\n')
            text.pop_back();
        throw CliError{text};
    }
    PrintShown(dialogs, ctx.out);
}

std::string RequireFolder(const std::string& folder) {
    const std::string f = platform::FolderWithSlash(folder);
    if (!platform::FileExists(f)) throw CliError{"No folder " + f};
    return f;
}

store::NameSortOrder SortOrderNamed(const std::string& name) {
    if (name == "code") return store::NameSortOrder::Code;
    if (name == "industry") return store::NameSortOrder::Industry;
    if (name == "gics") return store::NameSortOrder::Gics;
    return store::NameSortOrder::Category;
}

} // namespace

void RunNamesMaintenance(CliContext& ctx, app::Session& session, const std::string& sort,
                         bool dedupe) {
    const std::string folder = session.folders.DataFolder;
    store::NameFile file(store::NameFile::PathIn(folder));
    std::vector<store::NameRecord> records;
    if (auto s = file.ReadAll(records); !s) throw CliError{s.message()};
    platform::NullProgress progress;
    std::vector<store::NameRecord> sorted;
    const auto order = dedupe ? store::NameSortOrder::Code : SortOrderNamed(sort);
    if (auto s = store::SortNamesThroughFiles(folder, records, order, progress, sorted); !s)
        throw CliError{s.message()};
    if (dedupe) {
        std::vector<store::TextRow> rows;
        for (std::size_t i = 0; i < sorted.size(); ++i)
            rows.push_back(store::NameRowOf(sorted[i], static_cast<int>(i + 1)));
        const int removed = store::RemoveDuplicateCodes(rows);
        sorted.clear();
        for (const auto& row : rows)
            sorted.push_back(store::NameRecordOf(row));
        ctx.out << removed << store::name_text::kDuplicatesRemoved << "\n";
    }
    for (auto& r : sorted)
        r.Status = 0; // as every save from the editor writes it
    if (auto s = store::SaveNameFile(folder, sorted); !s)
        throw CliError{std::string(store::name_text::kSaveFailed) + ": " + s.message()};
    if (auto relink = store::RelinkChartLists(folder, progress); !relink.Status)
        throw CliError{relink.Status.message()};
}

void AddDataCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd =
        app.add_subcommand("data", "The records of a price file as the data editor shows them");
    struct Options {
        std::string code;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("CODE", o->code, "Security code")->required();
    cmd->add_flag("--json", o->json, "JSON array of the rows");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        if (!store::IsValidCode(Trim(o->code))) throw CliError{"Invalid Code: " + Trim(o->code)};
        const auto path =
            store::PriceFile::PathFor(session.folders.DataFolder, platform::Upper(Trim(o->code)));
        platform::NullProgress progress;
        const auto load = store::LoadDataRows(path, o->code, progress);
        if (!load.Ok) throw CliError{load.Message};
        PrintIssues(load.Issues, ctx.err);
        const auto headers = store::DataGridHeaders();
        if (o->json) {
            json rows = json::array();
            for (const auto& row : load.Rows) {
                json r = json::object();
                for (int c = 0; c < store::kDataShownColumns; ++c)
                    r[headers[static_cast<std::size_t>(c)]] =
                        TextJson(row[static_cast<std::size_t>(c)]);
                rows.push_back(std::move(r));
            }
            ctx.out << rows.dump(2) << "\n";
            return;
        }
        const char* fmt = "%6s  %-8s %10s %10s %10s %10s %11s %10s  %s\n";
        ctx.out << Printf(fmt, "Rec", "Date", "Open", "High", "Low", "Close", "Volume",
                          "Adj.Factor", "Adj.Desc.");
        for (const auto& row : load.Rows)
            ctx.out << Printf(fmt, row[0].c_str(), row[1].c_str(), row[2].c_str(), row[3].c_str(),
                              row[4].c_str(), row[5].c_str(), row[6].c_str(), row[7].c_str(),
                              platform::Latin1ToUtf8(row[8]).c_str());
    });
}

namespace {

void AddCodeChange(CLI::App& repair, CliContext& ctx) {
    auto* cmd =
        repair.add_subcommand("code-change", "A security's code changed: rename or combine");
    auto codes = std::make_shared<std::pair<std::string, std::string>>();
    cmd->add_option("OLD", codes->first, "Old code")->required();
    cmd->add_option("NEW", codes->second, "New code")->required();
    cmd->callback([&ctx, codes] {
        auto& session = ctx.OpenSession();
        platform::ScriptedDialogs dialogs;
        platform::NullProgress progress;
        const auto r = maint::AsxChg(session.folders.DataFolder, codes->first, codes->second,
                                     dialogs, progress);
        Finish(ctx, dialogs, r);
    });
}

void AddRemoveDate(CLI::App& repair, CliContext& ctx) {
    auto* cmd = repair.add_subcommand("remove-date", "Remove a date from every price file");
    struct Options {
        std::string date;
        bool all = false, latest = false;
        std::string folder;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("DATE", o->date, "d/m/yyyy")->required();
    auto* all = cmd->add_flag("--all", o->all, std::string(maint::rem_date_text::kAll));
    auto* latest = cmd->add_flag("--latest", o->latest, std::string(maint::rem_date_text::kLatest));
    all->excludes(latest);
    cmd->add_option("--folder", o->folder, "Data folder (default: the current one)");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        if (!o->all && !o->latest) throw CliError{"Choose --all or --latest"};
        const std::string folder =
            o->folder.empty() ? session.folders.DataFolder : RequireFolder(o->folder);
        platform::ScriptedDialogs dialogs;
        const auto r = maint::RemDate(folder, o->date,
                                      o->all ? maint::RemoveWhich::All : maint::RemoveWhich::Latest,
                                      dialogs, session.services().progress);
        Finish(ctx, dialogs, r);
        ctx.out << r.FilesChanged << " files changed\n";
    });
}

void AddDedupe(CLI::App& repair, CliContext& ctx) {
    auto* cmd = repair.add_subcommand("dedupe", "Sort every price file and remove duplicate dates");
    auto folder = std::make_shared<std::string>();
    cmd->add_option("FOLDER", *folder, "Data folder (default: the current one)");
    cmd->callback([&ctx, folder] {
        auto& session = ctx.OpenSession();
        const std::string f = folder->empty() ? session.folders.DataFolder : RequireFolder(*folder);
        const auto r = maint::RemDupST(f, session.services().progress);
        platform::ScriptedDialogs none;
        Finish(ctx, none, r);
        ctx.out << r.FilesChanged << " files changed\n" << maint::rem_dup_text::kCompleted << "\n";
    });
}

void AddVolumes(CLI::App& repair, CliContext& ctx) {
    auto* cmd = repair.add_subcommand("volumes", "Multiply or divide one item of some records");
    struct Options {
        std::string code, records, item;
        int times = 0, divide = 0;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("CODE", o->code, "Security code")->required();
    cmd->add_option("--records", o->records, "A:B, the records to change")->required();
    auto* t = cmd->add_option("--times", o->times, "Multiply by FACTOR (10, 100, 1000, 10000)");
    auto* d = cmd->add_option("--divide", o->divide, "Divide by FACTOR (10, 100, 1000, 10000)");
    t->excludes(d);
    cmd->add_option("--item", o->item, "OPEN, HIGH, LOW, CLOSE or VOLUME");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const auto item = maint::VolItemNamed(o->item);
        const auto op = o->times    ? maint::VolOp::Multiply
                        : o->divide ? maint::VolOp::Divide
                                    : maint::VolOp::None;
        if (const auto refusal = maint::VolModRefusal(item, op)) throw CliError{*refusal};
        const int factor = o->times ? o->times : o->divide;
        if (std::find(maint::kVolModFactors.begin(), maint::kVolModFactors.end(), factor) ==
            maint::kVolModFactors.end())
            throw CliError{"The factor must be 10, 100, 1000 or 10000"};
        int first = 0, last = 0;
        char tail = 0;
        if (std::sscanf(o->records.c_str(), "%d:%d%c", &first, &last, &tail) != 2)
            throw CliError{"--records takes A:B, the first and last record"};
        if (!store::IsValidCode(Trim(o->code))) throw CliError{"Invalid Code: " + Trim(o->code)};
        const auto path =
            store::PriceFile::PathFor(session.folders.DataFolder, platform::Upper(Trim(o->code)));
        platform::NullProgress progress;
        auto load = store::LoadDataRows(path, o->code, progress);
        if (!load.Ok) throw CliError{load.Message};
        if (first < 1 || last < first || last > static_cast<int>(load.Rows.size()))
            throw CliError{"Records " + std::to_string(first) + " to " + std::to_string(last) +
                           " are not in " + path.filename().string()};
        const int column = store::kDataOpen + static_cast<int>(*item);
        for (int r = first - 1; r < last; ++r) {
            auto& cell = load.Rows[static_cast<std::size_t>(r)][static_cast<std::size_t>(column)];
            if (const auto text = maint::VolModCell(cell, *item, op, factor)) cell = *text;
        }
        if (auto s = store::SaveDataRows(path, load.Rows, progress); !s)
            throw CliError{std::string(store::data_text::kSaveFailed) + ": " + s.message()};
        ctx.out << maint::VolModRangeText(first, last) << "\n";
    });
}

void AddDumpOld(CLI::App& repair, CliContext& ctx) {
    auto* cmd = repair.add_subcommand("dump-old", "Delete the '.Old' files of the data folder");
    cmd->callback([&ctx] {
        auto& session = ctx.OpenSession();
        const std::string folder = session.folders.DataFolder;
        if (maint::OldFiles(folder).empty()) {
            ctx.out << Trim(maint::NoOldFilesMessage(folder)) << "\n";
            return;
        }
        const auto r = maint::DumpOld(folder, session.services().progress);
        PrintIssues(r.Issues, ctx.err);
        if (!r.Issues.empty()) throw CliError{r.Issues.front().text};
        ctx.out << maint::old_text::kCompleted << "\n";
    });
}

void AddWritable(CLI::App& repair, CliContext& ctx) {
    auto* cmd = repair.add_subcommand("writable", "Make the files of a folder writable again");
    auto folder = std::make_shared<std::string>();
    cmd->add_option("FOLDER", *folder, "Folder")->required();
    cmd->callback([&ctx, folder] {
        auto& session = ctx.OpenSession(false);
        const auto r = maint::ResetFA(RequireFolder(*folder), session.services().progress);
        platform::ScriptedDialogs none;
        Finish(ctx, none, r);
        ctx.out << r.FilesChanged << " files made writable\n";
    });
}

void AddMove(CLI::App& repair, CliContext& ctx) {
    auto* cmd = repair.add_subcommand("move", "Move or merge a security into another folder");
    struct Options {
        std::string code, from, to;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("CODE", o->code, "Security code or file name")->required();
    cmd->add_option("--from", o->from, "Source folder")->required();
    cmd->add_option("--to", o->to, "Destination folder")->required();
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession(false);
        platform::ScriptedDialogs dialogs;
        const auto r = maint::MoveFiles(RequireFolder(o->from), RequireFolder(o->to), o->code,
                                        dialogs, session.services().progress);
        Finish(ctx, dialogs, r);
        ctx.out << maint::move_text::kCompleted << "\n";
    });
}

} // namespace

void AddRepairCommand(CLI::App& app, CliContext& ctx) {
    auto* repair = app.add_subcommand("repair", "Data repair tools");
    repair->require_subcommand(1);
    AddCodeChange(*repair, ctx);
    AddRemoveDate(*repair, ctx);
    AddDedupe(*repair, ctx);
    AddVolumes(*repair, ctx);
    AddDumpOld(*repair, ctx);
    AddWritable(*repair, ctx);
    AddMove(*repair, ctx);
}

} // namespace kori::cli
