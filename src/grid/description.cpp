#include "grid/description.h"

#include "units/units.h"

namespace ryn {

namespace {

GridAxisDescription DescribeAxis(const SpatialAxis& axis) {
    GridAxisDescription described;
    described.name = axis.name;
    described.units = axis.units;
    described.size = axis.size;
    if (!axis.values.empty()) {
        described.first = axis.values.front();
        described.last = axis.values.back();
    }
    described.isRegular = axis.isRegular;
    described.isTurned = axis.isTurned;
    return described;
}

std::string StorageOf(const NcFile& file, const NcVariable& variable) {
    std::string storage;
    for (std::size_t i = 0; i < variable.dimensions.size(); ++i)
        storage += (i == 0 ? "" : ", ") + file.DimensionOf(variable, i).name;
    return storage;
}

GridItemDescription DescribeItem(const NcFile& file, const NcVariable& variable,
                                 const GridItem& item) {
    GridItemDescription described;
    described.name = item.name;
    described.variable = variable.name;
    described.units = file.Text(variable.id, "units").value_or("");
    described.type = ItemTypeText(item.type);
    described.layers = item.layers;
    described.storage = StorageOf(file, variable);
    return described;
}

void DescribeTimes(const GridFile& grid, GridDescription* described) {
    const GridHeader& header = *grid.Header();
    if (const NcVariable* const time = grid.File().FindVariable(grid.Layout().timeName)) {
        described->timeUnits = grid.File().Text(time->id, "units").value_or("");
        described->calendar = grid.File().Text(time->id, "calendar").value_or("");
    }
    described->steps = static_cast<int>(header.milliseconds.size());
    described->hasEqualSteps = header.hasEqualSteps;
    described->stepSeconds = header.stepSeconds;
    described->first = CQxDateTime::FromUnixMilliseconds(header.milliseconds.front());
    described->last = CQxDateTime::FromUnixMilliseconds(header.milliseconds.back());
}

} // namespace

GridDescription DescribeGrid(const GridFile& grid) {
    const GridHeader& header = *grid.Header();
    GridDescription described;
    described.title = grid.File().Text(kNcGlobal, "title").value_or("");
    DescribeTimes(grid, &described);
    described.x = DescribeAxis(grid.Layout().x);
    described.y = DescribeAxis(grid.Layout().y);
    described.runsByIndex = header.runsByIndex;
    described.deleteValue = header.deleteValue;
    described.notes = header.notes;
    for (std::size_t i = 0; i < header.items.size(); ++i) {
        described.items.push_back(
            DescribeItem(grid.File(), *grid.Layout().items[i].variable, header.items[i]));
        described.items.back().number = static_cast<int>(i) + 1;
    }
    return described;
}

} // namespace ryn
