#include "apps/cli/date_text.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

#include "base/number_text.h"

namespace ryn::cli {

namespace {

/// Reads numbers of fixed widths with given characters between them.
class FixedFields {
  public:
    explicit FixedFields(std::string_view source) : text(source) {}

    int Number(std::size_t digits) {
        const std::string_view field = text.substr(std::min(place, text.size()), digits);
        place += digits;
        const bool plain = field.size() == digits &&
                           field.find_first_not_of("0123456789") == std::string_view::npos;
        valid = valid && plain;
        return plain ? *ParseInt(field) : 0;
    }
    void Character(char expected) {
        valid = valid && place < text.size() && text[place] == expected;
        ++place;
    }
    bool IsWhole() const { return valid && place == text.size(); }

  private:
    std::string_view text;
    std::size_t place = 0;
    bool valid = true;
};

COleDateTime ParseDayOfYear(std::string_view text, int year) {
    FixedFields fields(text);
    const int month = fields.Number(2);
    fields.Character('-');
    const int day = fields.Number(2);
    if (!fields.IsWhole())
        return {};
    while (month == 2 && day == 29 && !IsLeapYear(year))
        ++year;
    return {year, month, day, 0, 0, 0};
}

COleDateTime ParseWholeDate(std::string_view text) {
    FixedFields fields(text);
    std::array<int, 6> parts{};
    parts[0] = fields.Number(4);
    fields.Character('-');
    parts[1] = fields.Number(2);
    fields.Character('-');
    parts[2] = fields.Number(2);
    if (text.size() > 10) {
        fields.Character('T');
        parts[3] = fields.Number(2);
        fields.Character(':');
        parts[4] = fields.Number(2);
    }
    if (text.size() > 16) {
        fields.Character(':');
        parts[5] = fields.Number(2);
    }
    if (!fields.IsWhole())
        return {};
    return {parts[0], parts[1], parts[2], parts[3], parts[4], parts[5]};
}

} // namespace

std::string IsoText(const COleDateTime& date) {
    return date.Format("%Y-%m-%dT%H:%M:%S");
}

std::string DateForPeople(const COleDateTime& date) {
    return date.Format(date.GetSecond() == 0 ? "%Y-%m-%d %H:%M" : "%Y-%m-%d %H:%M:%S");
}

std::string LengthForPeople(COleDateTimeSpan span) {
    constexpr std::array<std::pair<std::string_view, long long>, 4> kUnits = {
        {{" d", 86400}, {" h", 3600}, {" min", 60}, {" s", 1}}};
    const double days = span.GetTotalDays();
    if (!std::isfinite(days))
        return {};
    long long rest = std::llround(std::fabs(days) * 86400.0);
    std::string text;
    for (const auto& [unit, seconds] : kUnits) {
        if (const long long number = rest / seconds; number > 0)
            text += (text.empty() ? "" : " ") + std::to_string(number) + std::string(unit);
        rest %= seconds;
    }
    return text.empty() ? "0 s" : text;
}

std::optional<COleDateTime> ParseDate(std::string_view text, int year) {
    const COleDateTime date = text.size() == 5 ? ParseDayOfYear(text, year) : ParseWholeDate(text);
    return date.IsValid() ? std::optional(date) : std::nullopt;
}

} // namespace ryn::cli
