#pragma once

#include <string>
#include <vector>

#include "base/status.h"
#include "grid/grid_records.h"
#include "run/batch_run.h"

namespace ryn {

/// The results of one tile of a grid, as one of several processes leaves them for the one that
/// merges them.
struct ResultTile {
    struct Point {
        int number = 0; ///< in point order over the whole grid
        bool isGood = false;
        std::vector<float> results; ///< of a good one
    };

    std::string fingerprint; ///< of what the numbers were made from
    int withMissing = 0;     ///< as in BatchCounts, and so the next
    int withFewerPeaks = 0;
    int withMissingYears = 0;
    std::vector<Point> points; ///< the active ones
};

/// Writes a tile whole or not at all. It is not flushed: one that a power cut takes is made anew.
Status WriteResultTile(const ResultTile& tile, const std::string& path);

/// Reads a tile whose points each have `items` results. A file that is missing, broken, or not made
/// from what `fingerprint` stands for is a fault.
Status ReadResultTile(const std::string& path, const std::string& fingerprint, std::size_t items,
                      ResultTile* tile);

/// A text that changes when the analysis, the grid file (its name, size or time) or the program's
/// version does.
std::string BatchFingerprint(CGlobalKvf& root, const GridPlan& plan,
                             const std::string& baseDirectory);

} // namespace ryn
