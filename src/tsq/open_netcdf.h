#pragma once

#include <memory>
#include <string>

#include "netcdf/cf_time_axis.h"
#include "tsq/records.h"
#include "tsq/step_source.h"

namespace ryn {

/// Opens a netCDF file of ours or of another program: its description, and where its numbers come
/// from.
Status OpenNetcdf(const std::string& path, TimeOrder order, TsqHeader* header,
                  std::unique_ptr<StepSource>* source);

} // namespace ryn
