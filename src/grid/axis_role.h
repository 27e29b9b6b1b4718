#pragma once

#include "netcdf/nc_file.h"

namespace ryn {

/// What a dimension, or a variable with its coordinates, measures.
enum class AxisRole {
    None,  ///< nothing that is known: members, stations, corners
    X,     ///< longitude, or the projection's or grid's own x
    Y,     ///< latitude, and so on
    Level, ///< height, depth, pressure
};

/// By the attributes of CF (`axis`, `standard_name`, `units`, `positive`) and of the Unidata
/// conventions (`_CoordinateAxisType`).
AxisRole RoleOfCoordinates(const NcFile& file, const NcVariable& variable);

/// The variable with one number for each place of a dimension: the one named as the dimension, else
/// the only one that says that it is a longitude or latitude or such. Null when there is none, or
/// when the dimension has both, as a list of stations does.
const NcVariable* CoordinatesOf(const NcFile& file, int dimension);

/// By its coordinates, else by its name where that is an established one ("lon", "south_north").
AxisRole RoleOfDimension(const NcFile& file, int dimension);

/// True for degrees of longitude or latitude; those of a rotated pole are none.
bool IsGeographic(const NcFile& file, const NcVariable& variable);
/// True for degrees that count from a rotated pole.
bool IsRotated(const NcFile& file, const NcVariable& variable);

} // namespace ryn
