#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "grid/spatial_axis.h"
#include "netcdf/cf_time_axis.h"

namespace ryn {

/// A data variable on the grid's axes, and where among its dimensions they stand.
struct GridVariable {
    const NcVariable* variable = nullptr;
    std::size_t timePlace = 0;
    std::size_t yPlace = 0;
    std::size_t xPlace = 0;
    /// The other dimensions, which make the layers: levels, members. Slowest first.
    std::vector<std::size_t> layerPlaces;
    int layers = 1; ///< the product of their lengths
};

/// What of a file is a grid: one time axis, one pair of spatial axes, and the variables on them.
struct GridLayout {
    CfTimeAxis time;
    std::string timeName;
    SpatialAxis x;
    SpatialAxis y;
    std::vector<GridVariable> items; ///< in file order
    /// Variables along time and two spatial axes that are not these.
    std::vector<std::string> left;
    /// Degrees of each cell over both dimensions; null where the axes themselves tell them.
    const NcVariable* longitudes = nullptr;
    const NcVariable* latitudes = nullptr;
};

/// Finds the grid in a file. The first variable along time and two spatial axes decides which pair
/// it is. Refused with one line that names the file and what is missing.
Status FindGrid(const NcFile& file, GridLayout* layout);

} // namespace ryn
