#pragma once

#include <vector>

#include "base/qx_array2d.h"
#include "grid/grid_file.h"

namespace ryn {

/// Planes that were read together because they share chunks or lie interleaved, so that walking
/// through the steps does not read, or decompress, the same part of the file once per step.
class SliceCache {
  public:
    /// Reads the plane of a step (GridFile::PlaneTile), which the file has.
    Status Read(const GridFile& grid, const GridTile& request, CQxArray2D<float>* plane);
    void Clear();

  private:
    bool Holds(const GridTile& request) const;
    Status Fill(const GridFile& grid, const GridTile& request);

    GridTile held; ///< no steps while empty
    std::vector<float> values;
};

} // namespace ryn
