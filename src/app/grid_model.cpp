#include "app/grid_model.h"

#include "platform/text.h"

#include <algorithm>

namespace kori::app {

namespace {
const std::string kEmpty;
}

GridModel::GridModel(std::vector<std::string> headers, CellCheck check, int hiddenColumns)
    : m_headers(std::move(headers)), m_check(std::move(check)),
      m_hidden(std::max(0, hiddenColumns)) {}

const std::string& GridModel::cell(int row, int column) const {
    if (row < 0 || row >= rowCount() || column < 0 || column >= columnCount() + m_hidden)
        return kEmpty;
    return m_rows[static_cast<std::size_t>(row)][static_cast<std::size_t>(column)];
}

void GridModel::SetReadOnly(int column, std::string message, std::string title) {
    m_readOnly.push_back({column, std::move(message), std::move(title)});
}

void GridModel::PutCell(int row, int column, std::string text) {
    if (row < 0 || row >= rowCount() || column < 0 || column >= columnCount() + m_hidden) return;
    m_rows[static_cast<std::size_t>(row)][static_cast<std::size_t>(column)] = std::move(text);
    if (column < columnCount()) m_changed = true;
}

void GridModel::SetHiddenCell(int row, int column, std::string text) {
    if (row < 0 || row >= rowCount() || column < columnCount() ||
        column >= columnCount() + m_hidden)
        return;
    m_rows[static_cast<std::size_t>(row)][static_cast<std::size_t>(column)] = std::move(text);
}

CellVerdict GridModel::Check(int column, const std::string& text) const {
    if (!m_check) return {true, text, {}, {}};
    return m_check(column, text);
}

void GridModel::PutInForm(std::vector<Row>& rows) const {
    for (Row& r : rows) {
        r.resize(Width());
        for (std::size_t c = 0; c < m_headers.size(); ++c) {
            CellVerdict v = Check(static_cast<int>(c), r[c]);
            if (v.Accepted) r[c] = std::move(v.Text);
        }
    }
}

void GridModel::Load(std::vector<Row> rows) {
    m_rows = std::move(rows);
    PutInForm(m_rows);
    m_changed = false;
}

void GridModel::LoadInForm(std::vector<Row> rows) {
    m_rows = std::move(rows);
    for (Row& r : m_rows)
        if (r.size() != Width()) r.resize(Width());
    m_changed = false;
}

void GridModel::ReplaceRows(std::vector<Row> rows) {
    m_rows = std::move(rows);
    PutInForm(m_rows);
    m_changed = true;
}

CellVerdict GridModel::SetCell(int row, int column, std::string text) {
    if (row < 0 || row >= rowCount() || column < 0 || column >= columnCount())
        return {false, text, "No such cell", {}};
    for (const auto& ro : m_readOnly)
        if (ro.Column == column) {
            const std::string& had =
                m_rows[static_cast<std::size_t>(row)][static_cast<std::size_t>(column)];
            return {false, had, ro.Message, ro.Title, true};
        }
    CellVerdict v = Check(column, text);
    std::string& stored = m_rows[static_cast<std::size_t>(row)][static_cast<std::size_t>(column)];
    if (!v.Accepted && v.Revert) {
        v.Text = stored; // a column that is not edited keeps what it had
        return v;
    }
    stored = v.Accepted ? v.Text : text;
    if (!v.Accepted) v.Text = text;
    m_changed = true;
    return v;
}

int GridModel::InsertRow(int at) {
    if (at < 0 || at > rowCount()) at = rowCount();
    m_rows.insert(m_rows.begin() + at, Row(Width()));
    m_changed = true;
    return at;
}

bool GridModel::DeleteRow(int row) {
    if (row < 0 || row >= rowCount()) return false;
    m_rows.erase(m_rows.begin() + row);
    m_changed = true;
    return true;
}

std::optional<CellRefusal> GridModel::FirstRefusal() const {
    for (int r = 0; r < rowCount(); ++r)
        for (int c = 0; c < columnCount(); ++c) {
            const CellVerdict v = Check(c, cell(r, c));
            if (!v.Accepted) return CellRefusal{r, c, v.Message, v.Title};
        }
    return std::nullopt;
}

std::optional<CellRefusal> GridModel::SortBy(int column) {
    if (auto refused = FirstRefusal()) return refused;
    if (column < 0 || column >= columnCount()) return std::nullopt;
    const auto c = static_cast<std::size_t>(column);
    auto sorted = m_rows;
    std::stable_sort(sorted.begin(), sorted.end(), [c](const Row& a, const Row& b) {
        const std::string ka = platform::Trim(a[c]), kb = platform::Trim(b[c]);
        if (ka.empty() != kb.empty()) return kb.empty();
        return ka < kb;
    });
    if (sorted != m_rows) {
        m_rows = std::move(sorted);
        m_changed = true;
    }
    return std::nullopt;
}

std::vector<GridModel::Row> GridModel::TrimmedRows() const {
    std::vector<Row> out = m_rows;
    for (Row& r : out)
        for (std::string& cellText : r)
            cellText = platform::Trim(cellText);
    return out;
}

} // namespace kori::app
