// kori adjust: a capital issue applied to a security's history, or the latest one taken off,
// by the same rules as the manual adjustment windows.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "adjust/adjustment.h"
#include "app/adjustment_forms.h"
#include "app/window_rules.h"
#include "platform/date_entry.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_file.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <memory>
#include <optional>

namespace kori::cli {

namespace {

using adjust::AdjType;

struct AdjustOptions {
    std::string code;
    std::optional<std::string> bonus, cash, split, call, dividend, date;
    bool remove = false, all = false, json = false;
};

double Number(std::string_view text, std::string_view what) {
    const auto v = app::TypedNumber(text);
    if (!v) throw CliError{std::string(what) + " is not a number: '" + std::string(text) + "'"};
    return *v;
}

platform::Money Currency(std::string_view text, std::string_view what) {
    const auto m = platform::Money::FromDouble(Number(text, what));
    if (!m) throw CliError{std::string(what) + " is out of range: '" + std::string(text) + "'"};
    return *m;
}

// "A:B" into the two ratio terms.
void ReadRatio(std::string_view text, adjust::AdjustmentTerms& t) {
    const auto colon = text.find(':');
    if (colon == std::string_view::npos)
        throw CliError{"A ratio is written A:B, e.g. 1:4: '" + std::string(text) + "'"};
    t.RatioA = static_cast<float>(Number(text.substr(0, colon), "Ratio term A"));
    t.RatioB = static_cast<float>(Number(text.substr(colon + 1), "Ratio term B"));
}

adjust::AdjustmentTerms TermsOf(const AdjustOptions& o) {
    adjust::AdjustmentTerms t;
    int kinds = 0;
    if (o.bonus) {
        ++kinds;
        t.Type = AdjType::Bonus;
        ReadRatio(*o.bonus, t);
    }
    if (o.split) {
        ++kinds;
        t.Type = AdjType::Split;
        ReadRatio(*o.split, t);
    }
    if (o.cash) {
        ++kinds;
        t.Type = AdjType::Cash;
        const auto at = o.cash->find('@');
        if (at == std::string::npos)
            throw CliError{"A cash issue is written A:B@COST, e.g. 1:4@2.10"};
        ReadRatio(std::string_view(*o.cash).substr(0, at), t);
        t.Cost = Currency(std::string_view(*o.cash).substr(at + 1), "Cost per new share");
    }
    if (o.call) {
        ++kinds;
        t.Type = AdjType::Call;
        t.Amount = Currency(*o.call, "Amount of call");
    }
    if (o.dividend) {
        ++kinds;
        t.Type = AdjType::Dividend;
        t.Amount = Currency(*o.dividend, "Dividend amount");
    }
    if (kinds != 1)
        throw CliError{"Give one of --bonus, --cash, --split, --call, --dividend, or --remove"};
    return t;
}

// The security, refused unless it may be adjusted.
std::string AdjustableCode(app::Session& session, const std::string& code) {
    platform::Status why;
    const auto found = store::FindCode(session.folders.DataFolder, code, why);
    if (!why) throw CliError{why.message()};
    if (!found) throw CliError{"No File For That Name"};
    if (found->Record.RecordType <= 3) throw CliError{std::string(adjust::kOnlyTypes4And5)};
    return found->Record.TrimmedCode();
}

json Outcome(const std::string& code, int record, const std::string& date, float factor,
             const std::string& note) {
    return {{"code", code},
            {"record", record},
            {"date", date},
            {"factor", FloatJson(factor)},
            {"note", TextJson(note)}};
}

void Apply(CliContext& ctx, const AdjustOptions& o) {
    auto& session = ctx.OpenSession();
    const auto terms = TermsOf(o);
    if (!o.date) throw CliError{"--date d/m/yy is required"};
    const std::string code = AdjustableCode(session, o.code);
    const auto date = platform::ParseEntryDate(*o.date);
    if (!date.Date) throw CliError{date.Message};

    adjust::DateChoice choice;
    if (auto s =
            adjust::ChooseAdjustmentDate(session.folders.DataFolder, code, date.Date->Text, choice);
        !s)
        throw CliError{s.message()};
    if (choice.Record == 0)
        throw CliError{"No record of " + code + " after its first lies on or before " +
                       date.Date->Shown + ": nothing to adjust"};
    if (!choice.ExactDate) ctx.err << choice.Message << "\n";

    platform::Status why;
    const auto factor = adjust::WorkOutFactor(terms, choice.Close, why);
    if (!factor) throw CliError{why.message()};
    adjust::AdjustmentJob job;
    job.DataFolder = session.folders.DataFolder;
    job.ChtMiscFolder = session.folders.ChtMiscFolder;
    job.Code = code;
    job.AdjRecord = choice.Record;
    job.AdjFactor = factor->Value;
    job.AdjNote = factor->Note;
    job.NoteColour = app::AdjustmentNoteColour(session);
    adjust::Applied applied;
    if (auto s = adjust::ApplyAdjustment(job, applied); !s) throw CliError{s.message()};
    if (o.json) {
        ctx.out << Outcome(code, choice.Record, applied.Date, factor->Value, factor->Note).dump()
                << "\n";
        return;
    }
    ctx.out << "Adjustments made to " << code << ": record " << choice.Record << " ("
            << platform::FormatDate(applied.Date, "d/m/yy") << "), factor "
            << platform::FloatText(factor->Value) << ", " << factor->Note << "\n";
}

void Remove(CliContext& ctx, const AdjustOptions& o) {
    auto& session = ctx.OpenSession();
    const std::string code = AdjustableCode(session, o.code);
    json removedJson = json::array();
    int removedCount = 0;
    while (true) {
        adjust::Removed removed;
        if (auto s = adjust::RemoveLatestAdjustment(session.folders.DataFolder, code, removed); !s)
            throw CliError{s.message()};
        if (removed.Entries == 0) {
            if (removedCount == 0) throw CliError{std::string(adjust::kNotAdjusted)};
            break;
        }
        ++removedCount;
        if (o.json)
            removedJson.push_back(
                Outcome(code, removed.Record, removed.Date, removed.Factor, removed.Note));
        else
            ctx.out << adjust::LatestRemovedText(code) << ": record " << removed.Record << " ("
                    << platform::FormatDate(removed.Date, "d/m/yy") << "), factor "
                    << platform::FloatText(removed.Factor) << ", " << removed.Note << "\n";
        if (!o.all || removed.Entries == 1) break;
    }
    if (o.json) ctx.out << removedJson.dump() << "\n";
}

} // namespace

void AddAdjustCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand(
        "adjust",
        "Adjust a security's history for a capital issue, or remove the latest adjustment");
    auto o = std::make_shared<AdjustOptions>();
    cmd->add_option("CODE", o->code, "Security code (record type 4 or 5)")->required();
    cmd->add_option("--bonus", o->bonus, "Bonus issue: A bonus shares for every B held")
        ->option_text("A:B");
    cmd->add_option("--cash", o->cash, "Cash issue: A new shares for every B held at COST")
        ->option_text("A:B@COST");
    cmd->add_option("--split", o->split, "Share split: A new shares for every B old")
        ->option_text("A:B");
    cmd->add_option("--call", o->call, "Call on contributing shares, per share")
        ->option_text("AMOUNT");
    cmd->add_option("--dividend", o->dividend, "Dividend per share")->option_text("AMOUNT");
    cmd->add_option("--date", o->date, "Last day the adjustment applies to")->option_text("d/m/yy");
    cmd->add_flag("--remove", o->remove, "Remove the latest adjustment");
    cmd->add_flag("--all", o->all, "With --remove: remove every adjustment, newest first");
    cmd->add_flag("--json", o->json, "Print {code, record, date, factor, note}");
    cmd->callback([&ctx, o] {
        if (o->remove) {
            if (o->bonus || o->cash || o->split || o->call || o->dividend || o->date)
                throw CliError{"--remove takes no terms or date"};
            Remove(ctx, *o);
        } else {
            if (o->all) throw CliError{"--all goes with --remove"};
            Apply(ctx, *o);
        }
    });
}

} // namespace kori::cli
