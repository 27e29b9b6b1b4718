#pragma once

#include <nlohmann/json.hpp>

#include "apps/cli/console.h"
#include "base/ole_date_time.h"

namespace ryn::cli {

/// Members stay in the order in which they were added.
using Json = nlohmann::ordered_json;

/// A number as JSON; null for what is not finite.
Json JsonOf(double value);
/// With the fewest digits that read back as the same 32-bit number.
Json JsonOf(float value);
/// "YYYY-MM-DDTHH:MM:SS"; null for an invalid date.
Json JsonOf(const COleDateTime& date);

/// Prints a value over several lines. Bytes that are no valid UTF-8 become U+FFFD.
void PrintJson(Console& console, const Json& value);

} // namespace ryn::cli
