#pragma once
// The Shell sort both editors use on their key arrays. The gap starts at 4, doubles while it is
// below the number of entries, loses 1, and is halved before every pass until it falls below 1;
// each pass walks i from the first entry to n - gap and moves the entry at j + gap down past
// every earlier entry (j, j - gap, ...) whose key is greater. It is not stable: equal keys may
// end in any order.
#include <cstddef>
#include <utility>
#include <vector>

namespace kori::store {

// `less(a, b)`: the key of a sorts before the key of b.
template <typename Entry, typename Less> void ShellSort(std::vector<Entry>& keys, Less less) {
    const std::size_t n = keys.size();
    if (n < 2) return;
    std::size_t gap = 4;
    while (gap < n)
        gap *= 2;
    gap -= 1;
    for (gap /= 2; gap >= 1; gap /= 2) {
        for (std::size_t i = 0; i + gap < n; ++i) {
            for (std::size_t j = i + 1; j >= 1; j -= gap) {
                // j is 1-based here, as the walk is told: compare key[j + gap] with key[j].
                Entry& lower = keys[j - 1];
                Entry& upper = keys[j - 1 + gap];
                if (!less(upper, lower)) break;
                std::swap(lower, upper);
                if (j <= gap) break;
            }
        }
    }
}

} // namespace kori::store
