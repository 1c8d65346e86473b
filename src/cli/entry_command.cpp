// kori entry: one day's figures typed on the command line, with the checks of keyboard entry.
#include "cli/cli_context.h"

#include "intake/keyboard_entry.h"
#include "platform/date_entry.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

void AddEntryCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand(
        "entry", "Append one day's figures to a security's price file, as keyboard entry does");
    struct Options {
        std::string code, date;
        std::optional<std::string> open, high, low, close, volume, rises, falls, total;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("CODE", o->code, "Security code")->required();
    cmd->add_option("--date", o->date, "Date as d/m/yy (or d/m/yyyy, or with -)")->required();
    cmd->add_option("--open", o->open, "Open");
    cmd->add_option("--high", o->high, "High");
    cmd->add_option("--low", o->low, "Low");
    cmd->add_option("--close", o->close, "Close");
    cmd->add_option("--volume", o->volume, "Volume in shares");
    cmd->add_option("--rises", o->rises, "Advances (advance-decline series, record type 3)");
    cmd->add_option("--falls", o->falls, "Declines (record type 3)");
    cmd->add_option("--total", o->total, "Cumulative total (record type 3)");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        platform::Status why;
        const auto found = store::FindCode(session.folders.DataFolder, o->code, why);
        if (!why) throw CliError{why.message()};
        if (!found) throw CliError{"No File For That Name: " + platform::Trim(o->code)};
        const auto& name = found->Record;
        const bool advanceDecline = name.RecordType == 3;
        const bool adOptions = o->rises || o->falls || o->total;
        const bool priceOptions = o->open || o->high || o->low || o->close || o->volume;
        if (advanceDecline && priceOptions)
            throw CliError{name.TrimmedCode() +
                           " is an advance-decline series: give --rises, --falls and --total"};
        if (!advanceDecline && adOptions)
            throw CliError{"--rises, --falls and --total are for advance-decline series; " +
                           name.TrimmedCode() + " takes --open, --high, --low, --close"};
        intake::KeyedDay day;
        day.Date = o->date;
        if (advanceDecline) {
            day.High = o->rises.value_or("");
            day.Low = o->falls.value_or("");
            day.Close = o->total.value_or("");
        } else {
            day.Open = o->open.value_or("");
            day.High = o->high.value_or("");
            day.Low = o->low.value_or("");
            day.Close = o->close.value_or("");
            day.Volume = o->volume.value_or("");
        }
        const auto r = intake::SaveKeyedDay(session.folders.DataFolder, name, day);
        if (!r.Saved) throw CliError{platform::Trim(r.Refusal.Title) + ": " + r.Refusal.Message};
        ctx.out << name.TrimmedCode() << ": record " << r.RecordNumber << " written for "
                << platform::DateTextToEntry(r.Record.Date) << "\n";
    });
}

} // namespace kori::cli
