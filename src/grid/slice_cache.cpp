#include "grid/slice_cache.h"

#include <algorithm>

namespace ryn {

namespace {

// Together with the reader's own block: what a slice costs beside the plane itself.
constexpr std::size_t kCacheBytes = std::size_t{64} << 20;
constexpr std::size_t kScratchBytes = std::size_t{16} << 20;

/// The plane is allocated whole: it must be one that the file can hold.
Status CheckPlane(const GridFile& grid, std::size_t cells) {
    constexpr std::size_t kUnsuspicious = std::size_t{1} << 22;
    if (cells > kUnsuspicious && cells / kMostExpansion > grid.File().FileSize())
        return grid.File().InputFault("a plane counts more values than the file can hold");
    return Status::Ok();
}

} // namespace

void SliceCache::Clear() {
    held = {};
    values = {};
}

bool SliceCache::Holds(const GridTile& request) const {
    return held.item == request.item && held.layer == request.layer &&
           request.firstStep >= held.firstStep &&
           request.firstStep < held.firstStep + held.countSteps;
}

Status SliceCache::Fill(const GridFile& grid, const GridTile& request) {
    const std::size_t fitting = kCacheBytes / sizeof(float) / request.Points();
    const auto steps = static_cast<int>(grid.Header()->milliseconds.size());
    const int together = static_cast<int>(std::min<std::size_t>(
        fitting, static_cast<std::size_t>(grid.PlanesTogether(request.item))));
    GridTile wanted = request;
    if (together > 1) { // from where the chunk begins, so that walking back is served as well
        wanted.firstStep = request.firstStep / together * together;
        wanted.countSteps = std::min(together, steps - wanted.firstStep);
    }
    // Emptied first: on failure it must not pass for what it held, and two sets of planes at once
    // would double the memory.
    Clear();
    values.resize(wanted.Values());
    Status status = grid.ReadPlanes(wanted, kScratchBytes, values);
    if (status)
        held = wanted;
    return status;
}

Status SliceCache::Read(const GridFile& grid, const GridTile& request, CQxArray2D<float>* plane) {
    if (Status status = CheckPlane(grid, request.Points()); !status)
        return status;
    if (!Holds(request))
        if (Status status = Fill(grid, request); !status)
            return status;
    if (plane->SizeX() != request.countX || plane->SizeY() != request.countY)
        *plane = CQxArray2D<float>(request.countX, request.countY, grid.Header()->deleteValue);
    const auto first =
        static_cast<std::size_t>(request.firstStep - held.firstStep) * request.Points();
    std::copy_n(values.begin() + static_cast<std::ptrdiff_t>(first), request.Points(),
                plane->Data());
    return Status::Ok();
}

} // namespace ryn
