#include "import/time_pattern.h"

#include "import/clock_text.h"
#include "import/date_text.h"
#include "import/text_cursor.h"

namespace ryn {

namespace {

constexpr std::string_view kFieldLetters = "YymdejHIMSfpbBhz";

std::string_view ShortForm(char letter) {
    switch (letter) {
    // Written out when the format is compiled, so that parsing knows single fields only.
    case 'F':
        return "%Y-%m-%d";
    case 'T':
        return "%H:%M:%S";
    case 'R':
        return "%H:%M";
    default:
        return {};
    }
}

bool TakeInt(TextCursor* cursor, int most, int* value) {
    int digits = 0;
    *value = cursor->TakeNumber(most, &digits);
    return digits > 0;
}

bool TakeMonthName(TextCursor* cursor, TimeParts* parts) {
    parts->month = MonthOfName(cursor->TakeWord());
    if (parts->month > 0)
        cursor->Take('.'); // an abbreviation's point
    return parts->month > 0;
}

bool TakeFraction(TextCursor* cursor, TimeParts* parts) {
    int count = 0;
    parts->millisecond = cursor->TakeNumber(3, &count);
    for (int missing = count; missing < 3; ++missing)
        parts->millisecond *= 10;
    // Finer digits than the system keeps are cut off, not refused.
    while (IsDigit(cursor->Peek()))
        cursor->Skip();
    return count > 0;
}

/// Up to the next blank.
bool TakeZone(TextCursor* cursor, TimeParts* parts) {
    const std::string_view rest = cursor->Rest();
    const std::string_view zone = rest.substr(0, rest.find(' '));
    int minutes = 0;
    if (!ParseZone(zone, &minutes))
        return false;
    parts->offsetMinutes = minutes;
    cursor->Skip(zone.size());
    return true;
}

/// Behind the hour, as everybody writes it.
bool TakeHalfOfDay(TextCursor* cursor, TimeParts* parts) {
    const std::string_view word = cursor->TakeWord();
    const bool isAfternoon = IsOneOf(word, "pm");
    if ((!isAfternoon && !IsOneOf(word, "am")) || parts->hour < 1 || parts->hour > 12)
        return false;
    parts->hour = parts->hour % 12 + (isAfternoon ? 12 : 0);
    return true;
}

/// Of several years the first holds: a hydrological year "1999/00" is called after its start.
bool TakeYear(TextCursor* cursor, int digits, TimeParts* parts) {
    int year = 0;
    if (!TakeInt(cursor, digits, &year))
        return false;
    if (parts->year == TimeParts().year)
        parts->year = digits == 2 ? YearOfTwoDigits(year) : year;
    return true;
}

bool TakeField(char letter, TextCursor* cursor, TimeParts* parts) {
    switch (letter) {
    case 'Y':
        return TakeYear(cursor, 4, parts);
    case 'y':
        return TakeYear(cursor, 2, parts);
    case 'm':
        return TakeInt(cursor, 2, &parts->month);
    case 'd':
    case 'e':
        return TakeInt(cursor, 2, &parts->day);
    case 'j':
        return TakeInt(cursor, 3, &parts->dayOfYear);
    case 'H':
    case 'I':
        return TakeInt(cursor, 2, &parts->hour);
    case 'M':
        return TakeInt(cursor, 2, &parts->minute);
    case 'S':
        return TakeInt(cursor, 2, &parts->second);
    case 'f':
        return TakeFraction(cursor, parts);
    case 'p':
        return TakeHalfOfDay(cursor, parts);
    case 'z':
        return TakeZone(cursor, parts);
    default: // b, B, h
        return TakeMonthName(cursor, parts);
    }
}

} // namespace

bool TimePattern::Compile(std::string_view format, TimePattern* pattern, std::string* reason) {
    TimePattern compiled;
    compiled.source = std::string(format);
    bool hasField = false;
    for (std::size_t i = 0; i < format.size(); ++i) {
        if (format[i] != '%') {
            compiled.expanded += format[i];
            continue;
        }
        const char letter = i + 1 < format.size() ? format[i + 1] : '\0';
        const std::string_view shortForm = ShortForm(letter);
        if (shortForm.empty() && letter != '%' &&
            (letter == '\0' || kFieldLetters.find(letter) == std::string_view::npos)) {
            *reason = "%" + std::string(letter == '\0' ? 0 : 1, letter) + " is no field of a time";
            return false;
        }
        compiled.expanded +=
            shortForm.empty() ? std::string(format.substr(i, 2)) : std::string(shortForm);
        hasField = hasField || letter != '%';
        ++i;
    }
    *reason = hasField ? "" : "it has no field such as %Y";
    if (hasField)
        *pattern = std::move(compiled);
    return hasField;
}

TimeResult TimePattern::Parse(std::string_view text, TimeParts* parts) const {
    TextCursor cursor(text);
    for (std::size_t i = 0; i < expanded.size(); ++i) {
        const char c = expanded[i];
        if (c == ' ') {
            cursor.SkipBlanks();
        } else if (c == '%' && expanded[i + 1] != '%') {
            cursor.SkipBlanks(); // "%d" reads " 5" too
            if (!TakeField(expanded[++i], &cursor, parts))
                return TimeResult::Bad;
        } else {
            i += c == '%' ? 1 : 0;
            if (!cursor.Take(c))
                return TimeResult::Bad;
        }
    }
    // All of the text has to be understood: what is left over could be the part that matters.
    cursor.SkipBlanks();
    if (!cursor.IsAtEnd())
        return TimeResult::Bad;
    return parts->month == 0 || parts->day == 0 ? TimeResult::Incomplete : TimeResult::Ok;
}

bool TimePattern::Has(std::string_view letters) const {
    for (std::size_t i = 0; i + 1 < expanded.size(); ++i) {
        // A doubled percent sign is a plain character.
        if (expanded[i] != '%')
            continue;
        if (letters.find(expanded[i + 1]) != std::string_view::npos)
            return true;
        ++i;
    }
    return false;
}

} // namespace ryn
