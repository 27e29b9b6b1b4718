#include "series/season.h"

#include <cmath>

namespace ryn {

MonthDay MonthDay::In(int year) const {
    return month == 2 && day == 29 && !IsLeapYear(year) ? MonthDay{3, 1} : *this;
}

COleDateTime MonthDay::MidnightIn(int year) const {
    if (year < 100)
        return {100, 1, 1, 0, 0, 0};
    if (year > 9999)
        return COleDateTime(2958465.9999999); // some 10 ms before the end of 9999
    const MonthDay real = In(year);
    return {year, real.month, real.day, 0, 0, 0};
}

Season::Season(const COleDateTime& startDate, const COleDateTime& endDate)
    : start(MonthDay::Of(startDate)),
      end(MonthDay::Of(endDate)) {}

bool Season::Holds(const COleDateTime& date) {
    // Half a second is added as the fields do, so that both change days at the same moment.
    const double day = std::floor(date.LinearCount() + COleDateTime::kHalfSecond);
    if (day != knownDay) {
        knownDay = day;
        knownAnswer = HoldsDay(date);
    }
    return knownAnswer;
}

bool Season::HoldsDay(const COleDateTime& date) const {
    const COleDateTime::Fields fields = date.GetFields();
    const MonthDay day{fields.month, fields.day};
    const MonthDay first = start.In(fields.year);
    const MonthDay last = end.In(fields.year);
    return Wraps() ? day > first || day < last : first <= day && day <= last;
}

} // namespace ryn
