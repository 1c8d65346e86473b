#include "app/name_form_model.h"

#include "maint/security_details.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list_relink.h"
#include "store/master_list.h"
#include "store/name_file.h"

namespace kori::app {

namespace nt = store::name_text;
namespace dlt = store::delete_text;
using platform::Answer;
using platform::Buttons;

namespace {
GridModel::CellCheck NameCheck() {
    return [](int column, const std::string& text) -> CellVerdict {
        const store::CellRule r = store::CheckNameCell(column, text);
        return {r.Accepted, r.Text, r.Message, r.Title};
    };
}
} // namespace

NameFormModel::NameFormModel(std::string dataFolder, std::string systemFolder, int dataService,
                             platform::Dialogs& dialogs, platform::Progress& progress,
                             platform::IniFile& ini)
    : m_folder(platform::FolderWithSlash(dataFolder)), m_systemFolder(std::move(systemFolder)),
      m_dataService(dataService), m_dialogs(dialogs), m_progress(progress), m_ini(ini),
      m_grid(store::NameGridHeaders(), NameCheck(), store::kNameHiddenColumns) {
    m_grid.SetReadOnly(store::kNameRec, "Cannot edit this column", std::string(nt::kFileTitle));
}

std::string NameFormModel::Caption() const {
    if (m_dataService == 1 || m_dataService == 3) return std::string(nt::kNoTradeCaption);
    return std::string(nt::kCaption) + "  " + m_folder;
}

void NameFormModel::LoadRecords(const std::vector<store::NameRecord>& records, bool changed) {
    std::vector<GridModel::Row> rows;
    rows.reserve(records.size());
    for (std::size_t i = 0; i < records.size(); ++i)
        rows.push_back(store::NameRowOf(records[i], static_cast<int>(i + 1)));
    if (changed)
        m_grid.ReplaceRows(std::move(rows));
    else
        m_grid.Load(std::move(rows));
}

void NameFormModel::SetRows(std::vector<store::TextRow> rows) {
    m_grid.ReplaceRows(std::move(rows));
}

std::vector<store::NameRecord> NameFormModel::GridRecords() const {
    std::vector<store::NameRecord> out;
    out.reserve(m_grid.rows().size());
    for (const auto& row : m_grid.rows())
        if (!platform::Trim(row[store::kNameCode]).empty()) out.push_back(store::NameRecordOf(row));
    return out;
}

bool NameFormModel::ShowNames() {
    const auto path = store::NameFile::PathIn(m_folder);
    std::vector<store::NameRecord> records;
    store::NameFile file(path);
    if (platform::FileExists(path))
        if (auto s = file.ReadAll(records); !s) {
            m_dialogs.MsgBox(s.message(), nt::kNoRecordsTitle);
            m_grid.Load({});
            return false;
        }
    if (records.empty()) {
        m_dialogs.MsgBox(std::string(nt::kNoRecords) + path.filename().string(),
                         nt::kNoRecordsTitle);
        m_grid.Load({});
        return false;
    }
    LoadRecords(records, false);
    return true;
}

bool NameFormModel::SaveNames() {
    m_refusal = store::CheckNameRows(m_grid.rows());
    if (m_refusal) {
        m_dialogs.MsgBox(m_refusal->Message, m_refusal->Title);
        return false;
    }
    const auto records = store::NameRecordsToSave(m_grid.rows());
    if (auto s = store::SaveNameFile(m_folder, records); !s) {
        m_dialogs.MsgBox(std::string(nt::kSaveFailed) + "\n" + s.message(), nt::kSaveTitle);
        return false;
    }
    LoadRecords(records, false);
    const auto relink = store::RelinkChartLists(m_folder, m_progress);
    if (!relink.Status) m_dialogs.MsgBox(relink.Status.message(), store::kRelinkStatus);
    return true;
}

bool NameFormModel::Sort(store::NameSortOrder order) {
    std::vector<store::NameRecord> sorted;
    if (auto s = store::SortNamesThroughFiles(m_folder, GridRecords(), order, m_progress, sorted);
        !s) {
        m_dialogs.MsgBox(s.message(), nt::kFileTitle);
        return false;
    }
    LoadRecords(sorted, true);
    return true;
}

int NameFormModel::Dupnames() {
    if (m_dialogs.MsgBox(nt::kSortFirst, nt::kFileTitle, Buttons::YesNo) != Answer::Yes) return -1;
    if (!Sort(store::NameSortOrder::Code)) return -1;
    auto rows = m_grid.rows();
    const int removed = store::RemoveDuplicateCodes(rows);
    if (removed > 0) SetRows(std::move(rows));
    m_dialogs.MsgBox(std::to_string(removed) + std::string(nt::kDuplicatesRemoved), nt::kFileTitle);
    return removed;
}

int NameFormModel::DeleteWarrants() {
    if (m_dialogs.MsgBox(std::string(nt::kWarrantsWarning) + "\n" + std::string(nt::kContinue),
                         nt::kWarrantsTitle, Buttons::OkCancel) != Answer::Ok)
        return -1;
    auto rows = m_grid.rows();
    const int removed = store::RemoveWarrantRows(rows);
    if (removed > 0) SetRows(std::move(rows));
    m_dialogs.MsgBox(std::to_string(removed) + std::string(nt::kWarrantsRemoved), nt::kFileTitle);
    store::WriteNoWarrantKeys(m_ini);
    return removed;
}

int NameFormModel::RemoveExpiredOptions() {
    auto rows = m_grid.rows();
    const int removed = store::RemoveExpiredOptionRows(rows);
    if (removed > 0) SetRows(std::move(rows));
    return removed;
}

bool NameFormModel::CleanOptionalDetails() {
    if (m_dialogs.MsgBox(nt::kCleanQuestion, nt::kFileTitle, Buttons::OkCancel) != Answer::Ok)
        return false;
    auto rows = m_grid.rows();
    store::CleanOptionalDetails(rows);
    SetRows(std::move(rows));
    return true;
}

void NameFormModel::TitleCase() {
    auto rows = m_grid.rows();
    store::TitleCaseNames(rows);
    SetRows(std::move(rows));
}

int NameFormModel::GdSpecial() {
    auto rows = m_grid.rows();
    const int changed = store::RefreshOptionDetails(rows);
    if (changed > 0) SetRows(std::move(rows));
    return changed;
}

int NameFormModel::UpdateNames() {
    const auto master = store::ReadMasterRecords(m_systemFolder);
    if (!master) {
        m_dialogs.MsgBox(std::string(store::kMasterMissing) + "\n" +
                             std::string(store::kMasterDownload),
                         nt::kFileTitle);
        return -1;
    }
    auto rows = m_grid.rows();
    const int changed = store::UpdateNamesFromMaster(rows, store::MasterNames(*master));
    if (changed > 0) SetRows(std::move(rows));
    m_dialogs.MsgBox(std::to_string(changed) + std::string(nt::kNamesUpdated), nt::kFileTitle);
    return changed;
}

int NameFormModel::UpdateIC_from_Stock() {
    auto rows = m_grid.rows();
    const int changed = store::CopyClassFromUnderlying(rows);
    if (changed > 0) SetRows(std::move(rows));
    m_dialogs.MsgBox(std::to_string(changed) + std::string(nt::kClassesUpdated), nt::kFileTitle);
    return changed;
}

int NameFormModel::UpdateGICS() {
    const auto sectors = maint::GicsSectorsFromDetails(m_systemFolder);
    if (!sectors) {
        m_dialogs.MsgBox(nt::kNoSectorColumn, nt::kFileTitle);
        return -1;
    }
    auto rows = m_grid.rows();
    const int changed = store::UpdateGicsSectors(rows, *sectors);
    if (changed > 0) SetRows(std::move(rows));
    m_dialogs.MsgBox(std::to_string(changed) + std::string(nt::kSectorsUpdated), nt::kFileTitle);
    return changed;
}

namespace {
bool InRange(int first, int last, int rows) {
    return first >= 1 && last >= first && last <= rows;
}
} // namespace

bool NameFormModel::ChangeCategory(int first, int last) {
    if (!InRange(first, last, m_grid.rowCount())) return false;
    const std::string current = platform::Trim(m_grid.cell(first - 1, store::kNameCat));
    const auto answer = m_dialogs.InputBox(std::string(nt::kCurrentCategory) + current + "\n" +
                                               std::string(nt::kEnterCategory),
                                           nt::kCategoryPromptTitle, current);
    if (!answer) return false;
    const auto category = store::CategoryAnswer(*answer);
    if (!category) {
        m_dialogs.MsgBox(nt::kCategoryRange, nt::kCategoryTitle);
        return false;
    }
    for (int r = first - 1; r < last; ++r)
        m_grid.PutCell(r, store::kNameCat, std::to_string(*category));
    return true;
}

bool NameFormModel::ChangeRecordType(int first, int last) {
    if (!InRange(first, last, m_grid.rowCount())) return false;
    const std::string current = platform::Trim(m_grid.cell(first - 1, store::kNameType));
    const auto answer = m_dialogs.InputBox(std::string(nt::kCurrentType) + current + "\n" +
                                               std::string(nt::kEnterType),
                                           nt::kTypePromptTitle, current);
    if (!answer) return false;
    const auto type = store::RecordTypeAnswer(*answer);
    if (!type) {
        m_dialogs.MsgBox("Record Type must be either 4 or 5", nt::kTypePromptTitle);
        return false;
    }
    // Only securities of types 4 and 5 change between them; statistics and lines stay.
    for (int r = first - 1; r < last; ++r) {
        const std::string t = platform::Trim(m_grid.cell(r, store::kNameType));
        if (t == "4" || t == "5") m_grid.PutCell(r, store::kNameType, std::to_string(*type));
    }
    return true;
}

bool NameFormModel::DeleteRows(int first, int last) {
    if (first < 1) {
        m_dialogs.MsgBox(dlt::kOnlyTransactions, dlt::kTransactionTitle);
        return false;
    }
    if (!InRange(first, last, m_grid.rowCount())) return false;
    if (m_dialogs.MsgBox(store::DeleteRowsQuestion(first, last), dlt::kTitle, Buttons::YesNo) !=
        Answer::Yes)
        return false;
    auto rows = m_grid.rows();
    rows.erase(rows.begin() + (first - 1), rows.begin() + last);
    SetRows(std::move(rows));
    return true;
}

int NameFormModel::AddRow() {
    return m_grid.InsertRow(m_grid.rowCount());
}

bool NameFormModel::Close() {
    if (!m_grid.changed()) return true;
    if (m_dialogs.MsgBox(nt::kChangedQuestion, nt::kFileTitle, Buttons::YesNo) != Answer::Yes)
        return true;
    return SaveNames();
}

} // namespace kori::app
