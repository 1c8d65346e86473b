#include "app/data_form_model.h"

#include "platform/text.h"
#include "store/name_record.h"
#include "store/price_file.h"

namespace kori::app {

namespace dt = store::data_text;
namespace dlt = store::delete_text;
using platform::Answer;
using platform::Buttons;

std::optional<std::filesystem::path>
DataFileForCode(std::string_view dataFolder, std::string_view code, platform::Dialogs& dialogs) {
    if (!store::IsValidCode(platform::Trim(code))) {
        dialogs.MsgBox("Invalid Code", dt::kTitle);
        return std::nullopt;
    }
    return store::PriceFile::PathFor(dataFolder, platform::Upper(platform::Trim(code)));
}

namespace {
GridModel::CellCheck DataCheck() {
    return [](int column, const std::string& text) -> CellVerdict {
        const store::CellRule r = store::CheckDataCell(column, text);
        return {r.Accepted, r.Text, r.Message, r.Title};
    };
}
} // namespace

DataFormModel::DataFormModel(std::filesystem::path file, std::string code,
                             platform::Dialogs& dialogs, platform::Progress& progress)
    : m_file(std::move(file)), m_code(platform::Upper(platform::Trim(code))), m_dialogs(dialogs),
      m_progress(progress),
      m_grid(store::DataGridHeaders(), DataCheck(), store::kDataHiddenColumns) {
    m_grid.SetReadOnly(store::kDataRec, std::string(dt::kCannotEdit), std::string(dt::kCellTitle));
    m_grid.SetReadOnly(store::kDataAdjFactor, std::string(dt::kCannotEdit),
                       std::string(dt::kCellTitle));
}

bool DataFormModel::ShowData() {
    auto load = store::LoadDataRows(m_file, m_code, m_progress);
    m_issues = std::move(load.Issues);
    if (!load.Ok) {
        m_dialogs.MsgBox(load.Message, load.Title);
        m_grid.Load({});
        return false;
    }
    m_grid.LoadInForm(std::move(load.Rows)); // the cells are as the checks would leave them
    return true;
}

bool DataFormModel::SaveData() {
    m_refusal = m_grid.FirstRefusal();
    if (m_refusal) {
        m_dialogs.MsgBox(m_refusal->Message,
                         m_refusal->Title.empty() ? dt::kCellTitle : m_refusal->Title);
        return false;
    }
    if (auto s = store::SaveDataRows(m_file, m_grid.rows(), m_progress); !s) {
        m_dialogs.MsgBox(std::string(dt::kSaveFailed) + "\n" + s.message(), dt::kTitle);
        return false;
    }
    m_grid.MarkSaved();
    return true;
}

bool DataFormModel::SortData() {
    m_refusal = m_grid.FirstRefusal();
    if (m_refusal) {
        m_dialogs.MsgBox(m_refusal->Message,
                         m_refusal->Title.empty() ? dt::kCellTitle : m_refusal->Title);
        return false;
    }
    std::vector<store::TextRow> sorted;
    if (auto s = store::SortDataRows(m_file, m_grid.rows(), m_progress, sorted); !s) {
        m_dialogs.MsgBox(std::string(dt::kSaveFailed) + "\n" + s.message(), dt::kTitle);
        return false;
    }
    m_grid.LoadInForm(std::move(sorted)); // the file now holds what the grid shows
    return true;
}

void DataFormModel::Renumber() {
    for (int r = 0; r < m_grid.rowCount(); ++r)
        if (m_grid.cell(r, store::kDataRec) != std::to_string(r + 1))
            m_grid.PutCell(r, store::kDataRec, std::to_string(r + 1));
}

bool DataFormModel::DeleteRows(int first, int last) {
    if (first < 1) {
        m_dialogs.MsgBox(dlt::kOnlyTransactions, dlt::kTransactionTitle);
        return false;
    }
    if (last < first || last > m_grid.rowCount()) return false;
    if (m_dialogs.MsgBox(store::DeleteRowsQuestion(first, last), dlt::kTitle, Buttons::YesNo) !=
        Answer::Yes)
        return false;
    auto rows = m_grid.rows();
    rows.erase(rows.begin() + (first - 1), rows.begin() + last);
    m_grid.ReplaceRows(std::move(rows));
    Renumber();
    return true;
}

bool DataFormModel::AdjustVolumes(int first, int last, std::optional<maint::VolItem> item,
                                  maint::VolOp op, int factor) {
    if (const auto refusal = maint::VolModRefusal(item, op)) {
        m_dialogs.MsgBox(*refusal, maint::vol_mod_text::kCaption);
        if (item) m_dialogs.Beep();
        return false;
    }
    if (first < 1 || last < first || last > m_grid.rowCount()) return false;
    const int column = store::kDataOpen + static_cast<int>(*item);
    for (int r = first - 1; r < last; ++r)
        if (const auto text = maint::VolModCell(m_grid.cell(r, column), *item, op, factor))
            m_grid.PutCell(r, column, *text);
    // The window counts as changed even when every cell was 0 and stayed.
    m_grid.PutCell(first - 1, store::kDataRec, m_grid.cell(first - 1, store::kDataRec));
    return true;
}

bool DataFormModel::Close() {
    if (!m_grid.changed()) return true;
    if (m_dialogs.MsgBox(std::string(dt::kChanged) + "\n" + dt::SaveQuestion(m_code), dt::kTitle,
                         Buttons::YesNo) != Answer::Yes)
        return true;
    return SaveData();
}

} // namespace kori::app
