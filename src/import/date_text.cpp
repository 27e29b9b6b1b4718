#include "import/date_text.h"

#include <array>
#include <cmath>
#include <optional>

#include "base/number_text.h"
#include "import/clock_text.h"
#include "import/text_cursor.h"

namespace ryn {

namespace {

/// One of the three pieces of a date.
struct DateToken {
    int value = -1;
    int digits = 0; ///< 0 for a month's name
};

struct DateTokens {
    std::array<DateToken, 3> token;
    int count = 0;
    char separator = '\0'; ///< ' ' where a month's name stands
};

/// Digits, or a month's name.
bool TakeToken(TextCursor* cursor, DateToken* token) {
    if (IsDigit(cursor->Peek())) {
        // Five digits and more are no part of a separated date.
        token->value = cursor->TakeNumber(4, &token->digits);
        return !IsDigit(cursor->Peek());
    }
    token->value = MonthOfName(cursor->TakeWord());
    token->digits = 0;
    return token->value > 0;
}

/// The sign between two pieces of a date: one of - / . or a blank; with a month's name also ", ".
char TakeDateSeparator(TextCursor* cursor) {
    const char c = cursor->Peek();
    if (c != '-' && c != '/' && c != '.' && c != ' ' && c != ',')
        return '\0';
    cursor->Skip();
    // "31. Dezember 2001", "Dec 31, 2001".
    if (c == '.' || c == ',')
        cursor->SkipBlanks();
    return c;
}

bool HasName(const DateTokens& date) {
    for (int i = 0; i < date.count; ++i)
        if (date.token[static_cast<std::size_t>(i)].digits == 0)
            return true;
    return false;
}

/// Takes up to three pieces; false where no date starts or its separators are mixed.
bool TakeDateTokens(TextCursor* cursor, DateTokens* date) {
    while (date->count < 3) {
        if (!TakeToken(cursor, &date->token[static_cast<std::size_t>(date->count)]))
            return false;
        ++date->count;
        if (date->count == 3 || cursor->IsAtEnd())
            break;
        const char separator = TakeDateSeparator(cursor);
        if (separator == '\0')
            return false;
        if (date->separator != '\0' && separator != date->separator && !HasName(*date) &&
            !IsLetter(cursor->Peek()))
            return false;
        date->separator = separator;
    }
    return true;
}

/// A year of four digits, or of two by the rule for them.
bool SetYear(const DateToken& token, TimeParts* parts) {
    parts->year = token.digits <= 2 ? YearOfTwoDigits(token.value) : token.value;
    return token.digits == 4 || token.digits == 2;
}

bool SetMonth(const DateToken& token, TimeParts* parts) {
    parts->month = token.value;
    return token.digits <= 2 && token.value <= 12;
}

bool SetDay(const DateToken& token, TimeParts* parts) {
    parts->day = token.value;
    return (token.digits == 1 || token.digits == 2) && token.value <= 31;
}

/// "1869-07", "07/1869", "1939": dates of which only month or year is known.
bool IsPartOfDate(const DateTokens& date) {
    if (date.count == 1)
        return date.token[0].digits == 4;
    if (date.count != 2 || date.separator == '.' || date.separator == ' ')
        return false;
    return (date.token[0].digits == 4 && date.token[1].digits <= 2 && date.token[1].value <= 12) ||
           (date.token[1].digits == 4 && date.token[0].digits <= 2 && date.token[0].value <= 12);
}

/// The pieces in the order of the form; false where one cannot be what it should. The number of its
/// digits tells a year from a day, so that a form is not read as another by chance.
bool AssignTokens(const DateTokens& date, DateForm form, TimeParts* parts) {
    const auto& [a, b, c] = date.token;
    switch (form) {
    case DateForm::YearMonthDay:
        return a.digits == 4 && SetYear(a, parts) && SetMonth(b, parts) && SetDay(c, parts);
    case DateForm::ShortYearMonthDay:
        return a.digits == 2 && SetYear(a, parts) && SetMonth(b, parts) && SetDay(c, parts);
    case DateForm::DayMonthYear:
        return SetDay(a, parts) && SetMonth(b, parts) && SetYear(c, parts);
    case DateForm::MonthDayYear:
        return SetMonth(a, parts) && SetDay(b, parts) && SetYear(c, parts);
    default:
        return false;
    }
}

/// What may follow a date: nothing, or a separator and a clock time.
bool TakeClockTail(TextCursor* cursor, TimeParts* parts) {
    if (cursor->IsAtEnd())
        return true;
    const char c = cursor->Peek();
    if (c == 'T' || c == ' ' || c == '/' || c == '-' || c == ':' || c == '_' || c == ',') {
        cursor->Skip();
        cursor->SkipBlanks();
        // Behind a comma only a clock with a colon: "2001-01-01,5" is a date and a value.
        return (c != ',' || cursor->Rest().find(':') != std::string_view::npos) &&
               ParseClock(cursor->Rest(), parts);
    }
    return false;
}

/// The year with four digits, or a month's name, tells which is which.
TimeResult ParseYearMonth(std::string_view text, TimeParts* parts) {
    TextCursor cursor(text);
    DateTokens date;
    if (!TakeDateTokens(&cursor, &date) || !cursor.IsAtEnd() || date.separator == '.')
        return TimeResult::Bad;
    if (date.count == 1)
        return date.token[0].digits == 4 ? TimeResult::Incomplete : TimeResult::Bad;
    if (date.count != 2)
        return TimeResult::Bad;
    // Either order is clear: only one of the two has four digits.
    const bool yearFirst = date.token[0].digits == 4;
    const DateToken& year = date.token[yearFirst ? 0 : 1];
    const DateToken& month = date.token[yearFirst ? 1 : 0];
    if ((year.digits != 4 && month.digits != 0) || !SetYear(year, parts) || !SetMonth(month, parts))
        return TimeResult::Bad;
    return parts->month == 0 ? TimeResult::Incomplete : TimeResult::Ok;
}

TimeResult ParseSeparated(std::string_view text, DateForm form, TimeParts* parts) {
    TextCursor cursor(text);
    DateTokens date;
    if (!TakeDateTokens(&cursor, &date))
        return TimeResult::Bad;
    if (date.count < 3) {
        if (!cursor.IsAtEnd() || !IsPartOfDate(date))
            return TimeResult::Bad;
        (void)ParseYearMonth(text, parts); // as far as the parts are there
        return TimeResult::Incomplete;
    }
    if (!AssignTokens(date, form, parts) || !TakeClockTail(&cursor, parts))
        return TimeResult::Bad;
    return parts->month == 0 || parts->day == 0 ? TimeResult::Incomplete : TimeResult::Ok;
}

int TwoDigits(std::string_view text, std::size_t position) {
    return (text[position] - '0') * 10 + (text[position + 1] - '0');
}

/// Eight digits of the date; ten, twelve or fourteen with the hour, minute and second.
TimeResult ParseCompact(std::string_view text, DateForm form, TimeParts* parts) {
    std::size_t digits = 0;
    while (digits < text.size() && IsDigit(text[digits]))
        ++digits;
    if (digits != 8 && digits != 10 && digits != 12 && digits != 14)
        return TimeResult::Bad;
    const bool yearFirst = form == DateForm::Compact;
    const std::size_t year = yearFirst ? 0 : 4;
    parts->year = TwoDigits(text, year) * 100 + TwoDigits(text, year + 2);
    parts->month = TwoDigits(text, yearFirst ? 4 : 2);
    parts->day = TwoDigits(text, yearFirst ? 6 : 0);
    // Here already, so that a column of long numbers is not taken for dates.
    if (parts->month > 12 || parts->day > 31)
        return TimeResult::Bad;
    if (digits >= 10)
        parts->hour = TwoDigits(text, 8);
    if (digits >= 12)
        parts->minute = TwoDigits(text, 10);
    if (digits == 14)
        parts->second = TwoDigits(text, 12);
    TextCursor cursor(text.substr(digits));
    const bool isWhole =
        digits == 8 ? TakeClockTail(&cursor, parts) : ParseZoneTail(cursor.Rest(), parts);
    if (!isWhole)
        return TimeResult::Bad;
    return parts->month == 0 || parts->day == 0 ? TimeResult::Incomplete : TimeResult::Ok;
}

TimeResult ParseCompactYearMonth(std::string_view text, TimeParts* parts) {
    if (text.size() != 6 || !IsDigits(text))
        return TimeResult::Bad;
    parts->year = TwoDigits(text, 0) * 100 + TwoDigits(text, 2);
    parts->month = TwoDigits(text, 4);
    if (parts->month > 12)
        return TimeResult::Bad;
    return parts->month == 0 ? TimeResult::Incomplete : TimeResult::Ok;
}

TimeResult ParseYear(std::string_view text, TimeParts* parts) {
    // A table that passed through a spreadsheet may write years as "1923.0".
    if (text.size() == 6 && text.substr(4) == ".0")
        text = text.substr(0, 4);
    if (!IsDigits(text) || text.size() == 3 || text.size() > 4)
        return TimeResult::Bad;
    const int year = *ParseInt(text);
    parts->year = text.size() <= 2 ? YearOfTwoDigits(year) : year;
    return TimeResult::Ok;
}

TimeResult SetWhole(std::optional<Millis> moment, TimeParts* parts) {
    parts->whole = moment;
    return moment ? TimeResult::Ok : TimeResult::Bad;
}

/// Decimal years, serial numbers of spreadsheets, seconds: one number for the whole moment.
TimeResult ParseCounted(std::string_view text, DateForm form, TimeParts* parts) {
    std::string plain(text.substr(0, 40));
    for (char& c : plain)
        c = c == ',' ? '.' : c;
    const std::optional<double> number = ParseDouble(plain);
    constexpr double kMostSeconds = 3e11; // past the year 9999
    if (!number || !(std::abs(*number) < kMostSeconds))
        return TimeResult::Bad;
    if (form == DateForm::DecimalYear)
        return SetWhole(MomentOfDecimalYear(*number), parts);
    // A spreadsheet's serial number has too few digits for more than whole seconds.
    constexpr double kDaysTo1970 = 25569.0;
    const double seconds =
        form == DateForm::ExcelSerial ? std::round((*number - kDaysTo1970) * 86400.0) : *number;
    if (!(std::abs(seconds) < kMostSeconds))
        return TimeResult::Bad;
    const auto moment = static_cast<Millis>(std::llround(seconds * 1000.0));
    return SetWhole(IsInCalendar(moment) ? std::optional(moment) : std::nullopt, parts);
}

} // namespace

TimeResult ParseDate(std::string_view text, DateForm form, TimeParts* parts) {
    switch (form) {
    case DateForm::YearMonthDay:
    case DateForm::DayMonthYear:
    case DateForm::MonthDayYear:
    case DateForm::ShortYearMonthDay:
        return ParseSeparated(text, form, parts);
    case DateForm::Compact:
    case DateForm::CompactDayFirst:
        return ParseCompact(text, form, parts);
    case DateForm::YearMonth:
        return ParseYearMonth(text, parts);
    case DateForm::CompactYearMonth:
        return ParseCompactYearMonth(text, parts);
    case DateForm::Year:
        return ParseYear(text, parts);
    case DateForm::Duration:
        return SetWhole(ParseDuration(text), parts);
    case DateForm::DecimalYear:
    case DateForm::ExcelSerial:
    case DateForm::UnixSeconds:
        return ParseCounted(text, form, parts);
    }
    return TimeResult::Bad;
}

std::string DateFormName(DateForm form) {
    switch (form) {
    case DateForm::YearMonthDay:
        return "year-month-day";
    case DateForm::DayMonthYear:
        return "day-month-year";
    case DateForm::MonthDayYear:
        return "month-day-year";
    case DateForm::ShortYearMonthDay:
        return "year-month-day with two-digit years";
    case DateForm::Compact:
        return "YYYYMMDD";
    case DateForm::CompactDayFirst:
        return "DDMMYYYY";
    case DateForm::YearMonth:
        return "year-month";
    case DateForm::CompactYearMonth:
        return "YYYYMM";
    case DateForm::Year:
        return "year";
    case DateForm::DecimalYear:
        return "decimal year";
    case DateForm::Duration:
        return "length of time from the start";
    case DateForm::ExcelSerial:
        return "Excel serial number";
    case DateForm::UnixSeconds:
        return "seconds since 1970";
    }
    return {};
}

} // namespace ryn
