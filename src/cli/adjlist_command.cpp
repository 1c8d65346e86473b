// kori adjlist: the maintenance list of the library, a day's bulletins filtered into it, and
// the marked items carried out, by the same rules as the AdjList window.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "adjust/adjustment_list.h"
#include "app/adjustment_list_form.h"
#include "platform/text.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <memory>
#include <optional>

namespace kori::cli {

namespace {

struct AdjListOptions {
    std::optional<std::string> bulletins;
    bool apply = false, json = false;
};

// The download program's folders; outside services 1 and 3 they are read here all the same, so
// that a library fed otherwise can still take its bulletins from the command line.
std::string DownloadFolderKey(app::Session& session, const std::string& read, const char* key) {
    if (!platform::Trim(read).empty()) return read;
    return platform::Trim(session.ini().Read("Download", key));
}

json ItemJson(const adjust::ListItem& item) {
    json fields = json::array();
    for (const auto& f : item.Fields)
        fields.push_back(TextJson(f));
    return {{"act", TextJson(item.Action())},
            {"code", TextJson(item.Code())},
            {"adj", TextJson(item.Indicator())},
            {"fields", fields}};
}

void Show(CliContext& ctx, app::Session& session, bool asJson) {
    std::vector<adjust::ListItem> items;
    if (auto st = adjust::ReadAdjustmentList(app::AdjustmentListFolder(session), items); !st)
        throw CliError{st.message()};
    if (asJson) {
        json all = json::array();
        for (const auto& i : items)
            all.push_back(ItemJson(i));
        ctx.out << all.dump() << "\n";
        return;
    }
    if (items.empty()) {
        ctx.out << app::kNoBulletinData << "\n";
        return;
    }
    for (const auto& i : items)
        ctx.out << i.Line() << "\n";
}

void Bulletins(CliContext& ctx, app::Session& session, const std::string& stem, bool asJson) {
    auto settings = app::ListSettingsOf(session);
    settings.In = DownloadFolderKey(session, settings.In, "In");
    settings.Out = DownloadFolderKey(session, settings.Out, "Out");
    adjust::ListUpdate u;
    if (auto st =
            adjust::UpdateAdjustmentsList(app::AdjustmentListFolder(session), platform::Upper(stem),
                                          settings, session.services().progress, u);
        !st)
        throw CliError{st.message()};
    if (asJson) {
        ctx.out << json{{"bulletins", u.BulletinsFiltered},
                        {"lines_added", u.LinesAdded},
                        {"trimmed", u.Trimmed}}
                       .dump()
                << "\n";
        return;
    }
    ctx.out << u.BulletinsFiltered << " bulletins filtered, " << u.LinesAdded << " items added to "
            << adjust::kListFile << "\n";
    if (u.NewItems) ctx.out << adjust::kItemsAdded << "\n";
}

void Apply(CliContext& ctx, app::Session& session, bool asJson) {
    app::AdjustmentListForm form(session);
    if (!form.Load()) throw CliError{"the data folders are not defined"};
    adjust::MakeReport report;
    const auto st = form.Make(report, {});
    if (asJson) {
        json messages = json::array();
        for (const auto& m : report.Messages)
            messages.push_back(TextJson(m));
        ctx.out << json{{"messages", messages},
                        {"items_run", report.ItemsRun},
                        {"items_removed", report.ItemsRemoved},
                        {"items_left", form.items().size()},
                        {"name_file_compacted", report.NameFileCompacted}}
                       .dump()
                << "\n";
    } else {
        for (const auto& m : report.Messages)
            ctx.out << m << "\n";
        ctx.out << report.ItemsRun << " items carried out, " << form.items().size()
                << " left in the list\n";
    }
    if (!st)
        throw CliError{st.message() + "; the list is as it was: run kori adjlist --apply again "
                                      "to finish"};
}

} // namespace

void AddAdjListCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand(
        "adjlist", "Show the maintenance list, fill it from a day's bulletins, or carry it out");
    auto o = std::make_shared<AdjListOptions>();
    cmd->add_option("--bulletins", o->bulletins,
                    "Filter the bulletins of the day DDMMMYY from the In folder into the list")
        ->option_text("DATESTEM");
    cmd->add_flag("--apply", o->apply, "Carry out the items marked Y (MAKE ADJUSTMENTS)");
    cmd->add_flag("--json", o->json, "Report as JSON");
    cmd->callback([&ctx, o] {
        if (o->bulletins && o->apply) throw CliError{"Give --bulletins or --apply, not both"};
        auto& session = ctx.OpenSession();
        if (o->bulletins) {
            if (o->bulletins->size() != 7 || adjust::ListDate(*o->bulletins).empty())
                throw CliError{"A bulletin day is written DDMMMYY, e.g. 23NOV26: '" +
                               *o->bulletins + "'"};
            Bulletins(ctx, session, *o->bulletins, o->json);
        } else if (o->apply) {
            Apply(ctx, session, o->json);
        } else {
            Show(ctx, session, o->json);
        }
    });
}

} // namespace kori::cli
