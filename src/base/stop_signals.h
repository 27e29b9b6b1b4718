#pragma once

#include <array>
#include <csignal>
#include <cstddef>

namespace ryn {

/// While it lives, SIGINT, SIGTERM and SIGHUP end nothing but are remembered, for work that leaves
/// files behind unless it comes to its own end. A signal that the process ignores stays ignored.
/// One object at a time.
class StopSignals {
  public:
    StopSignals();
    /// Puts back what the signals did before.
    ~StopSignals();
    StopSignals(const StopSignals&) = delete;
    StopSignals& operator=(const StopSignals&) = delete;

    /// The first signal that came since the object was made; 0 for none.
    static int Caught();

  private:
    static constexpr std::size_t kCount = 3;
    std::array<struct sigaction, kCount> before{};
};

/// Ends the process by a signal, as if it had never been held back.
void EndBySignal(int signal);

} // namespace ryn
