#pragma once

#include <boost/math/policies/policy.hpp>
#include <boost/math/tools/roots.hpp>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <optional>

namespace ryn::stats {

/// Where a root is looked for; lower < upper.
struct Bracket {
    double lower;
    double upper;
};

/// True when both ends agree to a relative 1e-13. The absolute part lets a root at 0 be reached:
/// shapes closer to 0 than 1e-14 count as 0 anyway.
inline bool RootIsReached(double a, double b) {
    return std::abs(a - b) <= 1e-13 * std::max(std::abs(a), std::abs(b)) + 1e-16;
}

/// The root of `f` between the ends of `bracket`, to a relative 1e-13, by Alefeld, Potra and Shi's
/// method (ACM TOMS 748), which like Brent's (1973) keeps the root bracketed; at most 200 more
/// evaluations. Nothing when `f` has the same sign at both ends, or NaN at one of them.
template <class F>
std::optional<double> Root(F&& f, Bracket bracket) {
    const double atLower = f(bracket.lower);
    const double atUpper = f(bracket.upper);
    if (atLower == 0 || atUpper == 0) {
        return atLower == 0 ? bracket.lower : bracket.upper;
    }
    if (!((atLower < 0 && atUpper > 0) || (atLower > 0 && atUpper < 0))) {
        return std::nullopt;
    }
    using namespace boost::math::policies;
    using Quiet = policy<domain_error<ignore_error>, evaluation_error<ignore_error>>;
    std::uintmax_t evaluations = 200;
    const auto [a, b] = boost::math::tools::toms748_solve(
        f, bracket.lower, bracket.upper, atLower, atUpper, RootIsReached, evaluations, Quiet());
    return a + (b - a) / 2;
}

/// As Root, but tries the neighbourhood `guess` +- `reach` first: with a good guess this takes a
/// few evaluations instead of a dozen. The guess changes the cost, not the answer, where `f` has
/// one root.
template <class F>
std::optional<double> RootNear(F&& f, Bracket bracket, double guess, double reach) {
    const Bracket narrow{std::max(bracket.lower, guess - reach),
                         std::min(bracket.upper, guess + reach)};
    if (narrow.lower < narrow.upper) {
        if (const auto root = Root(f, narrow)) {
            return root;
        }
    }
    return Root(f, bracket);
}

} // namespace ryn::stats
