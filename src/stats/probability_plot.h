#pragma once

#include "stats/distribution.h"
#include "stats/plotting_position.h"

#include <span>
#include <vector>

namespace ryn::stats {

/// A sample beside a distribution fitted to it; all lists ascend and are of one length.
struct ProbabilityPlot {
    std::vector<double> observed;  ///< x(i)
    std::vector<double> positions; ///< p(i), non-exceedance probabilities
    std::vector<double> quantiles; ///< the distribution's quantile of p(i)
};

/// `sorted` must be ascending.
ProbabilityPlot ProbabilityPlotOf(const Distribution& d, std::span<const double> sorted,
                                  PlottingMethod method);

/// Standard least-squares criterion.
struct LeastSquaresCriterion {
    double criterion = 0;   ///< about 0.02 for a good fit, above 0.04 for a poor one
    double lowVariate = 0;  ///< s*(0.01), standard variate of the quantile of 0.01
    double highVariate = 0; ///< s*(0.99)
};

/// SLSC: the root mean square difference of the standard variates of x(i) and of the quantile of
/// p(i), over s*(0.99) - s*(0.01) (Takara and Takasao 1988). NaN where a variate is not finite, as
/// that of a value below the lower bound of a log-normal distribution.
LeastSquaresCriterion LeastSquaresCriterionOf(const Distribution& d, const ProbabilityPlot& plot);

/// PPCC I: the correlation of x(i) and the quantile of p(i) (Filliben 1975; Vogel 1986; Kinnison
/// 1989). NaN where a term is not finite, or one side has no spread.
double PlotCorrelation(const ProbabilityPlot& plot);

/// PPCC II: the correlation of the reduced variates u(x(i)) and u(p(i)), on the paper where the
/// fitted curve is a straight line. NaN as PlotCorrelation.
double ReducedPlotCorrelation(const Distribution& d, const ProbabilityPlot& plot);

} // namespace ryn::stats
