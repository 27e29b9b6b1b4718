#include "stats/gev_profile.h"

#include "stats/shape_functions.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace ryn::stats {

namespace {

// t(u, kappa) with its derivatives. In ln u: r = u/q with q = 1 - kappa u, then u/q^2 and, mixed
// with kappa, r^2. In kappa: k and kk.
struct Transformed {
    double t;
    double q;
    double r;
    double k;
    double kk;
};

Transformed Directly(double u, double kappa, double inverse) {
    const double q = 1 - kappa * u;
    const double r = u / q;
    const double t = -std::log(q) * inverse;
    const double k = (r - t) * inverse;
    return {t, q, r, k, (r * r - 2 * k) * inverse};
}

// The direct forms divide small differences by kappa; from |kappa| = 1e-3 on, what they lose around
// h = kappa u = 0 is small against the sums. Nearer to 0 the power series
//     t = u sum h^j/(j+1),  k = u^2 sum (j+1) h^j/(j+2),  kk = u^3 sum (j+1)(j+2) h^j/(j+3),
// of which nine terms leave less than 1e-13 at |h| < 0.02, take their place for small h.
constexpr double kSeriesShapes = 1e-3;
constexpr double kSeriesRange = 0.02;

Transformed BySeries(double u, double h) {
    double t = 0;
    double k = 0;
    double kk = 0;
    for (int j = 8; j >= 0; --j) {
        t = t * h + 1.0 / (j + 1);
        k = k * h + (j + 1.0) / (j + 2);
        kk = kk * h + (j + 1.0) * (j + 2) / (j + 3);
    }
    return {u * t, 1 - h, u / (1 - h), u * u * k, u * u * u * kk};
}

Transformed Transform(double u, double kappa) {
    const double h = kappa * u;
    const bool bySeries = std::abs(kappa) < kSeriesShapes && std::abs(h) < kSeriesRange;
    return bySeries ? BySeries(u, h) : Directly(u, kappa, 1 / kappa);
}

// Sums over the sample, plain and with the weights w = exp(leastT - t).
struct Sums {
    double leastT;
    double w = 0, wr = 0, wrr = 0, wrb = 0, wk = 0, wkk = 0, wrk = 0, wCurve = 0;
    double t = 0, r = 0, rr = 0, rb = 0, k = 0, curve = 0;

    void Add(const Transformed& at) {
        const double weight = std::exp(leastT - at.t);
        const double rWeighted = weight * at.r;
        const double kWeighted = weight * at.k;
        const double slopeOfR = at.r / at.q;
        w += weight;
        wr += rWeighted;
        wrr += rWeighted * at.r;
        wrb += weight * slopeOfR;
        wk += kWeighted;
        wkk += kWeighted * at.k;
        wrk += rWeighted * at.k;
        wCurve += weight * at.kk;
        t += at.t;
        r += at.r;
        rr += at.r * at.r;
        rb += slopeOfR;
        k += at.k;
        curve += at.kk;
    }
};

// Two loops, since all the time of a fit goes here.
Sums SumsOver(std::span<const double> fromEdge, double b, double kappa, double leastT) {
    Sums sums{leastT};
    if (std::abs(kappa) < kSeriesShapes) {
        for (const double d : fromEdge) {
            sums.Add(Transform(b * d, kappa));
        }
    } else {
        const double inverse = 1 / kappa;
        for (const double d : fromEdge) {
            sums.Add(Directly(b * d, kappa, inverse));
        }
    }
    return sums;
}

} // namespace

GevProfile::GevProfile(std::span<const double> sample, double edgeValue)
    : fromEdge(sample),
      edge(edgeValue),
      least(*std::min_element(sample.begin(), sample.end())),
      lastLogT(std::log(std::abs(edge))) {}

// Means with the weights w are moments of a distribution: the derivatives of ln mean(w) are its
// means, variances and covariance.
GevProfile::Surface GevProfile::SurfaceAt(double b, double kappa) const {
    const double leastT = Transform(b * least, kappa).t;
    const Sums s = SumsOver(fromEdge, b, kappa, leastT);
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
            logWeight};
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
    const double path = -at.bKappa / at.bb;
    const double drift = std::abs(kappa * u) < 1e-6 ? u / 2 : (ratio - 1) / kappa;
    return {{at.value + at.b * toPath / 2, at.kappa + at.bKappa * toPath,
             at.kappaKappa + at.bKappa * path},
            curvature < 0 ? -slope / curvature : std::copysign(1.0, slope),
            ratio,
            (path - drift) / ratio};
}

// Newton's method in ln |t|, in a bracket that the direction of the steps narrows. It ends where
// the square of the step, in ln b, is small against the slope in kappa, whose sign then is beyond
// doubt. At the end of a search in kappa that step is far smaller, and the two searches together
// make Newton's method in both unknowns.
ProfilePoint GevProfile::operator()(double kappa) {
    double logT = lastLogT + std::clamp(pathSlope * (kappa - lastKappa), -1.0, 1.0);
    double lower = -std::numeric_limits<double>::infinity();
    double upper = std::numeric_limits<double>::infinity();
    for (int pass = 0; pass < 40; ++pass) {
        const Sight sight = Look(logT, kappa);
        const double step = sight.step;
        const double size = std::abs(step) * sight.scaleSlope;
        if (size < 1e-9 || (size < 0.03 && size * size < 0.02 * std::abs(sight.point.slope))) {
            lastKappa = kappa;
            lastLogT = logT + step;
            pathSlope = sight.pathSlope;
            return sight.point;
        }
        (step > 0 ? lower : upper) = logT;
        const double next = logT + std::clamp(step, -1.0, 1.0);
        logT = next > lower && next < upper ? next : lower + (upper - lower) / 2;
    }
    return kNoProfile;
}

// The first call comes near the path, the second puts it right.
GevProfile::Rest GevProfile::RestAt(double kappa) {
    (*this)(kappa);
    (*this)(kappa);
    const double b = ScaleAt(lastLogT, kappa);
    return {b, SurfaceAt(b, kappa).logMeanWeight};
}

} // namespace ryn::stats
