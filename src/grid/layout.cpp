#include "grid/layout.h"

#include <algorithm>
#include <climits>
#include <cstdint>
#include <optional>
#include <set>
#include <sstream>
#include <utility>

namespace ryn {

namespace {

struct Plane {
    int y = 0; ///< places in NcFile::Dimensions
    int x = 0;
};

bool Has(const NcVariable& variable, int dimension) {
    return std::ranges::count(variable.dimensions, dimension) == 1;
}

std::size_t PlaceOf(const NcVariable& variable, int dimension) {
    const auto found = std::ranges::find(variable.dimensions, dimension);
    return static_cast<std::size_t>(std::distance(variable.dimensions.begin(), found));
}

/// For a message: one line of bounded length, whatever the file holds.
std::string Quoted(std::string text) {
    text.resize(std::min<std::size_t>(text.size(), 80));
    std::ranges::replace_if(
        text, [](unsigned char c) { return c < 0x20; }, ' ');
    return "\"" + text + "\"";
}

class Finder {
  public:
    Finder(const NcFile& source, GridLayout* result) : file(source), layout(*result) {}

    /// Cheap tests come first, so that a file of another kind is told by what it lacks and not by a
    /// fault of its times.
    Status Find() {
        const NcVariable* const time = FindTimeVariable(file);
        if (time == nullptr)
            return file.InputFault("no grid: it has no time axis of the CF conventions (a variable "
                                   "with units such as \"hours since 1990-01-01\")");
        timeDimension = TimeDimensionOf(file, *time);
        FindCandidates();
        const std::optional<Plane> plane = FirstPlane();
        if (!plane)
            return NoPlane();
        if (Status status = ReadAxes(*plane); !status)
            return status;
        if (Status status = ReadItems(*plane); !status)
            return status;
        return ReadTimes(*time);
    }

  private:
    /// Variables that describe others: bounds, coordinates, weights.
    std::set<std::string> DescribingVariables() const {
        std::set<std::string> names;
        for (const NcVariable& variable : file.Variables())
            for (const char* const attribute :
                 {"bounds", "climatology", "coordinates", "grid_mapping"}) {
                std::istringstream list(file.Text(variable.id, attribute).value_or(""));
                for (std::string name; list >> name;)
                    names.insert(name);
            }
        return names;
    }

    /// Numbers along time, in file order.
    void FindCandidates() {
        const std::set<std::string> describing = DescribingVariables();
        for (const NcVariable& variable : file.Variables())
            if (IsNumeric(variable.type) && Has(variable, timeDimension) &&
                variable.dimensions.size() > 1 && !describing.contains(variable.name))
                candidates.push_back(&variable);
    }

    std::optional<Plane> FirstPlane() const {
        for (const NcVariable* const variable : candidates)
            if (const auto plane = PlaneOf(*variable))
                return plane;
        return std::nullopt;
    }

    /// The pair of spatial dimensions of a variable: by their own coordinates or names, else those
    /// of the latitudes of each cell, which are stored row by row.
    std::optional<Plane> PlaneOf(const NcVariable& variable) const {
        const int x = OnlyWithRole(variable, AxisRole::X);
        const int y = OnlyWithRole(variable, AxisRole::Y);
        if (x >= 0 && y >= 0)
            return Plane{y, x};
        for (const NcVariable& other : file.Variables()) {
            const auto plane = PlaneOfCells(other);
            if (plane && Has(variable, plane->x) && Has(variable, plane->y))
                return plane;
        }
        return std::nullopt;
    }

    int OnlyWithRole(const NcVariable& variable, AxisRole role) const {
        int found = -1;
        for (const int dimension : variable.dimensions)
            if (dimension != timeDimension && Has(variable, dimension) &&
                RoleOfDimension(file, dimension) == role)
                found = found < 0 ? dimension : -2;
        return found;
    }

    /// The two dimensions of a variable with the latitude of each cell.
    std::optional<Plane> PlaneOfCells(const NcVariable& variable) const {
        if (!IsNumeric(variable.type) || RoleOfCoordinates(file, variable) != AxisRole::Y)
            return std::nullopt;
        std::vector<int> dimensions = variable.dimensions;
        std::erase(dimensions, timeDimension);
        if (dimensions.size() != 2 || dimensions[0] == dimensions[1])
            return std::nullopt;
        return Plane{dimensions[0], dimensions[1]};
    }

    Status NoPlane() const {
        if (candidates.empty())
            return file.InputFault("no grid: no variable has axes of space besides time");
        const NcVariable& first = *candidates.front();
        std::string axes;
        for (const int dimension : first.dimensions)
            if (dimension != timeDimension)
                axes += (axes.empty() ? "" : ", ") +
                        Quoted(file.Dimensions()[static_cast<std::size_t>(dimension)].name);
        return file.InputFault("no grid: besides time, " + Quoted(first.name) + " runs along " +
                               axes + ", not along two axes of space");
    }

    Status ReadAxes(const Plane& plane) {
        if (Status status = ReadSpatialAxis(file, plane.x, AxisRole::X, &layout.x); !status)
            return status;
        if (Status status = ReadSpatialAxis(file, plane.y, AxisRole::Y, &layout.y); !status)
            return status;
        layout.longitudes = FindCells(plane, AxisRole::X);
        layout.latitudes = FindCells(plane, AxisRole::Y);
        // One without the other places nothing.
        if (layout.longitudes == nullptr || layout.latitudes == nullptr)
            layout.longitudes = layout.latitudes = nullptr;
        return Status::Ok();
    }

    /// Degrees of each cell, alike at all times.
    const NcVariable* FindCells(const Plane& plane, AxisRole role) const {
        const auto isOther = [&](int dimension) {
            return dimension != plane.x && dimension != plane.y && dimension != timeDimension;
        };
        for (const NcVariable& variable : file.Variables())
            if (IsNumeric(variable.type) && Has(variable, plane.x) && Has(variable, plane.y) &&
                std::ranges::none_of(variable.dimensions, isOther) &&
                RoleOfCoordinates(file, variable) == role && IsGeographic(file, variable))
                return &variable;
        return nullptr;
    }

    Status ReadItems(const Plane& plane) {
        for (const NcVariable* const variable : candidates) {
            if (Has(*variable, plane.x) && Has(*variable, plane.y)) {
                GridVariable item;
                if (Status status = CheckChunk(*variable); !status)
                    return status;
                if (Status status = Describe(*variable, plane, &item); !status)
                    return status;
                layout.items.push_back(std::move(item));
            } else if (PlaneOf(*variable)) {
                layout.left.push_back(variable->name);
            }
        }
        return Status::Ok();
    }

    /// The library allocates a chunk as its header states it.
    Status CheckChunk(const NcVariable& variable) const {
        constexpr std::uint64_t kUnsuspicious = std::uint64_t{64} << 20;
        auto bytes = static_cast<std::uint64_t>(BytesOf(variable.type));
        for (const std::size_t length : file.ChunkShape(variable))
            if (__builtin_mul_overflow(bytes, length, &bytes))
                return file.InputFault(variable, "has chunks of an impossible size");
        return bytes <= kUnsuspicious || bytes / kMostExpansion <= file.FileSize()
                   ? Status::Ok()
                   : file.InputFault(variable, "has chunks larger than the file can hold");
    }

    Status Describe(const NcVariable& variable, const Plane& plane, GridVariable* item) const {
        item->variable = &variable;
        item->timePlace = PlaceOf(variable, timeDimension);
        item->yPlace = PlaceOf(variable, plane.y);
        item->xPlace = PlaceOf(variable, plane.x);
        std::size_t layers = 1;
        for (std::size_t i = 0; i < variable.dimensions.size(); ++i) {
            if (i == item->timePlace || i == item->yPlace || i == item->xPlace)
                continue;
            item->layerPlaces.push_back(i);
            if (__builtin_mul_overflow(layers, file.DimensionOf(variable, i).length, &layers) ||
                layers > static_cast<std::size_t>(INT_MAX) || layers == 0)
                return file.InputFault(variable, "does not have between 1 and 2147483647 layers");
        }
        item->layers = static_cast<int>(layers);
        return Status::Ok();
    }

    Status ReadTimes(const NcVariable& time) {
        if (Status status = ReadCfTimeAxis(file, time, TimeOrder::Ascending, &layout.time); !status)
            return status;
        layout.timeName = time.name;
        if (layout.time.time.IsRelative())
            return file.InputFault(time, "counts from no date: its units should be such as \"" +
                                             layout.time.time.UnitName() + " since 1990-01-01\"");
        return !layout.time.milliseconds.empty() ? Status::Ok()
                                                 : file.InputFault(time, "has no time steps");
    }

    const NcFile& file;
    GridLayout& layout;
    int timeDimension = 0;
    std::vector<const NcVariable*> candidates;
};

} // namespace

Status FindGrid(const NcFile& file, GridLayout* layout) {
    GridLayout found;
    Status status = Finder(file, &found).Find();
    if (status)
        *layout = std::move(found);
    return status;
}

} // namespace ryn
