#pragma once

#include <cstddef>
#include <span>

namespace ryn::stats {

/// Calls `f(first, count)` for each run of equal values, `first` being the index of its first.
template <class F>
void ForEachEqualRun(std::span<const double> sorted, F&& f) {
    for (std::size_t first = 0; first < sorted.size();) {
        std::size_t end = first + 1;
        while (end < sorted.size() && sorted[end] == sorted[first]) {
            ++end;
        }
        f(first, end - first);
        first = end;
    }
}

} // namespace ryn::stats
