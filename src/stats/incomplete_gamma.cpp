#include "stats/incomplete_gamma.h"

#include "stats/quiet_policy.h"

#include <boost/math/special_functions/gamma.hpp>
#include <boost/math/special_functions/log1p.hpp>

#include <array>
#include <cmath>
#include <cstddef>
#include <numbers>

namespace ryn::stats {

namespace {

// Temme's uniform expansion (1979; DLMF 8.12): with eta^2/2 = z/k - 1 - ln(z/k), eta signed like
// z - k,
//     Q = erfc(eta sqrt(k/2))/2 + S,   P = erfc(-eta sqrt(k/2))/2 - S
//     S = exp(-k eta^2/2)/sqrt(2 pi k) sum c_j(eta) k^-j
// Both keep their relative accuracy in their own tail. Six terms are exact to a double from here
// on, each as a power series in eta that is good to the largest |eta|.
constexpr double kExpandedFrom = 200;
constexpr double kLargestEta = 0.8;
constexpr std::size_t kTerms = 6;
constexpr std::size_t kPowers = 28;

using Series = std::array<double, kPowers>;

// With mu = z/k - 1 = sum a_n eta^n, from mu mu' = eta (1 + mu):
//     a_1 = 1,   (n + 1) a_n = a_(n-1) - sum over 2 <= j < n of j a_j a_(n+1-j)
// and c_0 = 1/mu - 1/eta = mu'/eta - 1 - 1/eta, so that its coefficient of eta^m is (m + 2) a_(m+2)
// but for the 1.
constexpr Series FirstSeries() {
    std::array<double, kPowers + 2> a{0, 1};
    for (std::size_t n = 2; n < a.size(); ++n) {
        double sum = a[n - 1];
        for (std::size_t j = 2; j < n; ++j) {
            sum -= static_cast<double>(j) * a[j] * a[n + 1 - j];
        }
        a[n] = sum / static_cast<double>(n + 1);
    }
    Series c{};
    for (std::size_t m = 0; m < kPowers; ++m) {
        c[m] = static_cast<double>(m + 2) * a[m + 2];
    }
    c[0] -= 1;
    return c;
}

// c_j = c_(j-1)'/eta + s/mu, where s is what removes the pole at eta = 0. Each costs two powers;
// what is 0 at the end is not known.
constexpr std::array<Series, kTerms> AllSeries() {
    std::array<Series, kTerms> c{FirstSeries()};
    for (std::size_t j = 1; j < kTerms; ++j) {
        for (std::size_t m = 0; m + 2 * j < kPowers; ++m) {
            c[j][m] = static_cast<double>(m + 2) * c[j - 1][m + 2] - c[j - 1][1] * c[0][m];
        }
    }
    return c;
}

constexpr std::array<Series, kTerms> kSeries = AllSeries();

double Value(const Series& series, std::size_t powers, double eta) {
    double sum = 0;
    for (std::size_t m = powers; m-- > 0;) {
        sum = sum * eta + series[m];
    }
    return sum;
}

double CorrectionSum(double k, double eta) {
    double sum = 0;
    for (std::size_t j = kTerms; j-- > 0;) {
        sum = sum / k + Value(kSeries[j], kPowers - 2 * j, eta);
    }
    return sum;
}

enum class Tail { Lower, Upper };

double Expanded(Tail tail, double k, double eta) {
    const double sign = tail == Tail::Upper ? 1 : -1;
    const double correction =
        std::exp(-k * eta * eta / 2) / std::sqrt(2 * std::numbers::pi * k) * CorrectionSum(k, eta);
    return std::erfc(sign * eta * std::sqrt(k / 2)) / 2 + sign * correction;
}

double Direct(Tail tail, double k, double z) {
    return tail == Tail::Lower ? boost::math::gamma_p(k, z, QuietPolicy())
                               : boost::math::gamma_q(k, z, QuietPolicy());
}

// Q and P are 0 and 1 above k, or the reverse.
double Extreme(Tail tail, double k, double z) {
    return (z > k) == (tail == Tail::Lower) ? 1 : 0;
}

double Gamma(Tail tail, double k, double z) {
    if (std::isinf(z) && z > 0) {
        return Extreme(tail, k, z);
    }
    if (!(k >= kExpandedFrom) || !(z > 0)) {
        return Direct(tail, k, z);
    }
    const double d = (z - k) / k;
    const double half = -boost::math::log1pmx(d, QuietPolicy()); // eta^2/2
    if (half <= kLargestEta * kLargestEta / 2) {
        return Expanded(tail, k, std::copysign(std::sqrt(2 * half), d));
    }
    // exp(-750) is no double; the library would try for minutes.
    return k * half > 750 ? Extreme(tail, k, z) : Direct(tail, k, z);
}

} // namespace

double LowerGamma(double k, double z) {
    return Gamma(Tail::Lower, k, z);
}

double UpperGamma(double k, double z) {
    return Gamma(Tail::Upper, k, z);
}

} // namespace ryn::stats
