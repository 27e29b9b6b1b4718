#include "stats/homogeneity_tests.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cmath>
#include <numeric>
#include <vector>

namespace ryn::stats {
namespace {

// Subsample 1 for the first `first` values, 2 for the rest.
std::vector<int> Parted(std::size_t first, std::size_t count) {
    std::vector<int> numbers(count, 2);
    std::fill_n(numbers.begin(), first, 1);
    return numbers;
}

// Small whole numbers, so that there are many ties.
std::vector<double> TiedValues() {
    const auto steps = *rc::gen::container<std::vector<int>>(rc::gen::inRange(-8, 8));
    return {steps.begin(), steps.end()};
}

RC_GTEST_PROP(TrendTest, CountsPairsAsTheDefinitionDoes, ()) {
    const auto values = TiedValues();
    std::int64_t s = 0;
    for (std::size_t j = 0; j < values.size(); ++j) {
        for (std::size_t i = 0; i < j; ++i) {
            s += values[j] > values[i] ? 1 : (values[j] < values[i] ? -1 : 0);
        }
    }
    RC_ASSERT(TrendTestOf(values).s == s);
}

// U counts the pairs in which the first subsample is the higher, ties by half.
RC_GTEST_PROP(ShiftTest, CountsPairsAsTheDefinitionDoesAndLeavesTheUnnumberedOut, ()) {
    const auto values = TiedValues();
    const auto numbers =
        *rc::gen::container<std::vector<int>>(values.size(), rc::gen::inRange(0, 3));
    double u = 0;
    for (std::size_t i = 0; i < values.size(); ++i) {
        for (std::size_t j = 0; j < values.size(); ++j) {
            const bool counts = numbers[i] == 1 && numbers[j] == 2;
            u += !counts || values[i] < values[j] ? 0 : (values[i] > values[j] ? 1 : 0.5);
        }
    }
    const ShiftTest test = ShiftTestOf(values, numbers);
    RC_ASSERT(test.score.obstacle == TestObstacle::TooFewInSubsample || test.u == u);
}

TEST(HomogeneityTests, SayWhyTheyCannotBeMade) {
    const std::vector<double> equal(9, 4.0);
    auto oneApart = equal;
    oneApart[3] = 5;
    for (const auto& values : {std::vector<double>{}, std::vector<double>{1}, equal}) {
        EXPECT_EQ(RunTestOf(values).score.obstacle, TestObstacle::TooFewBesideMedian);
        EXPECT_EQ(TrendTestOf(values).score.obstacle, TestObstacle::NoSpread);
    }
    EXPECT_EQ(RunTestOf(oneApart).score.obstacle, TestObstacle::TooFewBesideMedian);
    EXPECT_TRUE(TrendTestOf(oneApart).score.IsMade());
    EXPECT_EQ(ShiftTestOf(equal, Parted(4, 9)).score.obstacle, TestObstacle::NoSpread);
    const TestScore score = ShiftTestOf(oneApart, Parted(8, 9)).score;
    EXPECT_EQ(score.obstacle, TestObstacle::TooFewInSubsample);
    EXPECT_EQ(score.z, 0);
    EXPECT_EQ(score.level, 0);
    EXPECT_FALSE(TestObstacleText(score.obstacle).empty());
}

TEST(RunTest, LeavesOutValuesAtTheMedian) {
    const RunTest test = RunTestOf(std::vector<double>{1, 3, 2, 5, 3, 4, 3, 1, 6});
    EXPECT_EQ(test.median, 3);
    EXPECT_EQ(test.below, 3U);
    EXPECT_EQ(test.above, 3U);
    EXPECT_EQ(test.runs, 4U); // 1 2 | 5 4 | 1 | 6
}

TEST(TrendTest, TakesAHundredThousandValues) {
    std::vector<double> values(100000);
    std::iota(values.begin(), values.end(), 0.0);
    EXPECT_EQ(TrendTestOf(values).s, 4999950000);
    std::reverse(values.begin(), values.end());
    EXPECT_EQ(TrendTestOf(values).s, -4999950000);
}

TEST(HomogeneityTests, StandTheLargestNumbers) {
    const std::vector<double> values{-1.7e308, 1.7e308, 1.6e308, -1.6e308, 1.7e308, 5e-324};
    EXPECT_TRUE(std::isfinite(RunTestOf(values).score.z));
    EXPECT_TRUE(std::isfinite(TrendTestOf(values).score.z));
    EXPECT_TRUE(std::isfinite(ShiftTestOf(values, Parted(3, 6)).score.z));
}

} // namespace
} // namespace ryn::stats
