#pragma once

#include <optional>
#include <string_view>

#include "import/civil_time.h"

namespace ryn {

/// What may follow the last field of a time: nothing, or a zone, with or without blanks before it.
bool ParseZoneTail(std::string_view text, TimeParts* parts);

/// "0 days 00:10:00", "1 day, 2:00:00.5", "3 days", "26:10:00": a length of time.
std::optional<Millis> ParseDuration(std::string_view text);

} // namespace ryn
