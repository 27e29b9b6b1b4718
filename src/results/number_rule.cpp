#include "results/number_rule.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "base/number_text.h"

namespace ryn {

namespace {

/// A file can hold any number as precision; printing a billion decimals would not end.
std::int32_t Bounded(std::int32_t precision) {
    constexpr std::int32_t kMostDecimals = 10;
    return std::clamp(precision, 0, kMostDecimals);
}

} // namespace

std::int32_t CountDecimals(double value) {
    std::int32_t decimals = 0;
    if (value == 0.0)
        return decimals;
    for (double magnitude = std::fabs(value); magnitude < 1.0; magnitude *= 10.0)
        ++decimals;
    return decimals;
}

std::string DecimalText(double value, std::int32_t decimals) {
    return FixedText(value, Bounded(decimals));
}

std::string NumberText(double value, std::int32_t precision, std::int32_t extra) {
    return FixedText(value, std::max(Bounded(precision), CountDecimals(value) + extra));
}

double WithoutNanSign(double value) {
    return std::isnan(value) ? std::numeric_limits<double>::quiet_NaN() : value;
}

} // namespace ryn
