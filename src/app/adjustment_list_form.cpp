#include "app/adjustment_list_form.h"

#include "app/adjustment_forms.h"
#include "platform/text.h"

#include <algorithm>

namespace kori::app {

using platform::Answer;
using platform::Buttons;
using platform::Status;
using platform::Trim;

namespace {

constexpr std::string_view kIndicatorTitle = "Adjustment ";
constexpr std::string_view kIndicatorText =
    "Adjustment indicator can be Y, N or D\n Y = process,  N = do not process and  D = Delete "
    "this from list";
constexpr std::string_view kFoldersUndefined =
    "Separate destination folders for data have not been defined. Select Folder Locations and "
    "define data folders.";

adjust::DividendRule DivsRule(std::int16_t divs) {
    return divs >= 2 && divs <= 4 ? static_cast<adjust::DividendRule>(divs)
                                  : adjust::DividendRule::Leave;
}

bool NoFoldersDefined(const Session& s) {
    return std::all_of(s.chartDataPaths.begin(), s.chartDataPaths.end(),
                       [](const std::string& p) { return Trim(p).empty(); });
}

} // namespace

std::string AdjustmentListFolder(const Session& s) {
    if (s.download.DataService == 3 && !Trim(s.chartDataPaths[0]).empty())
        return s.chartDataPaths[0];
    return s.folders.DataFolder;
}

adjust::ListSettings ListSettingsOf(const Session& s) {
    adjust::ListSettings l;
    l.In = s.download.In;
    l.Out = s.download.Out;
    l.OptionsFolder = s.chartDataPaths[4];
    l.NoWarrants = s.download.NoWarrants;
    l.NoShortNames = s.adjustments.NoShortNames;
    l.Divs = DivsRule(s.adjustments.Divs);
    return l;
}

adjust::MakeSettings MakeSettingsOf(Session& s) {
    adjust::MakeSettings m;
    m.DataService = s.download.DataService;
    m.DataFolder = AdjustmentListFolder(s);
    for (std::size_t i = 0; i < m.Folders.size(); ++i)
        m.Folders[i] = s.chartDataPaths[i];
    m.ChtMiscFolder = s.folders.ChtMiscFolder;
    m.NoteColour = AdjustmentNoteColour(s);
    m.Today = s.services().clock.Today();
    return m;
}

intake::UpdateHooks AdjustmentHooks(Session& session, bool& newItems) {
    intake::UpdateHooks hooks;
    hooks.UpdateAdjustmentsList = [&session, &newItems](const std::string& folder,
                                                        const std::string& stem) {
        adjust::ListUpdate u;
        const auto st = adjust::UpdateAdjustmentsList(folder, stem, ListSettingsOf(session),
                                                      session.services().progress, u);
        // A file error ends the bulletin run; the update itself has done its work.
        if (!st) session.dialogs().MsgBox(st.message(), adjust::kItemsAddedTitle);
        newItems = newItems || u.NewItems;
    };
    return hooks;
}

bool TellItemsAdded(Session& session, bool newItems) {
    if (!newItems) return false;
    session.dialogs().MsgBox(adjust::kItemsAdded, adjust::kItemsAddedTitle);
    return true;
}

std::string ListHeading(int column) {
    switch (column) {
    case 0:
        return "Act";
    case 1:
        return "Code";
    case 2:
        return "File";
    case 4:
        return "ADJ";
    case 5:
        return "Name";
    default:
        return "";
    }
}

AdjustmentListForm::AdjustmentListForm(Session& session)
    : m_session(session), m_folder(AdjustmentListFolder(session)) {}

bool AdjustmentListForm::Load() {
    if (m_session.download.DataService == 3 && NoFoldersDefined(m_session)) {
        m_session.dialogs().MsgBox(kFoldersUndefined, "Data Paths");
        return false;
    }
    if (auto st = adjust::ReadAdjustmentList(m_folder, m_items); !st) {
        m_session.dialogs().MsgBox(st.message(), kAdjListCaption);
        m_items.clear();
    }
    m_edited = false;
    return true;
}

std::string AdjustmentListForm::Label() const {
    return std::string(m_items.empty() ? kNoBulletinData : kClickMake);
}

std::string AdjustmentListForm::Cell(int row, int column) const {
    if (row < 0 || row >= static_cast<int>(m_items.size())) return {};
    return m_items[static_cast<std::size_t>(row)].Field(static_cast<std::size_t>(column) + 1);
}

bool AdjustmentListForm::SetCell(int row, int column, const std::string& value) {
    if (row < 0 || row >= static_cast<int>(m_items.size()) || column < 0 ||
        column >= static_cast<int>(adjust::kMaxFields))
        return false;
    std::string v = platform::Upper(Trim(value));
    if (column == 4 && v != "Y" && v != "N" && v != "D") {
        m_session.dialogs().MsgBox(kIndicatorText, kIndicatorTitle);
        return false;
    }
    if (v.find(',') != std::string::npos) return false; // a comma would split the item
    m_items[static_cast<std::size_t>(row)].SetField(static_cast<std::size_t>(column) + 1, v);
    m_edited = true;
    return true;
}

void AdjustmentListForm::SetAll(const std::string& indicator) {
    for (auto& item : m_items)
        item.SetField(5, indicator);
    m_edited = m_edited || !m_items.empty();
}

void AdjustmentListForm::RemoveTag(const std::string& tag) {
    const auto before = m_items.size();
    std::erase_if(m_items, [&](const adjust::ListItem& i) { return Trim(i.Field(3)) == tag; });
    m_edited = m_edited || before != m_items.size();
}

bool AdjustmentListForm::DeleteRows(int first, int last) {
    if (first > last) std::swap(first, last);
    if (first < 0 || last >= static_cast<int>(m_items.size())) return false;
    const std::string question = first == last ? "Delete row " + std::to_string(first + 1) + " ?"
                                               : "Delete items " + std::to_string(first + 1) +
                                                     " to " + std::to_string(last + 1) + " ?";
    if (m_session.dialogs().MsgBox(question, "Delete Rows", Buttons::YesNo) != Answer::Yes)
        return false;
    m_items.erase(m_items.begin() + first, m_items.begin() + last + 1);
    m_edited = true;
    return true;
}

void AdjustmentListForm::Sort() {
    m_session.services().progress.SetStatus(kSorting);
    adjust::SortByRank(m_items);
    m_edited = true;
}

Status AdjustmentListForm::RemoveMarkedD() {
    std::erase_if(m_items, [](const adjust::ListItem& i) { return Trim(i.Indicator()) == "D"; });
    return Save();
}

Status AdjustmentListForm::Save() {
    auto st = adjust::WriteAdjustmentList(m_folder, m_items);
    if (st) m_edited = false;
    return st;
}

Status AdjustmentListForm::Make(adjust::MakeReport& report,
                                std::function<void(std::size_t)> onRow) {
    auto settings = MakeSettingsOf(m_session);
    settings.OnRow = std::move(onRow);
    m_session.dialogs().SetBusy(true);
    const auto st =
        adjust::MakeAdjustments(settings, m_items, m_session.services().progress, report);
    m_session.dialogs().SetBusy(false);
    m_processed = true;
    if (st)
        m_edited = false;
    else
        (void)adjust::ReadAdjustmentList(m_folder, m_items); // the file is what stands
    return st;
}

bool AdjustmentListForm::QueryClose(bool& process) {
    process = false;
    auto& dialogs = m_session.dialogs();
    if (m_edited && dialogs.MsgBox("File has changed. SAVE Changes?", "Adjustments List",
                                   Buttons::YesNo) == Answer::Yes) {
        if (auto st = Save(); !st) {
            dialogs.MsgBox(st.message(), "Adjustments List");
            return false;
        }
    }
    if (!m_processed && !m_items.empty() &&
        dialogs.MsgBox("You have not processed the adjustments.Do you want to process these now ?",
                       "Process Adjustments", Buttons::YesNo) == Answer::Yes)
        process = true;
    return true;
}

std::vector<std::string> AdjustmentOptionsForm::DivsChoices() {
    return {"Do not include dividends in list", "Include dividends - Set ADJ indicator to Y",
            "Include dividends - Set ADJ indicator to N",
            "Include dividends - Set ADJ indicator to D"};
}

AdjustmentOptionsForm AdjustmentOptionsForm::Read(const Session& s) {
    AdjustmentOptionsForm f;
    f.Divs = static_cast<int>(DivsRule(s.adjustments.Divs));
    f.NoShortNames = s.adjustments.NoShortNames;
    return f;
}

void AdjustmentOptionsForm::Save(Session& s) const {
    s.adjustments.Divs = static_cast<std::int16_t>(std::clamp(Divs, 1, 4));
    s.adjustments.NoShortNames = NoShortNames;
    WriteAdjustmentSettings(s.ini(), s.adjustments);
}

} // namespace kori::app
