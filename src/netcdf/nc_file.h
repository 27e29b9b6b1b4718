#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "base/status.h"
#include "netcdf/classic_header.h"
#include "netcdf/nc_type.h"

namespace ryn {

struct NcDimension {
    std::string name;
    std::size_t length = 0;
};

struct NcVariable {
    int id = 0; ///< also its place in NcFile::Variables
    std::string name;
    NcType type = NcType::Float;
    std::vector<int> dimensions; ///< places in NcFile::Dimensions, slowest first
};

/// Stands for the file where an attribute's variable is asked for.
inline constexpr int kNcGlobal = -1;

/// How a file is going to be read; only the speed depends on it.
enum class NcRuns {
    Long, ///< whole variables
    Short ///< a part of each of many steps
};

/// A netCDF file open for reading: classic, CDF-5 or netCDF-4, of which the root group is seen.
/// What a file says is checked against its size as far as the format allows (CheckContainer).
class NcFile {
  public:
    NcFile() = default;
    ~NcFile();
    NcFile(NcFile&& other) noexcept;
    NcFile& operator=(NcFile&& other) noexcept;

    /// Refused with a reason: no regular file, no netCDF file, a cut file, counts that lie.
    static Status Open(const std::string& path, NcFile* file, NcRuns runs = NcRuns::Long);

    const std::string& Path() const { return path; }
    NcContainer Container() const { return container; }
    std::uint64_t FileSize() const { return fileSize; }
    const std::vector<NcDimension>& Dimensions() const { return dimensions; }
    const std::vector<NcVariable>& Variables() const { return variables; }
    /// Null when there is none.
    const NcVariable* FindVariable(const std::string& name) const;
    const NcDimension& DimensionOf(const NcVariable& variable, std::size_t place) const {
        return dimensions[static_cast<std::size_t>(variable.dimensions[place])];
    }

    /// A text attribute without trailing NULs; nothing when there is none, it is no text, or it is
    /// longer than 64 KiB.
    std::optional<std::string> Text(int variable, const std::string& name) const;
    /// A numeric attribute's values; nothing when there is none, it is no number, or it has more
    /// than 1024 of them.
    std::optional<std::vector<double>> Numbers(int variable, const std::string& name) const;
    /// Its only value.
    std::optional<double> Number(int variable, const std::string& name) const;

    /// The lengths of a chunk of a netCDF-4 variable that is stored in chunks, one for each
    /// dimension; empty for a variable that lies in the file as it is.
    std::vector<std::size_t> ChunkShape(const NcVariable& variable) const;

    /// Reads a block of a numeric variable, one start and count for each dimension. The values are
    /// those of the file: neither scaled nor tested for being missing (NcValues does both).
    Status Read(const NcVariable& variable, std::span<const std::size_t> start,
                std::span<const std::size_t> count, double* values) const;
    Status Read(const NcVariable& variable, std::span<const std::size_t> start,
                std::span<const std::size_t> count, float* values) const;

    /// A fault that names the file and, where given, the variable.
    Status InputFault(const std::string& reason) const;
    Status InputFault(const NcVariable& variable, const std::string& reason) const;

  private:
    Status ReadLayout();
    Status ReadDimensions();
    Status ReadVariable(int id);
    void Close();

    static constexpr int kClosed = -1;

    int handle = kClosed;
    std::string path;
    NcContainer container = NcContainer::Classic;
    std::uint64_t fileSize = 0;
    std::vector<NcDimension> dimensions;
    std::vector<NcVariable> variables;
};

} // namespace ryn
