#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "base/file_access.h"
#include "run/batch_ports.h"
#include "run/grid_batch.h"
#include "run/point_series.h"
#include "run/result_grids.h"
#include "run/result_layout.h"

namespace ryn {

/// What is known of a point.
enum class PointState : char { Inactive, Waiting, Good, Failed };

/// Whether a process runs all points of a batch or a share of them. A share leaves no files of
/// single points behind, which other shares would leave too.
enum class BatchShare { Whole, Part };

/// The steps that a batch over a whole grid and one over a part of it have in common. Each gives
/// false where the batch ends; the outcome then says how.
///
/// The document keeps the batch's ports, and the process the parameter file's directory, as long as
/// the object lives.
class BatchRun {
  public:
    /// Takes the results of a good point.
    using TakeResults = std::function<void(int point, const std::vector<float>& results)>;

    BatchRun(CRynEditDoc& analysed, const GridBatchOptions& wanted,
             BatchShare ofAll = BatchShare::Whole);
    ~BatchRun();
    BatchRun(const BatchRun&) = delete;
    BatchRun& operator=(const BatchRun&) = delete;

    /// Reads the plan, opens the grid, and tests whether the output can be written, before anything
    /// is touched.
    bool Prepare();
    /// How many points' results are in memory at one time; without this call those of the whole
    /// grid.
    void ExpectResultsOf(int points);
    /// Finds out which points take part.
    bool ReadActivity();
    void SetActivity(const std::vector<bool>& active);

    /// Prints the lines of the chunks of series.
    void PrintCreatedLines();
    /// The active points of a part of the grid, by number.
    std::vector<int> PointsOf(const GridTile& part) const;

    /// Runs the active points of parts of the grid, which make up the rectangle `whole`, over
    /// series in memory; `endPart` is told when a part is done, counted from 0, and gives false
    /// where the batch ends.
    bool RunParts(const GridTile& whole, const std::vector<GridTile>& parts,
                  const TakeResults& take, const std::function<bool(std::size_t part)>& endPart);
    /// Runs one point over its series, with the files that it leaves behind.
    bool RunPoint(int point, CTsq0FileInfo& series, const TakeResults& take);
    /// Takes over what was found of a point elsewhere.
    void NotePoint(int point, PointState state);

    /// Leaves the files that a batch on disk leaves behind its last point, which are those of that
    /// point with the results of the last good one before it, or those that were there before the
    /// batch; and the document with the results of the last good point.
    bool LeaveLastFiles();
    /// Writes the output grid file.
    bool WriteOutput(ResultGrids& grids);

    bool Fail(Status reason);
    bool IsStopped();
    ScratchFiles MakeScratch() const;
    /// Bytes for a tile: what is wanted less all that is in memory beside it. Nothing, and a
    /// failure, where that does not hold one point.
    std::optional<std::size_t> MemoryForTile();

    PointSeries& Series() { return series; }
    const GridPlan& Plan() const { return series.Plan(); }
    const ResultLayout& Layout() const { return layout; }
    const std::vector<bool>& Active() const { return active; }
    const std::vector<PointState>& States() const { return states; }
    GridBatchOutcome& Outcome() { return outcome; }
    CGlobalKvf& Root() { return root; }
    /// The offsets of a point in the result grids.
    GridPoint OffsetsOf(int point) const;

  private:
    Status TestFiles(const GridPlan& plan);
    bool End(BatchEnd how, Status reason);
    bool Take(int point, const PointOutcome& ended);
    void RestoreResults();
    bool LeaveFilesOf(int point);
    void KeepIfNeeded(int point);
    std::size_t TileBytes(double allowed) const;
    bool LeavesEachPointsFiles() const;
    std::string KeptNameOf(int point) const;

    CRynEditDoc& document;
    CGlobalKvf& root;
    const GridBatchOptions& options;
    CurrentDirectoryScope directory;
    BatchPorts ports;
    PointAnalysis analysis;
    PointSeries series;
    ResultLayout layout;
    BatchShare share;
    double resultBytes = 0.0;
    std::vector<bool> active;
    std::vector<PointState> states;
    int lastActive = -1; ///< number of the last point that takes part
    std::optional<ComputationLines> lines;
    int done = 0; ///< points with a result, good or not
    GridBatchOutcome outcome;
};

} // namespace ryn
