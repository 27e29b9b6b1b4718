#include "run/grid_plan.h"

#include <algorithm>
#include <climits>
#include <cstdint>

#include "base/path_parts.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr const char* kX = "X_Range_And_Interval";
constexpr const char* kY = "Y_Range_And_Interval";
constexpr const char* kTime = "Time_Range_And_Interval";

// Steps below 1 would end in a division by zero or in a loop without end.
Status TestRange(const char* keyword, const IndexRange& range) {
    if (range.first < 0 || range.last < range.first)
        return Status::InputFault(
            FormatText(kTextGridRangeBackward, keyword, range.first, range.last));
    if (range.step < 1)
        return Status::InputFault(FormatText(kTextGridStepBelowOne, keyword, range.step));
    return Status::Ok();
}

Status TestInside(const char* keyword, int first, int last, int size) {
    return last < size ? Status::Ok()
                       : Status::InputFault(
                             FormatText(kTextGridRangeOutside, keyword, first, last, size - 1));
}

Status First(std::initializer_list<Status> tests) {
    for (const Status& test : tests)
        if (!test)
            return test;
    return Status::Ok();
}

/// The same places by a step that no sum of places and steps takes out of 32 bits.
IndexRange Bounded(const IndexRange& range) {
    const std::int64_t size = static_cast<std::int64_t>(range.last) - range.first + 1;
    return {range.first, range.last, static_cast<int>(std::min<std::int64_t>(range.step, size))};
}

std::int64_t PlacesOf(const IndexRange& range) {
    return (static_cast<std::int64_t>(range.last) - range.first) / range.step + 1;
}

} // namespace

Status MakeGridPlan(const CTsq2InputKvf& input, const std::string& baseDirectory, GridPlan* plan) {
    if (input.Tsq2InputFile.empty())
        return Status::InputFault(FormatText(kTextGridFileNotNamed, "Tsq2InputFile"));
    if (input.Tsq2OutputFile.empty())
        return Status::InputFault(FormatText(kTextGridFileNotNamed, "Tsq2OutputFile"));
    // The third number of the time range is not used: every step enters the series.
    const IndexRange& time = input.Time_Range_And_Interval;
    if (Status fault = First({TestRange(kX, input.X_Range_And_Interval),
                              TestRange(kY, input.Y_Range_And_Interval),
                              TestRange(kTime, {time.first, time.last, 1})});
        !fault)
        return fault;
    plan->gridFile = FullPath(input.Tsq2InputFile, baseDirectory);
    plan->outputFile = FullPath(input.Tsq2OutputFile, baseDirectory);
    plan->title = input.Tsq2OutputFile;
    plan->item = input.Tsq2ItemNo;
    plan->x = Bounded(input.X_Range_And_Interval);
    plan->y = Bounded(input.Y_Range_And_Interval);
    plan->firstStep = time.first;
    plan->lastStep = time.last;
    return Status::Ok();
}

Status TestPlan(const GridPlan& plan, const CGridEditHeaderInfo& grid) {
    if (plan.item < 1 || plan.item > grid.Items())
        return Status::InputFault(FormatText(kTextGridItemMissing, plan.item, grid.Items()));
    if (Status fault =
            First({TestInside(kX, plan.x.first, plan.x.last, grid.SizeX()),
                   TestInside(kY, plan.y.first, plan.y.last, grid.SizeY()),
                   TestInside(kTime, plan.firstStep, plan.lastStep, grid.TimeStepPast())});
        !fault)
        return fault;
    return PlacesOf(plan.x) * PlacesOf(plan.y) <= INT_MAX
               ? Status::Ok()
               : Status::InputFault(std::string(Text(kTextGridTooManyPoints)));
}

} // namespace ryn
