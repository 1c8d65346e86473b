#pragma once
// The manual adjustment windows without their widgets: `Adjust` picks the security, one entry
// window per kind of issue gathers the terms and the day, `AdjDate` confirms the record, and
// `AdjustR` takes the latest adjustment off. Every rule and message lives here.
#include "adjust/adjustment.h"
#include "app/session.h"
#include "store/name_record.h"

#include <array>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::app {

// The words of one entry window.
struct EntryWindowText {
    std::string_view Window;  // "AdjustB", ...
    std::string_view Title;   // "Bonus Issue", ...
    std::string_view LabelA;  // empty when the window has no ratio
    std::string_view Between; // text between the two ratio fields ("for every"), may be empty
    std::string_view LabelB;
    std::string_view MoneyLabel; // "Cost per New Share", "Amount of Call per share", ...
    std::string_view DateLabel;
    std::vector<std::string_view> Help;
};
const EntryWindowText& TextOf(adjust::AdjType type);

inline constexpr std::string_view kAdjustCaption = "Adjustments for Issues";
inline constexpr std::string_view kAdjDateTitle = "Exercise Date";
inline constexpr std::string_view kAdjDateLabel =
    "If Date and Price  incorrect select date required";
inline constexpr std::string_view kRemoveTitle = "Remove Adjustment";
inline constexpr std::array<std::string_view, 2> kRemoveHelp = {
    "This procedure removes the most recent adjustment made to the security.",
    "The corrected trading figures may vary from the original by fractions of a cent due to "
    "rounding during calculation"};

// The colour the chart notes take as their sixth field when an adjustment rewrites them: the
// 26th entry of the colour table, written as the notes writer writes colours.
std::string AdjustmentNoteColour(const Session& session);

// The inputs shared by the windows of one adjustment; only one adjustment is under way at a
// time, and a record chosen before stays chosen until another is.
struct AdjustmentInputs {
    std::string Code; // trimmed
    int AdjRecord = 0;
    std::string AdjDate; // "yyyymmdd"
};

// `Adjust`: the security chooser. Only record types 4 and 5 may be adjusted.
class AdjustSelection {
public:
    explicit AdjustSelection(Session& session);

    // Reads the name file and shows the first adjustable security; false when there is none.
    bool Load();
    bool HasSecurity() const { return m_index >= 0; }
    std::string Code() const;
    std::string Name() const;
    // Enter in the code field: an unknown code leaves the choice as it was (after "No File For
    // That Name"); a type below 4 is refused and the first adjustable security shown.
    void EnterCode(std::string_view typed);
    // The up-down control: the next or previous adjustable security, wrapping at both ends.
    void Step(int direction);

    AdjustmentInputs& inputs() { return m_inputs; }
    Session& session() { return m_session; }

private:
    void ShowIndex(int index);
    int FirstAdjustable() const;

    Session& m_session;
    std::vector<store::NameRecord> m_names;
    int m_index = -1;
    AdjustmentInputs m_inputs;
};

// One entry window: `AdjustB`, `AdjustC`, `AdjustSS`, `AdjustCC` or `AdjustD`.
class AdjustmentEntry {
public:
    AdjustmentEntry(Session& session, AdjustmentInputs& inputs, adjust::AdjType type);

    adjust::AdjType type() const { return m_type; }
    const EntryWindowText& text() const { return TextOf(m_type); }

    // A field's text on leaving it (and on the buttons): a number is stored; anything else
    // leaves the stored value, and the field should show `FieldText` again.
    void SetRatioA(std::string_view typed);
    void SetRatioB(std::string_view typed);
    void SetMoney(std::string_view typed); // cost or amount
    std::string RatioAText() const;
    std::string RatioBText() const;
    std::string MoneyText() const;
    // What typing into the ratio fields shows: "Ratio of Bonus Issue is a:b" (bonus, split),
    // "Ratio = a:b @ cost" (cash); empty for the others.
    std::string RatioReadOut() const;

    // The date field's button: checks the terms and the date, then chooses the record. True
    // when the date step ran, which enables "Adjust Data".
    bool DateStep(std::string_view typedDate);
    const std::string& DateField() const { return m_dateField; }
    const adjust::DateChoice& choice() const { return m_choice; }
    // The date list was shown and an entry chosen (the entry of the result is chosen at first).
    void ChooseEntry(int entry);
    const std::string& CloseLabel() const { return m_closeLabel; }

    bool AdjustEnabled() const { return m_dateStepDone; }
    // "Adjust Data": the factor, then the rewrite. True when the file was adjusted.
    bool AdjustData();
    // "Adjustment Desc :" + note, once the factor is worked out.
    const std::string& DescText() const { return m_desc; }

private:
    bool TermsComplete();
    platform::Dialogs& dialogs() { return m_session.dialogs(); }

    Session& m_session;
    AdjustmentInputs& m_inputs;
    adjust::AdjType m_type;
    float m_a = 0, m_b = 0;
    std::optional<platform::Money> m_money;
    std::string m_dateField;
    adjust::DateChoice m_choice;
    std::string m_closeLabel;
    bool m_dateStepDone = false;
    std::string m_desc;
};

// `AdjustR`'s Proceed: takes adjustments off newest first while the user answers Yes. Returns
// how many were removed; the window closes afterwards.
int ProceedRemoval(Session& session, std::string_view code);

} // namespace kori::app
