#include "run/grid_parts.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <string_view>
#include <system_error>
#include <utility>

#include "base/file_access.h"
#include "base/path_parts.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

/// A share has several tiles, so that one which is killed has not lost all.
constexpr int kTilesOfAPart = 8;

std::string TileDirectory(const GridPlan& plan) {
    return plan.outputFile + ".tiles";
}

std::string TileName(const GridPlan& plan, std::size_t tile, std::size_t count) {
    return TileDirectory(plan) + "/" + std::to_string(tile + 1) + "of" + std::to_string(count);
}

bool SkipDigits(std::string_view* text) {
    const std::size_t end = std::min(text->find_first_not_of("0123456789"), text->size());
    text->remove_prefix(end);
    return end > 0;
}

/// Whether a name is that of a tile, for any number of parts, or of one that was being written when
/// its part was killed.
bool IsNameOfTile(std::string_view name) {
    const bool isTemporary = name.starts_with('.');
    name.remove_prefix(isTemporary ? 1 : 0);
    if (!SkipDigits(&name) || !name.starts_with("of"))
        return false;
    name.remove_prefix(2);
    return SkipDigits(&name) && name.starts_with('.') == isTemporary && name.empty() != isTemporary;
}

/// What cannot be removed does no harm.
void RemoveTiles(const std::string& directory) {
    std::error_code error;
    std::vector<std::filesystem::path> found;
    for (std::filesystem::directory_iterator entry(directory, error), end; !error && entry != end;
         entry.increment(error))
        if (IsNameOfTile(entry->path().filename().string()))
            found.push_back(entry->path());
    for (const std::filesystem::path& path : found)
        std::filesystem::remove(path, error);
    std::filesystem::remove(directory, error);
}

/// The tiles of the whole grid: the same for every share, wherever and with however much memory it
/// runs.
bool PlanResultTiles(BatchRun& run, int parts, std::vector<GridTile>* tiles) {
    // A tile is a text of some 16 bytes a number, and several times that where it is in memory,
    // which no limit may be too small for.
    constexpr double kMostBytes = 8.0 * 1024 * 1024;
    const double bytes = 16.0 * static_cast<double>(run.Layout().Items()) * run.Plan().Points();
    const auto pieces = std::max<std::int64_t>(std::int64_t{kTilesOfAPart} * parts,
                                               static_cast<std::int64_t>(bytes / kMostBytes) + 1);
    Status divided = run.Series().Divide(
        static_cast<int>(std::min<std::int64_t>(pieces, run.Plan().Points())), tiles);
    return divided ? true : run.Fail(std::move(divided));
}

/// Tiles have as many places, but those of an interval above 1 are not as many points.
int MostPointsOf(BatchRun& run, const std::vector<GridTile>& tiles) {
    std::size_t most = 0;
    for (const GridTile& tile : tiles)
        most = std::max(most, run.Series().PointsOf(tile).size());
    return static_cast<int>(most);
}

/// Reads a tile that was made from the same, and holds just the active points of its part of the
/// grid.
bool ReadFittingTile(const BatchRun& run, const std::string& path, const std::string& fingerprint,
                     const GridTile& part, ResultTile* tile) {
    ResultTile read;
    if (!ReadResultTile(path, fingerprint, static_cast<std::size_t>(run.Layout().Items()), &read))
        return false;
    std::vector<int> expected = run.PointsOf(part);
    std::vector<int> found;
    for (const ResultTile::Point& point : read.points)
        found.push_back(point.number);
    std::sort(expected.begin(), expected.end());
    std::sort(found.begin(), found.end());
    *tile = std::move(read);
    return found == expected;
}

std::string FingerprintOf(BatchRun& run, const CRynEditDoc& document) {
    return BatchFingerprint(run.Root(), run.Plan(), SplitPath(document.GetPathName()).directory);
}

/// One share of a batch.
class PartRun {
  public:
    PartRun(CRynEditDoc& document, const GridBatchOptions& wanted, const GridPart& share)
        : options(WithoutLines(wanted)),
          print(wanted.print),
          run(document, options, BatchShare::Part),
          part(share),
          owner(document) {}

    GridBatchOutcome Execute();

  private:
    using GoodResults = std::map<int, std::vector<float>>; // by number of the point

    /// The lines of the computation count points over the whole grid.
    static GridBatchOptions WithoutLines(GridBatchOptions wanted) {
        wanted.print = {};
        return wanted;
    }
    bool MakeDirectory();
    bool Stands(std::size_t index) const;
    bool RunTiles(std::size_t first, std::size_t end);
    bool RunGroup(const GridTile& group, std::size_t first, std::size_t end);
    bool Write(std::size_t index, const GoodResults& good);
    void Print(int text, std::size_t index);

    GridBatchOptions options;
    PrintLine print;
    BatchRun run;
    GridPart part;
    CRynEditDoc& owner;
    std::string fingerprint;
    std::vector<GridTile> tiles;
    BatchCounts told; ///< of the points in the tiles written so far
};

void PartRun::Print(int text, std::size_t index) {
    if (print)
        print(FormatText(text, index + 1, tiles.size()));
}

bool PartRun::MakeDirectory() {
    std::error_code error;
    std::filesystem::create_directory(TileDirectory(run.Plan()), error);
    return error ? run.Fail(Status::FromErrno(TileDirectory(run.Plan()), error.value())) : true;
}

bool PartRun::Stands(std::size_t index) const {
    ResultTile tile;
    return ReadFittingTile(run, TileName(run.Plan(), index, tiles.size()), fingerprint,
                           tiles[index], &tile);
}

/// The part of the grid that two tiles cover together; nothing where they leave some of it out.
std::optional<GridTile> Joined(const GridTile& a, const GridTile& b) {
    GridTile both = a;
    both.firstX = std::min(a.firstX, b.firstX);
    both.firstY = std::min(a.firstY, b.firstY);
    both.countX = std::max(a.firstX + a.countX, b.firstX + b.countX) - both.firstX;
    both.countY = std::max(a.firstY + a.countY, b.firstY + b.countY) - both.firstY;
    return both.Points() == a.Points() + b.Points() ? std::optional(both) : std::nullopt;
}

// Tiles that are read in one go are run in one go, since a file is read in the longer runs the
// larger the part of it is.
bool PartRun::RunTiles(std::size_t first, std::size_t end) {
    const std::optional<std::size_t> memory = run.MemoryForTile();
    if (!memory)
        return false;
    const std::size_t most = CGridEditEngine::BytesForValues(*memory);
    for (std::size_t i = first; i < end;) {
        if (Stands(i)) {
            Print(kTextGridTileStands, i++);
            continue;
        }
        GridTile group = tiles[i];
        std::size_t past = i + 1;
        for (; past < end && !Stands(past); ++past) {
            const std::optional<GridTile> both = Joined(group, tiles[past]);
            if (!both || both->Values() * sizeof(float) > most)
                break;
            group = *both;
        }
        if (!RunGroup(group, i, past))
            return false;
        i = past;
    }
    return true;
}

// A tile is written when its points are done, so that a part that is killed has lost that one only.
bool PartRun::RunGroup(const GridTile& group, std::size_t first, std::size_t end) {
    const std::vector<GridTile> parts(tiles.begin() + static_cast<std::ptrdiff_t>(first),
                                      tiles.begin() + static_cast<std::ptrdiff_t>(end));
    GoodResults good;
    return run.RunParts(
        group, parts,
        [&good](int point, const std::vector<float>& results) { good.emplace(point, results); },
        [&](std::size_t index) { return Write(first + index, std::exchange(good, {})); });
}

bool PartRun::Write(std::size_t index, const GoodResults& good) {
    const BatchCounts before = std::exchange(told, run.Outcome().counts);
    ResultTile tile;
    tile.fingerprint = fingerprint;
    tile.withMissing = told.withMissing - before.withMissing;
    tile.withFewerPeaks = told.withFewerPeaks - before.withFewerPeaks;
    tile.withMissingYears = told.withMissingYears - before.withMissingYears;
    for (const int point : run.PointsOf(tiles[index])) {
        const auto results = good.find(point);
        const bool isGood = results != good.end();
        tile.points.push_back({point, isGood, isGood ? results->second : std::vector<float>()});
    }
    if (Status written = WriteResultTile(tile, TileName(run.Plan(), index, tiles.size())); !written)
        return run.Fail(std::move(written));
    Print(kTextGridTileWritten, index);
    return true;
}

GridBatchOutcome PartRun::Execute() {
    if (!run.Prepare())
        return std::move(run.Outcome());
    fingerprint = FingerprintOf(run, owner);
    if (!PlanResultTiles(run, part.count, &tiles))
        return std::move(run.Outcome());
    run.ExpectResultsOf(MostPointsOf(run, tiles));
    if (!MakeDirectory() || !run.ReadActivity())
        return std::move(run.Outcome());
    const auto count = static_cast<std::size_t>(part.count);
    const std::size_t first = tiles.size() * static_cast<std::size_t>(part.number - 1) / count;
    const std::size_t end = tiles.size() * static_cast<std::size_t>(part.number) / count;
    if (RunTiles(first, end))
        run.Outcome().end = BatchEnd::Written;
    return std::move(run.Outcome());
}

} // namespace

GridBatchOutcome RunGridPart(CRynEditDoc& document, const GridBatchOptions& options,
                             const GridPart& part) {
    return PartRun(document, options, part).Execute();
}

GridMerge::GridMerge(CRynEditDoc& analysed, const GridBatchOptions& wanted, int partCount)
    : options(wanted),
      document(analysed),
      run(analysed, options),
      parts(partCount) {}

bool GridMerge::Prepare() {
    if (!run.Prepare() || !PlanResultTiles(run, parts, &tiles))
        return false;
    // Before the sections point at a point.
    fingerprint = FingerprintOf(run, document);
    if (!run.ReadActivity())
        return false;
    states.assign(tiles.size(), TileState::Missing);
    if (options.print)
        run.PrintCreatedLines();
    grids.emplace(run.Layout(), run.Plan().CellsX(), run.Plan().CellsY(),
                  run.Series().Header().DeleteValue());
    return true;
}

void GridMerge::TakeTiles() {
    for (std::size_t i = 0; i < tiles.size(); ++i) {
        const std::string name = TileName(run.Plan(), i, tiles.size());
        if (states[i] == TileState::Taken || !CanOpenForReading(name))
            continue;
        ResultTile tile;
        const bool fits = ReadFittingTile(run, name, fingerprint, tiles[i], &tile);
        if (fits)
            TakeTile(tile);
        states[i] = fits ? TileState::Taken : TileState::Unfit;
    }
}

void GridMerge::TakeTile(const ResultTile& tile) {
    for (const ResultTile::Point& point : tile.points) {
        const GridPoint cell = run.OffsetsOf(point.number);
        grids->CopyRow(point.results, cell.x, cell.y);
        run.NotePoint(point.number, point.isGood ? PointState::Good : PointState::Failed);
    }
    BatchCounts& counts = run.Outcome().counts;
    counts.withMissing += tile.withMissing;
    counts.withFewerPeaks += tile.withFewerPeaks;
    counts.withMissingYears += tile.withMissingYears;
}

std::vector<std::string> GridMerge::TilesIn(TileState state) const {
    std::vector<std::string> names;
    for (std::size_t i = 0; i < tiles.size(); ++i)
        if (states[i] == state)
            names.push_back(TileName(run.Plan(), i, tiles.size()));
    return names;
}

GridBatchOutcome GridMerge::Finish() {
    if (run.LeaveLastFiles() && run.WriteOutput(*grids))
        RemoveTiles(TileDirectory(run.Plan()));
    return std::move(run.Outcome());
}

} // namespace ryn
