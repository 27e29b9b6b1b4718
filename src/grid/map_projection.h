#pragma once

#include <string>

#include "grid/layout.h"

namespace ryn {

/// How the plane lies on the earth, as the output file repeats it.
struct MapProjection {
    /// Well-known text or the name of a CF grid mapping; "latitude_longitude" for plain degrees,
    /// empty where the file says nothing.
    std::string text;
    double longitude = 0.0; ///< degrees; of the projection's origin or the rotated pole
    double latitude = 0.0;
    double rotation = 0.0; ///< degrees; of the rotated pole's own meridian
};

MapProjection ReadMapProjection(const NcFile& file, const GridLayout& layout);

} // namespace ryn
