#include "results/number_rule.h"

#include <limits>

#include <gtest/gtest.h>

namespace ryn {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

TEST(NumberRule, CountsTheDecimalsThatBringASmallNumberIntoView) {
    const struct {
        double value;
        int decimals;
    } cases[] = {
        {0.0, 0},        {1.0, 0},     {0.999, 1},  {0.1, 1},      {0.004, 3},
        {-0.004, 3},     {25.0, 0},    {-25.0, 0},  {kNaN, 0},     {kInfinity, 0},
        {-kInfinity, 0}, {0.00012, 4}, {1e-10, 10}, {5e-324, 324},
    };
    for (const auto& c : cases)
        EXPECT_EQ(CountDecimals(c.value), c.decimals) << c.value;
}

TEST(NumberRule, ShowsThePrecisionOrWhatASmallNumberNeeds) {
    const struct {
        double value;
        int precision;
        int extra;
        const char* text;
    } cases[] = {
        {0.00012, 3, 0, "0.0001"},
        {12.5, 3, 0, "12.500"},
        {0.0, 3, 0, "0.000"},
        {12.0, 0, 0, "12"},
        {12.0, 0, 2, "12.00"},
        {0.0, 0, 2, "0.00"},
        {0.04, 1, 2, "0.0400"},
        {-0.00004, 3, 0, "-0.00004"},
        {kNaN, 3, 0, "nan"},
        {-kNaN, 3, 0, "nan"},
        {-kInfinity, 3, 0, "-inf"},
        {1.5, -7, 0, "2"},
        {1.5, 2000000000, 0, "1.5000000000"}, // as a file may have it
    };
    for (const auto& c : cases)
        EXPECT_EQ(NumberText(c.value, c.precision, c.extra), c.text);
    EXPECT_EQ(DecimalText(0.0001, 3), "0.000"); // the plotting position page adds no decimals
}

} // namespace
} // namespace ryn
