#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "netcdf/nc_file.h"
#include "netcdf/nc_values.h"
#include "tsq/step_source.h"

namespace ryn {

/// How an item's numbers lie in its variable.
struct ItemColumn {
    const NcVariable* variable = nullptr;
    std::size_t timePlace = 0; ///< which of the variable's dimensions is the time
    std::size_t cells = 1;     ///< numbers in a step
    bool isStepwise = true;    ///< a step's numbers lie together, before those of the next
    bool isOurs = false;       ///< plain floats, none of which is missing
};

/// Where the times come from.
struct TimeColumn {
    const NcVariable* variable = nullptr; ///< of a file of ours: read block by block
    double start = 0.0;                   ///< what is taken off such times
    double millisecondsInUnit = 0.0;
    std::vector<double> seconds; ///< of other files: all of them, decoded
};

/// The numbers of a netCDF file in blocks.
class NetcdfSource : public StepSource {
  public:
    /// The columns point into the file's variables.
    NetcdfSource(std::shared_ptr<const NcFile> file, std::size_t steps, TimeColumn time,
                 std::vector<ItemColumn> items);

    Status LoadTimes(std::size_t step, StepBlock<double>* block) override;
    Status LoadValues(std::size_t item, std::size_t step, StepBlock<float>* block) override;
    Status CountMissing(std::size_t item, std::size_t* missing) override;

  private:
    Status ReadItem(std::size_t item, std::size_t step, std::size_t steps, float* values);
    std::size_t StepsAt(const ItemColumn& column, std::size_t step) const;

    std::shared_ptr<const NcFile> file;
    std::size_t count;
    TimeColumn time;
    std::vector<ItemColumn> items;
    std::vector<NcValues> decoders;
};

} // namespace ryn
