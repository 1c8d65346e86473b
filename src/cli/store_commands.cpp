// kori names, kori bars, kori lists: the library as text and JSON.
#include "cli/cli_context.h"
#include "cli/json_out.h"
#include "cli/maint_commands.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"
#include "store/load_chart_series.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <cstdio>
#include <iostream>
#include <memory>

namespace kori::cli {

using platform::Trim;

namespace {

std::vector<store::NameRecord> ReadNames(app::Session& session) {
    store::NameFile nf(store::NameFile::PathIn(session.folders.DataFolder));
    if (!platform::FileExists(nf.path()))
        throw CliError{"No name file in " + session.folders.DataFolder};
    std::vector<store::NameRecord> names;
    if (auto st = nf.ReadAll(names); !st) throw CliError{st.message()};
    return names;
}

} // namespace

void AddNamesCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("names", "List the securities of the name file");
    auto asJson = std::make_shared<bool>(false);
    auto codes = std::make_shared<bool>(false);
    cmd->add_flag("--json", *asJson, "JSON array of the name records");
    cmd->add_flag("--codes", *codes, "One code a line");
    auto sort = std::make_shared<std::string>();
    auto dedupe = std::make_shared<bool>(false);
    cmd->add_option("--sort", *sort, "Sort and save the file first")
        ->check(CLI::IsMember({"code", "category", "industry", "gics"}));
    cmd->add_flag("--dedupe", *dedupe,
                  "Sort by code and remove duplicate codes, saving the file first");
    cmd->callback([&ctx, asJson, codes, sort, dedupe] {
        auto& session = ctx.OpenSession();
        if (!sort->empty() || *dedupe) {
            (void)ReadNames(session); // no name file: say so
            RunNamesMaintenance(ctx, session, *sort, *dedupe);
        }
        const auto names = ReadNames(session);
        if (*codes) {
            for (const auto& n : names)
                ctx.out << n.TrimmedCode() << "\n";
            return;
        }
        if (*asJson) {
            json out = json::array();
            int rec = 0;
            for (const auto& n : names) {
                out.push_back({{"record", ++rec},
                               {"status", n.Status},
                               {"code", TextJson(n.Code)},
                               {"type", n.RecordType},
                               {"name", TextJson(n.Name)},
                               {"other_details", TextJson(n.OtherDetails)},
                               {"base", FloatJson(n.Base)},
                               {"top", FloatJson(n.Top)},
                               {"pf_increment", FloatJson(n.PFIncrement)},
                               {"scale_step", FloatJson(n.ScaleStep)},
                               {"percent_band_up", n.PercentBandUp},
                               {"percent_band_down", n.PercentBandDown},
                               {"bollinger_period", n.BollingerPeriod},
                               {"bollinger_width", n.BollingerWidth},
                               {"category", n.Category},
                               {"id", TextJson(n.Id)},
                               {"industry_class", TextJson(n.IndustryClass)},
                               {"gics_sector", TextJson(n.GicsSector)}});
            }
            ctx.out << out.dump(2) << "\n";
            return;
        }
        ctx.out << Printf("%5s  %-6s %4s  %-35s %-4s %-5s\n", "Rec", "Code", "Type", "Name", "Cat.",
                          "Class");
        int rec = 0;
        for (const auto& n : names)
            ctx.out << Printf("%5d  %-6s %4d  %-35s %4d %-5s\n", ++rec, n.TrimmedCode().c_str(),
                              n.RecordType, Trim(n.Name).c_str(), n.Category,
                              Trim(n.IndustryClass).c_str());
        ctx.out << Printf("%d securities in %s\n", rec, session.folders.DataFolder.c_str());
    });
}

void AddBarsCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("bars", "Chart bars of a security as the chart loads them");
    struct Options {
        std::string code;
        std::string period = "A";
        int first = 1;
        int last = 0;
        bool noVolume = false;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("CODE", o->code, "Security code")->required();
    cmd->add_option("--period", o->period, "A daily, W weekly, M monthly")
        ->check(CLI::IsMember({"A", "W", "M"}));
    cmd->add_option("--first", o->first, "First record (1-based)");
    cmd->add_option("--last", o->last, "Last record (default: the record count)");
    cmd->add_flag("--no-volume", o->noVolume, "Load without volumes");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        (void)ReadNames(session); // no name file: say so
        platform::Status why;
        const auto found = store::FindCode(session.folders.DataFolder, o->code, why);
        if (!why) throw CliError{why.message()};
        if (!found) throw CliError{"No File For That Name: " + Trim(o->code)};
        const store::NameRecord* rec = &found->Record;
        const auto path = store::PriceFile::PathFor(session.folders.DataFolder, rec->Code);
        store::PriceFile pf(path);
        if (auto st = pf.OpenWithData(); !st) throw CliError{st.message()};
        store::SeriesRequest q;
        if (auto st = store::SetRecordRange(q, o->first, o->last > 0 ? o->last : 0, pf.Count(),
                                            path.filename().string());
            !st)
            throw CliError{st.message()};
        q.Period = o->period[0];
        q.WantVolume = !o->noVolume;
        q.RecordType = rec->RecordType;
        store::ChartSeries s;
        if (auto st = store::LoadChartSeries(path.string(), q, s); !st)
            throw CliError{st.message()};
        const auto& r = s.Results;
        if (o->json) {
            json bars = json::array();
            for (int i = 0; i <= s.LastBar; ++i) {
                const auto& b = s.ChartBars[static_cast<std::size_t>(i)];
                bars.push_back({{"date", TextJson(b.DateText())},
                                {"open", FloatJson(b.Open)},
                                {"high", FloatJson(b.High)},
                                {"low", FloatJson(b.Low)},
                                {"close", FloatJson(b.Close)},
                                {"volume", b.Volume},
                                {"note", b.Note}});
            }
            json out = {{"code", TextJson(rec->Code)},
                        {"period", o->period},
                        {"first_record", q.FirstRecord},
                        {"last_record", q.LastRecord},
                        {"last_bar", s.LastBar},
                        {"highest_price", FloatJson(r.HighestPrice)},
                        {"lowest_price", FloatJson(r.LowestPrice)},
                        {"highest_volume", r.HighestVolume},
                        {"lowest_volume", r.LowestVolume},
                        {"average_volume", r.AverageVolume},
                        {"volumes_present", r.VolumesPresent},
                        {"bars", bars}};
            ctx.out << out.dump() << "\n";
            return;
        }
        ctx.out << Printf("%s  %s  records %d to %d, %d bars\n", Trim(rec->Code).c_str(),
                          Trim(rec->Name).c_str(), q.FirstRecord, q.LastRecord, s.LastBar + 1);
        ctx.out << Printf("%-8s %10s %10s %10s %10s %12s %5s\n", "Date", "Open", "High", "Low",
                          "Close", "Volume", "Note");
        for (int i = 0; i <= s.LastBar; ++i) {
            const auto& b = s.ChartBars[static_cast<std::size_t>(i)];
            ctx.out << Printf("%-8s %10g %10g %10g %10g %12d %5d\n",
                              std::string(b.DateText()).c_str(), b.Open, b.High, b.Low, b.Close,
                              b.Volume, b.Note);
        }
        ctx.out << Printf("Highest %g  lowest %g  volume %d..%d average %d%s\n", r.HighestPrice,
                          r.LowestPrice, r.LowestVolume, r.HighestVolume, r.AverageVolume,
                          r.VolumesPresent ? "" : " (no volumes)");
    });
}

void AddListsCommand(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("lists", "Show the chart lists with their names and codes");
    auto asJson = std::make_shared<bool>(false);
    cmd->add_flag("--json", *asJson, "JSON output");
    cmd->callback([&ctx, asJson] {
        auto& session = ctx.OpenSession();
        const auto display = store::GetSubLists(session.services().settings);
        json out = json::array();
        std::vector<std::string> unreadable;
        for (std::size_t i = 0; i < store::kListLetters.size(); ++i) {
            const char letter = store::kListLetters[i];
            const auto path = store::ListPath(session.folders.DataFolder, letter);
            std::vector<store::ChartListEntry> entries;
            if (platform::FileExists(path))
                if (auto st = store::ReadList(path, entries); !st)
                    unreadable.push_back(st.message());
            json codes = json::array();
            for (const auto& e : entries)
                codes.push_back(TextJson(e.Code));
            const std::string name = i < display.size() ? display[i] : "Chart List Z";
            out.push_back({{"list", std::string(1, letter)},
                           {"name", platform::Latin1ToUtf8(name)},
                           {"codes", codes}});
            if (!*asJson && !entries.empty()) {
                ctx.out << letter << "  " << name << ":";
                for (const auto& e : entries)
                    ctx.out << " " << Trim(e.Code);
                ctx.out << "\n";
            }
        }
        if (*asJson) ctx.out << out.dump(2) << "\n";
        // A list the format cannot hold is named, not passed over in silence.
        if (!unreadable.empty()) {
            std::string text = unreadable.front();
            for (std::size_t i = 1; i < unreadable.size(); ++i)
                text += "\n" + unreadable[i];
            throw CliError{text};
        }
    });
}

} // namespace kori::cli
