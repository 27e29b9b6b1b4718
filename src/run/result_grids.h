#pragma once

#include <string>
#include <vector>

#include "base/qx_array2d.h"
#include "base/status.h"
#include "grid/grid_edit.h"
#include "run/grid_plan.h"
#include "run/result_layout.h"

namespace ryn {

/// The grids of a batch: one for each number that is kept of a point, with a cell for each place of
/// the range. A cell that no good point reaches keeps the delete value.
class ResultGrids {
  public:
    /// Allocates all grids.
    ResultGrids(const ResultLayout& counts, int cellsX, int cellsY, float deleteValue);
    static double BytesFor(const ResultLayout& counts, const GridPlan& plan);

    /// Copies the results into the cells (i, j).
    void CopyPointResults(const COutputSettings& results, int i, int j);
    /// The same from numbers that PointResults made.
    void CopyRow(const std::vector<float>& row, int i, int j);

    const ResultLayout& Layout() const { return layout; }
    float DeleteValue() const { return missing; }
    /// In the order of the layout.
    std::vector<CQxArray2D<float>>& Grids() { return grids; }

  private:
    ResultLayout layout;
    float missing;
    std::vector<CQxArray2D<float>> grids;
};

/// What the output grid file takes over from the grid file.
struct ResultGridSource {
    GridPlan plan;
    CGridEditHeaderInfo header;
    GridCoordinates coordinates; ///< of the whole grid
    std::string startDate;       ///< of the first step used, "YYYY-MM-DD"
    std::string startTime;       ///< "HH:MM:SS"
};

/// Writes the output grid file: one time step that holds all items. Empties the grids as it goes,
/// so that none is in memory twice. On failure an old file stands as it was.
Status WriteResultGrids(const ResultGridSource& source, const std::vector<ResultItem>& items,
                        ResultGrids& results);

} // namespace ryn
