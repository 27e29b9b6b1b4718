#include <map>

#include "import/time_names.h"
#include "import/time_search.h"

namespace ryn {

namespace {

using Roles = std::map<TimeRole, std::size_t>;

bool Has(const Roles& roles, TimeRole role) {
    return roles.count(role) > 0;
}

/// An hour without a day, or a minute without an hour ("Min" may be a minimum), is none.
bool HasLarger(const Roles& roles, TimeRole role) {
    switch (role) {
    case TimeRole::Hour:
        return Has(roles, TimeRole::Day) || Has(roles, TimeRole::DayOfYear);
    case TimeRole::Minute:
        return Has(roles, TimeRole::Hour);
    case TimeRole::Second:
        return Has(roles, TimeRole::Minute);
    default:
        return true;
    }
}

/// The role that the column's values bear out, close to the one its name tells.
std::optional<TimeRole> BorneOut(const TimeSearch& search, const Roles& roles, std::size_t column,
                                 TimeRole named) {
    if (search.IsUsable(column, named))
        return named;
    const bool isDayOfYear = named == TimeRole::Day && !Has(roles, TimeRole::Month);
    if (isDayOfYear && search.IsUsable(column, TimeRole::DayOfYear))
        return TimeRole::DayOfYear;
    if (named == TimeRole::Hour && search.IsUsable(column, TimeRole::HourMinute))
        return TimeRole::HourMinute;
    return std::nullopt;
}

/// The columns by role, from the year downwards.
Roles RolesBorneOut(const TimeSearch& search) {
    std::vector<ColumnLayout> layouts = search.rows.Columns();
    for (std::size_t i = 0; i < layouts.size(); ++i)
        if (!search.Contains(i))
            layouts[i] = {};
    const std::vector<std::optional<TimeRole>> named = RolesOfNames(layouts);
    Roles roles;
    for (const TimeRole role : {TimeRole::Year, TimeRole::Month, TimeRole::DayOfYear, TimeRole::Day,
                                TimeRole::Hour, TimeRole::Minute, TimeRole::Second}) {
        const auto at = std::find(named.begin(), named.end(), std::optional(role));
        if (at == named.end() || !HasLarger(roles, role))
            continue;
        const auto column = static_cast<std::size_t>(at - named.begin());
        // A name alone is not enough: "Mon" may be a monitor, "sec" a second gauge.
        const std::optional<TimeRole> found = BorneOut(search, roles, column, role);
        if (found)
            roles.emplace(*found, column);
    }
    return roles;
}

/// Whole numbers side by side, from `first` on, in these roles.
TimeLayout SideBySide(std::size_t first, const std::vector<TimeRole>& roles) {
    TimeLayout time;
    for (const TimeRole role : roles)
        time.columns.push_back({first++, role});
    return time;
}

/// Years with four digits, and rising times in nearly all rows: three whole numbers side by side
/// are common, three that make rising dates are not. A column has to be left for values.
bool Fits(const TimeSearch& search, const TimeLayout& probe) {
    if (probe.columns.back().column + 1 >= search.rows.ColumnCount())
        return false;
    for (const TimeColumn& column : probe.columns)
        if (!search.Contains(column.column) ||
            (column.role == TimeRole::Year && !search.rows.HasDigitsOnly(column.column, 4)))
            return false;
    return FitTime(search.rows, probe).Rises();
}

} // namespace

PartsResult FindPartColumns(const TimeSearch& search, TimeLayout* time) {
    const Roles roles = RolesBorneOut(search);
    if (!Has(roles, TimeRole::Year) || roles.size() < 2)
        return PartsResult::None;
    if (Has(roles, TimeRole::Day) && !Has(roles, TimeRole::Month) && !search.hasStart)
        return PartsResult::NoMonth;
    *time = {};
    for (const auto& [role, column] : roles)
        time->columns.push_back({column, role});
    return PartsResult::Found;
}

bool FindUnnamedParts(const TimeSearch& search, TimeLayout* time) {
    using enum TimeRole;
    // With a clock behind, days repeat: hours and minutes make the times rise.
    const std::vector<std::vector<TimeRole>> orders = {{Year, Month, Day},
                                                       {Day, Month, Year},
                                                       {Month, Day, Year},
                                                       {Year, Month, Day, Hour},
                                                       {Year, Month, Day, Hour, Minute},
                                                       {Year, Month, Day, Hour, Minute, Second}};
    constexpr std::size_t kMostBefore = 3; // a station's number, a counter
    for (std::size_t first = 0; first < kMostBefore && first < search.rows.ColumnCount(); ++first) {
        for (const std::vector<TimeRole>& order : orders) {
            const TimeLayout probe = SideBySide(first, order);
            if (!search.rows.Column(first).name.empty() || !Fits(search, probe))
                continue;
            *time = probe;
            return true;
        }
    }
    return false;
}

} // namespace ryn
