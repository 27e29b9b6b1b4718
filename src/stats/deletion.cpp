#include "stats/deletion.h"

namespace ryn::stats {

namespace {

// Below this share of the whole, a remainder has lost too many digits to the subtraction. Written
// to be false where the whole is 0, or has overflowed so that all is NaN: there every deletion
// would be sent through the whole sample, and to no avail.
bool IsLost(double remainder, double whole) {
    return remainder <= 0.01 * whole && whole > 0;
}

double Center(std::span<const double> sorted) {
    return sorted.empty() ? 0.0 : sorted[sorted.size() / 2];
}

std::vector<double> Copy(std::span<const double> sorted, std::size_t withoutIndex) {
    std::vector<double> rest(sorted.begin(), sorted.end());
    rest.erase(rest.begin() + static_cast<std::ptrdiff_t>(withoutIndex));
    return rest;
}

} // namespace

// Taken from the median and not from the mean, since a value of the sample makes deviations without
// rounding even on a level far above the spread. The mean is never more than one standard deviation
// away, so that next to nothing cancels.
MomentDeletions::MomentDeletions(std::span<const double> ascending)
    : sorted(ascending),
      center(Center(ascending)),
      spread(CentralMomentsOf(ascending).m2) {
    for (const double value : sorted) {
        const double d = value - center;
        a1 += d;
        a2 += d * d;
        a3 += d * d * d;
        a4 += d * d * d * d;
    }
}

// The rest's mean lies c from the center; the sums of (d - c)^r over the rest open up into the old
// sums less the deleted value's powers.
CentralMoments MomentDeletions::Without(std::size_t index) const {
    const auto left = static_cast<double>(sorted.size() - 1);
    const double d = sorted[index] - center;
    const double c = (a1 - d) / left;
    const double q2 = (a2 - d * d) / left;
    const double q3 = (a3 - d * d * d) / left;
    const double q4 = (a4 - d * d * d * d) / left;
    const double m2 = q2 - c * c;
    if (IsLost(m2, spread)) {
        return CentralMomentsOf(Copy(sorted, index));
    }
    return {sorted.size() - 1, center + c, m2, q3 - 3 * c * q2 + 2 * c * c * c,
            q4 - 4 * c * q3 + 6 * c * c * q2 - 3 * c * c * c * c};
}

// The weights in the sums are (i-1), (i-1)(i-2), (i-1)(i-2)(i-3) with i from 1; their differences
// from i to i - 1 are 1, 2(i-2), 3(i-2)(i-3), those of the sums above an index.
LMomentDeletions::LMomentDeletions(std::span<const double> ascending)
    : sorted(ascending),
      center(Center(ascending)),
      spread(LMomentsOfSorted(ascending).l2),
      above(ascending.size()) {
    Above sums;
    for (std::size_t k = sorted.size(); k-- > 0;) {
        above[k] = sums;
        const double x = sorted[k] - center;
        const auto below = static_cast<double>(k); // i - 1
        a0 += x;
        a1 += below * x;
        a2 += below * (below - 1) * x;
        a3 += below * (below - 1) * (below - 2) * x;
        sums.b1 += x;
        sums.b2 += 2 * (below - 1) * x;
        sums.b3 += 3 * (below - 1) * (below - 2) * x;
    }
}

LMoments LMomentDeletions::InClosedForm(std::size_t index) const {
    const auto n = static_cast<double>(sorted.size());
    const auto below = static_cast<double>(index);
    const double x = sorted[index] - center;
    const Above& shifted = above[index];
    const double x1 = below * x;
    const double x2 = (below - 1) * x1;
    const double x3 = (below - 2) * x2;
    WeightedMoments b;
    b.count = sorted.size() - 1;
    b.b0 = (a0 - x) / (n - 1);
    b.b1 = (a1 - x1 - shifted.b1) / (n - 1) / (n - 2);
    b.b2 = (a2 - x2 - shifted.b2) / (n - 1) / (n - 2) / (n - 3);
    b.b3 = (a3 - x3 - shifted.b3) / (n - 1) / (n - 2) / (n - 3) / (n - 4);
    LMoments moments = LMomentsOf(b);
    moments.l1 += center;
    return moments;
}

LMoments LMomentDeletions::Without(std::size_t index) const {
    const LMoments moments = InClosedForm(index);
    return IsLost(moments.l2, spread) ? LMomentsOfSorted(Copy(sorted, index)) : moments;
}

ShortenedSample::ShortenedSample(std::span<const double> ascending)
    : sorted(ascending),
      rest(Copy(ascending, 0)) {}

// Between two deletions only the places between them differ.
std::span<const double> ShortenedSample::Without(std::size_t index) {
    for (; deleted < index; ++deleted) {
        rest[deleted] = sorted[deleted];
    }
    for (; deleted > index; --deleted) {
        rest[deleted - 1] = sorted[deleted];
    }
    return rest;
}

} // namespace ryn::stats
