#include "platform/csv_line.h"

#include "platform/text.h"

namespace kori::platform {

std::vector<std::string> SplitQuoted(std::string_view line, char separator) {
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    std::vector<std::string> fields;
    std::string field;
    bool quoted = false;    // inside quotes now
    bool wasQuoted = false; // this field had quotes: keep its inner blanks
    for (std::size_t i = 0; i < line.size(); ++i) {
        const char c = line[i];
        if (quoted) {
            if (c == '"' && i + 1 < line.size() && line[i + 1] == '"') {
                field += '"';
                ++i;
            } else if (c == '"') {
                quoted = false;
            } else {
                field += c;
            }
        } else if (c == '"' && Trim(field).empty()) {
            field.clear();
            quoted = wasQuoted = true;
        } else if (c == separator) {
            fields.push_back(field);
            field.clear();
            wasQuoted = false;
        } else if (!(wasQuoted && (c == ' ' || c == '\t'))) {
            field += c;
        }
    }
    fields.push_back(field);
    return fields;
}

int CountSeparators(std::string_view line, char separator) {
    int n = 0;
    bool quoted = false;
    for (char c : line) {
        if (c == '"') quoted = !quoted;
        if (c == separator && !quoted) ++n;
    }
    return n;
}

} // namespace kori::platform
