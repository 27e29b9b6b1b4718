#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "grid/axis_role.h"
#include "netcdf/nc_file.h"

namespace ryn {

/// One of the two axes of a grid's plane, in the order in which it is handed on: ascending.
struct SpatialAxis {
    std::string name; ///< of the coordinate variable, else of the dimension
    std::string standardName;
    std::string units;
    int dimension = 0;          ///< place in NcFile::Dimensions
    int size = 0;               ///< 1 or more
    std::vector<double> values; ///< empty where the file has no coordinates along the axis
    /// The file has the axis the other way round.
    bool isTurned = false;
    /// Equally spaced within a thousandth of the spacing, and no rotated pole's.
    bool isRegular = false;
    bool isGeographic = false; ///< degrees of longitude or latitude
    double origin = 0.0;       ///< first value, where it is regular
    double spacing = 1.0;      ///< positive; 1 for an axis of one place

    /// The place in the file of a place on the axis, and back.
    std::size_t InFile(int place) const {
        return static_cast<std::size_t>(isTurned ? size - 1 - place : place);
    }
};

/// Reads the axis along a dimension. A longitude axis that passes 360 or 180 degrees is continued
/// beyond. The fault names the file.
Status ReadSpatialAxis(const NcFile& file, int dimension, AxisRole role, SpatialAxis* axis);

/// The most that deflate makes of equal bytes, and a little more: a file of N bytes holds at most
/// N times this.
inline constexpr std::uint64_t kMostExpansion = 1100;

/// Refuses a variable with more values than a file of its size can hold, however compressed.
Status CheckHoldable(const NcFile& file, const NcVariable& variable);

} // namespace ryn
