#pragma once

namespace ryn {

/// Progress of long work. Calls may come often; whoever shows them thins them out.
class ProgressPort {
  public:
    virtual ~ProgressPort() = default;
    /// `done` of `total`; a total of 0 or less when it is not known.
    virtual void ShowProgress(long long done, long long total) = 0;
};

} // namespace ryn
