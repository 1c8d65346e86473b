// kori backup / kori restore: the library to one archive and back, as the window does it.
#include "cli/cli_context.h"

#include "app/backup_form.h"
#include "maint/backup.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

void AddBackupCommands(CLI::App& app, CliContext& ctx) {
    auto* backup = app.add_subcommand("backup", "Back up the whole library to one archive");
    auto to = std::make_shared<std::string>();
    backup
        ->add_option("--to", *to,
                     "The archive to write (default: a new file in the back-up "
                     "folder, keeping the newest back-ups there)")
        ->option_text("FILE");
    backup->callback([&ctx, to] {
        auto& session = ctx.OpenSession();
        app::BackupForm form(session);
        maint::BackupResult result;
        std::string message;
        if (to->empty()) {
            message = form.Backup(session.services().progress, &result);
        } else {
            result = maint::WriteBackup(form.Places(), *to, session.services().progress);
            message = result.Status ? std::to_string(result.Files) + " files backed up to " + *to
                                    : result.Status.message();
        }
        if (!result.Status) throw CliError{message};
        if (result.Cancelled) throw CliError{message, 3};
        ctx.out << message << "\n";
    });

    auto* restore = app.add_subcommand(
        "restore", "Check a back-up and restore the library from it (the replaced files are "
                   "kept beside)");
    struct Options {
        std::string file;
        bool verifyOnly = false;
    };
    auto o = std::make_shared<Options>();
    restore->add_option("FILE", o->file, "The back-up archive")->required();
    restore->add_flag("--verify-only", o->verifyOnly,
                      "Only check every file against the manifest; change nothing");
    restore->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        auto& progress = session.services().progress;
        if (o->verifyOnly) {
            const auto plan = maint::VerifyBackup(o->file, progress);
            if (!plan.Status) throw CliError{plan.Status.message()};
            if (plan.Cancelled) throw CliError{"Check cancelled", 3};
            ctx.out << o->file << " is whole: " << plan.Files << " files match their checksums\n";
            return;
        }
        const auto result = maint::RestoreBackup(o->file, progress, app::BackupForm::NowStamp());
        if (!result.Status)
            throw CliError{result.Status.message() + ". The library was not changed."};
        if (result.Cancelled) throw CliError{"Restore cancelled: the library was not changed", 3};
        ctx.out << result.Files << " files restored from " << o->file << "\n";
        for (const auto& kept : result.Replaced)
            ctx.out << "Replaced files kept in " << kept << "\n";
    });
}

} // namespace kori::cli
