#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "base/qx_date_time.h"

namespace ryn {

/// A part of an item: all its places from `firstX` on, `countX` of them, and so on. Places and
/// steps count from 0, items from 1; the axes ascend.
struct GridTile {
    int item = 1;
    int layer = 0;
    int firstX = 0;
    int countX = 0;
    int firstY = 0;
    int countY = 0;
    int firstStep = 0;
    int countSteps = 0;

    /// Cells of the plane in the tile, and values in all.
    std::size_t Points() const {
        return static_cast<std::size_t>(countX) * static_cast<std::size_t>(countY);
    }
    std::size_t Values() const { return Points() * static_cast<std::size_t>(countSteps); }
    friend bool operator==(const GridTile&, const GridTile&) = default;
};

/// Where the cells of a grid really lie, as its file says, with both axes ascending. What the file
/// does not have is empty.
struct GridCoordinates {
    struct Axis {
        std::string name;  ///< of the coordinate variable, else of the dimension
        std::string units; ///< as in the file, and so the next
        std::string standardName;
        std::vector<double> values; ///< one for each place
    };
    Axis x;
    Axis y;
    /// Degrees of each cell, x fast.
    std::vector<double> longitudes;
    std::vector<double> latitudes;
};

/// One axis of the plane.
struct GridAxisDescription {
    std::string name;  ///< of the coordinate variable, else of the dimension
    std::string units; ///< as in the file
    int size = 0;      ///< places, 1 or more
    /// First and last coordinate, ascending; both 0 where the file has none.
    double first = 0.0;
    double last = 0.0;
    bool isRegular = false;
    bool isTurned = false; ///< the file has it descending
};

/// One item.
struct GridItemDescription {
    int number = 1;       ///< as CGridEditSlice::SetItem takes it
    std::string name;     ///< `long_name`, else the variable's
    std::string variable; ///< name in the file
    std::string units;    ///< as in the file
    std::string type;     ///< text of the item type
    int layers = 1;       ///< counted from 0
    std::string storage;  ///< dimensions in the file's order, slowest first: "time, lat, lon"
};

/// What there is to say of a grid file.
struct GridDescription {
    std::string title;
    std::string timeUnits; ///< as in the file
    std::string calendar;  ///< as in the file; empty for the standard one
    int steps = 0;
    bool hasEqualSteps = false;
    double stepSeconds = 0.0; ///< of equal steps, else the mean one
    CQxDateTime first;
    CQxDateTime last;
    GridAxisDescription x;
    GridAxisDescription y;
    /// The plane runs by place number and spacing 1.
    bool runsByIndex = false;
    float deleteValue = 0.0F;
    std::vector<GridItemDescription> items;
    std::vector<std::string> notes; ///< CGridEditHeaderInfo::Notes
};

/// One layer of an item over all its steps.
struct GridSummary {
    std::uint64_t values = 0;
    std::uint64_t missing = 0;
    /// Of the values that are not missing; NaN when all are.
    float smallest = 0.0F;
    float largest = 0.0F;

    double MissingShare() const {
        return values != 0 ? static_cast<double>(missing) / static_cast<double>(values) : 0.0;
    }
};

} // namespace ryn
