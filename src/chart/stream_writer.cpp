#include "chart/stream_writer.h"

#include "platform/text.h"

namespace kori::chart {

platform::Status StreamWriter::Open(const std::filesystem::path& path, bool append) {
    Close();
    m_out.open(path, std::ios::binary | (append ? std::ios::app : std::ios::trunc));
    if (!m_out) return platform::Status::Error("Cannot open the chart stream " + path.string());
    return platform::Status::Ok();
}

void StreamWriter::Close() {
    if (m_out.is_open()) m_out.close();
}

std::string StreamWriter::Number(double v) {
    return platform::Str(v);
}

std::string StreamWriter::StripCommas(std::string_view text) {
    std::string r;
    r.reserve(text.size());
    for (char c : text)
        if (c != ',' && c != '\r' && c != '\n') r += c;
    return r;
}

void StreamWriter::WriteLine(const std::string& line) {
    if (RedrawOnly || !m_out.is_open()) return;
    m_out << line << "\r\n";
}

void StreamWriter::Shape(char letter, double x1, double y1, double x2, double y2,
                         platform::Colour colour) {
    if (RedrawOnly || !m_out.is_open()) return;
    WriteLine(std::string(1, letter) + "," + Number(x1) + "," + Number(y1) + "," + Number(x2) +
              "," + Number(y2) + "," + Number(colour));
}

void StreamWriter::Dot(char letter, double x, double y, platform::Colour colour) {
    if (RedrawOnly || !m_out.is_open()) return;
    WriteLine(std::string(1, letter) + "," + Number(x) + "," + Number(y) + "," + Number(colour));
}

void StreamWriter::Text(char letter, double size, double x, double y, std::string_view text,
                        platform::Colour colour) {
    if (RedrawOnly || !m_out.is_open()) return;
    WriteLine(std::string(1, letter) + "," + Number(size) + "," + Number(x) + "," + Number(y) +
              "," + StripCommas(text) + "," + Number(colour));
}

} // namespace kori::chart
