#pragma once

#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn extract`: selects the extreme value series of an analysis, writes the series file, takes it
/// over into DefineEVS and saves the analysis.
struct ExtractOptions {
    std::string file;
    OutputForm form = OutputForm::Text;
    Consent consent = Consent::NotGiven;
};

int RunExtract(const ExtractOptions& options, Console& console);
void AddExtractCommand(CommandLine& line);

/// Years as "1961, 1963-1965".
std::string YearRanges(const std::vector<int>& years);

} // namespace ryn::cli
