#include "run/batch_lines.h"

#include <algorithm>
#include <utility>

#include "base/process_limits.h"
#include "strings/catalogue.h"

namespace ryn {

namespace {

constexpr int kPointsOfALine = 200;

} // namespace

int PointsInChunk() {
    return std::max(1, static_cast<int>(0.8 * LimitOfOpenFiles()));
}

std::string CreatedLine(int created, int remaining) {
    return FormatText(kTextGridCreated, created, remaining);
}

void PrintCreatedLines(const std::vector<bool>& active, int chunkSize, const PrintLine& print) {
    const auto points = static_cast<int>(active.size());
    int created = 0;
    for (int first = 0; first < points; first += chunkSize) {
        const int end = first + std::min(chunkSize, points - first);
        created += static_cast<int>(std::count(active.begin() + first, active.begin() + end, true));
        print(CreatedLine(created, points - end));
    }
}

int WholeMinutes(double days) {
    constexpr double kHalfSecond = 5.787037037037037e-6;
    return static_cast<int>((days + (days < 0.0 ? -kHalfSecond : kHalfSecond)) * 1440.0);
}

ComputationLines::ComputationLines(const std::vector<bool>& active, PrintLine printLine)
    : print(std::move(printLine)),
      start(std::chrono::steady_clock::now()) {
    for (std::size_t p = 0; p < active.size(); ++p)
        if (active[p] && ++created % kPointsOfALine == 0)
            milestones.push_back(static_cast<int>(p));
    known.resize(milestones.size(), Known::No);
}

void ComputationLines::Computed(int point, bool good) {
    const auto found = std::lower_bound(milestones.begin(), milestones.end(), point);
    if (found != milestones.end() && *found == point)
        known[static_cast<std::size_t>(found - milestones.begin())] =
            good ? Known::Good : Known::Failed;
    if (++computed % kPointsOfALine == 0)
        elapsed.push_back(DaysSinceStart());
    PrintSettled();
}

double ComputationLines::DaysSinceStart() const {
    using Days = std::chrono::duration<double, std::ratio<86400>>;
    return Days(std::chrono::steady_clock::now() - start).count();
}

// A line waits for its own point, which another part of the grid may hold, and for the lines before
// it; but not for long, since the log of a run of hours must not stay silent until its end.
void ComputationLines::PrintSettled() {
    constexpr double kPatience = 1.0 / 1440.0; // days
    const auto isSettled = [this](std::size_t line) {
        return known[line] != Known::No || DaysSinceStart() - elapsed[line] > kPatience;
    };
    for (; settled < elapsed.size() && isSettled(settled); ++settled) {
        if (known[settled] == Known::Failed || !print)
            continue;
        const int count = static_cast<int>(settled + 1) * kPointsOfALine;
        const double remaining = elapsed[settled] * (created - count) / count;
        print(FormatText(kTextGridComputed, count, WholeMinutes(elapsed[settled]),
                         WholeMinutes(remaining)));
    }
}

} // namespace ryn
