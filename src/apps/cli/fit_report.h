#pragma once

#include <iosfwd>
#include <optional>
#include <string>
#include <vector>

#include "apps/cli/json_output.h"
#include "stats/fit.h"

namespace ryn::cli {

/// The event of one return period.
struct FitQuantile {
    double period = 0.0;     ///< years
    double exceedance = 0.0; ///< probability that an event of the series exceeds it
    double estimate = 0.0;   ///< in the unit of the values
};

/// What a fit came to.
struct FitReport {
    std::string name;
    std::size_t count = 0;
    std::string unit;    ///< of the values; empty where none is known
    std::string failure; ///< empty: fitted
    std::optional<stats::FittedModel> model;
    std::vector<FitQuantile> quantiles;
};

/// Members: name, n, unit, failed (null or the reason), parameters (symbol, estimate),
/// logLikelihood, quantiles (period, probability of exceedance, estimate, average,
/// standardDeviation; the last two are null, since no uncertainty was estimated), goodness.
Json JsonOfFit(const FitReport& report);
void PrintFit(std::ostream& out, const FitReport& report);

/// Decimals that show a value with so many significant digits; 0 to 12.
int DecimalsFor(double value, int significantDigits);

} // namespace ryn::cli
