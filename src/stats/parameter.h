#pragma once

#include "stats/fixed_list.h"

#include <string_view>

namespace ryn::stats {

/// Whether the location of a distribution is known beforehand (0, or the threshold of a partial
/// duration series) or estimated from the sample. The numbers are those of the setup file.
enum class LocationType { Fixed = 0, Estimated = 1 };

/// One parameter of a distribution.
struct Parameter {
    std::string_view symbol; ///< ASCII word: xi, alpha, kappa, mu, sigma, a or b
    double value = 0;
    bool estimated = true; ///< false for a location that was given
};

/// All parameters of a distribution, in the order in which results list them.
using ParameterList = FixedList<Parameter, 3>;
/// The symbols alone, where there is no fit to take values from.
using SymbolList = FixedList<std::string_view, 3>;

/// Values of a location and scale family, in the unit of the series.
struct LocationScale {
    double xi = 0;    ///< location; finite
    double alpha = 1; ///< scale; finite, > 0
};

/// Values of a family with one shape parameter.
struct LocationScaleShape {
    double xi = 0;    ///< location; finite
    double alpha = 1; ///< scale; finite, > 0 (Pearson 3 and log-Pearson 3: not 0)
    double kappa = 0; ///< shape, without unit; its sign and range are the family's
};

/// Values of a family with a known lower bound and one shape parameter.
struct ScaleShape {
    double alpha = 1; ///< scale; finite, > 0
    double kappa = 1; ///< shape, without unit; finite, > 0
};

/// Values of the log-normal distribution.
struct LowerBoundMeanDeviation {
    double xi = 0;    ///< lower bound; finite
    double mu = 0;    ///< mean of ln(x - xi); finite
    double sigma = 1; ///< standard deviation of ln(x - xi); finite, > 0
};

/// Values of the square-root exponential distribution.
struct SquareRootParameters {
    double a = 1; ///< -ln of the probability of 0, without unit; finite, > 0
    double b = 1; ///< in one over the unit of the series; finite, > 0
};

} // namespace ryn::stats
