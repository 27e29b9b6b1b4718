#pragma once

#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn show`: prints an output page of an analysis that was run.
struct ShowOptions {
    std::string file;
    int page = 0; ///< 12 or 14
};

int RunShow(const ShowOptions& options, Console& console);
void AddShowCommand(CommandLine& line);

} // namespace ryn::cli
