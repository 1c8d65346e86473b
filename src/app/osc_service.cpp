#include "app/osc_service.h"

#include "osc/compare_osc.h"
#include "osc/osc_identifiers.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/load_chart_series.h"
#include "store/price_file.h"

namespace kori::app {

std::optional<store::ChartSeries> LoadWholePriceFile(const std::filesystem::path& path) {
    if (!platform::FileExists(path)) return std::nullopt;
    store::PriceFile pf(path);
    if (!pf.Open() || pf.Count() < 1) return std::nullopt;
    store::SeriesRequest q;
    q.FirstRecord = 1;
    q.LastRecord = static_cast<std::int16_t>(pf.Count());
    q.Period = 'A';
    q.WantVolume = true;
    q.RecordType = 4;
    store::ChartSeries s;
    if (!store::LoadChartSeries(path.string(), q, s)) return std::nullopt;
    return s;
}

LoadedCompareFile LoadCompareFile(Session& session, std::string_view compFile) {
    LoadedCompareFile out;
    const osc::CompareFile f = osc::ResolveCompareFile(compFile, session.dialogs());
    if (f.CompareCode.empty()) return out;
    // A comparison file that cannot be read at drawing time ends the routine quietly.
    auto series = LoadWholePriceFile(f.Path);
    if (!series) return out;
    out.CompareCode = f.CompareCode;
    out.Series = std::move(*series);
    return out;
}

namespace {

bool SetBool(bool& field, std::string_view value) {
    const std::string v = platform::Upper(platform::Trim(value));
    field = v == "TRUE" || v == "1" || v == "-1" || v == "YES";
    return true;
}

} // namespace

platform::Status InstallOscDefaults(Session& session) {
    if (platform::Trim(session.ini().Read("OscDef", "RsiP")) != platform::kUnknown)
        return platform::Status::Ok();
    osc::OscDef def = osc::ReadOscSettings(session.ini());
    for (const auto& id : osc::OscIdentifiers()) {
        osc::FillOscDefaults(def, id.OscName, false);
        osc::FillOscDefaults(def, id.OscName, true);
    }
    // The settings window has no ATR period; the chart defaults set it.
    if (def.AtrD == 0) def.AtrD = 14;
    if (def.AtrW == 0) def.AtrW = 14;
    if (def.CompFile.empty() || def.CompFile == platform::kUnknown)
        def.CompFile = session.folders.DataFolder + "XAO.WDT";
    if (!osc::WriteOscSettings(session.ini(), def))
        return platform::Status::Error("Cannot write the oscillator settings to Kori.ini");
    return platform::Status::Ok();
}

bool SetOscKey(osc::OscDef& def, std::string_view key, std::string_view value) {
    const std::string k = platform::Trim(key);
    if (const osc::OscPeriodKey* p = osc::FindOscPeriodKeyByName(k)) {
        const double v = platform::Val(value);
        def.*(k == p->Daily ? p->DailyField : p->WeeklyField) =
            static_cast<std::int16_t>(v < -32768  ? -32768
                                      : v > 32767 ? 32767
                                                  : v);
        return true;
    }
    if (k == "CompFile") {
        def.CompFile = platform::Trim(value);
        return true;
    }
    if (k == "FXRev") return SetBool(def.FXRev, value);
    if (k == "FillIn") return SetBool(def.FillIn, value);
    if (k == "RFAve") return SetBool(def.RFAve, value);
    if (k == "NoClassicMACD") return SetBool(def.NoClassicMACD, value);
    return false;
}

osc::OscOutcome DrawSecurityOscillator(Session& session, const ChartJob& chartJob,
                                       chart::Chart& chart, const OscPanelJob& job,
                                       platform::Surface& panel) {
    const osc::OscDef def = job.Settings ? *job.Settings : osc::ReadOscSettings(session.ini());
    const std::string name = platform::Trim(job.OscName);
    const char period = chartJob.Request.ChartPeriod;

    LoadedCompareFile compare;
    std::optional<store::ChartSeries> own;
    if ((name == "RMO" && period == 'A') || name == "RMX") {
        compare = LoadCompareFile(session, def.CompFile);
        if (name == "RMO")
            own = LoadWholePriceFile(
                store::PriceFile::PathFor(session.folders.DataFolder, chartJob.Name.Code));
    }
    osc::OscDrawInputs in{session.palette, session.fonts, session.dialogs()};
    in.StreamPath = chartJob.WriteStream ? ChartStreamPath(session) : std::filesystem::path();
    in.DisplayScale = chartJob.Defaults.Zoom / 100.0;
    in.PanelOffset = job.PanelOffset;
    in.TargetName = job.TargetName;
    in.SlowStochastic = job.SlowStochastic;
    in.ShowStochSignals = session.switches.RM || session.switches.GD;
    in.PriceSurface = job.PriceSurface;
    in.RecordType = chartJob.Name.RecordType;
    if (!compare.CompareCode.empty()) {
        in.CompareFile = &compare.Series;
        in.CompareCode = compare.CompareCode;
    }
    if (own) in.SecurityFile = &*own;
    return osc::ShowOscillator(chart, name, period, def, in, panel);
}

} // namespace kori::app
