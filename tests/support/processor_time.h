#pragma once

#include <ctime>

namespace ryn::test {

/// Seconds that this process has had of the processors: not those in which others had them.
inline double ProcessorSeconds() {
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

} // namespace ryn::test
