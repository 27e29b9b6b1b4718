#pragma once

#include <string>

#include "apps/cli/case_arguments.h"
#include "apps/cli/command_line.h"
#include "apps/cli/console.h"
#include "apps/cli/grid_arguments.h"

namespace ryn::cli {

/// `ryn new`: makes the parameter file of an analysis.
struct NewOptions {
    std::string file; ///< named .ryn or .RYN; saved as .RYN
    CaseArguments arguments;
    GridArguments grid;
    Consent consent = Consent::NotGiven;
};

int RunNew(const NewOptions& options, Console& console);
void AddNewCommand(CommandLine& line);

} // namespace ryn::cli
