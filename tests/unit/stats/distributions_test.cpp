#include "stats/distribution.h"

#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <limits>
#include <map>
#include <string>
#include <variant>
#include <vector>

namespace ryn::stats {
namespace {

using testing::ReferenceNumber;
using testing::ReferenceTable;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kEpsilon = std::numeric_limits<double>::epsilon();

Distribution Member(const std::vector<std::string>& row) {
    const double a = ReferenceNumber(row[1]);
    const double b = ReferenceNumber(row[2]);
    const double c = ReferenceNumber(row[3]);
    const std::map<std::string, std::function<Distribution()>> makers = {
        {"WEI",
         [=] {
             return Weibull::Make({a, b, c}).value();
         }},
        {"FRE",
         [=] {
             return Frechet::Make({a, b}).value();
         }},
        {"P3",
         [=] {
             return PearsonThree::Make({a, b, c}).value();
         }},
        {"LP3",
         [=] {
             return LogPearsonThree::Make({a, b, c}).value();
         }},
        {"LN3",
         [=] {
             return LogNormal::Make({a, b, c}).value();
         }},
        {"SQE",
         [=] {
             return SquareRootExponential::Make({a, b}).value();
         }},
        {"TGUM",
         [=] {
             return TruncatedGumbel::Make({a, b}, c).value();
         }},
    };
    return makers.at(row[0])();
}

// The level whose rounding moves a quantile: that of the location, or of its logarithm.
double RoundingLevel(const Distribution& d, double x) {
    const bool isLogarithmic =
        std::holds_alternative<LogPearsonThree>(d) || std::holds_alternative<LogNormal>(d);
    double sum = 0;
    for (const Parameter& parameter : Parameters(d)) {
        sum += std::abs(parameter.symbol == "kappa" ? 1 : parameter.value);
    }
    return isLogarithmic ? std::abs(x) * sum : std::abs(x) + sum;
}

// 50 digits, from the definitions; probabilities down to 1e-12, shapes from 0.05 to 4e6.
TEST(TailsOfOtherFamilies, AgreeWithHighPrecision) {
    const auto rows = ReferenceTable("families.csv");
    for (const auto& row : rows) {
        SCOPED_TRACE(row[0] + " " + row[1] + " " + row[2] + " " + row[3] + " at " + row[4]);
        const Distribution d = Member(row);
        const double p = ReferenceNumber(row[4]);
        const double upper = ReferenceNumber(row[5]);
        const double lower = ReferenceNumber(row[6]);
        EXPECT_NEAR(QuantileOfExceedance(d, p), upper, 2e-14 * RoundingLevel(d, upper));
        EXPECT_NEAR(Quantile(d, p), lower, 2e-14 * RoundingLevel(d, lower));
        const double density = ReferenceNumber(row[7]);
        const double step = 4 * kEpsilon * RoundingLevel(d, upper);
        const double slack = std::abs(LogDensity(d, upper + step) - LogDensity(d, upper));
        EXPECT_NEAR(LogDensity(d, upper), density, slack + 2e-14 * (1 + std::abs(density)));
    }
    EXPECT_EQ(rows.size(), 155U);
}

// False where x has too few digits left to compare densities: within 1e-3 of a bound's pole.
template <Family D>
bool ExpectRow(const D& d, const std::vector<std::string>& row) {
    const double p = ReferenceNumber(row[2]);
    const double upper = ReferenceNumber(row[3]);
    const double lower = ReferenceNumber(row[4]);
    const std::string place = row[0] + ", kappa " + row[1] + ", probability " + row[2];
    EXPECT_NEAR(QuantileOfExceedance(d, p), upper, 1e-13 * std::abs(upper)) << place;
    EXPECT_NEAR(Quantile(d, p), lower, 1e-13 * (std::abs(lower) + 3)) << place;
    // The reference has the density at the exact quantile, and near a bound a few units in the last
    // place of x make much of it.
    const double step = 4 * (std::nextafter(upper, kInfinity) - upper);
    const double slack = std::abs(LogDensity(d, upper + step) - LogDensity(d, upper - step));
    const double density = ReferenceNumber(row[5]);
    if (slack > 1e-3 || std::isnan(slack)) {
        return false;
    }
    EXPECT_NEAR(LogDensity(d, upper), density, slack + 1e-13 * std::abs(density)) << place;
    return true;
}

// Decimal arithmetic of 60 digits; shapes through 0, probabilities down to 1e-12.
TEST(TailsOfGevAndPareto, AgreeWithHighPrecision) {
    int densities = 0;
    const auto rows = ReferenceTable("tails.csv");
    for (const auto& row : rows) {
        const LocationScaleShape values{2, 3, ReferenceNumber(row[1])};
        const bool compared = row[0] == "GEV"
                                  ? ExpectRow(Gev::Make(values).value(), row)
                                  : ExpectRow(GeneralisedPareto::Make(values).value(), row);
        densities += compared ? 1 : 0;
    }
    EXPECT_EQ(rows.size(), 252U);
    EXPECT_GE(densities, 244);
}

TEST(TailsOfGumbelAndExponential, AreThoseOfShapeZero) {
    const Gumbel gumbel = Gumbel::Make({2, 3}).value();
    const Exponential exponential = Exponential::Make({2, 3}).value();
    int rows = 0;
    for (const auto& row : ReferenceTable("tails.csv")) {
        if (row[1] != "0") {
            continue;
        }
        ++rows;
        EXPECT_TRUE(row[0] == "GEV" ? ExpectRow(gumbel, row) : ExpectRow(exponential, row));
    }
    EXPECT_EQ(rows, 18);
}

TEST(GeneralisedPareto, DensityAtTheUpperEndFollowsTheShape) {
    const auto density = [](double kappa) {
        const GeneralisedPareto d = GeneralisedPareto::Make({0, 1, kappa}).value();
        return Density(d, Support(d).upper);
    };
    EXPECT_EQ(density(0.5), 0);
    EXPECT_EQ(density(1), 1);
    EXPECT_EQ(density(2), kInfinity);
}

TEST(ReducedVariate, GoesOnBelowAnEstimatedLowerBound) {
    const GeneralisedPareto pareto = GeneralisedPareto::Make({10, 2, 0.5}).value();
    EXPECT_NEAR(ReducedVariate(pareto, 9), -2 * std::log(1.25), 1e-15);
    EXPECT_EQ(ReducedVariate(Exponential::Make({10, 2}).value(), 9), -0.5);
    EXPECT_EQ(ReducedVariate(pareto, 14), kInfinity);
    EXPECT_EQ(StandardVariate(pareto, 9), -0.5);
}

// F(0) = exp(-a) belongs to the value 0 alone.
TEST(SquareRootExponential, GivesZeroAProbabilityOfItsOwn) {
    const auto d = SquareRootExponential::Make({2, 0.1}).value();
    EXPECT_EQ(Cdf(d, 0), std::exp(-2));
    EXPECT_EQ(Quantile(d, 0.13), 0);
    EXPECT_EQ(QuantileOfExceedance(d, 0.87), 0);
    const double above = Quantile(d, 0.136);
    EXPECT_GT(above, 0);
    EXPECT_NEAR(Cdf(d, above), 0.136, 1e-15);
    EXPECT_EQ(Cdf(d, -1e-300), 0);
}

// Bounds in logarithms that no double can be.
TEST(LogPearsonThree, HasBoundsBeyondTheDoubles) {
    const Interval low = LogPearsonThree::Make({-2000, 5e-4, 4e6}).value().Support();
    EXPECT_EQ(low.lower, 0);
    EXPECT_FALSE(low.Contains(0));
    const Interval high = LogPearsonThree::Make({2000, -5e-4, 4e6}).value().Support();
    EXPECT_EQ(high.upper, kInfinity);
    EXPECT_TRUE(high.Contains(1e308));
}

TEST(Parameters, TellWhichWereEstimated) {
    const auto fixed = GeneralisedPareto::Make({40, 11, -0.1}, LocationType::Fixed);
    const Distribution d = fixed.value();
    ASSERT_EQ(Parameters(d).size(), 3U);
    EXPECT_EQ(Parameters(d)[0].symbol, "xi");
    EXPECT_EQ(Parameters(d)[0].value, 40);
    EXPECT_FALSE(Parameters(d)[0].estimated);
    ASSERT_EQ(EstimatedParameters(d).size(), 2U);
    EXPECT_EQ(EstimatedParameters(d)[0].symbol, "alpha");
    EXPECT_EQ(EstimatedParameters(d)[1].value, -0.1);
}

} // namespace
} // namespace ryn::stats
