#include "chart/stream_writer.h"

#include "platform/text.h"

#include <charconv>
#include <cmath>
#include <cstdlib>

namespace kori::chart {

namespace {

// Nearly every number of a chart is whole or has at most two decimals (half-unit ticks, font
// sizes such as 8.25): those are written directly, exactly as the classic conversion writes
// them ("-3", " 12", " .5", " 8.25"); anything else goes the long way.
void AppendNumber(std::string& out, double v) {
    const double hundredths = v * 100;
    if (!(std::fabs(v) < 1e12) || hundredths != std::trunc(hundredths)) {
        out += platform::Str(v);
        return;
    }
    const long long n = std::llabs(static_cast<long long>(hundredths));
    if (n == 0) {
        out += " 0";
        return;
    }
    out += v < 0 ? '-' : ' ';
    const long long whole = n / 100;
    const int frac = static_cast<int>(n % 100);
    if (whole != 0 || frac == 0) {
        char buf[24];
        const auto r = std::to_chars(buf, buf + sizeof buf, whole);
        out.append(buf, r.ptr);
    }
    if (frac != 0) {
        out += '.';
        out += static_cast<char>('0' + frac / 10);
        if (frac % 10 != 0) out += static_cast<char>('0' + frac % 10);
    }
}

void AppendText(std::string& out, std::string_view text) {
    for (char c : text)
        if (c != ',' && c != '\r' && c != '\n') out += c;
}

} // namespace

platform::Status StreamWriter::Open(const std::filesystem::path& path, bool append) {
    (void)Close();
    if (!append) m_status = platform::Status::Ok();
    m_path = path;
    m_out.clear();
    m_out.open(path, std::ios::binary | (append ? std::ios::app : std::ios::trunc));
    if (!m_out) {
        Fail("Cannot open the chart stream ");
        return m_status;
    }
    return platform::Status::Ok();
}

void StreamWriter::Fail(const std::string& what) {
    if (m_status) m_status = platform::Status::Error(what + m_path.string());
}

platform::Status StreamWriter::Close() {
    if (m_out.is_open()) {
        m_out.flush();
        if (!m_out) Fail("Cannot write the chart stream ");
        m_out.close();
        if (!m_out) Fail("Cannot close the chart stream ");
        m_out.clear();
    }
    return m_status;
}

std::string StreamWriter::Number(double v) {
    std::string s;
    AppendNumber(s, v);
    return s;
}

std::string StreamWriter::StripCommas(std::string_view text) {
    std::string r;
    r.reserve(text.size());
    AppendText(r, text);
    return r;
}

void StreamWriter::WriteLine(const std::string& line) {
    if (RedrawOnly || !m_out.is_open()) return;
    m_out.write(line.data(), static_cast<std::streamsize>(line.size()));
    m_out.write("\r\n", 2);
    if (!m_out) {
        // The rest of the chart would only be a torn copy: stop writing it.
        Fail("Cannot write the chart stream ");
        m_out.close();
    }
}

void StreamWriter::Shape(char letter, double x1, double y1, double x2, double y2,
                         platform::Colour colour) {
    if (RedrawOnly || !m_out.is_open()) return;
    std::string line(1, letter);
    for (double v : {x1, y1, x2, y2, static_cast<double>(colour)}) {
        line += ',';
        AppendNumber(line, v);
    }
    WriteLine(line);
}

void StreamWriter::Dot(char letter, double x, double y, platform::Colour colour) {
    if (RedrawOnly || !m_out.is_open()) return;
    std::string line(1, letter);
    for (double v : {x, y, static_cast<double>(colour)}) {
        line += ',';
        AppendNumber(line, v);
    }
    WriteLine(line);
}

void StreamWriter::Text(char letter, double size, double x, double y, std::string_view text,
                        platform::Colour colour) {
    if (RedrawOnly || !m_out.is_open()) return;
    std::string line(1, letter);
    for (double v : {size, x, y}) {
        line += ',';
        AppendNumber(line, v);
    }
    line += ',';
    AppendText(line, text);
    line += ',';
    AppendNumber(line, static_cast<double>(colour));
    WriteLine(line);
}

} // namespace kori::chart
