#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "base/status.h"
#include "netcdf/cf_calendar.h"

namespace ryn {

/// Times of a CF axis: a unit, a reference moment and a calendar ("days since 1850-01-01" with
/// "noleap"). Units from nanoseconds to years in their usual writings. A unit without a reference
/// ("s") makes a relative axis.
///
/// Months and years count by the calendar ("months since 2000-01-15" puts 1 at 15 February) until
/// UseMeanMonths is called, which makes them UDUNITS' mean ones (a twelfth of 365.242198781 days):
/// a file with fractions of months can mean nothing else.
class CfTime {
  public:
    /// The fault's text says what is wrong with which attribute, and names no file.
    static Status Parse(std::string_view units, std::string_view calendar, CfTime* result);

    bool IsRelative() const { return !reference.has_value(); }
    bool CountsMonths() const { return monthsInUnit != 0; }
    void UseMeanMonths() { monthsInUnit = 0; }

    /// A time as milliseconds since 1970-01-01 00:00:00, proleptic Gregorian, rounded; of a
    /// relative axis as milliseconds since its zero. Nothing for what is not finite or not within
    /// the years 100 to 9999.
    std::optional<std::int64_t> Milliseconds(double value) const;

    /// The unit as the file writes it ("days").
    const std::string& UnitName() const { return unitName; }
    CfCalendar Calendar() const { return calendar; }
    /// The reference moment as Milliseconds gives them; 0 for a relative axis.
    std::int64_t ReferenceMilliseconds() const;

  private:
    std::int64_t AddMonths(std::int64_t months) const;

    std::string unitName;
    double millisecondsInUnit = 0.0;
    int monthsInUnit = 0;
    CfCalendar calendar = CfCalendar::Standard;
    std::optional<std::int64_t> reference; // on the calendar's own count
};

} // namespace ryn
