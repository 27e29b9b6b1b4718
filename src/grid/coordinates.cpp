#include <algorithm>
#include <utility>

#include "grid/grid_file.h"

namespace ryn {

namespace {

GridCoordinates::Axis AxisOf(const SpatialAxis& axis) {
    return {axis.name, axis.units, axis.standardName, axis.values};
}

/// The degrees of each cell in the order in which the axes are handed on.
class CellReader {
  public:
    CellReader(const NcFile& source, const GridLayout& of) : file(source), layout(of) {}

    Status Read(const NcVariable& variable, std::vector<double>* degrees) const {
        if (Status status = CheckHoldable(file, variable); !status)
            return status;
        // Where the cells change in time they are those of the first step.
        std::vector<std::size_t> count(variable.dimensions.size(), 1);
        const std::size_t xPlace = PlaceOf(variable, layout.x);
        const std::size_t yPlace = PlaceOf(variable, layout.y);
        count[xPlace] = static_cast<std::size_t>(layout.x.size);
        count[yPlace] = static_cast<std::size_t>(layout.y.size);
        std::vector<double> stored(count[xPlace] * count[yPlace]);
        const std::vector<std::size_t> start(count.size(), 0);
        if (Status status = file.Read(variable, start, count, stored.data()); !status)
            return status;
        degrees->clear();
        for (int y = 0; y < layout.y.size; ++y)
            for (int x = 0; x < layout.x.size; ++x) {
                const std::size_t row = layout.y.InFile(y);
                const std::size_t column = layout.x.InFile(x);
                degrees->push_back(xPlace > yPlace ? stored[row * count[xPlace] + column]
                                                   : stored[column * count[yPlace] + row]);
            }
        return Status::Ok();
    }

  private:
    static std::size_t PlaceOf(const NcVariable& variable, const SpatialAxis& axis) {
        const auto found = std::ranges::find(variable.dimensions, axis.dimension);
        return static_cast<std::size_t>(std::distance(variable.dimensions.begin(), found));
    }

    const NcFile& file;
    const GridLayout& layout;
};

} // namespace

Status GridFile::ReadCoordinates(GridCoordinates* coordinates) const {
    // All or nothing: half of the coordinates would be taken for those of another kind of grid.
    GridCoordinates read;
    read.x = AxisOf(layout.x);
    read.y = AxisOf(layout.y);
    if (layout.longitudes != nullptr) {
        const CellReader reader(file, layout);
        if (Status status = reader.Read(*layout.longitudes, &read.longitudes); !status)
            return status;
        if (Status status = reader.Read(*layout.latitudes, &read.latitudes); !status)
            return status;
    }
    *coordinates = std::move(read);
    return Status::Ok();
}

} // namespace ryn
