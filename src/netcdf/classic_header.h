#pragma once

#include <string>

#include "base/status.h"

namespace ryn {

/// What a file's first bytes say that it is.
enum class NcContainer {
    Classic, ///< CDF-1, CDF-2 or CDF-5
    Hdf5,    ///< netCDF-4
};

/// Judges an open regular file before the C library sees it. Of a classic file the whole header is
/// walked: every count is tested against the bytes that are there, and every variable must end
/// within the file, since the library reads what is cut off as zeros. Anything that is neither is
/// refused, so that the library does not try its other formats on it.
///
/// The format is that of "The NetCDF Classic Format Specification" (Unidata).
Status CheckContainer(int descriptor, const std::string& path, NcContainer* container);

} // namespace ryn
