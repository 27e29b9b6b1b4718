#pragma once

#include <iosfwd>
#include <string>
#include <vector>

#include "apps/cli/json_output.h"
#include "base/status.h"
#include "grid/grid_edit.h"
#include "ports/progress_port.h"

namespace ryn::cli {

/// What a grid file holds.
struct GridInfo {
    GridDescription grid;
    /// Of each item: its first layer, which the batch runs, over all steps.
    std::vector<GridSummary> summaries;
};

/// Reads from an open grid file its description and, for ranges and missing values, all of each
/// item's first layer.
Status ReadGridInfo(CGridEditEngine& engine, ProgressPort& progress, GridInfo* info);

Json JsonOfGrid(const GridInfo& info);
/// For people; `name` is the file's.
void PrintGrid(std::ostream& out, const GridInfo& info, const std::string& name);

} // namespace ryn::cli
