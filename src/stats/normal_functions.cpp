#include "stats/normal_functions.h"

#include "stats/quiet_policy.h"

#include <boost/math/special_functions/erf.hpp>

#include <cmath>
#include <numbers>

namespace ryn::stats {

double NormalCdf(double w) {
    return std::erfc(-w / std::numbers::sqrt2) / 2;
}

double NormalQuantile(double probability) {
    return -std::numbers::sqrt2 * boost::math::erfc_inv(2 * probability, QuietPolicy());
}

} // namespace ryn::stats
