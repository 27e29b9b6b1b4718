#pragma once

#include <vector>

namespace ryn {

/// Tells the user, modally, which years an annual maximum series has no value for.
class MissingYearsPort {
  public:
    virtual ~MissingYearsPort() = default;
    virtual void ShowMissingYears(const std::vector<int>& years) = 0;
};

} // namespace ryn
