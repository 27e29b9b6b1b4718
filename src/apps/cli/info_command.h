#pragma once

#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn info`: what a data, grid, parameter or result file holds.
struct InfoOptions {
    std::string file;
    OutputForm form = OutputForm::Text;
};

int RunInfo(const InfoOptions& options, Console& console);
void AddInfoCommand(CommandLine& line);

} // namespace ryn::cli
