#include "base/ole_date_time.h"

#include <array>
#include <cmath>
#include <cstdint>

namespace ryn {

namespace {

constexpr int kFirstYear = 100;
constexpr int kLastYear = 9999;
constexpr std::int64_t kSecondsPerDay = 86400;

// Days since 30 December 1899 of a civil date, and back, by counting 400-year eras from 1 March of
// year 0 (Fliegel-type arithmetic: with the year starting in March, the leap day comes last).
constexpr std::int64_t kDaysFromEraStartToEpoch = 693899; // 0000-03-01 to 1899-12-30

std::int64_t DaysFromCivil(int year, int month, int day) {
    const std::int64_t y = month <= 2 ? year - 1 : year;
    const std::int64_t era = y / 400;
    const std::int64_t yearOfEra = y - era * 400;
    const std::int64_t dayOfYear = (153 * (month + (month > 2 ? -3 : 9)) + 2) / 5 + day - 1;
    const std::int64_t dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
    return era * 146097 + dayOfEra - kDaysFromEraStartToEpoch;
}

void CivilFromDays(std::int64_t days, COleDateTime::Fields* fields) {
    const std::int64_t z = days + kDaysFromEraStartToEpoch; // positive for every year from 100 on
    const std::int64_t era = z / 146097;
    const std::int64_t dayOfEra = z - era * 146097;
    const std::int64_t yearOfEra =
        (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const std::int64_t dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const std::int64_t shiftedMonth = (5 * dayOfYear + 2) / 153;
    fields->day = static_cast<int>(dayOfYear - (153 * shiftedMonth + 2) / 5 + 1);
    fields->month = static_cast<int>(shiftedMonth < 10 ? shiftedMonth + 3 : shiftedMonth - 9);
    fields->year = static_cast<int>(yearOfEra + era * 400 + (fields->month <= 2 ? 1 : 0));
}

bool FieldsInRange(const COleDateTime::Fields& f) {
    return f.year >= kFirstYear && f.year <= kLastYear && f.month >= 1 && f.month <= 12 &&
           f.day >= 1 && f.day <= DaysInMonth(f.year, f.month) && f.hour >= 0 && f.hour <= 23 &&
           f.minute >= 0 && f.minute <= 59 && f.second >= 0 && f.second <= 59;
}

void AppendPadded(std::string* text, int value, std::size_t width) {
    const std::string digits = std::to_string(value);
    if (digits.size() < width)
        text->append(width - digits.size(), '0');
    text->append(digits);
}

} // namespace

bool IsLeapYear(int year) {
    return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
}

int DaysInMonth(int year, int month) {
    static constexpr std::array<int, 12> kDays = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    return month == 2 && IsLeapYear(year) ? 29 : kDays[static_cast<std::size_t>(month - 1)];
}

COleDateTime::COleDateTime(double dayCount) {
    const double whole = std::ceil(dayCount);
    *this = FromLinearCount(dayCount > -kHalfSecond ? dayCount : whole - (dayCount - whole));
}

COleDateTime::COleDateTime(int year, int month, int day, int hour, int minute, int second) {
    const Fields fields{year, month, day, hour, minute, second};
    if (!FieldsInRange(fields))
        return;
    const auto whole = static_cast<double>(DaysFromCivil(year, month, day));
    const double fraction = static_cast<double>(hour * 3600 + minute * 60 + second) /
                            static_cast<double>(kSecondsPerDay);
    linear = whole + fraction;
}

double COleDateTime::DayCount() const {
    if (!(linear <= -kHalfSecond))
        return linear;
    const double whole = std::floor(linear);
    return whole + (whole - linear);
}

COleDateTime::Fields COleDateTime::GetFields() const {
    Fields fields;
    if (!IsValid())
        return fields;
    const auto total = static_cast<std::int64_t>(
        std::floor(LinearCount() * static_cast<double>(kSecondsPerDay) + 0.5));
    std::int64_t days = total / kSecondsPerDay;
    std::int64_t seconds = total - days * kSecondsPerDay;
    if (seconds < 0) {
        seconds += kSecondsPerDay;
        --days;
    }
    CivilFromDays(days, &fields);
    fields.hour = static_cast<int>(seconds / 3600);
    fields.minute = static_cast<int>(seconds / 60 % 60);
    fields.second = static_cast<int>(seconds % 60);
    return fields;
}

std::string COleDateTime::Format(std::string_view pattern) const {
    std::string text;
    if (!IsValid())
        return text;
    const Fields fields = GetFields();
    for (std::size_t i = 0; i < pattern.size(); ++i) {
        if (pattern[i] != '%' || i + 1 == pattern.size()) {
            text.push_back(pattern[i]);
            continue;
        }
        switch (pattern[++i]) {
        case 'Y':
            AppendPadded(&text, fields.year, 4);
            break;
        case 'm':
            AppendPadded(&text, fields.month, 2);
            break;
        case 'd':
            AppendPadded(&text, fields.day, 2);
            break;
        case 'H':
            AppendPadded(&text, fields.hour, 2);
            break;
        case 'M':
            AppendPadded(&text, fields.minute, 2);
            break;
        case 'S':
            AppendPadded(&text, fields.second, 2);
            break;
        default:
            text.push_back(pattern[i]);
            break;
        }
    }
    return text;
}

COleDateTime COleDateTime::operator+(COleDateTimeSpan span) const {
    return FromLinearCount(LinearCount() + span.GetTotalDays());
}

COleDateTime COleDateTime::operator-(COleDateTimeSpan span) const {
    return FromLinearCount(LinearCount() - span.GetTotalDays());
}

COleDateTimeSpan COleDateTime::operator-(const COleDateTime& other) const {
    return COleDateTimeSpan(LinearCount() - other.LinearCount());
}

} // namespace ryn
