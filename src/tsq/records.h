#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <vector>

#include "tsq/tsq.h"
#include "units/units.h"

namespace ryn {

/// Two equidistant spatial axes; no values where an item has none.
struct TsqPlane {
    int unit = kUnitUndefined;
    int sizeX = 0;
    int sizeY = 0;
    float originX = 0.0F;
    float originY = 0.0F;
    float stepX = 0.0F;
    float stepY = 0.0F;

    friend bool operator==(const TsqPlane&, const TsqPlane&) = default;
};

struct TsqItem {
    int type = kItemTypeUndefined;
    std::string name;
    int unit = kUnitUndefined;
    int dataType = kTsqDataTypeFloat;
    int valueType = 0;
    std::array<float, 3> reference{};
    std::array<float, 3> orientation{};
    int dimensions = 0;    ///< number of spatial ones
    TsqPlane plane;        ///< of an item that is written with two
    std::size_t cells = 1; ///< values in a time step
};

struct TsqProjection {
    std::string text;
    double longitude = 0.0;
    double latitude = 0.0;
    double rotation = 0.0;
};

struct TsqHeader {
    int fileType = 0;
    int statisticsKind = 0;
    std::string title;
    std::string applicationName;
    std::string applicationTitle;
    int applicationVersion = 0;
    int dataType = 0;
    float deleteFloat = 0.0F;
    double deleteDouble = 0.0;
    TsqProjection projection;
    TsqAxis axis;
    TsqGridCoordinates coordinates;
    Durability durability = Durability::Flushed;
    std::vector<TsqItem> items; ///< keeps its size, so that item handles stay
};

/// A whole data file. Equidistant axes keep no times.
struct TsqContent {
    TsqHeader header;
    std::vector<double> times;
    std::vector<std::vector<float>> values; ///< of each item, step by step
};

/// Milliseconds in a time unit; 0 for a unit that is none.
double MillisecondsInUnit(int unit);
/// A time in a unit, rounded to the millisecond.
inline double RoundedToMillisecond(double time, double millisecondsInUnit) {
    constexpr double kLimit = 2251799813685248.0; // 2^51 milliseconds: 71 thousand years
    // Beside this number doubles have no fraction, so that adding it rounds; a call of nearbyint
    // for each step that is written would cost more than the rest of the step.
    constexpr double kRounding = 3.0 * kLimit;
    const double milliseconds = time * millisecondsInUnit;
    const bool fits = milliseconds > -kLimit && milliseconds < kLimit;
    return fits ? ((milliseconds + kRounding) - kRounding) / millisecondsInUnit : time;
}

} // namespace ryn
