#pragma once

#include <span>
#include <string_view>

#include "stats/combination.h"

namespace ryn::selfcheck {

/// The series of the published cases, by their place in AllSeries().
enum class SeriesId { PortPirie, Floyd, Fishkill, Nile, Rain40, Rain30, Peaks38 };

struct ReferenceSeries {
    std::string_view name;
    std::string_view description;   ///< what was measured, where, and who published it
    stats::SeriesFrame frame;       ///< how it came from its record
    std::span<const double> values; ///< in time order
};

std::span<const ReferenceSeries> AllSeries();
const ReferenceSeries& SeriesOf(SeriesId id);

} // namespace ryn::selfcheck
