#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "base/status.h"
#include "grid/grid_edit.h"
#include "run/grid_plan.h"
#include "run/scratch_files.h"
#include "run/tile_buffer.h"
#include "run/tsq0_file_info.h"

namespace ryn {

/// Whether the points after this one are still wanted.
enum class Next { GoOn, Stop };

/// Turns the histories of grid points into series files.
///
/// A point takes part when its value at the first time step is not missing. Missing values of later
/// steps enter its series unchanged, as data.
class PointSeries {
  public:
    /// Opens the grid and tests the plan against it.
    Status Open(const GridPlan& wanted);
    void Close() { (void)engine.CloseFile(); }

    const CGridEditHeaderInfo& Header() const { return header; }
    const GridPlan& Plan() const { return plan; }
    /// Date and time of the first step used: "YYYY-MM-DD", "HH:MM:SS".
    const std::string& StartDate() const { return startDate; }
    const std::string& StartTime() const { return startTime; }
    Status ReadCoordinates(GridCoordinates* coordinates);

    /// CGridEditEngine::DividePlane for the plan's part of the grid.
    Status Divide(int pieces, std::vector<GridTile>* tiles);
    /// The numbers of the points in a part of the grid, in point order.
    std::vector<int> PointsOf(const GridTile& part) const;

    /// Bytes that one point costs beside its tile.
    std::size_t BytesOfPoint() const;

    /// Which points take part, by number. Reads the first step, in parts of `memory` bytes.
    Status ReadActivity(std::size_t memory, std::vector<bool>* active);

    /// What to do with the points of parts of the grid.
    struct Visit {
        /// With each active point's number and series. One series exists at a time.
        std::function<Next(int point, CTsq0FileInfo& series)> use;
        /// When all points of a part, counted from 0, are done; may be empty.
        std::function<Next(std::size_t part)> endPart;
    };
    /// Visits parts of the grid that make up the rectangle `whole`. It is read in tiles of at most
    /// `memory` bytes; within a tile go the parts one after the other, each in point order.
    Status ForEachPoint(const GridTile& whole, const std::vector<GridTile>& parts,
                        std::size_t memory, const std::vector<bool>& active, ScratchFiles& scratch,
                        const Visit& visit);

    /// Within `use`: keeps the history of that point, so that it need not be read again.
    void KeepHistory(int point);
    /// Calls `use` with the series of some active points, in the order given; those whose history
    /// was not kept are read, in one go where they lie close together.
    Status ForPoints(const std::vector<int>& points, std::size_t memory, ScratchFiles& scratch,
                     const std::function<Next(int point, CTsq0FileInfo& series)>& use);

    /// Makes the series of points `first` to `end` - 1 in one walk through the time steps; all are
    /// open at once. Each point's record says whether it takes part.
    Status MakeSeries(std::vector<CTsq0FileInfo>& points, int first, int end,
                      const std::function<bool()>& isStopped);

    /// How many of the series made so far have missing values, after the first step, as data.
    int SeriesWithMissing() const { return withMissing; }

  private:
    Status ReadHistories(const std::vector<int>& points, std::size_t memory);
    Status MakeOne(CTsq0FileInfo& series, int point, const float* values);
    Status VisitPoint(int point, const float* values, ScratchFiles& scratch, const Visit& visit,
                      Next* next);
    Status BeginAll(std::vector<CTsq0FileInfo>& points, int first, int end,
                    const CQxArray2D<float>& plane);
    Status EndAll(std::vector<CTsq0FileInfo>& points, int first, int end);

    CGridEditEngine engine;
    CGridEditHeaderInfo header;
    GridPlan plan;
    std::string startDate;
    std::string startTime;
    std::vector<double> seconds; ///< of each step, from the first one used
    int withMissing = 0;
    TileBuffer buffer;
    const float* history = nullptr; ///< of the point being used
    std::map<int, std::vector<float>> kept;
};

} // namespace ryn
