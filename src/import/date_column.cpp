#include "import/table_text.h"
#include "import/time_names.h"
#include "import/time_search.h"

namespace ryn {

namespace {

/// The forms that read most rows of a column: one row that only some forms read decides against the
/// others.
std::vector<DateForm> FittingForms(const SampleRows& rows, std::size_t column,
                                   const std::vector<DateForm>& forms) {
    std::vector<DateForm> fitting;
    double most = 0.0;
    for (const DateForm form : forms) {
        const TimeFit fit = FitTime(rows, DateLayout(column, form));
        if (!fit.IsGood() || fit.ok < most)
            continue;
        if (fit.ok > most)
            fitting.clear();
        most = fit.ok;
        fitting.push_back(form);
    }
    return fitting;
}

/// Dates in digits alone. Whole numbers of other lengths are values.
std::vector<DateForm> FormsOfNumbers(const SampleRows& rows, std::size_t column) {
    bool isDigits = false;
    for (const unsigned size : {8U, 10U, 12U, 14U})
        isDigits = isDigits || rows.HasDigitsOnly(column, size);
    if (!isDigits)
        return {};
    std::vector<DateForm> forms =
        FittingForms(rows, column, {DateForm::Compact, DateForm::CompactDayFirst});
    // The year stands first wherever it can: 20011210 is no day 20 of month 1.
    forms.resize(std::min<std::size_t>(forms.size(), 1));
    return forms;
}

/// Dates with signs between, or with a clock behind their digits.
std::vector<DateForm> FormsOfTexts(const SampleRows& rows, std::size_t column) {
    std::vector<DateForm> forms =
        FittingForms(rows, column,
                     {DateForm::YearMonthDay, DateForm::DayMonthYear, DateForm::MonthDayYear,
                      DateForm::ShortYearMonthDay});
    if (forms.empty())
        forms = FittingForms(rows, column, {DateForm::Compact});
    // Nobody writes the month first with points between.
    const std::string_view first = rows.All().front()[column];
    if (forms.size() > 1 && std::count(first.begin(), first.end(), '.') >= 2)
        forms.resize(1);
    return forms;
}

/// A name for hours or times of day. "Hour Ending" is one; "sunshine hours" only counts them.
bool IsClockName(const std::string& name) {
    const std::vector<std::string> words = Words(name);
    if (words.empty() || name.size() < 2)
        return false;
    if (IsOneOf(words.back(), "time|tm|zeit|uhrzeit|tijd|heure|hora|hhmm"))
        return true;
    return words.front().size() > 1 && RoleOfName(words.front()) == TimeRole::Hour &&
           (words.size() == 1 || words.front() != "hours");
}

/// The role that a column can play as the time of day beside a date: clock times, or numbers under
/// a name for one.
std::optional<TimeRole> ClockRole(const TimeSearch& search, std::size_t column) {
    const ColumnLayout& layout = search.rows.Column(column);
    if (layout.kind == ColumnKind::Time && search.IsUsable(column, TimeRole::Clock))
        return TimeRole::Clock;
    if (layout.kind != ColumnKind::Number || !IsClockName(layout.name))
        return std::nullopt;
    for (const TimeRole role : {TimeRole::Hour, TimeRole::HourMinute})
        if (search.IsUsable(column, role))
            return role;
    return std::nullopt;
}

/// The nearest column from the left that gives the time of day, with the minutes beside its hours.
void AddClock(const TimeSearch& search, TimeLayout* time) {
    const std::size_t date = time->columns[0].column;
    for (const std::size_t column : search.columns) {
        const std::optional<TimeRole> role =
            column == date ? std::nullopt : ClockRole(search, column);
        if (!role)
            continue;
        time->columns.push_back({column, *role});
        const std::size_t next = column + 1;
        if (role == TimeRole::Hour && search.Contains(next) &&
            IsMinuteName(search.rows.Column(next).name) && search.IsUsable(next, TimeRole::Minute))
            time->columns.push_back({next, TimeRole::Minute});
        return;
    }
}

/// A column of zone names ("EST", "EDT") beside the time.
void AddZone(const TimeSearch& search, TimeLayout* time) {
    const std::size_t column = time->columns.back().column + 1;
    if (!search.Contains(column) || search.rows.Column(column).kind != ColumnKind::Text)
        return;
    TimeLayout probe = *time;
    probe.columns.push_back({column, TimeRole::Zone});
    if (FitTime(search.rows, probe).IsGood())
        *time = probe;
}

} // namespace

bool FindDateColumn(const TimeSearch& search, TimeLayout* time) {
    for (const std::size_t column : search.columns) {
        const bool isNumber = search.rows.Column(column).kind == ColumnKind::Number;
        const std::vector<DateForm> forms =
            isNumber ? FormsOfNumbers(search.rows, column) : FormsOfTexts(search.rows, column);
        if (forms.empty())
            continue;
        *time = DateLayout(column, forms[0]);
        time->rivals.assign(forms.begin() + 1, forms.end());
        if (FitTime(search.rows, *time).withClock == 0.0)
            AddClock(search, time);
        AddZone(search, time);
        return true;
    }
    return false;
}

} // namespace ryn
