#include "apps/cli/grid_info.h"

#include <cmath>
#include <ostream>

#include "apps/cli/date_text.h"
#include "apps/cli/plain_text.h"
#include "apps/cli/text_table.h"
#include "base/number_text.h"
#include "grid/grid_edit.h"
#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string TextOf(int id) {
    return std::string(Text(id));
}

COleDateTime DateOf(const CQxDateTime& date) {
    return COleDateTime::FromLinearCount(date);
}

double SpacingOf(const GridAxisDescription& axis) {
    return axis.size > 1 ? (axis.last - axis.first) / (axis.size - 1) : 0.0;
}

/// As a float: files have many coordinates so, and as doubles they would show their rounding.
std::string CoordinateText(double value) {
    return ShortestText(static_cast<float>(value));
}

std::string AxisText(const GridAxisDescription& axis) {
    std::string text = std::to_string(axis.size);
    if (axis.first != 0.0 || axis.last != 0.0) {
        text += ": " + CoordinateText(axis.first) + " - " + CoordinateText(axis.last);
        if (!axis.units.empty())
            text += " " + axis.units;
    }
    if (!axis.isRegular)
        text += ", " + TextOf(kTextCliGridIrregular);
    else if (axis.size > 1)
        text += ", " + FormatText(kTextCliGridSpacing, CoordinateText(SpacingOf(axis)));
    if (axis.isTurned)
        text += ", " + TextOf(kTextCliGridTurned);
    return text;
}

std::string StepText(const GridDescription& grid) {
    const double days = grid.stepSeconds / 86400.0;
    const bool isWhole = grid.stepSeconds == std::round(grid.stepSeconds);
    const std::string length = grid.hasEqualSteps && isWhole
                                   ? LengthForPeople(COleDateTimeSpan(days))
                                   : FixedText(days, 3) + " d";
    return grid.hasEqualSteps ? length : FormatText(kTextCliGridMeanStep, length);
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
    if (!grid.calendar.empty())
        head.AddRow({TextOf(kTextCliGridCalendar), grid.calendar});
    head.AddRow({TextOf(kTextCliGridMark), ShortestText(grid.deleteValue)});
    head.Print(out);
}

void PrintItem(std::ostream& out, const GridItemDescription& item, const GridSummary& summary) {
    out << '\n' << FormatText(kTextCliItemHeading, item.number, PlainLine(item.name));
    if (!item.units.empty())
        out << " [" << PlainLine(item.units) << ']';
    out << '\n';
    TextTable table({Alignment::Left, Alignment::Left});
    table.AddRow({TextOf(kTextCliGridVariable), item.variable + "(" + item.storage + ")"});
    if (item.layers > 1)
        table.AddRow({TextOf(kTextCliGridLayers), FormatText(kTextCliGridFirstLayer, item.layers)});
    table.AddRow({TextOf(kTextCliMissing), FixedText(100.0 * summary.MissingShare(), 1) + " %"});
    if (summary.missing < summary.values) {
        table.AddRow({TextOf(kTextCliSmallest), ShortestText(summary.smallest)});
        table.AddRow({TextOf(kTextCliLargest), ShortestText(summary.largest)});
    }
    table.Print(out);
}

Json JsonOfAxis(const GridAxisDescription& axis, bool runsByIndex) {
    return {{"name", axis.name},
            {"units", axis.units},
            {"size", axis.size},
            {"first", JsonOf(axis.first)},
            {"last", JsonOf(axis.last)},
            {"spacing", axis.isRegular ? JsonOf(SpacingOf(axis)) : Json(nullptr)},
            {"turned", axis.isTurned},
            {"byIndex", runsByIndex}};
}

Json JsonOfItem(const GridItemDescription& item, const GridSummary& summary) {
    return {{"number", item.number},
            {"name", item.name},
            {"variable", item.variable},
            {"units", item.units},
            {"type", item.type},
            {"layers", item.layers},
            {"storage", item.storage},
            {"values", summary.values},
            {"missing", summary.missing},
            {"minimum", JsonOf(summary.smallest)},
            {"maximum", JsonOf(summary.largest)}};
}

} // namespace

Status ReadGridInfo(const std::string& path, ProgressPort& progress, GridInfo* info) {
    CGridEditEngine engine;
    if (engine.OpenFile(path, true) != kGridOk)
        return engine.LastError();
    GridInfo read;
    read.grid = engine.Describe();
    const auto count = static_cast<long long>(read.grid.items.size());
    for (const GridItemDescription& item : read.grid.items) {
        progress.ShowProgress(item.number - 1, count);
        if (engine.Summarise(item.number, 0, &read.summaries.emplace_back()) != kGridOk)
            return engine.LastError();
    }
    *info = std::move(read);
    return Status::Ok();
}

Json JsonOfGrid(const GridInfo& info) {
    const GridDescription& grid = info.grid;
    Json items = Json::array();
    for (std::size_t i = 0; i < grid.items.size(); ++i)
        items.push_back(JsonOfItem(grid.items[i], info.summaries[i]));
    return {{"title", grid.title},
            {"x", JsonOfAxis(grid.x, grid.runsByIndex)},
            {"y", JsonOfAxis(grid.y, grid.runsByIndex)},
            {"count", grid.steps},
            {"first", JsonOf(DateOf(grid.first))},
            {"last", JsonOf(DateOf(grid.last))},
            {"equalSteps", grid.hasEqualSteps},
            {"step", JsonOf(grid.stepSeconds)},
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
