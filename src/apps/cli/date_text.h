#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "base/ole_date_time.h"

namespace ryn::cli {

/// "YYYY-MM-DDTHH:MM:SS", for files and JSON; empty for an invalid date.
std::string IsoText(const COleDateTime& date);

/// For people: "YYYY-MM-DD HH:MM", the seconds behind it only where there are any.
std::string DateForPeople(const COleDateTime& date);

/// A length of time for people in its largest units: "31 d 6 h", "10 min", "1 s".
std::string LengthForPeople(COleDateTimeSpan span);

/// Reads "YYYY-MM-DD", with "THH:MM" or "THH:MM:SS" behind it, or "MM-DD". A day without a year is
/// taken in `year`; 29 February then goes to the next leap year. Nothing for anything else and for
/// days that do not exist.
std::optional<COleDateTime> ParseDate(std::string_view text, int year);

} // namespace ryn::cli
