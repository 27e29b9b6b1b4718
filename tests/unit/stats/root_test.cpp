#include "stats/root.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ryn::stats {
namespace {

TEST(Root, IsFoundToThirteenDigits) {
    const auto root = Root([](double x) { return std::cos(x) - x; }, {0, 1});
    ASSERT_TRUE(root);
    EXPECT_NEAR(*root, 0.73908513321516064, 2e-13); // Dottie's number
}

TEST(Root, IsFoundAtAnEndAndAtZero) {
    const auto identity = [](double x) { return x; };
    EXPECT_EQ(Root(identity, {0, 1}), 0.0);
    EXPECT_EQ(Root(identity, {-1, 0}), 0.0);
    EXPECT_NEAR(Root(identity, {-1, 3}).value(), 0, 1e-15);
}

TEST(Root, NeedsAChangeOfSign) {
    EXPECT_FALSE(Root([](double x) { return x * x + 1; }, {-1, 1}));
    EXPECT_FALSE(Root([](double) { return std::nan(""); }, {-1, 1}));
}

TEST(Root, EndsWithinItsBoundForAStep) {
    int calls = 0;
    const auto step = [&calls](double x) {
        ++calls;
        return x < 1e-7 ? -1.0 : 1.0;
    };
    EXPECT_NEAR(Root(step, {-1e9, 1e9}).value(), 1e-7, 1e-15);
    EXPECT_LE(calls, 202);
}

TEST(RootNear, TakesTheShortWayOnlyWithAGoodGuess) {
    int calls = 0;
    const auto cubic = [&calls](double x) {
        ++calls;
        return x * x * x - 8;
    };
    EXPECT_NEAR(RootNear(cubic, {-100, 100}, 2.0004, 1e-3).value(), 2, 1e-12);
    const int near = calls;
    EXPECT_NEAR(RootNear(cubic, {-100, 100}, 50, 1e-3).value(), 2, 1e-12);
    EXPECT_LT(near, calls - near);
    EXPECT_NEAR(RootNear(cubic, {-100, 100}, std::nan(""), 1e-3).value(), 2, 1e-12);
}

} // namespace
} // namespace ryn::stats
