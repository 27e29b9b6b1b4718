#include "selfcheck/self_check.h"

#include <algorithm>
#include <map>
#include <set>
#include <string>
#include <tuple>

#include <gtest/gtest.h>

#include "selfcheck/named_combination.h"
#include "selfcheck/reference_series.h"
#include "unit/stats/named_combinations.h"
#include "unit/stats/reference_files.h"

namespace ryn::selfcheck {
namespace {

TEST(SelfCheck, MeetsEveryPublishedValueToEveryDigit) {
    for (const Comparison& c : RunSelfCheck()) {
        EXPECT_TRUE(c.agrees) << c.label.number << ' ' << c.label.series << ' ' << c.label.subject
                              << ' ' << c.quantity << ": expected " << c.expected << ", found "
                              << FoundText(c);
        EXPECT_EQ(FoundText(c).size(), c.expected.size()) << c.expected;
    }
}

TEST(SelfCheck, HoldsEachValueOnceWithItsSource) {
    std::set<std::tuple<std::string_view, std::string_view, std::string>> seen;
    for (const Comparison& c : RunSelfCheck()) {
        EXPECT_TRUE(seen.insert({c.label.number, c.label.subject, c.quantity}).second)
            << c.label.number << ' ' << c.quantity;
        EXPECT_FALSE(c.label.source.empty()) << c.label.number;
        EXPECT_FALSE(c.expected.empty()) << c.label.number << ' ' << c.quantity;
    }
}

TEST(SelfCheck, HoldsEveryCaseOfEveryGroup) {
    std::map<char, std::set<std::string_view>> numbers;
    for (const Comparison& c : RunSelfCheck())
        numbers[c.label.number.front()].insert(c.label.number);
    const std::map<char, std::size_t> expected = {{'A', 41}, {'P', 37}, {'Y', 3}, {'C', 2},
                                                  {'B', 2},  {'G', 13}, {'T', 9}, {'U', 9},
                                                  {'M', 3},  {'S', 4},  {'Q', 1}, {'F', 14}};
    for (const auto& [group, count] : expected)
        EXPECT_EQ(numbers[group].size(), count) << group;
    EXPECT_EQ(numbers.size(), expected.size());
}

// Each combination of the dialogs whose fit was published at all.
TEST(SelfCheck, KnowsItsCombinationsByTheirNames) {
    for (const NamedCombination& known : kCombinations) {
        std::string name(known.name);
        if (const std::size_t blank = name.find(" corrected"); blank != std::string::npos)
            name.replace(blank, std::string::npos, " corr");
        const stats::Combination expected = stats::testing::Named(name);
        EXPECT_EQ(known.combination.distribution, expected.distribution) << name;
        EXPECT_EQ(known.combination.method, expected.method) << name;
        EXPECT_EQ(known.combination.location, expected.location) << name;
        EXPECT_EQ(known.combination.logPearson, expected.logPearson) << name;
        EXPECT_EQ(known.combination.logNormal, expected.logNormal) << name;
        EXPECT_EQ(known.combination.sampleCorrection, expected.sampleCorrection) << name;
    }
}

// The scripts that make the reference tables read these files.
TEST(ReferenceSeries, AreThoseOfTheReferenceFiles) {
    EXPECT_EQ(AllSeries().size(), 7U);
    for (const ReferenceSeries& series : AllSeries()) {
        const std::string name(series.name);
        const auto values = stats::testing::ReferenceSeries(name);
        EXPECT_TRUE(
            std::equal(values.begin(), values.end(), series.values.begin(), series.values.end()))
            << name;
        const stats::SeriesFrame frame = stats::testing::FrameOf(name);
        EXPECT_EQ(series.frame.kind, frame.kind) << name;
        EXPECT_EQ(series.frame.threshold, frame.threshold) << name;
        EXPECT_EQ(series.frame.rate, frame.rate) << name;
    }
}

} // namespace
} // namespace ryn::selfcheck
