#include "base/large_page_allocator.h"

#include <sys/mman.h>

namespace ryn {

void* AllocateLarge(std::size_t bytes) {
    if (bytes < kLargePage)
        return ::operator new(bytes);
    void* const memory = ::operator new(bytes, std::align_val_t(kLargePage));
    // Advice only: where the system has no large pages the memory is as good as any.
    (void)::madvise(memory, bytes / kLargePage * kLargePage, MADV_HUGEPAGE);
    return memory;
}

void FreeLarge(void* memory, std::size_t bytes) noexcept {
    if (bytes < kLargePage)
        ::operator delete(memory);
    else
        ::operator delete(memory, std::align_val_t(kLargePage));
}

} // namespace ryn
