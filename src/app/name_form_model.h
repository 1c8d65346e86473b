#pragma once
// The state and rules of the name-file editor window (NameForm): the grid of Names.dat with the
// fields it does not show carried in hidden cells, and every menu command. The window shows the
// grid and passes the user's commands in; questions and messages go through the dialogs.
#include "app/grid_model.h"
#include "platform/dialogs.h"
#include "platform/ini_file.h"
#include "platform/progress.h"
#include "store/name_editor.h"

#include <optional>
#include <string>

namespace kori::app {

class NameFormModel {
public:
    // The system folder holds the master list and the downloaded security details that the
    // three "Update ..." commands read.
    NameFormModel(std::string dataFolder, std::string systemFolder, int dataService,
                  platform::Dialogs& dialogs, platform::Progress& progress, platform::IniFile& ini);

    GridModel& grid() { return m_grid; }
    const GridModel& grid() const { return m_grid; }
    // The top label: "NAMES.DAT" and the folder, or the no-trade note for services 1 and 3.
    std::string Caption() const;

    // ShowNames: the file into the grid; false (with the message) when it holds no record.
    bool ShowNames();
    // SaveNames: every row checked (the first refused one in `refusal()` for the cursor), the
    // file written with names.bak kept, the grid read back, the chart lists re-linked.
    bool SaveNames();
    const std::optional<store::RowRefusal>& refusal() const { return m_refusal; }

    bool Sort(store::NameSortOrder order);
    // "Check for Duplicate Entries": asks to sort by code first; the number removed or -1.
    int Dupnames();
    // "Remove Warrants from list": -1 when the user cancels.
    int DeleteWarrants();
    int RemoveExpiredOptions();
    bool CleanOptionalDetails();
    void TitleCase();
    int GdSpecial();
    // "Update Names from KORI Master list", "Update Indust.Classifications from underlying
    // stock", "Update GICS Sectors from download": the rows changed, told to the user; -1 when
    // the file to read from is missing (also told).
    int UpdateNames();
    int UpdateIC_from_Stock();
    int UpdateGICS();
    // Rows first..last, 1-based as the grid numbers them.
    bool ChangeCategory(int first, int last);
    bool ChangeRecordType(int first, int last);
    bool DeleteRows(int first, int last);
    // A blank row at the end; its index (the cursor goes to its code cell).
    int AddRow();
    // The closing question when there are changes; true when the window may close.
    bool Close();

private:
    void LoadRecords(const std::vector<store::NameRecord>& records, bool changed);
    std::vector<store::NameRecord> GridRecords() const;
    void SetRows(std::vector<store::TextRow> rows);

    std::string m_folder;
    std::string m_systemFolder;
    int m_dataService;
    platform::Dialogs& m_dialogs;
    platform::Progress& m_progress;
    platform::IniFile& m_ini;
    GridModel m_grid;
    std::optional<store::RowRefusal> m_refusal;
};

} // namespace kori::app
