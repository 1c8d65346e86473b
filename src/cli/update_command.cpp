// kori update: the waiting day files of the download folder into the library, as the update
// window does it, with the questions answered from the command line.
#include "cli/cli_context.h"

#include "adjust/adjustment_list.h"
#include "app/adjustment_list_form.h"
#include "app/download_list_form.h"
#include "cli/json_out.h"

#include "intake/check_targets.h"
#include "intake/download_list.h"
#include "intake/download_update.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/targets_file.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <memory>
#include <ostream>

namespace kori::cli {

namespace {

using platform::Answer;
using platform::Buttons;

// Messages go to standard error; an OK/Cancel question is answered OK only when the user said
// --yes beforehand, so a script never changes the library by a default.
class AnsweringDialogs : public platform::Dialogs {
public:
    AnsweringDialogs(std::ostream& err, bool yes) : m_err(err), m_yes(yes) {}
    Answer MsgBox(std::string_view text, std::string_view title, Buttons buttons,
                  platform::Icon) override {
        m_err << platform::Trim(title) << ": " << platform::Trim(text) << "\n";
        switch (buttons) {
        case Buttons::Ok:
            return Answer::Ok;
        case Buttons::OkCancel:
            m_err << (m_yes ? "  (answered OK: --yes)\n" : "  (answered Cancel: no --yes)\n");
            return m_yes ? Answer::Ok : Answer::Cancel;
        case Buttons::YesNo:
        case Buttons::YesNoCancel:
            return m_yes ? Answer::Yes : Answer::No;
        case Buttons::RetryCancel:
            return Answer::Cancel;
        }
        return Answer::Cancel;
    }
    std::optional<std::string> InputBox(std::string_view, std::string_view,
                                        std::string_view) override {
        return std::nullopt;
    }
    void Beep() override {}

private:
    std::ostream& m_err;
    bool m_yes;
};

struct UpdateOptions {
    std::vector<std::string> files;
    bool all = false;
    bool yes = false;
    bool json = false;
};

// The list items to update, in list order.
std::vector<std::string> Chosen(const std::vector<std::string>& waiting, const UpdateOptions& o,
                                const std::string& folder) {
    if (o.files.empty()) {
        if (waiting.empty()) return {};
        return o.all ? waiting : std::vector<std::string>{waiting.front()};
    }
    std::vector<std::string> chosen;
    for (const auto& item : waiting) {
        const bool named = std::any_of(o.files.begin(), o.files.end(), [&](const std::string& f) {
            return platform::EqualsNoCase(std::filesystem::path(f).filename().string(), item);
        });
        if (named) chosen.push_back(item);
    }
    for (const auto& f : o.files) {
        const std::string name = std::filesystem::path(f).filename().string();
        const bool found = std::any_of(waiting.begin(), waiting.end(), [&](const std::string& w) {
            return platform::EqualsNoCase(w, name);
        });
        if (!found) throw CliError{"No waiting day file " + name + " in " + folder};
    }
    return chosen;
}

} // namespace

void AddUpdateCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand(
        "update", "Update the library from the day files waiting in the download folder");
    auto o = std::make_shared<UpdateOptions>();
    cmd->add_option("FILE", o->files, "Waiting day files to update from (default: the oldest)");
    cmd->add_flag("--all", o->all, "Every waiting file, oldest first");
    cmd->add_flag("--yes", o->yes, "Answer OK to the questions (a replace or an insert)");
    cmd->add_flag("--json", o->json, "Report as JSON");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        AnsweringDialogs dialogs(ctx.err, o->yes);
        auto settings = app::UpdateSettingsOf(session);
        const auto waiting = intake::BuildDownloadFileList(
            settings.DownloadFolder, settings.DataService, session.download.InternetDLfmt, dialogs);
        const auto chosen = Chosen(waiting, *o, settings.DownloadFolder);
        intake::UpdateHost host{dialogs, session.services().progress, &session.services().settings,
                                &session.ini()};
        bool listHasNewItems = false;
        intake::UpdateHooks hooks = app::UpdateHooksOf(session);
        hooks.UpdateAdjustmentsList =
            app::AdjustmentHooks(session, listHasNewItems).UpdateAdjustmentsList;
        const std::string today = session.services().clock.Today();

        json files = json::array();
        bool cancelled = false, failed = false, updated = false;
        std::string targetFolder = settings.DataFolder;
        for (std::size_t i = 0; i < chosen.size() && !failed; ++i) {
            const bool more = i + 1 < chosen.size();
            const auto r =
                intake::RunDownloadUpdate(settings, host, hooks, chosen[i],
                                          intake::UpdateDateFromItem(chosen[i], today), more);
            for (const auto& f : r.Files) {
                cancelled = cancelled || f.State == intake::FileState::Cancelled;
                files.push_back(
                    {{"file", f.File},
                     {"segment", platform::Trim(f.Segment)},
                     {"state", std::string(intake::StateName(f.State))},
                     {"records", f.Records},
                     {"new_securities", f.NewSecurities},
                     {"fillers", f.Fillers},
                     {"renamed_to", f.RenamedTo.empty() ? json(nullptr) : json(f.RenamedTo)}});
                if (!o->json)
                    ctx.out << f.File << (f.Segment.empty() ? "" : " " + platform::Trim(f.Segment))
                            << ": " << intake::StateName(f.State) << ", " << f.Records
                            << " records, " << f.NewSecurities << " new securities, " << f.Fillers
                            << " fillers"
                            << (f.RenamedTo.empty() ? "" : ", renamed to " + f.RenamedTo) << "\n";
            }
            failed = r.Failed || r.Stopped;
            updated = updated || std::any_of(r.Files.begin(), r.Files.end(),
                                             [](const auto& f) { return f.Records > 0; });
            targetFolder = r.CurrentDataFolder;
        }
        // The targets are tested once the day's prices are in.
        json alerts = json::array();
        if (updated && !failed) {
            for (const auto& a : intake::CheckTargets(
                     store::TargetsFilePath(session.folders.SystemFolder), targetFolder)) {
                alerts.push_back(a);
                if (!o->json) ctx.out << a << "\n";
            }
        }
        if (listHasNewItems && !o->json) ctx.out << adjust::kItemsAdded << "\n";
        if (o->json)
            ctx.out << json{{"files", files},
                            {"alerts", alerts},
                            {"adjustment_list_grew", listHasNewItems}}
                           .dump()
                    << "\n";
        if (failed) throw CliError{"the update stopped; the files above are whole", 1};
        if (cancelled)
            throw CliError{o->yes ? "a file was not updated and stays waiting"
                                  : "a file was not updated and stays waiting (use --yes to "
                                    "answer OK)",
                           3};
    });
}

} // namespace kori::cli
