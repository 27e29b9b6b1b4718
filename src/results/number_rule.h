#pragma once

#include <cstdint>
#include <string>

namespace ryn {

/// How the pages' tables write numbers.

/// The number of decimals that bring the first significant digit of a small number into view: 3 for
/// 0.004, 0 for 25, 0 and what is not finite.
std::int32_t CountDecimals(double value);

/// `value` with `decimals` decimals, at least 0 and at most what the dialogs let a user choose.
std::string DecimalText(double value, std::int32_t decimals);

/// `value` with `precision` decimals or, if that is more, with the number that CountDecimals gives
/// plus `extra`, so that a small value never shows as all zeros.
std::string NumberText(double value, std::int32_t precision, std::int32_t extra = 0);

/// `value`, but not a number without the sign that printf would show of it.
double WithoutNanSign(double value);

} // namespace ryn
