// kori export: closing prices of a day, or the records of a security or a list, as text.
#include "cli/cli_context.h"

#include "maint/text_export.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

namespace {

char ListLetter(const std::string& list) {
    const std::string l = platform::Upper(list);
    return l.empty() || l == "FULL" ? '\0' : l[0];
}

CLI::Option* AddListOption(CLI::App* cmd, std::string& list) {
    return cmd->add_option("--list", list, "full (the name file) or a chart list A..K, Z")
        ->check(CLI::IsMember({"full", "A", "B", "C", "D", "E", "F", "G", "H", "I", "J", "K", "Z"},
                              CLI::ignore_case));
}

void CheckDate(const std::string& date, const char* what) {
    if (!date.empty() && !platform::IsValidDateText(date))
        throw CliError{std::string(what) + " must be a date yyyymmdd: " + date};
}

// The text to -o FILE (written beside and renamed) or to standard output.
void Deliver(CliContext& ctx, const std::string& text, const std::string& file) {
    if (file.empty() || file == "-") {
        ctx.out << text;
        return;
    }
    if (auto s = platform::WriteFileAtomic(file, text); !s) throw CliError{s.message()};
}

void AddClosesCommand(CLI::App* parent, CliContext& ctx) {
    struct Options {
        std::string date, list = "full", output;
    };
    auto o = std::make_shared<Options>();
    auto* cmd = parent->add_subcommand("closes", "Closing prices of one day, one line a security");
    cmd->add_option("--date", o->date, "The day, yyyymmdd (default: the latest)");
    AddListOption(cmd, o->list);
    cmd->add_option("-o,--output", o->output, "File to write (default: standard output)");
    cmd->callback([&ctx, o] {
        CheckDate(o->date, "--date");
        auto& session = ctx.OpenSession();
        const store::SecurityList list{session.folders.DataFolder, ListLetter(o->list)};
        const auto r = maint::ExportCloses(list, o->date, session.services().progress);
        if (!r.Status) throw CliError{r.Status.message()};
        if (r.Cancelled) throw CliError{"Export cancelled", 3};
        Deliver(ctx, r.Csv, o->output);
        if (!o->output.empty())
            ctx.err << r.Lines << " closing prices of " << platform::DateTextToDisplay(r.Date)
                    << " written to " << o->output << "\n";
    });
}

void AddDataCommand(CLI::App* parent, CliContext& ctx) {
    struct Options {
        std::string code, list, from, to, format = "csv", output;
    };
    auto o = std::make_shared<Options>();
    auto* cmd = parent->add_subcommand("data", "The records of a security or of a list");
    cmd->add_option("CODE", o->code, "Security code");
    AddListOption(cmd, o->list)->excludes(cmd->get_option("CODE"));
    cmd->add_option("--from", o->from, "First day, yyyymmdd");
    cmd->add_option("--to", o->to, "Last day, yyyymmdd");
    cmd->add_option("--format", o->format, "csv, or day: one day file a date in a folder")
        ->check(CLI::IsMember({"csv", "day"}));
    cmd->add_option("-o,--output", o->output,
                    "File to write (csv, default standard output) or folder (day)");
    cmd->callback([&ctx, o] {
        if (o->code.empty() == o->list.empty()) throw CliError{"Name a security CODE or a --list"};
        CheckDate(o->from, "--from");
        CheckDate(o->to, "--to");
        if (o->format == "day" && o->output.empty())
            throw CliError{"Day files need a folder: -o DIR"};
        auto& session = ctx.OpenSession();
        const store::SecurityList list{session.folders.DataFolder, ListLetter(o->list)};
        const auto r = maint::ExportData(list, o->code, {o->from, o->to}, o->format == "day",
                                         session.services().progress);
        if (!r.Status) throw CliError{r.Status.message()};
        for (const auto& issue : r.Skipped)
            ctx.err << "kori: " << issue.text << "\n";
        if (r.Cancelled) throw CliError{"Export cancelled", 3};
        if (o->format == "day") {
            std::vector<std::string> written;
            if (auto s = r.Days.WriteTo(o->output, &written); !s) throw CliError{s.message()};
            ctx.err << written.size() << " day files written to " << o->output << "\n";
            return;
        }
        Deliver(ctx, r.Csv, o->output);
    });
}

} // namespace

void AddExportCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("export", "Text files of closing prices or of data");
    cmd->require_subcommand(1);
    AddClosesCommand(cmd, ctx);
    AddDataCommand(cmd, ctx);
}

} // namespace kori::cli
