#include "run/result_grids.h"

#include <algorithm>
#include <cstddef>

#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn {

namespace {

constexpr int kFileType = 1;
constexpr const char* kApplicationName = "RYNEdit";
constexpr int kStatisticsKind = 1;

void AddResultItem(const ResultGridSource& source, int* status, int number, TsqHeader* header,
                   const std::string& name, int sourceItem) {
    const CGridEditHeaderInfo& grid = source.header;
    const GridPlan& plan = source.plan;
    TsqItem* const item = tsqItemD(header, number);
    int type = kItemTypeUndefined;
    int unit = kUnitUndefined;
    if (sourceItem >= 1) {
        type = grid.DynamicItem(sourceItem).GetItemTag();
        unit = grid.DynamicItem(sourceItem).GetUnitTag();
    }
    const float x0 = grid.X0() + static_cast<float>(plan.x.first) * grid.DX();
    const float y0 = grid.Y0() + static_cast<float>(plan.y.first) * grid.DY();
    *status |= tsqSetItemInfo(header, item, type, name, unit, kTsqDataTypeFloat);
    *status |= tsqSetItemValueType(item, 0);
    *status |= tsqSetItemAxisEqD2(item, grid.QtyUnit(), plan.CellsX(), plan.CellsY(), x0, y0,
                                  grid.DX(), grid.DY());
    *status |= tsqSetItemRefCoords(item, x0, y0, grid.Z0());
}

TsqGridCoordinates::Axis PartOf(const GridCoordinates::Axis& axis, const IndexRange& range) {
    TsqGridCoordinates::Axis part{axis.name, axis.units, axis.standardName, {}};
    if (static_cast<std::size_t>(range.last) < axis.values.size())
        part.values.assign(axis.values.begin() + range.first, axis.values.begin() + range.last + 1);
    return part;
}

std::vector<double> PartOf(const std::vector<double>& cells, const ResultGridSource& source) {
    const auto sizeX = static_cast<std::size_t>(source.header.SizeX());
    const auto sizeY = static_cast<std::size_t>(source.header.SizeY());
    if (cells.size() != sizeX * sizeY)
        return {};
    std::vector<double> part;
    for (int y = source.plan.y.first; y <= source.plan.y.last; ++y) {
        const auto row = cells.begin() + static_cast<std::ptrdiff_t>(sizeX) * y;
        part.insert(part.end(), row + source.plan.x.first, row + source.plan.x.last + 1);
    }
    return part;
}

/// The real coordinates, which a grid that runs by index has nowhere else, and which an origin and
/// a spacing of 32 bits would round.
TsqGridCoordinates CoordinatesOf(const ResultGridSource& source) {
    TsqGridCoordinates part;
    part.x = PartOf(source.coordinates.x, source.plan.x);
    part.y = PartOf(source.coordinates.y, source.plan.y);
    part.longitudes = PartOf(source.coordinates.longitudes, source);
    part.latitudes = PartOf(source.coordinates.latitudes, source);
    return part;
}

int MakeHeader(const ResultGridSource& source, const std::vector<ResultItem>& items,
               float deleteValue, TsqHeaderHandle* header) {
    const CGridEditHeaderInfo& grid = source.header;
    int status = tsqHeaderCreate(kFileType, source.plan.title, kApplicationName, 1,
                                 static_cast<int>(items.size()), kStatisticsKind, header);
    status |= tsqSetDeleteValFloat(header->get(), deleteValue);
    // Equidistant whatever the grid's own axis is: there is one step.
    status |= tsqSetEqCalendarAxis(header->get(), source.startDate, source.startTime, kUnitSecond,
                                   0.0, grid.TimeStep(), 0);
    status |= tsqSetDataType(header->get(), grid.DataType());
    status |= tsqSetGeoInfoUTMProj(header->get(), grid.MapProjection(), grid.Longitude(),
                                   grid.Latitude(), grid.Rotation());
    status |= tsqSetGridCoordinates(header->get(), CoordinatesOf(source));
    int number = 0;
    for (const ResultItem& item : items)
        AddResultItem(source, &status, ++number, header->get(), item.name,
                      item.isQuantity ? source.plan.item : 0);
    return status;
}

void WriteGrids(const ResultGridSource& source, TsqHeader* header, TsqFile* file,
                ResultGrids& results) {
    constexpr double kSecondsPerDay = 86400.0;
    const double time = static_cast<double>(source.header.GetStartTime()) * kSecondsPerDay;
    for (CQxArray2D<float>& grid : results.Grids()) {
        if (tsqWriteItemTimeStep(header, file, time, grid.Data()) != 0)
            return; // the close reports it
        grid = CQxArray2D<float>();
    }
}

} // namespace

ResultGrids::ResultGrids(const ResultLayout& counts, int cellsX, int cellsY, float deleteValue)
    : layout(counts),
      missing(deleteValue),
      grids(static_cast<std::size_t>(counts.Items()),
            CQxArray2D<float>(cellsX, cellsY, deleteValue)) {}

double ResultGrids::BytesFor(const ResultLayout& counts, const GridPlan& plan) {
    return static_cast<double>(counts.Items()) * plan.CellsX() * plan.CellsY() * sizeof(float);
}

void ResultGrids::CopyPointResults(const COutputSettings& results, int i, int j) {
    CopyRow(PointResults(results, layout, missing), i, j);
}

void ResultGrids::CopyRow(const std::vector<float>& row, int i, int j) {
    for (std::size_t n = 0; n < std::min(row.size(), grids.size()); ++n)
        grids[n](i, j) = row[n];
}

Status WriteResultGrids(const ResultGridSource& source, const std::vector<ResultItem>& items,
                        ResultGrids& results) {
    (void)tsqTakeError();
    TsqHeaderHandle header;
    TsqFileHandle file;
    if (MakeHeader(source, items, results.DeleteValue(), &header) == 0 &&
        tsqFileCreate(source.plan.outputFile, header.get(), &file) == 0)
        WriteGrids(source, header.get(), file.get(), results);
    tsqFileClose(header.get(), &file);
    tsqHeaderDestroy(&header);
    return tsqTakeError();
}

} // namespace ryn
