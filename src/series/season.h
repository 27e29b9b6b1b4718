#pragma once

#include <compare>
#include <limits>

#include "base/ole_date_time.h"
#include "series/selection_rules.h"

namespace ryn {

/// A day of the year: month, then day.
struct MonthDay {
    int month = 1;
    int day = 1;

    static MonthDay Of(const COleDateTime& date) {
        const COleDateTime::Fields fields = date.GetFields();
        return {fields.month, fields.day};
    }
    // The check takes the zero of a defaulted comparison for a pointer.
    auto operator<=>(const MonthDay&) const = default; // NOLINT(modernize-use-nullptr)

    /// This day in a year: 29 February becomes 1 March in a common year.
    MonthDay In(int year) const;
    /// Midnight at the start of this day in a year. Years out of the calendar's range give its
    /// first and its last moment.
    COleDateTime MidnightIn(int year) const;
};

/// The part of the year whose samples count.
///
/// With the start strictly before the end the season lies within one calendar year and holds both
/// days. Otherwise, equal days included, it wraps over the new year and holds neither.
class Season {
  public:
    Season(const COleDateTime& start, const COleDateTime& end);

    bool Wraps() const { return !(start < end); }
    const MonthDay& Start() const { return start; }
    const MonthDay& End() const { return end; }

    bool Holds(const COleDateTime& date);

  private:
    bool HoldsDay(const COleDateTime& date) const;

    MonthDay start;
    MonthDay end;
    // Samples of one day stand together in a series, so the last day's answer serves for most.
    double knownDay = std::numeric_limits<double>::quiet_NaN();
    bool knownAnswer = false;
};

} // namespace ryn
