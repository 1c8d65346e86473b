#pragma once
// ImportCsv ("Import CSV History"): a CSV file of one security's days brought into the data
// folder, under a code and (for a security new to the name file) a name.
#include "intake/csv_import.h"
#include "platform/dialogs.h"

#include <string>

namespace kori::app {

class CsvImportForm {
public:
    static constexpr const char* kTitle = "Import CSV History";

    CsvImportForm(std::string dataFolder, platform::Dialogs& dialogs);

    std::string file;
    std::string code;
    std::string name;
    bool replace = false;

    // A code typed: the name of a security already in the name file (blank for a new one),
    // shown so the user sees whether the import adds to a history or starts one.
    std::string ExistingName() const;
    // Runs the import; the result text says what was done or why nothing was. A refusal is
    // also shown in a message box.
    bool Import();
    const std::string& resultText() const { return m_result; }

private:
    std::string m_dataFolder;
    platform::Dialogs& m_dialogs;
    std::string m_result;
};

} // namespace kori::app
