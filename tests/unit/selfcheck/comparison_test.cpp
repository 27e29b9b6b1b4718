#include "selfcheck/comparison.h"

#include <clocale>
#include <cmath>

#include <gtest/gtest.h>

#include "base/number_text.h"

namespace ryn::selfcheck {
namespace {

Comparison Compared(std::string_view expected, double found) {
    Comparisons list;
    Compare(list, {"A1", "portpirie", "GEV/MOM", "a book"}, "xi", expected, found);
    return list.at(0);
}

// Half a unit on both sides, and not a thousandth of a unit more.
TEST(Comparison, AgreesWithinHalfAUnitOfTheLastDigit) {
    const struct {
        std::string_view expected;
        double unit;
    } cases[] = {{"4.29620", 1e-5},      {"-0.050", 1e-3},        {"11", 1},
                 {"9.552665e-6", 1e-12}, {"5.380186e-32", 1e-38}, {"1.36789e8", 1e3}};
    for (const auto& c : cases) {
        const double value = ParseDouble(c.expected).value();
        for (const double side : {-1.0, 1.0}) {
            EXPECT_TRUE(Compared(c.expected, value + side * 0.499 * c.unit).agrees) << c.expected;
            EXPECT_FALSE(Compared(c.expected, value + side * 0.501 * c.unit).agrees) << c.expected;
        }
        EXPECT_NEAR(Tolerance(c.expected), 0.5 * c.unit, 1e-6 * c.unit);
    }
}

TEST(Comparison, NeverAgreesWithANumberThatIsNone) {
    EXPECT_FALSE(Compared("1.0", std::nan("")).agrees);
    EXPECT_FALSE(Compared("1.0", INFINITY).agrees);
    EXPECT_FALSE(Compared("none", 1.0).agrees);
    EXPECT_TRUE(Compared("none", std::nan("")).agrees);
    EXPECT_FALSE(Compared("one", 1.0).agrees); // no number was expected
}

TEST(Comparison, ShowsWhatWasFoundInTheNotationOfWhatWasExpected) {
    EXPECT_EQ(FoundText(Compared("4.29620", 4.2961963)), "4.29620");
    EXPECT_EQ(FoundText(Compared("11", 12.0)), "12");
    EXPECT_EQ(FoundText(Compared("9.552665e-6", 9.5526649e-6)), "9.552665e-6");
    EXPECT_EQ(FoundText(Compared("1.36789e8", 136789437.0)), "1.36789e8");
    EXPECT_EQ(FoundText(Compared("1.0", std::nan(""))), "none");
}

TEST(Comparison, TakesNoNoticeOfTheLocale) {
    ASSERT_NE(std::setlocale(LC_ALL, "de_DE.UTF-8"), nullptr);
    const Comparison comparison = Compared("4.29620", 4.2962);
    EXPECT_TRUE(comparison.agrees);
    EXPECT_EQ(FoundText(comparison), "4.29620");
    std::setlocale(LC_ALL, "C");
}

} // namespace
} // namespace ryn::selfcheck
