#include "run/tile_buffer.h"

#include <limits>
#include <new>
#include <sys/mman.h>

namespace ryn {

TileBuffer::~TileBuffer() {
    Release();
}

void TileBuffer::Release() {
    if (memory != nullptr)
        ::munmap(memory, bytes);
    memory = nullptr;
    bytes = 0;
}

std::span<float> TileBuffer::Take(std::size_t count) {
    if (count > std::numeric_limits<std::size_t>::max() / sizeof(float))
        throw std::bad_alloc();
    if (const std::size_t wanted = count * sizeof(float); wanted > bytes) {
        Release();
        void* const found =
            ::mmap(nullptr, wanted, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        if (found == MAP_FAILED)
            throw std::bad_alloc();
        memory = found;
        bytes = wanted;
        ::madvise(memory, bytes, MADV_HUGEPAGE); // where that is not to be had, small pages serve
    }
    return {static_cast<float*>(memory), count};
}

} // namespace ryn
