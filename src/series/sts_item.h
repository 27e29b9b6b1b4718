#pragma once

#include <vector>

#include "base/ole_date_time.h"

namespace ryn {

/// One sample of a series.
struct STSItem {
    COleDateTime date;
    double value = 0.0; ///< in the item's unit, widened from the file's 32-bit float
    int selected = 0;   ///< 0 or 1: the selection's working mark, 0 after reading
};

/// The samples of a series in file order.
using SampleArray = std::vector<STSItem>;

} // namespace ryn
