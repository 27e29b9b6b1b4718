#include "grid/map_projection.h"

#include <array>

namespace ryn {

namespace {

double FirstNumber(const NcFile& file, int variable, std::span<const char* const> names) {
    for (const char* const name : names)
        if (const auto numbers = file.Numbers(variable, name); numbers && !numbers->empty())
            return numbers->front();
    return 0.0;
}

std::string FirstText(const NcFile& file, int variable, std::span<const char* const> names) {
    for (const char* const name : names)
        if (const auto text = file.Text(variable, name); text && !text->empty())
            return *text;
    return "";
}

} // namespace

MapProjection ReadMapProjection(const NcFile& file, const GridLayout& layout) {
    // Well-known text first: it says the most, and other programs take it as it is.
    constexpr std::array kTexts = {"crs_wkt", "spatial_ref", "grid_mapping_name"};
    constexpr std::array kLongitudes = {"longitude_of_projection_origin",
                                        "longitude_of_central_meridian",
                                        "grid_north_pole_longitude"};
    constexpr std::array kLatitudes = {"latitude_of_projection_origin", "grid_north_pole_latitude"};
    constexpr std::array kRotations = {"north_pole_grid_longitude"};
    MapProjection projection;
    const int item = layout.items.front().variable->id;
    const NcVariable* const mapping =
        file.FindVariable(file.Text(item, "grid_mapping").value_or(""));
    if (mapping != nullptr) {
        projection.text = FirstText(file, mapping->id, kTexts);
        projection.longitude = FirstNumber(file, mapping->id, kLongitudes);
        projection.latitude = FirstNumber(file, mapping->id, kLatitudes);
        projection.rotation = FirstNumber(file, mapping->id, kRotations);
    }
    if (projection.text.empty() && layout.x.isGeographic && layout.y.isGeographic)
        projection.text = "latitude_longitude";
    return projection;
}

} // namespace ryn
