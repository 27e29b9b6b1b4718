#pragma once

#include <string>

#include "apps/cli/case_arguments.h"
#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn set`: changes settings of an analysis.
struct SetOptions {
    std::string file; ///< read in the spelling that exists; saved as .RYN
    CaseArguments arguments;
    Consent consent = Consent::NotGiven;
};

int RunSet(const SetOptions& options, Console& console);
void AddSetCommand(CommandLine& line);

} // namespace ryn::cli
