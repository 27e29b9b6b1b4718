#include <algorithm>
#include <array>
#include <string_view>

#include "units/units.h"

namespace ryn {

namespace {

struct ItemTypeRow {
    int code;
    std::string_view text;
};

// Codes are stored in files: a row may be added, but none changed or taken away.
constexpr std::array kItemTypes = std::to_array<ItemTypeRow>({
    {100, "Water level"},
    {101, "Water depth"},
    {102, "Discharge"},
    {103, "Specific discharge"},
    {104, "Volume"},
    {105, "Current speed"},
    {106, "Current direction"},
    {107, "Surge level"},
    {108, "Groundwater level"},
    {109, "Soil moisture"},
    {200, "Rainfall"},
    {201, "Rainfall intensity"},
    {202, "Snow depth"},
    {203, "Snow water equivalent"},
    {204, "Evaporation"},
    {300, "Wind speed"},
    {301, "Wind direction"},
    {302, "Air pressure"},
    {303, "Temperature"},
    {304, "Relative humidity"},
    {305, "Radiation"},
    {400, "Significant wave height"},
    {401, "Maximum wave height"},
    {402, "Wave period"},
    {403, "Mean wave direction"},
    {404, "Wave energy flux"},
    {500, "Concentration"},
    {501, "Salinity"},
    {502, "Sediment transport"},
    {600, "Length"},
    {601, "Area"},
    {602, "Speed"},
    {603, "Angle"},
    {604, "Time"},
    {605, "Mass"},
    {606, "Frequency"},
    {607, "Acceleration"},
    {608, "Energy"},
    {609, "Fraction"},
    {kItemTypeUndefined, "Undefined"},
});

struct Suggestion {
    int firstUnit;
    int lastUnit;
    int itemType;
};

// Only what the unit leaves no doubt of: metres may be a level, a depth or a wave's height, and
// metres per second wind or current.
constexpr std::array kSuggestions = std::to_array<Suggestion>({
    {1003, 1003, 200}, // mm
    {1009, 1009, 200}, // 0.1 mm
    {1012, 1012, 200}, // 0.01 inch
    {1100, 1199, 601}, {1200, 1299, 104}, {1300, 1399, 605}, {1400, 1499, 604}, {1506, 1506, 607},
    {1600, 1607, 201}, {1700, 1704, 102}, {1705, 1707, 103}, {1708, 1708, 102}, {1800, 1899, 303},
    {1900, 1999, 302}, {2100, 2199, 603}, {2200, 2200, 305}, {2206, 2206, 404}, {2301, 2302, 500},
    {2306, 2306, 500}, {2400, 2400, 606},
});

} // namespace

std::string ItemTypeText(int code) {
    const auto* const row = std::ranges::find(kItemTypes, code, &ItemTypeRow::code);
    return std::string(row != kItemTypes.end() ? row->text : kItemTypes.back().text);
}

int ItemTypeOfUnit(int unitCode) {
    const auto* const row = std::ranges::find_if(kSuggestions, [&](const Suggestion& s) {
        return unitCode >= s.firstUnit && unitCode <= s.lastUnit;
    });
    return row != kSuggestions.end() ? row->itemType : kItemTypeUndefined;
}

} // namespace ryn
