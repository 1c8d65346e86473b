#pragma once
// AdjList ("KORI Data Mainenance"): the maintenance list as the user edits and runs it, and
// AdjOpts, how bulletins enter it. The windows show the grid and pass the user's acts in; the
// rules and the questions live here.
#include "adjust/adjustment_list.h"
#include "app/session.h"
#include "intake/download_update.h"

#include <string>
#include <vector>

namespace kori::app {

inline constexpr std::string_view kAdjListCaption = "KORI Data Mainenance";
inline constexpr std::string_view kNoBulletinData = "There is no bulletin data";
inline constexpr std::string_view kClickMake =
    "Click MAKE ADJUSTMENTS (above) to process maintenance data";
inline constexpr std::string_view kSorting = "SORTING Adjustments List   -  WAIT";

// The folder of Adjust.Lst: the Australian stocks folder under service 3, else the data folder.
std::string AdjustmentListFolder(const Session& session);
adjust::ListSettings ListSettingsOf(const Session& session);
adjust::MakeSettings MakeSettingsOf(Session& session);
// The download update's hook: fills the list and notes in `newItems` that it grew.
intake::UpdateHooks AdjustmentHooks(Session& session, bool& newItems);
// After an update that grew the list: "There have been maintenance items added to the
// Adjustment List". True when the list should now be opened.
bool TellItemsAdded(Session& session, bool newItems);

// The grid's columns: the first nine fields.
inline constexpr int kListColumns = 9;
std::string ListHeading(int column); // "Act", "Code", "File", "", "ADJ", "Name", ...

class AdjustmentListForm {
public:
    explicit AdjustmentListForm(Session& session);

    // Reads the list. Under service 3 with no folders defined, tells the user and gives false.
    bool Load();
    const std::vector<adjust::ListItem>& items() const { return m_items; }
    std::string Label() const; // the label over the grid
    std::string Cell(int row, int column) const;
    bool edited() const { return m_edited; }

    // A cell typed into. The ADJ column takes only Y, N or D (any case); anything else is
    // refused with its message and false.
    bool SetCell(int row, int column, const std::string& value);
    void SetAll(const std::string& indicator); // alSetY / alSetN / alSetD
    void RemoveTag(const std::string& tag);    // rmOPTS ("OPT"), rmWNT ("WNT")
    // alDelRow over rows first..last (0-based); asks first. True when deleted.
    bool DeleteRows(int first, int last);
    void Sort(); // alSort
    // muRemAdj: drops the rows marked D and saves.
    platform::Status RemoveMarkedD();
    // alSave.
    platform::Status Save();
    // muAdj: runs the list; the report's messages are what the user is shown.
    platform::Status Make(adjust::MakeReport& report, std::function<void(std::size_t)> onRow);
    bool processed() const { return m_processed; }
    // The closing questions; false when the window should stay open. `process` is set when the
    // user asked to run the list now.
    bool QueryClose(bool& process);

private:
    Session& m_session;
    std::string m_folder;
    std::vector<adjust::ListItem> m_items;
    bool m_edited = false;
    bool m_processed = false;
};

// AdjOpts ("Adjustments"): the two options of section "Adjustments".
struct AdjustmentOptionsForm {
    static std::vector<std::string> DivsChoices(); // the four texts, in order 1 to 4
    static constexpr std::string_view kNoShortNamesText = "Do NOT include Short Names ( NI's)";
    static constexpr std::string_view kCaption = "Adjustments";
    int Divs = 1;
    bool NoShortNames = false;

    static AdjustmentOptionsForm Read(const Session& session);
    void Save(Session& session) const;
};

} // namespace kori::app
