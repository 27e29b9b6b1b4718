#include "stats/shape_functions.h"

#include "unit/stats/reference_files.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace ryn::stats {
namespace {

using testing::ReferenceNumber;
using testing::ReferenceTable;

constexpr double kInfinity = std::numeric_limits<double>::infinity();

// 1e-16 stands in for B(1) = 0.
double Error(double value, double expected) {
    return std::abs(value - expected) / std::max(std::abs(expected), 1e-4);
}

// The table is made in decimal arithmetic of 80 digits and holds shapes on both sides of the seam
// between power series and direct form, at |kappa| = 0.01.
TEST(ShapeFunctions, AgreeWithHighPrecisionOnBothSidesOfTheSeam) {
    for (const auto& row : ReferenceTable("shape_functions.csv")) {
        const double kappa = ReferenceNumber(row[0]);
        EXPECT_LT(Error(GevVarianceFactor(kappa), ReferenceNumber(row[1])), 1e-13) << row[0];
        EXPECT_LT(Error(GevMeanFactor(kappa), ReferenceNumber(row[2])), 2e-14) << row[0];
        EXPECT_LT(Error(GevSkewness(kappa), ReferenceNumber(row[3])), 1e-11) << row[0];
        EXPECT_LT(Error(GevLSkewness(kappa), ReferenceNumber(row[4])), 1e-13) << row[0];
    }
}

TEST(ShapeFunctions, AreContinuousAcrossTheSeam) {
    for (const double seam : {-0.01, 0.01}) {
        const double inside = std::nextafter(seam, 0.0);
        EXPECT_LT(Error(GevVarianceFactor(seam), GevVarianceFactor(inside)), 1e-12);
        EXPECT_LT(Error(GevMeanFactor(seam), GevMeanFactor(inside)), 1e-13);
        EXPECT_LT(Error(GevSkewness(seam), GevSkewness(inside)), 1e-11);
    }
}

TEST(ShapeFunctions, TakePublishedValuesOfTheSkewness) {
    EXPECT_NEAR(GevSkewness(0.01), 1.08107375980727, 1e-11);
    EXPECT_NEAR(GevSkewness(-0.01), 1.20047851976256, 1e-11);
    EXPECT_NEAR(GevSkewness(0), 1.1395470994, 1e-10); // 12 sqrt(6) zeta(3)/pi^3
}

TEST(ShapeFunctions, ReducedAndStandardVariateAreInverse) {
    for (const double kappa : {-0.9, -0.1, -1e-9, -1e-15, 0.0, 1e-15, 1e-9, 0.1, 1.0, 3.0}) {
        for (const double y : {-3.0, -0.1, 1e-9, 0.5, 5.0, 9.0}) {
            // Near a bound 1 - kappa z has lost digits that z once had.
            const double slack = 1e-15 * (1 + std::exp(std::abs(kappa * y)));
            EXPECT_NEAR(ReducedOfStandard(StandardOfReduced(y, kappa), kappa), y,
                        slack * (1 + std::abs(y)) / std::max(std::abs(kappa), 0.1))
                << kappa << ", " << y;
        }
    }
}

TEST(ShapeFunctions, MapBoundsToInfinityAndBack) {
    EXPECT_EQ(ReducedOfStandard(2.0, 0.5), kInfinity);
    EXPECT_EQ(ReducedOfStandard(2.1, 0.5), kInfinity);
    EXPECT_EQ(ReducedOfStandard(-2.0, -0.5), -kInfinity);
    EXPECT_EQ(ReducedOfStandard(-2.1, -0.5), -kInfinity);
    EXPECT_EQ(StandardOfReduced(kInfinity, 0.5), 2);
    EXPECT_EQ(StandardOfReduced(-kInfinity, -0.5), -2);
    EXPECT_EQ(StandardOfReduced(kInfinity, -0.5), kInfinity);
    EXPECT_EQ(StandardOfReduced(-kInfinity, 0.5), -kInfinity);
    EXPECT_TRUE(std::isnan(ReducedOfStandard(std::nan(""), 0.5)));
}

} // namespace
} // namespace ryn::stats
