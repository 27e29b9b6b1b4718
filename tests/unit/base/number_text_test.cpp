#include "base/number_text.h"

#include <clocale>
#include <cmath>
#include <cstring>
#include <limits>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace ryn {
namespace {

TEST(NumberText, IsTheShortestThatReadsBack) {
    EXPECT_EQ(ShortestText(0.1), "0.1");
    EXPECT_EQ(ShortestText(0.1F), "0.1");
    EXPECT_EQ(ShortestText(1e300), "1e+300");
    EXPECT_EQ(ShortestText(-0.0), "-0");
    EXPECT_EQ(ShortestText(std::numeric_limits<double>::infinity()), "inf");
    EXPECT_EQ(ShortestText(-std::nan("")), "nan");
}

TEST(NumberText, HasFixedDecimals) {
    EXPECT_EQ(FixedText(2.5, 0), "2");
    EXPECT_EQ(FixedText(-1.0 / 3.0, 3), "-0.333");
    EXPECT_EQ(FixedText(1e22, 1), "10000000000000000000000.0");
    EXPECT_EQ(FixedText(std::numeric_limits<double>::max(), 10).size(), 320U);
}

TEST(NumberText, ReadsWholeTextsOnly) {
    EXPECT_EQ(ParseDouble("12.5"), 12.5);
    EXPECT_EQ(ParseDouble("+1e3"), 1000.0);
    EXPECT_EQ(ParseDouble("-.5"), -0.5);
    for (const char* text :
         {"", " 1", "1 ", "1,5", "0x10", "+-1", "++1", "1e", "abc", "1e999", "-1e999", "1.5.2"})
        EXPECT_EQ(ParseDouble(text), std::nullopt) << text;
    EXPECT_EQ(ParseDouble("1e-999"), 0.0);
    EXPECT_TRUE(std::signbit(*ParseDouble("-1e-999")));
    const std::string zeros(400, '0');
    EXPECT_EQ(ParseDouble("1" + zeros + "e-1"), std::nullopt);
    EXPECT_EQ(ParseDouble("0." + zeros + "1e1"), 0.0);
    EXPECT_EQ(ParseDouble("1e-99999999999999999999"), 0.0);
    EXPECT_EQ(ParseDouble("1e99999999999999999999"), std::nullopt);
    EXPECT_EQ(ParseFloat("1e39"), std::nullopt);
    EXPECT_EQ(ParseFloat("0.00000000000000000000000000000000000000000000000001"), 0.0F);
    EXPECT_TRUE(std::isnan(*ParseDouble("NaN")));
    EXPECT_TRUE(std::isinf(*ParseDouble("-Infinity")));
    EXPECT_EQ(ParseInt("2147483647"), 2147483647);
    EXPECT_EQ(ParseInt("2147483648"), std::nullopt);
    EXPECT_EQ(ParseInt("1.0"), std::nullopt);
}

TEST(NumberText, HasADecimalPointInALocaleWithAComma) {
    ASSERT_NE(std::setlocale(LC_ALL, "de_DE.UTF-8"), nullptr);
    EXPECT_EQ(FixedText(1.5, 2), "1.50");
    EXPECT_EQ(ShortestText(1.5), "1.5");
    EXPECT_EQ(ParseDouble("1.5"), 1.5);
    EXPECT_EQ(ParseDouble("1,5"), std::nullopt);
    std::setlocale(LC_ALL, "C");
}

template <typename To, typename From>
To BitsAs(From bits) {
    To value{};
    static_assert(sizeof value == sizeof bits);
    std::memcpy(&value, &bits, sizeof value);
    return value;
}

RC_GTEST_PROP(NumberTextProperty, EveryNumberSurvivesTheWayThroughText, ()) {
    const auto number = BitsAs<double>(*rc::gen::arbitrary<std::uint64_t>());
    const auto single = BitsAs<float>(*rc::gen::arbitrary<std::uint32_t>());
    if (!std::isnan(number))
        RC_ASSERT(ParseDouble(ShortestText(number)) == number);
    if (!std::isnan(single))
        RC_ASSERT(ParseFloat(ShortestText(single)) == single);
}

} // namespace
} // namespace ryn
