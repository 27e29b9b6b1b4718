#pragma once

#include <string>

#include "base/status.h"
#include "tsq/records.h"

namespace ryn {

/// Writes a data file over the existing file `path`; faults name `shownPath`. The same content
/// gives the same bytes.
Status EncodeNetcdf(const TsqContent& content, const std::string& path,
                    const std::string& shownPath);

/// Tests that coordinates that were set have the size of every plane.
Status CheckCoordinates(const std::string& path, const TsqHeader& header);

} // namespace ryn
