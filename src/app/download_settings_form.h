#pragma once
// The three windows that set what the download update reads: ModDetails (the service, the
// download folder, the file-name form, the volume divisor), DLWizard (the segments received
// and a folder for each) and INUpList (which securities a day file gives). The windows show
// these models and pass the user's choices in; the checks, messages and writes are here.
#include "app/grid_model.h"
#include "app/session.h"

#include <array>
#include <string>
#include <string_view>
#include <vector>

namespace kori::app {

class ModDetailsForm {
public:
    static constexpr const char* kTitle = "Data Download Service Details";
    static constexpr int kServiceItems = 2;
    static constexpr int kFormatItems = 7;

    explicit ModDetailsForm(Session& session);

    static const std::array<std::string_view, kServiceItems>& ServiceItems();
    static const std::array<std::string_view, kFormatItems>& FormatItems();
    // The stored form ("DDMMMYY.D", ...) of a format item.
    static std::string_view FormatValue(int item);

    int service() const { return m_service; } // -1: none of the items
    const std::string& folder() const { return m_folder; }
    int format() const { return m_format; } // -1: the stored form matched no item
    const std::string& divisor() const { return m_divisor; }
    // The form, divisor and update-list controls are shown for the internet files only.
    bool internetControlsShown() const { return m_service == 1; }

    // Picking a service proposes a folder below the install root when none is set.
    void ChooseService(int item);
    void SetFolder(std::string folder) { m_folder = std::move(folder); }
    void ChooseFormat(int item) { m_format = item; }
    // Leaving the divisor field: false (with the message) unless it is 1, 10, 100, 1000, 10000.
    bool LeaveDivisor(std::string text);
    // "SAVE": the folder must end with a separator; the keys are written and the session
    // follows. False when refused.
    bool Save();

    // The value a service item stores.
    static std::int16_t ServiceValue(int item);

private:
    Session& m_session;
    int m_service = -1;
    std::string m_folder;
    int m_format = -1;
    std::string m_divisor;
};

class DownloadWizardForm {
public:
    static constexpr const char* kTitle = "Download Data Settings";

    explicit DownloadWizardForm(Session& session);

    // The segment labels, one a row of the window.
    static const std::array<std::string_view, kDataTypeCount>& Labels();
    // The place in the data-folder list of the folder of a row.
    static std::size_t FolderOf(int row);

    bool received(int i) const { return m_received.at(static_cast<std::size_t>(i)); }
    const std::string& folder(int i) const { return m_folders.at(static_cast<std::size_t>(i)); }
    void SetReceived(int i, bool on) { m_received.at(static_cast<std::size_t>(i)) = on; }
    void SetFolder(int i, std::string folder) {
        m_folders.at(static_cast<std::size_t>(i)) = std::move(folder);
    }

    // "Save Settings": the folders of the segments received (a segment not received keeps no
    // folder) go into the data-folder list as the data-folders window saves them. A segment
    // ticked without a folder is refused with a message naming it.
    bool Save();

private:
    Session& m_session;
    std::array<bool, kDataTypeCount> m_received{}; // by row
    ChartDataPaths m_folders;                      // by row
};

class UpdateListForm {
public:
    static constexpr const char* kTitle = "Download Update List";
    enum Option { kAllStocks = 0, kNoWarrants = 1, kListedOnly = 2 };
    static const std::array<std::string_view, 3>& OptionLabels();

    explicit UpdateListForm(Session& session);

    // Update.Lst into the grid, the option from the session, the master list when present.
    void Load();

    int option() const { return m_option; }
    // Picking the third option warns that nothing else is updated.
    void ChooseOption(int option);
    GridModel& grid() { return m_grid; }

    // The master list: one text line a 62-byte record, or the two lines that say it is missing.
    bool masterPresent() const { return m_masterPresent; }
    const std::vector<std::string>& masterLines() const { return m_master; }
    // "Add checked items to list": the chosen master records as rows at the end.
    int AddMasterItems(const std::vector<int>& indices);

    // ulAdd: asks how many blank rows (1 - 200) and adds them at the end. The rows added.
    int AddRows();
    // ulDel: asks, then deletes rows `first` to `last` (0-based, inclusive).
    bool DeleteRows(int first, int last);

    // Writes Update.Lst (the old one kept as Update.Bak) and the option. False when a cell is
    // refused or the file cannot be written.
    bool Save();
    // Closing: with changes, asks whether to save. False when the window stays open.
    bool CanClose();
    bool changed() const { return m_grid.changed() || m_optionChanged; }

private:
    Session& m_session;
    GridModel m_grid;
    int m_option = kAllStocks;
    bool m_optionChanged = false;
    bool m_masterPresent = false;
    std::vector<std::string> m_master;
};

// "&Downloaded Data Update": the update list, unless the download folder does not exist; then
// that is said and the service details are offered instead.
enum class DownloadUpdateOpens { List, Settings, Nothing };
DownloadUpdateOpens WhatDownloadUpdateOpens(Session& session);

} // namespace kori::app
