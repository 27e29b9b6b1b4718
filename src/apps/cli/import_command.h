#pragma once

#include <string>
#include <vector>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"
#include "import/import_options.h"

namespace ryn::cli {

/// `ryn import`: a table of text, or a netCDF file of another program, as a data file. It says what
/// it took the table for and what it left out.
struct ImportCommandOptions {
    std::string input;
    std::string output;
    ImportOptions table;            ///< what the user says about the table; the rest is found out
    std::vector<std::string> units; ///< one for all items, or one for each of --item
    std::vector<std::string> names; ///< one for each item
    OutputForm form = OutputForm::Text;
    Consent consent = Consent::NotGiven;
};

int RunImport(const ImportCommandOptions& options, Console& console);
void AddImportCommand(CommandLine& line);

} // namespace ryn::cli
