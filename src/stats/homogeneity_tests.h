#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace ryn::stats {

/// Why a test of independence or homogeneity cannot be made.
enum class TestObstacle {
    None,
    TooFewBesideMedian, ///< fewer than two values above or below the median
    TooFewInSubsample,  ///< fewer than two values in one of the two subsamples
    NoSpread,           ///< all values equal, or fewer than two
};

/// One line for the log, without full stop; empty for None.
std::string_view TestObstacleText(TestObstacle obstacle);

/// What all three tests end in. A test that cannot be made has z and level 0.
struct TestScore {
    TestObstacle obstacle = TestObstacle::None;
    double z = 0;     ///< standard normal where the hypothesis holds and the sample is not small
    double level = 0; ///< two-sided significance level 2 (1 - Phi(|z|)), a fraction

    bool IsMade() const { return obstacle == TestObstacle::None; }
};

/// Independence.
struct RunTest {
    TestScore score; ///< z < 0: too few runs, a trend or persistence
    double median = 0;
    std::size_t above = 0;   ///< n1, values above the median
    std::size_t below = 0;   ///< n2; values equal to the median are in neither
    std::size_t runs = 0;    ///< R
    double expectedRuns = 0; ///< 1 + 2 n1 n2/(n1 + n2)
    double variance = 0;     ///< of R
};

/// Runs above and below the median, without continuity correction (Wald and Wolfowitz 1940;
/// Bradley 1968). Values finite, in time order.
RunTest RunTestOf(std::span<const double> values);

/// Trend.
struct TrendTest {
    TestScore score;     ///< z > 0: rising
    std::int64_t s = 0;  ///< S, the pairs that rise less those that fall
    double variance = 0; ///< of S, less for ties
};

/// Mann (1945) and Kendall (1975), with continuity correction. Values finite, in time order. Takes
/// time in proportion to n log n.
TrendTest TrendTestOf(std::span<const double> values);

/// Shift in mean between two subsamples.
struct ShiftTest {
    TestScore score;        ///< z > 0: the first subsample is the higher
    std::size_t first = 0;  ///< n1, size of the first subsample
    std::size_t second = 0; ///< n2
    double rankSum = 0;     ///< W, mid-ranks of the first subsample within both
    double u = 0;           ///< U = W - n1 (n1 + 1)/2
    double variance = 0;    ///< of U, less for ties
};

/// Rank sum test (Wilcoxon 1945; Mann and Whitney 1947) with continuity correction.
/// `sampleNumbers` says of each value whether it belongs to subsample 1 or 2; any other number
/// leaves it out, as does a missing one. Values finite, any order.
ShiftTest ShiftTestOf(std::span<const double> values, std::span<const int> sampleNumbers);

} // namespace ryn::stats
