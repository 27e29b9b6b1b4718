#pragma once

#include <memory>
#include <string>

#include "base/atomic_file.h"
#include "tsq/records.h"

namespace ryn {

/// Gathers the time steps of a file being written; Finish makes the file of them.
class StepWriter {
  public:
    /// For a file on disk, which is made under a temporary name beside `path` at once. A path in a
    /// memory directory touches no disk.
    static Status Create(const std::string& path, const TsqHeader& header,
                         std::unique_ptr<StepWriter>* writer);

    /// Appends the next item of the current step. A failure stays, since a file that lacks a step
    /// must not take its name.
    bool Append(double time, const float* values);
    /// The same for `size` whole steps of a file with one item without spatial dimensions; `times`
    /// is not looked at on an equidistant axis.
    bool AppendSteps(const double* times, const float* values, std::size_t size);
    const Status& Failure() const { return failure; }
    Status Finish();

  private:
    bool AppendTime(double time);
    bool AppendTimes(const double* times, std::size_t size);
    void AppendPlane(const TsqItem& item, const float* values);
    bool Fail(const std::string& reason);
    void CompleteAxis();

    std::string path;
    bool isInMemory = false;
    AtomicFile target;
    TsqContent content;
    double millisecondsInUnit = 0.0;
    std::size_t item = 0;
    std::size_t count = 0; // whole steps
    Status failure;
};

} // namespace ryn
