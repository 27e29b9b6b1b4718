#include "grid/make_header.h"

#include <array>
#include <cmath>
#include <cstdlib>

#include "grid/delete_value.h"
#include "netcdf/nc_values.h"

namespace ryn {

namespace {

/// The step of equally spaced times, which were rounded to the millisecond each; else the mean one
/// with hasEqualSteps false. A single step counts as equal, with a day for its length, so that an
/// axis can be made of it.
void JudgeSteps(GridHeader* header) {
    const auto& times = header->milliseconds;
    header->stepSeconds = 86400.0;
    header->hasEqualSteps = true;
    if (times.size() < 2)
        return;
    const double step =
        static_cast<double>(times.back() - times.front()) / static_cast<double>(times.size() - 1);
    header->stepSeconds = step / 1000.0;
    // Against the rule and not against the step before: small shifts must not add up.
    for (std::size_t i = 0; i < times.size(); ++i) {
        const double ruled = static_cast<double>(i) * step;
        if (std::abs(static_cast<double>(times[i] - times.front()) - ruled) > 1.0)
            header->hasEqualSteps = false;
    }
}

/// The code of the axes' unit when they run by coordinate and share one. A file of results has one
/// unit for both, so axes of two (degrees across, metres up) cannot run by coordinate.
bool ShareUnit(const GridLayout& layout, int* unit) {
    if (layout.x.isGeographic != layout.y.isGeographic)
        return false;
    if (layout.x.isGeographic) {
        *unit = UnitOfText("degree");
        return true;
    }
    *unit = UnitOfText(layout.x.units);
    return *unit == UnitOfText(layout.y.units);
}

void PlaceAxes(const GridLayout& layout, GridHeader* header) {
    header->sizeX = layout.x.size;
    header->sizeY = layout.y.size;
    int unit = kUnitUndefined;
    header->runsByIndex = !(layout.x.isRegular && layout.y.isRegular && ShareUnit(layout, &unit));
    if (header->runsByIndex)
        return;
    header->unit = unit;
    header->originX = static_cast<float>(layout.x.origin);
    header->originY = static_cast<float>(layout.y.origin);
    header->spacingX = static_cast<float>(layout.x.spacing);
    header->spacingY = static_cast<float>(layout.y.spacing);
}

/// Of the first item's first layer, where one axis tells it.
float FirstLevel(const NcFile& file, const GridVariable& item) {
    if (item.layerPlaces.size() != 1)
        return 0.0F;
    const int dimension = item.variable->dimensions[item.layerPlaces[0]];
    const NcVariable* const levels = CoordinatesOf(file, dimension);
    float value = 0.0F;
    if (levels == nullptr ||
        !NcValues(&file, levels)
             .Read(std::array{std::size_t{0}}, std::array{std::size_t{1}}, &value))
        return 0.0F;
    return std::isfinite(value) ? value : 0.0F;
}

GridItem DescribeItem(const NcFile& file, const GridVariable& item) {
    GridItem described;
    described.name = ItemName(file, *item.variable);
    described.unit = UnitOfText(file.Text(item.variable->id, "units").value_or(""));
    described.type = ItemTypeOfUnit(described.unit);
    described.layers = item.layers;
    return described;
}

std::string Joined(const std::vector<std::string>& names) {
    std::string joined;
    for (const std::string& name : names)
        joined += (joined.empty() ? "" : ", ") + name;
    return joined;
}

std::vector<std::string> Notes(const GridLayout& layout, const GridHeader& header) {
    std::vector<std::string> notes;
    if (layout.time.time.Calendar() == CfCalendar::Day360)
        notes.emplace_back("The calendar has years of 360 days: each day is placed at the same "
                           "fraction of the real year.");
    if (layout.time.time.Calendar() == CfCalendar::AllLeap)
        notes.emplace_back("The calendar has a 29 February in every year: times of common years "
                           "are placed at the same fraction of the real year.");
    if (header.runsByIndex)
        notes.emplace_back("The axes are not regular degrees or lengths: the grid runs by place "
                           "number, from 0 in steps of 1.");
    if (!layout.left.empty())
        notes.push_back("On other axes of space, and left out: " + Joined(layout.left) + ".");
    return notes;
}

} // namespace

std::string ItemName(const NcFile& file, const NcVariable& variable) {
    for (const char* const name : {"long_name", "standard_name"})
        if (const auto text = file.Text(variable.id, name); text && !text->empty())
            return *text;
    return variable.name;
}

GridHeader MakeGridHeader(const NcFile& file, const GridLayout& layout) {
    GridHeader header;
    header.milliseconds = layout.time.milliseconds;
    JudgeSteps(&header);
    PlaceAxes(layout, &header);
    header.originZ = FirstLevel(file, layout.items.front());
    header.deleteValue = ChooseDeleteValue(file, layout.items);
    header.projection = ReadMapProjection(file, layout);
    for (const GridVariable& item : layout.items)
        header.items.push_back(DescribeItem(file, item));
    header.notes = Notes(layout, header);
    return header;
}

} // namespace ryn
