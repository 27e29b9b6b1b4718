#include "import/time_names.h"

#include <algorithm>

#include "import/table_text.h"

namespace ryn {

namespace {

struct RoleWord {
    std::string_view word;
    TimeRole role;
};

constexpr RoleWord kRoleWords[] = {{"year", TimeRole::Year},
                                   {"years", TimeRole::Year},
                                   {"yr", TimeRole::Year},
                                   {"yyyy", TimeRole::Year},
                                   {"yy", TimeRole::Year},
                                   {"jaar", TimeRole::Year},
                                   {"jahr", TimeRole::Year},
                                   {"annee", TimeRole::Year},
                                   {"ann\xC3\xA9"
                                    "e",
                                    TimeRole::Year},
                                   {"anno", TimeRole::Year},
                                   {"a\xC3\xB1o", TimeRole::Year},
                                   {"ano", TimeRole::Year},
                                   {"\xC3\xA5r", TimeRole::Year},
                                   {"rok", TimeRole::Year},
                                   {"wy", TimeRole::Year},
                                   {"wateryear", TimeRole::Year},
                                   {"hyear", TimeRole::Year},
                                   {"vuosi", TimeRole::Year},
                                   {"month", TimeRole::Month},
                                   {"mon", TimeRole::Month},
                                   {"mo", TimeRole::Month},
                                   {"mm", TimeRole::Month},
                                   {"mnth", TimeRole::Month},
                                   {"mth", TimeRole::Month},
                                   {"maand", TimeRole::Month},
                                   {"monat", TimeRole::Month},
                                   {"mois", TimeRole::Month},
                                   {"mese", TimeRole::Month},
                                   {"mes", TimeRole::Month},
                                   {"m\xC3\xA5ned", TimeRole::Month},
                                   {"m\xC3\xA5nad", TimeRole::Month},
                                   {"day", TimeRole::Day},
                                   {"dy", TimeRole::Day},
                                   {"dd", TimeRole::Day},
                                   {"mday", TimeRole::Day},
                                   {"dag", TimeRole::Day},
                                   {"tag", TimeRole::Day},
                                   {"jour", TimeRole::Day},
                                   {"giorno", TimeRole::Day},
                                   {"dia", TimeRole::Day},
                                   {"d\xC3\xAD"
                                    "a",
                                    TimeRole::Day},
                                   {"doy", TimeRole::DayOfYear},
                                   {"jday", TimeRole::DayOfYear},
                                   {"yday", TimeRole::DayOfYear},
                                   {"julian", TimeRole::DayOfYear},
                                   {"dayofyear", TimeRole::DayOfYear},
                                   {"hour", TimeRole::Hour},
                                   {"hours", TimeRole::Hour},
                                   {"hr", TimeRole::Hour},
                                   {"hh", TimeRole::Hour},
                                   {"uur", TimeRole::Hour},
                                   {"uhr", TimeRole::Hour},
                                   {"stunde", TimeRole::Hour},
                                   {"heure", TimeRole::Hour},
                                   {"ora", TimeRole::Hour},
                                   {"hora", TimeRole::Hour},
                                   {"minute", TimeRole::Minute},
                                   {"minutes", TimeRole::Minute},
                                   {"min", TimeRole::Minute},
                                   {"mn", TimeRole::Minute},
                                   {"mi", TimeRole::Minute},
                                   {"minuut", TimeRole::Minute},
                                   {"minuto", TimeRole::Minute},
                                   {"second", TimeRole::Second},
                                   {"seconds", TimeRole::Second},
                                   {"sec", TimeRole::Second},
                                   {"ss", TimeRole::Second},
                                   {"y", TimeRole::Year},
                                   {"m", TimeRole::Month},
                                   {"d", TimeRole::Day},
                                   {"h", TimeRole::Hour}};

std::optional<TimeRole> RoleOfWord(std::string_view word) {
    for (const RoleWord& known : kRoleWords)
        if (known.word == word)
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
    if (RoleOfName(name))
        return true;
    const std::vector<std::string> words = Words(name);
    return std::any_of(words.begin(), words.end(), [](const std::string& word) {
        return IsOneOf(word,
                       {"date",      "time",    "datetime",   "timestamp",    "datum", "zeit",
                        "zeitpunkt", "tijd",    "fecha",      "data",         "dato",  "heure",
                        "hora",      "uhrzeit", "dt",         "tm",           "tmstp", "epoch",
                        "yyyymmdd",  "yyyymm",  "yyyymmddhh", "yyyymmddhhmm", "hhmm"});
    });
}

} // namespace ryn
