#pragma once

#include <cstdint>
#include <limits>
#include <vector>

#include "import/civil_time.h"

namespace ryn {

/// The value of an item in a row where it is missing, while rows are still being sorted out.
inline constexpr float kNoValue = std::numeric_limits<float>::quiet_NaN();

/// The rows of a table as samples, in file order: 12 bytes a row and 4 for each item.
struct TableSamples {
    bool isRelative = false;
    std::vector<Millis> times;
    std::vector<std::vector<float>> values; ///< for each item, one for each time
    std::vector<std::uint32_t> lines;       ///< of the table, for messages

    std::size_t Count() const { return times.size(); }

    /// Keeps the samples at these positions, in this order. Positions must rise.
    void Keep(const std::vector<std::size_t>& positions) {
        for (std::size_t i = 0; i < positions.size(); ++i)
            Move(positions[i], i);
        Resize(positions.size());
    }
    void Move(std::size_t from, std::size_t to) {
        times[to] = times[from];
        lines[to] = lines[from];
        for (std::vector<float>& item : values)
            item[to] = item[from];
    }
    void Resize(std::size_t count) {
        times.resize(count);
        lines.resize(count);
        for (std::vector<float>& item : values)
            item.resize(count);
    }
};

} // namespace ryn
