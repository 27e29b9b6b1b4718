#include "run/batch_run.h"

#include <algorithm>
#include <utility>

#include "base/atomic_file.h"
#include "base/path_parts.h"
#include "base/process_limits.h"
#include "results/result_file.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr double kMebibyte = 1024.0 * 1024.0;

/// What the engine, the stores and the netCDF library take, whatever the grid.
constexpr double kFixedBytes = 24 * kMebibyte;

} // namespace

BatchRun::BatchRun(CRynEditDoc& analysed, const GridBatchOptions& wanted, BatchShare ofAll)
    : document(analysed),
      root(analysed.GetGlobalKvf()),
      options(wanted),
      directory(SplitPath(analysed.GetPathName()).directory),
      ports(analysed),
      analysis(analysed, wanted.engines),
      layout(ResultLayout::Of(root)),
      share(ofAll) {
    outcome.logFile = LogFileOf(root.DefineEVS().OutputFileName);
    // The next point overwrites its files.
    document.SetDurability(Durability::Unflushed);
    root.Values().SetDurability(Durability::Unflushed);
}

BatchRun::~BatchRun() {
    document.SetDurability(Durability::Flushed);
    root.Values().SetDurability(Durability::Flushed);
}

bool BatchRun::End(BatchEnd how, Status reason) {
    outcome.end = how;
    outcome.reason = std::move(reason);
    return false;
}

bool BatchRun::Fail(Status reason) {
    return End(BatchEnd::Failed, std::move(reason));
}

bool BatchRun::IsStopped() {
    if (!options.isStopped || !options.isStopped())
        return false;
    outcome.end = BatchEnd::Stopped;
    return true;
}

// The grid is the user's data, and the files of the analysis are written while the batch runs.
Status BatchRun::TestFiles(const GridPlan& plan) {
    const std::string& results = root.DefineEVS().OutputFileName;
    for (const std::string& other :
         {plan.gridFile, document.GetPathName(), analysis.ParameterFile(), results})
        if (plan.outputFile == other || IsSameFile(plan.outputFile, other))
            return Status::InputFault(FormatText(kTextGridOutputTaken, plan.outputFile));
    // By a link, which a save follows.
    for (const std::string& other : {plan.gridFile, document.GetPathName()})
        if (IsSameFile(analysis.ParameterFile(), other))
            return Status::InputFault(
                FormatText(kTextGridPointFileTaken, analysis.ParameterFile()));
    if (Status free = document.TestResultFileName(); !free)
        return free;
    for (const std::string& written : {plan.outputFile, analysis.ParameterFile(), results})
        if (Status writable = TestAtomicWrite(written); !written.empty() && !writable)
            return writable;
    return Status::Ok();
}

bool BatchRun::Prepare() {
    const CTsq2InputKvf& input = root.GridInput();
    if (!input.UseTsq2Input)
        return false;
    GridPlan plan;
    if (Status fault = MakeGridPlan(input, SplitPath(document.GetPathName()).directory, &plan);
        !fault)
        return End(BatchEnd::Refused,
                   Status::InputFault(document.GetPathName() + ": " + fault.Text()));
    outcome.outputFile = plan.outputFile;
    Status fault = series.Open(plan);
    if (fault)
        fault = TestFiles(plan);
    if (!fault)
        return End(BatchEnd::Refused, std::move(fault));
    outcome.counts.points = plan.Points();
    resultBytes = ResultGrids::BytesFor(layout, plan);
    return true;
}

/// A grid that stays in the system's cache is read in tiles of a size that the processor's caches
/// and its address tables serve well; for one that does not, long runs on the disk count for more.
/// Of parts that run side by side each takes new memory, which costs more than shorter runs do.
std::size_t BatchRun::TileBytes(double allowed) const {
    const double wellServed = (share == BatchShare::Whole ? 256 : 96) * kMebibyte;
    const double whole = static_cast<double>(Plan().Whole().Values()) * sizeof(float);
    const bool staysInCache = whole <= static_cast<double>(UsableMemory()) / 2;
    const double least = 16.0 * Plan().Steps();
    return static_cast<std::size_t>(staysInCache ? std::min(allowed, std::max(wellServed, least))
                                                 : allowed);
}

std::optional<std::size_t> BatchRun::MemoryForTile() {
    const double wanted =
        static_cast<double>(options.memory != 0 ? options.memory : UsableMemory() / 4);
    const double slice = static_cast<double>(Plan().Whole().Points()) * sizeof(float);
    const double beside = resultBytes + 2.0 * slice + 2.0 * Plan().Points() +
                          static_cast<double>(series.BytesOfPoint()) + kFixedBytes;
    const double tile = std::max(slice, 8.0 * Plan().Steps());
    if (beside + tile <= wanted)
        return TileBytes(wanted - beside);
    End(BatchEnd::Refused,
        Status::SystemFault(
            FormatText(kTextGridMemoryTooSmall, (beside + tile) / kMebibyte, wanted / kMebibyte)));
    return std::nullopt;
}

void BatchRun::ExpectResultsOf(int points) {
    // As numbers, as a tree, and as the text of it.
    constexpr double kBytesOfNumber = 64.0;
    resultBytes = kBytesOfNumber * static_cast<double>(layout.Items()) * points;
}

void BatchRun::PrintCreatedLines() {
    ryn::PrintCreatedLines(active, PointsInChunk(), options.print);
}

std::vector<int> BatchRun::PointsOf(const GridTile& part) const {
    std::vector<int> points = series.PointsOf(part);
    std::erase_if(points, [this](int point) { return !active[static_cast<std::size_t>(point)]; });
    return points;
}

bool BatchRun::ReadActivity() {
    const std::optional<std::size_t> memory = MemoryForTile();
    if (!memory)
        return false;
    std::vector<bool> found;
    if (Status read = series.ReadActivity(*memory, &found); !read)
        return Fail(std::move(read));
    SetActivity(found);
    return true;
}

void BatchRun::SetActivity(const std::vector<bool>& found) {
    active = found;
    states.assign(active.size(), PointState::Inactive);
    for (std::size_t p = 0; p < active.size(); ++p)
        if (active[p])
            states[p] = PointState::Waiting;
    outcome.counts.active = static_cast<int>(std::count(active.begin(), active.end(), true));
    lines.emplace(active, options.print);
    for (std::size_t p = 0; p < active.size(); ++p)
        if (active[p])
            lastActive = static_cast<int>(p);
}

GridPoint BatchRun::OffsetsOf(int point) const {
    const GridPoint place = Plan().PointAt(point);
    return {place.x - Plan().x.first, place.y - Plan().y.first};
}

bool BatchRun::LeavesEachPointsFiles() const {
    return options.scratch == Scratch::Disk && share == BatchShare::Whole;
}

std::string BatchRun::KeptNameOf(int point) const {
    if (!root.GridInput().SaveEVS)
        return {};
    const PathParts parts = SplitPath(Plan().outputFile);
    const GridPoint offsets = OffsetsOf(point);
    return parts.directory + "ExtremeValueSeries/" + parts.name + "_" + std::to_string(offsets.x) +
           "_" + std::to_string(offsets.y) + ".tsq0";
}

ScratchFiles BatchRun::MakeScratch() const {
    const std::string other = SplitPath(document.GetPathName()).directory;
    if (options.scratch == Scratch::Memory)
        return ScratchFiles::InMemory(other);
    return share == BatchShare::Whole ? ScratchFiles::OnDisk(other)
                                      : ScratchFiles::InOwnDirectory(other);
}

void BatchRun::NotePoint(int point, PointState state) {
    states[static_cast<std::size_t>(point)] = state;
    ++outcome.counts.computed;
    outcome.counts.failed += state == PointState::Failed ? 1 : 0;
    lines->Computed(point, state == PointState::Good);
    if (options.progress != nullptr)
        options.progress->ShowProgress(++done, outcome.counts.active);
}

/// Notes how a point ended.
bool BatchRun::Take(int point, const PointOutcome& ended) {
    if (ended.end == PointEnd::Broken)
        return Fail(Status::SystemFault(ended.reason.Text()));
    outcome.counts.withFewerPeaks += ended.hasFewerPeaks ? 1 : 0;
    if (ended.end != PointEnd::SetUpFailed) {
        NotePoint(point, ended.end == PointEnd::Good ? PointState::Good : PointState::Failed);
        return true;
    }
    ++outcome.counts.computed;
    if (!LeavesEachPointsFiles() && !LeaveFilesOf(point))
        return false;
    outcome.end = BatchEnd::SetUpFailed;
    document.GetPorts().textViewer->ViewTextFile(outcome.logFile);
    return false;
}

bool BatchRun::RunPoint(int point, CTsq0FileInfo& files, const TakeResults& take) {
    if (IsStopped())
        return false;
    const int before = ports.ExtractionsWithMissingYears();
    const PointOutcome ended =
        analysis.Run({files.Path(), files.NameSeries(), KeptNameOf(point)},
                     LeavesEachPointsFiles() ? PointTrace::Files : PointTrace::None);
    outcome.counts.withMissingYears += ports.ExtractionsWithMissingYears() - before;
    if (ended.end == PointEnd::Good)
        take(point, PointResults(document.Results(), layout, series.Header().DeleteValue()));
    return Take(point, ended);
}

/// The last points are run again when all are done; reading them anew takes long where each value
/// of a history lies apart from the next.
void BatchRun::KeepIfNeeded(int point) {
    constexpr int kKept = 16;
    if (share == BatchShare::Whole && point > lastActive - kKept)
        series.KeepHistory(point);
}

bool BatchRun::RunParts(const GridTile& whole, const std::vector<GridTile>& parts,
                        const TakeResults& take,
                        const std::function<bool(std::size_t part)>& endPart) {
    const std::optional<std::size_t> memory = MemoryForTile();
    if (!memory)
        return false;
    ScratchFiles scratch = MakeScratch();
    bool goesOn = true;
    const auto orStop = [&goesOn](bool good) {
        goesOn = good;
        return good ? Next::GoOn : Next::Stop;
    };
    PointSeries::Visit visit;
    visit.use = [&](int point, CTsq0FileInfo& files) {
        const bool good = RunPoint(point, files, take);
        outcome.counts.withMissing = series.SeriesWithMissing();
        return orStop(good);
    };
    visit.endPart = [&](std::size_t part) { return orStop(endPart(part)); };
    Status read = series.ForEachPoint(whole, parts, *memory, active, scratch, visit);
    return read ? goesOn : Fail(std::move(read));
}

/// The save before the last point's run writes the results of the last good point before it or,
/// without one, those that the document was opened with.
void BatchRun::RestoreResults() {
    document.Results().Clear();
    if (const std::string& file = root.DefineEVS().OutputFileName; !file.empty())
        (void)ReadResultFile(document.Results(), file, SplitPath(document.GetPathName()).directory);
}

bool BatchRun::LeaveFilesOf(int point) {
    const std::optional<std::size_t> memory = MemoryForTile();
    if (!memory)
        return false;
    std::vector<int> points;
    for (int p = point - 1; p >= 0 && points.empty(); --p)
        if (states[static_cast<std::size_t>(p)] == PointState::Good)
            points.push_back(p);
    if (points.empty())
        RestoreResults();
    points.push_back(point);
    ScratchFiles scratch = MakeScratch();
    PointOutcome ended;
    Status read = series.ForPoints(points, *memory, scratch, [&](int each, CTsq0FileInfo& files) {
        ended = analysis.Run({files.Path(), files.NameSeries(), ""},
                             each == point ? PointTrace::Files : PointTrace::None);
        return ended.end == PointEnd::Broken ? Next::Stop : Next::GoOn;
    });
    if (!read)
        return Fail(std::move(read));
    return ended.end == PointEnd::Broken ? Fail(Status::SystemFault(ended.reason.Text())) : true;
}

bool BatchRun::LeaveLastFiles() {
    return lastActive < 0 || LeaveFilesOf(lastActive);
}

bool BatchRun::WriteOutput(ResultGrids& grids) {
    const bool hasGood = std::count(states.begin(), states.end(), PointState::Good) != 0;
    if (!hasGood || !HasLayout(document.Results(), layout)) {
        outcome.end = BatchEnd::NothingGood;
        if (options.print)
            options.print(FormatText(kTextGridNothingGood, outcome.counts.points));
        return false;
    }
    ResultGridSource source{Plan(), series.Header(), {}, series.StartDate(), series.StartTime()};
    if (Status read = series.ReadCoordinates(&source.coordinates); !read)
        return Fail(std::move(read));
    series.Close();
    if (Status written =
            WriteResultGrids(source, ResultItems(root, document.Results(), layout), grids);
        !written)
        return Fail(Status::SystemFault(written.Text()));
    outcome.end = BatchEnd::Written;
    return true;
}

} // namespace ryn
