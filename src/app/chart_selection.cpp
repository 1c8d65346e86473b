#include "app/chart_selection.h"

#include "osc/osc_identifiers.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/classifications.h"
#include "store/name_file.h"
#include "store/name_record.h"

#include <algorithm>
#include <cctype>
#include <filesystem>

namespace kori::app {

const std::vector<OscChoice>& OscChoices() {
    static const std::vector<OscChoice> rows = [] {
        std::vector<OscChoice> r{{"(None)", "", false}};
        for (const osc::OscChoice& c : osc::ChooserOrder())
            r.push_back(
                {std::string(osc::ChooserCaption(c)), std::string(c.OscName), c.SlowStochastic});
        return r;
    }();
    return rows;
}

int OscChoiceOf(const chart::ChartRequest& r) {
    if (!r.AutoOsc) return 0;
    const auto& rows = OscChoices();
    for (std::size_t i = 1; i < rows.size(); ++i)
        if (r.AutoOscCode == rows[i].Code &&
            (r.AutoOscCode != "STO" || rows[i].Slow == r.AutoOscSlow))
            return static_cast<int>(i);
    return 0;
}

int StyleIndexOf(char style) {
    for (std::size_t i = 0; i < kStyleLetters.size(); ++i)
        if (kStyleLetters[i] == style) return static_cast<int>(i);
    return 2;
}

int PeriodIndexOf(char period) {
    for (std::size_t i = 0; i < kPeriodLetters.size(); ++i)
        if (kPeriodLetters[i] == period) return static_cast<int>(i);
    return 0;
}

std::optional<std::string> ParseFinishDate(std::string_view typed) {
    const std::string t = platform::Trim(typed);
    int parts[3] = {0, 0, 0};
    int digits[3] = {0, 0, 0};
    int field = 0;
    for (char ch : t) {
        if (ch == '/') {
            if (++field > 2) return std::nullopt;
            continue;
        }
        if (!std::isdigit(static_cast<unsigned char>(ch))) return std::nullopt;
        parts[field] = parts[field] * 10 + (ch - '0');
        if (++digits[field] > 4) return std::nullopt;
    }
    if (field != 2 || digits[0] == 0 || digits[0] > 2 || digits[1] == 0 || digits[1] > 2)
        return std::nullopt;
    int year = parts[2];
    if (digits[2] == 2)
        year += year < 30 ? 2000 : 1900;
    else if (digits[2] != 4)
        return std::nullopt;
    const platform::CivilDate d{year, parts[1], parts[0]};
    const std::string text = platform::DateText(d);
    if (!platform::IsValidDateText(text)) return std::nullopt;
    return text;
}

int TypedSpacing(int value, char style) {
    int v = value < 1 ? 2 : (value > 20 ? 20 : value);
    if (style == 'C' && v < 3) v = 3;
    return v;
}

ChartSelection::ChartSelection(Session& session, ChartState& state)
    : m_session(session), m_state(state), m_walk(session) {}

void ChartSelection::ShowAverages() {
    const auto& d = m_state.Defaults;
    const bool longer = m_form.PeriodIndex != 0;
    m_form.AvOnePeriod = longer ? d.MAPeriod1Long : d.MAPeriod1Daily;
    m_form.AvTwoPeriod = longer ? d.MAPeriod2Long : d.MAPeriod2Daily;
    m_form.AvOne = m_state.Request.AvOne;
    m_form.AvTwo = m_state.Request.AvTwo;
}

bool ChartSelection::Load() {
    auto& r = m_state.Request;
    m_state.Defaults = chart::LoadChartDefaults(m_session.ini());
    const std::string dataFolder = m_session.folders.DataFolder;
    std::error_code ec;
    if (!std::filesystem::is_directory(platform::ResolvePath(dataFolder), ec)) {
        m_session.dialogs().MsgBox("The directory path " + dataFolder +
                                       " is invalid. Change to the correct path and try again.",
                                   "Chart Selection");
        return false;
    }
    if (!m_state.SettingsLoaded) {
        chart::LoadChartRequestSettings(m_session.ini(), r);
        r.ListMode = 1;
        r.ListName.clear();
        r.AutoOsc = false;
        r.AutoOscCode.clear();
        r.ChartBands = 0;
    }
    m_form.StyleIndex = StyleIndexOf(r.ChartStyle);
    m_form.PeriodIndex = PeriodIndexOf(r.ChartPeriod);
    m_form.OscIndex = m_state.SettingsLoaded ? OscChoiceOf(r) : 0;
    m_form.BandIndex = m_state.SettingsLoaded ? std::clamp<int>(r.ChartBands, 0, 2) : 0;
    m_form.Spacing = r.BarSpacing;
    ShowAverages();
    if (r.ListMode >= 12) r.ListMode = 1;
    // A name file that exists but cannot be used says why (a missing one is the empty library).
    if (!m_walk.Open(r) &&
        platform::FileExists(store::NameFile::PathIn(m_session.folders.DataFolder)))
        m_session.dialogs().MsgBox(m_walk.status().message(), "Chart Selection");
    m_form.ListCaption = m_walk.Caption();
    m_state.SettingsLoaded = true;
    m_form.Count = m_walk.Count();
    if (r.ListPosition > m_form.Count || r.ListPosition < 1) r.ListPosition = 1;
    ShowRecord(r.ListPosition);
    m_form.ChoosersEnabled = r.ChartStyle != 'P';
    m_form.VolumeOn = r.ShowVolume;
    m_form.FinishText = r.ByFinishDate ? platform::DateTextToShort(r.FinishDate) : kLatest;
    if (r.ByFinishDate) {
        // "d/m/yy": the short form without its leading zeros.
        const auto d = platform::ParseDateText(r.FinishDate);
        if (d)
            m_form.FinishText = std::to_string(d->day) + "/" + std::to_string(d->month) + "/" +
                                r.FinishDate.substr(2, 2);
    }
    return true;
}

void ChartSelection::Activate() {
    if (!m_state.ListChanged) {
        // Back from the chart window: show where it got to, in the style and period it used.
        auto& r = m_state.Request;
        m_form.PeriodIndex = PeriodIndexOf(r.ChartPeriod);
        m_form.StyleIndex = StyleIndexOf(r.ChartStyle);
        m_form.Spacing = r.BarSpacing;
        ShowAverages();
        if (r.ListPosition >= 1 && r.ListPosition <= m_walk.Count()) ShowRecord(r.ListPosition);
        return;
    }
    m_state.ListChanged = false;
    m_walk.Open(m_state.Request);
    if (m_state.Request.ListMode != 1) {
        SetClassWalk(false, false);
        SetClassWalk(true, false);
    }
    m_form.ListCaption = m_walk.Caption();
    m_form.Count = m_walk.Count();
    m_state.Request.ListPosition = 1;
    ShowRecord(1);
}

void ChartSelection::ApplyStyleRule(const store::NameRecord& rec) {
    auto& r = m_state.Request;
    // The chooser shows the line for close-only types; the request takes it at "SHOW CHART".
    if (IsCloseOnly(rec.RecordType)) {
        if (r.ChartStyle != 'P' || !m_state.SettingsLoaded) m_form.StyleIndex = 2;
    } else {
        m_form.StyleIndex = StyleIndexOf(r.ChartStyle);
    }
    m_form.SpacingCaption = r.ChartStyle == 'P' ? "Point Reversal" : "Chart Spacing";
}

void ChartSelection::ShowRecord(int position) {
    m_form.Position = position;
    const auto rec = m_walk.RecordAt(position);
    if (!rec) {
        m_form.Code.clear();
        m_form.Name.clear();
        return;
    }
    m_form.Code = platform::Trim(rec->Code);
    m_form.Name = platform::Trim(rec->Name);
    ApplyStyleRule(*rec);
}

void ChartSelection::ForceSpacing() {
    if (m_form.Spacing < 1 || m_form.Spacing > 20) m_form.Spacing = 2;
    m_state.Request.BarSpacing = static_cast<std::int16_t>(m_form.Spacing);
}

bool ChartSelection::TypeCode(std::string_view typed) {
    const std::string t = platform::Trim(typed);
    if (t.empty()) return false;
    const std::string wanted = store::PadCode(t);
    const int count = m_walk.Count();
    auto take = [&](int pos) {
        m_state.Request.ListPosition = static_cast<std::int16_t>(pos);
        ShowRecord(pos);
        m_state.Request.ChartPeriod = 'A';
        m_form.PeriodIndex = 0;
        ShowAverages();
        ForceSpacing();
    };
    for (int pos = 1; pos <= count; ++pos) {
        const auto rec = m_walk.RecordAt(pos);
        if (rec && store::PadCode(rec->Code) == wanted) {
            take(pos);
            return true;
        }
    }
    if (m_session.dialogs().MsgBox("No record on file for that code - Find nearest code ?",
                                   "Chart Selection", platform::Buttons::YesNo,
                                   platform::Icon::Question) != platform::Answer::Yes)
        return false;
    const std::string head = wanted.substr(0, 3);
    for (int pos = 1; pos <= count; ++pos) {
        const auto rec = m_walk.RecordAt(pos);
        if (rec && store::PadCode(rec->Code).substr(0, 3) >= head) {
            take(pos);
            return false;
        }
    }
    return false;
}

void ChartSelection::ScrollTo(int value) {
    int v = value;
    if (v > m_walk.Count() || v < 1) {
        v = 1;
        m_session.dialogs().Beep();
    }
    if ((m_state.ClassWalk || m_state.GicsWalk) && m_state.Request.ListMode == 1) {
        m_state.Request.ListPosition = static_cast<std::int16_t>(v - 1);
        FindNextClass();
        return;
    }
    m_state.Request.ListPosition = static_cast<std::int16_t>(v);
    ShowRecord(v);
}

void ChartSelection::SetClassWalk(bool gics, bool on) {
    if (gics) {
        m_state.GicsWalk = on;
        m_state.GicsCode.clear();
        if (on) m_state.ClassWalk = false;
    } else {
        m_state.ClassWalk = on;
        m_state.ClassCode.clear();
        if (on) m_state.GicsWalk = false;
    }
}

bool ChartSelection::SetClassCode(bool gics, std::string_view code) {
    const std::string c = platform::Trim(code);
    const std::string sys = m_session.folders.SystemFolder;
    // A code of the table, or a group ("..0") that some code of the table falls in.
    bool known = false;
    if (!c.empty())
        for (const auto& row :
             store::ReadClassFile(sys, gics ? "Gics.dat" : "IndClass.dat", gics ? 3 : 2)) {
            const std::string id = row.empty() ? std::string() : platform::Trim(row[0]);
            if (id == c ||
                (c.back() == '0' && id.size() == c.size() && id.substr(0, 2) == c.substr(0, 2)))
                known = true;
        }
    if (!known) {
        if (gics)
            m_session.dialogs().MsgBox("GICS Classification invalid", "Chart Select");
        else
            m_session.dialogs().MsgBox("Industry Classification invalid", "Analysis");
        SetClassWalk(gics, false);
        return false;
    }
    SetClassWalk(gics, true);
    (gics ? m_state.GicsCode : m_state.ClassCode) = c;
    m_state.Request.ListPosition = 0;
    return FindNextClass();
}

bool ChartSelection::FindNextClass() {
    const bool gics = m_state.GicsWalk;
    const std::string& code = gics ? m_state.GicsCode : m_state.ClassCode;
    const int pos =
        store::FindNextClassRecord(m_walk.names(), m_state.Request.ListPosition, code, gics);
    if (pos == 0) {
        if (gics)
            m_session.dialogs().MsgBox("No records on file for that GICS classification",
                                       "GICS Classification");
        else
            m_session.dialogs().MsgBox(
                "No records on file for that Industry classification or group",
                "Industry Classification");
        return false;
    }
    auto& r = m_state.Request;
    r.ListPosition = static_cast<std::int16_t>(pos);
    const auto rec = m_walk.RecordAt(pos);
    if (rec) r.ChartStyle = IsCloseOnly(rec->RecordType) ? 'L' : 'B';
    ShowRecord(pos);
    r.ChartPeriod = 'A';
    m_form.PeriodIndex = 0;
    ShowAverages();
    ForceSpacing();
    return true;
}

void ChartSelection::StepSpacing(int delta) {
    int v = m_form.Spacing + delta;
    if (v <= 0) v = 10;
    if (v > 10) v = 1;
    if (m_state.Request.ChartStyle == 'C' && v < 3) {
        v = 3;
        m_session.dialogs().Beep();
    }
    m_form.Spacing = v;
}

void ChartSelection::TypeSpacingValue(int value) {
    m_form.Spacing = TypedSpacing(value, m_state.Request.ChartStyle);
}

void ChartSelection::ChooseStyle(int index) {
    auto& r = m_state.Request;
    index = std::clamp(index, 0, 3);
    r.ChartStyle = kStyleLetters[static_cast<std::size_t>(index)];
    m_form.StyleIndex = index;
    if (r.ChartStyle == 'P') {
        m_form.SpacingCaption = "Point Reversal";
        r.ChartPeriod = 'A';
        m_form.PeriodIndex = 0;
        m_form.ChoosersEnabled = false;
        r.AutoOsc = false;
        m_form.OscIndex = 0;
        r.ByFinishDate = false;
        m_form.FinishText = kLatest;
        ShowAverages();
    } else {
        m_form.SpacingCaption = "Chart Spacing";
        m_form.ChoosersEnabled = true;
        if (r.ChartStyle == 'C' && m_form.Spacing < 3) m_form.Spacing = 3;
    }
}

void ChartSelection::ChoosePeriod(int index) {
    if (m_state.Request.ChartStyle == 'P') return;
    index = std::clamp(index, 0, 2);
    m_state.Request.ChartPeriod = kPeriodLetters[static_cast<std::size_t>(index)];
    m_form.PeriodIndex = index;
    ShowAverages();
}

void ChartSelection::ChooseOscillator(int index) {
    const auto& rows = OscChoices();
    if (index < 0 || index >= static_cast<int>(rows.size())) index = 0;
    auto& r = m_state.Request;
    m_form.OscIndex = index;
    r.AutoOsc = index != 0;
    r.AutoOscCode = rows[static_cast<std::size_t>(index)].Code;
    r.AutoOscSlow = rows[static_cast<std::size_t>(index)].Slow;
}

bool ChartSelection::ChooseBands(int index, std::optional<std::pair<int, int>> values) {
    index = std::clamp(index, 0, 2);
    if (index != 0 && values) {
        const auto [up, down] = *values;
        if (up < 0 || up > 100 || down < 0 || down > 100) {
            m_session.dialogs().MsgBox("Values must be between 0 - 100", "Bands");
            return false;
        }
        if (auto rec = Current()) {
            rec->PercentBandUp = static_cast<std::int16_t>(up);
            rec->PercentBandDown = static_cast<std::int16_t>(down);
            if (auto s = m_walk.WriteRecordAt(m_form.Position, *rec); !s)
                m_session.dialogs().MsgBox(s.message(), "Bands");
        }
    }
    m_form.BandIndex = index;
    m_state.Request.ChartBands = static_cast<std::int16_t>(index);
    return true;
}

void ChartSelection::SetAverage(int which, bool on) {
    if (which == 1)
        m_state.Request.AvOne = on;
    else
        m_state.Request.AvTwo = on;
    ShowAverages();
}

void ChartSelection::SetVolume(bool on) {
    m_form.VolumeOn = on;
    m_state.Request.ShowVolume = on;
}

bool ChartSelection::FinishDateClicked() {
    if (m_state.Request.ChartStyle == 'P') return false;
    if (m_form.FinishText == kLatest) return true;
    m_form.FinishText = kLatest;
    m_state.Request.ByFinishDate = false;
    return false;
}

bool ChartSelection::SetFinishDate(std::optional<std::string> typed) {
    auto& r = m_state.Request;
    if (!typed) {
        m_form.FinishText = kLatest;
        r.ByFinishDate = false;
        return true;
    }
    const auto date = ParseFinishDate(*typed);
    if (!date) {
        m_session.dialogs().MsgBox(kDateFormatMessage, "Date");
        return false;
    }
    m_form.FinishText = platform::Trim(*typed);
    r.FinishDate = *date;
    r.ByFinishDate = true;
    return true;
}

void ChartSelection::WriteSettings() {
    chart::SaveChartRequestSettings(m_session.ini(), m_state.Request);
}

void ChartSelection::ShowChart() {
    auto& r = m_state.Request;
    r.ScrollMode = false;
    r.ChartStyle = kStyleLetters[static_cast<std::size_t>(m_form.StyleIndex)];
    r.ChartPeriod = kPeriodLetters[static_cast<std::size_t>(m_form.PeriodIndex)];
    r.BarSpacing =
        static_cast<std::int16_t>(r.ChartStyle == 'P' && m_form.Spacing < 2 ? 2 : m_form.Spacing);
    if (r.ChartStyle != 'P') {
        r.ChartBands = static_cast<std::int16_t>(m_form.BandIndex);
        ChooseOscillator(m_form.OscIndex);
    } else {
        r.AutoOsc = false;
        r.ChartBands = 0;
    }
    r.ShowVolume = m_form.VolumeOn;
    r.AvOnePeriod = static_cast<std::int16_t>(m_form.AvOnePeriod);
    r.AvTwoPeriod = static_cast<std::int16_t>(m_form.AvTwoPeriod);
    WriteSettings();
    r.ListPosition = static_cast<std::int16_t>(m_form.Position - 1);
}

void ChartSelection::Close() {
    const auto& r = m_state.Request;
    auto& ini = m_session.ini();
    const char* s = "Charts";
    if (r.ChartStyle != ' ') ini.Write(s, "Type", std::string(1, r.ChartStyle));
    if (r.ChartPeriod != ' ') ini.Write(s, "Period", std::string(1, r.ChartPeriod));
    if (m_form.Spacing >= 1 && m_form.Spacing <= 10)
        ini.Write(s, "Spacing", std::to_string(m_form.Spacing));
    if (r.ChartBands == 1 || r.ChartBands == 2) ini.Write(s, "Bands", std::to_string(r.ChartBands));
    ini.Write(s, "AutoOsc", r.AutoOsc ? "True" : "False");
    if (r.ListMode >= 1 && r.ListMode <= 3) ini.Write(s, "List", std::to_string(r.ListMode));
    ini.Write(s, "AvOne", r.AvOne ? "True" : "False");
    ini.Write(s, "AvTwo", r.AvTwo ? "True" : "False");
}

void ChartSelection::ChangeList(int listMode, std::string listName) {
    auto& r = m_state.Request;
    r.ListMode = static_cast<std::int16_t>(listMode < 1 || listMode > 12 ? 1 : listMode);
    r.ListName = r.ListMode == 1 ? std::string() : std::move(listName);
    r.ListPosition = 0;
    m_state.ListChanged = true;
}

void ChartSelection::FolderChanged() {
    m_state.Request.ListMode = 1;
    m_state.Request.ListName.clear();
    m_state.Request.ListPosition = 1;
    Load();
}

} // namespace kori::app

namespace kori::app {

int FindNextMatch(const std::vector<store::NameRecord>& names, int afterPosition,
                  std::string_view text) {
    const std::string wanted = platform::Upper(platform::Trim(text));
    if (wanted.empty()) return 0;
    for (int pos = std::max(afterPosition, 0) + 1; pos <= static_cast<int>(names.size()); ++pos) {
        const auto& r = names[static_cast<std::size_t>(pos - 1)];
        if (platform::Upper(r.Code).find(wanted) != std::string::npos ||
            platform::Upper(r.Name).find(wanted) != std::string::npos)
            return pos;
    }
    return 0;
}

} // namespace kori::app
