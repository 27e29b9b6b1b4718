#include "grid/spatial_axis.h"

#include <algorithm>
#include <array>
#include <climits>
#include <cmath>
#include <cstdint>
#include <limits>
#include <utility>

namespace ryn {

namespace {

/// From one value to the next below zero throughout.
bool IsDescending(const std::vector<double>& values) {
    const auto rises = [](double a, double b) { return !(b < a); };
    return values.size() > 1 && std::ranges::adjacent_find(values, rises) == values.end();
}

/// 350, 355, 0, 5 becomes 350, 355, 360, 365.
void ContinueCircle(std::vector<double>* longitudes) {
    auto& values = *longitudes;
    if (values.size() < 3)
        return;
    const double step = std::remainder(values[1] - values[0], 360.0);
    for (std::size_t i = 1; i < values.size(); ++i) {
        // More than one turn is no meridian but a fault of the file.
        const double turns = std::round((values[i - 1] + step - values[i]) / 360.0);
        if (std::abs(turns) == 1.0)
            values[i] += turns * 360.0;
    }
}

/// The values of the axis are often floats, or written with few decimals: a thousandth of a cell
/// apart is still regular. The latitudes of Gaussian grids are further off.
bool IsEquallySpaced(const std::vector<double>& values) {
    if (values.size() < 2)
        return values.size() == 1 && std::isfinite(values[0]);
    const double span = values.back() - values.front();
    const double spacing = span / static_cast<double>(values.size() - 1);
    const double largest = std::max(std::abs(values.front()), std::abs(values.back()));
    const double tolerance =
        1e-3 * spacing + 2.0 * static_cast<double>(std::numeric_limits<float>::epsilon()) * largest;
    if (!(spacing > 0.0 && std::isfinite(spacing)))
        return false;
    for (std::size_t i = 0; i < values.size(); ++i)
        if (!(std::abs(values[i] - (values.front() + static_cast<double>(i) * spacing)) <=
              tolerance))
            return false;
    return true;
}

Status ReadCoordinates(const NcFile& file, const NcVariable& variable,
                       std::vector<double>* values) {
    if (Status status = CheckHoldable(file, variable); !status)
        return status;
    values->resize(file.DimensionOf(variable, 0).length);
    const std::array<std::size_t, 1> start{};
    const std::array count = {values->size()};
    if (Status status = file.Read(variable, start, count, values->data()); !status)
        return status;
    const double scale = file.Number(variable.id, "scale_factor").value_or(1.0);
    const double offset = file.Number(variable.id, "add_offset").value_or(0.0);
    for (double& value : *values)
        value = value * scale + offset;
    return Status::Ok();
}

void Judge(AxisRole role, SpatialAxis* axis, bool isRotated) {
    if (role == AxisRole::X && axis->isGeographic)
        ContinueCircle(&axis->values);
    axis->isTurned = IsDescending(axis->values);
    if (axis->isTurned)
        std::ranges::reverse(axis->values);
    axis->isRegular = !isRotated && IsEquallySpaced(axis->values);
    if (!axis->isRegular)
        return;
    axis->origin = axis->values.front();
    if (axis->size > 1)
        axis->spacing = (axis->values.back() - axis->origin) / (axis->size - 1);
}

} // namespace

Status CheckHoldable(const NcFile& file, const NcVariable& variable) {
    std::uint64_t bytes = static_cast<std::uint64_t>(BytesOf(variable.type));
    for (std::size_t i = 0; i < variable.dimensions.size(); ++i)
        if (__builtin_mul_overflow(bytes, file.DimensionOf(variable, i).length, &bytes))
            bytes = std::numeric_limits<std::uint64_t>::max();
    return bytes / kMostExpansion <= file.FileSize()
               ? Status::Ok()
               : file.InputFault(variable, "counts more values than the file can hold");
}

Status ReadSpatialAxis(const NcFile& file, int dimension, AxisRole role, SpatialAxis* axis) {
    const NcDimension& along = file.Dimensions()[static_cast<std::size_t>(dimension)];
    if (along.length < 1 || along.length > static_cast<std::size_t>(INT_MAX))
        return file.InputFault("its axis \"" + along.name + "\" has " +
                               std::to_string(along.length) + " places");
    SpatialAxis read;
    read.name = along.name;
    read.dimension = dimension;
    read.size = static_cast<int>(along.length);
    if (const NcVariable* const variable = CoordinatesOf(file, dimension)) {
        read.name = variable->name;
        read.standardName = file.Text(variable->id, "standard_name").value_or("");
        read.units = file.Text(variable->id, "units").value_or("");
        read.isGeographic = IsGeographic(file, *variable);
        if (Status status = ReadCoordinates(file, *variable, &read.values); !status)
            return status;
        Judge(role, &read, IsRotated(file, *variable));
    }
    *axis = std::move(read);
    return Status::Ok();
}

} // namespace ryn
