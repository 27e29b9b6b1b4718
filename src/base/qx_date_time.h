#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "base/ole_date_time.h"

namespace ryn {

/// A date and time that converts to a double count of days since 30 December 1899, proleptic
/// Gregorian. The count is the linear one, which has no sign rule for the time of day: differences
/// are those of the numbers. An invalid date converts to NaN.
class CQxDateTime {
  public:
    /// An invalid date.
    CQxDateTime() = default;
    /// Invalid when the count is not finite or outside the years 100 to 9999.
    explicit CQxDateTime(double dayCount) : date(COleDateTime::FromLinearCount(dayCount)) {}
    /// From milliseconds since 1970-01-01 00:00:00.
    static CQxDateTime FromUnixMilliseconds(std::int64_t milliseconds) {
        constexpr double kUnixEpochDay = 25569.0;
        return CQxDateTime(static_cast<double>(milliseconds) / 86400000.0 + kUnixEpochDay);
    }

    bool IsValid() const { return date.IsValid(); }
    operator double() const { return date.LinearCount(); }
    /// As COleDateTime::Format: %Y %m %d %H %M %S of the nearest whole second.
    std::string Format(std::string_view pattern) const { return date.Format(pattern); }

  private:
    COleDateTime date;
};

} // namespace ryn
