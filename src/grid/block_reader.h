#pragma once

#include <array>
#include <cstddef>
#include <vector>

#include "grid/block_shape.h"
#include "grid/layout.h"
#include "netcdf/nc_values.h"

namespace ryn {

/// Three lengths or places: of time, y and x, in this order, unless said otherwise.
using Triple = std::array<std::size_t, 3>;

/// A box of one layer: runs along time, y and x, in places of the file, where a turned axis still
/// runs backwards.
struct GridBox {
    std::array<Run, 3> runs;
};

/// Where the value at a place of a box goes: the distance of neighbours along each direction, which
/// is negative along a turned axis, and the place of the box's first value.
struct GridTarget {
    float* first = nullptr;
    std::array<std::ptrdiff_t, 3> stride{};
};

/// Reads one layer of one item. Everything must outlive the reader, and every box lie within the
/// variable.
class BlockReader {
  public:
    BlockReader(const NcFile& file, const GridVariable& item, int layer);

    /// Puts the box's values where `target` says, NaN where they are missing. The library is asked
    /// for blocks of whole chunks, and for contiguous ones where nothing is chunked; no more than
    /// `budgetBytes` are used besides the target, as far as a chunk allows it.
    Status Read(const GridBox& box, const GridTarget& target, std::size_t budgetBytes);

    /// Hands each block of the box to `take` as a span of floats in the file's order.
    template <typename Take>
    Status ForEachBlock(const GridBox& box, std::size_t budgetBytes, Take take) {
        for (const GridBox& block : Blocks(box, budgetBytes)) {
            if (Status status = ReadBlock(block); !status)
                return status;
            take(block, std::span<const float>(values));
        }
        return Status::Ok();
    }

    /// Lengths of a chunk along time, y and x; 1 where nothing is chunked.
    const Triple& Chunk() const { return chunk; }
    /// Time, y and x (0, 1, 2) from the slowest dimension to the fastest.
    const Triple& Order() const { return order; }

  private:
    std::vector<GridBox> Blocks(const GridBox& box, std::size_t budgetBytes) const;
    Status ReadBlock(const GridBox& block);
    void Scatter(const GridBox& block, const GridTarget& target) const;

    const NcVariable* variable;
    NcValues decoder;
    Triple place{}; // among the variable's dimensions
    Triple order{};
    Triple chunk{1, 1, 1};
    std::size_t bytesOfValue = sizeof(float);
    std::vector<std::size_t> start; // of the layer
    std::vector<std::size_t> count;
    std::vector<float> values;
};

} // namespace ryn
