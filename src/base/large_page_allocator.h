#pragma once

#include <cstddef>
#include <limits>
#include <new>

namespace ryn {

/// Bytes from which memory is asked for in large pages: the size of one on the common processors.
inline constexpr std::size_t kLargePage = std::size_t{1} << 21;

/// Memory for `bytes`, from kLargePage on aligned to large pages and advised to use them. Throws
/// std::bad_alloc.
void* AllocateLarge(std::size_t bytes);
void FreeLarge(void* memory, std::size_t bytes) noexcept;

/// For arrays of many millions of elements that are filled once: most of the time of filling one in
/// pages of 4 KiB goes to the system's handling of page faults.
template <typename T>
class LargePageAllocator {
  public:
    using value_type = T;

    LargePageAllocator() = default;
    template <typename U>
    LargePageAllocator(const LargePageAllocator<U>& /*other*/) {}

    T* allocate(std::size_t count) {
        if (count > std::numeric_limits<std::size_t>::max() / sizeof(T))
            throw std::bad_alloc();
        return static_cast<T*>(AllocateLarge(count * sizeof(T)));
    }
    void deallocate(T* memory, std::size_t count) noexcept { FreeLarge(memory, count * sizeof(T)); }

    template <typename U>
    bool operator==(const LargePageAllocator<U>& /*other*/) const {
        return true;
    }
};

} // namespace ryn
