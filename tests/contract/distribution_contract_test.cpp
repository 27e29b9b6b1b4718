// What every distribution promises, run through every distribution. A family joins by its
// Examples; only what is peculiar to it is tested elsewhere.

#include "stats/distribution.h"

#include <boost/math/quadrature/gauss_kronrod.hpp>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <optional>
#include <vector>

namespace ryn::stats {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kEpsilon = std::numeric_limits<double>::epsilon();

// Valid members of a family over its range of shapes and scales, and attempts at invalid ones.
template <class D>
struct Examples;

template <class D>
std::vector<D> Made(std::initializer_list<LocationScaleShape> values) {
    std::vector<D> made;
    for (const auto& v : values) {
        made.push_back(D::Make(v).value());
    }
    return made;
}

const std::initializer_list<LocationScaleShape> kShapes = {
    {0, 1, -0.9},      {0, 1, -0.3},       {0, 1, -1e-9},  {0, 1, -1e-15}, {0, 1, 0},
    {0, 1, 1e-15},     {0, 1, 1e-9},       {0, 1, 0.01},   {0, 1, 0.3},    {0, 1, 1},
    {3.87, 0.2, 0.05}, {1825, 884, -0.34}, {-5, 0.01, 0.3}};

template <class D>
std::vector<std::optional<D>> InvalidShapes() {
    return {D::Make({kNaN, 1, 0}),      D::Make({kInfinity, 1, 0}), D::Make({0, kNaN, 0}),
            D::Make({0, kInfinity, 0}), D::Make({0, 0, 0}),         D::Make({0, -1, 0}),
            D::Make({0, 1, kNaN}),      D::Make({0, 1, -kInfinity})};
}

template <class D>
std::vector<std::optional<D>> InvalidScales() {
    return {D::Make({kNaN, 1}),      D::Make({-kInfinity, 1}), D::Make({0, kNaN}),
            D::Make({0, kInfinity}), D::Make({0, 0}),          D::Make({0, -1})};
}

template <>
struct Examples<Gev> {
    static std::vector<Gev> Valid() { return Made<Gev>(kShapes); }
    static auto Invalid() { return InvalidShapes<Gev>(); }
};

template <>
struct Examples<GeneralisedPareto> {
    static std::vector<GeneralisedPareto> Valid() { return Made<GeneralisedPareto>(kShapes); }
    static auto Invalid() { return InvalidShapes<GeneralisedPareto>(); }
};

template <>
struct Examples<Gumbel> {
    static std::vector<Gumbel> Valid() {
        return {*Gumbel::Make({0, 1}), *Gumbel::Make({3.87, 0.2}), *Gumbel::Make({-5000, 1e4})};
    }
    static auto Invalid() { return InvalidScales<Gumbel>(); }
};

template <>
struct Examples<Exponential> {
    static std::vector<Exponential> Valid() {
        return {*Exponential::Make({0, 1}), *Exponential::Make({40, 12}, LocationType::Fixed),
                *Exponential::Make({-5000, 1e4})};
    }
    static auto Invalid() { return InvalidScales<Exponential>(); }
};

template <class D>
class DistributionContract : public ::testing::Test {
  protected:
    const std::vector<D> valid = Examples<D>::Valid();
};

using Families = ::testing::Types<Gev, Gumbel, GeneralisedPareto, Exponential>;
TYPED_TEST_SUITE(DistributionContract, Families);

// 1e-12 to 1 - 1e-12, dense at both ends.
std::vector<double> Probabilities() {
    std::vector<double> probabilities;
    for (int exponent = -12; exponent < -1; ++exponent) {
        probabilities.push_back(std::pow(10.0, exponent));
    }
    for (int i = 2; i < 19; ++i) {
        probabilities.push_back(0.05 * i);
    }
    for (int exponent = -2; exponent >= -12; --exponent) {
        probabilities.push_back(1 - std::pow(10.0, exponent));
    }
    return probabilities;
}

// How far the rounding of x, and of x - xi, moves a probability whose density at x is `density`.
template <class D>
double Slack(const D& d, double x, double probability) {
    double level = std::abs(x);
    for (const Parameter& parameter : Parameters(d)) {
        level += std::abs(parameter.value);
    }
    return 8 * kEpsilon * level * Density(d, x) + 2e-14 * probability;
}

TYPED_TEST(DistributionContract, RefusesInvalidParameters) {
    for (const auto& made : Examples<TypeParam>::Invalid()) {
        EXPECT_FALSE(made);
    }
}

TYPED_TEST(DistributionContract, NamesItsParameters) {
    for (const auto& d : this->valid) {
        ASSERT_FALSE(Parameters(d).empty());
        for (const Parameter& parameter : Parameters(d)) {
            EXPECT_FALSE(parameter.symbol.empty());
            EXPECT_TRUE(std::isfinite(parameter.value));
        }
    }
}

TYPED_TEST(DistributionContract, CdfInvertsTheQuantile) {
    for (const auto& d : this->valid) {
        for (const double p : Probabilities()) {
            const double x = Quantile(d, p);
            ASSERT_TRUE(std::isfinite(x)) << p;
            EXPECT_NEAR(Cdf(d, x), p, Slack(d, x, p)) << "x " << x;
        }
    }
}

TYPED_TEST(DistributionContract, SurvivalInvertsTheQuantileOfExceedance) {
    for (const auto& d : this->valid) {
        for (const double e : Probabilities()) {
            const double x = QuantileOfExceedance(d, e);
            ASSERT_TRUE(std::isfinite(x)) << e;
            EXPECT_NEAR(Survival(d, x), e, Slack(d, x, e)) << "x " << x;
        }
    }
}

TYPED_TEST(DistributionContract, CdfAndSurvivalAddUpToOne) {
    for (const auto& d : this->valid) {
        for (const double p : Probabilities()) {
            const double x = Quantile(d, p);
            EXPECT_NEAR(Cdf(d, x) + Survival(d, x), 1, 4 * kEpsilon) << p;
        }
    }
}

TYPED_TEST(DistributionContract, RisesFromTheLowerToTheUpperEnd) {
    for (const auto& d : this->valid) {
        double previous = -kInfinity;
        for (const double p : Probabilities()) {
            const double x = Quantile(d, p);
            EXPECT_GE(x, previous) << p;
            EXPECT_GE(x, Support(d).lower);
            EXPECT_LE(x, Support(d).upper);
            EXPECT_GE(Cdf(d, x), Cdf(d, previous));
            EXPECT_LE(Survival(d, x), Survival(d, previous));
            EXPECT_GE(ReducedVariate(d, x), ReducedVariate(d, previous));
            previous = x;
        }
        EXPECT_LT(Quantile(d, 0.001), Quantile(d, 0.999));
    }
}

TYPED_TEST(DistributionContract, DensityIntegratesToTheCdf) {
    using Rule = boost::math::quadrature::gauss_kronrod<double, 31>;
    const double limits[] = {0.001, 0.01, 0.1, 0.3, 0.5, 0.7, 0.9, 0.99, 0.999};
    for (const auto& d : this->valid) {
        for (std::size_t i = 1; i < std::size(limits); ++i) {
            const auto density = [&](double x) { return Density(d, x); };
            const double mass = Rule::integrate(density, Quantile(d, limits[i - 1]),
                                                Quantile(d, limits[i]), 10, 1e-11);
            EXPECT_NEAR(mass, limits[i] - limits[i - 1], 1e-10);
        }
    }
}

TYPED_TEST(DistributionContract, DensityIsTheExponentialOfItsLogarithm) {
    for (const auto& d : this->valid) {
        for (const double p : Probabilities()) {
            const double x = Quantile(d, p);
            EXPECT_EQ(Density(d, x), std::exp(LogDensity(d, x)));
            EXPECT_FALSE(std::isnan(LogDensity(d, x)));
        }
    }
}

TYPED_TEST(DistributionContract, ReducedVariateOfAQuantileIsThatOfItsProbability) {
    for (const auto& d : this->valid) {
        for (const double p : {1e-6, 0.01, 0.2, 0.5, 0.8, 0.99, 0.999}) {
            const double u = ReducedVariateOfProbability(d, p);
            EXPECT_NEAR(ReducedVariate(d, Quantile(d, p)), u, 1e-8 * (1 + std::abs(u))) << p;
        }
    }
}

TYPED_TEST(DistributionContract, GivesNaNForNaN) {
    for (const auto& d : this->valid) {
        EXPECT_TRUE(std::isnan(LogDensity(d, kNaN)));
        EXPECT_TRUE(std::isnan(Density(d, kNaN)));
        EXPECT_TRUE(std::isnan(Cdf(d, kNaN)));
        EXPECT_TRUE(std::isnan(Survival(d, kNaN)));
        EXPECT_TRUE(std::isnan(Quantile(d, kNaN)));
        EXPECT_TRUE(std::isnan(QuantileOfExceedance(d, kNaN)));
        EXPECT_TRUE(std::isnan(ReducedVariate(d, kNaN)));
        EXPECT_TRUE(std::isnan(ReducedVariateOfProbability(d, kNaN)));
        EXPECT_TRUE(std::isnan(StandardVariate(d, kNaN)));
    }
}

template <class D>
void ExpectBelow(const D& d, double x) {
    EXPECT_EQ(Cdf(d, x), 0) << x;
    EXPECT_EQ(Survival(d, x), 1) << x;
    EXPECT_EQ(LogDensity(d, x), -kInfinity) << x;
    EXPECT_EQ(Density(d, x), 0) << x;
}

template <class D>
void ExpectAbove(const D& d, double x) {
    EXPECT_EQ(Cdf(d, x), 1) << x;
    EXPECT_EQ(Survival(d, x), 0) << x;
    EXPECT_EQ(LogDensity(d, x), -kInfinity) << x;
    EXPECT_EQ(Density(d, x), 0) << x;
}

TYPED_TEST(DistributionContract, KnowsItsEndsAndWhatLiesBeyond) {
    for (const auto& d : this->valid) {
        const Interval support = Support(d);
        ASSERT_LT(support.lower, support.upper);
        ExpectBelow(d, -kInfinity);
        ExpectAbove(d, kInfinity);
        if (std::isfinite(support.lower)) {
            ExpectBelow(d, std::nextafter(support.lower, -kInfinity));
            EXPECT_EQ(Cdf(d, support.lower) + Survival(d, support.lower), 1);
            EXPECT_FALSE(std::isnan(LogDensity(d, support.lower)));
        }
        if (std::isfinite(support.upper)) {
            ExpectAbove(d, std::nextafter(support.upper, kInfinity));
            EXPECT_EQ(Cdf(d, support.upper) + Survival(d, support.upper), 1);
            EXPECT_FALSE(std::isnan(LogDensity(d, support.upper)));
        }
    }
}

TYPED_TEST(DistributionContract, StaysInItsRangeOverAllNumbers) {
    const double largest = std::numeric_limits<double>::max();
    for (const auto& d : this->valid) {
        for (const double x : {-largest, -1e100, -1e9, 0.0, 1e9, 1e100, largest}) {
            EXPECT_GE(Cdf(d, x), 0) << x;
            EXPECT_LE(Cdf(d, x), 1) << x;
            EXPECT_GE(Survival(d, x), 0) << x;
            EXPECT_LE(Survival(d, x), 1) << x;
            EXPECT_FALSE(std::isnan(LogDensity(d, x))) << x;
        }
    }
}

TYPED_TEST(DistributionContract, HasQuantilesOfZeroToOneAlone) {
    for (const auto& d : this->valid) {
        EXPECT_EQ(Quantile(d, 0), Support(d).lower);
        EXPECT_EQ(Quantile(d, 1), Support(d).upper);
        EXPECT_EQ(QuantileOfExceedance(d, 1), Support(d).lower);
        EXPECT_EQ(QuantileOfExceedance(d, 0), Support(d).upper);
        for (const double p : {-1e-300, -1.0, 1 + kEpsilon, 2.0, kInfinity, -kInfinity}) {
            EXPECT_TRUE(std::isnan(Quantile(d, p))) << p;
            EXPECT_TRUE(std::isnan(QuantileOfExceedance(d, p))) << p;
            EXPECT_TRUE(std::isnan(ReducedVariateOfProbability(d, p))) << p;
        }
    }
}

TYPED_TEST(DistributionContract, IsTheSameAsAnyDistribution) {
    for (const auto& d : this->valid) {
        const Distribution any = d;
        for (const double p : {0.01, 0.5, 0.99}) {
            const double x = Quantile(d, p);
            EXPECT_EQ(Quantile(any, p), x);
            EXPECT_EQ(QuantileOfExceedance(any, p), QuantileOfExceedance(d, p));
            EXPECT_EQ(Cdf(any, x), Cdf(d, x));
            EXPECT_EQ(Survival(any, x), Survival(d, x));
            EXPECT_EQ(LogDensity(any, x), LogDensity(d, x));
            EXPECT_EQ(Density(any, x), Density(d, x));
            EXPECT_EQ(ReducedVariate(any, x), ReducedVariate(d, x));
            EXPECT_EQ(ReducedVariateOfProbability(any, p), ReducedVariateOfProbability(d, p));
            EXPECT_EQ(StandardVariate(any, x), StandardVariate(d, x));
        }
        EXPECT_EQ(Support(any).lower, Support(d).lower);
        EXPECT_EQ(Support(any).upper, Support(d).upper);
        EXPECT_EQ(Parameters(any).size(), Parameters(d).size());
    }
}

} // namespace
} // namespace ryn::stats
