#pragma once

#include <span>
#include <string>

#include "stats/fit.h"

/// What a fit has to say, in the language of the command line.
namespace ryn::cli {

/// Why a combination could not be fitted to values: the log's code and one line, "C03: too few
/// values: ...". Of values that are all equal it says so, where the log names the statistics that
/// they have none of.
std::string FitFailureText(const stats::FitFailure& failure, std::span<const double> values);

/// One line, as the log's.
std::string FitWarningText(const stats::FitWarning& warning);

} // namespace ryn::cli
