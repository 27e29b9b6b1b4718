#pragma once

#include <string>
#include <vector>

#include "apps/cli/fit_report.h"
#include "stats/fit.h"

/// What a fit has to say, in the language of the command line.
namespace ryn::cli {

/// Why a combination could not be fitted: the log's code and one line, "C10: estimated ...".
std::string FitFailureText(const stats::FitFailure& failure);

/// One line, as the log's.
std::string FitWarningText(const stats::FitWarning& warning);

/// All that a fit that stands is to be read with, each one line: the warnings of the fit, events
/// beyond all numbers, and what has no uncertainty though it was asked for.
std::vector<std::string> FitWarnings(const FitReport& report);

} // namespace ryn::cli
