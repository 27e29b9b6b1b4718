#pragma once

#include <optional>
#include <string>

#include "apps/cli/command_line.h"
#include "apps/cli/console.h"

namespace ryn::cli {

/// `ryn fit`: one combination of distribution and estimation method fitted to a column of numbers
/// or to a data file, with its quantiles.
struct FitOptions {
    std::string name;                   ///< of the combination: "GEV/LMOM"
    std::string values;                 ///< a text, a data file, or "-" for standard input
    std::optional<int> item;            ///< of a data file, from 1; none: the first
    std::optional<std::string> periods; ///< "2,10,100" in years
    bool partialDurations = false;      ///< with rate and threshold; else annual maxima
    std::optional<double> rate;         ///< events a year
    std::optional<double> threshold;    ///< in the unit of the values
    OutputForm form = OutputForm::Text;
};

/// kExitAnalysis when the combination cannot be fitted.
int RunFit(const FitOptions& options, Console& console);
void AddFitCommand(CommandLine& line);

} // namespace ryn::cli
