#include "apps/cli/grid_progress.h"

#include <algorithm>
#include <cmath>
#include <ostream>
#include <string>

#include "strings/catalogue.h"

namespace ryn::cli {

namespace {

std::string ClockText(double seconds) {
    const auto whole = static_cast<long long>(std::lround(std::min(seconds, 1e9)));
    return fmt::sprintf("%d:%02d:%02d", whole / 3600, whole / 60 % 60, whole % 60);
}

} // namespace

GridProgress::GridProgress(Console& shownOn)
    : console(shownOn),
      start(Clock::now()),
      shown(start) {}

GridProgress::~GridProgress() {
    Clear();
}

void GridProgress::ShowProgress(long long done, long long total) {
    constexpr std::chrono::milliseconds kInterval(500);
    const auto now = Clock::now();
    if (!console.errIsTerminal || done <= 0 || now - shown < kInterval)
        return;
    shown = now;
    const double elapsed = std::chrono::duration<double>(now - start).count();
    const double rate = static_cast<double>(done) / elapsed;
    std::string line = FormatText(kTextCliGridProgress, done, total, rate,
                                  ClockText(static_cast<double>(total - done) / rate));
    const std::size_t size = line.size();
    line.append(width > size ? width - size : 0, ' '); // over what the last line left
    width = size;
    console.err << '\r' << line << std::flush;
}

void GridProgress::Clear() {
    if (width > 0)
        console.err << '\r' << std::string(width, ' ') << '\r' << std::flush;
    width = 0;
}

} // namespace ryn::cli
