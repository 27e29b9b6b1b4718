#pragma once

#include <array>
#include <cassert>
#include <cstddef>
#include <initializer_list>

namespace ryn::stats {

/// A list of at most `capacity` values, held in place: copying it allocates nothing, so that fits
/// by the thousand can hand their parameters and warnings about as values.
template <class T, std::size_t capacity>
class FixedList {
  public:
    constexpr FixedList() = default;
    constexpr FixedList(std::initializer_list<T> initial) {
        for (const T& value : initial) {
            Add(value);
        }
    }

    /// The list must not be full.
    constexpr void Add(const T& value) {
        assert(count < capacity);
        values[count++] = value;
    }

    constexpr std::size_t size() const { return count; }
    constexpr bool empty() const { return count == 0; }
    constexpr const T* begin() const { return values.data(); }
    constexpr const T* end() const { return values.data() + count; }
    /// `index` must be below size().
    constexpr const T& operator[](std::size_t index) const {
        assert(index < count);
        return values[index];
    }

  private:
    std::array<T, capacity> values{};
    std::size_t count = 0;
};

} // namespace ryn::stats
