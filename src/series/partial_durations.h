#pragma once

#include <vector>

#include "series/selection_rules.h"
#include "series/sts_item.h"

namespace ryn {

struct PartialDurations {
    /// In time order; they point into the samples.
    std::vector<const STSItem*> selection;
    /// True when a selection by number found fewer peaks than asked for. `Threshold` and `AvgAnNum`
    /// are then those of the peaks found; otherwise those of the rules.
    bool fewerThanRequired = false;
    double Threshold = 0.0;
    double AvgAnNum = 0.0;
};

/// Selects the independent peaks above a threshold, or the largest independent peaks up to an
/// average annual number, and marks them.
///
/// Two peaks are independent when more than InterTime days lie between them and, where the level
/// criterion is on too, the lowest sample between them is below InterLevel times the smaller peak.
/// Without the time criterion every sample is a peak, in season or not. A value equal to the
/// threshold stays. Differences of dates within 1e-9 days (0.1 ms) of InterTime count as equal to
/// it: a date's day fraction is rounded, and 24 hours must not be "more than 1 day" by that alone.
///
/// Rules whose season is needed and invalid give nothing.
///
/// `samples` are in ascending time order with their marks at 0. Each pass is linear in their
/// number.
PartialDurations SelectPartialDurations(SampleArray& samples, const SelectionRules& rules);

} // namespace ryn
