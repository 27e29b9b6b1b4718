#pragma once

#include <string>

#include "apps/cli/fit_report.h"
#include "apps/cli/fit_task.h"

namespace ryn::cli {

/// Why the series cannot be analysed whatever is fitted to it, by the rules of an analysis: fewer
/// than five values, one that is not finite, all equal, or one of partial durations below the
/// threshold by more than the rounding of a 32-bit float. One line with the values' source; empty
/// when it can.
std::string SeriesFault(const FitTask& task);

/// Fits one of the task's combinations to a series without fault.
FitReport FitOne(const FitTask& task, const NamedFit& fit);

/// The report of a combination that was not even tried.
FitReport UnfittedReport(const FitTask& task, const NamedFit& fit, const std::string& failure);

} // namespace ryn::cli
