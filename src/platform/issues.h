#pragma once
// Non-fatal problems found by a walk, a load, an import or a repair, returned as values for the
// window or the command line to show: what went wrong, in which file and at which record.
#include <string>
#include <vector>

namespace kori::platform {

enum class Severity { Note, Warning, Error };

struct Issue {
    Severity severity = Severity::Warning;
    std::string text;
    std::string file; // the file's name, empty when the problem is not in one file
    int record = 0;   // 1-based record number, 0 when none applies

    friend bool operator==(const Issue&, const Issue&) = default;
};

using Issues = std::vector<Issue>;

} // namespace kori::platform
