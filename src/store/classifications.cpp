#include "store/classifications.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <cctype>
#include <sstream>

namespace kori::store {

namespace {
std::vector<std::string> SplitCommas(const std::string& line) {
    std::vector<std::string> fields;
    std::string f;
    for (char c : line) {
        if (c == ',') {
            fields.push_back(f);
            f.clear();
        } else if (c != '\r' && c != '\n') {
            f += c;
        }
    }
    fields.push_back(f);
    return fields;
}

std::vector<std::vector<std::string>> ReadLines(std::string_view folder, std::string_view name) {
    std::vector<std::vector<std::string>> lines;
    const auto content = platform::ReadWholeFile(platform::ResolveIn(folder, name));
    if (!content) return lines;
    std::istringstream in(*content);
    std::string line;
    while (std::getline(in, line))
        lines.push_back(SplitCommas(line));
    return lines;
}

std::string Field(const std::vector<std::string>& f, std::size_t i) {
    return i < f.size() ? platform::Trim(f[i]) : std::string();
}
} // namespace

std::string ClassNameOf(std::string_view systemFolder, std::string_view classId) {
    const std::string wanted = platform::Upper(platform::Trim(classId));
    for (const auto& f : ReadLines(systemFolder, "IndClass.dat")) {
        if (platform::Upper(Field(f, 0)) != wanted) continue;
        const std::string name = Field(f, 1);
        return name.empty() ? "unknown" : name;
    }
    return "unknown";
}

std::string SectorNameOf(std::string_view systemFolder, std::string_view gicsCode) {
    const std::string wanted = platform::Upper(platform::Trim(gicsCode));
    for (const auto& f : ReadLines(systemFolder, "Gics.dat")) {
        if (platform::Upper(Field(f, 0)) != wanted) continue;
        const std::string joined = Field(f, 1) + "_" + Field(f, 2);
        return joined == "_" ? "unknown" : joined;
    }
    return "unknown";
}

int FindNextClassRecord(const std::vector<NameRecord>& names, int fromPosition,
                        std::string_view request, bool gics) {
    const std::string want = platform::Trim(request);
    if (want.empty()) return 0;
    const bool group = want.back() == '0';
    for (int pos = fromPosition + 1; pos <= static_cast<int>(names.size()); ++pos) {
        const auto& r = names[static_cast<std::size_t>(pos - 1)];
        const std::string cls = platform::Trim(gics ? r.GicsSector : r.IndustryClass);
        if (cls.empty()) continue;
        if (group) {
            const std::size_t width = gics ? 4 : 3;
            if (cls.size() != width) continue;
            if (cls.substr(0, 2) == want.substr(0, 2)) return pos;
        } else if (cls == want) {
            return pos;
        }
    }
    return 0;
}

std::optional<std::string> CheckClassId(std::string_view cell, int digits) {
    const std::string t = platform::Trim(cell);
    if (t.empty()) return std::string();
    for (char c : t)
        if (!std::isdigit(static_cast<unsigned char>(c))) return std::nullopt;
    return platform::Format(platform::Val(t), std::string(static_cast<std::size_t>(digits), '0'));
}

std::vector<ClassRow> ReadClassFile(std::string_view systemFolder, std::string_view fileName,
                                    std::size_t fields) {
    std::vector<ClassRow> rows;
    for (const auto& f : ReadLines(systemFolder, fileName)) {
        ClassRow row;
        for (std::size_t i = 0; i < fields; ++i)
            row.push_back(Field(f, i));
        if (row[0].empty() && (fields < 2 || row[1].empty())) continue;
        rows.push_back(row);
    }
    return rows;
}

platform::Status WriteClassFile(std::string_view systemFolder, std::string_view fileName,
                                const std::vector<ClassRow>& rows) {
    std::string out;
    for (const auto& row : rows) {
        if (row.size() < 2 || platform::Trim(row[0]).empty() || platform::Trim(row[1]).empty())
            continue;
        for (std::size_t i = 0; i < row.size(); ++i) {
            if (i) out += ',';
            out += platform::Trim(row[i]);
        }
        out += "\r\n";
    }
    return platform::WriteFileAtomic(platform::ResolveIn(systemFolder, fileName), out);
}

} // namespace kori::store
