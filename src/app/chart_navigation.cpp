#include "app/chart_navigation.h"

#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/classifications.h"
#include "store/name_file.h"

#include <algorithm>

namespace kori::app {

namespace {

std::string ListDisplayName(Session& session, int listMode) {
    if (listMode == 12) return "Chart List Z";
    const auto names = store::GetSubLists(session.services().settings);
    const auto i = static_cast<std::size_t>(listMode - 2);
    return i < names.size() ? platform::Trim(names[i]) : std::string();
}

} // namespace

bool ChartWalk::Open(chart::ChartRequest& request, bool quiet) {
    m_names.clear();
    m_list.clear();
    store::NameFile nf(store::NameFile::PathIn(m_session.folders.DataFolder));
    m_status = platform::FileExists(nf.path())
                   ? nf.ReadAll(m_names)
                   : platform::Status::Error("The name file cannot be read");
    if (!m_status) {
        m_names.clear();
        request.ListMode = 1;
        request.ListName.clear();
        m_fullList = true;
        m_caption = kFullListCaption;
        return false;
    }
    const char letter = store::ListLetterOfMode(request.ListMode);
    if (letter != 0) {
        const std::string name = request.ListName.empty()
                                     ? ListDisplayName(m_session, request.ListMode)
                                     : request.ListName;
        const auto path = store::ListPath(m_session.folders.DataFolder, letter);
        const auto listRead =
            platform::FileHasData(path) ? store::ReadList(path, m_list) : platform::Status::Ok();
        if (listRead && !m_list.empty()) {
            m_fullList = false;
            m_caption = " " + name;
            request.ListName = name;
            return true;
        }
        m_list.clear();
        // A list over the record limit says so; an empty one gets the empty-list message.
        if (!quiet)
            m_session.dialogs().MsgBox(listRead ? store::EmptyListMessage(name)
                                                : listRead.message(),
                                       store::EmptyListTitle(m_session.folders.DataFolder));
    }
    request.ListMode = 1;
    request.ListName.clear();
    m_fullList = true;
    m_caption = kFullListCaption;
    return true;
}

int ChartWalk::Count() const {
    return static_cast<int>(m_fullList ? m_names.size() : m_list.size());
}

int ChartWalk::NameRecordNumberAt(int position) const {
    if (position < 1 || position > Count()) return 0;
    if (m_fullList) return position;
    return m_list[static_cast<std::size_t>(position - 1)].NameRecord;
}

std::optional<store::NameRecord> ChartWalk::RecordAt(int position) const {
    const int n = NameRecordNumberAt(position);
    if (n < 1 || n > NameCount()) return std::nullopt;
    return m_names[static_cast<std::size_t>(n - 1)];
}

platform::Status ChartWalk::WriteRecordAt(int position, const store::NameRecord& r) {
    const int n = NameRecordNumberAt(position);
    if (n < 1 || n > NameCount()) return platform::Status::Error("No record at that position");
    store::NameFile nf(store::NameFile::PathIn(m_session.folders.DataFolder));
    if (auto s = nf.Open(); !s) return s;
    if (auto s = nf.Write(n, r); !s) return s;
    m_names[static_cast<std::size_t>(n - 1)] = r;
    return platform::Status::Ok();
}

std::optional<store::NameRecord> StepChart(ChartWalk& walk, chart::ChartRequest& request,
                                           int delta) {
    const int count = walk.Count();
    if (count <= 0) return std::nullopt;
    int pos = request.ListPosition + delta;
    if (pos > count) pos = 1;
    if (pos < 1) pos = count;
    request.ListPosition = static_cast<std::int16_t>(pos);
    return walk.RecordAt(pos);
}

std::optional<store::NameRecord> StepClassChart(ChartWalk& walk, chart::ChartRequest& request,
                                                int delta, std::string_view classCode, bool gics,
                                                platform::Dialogs& dialogs) {
    std::vector<int> matches;
    for (int p = 0; (p = store::FindNextClassRecord(walk.names(), p, classCode, gics)) != 0;)
        matches.push_back(p);
    if (matches.empty()) {
        if (gics)
            dialogs.MsgBox("No records on file for that GICS classification",
                           "GICS Classification");
        else
            dialogs.MsgBox("No records on file for that Industry classification or group",
                           "Industry Classification");
        return std::nullopt;
    }
    const int at = request.ListPosition;
    int pos = 0;
    if (delta >= 0) {
        for (int m : matches)
            if (delta == 0 ? m >= at : m > at) {
                pos = m;
                break;
            }
        if (pos == 0) pos = matches.front();
    } else {
        for (auto it = matches.rbegin(); it != matches.rend(); ++it)
            if (*it < at) {
                pos = *it;
                break;
            }
        if (pos == 0) pos = matches.back();
    }
    request.ListPosition = static_cast<std::int16_t>(pos);
    return walk.RecordAt(pos);
}

int BarUnder(const chart::Chart& chart, double x) {
    const int spacing = chart.BarSpacing <= 0 ? 1 : chart.BarSpacing;
    if (x < chart.PlotLeft - spacing / 2.0) return -1;
    const int i = static_cast<int>((x - chart.PlotLeft) / spacing + 0.5);
    if (i < 0 || i > chart.LastBar()) return -1;
    if (static_cast<std::size_t>(i) >= chart.ChartBars().size()) return -1;
    return i;
}

std::string ReadoutPrice(double price) {
    if (price == 0) return {};
    return platform::Trim(platform::Format(price, "#####.00#", platform::ZeroSign::Dropped));
}

namespace {
std::string Volume(double v) {
    return platform::Trim(platform::Format(v, "###0", platform::ZeroSign::Dropped));
}
} // namespace

std::vector<std::string> CursorReadout(const chart::Chart& chart, double x, bool closeOnly) {
    const int i = BarUnder(chart, x);
    if (i < 0) return {};
    const auto& b = chart.ChartBars()[static_cast<std::size_t>(i)];
    if (closeOnly) return {"Close  " + ReadoutPrice(b.Close), "Vol  " + Volume(b.Volume)};
    return {"Open  " + ReadoutPrice(b.Open), "High  " + ReadoutPrice(b.High),
            "Low  " + ReadoutPrice(b.Low), "Close  " + ReadoutPrice(b.Close),
            "Vol  " + Volume(b.Volume)};
}

std::vector<std::string> DayCountReadout(const chart::Chart& chart, double xA, double xB) {
    int a = BarUnder(chart, xA);
    int b = BarUnder(chart, xB);
    if (a < 0 || b < 0) return {};
    if (a > b) std::swap(a, b);
    const auto& bars = chart.ChartBars();
    const auto da = platform::DaySerial(bars[static_cast<std::size_t>(a)].DateText());
    const auto db = platform::DaySerial(bars[static_cast<std::size_t>(b)].DateText());
    std::vector<std::string> out = {"Trading days  " + std::to_string(b - a)};
    if (da && db) out.push_back("Calendar days  " + std::to_string(*db - *da));
    return out;
}

std::vector<std::string> RiseFallReadout(const chart::Chart& chart, double xDown, double x) {
    int a = BarUnder(chart, xDown);
    int b = BarUnder(chart, x);
    if (a < 0 || b < 0) return {};
    const auto& bars = chart.ChartBars();
    const double first = bars[static_cast<std::size_t>(a)].Close;
    const double last = bars[static_cast<std::size_t>(b)].Close;
    if (a > b) std::swap(a, b);
    double high = 0, low = 0, volume = 0;
    bool any = false;
    for (int i = a; i <= b; ++i) {
        const auto& bar = bars[static_cast<std::size_t>(i)];
        volume += bar.Volume;
        const double h = bar.High != 0 ? bar.High : bar.Close;
        const double l = bar.Low != 0 ? bar.Low : bar.Close;
        if (h == 0 && l == 0) continue;
        if (!any || h > high) high = h;
        if (!any || l < low) low = l;
        any = true;
    }
    const double rise = std::max(0.0, high - first);
    const double fall = std::max(0.0, first - low);
    return {"Rise  " + ReadoutPrice(rise), "Fall  " + ReadoutPrice(fall),
            "Total  " + ReadoutPrice(last - first), "Vol  " + Volume(volume)};
}

} // namespace kori::app

#include "store/price_file.h"

namespace kori::app {

int PriceRecordCount(const Session& session, std::string_view code) {
    store::PriceFile pf(
        store::PriceFile::PathFor(session.folders.DataFolder, platform::Trim(code)));
    if (!pf.Open()) return 0;
    return pf.Count();
}

std::string PriceRecordDate(const Session& session, std::string_view code, int recordNumber) {
    store::PriceFile pf(
        store::PriceFile::PathFor(session.folders.DataFolder, platform::Trim(code)));
    store::PriceRecord r;
    if (!pf.Open() || !pf.Read(recordNumber, r)) return {};
    return r.Date;
}

} // namespace kori::app
