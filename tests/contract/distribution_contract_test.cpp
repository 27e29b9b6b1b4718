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

const std::initializer_list<LocationScaleShape> kPositiveShapes = {
    {0, 1, 0.3}, {0, 1, 1}, {0, 1, 7}, {40, 12, 0.9}, {-3000, 5e3, 30}, {3.5, 0.5, 1.9}};

const std::initializer_list<LocationScaleShape> kGammaShapes = {
    {0, 1, 0.3},      {0, 1, 1},          {0, 1, 7},       {41, 15, 0.73}, {0, 1, 19.9},
    {0, 1, 20.1},     {3.3, 0.09, 7.5},   {200, -12, 5.7}, {0, -1, 0.4},   {0, -1, 1},
    {-200, 0.1, 1e4}, {2000, -5e-4, 4e6}, {0, 3e-6, 1e11}};

template <class D>
std::vector<std::optional<D>> InvalidPositiveShapes() {
    auto invalid = InvalidShapes<D>(); // all of which have kappa = 0
    for (const LocationScaleShape& v : std::initializer_list<LocationScaleShape>{
             {0, 1, -1}, {kNaN, 1, 1}, {0, kInfinity, 1}, {0, 0, 1}, {0, 1, kInfinity}}) {
        invalid.push_back(D::Make(v));
    }
    return invalid;
}

template <>
struct Examples<Weibull> {
    static std::vector<Weibull> Valid() { return Made<Weibull>(kPositiveShapes); }
    static auto Invalid() { return InvalidPositiveShapes<Weibull>(); }
};

template <>
struct Examples<PearsonThree> {
    static std::vector<PearsonThree> Valid() { return Made<PearsonThree>(kGammaShapes); }
    static auto Invalid() { return InvalidPositiveShapes<PearsonThree>(); }
};

template <>
struct Examples<LogPearsonThree> {
    static std::vector<LogPearsonThree> Valid() {
        return Made<LogPearsonThree>({{0, 0.1, 0.7},
                                      {0, 0.2, 1},
                                      {6.2, 0.2, 7.5},
                                      {16, -0.053, 155},
                                      {13.5, -0.49, 12},
                                      {1.2, 0.02, 9},
                                      {-2000, 5e-4, 4e6},
                                      {2000, -5e-4, 4e6}});
    }
    static auto Invalid() {
        auto invalid = InvalidPositiveShapes<LogPearsonThree>();
        invalid.push_back(LogPearsonThree::Make({1000, 1, 1}));
        invalid.push_back(LogPearsonThree::Make({-1000, -1, 1}));
        return invalid;
    }
};

template <>
struct Examples<Frechet> {
    static std::vector<Frechet> Valid() {
        return {*Frechet::Make({1, 0.5}), *Frechet::Make({2000, 2.9}), *Frechet::Make({3.9, 22})};
    }
    static auto Invalid() {
        return std::vector{Frechet::Make({0, 1}),    Frechet::Make({-1, 1}),
                           Frechet::Make({1, 0}),    Frechet::Make({1, -2}),
                           Frechet::Make({kNaN, 1}), Frechet::Make({1, kInfinity})};
    }
};

template <>
struct Examples<LogNormal> {
    static std::vector<LogNormal> Valid() {
        return {*LogNormal::Make({0, 0, 1}), *LogNormal::Make({30, 2.5, 0.7}),
                *LogNormal::Make({40, 1.9, 1.2}, LocationType::Fixed),
                *LogNormal::Make({-300, 8, 0.06}), *LogNormal::Make({0, -3, 4})};
    }
    static auto Invalid() {
        return std::vector{LogNormal::Make({kNaN, 0, 1}),      LogNormal::Make({0, kNaN, 1}),
                           LogNormal::Make({0, kInfinity, 1}), LogNormal::Make({0, 0, 0}),
                           LogNormal::Make({0, 0, -1}),        LogNormal::Make({0, 0, kInfinity})};
    }
};

// With probabilities of 0 below 1e-12, so that what all distributions promise holds.
template <>
struct Examples<SquareRootExponential> {
    static std::vector<SquareRootExponential> Valid() {
        return {*SquareRootExponential::Make({72, 13.3}), *SquareRootExponential::Make({30, 1e-3}),
                *SquareRootExponential::Make({4e16, 450})};
    }
    static auto Invalid() {
        using D = SquareRootExponential;
        return std::vector{D::Make({0, 1}),    D::Make({1, 0}),         D::Make({-1, 1}),
                           D::Make({kNaN, 1}), D::Make({kInfinity, 1}), D::Make({1, kInfinity})};
    }
};

// Thresholds far up the right tail, where the distribution is exponential, to far down the left.
template <>
struct Examples<TruncatedGumbel> {
    static std::vector<TruncatedGumbel> Valid() {
        return {*TruncatedGumbel::Make({3.935, 0.17}, 3.8), *TruncatedGumbel::Make({0, 1}, 20),
                *TruncatedGumbel::Make({0, 1}, 690),        *TruncatedGumbel::Make({0, 1}, 0),
                *TruncatedGumbel::Make({0, 1}, -6),         *TruncatedGumbel::Make({5, 2}, -1375)};
    }
    static auto Invalid() {
        using D = TruncatedGumbel;
        return std::vector{D::Make({kNaN, 1}, 0), D::Make({0, 0}, 0),    D::Make({0, -1}, 0),
                           D::Make({0, 1}, kNaN), D::Make({0, 1}, -700), D::Make({0, 1}, 700)};
    }
};

template <class D>
class DistributionContract : public ::testing::Test {
  protected:
    const std::vector<D> valid = Examples<D>::Valid();
};

using Families = ::testing::Types<Gev, Gumbel, Weibull, Frechet, GeneralisedPareto, PearsonThree,
                                  LogPearsonThree, LogNormal, Exponential, SquareRootExponential,
                                  TruncatedGumbel>;
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

double ParameterSum(const ParameterList& parameters) {
    double sum = 0;
    for (const Parameter& parameter : parameters) {
        sum += std::abs(parameter.value);
    }
    return sum;
}

// The level whose rounding moves x.
template <class D>
double Level(const D& d, double x) {
    return std::abs(x) + ParameterSum(Parameters(d));
}

// Here the parameters move ln x.
double Level(const LogPearsonThree& d, double x) {
    return x * (1 + ParameterSum(Parameters(d)));
}

double Level(const LogNormal& d, double x) {
    return std::abs(x) + std::abs(x - d.Values().xi) * (1 + ParameterSum(Parameters(d)));
}

double Level(const TruncatedGumbel& d, double x) {
    return std::abs(x) + std::abs(d.Threshold()) + ParameterSum(Parameters(d));
}

// How far rounding of that level moves a probability.
template <class D>
double Slack(const D& d, double x, double probability) {
    return 8 * kEpsilon * Level(d, x) * Density(d, x) + 2e-14 * probability;
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

// Through the smaller of both tails, whose rounding moves x the least.
TYPED_TEST(DistributionContract, QuantileInvertsTheCdf) {
    for (const auto& d : this->valid) {
        for (const double p : Probabilities()) {
            const double x = Quantile(d, p);
            const bool lower = p < 0.5;
            const double tail = lower ? Cdf(d, x) : Survival(d, x);
            const double back = lower ? Quantile(d, tail) : QuantileOfExceedance(d, tail);
            const double rounding = 8 * kEpsilon * Level(d, x) + 2e-14 * tail / Density(d, x);
            EXPECT_NEAR(back, x, 2 * rounding) << p;
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

// A rise of the reduced variate is a fall for the families whose paper runs the other way.
template <class D>
double Direction(const D& d) {
    return ReducedVariate(d, Quantile(d, 0.999)) < ReducedVariate(d, Quantile(d, 0.001)) ? -1 : 1;
}

TYPED_TEST(DistributionContract, RisesFromTheLowerToTheUpperEnd) {
    for (const auto& d : this->valid) {
        const double direction = Direction(d);
        double previous = -kInfinity;
        for (const double p : Probabilities()) {
            const double x = Quantile(d, p);
            EXPECT_GE(x, previous) << p;
            EXPECT_GE(x, Support(d).lower);
            EXPECT_LE(x, Support(d).upper);
            EXPECT_GE(Cdf(d, x), Cdf(d, previous));
            EXPECT_LE(Survival(d, x), Survival(d, previous));
            EXPECT_GE(direction * ReducedVariate(d, x), direction * ReducedVariate(d, previous));
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
