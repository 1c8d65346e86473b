#include "app/download_settings_form.h"

#include "app/folder_config.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/master_list.h"
#include "store/name_editor.h"

#include <algorithm>

namespace kori::app {

using platform::Answer;
using platform::Buttons;
using platform::Icon;
using platform::Trim;
using platform::Upper;

namespace {

bool EndsWithSeparator(std::string_view folder) {
    return !folder.empty() && (folder.back() == '/' || folder.back() == '\\');
}

// The install root stands for the drive the program was installed on.
std::string Drive(const Session& session) {
    return platform::FolderWithSlash(session.root().string());
}

constexpr std::array<std::string_view, ModDetailsForm::kFormatItems> kFormatValues = {
    "DDMMMYY.D", "YYMMDD.D", "YYMMDD.ASX", "DDMMYY.D", "DDMMYY.ASX", "DDMMYYYY.D", "YYYYMMDD.D"};

bool IsDivisor(std::string_view text) {
    const std::string t = Trim(text);
    return t == "1" || t == "10" || t == "100" || t == "1000" || t == "10000";
}

} // namespace

// --- ModDetails ----------------------------------------------------------------------------

const std::array<std::string_view, ModDetailsForm::kServiceItems>& ModDetailsForm::ServiceItems() {
    static const std::array<std::string_view, kServiceItems> items = {
        "KORI/Zevot ( All ASX  and Indices) ", "Other Internet data "};
    return items;
}

const std::array<std::string_view, ModDetailsForm::kFormatItems>& ModDetailsForm::FormatItems() {
    static const std::array<std::string_view, kFormatItems> items = {
        "ddMMMyy.d        (eg 15SEP98.d)", "yymmdd.d          (eg 980915.d)",
        "yymmdd.ASX     (eg 980915.ASX)",  "ddmmyy.d          (eg 150998.d)",
        "ddmmyy.ASX     (eg 150998.ASX)",  "ddmmyyyy.d       (eg 15091998.d",
        "yyyymmdd.d       (eg 19980915.d"};
    return items;
}

std::string_view ModDetailsForm::FormatValue(int item) {
    if (item < 0 || item >= kFormatItems) return {};
    return kFormatValues[static_cast<std::size_t>(item)];
}

std::int16_t ModDetailsForm::ServiceValue(int item) {
    if (item == 0) return 3;
    if (item == 1) return 4;
    return 1;
}

ModDetailsForm::ModDetailsForm(Session& session) : m_session(session) {
    const auto& d = session.download;
    m_service = d.DataService == 3 ? 0 : d.DataService == 4 ? 1 : -1;
    const std::string dl = Trim(session.ini().Read("Download", "DLPath"));
    m_folder = dl == platform::kUnknown ? std::string() : dl;
    const std::string form = Upper(Trim(d.InternetDLfmt));
    for (int i = 0; i < kFormatItems; ++i)
        if (form == kFormatValues[static_cast<std::size_t>(i)]) m_format = i;
    m_divisor = std::to_string(d.VolumeDivisor);
}

void ModDetailsForm::ChooseService(int item) {
    m_service = item;
    if (item == 0 && Trim(m_folder).empty()) m_folder = Drive(m_session) + "koriwin/download/Out/";
    if (item == 1 && Trim(m_folder).size() < 3) m_folder = Drive(m_session) + "NetData/";
}

bool ModDetailsForm::LeaveDivisor(std::string text) {
    m_divisor = std::move(text);
    if (IsDivisor(m_divisor)) return true;
    m_session.dialogs().MsgBox("Volume divisor can only be either 1, 10,  100,  1000  or 10000",
                               "Volume Divisor", Buttons::Ok, Icon::Exclamation);
    return false;
}

bool ModDetailsForm::Save() {
    const std::string folder = Trim(m_folder);
    if (!EndsWithSeparator(folder)) {
        m_session.dialogs().MsgBox("Path must end with a backslash \\ ", "Download", Buttons::Ok,
                                   Icon::Exclamation);
        return false;
    }
    // The divisor only matters where it is shown; elsewhere what is stored stays.
    if (internetControlsShown() && !LeaveDivisor(m_divisor)) return false;
    const std::int16_t service = ServiceValue(m_service);
    const std::string form = service == 4 ? std::string(FormatValue(m_format)) : std::string();
    auto& ini = m_session.ini();
    (void)ini.Write("Download", "DataService", std::to_string(service));
    (void)ini.Write("Download", "DLPath", folder);
    (void)ini.Write("Download", "InternetDLfmt", form);
    if (IsDivisor(m_divisor)) (void)ini.Write("Download", "Volume divisor", Trim(m_divisor));
    // The session reads the keys back by their load rules, so it holds what start-up would.
    m_session.ReadFolders();
    return true;
}

// --- DLWizard -------------------------------------------------------------------------------

const std::array<std::string_view, kDataTypeCount>& DownloadWizardForm::Labels() {
    static const std::array<std::string_view, kDataTypeCount> labels = {
        "All ASX stocks, warrants", "ASX Indices",
        "Overseas Indices etc.",    "SFE Futures",
        "Put / Call Options",       "London Stocks.",
        "London Indices",           "London Liffe Futures"};
    return labels;
}

std::size_t DownloadWizardForm::FolderOf(int row) {
    // The window lists overseas before futures; the data-folder list has them the other way.
    static constexpr std::array<std::size_t, kDataTypeCount> folders = {0, 1, 3, 2, 4, 5, 6, 7};
    return folders.at(static_cast<std::size_t>(row));
}

DownloadWizardForm::DownloadWizardForm(Session& session) : m_session(session) {
    const auto paths = ReadChartPathsFile(session.folders.SystemFolder + "ChtPaths.lst");
    for (int row = 0; row < kDataTypeCount; ++row) {
        const auto at = static_cast<std::size_t>(row);
        if (paths) m_folders[at] = (*paths)[FolderOf(row)];
        m_received[at] = !Trim(m_folders[at]).empty();
    }
}

bool DownloadWizardForm::Save() {
    ChartDataPaths paths;
    for (int row = 0; row < kDataTypeCount; ++row) {
        const auto at = static_cast<std::size_t>(row);
        if (!m_received[at]) continue;
        std::string& path = paths[FolderOf(row)];
        path = Trim(m_folders[at]);
        if (path.empty()) {
            m_session.dialogs().MsgBox("Enter the folder for " + std::string(Labels()[at]), kTitle,
                                       Buttons::Ok, Icon::Exclamation);
            return false;
        }
    }
    return SaveDataPaths(m_session, paths);
}

// --- INUpList -------------------------------------------------------------------------------

const std::array<std::string_view, 3>& UpdateListForm::OptionLabels() {
    static const std::array<std::string_view, 3> labels = {"Update ALL STOCKS",
                                                           "Update ALL stocks but exclude WARRANTS",
                                                           "Update ONLY the stocks listed below"};
    return labels;
}

namespace {

constexpr const char* kListTitle = "Update List";

CellVerdict CheckUpdateCell(int column, const std::string& text) {
    CellVerdict v;
    v.Text = text;
    if (text.find(',') != std::string::npos) {
        v.Accepted = false;
        v.Message = "Commas cannot be used";
        return v;
    }
    if (column == 0) v.Text = Upper(Trim(text));
    if (column == 1) {
        const std::string t = Trim(text);
        const bool number = !t.empty() && std::all_of(t.begin(), t.end(), [](unsigned char c) {
            return c >= '0' && c <= '9';
        });
        if (t.empty()) return v;
        if (!number || t.size() > 2) {
            v.Accepted = false;
            v.Message = "Category must be in the range 0 to 99";
            return v;
        }
        v.Text = std::to_string(std::stoi(t));
    }
    return v;
}

std::vector<std::string> Lines(std::string_view text) {
    std::vector<std::string> lines;
    std::size_t start = 0;
    while (start < text.size()) {
        std::size_t end = text.find('\n', start);
        if (end == std::string_view::npos) end = text.size();
        std::string line(text.substr(start, end - start));
        if (!line.empty() && line.back() == '\r') line.pop_back();
        lines.push_back(std::move(line));
        start = end + 1;
    }
    return lines;
}

} // namespace

UpdateListForm::UpdateListForm(Session& session)
    : m_session(session), m_grid({"ASX Code", "CAT.", "Name"}, CheckUpdateCell) {}

void UpdateListForm::Load() {
    const auto& d = m_session.download;
    m_option = !d.UpdateAll ? kListedOnly : d.NoWarrants ? kNoWarrants : kAllStocks;
    m_optionChanged = false;
    std::vector<GridModel::Row> rows;
    const std::string& system = m_session.folders.SystemFolder;
    if (const auto text = platform::ReadWholeFile(platform::ResolveIn(system, "Update.Lst"))) {
        for (const auto& line : Lines(*text)) {
            if (Trim(line).empty()) continue;
            GridModel::Row row(3);
            std::size_t start = 0;
            for (std::size_t f = 0; f < 3; ++f) {
                const std::size_t comma = f < 2 ? line.find(',', start) : std::string::npos;
                row[f] = Trim(line.substr(start, comma == std::string::npos ? std::string::npos
                                                                            : comma - start));
                if (comma == std::string::npos) break;
                start = comma + 1;
            }
            rows.push_back(std::move(row));
        }
    }
    m_grid.Load(std::move(rows));

    auto master = store::ReadMasterRecords(system);
    m_masterPresent = master.has_value();
    m_master = master ? std::move(*master)
                      : std::vector<std::string>{std::string(store::kMasterMissing),
                                                 std::string(store::kMasterDownload)};
}

void UpdateListForm::ChooseOption(int option) {
    if (option == m_option) return;
    m_option = option;
    m_optionChanged = true;
    if (option != kListedOnly) return;
    m_session.dialogs().MsgBox(std::string("IMPORTANT !! ") +
                                   "Selecting this option only allows the stocks in this list to "
                                   "be updated during the download process." +
                                   " ALL OTHER STOCKS ARE IGNORED. ",
                               kListTitle, Buttons::Ok, Icon::Exclamation);
}

int UpdateListForm::AddMasterItems(const std::vector<int>& indices) {
    if (!m_masterPresent) return 0;
    int added = 0;
    for (const int i : indices) {
        if (i < 0 || i >= static_cast<int>(m_master.size())) continue;
        const int row = m_grid.InsertRow(m_grid.rowCount());
        const auto entry = store::ParseMasterRecord(m_master[static_cast<std::size_t>(i)]);
        const GridModel::Row cells{entry.Code, "0", entry.Name};
        for (int c = 0; c < 3; ++c)
            m_grid.PutCell(row, c, cells[static_cast<std::size_t>(c)]);
        ++added;
    }
    return added;
}

int UpdateListForm::AddRows() {
    const auto answer = m_session.dialogs().InputBox("Enter number of rows to add (1 - 200)",
                                                     "Add Blank Row/s to list", "1");
    if (!answer) return 0;
    const double n = platform::Val(*answer);
    if (n < 1 || n > 200) return 0;
    const int count = static_cast<int>(n);
    for (int i = 0; i < count; ++i)
        m_grid.InsertRow(m_grid.rowCount());
    return count;
}

bool UpdateListForm::DeleteRows(int first, int last) {
    if (first > last) std::swap(first, last);
    if (first < 0 || last >= m_grid.rowCount()) return false;
    if (m_session.dialogs().MsgBox(store::DeleteRowsQuestion(first + 1, last + 1),
                                   store::delete_text::kTitle, Buttons::YesNo,
                                   Icon::Question) != Answer::Yes)
        return false;
    for (int r = last; r >= first; --r)
        m_grid.DeleteRow(r);
    return true;
}

bool UpdateListForm::Save() {
    if (const auto refusal = m_grid.FirstRefusal()) {
        m_session.dialogs().MsgBox(refusal->Message, kListTitle, Buttons::Ok, Icon::Exclamation);
        return false;
    }
    std::string text;
    int listed = 0;
    for (const auto& row : m_grid.TrimmedRows()) {
        if (row[0].empty()) continue; // a row without a code takes nothing
        text += row[0] + "," + (row[1].empty() ? std::string("0") : row[1]) + "," + row[2] + "\r\n";
        ++listed;
    }
    if (m_option == kListedOnly && listed == 0) {
        m_session.dialogs().MsgBox(
            "You have selected the option to update only stocks the stocks listed, but THERE ARE "
            "NO STOCKS LISTED. Your option will be reset to update All Stocks.",
            kListTitle, Buttons::Ok, Icon::Exclamation);
        m_option = kAllStocks;
    }
    const auto path = platform::ResolveIn(m_session.folders.SystemFolder, "Update.Lst");
    const bool hadList = platform::FileExists(path);
    const auto status =
        platform::WriteFileAtomic(path, text, {"", hadList ? std::string("Update.Bak") : ""});
    if (!status.ok()) {
        m_session.dialogs().MsgBox(status.message(), kListTitle, Buttons::Ok, Icon::Critical);
        return false;
    }
    auto& d = m_session.download;
    d.UpdateAll = m_option != kListedOnly;
    d.NoWarrants = m_option == kNoWarrants;
    (void)m_session.ini().Write("Download", "UpdateAll", BoolText(d.UpdateAll));
    (void)m_session.ini().Write("Download", "NoWarrants", BoolText(d.NoWarrants));
    m_grid.MarkSaved();
    m_optionChanged = false;
    return true;
}

bool UpdateListForm::CanClose() {
    if (!changed()) return true;
    const Answer a = m_session.dialogs().MsgBox("File has changed. SAVE Changes?", kListTitle,
                                                Buttons::YesNoCancel, Icon::Question);
    if (a == Answer::Cancel) return false;
    if (a == Answer::Yes) return Save();
    return true;
}

DownloadUpdateOpens WhatDownloadUpdateOpens(Session& session) {
    const std::string& folder = session.folders.DownloadFolder;
    if (platform::FileExists(folder)) return DownloadUpdateOpens::List;
    const std::string text = "The download folder " + folder +
                             " does not exist. Show the Download Settings to choose another?";
    return session.dialogs().MsgBox(text, "Downloaded Data", Buttons::YesNo, Icon::Question) ==
                   Answer::Yes
               ? DownloadUpdateOpens::Settings
               : DownloadUpdateOpens::Nothing;
}

} // namespace kori::app
