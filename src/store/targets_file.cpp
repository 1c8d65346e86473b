#include "store/targets_file.h"

#include "platform/files.h"
#include "platform/number_format.h"
#include "platform/text.h"

#include <array>
#include <sstream>

namespace kori::store {

namespace {

constexpr std::size_t kSlots = 5;

// At most five slots: the fifth takes whatever follows the fourth comma.
std::array<std::string, kSlots> SplitSlots(const std::string& line) {
    std::array<std::string, kSlots> slots;
    std::size_t from = 0;
    for (std::size_t i = 0; i < kSlots; ++i) {
        const auto comma = i + 1 < kSlots ? line.find(',', from) : std::string::npos;
        slots[i] = line.substr(from, comma == std::string::npos ? std::string::npos : comma - from);
        if (comma == std::string::npos) break;
        from = comma + 1;
    }
    return slots;
}

bool HoldsSeparator(std::string_view field) {
    return field.find_first_of(",\r\n") != std::string_view::npos;
}

} // namespace

std::filesystem::path TargetsFilePath(std::string_view systemFolder) {
    return platform::ResolveIn(systemFolder, "Targets.txt");
}

std::string TargetOutcome(const TargetLine& line, const PriceRecord& last) {
    // The prices are 32-bit floats: the target is compared in the same width, so a target
    // typed as the day's low (say 1.1) counts as touched.
    const auto target = static_cast<float>(platform::Val(line.Target));
    const bool inRange = last.Low <= target && target <= last.High;
    const std::string direction = platform::Upper(line.Direction);
    if (direction == "U") {
        if (inRange) return "target reached UP";
        if (last.Close > target) return "target exceeded UP";
    } else if (direction == "D") {
        if (inRange) return "target reached DOWN";
        if (last.Close < target) return "target exceeded DOWN";
    }
    return {};
}

std::vector<TargetLine> ReadTargetsFile(const std::filesystem::path& file) {
    std::vector<TargetLine> lines;
    const auto content = platform::ReadWholeFile(file);
    if (!content) return lines;
    std::istringstream in(*content);
    for (std::string line; std::getline(in, line);) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        if (platform::Trim(line).empty()) continue;
        const auto slots = SplitSlots(line);
        lines.push_back(
            {platform::Trim(slots[0]), platform::Trim(slots[1]), platform::Trim(slots[2])});
    }
    return lines;
}

platform::Status WriteTargetsFile(const std::filesystem::path& file,
                                  const std::vector<TargetLine>& lines) {
    std::string text;
    for (const auto& l : lines) {
        if (HoldsSeparator(l.Code) || HoldsSeparator(l.Target) || HoldsSeparator(l.Direction))
            return platform::Status::Error("Commas cannot be used");
        text += platform::Trim(l.Code) + "," + platform::Trim(l.Target) + "," +
                platform::Trim(l.Direction) + "\r\n";
    }
    return platform::WriteFileAtomic(file, text);
}

} // namespace kori::store
