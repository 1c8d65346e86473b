// kori scan1, scan2, scan3, scan6, stats and adtotals: the scans and market statistics of the
// library. Each stores its finds in the scan list Z as its window does; a choice the window
// would refuse gives the window's message and a non-zero exit.
#include "cli/cli_context.h"
#include "cli/json_out.h"

#include "app/chart_service.h"
#include "app/osc_service.h"
#include "chart/chart_defaults.h"
#include "osc/osc_settings.h"
#include "platform/date_text.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "scan/chart_scans.h"
#include "scan/cht_scan1.h"
#include "scan/snapshot.h"
#include "scan/statistics.h"
#include "store/chart_list.h"
#include "store/name_file.h"
#include "store/price_file.h"

#include <CLI/CLI.hpp>

#include <memory>

namespace kori::cli {

namespace {

using platform::Trim;

// "full" or one letter of the chart lists.
char ListLetter(const std::string& list) {
    if (list.empty() || platform::EqualsNoCase(list, "full")) return 0;
    const std::string up = platform::Upper(Trim(list));
    if (up.size() == 1)
        for (char letter : store::kListLetters)
            if (up[0] == letter) return letter;
    throw CliError{"--list wants full or a chart list letter (A to K without I, or Z): " + list};
}

// "MIN:MAX" into a price range that is on.
scan::PriceRange Range(const std::string& text) {
    const auto colon = text.find(':');
    if (colon == std::string::npos) throw CliError{"--range wants MIN:MAX: " + text};
    return {true, text.substr(0, colon), text.substr(colon + 1)};
}

[[noreturn]] void Refuse(const scan::ScanMessage& m) {
    throw CliError{Trim(m.Title) + ": " + m.Text, 2};
}

void Check(const platform::Status& s) {
    if (!s) throw CliError{s.message()};
}

std::string MessageText(const std::optional<scan::ScanMessage>& m) {
    return m ? m->Text : std::string();
}

// Text output: the message after the rows, its lines as the box shows them.
void PrintMessage(std::ostream& out, const std::optional<scan::ScanMessage>& m, bool cancelled) {
    if (cancelled) out << "Cancelled: the scan list was left as it was.\n";
    if (m) out << m->Text << "\n";
}

json OptionalNumber(const std::optional<double>& v) {
    return v ? json(*v) : json(nullptr);
}

void ShowIssues(CliContext& ctx, const platform::Issues& issues) {
    for (const auto& i : issues)
        ctx.err << "kori: " << i.text << "\n";
}

void AddScan1(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("scan1", "Chart Scan 1: price moves and oscillator indications");
    struct Options {
        std::string list = "full", rise, fall, range, category, cls, osc;
        bool noWarrants = false, ob = false, os = false, cutOb = false, cutOs = false;
        std::vector<std::string> sets;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("--list", o->list, "full, or a chart list letter");
    cmd->add_option("--rise", o->rise, "Find a rise of at least PCT per cent")->option_text("PCT");
    cmd->add_option("--fall", o->fall, "Find a fall of at least PCT per cent")->option_text("PCT");
    cmd->add_option("--range", o->range, "Keep closes from MIN to MAX")->option_text("MIN:MAX");
    cmd->add_option("--category", o->category, "Only securities of this category");
    cmd->add_option("--class", o->cls, "Only this industry class (ending in 0: a group)");
    cmd->add_flag("--no-warrants", o->noWarrants, "Skip codes of six characters");
    cmd->add_option("--osc", o->osc, "Oscillators to test: STO,WMS,ROC,MM,RSI");
    cmd->add_flag("--ob", o->ob, "OB (over bought)");
    cmd->add_flag("--os", o->os, "OS (over sold)");
    cmd->add_flag("--cut-ob", o->cutOb, "Cut OB (up or down)");
    cmd->add_flag("--cut-os", o->cutOs, "Cut OS (up or down)");
    cmd->add_option("--set", o->sets, "KEY=VALUE of section OscDef for this run");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        scan::Scan1Options so;
        so.List = ListLetter(o->list);
        if (!o->rise.empty()) so.Rise = true, so.RisePercent = o->rise;
        if (!o->fall.empty()) so.Fall = true, so.FallPercent = o->fall;
        if (!o->range.empty()) so.Range = Range(o->range);
        if (!o->category.empty()) so.CategoryOn = true, so.Category = o->category;
        if (!o->cls.empty()) so.ClassOn = true, so.Class = o->cls;
        so.NoWarrants = o->noWarrants;
        std::string oscs = o->osc;
        for (std::size_t start = 0; start < oscs.size();) {
            const auto comma = std::min(oscs.find(',', start), oscs.size());
            const std::string name = platform::Upper(Trim(oscs.substr(start, comma - start)));
            bool known = false;
            for (std::size_t k = 0; k < scan::kScanOscs.size(); ++k)
                if (name == scan::OscColumn(scan::kScanOscs[k])) so.Osc[k] = known = true;
            if (!known) throw CliError{"--osc wants STO, WMS, ROC, MM or RSI: " + name};
            start = comma + 1;
        }
        so.Indications = {o->ob, o->os, o->cutOb, o->cutOs};
        osc::OscDef def = osc::ReadOscSettings(session.ini());
        for (const auto& set : o->sets) {
            const auto eq = set.find('=');
            if (eq == std::string::npos ||
                !app::SetOscKey(def, set.substr(0, eq), set.substr(eq + 1)))
                throw CliError{"--set wants KEY=VALUE with a key of section OscDef: " + set};
        }
        if (auto m = scan::ValidateScan1(so, def)) Refuse(*m);
        const auto r =
            scan::RunScan1(session.folders.DataFolder, so, def, session.services().progress);
        ShowIssues(ctx, r.Issues);
        Check(r.Status);
        if (o->json) {
            json rows = json::array();
            for (const auto& row : r.Rows) {
                json ind = json::object();
                for (std::size_t k = 0; k < scan::kScanOscs.size(); ++k)
                    if (!row.Indications[k].empty())
                        ind[std::string(scan::OscColumn(scan::kScanOscs[k]))] = row.Indications[k];
                rows.push_back({{"code", TextJson(row.Code)},
                                {"name", TextJson(row.Name)},
                                {"close", FloatJson(row.Close)},
                                {"move", row.Move},
                                {"change", OptionalNumber(row.Change)},
                                {"indications", ind},
                                {"all", row.All}});
            }
            ctx.out << json{{"last_date", r.LastDate},
                            {"rows", rows},
                            {"message", MessageText(r.Message)}}
                           .dump()
                    << "\n";
            return;
        }
        ctx.out << "SCAN RESULTS        Date: " << platform::FormatDate(r.LastDate, "d/m/yy")
                << "\n";
        ctx.out << Printf("%-3s %-6s %-35s %8s %4s %8s", "", "Code", "Name", "Close", "Move",
                          "Change");
        for (auto osc : scan::kScanOscs)
            ctx.out << Printf(" %-10s", std::string(scan::OscColumn(osc)).c_str());
        ctx.out << "\n";
        for (const auto& row : r.Rows) {
            ctx.out << Printf(
                "%-3s %-6s %-35s %8s %4s %8s", row.All ? "*" : "", row.Code.c_str(),
                row.Name.c_str(), platform::FormatSingle(row.Close, "####.00").c_str(),
                row.Move.c_str(), row.Change ? platform::Format(*row.Change, "0.00").c_str() : "");
            for (const auto& ind : row.Indications)
                ctx.out << Printf(" %-10s", ind.c_str());
            ctx.out << "\n";
        }
        if (!r.Rows.empty()) ctx.out << "* " << scan::kScan1AllLabel << "\n";
        PrintMessage(ctx.out, r.Message, r.Cancelled);
    });
}

// The finds of a listing scan: JSON rows and the closing message, or the listing as the window
// shows it (under its title and heading where the scan has them) and the message.
template <class Result, class RowJson, class LineOf>
void ShowListingResult(CliContext& ctx, bool asJson, const Result& r, std::string_view heading,
                       RowJson rowJson, LineOf lineOf) {
    ShowIssues(ctx, r.Issues);
    Check(r.Status);
    if (asJson) {
        json rows = json::array();
        for (const auto& row : r.Rows)
            rows.push_back(rowJson(row));
        ctx.out << json{{"rows", rows}, {"message", MessageText(r.Message)}}.dump() << "\n";
        return;
    }
    if (!heading.empty()) ctx.out << heading;
    for (const auto& row : r.Rows)
        ctx.out << lineOf(row) << "\n";
    PrintMessage(ctx.out, r.Message, r.Cancelled);
}

void AddScan2(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("scan2", "Chart Scan 2 (Increases in Volume)");
    struct Options {
        std::string range, volume, price, list = "full", cls;
        bool noWarrants = false, json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("--range", o->range, "A: closes from MIN to MAX")->option_text("MIN:MAX");
    cmd->add_option("--volume", o->volume, "B: last volume PCT over the mean of DAYS")
        ->option_text("PCT:DAYS");
    cmd->add_option("--price", o->price, "C: a rise or fall of at least PCT")->option_text("PCT");
    cmd->add_option("--list", o->list, "full, or a chart list letter");
    cmd->add_option("--class", o->cls, "Only this industry class");
    cmd->add_flag("--no-warrants", o->noWarrants, "Skip codes of six characters");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        scan::Scan2Options so;
        so.List = ListLetter(o->list);
        if (!o->range.empty()) so.Frame.Range = Range(o->range);
        if (!o->volume.empty()) {
            const auto colon = o->volume.find(':');
            if (colon == std::string::npos) throw CliError{"--volume wants PCT:DAYS"};
            so.Volume = true;
            so.VolumePercent = o->volume.substr(0, colon);
            so.VolumeDays = o->volume.substr(colon + 1);
        }
        if (!o->price.empty()) so.Price = true, so.PricePercent = o->price;
        if (!o->cls.empty()) so.Frame.ClassOn = true, so.Frame.Class = o->cls;
        so.NoWarrants = o->noWarrants;
        so.ReportFolder = app::TempFolder(session).string();
        if (auto m = scan::ValidateScan2(so)) Refuse(*m);
        const auto r = scan::RunScan2(session.folders.DataFolder, so, session.services().progress);
        ShowListingResult(
            ctx, o->json, r,
            std::string(scan::kScan2Title) + "\n" + std::string(scan::kScan2Heading) + "\n",
            [](const scan::Scan2Row& row) {
                return json{{"code", TextJson(row.Code)},
                            {"close", FloatJson(row.Close)},
                            {"vol_up", row.VolUp ? json(*row.VolUp) : json(nullptr)},
                            {"change", OptionalNumber(row.Change)}};
            },
            scan::Scan2Line);
    });
}

void AddScan3(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("scan3", "Chart Scan 3 (Stocks breaking Parabolic Indicator)");
    struct Options {
        bool up = false, down = false, noWarrants = false, json = false;
        std::string category, range, list = "full", cls;
    };
    auto o = std::make_shared<Options>();
    cmd->add_flag("--up", o->up, "Look for break UP");
    cmd->add_flag("--down", o->down, "Look for break DOWN");
    cmd->add_option("--category", o->category, "Only securities of this category");
    cmd->add_option("--range", o->range, "Closes from MIN to MAX")->option_text("MIN:MAX");
    cmd->add_option("--list", o->list, "full, or a chart list letter");
    cmd->add_option("--class", o->cls, "Only this industry class");
    cmd->add_flag("--no-warrants", o->noWarrants, "Skip codes of six characters");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        scan::Scan3Options so;
        so.List = ListLetter(o->list);
        so.Up = o->up;
        so.Down = o->down;
        if (!o->category.empty()) so.CategoryOn = true, so.Category = o->category;
        if (!o->range.empty()) so.Frame.Range = Range(o->range);
        if (!o->cls.empty()) so.Frame.ClassOn = true, so.Frame.Class = o->cls;
        so.NoWarrants = o->noWarrants;
        if (auto m = scan::ValidateScan3(so)) Refuse(*m);
        const auto r = scan::RunScan3(session.folders.DataFolder, so, session.services().progress);
        ShowListingResult(
            ctx, o->json, r,
            std::string(scan::kScan3Title) + "\n" + std::string(scan::kScan3Heading) + "\n",
            [](const scan::Scan3Row& row) {
                return json{{"code", TextJson(row.Code)},
                            {"close", FloatJson(row.Close)},
                            {"direction", row.Direction}};
            },
            scan::Scan3Line);
    });
}

void AddScan6(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("scan6", "Chart Scan 6 - Average Crossover");
    struct Options {
        std::string codeLength = "All", range, cls;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("--code-length", o->codeLength, "All, 3, 4, 5 or 6");
    cmd->add_option("--range", o->range, "Closes from MIN to MAX")->option_text("MIN:MAX");
    cmd->add_option("--class", o->cls, "Only this industry class");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const chart::ChartDefaults defaults = chart::LoadChartDefaults(session.ini());
        scan::Scan6Options so;
        so.Av1D = defaults.MAPeriod1Daily;
        so.Av2D = defaults.MAPeriod2Daily;
        so.CodeLength = o->codeLength;
        if (!o->range.empty()) so.Frame.Range = Range(o->range);
        if (!o->cls.empty()) so.Frame.ClassOn = true, so.Frame.Class = o->cls;
        if (auto m = scan::ValidateScan6(so)) Refuse(*m);
        so.ReportFolder = app::TempFolder(session).string();
        const auto r = scan::RunScan6(session.folders.DataFolder, so, session.services().progress);
        ShowListingResult(
            ctx, o->json, r, "",
            [](const scan::Scan6Row& row) {
                return json{{"code", TextJson(row.Code)},
                            {"close", FloatJson(row.Close)},
                            {"gap", row.Gap},
                            {"name", TextJson(row.Name)},
                            {"class", TextJson(row.Class)}};
            },
            scan::Scan6Line);
    });
}

void AddStats(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("stats", "Top Movers by Percentage");
    struct Options {
        std::string filter = "ALL", top;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("--filter", o->filter, "ALL, 3 (FP shares), NW (no warrants), WO (warrants)")
        ->check(CLI::IsMember({"ALL", "3", "NW", "WO"}));
    cmd->add_option("--top", o->top, "How many rises and falls (default 20)");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        scan::MarketStatistics stats;
        const auto s =
            stats.Check(session.folders.DataFolder, o->filter, session.services().progress);
        ShowIssues(ctx, stats.Issues());
        if (!s) throw CliError{std::string(scan::kStatisticsTitle) + ": " + s.message()};
        const auto d = stats.Display(o->top);
        const auto& c = stats.Counters();
        auto block = [](const std::vector<scan::MoverRow>& rows) {
            json out = json::array();
            for (const auto& r : rows)
                out.push_back({{"code", TextJson(r.Code)},
                               {"name", TextJson(r.Name)},
                               {"previous", r.Previous},
                               {"latest", r.Latest},
                               {"percent", r.Percent * 100}});
            return out;
        };
        if (o->json) {
            ctx.out << json{{"rises", c.Rises},           {"falls", c.Falls},
                            {"steady", c.Steady},         {"traded", c.Traded},
                            {"untraded", c.Untraded},     {"top_rises", block(d.Rises)},
                            {"top_falls", block(d.Falls)}}
                           .dump()
                    << "\n";
            return;
        }
        ctx.out << "Top Movers by Percentage\n";
        ctx.out << Printf("%-6s %-30s %9s %9s %9s   %-6s %-30s %9s %9s %9s\n", "Code", "RISES",
                          "Previous", "Latest", "+%", "Code", "FALLS", "Previous", "Latest", "-%");
        for (int i = 0; i < d.TopCount; ++i) {
            const auto& up = d.Rises[static_cast<std::size_t>(i)];
            const auto& dn = d.Falls[static_cast<std::size_t>(i)];
            ctx.out << Printf("%-6s %-30s %9s %9s %9s   %-6s %-30s %9s %9s %9s\n", up.Code.c_str(),
                              up.Name.c_str(), up.Previous.c_str(), up.Latest.c_str(),
                              platform::Format(up.Percent, "0.00 %").c_str(), dn.Code.c_str(),
                              dn.Name.c_str(), dn.Previous.c_str(), dn.Latest.c_str(),
                              platform::Format(dn.Percent, "0.00 %").c_str());
        }
        ctx.out << Printf("Rises %d\nFalls %d\nSteady %d\nTraded %d\nUntraded %d\n", c.Rises,
                          c.Falls, c.Steady, c.Traded, c.Untraded);
    });
}

void AddADTotals(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("adtotals", "Check Advance/Decline Totals of a type 3 series");
    struct Options {
        std::string code, base;
        bool json = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("CODE", o->code, "Code of the advance-decline series")->required();
    cmd->add_option("--base", o->base, "Base Value (default: from the first record)");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        platform::Status why;
        const auto found = store::FindCode(session.folders.DataFolder, o->code, why);
        Check(why);
        if (!found) throw CliError{"No File For That Name: " + Trim(o->code)};
        if (found->Record.RecordType != 3)
            throw CliError{Trim(o->code) + " is not an advance-decline series (record type 3)"};
        const auto path = store::PriceFile::PathFor(session.folders.DataFolder, found->Record.Code);
        double base = 0;
        if (auto s = scan::ADBaseValue(path, base); !s)
            throw CliError{std::string(scan::kADTitle) + ": " + s.message()};
        if (!o->base.empty()) {
            if (!scan::IsNumericText(o->base))
                throw CliError{"Base Value: Base Value must be numeric", 2};
            base = platform::Val(o->base);
        }
        std::int32_t total = 0;
        Check(scan::CheckADTotals(path, base, total));
        if (o->json) {
            ctx.out << json{{"code", TextJson(found->Record.Code)},
                            {"base", base},
                            {"total", total}}
                           .dump()
                    << "\n";
            return;
        }
        ctx.out << scan::ADCheckedMessage(path, total) << "\n";
    });
}

// kori snapshot: each security's last day beside its oscillators, and the market's breadth.
void AddSnapshot(CLI::App& app, CliContext& ctx) {
    auto* cmd = app.add_subcommand("snapshot", "Each security's last day, oscillators and the "
                                               "market's breadth");
    struct Options {
        std::string list = "full";
        bool json = false, csv = false;
    };
    auto o = std::make_shared<Options>();
    cmd->add_option("--list", o->list, "full, or a chart list letter");
    cmd->add_flag("--json", o->json, "JSON output");
    cmd->add_flag("--csv", o->csv, "The grid as CSV");
    cmd->callback([&ctx, o] {
        auto& session = ctx.OpenSession();
        const store::SecurityList list{session.folders.DataFolder, ListLetter(o->list)};
        const auto result = scan::TakeSnapshot(list, scan::SnapshotSettingsFrom(session.ini()),
                                               session.services().progress);
        if (!result.Status) throw CliError{result.Status.message()};
        const auto& b = result.Market;
        if (o->csv) {
            ctx.out << scan::SnapshotCsv(result);
        } else if (o->json) {
            const auto number = [](std::optional<double> v) { return v ? json(*v) : json(); };
            json rows = json::array();
            for (const auto& r : result.Rows)
                rows.push_back(
                    {{"code", TextJson(r.Code)},
                     {"name", TextJson(r.Name)},
                     {"date", r.Date},
                     {"close", r.Close},
                     {"change", number(r.Change)},
                     {"percent", number(r.ChangePercent)},
                     {"volume_ratio", number(r.VolumeRatio)},
                     {"rsi", number(r.Rsi)},
                     {"stochastic_k", number(r.StochasticK)},
                     {"macd_above_signal", r.MacdAboveSignal ? json(*r.MacdAboveSignal) : json()},
                     {"above_average1", number(r.AboveAverage1)},
                     {"above_average2", number(r.AboveAverage2)},
                     {"year_high", r.YearHigh},
                     {"year_low", r.YearLow},
                     {"new_high", r.NewHigh},
                     {"new_low", r.NewLow}});
            json out = {{"breadth",
                         {{"advances", b.Advances},
                          {"declines", b.Declines},
                          {"unchanged", b.Unchanged},
                          {"new_highs", b.NewHighs},
                          {"new_lows", b.NewLows}}},
                        {"cancelled", result.Cancelled},
                        {"rows", rows}};
            ctx.out << out.dump(2) << "\n";
        } else {
            const auto cell = [](std::optional<double> v, const char* format) {
                return v ? platform::Format(*v, format) : std::string("-");
            };
            ctx.out << Printf("%-6s %-10s %9s %8s %7s %6s %6s %5s %8s %8s\n", "Code", "Date",
                              "Close", "Change%", "Vol/Av", "RSI", "%K", "MACD", "52wHigh",
                              "52wLow");
            for (const auto& r : result.Rows)
                ctx.out << Printf(
                    "%-6s %-10s %9s %8s %7s %6s %6s %5s %8s %8s\n", r.Code.c_str(),
                    platform::DateTextToDisplay(r.Date).c_str(),
                    platform::Format(r.Close, "0.000").c_str(),
                    cell(r.ChangePercent, "0.00").c_str(), cell(r.VolumeRatio, "0.00").c_str(),
                    cell(r.Rsi, "0.0").c_str(), cell(r.StochasticK, "0.0").c_str(),
                    r.MacdAboveSignal ? (*r.MacdAboveSignal ? "above" : "below") : "-",
                    platform::Format(r.YearHigh, "0.000").c_str(),
                    platform::Format(r.YearLow, "0.000").c_str());
            ctx.out << Printf("Advances %d, declines %d, unchanged %d, new highs %d, new lows %d\n",
                              b.Advances, b.Declines, b.Unchanged, b.NewHighs, b.NewLows);
        }
        if (result.Cancelled) throw CliError{"Snapshot cancelled", 3};
    });
}

} // namespace

void AddScanCommands(CLI::App& app, CliContext& ctx) {
    AddScan1(app, ctx);
    AddScan2(app, ctx);
    AddScan3(app, ctx);
    AddScan6(app, ctx);
    AddStats(app, ctx);
    AddADTotals(app, ctx);
    AddSnapshot(app, ctx);
}

} // namespace kori::cli
