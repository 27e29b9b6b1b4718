#pragma once

#include <optional>
#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn export`: a data file as a table of text. A heading line, then one line for each time step:
/// time as YYYY-MM-DDTHH:MM:SS, and for each item the shortest text that reads back as the same
/// 32-bit number; empty where the file marks a value as missing.
struct ExportOptions {
    std::string file;
    std::optional<int> item;           ///< from 1; none: all that are plain series
    std::optional<std::string> output; ///< a file; none or "-": standard output
    Consent consent = Consent::NotGiven;
};

int RunExport(const ExportOptions& options, Console& console);
void AddExportCommand(CommandLine& line);

} // namespace ryn::cli
