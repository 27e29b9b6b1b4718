#include "stats/sample_statistics.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace ryn::stats {

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// b_r of the values less `shift`. The weight of b_r is that of b_(r-1) times (i - r)/(n - r); the
// factors in i are built up along the sample, and those in n are divided out at the end, one by
// one, since their product would outgrow an integer.
WeightedMoments Weighted(std::span<const double> sorted, double shift) {
    const auto n = static_cast<double>(sorted.size());
    double s0 = 0;
    double s1 = 0;
    double s2 = 0;
    double s3 = 0;
    double below = 0; // i - 1
    for (const double value : sorted) {
        const double x = value - shift;
        const double x1 = below * x;
        const double x2 = (below - 1) * x1;
        s0 += x;
        s1 += x1;
        s2 += x2;
        s3 += (below - 2) * x2;
        below += 1;
    }
    WeightedMoments b{sorted.size(), s0 / n, kNaN, kNaN, kNaN};
    if (n > 1) {
        b.b1 = s1 / n / (n - 1);
    }
    if (n > 2) {
        b.b2 = s2 / n / (n - 1) / (n - 2);
    }
    if (n > 3) {
        b.b3 = s3 / n / (n - 1) / (n - 2) / (n - 3);
    }
    return b;
}

} // namespace

double CentralMoments::Variance() const {
    const auto n = static_cast<double>(count);
    return count < 2 ? kNaN : n / (n - 1) * m2;
}

double CentralMoments::StandardDeviation() const {
    return std::sqrt(Variance());
}

double CentralMoments::BiasedSkewness() const {
    return m3 / (m2 * std::sqrt(m2));
}

double CentralMoments::Skewness() const {
    const auto n = static_cast<double>(count);
    return count < 3 ? kNaN : BiasedSkewness() * std::sqrt(n * (n - 1)) / (n - 2);
}

double CentralMoments::Kurtosis() const {
    const auto n = static_cast<double>(count);
    if (count < 4) {
        return kNaN;
    }
    return (n - 1) / ((n - 2) * (n - 3)) * ((n + 1) * (m4 / (m2 * m2) - 3) + 6) + 3;
}

CentralMoments CentralMomentsOf(std::span<const double> values) {
    const auto n = static_cast<double>(values.size());
    // Summed from the first value on, so that equal values have exactly no spread.
    const double origin = values.empty() ? 0.0 : values.front();
    double sum = 0;
    for (const double x : values) {
        sum += x - origin;
    }
    CentralMoments moments{values.size(), origin + sum / n, 0, 0, 0};
    for (const double x : values) {
        const double d = x - moments.mean;
        const double square = d * d;
        moments.m2 += square;
        moments.m3 += square * d;
        moments.m4 += square * square;
    }
    moments.m2 /= n;
    moments.m3 /= n;
    moments.m4 /= n;
    return moments;
}

WeightedMoments WeightedMomentsOfSorted(std::span<const double> sorted) {
    return Weighted(sorted, 0);
}

void SortAscending(std::span<double> values) {
    const auto numbersEnd =
        std::partition(values.begin(), values.end(), [](double x) { return !std::isnan(x); });
    std::sort(values.begin(), numbersEnd);
}

LMoments LMomentsOf(const WeightedMoments& b) {
    return {b.count, b.b0, 2 * b.b1 - b.b0, 6 * b.b2 - 6 * b.b1 + b.b0,
            20 * b.b3 - 30 * b.b2 + 12 * b.b1 - b.b0};
}

// b_r of x + c is b_r + c/(r + 1), and in l2 to l4 these terms cancel: they may as well never
// enter.
LMoments LMomentsOfSorted(std::span<const double> sorted) {
    const double median = sorted.empty() ? 0.0 : sorted[sorted.size() / 2];
    LMoments moments = LMomentsOf(Weighted(sorted, median));
    moments.l1 += median;
    return moments;
}

SampleStatistics SampleStatisticsOf(std::span<const double> values) {
    std::vector<double> sorted(values.begin(), values.end());
    SortAscending(sorted);
    const CentralMoments central = CentralMomentsOf(sorted);
    const LMoments l = LMomentsOfSorted(sorted);
    return {.count = values.size(),
            .mean = central.mean,
            .variance = central.Variance(),
            .skewness = central.Skewness(),
            .kurtosis = central.Kurtosis(),
            .weighted = WeightedMomentsOfSorted(sorted),
            .l1 = l.l1,
            .l2 = l.l2,
            .lSkewness = l.LSkewness(),
            .lKurtosis = l.LKurtosis()};
}

} // namespace ryn::stats
