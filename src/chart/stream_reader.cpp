#include "chart/stream_reader.h"

#include "platform/files.h"
#include "platform/text.h"

#include <cctype>
#include <cmath>
#include <string_view>

namespace kori::chart {

namespace {

constexpr std::string_view kShapeLetters = "BFCXHLMDEV";
constexpr std::string_view kDotLetters = "PK";
constexpr std::string_view kTextLetters = "TSZ";

// Field 5 of a "T" line is the text, kept as it stands.
constexpr int kTextField = 4;

} // namespace

bool SplitStreamLine(std::string_view line, StreamFields& fields) {
    for (auto& f : fields)
        f.clear();
    const bool keepTextBlanks = !line.empty() && line.front() == 'T';
    int field = 0;
    for (char c : line) {
        if (c == ',') {
            if (++field >= kStreamFields) return false;
            continue;
        }
        if (c == ' ' && !(keepTextBlanks && field == kTextField)) continue;
        fields[static_cast<std::size_t>(field)] += c;
    }
    return true;
}

bool IsTextLetter(char letter) {
    return kTextLetters.find(letter) != std::string_view::npos;
}
bool IsDotLetter(char letter) {
    return kDotLetters.find(letter) != std::string_view::npos;
}

bool IsStreamLetter(char letter) {
    return letter != 0 && (IsTextLetter(letter) || IsDotLetter(letter) ||
                           kShapeLetters.find(letter) != std::string_view::npos);
}

bool ReadStreamColour(std::string_view field, platform::Colour& colour) {
    const double v = std::nearbyint(platform::Val(field));
    // Colours are long integers; system colours may come through negative.
    if (!(v >= -2147483648.0 && v <= 4294967295.0)) return false;
    const double wrapped = v < 0 ? v + 4294967296.0 : v;
    colour = static_cast<platform::Colour>(wrapped);
    return true;
}

StreamReader::StreamReader(const std::filesystem::path& path) {
    auto text = platform::ReadWholeFile(path);
    if (!text) {
        m_readable = false;
        return;
    }
    m_text = std::move(*text);
}

StreamReader StreamReader::FromText(std::string text) {
    StreamReader r;
    r.m_text = std::move(text);
    return r;
}

// Lines end at CR/LF, a lone LF or a lone CR.
bool StreamReader::NextLine(std::string_view& line) {
    if (m_pos >= m_text.size()) return false;
    const std::size_t end = m_text.find_first_of("\r\n", m_pos);
    const std::size_t stop = end == std::string::npos ? m_text.size() : end;
    line = std::string_view(m_text).substr(m_pos, stop - m_pos);
    m_pos = stop;
    if (m_pos < m_text.size() && m_text[m_pos] == '\r') ++m_pos;
    if (m_pos < m_text.size() && m_text[m_pos] == '\n') ++m_pos;
    ++m_lineNumber;
    return true;
}

StreamReader::Result StreamReader::Next(Instruction& out) {
    if (!m_readable) return Result::Unreadable;
    std::string_view line;
    StreamFields f;
    while (NextLine(line)) {
        if (!SplitStreamLine(line, f)) return Result::Malformed;
        if (f[0].size() != 1) continue;
        const char letter = static_cast<char>(std::toupper(static_cast<unsigned char>(f[0][0])));
        if (!IsStreamLetter(letter)) continue;

        out = Instruction{};
        out.Letter = letter;
        std::size_t colourField = 5;
        if (IsTextLetter(letter)) {
            out.Size = platform::Val(f[1]);
            out.X1 = platform::Val(f[2]);
            out.Y1 = platform::Val(f[3]);
            out.Text = std::move(f[4]);
        } else if (IsDotLetter(letter)) {
            out.X1 = platform::Val(f[1]);
            out.Y1 = platform::Val(f[2]);
            colourField = 3;
        } else {
            out.X1 = platform::Val(f[1]);
            out.Y1 = platform::Val(f[2]);
            out.X2 = platform::Val(f[3]);
            out.Y2 = platform::Val(f[4]);
        }
        if (!ReadStreamColour(f[colourField], out.Colour)) return Result::Malformed;
        return Result::Instruction;
    }
    return Result::End;
}

} // namespace kori::chart
