#include "grid/grid_file.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include "grid/block_reader.h"
#include "grid/make_header.h"

namespace ryn {

namespace {

// More than this makes reading no faster, and leaves less room for the tile itself.
constexpr std::size_t kMostScratch = std::size_t{16} << 20;

std::size_t Size(int count) {
    return static_cast<std::size_t>(count);
}

Run RunOf(const SpatialAxis& axis, int first, int count) {
    return {std::min(axis.InFile(first), axis.InFile(first + count - 1)), Size(count)};
}

/// Where the box's first value in the file goes, from which a turned axis runs backwards.
GridTarget TargetOf(const GridLayout& layout, const GridTile& tile,
                    std::array<std::ptrdiff_t, 3> stride, float* values) {
    GridTarget target{values, stride};
    if (layout.y.isTurned) {
        target.first += stride[1] * (tile.countY - 1);
        target.stride[1] = -stride[1];
    }
    if (layout.x.isTurned) {
        target.first += stride[2] * (tile.countX - 1);
        target.stride[2] = -stride[2];
    }
    return target;
}

/// "x 3 to 5 of 0 to 4" when a part does not lie within its axis.
std::string Outside(const char* what, int first, int count, int size) {
    if (first >= 0 && count > 0 && first <= size - count)
        return {};
    return std::string(what) + " " + std::to_string(first) + " to " +
           std::to_string(static_cast<long long>(first) + count - 1) + ", but has 0 to " +
           std::to_string(size - 1);
}

int FirstOf(const SpatialAxis& axis, const Run& run) {
    const auto first = static_cast<int>(run.start);
    return axis.isTurned ? axis.size - first - static_cast<int>(run.count) : first;
}

} // namespace

Status GridFile::Open(const std::string& path, std::unique_ptr<GridFile>* result) {
    auto opened = std::make_unique<GridFile>();
    if (Status status = NcFile::Open(path, &opened->file, NcRuns::Short); !status)
        return status;
    if (Status status = FindGrid(opened->file, &opened->layout); !status)
        return status;
    opened->header =
        std::make_shared<const GridHeader>(MakeGridHeader(opened->file, opened->layout));
    *result = std::move(opened);
    return Status::Ok();
}

Status GridFile::CheckTile(const GridTile& tile) const {
    const auto items = static_cast<int>(layout.items.size());
    if (tile.item < 1 || tile.item > items)
        return file.InputFault("it has no item " + std::to_string(tile.item) + " (1 to " +
                               std::to_string(items) + ")");
    for (const std::string& fault : {Outside("layer", tile.layer, 1, Item(tile.item).layers),
                                     Outside("x", tile.firstX, tile.countX, layout.x.size),
                                     Outside("y", tile.firstY, tile.countY, layout.y.size),
                                     Outside("time step", tile.firstStep, tile.countSteps,
                                             static_cast<int>(header->milliseconds.size()))})
        if (!fault.empty())
            return file.InputFault("it was asked for " + fault);
    return Status::Ok();
}

Status GridFile::PlanTiles(const GridTile& whole, std::size_t limitBytes,
                           std::vector<GridTile>* tiles) const {
    if (Status status = CheckTile(whole); !status)
        return status;
    if (Status status = CheckHoldable(file, *Item(whole.item).variable); !status)
        return status;
    const std::size_t forValues = limitBytes - ScratchOf(limitBytes);
    const std::size_t points = forValues / sizeof(float) / Size(whole.countSteps);
    if (points < 1)
        return file.InputFault("the memory allowed, " + std::to_string(limitBytes) +
                               " bytes, does not hold the " + std::to_string(whole.countSteps) +
                               " steps of one point");
    *tiles = CutPlane(whole, points);
    return Status::Ok();
}

Status GridFile::DividePlane(const GridTile& whole, int pieces,
                             std::vector<GridTile>* tiles) const {
    if (Status status = CheckTile(whole); !status)
        return status;
    const std::size_t count = Size(std::max(1, pieces));
    const Run x = RunOf(layout.x, whole.firstX, whole.countX);
    const Run y = RunOf(layout.y, whole.firstY, whole.countY);
    const bool isXFaster = Item(whole.item).xPlace > Item(whole.item).yPlace;
    const Triple chunk = BlockReader(file, Item(whole.item), whole.layer).Chunk();
    const bool isChunked = chunk[1] > 1 || chunk[2] > 1;
    if (isChunked || (isXFaster ? y : x).count < count)
        *tiles = CutPlane(whole, std::max<std::size_t>(1, whole.Points() / count));
    else if (isXFaster)
        *tiles = TilesOf(whole, {x}, CutEvenly(y, count));
    else
        *tiles = TilesOf(whole, CutEvenly(x, count), {y});
    return Status::Ok();
}

std::vector<GridTile> GridFile::CutPlane(const GridTile& whole, std::size_t points) const {
    const BlockReader reader(file, Item(whole.item), whole.layer);
    // Tiles grow along the faster of the two first, whichever comes first in the file.
    const bool isXFaster = Item(whole.item).xPlace > Item(whole.item).yPlace;
    const Run x = RunOf(layout.x, whole.firstX, whole.countX);
    const Run y = RunOf(layout.y, whole.firstY, whole.countY);
    const Triple& chunk = reader.Chunk();
    const std::array<std::size_t, 2> chunks = {isXFaster ? chunk[1] : chunk[2],
                                               isXFaster ? chunk[2] : chunk[1]};
    const std::array<std::size_t, 2> extent = {isXFaster ? y.count : x.count,
                                               isXFaster ? x.count : y.count};
    const std::vector<std::size_t> shape = BlockShape(chunks, extent, points);
    return TilesOf(whole, CutRun(x, chunk[2], shape[isXFaster ? 1 : 0]),
                   CutRun(y, chunk[1], shape[isXFaster ? 0 : 1]));
}

std::vector<GridTile> GridFile::TilesOf(const GridTile& whole, const std::vector<Run>& x,
                                        const std::vector<Run>& y) const {
    std::vector<GridTile> tiles;
    for (const Run& along : x)
        for (const Run& across : y) {
            GridTile tile = whole;
            tile.firstX = FirstOf(layout.x, along);
            tile.countX = static_cast<int>(along.count);
            tile.firstY = FirstOf(layout.y, across);
            tile.countY = static_cast<int>(across.count);
            tiles.push_back(tile);
        }
    return tiles;
}

std::size_t GridFile::ScratchOf(std::size_t limitBytes) {
    return std::min(limitBytes / 4, kMostScratch);
}

Status GridFile::ReadInto(const GridTile& tile, std::array<std::ptrdiff_t, 3> stride,
                          std::size_t scratchBytes, std::span<float> values) const {
    if (Status status = CheckTile(tile); !status)
        return status;
    if (values.size() < tile.Values())
        return file.InputFault("the buffer given does not hold the tile");
    const GridBox box{{Run{Size(tile.firstStep), Size(tile.countSteps)},
                       RunOf(layout.y, tile.firstY, tile.countY),
                       RunOf(layout.x, tile.firstX, tile.countX)}};
    BlockReader reader(file, Item(tile.item), tile.layer);
    if (Status status =
            reader.Read(box, TargetOf(layout, tile, stride, values.data()), scratchBytes);
        !status)
        return status;
    const auto end = values.begin() + static_cast<std::ptrdiff_t>(tile.Values());
    std::replace_if(
        values.begin(), end, [](float value) { return std::isnan(value); }, header->deleteValue);
    return Status::Ok();
}

Status GridFile::ReadTile(const GridTile& tile, std::size_t scratchBytes,
                          std::span<float> values) const {
    return ReadInto(tile, {1, tile.countSteps, std::ptrdiff_t{tile.countY} * tile.countSteps},
                    scratchBytes, values);
}

Status GridFile::ReadPlanes(const GridTile& tile, std::size_t scratchBytes,
                            std::span<float> values) const {
    return ReadInto(tile, {std::ptrdiff_t{tile.countX} * tile.countY, tile.countX, 1}, scratchBytes,
                    values);
}

int GridFile::PlanesTogether(int item) const {
    const BlockReader reader(file, Item(item), 0);
    // Interleaved steps: reading one costs as much of the disk as reading all.
    if (reader.Order()[0] != 0 && reader.Chunk()[0] == 1)
        return std::numeric_limits<int>::max();
    return static_cast<int>(std::min(reader.Chunk()[0], header->milliseconds.size()));
}

Status GridFile::Summarise(int item, int layer, GridSummary* summary) const {
    const auto steps = static_cast<int>(header->milliseconds.size());
    const GridTile all{item, layer, 0, layout.x.size, 0, layout.y.size, 0, steps};
    if (Status status = CheckTile(all); !status)
        return status;
    if (Status status = CheckHoldable(file, *Item(item).variable); !status)
        return status;
    GridSummary found;
    // A NaN loses every comparison, so missing values need no test of their own below.
    found.smallest = std::numeric_limits<float>::infinity();
    found.largest = -found.smallest;
    const GridBox box{
        {Run{0, Size(steps)}, Run{0, Size(layout.y.size)}, Run{0, Size(layout.x.size)}}};
    BlockReader reader(file, Item(item), layer);
    Status status = reader.ForEachBlock(box, kMostScratch,
                                        [&found](const GridBox&, std::span<const float> values) {
                                            found.values += values.size();
                                            for (const float value : values) {
                                                found.missing += std::isnan(value) ? 1 : 0;
                                                found.smallest = std::min(found.smallest, value);
                                                found.largest = std::max(found.largest, value);
                                            }
                                        });
    if (!status)
        return status;
    if (found.missing == found.values)
        found.smallest = found.largest = std::numeric_limits<float>::quiet_NaN();
    *summary = found;
    return Status::Ok();
}

} // namespace ryn
