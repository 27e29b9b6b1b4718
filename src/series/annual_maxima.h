#pragma once

#include <vector>

#include "series/selection_rules.h"
#include "series/sts_item.h"

namespace ryn {

struct AnnualMaxima {
    /// One for each year or season with samples, in time order; they point into the samples.
    std::vector<const STSItem*> selection;
    /// Years that the walk passed over on its way from one sample in season to the next.
    std::vector<int> missingYears;
};

/// Selects the largest sample of each year, or of each season, and marks it. Of equal maxima the
/// earliest stands. A year begins at midnight of AmsStartDate's day and is named by the calendar
/// year in which it begins. A series with a single sample in season gives nothing, and so do rules
/// whose dates are invalid.
///
/// `samples` are in ascending time order with their marks at 0. Time is linear in their number.
AnnualMaxima SelectAnnualMaxima(SampleArray& samples, const SelectionRules& rules);

} // namespace ryn
