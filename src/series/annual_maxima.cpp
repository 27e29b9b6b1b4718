#include "series/annual_maxima.h"

#include <algorithm>
#include <optional>

#include "series/season.h"

namespace ryn {

namespace {

constexpr int kLastYear = 9999;

/// The current year or season of the walk.
class Period {
  public:
    Period(const SelectionRules& rules, int baseYear)
        : season(rules.IncludeSeasonalAnalysis
                     ? std::optional<Season>(Season(rules.SeasonalStartDate, rules.SeasonalEndDate))
                     : std::nullopt),
          yearStart(MonthDay::Of(rules.AmsStartDate)) {
        MoveTo(baseYear);
    }

    int Year() const { return year; }
    /// Whether a sample takes part at all.
    bool Admits(const COleDateTime& date) {
        return season ? season->Holds(date) : !IsClearlyBefore(date, start);
    }
    bool Holds(const COleDateTime& date) const {
        return date >= start && IsClearlyBefore(date, end);
    }
    /// Whether both are certain at a glance: away from the edges of a year without a season. Most
    /// samples of a long series lie so.
    bool SurelyHolds(const COleDateTime& date) const {
        return !season && date.LinearCount() > start.LinearCount() &&
               date.LinearCount() < end.LinearCount() - 2.0 * COleDateTime::kHalfSecond;
    }
    void MoveTo(int newYear) {
        year = newYear;
        if (!season) {
            start = yearStart.MidnightIn(year);
            end = yearStart.MidnightIn(year + 1);
            return;
        }
        start = season->Start().MidnightIn(year);
        end = season->Wraps() ? season->End().MidnightIn(year + 1)
                              : season->End().MidnightIn(year) + COleDateTimeSpan(1.0);
        if (!end.IsValid()) // behind the calendar's last day
            end = MonthDay().MidnightIn(year + 1);
    }

  private:
    std::optional<Season> season;
    MonthDay yearStart;
    int year = 0;
    COleDateTime start;
    COleDateTime end;
};

/// Moves the period on to the one that holds the date. The first move of a run only reaches the
/// next year; each further one passes over a year without a sample.
void MovePeriod(Period& period, const COleDateTime& date, std::vector<int>& missingYears) {
    int moves = 0;
    while (!period.Holds(date) && period.Year() < kLastYear) {
        if (++moves > 1)
            missingYears.push_back(period.Year());
        period.MoveTo(period.Year() + 1);
    }
}

void Mark(STSItem& sample, std::vector<const STSItem*>& selection) {
    if (sample.selected == 0)
        selection.push_back(&sample);
    sample.selected = 1;
}

} // namespace

AnnualMaxima SelectAnnualMaxima(SampleArray& samples, const SelectionRules& rules) {
    AnnualMaxima result;
    if (samples.empty() || !NeededDatesAreValid(rules))
        return result;
    Period period(rules, samples.front().date.GetYear() - 1);
    STSItem* best = &samples.front();
    const STSItem* current = nullptr;
    const STSItem* previous = nullptr;
    for (STSItem& sample : samples) {
        const bool isHeld = period.SurelyHolds(sample.date);
        if (!isHeld && !period.Admits(sample.date))
            continue;
        previous = current;
        current = &sample;
        if (isHeld || period.Holds(sample.date)) {
            if (sample.value > best->value)
                best = &sample;
            continue;
        }
        MovePeriod(period, sample.date, result.missingYears);
        if (previous != nullptr)
            Mark(*best, result.selection);
        best = &sample;
    }
    if (previous != nullptr)
        Mark(*best, result.selection);
    // In file order, which the walk has already where the dates ascend.
    std::sort(result.selection.begin(), result.selection.end());
    return result;
}

} // namespace ryn
