#include "run/point_series.h"

#include <algorithm>
#include <climits>
#include <new>
#include <span>

#include "series/sts_item.h"
#include "strings/catalogue.h"
#include "tsq/tsq.h"

namespace ryn {

namespace {

/// The cells that a tile and a part of the grid have in common.
GridTile Common(const GridTile& tile, const GridTile& part) {
    GridTile common = tile;
    common.firstX = std::max(tile.firstX, part.firstX);
    common.firstY = std::max(tile.firstY, part.firstY);
    common.countX =
        std::max(0, std::min(tile.firstX + tile.countX, part.firstX + part.countX) - common.firstX);
    common.countY =
        std::max(0, std::min(tile.firstY + tile.countY, part.firstY + part.countY) - common.firstY);
    return common;
}

/// The points of a tile that lie in a part of the grid, in point order, with the offset of their
/// history in the tile.
template <typename Use>
Next ForEachPlace(const GridPlan& plan, const GridTile& tile, const GridTile& part, Use use) {
    const auto firstFrom = [](const IndexRange& range, int place) {
        return range.first + (place - range.first + range.step - 1) / range.step * range.step;
    };
    const GridTile in = Common(tile, part);
    for (int x = firstFrom(plan.x, in.firstX); x < in.firstX + in.countX; x += plan.x.step)
        for (int y = firstFrom(plan.y, in.firstY); y < in.firstY + in.countY; y += plan.y.step) {
            const int point = (x - plan.x.first) / plan.x.step * plan.PointsY() +
                              (y - plan.y.first) / plan.y.step;
            const std::size_t place =
                static_cast<std::size_t>(x - tile.firstX) * static_cast<std::size_t>(tile.countY) +
                static_cast<std::size_t>(y - tile.firstY);
            if (use(point, place * static_cast<std::size_t>(tile.countSteps)) == Next::Stop)
                return Next::Stop;
        }
    return Next::GoOn;
}

Status StoreError(const CTsq0FileInfo& series) {
    const Status reason = tsqTakeError();
    return reason ? Status::SystemFault(FormatText(kTextGridSeriesNotMade, series.Path())) : reason;
}

Status NotEnoughMemory() {
    return Status::SystemFault(std::string(Text(kTextGridOutOfMemory)));
}

} // namespace

Status PointSeries::Open(const GridPlan& wanted) {
    if (engine.OpenFile(wanted.gridFile, true) != kGridOk)
        return engine.LastError();
    header = engine.QueryHeaderInfo();
    plan = wanted;
    if (Status fault = TestPlan(plan, header); !fault)
        return Status::InputFault(plan.gridFile + ": " + fault.Text());
    const CQxDateTime origin = header.TimeOfStep(plan.firstStep);
    startDate = origin.Format("%Y-%m-%d");
    startTime = origin.Format("%H:%M:%S");
    constexpr double kSecondsPerDay = 86400.0;
    for (int t = plan.firstStep; t <= plan.lastStep; ++t)
        seconds.push_back((static_cast<double>(header.TimeOfStep(t)) - origin) * kSecondsPerDay);
    return Status::Ok();
}

Status PointSeries::ReadCoordinates(GridCoordinates* coordinates) {
    return engine.ReadCoordinates(coordinates) == kGridOk ? Status::Ok() : engine.LastError();
}

Status PointSeries::Divide(int pieces, std::vector<GridTile>* tiles) {
    return engine.DividePlane(plan.Whole(), pieces, tiles) == kGridOk ? Status::Ok()
                                                                      : engine.LastError();
}

std::vector<int> PointSeries::PointsOf(const GridTile& part) const {
    std::vector<int> points;
    ForEachPlace(plan, part, part, [&points](int point, std::size_t /*offset*/) {
        points.push_back(point);
        return Next::GoOn;
    });
    return points;
}

std::size_t PointSeries::BytesOfPoint() const {
    // Its series in the store, with times where steps differ, and its samples.
    return static_cast<std::size_t>(plan.Steps()) *
           (sizeof(float) + sizeof(double) + sizeof(STSItem));
}

Status PointSeries::ReadActivity(std::size_t memory, std::vector<bool>* active) try {
    active->assign(static_cast<std::size_t>(plan.Points()), false);
    GridTile firstStep = plan.Whole();
    firstStep.countSteps = 1;
    std::vector<GridTile> tiles;
    if (engine.PlanTiles(firstStep, memory, &tiles) != kGridOk)
        return engine.LastError();
    std::vector<float> values;
    for (const GridTile& tile : tiles) {
        values.resize(tile.Values());
        if (engine.ReadTile(tile, memory, values) != kGridOk)
            return engine.LastError();
        ForEachPlace(plan, tile, tile, [&](int point, std::size_t offset) {
            (*active)[static_cast<std::size_t>(point)] = values[offset] != header.DeleteValue();
            return Next::GoOn;
        });
    }
    return Status::Ok();
} catch (const std::bad_alloc&) {
    return NotEnoughMemory();
}

Status PointSeries::MakeOne(CTsq0FileInfo& series, int point, const float* values) {
    const auto steps = static_cast<std::size_t>(plan.Steps());
    const bool good = series.Create(header, point, plan.item, startDate, startTime, true) &&
                      series.WriteValues(seconds.data(), values, steps) && series.Close();
    return good ? Status::Ok() : StoreError(series);
}

Status PointSeries::VisitPoint(int point, const float* values, ScratchFiles& scratch,
                               const Visit& visit, Next* next) {
    CTsq0FileInfo files(scratch);
    const GridPoint place = plan.PointAt(point);
    files.SetPosition(place.x, place.y);
    history = values;
    const std::span<const float> whole(history, static_cast<std::size_t>(plan.Steps()));
    withMissing += std::ranges::find(whole, header.DeleteValue()) != whole.end() ? 1 : 0;
    Status made = MakeOne(files, point, history);
    *next = made ? visit.use(point, files) : Next::Stop;
    return made;
}

Status PointSeries::ForEachPoint(const GridTile& whole, const std::vector<GridTile>& parts,
                                 std::size_t memory, const std::vector<bool>& active,
                                 ScratchFiles& scratch, const Visit& visit) try {
    std::vector<GridTile> tiles;
    if (engine.PlanTiles(whole, memory, &tiles) != kGridOk)
        return engine.LastError();
    std::vector<std::size_t> left; // cells of each part that are not done
    left.reserve(parts.size());
    for (const GridTile& part : parts)
        left.push_back(part.Points());
    for (const GridTile& tile : tiles) {
        const std::span<float> tileValues = buffer.Take(tile.Values());
        if (engine.ReadTile(tile, memory, tileValues) != kGridOk)
            return engine.LastError();
        for (std::size_t i = 0; i < parts.size(); ++i) {
            Status made;
            Next next = ForEachPlace(plan, tile, parts[i], [&](int point, std::size_t offset) {
                if (!active[static_cast<std::size_t>(point)])
                    return Next::GoOn;
                Next afterwards = Next::GoOn;
                made = VisitPoint(point, tileValues.data() + offset, scratch, visit, &afterwards);
                return afterwards;
            });
            const std::size_t cells = Common(tile, parts[i]).Points();
            left[i] -= cells;
            if (next == Next::GoOn && cells > 0 && left[i] == 0 && visit.endPart)
                next = visit.endPart(i);
            if (next == Next::Stop)
                return made;
        }
    }
    return Status::Ok();
} catch (const std::bad_alloc&) {
    return NotEnoughMemory();
}

void PointSeries::KeepHistory(int point) {
    kept[point].assign(history, history + plan.Steps());
}

Status PointSeries::ReadHistories(const std::vector<int>& points, std::size_t memory) {
    GridTile tile = plan.Whole();
    int lastX = -1;
    int lastY = -1;
    tile.firstX = tile.firstY = INT_MAX;
    for (const int point : points) {
        const GridPoint place = plan.PointAt(point);
        tile.firstX = std::min(tile.firstX, place.x);
        tile.firstY = std::min(tile.firstY, place.y);
        lastX = std::max(lastX, place.x);
        lastY = std::max(lastY, place.y);
    }
    tile.countX = lastX - tile.firstX + 1;
    tile.countY = lastY - tile.firstY + 1;
    constexpr std::size_t kClose = 16;
    if (points.size() > 1 && tile.Points() > kClose * points.size()) {
        for (const int point : points)
            if (Status read = ReadHistories({point}, memory); !read)
                return read;
        return Status::Ok();
    }
    std::vector<GridTile> tiles;
    std::vector<float> values;
    if (engine.PlanTiles(tile, memory, &tiles) != kGridOk)
        return engine.LastError();
    for (const GridTile& part : tiles) {
        values.resize(part.Values());
        if (engine.ReadTile(part, memory, values) != kGridOk)
            return engine.LastError();
        ForEachPlace(plan, part, part, [&](int point, std::size_t offset) {
            history = values.data() + offset;
            if (std::ranges::find(points, point) != points.end())
                KeepHistory(point);
            return Next::GoOn;
        });
    }
    return Status::Ok();
}

Status
PointSeries::ForPoints(const std::vector<int>& points, std::size_t memory, ScratchFiles& scratch,
                       const std::function<Next(int point, CTsq0FileInfo& series)>& use) try {
    std::vector<int> missing = points;
    std::erase_if(missing, [this](int point) { return kept.contains(point); });
    if (!missing.empty())
        if (Status read = ReadHistories(missing, memory); !read)
            return read;
    for (const int point : points) {
        CTsq0FileInfo series(scratch);
        const GridPoint place = plan.PointAt(point);
        series.SetPosition(place.x, place.y);
        if (Status made = MakeOne(series, point, kept[point].data()); !made)
            return made;
        if (use(point, series) == Next::Stop)
            break;
    }
    return Status::Ok();
} catch (const std::bad_alloc&) {
    return NotEnoughMemory();
}

Status PointSeries::BeginAll(std::vector<CTsq0FileInfo>& points, int first, int end,
                             const CQxArray2D<float>& plane) {
    for (int p = first; p < end; ++p) {
        CTsq0FileInfo& point = points[static_cast<std::size_t>(p)];
        const float value = plane(point.Position().x, point.Position().y);
        // A NaN is not equal, so that such a point takes part.
        if (!point.Create(header, p, plan.item, startDate, startTime,
                          value != header.DeleteValue()))
            return StoreError(point);
    }
    return Status::Ok();
}

Status PointSeries::EndAll(std::vector<CTsq0FileInfo>& points, int first, int end) {
    for (int p = first; p < end; ++p)
        if (CTsq0FileInfo& point = points[static_cast<std::size_t>(p)]; !point.Close())
            return StoreError(point);
    return Status::Ok();
}

Status PointSeries::MakeSeries(std::vector<CTsq0FileInfo>& points, int first, int end,
                               const std::function<bool()>& isStopped) try {
    CGridEditSlice slice;
    slice.Initilize(header, 0);
    slice.SetDynamic(true);
    slice.SetItem(plan.item);
    slice.SetLayer(0);
    std::vector<bool> hasMissing(static_cast<std::size_t>(end - first), false);
    for (int t = plan.firstStep; t <= plan.lastStep && !isStopped(); ++t) {
        slice.SetTimeStep(t);
        if (engine.GetSlice(slice) != kGridOk)
            return engine.LastError();
        const CQxArray2D<float> plane = slice.GetArray();
        (void)engine.ReturnSlice(slice, false);
        if (t == plan.firstStep)
            if (Status begun = BeginAll(points, first, end, plane); !begun)
                return begun;
        const double time = seconds[static_cast<std::size_t>(t - plan.firstStep)];
        for (int p = first; p < end; ++p) {
            CTsq0FileInfo& point = points[static_cast<std::size_t>(p)];
            const float value = plane(point.Position().x, point.Position().y);
            if (point.IsActive() && value == header.DeleteValue())
                hasMissing[static_cast<std::size_t>(p - first)] = true;
            if (!point.WriteValue(time, value))
                return StoreError(point);
        }
    }
    withMissing += static_cast<int>(std::ranges::count(hasMissing, true));
    return isStopped() ? Status::Ok() : EndAll(points, first, end);
} catch (const std::bad_alloc&) {
    return NotEnoughMemory();
}

} // namespace ryn
