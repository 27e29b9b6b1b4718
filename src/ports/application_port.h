#pragma once

#include <string>

namespace ryn {

/// The running application.
class ApplicationPort {
  public:
    virtual ~ApplicationPort() = default;
    /// Its name, which series files carry.
    virtual std::string ApplicationName() = 0;
};

} // namespace ryn
