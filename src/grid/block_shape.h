#pragma once

#include <cstddef>
#include <span>
#include <vector>

namespace ryn {

/// The shape of the blocks in which a part of a stored array is read: whole chunks, so many that a
/// block stays within `budget` values, growing along the fastest dimensions first, so that a block
/// lies together in the file. All spans run from the slowest to the fastest dimension; what is not
/// chunked has chunks of 1. A single chunk beyond the budget is cut, the slowest dimension first.
/// No length is below 1.
std::vector<std::size_t> BlockShape(std::span<const std::size_t> chunk,
                                    std::span<const std::size_t> extent, std::size_t budget);

/// A run of places along a dimension.
struct Run {
    std::size_t start = 0;
    std::size_t count = 0;
    friend bool operator==(const Run&, const Run&) = default;
};

/// Cuts a run into pieces of a length, at multiples of the length counted from the start of the
/// chunk in which the run begins, so that no chunk is cut when the length is made of whole ones.
std::vector<Run> CutRun(const Run& run, std::size_t chunk, std::size_t length);

/// Cuts a run into so many pieces, of which none is longer than another by more than 1. `pieces`
/// is 1 to run.count.
std::vector<Run> CutEvenly(const Run& run, std::size_t pieces);

} // namespace ryn
