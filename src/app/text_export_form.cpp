#include "app/text_export_form.h"

#include "app/chart_selection.h"
#include "maint/text_export.h"
#include "platform/date_text.h"
#include "platform/files.h"
#include "platform/text.h"
#include "store/chart_list.h"

namespace kori::app {

std::vector<std::string> ExportListCaptions(Session& session) {
    std::vector<std::string> captions{"Full List (Names.Dat)"};
    for (auto& c : store::ListChoices(session.services().settings, true))
        captions.push_back(std::move(c));
    return captions;
}

char ExportListLetter(int index) {
    return index <= 0 ? '\0' : store::ListLetterOfMode(store::ModeOfChoice(index - 1));
}

std::optional<std::string> TypedExportDate(const std::string& typed) {
    const std::string t = platform::Trim(typed);
    if (t.empty()) return std::string();
    return ParseFinishDate(t);
}

ExportOutcome ClosesForm::Run(Session& session, platform::Progress& progress) const {
    const auto date = TypedExportDate(DateText);
    if (!date) return {false, kDateFormatMessage};
    if (platform::Trim(File).empty()) return {false, "Choose the file to write"};
    const auto r = maint::ExportCloses({session.folders.DataFolder, ExportListLetter(ListIndex)},
                                       *date, progress);
    if (!r.Status) return {false, r.Status.message()};
    if (r.Cancelled) return {false, "Export cancelled: nothing written"};
    if (auto s = platform::WriteFileAtomic(File, r.Csv); !s) return {false, s.message()};
    return {true, std::to_string(r.Lines) + " closing prices of " +
                      platform::DateTextToDisplay(r.Date) + " written to " + File};
}

ExportOutcome DataForm::Run(Session& session, platform::Progress& progress) const {
    const auto from = TypedExportDate(FromText);
    const auto to = TypedExportDate(ToText);
    if (!from || !to) return {false, kDateFormatMessage};
    if (!from->empty() && !to->empty() && *from > *to)
        return {false, "The first day comes after the last"};
    if (platform::Trim(Output).empty())
        return {false,
                DayFiles ? "Choose the folder for the day files" : "Choose the file to write"};
    const store::SecurityList list{session.folders.DataFolder, ExportListLetter(ListIndex)};
    const auto r = maint::ExportData(list, OneSecurity ? platform::Trim(Code) : "", {*from, *to},
                                     DayFiles, progress);
    if (!r.Status) return {false, r.Status.message()};
    if (r.Cancelled) return {false, "Export cancelled: nothing written"};
    const int securities = r.Securities;
    if (DayFiles) {
        std::vector<std::string> written;
        if (auto s = r.Days.WriteTo(Output, &written); !s) return {false, s.message()};
        return {true, std::to_string(written.size()) + " day files of " +
                          std::to_string(securities) + " securities written to " + Output};
    }
    if (auto s = platform::WriteFileAtomic(Output, r.Csv); !s) return {false, s.message()};
    return {true, "Records of " + std::to_string(securities) +
                      (securities == 1 ? " security" : " securities") + " written to " + Output};
}

} // namespace kori::app
