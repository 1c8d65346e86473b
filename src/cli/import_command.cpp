// kori import: a CSV history into one security, or a folder of day files for a first load.
#include "cli/cli_context.h"

#include "intake/csv_import.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

void AddImportCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand(
        "import", "Import a CSV price history (FILE --code CODE) or a folder of day files");
    struct Options {
        std::string file, code, name, dayFiles;
        int type = 4;
        bool replace = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("FILE", o->file,
                    "CSV file with a header row (Date, Open, High, Low, Close, Volume)");
    cmd->add_option("--code", o->code, "Security code the CSV history is for");
    cmd->add_option("--name", o->name, "Name of a security new to the name file");
    cmd->add_option("--type", o->type, "Record type of a new security (1 to 5)")
        ->check(CLI::Range(1, 5));
    cmd->add_flag("--replace", o->replace, "Days already on file take the imported figures");
    cmd->add_option("--day-files", o->dayFiles,
                    "Folder of day files (code,date,open,high,low,close,vol,spare)");
    cmd->callback([&ctx, o] {
        if (o->dayFiles.empty() == o->file.empty())
            throw CliError{"Give either a CSV FILE with --code, or --day-files DIR"};
        if (!o->file.empty() && o->code.empty()) throw CliError{"A CSV history needs --code CODE"};
        auto& session = ctx.OpenSession();
        const auto report =
            o->file.empty()
                ? intake::ImportDayFiles(o->dayFiles, session.folders.DataFolder, o->replace)
                : intake::ImportCsvFile(
                      o->file, session.folders.DataFolder,
                      {o->code, o->name, static_cast<std::int16_t>(o->type), o->replace});
        if (!report.Ok) throw CliError{report.Message};
        ctx.out << report.Message << "\n";
    });
}

} // namespace kori::cli
