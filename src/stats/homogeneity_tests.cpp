#include "stats/homogeneity_tests.h"

#include "stats/equal_runs.h"
#include "stats/sample_statistics.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <numeric>
#include <vector>

namespace ryn::stats {

namespace {

// 2 (1 - Phi(|z|)) without the difference, which would be 0 from |z| = 8.3 on.
TestScore Scored(double z) {
    return {TestObstacle::None, z, std::erfc(std::abs(z) / std::numbers::sqrt2)};
}

TestScore NotMade(TestObstacle obstacle) {
    return {obstacle, 0, 0};
}

// A statistic that moves in whole steps, drawn `correction` (half a step) towards 0: what the
// normal distribution gives to the step's other half.
TestScore ScoredWithCorrection(double difference, double correction, double variance) {
    if (!(variance > 0)) {
        return NotMade(TestObstacle::NoSpread);
    }
    const double corrected =
        difference == 0 ? 0.0 : difference - std::copysign(correction, difference);
    return Scored(corrected / std::sqrt(variance));
}

// Of two middle values the midpoint without overflow.
double Median(std::span<const double> values) {
    if (values.empty()) {
        return 0;
    }
    std::vector<double> sorted(values.begin(), values.end());
    SortAscending(sorted);
    const std::size_t half = sorted.size() / 2;
    return sorted.size() % 2 == 1 ? sorted[half] : std::midpoint(sorted[half - 1], sorted[half]);
}

// Values at the median are on neither side and end no run (Bradley 1968).
void CountRuns(std::span<const double> values, RunTest& test) {
    int side = 0;
    for (const double x : values) {
        const int now = x > test.median ? 1 : (x < test.median ? -1 : 0);
        if (now == 0) {
            continue;
        }
        ++(now > 0 ? test.above : test.below);
        test.runs += now != side ? 1 : 0;
        side = now;
    }
}

// Merges two ascending neighbours [begin, middle) and [middle, end) of `from` into `to`, and
// counts the pairs in which the later value is the smaller: each value taken from the right
// half passes all that are left of the left half.
std::int64_t MergeCounting(std::span<const double> from, std::span<double> to, std::size_t middle) {
    std::int64_t falling = 0;
    std::size_t left = 0;
    std::size_t right = middle;
    for (double& next : to) {
        const bool takeRight = left == middle || (right < from.size() && from[right] < from[left]);
        falling += takeRight ? static_cast<std::int64_t>(middle - left) : 0;
        next = from[takeRight ? right++ : left++];
    }
    return falling;
}

// Sorts by merging runs of doubled length and counts the falling pairs (Knight 1966), where going
// through all pairs would take minutes for a hundred thousand values.
std::int64_t SortCountingFallingPairs(std::vector<double>& values) {
    const std::size_t n = values.size();
    std::vector<double> merged(n);
    std::int64_t falling = 0;
    for (std::size_t width = 1; width < n; width *= 2) {
        for (std::size_t begin = 0; begin < n; begin += 2 * width) {
            const std::size_t length = std::min(2 * width, n - begin);
            falling +=
                MergeCounting(std::span(values).subspan(begin, length),
                              std::span(merged).subspan(begin, length), std::min(width, length));
        }
        values.swap(merged);
    }
    return falling;
}

std::int64_t Pairs(std::size_t count) {
    const auto n = static_cast<std::int64_t>(count);
    return n * (n - 1) / 2;
}

struct Subsamples {
    std::vector<double> first;
    std::vector<double> both;
};

Subsamples Parted(std::span<const double> values, std::span<const int> sampleNumbers) {
    Subsamples parted;
    for (std::size_t i = 0; i < std::min(values.size(), sampleNumbers.size()); ++i) {
        if (sampleNumbers[i] == 1) {
            parted.first.push_back(values[i]);
        }
        if (sampleNumbers[i] == 1 || sampleNumbers[i] == 2) {
            parted.both.push_back(values[i]);
        }
    }
    SortAscending(parted.first);
    SortAscending(parted.both);
    return parted;
}

// Both lists ascend, so that the first sample's share of each tied group is found going along.
double RankSum(const Subsamples& parted) {
    double sum = 0;
    auto own = parted.first.begin();
    ForEachEqualRun(parted.both, [&](std::size_t begin, std::size_t count) {
        const double midRank = static_cast<double>(begin) + (static_cast<double>(count) + 1) / 2;
        for (; own != parted.first.end() && *own == parted.both[begin]; ++own) {
            sum += midRank;
        }
    });
    return sum;
}

// sum (t^3 - t) over groups of t tied values.
double TieTerm(std::span<const double> sorted) {
    double sum = 0;
    ForEachEqualRun(sorted, [&](std::size_t, std::size_t count) {
        const auto t = static_cast<double>(count);
        sum += (t - 1) * t * (t + 1);
    });
    return sum;
}

} // namespace

std::string_view TestObstacleText(TestObstacle obstacle) {
    switch (obstacle) {
    case TestObstacle::TooFewBesideMedian:
        return "fewer than two values lie above or below the median";
    case TestObstacle::TooFewInSubsample:
        return "one of the two subsamples has fewer than two values";
    case TestObstacle::NoSpread:
        return "the values do not differ";
    case TestObstacle::None:
        break;
    }
    return {};
}

RunTest RunTestOf(std::span<const double> values) {
    RunTest test;
    test.median = Median(values);
    CountRuns(values, test);
    if (test.above < 2 || test.below < 2) {
        test.score = NotMade(TestObstacle::TooFewBesideMedian);
        return test;
    }
    // Mean and variance of R where every order of the sides is as likely (Wald and Wolfowitz
    // 1940); divided step by step, since the product of four counts would lose digits.
    const auto n = static_cast<double>(test.above + test.below);
    const double twice = 2 * static_cast<double>(test.above) * static_cast<double>(test.below);
    test.expectedRuns = 1 + twice / n;
    test.variance = twice / n * (twice - n) / n / (n - 1);
    test.score =
        Scored((static_cast<double>(test.runs) - test.expectedRuns) / std::sqrt(test.variance));
    return test;
}

TrendTest TrendTestOf(std::span<const double> values) {
    std::vector<double> sorted(values.begin(), values.end());
    const std::int64_t falling = SortCountingFallingPairs(sorted);
    TrendTest test;
    test.s = Pairs(sorted.size()) - 2 * falling;
    // Kendall (1975): each group of t tied values takes away what a sample of t would have.
    const auto term = [](double t) { return t * (t - 1) * (2 * t + 5); };
    double ties = 0;
    ForEachEqualRun(sorted, [&](std::size_t, std::size_t count) {
        test.s -= Pairs(count);
        ties += term(static_cast<double>(count));
    });
    test.variance = (term(static_cast<double>(sorted.size())) - ties) / 18;
    test.score = ScoredWithCorrection(static_cast<double>(test.s), 1, test.variance);
    return test;
}

ShiftTest ShiftTestOf(std::span<const double> values, std::span<const int> sampleNumbers) {
    const Subsamples parted = Parted(values, sampleNumbers);
    ShiftTest test;
    test.first = parted.first.size();
    test.second = parted.both.size() - parted.first.size();
    if (test.first < 2 || test.second < 2) {
        test.score = NotMade(TestObstacle::TooFewInSubsample);
        return test;
    }
    const auto n1 = static_cast<double>(test.first);
    const auto n2 = static_cast<double>(test.second);
    const double n = n1 + n2;
    // Tied values have equal ranks, which spread less: the last term is what that takes away.
    test.rankSum = RankSum(parted);
    test.u = test.rankSum - n1 * (n1 + 1) / 2;
    test.variance = n1 * n2 / 12 * (n + 1 - TieTerm(parted.both) / n / (n - 1));
    test.score = ScoredWithCorrection(test.u - n1 * n2 / 2, 0.5, test.variance);
    return test;
}

} // namespace ryn::stats
