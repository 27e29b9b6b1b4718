#pragma once

#include <cstddef>
#include <span>

namespace ryn {

/// Memory for the values of one tile after another. Large ones lie in large pages where the system
/// has them: a tile is written across its whole length for each run that is read.
class TileBuffer {
  public:
    TileBuffer() = default;
    ~TileBuffer();
    TileBuffer(const TileBuffer&) = delete;
    TileBuffer& operator=(const TileBuffer&) = delete;

    /// Room for so many numbers, whose values are undefined; what was there before is gone. Throws
    /// std::bad_alloc.
    std::span<float> Take(std::size_t count);

  private:
    void Release();

    void* memory = nullptr;
    std::size_t bytes = 0;
};

} // namespace ryn
