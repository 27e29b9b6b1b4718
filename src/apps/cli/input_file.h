#pragma once

#include <string>

#include "apps/cli/console.h"
#include "base/status.h"

namespace ryn::cli {

/// Whether a file can be read, before a store is asked to: a name that does not exist, or is no
/// regular file, is the user's fault; a file that the system does not give out is not.
Status TestReadable(const std::string& path);

/// Whether a file may be made under a name: one that exists is replaced only with consent, and what
/// is no regular file never.
Status TestReplaceable(const std::string& path, Consent consent);

enum class FileKind { DataFile, ParameterTree };

/// What a readable file is by its first bytes: a data file (netCDF or HDF5), else text.
FileKind KindOfFile(const std::string& path);

} // namespace ryn::cli
