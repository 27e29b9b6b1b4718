#include "stats/gev_profile.h"

#include "stats/pair.h"
#include "stats/shape_functions.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

namespace ryn::stats {

namespace {

// t(u, kappa) with its derivatives. In ln u: r = u/q with q = 1 - kappa u, then u/q^2 and, mixed
// with kappa, r^2. In kappa: k and kk. N is a number or a pair of them.
template <class N>
struct Transformed {
    N t;
    N r;
    N slopeOfR;
    N k;
    N kk;
};

template <class N>
Transformed<N> Directly(const N& u, double kappa, double inverse) {
    using std::log;
    const N inverseQ = 1.0 / (1.0 - kappa * u);
    const N r = u * inverseQ;
    const N t = log(inverseQ) * inverse;
    const N k = (r - t) * inverse;
    return {t, r, r * inverseQ, k, (r * r - 2.0 * k) * inverse};
}

// Their limits at kappa = 0, where every walk begins.
template <class N>
Transformed<N> AtZero(const N& u) {
    const N square = u * u;
    return {u, u, u, 0.5 * square, 2.0 / 3 * square * u};
}

// The direct forms divide small differences by kappa; from |kappa| = 1e-3 on, what they lose around
// h = kappa u = 0 is small against the sums. Nearer to 0 the power series
//     t = u sum h^j/(j+1),  k = u^2 sum (j+1) h^j/(j+2),  kk = u^3 sum (j+1)(j+2) h^j/(j+3),
// of which nine terms leave less than 1e-13 at |h| < 0.02, take their place for small h.
constexpr double kSeriesShapes = 1e-3;
constexpr double kSeriesRange = 0.02;

Transformed<double> BySeries(double u, double h) {
    double t = 0;
    double k = 0;
    double kk = 0;
    for (int j = 8; j >= 0; --j) {
        t = t * h + 1.0 / (j + 1);
        k = k * h + (j + 1.0) / (j + 2);
        kk = kk * h + (j + 1.0) * (j + 2) / (j + 3);
    }
    const double r = u / (1 - h);
    return {u * t, r, r / (1 - h), u * u * k, u * u * u * kk};
}

Transformed<double> Transform(double u, double kappa) {
    const double h = kappa * u;
    const bool bySeries = std::abs(kappa) < kSeriesShapes && std::abs(h) < kSeriesRange;
    return bySeries ? BySeries(u, h) : Directly(u, kappa, 1 / kappa);
}

// Sums over the sample, plain and with the weights w = exp(leastT - t).
template <class N>
struct Sums {
    N w{0}, wr{0}, wrr{0}, wrb{0}, wk{0}, wkk{0}, wrk{0}, wCurve{0};
    N t{0}, r{0}, rr{0}, rb{0}, k{0}, curve{0};

    void Add(const Transformed<N>& at, double leastT) {
        using std::exp;
        const N weight = exp(leastT - at.t);
        const N rWeighted = weight * at.r;
        const N kWeighted = weight * at.k;
        w += weight;
        wr += rWeighted;
        wrr += rWeighted * at.r;
        wrb += weight * at.slopeOfR;
        wk += kWeighted;
        wkk += kWeighted * at.k;
        wrk += rWeighted * at.k;
        wCurve += weight * at.kk;
        t += at.t;
        r += at.r;
        rr += at.r * at.r;
        rb += at.slopeOfR;
        k += at.k;
        curve += at.kk;
    }
};

Sums<double> Total(const Sums<Pair>& pairs) {
    const auto& s = pairs;
    return {s.w.Sum(),   s.wr.Sum(),  s.wrr.Sum(),    s.wrb.Sum(),  s.wk.Sum(),
            s.wkk.Sum(), s.wrk.Sum(), s.wCurve.Sum(), s.t.Sum(),    s.r.Sum(),
            s.rr.Sum(),  s.rb.Sum(),  s.k.Sum(),      s.curve.Sum()};
}

// Two values at a time, in one loop for all sums. An odd value is left over.
template <class F>
Sums<double> SumsOfPairs(std::span<const double> fromEdge, double b, double leastT, F&& transform) {
    Sums<Pair> pairs;
    for (std::size_t i = 0; i + 1 < fromEdge.size(); i += 2) {
        pairs.Add(transform(b * Pair(fromEdge[i], fromEdge[i + 1])), leastT);
    }
    return Total(pairs);
}

// All the time of a fit goes here.
Sums<double> SumsOver(std::span<const double> fromEdge, double b, double kappa, double leastT) {
    Sums<double> sums;
    if (kappa == 0) {
        sums = SumsOfPairs(fromEdge, b, leastT, [](const Pair& u) { return AtZero(u); });
    } else if (std::abs(kappa) >= kSeriesShapes) {
        sums = SumsOfPairs(fromEdge, b, leastT, [kappa, inverse = 1 / kappa](const Pair& u) {
            return Directly(u, kappa, inverse);
        });
    } else {
        for (const double d : fromEdge.first(fromEdge.size() / 2 * 2)) {
            sums.Add(Transform(b * d, kappa), leastT);
        }
    }
    if (fromEdge.size() % 2 == 1) {
        sums.Add(Transform(b * fromEdge.back(), kappa), leastT);
    }
    return sums;
}

} // namespace

GevProfile::GevProfile(std::span<const double> sample, double edgeValue, const Closeness& end)
    : fromEdge(sample),
      edge(edgeValue),
      least(*std::min_element(sample.begin(), sample.end())),
      closeness(end),
      last{0, std::log(std::abs(edge)), 0} {}

// Means with the weights w are moments of a distribution: the derivatives of ln mean(w) are its
// means, variances and covariance.
GevProfile::Surface GevProfile::SurfaceAt(double b, double kappa) const {
    const double leastT = Transform(b * least, kappa).t;
    const Sums<double> s = SumsOver(fromEdge, b, kappa, leastT);
    const auto n = static_cast<double>(fromEdge.size());
    const double f = (1 - kappa) / n;
    const double logWeight = std::log(s.w / n) - leastT;
    const double r = s.wr / s.w;
    const double k = s.wk / s.w;
    return {std::log(b) - logWeight - f * s.t - 1,
            1 + r - f * s.r,
            k + s.t / n - f * s.k,
            s.wrb / s.w - (s.wrr / s.w - r * r) - f * s.rb,
            s.wrr / s.w - (s.wrk / s.w - r * k) + s.r / n - f * s.rr,
            s.wCurve / s.w - (s.wkk / s.w - k * k) + 2 * s.k / n - f * s.curve,
            logWeight,
            r,
            k};
}

// Seen from the edge, the Gumbel location lies -edge away and at -t.
double GevProfile::ScaleAt(double logT, double kappa) const {
    return StandardOfReduced(std::copysign(std::exp(logT), edge), -kappa) / edge;
}

// With m = ln |t| and u the edge in units of the scale at the Gumbel location, d ln b/dm = t/u, the
// derivative of which in m is t/u (1 - t/(b edge)); at a fixed m, d ln b/d kappa = (t/u - 1)/kappa.
GevProfile::Sight GevProfile::Look(double logT, double kappa) const {
    const double t = std::copysign(std::exp(logT), edge);
    const double u = StandardOfReduced(t, kappa);
    const double b = ScaleAt(logT, kappa);
    const Surface at = SurfaceAt(b, kappa);
    const double ratio = t / u;
    const double slope = at.b * ratio;
    const double curvature = ratio * (at.bb * ratio + at.b * (1 - t / (b * edge)));
    if (!std::isfinite(slope)) {
        return {kNoProfile, -1, 1, 0};
    }
    const double toPath = -at.b / at.bb;
    const double alongPath = -at.bKappa / at.bb;
    const double drift = std::abs(kappa * u) < 1e-6 ? u / 2 : (ratio - 1) / kappa;
    return {{at.value + at.b * toPath / 2, at.kappa + at.bKappa * toPath,
             at.kappaKappa + at.bKappa * alongPath},
            curvature < 0 ? -slope / curvature : std::copysign(1.0, slope),
            ratio,
            (alongPath - drift) / ratio};
}

// Newton's method in ln |t|, in a bracket that the direction of the steps narrows. It ends where
// the square of the step is small against the slope in kappa, whose sign then is beyond doubt. Next
// to a wild outlier a small step in ln |t| is a large one in ln b, and counts as such.
ProfilePoint GevProfile::operator()(double kappa) {
    double logT = ExpectedLogT(kappa);
    double lower = -std::numeric_limits<double>::infinity();
    double upper = std::numeric_limits<double>::infinity();
    for (int pass = 0; pass < 40; ++pass) {
        const Sight sight = Look(logT, kappa);
        const double step = sight.step;
        const double size = std::abs(step) * std::max(1.0, sight.scaleSlope / 3);
        const double slope = std::abs(sight.point.slope);
        if (size < 1e-9 || (size < closeness.largest && size * size < closeness.share * slope)) {
            last = {kappa, logT + step, sight.pathSlope};
            if (path.size() < 64) {
                path.Add(last);
            }
            return sight.point;
        }
        (step > 0 ? lower : upper) = logT;
        const double next = logT + std::clamp(step, -1.0, 1.0);
        logT = next > lower && next < upper ? next : lower + (upper - lower) / 2;
    }
    return kNoProfile;
}

double GevProfile::ExpectedLogT(double kappa) const {
    return last.logT + std::clamp(last.slope * (kappa - last.kappa), -1.0, 1.0);
}

// A walk ends far from the maximum that it met.
void GevProfile::GoBackTo(double kappa) {
    for (const PathPoint& point : path) {
        if (std::abs(point.kappa - kappa) < std::abs(last.kappa - kappa)) {
            last = point;
        }
    }
}

// What a walk knows of the path may be too coarse to start from; the path is then met at the place
// itself.
std::optional<GevProfile::Maximum> GevProfile::MaximumNear(double kappa) {
    GoBackTo(kappa);
    auto maximum = MaximumFrom(kappa);
    if (!maximum) {
        (*this)(kappa);
        maximum = MaximumFrom(kappa);
    }
    return maximum;
}

std::optional<GevProfile::Maximum> GevProfile::MaximumFrom(double kappa) const {
    double b = ScaleAt(ExpectedLogT(kappa), kappa);
    for (int pass = 0; pass < 8; ++pass) {
        const Surface at = SurfaceAt(b, kappa);
        const double determinant = at.bb * at.kappaKappa - at.bKappa * at.bKappa;
        const double inB = (at.kappa * at.bKappa - at.b * at.kappaKappa) / determinant;
        const double inKappa = (at.b * at.bKappa - at.kappa * at.bb) / determinant;
        const double size = std::max(std::abs(inB), std::abs(inKappa));
        if (!(at.bb < 0 && determinant > 0 && size < 0.3)) {
            return std::nullopt;
        }
        kappa += inKappa;
        b *= std::exp(inB);
        if (size < 2e-7) {
            return Maximum{kappa, b,
                           at.logMeanWeight - at.weightB * inB - at.weightKappa * inKappa};
        }
    }
    return std::nullopt;
}

// The first call comes near the path, the second puts it right.
GevProfile::Maximum GevProfile::PathAt(double kappa) {
    GoBackTo(kappa);
    (*this)(kappa);
    (*this)(kappa);
    const double b = ScaleAt(last.logT, kappa);
    return {kappa, b, SurfaceAt(b, kappa).logMeanWeight};
}

} // namespace ryn::stats
