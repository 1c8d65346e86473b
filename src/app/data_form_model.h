#pragma once
// The state and rules of the data-file editor window (DataForm) and of the code entry window
// that leads to it: one price file in a grid, row number = record number, saved whole.
#include "app/grid_model.h"
#include "maint/vol_mod.h"
#include "platform/dialogs.h"
#include "platform/issues.h"
#include "platform/progress.h"
#include "store/data_editor.h"

#include <filesystem>
#include <optional>
#include <string>

namespace kori::app {

// The code entry window's answer: the price file of a typed code, or nullopt after the message
// "Invalid Code" for a code that cannot name a file.
std::optional<std::filesystem::path>
DataFileForCode(std::string_view dataFolder, std::string_view code, platform::Dialogs& dialogs);

class DataFormModel {
public:
    DataFormModel(std::filesystem::path file, std::string code, platform::Dialogs& dialogs,
                  platform::Progress& progress);

    GridModel& grid() { return m_grid; }
    const GridModel& grid() const { return m_grid; }
    const std::string& code() const { return m_code; }
    // Records whose prices are not numbers, found by the last load.
    const platform::Issues& issues() const { return m_issues; }

    // ShowData: false (with the message) when the file is missing or empty.
    bool ShowData();
    // SaveData: every cell checked first (the first refusal shown, in `refusal()`), then the
    // file written whole with Temp.WRK kept.
    bool SaveData();
    const std::optional<CellRefusal>& refusal() const { return m_refusal; }
    // The rows in date order, written as the file through Temp.Wk2 and read back.
    bool SortData();
    // Rows first..last, 1-based.
    bool DeleteRows(int first, int last);
    // nmAdjVol / VolMod over rows first..last; false with the message when refused.
    bool AdjustVolumes(int first, int last, std::optional<maint::VolItem> item, maint::VolOp op,
                       int factor);
    bool Close();

private:
    void Renumber();

    std::filesystem::path m_file;
    std::string m_code;
    platform::Dialogs& m_dialogs;
    platform::Progress& m_progress;
    GridModel m_grid;
    platform::Issues m_issues;
    std::optional<CellRefusal> m_refusal;
};

} // namespace kori::app
