#pragma once

#include <cstddef>
#include <string>

#include "base/status.h"
#include "grid/grid_edit.h"
#include "params/tsq2_input_kvf.h"

namespace ryn {

/// A point of the grid by its place numbers.
struct GridPoint {
    int x = 0;
    int y = 0;
};

/// Which points of which grid a batch runs, and the cells of its result grids: one for each place
/// of the range, so that with a step above 1 the cells between points stay empty.
struct GridPlan {
    std::string gridFile;   ///< absolute
    std::string outputFile; ///< absolute
    std::string title;      ///< of the output file: its name as the parameter file has it
    int item = 1;
    IndexRange x; ///< places from 0; 0 <= first <= last, step at least 1
    IndexRange y;
    int firstStep = 0; ///< every time step from here
    int lastStep = 0;  ///< to here enters the series

    int PointsX() const { return (x.last - x.first) / x.step + 1; }
    int PointsY() const { return (y.last - y.first) / y.step + 1; }
    int Points() const { return PointsX() * PointsY(); }
    int CellsX() const { return x.last - x.first + 1; }
    int CellsY() const { return y.last - y.first + 1; }
    int Steps() const { return lastStep - firstStep + 1; }

    /// Point by number, from 0: x is the outer loop, y the inner one.
    GridPoint PointAt(int number) const {
        return {x.first + number / PointsY() * x.step, y.first + number % PointsY() * y.step};
    }
    /// All values that the batch reads.
    GridTile Whole() const {
        return {item, 0, x.first, CellsX(), y.first, CellsY(), firstStep, Steps()};
    }
};

/// Makes the plan of section Tsq2Input, whose file names count from `baseDirectory`. Refused with
/// one line: a file that is not named, ranges that go backward, begin below 0 or have a step below
/// 1.
Status MakeGridPlan(const CTsq2InputKvf& input, const std::string& baseDirectory, GridPlan* plan);

/// Whether the grid has the plan's item, places and time steps, and the points can be counted by a
/// 32-bit number. Before this says so the plan's counts mean nothing.
Status TestPlan(const GridPlan& plan, const CGridEditHeaderInfo& grid);

} // namespace ryn
