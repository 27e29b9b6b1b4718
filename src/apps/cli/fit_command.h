#pragma once

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"
#include "apps/cli/fit_task.h"

namespace ryn::cli {

/// `ryn fit`: combinations of distribution and estimation method fitted to a column of numbers or
/// to a data file, with their quantiles and how well they fit. kExitAnalysis when the series cannot
/// be analysed or no combination can be fitted; one that cannot among others that can is told.
int RunFit(const FitOptions& options, Console& console);
void AddFitCommand(CommandLine& line);

} // namespace ryn::cli
