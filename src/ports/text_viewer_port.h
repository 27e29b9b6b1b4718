#pragma once

#include <string>

namespace ryn {

/// Shows a text file beside the program.
class TextViewerPort {
  public:
    virtual ~TextViewerPort() = default;
    /// Starts a viewer on the file, which need not exist, and does not wait for it.
    virtual void ViewTextFile(const std::string& path) = 0;
};

} // namespace ryn
