#include "grid/block_shape.h"

#include <algorithm>

namespace ryn {

namespace {

using Lengths = std::span<const std::size_t>;

/// Values of a block, of which what reaches beyond the extent is not read.
std::size_t Volume(Lengths shape, Lengths extent) {
    std::size_t volume = 1;
    for (std::size_t i = 0; i < shape.size(); ++i)
        if (__builtin_mul_overflow(volume, std::min(shape[i], extent[i]), &volume))
            return static_cast<std::size_t>(-1);
    return volume;
}

void CutToBudget(std::vector<std::size_t>* shape, Lengths extent, std::size_t budget) {
    for (std::size_t& length : *shape) {
        if (Volume(*shape, extent) <= budget)
            return;
        const std::size_t whole = length;
        length = 1;
        length = std::clamp<std::size_t>(budget / Volume(*shape, extent), 1, whole);
    }
}

/// Whole chunks that cover an extent wherever in a chunk it begins.
std::size_t Cover(std::size_t chunk, std::size_t extent) {
    return (extent + 2 * chunk - 2) / chunk * chunk;
}

} // namespace

std::vector<std::size_t> BlockShape(Lengths chunk, Lengths extent, std::size_t budget) {
    std::vector<std::size_t> shape;
    for (std::size_t i = 0; i < extent.size(); ++i)
        shape.push_back(std::max<std::size_t>(1, std::min(chunk[i], extent[i])));
    // What must be unpacked together is read together, be it across the file's order.
    const std::vector<std::size_t> whole = shape;
    CutToBudget(&shape, extent, budget);
    // Of a cut chunk nothing may grow: the other parts would only be read again.
    if (shape != whole)
        return shape;
    for (std::size_t i = shape.size(); i-- > 0;) {
        const std::size_t times = budget / Volume(shape, extent);
        if (times < 2)
            break;
        if (shape[i] * times < extent[i]) {
            shape[i] *= times;
            break;
        }
        shape[i] = Cover(chunk[i], extent[i]);
    }
    return shape;
}

std::vector<Run> CutRun(const Run& run, std::size_t chunk, std::size_t length) {
    std::vector<Run> pieces;
    const std::size_t end = run.start + run.count;
    const std::size_t base = run.start - run.start % chunk;
    for (std::size_t start = run.start; start < end;) {
        const std::size_t edge = base + ((start - base) / length + 1) * length;
        pieces.push_back({start, std::min(edge, end) - start});
        start = pieces.back().start + pieces.back().count;
    }
    return pieces;
}

std::vector<Run> CutEvenly(const Run& run, std::size_t pieces) {
    std::vector<Run> cut;
    for (std::size_t i = 0; i < pieces; ++i) {
        const std::size_t first = run.count * i / pieces;
        cut.push_back({run.start + first, run.count * (i + 1) / pieces - first});
    }
    return cut;
}

} // namespace ryn
