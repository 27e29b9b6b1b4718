#include "tsq/open_netcdf.h"

#include <algorithm>
#include <array>
#include <climits>
#include <cmath>
#include <limits>
#include <optional>
#include <set>
#include <sstream>
#include <utility>

#include "base/ole_date_time.h"
#include "netcdf/nc_values.h"
#include "tsq/layout.h"
#include "tsq/netcdf_source.h"

namespace ryn {

namespace {

constexpr double kUnixEpochDay = 25569.0; // 1 January 1970 in days since 30 December 1899
constexpr std::int64_t kSecond = 1000;
constexpr float kNoDeleteValue = 9.9692099683868690e+36F; // netCDF's own fill of floats

std::optional<int> IntOf(const NcFile& file, int variable, const char* name) {
    const auto number = file.Number(variable, name);
    const bool isInt =
        number && *number >= INT_MIN && *number <= INT_MAX && *number == std::floor(*number);
    return isInt ? std::optional(static_cast<int>(*number)) : std::nullopt;
}

std::array<float, 3> ThreeFloats(const NcFile& file, int variable, const char* name) {
    std::array<float, 3> result{};
    const auto numbers = file.Numbers(variable, name);
    if (numbers && numbers->size() == 3)
        std::ranges::transform(*numbers, result.begin(),
                               [](double value) { return static_cast<float>(value); });
    return result;
}

/// A moment as the axis's date and time, whole seconds.
void SetMoment(TsqAxis* axis, std::int64_t seconds) {
    const double days = static_cast<double>(seconds) / 86400.0 + kUnixEpochDay;
    // The sign rule of the stored count: a negative one keeps its time of day positive.
    const double whole = std::floor(days);
    const COleDateTime moment(days >= 0.0 ? days : whole - (days - whole));
    axis->date = moment.Format("%Y-%m-%d");
    axis->time = moment.Format("%H:%M:%S");
}

std::int64_t FloorSeconds(std::int64_t milliseconds) {
    return milliseconds / kSecond - (milliseconds % kSecond < 0 ? 1 : 0);
}

/// One pass over a file's description. Ours and other programs' files go the same way; our
/// attributes refine what the CF ones say, and give way where they no longer fit.
class Opener {
  public:
    explicit Opener(TsqHeader* target) : header(*target) {}

    Status Open(const std::string& path, TimeOrder order, std::unique_ptr<StepSource>* source) {
        auto opened = std::make_shared<NcFile>();
        if (Status status = NcFile::Open(path, opened.get()); !status)
            return status;
        file = std::move(opened);
        time = FindTimeVariable(*file);
        if (time == nullptr)
            return file->InputFault("has no time axis");
        timeDimension = TimeDimensionOf(*file, *time);
        ReadGlobals();
        if (Status status = ReadAxis(order); !status)
            return status;
        ReadItems();
        if (header.items.empty())
            return file->InputFault("has no item along its time axis");
        SetForeignDeleteValue();
        *source = std::make_unique<NetcdfSource>(file, static_cast<std::size_t>(header.axis.count),
                                                 std::move(timeColumn), std::move(columns));
        return Status::Ok();
    }

  private:
    int GlobalInt(const char* name) const { return IntOf(*file, kNcGlobal, name).value_or(0); }
    std::string GlobalText(const char* name) const {
        return file->Text(kNcGlobal, name).value_or("");
    }

    void ReadGlobals() {
        isMarked = GlobalInt(layout::kFormatName) == layout::kFormat;
        header.title = GlobalText("title");
        if (!isMarked)
            return;
        header.fileType = GlobalInt(layout::kFileType);
        header.statisticsKind = GlobalInt(layout::kStatisticsKind);
        header.applicationName = GlobalText(layout::kApplication);
        header.applicationVersion = GlobalInt(layout::kApplicationVersion);
        header.applicationTitle = GlobalText(layout::kApplicationTitle);
        header.dataType = GlobalInt(layout::kDataType);
        header.deleteFloat =
            static_cast<float>(file->Number(kNcGlobal, layout::kDeleteFloat).value_or(0.0));
        header.deleteDouble = file->Number(kNcGlobal, layout::kDeleteDouble).value_or(0.0);
        header.projection.text = GlobalText(layout::kProjection);
        const auto origin = file->Numbers(kNcGlobal, layout::kProjectionOrigin);
        if (origin && origin->size() == 3) {
            header.projection.longitude = (*origin)[0];
            header.projection.latitude = (*origin)[1];
            header.projection.rotation = (*origin)[2];
        }
    }

    /// Along the time dimension, whatever the time variable's other dimensions of length 1.
    std::size_t Steps() const {
        return file->Dimensions()[static_cast<std::size_t>(timeDimension)].length;
    }

    Status ReadAxis(TimeOrder order) {
        if (Steps() > static_cast<std::size_t>(INT_MAX))
            return file->InputFault(*time, "has more than 2147483647 time steps");
        header.axis.count = static_cast<int>(Steps());
        CfTime parsed;
        if (Status status = ReadCfTime(*file, *time, &parsed); !status)
            return status;
        if (isMarked && ReadOwnAxis(parsed))
            return ReadOwnSpan();
        return ReadForeignAxis(order);
    }

    /// False when the time variable is not as this system writes it: another program may have
    /// written the file anew with its own times and kept our attributes.
    bool ReadOwnAxis(const CfTime& parsed) {
        TsqAxis axis = header.axis;
        axis.type = IntOf(*file, time->id, layout::kAxis).value_or(0);
        axis.unit = IntOf(*file, time->id, layout::kAxisUnit).value_or(kUnitUndefined);
        axis.index = IntOf(*file, time->id, layout::kIndex).value_or(0);
        const auto start = file->Number(time->id, layout::kStart);
        if (axis.type < kTsqEqTimeAxis || axis.type > kTsqNeqCalendarAxis || !start ||
            !std::isfinite(*start) || !IsOurTime(axis, parsed))
            return false;
        axis.start = *start;
        axis.step = file->Number(time->id, layout::kStep).value_or(0.0);
        if (axis.IsEquidistant() && !(axis.step > 0.0 && std::isfinite(axis.step)))
            return false;
        if (axis.IsCalendar())
            SetMoment(&axis, FloorSeconds(parsed.ReferenceMilliseconds()));
        header.axis = axis;
        return true;
    }

    /// Only such times can be read block by block as they stand.
    bool IsOurTime(const TsqAxis& axis, const CfTime& parsed) const {
        const bool isPlain = time->type == NcType::Double && time->dimensions.size() == 1 &&
                             !file->Number(time->id, "scale_factor") &&
                             !file->Number(time->id, "add_offset");
        if (!isPlain || UnitOfText(parsed.UnitName()) != axis.unit ||
            MillisecondsInUnit(axis.unit) == 0.0 || axis.IsCalendar() == parsed.IsRelative())
            return false;
        return parsed.IsRelative() || (parsed.Calendar() == CfCalendar::ProlepticGregorian &&
                                       parsed.ReferenceMilliseconds() % kSecond == 0 &&
                                       parsed.Milliseconds(0.0).has_value());
    }

    Status StoredTime(std::size_t step, double* value) const {
        if (Status status = file->Read(*time, std::array{step}, std::array{std::size_t{1}}, value);
            !status)
            return status;
        return std::isfinite(*value) ? Status::Ok() : file->InputFault(*time, "is not finite");
    }

    /// The last step's time. An equidistant axis of which steps were cut out by another program is
    /// no longer one.
    Status ReadOwnSpan() {
        TsqAxis& axis = header.axis;
        const double milliseconds = MillisecondsInUnit(axis.unit);
        timeColumn = {time, axis.start, milliseconds, {}};
        if (Steps() == 0)
            return Status::Ok();
        double first = 0.0;
        double last = 0.0;
        if (Status status = StoredTime(0, &first); !status)
            return status;
        if (Status status = StoredTime(Steps() - 1, &last); !status)
            return status;
        const double ruled = static_cast<double>(Steps() - 1) * axis.step;
        // A step of a third of a second was rounded to the millisecond when it was stored.
        const auto agree = [&](double stored, double fromStart) {
            const double apart = std::abs(stored - (axis.start + fromStart)) * milliseconds;
            return apart <= 1.0 + 1e-12 * std::abs(stored) * milliseconds;
        };
        if (axis.IsEquidistant() && !(agree(first, 0.0) && agree(last, ruled))) {
            axis.type = axis.IsCalendar() ? kTsqNeqCalendarAxis : kTsqNeqTimeAxis;
            axis.step = 0.0;
        }
        axis.span =
            axis.IsEquidistant() ? ruled : RoundedToMillisecond(last - axis.start, milliseconds);
        return Status::Ok();
    }

    /// Seconds from the first step, whose second is the axis's date.
    Status ReadForeignAxis(TimeOrder order) {
        CfTimeAxis read;
        if (Status status = ReadCfTimeAxis(*file, *time, order, &read); !status)
            return status;
        TsqAxis& axis = header.axis;
        std::int64_t base = 0;
        axis.type = kTsqNeqTimeAxis;
        if (!read.time.IsRelative()) {
            base = FloorSeconds(read.milliseconds.empty() ? read.time.ReferenceMilliseconds()
                                                          : read.milliseconds.front());
            axis.type = kTsqNeqCalendarAxis;
            SetMoment(&axis, base);
        }
        timeColumn.seconds.reserve(read.milliseconds.size());
        for (const std::int64_t step : read.milliseconds)
            timeColumn.seconds.push_back(static_cast<double>(step - base * kSecond) / 1000.0);
        axis.span = timeColumn.seconds.empty() ? 0.0 : timeColumn.seconds.back();
        return Status::Ok();
    }

    /// Variables that describe others: bounds of the time steps, places of a moving instrument.
    std::set<std::string> DescribingVariables() const {
        std::set<std::string> names = {time->name};
        for (const NcVariable& variable : file->Variables())
            for (const char* const attribute : {"bounds", "climatology", "coordinates"}) {
                std::istringstream list(file->Text(variable.id, attribute).value_or(""));
                for (std::string name; list >> name;)
                    names.insert(name);
            }
        // A coordinate variable is named as its dimension.
        for (const NcDimension& dimension : file->Dimensions())
            names.insert(dimension.name);
        return names;
    }

    void ReadItems() {
        const std::set<std::string> describing = DescribingVariables();
        for (const NcVariable& variable : file->Variables()) {
            const auto along = std::ranges::find(variable.dimensions, timeDimension);
            if (!IsNumeric(variable.type) || along == variable.dimensions.end() ||
                describing.contains(variable.name))
                continue;
            ItemColumn column;
            column.variable = &variable;
            column.timePlace =
                static_cast<std::size_t>(std::distance(variable.dimensions.begin(), along));
            header.items.push_back(ReadItem(&column));
            columns.push_back(column);
        }
    }

    TsqItem ReadItem(ItemColumn* column) const {
        const NcVariable& variable = *column->variable;
        TsqItem item;
        item.name = file->Text(variable.id, "long_name").value_or(isMarked ? "" : variable.name);
        // The text decides: a code outside the table belonged to another process.
        const auto units = file->Text(variable.id, "units");
        item.unit = units ? UnitOfText(*units)
                          : IntOf(*file, variable.id, layout::kItemUnit).value_or(kUnitUndefined);
        item.type =
            IntOf(*file, variable.id, layout::kItemType).value_or(ItemTypeOfUnit(item.unit));
        item.valueType = IntOf(*file, variable.id, layout::kValueType).value_or(0);
        item.reference = ThreeFloats(*file, variable.id, layout::kReference);
        item.orientation = ThreeFloats(*file, variable.id, layout::kOrientation);
        MeasureStep(&item, column);
        column->isOurs = isMarked && HoldsOurValues(variable, item);
        return item;
    }

    /// Length of a step, and whether its numbers lie together.
    void MeasureStep(TsqItem* item, ItemColumn* column) const {
        for (std::size_t i = 0; i < column->variable->dimensions.size(); ++i) {
            const std::size_t length = file->DimensionOf(*column->variable, i).length;
            if (i == column->timePlace || length == 1)
                continue;
            ++item->dimensions;
            column->isStepwise = column->isStepwise && i > column->timePlace;
            // A forged count: the reader refuses so many values when they are asked for.
            if (__builtin_mul_overflow(item->cells, length, &item->cells))
                item->cells = std::numeric_limits<std::size_t>::max();
        }
        column->cells = item->cells;
    }

    /// Plain floats. The fill value of our grids is their delete value; one that another program
    /// added to a series marks what that program left out.
    bool HoldsOurValues(const NcVariable& variable, const TsqItem& item) const {
        if (NcValues(file.get(), &variable).IsPlain())
            return true;
        const auto fill = file->Number(variable.id, "_FillValue");
        return item.dimensions > 0 && variable.type == NcType::Float &&
               !file->Number(variable.id, "scale_factor") &&
               !file->Number(variable.id, "missing_value") && fill &&
               static_cast<float>(*fill) == header.deleteFloat;
    }

    void SetForeignDeleteValue() {
        if (isMarked)
            return;
        // One value for the whole file, while each item may have several marks of its own.
        const NcValues values(file.get(), columns.front().variable);
        const auto marks = values.MissingMarks();
        const auto isFloat = [](double mark) {
            return std::abs(mark) <= static_cast<double>(std::numeric_limits<float>::max());
        };
        const auto mark = std::ranges::find_if(marks, isFloat);
        header.deleteFloat = mark != marks.end() ? static_cast<float>(*mark) : kNoDeleteValue;
        header.deleteDouble = static_cast<double>(header.deleteFloat);
    }

    TsqHeader& header;
    std::shared_ptr<const NcFile> file;
    const NcVariable* time = nullptr;
    int timeDimension = 0;
    bool isMarked = false;
    TimeColumn timeColumn;
    std::vector<ItemColumn> columns;
};

} // namespace

Status OpenNetcdf(const std::string& path, TimeOrder order, TsqHeader* header,
                  std::unique_ptr<StepSource>* source) {
    return Opener(header).Open(path, order, source);
}

} // namespace ryn
