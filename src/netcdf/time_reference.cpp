#include "netcdf/time_reference.h"

#include <cmath>

namespace ryn {

namespace {

constexpr bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

/// Digits and marks one behind the other.
class Scanner {
  public:
    explicit Scanner(std::string_view text) : rest(text) {}

    bool AtEnd() const { return rest.empty(); }
    bool AtDigit() const { return !rest.empty() && IsDigit(rest.front()); }
    bool Take(char mark) {
        if (rest.empty() || rest.front() != mark)
            return false;
        rest.remove_prefix(1);
        return true;
    }
    bool TakeWord(std::string_view word) {
        if (!rest.starts_with(word))
            return false;
        rest.remove_prefix(word.size());
        return true;
    }
    void SkipBlanks() {
        while (Take(' ') || Take('\t')) {
        }
    }
    std::size_t Digits() const {
        std::size_t count = 0;
        while (count < rest.size() && IsDigit(rest[count]))
            ++count;
        return count;
    }
    /// At most `most` digits as a number; nothing when there is none or there are more.
    std::optional<int> Number(std::size_t most) {
        const std::size_t count = Digits();
        return count >= 1 && count <= most ? std::optional(TakeDigits(count)) : std::nullopt;
    }
    int TakeDigits(std::size_t count) {
        int value = 0;
        for (std::size_t i = 0; i < count; ++i)
            value = value * 10 + (rest[i] - '0');
        rest.remove_prefix(count);
        return value;
    }
    /// The digits behind a decimal point, as thousandths rounded.
    int Thousandths() {
        double value = 0.0;
        double place = 100.0;
        for (; AtDigit(); place /= 10.0)
            value += place * TakeDigits(1);
        return static_cast<int>(std::lround(value));
    }

  private:
    std::string_view rest;
};

std::optional<CfDate> ScanDate(Scanner* scanner) {
    const int sign = scanner->Take('-') ? -1 : 1;
    CfDate date;
    if (scanner->Digits() == 8) { // 19900101
        date.year = static_cast<std::int64_t>(sign) * scanner->TakeDigits(4);
        date.month = scanner->TakeDigits(2);
        date.day = scanner->TakeDigits(2);
        return date;
    }
    const auto year = scanner->Number(6);
    if (!year)
        return std::nullopt;
    date.year = static_cast<std::int64_t>(sign) * *year;
    for (int* const part : {&date.month, &date.day}) {
        if (!scanner->Take('-'))
            return date;
        const auto number = scanner->Number(2);
        if (!number)
            return std::nullopt;
        *part = *number;
    }
    return date;
}

/// Hours, minutes and seconds as far as they are given.
std::optional<std::int64_t> ScanTimeOfDay(Scanner* scanner) {
    const auto hour = scanner->Number(2);
    if (!hour || *hour > 24)
        return std::nullopt;
    std::int64_t milliseconds = *hour * 3600000LL;
    for (const int unit : {60000, 1000}) {
        if (!scanner->Take(':'))
            return milliseconds;
        const auto number = scanner->Number(2);
        if (!number || *number > 59)
            return std::nullopt;
        milliseconds += *number * static_cast<std::int64_t>(unit);
    }
    if (scanner->Take('.'))
        milliseconds += scanner->Thousandths();
    return milliseconds;
}

/// What the zone is ahead of universal time; nothing when it is no zone.
std::optional<std::int64_t> ScanZone(Scanner* scanner) {
    for (const std::string_view universal : {"Z", "z", "UTC", "utc", "GMT"})
        if (scanner->TakeWord(universal))
            return 0;
    const bool isBehind = scanner->Take('-');
    if (!isBehind && !scanner->Take('+'))
        return scanner->AtEnd() ? std::optional<std::int64_t>(0) : std::nullopt;
    const bool isPacked = scanner->Digits() == 4; // +0130
    const auto hours = isPacked ? scanner->TakeDigits(2) : scanner->Number(2);
    if (!hours)
        return std::nullopt;
    const auto minutes = isPacked || scanner->Take(':') ? scanner->Number(2) : 0;
    if (!minutes || *hours > 15 || *minutes > 59)
        return std::nullopt;
    const std::int64_t ahead = *hours * 3600000LL + *minutes * 60000LL;
    return isBehind ? -ahead : ahead;
}

} // namespace

std::optional<std::int64_t> ParseTimeReference(std::string_view text, CfCalendar calendar) {
    Scanner scanner(text);
    scanner.SkipBlanks();
    const auto date = ScanDate(&scanner);
    if (!date || !HasDate(calendar, *date))
        return std::nullopt;
    std::int64_t result = DayNumber(calendar, *date) * kMillisecondsPerDay;
    if (!scanner.Take('T') && !scanner.Take('t'))
        scanner.SkipBlanks();
    if (scanner.AtDigit()) {
        const auto time = ScanTimeOfDay(&scanner);
        if (!time)
            return std::nullopt;
        result += *time;
    }
    scanner.SkipBlanks();
    const auto zone = ScanZone(&scanner);
    scanner.SkipBlanks();
    if (!zone || !scanner.AtEnd())
        return std::nullopt;
    return result - *zone;
}

} // namespace ryn
