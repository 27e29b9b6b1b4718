#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "netcdf/cf_calendar.h"

namespace ryn {

/// The reference moment of a time unit ("1990-1-1T00:00:00Z", "1900-01-01 00:00:0.0 +1:00",
/// "19700101", "1850-01"), in milliseconds on the calendar's own count (RealMilliseconds) and in
/// universal time. Nothing when the text is none or the calendar has no such day.
std::optional<std::int64_t> ParseTimeReference(std::string_view text, CfCalendar calendar);

} // namespace ryn
