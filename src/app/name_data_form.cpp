#include "app/name_data_form.h"

#include "store/name_record.h"

namespace kori::app {

using platform::Answer;
using platform::Buttons;
using platform::Icon;

bool NameDataForm::Ask() {
    return m_session.dialogs().MsgBox(kNameDataQuestion, kNameDataTitle, Buttons::YesNo,
                                      Icon::Question) == Answer::Yes;
}

bool NameDataForm::Check() {
    m_result = maint::CheckNameFile(m_session.folders.DataFolder);
    m_addable = 0;
    for (const auto& f : m_result.Findings)
        if (f.What == maint::name_finding::NoNameRecord && store::IsValidCode(f.Code)) ++m_addable;
    if (!m_result.Status) {
        m_session.dialogs().MsgBox(m_result.Status.message(), kNameDataTitle);
        return false;
    }
    return true;
}

std::string NameDataForm::Summary() const {
    const auto n = m_result.Findings.size();
    return std::to_string(m_result.Records) + " name records, " +
           std::to_string(m_result.PriceFiles) + " price files: " +
           (n == 0 ? std::string("no findings, the name file and the price files agree")
                   : std::to_string(n) + (n == 1 ? " finding" : " findings"));
}

GridModel NameDataForm::Report() const {
    GridModel grid({"Code", "Record", "Finding", "Detail"});
    std::vector<GridModel::Row> rows;
    rows.reserve(m_result.Findings.size());
    for (const auto& f : m_result.Findings)
        rows.push_back({f.Code, f.Record > 0 ? std::to_string(f.Record) : "", f.What, f.Detail});
    grid.LoadInForm(std::move(rows));
    return grid;
}

bool NameDataForm::AddMissing(platform::Progress& progress) {
    if (m_addable == 0) return false;
    const std::string question = "Add " + std::to_string(m_addable) +
                                 (m_addable == 1 ? " name record" : " name records") +
                                 " (record type 4, name blank) for the price files without one ?";
    if (m_session.dialogs().MsgBox(question, kNameDataTitle, Buttons::YesNo, Icon::Question) !=
        Answer::Yes)
        return false;
    return Fix(true, progress);
}

bool NameDataForm::RemoveWithoutData(platform::Progress& progress) {
    const int n = WithoutData();
    if (n == 0) return false;
    const std::string question = "Remove " + std::to_string(n) + (n == 1 ? " entry" : " entries") +
                                 " without a price file from the name file ?";
    if (m_session.dialogs().MsgBox(question, kNameDataTitle, Buttons::YesNo, Icon::Question) !=
        Answer::Yes)
        return false;
    return Fix(false, progress);
}

bool NameDataForm::Fix(bool add, platform::Progress& progress) {
    const auto fixed = maint::FixNameFile(m_session.folders.DataFolder, add, !add, progress);
    if (!fixed.Status) {
        m_session.dialogs().MsgBox(fixed.Status.message(), kNameDataTitle);
        Check();
        return false;
    }
    Check();
    const int n = add ? fixed.Added : fixed.Removed;
    m_session.dialogs().MsgBox(std::to_string(n) + (n == 1 ? " entry " : " entries ") +
                                   (add ? "added to" : "removed from") +
                                   " the name file. The old file is kept as names.bak.",
                               kNameDataTitle);
    return true;
}

} // namespace kori::app
