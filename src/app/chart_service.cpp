#include "app/chart_service.h"

#include "chart/file_price_source.h"
#include "chart/targets.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"

namespace kori::app {

std::filesystem::path TempFolder(const Session& session) {
    const std::filesystem::path dir = session.folders.SystemFolder + "temp";
    platform::CreateFolder(dir);
    return dir;
}

std::filesystem::path ChartStreamPath(const Session& session) {
    if (!session.chartStream.empty()) return session.chartStream;
    return TempFolder(session) / "TCht.Tmp";
}

chart::ChartName ChartNameOf(const store::NameRecord& r) {
    chart::ChartName n;
    n.Code = platform::Trim(r.Code);
    n.Name = r.Name;
    n.OtherDetails = r.OtherDetails;
    n.RecordType = r.RecordType;
    n.Base = r.Base;
    n.Top = r.Top;
    n.PercentBandUp = r.BandUp();
    n.PercentBandDown = r.BandDown();
    n.PFIncrement = r.PFIncrement;
    return n;
}

platform::Status BuildSecurityChart(Session& session, ChartJob& job, chart::Chart& chart,
                                    platform::Surface& surface) {
    chart::FilePriceSource source(
        store::PriceFile::PathFor(session.folders.DataFolder, job.Name.Code));
    if (auto s = source.Open(); !s) {
        session.dialogs().MsgBox(s.message(), "Chart Display");
        return s;
    }
    const chart::ChartName name = ChartNameOf(job.Name);
    const bool split = job.Request.SplitMode && job.Lower.has_value();
    const std::string lowerCode = split ? platform::Trim(job.Lower->Name.Code) : std::string();
    chart::FilePriceSource lowerSource(
        store::PriceFile::PathFor(session.folders.DataFolder, split ? lowerCode : job.Name.Code));
    chart::ChartName lowerName;
    chart::SplitLowerHalf lower;
    if (split) {
        if (auto s = lowerSource.Open(); !s) {
            session.dialogs().MsgBox(s.message(), "Chart Display");
            return s;
        }
        lowerName = ChartNameOf(job.Lower->Name);
        lower = {&lowerName, &lowerSource, job.Lower->ChartPeriod};
    }
    chart::ChartBuild build{job.Request,
                            job.Defaults,
                            name,
                            session.palette,
                            session.fonts,
                            session.dialogs(),
                            job.WriteStream ? ChartStreamPath(session) : std::filesystem::path(),
                            false, // no setting holds the bold-print option yet
                            session.download.VolumeDivisor,
                            job.Page,
                            {}};
    if (split) build.Lower = &lower;
    // Target lines go on last, while the stream is still open; each half has its security's.
    const auto targetsFile = std::filesystem::path(session.folders.SystemFolder) / "Targets.txt";
    const std::vector<float> targets = chart::ReadTargetPrices(targetsFile, name.Code);
    const std::vector<float> lowerTargets =
        split ? chart::ReadTargetPrices(targetsFile, lowerCode) : std::vector<float>();
    build.DrawOverlays = [&job, &session, &targets, &lowerTargets](chart::Chart& c,
                                                                   platform::Surface& s) {
        const bool lowerHalf = job.Request.SplitMode && job.Request.SplitHalf == 2;
        chart::DrawTargetLines(c, s, session.palette, lowerHalf ? lowerTargets : targets);
        if (job.DrawOverlays) job.DrawOverlays(c, s);
    };
    return chart::BuildChart(chart, build, source, surface);
}

} // namespace kori::app
