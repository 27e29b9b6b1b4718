#pragma once

#include <array>
#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <vector>

#include "grid/block_shape.h"
#include "grid/grid_header.h"
#include "grid/grid_records.h"
#include "grid/layout.h"
#include "netcdf/nc_file.h"

namespace ryn {

/// A grid file open for reading. Missing values are the header's delete value everywhere.
class GridFile {
  public:
    /// The fault is one line that names the file.
    static Status Open(const std::string& path, std::unique_ptr<GridFile>* file);

    /// All three stay the same from opening on.
    const NcFile& File() const { return file; }
    const GridLayout& Layout() const { return layout; }
    const std::shared_ptr<const GridHeader>& Header() const { return header; }

    /// The whole plane of one step.
    GridTile PlaneTile(int item, int layer, int step) const {
        return {item, layer, 0, layout.x.size, 0, layout.y.size, step, 1};
    }
    /// A fault that says what of the tile does not exist.
    Status CheckTile(const GridTile& tile) const;
    /// CGridEditEngine::PlanTiles.
    Status PlanTiles(const GridTile& whole, std::size_t limitBytes,
                     std::vector<GridTile>* tiles) const;
    /// CGridEditEngine::DividePlane.
    Status DividePlane(const GridTile& whole, int pieces, std::vector<GridTile>* tiles) const;
    /// CGridEditEngine::ReadTile.
    Status ReadTile(const GridTile& tile, std::size_t scratchBytes, std::span<float> values) const;
    /// Whole planes one behind the other, x fast.
    Status ReadPlanes(const GridTile& tile, std::size_t scratchBytes,
                      std::span<float> values) const;
    /// What of a memory limit the reading of a tile takes besides the tile.
    static std::size_t ScratchOf(std::size_t limitBytes);
    /// Both as the engine's operations of these names.
    Status Summarise(int item, int layer, GridSummary* summary) const;
    Status ReadCoordinates(GridCoordinates* coordinates) const;

    /// How many planes of an item are best read together: as many as share chunks, or as lie
    /// interleaved where time is not the slowest dimension.
    int PlanesTogether(int item) const;

  private:
    const GridVariable& Item(int item) const {
        return layout.items[static_cast<std::size_t>(item - 1)];
    }
    /// Tiles of at most `points` places.
    std::vector<GridTile> CutPlane(const GridTile& whole, std::size_t points) const;
    /// The tiles whose sides are these runs along the axes as stored.
    std::vector<GridTile> TilesOf(const GridTile& whole, const std::vector<Run>& x,
                                  const std::vector<Run>& y) const;
    Status ReadInto(const GridTile& tile, std::array<std::ptrdiff_t, 3> stride,
                    std::size_t scratchBytes, std::span<float> values) const;

    NcFile file;
    GridLayout layout;
    std::shared_ptr<const GridHeader> header;
};

} // namespace ryn
