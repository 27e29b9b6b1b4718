#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/status.h"
#include "netcdf/nc_type.h"

namespace ryn {

/// Classic formats that files are written in.
enum class NcFormat {
    Offset64, ///< CDF-2: each variable but the last below 4 GiB
    Data64,   ///< CDF-5
};

/// The older format, which more programs read, where the largest variable allows it.
NcFormat FormatForVariable(std::size_t largestVariableBytes);

/// Writes a netCDF file of a classic format over an existing one: dimensions, variables and
/// attributes first, values after EndDefinitions. The first failure stays and is reported by
/// Finish; what follows it does nothing.
class NcWriter {
  public:
    /// `path` is the file that is replaced; faults name `shownPath`.
    NcWriter(const std::string& path, std::string shownPath, NcFormat format);
    ~NcWriter();
    NcWriter(const NcWriter&) = delete;
    NcWriter& operator=(const NcWriter&) = delete;

    /// A length of 0 makes the dimension of records, of which there are none; a classic file can
    /// hold no other empty dimension.
    int DefineDimension(const std::string& name, std::size_t length);
    int DefineVariable(const std::string& name, NcType type, std::span<const int> dimensions);

    void PutText(int variable, const std::string& name, std::string_view text);
    void PutInt(int variable, const std::string& name, int value);
    void PutFloats(int variable, const std::string& name, std::span<const float> values);
    void PutDoubles(int variable, const std::string& name, std::span<const double> values);

    void EndDefinitions();
    void Write(int variable, std::span<const std::size_t> start, std::span<const std::size_t> count,
               const double* values);
    void Write(int variable, std::span<const std::size_t> start, std::span<const std::size_t> count,
               const float* values);
    bool Good() const { return status.IsOk(); }
    Status Finish();

  private:
    void Note(const std::string& place, int code);

    static constexpr int kClosed = -1;

    int handle = kClosed;
    std::string shown;
    Status status;
};

} // namespace ryn
