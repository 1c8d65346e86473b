#pragma once
// Targets ("Quoren Alerts"): the price targets of Targets.txt in a grid of code, target and
// direction, checked cell by cell, kept with one blank row at the end to type a new target
// into, and written back whole.
#include "app/grid_model.h"
#include "platform/dialogs.h"

#include <optional>
#include <string>

namespace kori::app {

class TargetsForm {
public:
    static constexpr const char* kTitle = "Quoren Alerts";
    static constexpr const char* kMaxLabel = "Max. 2 alerts per stock";
    static constexpr int kMaxPerStock = 2;

    TargetsForm(std::string systemFolder, platform::Dialogs& dialogs);

    GridModel& grid() { return m_grid; }
    const GridModel& grid() const { return m_grid; }
    bool changed() const { return m_grid.changed(); }

    // The file into the grid (codes upper case, targets as "0.00#"), plus the blank row.
    void Load();
    // After any edit: a blank row stays at the end. True when one was added.
    bool KeepBlankRow();
    // "&Delete Row": the row goes (the blank row at the end is put back).
    bool DeleteRow(int row);
    // "&Sort List": by code, blank rows last. False (with the message) when a cell is refused.
    bool SortList();
    // "&Save": every row checked (a row needs all three fields, a code at most two rows), then
    // the file written beside the old one and renamed over it. False with the message shown,
    // and `refusal()` names the cell to go back to.
    bool Save();
    // Closing: with changes, asks whether to save them first. False keeps the window open.
    bool CanClose();

    const std::optional<CellRefusal>& refusal() const { return m_refusal; }

private:
    bool Refuse(CellRefusal r);

    std::string m_systemFolder;
    platform::Dialogs& m_dialogs;
    GridModel m_grid;
    std::optional<CellRefusal> m_refusal;
};

} // namespace kori::app
