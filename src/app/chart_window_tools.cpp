#include "app/chart_window_tools.h"

#include "app/chart_service.h"
#include "chart/stream_reader.h"
#include "chart/stream_writer.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/name_record.h"

#include <cmath>
#include <filesystem>

namespace kori::app {

namespace {

void AppendShape(const std::filesystem::path& path, char letter, const chart::Segment& s,
                 platform::Colour colour) {
    chart::StreamWriter w;
    if (!w.Open(path, true)) return;
    w.Shape(letter, s.x1, s.y1, s.x2, s.y2, colour);
    (void)w.Close();
}

platform::Colour Entry(const Session& session, int entry) {
    return session.palette[static_cast<std::size_t>(entry)];
}

void DrawSegment(platform::Surface& surface, const chart::Segment& s, platform::Colour colour) {
    if (s.Letter == 'D') surface.SetLineStyle(platform::LineStyle::Dot);
    surface.Line(s.x1, s.y1, s.x2, s.y2, colour);
    surface.SetLineStyle(platform::LineStyle::Solid);
}

} // namespace

chart::ToolFrame ToolFrameOf(const chart::Chart& chart, const chart::ChartRequest& request) {
    chart::ToolFrame f;
    f.PlotLeft = chart.PlotLeft;
    f.PlotRight = chart.PlotRight;
    f.PlotTop = chart.PlotTop;
    f.PlotBottom = chart.PlotBottom;
    f.BarSpacing = chart.BarSpacing;
    f.UpsideDown = request.UpsideDown;
    f.ChartPeriod = request.ChartPeriod;
    f.Bars = &chart.ChartBars();
    f.LastBar = chart.LastBar();
    f.PriceToY = [&chart](double p) { return static_cast<double>(chart.PriceToY(p)); };
    f.YToPrice = [&chart](double y) { return chart.YToPrice(y); };
    return f;
}

std::filesystem::path TrendlinePath(const Session& session, std::string_view code) {
    platform::CreateFolder(session.folders.ChtMiscFolder);
    return store::TrendlineFile::PathFor(session.folders.ChtMiscFolder, platform::Trim(code));
}

std::filesystem::path NotesPath(const Session& session, std::string_view code) {
    platform::CreateFolder(session.folders.ChtMiscFolder);
    return std::filesystem::path(session.folders.ChtMiscFolder) / (platform::Trim(code) + ".Txt");
}

std::filesystem::path ChartLinesPath(const Session& session) {
    return TempFolder(session) / "ChtLns.Tmp";
}

void ClearChartLines(const Session& session) {
    (void)platform::WriteFileAtomic(ChartLinesPath(session), "");
}

void RecordChartLine(const Session& session, platform::Surface& surface, const chart::Segment& s) {
    const platform::Colour colour = Entry(session, s.PaletteEntry);
    DrawSegment(surface, s, colour);
    AppendShape(ChartLinesPath(session), s.Letter, s, colour);
    AppendShape(ChartStreamPath(session), s.Letter, s, colour);
}

int ReplayChartLines(const Session& session, platform::Surface& surface) {
    chart::StreamReader reader(ChartLinesPath(session));
    chart::Instruction in;
    int played = 0;
    while (reader.Next(in) == chart::StreamReader::Result::Instruction) {
        if (in.Letter != 'H' && in.Letter != 'L' && in.Letter != 'D' && in.Letter != 'M') continue;
        DrawSegment(surface, {in.X1, in.Y1, in.X2, in.Y2, 0, in.Letter == 'D' ? 'D' : 'L'},
                    in.Colour);
        ++played;
    }
    return played;
}

std::vector<chart::TrendEnds> TrendEndsOf(const Session& session, const chart::Chart& chart,
                                          const chart::ChartRequest& request,
                                          std::string_view code) {
    if (request.ChartSlot != 0 || request.SplitMode || chart.Style == 'P') return {};
    const auto path = TrendlinePath(session, code);
    if (!platform::FileHasData(path)) return {};
    return chart::ReplayTrendlines(ToolFrameOf(chart, request),
                                   store::TrendlineFile::ReadAll(path));
}

std::vector<chart::TrendEnds> DrawChartLines(const Session& session, chart::Chart& chart,
                                             const chart::ChartRequest& request,
                                             std::string_view code, platform::Surface& surface) {
    auto ends = TrendEndsOf(session, chart, request, code);
    const platform::Colour colour = Entry(session, kTrendlineEntry);
    for (const auto& e : ends) {
        surface.Line(e.xA, e.yA, e.xB, e.yB, colour);
        chart.Stream.Shape('H', e.xA, e.yA, e.xB, e.yB, colour);
    }
    return ends;
}

bool AddTrendline(const Session& session, const chart::Chart& chart,
                  const chart::ChartRequest& request, std::string_view code,
                  platform::Surface& surface, double x1, double y1, double x2, double y2) {
    const auto frame = ToolFrameOf(chart, request);
    const auto record = chart::MakeTrendRecord(frame, x1, y1, x2, y2);
    if (!record) return false;
    platform::Status s;
    store::TrendlineFile::AddRecord(TrendlinePath(session, code), *record, s);
    if (!s) return false;
    if (x2 < x1) {
        std::swap(x1, x2);
        std::swap(y1, y2);
    }
    const double limit = chart.PlotRight + 10;
    if (x2 > limit) {
        y2 = y1 + (y2 - y1) * (limit - x1) / (x2 - x1);
        x2 = limit;
    }
    RecordChartLine(session, surface, {x1, y1, x2, y2, kTrendlineEntry, 'H'});
    return true;
}

platform::Status EraseTrendline(const Session& session, std::string_view code, int recordNumber) {
    return store::TrendlineFile::DeleteRecord(TrendlinePath(session, code), recordNumber);
}

bool MoveTrendline(const Session& session, const chart::Chart& chart,
                   const chart::ChartRequest& request, std::string_view code, int recordNumber,
                   double x1, double y1, double x2, double y2) {
    const auto record = chart::MakeTrendRecord(ToolFrameOf(chart, request), x1, y1, x2, y2);
    if (!record) return false;
    return store::TrendlineFile::WriteRecord(TrendlinePath(session, code), recordNumber, *record)
        .ok();
}

platform::Status PackTrendlines(const Session& session, std::string_view code) {
    const auto path = TrendlinePath(session, code);
    if (!platform::FileExists(path)) return platform::Status::Ok();
    return store::TrendlineFile::Pack(path);
}

bool RemoveAllTrendlines(Session& session, std::string_view code) {
    const std::string c = platform::Trim(code);
    if (session.dialogs().MsgBox("WARNING - All trendlines for " + c +
                                     " will be removed. Are you sure?",
                                 "Remove all Trendlines", platform::Buttons::YesNo,
                                 platform::Icon::Exclamation) != platform::Answer::Yes)
        return false;
    std::error_code ec;
    std::filesystem::remove(TrendlinePath(session, c), ec);
    return !ec;
}

platform::Status AddTextNote(const Session& session, const chart::Chart& chart,
                             const chart::ChartRequest& request, std::string_view code, double x,
                             double y, std::string_view text) {
    const auto frame = ToolFrameOf(chart, request);
    if (chart.LastBar() < 0) return platform::Status::Error("No chart to write on");
    int i = frame.BarIndexAt(x);
    if (i > chart.LastBar()) i = chart.LastBar();
    if (i < 0) i = 0;
    const std::string date(chart.ChartBars()[static_cast<std::size_t>(i)].DateText());
    const double price = chart.YToPrice(y);
    std::string line = "T,8.25," + date + "," + chart::StreamWriter::Number(price) + "," +
                       chart::StreamWriter::StripCommas(text) + "," +
                       chart::StreamWriter::Number(Entry(session, kTextNoteEntry)) + "\r\n";
    return platform::AppendToFile(NotesPath(session, code), line);
}

int DrawTextNotes(const Session& session, chart::Chart& chart, const chart::ChartRequest& request,
                  std::string_view code, platform::Surface& surface) {
    const auto content = platform::ReadWholeFile(NotesPath(session, code));
    if (!content || chart.Style == 'P') return 0;
    const auto frame = ToolFrameOf(chart, request);
    int drawn = 0;
    std::size_t pos = 0;
    while (pos < content->size()) {
        std::size_t end = content->find('\n', pos);
        if (end == std::string::npos) end = content->size();
        std::string line = content->substr(pos, end - pos);
        pos = end + 1;
        if (!line.empty() && line.back() == '\r') line.pop_back();
        chart::StreamFields f;
        if (line.empty() || !chart::SplitStreamLine(line, f)) continue;
        // A note dated before the first bar has no place on this chart (as a trendline).
        const std::string date = platform::Trim(f[2]);
        if (chart.LastBar() < 0 || date < std::string(chart.ChartBars()[0].DateText())) continue;
        const double x = chart::DateToX(frame, date);
        if (x == 0) continue;
        const double y = chart.PriceToY(platform::Val(f[3]));
        platform::Colour colour = Entry(session, kTextNoteEntry);
        surface.SetForeColour(colour);
        surface.SetTextPosition(x, y);
        surface.PrintText(f[4]);
        chart.Stream.Text('T', platform::Val(f[1]), x, y, f[4], colour);
        ++drawn;
    }
    return drawn;
}

} // namespace kori::app
