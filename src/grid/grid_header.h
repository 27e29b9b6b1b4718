#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "grid/map_projection.h"
#include "units/units.h"

namespace ryn {

/// One item, as CGridEditItemInfo tells it.
struct GridItem {
    std::string name;              ///< for people: ItemName
    int type = kItemTypeUndefined; ///< what the unit suggests
    int unit = kUnitUndefined;     ///< of the values
    int layers = 1;
};

/// What a header tells of an open grid; it outlives the file.
struct GridHeader {
    std::vector<std::int64_t> milliseconds; ///< of each step, since 1970-01-01
    bool hasEqualSteps = false;
    double stepSeconds = 0.0; ///< the mean where they differ
    float deleteValue = 0.0F; ///< finite
    int sizeX = 0;
    int sizeY = 0;
    bool runsByIndex = false; ///< origin 0 and spacing 1 then, and no unit
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
