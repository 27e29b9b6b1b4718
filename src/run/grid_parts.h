#pragma once

#include <optional>
#include <string>
#include <vector>

#include "run/batch_run.h"
#include "run/grid_batch.h"
#include "run/result_grids.h"
#include "run/result_tile.h"

namespace ryn {

/// One of several shares of a batch.
struct GridPart {
    int number = 1; ///< 1 to count
    int count = 1;
};

/// Runs one share of the points and leaves their results in tiles beside the output, in the
/// directory OUTPUT.tiles. A tile that is there and fits is passed over. Files of single points are
/// not left: the merge does that for the last one. `end` is Written when all tiles of the share
/// stand.
///
/// GridBatchOptions::print gets one line for each tile.
GridBatchOutcome RunGridPart(CRynEditDoc& document, const GridBatchOptions& options,
                             const GridPart& part);

/// Makes the output grid of the tiles of all shares: bit for bit that of one process.
class GridMerge {
  public:
    enum class TileState { Missing, Unfit, Taken };

    GridMerge(CRynEditDoc& document, const GridBatchOptions& options, int parts);

    /// Opens the grid; false where that ends the batch, as Outcome says. GridBatchOptions::print
    /// gets the lines of the series.
    bool Prepare();
    /// Takes over the tiles that stand by now and fit. With `print`, tells how far the computation
    /// has come.
    void TakeTiles();
    /// The tiles in a state, by the names of their files.
    std::vector<std::string> TilesIn(TileState state) const;
    /// With all tiles taken: leaves the files of the last point, writes the output, and removes the
    /// tiles, those of another number of parts too.
    GridBatchOutcome Finish();
    GridBatchOutcome& Outcome() { return run.Outcome(); }

  private:
    void TakeTile(const ResultTile& tile);

    GridBatchOptions options;
    CRynEditDoc& document;
    BatchRun run;
    int parts;
    std::string fingerprint;
    std::vector<GridTile> tiles;
    std::vector<TileState> states;
    std::optional<ResultGrids> grids;
};

} // namespace ryn
