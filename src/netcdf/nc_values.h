#pragma once

#include <cstddef>
#include <span>
#include <vector>

#include "base/status.h"
#include "netcdf/nc_file.h"

namespace ryn {

/// The values of one variable as CF means them: unpacked (`scale_factor`, `add_offset`,
/// `_Unsigned`), and NaN where they are missing: equal to `_FillValue` or to a `missing_value`, not
/// finite, or, in a variable without `_FillValue`, equal to the library's default fill of its type.
class NcValues {
  public:
    NcValues() = default;
    /// Both must live as long as the object.
    NcValues(const NcFile* file, const NcVariable* variable);

    /// Reads a block, one start and count for each dimension, as 32-bit floats. A number beyond
    /// their range counts as missing.
    Status Read(std::span<const std::size_t> start, std::span<const std::size_t> count,
                float* values);
    /// What stands for a missing value, as it stands in the file, the default fill included.
    std::span<const double> MissingMarks() const& { return marks; }
    std::span<const double> MissingMarks() const&& = delete;
    /// True when the values are floats that stand in the file as they are and none is marked.
    bool IsPlain() const { return isPlain; }

  private:
    void ReadMarks();
    Status ReadFloats(std::span<const std::size_t> start, std::span<const std::size_t> count,
                      std::size_t size, float* values) const;
    float Decode(double raw) const;

    const NcFile* file = nullptr;
    const NcVariable* variable = nullptr;
    double scale = 1.0;
    double offset = 0.0;
    double wrap = 0.0; // added to negative numbers of a type that stands for an unsigned one
    bool isPlain = true;
    std::vector<double> marks; // as they stand in the file
    std::vector<double> block;
};

} // namespace ryn
