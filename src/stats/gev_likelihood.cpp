#include "stats/checked.h"
#include "stats/gev_profile.h"
#include "stats/likelihood_estimators.h"
#include "stats/shape_functions.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace ryn::stats {

namespace {

// What ends of the support there can be, with the value next to them.
enum class Side { UpperBound, LowerBound };

double EdgeOn(Side side, std::span<const double> values) {
    return side == Side::UpperBound ? *std::max_element(values.begin(), values.end())
                                    : *std::min_element(values.begin(), values.end());
}

// The Gumbel fit is the point of the profile at kappa = 0. Its location lies inside the sample, and
// its scale makes the unknowns free of units.
GevProfile ProfileOn(Side side, std::span<const double> values, const LocationScale& gumbel,
                     LikelihoodBuffer& buffer) {
    const double edge = EdgeOn(side, values);
    buffer.clear();
    for (const double x : values) {
        buffer.push_back((x - edge) / gumbel.alpha);
    }
    return {buffer, (edge - gumbel.xi) / gumbel.alpha};
}

// Both walks begin at the Gumbel fit, so that each keeps to the path of the best scales. Profiles
// with two maxima have them 0.4 and more apart; towards an upper bound they are steeper. For a
// summit at kappa = 0 rounding may make either walk leave it to the other.
std::optional<Peak> HighestPeak(std::span<const double> values, const LocationScale& gumbel,
                                LikelihoodBuffer& buffer) {
    constexpr double kLargestShape = 0.98;
    PeakSearch search;
    const ProfilePoint up =
        search.Walk(ProfileOn(Side::UpperBound, values, gumbel, buffer), 0, kLargestShape, 6);
    const ProfilePoint down =
        search.Walk(ProfileOn(Side::LowerBound, values, gumbel, buffer), 0, -kLargestShape, 4);
    if (up.slope <= 0 && down.slope > 0) {
        search.Note({0, up.value});
    }
    return search.Highest();
}

} // namespace

Outcome<Gev> MostLikelyGev(std::span<const double> values, LikelihoodBuffer& buffer) {
    const auto gumbel = MostLikelyGumbel(values, buffer);
    if (!gumbel) {
        return gumbel.Failure();
    }
    const LocationScale& unit = gumbel->Values();
    const auto peak = HighestPeak(values, unit, buffer);
    if (!peak) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    // y = t + ln mean(exp(-t)) is the reduced variate: 0 at xi, with slope 1/alpha there.
    const double kappa = peak->place;
    const Side side = kappa > 0 ? Side::UpperBound : Side::LowerBound;
    const auto [b, logMeanWeight] = ProfileOn(side, values, unit, buffer).RestAt(kappa);
    const double alpha = unit.alpha * std::exp(kappa * logMeanWeight) / b;
    const double xi =
        EdgeOn(side, values) + unit.alpha * StandardOfReduced(-logMeanWeight, kappa) / b;
    return Checked(Gev::Make({xi, alpha, kappa}));
}

} // namespace ryn::stats
