#include "stats/deletion.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

namespace ryn::stats {
namespace {

// Ascending, with ties, on a level far above the spread or with one value far from the rest.
std::vector<double> AscendingSample() {
    const auto steps = *rc::gen::container<std::vector<int>>(*rc::gen::inRange<std::size_t>(5, 40),
                                                             rc::gen::inRange(0, 50));
    const double level = *rc::gen::element(0.0, -3.0, 1e6);
    std::vector<double> values;
    values.reserve(steps.size());
    for (const int step : steps) {
        values.push_back(level + step / 8.0);
    }
    values.back() += *rc::gen::element(0.0, 1e3, -1e9);
    std::sort(values.begin(), values.end());
    return values;
}

std::vector<double> Without(std::vector<double> values, std::size_t index) {
    values.erase(values.begin() + static_cast<std::ptrdiff_t>(index));
    return values;
}

bool Near(double a, double b, double slack) {
    return std::abs(a - b) <= slack;
}

RC_GTEST_PROP(MomentDeletions, AreTheMomentsOfTheRest, ()) {
    const auto sample = AscendingSample();
    const MomentDeletions deletions(sample);
    for (std::size_t j = 0; j < sample.size(); ++j) {
        const CentralMoments quick = deletions.Without(j);
        const CentralMoments slow = CentralMomentsOf(Without(sample, j));
        const double s = std::sqrt(slow.m2);
        RC_ASSERT(quick.count == slow.count);
        // The reference rounds its mean, which shows in the odd moments where the level is high.
        const double slack = 1e-10 + 1e-15 * (s > 0 ? std::abs(slow.mean) / s : 0);
        RC_ASSERT(Near(quick.mean, slow.mean, 1e-15 * std::abs(slow.mean) + 1e-12 * s));
        RC_ASSERT(Near(quick.m2, slow.m2, slack * slow.m2));
        RC_ASSERT(Near(quick.m3, slow.m3, slack * slow.m2 * s));
        RC_ASSERT(Near(quick.m4, slow.m4, slack * slow.m4));
    }
}

RC_GTEST_PROP(LMomentDeletions, AreTheLMomentsOfTheRest, ()) {
    const auto sample = AscendingSample();
    const LMomentDeletions deletions(sample);
    for (std::size_t j = 0; j < sample.size(); ++j) {
        const LMoments quick = deletions.Without(j);
        const LMoments slow = LMomentsOfSorted(Without(sample, j));
        RC_ASSERT(quick.count == slow.count);
        const double slack = 1e-10 * slow.l2;
        RC_ASSERT(Near(quick.l1, slow.l1, 1e-15 * std::abs(slow.l1) + slack));
        RC_ASSERT(Near(quick.l2, slow.l2, slack));
        RC_ASSERT(Near(quick.l3, slow.l3, slack));
        RC_ASSERT(Near(quick.l4, slow.l4, slack));
    }
}

RC_GTEST_PROP(ShortenedSample, HoldsTheRestInAnyOrderOfDeletions, ()) {
    const auto sample = AscendingSample();
    ShortenedSample shortened(sample);
    const auto order = *rc::gen::container<std::vector<std::size_t>>(
        rc::gen::inRange<std::size_t>(0, sample.size()));
    for (const std::size_t j : order) {
        const auto rest = shortened.Without(j);
        const auto expected = Without(sample, j);
        RC_ASSERT(std::equal(rest.begin(), rest.end(), expected.begin(), expected.end()));
    }
}

} // namespace
} // namespace ryn::stats
