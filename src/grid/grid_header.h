#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "grid/map_projection.h"
#include "units/units.h"

namespace ryn {

struct GridItem {
    std::string name;
    int type = kItemTypeUndefined;
    int unit = kUnitUndefined;
    int layers = 1;
};

/// What a header tells of an open grid; it outlives the file.
struct GridHeader {
    std::vector<std::int64_t> milliseconds; ///< of each step, since 1970-01-01
    bool hasEqualSteps = false;
    double stepSeconds = 0.0;
    float deleteValue = 0.0F;
    int sizeX = 0;
    int sizeY = 0;
    bool runsByIndex = false;
    float originX = 0.0F;
    float originY = 0.0F;
    float originZ = 0.0F;
    float spacingX = 1.0F;
    float spacingY = 1.0F;
    int unit = kUnitUndefined; ///< of the plane's axes
    MapProjection projection;
    std::vector<GridItem> items;
    std::vector<std::string> notes;
};

} // namespace ryn
