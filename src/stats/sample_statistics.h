#pragma once

#include <cstddef>
#include <span>

namespace ryn::stats {

/// Mean and central moments with divisor n: what moment estimators start from. A value that the
/// sample is too small for is NaN, and so is one whose divisor is 0 (all values equal).
struct CentralMoments {
    std::size_t count = 0;
    double mean = 0; ///< NaN for no values
    double m2 = 0;   ///< (1/n) sum (x - mean)^2
    double m3 = 0;
    double m4 = 0;

    /// s^2, divisor n - 1; NaN for n < 2.
    double Variance() const;
    double StandardDeviation() const;
    /// Fisher's G1, the estimator of Bulletin 17B (IACWD 1982); NaN for n < 3.
    double Skewness() const;
    /// m3/m2^1.5, biased.
    double BiasedSkewness() const;
    /// Fisher's G2 + 3, which is 3 on average for normal samples; NaN for n < 4.
    double Kurtosis() const;
};

/// Two passes: the mean, then the powers of the deviations from it. Any order.
CentralMoments CentralMomentsOf(std::span<const double> values);

/// Sorts in place; NaN, which has no place in the order, goes to the end.
void SortAscending(std::span<double> values);

/// Unbiased probability weighted moments b0..b3 (Landwehr et al. 1979). b_r is NaN for n <= r.
struct WeightedMoments {
    std::size_t count = 0;
    double b0 = 0;
    double b1 = 0;
    double b2 = 0;
    double b3 = 0;
};

/// `sorted` must be ascending.
WeightedMoments WeightedMomentsOfSorted(std::span<const double> sorted);

/// Sample L-moments (Hosking 1990; Hosking and Wallis 1997); NaN where a b_r is.
struct LMoments {
    std::size_t count = 0;
    double l1 = 0;
    double l2 = 0;
    double l3 = 0;
    double l4 = 0;

    /// l2/l1; means something for a variable that takes no negative values.
    double LCv() const { return l2 / l1; }
    /// l3/l2, between -1 and 1 from three values that are not all equal.
    double LSkewness() const { return l3 / l2; }
    /// l4/l2; that of a distribution lies between -1/4 and 1.
    double LKurtosis() const { return l4 / l2; }
};

LMoments LMomentsOf(const WeightedMoments& b);

/// From an ascending sample, through deviations from its median: l2 to l4 keep their digits where
/// the spread is small against the level, as in water levels above a distant datum.
LMoments LMomentsOfSorted(std::span<const double> sorted);

/// What the statistics page shows of a series; all on the values, not the exceedances. NaN where
/// the sample is too small.
struct SampleStatistics {
    std::size_t count = 0;
    double mean = 0;
    double variance = 0;
    double skewness = 0;
    double kurtosis = 0;
    WeightedMoments weighted;
    double l1 = 0;
    double l2 = 0;
    double lSkewness = 0;
    double lKurtosis = 0;
};

/// Any order, which shows in no bit: sorts a copy.
SampleStatistics SampleStatisticsOf(std::span<const double> values);

} // namespace ryn::stats
