#pragma once

#include <chrono>

#include "apps/cli/console.h"
#include "ports/progress_port.h"

namespace ryn::cli {

/// A terminal's line that shows how many points of a batch are done, how fast they go and how long
/// the rest will take; nothing where standard error is no terminal.
class GridProgress final : public ProgressPort {
  public:
    explicit GridProgress(Console& shownOn);
    ~GridProgress() override;
    GridProgress(const GridProgress&) = delete;
    GridProgress& operator=(const GridProgress&) = delete;

    void ShowProgress(long long done, long long total) override;
    /// Takes the line away, before something else is written there.
    void Clear();

  private:
    using Clock = std::chrono::steady_clock;

    Console& console;
    Clock::time_point start;
    Clock::time_point shown;
    std::size_t width = 0; ///< of the line that stands
};

} // namespace ryn::cli
