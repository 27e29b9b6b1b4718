#include "stats/checked.h"
#include "stats/exceedances.h"
#include "stats/likelihood_estimators.h"
#include "stats/profile_maximum.h"

#include <array>
#include <cmath>

namespace ryn::stats {

namespace {

// Grimshaw's (1993) profile, with theta = kappa/alpha and the exceedances as shares p of the
// largest:
//     kappa = -mean ln(1 - theta p),  alpha = kappa/theta,  l/n = -ln alpha - 1 + kappa
// The unknown is v with theta = 1 - exp(-v). In it the profile is as smooth towards the bound
// theta = 1 as towards heavy tails, and 1 - theta p = 1 - p + p exp(-v) cancels nowhere.
class ParetoProfile {
  public:
    explicit ParetoProfile(std::span<const double> sharesOfLargest) : shares(sharesOfLargest) {
        for (const double p : shares) {
            double power = 1 / static_cast<double>(shares.size());
            for (double& mean : powers) {
                power *= p;
                mean += power;
            }
        }
    }

    double Kappa(double v) const;
    double Alpha(double v) const;
    ProfilePoint operator()(double v) const;

  private:
    /// A quantity and its derivatives in v.
    struct Jet {
        double value = 0;
        double first = 0;
        double second = 0;
    };

    Jet KappaJet(double v) const;
    Jet LogAlphaJet(double v, const Jet& kappa) const;

    std::span<const double> shares;
    std::array<double, 5> powers{}; ///< means of p to p^5
};

ParetoProfile::Jet ParetoProfile::KappaJet(double v) const {
    const double scale = std::exp(-v);
    Jet sum;
    for (const double p : shares) {
        const double q = (1 - p) + p * scale;
        const double r = p * scale / q;
        sum.value -= std::log(q);
        sum.first += r;
        sum.second += r * r - r;
    }
    const auto n = static_cast<double>(shares.size());
    return {sum.value / n, sum.first / n, sum.second / n};
}

// alpha = kappa/theta has a removable gap at theta = 0, around which its power series
// sum mean(p^j) theta^(j-1)/j is used; five terms leave 1e-15 at 1e-3.
ParetoProfile::Jet ParetoProfile::LogAlphaJet(double v, const Jet& kappa) const {
    const double theta = -std::expm1(-v);
    const double d = std::exp(-v); // d theta/dv, and minus the second derivative
    if (std::abs(v) >= 1e-3) {
        const double k = kappa.first / kappa.value;
        const double t = d / theta;
        return {std::log(kappa.value / theta), k - t,
                kappa.second / kappa.value - k * k + t + t * t};
    }
    Jet alpha; // in theta
    for (std::size_t j = powers.size(); j-- > 0;) {
        alpha.second = alpha.second * theta + 2 * alpha.first;
        alpha.first = alpha.first * theta + alpha.value;
        alpha.value = alpha.value * theta + powers[j] / static_cast<double>(j + 1);
    }
    const double first = alpha.first / alpha.value;
    return {std::log(alpha.value), first * d,
            (alpha.second / alpha.value - first * first) * d * d - first * d};
}

double ParetoProfile::Kappa(double v) const {
    const double theta = -std::expm1(-v);
    return std::abs(v) < 1e-3 ? Alpha(v) * theta : KappaJet(v).value;
}

double ParetoProfile::Alpha(double v) const {
    return std::exp(LogAlphaJet(v, KappaJet(v)).value);
}

ProfilePoint ParetoProfile::operator()(double v) const {
    const Jet kappa = KappaJet(v);
    const Jet logAlpha = LogAlphaJet(v, kappa);
    return {kappa.value - logAlpha.value - 1, kappa.first - logAlpha.first,
            kappa.second - logAlpha.second};
}

// kappa rises with v, and the likelihood is bounded for kappa < 1 only. theta ends at -1000 over
// the mean exceedance and at 0.999999 over the largest.
Bracket DomainOf(const ParetoProfile& profile, double largestOverMean) {
    const double lowest = -std::log1p(1000 * largestOverMean);
    const double highest = -std::log(1e-6);
    if (profile.Kappa(highest) < 1) {
        return {lowest, highest};
    }
    const auto excess = [&](double v) { return profile.Kappa(v) - 1; };
    return {lowest, Root(excess, {lowest, highest}).value_or(highest)};
}

} // namespace

// An end of the domain that stands higher than every maximum inside means that there is none worth
// the name: a bounded sample that asks for kappa > 1, or many values at the threshold.
Outcome<GeneralisedPareto> MostLikelyParetoAbove(double threshold, std::span<const double> values,
                                                 LikelihoodBuffer& buffer) {
    const auto exceedances = ExceedancesOf(values, threshold, ZeroExceedances::Kept, buffer);
    if (!exceedances) {
        return exceedances.Failure();
    }
    // The bound of theta then is 1, whatever the sample.
    for (double& y : buffer) {
        y /= exceedances->largest;
    }
    const ParetoProfile profile(buffer);
    const Bracket domain = DomainOf(profile, exceedances->largest);
    constexpr double kStep = 0.8;
    PeakSearch search;
    search.Walk(profile, domain.lower, domain.upper,
                static_cast<int>((domain.upper - domain.lower) / kStep) + 1);
    if (!search.Highest() || search.Highest()->value < search.HighestEnd()) {
        return FitFailure{FitFault::NoInteriorMaximum};
    }
    const double v = search.Highest()->place;
    const double unit = exceedances->largest * exceedances->mean;
    return Checked(GeneralisedPareto::Make({threshold, unit * profile.Alpha(v), profile.Kappa(v)},
                                           LocationType::Fixed));
}

} // namespace ryn::stats
