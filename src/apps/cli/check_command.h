#pragma once

#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn check`: the findings of an analysis, one a line with the page that they belong to.
struct CheckOptions {
    std::string file;
    OutputForm form = OutputForm::Text;
};

/// kExitInput when there are findings.
int RunCheck(const CheckOptions& options, Console& console);
void AddCheckCommand(CommandLine& line);

} // namespace ryn::cli
