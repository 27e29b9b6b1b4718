#pragma once

#include "stats/distribution.h"
#include "stats/fit.h"

#include <cstddef>
#include <span>
#include <vector>

namespace ryn::stats {

// How well a fitted distribution agrees with its sample. Six measures: the two tests and the
// information criterion here, three that need plotting positions in stats/probability_plot.h, and
// the log-likelihood, which comes with the fit (FittedModel::logLikelihood).
//
// Levels are in percent. They take the parameters as known; with parameters fitted to the same
// sample they are too high.

/// One class of the chi-squared test.
struct ChiSquaredClass {
    double lower = 0; ///< quantile of j/k; an end of the support for the first
    double upper = 0;
    std::size_t observed = 0;
    double contribution = 0; ///< (observed - expected)^2/expected
};

struct ChiSquaredTest {
    std::vector<ChiSquaredClass> classes; ///< k, each as probable as the other
    double expected = 0;                  ///< n/k, the same in each
    std::size_t degreesOfFreedom = 0;     ///< k - 1 - p, at least 1
    double statistic = 0;                 ///< NaN for fewer values than classes
    double level = 0;                     ///< percent; NaN likewise
};

/// Chi-squared test with equiprobable classes, of which there are
/// max(min(floor(n/5), ceil(2 n^0.4)), p + 2) for p estimated parameters (Moore 1986). Values
/// outside the support fall into the first or the last class. Values finite, any order.
ChiSquaredTest ChiSquaredTestOf(const Distribution& d, std::span<const double> values);

struct KolmogorovSmirnovTest {
    double statistic = 0; ///< D, the largest distance of the two step functions; NaN for no values
    double level = 0;     ///< percent
    std::size_t rank = 0; ///< ascending rank of the value at which D occurs, the first if several
    double at = 0;        ///< that value
    double cdf = 0;       ///< F there
    double empirical = 0; ///< the sample's step function there, on the side where D occurs
};

/// Level by Stephens's (1970) modification of D. `sorted` must be ascending.
KolmogorovSmirnovTest KolmogorovSmirnovTestOf(const Distribution& d,
                                              std::span<const double> sorted);

/// The probability that Kolmogorov's limit distribution exceeds `x`: 1 for x <= 0.
double KolmogorovSurvival(double x);

/// Akaike's information criterion 2p - 2 ln L; NaN where the log-likelihood is.
double AkaikeCriterion(const FittedModel& model);

} // namespace ryn::stats
