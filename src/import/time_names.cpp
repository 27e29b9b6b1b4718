#include "import/time_names.h"

#include <algorithm>

#include "import/table_text.h"

namespace ryn {

namespace {

struct RoleWords {
    TimeRole role;
    std::string_view words;
};

// In English, German, Dutch, French, Italian, Spanish, Portuguese the Nordic languages and
// Japanese.
constexpr RoleWords kRoles[] = {
    {TimeRole::Year, "year|years|yr|yyyy|yy|y|jaar|jahr|année|annee|anno|año|ano|år|rok|vuosi|wy|"
                     "wateryear|hyear|年"},
    {TimeRole::Month, "month|mon|mo|mm|m|mnth|mth|maand|monat|mois|mese|mes|måned|månad|月"},
    {TimeRole::Day, "day|dy|dd|d|mday|dag|tag|jour|giorno|dia|día|日"},
    {TimeRole::DayOfYear, "doy|jday|yday|julian|dayofyear"},
    {TimeRole::Hour, "hour|hours|hr|hh|h|uur|uhr|stunde|heure|ora|hora|時"},
    {TimeRole::Minute, "minute|minutes|min|mn|mi|minuut|minuto|分"},
    {TimeRole::Second, "second|seconds|sec|ss|秒"}};

std::optional<TimeRole> RoleOfWord(std::string_view word) {
    for (const RoleWords& known : kRoles)
        if (IsOneOf(word, known.words))
            return known.role;
    return std::nullopt;
}

} // namespace

std::optional<TimeRole> RoleOfName(const std::string& name) {
    const std::vector<std::string> words = Words(name);
    // "H2" and "S1" are no times.
    if (words.empty() || name.find_first_of("0123456789") != std::string::npos)
        return std::nullopt;
    const bool hasYear = std::find(words.begin(), words.end(), "year") != words.end();
    const bool hasDay = std::find(words.begin(), words.end(), "day") != words.end();
    if (hasDay && hasYear)
        return TimeRole::DayOfYear; // "day of year"
    // "water_year", "year", "from.yr": of several words the last one counts; but not the single
    // letters, which end many names ("Q_m").
    const std::string& last = words.back();
    if (words.size() == 1 ||
        (words.size() == 2 && last.size() > 1 && last != "mm" && last != "min"))
        return RoleOfWord(last);
    return std::nullopt;
}

std::vector<std::optional<TimeRole>> RolesOfNames(const std::vector<ColumnLayout>& columns) {
    const bool hasUpper = std::any_of(columns.begin(), columns.end(),
                                      [](const ColumnLayout& c) { return c.name == "MM"; });
    std::vector<std::optional<TimeRole>> roles;
    const auto isTaken = [&roles](TimeRole role) {
        return std::find(roles.begin(), roles.end(), std::optional(role)) != roles.end();
    };
    for (const ColumnLayout& column : columns) {
        std::optional<TimeRole> role = RoleOfName(column.name);
        const bool isMm = Lowercase(column.name) == "mm" || Lowercase(column.name) == "m";
        if (isMm && (isTaken(TimeRole::Month) || (hasUpper && column.name == "mm")))
            role = TimeRole::Minute;
        if (role && isTaken(*role))
            role.reset();
        roles.push_back(role);
    }
    return roles;
}

bool IsMinuteName(const std::string& name) {
    return RoleOfName(name) == TimeRole::Minute || Lowercase(name) == "mm";
}

bool IsTimeName(const std::string& name) {
    // "H" is more often a water level than an hour.
    if (name.size() > 1 && RoleOfName(name))
        return true;
    const std::vector<std::string> words = Words(name);
    if (words.size() > 1 && std::all_of(words.begin(), words.end(), RoleOfWord)) // "hh:mm"
        return true;
    return std::any_of(words.begin(), words.end(), [](const std::string& word) {
        return IsOneOf(
            word, "date|time|datetime|timestamp|datum|zeit|zeitpunkt|uhrzeit|tijd|fecha|data|"
                  "dato|heure|hora|dt|tm|tmstp|epoch|hhmm|yyyymm|yyyymmdd|yyyymmddhh|"
                  "yyyymmddhhmm|clock|tijdstip|orario|時刻|時間|観測時刻|時分|日時|観測日時|日付|"
                  "年月日|年月日時|年月");
    });
}

} // namespace ryn
