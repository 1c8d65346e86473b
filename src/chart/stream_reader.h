#pragma once
// Reader of the chart instruction stream (TCht.Tmp and saved .cht files), shared by the screen
// and the paper player so that both split a line the same way.
//
// A line has at most six comma-separated fields, with no quoting. Blanks are squeezed out of
// every field except field 5 of a line whose raw first character is "T", so numbers written
// with a leading blank read correctly while the text of "S" and "Z" loses its inner blanks.
// A seventh field makes the line malformed.
#include "platform/surface.h"

#include <array>
#include <cstddef>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::chart {

inline constexpr int kStreamFields = 6;
using StreamFields = std::array<std::string, kStreamFields>;

// Splits one line (without its line end) into `fields`. False: a seventh field.
[[nodiscard]] bool SplitStreamLine(std::string_view line, StreamFields& fields);

// Whether `letter` (already upper case) is one of the instructions of the stream.
bool IsStreamLetter(char letter);

// One instruction as read: letter folded to upper case and its fields as numbers. Shapes
// ("B" "F" "C" "X" "H" "L" "M" "D" "E" "V") use X1..Y2; dots ("P" "K") X1, Y1; texts
// ("T" "S" "Z") Size, X1, Y1 and Text. Numbers that do not parse read 0.
struct Instruction {
    char Letter = 0;
    double Size = 0;
    double X1 = 0, Y1 = 0, X2 = 0, Y2 = 0;
    std::string Text;
    platform::Colour Colour = 0;
};

bool IsTextLetter(char letter);
bool IsDotLetter(char letter);

class StreamReader {
public:
    enum class Result { Instruction, End, Malformed, Unreadable };

    // Reads the whole file at once; an unreadable file answers Unreadable on the first Next.
    explicit StreamReader(const std::filesystem::path& path);
    // Over text already in memory.
    static StreamReader FromText(std::string text);

    // The next recognised instruction; empty lines and unknown letters are passed over.
    Result Next(Instruction& out);
    // Number (from 1) of the line last read.
    std::size_t lineNumber() const { return m_lineNumber; }

private:
    StreamReader() = default;
    bool NextLine(std::string_view& line);

    std::string m_text;
    bool m_readable = true;
    std::size_t m_pos = 0;
    std::size_t m_lineNumber = 0;
};

// How a play-back of a stream ended.
enum class PlayOutcome {
    Played,        // at least one instruction was drawn
    NothingPlayed, // no recognised instruction
    Malformed,     // a line of more than six fields, or a number out of range
    Unreadable,    // the file could not be read
    PrinterFailed, // the page could not be finished
};

// Colour text of a field as the packed 32-bit value; false when it does not fit 32 bits.
[[nodiscard]] bool ReadStreamColour(std::string_view field, platform::Colour& colour);

} // namespace kori::chart
