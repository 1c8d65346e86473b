#pragma once
// The rows of an editing grid and what every such grid does with them: a cell checked as the
// user leaves it, rows inserted and deleted, a sort by one column, a check of every cell before
// the rows are written, and whether anything changed since they were read. The class windows
// use it now; the editors, scan results and update lists that come are grids of the same kind.
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

// The answer of a cell check: the text to keep (the text itself, or a code formatted, say), or
// a refusal with the message the user sees.
struct CellVerdict {
    bool Accepted = true;
    std::string Text;
    std::string Message;
    std::string Title;   // of the message box; empty: the grid's own title
    bool Revert = false; // refused, and the cell keeps the text it had (a column not edited)
};

struct CellRefusal {
    int Row = 0, Column = 0;
    std::string Message;
    std::string Title; // empty: the grid's own title
};

class GridModel {
public:
    using Row = std::vector<std::string>;
    using CellCheck = std::function<CellVerdict(int column, const std::string& text)>;

    // `hiddenColumns`: cells each row carries after the shown ones, which no view shows and no
    // check reads (the fields of a record the grid does not show), moved with their row.
    explicit GridModel(std::vector<std::string> headers, CellCheck check = {},
                       int hiddenColumns = 0);

    const std::vector<std::string>& headers() const { return m_headers; }
    int rowCount() const { return static_cast<int>(m_rows.size()); }
    int columnCount() const { return static_cast<int>(m_headers.size()); }
    const std::vector<Row>& rows() const { return m_rows; }
    // A shown or a hidden cell (hidden ones follow the shown ones).
    const std::string& cell(int row, int column) const;
    int hiddenColumnCount() const { return m_hidden; }
    // A column the user may not edit: a change to it is refused with this message and the cell
    // keeps its text. Loads and whole-grid checks pass it as it stands.
    void SetReadOnly(int column, std::string message, std::string title = {});
    // Sets a cell from the program (a read-only or a hidden one too); the grid has changed
    // unless the cell is hidden.
    void PutCell(int row, int column, std::string text);
    // Sets a hidden cell; nothing counts as changed.
    void SetHiddenCell(int row, int column, std::string text);

    // Rows as read from a file: cut or padded to the columns, each cell put in the form its
    // check gives where it passes. Nothing counts as changed.
    void Load(std::vector<Row> rows);
    // Rows the program made already in the form their checks give: taken as they are, without
    // running a check over every cell (a long file loads at the speed of its reading).
    void LoadInForm(std::vector<Row> rows);
    // A cell the user left: kept in the form the check gives, or kept as typed when refused
    // (the verdict carries the message). Either way the grid has changed.
    CellVerdict SetCell(int row, int column, std::string text);
    // A blank row at `at` (the end when out of range); its index.
    int InsertRow(int at);
    bool DeleteRow(int row);
    // All rows at once, put in form by the checks as Load does, and the grid has changed.
    void ReplaceRows(std::vector<Row> rows);
    // Rows in text order of `column`, rows with that cell blank last, ties in their order.
    // Every cell must pass first; otherwise the first refusal and no sort.
    std::optional<CellRefusal> SortBy(int column);
    // The first cell, row by row, that its check refuses.
    std::optional<CellRefusal> FirstRefusal() const;
    // The rows with every cell trimmed, as a file takes them.
    std::vector<Row> TrimmedRows() const;

    bool changed() const { return m_changed; }
    void MarkSaved() { m_changed = false; }

private:
    CellVerdict Check(int column, const std::string& text) const;
    void PutInForm(std::vector<Row>& rows) const;
    std::size_t Width() const { return m_headers.size() + static_cast<std::size_t>(m_hidden); }

    std::vector<std::string> m_headers;
    CellCheck m_check;
    int m_hidden = 0;
    struct ReadOnlyColumn {
        int Column;
        std::string Message, Title;
    };
    std::vector<ReadOnlyColumn> m_readOnly;
    std::vector<Row> m_rows;
    bool m_changed = false;
};

} // namespace kori::app
