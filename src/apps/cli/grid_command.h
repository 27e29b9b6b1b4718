#pragma once

#include <cstddef>
#include <optional>
#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"
#include "run/grid_batch.h"

namespace ryn::cli {

/// `ryn grid`: runs an analysis at each chosen point of a grid file and writes a grid file of the
/// results. Standard output has the batch's own lines; what was found besides, and why it ended
/// where it did, stands on standard error.
struct GridOptions {
    std::string file;
    Scratch scratch = Scratch::Memory;
    std::size_t memory = 0;   ///< bytes; 0 for a quarter of what the process may use
    std::optional<int> parts; ///< shares that the points are cut into
    std::optional<int> part;  ///< the share to run, from 1
    bool merge = false;       ///< makes the output of what the shares left
    std::optional<int> jobs;  ///< shares to run at once on this machine, then merged
};

int RunGrid(const GridOptions& options, Console& console);
void AddGridCommand(CommandLine& line);

} // namespace ryn::cli
