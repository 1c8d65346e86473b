#include "app/csv_import_form.h"

#include "platform/text.h"
#include "store/name_file.h"

namespace kori::app {

CsvImportForm::CsvImportForm(std::string dataFolder, platform::Dialogs& dialogs)
    : m_dataFolder(std::move(dataFolder)), m_dialogs(dialogs) {}

std::string CsvImportForm::ExistingName() const {
    if (!store::IsValidCode(code)) return {};
    platform::Status why;
    const auto found = store::FindCode(m_dataFolder, code, why);
    return found ? platform::Trim(found->Record.Name) : std::string();
}

bool CsvImportForm::Import() {
    std::string refusal;
    if (platform::Trim(file).empty())
        refusal = "Choose the CSV file to import";
    else if (platform::Trim(code).empty())
        refusal = "Enter the code of the security";
    intake::ImportReport report;
    if (refusal.empty()) {
        report = intake::ImportCsvFile(platform::Trim(file), m_dataFolder,
                                       {platform::Trim(code), platform::Trim(name), 4, replace});
        if (!report.Ok) refusal = report.Message;
    }
    if (!refusal.empty()) {
        m_result = refusal;
        m_dialogs.MsgBox(refusal, kTitle);
        return false;
    }
    m_result = report.Message;
    return true;
}

} // namespace kori::app
