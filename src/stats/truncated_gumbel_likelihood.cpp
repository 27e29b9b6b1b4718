#include "stats/checked.h"
#include "stats/exceedances.h"
#include "stats/likelihood_estimators.h"
#include "stats/profile_maximum.h"

#include <cmath>

namespace ryn::stats {

namespace {

// 1/c - 1/(exp(c) - 1) for c > 0, which falls from 1/2 to 0, with its derivative. Below 0.2 the
// direct forms lose digits, and the power series leaves 1e-14.
struct MeanAndSlope {
    double value;
    double slope;
};

MeanAndSlope ExpectedMeanAt(double c) {
    const double s = c * c;
    if (c < 0.2) {
        return {0.5 - c * (1.0 / 12 - s * (1.0 / 720 - s * (1.0 / 30240 - s / 1209600))),
                -1.0 / 12 + s * (1.0 / 240 - s * (1.0 / 6048 - s / 172800))};
    }
    const double sinh = std::sinh(c / 2);
    return {1 / c - 1 / std::expm1(c), -1 / s + 1 / (4 * sinh * sinh)};
}

// The c with that mean, 0 < mean < 1/2, from Cohen's (1991) approximation of the inverse Langevin
// function, 1 - 2 mean being that function of c/2; it is 5 % off at most, and Newton's method on a
// convex function cannot miss from there.
double CWithMean(double mean) {
    const double y = 1 - 2 * mean;
    double c = y * (3 - y * y) / (2 * mean * (1 - mean));
    for (int i = 0; i < 20; ++i) {
        const auto [value, slope] = ExpectedMeanAt(c);
        const double step = (mean - value) / slope;
        c += step;
        if (!(std::abs(step) > 1e-14 * c)) {
            break;
        }
    }
    return c;
}

// exp(-20): below this the distribution cannot be told from the exponential, its limit for c = 0.
constexpr double kSmallestC = 2.061153622438558e-9;

// The Gumbel distribution with alpha and xi, given that a value exceeds the threshold by y > 0, has
// with z = y/alpha and c = exp((xi - threshold)/alpha) the density
//     ln f = -ln alpha - z - c exp(-z) + ln(c/(1 - exp(-c)))
// At a given alpha the best c has 1/c - 1/(exp(c) - 1) = mean(exp(-z)); where the mean reaches 1/2
// there is none, and the best is c = 0, the exponential.
class TruncatedGumbelProfile {
  public:
    explicit TruncatedGumbelProfile(std::span<const double> exceedancesOverMean)
        : exceedances(exceedancesOverMean) {}

    /// The best c at ln alpha; 0 for the exponential.
    double CAt(double logAlpha) const { return BestC(MeansAt(std::exp(-logAlpha)).w); }

    ProfilePoint operator()(double logAlpha) const;

  private:
    /// Means of w = exp(-z), z w and z^2 w.
    struct Means {
        double w = 0, zw = 0, zzw = 0;
    };

    Means MeansAt(double rate) const;

    static double BestC(double meanW) {
        const double c = meanW < 0.5 ? CWithMean(meanW) : 0.0;
        return c > kSmallestC ? c : 0.0;
    }

    std::span<const double> exceedances;
};

TruncatedGumbelProfile::Means TruncatedGumbelProfile::MeansAt(double rate) const {
    Means means;
    for (const double y : exceedances) {
        const double z = rate * y;
        const double w = std::exp(-z);
        means.w += w;
        means.zw += z * w;
        means.zzw += z * z * w;
    }
    const auto n = static_cast<double>(exceedances.size());
    return {means.w / n, means.zw / n, means.zzw / n};
}

// Derivatives in ln alpha: z' = -z, and c' follows mean(w)' = mean(z w).
ProfilePoint TruncatedGumbelProfile::operator()(double logAlpha) const {
    const double rate = std::exp(-logAlpha); // the mean of z too
    const Means means = MeansAt(rate);
    const double c = BestC(means.w);
    if (c == 0) {
        return {-logAlpha - rate, rate - 1, -rate};
    }
    const double cSlope = means.zw / ExpectedMeanAt(c).slope;
    return {-logAlpha - rate - c * means.w + std::log(-c / std::expm1(-c)), rate - 1 - c * means.zw,
            -rate - c * (means.zzw - means.zw) - cSlope * means.zw};
}

} // namespace

Outcome<TruncatedGumbelFit> MostLikelyTruncatedGumbel(double threshold,
                                                      std::span<const double> values,
                                                      LikelihoodBuffer& buffer) {
    const auto exceedances = ExceedancesOf(values, threshold, ZeroExceedances::Kept, buffer);
    if (!exceedances) {
        return exceedances.Failure();
    }
    const TruncatedGumbelProfile profile(buffer);
    PeakSearch search;
    search.Walk(profile, std::log(0.05), std::log(20), 12);
    // The exponential with the mean of the sample is a maximum of its own where it is the limit
    // there; with a minimum close by it is no change of sign for the walk.
    if (profile.CAt(0) == 0) {
        search.Note({0, profile(0).value});
    }
    if (!search.Highest() || search.Highest()->value < search.HighestEnd()) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    const double logAlpha = search.Highest()->place;
    const double c = profile.CAt(logAlpha);
    const double alpha = exceedances->mean * std::exp(logAlpha);
    const double xi = threshold + alpha * (c > 0 ? std::log(c) : -20);
    const auto made = Checked(TruncatedGumbel::Make({xi, alpha}, threshold));
    if (!made) {
        return made.Failure();
    }
    return TruncatedGumbelFit{*made, c > 0 ? TruncatedTail::Gumbel : TruncatedTail::Exponential};
}

} // namespace ryn::stats
