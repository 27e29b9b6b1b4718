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

// The walks need no more than the signs of the profile's slopes, and Newton's method in both
// unknowns does the rest. Should that go astray, the walks alone can do it.
struct Search {
    int upwards; ///< steps to the largest shape; towards an upper bound profiles are steeper
    int downwards;
    GevProfile::Closeness closeness;
    double precision;
};
constexpr Search kQuick{4, 3, {0.2, 0.1}, 0.02};
constexpr Search kThorough{6, 4, {0.03, 0.02}, 1e-9};

// The Gumbel fit is the point of the profile at kappa = 0. Its location lies inside the sample, and
// its scale makes the unknowns free of units.
GevProfile ProfileOn(Side side, std::span<const double> values, const LocationScale& gumbel,
                     std::span<double> deviations, const Search& search) {
    const double edge = EdgeOn(side, values);
    std::transform(values.begin(), values.end(), deviations.begin(),
                   [&](double x) { return (x - edge) / gumbel.alpha; });
    return {deviations, (edge - gumbel.xi) / gumbel.alpha, search.closeness};
}

struct Found {
    Side side;
    std::optional<GevProfile::Maximum> maximum; ///< none where Newton's method went astray
};

// Both walks begin at the Gumbel fit, so that each keeps to the path of the best scales. Profiles
// with two maxima have them 0.4 and more apart. For a summit at kappa = 0 rounding may make either
// walk leave it to the other. Nothing where no maximum is met.
std::optional<Found> HighestMaximum(std::span<const double> values, const LocationScale& gumbel,
                                    LikelihoodBuffer& buffer, const Search& search) {
    constexpr double kLargestShape = 0.98;
    const std::size_t count = values.size();
    buffer.resize(2 * count);
    const std::span<double> deviations(buffer);
    GevProfile upper = ProfileOn(Side::UpperBound, values, gumbel, deviations.first(count), search);
    GevProfile lower = ProfileOn(Side::LowerBound, values, gumbel, deviations.last(count), search);
    PeakSearch peaks(search.precision);
    const ProfilePoint up = peaks.Walk(upper, 0, kLargestShape, search.upwards);
    const ProfilePoint down = peaks.Walk(lower, 0, -kLargestShape, search.downwards);
    if (up.slope <= 0 && down.slope > 0 && up.curvature < 0) {
        peaks.Note({0, up.value});
    }
    if (!peaks.Highest()) {
        return std::nullopt;
    }
    const double kappa = peaks.Highest()->place;
    const Side side = kappa > 0 ? Side::UpperBound : Side::LowerBound;
    GevProfile& profile = side == Side::UpperBound ? upper : lower;
    auto maximum = profile.MaximumNear(kappa);
    if (maximum && (std::abs(maximum->kappa) > kLargestShape ||
                    std::abs(maximum->kappa - kappa) > 5 * kQuick.precision)) {
        maximum.reset(); // another place than the one that the walks met
    }
    if (!maximum && search.precision == kThorough.precision) {
        maximum = profile.PathAt(kappa);
    }
    return Found{side, maximum};
}

} // namespace

Outcome<Gev> MostLikelyGev(std::span<const double> values, LikelihoodBuffer& buffer) {
    const auto gumbel = MostLikelyGumbel(values, buffer);
    if (!gumbel) {
        return gumbel.Failure();
    }
    const LocationScale& unit = gumbel->Values();
    auto found = HighestMaximum(values, unit, buffer, kQuick);
    if (found && !found->maximum) {
        found = HighestMaximum(values, unit, buffer, kThorough);
    }
    if (!found || !found->maximum) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    // y = t + ln mean(exp(-t)) is the reduced variate: 0 at xi, with slope 1/alpha there.
    const auto [kappa, b, logMeanWeight] = *found->maximum;
    const double alpha = unit.alpha * std::exp(kappa * logMeanWeight) / b;
    const double xi =
        EdgeOn(found->side, values) + unit.alpha * StandardOfReduced(-logMeanWeight, kappa) / b;
    return Checked(Gev::Make({xi, alpha, kappa}));
}

} // namespace ryn::stats
