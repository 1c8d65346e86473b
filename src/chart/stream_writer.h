#pragma once
// Writer of the chart instruction stream (TCht.Tmp). One drawing call, then one line, unless
// RedrawOnly: a repaint adds nothing. Lines are "letter, field, field, ..." with numbers as the
// classic number-to-text gives them; text fields lose their commas, which would break a line.
#include "platform/status.h"
#include "platform/surface.h"

#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

namespace kori::chart {

class StreamWriter {
public:
    StreamWriter() = default;

    // A new chart (ChartSlot below 2, not the second half of a split) overwrites the stream;
    // otherwise the stream is appended to so one stream carries every chart of a page.
    platform::Status Open(const std::filesystem::path& path, bool append);
    // Flushes and closes; a failed write or close since the stream was started is returned.
    platform::Status Close();
    bool isOpen() const { return m_out.is_open(); }
    // The first failure since the stream was started afresh (an append keeps it): a stream
    // that failed once is incomplete, whatever later writes do.
    const platform::Status& status() const { return m_status; }

    bool RedrawOnly = false;

    // Four-coordinate instructions: "B" "F" "C" "X" "H" "L" "M" "D" "E" "V".
    void Shape(char letter, double x1, double y1, double x2, double y2, platform::Colour colour);
    // "P" and "K".
    void Dot(char letter, double x, double y, platform::Colour colour);
    // "T" "S" "Z": size, x, y, text, colour.
    void Text(char letter, double size, double x, double y, std::string_view text,
              platform::Colour colour);

    static std::string Number(double v);
    static std::string StripCommas(std::string_view text);

private:
    void WriteLine(const std::string& line);
    void Fail(const std::string& what);
    std::ofstream m_out;
    std::filesystem::path m_path;
    platform::Status m_status = platform::Status::Ok();
};

} // namespace kori::chart
