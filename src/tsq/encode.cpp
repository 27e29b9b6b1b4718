#include "tsq/encode.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <vector>

#include "base/number_text.h"
#include "netcdf/nc_writer.h"
#include "tsq/layout.h"
#include "tsq/variable_names.h"

namespace ryn {

namespace {

constexpr std::size_t kBlock = 65536;
constexpr int kFile = -1; // the file where an attribute's variable is asked for

/// Plural names, which other programs take for a CF time whatever their unit library.
std::string TimeUnitName(int unit) {
    constexpr std::array kNames = {"seconds", "minutes", "hours", "days",
                                   "weeks",   "months",  "years", "milliseconds"};
    return kNames.at(static_cast<std::size_t>(unit - kUnitSecond));
}

/// The number that a float was written as: 0.1F is meant as 0.1.
double AsWritten(float value) {
    return ParseDouble(ShortestText(value)).value_or(static_cast<double>(value));
}

bool IsGeographic(int unit) {
    return UnitText(unit).starts_with("degree");
}

std::size_t LargestVariable(const TsqContent& content) {
    std::size_t bytes = static_cast<std::size_t>(content.header.axis.count) * sizeof(double);
    for (const auto& values : content.values)
        bytes = std::max(bytes, values.size() * sizeof(float));
    return bytes;
}

/// Definitions first, then values: classic netCDF has its header in front, and opening it again
/// would move everything behind it.
class Encoder {
  public:
    Encoder(const TsqContent& source, NcWriter* target)
        : content(source),
          header(source.header),
          out(*target),
          steps(static_cast<std::size_t>(source.header.axis.count)) {}

    void Run() {
        PutGlobals();
        DefineTime();
        DefinePlanes();
        DefineItems();
        out.EndDefinitions();
        WriteTimes();
        WritePlanes();
        WriteItems();
    }

  private:
    struct Plane {
        TsqPlane plane;
        std::array<int, 2> dimensions{}; // y, x
        int x = 0;
        int y = 0;
    };

    void PutGlobals() {
        out.PutText(kFile, "Conventions", "CF-1.8");
        out.PutText(kFile, "title", header.title);
        out.PutInt(kFile, layout::kFormatName, layout::kFormat);
        out.PutInt(kFile, layout::kFileType, header.fileType);
        out.PutInt(kFile, layout::kStatisticsKind, header.statisticsKind);
        out.PutText(kFile, layout::kApplication, header.applicationName);
        out.PutInt(kFile, layout::kApplicationVersion, header.applicationVersion);
        out.PutText(kFile, layout::kApplicationTitle, header.applicationTitle);
        out.PutInt(kFile, layout::kDataType, header.dataType);
        out.PutFloats(kFile, layout::kDeleteFloat, std::array{header.deleteFloat});
        out.PutDoubles(kFile, layout::kDeleteDouble, std::array{header.deleteDouble});
        if (header.projection.text.empty())
            return;
        const TsqProjection& projection = header.projection;
        out.PutText(kFile, layout::kProjection, projection.text);
        out.PutDoubles(kFile, layout::kProjectionOrigin,
                       std::array{projection.longitude, projection.latitude, projection.rotation});
    }

    void DefineTime() {
        const TsqAxis& axis = header.axis;
        names.Reserve(layout::kTime);
        timeDimension = out.DefineDimension(layout::kTime, steps);
        time = out.DefineVariable(layout::kTime, NcType::Double, std::array{timeDimension});
        if (axis.IsCalendar()) {
            out.PutText(time, "standard_name", "time");
            out.PutText(time, "units",
                        TimeUnitName(axis.unit) + " since " + axis.date + " " + axis.time);
            out.PutText(time, "calendar", "proleptic_gregorian");
        } else {
            // Short: programs that take "seconds" for a duration leave "s" a number.
            out.PutText(time, "long_name", "time from 1900-01-01 00:00:00");
            out.PutText(time, "units", UnitText(axis.unit));
        }
        out.PutText(time, "axis", "T");
        out.PutInt(time, layout::kAxis, axis.type);
        out.PutInt(time, layout::kAxisUnit, axis.unit);
        out.PutDoubles(time, layout::kStart, std::array{axis.start});
        if (axis.IsEquidistant())
            out.PutDoubles(time, layout::kStep, std::array{axis.step});
        out.PutInt(time, layout::kIndex, axis.index);
    }

    void DefinePlanes() {
        for (const TsqItem& item : header.items)
            if (item.dimensions == 2 && FindPlane(item.plane) == nullptr)
                DefinePlane(item.plane);
        const auto& coordinates = header.coordinates;
        if (planes.empty() || coordinates.longitudes.empty())
            return;
        names.Reserve("longitude");
        names.Reserve("latitude");
        longitude = out.DefineVariable("longitude", NcType::Double, planes.front().dimensions);
        PutDescription(longitude, "longitude", "degrees_east");
        latitude = out.DefineVariable("latitude", NcType::Double, planes.front().dimensions);
        PutDescription(latitude, "latitude", "degrees_north");
    }

    /// Items of the same grid share their axes.
    const Plane* FindPlane(const TsqPlane& plane) const {
        const auto found = std::ranges::find(planes, plane, &Plane::plane);
        return found != planes.end() ? &*found : nullptr;
    }

    void DefinePlane(const TsqPlane& plane) {
        const bool isGeographic = IsGeographic(plane.unit);
        Plane made;
        made.plane = plane;
        made.dimensions[0] =
            DefineAxis(header.coordinates.y, plane.sizeY, isGeographic ? "lat" : "y", &made.y);
        made.dimensions[1] =
            DefineAxis(header.coordinates.x, plane.sizeX, isGeographic ? "lon" : "x", &made.x);
        Describe(made.y, header.coordinates.y, "Y", plane.unit,
                 isGeographic ? "latitude" : "projection_y_coordinate", "degrees_north");
        Describe(made.x, header.coordinates.x, "X", plane.unit,
                 isGeographic ? "longitude" : "projection_x_coordinate", "degrees_east");
        planes.push_back(made);
    }

    int DefineAxis(const TsqGridCoordinates::Axis& given, int size, const char* usualName,
                   int* variable) {
        const std::string name = names.For(given.name.empty() ? usualName : given.name, 1);
        const int dimension = out.DefineDimension(name, static_cast<std::size_t>(size));
        *variable = out.DefineVariable(name, NcType::Double, std::array{dimension});
        return dimension;
    }

    void Describe(int variable, const TsqGridCoordinates::Axis& given, const char* axis, int unit,
                  const char* standardName, const char* geographicUnit) {
        out.PutText(variable, "axis", axis);
        const bool needsName = given.standardName.empty() && IsGeographic(unit);
        if (!given.values.empty())
            PutDescription(variable, needsName ? standardName : given.standardName, given.units);
        else if (IsGeographic(unit))
            PutDescription(variable, standardName, geographicUnit);
        else if (unit != kUnitUndefined)
            PutDescription(variable, standardName, UnitText(unit));
    }

    void PutDescription(int variable, const std::string& standardName, const std::string& units) {
        if (!standardName.empty())
            out.PutText(variable, "standard_name", standardName);
        if (!units.empty())
            out.PutText(variable, "units", units);
    }

    void DefineItems() {
        for (std::size_t i = 0; i < header.items.size(); ++i) {
            const TsqItem& item = header.items[i];
            std::vector<int> dimensions = {timeDimension};
            if (const Plane* plane = item.dimensions == 2 ? FindPlane(item.plane) : nullptr)
                dimensions.insert(dimensions.end(), plane->dimensions.begin(),
                                  plane->dimensions.end());
            const int id =
                out.DefineVariable(names.For(item.name, i + 1), NcType::Float, dimensions);
            PutItem(id, item);
            items.push_back(id);
        }
    }

    void PutItem(int id, const TsqItem& item) {
        out.PutText(id, "long_name", item.name);
        if (const std::string unit = UnitText(item.unit); !unit.empty())
            out.PutText(id, "units", unit);
        out.PutInt(id, layout::kItemType, item.type);
        // Other codes last as long as the process; there the text is the unit.
        if (IsTableUnit(item.unit) || UnitText(item.unit).empty())
            out.PutInt(id, layout::kItemUnit, item.unit);
        out.PutInt(id, layout::kValueType, item.valueType);
        out.PutFloats(id, layout::kReference, item.reference);
        out.PutFloats(id, layout::kOrientation, item.orientation);
        if (IsTableUnit(item.plane.unit))
            out.PutInt(id, layout::kAxesUnit, item.plane.unit);
        if (item.dimensions != 2)
            return; // a series' delete value is data to this system, and must not be hidden
        out.PutFloats(id, "_FillValue", std::array{header.deleteFloat});
        if (!header.coordinates.longitudes.empty())
            out.PutText(id, "coordinates", "longitude latitude");
    }

    /// Times as others read them: from the date of the axis on.
    double StoredTime(std::size_t step, double millisecondsInUnit) const {
        const TsqAxis& axis = header.axis;
        const double fromStart =
            axis.IsEquidistant() ? static_cast<double>(step) * axis.step : content.times[step];
        return RoundedToMillisecond(axis.start + fromStart, millisecondsInUnit);
    }

    void WriteTimes() {
        const double milliseconds = MillisecondsInUnit(header.axis.unit);
        // Equidistant times exist nowhere, and are not all made at once.
        std::vector<double> block(std::min(steps, kBlock));
        for (std::size_t first = 0; first < steps && out.Good(); first += kBlock) {
            const std::size_t size = std::min(kBlock, steps - first);
            for (std::size_t i = 0; i < size; ++i)
                block[i] = StoredTime(first + i, milliseconds);
            out.Write(time, std::array{first}, std::array{size}, block.data());
        }
    }

    void WriteAxis(int variable, const TsqGridCoordinates::Axis& given, int size, float origin,
                   float step) {
        std::vector<double> values = given.values;
        for (int i = 0; given.values.empty() && i < size; ++i)
            values.push_back(AsWritten(origin) + i * AsWritten(step));
        out.Write(variable, std::array{std::size_t{0}}, std::array{values.size()}, values.data());
    }

    void WritePlanes() {
        for (const Plane& each : planes) {
            const TsqPlane& plane = each.plane;
            WriteAxis(each.y, header.coordinates.y, plane.sizeY, plane.originY, plane.stepY);
            WriteAxis(each.x, header.coordinates.x, plane.sizeX, plane.originX, plane.stepX);
        }
        if (planes.empty() || header.coordinates.longitudes.empty())
            return;
        const TsqPlane& plane = planes.front().plane;
        const std::array<std::size_t, 2> start{};
        const std::array size = {static_cast<std::size_t>(plane.sizeY),
                                 static_cast<std::size_t>(plane.sizeX)};
        out.Write(longitude, start, size, header.coordinates.longitudes.data());
        out.Write(latitude, start, size, header.coordinates.latitudes.data());
    }

    /// Each item as one block. Without steps there is nothing to write: an empty block of the
    /// record dimension is an error to the library.
    void WriteItems() {
        const std::array<std::size_t, 3> start{};
        for (std::size_t i = 0; i < items.size() && steps > 0; ++i) {
            const TsqPlane& plane = header.items[i].plane;
            const std::array size = {steps, static_cast<std::size_t>(plane.sizeY),
                                     static_cast<std::size_t>(plane.sizeX)};
            out.Write(items[i], start, size, content.values[i].data());
        }
    }

    const TsqContent& content;
    const TsqHeader& header;
    NcWriter& out;
    std::size_t steps;
    VariableNames names;
    int timeDimension = 0;
    int time = 0;
    int longitude = 0;
    int latitude = 0;
    std::vector<Plane> planes;
    std::vector<int> items;
};

bool HasSize(const std::vector<double>& values, std::size_t size) {
    return values.empty() || values.size() == size;
}

} // namespace

Status CheckCoordinates(const std::string& path, const TsqHeader& header) {
    const TsqGridCoordinates& given = header.coordinates;
    const auto fits = [&](const TsqItem& item) {
        return item.dimensions != 2 ||
               (HasSize(given.x.values, static_cast<std::size_t>(item.plane.sizeX)) &&
                HasSize(given.y.values, static_cast<std::size_t>(item.plane.sizeY)) &&
                HasSize(given.longitudes, item.cells) &&
                given.longitudes.size() == given.latitudes.size());
    };
    return std::ranges::all_of(header.items, fits)
               ? Status::Ok()
               : Status::InputFault(path + ": the coordinates do not have the size of the grid");
}

Status EncodeNetcdf(const TsqContent& content, const std::string& path,
                    const std::string& shownPath) {
    NcWriter writer(path, shownPath, FormatForVariable(LargestVariable(content)));
    Encoder(content, &writer).Run();
    return writer.Finish();
}

} // namespace ryn
