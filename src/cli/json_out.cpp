#include "cli/json_out.h"

#include "platform/text.h"

#include <cmath>

namespace kori::cli {

json FloatJson(float v) {
    if (!std::isfinite(v)) return nullptr;
    return json::parse(platform::FloatText(v));
}

json TextJson(std::string_view latin1) {
    return platform::Latin1ToUtf8(platform::Trim(latin1));
}

} // namespace kori::cli
