#include "grid/block_reader.h"

#include <algorithm>

namespace ryn {

BlockReader::BlockReader(const NcFile& file, const GridVariable& item, int layer)
    : variable(item.variable),
      decoder(&file, item.variable),
      place{item.timePlace, item.yPlace, item.xPlace},
      order{0, 1, 2},
      start(item.variable->dimensions.size(), 0),
      count(item.variable->dimensions.size(), 1) {
    std::ranges::sort(order, {}, [this](std::size_t direction) { return place[direction]; });
    const std::vector<std::size_t> lengths = file.ChunkShape(*variable);
    for (std::size_t i = 0; i < chunk.size() && !lengths.empty(); ++i)
        chunk[i] = lengths[place[i]];
    // What is packed is read as doubles and unpacked into floats.
    const bool isScaled =
        file.Number(variable->id, "scale_factor") || file.Number(variable->id, "add_offset");
    if (variable->type != NcType::Float || isScaled)
        bytesOfValue += sizeof(double);
    // A layer's number counts the last of its dimensions fastest.
    auto rest = static_cast<std::size_t>(layer);
    for (std::size_t i = item.layerPlaces.size(); i-- > 0;) {
        const std::size_t length = file.DimensionOf(*variable, item.layerPlaces[i]).length;
        start[item.layerPlaces[i]] = rest % length;
        rest /= length;
    }
}

std::vector<GridBox> BlockReader::Blocks(const GridBox& box, std::size_t budgetBytes) const {
    Triple chunks{};
    Triple extent{};
    for (std::size_t i = 0; i < order.size(); ++i) {
        chunks[i] = chunk[order[i]];
        extent[i] = box.runs[order[i]].count;
    }
    const std::vector<std::size_t> shape =
        BlockShape(chunks, extent, std::max<std::size_t>(1, budgetBytes / bytesOfValue));
    std::array<std::vector<Run>, 3> pieces;
    for (std::size_t i = 0; i < order.size(); ++i)
        pieces[i] = CutRun(box.runs[order[i]], chunks[i], shape[i]);
    std::vector<GridBox> blocks;
    for (const Run& slow : pieces[0])
        for (const Run& middle : pieces[1])
            for (const Run& fast : pieces[2]) {
                GridBox block;
                block.runs[order[0]] = slow;
                block.runs[order[1]] = middle;
                block.runs[order[2]] = fast;
                blocks.push_back(block);
            }
    return blocks;
}

Status BlockReader::ReadBlock(const GridBox& block) {
    std::size_t size = 1;
    for (std::size_t i = 0; i < place.size(); ++i) {
        start[place[i]] = block.runs[i].start;
        count[place[i]] = block.runs[i].count;
        size *= block.runs[i].count;
    }
    values.resize(size);
    return decoder.Read(start, count, values.data());
}

Status BlockReader::Read(const GridBox& box, const GridTarget& target, std::size_t budgetBytes) {
    return ForEachBlock(box, budgetBytes, [&](const GridBox& block, std::span<const float>) {
        GridTarget part = target;
        for (std::size_t i = 0; i < part.stride.size(); ++i)
            part.first += part.stride[i] *
                          static_cast<std::ptrdiff_t>(block.runs[i].start - box.runs[i].start);
        Scatter(block, part);
    });
}

/// Walks the block as it lies in memory; only the writing jumps, within a block that was kept
/// small.
void BlockReader::Scatter(const GridBox& block, const GridTarget& target) const {
    const float* from = values.data();
    const auto along = [&](std::size_t i) {
        return static_cast<std::ptrdiff_t>(block.runs[order[i]].count);
    };
    const auto stride = [&](std::size_t i) { return target.stride[order[i]]; };
    const std::ptrdiff_t length = along(2);
    const std::ptrdiff_t step = stride(2);
    for (std::ptrdiff_t slow = 0; slow < along(0); ++slow)
        for (std::ptrdiff_t middle = 0; middle < along(1); ++middle) {
            float* const to = target.first + slow * stride(0) + middle * stride(1);
            for (std::ptrdiff_t i = 0; i < length; ++i)
                to[i * step] = *from++;
        }
}

} // namespace ryn
