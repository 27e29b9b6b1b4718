#pragma once

#include <optional>
#include <string>
#include <vector>

#include "apps/cli/data_file.h"
#include "apps/cli/json_output.h"
#include "base/ole_date_time.h"
#include "base/status.h"

namespace ryn::cli {

/// A value with its time step. Invalid date: there is none.
struct DatedValue {
    COleDateTime date;
    float value = 0.0F;
};

/// What one item of a data file holds. Missing values are left out.
struct ItemExtent {
    DataItem item;
    int valueCount = 0;
    int missingCount = 0;
    DatedValue first;
    DatedValue last;
    DatedValue minimum; ///< of equal values the earliest
    DatedValue maximum;
};

/// What a data file holds.
struct SeriesInfo {
    std::string title;
    /// Equidistant also for an axis that the file stores time by time, as other programs do, when
    /// it has a step.
    AxisKind axis = AxisKind::EquidistantRelative;
    /// Seconds from time step to time step, where they are equal to half a second and a tenth of
    /// themselves. Two time steps alone make no step on an axis stored time by time.
    std::optional<double> step;
    int stepCount = 0;
    COleDateTime first; ///< time step
    COleDateTime last;
    COleDateTime gapFrom; ///< the longest time between two steps that follow each other
    COleDateTime gapTo;
    int backwardSteps = 0; ///< steps that do not lie after the one before them
    std::vector<ItemExtent> items;
};

/// Reads a data file in one pass.
Status ReadSeriesInfo(const std::string& path, ProgressPort& progress, SeriesInfo* info);

Json JsonOfSeries(const SeriesInfo& info);
/// For people; `name` is the file's.
void PrintSeries(std::ostream& out, const SeriesInfo& info, const std::string& name);

} // namespace ryn::cli
