#include "run/tsq0_file_info.h"

#include <bit>
#include <cstdint>
#include <utility>

#include "base/path_parts.h"
#include "units/units.h"

namespace ryn {

namespace {

constexpr const char* kApplicationName = "RynEdit";
constexpr int kEquidistantFile = 1;
constexpr int kNonEquidistantFile = 4;
constexpr int kStatisticsKind = 2;
/// -1e-30, whatever the grid's own is: the series takes the grid's as a value like any other.
constexpr float kDeleteValue = std::bit_cast<float>(std::uint32_t{0x8DA24260});

} // namespace

CTsq0FileInfo::CTsq0FileInfo(CTsq0FileInfo&& other) noexcept
    : scratch(other.scratch),
      file(std::move(other.file)),
      header(std::move(other.header)),
      path(std::exchange(other.path, {})),
      seriesPath(std::exchange(other.seriesPath, {})),
      active(std::exchange(other.active, false)),
      position(other.position) {}

CTsq0FileInfo::~CTsq0FileInfo() {
    // What is still being written must not take its name any more.
    file.reset();
    if (!active || path.empty())
        return;
    scratch->Remove(path);
    if (!seriesPath.empty())
        scratch->Remove(seriesPath);
}

bool CTsq0FileInfo::Create(const CGridEditHeaderInfo& grid, int point, int itemNumber,
                           const std::string& startDate, const std::string& startTime,
                           bool isActive) {
    active = isActive;
    if (!active)
        return true;
    path = scratch->NewName(point) + ".tsq0";
    const bool isEquidistant = grid.EqualTimeSteps();
    bool good = tsqHeaderCreate(isEquidistant ? kEquidistantFile : kNonEquidistantFile, path,
                                kApplicationName, 1, 1, kStatisticsKind, &header) == 0;
    good &= (isEquidistant ? tsqSetEqCalendarAxis(header.get(), startDate, startTime, kUnitSecond,
                                                  0.0, grid.TimeStep(), 0)
                           : tsqSetNeqCalendarAxis(header.get(), startDate, startTime, kUnitSecond,
                                                   0.0, 0)) == 0;
    TsqItem* const item = tsqItemD(header.get(), 1);
    const CGridEditItemInfo source = grid.DynamicItem(itemNumber);
    good &= tsqSetItemInfo(header.get(), item, source.GetItemTag(), source.GetName(),
                           source.GetUnitTag(), kTsqDataTypeFloat) == 0;
    good &= tsqSetItemValueType(item, 0) == 0;
    good &= tsqSetItemAxisEqD0(item, grid.QtyUnit()) == 0;
    good &= tsqSetDeleteValFloat(header.get(), kDeleteValue) == 0;
    good &= tsqSetDurability(header.get(), Durability::Unflushed) == 0;
    return (tsqFileCreate(path, header.get(), &file) == 0) && good;
}

bool CTsq0FileInfo::WriteValue(double seconds, float value) {
    return !active || tsqWriteItemTimeStep(header.get(), file.get(), seconds, &value) == 0;
}

bool CTsq0FileInfo::WriteValues(const double* seconds, const float* values, std::size_t count) {
    return !active || tsqWriteItemBlock(header.get(), file.get(), seconds, values, count) == 0;
}

bool CTsq0FileInfo::Close() {
    if (!active)
        return true;
    const bool good = tsqFileClose(header.get(), &file) == 0;
    tsqHeaderDestroy(&header);
    return good;
}

const std::string& CTsq0FileInfo::NameSeries() {
    const PathParts parts = SplitPath(path);
    seriesPath = parts.directory + parts.name + "Extract" + parts.extension;
    return seriesPath;
}

} // namespace ryn
