#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <vector>

namespace ryn {

/// What a batch prints on its standard output; each text ends its line.
using PrintLine = std::function<void(const std::string&)>;

/// Points whose series are open at one time: 80 % of the limit of open files, and 1 at least.
int PointsInChunk();

/// Prints the line of one chunk of series files for each chunk of `chunkSize` points, the last one
/// with none remaining.
void PrintCreatedLines(const std::vector<bool>& active, int chunkSize, const PrintLine& print);
std::string CreatedLine(int created, int remaining);

/// Whole minutes of a span in days, rounded to the second first.
int WholeMinutes(double days);

/// The lines that tell how far the computation of the points has come: one at each 200th computed
/// point, left out where that point failed. Points may be computed in any order: which lines there
/// are, and their order, are those of computing them in point order, unless a line would have to
/// wait for its point longer than a minute.
class ComputationLines {
  public:
    /// Time counts from here. `print` may be empty.
    ComputationLines(const std::vector<bool>& active, PrintLine print);

    /// A point, by its number in point order, was computed.
    void Computed(int point, bool good);

  private:
    enum class Known : char { No, Good, Failed };

    void PrintSettled();
    double DaysSinceStart() const;

    PrintLine print;
    std::chrono::steady_clock::time_point start;
    int created = 0;
    int computed = 0;
    std::vector<int> milestones; ///< number of each 200th active point
    std::vector<Known> known;    ///< of each of them
    std::vector<double> elapsed; ///< days, of each line that is due
    std::size_t settled = 0;     ///< lines printed or left out
};

} // namespace ryn
