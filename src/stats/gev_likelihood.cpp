#include "stats/checked.h"
#include "stats/gev_profile.h"
#include "stats/likelihood_estimators.h"
#include "stats/shape_functions.h"

#include <cmath>
#include <optional>

namespace ryn::stats {

namespace {

using Side = GevProfile::Side;

// Both walks begin at the Gumbel fit, so that each keeps to the path of the best scales. Profiles
// with two maxima have them 0.4 and more apart; towards an upper bound they are steeper.
std::optional<Peak> HighestPeak(std::span<const double> deviations) {
    constexpr double kLargestShape = 0.98;
    PeakSearch search;
    search.Walk(GevProfile(deviations, Side::UpperBound), 0, kLargestShape, 6);
    search.Walk(GevProfile(deviations, Side::LowerBound), 0, -kLargestShape, 4);
    return search.Highest();
}

} // namespace

// The Gumbel fit is the point of the profile at kappa = 0. Its location lies inside the sample, and
// its scale makes the unknowns free of units.
Outcome<Gev> MostLikelyGev(std::span<const double> values, LikelihoodBuffer& buffer) {
    const auto gumbel = MostLikelyGumbel(values, buffer);
    if (!gumbel) {
        return gumbel.Failure();
    }
    const LocationScale& unit = gumbel->Values();
    buffer.clear();
    for (const double x : values) {
        buffer.push_back((x - unit.xi) / unit.alpha);
    }
    const auto peak = HighestPeak(buffer);
    if (!peak) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    // y = t + ln mean(exp(-t)) is the reduced variate: 0 at xi, with slope 1/alpha there.
    const double kappa = peak->place;
    const auto [b, logMeanWeight] =
        GevProfile(buffer, kappa > 0 ? Side::UpperBound : Side::LowerBound).RestAt(kappa);
    const double alpha = unit.alpha * std::exp(kappa * logMeanWeight) / b;
    const double xi = unit.xi + unit.alpha * StandardOfReduced(-logMeanWeight, kappa) / b;
    return Checked(Gev::Make({xi, alpha, kappa}));
}

} // namespace ryn::stats
