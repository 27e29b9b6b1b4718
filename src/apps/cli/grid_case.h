#pragma once

#include "apps/cli/case_file.h"
#include "base/status.h"

namespace ryn::cli {

/// What of an analysis would go wrong at the first point of a batch over a grid, and at every
/// other.
Status TestGridSettings(CaseFile& file);

/// Whether the grid can be read, and has the item and the ranges that are asked for.
Status TestGridPlan(CaseFile& file);

} // namespace ryn::cli
