#pragma once
// Names.dat: fixed 96-byte records, 1-based, no header, in the data folder. Found whatever the
// case of its name; an absent file opened for random access is created empty.
#include "platform/dialogs.h"
#include "platform/status.h"
#include "store/name_record.h"
#include "store/record_file.h"

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

// Names.dat in a data folder, found whatever the case of its name.
class NameFile : public RecordFile<NameRecord> {
public:
    using RecordFile::RecordFile;
    static std::filesystem::path PathIn(std::string_view dataFolder);
};

struct FoundCode {
    std::string CurrentFile; // data folder + trimmed code + ".WDT"
    int RecordNumber = 0;
    NameRecord Record;
};

// The one lookup of a code: from record 1 in file order, the first record whose six-character
// code equals the request upper-cased and padded to six ("PRN" and "AUX" in their safe forms).
// Nullopt with `status` ok when the code (or the file) is absent; an error in `status` when the
// file cannot be read or holds more records than the format allows.
std::optional<FoundCode> FindCode(std::string_view dataFolder, std::string_view code,
                                  platform::Status& status);

// `FindCodeInNameFile`: the lookup with the hourglass and "No File For That Name" when absent
// (a file that cannot be used gives its own message instead).
std::optional<FoundCode> FindCodeInNameFile(std::string_view dataFolder, std::string_view code,
                                            platform::Dialogs& dialogs);

// Silent: trimmed name and industry class of a code. Both outputs stay as they were when the
// file is absent, and become empty when nothing matches.
void LookupNameAndClass(std::string_view dataFolder, std::string_view code, std::string& name,
                        std::string& industryClass);

// Silent: "0000" for an empty code, an empty file or no match; else the sector, four digits.
std::string LookupGicsSector(std::string_view dataFolder, std::string_view code);

} // namespace kori::store
