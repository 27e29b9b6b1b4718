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
        return true;
    }
    return false;
}

} // namespace ryn
