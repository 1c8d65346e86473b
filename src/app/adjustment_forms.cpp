#include "app/adjustment_forms.h"

#include "app/window_rules.h"
#include "chart/stream_writer.h"
#include "platform/date_entry.h"
#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"
#include "store/name_file.h"
#include "store/price_file.h"

namespace kori::app {

using adjust::AdjType;
using platform::Buttons;
using platform::Icon;

namespace {

constexpr std::string_view kDateOfAdjustment = "Date of Adjustment (d/m/yy)";

bool Adjustable(const store::NameRecord& r) {
    return r.RecordType > 3;
}

std::string NumberText(float v) {
    return platform::Trim(platform::StrSingle(v));
}

} // namespace

const EntryWindowText& TextOf(AdjType type) {
    static const EntryWindowText bonus{"AdjustB",
                                       "Bonus Issue",
                                       "Bonus Shares for every",
                                       "",
                                       "Shares held",
                                       "",
                                       kDateOfAdjustment,
                                       {" Enter the Ratio of the Bonus Issue.",
                                        " ie 1 Bonus Share/s for every 4 Shares held",
                                        " Date is the day before the equity is Ex Bonus"}};
    static const EntryWindowText cash{"AdjustC",
                                      "Cash Issues",
                                      "New shares for every",
                                      "",
                                      "Shares held",
                                      "Cost per New Share",
                                      "Exercise Date",
                                      {" Enter the Ratio of the Cash Issue.",
                                       " ie 1 New Share/s for every 4 Shares held",
                                       " and the cost per share of the New Shares",
                                       " Date is the day before the exercise date "}};
    static const EntryWindowText split{"AdjustSS",
                                       "Share Splits",
                                       "No. of New Shares ",
                                       "for every",
                                       "Old Shares",
                                       "",
                                       kDateOfAdjustment,
                                       {" Enter the Ratio of the Share Split.",
                                        " ie 1 New Share/s for every 4 Shares held",
                                        " Date is the day before Split takes effect"}};
    static const EntryWindowText call{"AdjustCC",
                                      "Calls on Contributing Shares",
                                      "",
                                      "",
                                      "",
                                      "Amount of Call per share",
                                      kDateOfAdjustment,
                                      {}};
    static const EntryWindowText dividend{
        "AdjustD", "Dividends", "", "", "", "Dividend Amount per Share", kDateOfAdjustment, {}};
    switch (type) {
    case AdjType::Bonus:
        return bonus;
    case AdjType::Cash:
        return cash;
    case AdjType::Split:
        return split;
    case AdjType::Call:
        return call;
    case AdjType::Dividend:
        return dividend;
    }
    return bonus;
}

std::string AdjustmentNoteColour(const Session& session) {
    return platform::Trim(chart::StreamWriter::Number(session.palette[25]));
}

// ---- Adjust ---------------------------------------------------------------------------------

AdjustSelection::AdjustSelection(Session& session) : m_session(session) {}

bool AdjustSelection::Load() {
    m_names.clear();
    m_index = -1;
    store::NameFile names(store::NameFile::PathIn(m_session.folders.DataFolder));
    if (platform::FileExists(names.path())) {
        if (auto s = names.ReadAll(m_names); !s) {
            m_session.dialogs().MsgBox(s.message(), adjust::kAdjustTitle, Buttons::Ok,
                                       Icon::Exclamation);
            m_names.clear();
        }
    }
    ShowIndex(FirstAdjustable());
    return HasSecurity();
}

int AdjustSelection::FirstAdjustable() const {
    for (std::size_t i = 0; i < m_names.size(); ++i)
        if (Adjustable(m_names[i])) return static_cast<int>(i);
    return -1;
}

void AdjustSelection::ShowIndex(int index) {
    m_index = index;
    const std::string code = HasSecurity() ? Code() : std::string();
    if (code != m_inputs.Code) m_inputs = AdjustmentInputs{code, 0, ""};
}

std::string AdjustSelection::Code() const {
    return HasSecurity() ? m_names[static_cast<std::size_t>(m_index)].TrimmedCode() : "";
}

std::string AdjustSelection::Name() const {
    return HasSecurity() ? platform::Trim(m_names[static_cast<std::size_t>(m_index)].Name) : "";
}

void AdjustSelection::EnterCode(std::string_view typed) {
    const auto found =
        store::FindCodeInNameFile(m_session.folders.DataFolder, typed, m_session.dialogs());
    if (!found) return;
    if (!Adjustable(found->Record)) {
        m_session.dialogs().MsgBox(adjust::kOnlyTypes4And5, adjust::kAdjustTitle, Buttons::Ok,
                                   Icon::Exclamation);
        ShowIndex(FirstAdjustable());
        return;
    }
    const int index = found->RecordNumber - 1;
    // The list was read when the window opened; a name file changed since is read again.
    if (index >= static_cast<int>(m_names.size()) ||
        m_names[static_cast<std::size_t>(index)].Code != found->Record.Code) {
        Load();
        if (index >= static_cast<int>(m_names.size())) return;
    }
    ShowIndex(index);
}

void AdjustSelection::Step(int direction) {
    if (!HasSecurity() || direction == 0) return;
    const int n = static_cast<int>(m_names.size());
    int i = m_index;
    for (int tries = 0; tries < n; ++tries) {
        i = ((i + (direction > 0 ? 1 : -1)) % n + n) % n;
        if (Adjustable(m_names[static_cast<std::size_t>(i)])) {
            ShowIndex(i);
            return;
        }
    }
}

// ---- Entry windows -------------------------------------------------------------------------

AdjustmentEntry::AdjustmentEntry(Session& session, AdjustmentInputs& inputs, AdjType type)
    : m_session(session), m_inputs(inputs), m_type(type) {}

void AdjustmentEntry::SetRatioA(std::string_view typed) {
    if (const auto v = TypedNumber(typed)) m_a = static_cast<float>(*v);
}

void AdjustmentEntry::SetRatioB(std::string_view typed) {
    if (const auto v = TypedNumber(typed)) m_b = static_cast<float>(*v);
}

void AdjustmentEntry::SetMoney(std::string_view typed) {
    if (const auto v = TypedNumber(typed))
        if (const auto m = platform::Money::FromDouble(*v)) m_money = *m;
}

std::string AdjustmentEntry::RatioAText() const {
    return m_a == 0 ? "" : NumberText(m_a);
}
std::string AdjustmentEntry::RatioBText() const {
    return m_b == 0 ? "" : NumberText(m_b);
}
std::string AdjustmentEntry::MoneyText() const {
    return m_money ? adjust::MoneyText(*m_money) : "";
}

std::string AdjustmentEntry::RatioReadOut() const {
    switch (m_type) {
    case AdjType::Bonus:
    case AdjType::Split:
        return adjust::BonusRatioText(NumberText(m_a), NumberText(m_b));
    case AdjType::Cash:
        return adjust::CashRatioText(NumberText(m_a), NumberText(m_b),
                                     m_money ? adjust::MoneyText(*m_money) : "");
    default:
        return "";
    }
}

bool AdjustmentEntry::TermsComplete() {
    bool complete = true;
    std::string_view message = adjust::kDataIncomplete;
    switch (m_type) {
    case AdjType::Bonus:
    case AdjType::Split:
        complete = m_a != 0 && m_b != 0;
        message = adjust::kRatioDataIncomplete;
        break;
    case AdjType::Cash:
        complete = m_a != 0 && m_b != 0 && m_money.has_value();
        break;
    case AdjType::Call:
    case AdjType::Dividend:
        complete = m_money.has_value();
        break;
    }
    if (!complete) dialogs().MsgBox(message, adjust::kAdjustTitle, Buttons::Ok, Icon::Exclamation);
    return complete;
}

bool AdjustmentEntry::DateStep(std::string_view typedDate) {
    if (!TermsComplete()) return false;
    const auto date = platform::ParseEntryDate(typedDate);
    if (!date.Date) {
        dialogs().MsgBox(date.Message, date.Title, Buttons::Ok, Icon::Exclamation);
        return false;
    }
    m_dateField = date.Date->Shown;
    m_inputs.AdjDate = date.Date->Text;
    m_closeLabel.clear();
    if (auto s = adjust::ChooseAdjustmentDate(m_session.folders.DataFolder, m_inputs.Code,
                                              m_inputs.AdjDate, m_choice);
        !s) {
        dialogs().MsgBox(s.message(), adjust::kAdjustTitle, Buttons::Ok, Icon::Exclamation);
        return false;
    }
    if (m_choice.Record > 0) {
        m_inputs.AdjRecord = m_choice.Record;
        if (m_choice.ExactDate)
            m_closeLabel = m_choice.Message;
        else
            dialogs().MsgBox(m_choice.Message, adjust::kAdjustTitle, Buttons::Ok,
                             Icon::Information);
    }
    m_dateStepDone = true;
    return true;
}

void AdjustmentEntry::ChooseEntry(int entry) {
    if (entry < 0 || entry >= static_cast<int>(m_choice.Lines.size())) return;
    m_inputs.AdjRecord = adjust::RecordOfEntry(m_choice, entry);
    if (m_type == AdjType::Bonus || m_type == AdjType::Cash)
        m_dateField =
            platform::FormatDate(m_choice.Dates[static_cast<std::size_t>(entry)], "d/m/yy");
}

bool AdjustmentEntry::AdjustData() {
    if (!m_dateStepDone || !TermsComplete()) return false;
    const auto fail = [this](const platform::Status& s) {
        dialogs().MsgBox(s.message(), adjust::kAdjustTitle, Buttons::Ok, Icon::Exclamation);
        return false;
    };
    store::PriceFile file(store::PriceFile::PathFor(m_session.folders.DataFolder, m_inputs.Code));
    if (auto s = file.OpenWithData(); !s) return fail(s);
    store::PriceRecord onDay;
    if (m_inputs.AdjRecord < 1 || m_inputs.AdjRecord > file.Count())
        return fail(platform::Status::Error("No record of " + m_inputs.Code +
                                            " has been chosen for the adjustment"));
    if (auto s = file.Read(m_inputs.AdjRecord, onDay); !s) return fail(s);

    adjust::AdjustmentTerms terms{m_type, m_a, m_b, {}, {}};
    if (m_type == AdjType::Cash) terms.Cost = m_money;
    if (m_type == AdjType::Call || m_type == AdjType::Dividend) terms.Amount = m_money;
    platform::Status why;
    const auto factor = adjust::WorkOutFactor(terms, onDay.Close, why);
    if (!factor) return fail(why);
    m_desc = "Adjustment Desc :" + factor->Note;

    adjust::AdjustmentJob job;
    job.DataFolder = m_session.folders.DataFolder;
    job.ChtMiscFolder = m_session.folders.ChtMiscFolder;
    job.Code = m_inputs.Code;
    job.AdjRecord = m_inputs.AdjRecord;
    job.AdjFactor = factor->Value;
    job.AdjNote = factor->Note;
    job.NoteColour = AdjustmentNoteColour(m_session);
    adjust::Applied applied;
    if (auto s = adjust::ApplyAdjustment(job, applied); !s) return fail(s);
    dialogs().MsgBox(adjust::AdjustmentsMadeText(m_inputs.Code), adjust::kAdjustmentsMadeTitle,
                     Buttons::Ok, Icon::Information);
    return true;
}

// ---- AdjustR -------------------------------------------------------------------------------

int ProceedRemoval(Session& session, std::string_view code) {
    auto& dialogs = session.dialogs();
    int removedCount = 0;
    while (true) {
        adjust::Removed removed;
        if (auto s = adjust::RemoveLatestAdjustment(session.folders.DataFolder, code, removed);
            !s) {
            dialogs.MsgBox(s.message(), adjust::kNotAdjustedTitle, Buttons::Ok, Icon::Exclamation);
            return removedCount;
        }
        if (removed.Entries == 0) {
            dialogs.MsgBox(adjust::kNotAdjusted, adjust::kNotAdjustedTitle, Buttons::Ok,
                           Icon::Information);
            return removedCount;
        }
        ++removedCount;
        const std::string done = adjust::LatestRemovedText(code);
        if (removed.Entries == 1) {
            dialogs.MsgBox(done, adjust::kRemovedTitle, Buttons::Ok, Icon::Information);
            return removedCount;
        }
        if (dialogs.MsgBox(done + "\n" + std::string(adjust::kRemoveNext), adjust::kRemovedTitle,
                           Buttons::YesNo, Icon::Question) != platform::Answer::Yes)
            return removedCount;
    }
}

} // namespace kori::app
