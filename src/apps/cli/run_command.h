#pragma once

#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn run`: the Run command. Saves the analysis, computes, writes the result file and prints the
/// quantiles with their standard deviations. A failed computation shows the end of the engine's
/// log and gives kExitAnalysis.
struct RunOptions {
    std::string file;
    OutputForm form = OutputForm::Text;
};

int RunRun(const RunOptions& options, Console& console);
void AddRunCommand(CommandLine& line);

} // namespace ryn::cli
