#pragma once
// What the chart window's mouse tools leave behind: trendlines in the security's .TND file,
// text notes in <code>.Txt, and the lines of the chart in hand in ChtLns.Tmp, which a repaint
// plays back. Drawing goes to the surface and, in stream grammar, to TCht.Tmp as well so that
// printing and saving carry it.
#include "app/session.h"
#include "chart/chart.h"
#include "chart/chart_request.h"
#include "chart/chart_tools.h"
#include "platform/surface.h"

#include <filesystem>
#include <string>
#include <vector>

namespace kori::app {

// Trendline and note lines go out in these palette entries.
inline constexpr int kTrendlineEntry = 23;
inline constexpr int kTextNoteEntry = 27;

chart::ToolFrame ToolFrameOf(const chart::Chart& chart, const chart::ChartRequest& request);

std::filesystem::path TrendlinePath(const Session& session, std::string_view code);
std::filesystem::path NotesPath(const Session& session, std::string_view code);
std::filesystem::path ChartLinesPath(const Session& session);

// A new chart: ChtLns.Tmp starts empty.
void ClearChartLines(const Session& session);
// One line drawn with the mouse: onto the surface, then as a stream line to ChtLns.Tmp and
// to TCht.Tmp.
void RecordChartLine(const Session& session, platform::Surface& surface, const chart::Segment& s);
// A repaint: "H", "L" solid and "D" dashed, as stored in ChtLns.Tmp. Returns the lines played.
int ReplayChartLines(const Session& session, platform::Surface& surface);

// `DrawChartLines`: the .TND lines of this chart's period, drawn at the end of a build into
// the chart's open stream. Only single charts that are not point and figure carry them.
std::vector<chart::TrendEnds> DrawChartLines(const Session& session, chart::Chart& chart,
                                             const chart::ChartRequest& request,
                                             std::string_view code, platform::Surface& surface);

// The .TND lines this chart would draw, by the replay rules, without drawing them.
std::vector<chart::TrendEnds> TrendEndsOf(const Session& session, const chart::Chart& chart,
                                          const chart::ChartRequest& request,
                                          std::string_view code);

// A trendline drawn from (x1, y1) to (x2, y2): written to the next free record of .TND, drawn
// and recorded. False when the ends do not make a line or the file cannot be written.
bool AddTrendline(const Session& session, const chart::Chart& chart,
                  const chart::ChartRequest& request, std::string_view code,
                  platform::Surface& surface, double x1, double y1, double x2, double y2);

// Blanks a record; its place is reused by the next line.
platform::Status EraseTrendline(const Session& session, std::string_view code, int recordNumber);
// Moves a line: its record is rewritten from the new ends.
bool MoveTrendline(const Session& session, const chart::Chart& chart,
                   const chart::ChartRequest& request, std::string_view code, int recordNumber,
                   double x1, double y1, double x2, double y2);
// Leaving a chart whose trendlines changed packs the file through Temp.Wk3.
platform::Status PackTrendlines(const Session& session, std::string_view code);
// "Remove all trendlines for ": after the warning, the file goes. True when removed.
bool RemoveAllTrendlines(Session& session, std::string_view code);

// A text note at a click: the date of the bar under x (the last bar's right of the chart), the
// price at y. Appends "T,8.25,date,price,text,colour" to <code>.Txt.
platform::Status AddTextNote(const Session& session, const chart::Chart& chart,
                             const chart::ChartRequest& request, std::string_view code, double x,
                             double y, std::string_view text);
// The notes of the security, printed in entry 27 and written to the stream with x and y.
int DrawTextNotes(const Session& session, chart::Chart& chart, const chart::ChartRequest& request,
                  std::string_view code, platform::Surface& surface);

} // namespace kori::app
