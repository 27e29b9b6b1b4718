#pragma once

#include <string>

#include "engine/analysis.h"

namespace ryn {

/// What a user should know of results that stand, as the log's warnings.

/// Tests that could not be made, and return periods that have no event.
Sentences SeriesWarnings(const EngineInput& input, const SeriesResults& series);

/// Of a combination that was fitted: the fit's own warnings, and quantiles or uncertainties that
/// could not be computed. Each begins with `label`, the combination's name.
Sentences CombinationWarnings(const std::string& label, const SeriesResults& series,
                              const CombinationResults& results);

/// Why a combination could not be fitted: "failed: REASON (CODE)".
std::string FailureSentence(const stats::FitFailure& failure);

} // namespace ryn
