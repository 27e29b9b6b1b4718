#pragma once

#include "base/ole_date_time.h"

namespace ryn {

inline constexpr int kSelectAnnualMaxima = 0;
inline constexpr int kSelectPartialDurations = 1;
inline constexpr int kPartialDurationsByThreshold = 0;
inline constexpr int kPartialDurationsByNumber = 1;

/// How extremes are selected from a series. Members are named as their keywords in the parameter
/// file. Of the three dates only month and day count; 29 February is taken as 1 March in a common
/// year.
struct SelectionRules {
    int SelectionMethod = kSelectAnnualMaxima;
    int PdsDataType = kPartialDurationsByThreshold;
    bool IncludeSeasonalAnalysis = false; ///< only samples inside the season count
    bool InterTimeSpecified = true;       ///< events are separated by time
    bool InterLevelSpecified = true;      ///< and by the level between them
    double Threshold = 0.0;               ///< in the item's unit
    double AvgAnNum = 0.0;                ///< average annual number of exceedances
    double InterTime = 1.0;               ///< days
    double InterLevel = 0.5;              ///< fraction of the smaller of two peaks, 0 to 1
    double RecordLength = 0.0;            ///< years, as the user gave it
    COleDateTime AmsStartDate{1990, 1, 1, 0, 0, 0};
    COleDateTime SeasonalStartDate{1990, 1, 1, 0, 0, 0};
    COleDateTime SeasonalEndDate{1990, 1, 1, 0, 0, 0};
};

/// Whether the dates that a selection by these rules goes by are valid ones.
inline bool NeededDatesAreValid(const SelectionRules& rules) {
    const bool byYear = rules.SelectionMethod != kSelectPartialDurations;
    if (!rules.IncludeSeasonalAnalysis)
        return !byYear || rules.AmsStartDate.IsValid();
    // Without the time criterion a partial duration series takes samples in season or not.
    return (!byYear && !rules.InterTimeSpecified) ||
           (rules.SeasonalStartDate.IsValid() && rules.SeasonalEndDate.IsValid());
}

} // namespace ryn
