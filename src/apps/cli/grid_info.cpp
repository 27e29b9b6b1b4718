#include "apps/cli/grid_info.h"

#include <cmath>
#include <optional>
#include <ostream>
#include <utility>

#include "apps/cli/date_text.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "strings/catalogue.h"
#include "units/units.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

COleDateTime DateOf(const CQxDateTime& date) {
    return COleDateTime::FromLinearCount(date);
}

/// An axis without coordinates in its file has 0 at both ends.
bool HasCoordinates(const GridAxisDescription& axis) {
    return axis.first != axis.last || (axis.size == 1 && axis.isRegular);
}

std::string CoordinateText(double value) {
    return ShortestText(static_cast<float>(value));
}

/// A coordinate as it was meant: files have many as floats, whose rounding a double would show.
double AsMeant(double coordinate) {
    const auto rounded = static_cast<float>(coordinate);
    return static_cast<double>(rounded) == coordinate ? *ParseDouble(ShortestText(rounded))
                                                      : coordinate;
}

/// To the precision in which an analysis takes it.
std::optional<float> SpacingOf(const GridAxisDescription& axis) {
    if (!axis.isRegular || axis.size < 2)
        return std::nullopt;
    return static_cast<float>((AsMeant(axis.last) - AsMeant(axis.first)) / (axis.size - 1));
}

std::string AxisText(const GridAxisDescription& axis) {
    std::string text = std::to_string(axis.size);
    if (HasCoordinates(axis)) {
        const std::string first = CoordinateText(axis.first);
        text += ": " + (axis.size == 1
                            ? first
                            : FormatText(kTextCliGridExtent, first, CoordinateText(axis.last)));
        if (!axis.units.empty())
            text += " " + axis.units;
    }
    if (!axis.isRegular)
        text += ", " + TextOf(kTextCliGridIrregular);
    else if (const std::optional<float> spacing = SpacingOf(axis))
        text += ", " + FormatText(kTextCliGridSpacing, ShortestText(*spacing));
    if (axis.isTurned)
        text += ", " + TextOf(kTextCliGridTurned);
    return text;
}

std::string StepText(const GridDescription& grid) {
    const double days = grid.stepSeconds / 86400.0;
    if (!grid.hasEqualSteps)
        return FormatText(kTextCliGridMeanStep, FixedText(days, 3) + " d");
    return grid.stepSeconds == std::round(grid.stepSeconds)
               ? LengthForPeople(COleDateTimeSpan(days))
               : ShortestText(grid.stepSeconds) + " s";
}

std::string TimeUnitsText(const GridDescription& grid) {
    return grid.calendar.empty() ? grid.timeUnits
                                 : FormatText(kTextCliGridCalendar, grid.timeUnits, grid.calendar);
}

void PrintHead(std::ostream& out, const GridDescription& grid) {
    TextTable head({Alignment::Left, Alignment::Left});
    if (!grid.title.empty())
        head.AddRow({TextOf(kTextCliTitle), grid.title});
    head.AddRow({"x  " + grid.x.name, AxisText(grid.x)});
    head.AddRow({"y  " + grid.y.name, AxisText(grid.y)});
    head.AddRow({TextOf(kTextCliSteps), std::to_string(grid.steps)});
    head.AddRow({TextOf(kTextCliFirst), DateForPeople(DateOf(grid.first))});
    head.AddRow({TextOf(kTextCliLast), DateForPeople(DateOf(grid.last))});
    if (grid.steps > 1)
        head.AddRow({TextOf(kTextCliTimeStep), StepText(grid)});
    head.AddRow({TextOf(kTextCliGridTimeUnits), TimeUnitsText(grid)});
    head.AddRow({TextOf(kTextCliGridMark), ShortestText(grid.deleteValue)});
    head.Print(out);
    for (const std::string& note : grid.notes)
        out << Text(kTextCliNote) << PlainLine(note) << '\n';
}

std::string MissingText(const GridSummary& summary) {
    const std::string count = std::to_string(summary.missing);
    return summary.missing == 0
               ? count
               : count + " (" + FixedText(100.0 * summary.MissingShare(), 2) + " %)";
}

void PrintItem(std::ostream& out, const GridItemDescription& item, const GridSummary& summary) {
    out << '\n' << FormatText(kTextCliItemHeading, item.number, PlainLine(item.name));
    if (!item.units.empty())
        out << " [" << PlainLine(item.units) << ']';
    out << '\n';
    TextTable table({Alignment::Left, Alignment::Left});
    table.AddRow({TextOf(kTextCliGridVariable), item.variable + "(" + item.storage + ")"});
    if (item.type != ItemTypeText(kItemTypeUndefined))
        table.AddRow({TextOf(kTextCliGridType), item.type});
    if (item.layers > 1)
        table.AddRow({TextOf(kTextCliGridLayers), FormatText(kTextCliGridFirstLayer, item.layers)});
    table.AddRow({TextOf(kTextCliValues), std::to_string(summary.values - summary.missing)});
    table.AddRow({TextOf(kTextCliMissing), MissingText(summary)});
    if (summary.missing < summary.values) {
        table.AddRow({TextOf(kTextCliSmallest), ShortestText(summary.smallest)});
        table.AddRow({TextOf(kTextCliLargest), ShortestText(summary.largest)});
    }
    table.Print(out);
}

Json JsonOfAxis(const GridAxisDescription& axis) {
    const bool isPlaced = HasCoordinates(axis);
    const std::optional<float> spacing = SpacingOf(axis);
    return {{"name", axis.name},
            {"units", axis.units},
            {"size", axis.size},
            {"first", isPlaced ? JsonOf(AsMeant(axis.first)) : Json(nullptr)},
            {"last", isPlaced ? JsonOf(AsMeant(axis.last)) : Json(nullptr)},
            {"spacing", spacing ? JsonOf(*spacing) : Json(nullptr)},
            {"turned", axis.isTurned}};
}

Json JsonOfItem(const GridItemDescription& item, const GridSummary& summary) {
    return {{"number", item.number},
            {"name", item.name},
            {"variable", item.variable},
            {"units", item.units},
            {"type", item.type},
            {"layers", item.layers},
            {"storage", item.storage},
            {"values", summary.values - summary.missing},
            {"missing", summary.missing},
            {"missingShare", summary.MissingShare()},
            {"minimum", JsonOf(summary.smallest)},
            {"maximum", JsonOf(summary.largest)}};
}

} // namespace

Status ReadGridInfo(CGridEditEngine& engine, ProgressPort& progress, GridInfo* info) {
    GridInfo read;
    read.grid = engine.Describe();
    const auto count = static_cast<long long>(read.grid.items.size());
    for (const GridItemDescription& item : read.grid.items) {
        progress.ShowProgress(item.number - 1, count);
        // Layers often lie interleaved, each as dear to read as all; the batch runs the first.
        if (engine.Summarise(item.number, 0, &read.summaries.emplace_back()) != kGridOk)
            return engine.LastError();
    }
    *info = std::move(read);
    return Status::Ok();
}

Json JsonOfGrid(const GridInfo& info) {
    const GridDescription& grid = info.grid;
    const bool hasSteps = grid.steps > 1; // the length of a single one is made up
    Json items = Json::array();
    for (std::size_t i = 0; i < grid.items.size(); ++i)
        items.push_back(JsonOfItem(grid.items[i], info.summaries[i]));
    return {{"title", grid.title},
            {"x", JsonOfAxis(grid.x)},
            {"y", JsonOfAxis(grid.y)},
            {"byIndex", grid.runsByIndex},
            {"count", grid.steps},
            {"first", JsonOf(DateOf(grid.first))},
            {"last", JsonOf(DateOf(grid.last))},
            {"step", hasSteps && grid.hasEqualSteps ? JsonOf(grid.stepSeconds) : Json(nullptr)},
            {"meanStep", hasSteps ? JsonOf(grid.stepSeconds) : Json(nullptr)},
            {"timeUnits", grid.timeUnits},
            {"calendar", grid.calendar},
            {"deleteValue", JsonOf(grid.deleteValue)},
            {"notes", grid.notes},
            {"items", std::move(items)}};
}

void PrintGrid(std::ostream& out, const GridInfo& info, const std::string& name) {
    out << PlainLine(name) << '\n';
    PrintHead(out, info.grid);
    for (std::size_t i = 0; i < info.grid.items.size(); ++i)
        PrintItem(out, info.grid.items[i], info.summaries[i]);
}

} // namespace ryn::cli
