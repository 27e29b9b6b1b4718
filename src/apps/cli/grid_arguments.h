#pragma once

#include <optional>
#include <string>

#include "base/status.h"
#include "params/tsq2_input_kvf.h"

namespace ryn::cli {

/// What `new` takes of a grid: the file, the item, the part of it, and the file of results.
struct GridArguments {
    std::optional<std::string> grid;
    std::optional<int> item;
    std::optional<std::string> x; ///< "first:last:step" or "first:last", places from 0
    std::optional<std::string> y;
    std::optional<std::string> time; ///< "first:last", steps from 0
    std::optional<std::string> output;
};

/// Fills section Tsq2Input. The grid is opened: what is not given is the whole axis, and what is
/// given must be there. Files count from `callerDirectory`, but for the
/// absolute `caseFile`, which the results may not take the place of. Nothing happens without any of
/// the options. After a fault, one line that names the option, the section is to be thrown away.
Status ApplyGridArguments(const GridArguments& arguments, const std::string& callerDirectory,
                          const std::string& caseFile, CTsq2InputKvf& input);

} // namespace ryn::cli
