#pragma once
// DataEntry ("Data Entry - Keyboard"): one day's figures typed for a security, shown beside its
// last record, checked and appended to its price file. The window shows this model and passes
// the user's keys in.
#include "intake/keyboard_entry.h"
#include "platform/dialogs.h"
#include "store/name_record.h"
#include "store/price_file.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace kori::app {

class DataEntryForm {
public:
    static constexpr const char* kTitle = "Data Entry - Keyboard";
    // The figure rows in order: open, high, low, close, volume.
    static constexpr int kFigures = 5;

    struct FigureRow {
        std::string Label; // "" when the record type has no such field
        bool Shown = false;
    };

    DataEntryForm(std::string dataFolder, platform::Dialogs& dialogs);

    // Reads the name file of the data folder and shows its first security. An empty name file:
    // "No Records in Name File" and false.
    bool Open();
    // Another data folder ("Change Folder"): the same as Open there.
    bool ChangeFolder(std::string dataFolder);

    const std::string& dataFolder() const { return m_dataFolder; }
    int securityCount() const { return static_cast<int>(m_names.size()); }
    int current() const { return m_current; } // 0-based; -1 before a successful Open
    const store::NameRecord& name() const {
        return m_names.at(static_cast<std::size_t>(m_current));
    }
    // "Rec.Tp  " and the record type.
    std::string RecordTypeText() const;
    // The labels by record type: types 1, 2, 4, 5 "Open", "High", "Low", "Close" and (not type
    // 2) "Volume"; type 3 "Rises", "Falls", "Cum.Total" in the high, low and close rows.
    std::array<FigureRow, kFigures> Figures() const;

    // The last record as the "Previous" column shows it: date "d/m/yy" then the five figures
    // (blank where the row is not shown); all blank for an empty file.
    std::array<std::string, kFigures + 1> PreviousTexts() const;
    const std::optional<store::PriceRecord>& previous() const { return m_previous; }

    // The "Current" column, as typed.
    intake::KeyedDay entered;
    bool autoDateAdvance = true;   // Check1 "Auto Date Advance"
    bool advanceAfterSave = false; // Check2 "Advance after Save"

    // Shows the security at `index` (0-based): its last record read, and with Check1 on the
    // date after it proposed, past a weekend. An empty price file says "No previous data for "
    // and the code.
    bool Show(int index);
    // A code typed and Enter: the security found in the name file, or "No File For That Name".
    bool GoToCode(std::string_view code);
    // The up-down control: the next or previous security, round at both ends.
    void Step(int delta);

    // Leaving the total field of a type 3 security: the cumulative check now. False (with the
    // beep and message) when the total does not follow.
    bool LeaveTotal();
    // The save: date and figures checked (a refusal beeps and says why, nothing is written),
    // the record appended. Then with Check1 on the security is shown again, so the record
    // just written becomes the previous one and the date after it is proposed; with Check1 off
    // the date stays, to be selected for the next entry, unless Check2 moves it on to the next
    // weekday.
    bool Save();
    // "Reset": the figures of the current column cleared; the date stays.
    void Reset();

    // After a save with Check1 off: the window selects the date text.
    bool selectDate() const { return m_selectDate; }

private:
    void Refuse(const intake::EntryRefusal& r);

    std::string m_dataFolder;
    platform::Dialogs& m_dialogs;
    std::vector<store::NameRecord> m_names;
    int m_current = -1;
    std::optional<store::PriceRecord> m_previous;
    bool m_selectDate = false;
};

} // namespace kori::app
