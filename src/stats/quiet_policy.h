#pragma once

#include <boost/math/policies/policy.hpp>

namespace ryn::stats {

/// For the special functions of Boost.Math: NaN or infinity where its default is to throw, and
/// arithmetic in double, which resampling needs for its speed.
using QuietPolicy = boost::math::policies::policy<
    boost::math::policies::promote_double<false>,
    boost::math::policies::domain_error<boost::math::policies::ignore_error>,
    boost::math::policies::pole_error<boost::math::policies::ignore_error>,
    boost::math::policies::overflow_error<boost::math::policies::ignore_error>,
    boost::math::policies::evaluation_error<boost::math::policies::ignore_error>,
    boost::math::policies::rounding_error<boost::math::policies::ignore_error>,
    boost::math::policies::indeterminate_result_error<boost::math::policies::ignore_error>>;

} // namespace ryn::stats
