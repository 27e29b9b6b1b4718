#pragma once

#include <algorithm>
#include <memory>
#include <string>

#include "tsq/records.h"
#include "tsq/step_source.h"
#include "tsq/tsq.h"

namespace ryn {

/// Walks over the items of each time step. Only what is asked for is loaded.
class StepReader {
  public:
    StepReader(std::string path, const TsqHeader& header, std::unique_ptr<StepSource> source);

    void Rewind();
    /// The next item; nothing moves on failure.
    bool Next(double* time, float* values) {
        if (step >= count || (time != nullptr && !GiveTime(time)) ||
            (values != nullptr && !GiveValues(values)))
            return NoteFailure();
        if (++item == blocks.size()) {
            item = 0;
            ++step;
        }
        return true;
    }
    /// The steps from the current one on that are at hand of one item, up to the end of the shorter
    /// block of times and values; passes over them.
    bool NextBlock(std::size_t wanted, TsqBlock* block);
    /// Why Next or NextBlock failed.
    const Status& Failure() const { return failure; }
    Status CountMissing(std::size_t itemIndex, std::size_t* missing);

  private:
    bool GiveTime(double* time) {
        if (equidistantStep > 0.0) {
            *time = static_cast<double>(step) * equidistantStep;
            return true;
        }
        if (!times.Holds(step) && !LoadTimes())
            return false;
        *time = *times.At(step);
        return true;
    }
    bool GiveValues(float* values) {
        StepBlock<float>& block = blocks[item];
        if (!block.Holds(step) && !LoadValues(item))
            return false;
        const float* const from = block.At(step);
        *values = *from;
        if (block.width > 1)
            std::copy_n(from, block.width, values);
        return true;
    }
    bool FindBlock(std::size_t wanted, TsqBlock* found);
    bool LoadTimes();
    bool LoadValues(std::size_t wanted);
    bool NoteFailure();

    std::string path;
    std::unique_ptr<StepSource> source;
    std::size_t count;
    double equidistantStep; // 0 where the times are stored
    std::size_t step = 0;
    std::size_t item = 0;
    StepBlock<double> times;
    std::vector<StepBlock<float>> blocks; // of each item
    Status failure;
};

} // namespace ryn
