#include "maint/rem_dup_st.h"

#include "platform/files.h"
#include "platform/text.h"
#include "store/price_file.h"
#include "store/security_walk.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <numeric>
#include <vector>

namespace kori::maint {

namespace rd = rem_dup_text;

namespace {

constexpr std::size_t kSize = store::PriceRecord::kSize;

std::string_view DateField(std::string_view bytes, std::size_t i) {
    return bytes.substr(i * kSize, 8);
}

// The date as the number it reads as: eight digits directly, anything else as Val reads it.
double DateValue(std::string_view date) {
    std::int64_t v = 0;
    for (char c : date) {
        if (c < '0' || c > '9') return platform::Val(date);
        v = v * 10 + (c - '0');
    }
    return static_cast<double>(v);
}

std::string_view TrimmedDate(std::string_view date) {
    while (!date.empty() && date.front() == ' ')
        date.remove_prefix(1);
    while (!date.empty() && (date.back() == ' ' || date.back() == '\0'))
        date.remove_suffix(1);
    return date;
}

std::int32_t VolumeOf(std::string_view bytes, std::size_t i) {
    std::uint32_t u = 0;
    for (int b = 3; b >= 0; --b)
        u = (u << 8) |
            static_cast<unsigned char>(bytes[i * kSize + 24 + static_cast<std::size_t>(b)]);
    return static_cast<std::int32_t>(u);
}

} // namespace

std::string SortRecordsByDate(std::string_view bytes) {
    const std::size_t n = bytes.size() / kSize;
    std::vector<double> keys(n);
    bool sorted = true;
    for (std::size_t i = 0; i < n; ++i) {
        keys[i] = DateValue(DateField(bytes, i));
        if (i > 0 && keys[i] < keys[i - 1]) sorted = false;
    }
    if (sorted) return std::string(bytes.substr(0, n * kSize));
    std::vector<std::size_t> order(n);
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::stable_sort(order.begin(), order.end(),
                     [&keys](std::size_t a, std::size_t b) { return keys[a] < keys[b]; });
    std::string out;
    out.reserve(n * kSize);
    for (std::size_t i : order)
        out.append(bytes.substr(i * kSize, kSize));
    return out;
}

std::string RemoveDuplicateDates(std::string_view bytes) {
    const std::size_t n = bytes.size() / kSize;
    if (n < 2) return std::string(bytes.substr(0, n * kSize));
    std::string out;
    out.reserve(n * kSize);
    bool skip = false;
    for (std::size_t i = 0; i < n; ++i) {
        if (skip) {
            skip = false;
            continue;
        }
        if (i + 1 == n) {
            out.append(bytes.substr(i * kSize, kSize));
            break;
        }
        if (TrimmedDate(DateField(bytes, i)) != TrimmedDate(DateField(bytes, i + 1))) {
            out.append(bytes.substr(i * kSize, kSize));
            continue;
        }
        const std::size_t keep = VolumeOf(bytes, i) != 0 ? i : i + 1;
        out.append(bytes.substr(keep * kSize, kSize));
        skip = true;
    }
    return out;
}

RepairResult RemDupST(std::string_view folderIn, platform::Progress& progress) {
    RepairResult result;
    const std::string folder = platform::FolderWithSlash(folderIn);
    if (!FolderWritable(folder)) {
        result.Issues.push_back({platform::Severity::Error, NotWritableMessage(folder), folder, 0});
        return result;
    }
    const auto walk =
        store::ForEachSecurity({folder, 0}, progress, [&](const store::WalkItem& item) {
            const std::string code = item.Name.TrimmedCode();
            const std::string name = item.PriceFile.filename().string();
            progress.SetStatus(std::string(rd::kSorting) + code);
            const auto bytes = ReadFileBytes(item.PriceFile);
            if (!bytes) {
                result.Issues.push_back(
                    {platform::Severity::Error, "Cannot read " + name, name, 0});
                return store::WalkStep::Continue;
            }
            const std::string whole = bytes->substr(0, bytes->size() / kSize * kSize);
            const std::string sorted = SortRecordsByDate(whole);
            progress.SetStatus(std::string(rd::kRemoving) + code);
            const std::string kept = RemoveDuplicateDates(sorted);
            if (kept == *bytes) return store::WalkStep::Continue;
            if (auto s = platform::WriteFileAtomic(item.PriceFile, kept, {"Temp.Tmp", ""}); !s)
                result.Issues.push_back({platform::Severity::Error, s.message(), name, 0});
            else
                ++result.FilesChanged;
            return store::WalkStep::Continue;
        });
    if (!walk.Status) {
        result.Issues.push_back({platform::Severity::Error, walk.Status.message(), "", 0});
        return result;
    }
    result.Issues.insert(result.Issues.begin(), walk.Issues.begin(), walk.Issues.end());
    result.Cancelled = walk.Cancelled;
    result.Done = !walk.Cancelled;
    if (result.Done) progress.SetStatus(rd::kCompleted);
    return result;
}

} // namespace kori::maint
