#pragma once

#include <cstddef>
#include <string>

#include "base/status.h"

namespace ryn {

/// True when the name can be opened for reading and is no directory.
bool CanOpenForReading(const std::string& path);

/// Opens a file for writing, which makes it or empties it, and closes it.
Status EmptyFile(const std::string& path);

/// True when both names lead to the same file on disk; false when either does not exist.
bool IsSameFile(const std::string& a, const std::string& b);

/// Reads a whole file of at most `limit` bytes. A directory, a file that cannot be read and a
/// larger one are faults.
Status ReadWholeFile(const std::string& path, std::size_t limit, std::string* content);

/// The current directory set to `directory` for the life of the object, then set back.
class CurrentDirectoryScope {
  public:
    explicit CurrentDirectoryScope(const std::string& directory);
    ~CurrentDirectoryScope();
    CurrentDirectoryScope(const CurrentDirectoryScope&) = delete;
    CurrentDirectoryScope& operator=(const CurrentDirectoryScope&) = delete;

  private:
    std::string previous;
};

/// Sets the process's current directory; an empty name does nothing.
Status SetCurrentDirectory(const std::string& directory);

} // namespace ryn
