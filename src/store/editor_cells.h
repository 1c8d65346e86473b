#pragma once
// Numbers in the cells of the editors: a cell is numeric only when the whole of its trimmed
// text is one finite number, and a stored float is shown in the shortest text that reads back
// to the same value, so loading and saving a file unchanged writes the same bytes.
#include <optional>
#include <string>
#include <string_view>

namespace kori::store {

std::optional<double> CellNumber(std::string_view text);
// The cell text of a stored float; non-finite values show as "NaN", "Infinity", "-Infinity",
// which no numeric cell accepts.
std::string CellFloat(float value);

} // namespace kori::store
