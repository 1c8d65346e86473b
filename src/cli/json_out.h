#pragma once
// Values of the files as JSON: text fields are Latin-1 in the files and UTF-8 in JSON; a float
// that is not a number or infinite is null, so one odd value never stops an export.
#include <nlohmann/json.hpp>

#include <string_view>

namespace kori::cli {

using json = nlohmann::ordered_json;

// A float as a JSON number that reads back to the same 32-bit value, or null.
json FloatJson(float v);
// A trimmed text field of a file as UTF-8.
json TextJson(std::string_view latin1);

} // namespace kori::cli
