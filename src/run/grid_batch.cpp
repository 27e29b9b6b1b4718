#include "run/grid_batch.h"

#include <algorithm>
#include <cstdio>
#include <vector>

#include "base/path_parts.h"
#include "base/stop_signals.h"
#include "document/parameter_file_name.h"
#include "run/batch_run.h"

namespace ryn {

namespace {

/// One batch over a whole grid.
class GridBatch {
  public:
    GridBatch(CRynEditDoc& document, const GridBatchOptions& wanted)
        : options(wanted),
          run(document, wanted) {}

    GridBatchOutcome Execute() {
        if (run.Prepare() &&
            (options.scratch == Scratch::Disk ? ComputeOnDisk() : ComputeInMemory()))
            run.WriteOutput(*grids);
        return std::move(run.Outcome());
    }

  private:
    void MakeGrids() {
        grids.emplace(run.Layout(), run.Plan().CellsX(), run.Plan().CellsY(),
                      run.Series().Header().DeleteValue());
    }
    BatchRun::TakeResults IntoGrids() {
        return [this](int point, const std::vector<float>& results) {
            const GridPoint cell = run.OffsetsOf(point);
            grids->CopyRow(results, cell.x, cell.y);
        };
    }
    void Print(const std::string& line) {
        if (options.print)
            options.print(line);
    }

    bool ComputeOnDisk();
    bool MakeSeriesOnDisk(std::vector<CTsq0FileInfo>& points);
    bool ComputeInMemory();

    const GridBatchOptions& options;
    BatchRun run;
    std::optional<ResultGrids> grids;
};

// What is written to the open files of a chunk waits in memory, so that a process that may open
// very many of them takes fewer points in one walk than it prints lines for.
bool GridBatch::MakeSeriesOnDisk(std::vector<CTsq0FileInfo>& points) {
    const std::optional<std::size_t> memory = run.MemoryForTile();
    if (!memory)
        return false;
    const int count = run.Plan().Points();
    const int chunk = PointsInChunk();
    const auto fitting = static_cast<int>(std::clamp<std::size_t>(
        *memory / run.Series().BytesOfPoint(), 1, static_cast<std::size_t>(chunk)));
    int created = 0;
    for (int first = 0; first < count; first += chunk) {
        const int end = first + std::min(chunk, count - first);
        for (int part = first; part < end; part += fitting) {
            Status made = run.Series().MakeSeries(points, part, std::min(end, part + fitting),
                                                  [this] { return run.IsStopped(); });
            if (!made)
                return run.Fail(std::move(made));
            if (run.IsStopped())
                return false;
        }
        for (int p = first; p < end; ++p)
            created += points[static_cast<std::size_t>(p)].IsActive() ? 1 : 0;
        Print(CreatedLine(created, count - end));
    }
    run.Outcome().counts.withMissing = run.Series().SeriesWithMissing();
    return true;
}

bool GridBatch::ComputeOnDisk() {
    ScratchFiles scratch = run.MakeScratch();
    std::vector<CTsq0FileInfo> points;
    points.reserve(static_cast<std::size_t>(run.Plan().Points()));
    for (int p = 0; p < run.Plan().Points(); ++p) {
        const GridPoint place = run.Plan().PointAt(p);
        points.emplace_back(scratch).SetPosition(place.x, place.y);
    }
    if (!MakeSeriesOnDisk(points))
        return false;
    std::vector<bool> active(points.size());
    std::transform(points.begin(), points.end(), active.begin(),
                   [](const CTsq0FileInfo& point) { return point.IsActive(); });
    run.SetActivity(active);
    MakeGrids();
    for (int p = 0; p < run.Plan().Points(); ++p)
        if (active[static_cast<std::size_t>(p)] &&
            !run.RunPoint(p, points[static_cast<std::size_t>(p)], IntoGrids()))
            return false;
    return true;
}

bool GridBatch::ComputeInMemory() {
    if (!run.ReadActivity())
        return false;
    if (options.print)
        run.PrintCreatedLines();
    MakeGrids();
    return run.RunParts(run.Plan().Whole(), {run.Plan().Whole()}, IntoGrids(),
                        [](std::size_t /*part*/) { return true; }) &&
           run.LeaveLastFiles();
}

void PrintOnStandardOutput(const std::string& line) {
    std::fputs(line.c_str(), stdout);
    std::fflush(stdout);
}

} // namespace

GridBatchOutcome RunGridAnalysis(CRynEditDoc& document, const GridBatchOptions& options) {
    return GridBatch(document, options).Execute();
}

void RynTsq2Analysis(const std::string& path) {
    const std::string name = FindParameterFile(FullPath(path));
    int caught = 0;
    {
        const StopSignals signals;
        CRynEditDoc document;
        document.OnOpenDocument(name);
        document.SetPathName(name, 1);
        GridBatchOptions options;
        options.print = PrintOnStandardOutput;
        options.isStopped = [] { return StopSignals::Caught() != 0; };
        RunGridAnalysis(document, options);
        caught = StopSignals::Caught();
    }
    if (caught != 0)
        EndBySignal(caught);
}

} // namespace ryn
