#include "grid/axis_role.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <string>
#include <string_view>

#include "units/units.h"

namespace ryn {

namespace {

struct RoleOfWord {
    std::string_view words; // parted by blanks, with one before and behind each
    AxisRole role;
};

constexpr std::array kAxisWords = std::to_array<RoleOfWord>({
    {" x lon geox ", AxisRole::X},
    {" y lat geoy ", AxisRole::Y},
    {" z height pressure geoz ", AxisRole::Level},
});

constexpr std::array kStandardNames = std::to_array<RoleOfWord>({
    {" longitude grid_longitude projection_x_coordinate projection_x_angular_coordinate ",
     AxisRole::X},
    {" latitude grid_latitude projection_y_coordinate projection_y_angular_coordinate ",
     AxisRole::Y},
    {" height altitude depth air_pressure model_level_number ", AxisRole::Level},
});

/// What ocean, weather and regional models call the dimensions of files without coordinate
/// variables.
constexpr std::array kDimensionNames = std::to_array<RoleOfWord>({
    {" x lon long longitude rlon xc nx ni i easting nlon xi_rho west_east ", AxisRole::X},
    {" y lat latitude rlat yc ny nj j northing nlat eta_rho south_north ", AxisRole::Y},
    {" z lev level plev depth height nz bottom_top ", AxisRole::Level},
});

std::string Lower(std::string text) {
    std::ranges::transform(text, text.begin(),
                           [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

template <typename Table>
AxisRole RoleIn(const Table& table, const std::string& word) {
    if (word.empty() || word.find(' ') != std::string::npos)
        return AxisRole::None;
    const std::string padded = " " + Lower(word) + " ";
    for (const RoleOfWord& row : table)
        if (row.words.find(padded) != std::string_view::npos)
            return row.role;
    return AxisRole::None;
}

std::string TextOf(const NcFile& file, const NcVariable& variable, const char* name) {
    return file.Text(variable.id, name).value_or("");
}

AxisRole RoleOfUnits(const NcFile& file, const NcVariable& variable) {
    const std::string units = TextOf(file, variable, "units");
    static const int kNorth = UnitOfText("degrees_north");
    static const int kEast = UnitOfText("degrees_east");
    // Other texts need no code of their own for this.
    if (!units.starts_with("degree"))
        return AxisRole::None;
    const int unit = UnitOfText(units);
    return unit == kEast ? AxisRole::X : unit == kNorth ? AxisRole::Y : AxisRole::None;
}

bool IsAlong(const NcFile& file, const NcVariable& variable, int dimension) {
    return variable.dimensions.size() == 1 && variable.dimensions[0] == dimension &&
           IsNumeric(variable.type) && file.DimensionOf(variable, 0).length > 0;
}

} // namespace

AxisRole RoleOfCoordinates(const NcFile& file, const NcVariable& variable) {
    // In the order of how seldom each is wrong: `axis` exists only to say this, while a `positive`
    // direction is told of depths that are data, too.
    if (const AxisRole role = RoleIn(kAxisWords, TextOf(file, variable, "axis"));
        role != AxisRole::None)
        return role;
    if (const AxisRole role = RoleIn(kStandardNames, TextOf(file, variable, "standard_name"));
        role != AxisRole::None)
        return role;
    if (const AxisRole role = RoleOfUnits(file, variable); role != AxisRole::None)
        return role;
    if (const AxisRole role = RoleIn(kAxisWords, TextOf(file, variable, "_CoordinateAxisType"));
        role != AxisRole::None)
        return role;
    return TextOf(file, variable, "positive").empty() ? AxisRole::None : AxisRole::Level;
}

const NcVariable* CoordinatesOf(const NcFile& file, int dimension) {
    const std::string& name = file.Dimensions()[static_cast<std::size_t>(dimension)].name;
    const NcVariable* const named = file.FindVariable(name);
    if (named != nullptr && IsAlong(file, *named, dimension))
        return named;
    // Files with dimensions of their own names (nlat, nlon) have the coordinates beside them.
    const NcVariable* found = nullptr;
    for (const NcVariable& variable : file.Variables()) {
        if (!IsAlong(file, variable, dimension))
            continue;
        const AxisRole role = RoleOfCoordinates(file, variable);
        if (role != AxisRole::X && role != AxisRole::Y)
            continue;
        if (found != nullptr && RoleOfCoordinates(file, *found) != role)
            return nullptr;
        found = &variable;
    }
    return found;
}

AxisRole RoleOfDimension(const NcFile& file, int dimension) {
    if (const NcVariable* const coordinates = CoordinatesOf(file, dimension))
        if (const AxisRole role = RoleOfCoordinates(file, *coordinates); role != AxisRole::None)
            return role;
    return RoleIn(kDimensionNames, file.Dimensions()[static_cast<std::size_t>(dimension)].name);
}

bool IsRotated(const NcFile& file, const NcVariable& variable) {
    return TextOf(file, variable, "standard_name").starts_with("grid_l");
}

bool IsGeographic(const NcFile& file, const NcVariable& variable) {
    if (IsRotated(file, variable))
        return false;
    if (RoleOfUnits(file, variable) != AxisRole::None)
        return true;
    const std::string units = TextOf(file, variable, "units");
    const std::string name = Lower(variable.name);
    const std::string standardName = TextOf(file, variable, "standard_name");
    const bool isNamed = standardName == "longitude" || standardName == "latitude" ||
                         name.starts_with("lon") || name.starts_with("lat");
    return isNamed && (units.empty() || UnitOfText(units) == UnitOfText("degree"));
}

} // namespace ryn
