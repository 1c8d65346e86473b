#include "platform/ini_file.h"

#include "platform/files.h"
#include "platform/text.h"

#include <sstream>
#include <sys/stat.h>

namespace kori::platform {

IniFile::IniFile(std::filesystem::path path) : m_path(std::move(path)) {}

bool IniFile::exists() const {
    return FileExists(m_path);
}

IniFile::Stamp IniFile::StampOf(const std::filesystem::path& path) {
    struct stat st {};
    Stamp s;
    if (::stat(ResolvePath(path).c_str(), &st) != 0) return s;
    s.exists = true;
    s.size = static_cast<long long>(st.st_size);
    s.seconds = static_cast<long long>(st.st_mtim.tv_sec);
    s.nanos = static_cast<long long>(st.st_mtim.tv_nsec);
    s.inode = static_cast<unsigned long long>(st.st_ino);
    return s;
}

void IniFile::Load() const {
    // Another window (or program) may have written the file: read it again only then. Changes
    // held by a batch stay until it saves them.
    if (m_batchDepth > 0 && m_loaded) return;
    const Stamp now = StampOf(m_path);
    if (m_loaded && now == m_stamp) return;
    m_lines.clear();
    m_loaded = true;
    m_stamp = now;
    if (!now.exists) return;
    ++m_diskReads;
    const auto content = ReadWholeFile(m_path);
    if (!content) return;
    std::istringstream in(*content);
    std::string raw;
    std::string section;
    while (std::getline(in, raw)) {
        if (!raw.empty() && raw.back() == '\r') raw.pop_back();
        Line line{raw, section, "", ""};
        const std::string t = Trim(raw);
        if (!t.empty() && t.front() == '[' && t.back() == ']') {
            section = Trim(t.substr(1, t.size() - 2));
            line.section = section;
        } else if (!t.empty() && t.front() != ';') {
            const auto eq = t.find('=');
            if (eq != std::string::npos) {
                line.key = Trim(t.substr(0, eq));
                line.value = Trim(t.substr(eq + 1));
            }
        }
        m_lines.push_back(std::move(line));
    }
}

bool IniFile::Batch::Commit() {
    if (m_done) return true;
    m_done = true;
    if (--m_ini.m_batchDepth == 0 && m_ini.m_unsaved) return m_ini.Save();
    return true;
}

IniFile::Batch::~Batch() {
    (void)Commit();
}

bool IniFile::Save() {
    if (m_batchDepth > 0) {
        m_unsaved = true;
        return true;
    }
    m_unsaved = false;
    std::string out;
    for (const auto& l : m_lines) {
        out += l.text;
        out += "\r\n";
    }
    const bool ok = WriteFileAtomic(m_path, out).ok();
    // What is in memory is what was written: no need to read it back.
    if (ok)
        m_stamp = StampOf(m_path);
    else
        m_loaded = false; // memory is not what the disk holds: read it again next time
    return ok;
}

std::string IniFile::ReadRaw(std::string_view section, std::string_view key) const {
    Load();
    for (const auto& l : m_lines)
        if (!l.key.empty() && EqualsNoCase(l.section, section) && EqualsNoCase(l.key, key))
            return l.value;
    return {};
}

std::string IniFile::Read(std::string_view section, std::string_view key) const {
    std::string v = ReadRaw(section, key);
    if (v.empty()) return std::string(kUnknown);
    if (v.size() > 60) v.resize(60);
    return v;
}

bool IniFile::Write(std::string_view section, std::string_view key, std::string_view value) {
    Load();
    const std::string v = Trim(value);
    const std::string text = std::string(key) + "=" + v;
    for (auto& l : m_lines) {
        if (!l.key.empty() && EqualsNoCase(l.section, section) && EqualsNoCase(l.key, key)) {
            l.value = v;
            l.text = std::string(l.key) + "=" + v;
            return Save();
        }
    }
    // Insert after the last line of the section, or start a new section at the end.
    std::size_t insertAt = m_lines.size();
    bool found = false;
    for (std::size_t i = 0; i < m_lines.size(); ++i) {
        if (EqualsNoCase(m_lines[i].section, section)) {
            found = true;
            if (!Trim(m_lines[i].text).empty()) insertAt = i + 1;
        }
    }
    if (!found) {
        if (!m_lines.empty() && !Trim(m_lines.back().text).empty())
            m_lines.push_back({"", m_lines.back().section, "", ""});
        m_lines.push_back({"[" + std::string(section) + "]", std::string(section), "", ""});
        insertAt = m_lines.size();
    }
    m_lines.insert(m_lines.begin() + static_cast<std::ptrdiff_t>(insertAt),
                   Line{text, std::string(section), std::string(key), v});
    return Save();
}

std::vector<std::pair<std::string, std::string>> IniFile::Section(std::string_view section) const {
    Load();
    std::vector<std::pair<std::string, std::string>> r;
    for (const auto& l : m_lines)
        if (!l.key.empty() && EqualsNoCase(l.section, section)) r.emplace_back(l.key, l.value);
    return r;
}

} // namespace kori::platform
