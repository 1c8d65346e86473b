#pragma once
// Targets.txt in the system folder: one price target a line, "code,target,U|D". A security may
// stand on two lines. The alerts after an update, the chart's target lines and the targets
// window all read it here.
#include "platform/status.h"
#include "store/price_file.h"

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace kori::store {

struct TargetLine {
    std::string Code;      // trimmed, as written
    std::string Target;    // the price as text ("0.00#" when the window wrote it)
    std::string Direction; // "U" or "D" in a good file; anything else is kept as read
};

// What the last price record says of one target: "target reached UP" when the day's range
// holds it, else "target exceeded UP" when the close is above it (DOWN: the same range test,
// else a close below); empty when neither, or when the direction is neither U nor D.
std::string TargetOutcome(const TargetLine& line, const PriceRecord& last);

// Targets.txt in the system folder, found whatever the case of its name.
std::filesystem::path TargetsFilePath(std::string_view systemFolder);

// Every non-blank line, split at its commas into at most five slots of which the first three
// are used; missing slots read as empty. An absent file gives no lines.
std::vector<TargetLine> ReadTargetsFile(const std::filesystem::path& file);

// The lines joined by CR LF, written beside the old file and renamed over it. A field holding a
// comma or a line break is refused, since the file could not be read back as written.
platform::Status WriteTargetsFile(const std::filesystem::path& file,
                                  const std::vector<TargetLine>& lines);

} // namespace kori::store
