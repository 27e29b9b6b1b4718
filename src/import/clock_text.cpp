#include "import/clock_text.h"

#include <array>

#include "import/date_text.h"
#include "import/text_cursor.h"

namespace ryn {

namespace {

struct Zone {
    std::string_view name;
    int minutes;
};

// The abbreviations that gauge networks write. BST is British Summer Time.
constexpr Zone kZones[] = {
    {"z", 0},       {"utc", 0},    {"gmt", 0},    {"ut", 0},     {"wet", 0},    {"west", 60},
    {"bst", 60},    {"cet", 60},   {"mez", 60},   {"met", 60},   {"cest", 120}, {"mesz", 120},
    {"mest", 120},  {"eet", 120},  {"eest", 180}, {"est", -300}, {"edt", -240}, {"cst", -360},
    {"cdt", -300},  {"mst", -420}, {"mdt", -360}, {"pst", -480}, {"pdt", -420}, {"akst", -540},
    {"akdt", -480}, {"hst", -600}, {"ast", -240}, {"adt", -180}, {"nzst", 720}, {"nzdt", 780},
    {"jst", 540},   {"aest", 600}, {"aedt", 660}, {"awst", 480}, {"acst", 570}};

/// "+01:00", "-0330", "+01".
bool ParseOffset(std::string_view text, int* minutes) {
    TextCursor cursor(text);
    const bool isNegative = cursor.Peek() == '-';
    cursor.Skip();
    int hourDigits = 0;
    int minuteDigits = 0;
    const int hours = cursor.TakeNumber(2, &hourDigits);
    const bool hasColon = cursor.Take(':');
    const int rest = cursor.TakeNumber(2, &minuteDigits);
    *minutes = (hours * 60 + rest) * (isNegative ? -1 : 1);
    // Zones in use are multiples of a quarter of an hour, up to 14 hours from UTC.
    return hourDigits == 2 && cursor.IsAtEnd() && hours <= 14 && rest % 15 == 0 && rest < 60 &&
           (minuteDigits == 2 || (minuteDigits == 0 && !hasColon));
}

/// Digits behind a decimal sign as milliseconds; finer ones are cut off.
int TakeFraction(TextCursor* cursor) {
    int millis = 0;
    int count = 0;
    for (; IsDigit(cursor->Peek()); cursor->Skip(), ++count)
        if (count < 3)
            millis = millis * 10 + (cursor->Peek() - '0');
    for (; count < 3; ++count)
        millis *= 10;
    return millis;
}

/// ":MM", ":MM:SS", ":MM:SS.fff" behind the hour.
bool TakeColonClock(TextCursor* cursor, TimeParts* parts) {
    int digits = 0;
    parts->minute = cursor->TakeNumber(2, &digits);
    if (digits != 2)
        return false;
    if (!cursor->Take(':'))
        return true;
    parts->second = cursor->TakeNumber(2, &digits);
    if (digits != 2)
        return false;
    if ((cursor->Peek() == '.' || cursor->Peek() == ',') && cursor->Rest().size() > 1) {
        cursor->Skip();
        parts->millisecond = TakeFraction(cursor);
    }
    return true;
}

/// Asked before words are compared: this runs for each row, and nearly none has one.
bool IsLetterAhead(const TextCursor& cursor) {
    return IsLetter(cursor.Peek()) || static_cast<unsigned char>(cursor.Peek()) >= 0x80;
}

/// Of a number with one of these words behind it; -1 and the cursor as it was for another text.
int TakeUnit(TextCursor* cursor, std::string_view words) {
    TextCursor ahead = *cursor;
    int digits = 0;
    ahead.SkipBlanks();
    const int value = ahead.TakeNumber(2, &digits);
    ahead.SkipBlanks();
    if (digits == 0 || !IsLetterAhead(ahead) || !IsOneOf(ahead.TakeWord(), words))
        return -1;
    *cursor = ahead;
    return value;
}

/// "7h30", "7 h", "7 Uhr 30", "9時30分": false, and the parts as they were, for another text.
bool TakeHourWord(TextCursor* cursor, TimeParts* parts) {
    TextCursor ahead = *cursor;
    const int hour = TakeUnit(&ahead, "h|hr|hrs|uhr|u|uur|heures|時");
    if (hour < 0)
        return false;
    parts->hour = hour;
    parts->minute = TakeUnit(&ahead, "m|min|分");
    if (parts->minute >= 0)
        parts->second = TakeUnit(&ahead, "s|sec|秒");
    *cursor = ahead;
    ahead.SkipBlanks();
    int digits = 0;
    const int minute = ahead.TakeNumber(2, &digits);
    if (parts->minute >= 0 || digits != 2)
        return true;
    parts->minute = minute;
    *cursor = ahead;
    return true;
}

/// "0730 hrs", "7:30 Uhr".
void SkipHourWord(TextCursor* cursor) {
    TextCursor ahead = *cursor;
    ahead.SkipBlanks();
    if (IsLetterAhead(ahead) && IsOneOf(ahead.TakeWord(), "h|hr|hrs|uhr|uur|heures"))
        *cursor = ahead;
}

/// "AM" or "PM" behind a time of the twelve-hour clock.
bool TakeHalfOfDay(TextCursor* cursor, TimeParts* parts) {
    TextCursor ahead = *cursor;
    ahead.SkipBlanks();
    if (!IsLetterAhead(ahead))
        return true;
    const std::string_view word = ahead.TakeWord();
    const bool isAfternoon = IsOneOf(word, "pm|p");
    const bool isAbbreviated =
        IsOneOf(word, "a|p") && ahead.Take('.') && IsOneOf(ahead.TakeWord(), "m");
    if (!isAbbreviated && !IsOneOf(word, "am|pm"))
        return true;
    if (isAbbreviated)
        ahead.Take('.');
    if (parts->hour < 1 || parts->hour > 12)
        return false;
    // 12 AM is midnight, 12 PM is noon.
    parts->hour = parts->hour % 12 + (isAfternoon ? 12 : 0);
    *cursor = ahead;
    return true;
}

/// "HH", "HHMM", "HHMMSS" without colons.
bool SetPlainClock(int value, int digits, TimeParts* parts) {
    if (digits == 6) {
        parts->hour = value / 10000;
        parts->minute = value / 100 % 100;
        parts->second = value % 100;
    } else if (digits == 4) {
        parts->hour = value / 100;
        parts->minute = value % 100;
    } else {
        parts->hour = value;
        return digits == 2;
    }
    return true;
}

} // namespace

bool ParseZone(std::string_view text, int* offsetMinutes) {
    if (!text.empty() && (text[0] == '+' || text[0] == '-'))
        return ParseOffset(text, offsetMinutes);
    constexpr std::size_t kLongestName = 4;
    if (text.empty() || text.size() > kLongestName)
        return false;
    const std::string name = Lowercase(text);
    for (const Zone& zone : kZones) {
        if (zone.name == name) {
            *offsetMinutes = zone.minutes;
            return true;
        }
    }
    return false;
}

bool ParseZoneTail(std::string_view text, TimeParts* parts) {
    const std::size_t whole = text.size();
    text = Trimmed(text);
    if (text.empty())
        return true;
    // Behind a blank an hour alone may be a value: "2001-01-01 10:00 -12,5".
    constexpr std::size_t kHourAlone = 3;
    if (text.size() < whole && text.size() == kHourAlone && text[0] == '-')
        return false;
    int minutes = 0;
    if (!ParseZone(text, &minutes))
        return false;
    parts->offsetMinutes = minutes;
    return true;
}

bool ParseClock(std::string_view text, TimeParts* parts) {
    TextCursor cursor(text);
    if (TakeHourWord(&cursor, parts))
        return ParseZoneTail(cursor.Rest(), parts);
    int digits = 0;
    const int value = cursor.TakeNumber(6, &digits);
    if (digits == 0 || IsDigit(cursor.Peek()))
        return false;
    const bool isTwelveHour = IsLetter(TextCursor(Trimmed(cursor.Rest())).Peek());
    if (cursor.Take(':')) {
        parts->hour = value;
        if (digits > 2 || !TakeColonClock(&cursor, parts))
            return false;
    } else if (!SetPlainClock(value, isTwelveHour && digits == 1 ? 2 : digits, parts)) {
        return false;
    }
    SkipHourWord(&cursor);
    return TakeHalfOfDay(&cursor, parts) && ParseZoneTail(cursor.Rest(), parts);
}

std::optional<Millis> ParseDuration(std::string_view text) {
    TextCursor cursor(text);
    const Millis sign = cursor.Take('-') ? -1 : 1;
    int digits = 0;
    Millis first = cursor.TakeNumber(8, &digits);
    if (digits == 0)
        return std::nullopt;
    Millis days = 0;
    cursor.SkipBlanks();
    if (IsLetter(cursor.Peek())) {
        if (!IsOneOf(cursor.TakeWord(), "d|day|days"))
            return std::nullopt;
        days = first;
        cursor.Take(',');
        cursor.SkipBlanks();
        if (cursor.IsAtEnd())
            return sign * days * kMillisPerDay;
        first = cursor.TakeNumber(2, &digits);
    }
    TimeParts parts;
    // Seconds are asked for: "12:30" alone is a time of day.
    if (digits == 0 || !cursor.Take(':') || !TakeColonClock(&cursor, &parts) || !cursor.IsAtEnd() ||
        parts.second < 0 || parts.minute > 59 || parts.second > 59)
        return std::nullopt;
    return sign *
           (days * kMillisPerDay + first * kMillisPerHour + parts.minute * kMillisPerMinute +
            parts.second * kMillisPerSecond + (parts.millisecond > 0 ? parts.millisecond : 0));
}

int MonthOfName(std::string_view name) {
    // By the first letters, which tell the months of these languages apart; but July goes before
    // June ("juillet", "juin"), and so the year is gone through backwards.
    constexpr std::array<std::string_view, 12> kStarts = {
        "jan|gen|ene", "feb|fév|fev",    "mar|mär|maa|mrt|mrz", "apr|avr|abr", "may|mai|mei|mag",
        "jun|jui|giu", "jul|juil|lug",   "aug|aou|aoû|ago",     "sep|set",     "oct|okt|ott|out",
        "nov",         "dec|déc|dez|dic"};
    constexpr std::size_t kLongestName = 10;
    const std::string lower = Lowercase(name.substr(0, kLongestName + 1));
    if (lower.size() < 3 || lower.size() > kLongestName)
        return 0;
    for (std::size_t month = kStarts.size(); month > 0; --month)
        if (StartsWithOneOf(lower, kStarts[month - 1]))
            return static_cast<int>(month);
    return 0;
}

} // namespace ryn
