#pragma once

#include <string>

#include "stats/fit_outcome.h"

namespace ryn::cli {

/// Why a combination could not be fitted, in the user's language: "C03: too few values: ...".
std::string FitFailureText(const stats::FitFailure& failure);
/// What a fit is to be read with, in the user's language.
std::string FitWarningText(const stats::FitWarning& warning);

} // namespace ryn::cli
