#include "series/partial_durations.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>
#include <optional>

#include "series/season.h"

namespace ryn {

namespace {

constexpr double kDateTolerance = 1e-9; // days
constexpr double kHighest = std::numeric_limits<double>::max();

/// Marks independent peaks in two passes and a third by level.
class PeakMarker {
  public:
    PeakMarker(SampleArray& series, const SelectionRules& selectionRules)
        : samples(series),
          rules(selectionRules) {
        if (rules.IncludeSeasonalAnalysis)
            season.emplace(rules.SeasonalStartDate, rules.SeasonalEndDate);
    }

    void MarkForward();
    void UnmarkBackward();
    void UnmarkByLevel();

  private:
    using Index = std::ptrdiff_t;
    static constexpr Index kNone = -1;

    Index Count() const { return static_cast<Index>(samples.size()); }
    STSItem& At(Index i) { return samples[static_cast<std::size_t>(i)]; }
    double Value(Index i) { return At(i).value; }
    bool IsInSeason(Index i) { return !season || season->Holds(At(i).date); }
    double Days(Index earlier, Index later) {
        return (At(later).date - At(earlier).date).GetTotalDays();
    }
    bool AreFarApart(Index earlier, Index later) {
        return Days(earlier, later) > rules.InterTime + kDateTolerance;
    }
    bool AreClose(Index earlier, Index later) {
        return Days(earlier, later) < rules.InterTime - kDateTolerance;
    }
    bool PassesPeakForward(Index i);
    bool TakesOverBackward(Index j);
    bool AreIndependent(Index earlier, Index later, double trough);

    SampleArray& samples;
    const SelectionRules& rules;
    std::optional<Season> season;
};

/// Whether a higher sample becomes the peak of the running event. A next sample close by that is at
/// least as high keeps it from that: the peak moves on to it or past it.
bool PeakMarker::PassesPeakForward(Index i) {
    return i + 1 == Count() || !AreClose(i, i + 1) || Value(i) > Value(i + 1);
}

void PeakMarker::MarkForward() {
    Index last = kNone;
    for (Index i = 0; i < Count(); ++i) {
        if (!IsInSeason(i))
            continue;
        if (last != kNone && AreFarApart(last, i)) {
            At(last).selected = 1;
            last = i;
        } else if (last == kNone || (Value(i) > Value(last) && PassesPeakForward(i))) {
            last = i;
        }
    }
    if (last != kNone) // none: no sample is in season
        At(last).selected = 1;
}

bool PeakMarker::TakesOverBackward(Index j) {
    return j == 0 || !AreClose(j - 1, j) || Value(j) > Value(j - 1);
}

void PeakMarker::UnmarkBackward() {
    Index last = kNone;
    for (Index j = Count() - 1; j >= 0; --j) {
        if (!IsInSeason(j))
            continue;
        if (last == kNone || AreFarApart(j, last)) {
            last = j;
        } else if (Value(j) > Value(last)) {
            if (TakesOverBackward(j)) {
                At(last).selected = 0;
                last = j;
            }
        } else if (Value(j) == Value(last) && At(j).selected != 0) {
            At(last).selected = 0; // of two equal peaks the earlier one stays
            last = j;
        } else {
            At(j).selected = 0;
        }
    }
}

bool PeakMarker::AreIndependent(Index earlier, Index later, double trough) {
    if (!AreFarApart(earlier, later))
        return false;
    return !rules.InterLevelSpecified ||
           rules.InterLevel * std::min(Value(earlier), Value(later)) > trough;
}

void PeakMarker::UnmarkByLevel() {
    Index last = 0;
    while (last < Count() && At(last).selected == 0)
        ++last;
    double trough = kHighest;
    for (Index k = last + 1; k < Count(); ++k) {
        if (At(k).selected == 0) {
            trough = std::min(trough, Value(k));
            continue;
        }
        if (AreIndependent(last, k, trough)) {
            last = k;
        } else if (Value(last) > Value(k)) {
            At(k).selected = 0;
        } else { // of two equal peaks the later one stays
            At(last).selected = 0;
            last = k;
        }
        trough = kHighest;
    }
}

void MarkPeaks(SampleArray& samples, const SelectionRules& rules) {
    if (!rules.InterTimeSpecified) {
        for (STSItem& sample : samples)
            sample.selected = 1;
        return;
    }
    PeakMarker marker(samples, rules);
    marker.MarkForward();
    marker.UnmarkBackward();
    marker.UnmarkByLevel();
}

std::vector<const STSItem*> Marked(const SampleArray& samples) {
    std::vector<const STSItem*> marked;
    for (const STSItem& sample : samples)
        if (sample.selected != 0)
            marked.push_back(&sample);
    return marked;
}

/// NaN sorts below every number, so that the order stays a strict one.
double SortKey(const STSItem& sample) {
    return std::isnan(sample.value) ? -std::numeric_limits<double>::infinity() : sample.value;
}

/// By date, and of equal dates by the place in the series.
bool IsEarlier(const STSItem* a, const STSItem* b) {
    const double first = a->date.LinearCount();
    const double second = b->date.LinearCount();
    return first != second ? first < second : a < b;
}

/// The number of peaks asked for, cut to an integer. A product a hair below one (0.29 x 100) counts
/// as that integer.
double RequiredNumber(const SelectionRules& rules) {
    const double number = std::trunc(rules.AvgAnNum * rules.RecordLength + 1e-9);
    return number > 0.0 ? number : 0.0; // 0 for NaN too
}

void KeepLargest(const SelectionRules& rules, PartialDurations* result) {
    std::vector<const STSItem*>& selection = result->selection;
    // Stable: of equal values the earlier samples stay.
    std::stable_sort(selection.begin(), selection.end(),
                     [](const STSItem* a, const STSItem* b) { return SortKey(*a) > SortKey(*b); });
    const double required = RequiredNumber(rules);
    const auto found = static_cast<double>(selection.size());
    if (found < required) {
        result->fewerThanRequired = true;
        result->AvgAnNum = found / rules.RecordLength;
        if (!selection.empty())
            result->Threshold = selection.back()->value;
    } else {
        selection.resize(static_cast<std::size_t>(required));
    }
    std::sort(selection.begin(), selection.end(), IsEarlier);
}

} // namespace

PartialDurations SelectPartialDurations(SampleArray& samples, const SelectionRules& rules) {
    PartialDurations result;
    result.Threshold = rules.Threshold;
    result.AvgAnNum = rules.AvgAnNum;
    if (!NeededDatesAreValid(rules))
        return result;
    MarkPeaks(samples, rules);
    if (rules.PdsDataType == kPartialDurationsByThreshold) {
        for (STSItem& sample : samples)
            if (sample.value < rules.Threshold)
                sample.selected = 0;
        result.selection = Marked(samples);
    } else {
        result.selection = Marked(samples);
        KeepLargest(rules, &result);
    }
    return result;
}

} // namespace ryn
