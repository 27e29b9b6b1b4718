#pragma once

#include <string>

namespace ryn {

/// The list of recently used parameter files.
class RecentFilesPort {
  public:
    virtual ~RecentFilesPort() = default;
    virtual void AddRecentFile(const std::string& path) = 0;
};

} // namespace ryn
