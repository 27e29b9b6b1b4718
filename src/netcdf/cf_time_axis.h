#pragma once

#include <cstdint>
#include <vector>

#include "base/status.h"
#include "netcdf/cf_time.h"
#include "netcdf/nc_file.h"

namespace ryn {

/// The variable with the times of a file's time axis; null when there is none. It has one dimension
/// (beside ones of length 1), is numeric, and its unit or its name, `axis` or `standard_name` says
/// that it is a time. A coordinate variable (named as its dimension) goes before others.
const NcVariable* FindTimeVariable(const NcFile& file);
/// The place in NcFile::Dimensions of the dimension along a time variable.
int TimeDimensionOf(const NcFile& file, const NcVariable& time);
/// The variable's unit and calendar; the fault names file and variable.
Status ReadCfTime(const NcFile& file, const NcVariable& time, CfTime* result);

/// Whether each step must lie behind the one before it.
enum class TimeOrder { Ascending, Any };

struct CfTimeAxis {
    CfTime time;
    std::vector<std::int64_t> milliseconds; ///< CfTime::Milliseconds of each step
};

/// Reads all times. Refused with a reason that names the step: a time that is missing, not finite
/// or outside the years 100 to 9999, one that does not ascend (when asked for), and more steps than
/// a file of its size can hold.
Status ReadCfTimeAxis(const NcFile& file, const NcVariable& time, TimeOrder order,
                      CfTimeAxis* axis);

} // namespace ryn
