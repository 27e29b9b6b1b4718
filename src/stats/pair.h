#pragma once

#include <cmath>

namespace ryn::stats {

/// Two numbers that go through the same arithmetic, each operation one instruction for both.
/// Compilers may not pair the sums of a loop by themselves, since that changes the order of the
/// additions.
struct Pair {
    using Lanes [[gnu::vector_size(16)]] = double;

    Pair() = default;
    Pair(Lanes both) : lanes(both) {}
    Pair(double first, double second) : lanes{first, second} {}
    /// The same number twice.
    Pair(double number) : lanes{number, number} {}

    double Sum() const { return lanes[0] + lanes[1]; }

    Lanes lanes{};
};

inline Pair operator+(const Pair& a, const Pair& b) {
    return a.lanes + b.lanes;
}

inline Pair operator-(const Pair& a, const Pair& b) {
    return a.lanes - b.lanes;
}

inline Pair operator*(const Pair& a, const Pair& b) {
    return a.lanes * b.lanes;
}

inline Pair operator/(const Pair& a, const Pair& b) {
    return a.lanes / b.lanes;
}

inline Pair& operator+=(Pair& a, const Pair& b) {
    return a = a + b;
}

inline Pair log(const Pair& a) {
    return {std::log(a.lanes[0]), std::log(a.lanes[1])};
}

inline Pair exp(const Pair& a) {
    return {std::exp(a.lanes[0]), std::exp(a.lanes[1])};
}

} // namespace ryn::stats
