#include "app/targets_form.h"

#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_record.h"
#include "store/targets_file.h"

#include <map>

namespace kori::app {

namespace {

enum Column { CodeColumn = 0, TargetColumn = 1, DirectionColumn = 2 };

constexpr const char* kUpOrDown = "Up or Down";
constexpr const char* kMustBeUorD = "Must be either U or D";

// Blank cells pass, so a half-typed row can be left; Save asks for the missing fields.
CellVerdict CheckTargetCell(int column, const std::string& typed) {
    const std::string text = platform::Trim(typed);
    if (text.empty()) return {true, text, {}, {}};
    if (text.find(',') != std::string::npos) return {false, typed, "Commas cannot be used", {}};
    switch (column) {
    case CodeColumn:
        if (!store::IsValidCode(text)) return {false, typed, "Not a valid security code", {}};
        return {true, platform::Upper(text), {}, {}};
    case TargetColumn:
        if (!platform::IsNumber(text) || !(platform::Val(text) > 0))
            return {false, typed, "The target must be a price above 0", {}};
        return {true, platform::Format(platform::Val(text), "0.00#"), {}, {}};
    case DirectionColumn: {
        const std::string d = platform::Upper(text);
        if (d != "U" && d != "D") return {false, typed, kMustBeUorD, kUpOrDown};
        return {true, d, {}, {}};
    }
    default:
        return {true, text, {}, {}};
    }
}

bool RowIsBlank(const GridModel& g, int row) {
    for (int c = 0; c < g.columnCount(); ++c)
        if (!platform::Trim(g.cell(row, c)).empty()) return false;
    return true;
}

} // namespace

TargetsForm::TargetsForm(std::string systemFolder, platform::Dialogs& dialogs)
    : m_systemFolder(std::move(systemFolder)), m_dialogs(dialogs),
      m_grid({"Code", "Target $", "Up/Down"}, CheckTargetCell) {}

void TargetsForm::Load() {
    std::vector<GridModel::Row> rows;
    for (const auto& line : store::ReadTargetsFile(store::TargetsFilePath(m_systemFolder)))
        rows.push_back({line.Code, line.Target, line.Direction});
    m_grid.Load(std::move(rows));
    KeepBlankRow();
    m_grid.MarkSaved(); // the row to type into is no change
    m_refusal.reset();
}

bool TargetsForm::KeepBlankRow() {
    const int n = m_grid.rowCount();
    if (n > 0 && RowIsBlank(m_grid, n - 1)) return false;
    const bool wasChanged = m_grid.changed();
    m_grid.InsertRow(n);
    if (!wasChanged) m_grid.MarkSaved();
    return true;
}

bool TargetsForm::DeleteRow(int row) {
    if (!m_grid.DeleteRow(row)) return false;
    KeepBlankRow();
    return true;
}

bool TargetsForm::SortList() {
    if (auto r = m_grid.SortBy(CodeColumn)) return Refuse(*r);
    m_refusal.reset();
    return true;
}

bool TargetsForm::Refuse(CellRefusal r) {
    m_dialogs.MsgBox(r.Message, r.Title.empty() ? kTitle : r.Title);
    m_refusal = std::move(r);
    return false;
}

bool TargetsForm::Save() {
    if (auto r = m_grid.FirstRefusal()) return Refuse(*r);
    std::vector<store::TargetLine> lines;
    std::map<std::string, int> perCode;
    for (int row = 0; row < m_grid.rowCount(); ++row) {
        if (RowIsBlank(m_grid, row)) continue;
        const std::string code = platform::Trim(m_grid.cell(row, CodeColumn));
        const std::string target = platform::Trim(m_grid.cell(row, TargetColumn));
        const std::string direction = platform::Trim(m_grid.cell(row, DirectionColumn));
        if (code.empty()) return Refuse({row, CodeColumn, "Enter the code", {}});
        if (target.empty()) return Refuse({row, TargetColumn, "Enter the target price", {}});
        if (direction.empty()) return Refuse({row, DirectionColumn, kMustBeUorD, kUpOrDown});
        if (++perCode[code] > kMaxPerStock) return Refuse({row, CodeColumn, kMaxLabel, {}});
        lines.push_back({code, target, direction});
    }
    if (auto s = store::WriteTargetsFile(store::TargetsFilePath(m_systemFolder), lines); !s) {
        m_dialogs.MsgBox(s.message(), kTitle);
        m_refusal.reset();
        return false;
    }
    m_grid.MarkSaved();
    m_refusal.reset();
    return true;
}

bool TargetsForm::CanClose() {
    if (!m_grid.changed()) return true;
    switch (m_dialogs.MsgBox("The targets have changed. Save the changes?", kTitle,
                             platform::Buttons::YesNoCancel, platform::Icon::Question)) {
    case platform::Answer::Yes:
        return Save();
    case platform::Answer::No:
        return true;
    default:
        return false;
    }
}

} // namespace kori::app
